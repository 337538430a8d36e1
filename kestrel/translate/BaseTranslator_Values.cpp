// The checks and conversions of attribute texts.

#include <climits>
#include <cstring>
#include <memory>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumberText.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/translate/BaseTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

constexpr size_t kNone = static_cast<size_t>(-1);

bool IsDigit(char16_t c) {
  return c >= u'0' && c <= u'9';
}

// The part of a text that TrimBlanks keeps: `first` to `last`.
template <typename Char>
void TrimRange(const Char*& first, const Char*& last) {
  const size_t length = static_cast<size_t>(last - first);
  size_t front = 0;
  while (front < length && first[front] == ' ')
    ++front;
  if (front == length) return;
  size_t back = length - 1;
  while (first[back] == ' ')
    --back;
  // As many characters as lie up to the last non-blank one, counted from the first: with blanks in front,
  // that many of the trailing ones stay. Documents in use depend on it.
  const size_t kept = back + 1 < length - front ? back + 1 : length - front;
  first += front;
  last = first + kept;
}

// Where a sign or letter that may occur once stands.
struct Places {
  size_t point = kNone;
  size_t exponent = kNone;
};

// The rules for exponent letters and the point; false when one is broken.
template <typename Char>
bool FindPlaces(const Char* text, size_t length, Places& places) {
  for (size_t i = 0; i < length; ++i) {
    const Char c = text[i];
    if (c == '.') {
      if (places.point != kNone || i + 1 == length) return false;
      places.point = i;
    } else if (c == 'e' || c == 'E') {
      if (places.exponent != kNone || i == 0 || i + 1 == length) return false;
      places.exponent = i;
    }
  }
  if (places.point != kNone && places.exponent != kNone) return places.point + 1 < places.exponent;
  return true;
}

// A sign may stand first and directly after the exponent letter, never last.
template <typename Char>
bool IsDoubleText(const Char* text, size_t length) {
  Places places;
  if (length == 0 || !FindPlaces(text, length, places)) return false;
  for (size_t i = 0; i < length; ++i) {
    const Char c = text[i];
    if (c == '-' || c == '+') {
      const bool allowed = i == 0 || (places.exponent != kNone && i == places.exponent + 1);
      if (!allowed || i + 1 == length) return false;
    } else if (!IsDigit(static_cast<char16_t>(c)) && i != places.point && i != places.exponent) {
      return false;
    }
  }
  return true;
}

template <typename Char>
bool ToDouble(const Char* first, const Char* last, double& out) {
  TrimRange(first, last);
  const size_t length = static_cast<size_t>(last - first);
  if (!IsDoubleText(first, length)) return false;
  // The text is plain ASCII now; only a freak does not fit the room on the stack.
  char room[64];
  std::unique_ptr<char[]> more;
  char* narrow = room;
  if (length > sizeof(room)) {
    more.reset(new char[length]);
    narrow = more.get();
  }
  for (size_t i = 0; i < length; ++i)
    narrow[i] = static_cast<char>(first[i]);
  // A sign and an exponent without a digit between keep the rules, and read as nothing.
  if (!ParseDouble(narrow, narrow + length, out)) out = 0.0;
  return true;
}

template <typename Char>
bool ToInt(const Char* text, size_t length, int& out) {
  if (length == 0) return false;
  const bool hasSign = text[0] == '-' || text[0] == '+';
  if (hasSign && length == 1) return false;
  const bool isNegative = text[0] == '-';
  long long value = 0;
  for (size_t i = hasSign ? 1 : 0; i < length; ++i) {
    if (!IsDigit(static_cast<char16_t>(text[i]))) return false;
    if (value <= INT_MAX) value = value * 10 + (text[i] - '0');
  }
  if (isNegative) value = -value;
  out = value > INT_MAX ? INT_MAX : value < INT_MIN ? INT_MIN : static_cast<int>(value);
  return true;
}

const char16_t* End(const char16_t* text) {
  while (*text != 0)
    ++text;
  return text;
}

[[noreturn]] void FailInt(const std::string& text) {
  Fail(KestrelException::kConversion, text + "Invalid integer string -- ");
}

[[noreturn]] void FailDouble(const std::string& text) {
  Fail(KestrelException::kConversion, text + "Invalid double string -- ");
}

}  // namespace

std::string BaseTranslator::TrimBlanks(const std::string& text) {
  const char* first = text.data();
  const char* last = first + text.size();
  TrimRange(first, last);
  return std::string(first, last);
}

int BaseTranslator::VerifyInt(const std::string& text) {
  int value = 0;
  if (!ToInt(text.data(), text.size(), value)) FailInt(text);
  return value;
}

int BaseTranslator::VerifyInt(const XMLCh* text) {
  const char16_t* const first = text != nullptr ? ToUtf16(text) : u"";
  int value = 0;
  if (!ToInt(first, static_cast<size_t>(End(first) - first), value)) FailInt(Narrow(text));
  return value;
}

double BaseTranslator::VerifyDouble(const std::string& text) {
  double value = 0.0;
  if (!ToDouble(text.data(), text.data() + text.size(), value)) FailDouble(text);
  return value;
}

double BaseTranslator::VerifyDouble(const XMLCh* text) {
  const char16_t* const first = text != nullptr ? ToUtf16(text) : u"";
  double value = 0.0;
  if (!ToDouble(first, End(first), value)) FailDouble(Narrow(text));
  return value;
}

double BaseTranslator::VerifyDateTime(const std::string& text, DateTimeType type) {
  if (!DateTimeValue::IsValidDateTime(text, type)) {
    Fail(KestrelException::kConversion, text + " Invalid date time string -- ");
  }
  return DateTimeValue(text, type).GetDouble();
}

double BaseTranslator::VerifyDateTime(const XMLCh* text, DateTimeType type) {
  return VerifyDateTime(Narrow(text), type);
}

ScoreValue* BaseTranslator::CarefullyMakeVarValue(const ScoreDictVar* var, const std::string& text) {
  if (var == nullptr) return nullptr;
  switch (var->GetVarType()) {
    case ScoreDictVar::kNUMERIC_VAR:
      return new NumericValue(VerifyDouble(text));
    case ScoreDictVar::STRING_VAR:
      return new StringValue(text);
    case ScoreDictVar::kDATETIME_VAR:
      return new DateTimeValue(VerifyDouble(text), var->GetDateTimeType());
  }
  return nullptr;
}

ScoreValue* BaseTranslator::CarefullyMakeVarValue(const ScoreDictVar* var, const XMLCh* text) {
  if (var != nullptr && var->GetVarType() == ScoreDictVar::kNUMERIC_VAR)
    return new NumericValue(VerifyDouble(text));
  return CarefullyMakeVarValue(var, Narrow(text));
}

}  // namespace MCKestrel_800
