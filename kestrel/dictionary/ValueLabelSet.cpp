#include "kestrel/dictionary/ValueLabelSet.h"

#include <ostream>

namespace MCKestrel_800 {

ScoreValueLabelSet::~ScoreValueLabelSet() = default;

ValueLabelSet::ValueLabelSet() = default;
ValueLabelSet::ValueLabelSet(const ValueLabelSet& other) = default;
ValueLabelSet& ValueLabelSet::operator=(const ValueLabelSet& other) = default;
ValueLabelSet::~ValueLabelSet() = default;

ValueLabelSet* ValueLabelSet::Clone() const {
  return new ValueLabelSet(*this);
}

bool ValueLabelSet::Add(ScoreValueLabel* label) {
  return elements_.Add(label);
}

bool ValueLabelSet::Remove(const ScoreValueLabel* label) {
  return elements_.Remove(label);
}

std::size_t ValueLabelSet::Size() const {
  return elements_.All().size();
}

const std::vector<ScoreValueLabel*>& ValueLabelSet::GetAllValueLabels() const {
  return elements_.All();
}

std::string ValueLabelSet::GetLabelOfValue(const ScoreValue* value) const {
  const std::size_t position = elements_.FirstWithValue(value);
  return position == ValueIndex::kNone ? std::string() : elements_.All()[position]->GetLabel();
}

bool ValueLabelSet::Contains(const ScoreValue* value) const {
  return elements_.FirstWithValue(value) != ValueIndex::kNone;
}

bool ValueLabelSet::ContainsEqualTo(const ScoreValue* value) const {
  return elements_.AnyEqualTo(value);
}

bool ValueLabelSet::ContainsEqual(const ScoreValue* value, bool exact, bool emptyStringOK) const {
  return elements_.AnyEqual(value, exact, emptyStringOK);
}

void ValueLabelSet::Display(std::ostream& os) const {
  os << "Start ScoreValueLabelSet Display:\n";
  for (const ScoreValueLabel* label : elements_.All())
    label->Display(os);
  os << "End of ScoreValueLabelSet Display.\n\n";
}

}  // namespace MCKestrel_800
