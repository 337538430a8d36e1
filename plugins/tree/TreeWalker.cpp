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
    branches_.reserve(static_cast<std::size_t>(tree.table.GetCount()));
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
    branches_.assign(1, {kFork, 0, 1.0, 0.0});
    has_votes = WeighChildren<kNotesPath>(node_, values, 0);
    if (has_votes) AddBranches();
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

/// Follows a branch to what predicts; false when nothing does.
template <bool kNotesPath>
bool TreeWalker::Weigh(int node, const double* values, std::size_t branch) {
  switch (Follow<kNotesPath>(node, values)) {
    case Stop::kPredicts:
      branches_[branch].node = node;
      return tree_.scores.HasScore(node);
    case Stop::kNothing:
      return false;
    default:
      return WeighChildren<kNotesPath>(node, values, branch);
  }
}

/// Makes branches of the children that are not false and predict; false when these have no weight together.
template <bool kNotesPath>
bool TreeWalker::WeighChildren(int node, const double* values, std::size_t fork) {
  const TreeTable& table = tree_.table;
  double total = 0.0;
  for (int child = table.FirstChild(node); child != table.NodeAfter(node); child = table.NodeAfter(child)) {
    if (Test(child, values) == ScorePredicate::PredFalse) continue;
    const std::size_t branch = branches_.size();
    const double weight = tree_.scores.GetRecordCount(child);
    branches_.push_back({kFork, static_cast<std::uint32_t>(fork), weight, 0.0});
    if (Weigh<kNotesPath>(child, values, branch)) {
      total += weight;
    } else {
      branches_.resize(branch);
    }
  }
  branches_[fork].total = total;
  return IsWeight(total);
}

/// Adds up the votes. Only here is it known what each fork weighs in all, and every branch stands behind its
/// fork, so one look at each is enough, however deep they lie.
void TreeWalker::AddBranches() {
  for (std::size_t i = 1; i < branches_.size(); ++i) {
    Branch& branch = branches_[i];
    const Branch& fork = branches_[branch.fork];
    branch.weight = branch.weight / fork.total * fork.weight;
    if (branch.node != kFork) AddVotes(branch.node, branch.weight);
  }
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
