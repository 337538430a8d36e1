// A predicate compiled to sixteen bytes, and how it is decided on a flat vector.

#ifndef KESTREL_PLUGINS_SUPPORT_CONDITION_H
#define KESTREL_PLUGINS_SUPPORT_CONDITION_H

#include <cmath>
#include <cstdint>
#include <limits>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/predicates/ScorePredicate.h"
#include "plugins/support/CaseVector.h"

namespace MCKestrel_800 {

/// One test of one slot of a CaseVector, or a reference to a compound in a ConditionTable.
struct Condition {
  enum Kind : std::uint32_t {
    kAlways,
    kNever,
    kUndecided,  ///< there is no predicate
    // Of number slots.
    kAtMost,    ///< x <= number
    kAbove,     ///< x > number
    kEqual,     ///< NumericValue::IsEqual(x, number)
    kNotEqual,  ///< x != number
    kPresent,
    kMissing,
    // Of category slots.
    kCodes,            ///< the code is one of the 64 lowest and set in `codes`
    kCodeRuns,         ///< the code lies in one of the table's runs
    kMissingCategory,  ///< the category is missing
    kNoCategory,       ///< the category is missing or none
    // Parts of the table.
    kOr,
    kAnd,
    kXor,
    kSurrogate
  };
  /// Whether the test of a node's first child tells which child is taken; see TreeTable.
  enum Decides : std::uint32_t { kDecidesNothing, kDecidesNumber, kDecidesNumberAbove, kDecidesCode };
  /// Consecutive entries of the table.
  struct Span {
    std::uint32_t first;
    std::uint32_t count;
  };

  union {
    double number;
    std::uint64_t codes;
    Span span;
  };
  std::uint32_t slot : 24;
  std::uint32_t kind : 6;
  std::uint32_t decides : 2;
  /// For the owner's use. Inside a ConditionTable: the entry after this one and all that belongs to it.
  std::int32_t next;
};
static_assert(sizeof(Condition) == 16, "a tree walks these by the million");

/// Whether a number is neither missing nor infinite nor NaN, so that plain comparisons decide. The largest
/// finite number is left out with them, being the missing one without its sign; it takes the longer way.
inline bool IsOrdinary(double x) {
  return std::fabs(x) < std::numeric_limits<double>::max();
}

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_CONDITION_H
