// The one implementation of ScoreValueLabelSet, with look-ups that do not grow with the number of categories.

#ifndef KESTREL_DICTIONARY_VALUELABELSET_H
#define KESTREL_DICTIONARY_VALUELABELSET_H

#include <string>
#include <vector>

#include "kestrel/dictionary/IndexedElements.h"
#include "kestrel/dictionary/ScoreValueLabelSet.h"
#include "kestrel/dictionary/ValueLbl.h"

namespace MCKestrel_800 {

/// A value-label set whose answers are those of a walk from the first element to the last, found through an
/// index once the set has grown beyond a few elements.
///
/// The index follows `ValueLbl::SetValueLabel` on an element. A value must not be changed through a pointer
/// that was kept after the value was given to its label. The index changes in `Add` and `Remove` alone: a set
/// that nobody changes may be read by several threads.
class KESTREL_API ValueLabelSet : public ScoreValueLabelSet {
 public:
  ValueLabelSet();
  ValueLabelSet(const ValueLabelSet& other);
  ValueLabelSet& operator=(const ValueLabelSet& other);
  ~ValueLabelSet() override;

  ValueLabelSet* Clone() const override;
  bool Add(ScoreValueLabel* label) override;
  bool Remove(const ScoreValueLabel* label) override;
  std::size_t Size() const override;
  const std::vector<ScoreValueLabel*>& GetAllValueLabels() const override;
  std::string GetLabelOfValue(const ScoreValue* value) const override;
  bool Contains(const ScoreValue* value) const override;
  void Display(std::ostream& os) const override;

  /// True when `value` says of some element's value that it equals it: how the categories of a variable other
  /// than text are matched. False for null.
  bool ContainsEqualTo(const ScoreValue* value) const;
  /// True when `Equal(value, exact, emptyStringOK)` holds for some element's value: how the categories of a
  /// string variable are matched. False for null.
  bool ContainsEqual(const ScoreValue* value, bool exact, bool emptyStringOK) const;

 private:
  IndexedElements<ScoreValueLabel, ValueLbl> elements_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_VALUELABELSET_H
