// The model of a PMML TreeModel.

#ifndef KESTREL_PLUGINS_TREE_TREEMODEL_H
#define KESTREL_PLUGINS_TREE_TREEMODEL_H

#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "plugins/support/VectorModel.h"
#include "plugins/tree/Tree.h"
#include "plugins/tree/TreeWalker.h"

namespace MCKestrel_800 {

class ResultEntities;

/// Scores cases by a tree; see VectorModel for what that comes to when data are missing or invalid.
///
/// A classification gives all categories of the target with their probabilities, and as the probability of
/// the prediction its confidence. The result's entities (kestrel/model/ResultEntities.h) name the node that
/// predicts, or the path.
class TreeModel : public VectorModel {
 public:
  /// All are taken over; `tree` and `frame` speak of the dictionaries' variables.
  TreeModel(ModelDictionaries dictionaries, ModelFrame frame, std::unique_ptr<Tree> tree);
  ~TreeModel() override;

  /// Scores a case that is a flat vector: a value for each of the tree's inputs, as CaseVector has them,
  /// derived fields included.
  MCScore::MCStatus ScoreVector(const double* values, ScoreResult* result);

  std::string GetModelKind() const override;
  /// Opens with "Start TreeModel Display:" and closes with "End of TreeModel Display.".
  void Display(std::ostream& out) const override;

  const Tree& GetTree() const { return *tree_; }

 protected:
  bool Predict(const double* values, unsigned outcome, ScoreResult& result) override;

 private:
  TreeWalker::End Walk(const double* values, ScoreResult& result);
  void NameEntities(TreeWalker::End end, bool has_path, ResultEntities& entities);
  /// The node's identifier or number; valid until the next call.
  std::string_view NameOf(int node);
  void PredictByNode(ScoreResult& result);
  void PredictTogether(ScoreResult& result);
  double Penalize(double confidence) const;

  std::unique_ptr<Tree> tree_;
  TreeWalker walker_;
  // Per case, kept so that scoring allocates nothing.
  std::string name_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_TREE_TREEMODEL_H
