// The model of a PMML RegressionModel: linear, polynomial and logistic regression of every kind that the
// element has.

#ifndef KESTREL_PLUGINS_REGRESSION_REGRESSIONMODEL_H
#define KESTREL_PLUGINS_REGRESSION_REGRESSIONMODEL_H

#include <memory>
#include <string>
#include <vector>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/model/BaseModel.h"
#include "plugins/regression/CategoryPlan.h"
#include "plugins/regression/Normalization.h"
#include "plugins/regression/RegressionEquation.h"
#include "plugins/regression/RegressionTable.h"
#include "plugins/support/CaseVector.h"
#include "plugins/support/MiningSchema.h"
#include "plugins/support/ModelDictionaries.h"

namespace MCKestrel_800 {

/// Scores cases by regression equations. Keeps nothing of the document. Serves one case at a time.
///
/// A case whose numbers are not all there has a missing result, which the missing-value policy settles: no
/// prediction and the error status 90027, or the target's default. The same goes for an equation or a
/// prediction that is not a finite number, and for equations that make no probabilities (see CategoryPlan). A
/// missing category is no failure: it adds nothing. A value that
/// the mining schema refuses gives the error status of ScoringStatus.h and no prediction.
class RegressionModel : public BaseModel {
 public:
  /// What a document says, in the model's own types.
  struct Definition {
    bool is_classification = false;
    Normalization normalization = Normalization::kNone;
    MiningSchema schema;
    std::vector<RegressionTable> tables;
  };

  /// dictionaries  taken over, whatever happens; the definition's schema and tables speak of their variables.
  /// target        the name of the variable that is predicted; empty for none.
  /// Errors (KestrelException without place): those of CategoryPlan; code 5 for "simplemax" in a regression.
  RegressionModel(ModelDictionaries dictionaries, Definition definition, const std::string& target);
  ~RegressionModel() override;

  MCScore::MCStatus Score(const ScoreCaseRecord* record, ScoreResult* result) override;
  /// The data fields that the equations use, in the order in which the document first names them; those that
  /// a derived field is computed from stand in its place.
  std::vector<const ScoreDictVar*> GetPredictors() const override;
  /// A RegResult or, for a classification, a ClsResult.
  ScoreResult* MakeResult() const override;
  std::string GetModelKind() const override;
  /// Always false.
  bool SuppressCategoryProbabilities() const override;
  /// Opens with "Start RegressionModel Display:" and closes with "End of RegressionModel Display.".
  void Display(std::ostream& out) const override;

 private:
  void CompileEquations(const std::vector<int>& tables);
  bool Evaluate();
  bool Predict(ScoreResult& result);
  bool Classify(ScoreResult& result);
  double Normalize(double y) const;

  Definition definition_;
  CaseVector inputs_;
  std::unique_ptr<CategoryPlan> plan_;  ///< of a classification
  std::vector<RegressionEquation> equations_;
  // Per case, kept so that scoring allocates nothing.
  std::vector<double> y_;
  std::vector<double> probabilities_;
  NumericValue prediction_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_REGRESSION_REGRESSIONMODEL_H
