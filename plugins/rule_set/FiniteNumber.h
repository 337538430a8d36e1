// The numbers of rules.

#ifndef KESTREL_PLUGINS_RULE_SET_FINITENUMBER_H
#define KESTREL_PLUGINS_RULE_SET_FINITENUMBER_H

#include <xercesc/util/XercesDefs.hpp>

#include <string>

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

/// The number that a text of the document reads as. Errors, at the element: code 3 when it is no number, code
/// 7 when it is infinite or the system-missing one.
double ReadFiniteNumber(const xercesc::DOMElement* element, const std::string& text);

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_RULE_SET_FINITENUMBER_H
