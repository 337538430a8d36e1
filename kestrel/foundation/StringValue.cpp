#include "kestrel/foundation/StringValue.h"

#include <limits>
#include <string_view>
#include <typeinfo>

#include "kestrel/foundation/NumberText.h"

namespace MCKestrel_800 {

namespace {

std::string_view WithoutTrailingBlanks(std::string_view text) {
  const size_t last = text.find_last_not_of(' ');
  return text.substr(0, last == std::string_view::npos ? 0 : last + 1);
}

/// The other's text without copying it, when it is of our own class; anything else, a class derived from ours
/// included, goes through its GetString. Asking for the exact class costs a tenth of a dynamic_cast.
class OtherText {
 public:
  explicit OtherText(const ScoreValue& other) {
    if (typeid(other) == typeid(StringValue)) {
      view_ = static_cast<const StringValue&>(other).GetText();
    } else {
      held_ = other.GetString();
      view_ = held_;
    }
  }
  OtherText(const OtherText&) = delete;
  OtherText& operator=(const OtherText&) = delete;
  std::string_view Trimmed() const { return WithoutTrailingBlanks(view_); }
  std::string_view Whole() const { return view_; }

 private:
  std::string held_;
  std::string_view view_;
};

/// Below 0, 0 or above 0; char_traits compares as unsigned bytes.
int Compare(const std::string& text, const ScoreValue& other) {
  return WithoutTrailingBlanks(text).compare(OtherText(other).Trimmed());
}

bool IsText(const ScoreValue& other) {
  return other.GetType() == ScoreValue::kString;
}

}  // namespace

StringValue::StringValue() = default;
StringValue::StringValue(const std::string& text) : text_(text), length_(static_cast<int32_t>(text.size())) {}
StringValue::StringValue(const char* text) : StringValue(std::string(text == nullptr ? "" : text)) {}
StringValue::StringValue(const StringValue& other) = default;
StringValue& StringValue::operator=(const StringValue& other) = default;
StringValue::~StringValue() = default;

void StringValue::SetValue(const ScoreValue* other) {
  if (other == nullptr || !IsText(*other)) {
    text_.clear();
  } else if (typeid(*other) == typeid(StringValue)) {
    text_ = static_cast<const StringValue*>(other)->text_;
  } else {
    text_ = other->GetString();
  }
}

ScoreValue* StringValue::GetValue() const {
  return Clone();
}
ScoreValue* StringValue::Clone() const {
  return new StringValue(*this);
}

bool StringValue::operator==(const ScoreValue& other) const {
  return IsText(other) && Compare(text_, other) == 0;
}
bool StringValue::operator>(const ScoreValue& other) const {
  return IsText(other) && Compare(text_, other) > 0;
}
bool StringValue::operator<(const ScoreValue& other) const {
  return IsText(other) && Compare(text_, other) < 0;
}
bool StringValue::operator<=(const ScoreValue& other) const {
  return IsText(other) && Compare(text_, other) <= 0;
}
bool StringValue::operator>=(const ScoreValue& other) const {
  return IsText(other) && Compare(text_, other) >= 0;
}

bool StringValue::Equal(const ScoreValue* other, bool exact, bool) const {
  if (other == nullptr || !IsText(*other)) return false;
  if (text_ == OtherText(*other).Whole()) return true;
  return !exact && Compare(text_, *other) == 0;
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
