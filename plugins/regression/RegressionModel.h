// The model of a PMML RegressionModel: linear, polynomial and logistic regression of every kind that the
// element has.

#ifndef KESTREL_PLUGINS_REGRESSION_REGRESSIONMODEL_H
#define KESTREL_PLUGINS_REGRESSION_REGRESSIONMODEL_H

#include <memory>
#include <string>
#include <vector>

#include "plugins/regression/CategoryPlan.h"
#include "plugins/regression/Normalization.h"
#include "plugins/regression/RegressionEquation.h"
#include "plugins/regression/RegressionTable.h"
#include "plugins/support/VectorModel.h"

namespace MCKestrel_800 {

/// Scores cases by regression equations; see VectorModel for what that comes to when data are missing or
/// invalid.
///
/// A case whose numbers are not all there has a missing result. So has one of which an equation or the
/// prediction is not a finite number, or of which the equations make no probabilities (see CategoryPlan). A
/// missing category adds nothing and is no failure.
class RegressionModel : public VectorModel {
 public:
  /// What a document says, in the model's own types.
  struct Definition {
    Normalization normalization = Normalization::kNone;
    std::vector<RegressionTable> tables;
  };

  /// dictionaries  taken over, whatever happens; the frame and the definition's tables speak of their
  /// variables. Errors (KestrelException without place): those of CategoryPlan; code 5 for "simplemax" in a
  /// regression.
  RegressionModel(ModelDictionaries dictionaries, ModelFrame frame, Definition definition);
  ~RegressionModel() override;

  std::string GetModelKind() const override;
  /// Opens with "Start RegressionModel Display:" and closes with "End of RegressionModel Display.".
  void Display(std::ostream& out) const override;

 protected:
  bool Predict(const double* values, unsigned outcome, ScoreResult& result) override;

 private:
  void CompileEquations(const std::vector<int>& tables);
  bool Evaluate(const double* values);
  bool PredictNumber(ScoreResult& result);
  bool Classify(ScoreResult& result);
  double Normalize(double y) const;

  Definition definition_;
  CaseVector inputs_;
  std::unique_ptr<CategoryPlan> plan_;  ///< of a classification
  std::vector<RegressionEquation> equations_;
  // Per case, kept so that scoring allocates nothing.
  std::vector<double> y_;
  std::vector<double> probabilities_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_REGRESSION_REGRESSIONMODEL_H
