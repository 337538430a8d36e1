// The process's environment, its C locale and the code page of its narrow text.

#ifndef KESTREL_PLATFORM_ENVIRONMENT_H
#define KESTREL_PLATFORM_ENVIRONMENT_H

#include <string>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// Puts a variable into the process's environment, over the value that it had. False when the system refuses.
/// Not safe while another thread reads the environment.
KESTREL_API bool SetEnvironmentVariableText(const std::string& name, const std::string& value);

/// Takes the process's whole C locale from the environment. False when the system does not know it; then the
/// locale stays as it was.
KESTREL_API bool SetLocaleFromEnvironment();
/// Sets the process's whole C locale. False when the system does not know it.
KESTREL_API bool SetLocaleByName(const std::string& name);
/// The name of the C locale that decides about characters.
KESTREL_API std::string CharacterLocaleName();

/// Whether the system's programs use UTF-8 for narrow text unless told otherwise.
KESTREL_API bool NarrowTextIsUtf8ByDefault();
/// The number of the code page of the process's narrow text, such as 1252; 0 where code pages have none.
KESTREL_API long CodePageNumber();
/// The name of that code page, such as "ISO-8859-1" or "windows-1252". On Linux it is that of the C locale of
/// the moment.
KESTREL_API std::string CodePageName();

}  // namespace MCKestrel_800

#endif  // KESTREL_PLATFORM_ENVIRONMENT_H
