#include "kestrel/foundation/PliantString.h"

#include <unicode/utf16.h>
#include <xercesc/util/XercesDefs.hpp>

#include <algorithm>
#include <charconv>
#include <cstring>
#include <type_traits>
#include <vector>

#include "kestrel/foundation/NarrowText.h"
#include "kestrel/foundation/Utf8Text.h"

namespace MCXML_800 {

static_assert(std::is_same<XMLCh, char16_t>::value, "xc_str must be what the parser library takes");

namespace {

size_t Length(const char* text) {
  return text == nullptr ? 0 : std::strlen(text);
}
size_t Length(const char16_t* text) {
  return text == nullptr ? 0 : std::char_traits<char16_t>::length(text);
}

std::u16string FromNarrow(const char* text, size_t length) {
  return text == nullptr ? std::u16string() : NarrowToUtf16(std::string_view(text, length));
}

/// Knuth, Morris and Pratt's search, since std::u16string::find takes the product of both lengths on texts
/// that repeat themselves.
class Searcher {
 public:
  explicit Searcher(const std::u16string& part) : part_(part), fallback_(part.size(), 0) {
    for (size_t i = 1, matched = 0; i < part.size(); ++i) {
      while (matched > 0 && part[i] != part[matched])
        matched = fallback_[matched - 1];
      if (part[i] == part[matched]) ++matched;
      fallback_[i] = matched;
    }
  }

  /// The first occurrence from `start` on, or npos. The part must not be empty.
  size_t Find(const std::u16string& text, size_t start) const {
    for (size_t i = start, matched = 0; i < text.size(); ++i) {
      while (matched > 0 && text[i] != part_[matched])
        matched = fallback_[matched - 1];
      if (text[i] == part_[matched]) ++matched;
      if (matched == part_.size()) return i + 1 - matched;
    }
    return std::u16string::npos;
  }

 private:
  const std::u16string& part_;
  std::vector<size_t> fallback_;
};

bool IsBlank(char16_t unit) {
  return unit == u' ' || unit == u'\t' || unit == u'\r' || unit == u'\n';
}

}  // namespace

// Defined here too, so that hosts and plug-ins can take its address.
constexpr size_t PliantString::npos;

PliantString::PliantString() = default;
PliantString::PliantString(const char* text) : text_(FromNarrow(text, Length(text))) {}
PliantString::PliantString(const std::string& text) : text_(NarrowToUtf16(text)) {}
PliantString::PliantString(const char16_t* text) : text_(text == nullptr ? u"" : text) {}
PliantString::PliantString(const std::u16string& text) : text_(text) {}
PliantString::PliantString(const PliantString&) = default;
PliantString::PliantString(PliantString&&) noexcept = default;
PliantString::~PliantString() = default;
PliantString& PliantString::operator=(const PliantString&) = default;
PliantString& PliantString::operator=(PliantString&&) noexcept = default;

PliantString& PliantString::assign(const PliantString& text) {
  text_ = text.text_;
  return *this;
}
PliantString& PliantString::assign(const PliantString& text, size_t start, size_t count) {
  text_ = start < text.length() ? text.text_.substr(start, count) : std::u16string();
  return *this;
}
PliantString& PliantString::assign(const char* text) {
  return assign(text, Length(text));
}
PliantString& PliantString::assign(const char* text, size_t length) {
  text_ = FromNarrow(text, length);
  return *this;
}
PliantString& PliantString::assign(const std::string& text) {
  return assign(text.data(), text.size());
}
PliantString& PliantString::assign(const char16_t* text) {
  return assign(text, Length(text));
}
PliantString& PliantString::assign(const char16_t* text, size_t length) {
  if (text == nullptr) {
    text_.clear();
  } else {
    text_.assign(text, length);
  }
  return *this;
}
PliantString& PliantString::assign(const std::u16string& text) {
  text_ = text;
  return *this;
}
PliantString& PliantString::assignUTF8(const char* text) {
  return assignUTF8(text, Length(text));
}
PliantString& PliantString::assignUTF8(const char* text, size_t length) {
  text_.clear();
  if (text != nullptr) AppendUtf8AsUtf16(text, length, text_);
  return *this;
}
PliantString& PliantString::assignUTF8(const std::string& text) {
  return assignUTF8(text.data(), text.size());
}

PliantString& PliantString::append(const PliantString& text) {
  text_.append(text.text_);
  return *this;
}
PliantString& PliantString::append(const PliantString& text, size_t start, size_t count) {
  if (start < text.length()) text_.append(text.text_, start, count);
  return *this;
}
PliantString& PliantString::append(const char* text) {
  return append(text, Length(text));
}
PliantString& PliantString::append(const char* text, size_t length) {
  text_.append(FromNarrow(text, length));
  return *this;
}
PliantString& PliantString::append(const std::string& text) {
  return append(text.data(), text.size());
}
PliantString& PliantString::append(const char16_t* text) {
  return append(text, Length(text));
}
PliantString& PliantString::append(const char16_t* text, size_t length) {
  if (text != nullptr) text_.append(text, length);
  return *this;
}
PliantString& PliantString::append(const std::u16string& text) {
  text_.append(text);
  return *this;
}
PliantString& PliantString::append(size_t count, char16_t unit) {
  text_.append(count, unit);
  return *this;
}

std::string PliantString::toUTF8() const {
  std::string out;
  AppendUtf16AsUtf8(text_.data(), text_.size(), out);
  return out;
}
std::string PliantString::toGeneric() const {
  return Utf16ToNarrow(text_.data(), text_.size());
}

bool PliantString::equals(const char16_t* text) const {
  return text_.compare(text == nullptr ? u"" : text) == 0;
}

int PliantString::compare(const PliantString& other) const {
  const auto [mine, theirs] =
      std::mismatch(text_.begin(), text_.end(), other.text_.begin(), other.text_.end());
  if (mine == text_.end() || theirs == other.text_.end()) {
    return static_cast<int>(mine != text_.end()) - static_cast<int>(theirs != other.text_.end());
  }
  // Halves of pairs stand for the highest code points, though some units are higher than they are.
  const bool mineIsHalf = U16_IS_SURROGATE(*mine), theirsIsHalf = U16_IS_SURROGATE(*theirs);
  if (mineIsHalf != theirsIsHalf) return mineIsHalf ? 1 : -1;
  return *mine < *theirs ? -1 : 1;
}

bool PliantString::convertToInteger(int& value) const {
  size_t first = 0, last = text_.size();
  while (first < last && IsBlank(text_[first]))
    ++first;
  while (last > first && IsBlank(text_[last - 1]))
    --last;
  // from_chars knows no plus sign, and takes a minus behind one.
  if (last - first > 1 && text_[first] == u'+' && text_[first + 1] != u'-') ++first;
  std::string digits;
  for (size_t i = first; i < last; ++i)
    digits.push_back(text_[i] < 0x80 ? static_cast<char>(text_[i]) : '?');
  int number = 0;
  const char* const end = digits.data() + digits.size();
  const auto [stop, error] = std::from_chars(digits.data(), end, number);
  if (error != std::errc() || stop != end) return false;
  value = number;
  return true;
}

PliantString& PliantString::truncateString(size_t length) {
  if (length >= text_.size()) return *this;
  if (length > 0 && U16_IS_TRAIL(text_[length]) && U16_IS_LEAD(text_[length - 1])) --length;
  text_.resize(length);
  return *this;
}

bool PliantString::ContainsString(const PliantString& part) const {
  return part.empty() || Searcher(part.text_).Find(text_, 0) != std::u16string::npos;
}

size_t PliantString::replaceSubstring(const PliantString& from, const PliantString& to) {
  if (from.empty()) return 0;
  const Searcher searcher(from.text_);
  std::u16string result;
  size_t count = 0, done = 0;
  for (size_t at = searcher.Find(text_, 0); at != std::u16string::npos; at = searcher.Find(text_, done)) {
    result.append(text_, done, at - done).append(to.text_);
    done = at + from.length();
    ++count;
  }
  if (count == 0) return 0;
  result.append(text_, done, std::u16string::npos);
  text_ = std::move(result);
  return count;
}

}  // namespace MCXML_800
