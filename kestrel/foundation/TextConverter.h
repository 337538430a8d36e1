// The converters behind the text functions: the default one, the process's code page, and what they do.

#ifndef KESTREL_FOUNDATION_TEXTCONVERTER_H
#define KESTREL_FOUNDATION_TEXTCONVERTER_H

#include <cstddef>
#include <string>

struct UConverter;

namespace MCXML_800 {

/// Makes the default converter anew when the encoding of narrow text is not the one it was made for: UTF-8
/// with the UTF-8 mode on, else the process's code page.
void RenewDefaultConverter(bool utf8);
int DefaultConverterCount();

/// The calling thread's own clone of the default converter, since a converter serves one thread at a time. It
/// belongs to the library. No lock is taken.
UConverter* DefaultConverter();
/// The same for the process's code page, whatever the UTF-8 mode. On Linux it is that of the C locale at the
/// time of the call. UTF-8 for a code page that ICU does not know.
UConverter* ProcessCodePageConverter();

/// The converter, or the default one for null.
inline UConverter* OrDefault(UConverter* converter) {
  return converter != nullptr ? converter : DefaultConverter();
}

bool IsUtf8(const UConverter* converter);

/// A new converter in the state of the given one, or null. Threads may clone one converter at once, as long
/// as none uses it.
UConverter* CloneConverter(const UConverter* converter);

/// Add the converted text to the end of `out`; 0, or kVEXAMBSubstituted when something had to be replaced.
/// The converter starts anew and keeps its own ways of treating errors. Null is the default converter.
int DecodeText(UConverter* converter, const char* text, size_t length, std::u16string& out);
int EncodeText(UConverter* converter, const char16_t* text, size_t length, std::string& out);

}  // namespace MCXML_800

#endif  // KESTREL_FOUNDATION_TEXTCONVERTER_H
