// The parser library's own start, once per process.

#ifndef KESTREL_TRANSLATE_PARSERPLATFORM_H
#define KESTREL_TRANSLATE_PARSERPLATFORM_H

#include <xercesc/util/XercesDefs.hpp>

#include "kestrel/platform/Export.h"

XERCES_CPP_NAMESPACE_BEGIN
class MemoryManager;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

/// Initialises the parser library at the first call in the process; later calls only look at how that went.
/// It is never terminated: pairs of both calls on several threads tear it down under each other, and the host
/// may use it as well. memory  where the parser library takes its own memory from for the rest of the
/// process; null for the heap. Only the
///         first call's counts, and none if the host has initialised the library before.
/// Errors: KestrelException code 5 with the parser's message when the first call failed, in that call and in
/// every later one, because the parser library is half initialised then and would crash. Threads: any number
/// at once.
KESTREL_API void RequireParser(xercesc::MemoryManager* memory = nullptr);

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_PARSERPLATFORM_H
