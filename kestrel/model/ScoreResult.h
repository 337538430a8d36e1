// The interface of what a model writes for a case and a host reads back.

#ifndef KESTREL_MODEL_SCORERESULT_H
#define KESTREL_MODEL_SCORERESULT_H

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

class ScoreValue;

/// The outcome of scoring one case. Values that are handed in are copied into storage that the result keeps
/// from case to case; the caller keeps its own. One result serves one scoring call at a time.
class KESTREL_API ScoreResult {
 public:
  ScoreResult() = default;
  ScoreResult(const ScoreResult&) = delete;
  ScoreResult& operator=(const ScoreResult&) = delete;
  virtual ~ScoreResult();

  /// Copies the predicted value; null clears the prediction.
  virtual void SetPrediction(const ScoreValue* value) = 0;

  /// The predicted value, or null when there is none. Belongs to the result; valid until the prediction
  /// changes.
  virtual const ScoreValue* GetPrediction() const = 0;

  /// Empties the result for the next case. The storage stays, so that filling it again allocates nothing.
  virtual void Reset() = 0;

  /// The probability (confidence) of the prediction; 0.0 until it is set.
  virtual void SetProbability(double probability) = 0;
  virtual double GetProbability() const = 0;

  /// The number of the result's kind: 0 for a classification, 1 for a regression, further ones for other
  /// models.
  virtual int GetResultKind() const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_MODEL_SCORERESULT_H
