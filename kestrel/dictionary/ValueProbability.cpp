#include "kestrel/dictionary/ValueProbability.h"

#include <functional>
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

ValueProbability::ValueProbability(const ValueProbability& other) = default;
ValueProbability& ValueProbability::operator=(const ValueProbability& other) = default;
ValueProbability::~ValueProbability() = default;

bool ValueProbability::SetValueProbability(ScoreValue* value, double probability) {
  if (value == nullptr || !IsProbability(probability)) return false;
  value_.Put(value);
  probability_ = probability;
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
  return value_.Is(std::equal_to<>(), other.GetValue());
}

bool ValueProbability::operator>(const ScoreValueProbability& other) const {
  return value_.Is(std::greater<>(), other.GetValue());
}

bool ValueProbability::operator<(const ScoreValueProbability& other) const {
  return value_.Is(std::less<>(), other.GetValue());
}

bool ValueProbability::operator<=(const ScoreValueProbability& other) const {
  return value_.Is(std::less_equal<>(), other.GetValue());
}

bool ValueProbability::operator>=(const ScoreValueProbability& other) const {
  return value_.Is(std::greater_equal<>(), other.GetValue());
}

double ValueProbability::GetProbability() const {
  return probability_;
}

const ScoreValue* ValueProbability::GetValue() const {
  return value_.Get();
}

void ValueProbability::Display(std::ostream& os) const {
  const ScoreValue* value = GetValue();
  os << "Value: " << (value == nullptr ? "NULL" : value->GetString())
     << ";  Probability: " << FormatSixDigits(probability_) << "\n";
}

}  // namespace MCKestrel_800
