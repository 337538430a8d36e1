#include "kestrel/translate/FieldRules.h"

#include <xercesc/dom/DOMElement.hpp>

#include "kestrel/dictionary/ValueLabelSet.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

using Tag = PMMLTagText;

struct LevelRow {
  const char16_t* text;
  ScoreDictVar::MeasureLevel level;
};

constexpr LevelRow kLevels[] = {
    {Tag::XML_VAL_OT_CONTINUOUS, ScoreDictVar::kContinuous},
    {Tag::XML_VAL_OT_CATEGORICAL, ScoreDictVar::kNominal},
    {Tag::XML_VAL_OT_ORDINAL, ScoreDictVar::kOrdinal},
};

}  // namespace

bool FindMeasureLevel(const XMLCh* text, ScoreDictVar::MeasureLevel& level) {
  for (const LevelRow& row : kLevels) {
    if (!Equals(text, row.text)) continue;
    level = row.level;
    return true;
  }
  return false;
}

bool IsListed(const ValueLabelSet& labels, const ScoreDictVar& variable, const ScoreValue& value) {
  if (variable.GetNoSpaceTrim()) return labels.ContainsEqual(&value, true, variable.GetEmptyStringOK());
  return labels.Contains(&value);
}

void CheckFlagCategories(const xercesc::DOMElement* where, const ScoreDictVar& variable,
                         std::size_t categories) {
  if (variable.IsFlagVariable() && categories != 2) {
    FailAt(where, KestrelException::kInconsistentDictionary, "Flag variable has to have two categories!");
  }
}

}  // namespace MCKestrel_800
