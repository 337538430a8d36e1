// The shape of a tree and the predicates of its nodes, as one flat array.

#ifndef KESTREL_PLUGINS_TREE_TREETABLE_H
#define KESTREL_PLUGINS_TREE_TREETABLE_H

#include <cstddef>
#include <vector>

#include "plugins/support/Condition.h"
#include "plugins/support/ConditionTable.h"

namespace MCKestrel_800 {

/// The nodes of a tree in document order (every node before its children), sixteen bytes each: the node's
/// compiled predicate with the number of the node after its subtree. So the first child of an inner node p is
/// p + 1, the child after c is the node after c's subtree, and a node is a leaf when its subtree is itself.
///
/// Descend takes the short way through nodes at which the first child's test tells which child is taken: when
/// it is false, the second child's predicate is true, for every number that is not missing or infinite and
/// every category. Binary splits are of this kind, as training programs write them.
///
/// Built with Open and Close, in document order, then sealed; then only read.
class TreeTable {
 public:
  /// Adds a node as the next child of the last one that is open. Returns its number.
  int Open(const Condition& condition);
  /// Ends the subtree of a node.
  void Close(int node) { nodes_[At(node)].next = GetCount(); }
  /// To be called once, when all nodes are closed and the inputs' categories are known.
  void Seal(const CaseVector& inputs);

  int GetCount() const { return count_; }
  bool IsLeaf(int node) const { return nodes_[At(node)].next == node + 1; }
  int FirstChild(int node) const { return node + 1; }
  int NodeAfter(int node) const { return nodes_[At(node)].next; }
  const Condition& GetCondition(int node) const { return nodes_[At(node)]; }
  int CountLeaves() const;
  /// The number of nodes on the longest way from the root to a leaf.
  int GetDepth() const;

  /// From a node down to the first one at which the short way ends: a leaf, or a node whose children have to
  /// be asked one by one.
  int Descend(int node, const double* values) const {
    const Condition* const nodes = nodes_.data();
    const Condition* at = nodes + node;
    for (;;) {
      // Of a leaf this is the node after it, which is nobody's first child and decides nothing.
      const Condition* const first = at + 1;
      if (first->decides == Condition::kDecidesNothing) break;
      const Condition* const second = nodes + first->next;
      const double x = values[first->slot];
      if (first->decides == Condition::kDecidesCode) {
        if (!(x >= 0)) break;
        at = (first->codes >> (static_cast<unsigned>(x) & 63u) & 1) != 0 ? first : second;
        continue;
      }
      if (!IsOrdinary(x)) break;
      // Half of all comparisons go either way, and a wrong guess costs more than a level of the tree. Both
      // nodes being at hand, the compiler chooses between them without a branch.
      const bool is_above = first->decides == Condition::kDecidesNumberAbove;
      const Condition* const low = is_above ? second : first;
      const Condition* const high = is_above ? first : second;
      at = x <= first->number ? low : high;
    }
    return static_cast<int>(at - nodes);
  }

  std::size_t GetMemorySize() const { return nodes_.capacity() * sizeof(Condition); }

 private:
  static std::size_t At(int node) { return static_cast<std::size_t>(node); }

  std::vector<Condition> nodes_;
  int count_ = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_TREE_TREETABLE_H
