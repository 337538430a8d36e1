// The edge between the parser's UTF-16 and the library's narrow text.

#ifndef KESTREL_FOUNDATION_NARROWTEXT_H
#define KESTREL_FOUNDATION_NARROWTEXT_H

#include <cstddef>
#include <string>
#include <string_view>

#include "kestrel/foundation/Locale.h"
#include "kestrel/platform/Export.h"

namespace MCXML_800 {

/// Narrow text is UTF-8 while the UTF-8 mode is on, which it is from the start on Linux, whatever the locale;
/// with the mode off it is the process's code page. What cannot be converted becomes the replacement
/// character (U+FFFD), or the code page's own substitute. Safe from several threads.
KESTREL_API std::string Utf16ToNarrow(const char16_t* text, size_t length);
/// The same, added to the end of `out`, which may have room from before.
KESTREL_API void AppendUtf16AsNarrow(const char16_t* text, size_t length, std::string& out);
KESTREL_API std::u16string NarrowToUtf16(std::string_view text);

}  // namespace MCXML_800

#endif  // KESTREL_FOUNDATION_NARROWTEXT_H
