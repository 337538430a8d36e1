#include "plugins/tree/TreeModel.h"

#include <algorithm>
#include <charconv>
#include <ostream>
#include <typeinfo>
#include <utility>

#include "kestrel/foundation/NumberText.h"
#include "kestrel/model/ResultEntities.h"
#include "kestrel/model/Results.h"
#include "kestrel/translate/PMMLModelTags.h"

namespace MCKestrel_800 {

TreeModel::TreeModel(ModelDictionaries dictionaries, ModelFrame frame, std::unique_ptr<Tree> tree)
    : VectorModel(std::move(dictionaries), std::move(frame), tree->inputs),
      tree_(std::move(tree)),
      walker_(*tree_) {}

TreeModel::~TreeModel() = default;

MCScore::MCStatus TreeModel::ScoreVector(const double* values, ScoreResult* result) {
  return ScoreInputs(values, CaseVector::kComplete, nullptr, *result);
}

bool TreeModel::Predict(const double* values, unsigned, ScoreResult& result) {
  // Most cases of most trees: a number at a leaf, into a result of the class that MakeResult gives.
  if (!tree_->options.is_classification && &typeid(result) == &typeid(RegResult)) {
    auto& number = static_cast<RegResult&>(result);
    if (!number.GetEntities().IsDecidingIdWanted() && walker_.Walk(values) == TreeWalker::End::kNode) {
      number.SetNumber(tree_->scores.GetNumber(walker_.GetNode()));
      return true;
    }
  }
  switch (Walk(values, result)) {
    case TreeWalker::End::kNode:
      PredictByNode(result);
      return true;
    case TreeWalker::End::kSeveral:
      PredictTogether(result);
      return true;
    default:
      return false;
  }
}

TreeWalker::End TreeModel::Walk(const double* values, ScoreResult& result) {
  ResultEntities* const entities = ResultEntities::Of(&result);
  if (entities == nullptr || !entities->IsDecidingIdWanted()) return walker_.Walk(values);
  const bool has_path = entities->IsPathWanted();
  const TreeWalker::End end = has_path ? walker_.WalkAndNotePath(values) : walker_.Walk(values);
  NameEntities(end, has_path, *entities);
  return end;
}

void TreeModel::NameEntities(TreeWalker::End end, bool has_path, ResultEntities& entities) {
  if (has_path) {
    for (const int node : walker_.GetPath())
      entities.AddToPath(NameOf(node));
  }
  if (end == TreeWalker::End::kNode) entities.SetDecidingId(NameOf(walker_.GetNode()));
}

std::string_view TreeModel::NameOf(int node) {
  const std::string_view id = tree_->scores.GetId(node);
  if (!id.empty()) return id;
  char digits[16];
  const auto [end, failure] = std::to_chars(std::begin(digits), std::end(digits), node + 1);
  static_cast<void>(failure);
  return name_.assign(1, '#').append(digits, end);
}

double TreeModel::Penalize(double confidence) const {
  for (int i = 0; i < walker_.GetSubstitutions(); ++i)
    confidence *= tree_->options.penalty;
  return confidence;
}

void TreeModel::PredictByNode(ScoreResult& result) {
  const NodeScores& scores = tree_->scores;
  const int node = walker_.GetNode();
  if (!tree_->options.is_classification) return SetNumber(result, scores.GetNumber(node));
  const int winner = scores.GetWinner(node);
  result.SetPrediction(&tree_->categories.Get(winner));
  const CategoryShare* share = scores.FirstShare(node);
  const CategoryShare* const end = scores.EndOfShares(node);
  const bool has_distribution = share != end;
  // Kind 0 is what MakeResult gives; another kind has no place for the single categories.
  auto* const classification = result.GetResultKind() == 0 ? static_cast<ScoreClsResult*>(&result) : nullptr;
  double confidence = has_distribution ? 0.0 : 1.0;
  for (int category = 0; category < tree_->categories.GetCount(); ++category) {
    double probability = !has_distribution && category == winner ? 1.0 : 0.0;
    if (share != end && share->category == category) {
      probability = share->probability;
      if (category == winner) confidence = share->confidence;
      ++share;
    }
    if (classification != nullptr)
      classification->AddCategoryProbability(&tree_->categories.Get(category), probability);
  }
  result.SetProbability(Penalize(confidence));
}

void TreeModel::PredictTogether(ScoreResult& result) {
  const std::vector<double>& votes = walker_.GetVotes();
  if (!tree_->options.is_classification) return SetNumber(result, votes[0]);
  const auto winner = static_cast<int>(std::max_element(votes.begin(), votes.end()) - votes.begin());
  result.SetPrediction(&tree_->categories.Get(winner));
  result.SetProbability(Penalize(votes[static_cast<std::size_t>(winner)]));
  if (result.GetResultKind() != 0) return;
  auto& classification = static_cast<ScoreClsResult&>(result);
  for (int category = 0; category < tree_->categories.GetCount(); ++category) {
    classification.AddCategoryProbability(&tree_->categories.Get(category),
                                          votes[static_cast<std::size_t>(category)]);
  }
}

std::string TreeModel::GetModelKind() const {
  return PMMLModelTags::XML_ELE_TREEMODEL;
}

void TreeModel::Display(std::ostream& out) const {
  const TreeOptions& options = tree_->options;
  out << "Start TreeModel Display:\n";
  out << "Function = " << (options.is_classification ? "classification" : "regression");
  if (!GetTargetName().empty()) out << "; Target = " << GetTargetName();
  out << "\nMissing value strategy = " << options.GetStrategyText()
      << "; Penalty = " << FormatSixDigits(options.penalty) << "; No true child = "
      << (options.returns_last_prediction ? PMMLModelTags::XML_VAL_RETURNLASTPREDICTION
                                          : PMMLModelTags::XML_VAL_RETURNNULLPREDICTION)
      << "\nNodes = " << tree_->table.GetCount() << "; Leaves = " << tree_->table.CountLeaves()
      << "; Levels = " << tree_->table.GetDepth() << "\n";
  out << "End of TreeModel Display.\n\n";
}

}  // namespace MCKestrel_800
