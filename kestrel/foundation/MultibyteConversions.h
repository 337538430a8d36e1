// Converting whole texts between a code page, UTF-8, UTF-16 and the library's own narrow text.

#ifndef KESTREL_FOUNDATION_MULTIBYTECONVERSIONS_H
#define KESTREL_FOUNDATION_MULTIBYTECONVERSIONS_H

#include <cstddef>
#include <string>

#include "kestrel/platform/Export.h"

struct UConverter;

/// "Generic" is the form that the library's narrow text has: UTF-8 with the UTF-8 mode on, else the process's
/// code page. The first argument is a converter, used as long as the call lasts and by one thread at a time:
/// for the CodePage functions that of the code page (with generic text on the other side), for the others
/// that of the generic side; null is the default converter. Without that argument the default is meant.
///
/// What cannot be converted is replaced, by U+FFFD or by the code page's own substitute, and the status says
/// so: nothing is lost unnoticed. Malformed bytes, half surrogate pairs and characters that the target lacks
/// all count. A character that is ignorable for display may be left out instead, with the same status.
///
/// String forms replace `out`, which may be the same object as the input.
///
/// Buffer forms take `length` units of text (kVEXAMBTerminated: up to its zero) and fill at most `size` units
/// of `out`. A zero always ends the result and counts against `size`. A result that does not fit is cut
/// between two characters, with status kVEXAMBBufferTooSmall. `*outLength`, unless null, becomes the number
/// of units written without the zero; when `out` is null or `size` is 0, nothing is written, the status is
/// kVEXAMBBufferTooSmall and `*outLength` becomes the number that the whole result has.
/// Units are bytes, for UTF-16 two bytes. Input and output must not overlap.
///
/// std::basic_string<unsigned short> is a type of the interface's callers; standard libraries offer it as an
/// extension. The forms with std::u16string do the same.
namespace MCXML_800 {

enum VEXAMBStatus : int {
  kVEXAMBOk = 0,
  kVEXAMBSubstituted = 1,     ///< The result is whole, with replacements in it.
  kVEXAMBBufferTooSmall = 2,  ///< The result is cut; it may hold replacements as well.
  kVEXAMBBadArgument = 3      ///< A text is null though it has a length, or a result's address is null.
};

constexpr size_t kVEXAMBTerminated = static_cast<size_t>(-1);

using VEXAMBU16String = std::basic_string<unsigned short>;

KESTREL_API int VEXAMBCodePageToGeneric(UConverter* codePage, const std::string& text, std::string& out);
KESTREL_API int VEXAMBGenericToCodePage(UConverter* codePage, const std::string& text, std::string& out);

KESTREL_API int VEXAMBU8ToGeneric(UConverter* generic, const std::string& text, std::string& out);
KESTREL_API int VEXAMBU8ToGeneric(const std::string& text, std::string& out);
KESTREL_API int VEXAMBGenericToU8(UConverter* generic, const std::string& text, std::string& out);
KESTREL_API int VEXAMBGenericToU8(const std::string& text, std::string& out);

KESTREL_API int VEXAMBU16ToGeneric(UConverter* generic, const VEXAMBU16String& text, std::string& out);
KESTREL_API int VEXAMBU16ToGeneric(UConverter* generic, const std::u16string& text, std::string& out);
KESTREL_API int VEXAMBU16ToGeneric(const VEXAMBU16String& text, std::string& out);
KESTREL_API int VEXAMBU16ToGeneric(const std::u16string& text, std::string& out);
KESTREL_API int VEXAMBGenericToU16(UConverter* generic, const std::string& text, VEXAMBU16String& out);
KESTREL_API int VEXAMBGenericToU16(UConverter* generic, const std::string& text, std::u16string& out);
KESTREL_API int VEXAMBGenericToU16(const std::string& text, VEXAMBU16String& out);
KESTREL_API int VEXAMBGenericToU16(const std::string& text, std::u16string& out);

KESTREL_API int VEXAMBU8ToCodePage(UConverter* codePage, const std::string& text, std::string& out);

KESTREL_API int VEXAMBCodePagetoGeneric(UConverter* codePage, const char* text, size_t length, char* out,
                                        size_t size, size_t* outLength);
KESTREL_API int VEXAMBGenerictoCodePage(UConverter* codePage, const char* text, size_t length, char* out,
                                        size_t size, size_t* outLength);
KESTREL_API int VEXAMBGenericto8(UConverter* generic, const char* text, size_t length, char* out, size_t size,
                                 size_t* outLength);
KESTREL_API int VEXAMB8toGeneric(UConverter* generic, const char* text, size_t length, char* out, size_t size,
                                 size_t* outLength);
KESTREL_API int VEXAMBGenericto16(UConverter* generic, const char* text, size_t length, unsigned short* out,
                                  size_t size, size_t* outLength);
KESTREL_API int VEXAMB16toGeneric(UConverter* generic, const unsigned short* text, size_t length, char* out,
                                  size_t size, size_t* outLength);
KESTREL_API int VEXAMBU8ToCodePage(UConverter* codePage, const char* text, size_t length, char* out,
                                   size_t size, size_t* outLength);

/// Terminated generic text to newly allocated, terminated UTF-16, and back. The caller frees `*out` with
/// delete[]. A null text gives a null result and status 0.
KESTREL_API int VEXAMBTranscodeGeneric(UConverter* generic, const char* text, unsigned short** out);
KESTREL_API int VEXAMBTranscodeGeneric(UConverter* generic, const unsigned short* text, char** out);

}  // namespace MCXML_800

#endif  // KESTREL_FOUNDATION_MULTIBYTECONVERSIONS_H
