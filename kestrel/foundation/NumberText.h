// Numbers read from and written to text, the same whatever locale the process or a stream is set to.

#ifndef KESTREL_FOUNDATION_NUMBERTEXT_H
#define KESTREL_FOUNDATION_NUMBERTEXT_H

#include <cstddef>
#include <string>
#include <string_view>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// Reads the whole text as a decimal number: an optional sign, digits with at most one point, an optional
/// exponent. False, and `out` unchanged, for anything else, blanks included. What a double cannot hold
/// becomes an infinity or zero.
KESTREL_API bool ParseDouble(const char* first, const char* last, double& out);

/// Reads a number from the start of the text as a standard stream with the classic locale does: leading white
/// space is skipped and what follows the number is ignored. False when there is no number (`out` is
/// unchanged) or it is too large (`out` is an infinity of its sign, and `tooLarge`, when given, is set).
KESTREL_API bool ReadDouble(std::string_view text, double& out, bool* tooLarge = nullptr);

/// Room for every text that FormatSixDigits writes.
constexpr size_t kSixDigitsRoom = 32;

/// Writes the number as a standard output stream does by default: six significant digits. Returns the length;
/// the text is not terminated.
KESTREL_API size_t FormatSixDigits(double value, char (&buffer)[kSixDigitsRoom]);
KESTREL_API std::string FormatSixDigits(double value);

}  // namespace MCKestrel_800

#endif  // KESTREL_FOUNDATION_NUMBERTEXT_H
