#include "kestrel/foundation/NumericValue.h"

#include <algorithm>
#include <cmath>

#include "kestrel/foundation/NumberText.h"

namespace MCKestrel_800 {

namespace {

constexpr double kOrderTolerance = 1e-14;

/// Whether both sides are numbers and neither is missing.
bool Comparable(const NumericValue& value, const ScoreValue& other) {
  return other.GetType() == ScoreValue::kNumeric && !value.IsSystemMissingValue() &&
         !other.IsSystemMissingValue();
}

}  // namespace

// Defined here too, so that hosts and plug-ins can take their address.
constexpr double NumericValue::gSysmisValue;
constexpr double NumericValue::gInfinity;
constexpr double NumericValue::fEpsilon;

// The constructor is constexpr, so this stands before any initialiser of another source can read it.
const NumericValue NumericValue::SYSMIS;

NumericValue::NumericValue(const std::string& text) {
  FromString(text);
}
NumericValue::~NumericValue() = default;

void NumericValue::SetValue(const ScoreValue* other) {
  if (other != nullptr && other->GetType() == kNumeric) value_ = other->GetDouble();
}

ScoreValue* NumericValue::GetValue() const {
  return Clone();
}
ScoreValue* NumericValue::Clone() const {
  return new NumericValue(*this);
}

bool NumericValue::operator==(const ScoreValue& other) const {
  return other.GetType() == kNumeric && IsEqual(value_, other.GetDouble());
}

bool NumericValue::Equal(const ScoreValue*, bool, bool) const {
  return true;
}

bool NumericValue::operator>(const ScoreValue& other) const {
  return Comparable(*this, other) && NumberLess(other.GetDouble(), value_);
}
bool NumericValue::operator<(const ScoreValue& other) const {
  return Comparable(*this, other) && NumberLess(value_, other.GetDouble());
}
bool NumericValue::operator<=(const ScoreValue& other) const {
  return Comparable(*this, other) && NumberLessOrEqual(value_, other.GetDouble());
}
bool NumericValue::operator>=(const ScoreValue& other) const {
  return Comparable(*this, other) && NumberLessOrEqual(other.GetDouble(), value_);
}

int NumericValue::GetInt() const {
  constexpr double kLowest = std::numeric_limits<int>::min(), kHighest = std::numeric_limits<int>::max();
  if (std::isnan(value_)) return 0;
  return static_cast<int>(std::clamp(value_, kLowest, kHighest));
}

std::string NumericValue::GetString() const {
  return value_ <= gSysmisValue ? "Undefined" : FormatSixDigits(value_);
}

void NumericValue::FromString(const std::string& text) {
  if (!ReadDouble(text, value_)) value_ = StartsWithInfinity(text) ? gInfinity : gSysmisValue;
}

bool NumericValue::IsEqual(double a, double b) {
  if (a == 0.0 && b == 0.0) return true;
  if (a == gSysmisValue || b == gSysmisValue) return a == b;
  return std::fabs(a - b) < std::max(std::fabs(a), std::fabs(b)) * fEpsilon;
}

bool NumberLess(double a, double b) {
  if (a == NumericValue::gSysmisValue || b == NumericValue::gSysmisValue) return false;
  const double d = a - b;
  return d < 0.0 && std::fabs(d) >= kOrderTolerance;
}

bool NumberLessOrEqual(double a, double b) {
  if (a == NumericValue::gSysmisValue || b == NumericValue::gSysmisValue) return false;
  const double d = a - b;
  return d < 0.0 || std::fabs(d) < kOrderTolerance;
}

}  // namespace MCKestrel_800
