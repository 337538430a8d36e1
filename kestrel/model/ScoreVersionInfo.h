// The interface of a model's version text.

#ifndef KESTREL_MODEL_SCOREVERSIONINFO_H
#define KESTREL_MODEL_SCOREVERSIONINFO_H

#include <string>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// The version of the format that a model was written in.
class KESTREL_API ScoreVersionInfo {
 public:
  virtual ~ScoreVersionInfo();

  virtual void SetVersionInfo(const std::string& version) = 0;

  /// A new copy that the caller owns.
  virtual ScoreVersionInfo* Clone() const = 0;

  /// True when the texts are the same, byte for byte.
  virtual bool operator==(const ScoreVersionInfo& other) const = 0;

  virtual const std::string& GetVersionInfo() const = 0;

 protected:
  ScoreVersionInfo() = default;
  ScoreVersionInfo(const ScoreVersionInfo&) = default;
  ScoreVersionInfo& operator=(const ScoreVersionInfo&) = default;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_MODEL_SCOREVERSIONINFO_H
