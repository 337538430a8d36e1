#include <unicode/ucnv.h>
#include <unicode/utf16.h>
#include <unicode/utf8.h>

#include <climits>
#include <cstdlib>
#include <cwchar>

#include "kestrel/foundation/MultibyteText.h"
#include "kestrel/foundation/MultibyteWalk.h"
#include "kestrel/foundation/TextConverter.h"

namespace MCXML_800 {

namespace {

constexpr size_t kMalformed = static_cast<size_t>(-1);
constexpr size_t kIncomplete = static_cast<size_t>(-2);

/// Text of the C library's locale. Each character is read from the initial shift state, as no multibyte
/// locale in use has another; the state lies here, so threads do not disturb each other.
class LocaleScheme {
 public:
  Step Next(const char* at, const char* end) const {
    wchar_t wide = 0;
    std::mbstate_t state{};
    const size_t bytes = std::mbrtowc(&wide, at, static_cast<size_t>(end - at), &state);
    if (bytes == kMalformed || bytes == kIncomplete) return Step::Without(at, 1, true);
    const auto codePoint = static_cast<char32_t>(wide);
    // Some C libraries read UTF-8 beyond Unicode's end.
    if (codePoint > 0x10FFFF || U_IS_SURROGATE(codePoint)) return Step::Without(at, bytes, false);
    return Step::Of(bytes == 0 ? 1 : bytes, codePoint);
  }

  bool IsLead(unsigned char byte) const {
    const char text = static_cast<char>(byte);
    return Length(&text, 1) == kIncomplete;
  }

  size_t SafePoint(const char* text, size_t, size_t index) const {
    if (MB_CUR_MAX == 1) return index;
    if (IsUtf8Locale()) return SafePointInUtf8(text, index);
    if (MB_CUR_MAX == 2) {
      // What is no lead byte can only end a character.
      while (index > 0 && IsLead(static_cast<unsigned char>(text[index - 1])))
        --index;
    } else {
      // In every multibyte locale a byte below the digits stands for itself.
      while (index > 0 && static_cast<unsigned char>(text[index - 1]) >= '0')
        --index;
    }
    return index;
  }

 private:
  static size_t Length(const char* text, size_t length) {
    std::mbstate_t state{};
    return std::mbrlen(text, length, &state);
  }

  /// Not ICU's way back, since C libraries differ from it, and from each other, in what is malformed: a byte
  /// that is no trail byte begins a character for all of them.
  static size_t SafePointInUtf8(const char* text, size_t index) {
    const size_t nearest = index - std::min<size_t>(index, MB_CUR_MAX - 1);
    for (size_t at = index;; --at) {
      if (!U8_IS_TRAIL(text[at])) return at;
      if (at == nearest) return index;  // what begins further back ends before
    }
  }

  /// No other encoding takes both texts, of two and of three bytes, for one character each.
  static bool IsUtf8Locale() { return Length("\xC3\xA9", 2) == 2 && Length("\xE2\x82\xAC", 3) == 3; }
};

Walk<LocaleScheme> LocaleWalk() {
  static LocaleScheme scheme;  // it has no state
  return Walk<LocaleScheme>(scheme);
}

}  // namespace

int VEXAMBmblen_C(const char* at, size_t length) {
  return LocaleWalk().Mblen(at, length);
}
size_t VEXAMBmbclen_C(const char* at) {
  return LocaleWalk().Mbclen(at);
}
bool VEXAMBIsLeadByte_C(unsigned char byte) {
  return LocaleScheme().IsLead(byte);
}
const char* VEXAMBstrinc_C(const char* at) {
  return LocaleWalk().Strinc(at);
}
const char* VEXAMBAnsiPrev_C(const char* start, const char* at) {
  return LocaleWalk().AnsiPrev(start, at);
}
size_t VEXAMBPreviousIndex_C(const char* text, size_t index) {
  return LocaleWalk().PreviousIndex(text, index);
}
size_t VEXAMBFindStart_C(const char* text, size_t length, size_t index) {
  return LocaleWalk().FindStart(text, length, index);
}
std::vector<size_t> VEXAMBFindStarts_C(const char* text, size_t length) {
  return LocaleWalk().FindStarts(text, length);
}
char* VEXAMBstrncpy_C(char* to, const char* from, size_t size) {
  return LocaleWalk().Strncpy(to, from, size);
}
const char* VEXAMBstrchr_C(const char* text, char32_t character) {
  return LocaleWalk().Strchr(text, character, false);
}
const char* VEXAMBstrrchr_C(const char* text, char32_t character) {
  return LocaleWalk().Strchr(text, character, true);
}
size_t VEXAMBstrcspn_C(const char* text, const char* set) {
  return LocaleWalk().Strcspn(text, set);
}
int VEXAMBstrnicmp_C(const char* left, const char* right, size_t size) {
  return LocaleWalk().Strnicmp(left, right, size);
}
int VEXAMBqstricmp_C(const char* left, const char* right) {
  return LocaleWalk().Stricmp(left, right);
}
char32_t VEXAMBU32Get_C(const char* at) {
  return LocaleWalk().U32Get(at);
}

UConverter* VEXAMBConverterNew_C(const char* name) {
  if (name == nullptr) return CloneConverter(DefaultConverter());
  UErrorCode status = U_ZERO_ERROR;
  return ucnv_open(name, &status);
}

void VEXAMBConverterDelete(UConverter* converter) {
  ucnv_close(converter);
}

}  // namespace MCXML_800
