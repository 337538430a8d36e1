#include "plugins/tree/TreeOptions.h"

#include <xercesc/dom/DOMElement.hpp>

#include <string>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/BaseTranslator.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {
namespace {

using xercesc::DOMElement;
using Names = PMMLModelTags;
using Tags = PMMLTagText;

// The attribute that the table of names does not list.
constexpr char16_t kSplitCharacteristic[] = u"splitCharacteristic";

template <typename T>
struct Word {
  const char* text;
  T meaning;
};

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
  const std::string text = Narrow(found);
  for (const Word<T>& word : vocabulary) {
    if (text == word.text) {
      meaning = word.meaning;
      return;
    }
  }
  FailAt(element, KestrelException::kInvalidDocument,
         "invalid " + Narrow(ToXMLCh(attribute)) + " -- " + text);
}

double ReadPenalty(const DOMElement* element) {
  const XMLCh* text = FindAttribute(element, Tags::XML_ATT_MISSINGVALUEPENALTY);
  if (IsEmpty(text)) return 1.0;
  double penalty = 1.0;
  try {
    penalty = BaseTranslator::VerifyDouble(text);
  } catch (const KestrelException& fault) {
    // The same words, with the place that the conversion does not know.
    FailAt(element, KestrelException::kConversion, fault.GetErrorMessage());
  }
  if (!(penalty >= 0.0 && penalty <= 1.0)) {
    FailAt(element, KestrelException::kInvalidDocument, "invalid missingValuePenalty -- " + Narrow(text));
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
