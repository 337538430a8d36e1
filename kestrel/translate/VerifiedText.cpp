#include "kestrel/translate/VerifiedText.h"

#include <xercesc/dom/DOMElement.hpp>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/BaseTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

double VerifyDoubleAt(const xercesc::DOMElement* element, const XMLCh* text) {
  try {
    return BaseTranslator::VerifyDouble(text);
  } catch (const KestrelException& fault) {
    FailAt(element, KestrelException::kConversion, fault.GetErrorMessage());
  }
}

int VerifyIntAt(const xercesc::DOMElement* element, const XMLCh* text) {
  try {
    return BaseTranslator::VerifyInt(text);
  } catch (const KestrelException& fault) {
    FailAt(element, KestrelException::kConversion, fault.GetErrorMessage());
  }
}

const XMLCh* RequiredAttribute(const xercesc::DOMElement* element, const char16_t* name) {
  const XMLCh* text = FindAttribute(element, name);
  return text != nullptr ? text : BaseTranslator::GetAttributeForced(element, Narrow(ToXMLCh(name)));
}

}  // namespace MCKestrel_800
