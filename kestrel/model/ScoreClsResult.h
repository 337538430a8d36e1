// The interface of a classification's outcome: a predicted category and a probability per category.

#ifndef KESTREL_MODEL_SCORECLSRESULT_H
#define KESTREL_MODEL_SCORECLSRESULT_H

#include <cstddef>

#include "kestrel/model/ScoreResult.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// A result that also holds categories with their probabilities, in the order in which they were added.
class KESTREL_API ScoreClsResult : public ScoreResult {
 public:
  ~ScoreClsResult() override;

  /// Appends a copy of the category with its probability. Null is ignored. A category is not looked for
  /// first: added twice, it is held twice, and the first one answers.
  virtual void AddCategoryProbability(const ScoreValue* category, double probability) = 0;

  /// The probability of the first entry whose category equals the value; 0.0 for null or an unknown category.
  /// Looks through the entries: whoever wants all of them walks them by position.
  virtual double GetCategoryProbability(const ScoreValue* category) const = 0;

  /// The number of entries.
  virtual size_t GetCategoryCount() const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_MODEL_SCORECLSRESULT_H
