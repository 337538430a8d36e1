#include "plugins/tree/TreeWalker.h"

#include <algorithm>
#include <cmath>

namespace MCKestrel_800 {

namespace {

using Result = ScorePredicate::PredicateResult;

/// Whether shares can be taken of a sum of record counts.
bool IsWeight(double total) {
  return total > 0.0 && std::isfinite(total);
}

}  // namespace

TreeWalker::TreeWalker(const Tree& tree)
    : tree_(tree), is_root_true_(tree.table.GetCondition(0).kind == Condition::kAlways) {
  const std::size_t votes =
      tree.options.is_classification ? static_cast<std::size_t>(tree.categories.GetCount()) : 1;
  votes_.resize(votes);
  if (tree.options.strategy == MissingValueStrategy::kWeightedConfidence) {
    const auto leaves = static_cast<std::size_t>(tree.table.CountLeaves());
    voters_.reserve(leaves);
    shares_.reserve(leaves);
  }
}

TreeWalker::End TreeWalker::Walk(const double* values) {
  if (is_root_true_) {
    // The way of nearly all cases: down to a leaf without asking twice. Every leaf has a score.
    node_ = tree_.table.Descend(0, values);
    substitutions_ = 0;
    if (tree_.table.IsLeaf(node_)) return End::kNode;
  }
  return Start<false>(values);
}

TreeWalker::End TreeWalker::WalkAndNotePath(const double* values) {
  path_.clear();
  return Start<true>(values);
}

template <bool kNotesPath>
TreeWalker::End TreeWalker::Start(const double* values) {
  substitutions_ = 0;
  const Result root = Test(0, values);
  if (root == ScorePredicate::PredSurrogateTrue) ++substitutions_;
  if (root == ScorePredicate::PredFalse || root == ScorePredicate::PredUnknown) return End::kNoPrediction;
  node_ = 0;
  switch (Follow<kNotesPath>(node_, values)) {
    case Stop::kPredicts:
      return tree_.scores.HasScore(node_) ? End::kNode : End::kNoPrediction;
    case Stop::kNothing:
      return End::kNoPrediction;
    default:
      break;
  }
  // The substitutes on the single branches are not counted.
  const int substitutions = substitutions_;
  std::fill(votes_.begin(), votes_.end(), 0.0);
  bool has_votes = false;
  if (tree_.options.strategy == MissingValueStrategy::kWeightedConfidence) {
    voters_.clear();
    shares_.clear();
    has_votes = WeighChildren<kNotesPath>(node_, values);
    for (std::size_t i = 0; i < voters_.size(); ++i)
      AddVotes(voters_[i], shares_[i]);
  } else {
    records_ = 0.0;
    AggregateChildren<kNotesPath>(node_, values);
    has_votes = ShareOut();
  }
  substitutions_ = substitutions;
  // A mean of numbers may be too large for one.
  return has_votes && std::isfinite(votes_[0]) ? End::kSeveral : End::kNoPrediction;
}

/// Takes a case from a node that it has come to as far down as one node after the other applies.
template <bool kNotesPath>
TreeWalker::Stop TreeWalker::Follow(int& node, const double* values) {
  const TreeTable& table = tree_.table;
  for (;;) {
    if (kNotesPath) {
      path_.push_back(node);
    } else {
      node = table.Descend(node, values);
    }
    if (table.IsLeaf(node)) return Stop::kPredicts;
    const int end = table.NodeAfter(node);
    int child = table.FirstChild(node);
    for (; child != end; child = table.NodeAfter(child)) {
      const Result result = Test(child, values);
      if (result == ScorePredicate::PredFalse) continue;
      if (result == ScorePredicate::PredTrue) break;
      if (result == ScorePredicate::PredSurrogateTrue) {
        ++substitutions_;
        break;
      }
      const MissingValueStrategy strategy = tree_.options.strategy;
      if (strategy == MissingValueStrategy::kNone) continue;
      if (strategy == MissingValueStrategy::kLastPrediction) return Stop::kPredicts;
      if (strategy == MissingValueStrategy::kNullPrediction) return Stop::kNothing;
      if (strategy != MissingValueStrategy::kDefaultChild) return Stop::kFork;
      ++substitutions_;
      child = tree_.scores.GetDefaultChild(node);
      break;
    }
    if (child == end) return tree_.options.returns_last_prediction ? Stop::kPredicts : Stop::kNothing;
    node = child;
  }
}

/// Adds the nodes that predict below a node, or itself, with shares that make up 1; false when there are
/// none.
template <bool kNotesPath>
bool TreeWalker::Weigh(int node, const double* values) {
  switch (Follow<kNotesPath>(node, values)) {
    case Stop::kPredicts:
      if (!tree_.scores.HasScore(node)) return false;
      voters_.push_back(node);
      shares_.push_back(1.0);
      return true;
    case Stop::kNothing:
      return false;
    default:
      return WeighChildren<kNotesPath>(node, values);
  }
}

template <bool kNotesPath>
bool TreeWalker::WeighChildren(int node, const double* values) {
  const TreeTable& table = tree_.table;
  const std::size_t first = voters_.size();
  double total = 0.0;
  for (int child = table.FirstChild(node); child != table.NodeAfter(node); child = table.NodeAfter(child)) {
    if (Test(child, values) == ScorePredicate::PredFalse) continue;
    const std::size_t first_of_child = voters_.size();
    if (!Weigh<kNotesPath>(child, values)) continue;
    const double weight = tree_.scores.GetRecordCount(child);
    total += weight;
    ScaleVoters(first_of_child, weight, 1.0);
  }
  if (IsWeight(total)) {
    ScaleVoters(first, 1.0, total);
    return true;
  }
  voters_.resize(first);
  shares_.resize(first);
  return false;
}

void TreeWalker::ScaleVoters(std::size_t first, double factor, double divisor) {
  for (std::size_t i = first; i < shares_.size(); ++i)
    shares_[i] = shares_[i] * factor / divisor;
}

void TreeWalker::AddVotes(int node, double weight) {
  const NodeScores& scores = tree_.scores;
  if (!tree_.options.is_classification) {
    votes_[0] += weight * scores.GetNumber(node);
    return;
  }
  if (!scores.HasDistribution(node)) votes_[static_cast<std::size_t>(scores.GetWinner(node))] += weight;
  for (const CategoryShare* share = scores.FirstShare(node); share != scores.EndOfShares(node); ++share)
    votes_[static_cast<std::size_t>(share->category)] += weight * share->confidence;
}

template <bool kNotesPath>
void TreeWalker::Aggregate(int node, const double* values) {
  switch (Follow<kNotesPath>(node, values)) {
    case Stop::kPredicts:
      return AddRecords(node);
    case Stop::kNothing:
      return;
    default:
      return AggregateChildren<kNotesPath>(node, values);
  }
}

template <bool kNotesPath>
void TreeWalker::AggregateChildren(int node, const double* values) {
  const TreeTable& table = tree_.table;
  for (int child = table.FirstChild(node); child != table.NodeAfter(node); child = table.NodeAfter(child)) {
    if (Test(child, values) != ScorePredicate::PredFalse) Aggregate<kNotesPath>(child, values);
  }
}

void TreeWalker::AddRecords(int node) {
  const NodeScores& scores = tree_.scores;
  if (!tree_.options.is_classification) {
    if (!scores.HasScore(node)) return;
    votes_[0] += scores.GetRecordCount(node) * scores.GetNumber(node);
    records_ += scores.GetRecordCount(node);
    return;
  }
  for (const CategoryShare* share = scores.FirstShare(node); share != scores.EndOfShares(node); ++share) {
    votes_[static_cast<std::size_t>(share->category)] += share->record_count;
    records_ += share->record_count;
  }
}

/// Turns counted records into shares; false when there are none, or more than a number holds.
bool TreeWalker::ShareOut() {
  if (!IsWeight(records_)) return false;
  for (double& vote : votes_)
    vote /= records_;
  return true;
}

}  // namespace MCKestrel_800
