// The predicate child of a tree's node or a rule.

#ifndef KESTREL_PLUGINS_SUPPORT_PREDICATEREADER_H
#define KESTREL_PLUGINS_SUPPORT_PREDICATEREADER_H

#include <xercesc/util/XercesDefs.hpp>

#include <memory>

#include "kestrel/predicates/ScorePredicate.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

class ScoreDictionary;

/// Whether the element is one of the five predicates.
bool IsPredicate(const xercesc::DOMElement* element);

/// Reads a predicate element; ordinal numbers are compared by the positions of their categories. Null for a
/// compound of nothing. Errors: those of PMMLTranslator's readers.
std::unique_ptr<ScorePredicate> ReadPredicate(xercesc::DOMElement* element,
                                              const ScoreDictionary& dictionary);

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_PREDICATEREADER_H
