#include "plugins/tree/TreeWalker.h"

#include <algorithm>

namespace MCKestrel_800 {

using Result = ScorePredicate::PredicateResult;

TreeWalker::TreeWalker(const Tree& tree)
    : tree_(tree), is_root_true_(tree.table.GetCondition(0).kind == Condition::kAlways) {
  const std::size_t votes =
      tree.options.is_classification ? static_cast<std::size_t>(tree.categories.GetCount()) : 1;
  votes_.resize(votes);
  const auto depth = static_cast<std::size_t>(tree.table.GetDepth());
  if (tree.options.strategy == MissingValueStrategy::kWeightedConfidence) room_.resize(votes * depth);
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
  bool has_votes = false;
  if (tree_.options.strategy == MissingValueStrategy::kWeightedConfidence) {
    has_votes = WeighChildren<kNotesPath>(node_, values, votes_.data(), room_.data());
  } else {
    std::fill(votes_.begin(), votes_.end(), 0.0);
    records_ = 0.0;
    AggregateChildren<kNotesPath>(node_, values);
    has_votes = ShareOut();
  }
  substitutions_ = substitutions;
  return has_votes ? End::kSeveral : End::kNoPrediction;
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

/// The votes of a subtree; false when it has no prediction. `room` is for the levels below.
template <bool kNotesPath>
bool TreeWalker::Weigh(int node, const double* values, double* votes, double* room) {
  switch (Follow<kNotesPath>(node, values)) {
    case Stop::kPredicts:
      if (!tree_.scores.HasScore(node)) return false;
      SetVotes(node, votes);
      return true;
    case Stop::kNothing:
      return false;
    default:
      return WeighChildren<kNotesPath>(node, values, votes, room);
  }
}

template <bool kNotesPath>
bool TreeWalker::WeighChildren(int node, const double* values, double* votes, double* room) {
  const TreeTable& table = tree_.table;
  const std::size_t count = votes_.size();
  std::fill_n(votes, count, 0.0);
  double total = 0.0;
  for (int child = table.FirstChild(node); child != table.NodeAfter(node); child = table.NodeAfter(child)) {
    if (Test(child, values) == ScorePredicate::PredFalse) continue;
    if (!Weigh<kNotesPath>(child, values, room, room + count)) continue;
    const double weight = tree_.scores.GetRecordCount(child);
    total += weight;
    for (std::size_t i = 0; i < count; ++i)
      votes[i] += weight * room[i];
  }
  if (!(total > 0.0)) return false;
  for (std::size_t i = 0; i < count; ++i)
    votes[i] /= total;
  return true;
}

void TreeWalker::SetVotes(int node, double* votes) const {
  const NodeScores& scores = tree_.scores;
  if (!tree_.options.is_classification) {
    votes[0] = scores.GetNumber(node);
    return;
  }
  std::fill_n(votes, votes_.size(), 0.0);
  if (!scores.HasDistribution(node)) votes[scores.GetWinner(node)] = 1.0;
  for (const CategoryShare* share = scores.FirstShare(node); share != scores.EndOfShares(node); ++share)
    votes[share->category] = share->confidence;
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

/// Turns counted records into shares; false when there are none.
bool TreeWalker::ShareOut() {
  if (!(records_ > 0.0)) return false;
  for (double& vote : votes_)
    vote /= records_;
  return true;
}

}  // namespace MCKestrel_800
