#include "kestrel/foundation/NarrowText.h"

#include <cstdint>
#include <cstring>

#include "kestrel/foundation/TextConverter.h"
#include "kestrel/foundation/Utf8Text.h"

namespace MCXML_800 {

namespace {

// Nearly all text of documents is ASCII, which is the same in UTF-8 and in every code page that we know. It
// is taken in words of the machine; the order of the bytes in them does not matter.

/// Copies the ASCII characters that the text begins with and returns their number. `to` has room for
/// `length`.
size_t CopyAscii(const char16_t* text, size_t length, char* to) {
  size_t at = 0;
  for (; at + 4 <= length; at += 4) {
    uint64_t units;
    std::memcpy(&units, text + at, sizeof units);
    if ((units & 0xFF80FF80FF80FF80u) != 0) break;
    units = (units | (units >> 8)) & 0x0000FFFF0000FFFFu;
    const auto bytes = static_cast<uint32_t>(units | (units >> 16));
    std::memcpy(to + at, &bytes, sizeof bytes);
  }
  for (; at < length && text[at] < 0x80; ++at)
    to[at] = static_cast<char>(text[at]);
  return at;
}

size_t CountAscii(std::string_view text) {
  size_t at = 0;
  for (; at + 8 <= text.size(); at += 8) {
    uint64_t bytes;
    std::memcpy(&bytes, text.data() + at, sizeof bytes);
    if ((bytes & 0x8080808080808080u) != 0) break;
  }
  while (at < text.size() && static_cast<unsigned char>(text[at]) < 0x80)
    ++at;
  return at;
}

void AppendOthers(const char16_t* text, size_t length, std::string& out) {
  if (qUTF8mode() != 0) {
    AppendUtf16AsUtf8(text, length, out);
  } else {
    EncodeText(nullptr, text, length, out);
  }
}

// Names and numbers fit; longer texts are taken in blocks of this size.
constexpr size_t kShortText = 256;

}  // namespace

void AppendUtf16AsNarrow(const char16_t* text, size_t length, std::string& out) {
  char block[kShortText];
  while (length > 0) {
    const size_t wanted = length < kShortText ? length : kShortText;
    const size_t ascii = CopyAscii(text, wanted, block);
    out.append(block, ascii);
    text += ascii;
    length -= ascii;
    if (ascii < wanted) return AppendOthers(text, length, out);
  }
}

std::string Utf16ToNarrow(const char16_t* text, size_t length) {
  char block[kShortText];
  const size_t ascii = CopyAscii(text, length < kShortText ? length : kShortText, block);
  std::string out(block, ascii);
  if (ascii < length) AppendUtf16AsNarrow(text + ascii, length - ascii, out);
  return out;
}

std::u16string NarrowToUtf16(std::string_view text) {
  const size_t ascii = CountAscii(text);
  std::u16string out(text.begin(), text.begin() + static_cast<std::ptrdiff_t>(ascii));
  if (ascii == text.size()) return out;
  text.remove_prefix(ascii);
  if (qUTF8mode() != 0) {
    AppendUtf8AsUtf16(text.data(), text.size(), out);
  } else {
    DecodeText(nullptr, text.data(), text.size(), out);
  }
  return out;
}

}  // namespace MCXML_800
