#include "plugins/rule_set/DistributionTable.h"

#include <algorithm>

namespace MCKestrel_800 {

int DistributionTable::Add(const std::vector<Share>& shares) {
  shares_.insert(shares_.end(), shares.begin(), shares.end());
  ends_.push_back(shares_.size());
  return static_cast<int>(ends_.size()) - 1;
}

void DistributionTable::Seal() {
  shares_.shrink_to_fit();
  ends_.shrink_to_fit();
}

void DistributionTable::Fill(int distribution, std::vector<double>& probabilities) const {
  std::fill(probabilities.begin(), probabilities.end(), 0.0);
  const std::size_t first = distribution == 0 ? 0 : ends_[distribution - 1];
  for (std::size_t i = first; i < ends_[distribution]; ++i)
    probabilities[shares_[i].score] = shares_[i].probability;
}

}  // namespace MCKestrel_800
