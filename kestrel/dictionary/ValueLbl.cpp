#include "kestrel/dictionary/ValueLbl.h"

#include <functional>
#include <ostream>

namespace MCKestrel_800 {

ScoreValueLabel::~ScoreValueLabel() = default;

ValueLbl::ValueLbl(ScoreValue* value, const std::string& label) : value_(value), label_(label) {}

ValueLbl::ValueLbl(const ValueLbl& other) = default;
ValueLbl& ValueLbl::operator=(const ValueLbl& other) = default;
ValueLbl::~ValueLbl() = default;

bool ValueLbl::SetValueLabel(ScoreValue* value, const std::string& label) {
  if (value == nullptr || label.empty()) return false;
  value_.Put(value);
  label_ = label;
  return true;
}

bool ValueLbl::SetLabel(const std::string& label) {
  if (label.empty()) return false;
  label_ = label;
  return true;
}

ValueLbl* ValueLbl::Clone() const {
  return new ValueLbl(*this);
}

bool ValueLbl::operator==(const ScoreValueLabel& other) const {
  return value_.Is(std::equal_to<>(), other.GetValue());
}

bool ValueLbl::operator>(const ScoreValueLabel& other) const {
  return value_.Is(std::greater<>(), other.GetValue());
}

bool ValueLbl::operator<(const ScoreValueLabel& other) const {
  return value_.Is(std::less<>(), other.GetValue());
}

bool ValueLbl::operator<=(const ScoreValueLabel& other) const {
  return value_.Is(std::less_equal<>(), other.GetValue());
}

bool ValueLbl::operator>=(const ScoreValueLabel& other) const {
  return value_.Is(std::greater_equal<>(), other.GetValue());
}

std::string ValueLbl::GetLabel() const {
  return label_;
}

const ScoreValue* ValueLbl::GetValue() const {
  return value_.Get();
}

void ValueLbl::Display(std::ostream& os) const {
  const ScoreValue* value = GetValue();
  os << "Value: " << (value == nullptr ? "NULL" : value->GetString()) << ";  Label: " << label_ << "\n";
}

}  // namespace MCKestrel_800
