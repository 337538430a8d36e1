#include <unicode/ucnv.h>

#include "kestrel/foundation/MultibyteText.h"
#include "kestrel/foundation/TextConverter.h"
#include "kestrel/foundation/Utf8Scheme.h"

namespace MCXML_800 {

namespace {

/// Text of a code page other than UTF-8. Each character is read from the converter's initial state: code
/// pages with shift states, which are for transport, cannot be entered in the middle anyhow.
class CodePageScheme {
 public:
  explicit CodePageScheme(UConverter* converter) : converter_(converter) {
    UErrorCode status = U_ZERO_ERROR;
    ucnv_setToUCallBack(converter_, UCNV_TO_U_CALLBACK_STOP, nullptr, &action_, &context_, &status);
  }
  ~CodePageScheme() {
    UErrorCode status = U_ZERO_ERROR;
    ucnv_setToUCallBack(converter_, action_, context_, nullptr, nullptr, &status);
    ucnv_resetToUnicode(converter_);
  }
  CodePageScheme(const CodePageScheme&) = delete;
  CodePageScheme& operator=(const CodePageScheme&) = delete;

  Step Next(const char* at, const char* end) {
    // Some characters make two code points: the second is dropped with the state.
    ucnv_resetToUnicode(converter_);
    const char* next = at;
    UErrorCode status = U_ZERO_ERROR;
    const UChar32 c = ucnv_getNextUChar(converter_, &next, end, &status);
    const size_t bytes = static_cast<size_t>(next - at);
    if (U_SUCCESS(status) && bytes > 0) return Step::Of(bytes, static_cast<char32_t>(c));
    if (status == U_INVALID_CHAR_FOUND && bytes > 0) return Step::Without(at, bytes, false);
    return Step::Without(at, 1, true);
  }

  /// Asks the converter, which waits for more after a lead byte. Its own table of them (ucnv_getStarters) is
  /// copied whole for each question, and not every converter has one.
  bool IsLead(unsigned char byte) {
    ucnv_resetToUnicode(converter_);
    const char text = static_cast<char>(byte);
    const char* next = &text;
    UErrorCode status = U_ZERO_ERROR;
    ucnv_getNextUChar(converter_, &next, &text + 1, &status);
    return status == U_TRUNCATED_CHAR_FOUND;
  }

  size_t SafePoint(const char* text, size_t, size_t index) {
    switch (ucnv_getType(converter_)) {
      case UCNV_SBCS:
      case UCNV_LATIN_1:
      case UCNV_US_ASCII:
        return index;
      case UCNV_DBCS:
      case UCNV_MBCS:
        return SafePointInMultibyte(text, index);
      default:
        return 0;
    }
  }

 private:
  size_t SafePointInMultibyte(const char* text, size_t index) {
    if (ucnv_getMaxCharSize(converter_) <= 2) {
      // What is no lead byte can only end a character. Looking at the byte before alone would not do: trail
      // bytes may look like lead bytes.
      while (index > 0 && IsLead(static_cast<unsigned char>(text[index - 1])))
        --index;
    } else {
      // Code pages with longer characters (GB 18030, EUC) have none with a byte below the digits.
      while (index > 0 && static_cast<unsigned char>(text[index - 1]) >= '0')
        --index;
    }
    return index;
  }

  UConverter* converter_;
  UConverterToUCallback action_ = nullptr;
  const void* context_ = nullptr;
};

/// Calls `operation` with the walk through the converter's kind of text.
template <class Operation>
auto WithWalk(UConverter* converter, Operation operation) {
  converter = OrDefault(converter);
  if (IsUtf8(converter)) {
    Utf8Scheme scheme;
    return operation(Walk<Utf8Scheme>(scheme));
  }
  CodePageScheme scheme(converter);
  return operation(Walk<CodePageScheme>(scheme));
}

}  // namespace

int VEXAMBmblen_A(UConverter* converter, const char* at, size_t length) {
  return WithWalk(converter, [&](auto walk) { return walk.Mblen(at, length); });
}
size_t VEXAMBmbclen_A(UConverter* converter, const char* at) {
  return WithWalk(converter, [&](auto walk) { return walk.Mbclen(at); });
}
bool VEXAMBIsLeadByte_A(UConverter* converter, unsigned char byte) {
  converter = OrDefault(converter);
  if (IsUtf8(converter)) return Utf8Scheme().IsLead(byte);
  return CodePageScheme(converter).IsLead(byte);
}
const char* VEXAMBstrinc_A(UConverter* converter, const char* at) {
  return WithWalk(converter, [&](auto walk) { return walk.Strinc(at); });
}
const char* VEXAMBAnsiPrev_A(UConverter* converter, const char* start, const char* at) {
  return WithWalk(converter, [&](auto walk) { return walk.AnsiPrev(start, at); });
}
size_t VEXAMBPreviousIndex_A(UConverter* converter, const char* text, size_t index) {
  return WithWalk(converter, [&](auto walk) { return walk.PreviousIndex(text, index); });
}
size_t VEXAMBFindStart_A(UConverter* converter, const char* text, size_t length, size_t index) {
  return WithWalk(converter, [&](auto walk) { return walk.FindStart(text, length, index); });
}
std::vector<size_t> VEXAMBFindStarts_A(UConverter* converter, const char* text, size_t length) {
  return WithWalk(converter, [&](auto walk) { return walk.FindStarts(text, length); });
}
char* VEXAMBstrncpy_A(UConverter* converter, char* to, const char* from, size_t size) {
  return WithWalk(converter, [&](auto walk) { return walk.Strncpy(to, from, size); });
}
const char* VEXAMBstrchr_A(UConverter* converter, const char* text, char32_t character) {
  return WithWalk(converter, [&](auto walk) { return walk.Strchr(text, character, false); });
}
const char* VEXAMBstrrchr_A(UConverter* converter, const char* text, char32_t character) {
  return WithWalk(converter, [&](auto walk) { return walk.Strchr(text, character, true); });
}
size_t VEXAMBstrcspn_A(UConverter* converter, const char* text, const char* set) {
  return WithWalk(converter, [&](auto walk) { return walk.Strcspn(text, set); });
}
int VEXAMBstrnicmp_A(UConverter* converter, const char* left, const char* right, size_t size) {
  return WithWalk(converter, [&](auto walk) { return walk.Strnicmp(left, right, size); });
}
int VEXAMBqstricmp_A(UConverter* converter, const char* left, const char* right) {
  return WithWalk(converter, [&](auto walk) { return walk.Stricmp(left, right); });
}
char32_t VEXAMBU32Get_A(UConverter* converter, const char* at) {
  return WithWalk(converter, [&](auto walk) { return walk.U32Get(at); });
}

UConverter* VEXAMBConverterNew_A(UConverter* converter, const char* name) {
  if (name == nullptr) return VEXAMBConverterNew_C(nullptr);
  std::u16string wide;
  if (DecodeText(converter, name, std::strlen(name), wide) != 0) return nullptr;
  UErrorCode status = U_ZERO_ERROR;
  return ucnv_openU(wide.c_str(), &status);
}

}  // namespace MCXML_800
