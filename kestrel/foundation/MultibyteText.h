// Walking through narrow text character by character.

#ifndef KESTREL_FOUNDATION_MULTIBYTETEXT_H
#define KESTREL_FOUNDATION_MULTIBYTETEXT_H

#include <cstddef>
#include <vector>

#include "kestrel/platform/Export.h"

struct UConverter;

/// Every operation is a function whose name is "VEXAMB", the operation and the kind of text that it serves:
///
///   _C  the C library's multibyte locale of the moment. It alone depends on the locale.
///   _A  a code page handled through an ICU converter, which comes first; null is the default converter. The
///       call uses the converter's state, so a converter serves one thread at a time.
///   _8  UTF-8.
///
/// Common rules:
///
/// - Texts without a length end at their zero byte; a null text counts as empty. Texts with a length need no
///   zero byte and may hold some.
/// - Bytes that are no character (malformed) count as a character of one byte each; in UTF-8 the longest
///   piece that begins like a character counts as one. Walking forwards and backwards finds the same
///   boundaries.
/// - A character that the code page allows and Unicode lacks is a character; its code point reads as U+FFFD.
/// - No call allocates, but for strcspn with characters beyond ASCII in its set and FindStarts.
/// - Steps forwards look at one character. Steps backwards in a code page must find a place where a character
///   surely begins, which is near in text with ASCII in it, and at worst the start of the text: whoever walks
///   far backwards takes FindStarts once.
///
/// Operations:
///
/// - mblen: the bytes of the character at `at`, of which `length` bytes are there; 0 at the end of the text
///   (zero byte or no length), -1 when the bytes are malformed or end within the character.
/// - mbclen: the same for terminated text; 1 or more, 0 at the end.
/// - IsLeadByte: whether a character of several bytes can begin with the byte.
/// - strinc: the next character; at the end it stays.
/// - AnsiPrev, PreviousIndex: the character before a place; at the start it stays. A place within a character
///   gives that character.
/// - FindStart: the start of the character that holds byte `index`; `length` when `index` is not less.
/// - FindStarts: the starts of all characters, in one pass.
/// - strncpy: copies whole characters, at most `size` bytes of them, and fills what is left of the `size`
///   bytes with zeros. As with C's function there is no zero byte when the text fills all. Returns `to`.
/// - strchr, strrchr: the first, or last, place of a code point, or null. Zero finds the end of the text.
/// - strcspn: how many bytes come before the first character that is in `set`.
/// - strnicmp, qstricmp: order two texts without regard to case (Unicode's simple case folding, the same in
///   every locale): less than, equal to or more than 0. strnicmp looks at the whole characters within the
///   first `size` bytes of each. A null text orders like an empty one.
/// - U32Get: the code point at `at`: 0 at the end, U+FFFD for what has none.
/// - ConverterNew: a new converter for a name in that kind of text, or for the default encoding when the name
///   is null; null when ICU does not know it. The caller frees it with VEXAMBConverterDelete.
namespace MCXML_800 {

KESTREL_API int VEXAMBmblen_C(const char* at, size_t length);
KESTREL_API int VEXAMBmblen_A(UConverter* converter, const char* at, size_t length);
KESTREL_API int VEXAMBmblen_8(const char* at, size_t length);

KESTREL_API size_t VEXAMBmbclen_C(const char* at);
KESTREL_API size_t VEXAMBmbclen_A(UConverter* converter, const char* at);
KESTREL_API size_t VEXAMBmbclen_8(const char* at);

KESTREL_API bool VEXAMBIsLeadByte_C(unsigned char byte);
KESTREL_API bool VEXAMBIsLeadByte_A(UConverter* converter, unsigned char byte);
KESTREL_API bool VEXAMBIsLeadByte_8(unsigned char byte);

KESTREL_API const char* VEXAMBstrinc_C(const char* at);
KESTREL_API const char* VEXAMBstrinc_A(UConverter* converter, const char* at);
KESTREL_API const char* VEXAMBstrinc_8(const char* at);

KESTREL_API const char* VEXAMBAnsiPrev_C(const char* start, const char* at);
KESTREL_API const char* VEXAMBAnsiPrev_A(UConverter* converter, const char* start, const char* at);
KESTREL_API const char* VEXAMBAnsiPrev_8(const char* start, const char* at);

KESTREL_API size_t VEXAMBPreviousIndex_C(const char* text, size_t index);
KESTREL_API size_t VEXAMBPreviousIndex_A(UConverter* converter, const char* text, size_t index);
KESTREL_API size_t VEXAMBPreviousIndex_8(const char* text, size_t index);

KESTREL_API size_t VEXAMBFindStart_C(const char* text, size_t length, size_t index);
KESTREL_API size_t VEXAMBFindStart_A(UConverter* converter, const char* text, size_t length, size_t index);
KESTREL_API size_t VEXAMBFindStart_8(const char* text, size_t length, size_t index);

KESTREL_API std::vector<size_t> VEXAMBFindStarts_C(const char* text, size_t length);
KESTREL_API std::vector<size_t> VEXAMBFindStarts_A(UConverter* converter, const char* text, size_t length);
KESTREL_API std::vector<size_t> VEXAMBFindStarts_8(const char* text, size_t length);

KESTREL_API char* VEXAMBstrncpy_C(char* to, const char* from, size_t size);
KESTREL_API char* VEXAMBstrncpy_A(UConverter* converter, char* to, const char* from, size_t size);
KESTREL_API char* VEXAMBstrncpy_8(char* to, const char* from, size_t size);

KESTREL_API const char* VEXAMBstrchr_C(const char* text, char32_t character);
KESTREL_API const char* VEXAMBstrchr_A(UConverter* converter, const char* text, char32_t character);
KESTREL_API const char* VEXAMBstrchr_8(const char* text, char32_t character);

KESTREL_API const char* VEXAMBstrrchr_C(const char* text, char32_t character);
KESTREL_API const char* VEXAMBstrrchr_A(UConverter* converter, const char* text, char32_t character);
KESTREL_API const char* VEXAMBstrrchr_8(const char* text, char32_t character);

KESTREL_API size_t VEXAMBstrcspn_C(const char* text, const char* set);
KESTREL_API size_t VEXAMBstrcspn_A(UConverter* converter, const char* text, const char* set);
KESTREL_API size_t VEXAMBstrcspn_8(const char* text, const char* set);

KESTREL_API int VEXAMBstrnicmp_C(const char* left, const char* right, size_t size);
KESTREL_API int VEXAMBstrnicmp_A(UConverter* converter, const char* left, const char* right, size_t size);
KESTREL_API int VEXAMBstrnicmp_8(const char* left, const char* right, size_t size);

KESTREL_API int VEXAMBqstricmp_C(const char* left, const char* right);
KESTREL_API int VEXAMBqstricmp_A(UConverter* converter, const char* left, const char* right);
KESTREL_API int VEXAMBqstricmp_8(const char* left, const char* right);

KESTREL_API char32_t VEXAMBU32Get_C(const char* at);
KESTREL_API char32_t VEXAMBU32Get_A(UConverter* converter, const char* at);
KESTREL_API char32_t VEXAMBU32Get_8(const char* at);

KESTREL_API UConverter* VEXAMBConverterNew_C(const char* name);
/// The name is in the converter's code page.
KESTREL_API UConverter* VEXAMBConverterNew_A(UConverter* converter, const char* name);
/// Null also for a name that is not UTF-8. Of a long name the first 59 bytes count.
KESTREL_API UConverter* VEXAMBConverterNew_8(const char* name);

/// Frees a converter of ConverterNew. Null is allowed.
KESTREL_API void VEXAMBConverterDelete(UConverter* converter);

}  // namespace MCXML_800

#endif  // KESTREL_FOUNDATION_MULTIBYTETEXT_H
