// One category of a variable: a value and the text that stands for it.

#ifndef KESTREL_DICTIONARY_SCOREVALUELABEL_H
#define KESTREL_DICTIONARY_SCOREVALUELABEL_H

#include <iosfwd>
#include <string>

#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// A value with its label. Two labels compare as their values do; the label texts play no part.
class KESTREL_API ScoreValueLabel {
 public:
  virtual ~ScoreValueLabel();

  /// Replaces value and label. Takes ownership of `value` and frees the value held so far. A null value or an
  /// empty label is refused: false, nothing changes and the caller keeps `value`.
  virtual bool SetValueLabel(ScoreValue* value, const std::string& label) = 0;
  /// Replaces the label. An empty label is refused: false, nothing changes.
  virtual bool SetLabel(const std::string& label) = 0;
  /// A deep copy, owned by the caller.
  virtual ScoreValueLabel* Clone() const = 0;

  /// The values' own operators of the same kind. A label without value compares false with everything.
  virtual bool operator==(const ScoreValueLabel& other) const = 0;
  virtual bool operator>(const ScoreValueLabel& other) const = 0;
  virtual bool operator<(const ScoreValueLabel& other) const = 0;
  virtual bool operator<=(const ScoreValueLabel& other) const = 0;
  virtual bool operator>=(const ScoreValueLabel& other) const = 0;

  virtual std::string GetLabel() const = 0;
  /// The value, still owned by the label; null when it was made without one.
  virtual const ScoreValue* GetValue() const = 0;
  /// Writes one line: the value's text (or "NULL") and the label.
  virtual void Display(std::ostream& os) const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_SCOREVALUELABEL_H
