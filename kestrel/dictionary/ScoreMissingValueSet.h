// The values of a variable that its document declares to be missing.

#ifndef KESTREL_DICTIONARY_SCOREMISSINGVALUESET_H
#define KESTREL_DICTIONARY_SCOREMISSINGVALUESET_H

#include <cstddef>
#include <iosfwd>
#include <vector>

#include "kestrel/platform/Export.h"
#include "kestrel/predicates/ScoreValueRange.h"

namespace MCKestrel_800 {

/// An ordered collection of ranges, which it owns. A single missing value is a range whose ends are the same
/// value.
class KESTREL_API ScoreMissingValueSet {
 public:
  virtual ~ScoreMissingValueSet();

  /// A deep copy, owned by the caller.
  virtual ScoreMissingValueSet* Clone() const = 0;
  /// Appends a range and takes ownership of it. Null, and a range equal to a stored one, are refused: false,
  /// and the caller still owns the range.
  virtual bool Add(ScoreValueRange* range) = 0;
  /// Removes and deletes the first range equal to the argument, which stays the caller's. False when it is
  /// null or nothing matches.
  virtual bool Remove(const ScoreValueRange* range) = 0;
  virtual std::size_t Size() const = 0;
  /// True when some stored range equals the argument; false for null.
  virtual bool Contains(const ScoreValueRange* range) const = 0;
  /// A copy of the list of ranges, in the order in which they were added; the ranges stay owned by the set.
  virtual std::vector<const ScoreValueRange*> GetMissingValues() const = 0;
  virtual void Display(std::ostream& os) const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_SCOREMISSINGVALUESET_H
