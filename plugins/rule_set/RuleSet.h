// What a `RuleSet` element says, compiled.

#ifndef KESTREL_PLUGINS_RULE_SET_RULESET_H
#define KESTREL_PLUGINS_RULE_SET_RULESET_H

#include "kestrel/foundation/NumericValue.h"
#include "plugins/rule_set/DistributionTable.h"
#include "plugins/rule_set/RuleScores.h"
#include "plugins/rule_set/RuleSelection.h"
#include "plugins/rule_set/RuleTable.h"

namespace MCKestrel_800 {

struct RuleSet {
  /// See RuleScores.
  RuleSet(bool is_classification, const ScoreDictVar* target) : scores(is_classification, target) {}

  RuleSelection selection = RuleSelection::kFirstHit;
  RuleTable rules;
  RuleScores scores;
  DistributionTable distributions;  ///< of a classification

  // What is predicted when no rule fires.
  int default_score = RuleTable::kNone;
  double default_confidence = NumericValue::gSysmisValue;  ///< system-missing for none
  int default_distribution = DistributionTable::kNone;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_RULE_SET_RULESET_H
