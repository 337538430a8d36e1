#include "kestrel/dictionary/ValueProbability.h"

#include <ostream>

#include "kestrel/foundation/NumberText.h"

namespace MCKestrel_800 {

namespace {

/// False for NaN too.
bool IsProbability(double probability) {
  return probability >= 0.0 && probability <= 1.0;
}

}  // namespace

ScoreValueProbability::~ScoreValueProbability() = default;

ValueProbability::ValueProbability(ScoreValue* value, double probability)
    : value_(value), probability_(IsProbability(probability) ? probability : 0.0) {}

ValueProbability::ValueProbability(const ValueProbability& other)
    : ScoreValueProbability(other),
      value_(other.value_ ? other.value_->Clone() : nullptr),
      probability_(other.probability_) {}

ValueProbability& ValueProbability::operator=(const ValueProbability& other) {
  if (this == &other) return *this;
  value_.reset(other.value_ ? other.value_->Clone() : nullptr);
  probability_ = other.probability_;
  MarkChanged();
  return *this;
}

ValueProbability::~ValueProbability() = default;

void ValueProbability::MarkChanged() {
  if (changed_ != nullptr) *changed_ = true;
}

bool ValueProbability::SetValueProbability(ScoreValue* value, double probability) {
  if (value == nullptr || !IsProbability(probability)) return false;
  if (value != value_.get()) value_.reset(value);
  probability_ = probability;
  MarkChanged();
  return true;
}

bool ValueProbability::SetProbability(double probability) {
  if (!IsProbability(probability)) return false;
  probability_ = probability;
  return true;
}

ValueProbability* ValueProbability::Clone() const {
  return new ValueProbability(*this);
}

bool ValueProbability::operator==(const ScoreValueProbability& other) const {
  const ScoreValue* value = other.GetValue();
  return value_ && value != nullptr && *value_ == *value;
}

bool ValueProbability::operator>(const ScoreValueProbability& other) const {
  const ScoreValue* value = other.GetValue();
  return value_ && value != nullptr && *value_ > *value;
}

bool ValueProbability::operator<(const ScoreValueProbability& other) const {
  const ScoreValue* value = other.GetValue();
  return value_ && value != nullptr && *value_ < *value;
}

bool ValueProbability::operator<=(const ScoreValueProbability& other) const {
  const ScoreValue* value = other.GetValue();
  return value_ && value != nullptr && *value_ <= *value;
}

bool ValueProbability::operator>=(const ScoreValueProbability& other) const {
  const ScoreValue* value = other.GetValue();
  return value_ && value != nullptr && *value_ >= *value;
}

double ValueProbability::GetProbability() const {
  return probability_;
}

const ScoreValue* ValueProbability::GetValue() const {
  return value_.get();
}

void ValueProbability::Display(std::ostream& os) const {
  os << "Value: " << (value_ ? value_->GetString() : "NULL")
     << ";  Probability: " << FormatSixDigits(probability_) << "\n";
}

}  // namespace MCKestrel_800
