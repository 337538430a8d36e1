#include "kestrel/foundation/NarrowText.h"

#include <unicode/ucnv.h>
#include <unicode/ustring.h>

#include <atomic>
#include <memory>

#include "kestrel/platform/Environment.h"

namespace MCXML_800 {

namespace {

std::atomic<int> utf8Mode{MCKestrel_800::NarrowTextIsUtf8ByDefault() ? 1 : 0};

struct CloseConverter {
  void operator()(UConverter* converter) const { ucnv_close(converter); }
};
using Converter = std::unique_ptr<UConverter, CloseConverter>;

/// A converter of the process's code page that belongs to the calling thread, since converters keep state.
UConverter* CodePageConverter() {
  thread_local Converter converter = [] {
    UErrorCode status = U_ZERO_ERROR;
    return Converter(ucnv_open(MCKestrel_800::CodePageName().c_str(), &status));
  }();
  if (converter != nullptr) ucnv_reset(converter.get());
  return converter.get();
}

bool IsHighSurrogate(char16_t c) {
  return c >= 0xD800 && c <= 0xDBFF;
}
bool IsLowSurrogate(char16_t c) {
  return c >= 0xDC00 && c <= 0xDFFF;
}

void AppendUtf8(char32_t c, std::string& out) {
  const auto put = [&out](char32_t byte) {
    out.push_back(static_cast<char>(static_cast<unsigned char>(byte)));
  };
  if (c < 0x80) {
    put(c);
  } else if (c < 0x800) {
    put(0xC0 | (c >> 6));
    put(0x80 | (c & 0x3F));
  } else if (c < 0x10000) {
    put(0xE0 | (c >> 12));
    put(0x80 | ((c >> 6) & 0x3F));
    put(0x80 | (c & 0x3F));
  } else {
    put(0xF0 | (c >> 18));
    put(0x80 | ((c >> 12) & 0x3F));
    put(0x80 | ((c >> 6) & 0x3F));
    put(0x80 | (c & 0x3F));
  }
}

void AppendAsUtf8(const char16_t* text, size_t length, std::string& out) {
  for (size_t i = 0; i < length; ++i) {
    char32_t c = text[i];
    if (IsHighSurrogate(text[i]) && i + 1 < length && IsLowSurrogate(text[i + 1])) {
      c = 0x10000 + ((c - 0xD800) << 10) + (static_cast<char32_t>(text[++i]) - 0xDC00);
    } else if (IsHighSurrogate(text[i]) || IsLowSurrogate(text[i])) {
      c = 0xFFFD;  // half of a pair stands for no character
    }
    AppendUtf8(c, out);
  }
}

void AppendAsCodePage(const char16_t* text, size_t length, std::string& out) {
  UConverter* const converter = CodePageConverter();
  if (converter == nullptr) return AppendAsUtf8(text, length, out);
  char block[256];
  const char16_t* at = text;
  UErrorCode status = U_ZERO_ERROR;
  do {
    char* end = block;
    status = U_ZERO_ERROR;
    ucnv_fromUnicode(converter, &end, block + sizeof block, &at, text + length, nullptr, true, &status);
    out.append(block, end);
  } while (status == U_BUFFER_OVERFLOW_ERROR);
}

std::u16string FromUtf8(std::string_view text) {
  std::u16string out(text.size(), u'\0');
  int32_t length = 0;
  UErrorCode status = U_ZERO_ERROR;
  u_strFromUTF8WithSub(out.data(), static_cast<int32_t>(out.size()), &length, text.data(),
                       static_cast<int32_t>(text.size()), 0xFFFD, nullptr, &status);
  out.resize(U_SUCCESS(status) ? static_cast<size_t>(length) : 0);
  return out;
}

std::u16string FromCodePage(std::string_view text) {
  UConverter* const converter = CodePageConverter();
  if (converter == nullptr) return FromUtf8(text);
  std::u16string out;
  char16_t block[256];
  const char* at = text.data();
  UErrorCode status = U_ZERO_ERROR;
  do {
    char16_t* end = block;
    status = U_ZERO_ERROR;
    ucnv_toUnicode(converter, &end, block + 256, &at, text.data() + text.size(), nullptr, true, &status);
    out.append(block, end);
  } while (status == U_BUFFER_OVERFLOW_ERROR);
  return out;
}

}  // namespace

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
    AppendAsUtf8(text + i, length - i, out);
  } else {
    AppendAsCodePage(text + i, length - i, out);
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
  return out + (qUTF8mode() != 0 ? FromUtf8(text.substr(i)) : FromCodePage(text.substr(i)));
}

void SetUTF8mode(int on) {
  utf8Mode.store(on, std::memory_order_relaxed);
}
int qUTF8mode() {
  return utf8Mode.load(std::memory_order_relaxed);
}

}  // namespace MCXML_800
