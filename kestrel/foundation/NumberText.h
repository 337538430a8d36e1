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

/// Reads a number from the start of the text as a standard input stream with the classic locale does, at a
/// fraction of its cost: leading white space is skipped and what follows the number is ignored. Neither names
/// ("inf", "nan") nor hexadecimal digits are read, and what is too small for a double is zero. False, with
/// what a stream leaves in `out`, when there is no number (0.0) or it is too large (the largest finite number
/// of its sign).
KESTREL_API bool ReadDouble(std::string_view text, double& out);

/// Whether the number at the start of the text, as the C library's atof reads it, is positive infinity: by
/// its name ("inf", "Infinity", whatever follows) or because it is too large. Hexadecimal digits are not
/// read.
KESTREL_API bool StartsWithInfinity(std::string_view text);

/// Room for every text that FormatSixDigits writes.
constexpr size_t kSixDigitsRoom = 32;

/// Writes the number as a standard output stream does by default: six significant digits. Returns the length;
/// the text is not terminated.
KESTREL_API size_t FormatSixDigits(double value, char (&buffer)[kSixDigitsRoom]);
KESTREL_API std::string FormatSixDigits(double value);

/// Room for every text that FormatShortest writes; the longest is "-1.2345678901234567e-308".
constexpr size_t kShortestRoom = 32;

/// Writes the number with as few digits as give back the same number when they are read. Returns the length;
/// the text is not terminated.
KESTREL_API size_t FormatShortest(double value, char (&buffer)[kShortestRoom]);

}  // namespace MCKestrel_800

#endif  // KESTREL_FOUNDATION_NUMBERTEXT_H
