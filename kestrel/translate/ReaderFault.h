// The one way in which readers of documents give up: KestrelException with the place in the document where it
// is known.

#ifndef KESTREL_TRANSLATE_READERFAULT_H
#define KESTREL_TRANSLATE_READERFAULT_H

#include <xercesc/util/XercesDefs.hpp>

#include <string>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/platform/Export.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMNode;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

/// Throws without a place.
[[noreturn]] KESTREL_API void Fail(KestrelException::ExceptionCode code, const std::string& message);

/// Throws with the line and column at which `where`'s start tag ends. `where` may be null, and may belong to
/// a document that was not read by ReadDocument: then the place stays unknown (0).
[[noreturn]] KESTREL_API void FailAt(const xercesc::DOMNode* where, KestrelException::ExceptionCode code,
                                     const std::string& message);

/// The same for a message about a named field: the field's name stands in front of `text`, which begins with
/// ": ".
[[noreturn]] KESTREL_API void FailOnField(const xercesc::DOMNode* where, KestrelException::ExceptionCode code,
                                          const std::string& field, const std::string& text);

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_READERFAULT_H
