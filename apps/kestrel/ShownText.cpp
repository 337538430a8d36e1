#include "apps/kestrel/ShownText.h"

namespace kestrel_program {
namespace {

/// What the second byte of a character may be; the first byte decides.
struct SecondByte {
  unsigned lowest;
  unsigned highest;
};

SecondByte SecondByteAfter(unsigned first) {
  switch (first) {
    case 0xC2:  // Below are control characters, which terminals obey like those of ASCII.
    case 0xE0:
      return {0xA0, 0xBF};
    case 0xED:
      return {0x80, 0x9F};
    case 0xF0:
      return {0x90, 0xBF};
    case 0xF4:
      return {0x80, 0x8F};
    default:
      return {0x80, 0xBF};
  }
}

/// The bytes of the printable character that the text begins with; 0 when it begins with none.
std::size_t PrintableLength(std::string_view text) {
  const unsigned first = static_cast<unsigned char>(text[0]);
  if (first < 0x80) return first >= 0x20 && first != 0x7F ? 1 : 0;
  if (first < 0xC2 || first > 0xF4) return 0;
  const std::size_t length = first < 0xE0 ? 2 : first < 0xF0 ? 3 : 4;
  if (text.size() < length) return 0;
  const SecondByte second = SecondByteAfter(first);
  const unsigned found = static_cast<unsigned char>(text[1]);
  if (found < second.lowest || found > second.highest) return 0;
  for (std::size_t i = 2; i < length; ++i) {
    if ((static_cast<unsigned char>(text[i]) & 0xC0u) != 0x80u) return 0;
  }
  return length;
}

}  // namespace

std::string ShownText(std::string_view text) {
  constexpr std::size_t kLongest = 60;
  std::string shown;
  while (!text.empty()) {
    const std::size_t length = PrintableLength(text);
    const std::size_t used = length == 0 ? 1 : length;
    if (shown.size() + used > kLongest) return shown + "...";
    if (length == 0) {
      shown += '?';
    } else {
      shown.append(text.substr(0, length));
    }
    text.remove_prefix(used);
  }
  return shown;
}

}  // namespace kestrel_program
