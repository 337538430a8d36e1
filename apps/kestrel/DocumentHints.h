// What a person can do about a document that cannot be used.

#ifndef KESTREL_APPS_KESTREL_DOCUMENTHINTS_H
#define KESTREL_APPS_KESTREL_DOCUMENTHINTS_H

#include <string>

namespace kestrel_program {

/// What would be accepted in the place of what the library complained of; null when there is nothing to say.
/// code     one of KestrelException's
/// message  the library's text, which is fixed but for the names and values in it
const char* HintForFault(int code, const std::string& message);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_DOCUMENTHINTS_H
