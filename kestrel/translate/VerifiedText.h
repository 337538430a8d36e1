// Attributes, checked: what is absent or not a number is reported with the element that should hold it.

#ifndef KESTREL_TRANSLATE_VERIFIEDTEXT_H
#define KESTREL_TRANSLATE_VERIFIEDTEXT_H

#include <xercesc/util/XercesDefs.hpp>

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

/// What BaseTranslator::VerifyDouble and VerifyInt give for a text of `element`; their code and message with
/// the element's place when they refuse it. Null is refused like the empty text.
double VerifyDoubleAt(const xercesc::DOMElement* element, const XMLCh* text);
int VerifyIntAt(const xercesc::DOMElement* element, const XMLCh* text);

/// What BaseTranslator::GetAttributeForced gives, without converting the name on the way: for what is read
/// often.
const XMLCh* RequiredAttribute(const xercesc::DOMElement* element, const char16_t* name);

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_VERIFIEDTEXT_H
