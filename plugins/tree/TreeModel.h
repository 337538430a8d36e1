// The model of a PMML TreeModel.

#ifndef KESTREL_PLUGINS_TREE_TREEMODEL_H
#define KESTREL_PLUGINS_TREE_TREEMODEL_H

#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/model/BaseModel.h"
#include "plugins/support/MiningSchema.h"
#include "plugins/support/ModelDictionaries.h"
#include "plugins/tree/Tree.h"
#include "plugins/tree/TreeWalker.h"

namespace MCKestrel_800 {

class RegResult;
class ResultEntities;

/// Scores cases by a tree. Keeps nothing of the document. Serves one case at a time.
///
/// A case for which the tree has no prediction is settled by the missing-value policy: no prediction and the
/// error status 90027, or the target's default. A value that the mining schema refuses gives the error status
/// of ScoringStatus.h and no prediction.
///
/// A classification gives all categories of the target with their probabilities, and as the probability of
/// the prediction its confidence. The result's entities (kestrel/model/ResultEntities.h) name the node that
/// predicts, or the path.
class TreeModel : public BaseModel {
 public:
  /// All are taken over; `tree` and `schema` speak of the dictionaries' variables.
  TreeModel(ModelDictionaries dictionaries, MiningSchema schema, const std::string& target,
            std::unique_ptr<Tree> tree);
  ~TreeModel() override;

  MCScore::MCStatus Score(const ScoreCaseRecord* record, ScoreResult* result) override;
  /// Scores a case that is a flat vector: a value for each of the tree's inputs, as CaseVector has them,
  /// derived fields included.
  MCScore::MCStatus ScoreVector(const double* values, ScoreResult* result);

  /// The data fields that the predicates use, in the order in which the document first names them; those that
  /// a derived field is computed from stand in its place.
  std::vector<const ScoreDictVar*> GetPredictors() const override;
  /// A RegResult or, for a classification, a ClsResult.
  ScoreResult* MakeResult() const override;
  std::string GetModelKind() const override;
  /// Always false.
  bool SuppressCategoryProbabilities() const override;
  /// Opens with "Start TreeModel Display:" and closes with "End of TreeModel Display.".
  void Display(std::ostream& out) const override;

  const Tree& GetTree() const { return *tree_; }

 private:
  MCScore::MCStatus ScoreNumber(const double* values, RegResult& result);
  MCScore::MCStatus ScoreAny(const double* values, ScoreResult& result);
  TreeWalker::End Walk(const double* values, ScoreResult& result);
  void NameEntities(TreeWalker::End end, bool has_path, ResultEntities& entities);
  /// The node's identifier or number; valid until the next call.
  std::string_view NameOf(int node);
  void Predict(ScoreResult& result);
  void PredictTogether(ScoreResult& result);
  double Penalize(double confidence) const;

  MiningSchema schema_;
  std::unique_ptr<Tree> tree_;
  TreeWalker walker_;
  // Per case, kept so that scoring allocates nothing.
  NumericValue prediction_;
  std::string name_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_TREE_TREEMODEL_H
