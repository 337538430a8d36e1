// The one implementation of ScoreValueProbabilitySet, with look-ups that do not grow with the number of
// values.

#ifndef KESTREL_DICTIONARY_VALUEPROBABILITYSET_H
#define KESTREL_DICTIONARY_VALUEPROBABILITYSET_H

#include <vector>

#include "kestrel/dictionary/IndexedElements.h"
#include "kestrel/dictionary/ScoreValueProbabilitySet.h"
#include "kestrel/dictionary/ValueProbability.h"

namespace MCKestrel_800 {

/// A value-probability set whose answers are those of a walk from the first element to the last, found
/// through an index once the set has grown beyond a few elements.
///
/// The index follows `ValueProbability::SetValueProbability` on an element. A value must not be changed
/// through a pointer that was kept after the value was given to its element. The index changes in `Add` and
/// `Remove` alone: a set that nobody changes may be read by several threads.
class KESTREL_API ValueProbabilitySet : public ScoreValueProbabilitySet {
 public:
  ValueProbabilitySet();
  ValueProbabilitySet(const ValueProbabilitySet& other);
  ValueProbabilitySet& operator=(const ValueProbabilitySet& other);
  ~ValueProbabilitySet() override;

  ValueProbabilitySet* Clone() const override;
  bool Add(ScoreValueProbability* element) override;
  bool Remove(const ScoreValueProbability* element) override;
  std::size_t Size() const override;
  const std::vector<ScoreValueProbability*>& GetAllValueProbabilities() const override;
  double GetProbabilityOfValue(const ScoreValue* value) const override;
  bool Contains(const ScoreValue* value) const override;
  void Display(std::ostream& os) const override;

 private:
  IndexedElements<ScoreValueProbability, ValueProbability> elements_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_VALUEPROBABILITYSET_H
