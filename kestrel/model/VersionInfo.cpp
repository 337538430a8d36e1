#include "kestrel/model/VersionInfo.h"

namespace MCKestrel_800 {

VersionInfo::VersionInfo() : version_("2.1") {}
VersionInfo::VersionInfo(const std::string& version) : version_(version) {}
VersionInfo::VersionInfo(const VersionInfo& other) = default;
VersionInfo& VersionInfo::operator=(const VersionInfo& other) = default;
VersionInfo::~VersionInfo() = default;

void VersionInfo::SetVersionInfo(const std::string& version) {
  version_ = version;
}

ScoreVersionInfo* VersionInfo::Clone() const {
  return new VersionInfo(*this);
}

bool VersionInfo::operator==(const ScoreVersionInfo& other) const {
  return version_ == other.GetVersionInfo();
}

bool VersionInfo::operator==(const ScoreVersionInfo* other) const {
  return other != nullptr && *this == *other;
}

const std::string& VersionInfo::GetVersionInfo() const {
  return version_;
}

}  // namespace MCKestrel_800
