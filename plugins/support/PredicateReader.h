// The predicate of a tree's node or a rule.

#ifndef KESTREL_PLUGINS_SUPPORT_PREDICATEREADER_H
#define KESTREL_PLUGINS_SUPPORT_PREDICATEREADER_H

#include <xercesc/util/XercesDefs.hpp>

#include "plugins/support/ConditionTable.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

class PredicateInputs;

/// Whether the element is one of the five predicates.
bool IsPredicate(const xercesc::DOMElement* element);

/// The one predicate among the children of an element. Errors: code 1, at the second one, when there are two;
/// code 4 when there is none.
xercesc::DOMElement* FindPredicate(const xercesc::DOMElement* element);

/// Reads a predicate element on the fields of `inputs` and compiles it; ordinal numbers are compared by the
/// positions of their categories. Errors: those of PMMLTranslator's predicate readers, and code 8, at the
/// predicate, for a field that is neither an active field of the mining schema nor a derived field.
Condition ReadCondition(xercesc::DOMElement* predicate, PredicateInputs& inputs, ConditionTable& conditions);

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_PREDICATEREADER_H
