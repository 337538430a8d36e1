#include "kestrel/transform/ValueMatcher.h"

namespace MCKestrel_800 {

ScoreValueMatcher::~ScoreValueMatcher() = default;

ValueMatcher::ValueMatcher(ScoreValue* value) : value_(value) {}

ValueMatcher::ValueMatcher(const ValueMatcher& other)
    : ScoreValueMatcher(other), value_(other.value_ == nullptr ? nullptr : other.value_->Clone()) {}

ValueMatcher& ValueMatcher::operator=(const ValueMatcher& other) {
  if (this != &other) value_.reset(other.value_ == nullptr ? nullptr : other.value_->Clone());
  return *this;
}

ValueMatcher::~ValueMatcher() = default;

bool ValueMatcher::Matches(const ScoreValue& value) const {
  return value_ != nullptr && *value_ == value;
}

ValueMatcher* ValueMatcher::Clone() const {
  return new ValueMatcher(*this);
}

}  // namespace MCKestrel_800
