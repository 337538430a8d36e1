#include "plugins/tree/TreeOptions.h"

#include <xercesc/dom/DOMElement.hpp>

#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/XmlText.h"
#include "plugins/support/Attributes.h"

namespace MCKestrel_800 {
namespace {

using xercesc::DOMElement;
using Names = PMMLModelTags;
using Tags = PMMLTagText;

// The attribute that the table of names does not list.
constexpr char16_t kSplitCharacteristic[] = u"splitCharacteristic";

// In the order of the enumeration.
constexpr Word<MissingValueStrategy> kStrategies[] = {
    {Names::XML_VAL_NONE, MissingValueStrategy::kNone},
    {Names::XML_VAL_LASTPREDICTION, MissingValueStrategy::kLastPrediction},
    {Names::XML_VAL_NULLPREDICTION, MissingValueStrategy::kNullPrediction},
    {Names::XML_VAL_DEFAULTCHILD, MissingValueStrategy::kDefaultChild},
    {Names::XML_VAL_WEIGHTEDCONFIDENCE, MissingValueStrategy::kWeightedConfidence},
    {Names::XML_VAL_AGGREGATENODES, MissingValueStrategy::kAggregateNodes},
};

// The meaning: whether the last prediction is returned.
constexpr Word<bool> kNoTrueChild[] = {
    {Names::XML_VAL_RETURNNULLPREDICTION, false},
    {Names::XML_VAL_RETURNLASTPREDICTION, true},
};

constexpr Word<bool> kSplitCharacteristics[] = {{"binarySplit", true}, {"multiSplit", false}};

/// Leaves `meaning` as it is when the attribute is absent.
template <typename T, std::size_t kSize>
void ReadWord(const DOMElement* element, const char16_t* attribute, const Word<T> (&vocabulary)[kSize],
              T& meaning) {
  const XMLCh* found = FindAttribute(element, attribute);
  if (found == nullptr) return;
  const Word<T>* const word = FindWord(vocabulary, Narrow(found));
  if (word == nullptr) FailOnAttribute(element, attribute, Narrow(found));
  meaning = word->meaning;
}

double ReadPenalty(const DOMElement* element) {
  const double penalty = ReadNumberOr(element, Tags::XML_ATT_MISSINGVALUEPENALTY, 1.0);
  if (!(penalty >= 0.0 && penalty <= 1.0)) {
    FailOnAttribute(element, Tags::XML_ATT_MISSINGVALUEPENALTY,
                    AttributeText(element, Tags::XML_ATT_MISSINGVALUEPENALTY));
  }
  return penalty;
}

}  // namespace

void TreeOptions::Read(const DOMElement* element) {
  ReadWord(element, Tags::XML_ATT_MISSINGVALUESTRATEGY, kStrategies, strategy);
  ReadWord(element, Tags::XML_ATT_NOTRUECHILDSTRATEGY, kNoTrueChild, returns_last_prediction);
  bool is_binary = false;
  ReadWord(element, kSplitCharacteristic, kSplitCharacteristics, is_binary);
  penalty = ReadPenalty(element);
}

const char* TreeOptions::GetStrategyText() const {
  return kStrategies[static_cast<int>(strategy)].text;
}

}  // namespace MCKestrel_800
