#include "kestrel/foundation/NarrowText.h"

#include "kestrel/foundation/TextConverter.h"
#include "kestrel/foundation/Utf8Text.h"

namespace MCXML_800 {

void AppendUtf16AsNarrow(const char16_t* text, size_t length, std::string& out) {
  // Nearly all text of documents is ASCII, which is the same in UTF-8 and in every code page that we know.
  const size_t start = out.size();
  out.resize(start + length);
  char* const to = out.data() + start;
  size_t i = 0;
  for (; i < length && text[i] < 0x80; ++i)
    to[i] = static_cast<char>(text[i]);
  if (i == length) return;
  out.resize(start + i);
  if (qUTF8mode() != 0) {
    AppendUtf16AsUtf8(text + i, length - i, out);
  } else {
    EncodeText(nullptr, text + i, length - i, out);
  }
}

std::string Utf16ToNarrow(const char16_t* text, size_t length) {
  std::string out;
  AppendUtf16AsNarrow(text, length, out);
  return out;
}

std::u16string NarrowToUtf16(std::string_view text) {
  std::u16string out(text.size(), u'\0');
  size_t i = 0;
  for (; i < text.size() && static_cast<unsigned char>(text[i]) < 0x80; ++i)
    out[i] = static_cast<char16_t>(text[i]);
  if (i == text.size()) return out;
  out.resize(i);
  if (qUTF8mode() != 0) {
    AppendUtf8AsUtf16(text.data() + i, text.size() - i, out);
  } else {
    DecodeText(nullptr, text.data() + i, text.size() - i, out);
  }
  return out;
}

}  // namespace MCXML_800
