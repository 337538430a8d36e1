// UTF-8 to UTF-16 and back, for whole texts of any size, without a converter.

#ifndef KESTREL_FOUNDATION_UTF8TEXT_H
#define KESTREL_FOUNDATION_UTF8TEXT_H

#include <cstddef>
#include <string>

namespace MCXML_800 {

/// Adds the text to the end of `out`. Half of a surrogate pair becomes U+FFFD; false when that happened.
bool AppendUtf16AsUtf8(const char16_t* text, size_t length, std::string& out);

/// Adds the text to the end of `out`. Every longest piece that begins like a character and is none (overlong,
/// truncated, a surrogate, beyond U+10FFFF, a trail byte alone) becomes one U+FFFD; false when that happened.
bool AppendUtf8AsUtf16(const char* text, size_t length, std::u16string& out);

}  // namespace MCXML_800

#endif  // KESTREL_FOUNDATION_UTF8TEXT_H
