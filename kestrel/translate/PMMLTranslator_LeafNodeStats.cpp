// The ScoreDistribution elements of a tree's node or a rule.

#include <cmath>
#include <cstddef>
#include <vector>

#include "kestrel/foundation/NarrowText.h"
#include "kestrel/translate/LeafNodeStats.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/VerifiedText.h"
#include "kestrel/translate/XmlText.h"

#include <xercesc/util/XMLString.hpp>

namespace MCKestrel_800 {

namespace {

using xercesc::DOMElement;
using Tag = PMMLTagText;

/// Reads the text of an attribute as a number from 0 to `most`, which may be infinite. An infinite number is
/// none.
double ReadNumber(const DOMElement* element, const char16_t* name, const XMLCh* text, double most) {
  const double number = VerifyDoubleAt(element, text);
  if (std::isfinite(number) && number >= 0.0 && number <= most) return number;
  FailAt(element, KestrelException::kInvalidDocument,
         "ScoreDistribution: invalid " + Narrow(ToXMLCh(name)) + " -- " + Narrow(text));
}

/// The same for an attribute that need not be there.
double ReadShare(const DOMElement* element, const char16_t* name) {
  const XMLCh* const text = FindAttribute(element, name);
  return text != nullptr ? ReadNumber(element, name, text, 1.0) : NumericValue::gSysmisValue;
}

void ReadStats(const DOMElement* element, LeafNodeStats& stats) {
  const XMLCh* const value = RequiredAttribute(element, Tag::XML_ATT_VALUE);
  stats.value.clear();
  MCXML_800::AppendUtf16AsNarrow(ToUtf16(value), xercesc::XMLString::stringLen(value), stats.value);
  stats.record_count =
      ReadNumber(element, Tag::XML_ATT_RECORDCOUNT, RequiredAttribute(element, Tag::XML_ATT_RECORDCOUNT),
                 NumericValue::GetInfinity());
  stats.confidence = ReadShare(element, Tag::XML_ATT_CONFIDENCE);
  stats.probability = ReadShare(element, Tag::XML_ATT_NODE_PROBABILITY);
}

}  // namespace

void PMMLTranslator::SetLeafNodeStats(DOMElement* node, std::vector<LeafNodeStats>& stats) {
  std::size_t count = 0;
  for (const DOMElement* element : ChildElements(node, Tag::XML_ELE_SCOREDISTRIBUTION)) {
    if (count == stats.size()) stats.emplace_back();
    ReadStats(element, stats[count]);
    ++count;
  }
  stats.resize(count);
}

}  // namespace MCKestrel_800
