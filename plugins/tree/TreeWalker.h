// The way of a case through a tree.

#ifndef KESTREL_PLUGINS_TREE_TREEWALKER_H
#define KESTREL_PLUGINS_TREE_TREEWALKER_H

#include <cstddef>
#include <cstdint>
#include <vector>

#include "kestrel/predicates/ScorePredicate.h"
#include "plugins/tree/Tree.h"

namespace MCKestrel_800 {

/// Walks cases through one tree. Holds the room that walking needs, so that it allocates nothing per case,
/// and serves one case at a time. The rules are in docs/documents.md.
class TreeWalker {
 public:
  /// Where a walk ended.
  enum class End {
    kNode,     ///< a node predicts
    kSeveral,  ///< several nodes predict together: GetVotes() has the outcome
    kNoPrediction
  };

  /// The tree must be complete and outlive the walker.
  explicit TreeWalker(const Tree& tree);

  /// Takes a case, as the values of the tree's inputs, from the root to its end.
  End Walk(const double* values);
  /// The same, noting every node that the case comes to.
  End WalkAndNotePath(const double* values);

  /// The node at which the last walk ended; without meaning when several predict.
  int GetNode() const { return node_; }
  /// How often on the way a default child or a surrogate decided, up to where several nodes predict.
  int GetSubstitutions() const { return substitutions_; }
  /// After kSeveral: the confidence of each category, or the one prediction of a regression.
  const std::vector<double>& GetVotes() const { return votes_; }
  /// The nodes, in the order in which the case came to them.
  const std::vector<int>& GetPath() const { return path_; }

 private:
  /// Why a case goes no further down.
  enum class Stop {
    kPredicts,  ///< the node is a leaf, or predicts in place of its children
    kNothing,   ///< there is no prediction
    kFork       ///< all children that are not false are to be followed
  };

  ScorePredicate::PredicateResult Test(int node, const double* values) const {
    return tree_.conditions.Evaluate(tree_.table.GetCondition(node), values);
  }
  template <bool kNotesPath>
  End Start(const double* values);
  template <bool kNotesPath>
  Stop Follow(int& node, const double* values);
  template <bool kNotesPath>
  bool Weigh(int node, const double* values);
  template <bool kNotesPath>
  bool WeighChildren(int node, const double* values);
  void ScaleVoters(std::size_t first, double factor, double divisor);
  template <bool kNotesPath>
  void Aggregate(int node, const double* values);
  template <bool kNotesPath>
  void AggregateChildren(int node, const double* values);
  bool ShareOut();
  void AddVotes(int node, double weight);
  void AddRecords(int node);

  const Tree& tree_;
  const bool is_root_true_;
  int node_ = 0;
  int substitutions_ = 0;
  std::vector<double> votes_;
  double records_ = 0.0;  ///< that aggregated nodes have together
  /// The nodes that predict below a fork of weighted confidences, in document order, and their shares in it.
  std::vector<int> voters_;
  std::vector<double> shares_;
  std::vector<int> path_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_TREE_TREEWALKER_H
