#include "plugins/tree/NodeScores.h"

namespace MCKestrel_800 {

void NodeScores::Add(const Node& node, const std::vector<CategoryShare>& shares) {
  if (columns_.is_classification) {
    winners_.push_back(node.winner);
    if (share_starts_.empty()) share_starts_.push_back(0);
    shares_.insert(shares_.end(), shares.begin(), shares.end());
    share_starts_.push_back(static_cast<std::uint32_t>(shares_.size()));
  } else {
    numbers_.push_back(node.number);
  }
  if (columns_.has_record_counts) record_counts_.push_back(node.record_count);
  if (columns_.has_default_children) default_children_.push_back(kNoChild);
  if (!node.id.empty() || !id_ends_.empty()) {
    id_ends_.resize(count_, 0);
    ids_.append(node.id);
    id_ends_.push_back(static_cast<std::uint32_t>(ids_.size()));
  }
  ++count_;
}

void NodeScores::Seal() {
  numbers_.shrink_to_fit();
  winners_.shrink_to_fit();
  record_counts_.shrink_to_fit();
  default_children_.shrink_to_fit();
  share_starts_.shrink_to_fit();
  shares_.shrink_to_fit();
  id_ends_.shrink_to_fit();
  ids_.shrink_to_fit();
}

std::string_view NodeScores::GetId(int node) const {
  if (id_ends_.empty()) return {};
  const std::uint32_t start = node == 0 ? 0 : id_ends_[At(node) - 1];
  return std::string_view(ids_).substr(start, id_ends_[At(node)] - start);
}

std::size_t NodeScores::GetMemorySize() const {
  return numbers_.capacity() * sizeof(double) + winners_.capacity() * sizeof(std::int32_t) +
         record_counts_.capacity() * sizeof(double) + default_children_.capacity() * sizeof(std::int32_t) +
         share_starts_.capacity() * sizeof(std::uint32_t) + id_ends_.capacity() * sizeof(std::uint32_t);
}

}  // namespace MCKestrel_800
