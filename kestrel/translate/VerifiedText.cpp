#include "kestrel/translate/VerifiedText.h"

#include <xercesc/dom/DOMElement.hpp>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/BaseTranslator.h"
#include "kestrel/translate/ReaderFault.h"

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

}  // namespace MCKestrel_800
