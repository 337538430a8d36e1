// A predicate that asks whether a variable's value is one of several.

#ifndef KESTREL_PREDICATES_SETPREDICATE_H
#define KESTREL_PREDICATES_SETPREDICATE_H

#include <iosfwd>
#include <string>
#include <vector>

#include "kestrel/platform/Export.h"
#include "kestrel/predicates/ScorePredicate.h"
#include "kestrel/predicates/ScoreSplitVar.h"

namespace MCKestrel_800 {

/// True exactly when its split maps the case's value to a child; operator and values are kept for inspection.
/// A missing value always gives PredUnknown: unlike a simple predicate, a set never sends it to a child.
class KESTREL_API SetPredicate : public ScorePredicate {
 public:
  enum SimpleSetPredOperator : int { kIsIn = 0, kIsNotIn = 1 };

  /// Without a split a predicate is PredUnknown.
  SetPredicate();
  /// Takes the split over.
  explicit SetPredicate(const ScoreSplitVar* split);
  SetPredicate(const SetPredicate& other);
  SetPredicate& operator=(const SetPredicate&) = delete;
  ~SetPredicate() override;

  SetPredicate* Clone() const override;
  PredicateResult Evaluate(const std::vector<double>& values) const override;
  PredicateResult Evaluate(const ScoreCaseRecord* record,
                           const ScoreCaseRecord* derivedRecord) const override;
  PredicateType GetPredType() const override;
  bool IsDerivedPredictor() const override;
  void SetSplit(const ScoreSplitVar* split) override;
  const ScoreSplitVar* GetSplit() const override;
  void Display(std::ostream& out) const override;

  /// "isIn", exactly; any other text is isNotIn.
  void SetPredicateOperator(const std::string& text);
  SimpleSetPredOperator GetPredicateOperator() const;
  /// The set's values as numbers or category codes. An empty vector leaves the values as they are.
  void SetArrayData(const std::vector<double>& values);
  const std::vector<double>& GetArrayData() const;

 private:
  const ScoreSplitVar* split_ = nullptr;
  SimpleSetPredOperator operator_ = kIsIn;
  std::vector<double> array_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PREDICATES_SETPREDICATE_H
