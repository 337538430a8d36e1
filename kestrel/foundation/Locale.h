// What the library's narrow text is, and what loading the library does to the process's locale.

#ifndef KESTREL_FOUNDATION_LOCALE_H
#define KESTREL_FOUNDATION_LOCALE_H

#include <string>

#include "kestrel/platform/Export.h"

namespace MCXML_800 {

/// Sets the process's locale from the environment. If the one for characters is "C" then, the whole locale
/// becomes "en_US" (where the system knows it) and "LC_ALL=en_US" is put into the environment. It does so
/// once per process, when the library is loaded; every later call does nothing. Nothing that the library
/// computes depends on the locale: only the functions whose names end in _C, and narrow text on Linux with
/// the UTF-8 mode off.
KESTREL_API void EnableLocale();

/// Whether narrow text is UTF-8 (not 0) or in the process's code page (0). On from the start on Linux,
/// whatever the locale; off on Windows. A host sets it before its first load, with no other thread in the
/// library. A change, also one of the code page since the last call with 0, makes a new default converter.
KESTREL_API void SetUTF8mode(int on);
/// 1 or 0. Threads: any number at once.
KESTREL_API int qUTF8mode();

/// How often the default converter, the one for narrow text, has been made in this process: at least 1.
/// Whoever keeps something that was derived from it sees by this number that it is out of date.
KESTREL_API int VEXAMBDefaultConverterID();

}  // namespace MCXML_800

#endif  // KESTREL_FOUNDATION_LOCALE_H
