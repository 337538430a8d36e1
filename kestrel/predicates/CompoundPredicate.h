// Predicates joined by a Boolean operator, or listed as surrogates of each other.

#ifndef KESTREL_PREDICATES_COMPOUNDPREDICATE_H
#define KESTREL_PREDICATES_COMPOUNDPREDICATE_H

#include <iosfwd>
#include <vector>

#include "kestrel/platform/Export.h"
#include "kestrel/predicates/ScorePredicate.h"

namespace MCKestrel_800 {

/// Owns its children and asks them in order, by the three-valued rules of PMML:
///   or         the first true child makes it true; else unknown if a child was unknown, else false
///   and        the first false child makes it false; else unknown if a child was unknown, else true
///   xor        the first unknown child makes it unknown; else true for an odd number of true children
///   surrogate  the first child that is not unknown decides; when that is true and not the first of the
///              list, the result is PredSurrogateTrue; unknown when all children are
/// PredSurrogateTrue of a child is not "true" to or and xor, and not "false" to and. Any other operator value
/// is PredUnknown.
class KESTREL_API CompoundPredicate : public ScorePredicate {
 public:
  /// A list of surrogates.
  CompoundPredicate();
  explicit CompoundPredicate(CompoundBoolOperator boolOperator);
  CompoundPredicate(const CompoundPredicate& other);
  CompoundPredicate& operator=(const CompoundPredicate&) = delete;
  ~CompoundPredicate() override;

  CompoundPredicate* Clone() const override;
  PredicateResult Evaluate(const std::vector<double>& values) const override;
  PredicateResult Evaluate(const ScoreCaseRecord* record,
                           const ScoreCaseRecord* derivedRecord) const override;
  PredicateType GetPredType() const override;
  bool IsDerivedPredictor() const override;
  /// Nothing: a compound has no split.
  void SetSplit(const ScoreSplitVar* split) override;
  /// Always null.
  const ScoreSplitVar* GetSplit() const override;
  void Display(std::ostream& out) const override;

  /// Appends a child, which the compound owns from then on. Null is refused: nothing happens.
  void AddPredicate(ScorePredicate* child);
  /// Takes the first child with that address out of the list; it is the caller's from then on. False when it
  /// is not there.
  bool RemovePredicate(ScorePredicate* child);
  /// The children, none of them null; whoever changes the list keeps it so.
  const std::vector<ScorePredicate*>& GetPredicates() const;
  std::vector<ScorePredicate*>& GetPredicates();
  int GetCount() const;
  CompoundBoolOperator GetBoolOperator() const;
  void SetBoolOperator(CompoundBoolOperator boolOperator);
  /// A surrogate list evaluated from a child on: the first child, from `startIndex`, that is not unknown
  /// decides. PredFalse when this is no surrogate list or has no such child.
  PredicateResult EvaluateSurrogate(const std::vector<double>& values, int startIndex) const;

 private:
  std::vector<ScorePredicate*> children_;
  CompoundBoolOperator operator_ = kSurrogate;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PREDICATES_COMPOUNDPREDICATE_H
