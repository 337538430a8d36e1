// A version text that models carry.

#ifndef KESTREL_MODEL_VERSIONINFO_H
#define KESTREL_MODEL_VERSIONINFO_H

#include <string>

#include "kestrel/model/ScoreVersionInfo.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// The version as a plain text, "2.1" unless another one is given.
class KESTREL_API VersionInfo : public ScoreVersionInfo {
 public:
  VersionInfo();
  explicit VersionInfo(const std::string& version);
  VersionInfo(const VersionInfo& other);
  VersionInfo& operator=(const VersionInfo& other);
  ~VersionInfo() override;

  void SetVersionInfo(const std::string& version) override;
  ScoreVersionInfo* Clone() const override;
  bool operator==(const ScoreVersionInfo& other) const override;
  /// The same for a pointer as models hand it out; null is unequal.
  bool operator==(const ScoreVersionInfo* other) const;
  const std::string& GetVersionInfo() const override;

 private:
  std::string version_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_MODEL_VERSIONINFO_H
