// The predicates that do not look at the case.

#ifndef KESTREL_PREDICATES_CONSTANTPREDICATES_H
#define KESTREL_PREDICATES_CONSTANTPREDICATES_H

#include <iosfwd>
#include <vector>

#include "kestrel/platform/Export.h"
#include "kestrel/predicates/ScorePredicate.h"

namespace MCKestrel_800 {

/// Always PredTrue.
class KESTREL_API TruePredicate : public ScorePredicate {
 public:
  TruePredicate();
  ~TruePredicate() override;

  TruePredicate* Clone() const override;
  PredicateResult Evaluate(const std::vector<double>& values) const override;
  PredicateResult Evaluate(const ScoreCaseRecord* record,
                           const ScoreCaseRecord* derivedRecord) const override;
  PredicateType GetPredType() const override;
  bool IsDerivedPredictor() const override;
  void SetSplit(const ScoreSplitVar* split) override;
  const ScoreSplitVar* GetSplit() const override;
  void Display(std::ostream& out) const override;
};

/// Always PredFalse.
class KESTREL_API FalsePredicate : public ScorePredicate {
 public:
  FalsePredicate();
  ~FalsePredicate() override;

  FalsePredicate* Clone() const override;
  PredicateResult Evaluate(const std::vector<double>& values) const override;
  PredicateResult Evaluate(const ScoreCaseRecord* record,
                           const ScoreCaseRecord* derivedRecord) const override;
  PredicateType GetPredType() const override;
  bool IsDerivedPredictor() const override;
  void SetSplit(const ScoreSplitVar* split) override;
  const ScoreSplitVar* GetSplit() const override;
  void Display(std::ostream& out) const override;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PREDICATES_CONSTANTPREDICATES_H
