// The prior probabilities of the values of a variable.

#ifndef KESTREL_DICTIONARY_SCOREVALUEPROBABILITYSET_H
#define KESTREL_DICTIONARY_SCOREVALUEPROBABILITYSET_H

#include <cstddef>
#include <iosfwd>
#include <vector>

#include "kestrel/dictionary/ScoreValueProbability.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// An ordered collection of value probabilities, which it owns.
class KESTREL_API ScoreValueProbabilitySet {
 public:
  virtual ~ScoreValueProbabilitySet();

  /// A deep copy, owned by the caller.
  virtual ScoreValueProbabilitySet* Clone() const = 0;
  /// Appends an element and takes ownership of it. Nothing checks for duplicates. Null is refused (false).
  virtual bool Add(ScoreValueProbability* element) = 0;
  /// Removes and deletes the first element whose value equals the argument's; the argument stays the
  /// caller's. False when it is null or nothing matches.
  virtual bool Remove(const ScoreValueProbability* element) = 0;
  virtual std::size_t Size() const = 0;
  /// The elements in the order in which they were added; they stay owned by the set.
  virtual const std::vector<ScoreValueProbability*>& GetAllValueProbabilities() const = 0;
  /// The probability (0 to 1) of the first element whose value equals `value`; 0.0 when there is none or
  /// `value` is null.
  virtual double GetProbabilityOfValue(const ScoreValue* value) const = 0;
  /// True when some element's value equals `value`; false for null.
  virtual bool Contains(const ScoreValue* value) const = 0;
  virtual void Display(std::ostream& os) const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_SCOREVALUEPROBABILITYSET_H
