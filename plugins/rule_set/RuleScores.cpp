#include "plugins/rule_set/RuleScores.h"

namespace MCKestrel_800 {

int RuleScores::FindNumber(double score) {
  const auto [found, is_new] = positions_.emplace(score, static_cast<int>(numbers_.size()));
  if (is_new) numbers_.emplace_back(score);
  return found->second;
}

}  // namespace MCKestrel_800
