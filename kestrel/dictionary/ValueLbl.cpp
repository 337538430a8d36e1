#include "kestrel/dictionary/ValueLbl.h"

#include <ostream>

namespace MCKestrel_800 {

ScoreValueLabel::~ScoreValueLabel() = default;

ValueLbl::ValueLbl(ScoreValue* value, const std::string& label) : value_(value), label_(label) {}

ValueLbl::ValueLbl(const ValueLbl& other)
    : ScoreValueLabel(other), value_(other.value_ ? other.value_->Clone() : nullptr), label_(other.label_) {}

ValueLbl& ValueLbl::operator=(const ValueLbl& other) {
  if (this == &other) return *this;
  value_.reset(other.value_ ? other.value_->Clone() : nullptr);
  label_ = other.label_;
  MarkChanged();
  return *this;
}

ValueLbl::~ValueLbl() = default;

void ValueLbl::MarkChanged() {
  if (changed_ != nullptr) *changed_ = true;
}

bool ValueLbl::SetValueLabel(ScoreValue* value, const std::string& label) {
  if (value == nullptr || label.empty()) return false;
  if (value != value_.get()) value_.reset(value);
  label_ = label;
  MarkChanged();
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
  const ScoreValue* value = other.GetValue();
  return value_ && value != nullptr && *value_ == *value;
}

bool ValueLbl::operator>(const ScoreValueLabel& other) const {
  const ScoreValue* value = other.GetValue();
  return value_ && value != nullptr && *value_ > *value;
}

bool ValueLbl::operator<(const ScoreValueLabel& other) const {
  const ScoreValue* value = other.GetValue();
  return value_ && value != nullptr && *value_ < *value;
}

bool ValueLbl::operator<=(const ScoreValueLabel& other) const {
  const ScoreValue* value = other.GetValue();
  return value_ && value != nullptr && *value_ <= *value;
}

bool ValueLbl::operator>=(const ScoreValueLabel& other) const {
  const ScoreValue* value = other.GetValue();
  return value_ && value != nullptr && *value_ >= *value;
}

std::string ValueLbl::GetLabel() const {
  return label_;
}

const ScoreValue* ValueLbl::GetValue() const {
  return value_.get();
}

void ValueLbl::Display(std::ostream& os) const {
  os << "Value: " << (value_ ? value_->GetString() : "NULL") << ";  Label: " << label_ << "\n";
}

}  // namespace MCKestrel_800
