// Summary statistics of a variable.

#ifndef KESTREL_DICTIONARY_SCOREVARSTATS_H
#define KESTREL_DICTIONARY_SCOREVARSTATS_H

#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// Minimum, maximum, mean and standard deviation of a variable, in its own unit, and what replaces a missing
/// value.
class KESTREL_API ScoreVarStats {
 public:
  virtual ~ScoreVarStats();

  /// A deep copy, owned by the caller.
  virtual ScoreVarStats* Clone() const = 0;
  virtual void SetMin(double min) = 0;
  virtual void SetMax(double max) = 0;
  virtual void SetStddev(double stddev) = 0;
  virtual void SetMean(double mean) = 0;
  /// Frees the replacement held so far and keeps a clone of the argument, or nothing when it is null. The
  /// caller keeps its own value.
  virtual void SetMissingReplacement(const ScoreValue* value) = 0;
  virtual double GetMin() const = 0;
  virtual double GetMax() const = 0;
  virtual double GetStddev() const = 0;
  virtual double GetMean() const = 0;
  /// Still owned by the statistics; null when there is none.
  virtual const ScoreValue* GetMissingReplacement() const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_SCOREVARSTATS_H
