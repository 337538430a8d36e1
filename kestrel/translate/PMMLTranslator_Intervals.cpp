// Intervals of data fields: the valid interval, the producers' invalid range and the plain interval element.

#include <memory>

#include "kestrel/dictionary/ScoreMissingValueSet.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/predicates/Range.h"
#include "kestrel/translate/IntervalClosure.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/VerifiedText.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

using xercesc::DOMElement;
using xercesc::DOMNode;
using Tag = PMMLTagText;

// Every other text, and none at all, means the open interval.
const IntervalClosure& ReadClosure(const DOMElement* interval) {
  const IntervalClosure* const closure = FindClosure(interval);
  return closure != nullptr ? *closure : kOpenInterval;
}

/// Reads a margin into `margin`; false, leaving it alone, when it is absent or empty.
bool ReadMargin(const DOMElement* interval, const char16_t* name, double& margin) {
  const XMLCh* text = Attribute(interval, name);
  if (IsEmpty(text)) return false;
  margin = VerifyDoubleAt(interval, text);
  return true;
}

void AddRange(ScoreMissingValueSet* set, double low, double high, bool lowIncluded, bool highIncluded) {
  auto lowValue = std::make_unique<NumericValue>(low);
  auto highValue = std::make_unique<NumericValue>(high);
  auto range = std::make_unique<Range>(lowValue.release(), highValue.release(), lowIncluded, highIncluded);
  // The set refuses a range that it holds already and leaves it to us.
  if (set->Add(range.get())) range.release();
}

}  // namespace

void PMMLTranslator::handleInterval(ScoreDictVar* /*var*/, DOMNode* interval, ScoreMissingValueSet* set,
                                    int /*reserved*/) {
  if (interval == nullptr || set == nullptr || interval->getNodeType() != DOMNode::ELEMENT_NODE) return;
  const DOMElement* element = static_cast<const DOMElement*>(interval);
  const IntervalClosure& closure = ReadClosure(element);
  double left = 0.0;
  double right = 0.0;
  const bool hasLeft = ReadMargin(element, Tag::XML_ATT_INTERVAL_LEFTMARGIN, left);
  const bool hasRight = ReadMargin(element, Tag::XML_ATT_INTERVAL_RIGHTMARGIN, right);
  // What is missing is the complement, so a margin is missing exactly when the interval leaves it out.
  const double infinity = NumericValue::GetInfinity();
  if (hasLeft) AddRange(set, -infinity, left, false, !closure.left);
  if (hasRight) AddRange(set, right, infinity, !closure.right, false);
}

void PMMLTranslator::handleTreeInterval(DOMElement* element, ScoreMissingValueSet* target) {
  if (element == nullptr || target == nullptr) return;
  const IntervalClosure& closure = ReadClosure(element);
  double left = -NumericValue::GetInfinity();
  double right = NumericValue::GetInfinity();
  ReadMargin(element, Tag::XML_ATT_INTERVAL_LEFTMARGIN, left);
  ReadMargin(element, Tag::XML_ATT_INTERVAL_RIGHTMARGIN, right);
  AddRange(target, left, right, closure.left, closure.right);
}

bool PMMLTranslator::HandleVEXAMissingInterval(ScoreMissingValueSet* set, int flags, double lower,
                                               double upper) {
  switch (flags) {
    case 0:
      return false;
    case 1:
    case 10:
    case 11:
      if (set == nullptr) return false;
      AddRange(set, lower, upper, true, true);
      return true;
    default:
      Fail(KestrelException::kUnsupported,
           "Only one \"invalidRangeLower\" or \"invalidRangeUpper\" is allowed!");
  }
}

}  // namespace MCKestrel_800
