#include "kestrel/foundation/NumberText.h"

#include <algorithm>
#include <charconv>
#include <limits>

namespace MCKestrel_800 {

namespace {

bool IsDigit(char c) {
  return c >= '0' && c <= '9';
}
bool IsExponentLetter(char c) {
  return c == 'e' || c == 'E';
}
const char* SkipSpace(const char* at, const char* end) {
  while (at != end && (*at == ' ' || (*at >= '\t' && *at <= '\r')))
    ++at;
  return at;
}

/// Whether a number that a double cannot hold is too large, rather than too small: its first digit that is
/// not zero decides, moved by the exponent.
bool IsTooLarge(const char* first, const char* last) {
  long long place = 0;
  bool point = false, seen = false;
  const char* at = first;
  for (; at != last && !IsExponentLetter(*at); ++at) {
    if (*at == '.') {
      point = true;
    } else if (IsDigit(*at)) {
      seen = seen || *at != '0';
      if (seen && !point) ++place;
      if (!seen && point) --place;
    }
  }
  if (at == last) return place > 0;
  ++at;
  const bool negative = at != last && *at == '-';
  if (at != last && (*at == '-' || *at == '+')) ++at;
  long long exponent = 0;
  for (; at != last && exponent < 1'000'000'000'000; ++at)
    exponent = 10 * exponent + (*at - '0');
  return place + (negative ? -exponent : exponent) > 0;
}

}  // namespace

bool ParseDouble(const char* first, const char* last, double& out) {
  const bool negative = first != last && *first == '-';
  if (first != last && (*first == '-' || *first == '+')) ++first;
  // from_chars alone would take a second sign, and names for infinity.
  if (first == last || !(IsDigit(*first) || *first == '.')) return false;
  double value = 0.0;
  const std::from_chars_result read = std::from_chars(first, last, value);
  if (read.ptr != last || read.ec == std::errc::invalid_argument) return false;
  if (read.ec == std::errc::result_out_of_range) {
    value = IsTooLarge(first, last) ? std::numeric_limits<double>::infinity() : 0.0;
  }
  out = negative ? -value : value;
  return true;
}

bool ReadDouble(std::string_view text, double& out) {
  out = 0.0;
  const char* const end = text.data() + text.size();
  const char* at = SkipSpace(text.data(), end);
  const bool negative = at != end && *at == '-';
  if (at != end && (*at == '-' || *at == '+')) ++at;
  // from_chars alone would take a second sign, and names for infinity.
  if (at == end || !(IsDigit(*at) || *at == '.')) return false;
  double value = 0.0;
  const std::from_chars_result read = std::from_chars(at, end, value);
  if (read.ec == std::errc::invalid_argument) return false;
  // A stream takes the letter of an exponent before it knows whether digits follow, and cannot give it back.
  if (read.ptr != end && IsExponentLetter(*read.ptr) && std::none_of(at, read.ptr, IsExponentLetter))
    return false;
  const bool tooLarge = read.ec == std::errc::result_out_of_range && IsTooLarge(at, read.ptr);
  if (tooLarge) value = std::numeric_limits<double>::max();
  out = negative ? -value : value;
  return !tooLarge;
}

bool StartsWithInfinity(std::string_view text) {
  const char* const end = text.data() + text.size();
  const char* at = SkipSpace(text.data(), end);
  if (at != end && *at == '+') ++at;
  // from_chars takes no plus sign, but a minus sign, and knows infinity by the names that atof knows.
  if (at == end || *at == '-') return false;
  double value = 0.0;
  const std::from_chars_result read = std::from_chars(at, end, value);
  if (read.ec == std::errc::result_out_of_range) return IsTooLarge(at, read.ptr);
  return read.ec == std::errc() && value == std::numeric_limits<double>::infinity();
}

size_t FormatSixDigits(double value, char (&buffer)[kSixDigitsRoom]) {
  const std::to_chars_result end =
      std::to_chars(buffer, buffer + kSixDigitsRoom, value, std::chars_format::general, 6);
  return static_cast<size_t>(end.ptr - buffer);
}

std::string FormatSixDigits(double value) {
  char buffer[kSixDigitsRoom];
  const size_t length = FormatSixDigits(value, buffer);
  return std::string(buffer, length);
}

size_t FormatShortest(double value, char (&buffer)[kShortestRoom]) {
  return static_cast<size_t>(std::to_chars(buffer, buffer + kShortestRoom, value).ptr - buffer);
}

}  // namespace MCKestrel_800
