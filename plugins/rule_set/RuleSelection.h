// The criteria by which a rule set chooses among the rules that fire.

#ifndef KESTREL_PLUGINS_RULE_SET_RULESELECTION_H
#define KESTREL_PLUGINS_RULE_SET_RULESELECTION_H

#include <string>

namespace MCKestrel_800 {

/// RuleSelector says what each does.
enum class RuleSelection { kWeightedSum, kWeightedMax, kFirstHit };

/// Sets `selection` to the criterion of that name, as documents write it. False, and nothing changed, for
/// another text.
bool FindRuleSelection(const std::string& text, RuleSelection& selection);

/// The criterion's name.
const char* RuleSelectionText(RuleSelection selection);

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_RULE_SET_RULESELECTION_H
