// Which of the rules that fire decides a case.

#ifndef KESTREL_PLUGINS_RULE_SET_RULESELECTOR_H
#define KESTREL_PLUGINS_RULE_SET_RULESELECTOR_H

#include <cstddef>
#include <vector>

#include "plugins/rule_set/RuleSelection.h"
#include "plugins/rule_set/RuleTable.h"

namespace MCKestrel_800 {

/// Chooses by one criterion among the rules that fire in a case:
///
///   firstHit      the first one in document order, with its confidence.
///   weightedMax   the one with the highest weight, of equal ones the first, with its confidence.
///   weightedSum   the score whose rules have the highest sum of weights, of equal ones the score that stands
///                 first in the rule set's list. Its confidence is the sum of its rules' confidences, divided
///                 by the number of all rules that fire. The rule is the one of that score with the highest
///                 weight, of equal ones the first.
///
/// Serves one case at a time and allocates nothing then.
class RuleSelector {
 public:
  struct Choice {
    int rule = RuleTable::kNone;  ///< kNone when no rule fires; then nothing else is set
    int score = RuleTable::kNone;
    double confidence = 0.0;
  };

  /// rules        must outlive the selector.
  /// score_count  above every rule's score.
  RuleSelector(RuleSelection selection, const RuleTable& rules, std::size_t score_count);

  /// Decides a case. `values` are a CaseVector's.
  Choice Choose(const double* values);

  /// After Choose by weightedSum: writes each score's share of all weights, by position. False when there are
  /// none: the weights sum up to nothing, or those of a score to less than nothing.
  bool FillShares(std::vector<double>& probabilities) const;

 private:
  /// What the rules of one score that fire in a case have together.
  struct Tally {
    double weight = 0.0;
    double confidence = 0.0;
    int rule = RuleTable::kNone;
  };

  Choice ChooseFirst(const double* values) const;
  Choice ChooseHeaviest(const double* values) const;
  Choice ChooseHeaviestScore(const double* values);

  const RuleSelection selection_;
  const RuleTable& rules_;
  std::vector<Tally> tallies_;  ///< by score, of weightedSum alone
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_RULE_SET_RULESELECTOR_H
