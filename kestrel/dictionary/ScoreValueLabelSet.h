// The categories of a variable, in the order in which they were declared.

#ifndef KESTREL_DICTIONARY_SCOREVALUELABELSET_H
#define KESTREL_DICTIONARY_SCOREVALUELABELSET_H

#include <cstddef>
#include <iosfwd>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreValueLabel.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// An ordered collection of value labels, which it owns.
class KESTREL_API ScoreValueLabelSet {
 public:
  virtual ~ScoreValueLabelSet();

  /// A deep copy, owned by the caller.
  virtual ScoreValueLabelSet* Clone() const = 0;
  /// Appends a label and takes ownership of it. Nothing checks for duplicates. Null is refused (false).
  virtual bool Add(ScoreValueLabel* label) = 0;
  /// Removes and deletes the first label whose value equals the argument's; the argument stays the caller's.
  /// False when it is null or nothing matches.
  virtual bool Remove(const ScoreValueLabel* label) = 0;
  virtual std::size_t Size() const = 0;
  /// The labels in the order in which they were added; they stay owned by the set.
  virtual const std::vector<ScoreValueLabel*>& GetAllValueLabels() const = 0;
  /// The label of the first element whose value equals `value`; empty when there is none or `value` is null.
  virtual std::string GetLabelOfValue(const ScoreValue* value) const = 0;
  /// True when some element's value equals `value`; false for null.
  virtual bool Contains(const ScoreValue* value) const = 0;
  virtual void Display(std::ostream& os) const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_SCOREVALUELABELSET_H
