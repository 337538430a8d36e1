#include "kestrel/dictionary/ValueProbabilitySet.h"

#include <ostream>

namespace MCKestrel_800 {

ScoreValueProbabilitySet::~ScoreValueProbabilitySet() = default;

ValueProbabilitySet::ValueProbabilitySet() = default;
ValueProbabilitySet::ValueProbabilitySet(const ValueProbabilitySet& other) = default;
ValueProbabilitySet& ValueProbabilitySet::operator=(const ValueProbabilitySet& other) = default;
ValueProbabilitySet::~ValueProbabilitySet() = default;

ValueProbabilitySet* ValueProbabilitySet::Clone() const {
  return new ValueProbabilitySet(*this);
}

bool ValueProbabilitySet::Add(ScoreValueProbability* element) {
  return elements_.Add(element);
}

bool ValueProbabilitySet::Remove(const ScoreValueProbability* element) {
  return elements_.Remove(element);
}

std::size_t ValueProbabilitySet::Size() const {
  return elements_.All().size();
}

const std::vector<ScoreValueProbability*>& ValueProbabilitySet::GetAllValueProbabilities() const {
  return elements_.All();
}

double ValueProbabilitySet::GetProbabilityOfValue(const ScoreValue* value) const {
  const std::size_t position = elements_.FirstWithValue(value);
  return position == ValueIndex::kNone ? 0.0 : elements_.All()[position]->GetProbability();
}

bool ValueProbabilitySet::Contains(const ScoreValue* value) const {
  return elements_.FirstWithValue(value) != ValueIndex::kNone;
}

void ValueProbabilitySet::Display(std::ostream& os) const {
  os << "Start ScoreValueProbabilitySet Display:\n";
  for (const ScoreValueProbability* element : elements_.All())
    element->Display(os);
  os << "End of ScoreValueProbabilitySet Display.\n\n";
}

}  // namespace MCKestrel_800
