#include "plugins/rule_set/FiniteNumber.h"

#include <xercesc/dom/DOMElement.hpp>

#include <cmath>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/translate/BaseTranslator.h"
#include "kestrel/translate/ReaderFault.h"

namespace MCKestrel_800 {
namespace {

double ReadNumber(const xercesc::DOMElement* element, const std::string& text) {
  try {
    return BaseTranslator::VerifyDouble(text);
  } catch (const KestrelException& fault) {
    // The same words, with the place that the conversion does not know.
    FailAt(element, KestrelException::kConversion, fault.GetErrorMessage());
  }
}

}  // namespace

double ReadFiniteNumber(const xercesc::DOMElement* element, const std::string& text) {
  const double number = ReadNumber(element, text);
  if (!std::isfinite(number) || NumericValue::IsSystemMissingValue(number)) {
    FailAt(element, KestrelException::kInvalidValue, text + ": invalid value!");
  }
  return number;
}

}  // namespace MCKestrel_800
