#include "kestrel/foundation/ExtNameStr.h"

#include <filesystem>
#include <system_error>

#include "kestrel/foundation/TextConverter.h"
#include "kestrel/foundation/Utf8Text.h"
#include "kestrel/platform/Environment.h"

namespace MCXML_800 {

namespace {

/// Null stands for UTF-8, and so for the name as it is held.
UConverter* SystemConverter() {
  return MCKestrel_800::NarrowTextIsUtf8ByDefault() ? nullptr : ProcessCodePageConverter();
}

/// UTF-8 text in the converter's encoding. What is UTF-8 already is not looked at: on Linux a name may be any
/// bytes.
int FromUtf8(UConverter* converter, const std::string& utf8, std::string& out) {
  if (IsUtf8(converter)) {
    out = utf8;
    return kVEXAMBOk;
  }
  return VEXAMBU8ToCodePage(converter, utf8, out);
}

int ToUtf8(UConverter* converter, const std::string& text, std::string& out) {
  if (IsUtf8(converter)) {
    out = text;
    return kVEXAMBOk;
  }
  return VEXAMBGenericToU8(converter, text, out);
}

}  // namespace

ExtNameStr::ExtNameStr() = default;
ExtNameStr::ExtNameStr(const char* utf8Name) : name_(utf8Name == nullptr ? "" : utf8Name) {}
ExtNameStr::ExtNameStr(const std::string& utf8Name) : name_(utf8Name) {}
ExtNameStr::ExtNameStr(const ExtNameStr&) = default;
ExtNameStr::ExtNameStr(ExtNameStr&&) noexcept = default;
ExtNameStr& ExtNameStr::operator=(const ExtNameStr&) = default;
ExtNameStr& ExtNameStr::operator=(ExtNameStr&&) noexcept = default;
ExtNameStr::~ExtNameStr() = default;

ExtNameStr ExtNameStr::FromCP(const std::string& name) {
  ExtNameStr made;
  made.error_ = ToUtf8(ProcessCodePageConverter(), name, made.name_);
  return made;
}

ExtNameStr ExtNameStr::FromSystem(const std::string& name) {
  ExtNameStr made;
  made.error_ = ToUtf8(SystemConverter(), name, made.name_);
  return made;
}

ExtNameStr ExtNameStr::FromU16(const std::u16string& name) {
  ExtNameStr made;
  made.error_ = AppendUtf16AsUtf8(name.data(), name.size(), made.name_) ? kVEXAMBOk : kVEXAMBSubstituted;
  return made;
}

ExtNameStr ExtNameStr::FromU16(const VEXAMBU16String& name) {
  return FromU16(std::u16string(name.begin(), name.end()));
}

ExtNameStr ExtNameStr::FromGeneric(const std::string& name) {
  ExtNameStr made;
  made.error_ = ToUtf8(DefaultConverter(), name, made.name_);
  return made;
}

std::string ExtNameStr::GetU8() const {
  error_ = kVEXAMBOk;
  return name_;
}
std::string ExtNameStr::GetCP() const {
  GetCPZ();
  return cp_;
}
std::string ExtNameStr::GetSystem() const {
  GetSystemZ();
  return system_;
}
VEXAMBU16String ExtNameStr::GetU16() const {
  GetU16Z();
  return u16_;
}

const char* ExtNameStr::GetU8Z() const {
  error_ = kVEXAMBOk;
  return name_.c_str();
}
const char* ExtNameStr::GetCPZ() const {
  error_ = FromUtf8(ProcessCodePageConverter(), name_, cp_);
  return cp_.c_str();
}
const char* ExtNameStr::GetSystemZ() const {
  error_ = FromUtf8(SystemConverter(), name_, system_);
  return system_.c_str();
}
const unsigned short* ExtNameStr::GetU16Z() const {
  std::u16string wide;
  error_ = AppendUtf8AsUtf16(name_.data(), name_.size(), wide) ? kVEXAMBOk : kVEXAMBSubstituted;
  u16_.assign(wide.begin(), wide.end());
  return u16_.c_str();
}
const char* ExtNameStr::GetGenericZ() const {
  error_ = FromUtf8(DefaultConverter(), name_, generic_);
  return generic_.c_str();
}

bool ExtNameStr::Open(std::ifstream& in, std::ios::openmode mode) const {
  if (in.is_open()) in.close();
  in.clear();
  if (name_.find('\0') != std::string::npos) {
    in.setstate(std::ios::failbit);
    return false;
  }
  try {
    in.open(std::filesystem::u8path(name_), mode);
  } catch (const std::system_error&) {
    // Windows cannot make a name of its own from text that is no UTF-8.
    in.setstate(std::ios::failbit);
  }
  return in.is_open();
}

}  // namespace MCXML_800
