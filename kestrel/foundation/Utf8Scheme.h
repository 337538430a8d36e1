// How UTF-8 text is walked through; see MultibyteWalk.h.

#ifndef KESTREL_FOUNDATION_UTF8SCHEME_H
#define KESTREL_FOUNDATION_UTF8SCHEME_H

#include <unicode/utf8.h>

#include "kestrel/foundation/MultibyteWalk.h"

namespace MCXML_800 {

class Utf8Scheme {
 public:
  Step Next(const char* at, const char* end) const {
    const auto length = static_cast<int32_t>(std::min<ptrdiff_t>(end - at, U8_MAX_LENGTH));
    int32_t bytes = 0;
    UChar32 c;
    U8_NEXT(at, bytes, length, c);
    return c >= 0 ? Step::Of(static_cast<size_t>(bytes), static_cast<char32_t>(c))
                  : Step::Without(at, static_cast<size_t>(bytes), true);
  }

  bool IsLead(unsigned char byte) const { return U8_IS_LEAD(byte); }

  size_t SafePoint(const char* text, size_t, size_t index) const {
    // ICU's macro counts in 32 bits, and never looks back further than one character.
    const size_t base = index - std::min<size_t>(index, U8_MAX_LENGTH - 1);
    auto back = static_cast<int32_t>(index - base);
    U8_SET_CP_START(reinterpret_cast<const uint8_t*>(text + base), 0, back);
    return base + static_cast<size_t>(back);
  }
};

}  // namespace MCXML_800

#endif  // KESTREL_FOUNDATION_UTF8SCHEME_H
