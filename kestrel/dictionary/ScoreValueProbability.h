// The prior probability of one value of a variable.

#ifndef KESTREL_DICTIONARY_SCOREVALUEPROBABILITY_H
#define KESTREL_DICTIONARY_SCOREVALUEPROBABILITY_H

#include <iosfwd>

#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// A value with its probability. Two of them compare as their values do; the probabilities play no part.
class KESTREL_API ScoreValueProbability {
 public:
  virtual ~ScoreValueProbability();

  /// Replaces value and probability. Takes ownership of `value` and frees the value held so far. A null
  /// value, or a probability that is not a number from 0 to 1, is refused: false, nothing changes and the
  /// caller keeps `value`.
  virtual bool SetValueProbability(ScoreValue* value, double probability) = 0;
  /// Replaces the probability. One that is not a number from 0 to 1 is refused: false, nothing changes.
  virtual bool SetProbability(double probability) = 0;
  /// A deep copy, owned by the caller.
  virtual ScoreValueProbability* Clone() const = 0;

  /// The values' own operators of the same kind. An object without value compares false with everything.
  virtual bool operator==(const ScoreValueProbability& other) const = 0;
  virtual bool operator>(const ScoreValueProbability& other) const = 0;
  virtual bool operator<(const ScoreValueProbability& other) const = 0;
  virtual bool operator<=(const ScoreValueProbability& other) const = 0;
  virtual bool operator>=(const ScoreValueProbability& other) const = 0;

  /// From 0 to 1.
  virtual double GetProbability() const = 0;
  /// The value, still owned by this object; null when it was made without one.
  virtual const ScoreValue* GetValue() const = 0;
  /// Writes one line: the value's text (or "NULL") and the probability.
  virtual void Display(std::ostream& os) const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_SCOREVALUEPROBABILITY_H
