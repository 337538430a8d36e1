#include <unicode/ucnv.h>
#include <unicode/ustring.h>

#include "kestrel/foundation/MultibyteText.h"
#include "kestrel/foundation/TextConverter.h"
#include "kestrel/foundation/Utf8Scheme.h"

namespace MCXML_800 {

namespace {

Walk<Utf8Scheme> Utf8Walk() {
  static Utf8Scheme scheme;  // it has no state
  return Walk<Utf8Scheme>(scheme);
}

}  // namespace

int VEXAMBmblen_8(const char* at, size_t length) {
  return Utf8Walk().Mblen(at, length);
}
size_t VEXAMBmbclen_8(const char* at) {
  return Utf8Walk().Mbclen(at);
}
bool VEXAMBIsLeadByte_8(unsigned char byte) {
  return Utf8Scheme().IsLead(byte);
}
const char* VEXAMBstrinc_8(const char* at) {
  return Utf8Walk().Strinc(at);
}
const char* VEXAMBAnsiPrev_8(const char* start, const char* at) {
  return Utf8Walk().AnsiPrev(start, at);
}
size_t VEXAMBPreviousIndex_8(const char* text, size_t index) {
  return Utf8Walk().PreviousIndex(text, index);
}
size_t VEXAMBFindStart_8(const char* text, size_t length, size_t index) {
  return Utf8Walk().FindStart(text, length, index);
}
std::vector<size_t> VEXAMBFindStarts_8(const char* text, size_t length) {
  return Utf8Walk().FindStarts(text, length);
}
char* VEXAMBstrncpy_8(char* to, const char* from, size_t size) {
  return Utf8Walk().Strncpy(to, from, size);
}
const char* VEXAMBstrchr_8(const char* text, char32_t character) {
  return Utf8Walk().Strchr(text, character, false);
}
const char* VEXAMBstrrchr_8(const char* text, char32_t character) {
  return Utf8Walk().Strchr(text, character, true);
}
size_t VEXAMBstrcspn_8(const char* text, const char* set) {
  return Utf8Walk().Strcspn(text, set);
}
int VEXAMBstrnicmp_8(const char* left, const char* right, size_t size) {
  return Utf8Walk().Strnicmp(left, right, size);
}
int VEXAMBqstricmp_8(const char* left, const char* right) {
  return Utf8Walk().Stricmp(left, right);
}
char32_t VEXAMBU32Get_8(const char* at) {
  return Utf8Walk().U32Get(at);
}

UConverter* VEXAMBConverterNew_8(const char* name) {
  if (name == nullptr) return VEXAMBConverterNew_C(nullptr);
  constexpr int32_t kMaxName = 59;
  // More units than this cannot matter: each makes at least one byte of the name.
  const size_t length = std::strlen(name);
  const size_t used = length > 4 * kMaxName ? VEXAMBFindStart_8(name, length, 4 * kMaxName) : length;
  char16_t wide[4 * kMaxName];
  int32_t wideLength = 0;
  UErrorCode status = U_ZERO_ERROR;
  u_strFromUTF8(wide, 4 * kMaxName, &wideLength, name, static_cast<int32_t>(used), &status);
  if (U_FAILURE(status)) return nullptr;

  UConverter* const clone = CloneConverter(DefaultConverter());
  if (clone == nullptr) return nullptr;
  char narrow[kMaxName + 1] = "";
  ucnv_fromUChars(clone, narrow, kMaxName, wide, wideLength, &status);
  ucnv_close(clone);
  if (U_FAILURE(status) && status != U_BUFFER_OVERFLOW_ERROR) return nullptr;
  return VEXAMBConverterNew_C(narrow);
}

}  // namespace MCXML_800
