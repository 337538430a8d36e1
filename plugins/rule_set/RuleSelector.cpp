#include "plugins/rule_set/RuleSelector.h"

#include <algorithm>
#include <cmath>

namespace MCKestrel_800 {

RuleSelector::RuleSelector(RuleSelection selection, const RuleTable& rules, std::size_t score_count)
    : selection_(selection),
      rules_(rules),
      tallies_(selection == RuleSelection::kWeightedSum ? score_count : 0) {}

RuleSelector::Choice RuleSelector::Choose(const double* values) {
  switch (selection_) {
    case RuleSelection::kFirstHit:
      return ChooseFirst(values);
    case RuleSelection::kWeightedMax:
      return ChooseHeaviest(values);
    default:
      return ChooseHeaviestScore(values);
  }
}

RuleSelector::Choice RuleSelector::ChooseFirst(const double* values) const {
  Choice choice;
  rules_.VisitFiring(values, [this, &choice](int rule) {
    choice = {rule, rules_.Get(rule).score, rules_.Get(rule).confidence};
    return false;
  });
  return choice;
}

RuleSelector::Choice RuleSelector::ChooseHeaviest(const double* values) const {
  Choice choice;
  rules_.VisitFiring(values, [this, &choice](int rule) {
    const RuleTable::Rule& found = rules_.Get(rule);
    if (choice.rule == RuleTable::kNone || found.weight > rules_.Get(choice.rule).weight)
      choice = {rule, found.score, found.confidence};
    return true;
  });
  return choice;
}

RuleSelector::Choice RuleSelector::ChooseHeaviestScore(const double* values) {
  std::fill(tallies_.begin(), tallies_.end(), Tally());
  int firing = 0;
  rules_.VisitFiring(values, [this, &firing](int rule) {
    const RuleTable::Rule& found = rules_.Get(rule);
    Tally& tally = tallies_[found.score];
    if (tally.rule == RuleTable::kNone || found.weight > rules_.Get(tally.rule).weight) tally.rule = rule;
    tally.weight += found.weight;
    tally.confidence += found.confidence;
    ++firing;
    return true;
  });
  Choice choice;
  for (std::size_t score = 0; score < tallies_.size(); ++score) {
    const Tally& tally = tallies_[score];
    if (tally.rule == RuleTable::kNone) continue;
    if (choice.rule != RuleTable::kNone && tally.weight <= tallies_[choice.score].weight) continue;
    choice = {tally.rule, static_cast<int>(score), tally.confidence / firing};
  }
  return choice;
}

bool RuleSelector::FillShares(std::vector<double>& probabilities) const {
  double total = 0.0;
  for (const Tally& tally : tallies_) {
    if (tally.weight < 0.0) return false;
    total += tally.weight;
  }
  if (total <= 0.0 || !std::isfinite(total)) return false;
  for (std::size_t score = 0; score < tallies_.size(); ++score)
    probabilities[score] = tallies_[score].weight / total;
  return true;
}

}  // namespace MCKestrel_800
