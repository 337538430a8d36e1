#include "plugins/rule_set/RuleSelection.h"

#include "kestrel/translate/PMMLModelTags.h"

namespace MCKestrel_800 {
namespace {

struct Row {
  const char* text;
  RuleSelection selection;
};

// In the order of the enumeration.
constexpr Row kRows[] = {
    {PMMLModelTags::XML_VAL_RULECRITERION_WSUM, RuleSelection::kWeightedSum},
    {PMMLModelTags::XML_VAL_RULECRITERION_WMAX, RuleSelection::kWeightedMax},
    {PMMLModelTags::XML_VAL_RULECRITERION_FIRSTHIT, RuleSelection::kFirstHit},
};

}  // namespace

bool FindRuleSelection(const std::string& text, RuleSelection& selection) {
  for (const Row& row : kRows) {
    if (text != row.text) continue;
    selection = row.selection;
    return true;
  }
  return false;
}

const char* RuleSelectionText(RuleSelection selection) {
  return kRows[static_cast<int>(selection)].text;
}

}  // namespace MCKestrel_800
