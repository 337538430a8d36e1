#include "kestrel/foundation/Utf8Text.h"

#include <unicode/utf16.h>
#include <unicode/utf8.h>

#include <algorithm>

namespace MCXML_800 {

namespace {

// A block's output has a fixed size on the stack, so that nothing is allocated for what may not come.
constexpr size_t kBlockUnits = 512;
constexpr size_t kMaxBytesPerUnit = 3;  // a pair of units makes 4 bytes

}  // namespace

bool AppendUtf16AsUtf8(const char16_t* text, size_t length, std::string& out) {
  char block[(kBlockUnits + 1) * kMaxBytesPerUnit];
  bool clean = true;
  size_t at = 0;
  while (at < length) {
    const size_t blockEnd = std::min(length, at + kBlockUnits);
    size_t bytes = 0;
    while (at < blockEnd) {
      UChar32 c;
      U16_NEXT(text, at, length, c);  // may take the second unit of a pair from beyond the block
      if (U_IS_SURROGATE(c)) {
        c = 0xFFFD;
        clean = false;
      }
      U8_APPEND_UNSAFE(block, bytes, c);
    }
    out.append(block, bytes);
  }
  return clean;
}

bool AppendUtf8AsUtf16(const char* text, size_t length, std::u16string& out) {
  const size_t start = out.size();
  out.resize(start + length);  // never more units than bytes
  char16_t* to = out.data() + start;
  bool clean = true;
  size_t at = 0;
  while (at < length) {
    UChar32 c;
    U8_NEXT(text, at, length, c);
    if (c < 0) {
      c = 0xFFFD;
      clean = false;
    }
    if (c <= 0xFFFF) {
      *to++ = static_cast<char16_t>(c);
    } else {
      *to++ = static_cast<char16_t>(U16_LEAD(c));
      *to++ = static_cast<char16_t>(U16_TRAIL(c));
    }
  }
  out.resize(static_cast<size_t>(to - out.data()));
  return clean;
}

}  // namespace MCXML_800
