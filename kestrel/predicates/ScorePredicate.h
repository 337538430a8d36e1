// The interface of a predicate: does a node of a tree, or a rule, apply to a case?

#ifndef KESTREL_PREDICATES_SCOREPREDICATE_H
#define KESTREL_PREDICATES_SCOREPREDICATE_H

#include <iosfwd>
#include <vector>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

class ScoreCaseRecord;
class ScoreSplitVar;

/// Decides on one case, given as records or as a flat vector of numbers.
///
/// The vector holds each variable's value at the variable's encoded value index: of a continuous variable the
/// number or the system-missing value, of an ordinal or nominal one its category code, -1 for a value that is
/// no category, or -2 for a missing one. Both ways give the same answer when the vector says "missing"
/// exactly where the record's value counts as missing, which for a nominal variable includes every value that
/// is not one of its categories.
///
/// Predicates are immutable while they are evaluated; evaluation allocates nothing and may run on several
/// threads at once.
class KESTREL_API ScorePredicate {
 public:
  enum PredicateResult : int {
    PredTrue = 0,
    PredFalse = 1,
    PredUnknown = 2,
    PredSurrogateTrue = 3  ///< true by a surrogate: the first predicate of the list could not be decided
  };
  enum PredicateType : int { kCompound = 0, kSimple = 1, kSet = 2, kTrue = 3, kFalse = 4 };
  enum CompoundBoolOperator : int { kOr = 0, kAnd = 1, kXor = 2, kSurrogate = 3 };

  virtual ~ScorePredicate();

  /// A new deep copy that the caller owns.
  virtual ScorePredicate* Clone() const = 0;
  virtual PredicateResult Evaluate(const std::vector<double>& values) const = 0;
  /// Values are found by the name of the predicate's variable. Those of derived variables are looked for in
  /// `derivedRecord`, or, when that is null, in `record` like all others. A null record holds nothing.
  virtual PredicateResult Evaluate(const ScoreCaseRecord* record,
                                   const ScoreCaseRecord* derivedRecord) const = 0;
  virtual PredicateType GetPredType() const = 0;
  /// Whether a derived variable decides, here or in a child.
  virtual bool IsDerivedPredictor() const = 0;
  /// Stores the split, which the predicate owns from then on; one that it held is not deleted. Nothing
  /// happens in a predicate that has no split of its own.
  virtual void SetSplit(const ScoreSplitVar* split) = 0;
  /// The split; null when there is none.
  virtual const ScoreSplitVar* GetSplit() const = 0;
  /// One line that names the kind.
  virtual void Display(std::ostream& out) const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PREDICATES_SCOREPREDICATE_H
