// A text that speaks the library's narrow text, UTF-8 and the parser's UTF-16.

#ifndef KESTREL_FOUNDATION_PLIANTSTRING_H
#define KESTREL_FOUNDATION_PLIANTSTRING_H

#include <cstddef>
#include <string>

#include "kestrel/platform/Export.h"

namespace MCXML_800 {

/// A string that is held as UTF-16. Lengths and positions count its units; a character beyond U+FFFF has two.
/// Narrow text (char) is generic text, UTF-8 or the process's code page by the UTF-8 mode of the moment;
/// where UTF-8 is meant whatever the mode, the name says so. Malformed bytes become U+FFFD. Null
/// pointers count as empty texts; a text with a length may hold zeros.
///
/// Threads: as with std::string, any number may read at once.
class KESTREL_API PliantString {
 public:
  static constexpr size_t npos = static_cast<size_t>(-1);

  PliantString();
  PliantString(const char* text);
  PliantString(const std::string& text);
  PliantString(const char16_t* text);
  PliantString(const std::u16string& text);
  PliantString(const PliantString&);
  PliantString(PliantString&&) noexcept;
  ~PliantString();

  PliantString& operator=(const PliantString&);
  PliantString& operator=(PliantString&&) noexcept;
  PliantString& operator=(const char* text) { return assign(text); }
  PliantString& operator=(const std::string& text) { return assign(text); }
  PliantString& operator=(const char16_t* text) { return assign(text); }
  PliantString& operator=(const std::u16string& text) { return assign(text); }

  /// Replace the text. The argument may be the object itself or part of it.
  PliantString& assign(const PliantString& text);
  /// The part from unit `start` on, at most `count` units.
  PliantString& assign(const PliantString& text, size_t start, size_t count = npos);
  PliantString& assign(const char* text);
  PliantString& assign(const char* text, size_t length);
  PliantString& assign(const std::string& text);
  PliantString& assign(const char16_t* text);
  PliantString& assign(const char16_t* text, size_t length);
  PliantString& assign(const std::u16string& text);
  PliantString& assignUTF8(const char* text);
  PliantString& assignUTF8(const char* text, size_t length);
  PliantString& assignUTF8(const std::string& text);

  /// Add to the end. The argument may be the object itself or part of it.
  PliantString& append(const PliantString& text);
  PliantString& append(const PliantString& text, size_t start, size_t count = npos);
  PliantString& append(const char* text);
  PliantString& append(const char* text, size_t length);
  PliantString& append(const std::string& text);
  PliantString& append(const char16_t* text);
  PliantString& append(const char16_t* text, size_t length);
  PliantString& append(const std::u16string& text);
  /// A unit as often as said.
  PliantString& append(size_t count, char16_t unit);
  PliantString& operator+=(const PliantString& text) { return append(text); }

  std::string toUTF8() const;
  /// The text as generic narrow text. What a code page lacks becomes its substitute.
  std::string toGeneric() const;
  /// The text for the parser library: terminated, good until the object changes or goes.
  const char16_t* xc_str() const { return text_.c_str(); }

  size_t length() const { return text_.size(); }
  bool empty() const { return text_.empty(); }
  void clear() { text_.clear(); }

  /// Whether the texts are the same, unit by unit.
  bool equals(const PliantString& other) const { return text_ == other.text_; }
  bool equals(const char* text) const { return equals(PliantString(text)); }
  bool equals(const char16_t* text) const;

  /// Less than, equal to or more than 0, by code points, which is also the order of the bytes in UTF-8.
  int compare(const PliantString& other) const;

  /// Reads the whole text as a decimal number, with an optional sign and blanks (spaces, tabs, line ends)
  /// around it. False, with `value` unchanged, when it is none or int cannot hold it.
  bool convertToInteger(int& value) const;

  /// Cuts the text to at most `length` units, one less where a character would be split.
  PliantString& truncateString(size_t length);

  /// Whether the other text occurs in this one. An empty text occurs in every text.
  bool ContainsString(const PliantString& part) const;

  /// Replaces every occurrence of `from`, taken from the left without overlaps; what is put in is not looked
  /// at again. Returns their number: 0 for an empty `from`.
  size_t replaceSubstring(const PliantString& from, const PliantString& to);

 private:
  std::u16string text_;
};

// Free functions, so that a text of another type may stand on either side.
inline bool operator==(const PliantString& left, const PliantString& right) {
  return left.equals(right);
}
inline bool operator!=(const PliantString& left, const PliantString& right) {
  return !left.equals(right);
}
inline bool operator<(const PliantString& left, const PliantString& right) {
  return left.compare(right) < 0;
}
inline bool operator>(const PliantString& left, const PliantString& right) {
  return left.compare(right) > 0;
}
inline bool operator<=(const PliantString& left, const PliantString& right) {
  return left.compare(right) <= 0;
}
inline bool operator>=(const PliantString& left, const PliantString& right) {
  return left.compare(right) >= 0;
}

}  // namespace MCXML_800

#endif  // KESTREL_FOUNDATION_PLIANTSTRING_H
