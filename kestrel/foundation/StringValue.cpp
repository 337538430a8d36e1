#include "kestrel/foundation/StringValue.h"

#include <limits>
#include <typeinfo>

#include "kestrel/foundation/NumberText.h"

namespace MCKestrel_800 {

namespace {

/// Asks the test about the other's text; false when the other is no text. The text of our own class is not
/// copied; any other class, one derived from ours included, is asked for its string. To ask for the exact
/// class costs a seventh of a dynamic_cast.
template <typename Test>
bool AskText(const ScoreValue& other, Test test) {
  if (typeid(other) == typeid(StringValue)) {
    return test(std::string_view(static_cast<const StringValue&>(other).GetText()));
  }
  return other.GetType() == ScoreValue::kString && test(std::string_view(other.GetString()));
}

/// The same for the sign of the comparison of two texts; char_traits compares as unsigned bytes.
template <typename Test>
bool AskOrder(const std::string& text, const ScoreValue& other, Test test) {
  return AskText(other, [&](std::string_view otherText) {
    return test(WithoutTrailingBlanks(text).compare(WithoutTrailingBlanks(otherText)));
  });
}

}  // namespace

// Defined here too, so that hosts and plug-ins can take its address.
constexpr int StringValue::MAX_STRING;

StringValue::StringValue() = default;
StringValue::StringValue(const std::string& text) : text_(text), length_(static_cast<int32_t>(text.size())) {}
StringValue::StringValue(const char* text) : StringValue(std::string(text == nullptr ? "" : text)) {}
StringValue::StringValue(const StringValue& other) = default;
StringValue& StringValue::operator=(const StringValue& other) = default;
StringValue::StringValue(StringValue&& other) noexcept = default;
StringValue& StringValue::operator=(StringValue&& other) noexcept = default;
StringValue::~StringValue() = default;

void StringValue::SetValue(const ScoreValue* other) {
  const auto take = [this](std::string_view text) {
    text_.assign(text);
    return true;
  };
  if (other == nullptr || !AskText(*other, take)) text_.clear();
}

ScoreValue* StringValue::GetValue() const {
  return Clone();
}
ScoreValue* StringValue::Clone() const {
  return new StringValue(*this);
}

bool StringValue::operator==(const ScoreValue& other) const {
  // Not through the order, which has to look into texts of different lengths.
  return AskText(other, [this](std::string_view text) {
    return WithoutTrailingBlanks(text_) == WithoutTrailingBlanks(text);
  });
}
bool StringValue::operator>(const ScoreValue& other) const {
  return AskOrder(text_, other, [](int order) { return order > 0; });
}
bool StringValue::operator<(const ScoreValue& other) const {
  return AskOrder(text_, other, [](int order) { return order < 0; });
}
bool StringValue::operator<=(const ScoreValue& other) const {
  return AskOrder(text_, other, [](int order) { return order <= 0; });
}
bool StringValue::operator>=(const ScoreValue& other) const {
  return AskOrder(text_, other, [](int order) { return order >= 0; });
}

bool StringValue::Equal(const ScoreValue* other, bool exact, bool) const {
  if (other == nullptr) return false;
  return exact ? AskText(*other, [this](std::string_view text) { return text_ == text; }) : *this == *other;
}

int StringValue::GetInt() const {
  size_t at = 0;
  while (at < text_.size() && (text_[at] == ' ' || (text_[at] >= '\t' && text_[at] <= '\r')))
    ++at;
  const bool negative = at < text_.size() && text_[at] == '-';
  if (at < text_.size() && (text_[at] == '-' || text_[at] == '+')) ++at;
  constexpr long long kBound = 1LL + std::numeric_limits<int>::max();
  long long number = 0;
  for (; at < text_.size() && text_[at] >= '0' && text_[at] <= '9' && number < kBound; ++at) {
    number = 10 * number + (text_[at] - '0');
  }
  if (negative) return number >= kBound ? std::numeric_limits<int>::min() : static_cast<int>(-number);
  return number >= kBound ? std::numeric_limits<int>::max() : static_cast<int>(number);
}

double StringValue::GetDouble() const {
  double number = 0.0;
  ReadDouble(text_, number);
  return number;
}

}  // namespace MCKestrel_800
