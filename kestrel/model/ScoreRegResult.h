// The interface of a regression's outcome: a predicted number and how sure it is.

#ifndef KESTREL_MODEL_SCOREREGRESULT_H
#define KESTREL_MODEL_SCOREREGRESULT_H

#include "kestrel/model/ScoreResult.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// A result that also holds the standard error of the prediction, in the target's unit.
class KESTREL_API ScoreRegResult : public ScoreResult {
 public:
  ~ScoreRegResult() override;

  virtual void SetStandardError(double error) = 0;

  /// The standard error; the system-missing value until one is set.
  virtual double GetStandardError() const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_MODEL_SCOREREGRESULT_H
