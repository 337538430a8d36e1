#include "plugins/support/Attributes.h"

#include <xercesc/dom/DOMElement.hpp>

#include <cmath>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/translate/BaseTranslator.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

using xercesc::DOMElement;

double ReadNumber(const DOMElement* element, const char16_t* attribute) {
  const XMLCh* text = Attribute(element, attribute);
  double number = 0.0;
  try {
    number = BaseTranslator::VerifyDouble(text);
  } catch (const KestrelException& fault) {
    // The same words, with the place that the conversion does not know.
    FailAt(element, KestrelException::kConversion, fault.GetErrorMessage());
  }
  if (!std::isfinite(number) || NumericValue::IsSystemMissingValue(number)) {
    FailOnAttribute(element, attribute, Narrow(text));
  }
  return number;
}

double ReadNumberOr(const DOMElement* element, const char16_t* attribute, double absent) {
  return IsEmpty(Attribute(element, attribute)) ? absent : ReadNumber(element, attribute);
}

void FailOnAttribute(const DOMElement* element, const char16_t* attribute, const std::string& text) {
  FailAt(element, KestrelException::kInvalidDocument,
         "invalid " + Narrow(ToXMLCh(attribute)) + " -- " + text);
}

bool IsExtension(const DOMElement* element) {
  const XMLCh* name = element->getTagName();
  return ElementIs(element, PMMLTagText::XML_ELE_EXTENSION) ||
         ((name[0] == u'X' || name[0] == u'x') && name[1] == u'-');
}

}  // namespace MCKestrel_800
