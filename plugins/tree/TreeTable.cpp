#include "plugins/tree/TreeTable.h"

#include <algorithm>

namespace MCKestrel_800 {
namespace {

/// The codes of a category slot, as a mask; none when they do not fit one.
std::uint64_t AllCodes(const CaseVector& inputs, int slot) {
  const int count = inputs.GetCodeCount(slot);
  if (count <= 0 || count > 64) return 0;
  return ~std::uint64_t{0} >> (64 - count);
}

/// What the first child's condition decides when the second child's is the next one asked.
Condition::Decides Decide(const Condition& first, const Condition& second, const CaseVector& inputs) {
  const bool is_rest = second.kind == Condition::kAlways;
  if (!is_rest && second.slot != first.slot) return Condition::kDecidesNothing;
  switch (first.kind) {
    case Condition::kAtMost:
      return is_rest || (second.kind == Condition::kAbove && second.number <= first.number)
                 ? Condition::kDecidesNumber
                 : Condition::kDecidesNothing;
    case Condition::kAbove:
      return is_rest || (second.kind == Condition::kAtMost && second.number >= first.number)
                 ? Condition::kDecidesNumberAbove
                 : Condition::kDecidesNothing;
    case Condition::kCodes: {
      const std::uint64_t all = AllCodes(inputs, static_cast<int>(first.slot));
      const bool is_complement =
          second.kind == Condition::kCodes && ((first.codes | second.codes) & all) == all;
      return all != 0 && (is_rest || is_complement) ? Condition::kDecidesCode : Condition::kDecidesNothing;
    }
    default:
      return Condition::kDecidesNothing;
  }
}

}  // namespace

int TreeTable::Open(const Condition& condition) {
  nodes_.push_back(condition);
  return count_++;
}

void TreeTable::Seal(const CaseVector& inputs) {
  for (int node = 0; node < count_; ++node) {
    if (IsLeaf(node)) continue;
    const int first = FirstChild(node);
    const int second = NodeAfter(first);
    if (second == NodeAfter(node)) continue;
    nodes_[At(first)].decides = Decide(nodes_[At(first)], nodes_[At(second)], inputs);
  }
  // Read, and found to decide nothing, at the last leaf.
  Condition end{};
  end.kind = Condition::kNever;
  nodes_.push_back(end);
  nodes_.shrink_to_fit();
}

int TreeTable::CountLeaves() const {
  int leaves = 0;
  for (int node = 0; node < count_; ++node)
    leaves += IsLeaf(node) ? 1 : 0;
  return leaves;
}

int TreeTable::GetDepth() const {
  std::vector<int> ends;  // of the subtrees that the node lies in
  int depth = 0;
  for (int node = 0; node < count_; ++node) {
    while (!ends.empty() && ends.back() <= node)
      ends.pop_back();
    ends.push_back(NodeAfter(node));
    depth = std::max(depth, static_cast<int>(ends.size()));
  }
  return depth;
}

}  // namespace MCKestrel_800
