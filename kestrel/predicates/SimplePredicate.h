// A predicate that compares one variable with one value.

#ifndef KESTREL_PREDICATES_SIMPLEPREDICATE_H
#define KESTREL_PREDICATES_SIMPLEPREDICATE_H

#include <iosfwd>
#include <string>
#include <vector>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/platform/Export.h"
#include "kestrel/predicates/ScorePredicate.h"
#include "kestrel/predicates/ScoreSplitVar.h"

namespace MCKestrel_800 {

/// True exactly when its split maps the case's value to a child. Operator and value are kept for inspection;
/// whoever builds the predicate builds the split from them:
///
///   auto split = std::make_unique<ScaleSplit>(variable);            // age < 18
///   split->PutSplit(new Range(-infinity, 18.0, false, false), 0);
///   SimplePredicate predicate(split.release());
///   predicate.SetPredicateValue("18");
///   predicate.SetPredicateOperator("lessThan");
///
/// A missing value gives PredTrue when the split sends missing values to a child, else PredUnknown.
class KESTREL_API SimplePredicate : public ScorePredicate {
 public:
  enum SimplePredOperator : int {
    kEqual = 0,
    kNotEqual = 1,
    kLessThan = 2,
    kLessOrEqual = 3,
    kGreaterThan = 4,
    kGreaterOrEqual = 5,
    kIsMissing = 6,
    kIsNotMissing = 7
  };

  /// Without a split a predicate is PredUnknown.
  SimplePredicate();
  /// Takes the split over.
  explicit SimplePredicate(const ScoreSplitVar* split);
  SimplePredicate(const SimplePredicate& other);
  SimplePredicate& operator=(const SimplePredicate&) = delete;
  ~SimplePredicate() override;

  SimplePredicate* Clone() const override;
  PredicateResult Evaluate(const std::vector<double>& values) const override;
  PredicateResult Evaluate(const ScoreCaseRecord* record,
                           const ScoreCaseRecord* derivedRecord) const override;
  PredicateType GetPredType() const override;
  bool IsDerivedPredictor() const override;
  void SetSplit(const ScoreSplitVar* split) override;
  const ScoreSplitVar* GetSplit() const override;
  void Display(std::ostream& out) const override;

  /// The operator of PMML's name for it; empty leaves it as it is, any unknown text is isNotMissing.
  void SetPredicateOperator(const std::string& text);
  SimplePredOperator GetPredicateOperator() const;
  /// Keeps the text and its number: the category code where the split's variable has an encoder (which
  /// registers a new text), else what the variable's own conversion gives. The split and its variable must
  /// be set before; without them the text alone is kept.
  void SetPredicateValue(const std::string& text);
  /// The system-missing value until one is set.
  double GetPredValueByDouble() const;
  const std::string& GetPredValueByString() const;
  /// Whether the predicate's own value is missing.
  bool IsMissingValue() const;
  void SetValueToMissing(bool missing);

 private:
  const ScoreSplitVar* split_ = nullptr;
  bool missing_ = false;
  double number_ = NumericValue::gSysmisValue;
  std::string text_;
  SimplePredOperator operator_ = kEqual;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PREDICATES_SIMPLEPREDICATE_H
