// What all models do around their own arithmetic: from a case record to a flat vector, and from an answer to
// a result.

#ifndef KESTREL_PLUGINS_SUPPORT_VECTORMODEL_H
#define KESTREL_PLUGINS_SUPPORT_VECTORMODEL_H

#include <vector>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/model/BaseModel.h"
#include "kestrel/model/ScoreResult.h"
#include "plugins/support/CaseVector.h"
#include "plugins/support/ModelDictionaries.h"
#include "plugins/support/ModelFrame.h"
#include "plugins/support/OutputFields.h"

namespace MCKestrel_800 {

/// A model that predicts from a CaseVector. A model kind derives from it and writes `Predict`, `GetModelKind`
/// and `Display`; roles, status codes, missing values, output fields and the kind of result are settled here.
///
/// Score gives the error status 90007 for a null record or result, and 90025, with no prediction, for a value
/// that the mining schema refuses (see ScoringStatus.h). A case for which `Predict` has no prediction is
/// settled by the missing-value policy: no prediction and the error status 90027, or the target's default
/// (see BaseModel::HandleMissingValue). Then the document's output fields are filled, whatever the status.
///
/// Keeps nothing of the document. Serves one case at a time.
class VectorModel : public BaseModel {
 public:
  ~VectorModel() override;

  MCScore::MCStatus Score(const ScoreCaseRecord* record, ScoreResult* result) override;
  /// The data fields that the model reads, in the order in which the document first names them; those that a
  /// derived field is computed from stand in its place.
  std::vector<const ScoreDictVar*> GetPredictors() const override;
  /// A RegResult or, for a classification, a ClsResult.
  ScoreResult* MakeResult() const override;
  /// Always false.
  bool SuppressCategoryProbabilities() const override;

 protected:
  /// dictionaries  taken over; frame and inputs speak of their variables.
  /// inputs        sealed before the first case; a member of the derived class, which is not touched here.
  VectorModel(ModelDictionaries dictionaries, ModelFrame frame, CaseVector& inputs);

  /// Writes the prediction into a result that is empty. False, and nothing written, when there is none
  /// because data are missing.
  /// values   the inputs by slot
  /// outcome  what filling them met, but for kInvalidInput
  virtual bool Predict(const double* values, unsigned outcome, ScoreResult& result) = 0;

  /// Whether what decides a case is a rule, which output fields of the feature "ruleValue" are about.
  virtual bool DecidesByRules() const;

  /// Scores a case whose inputs are at hand, as Score does.
  /// record  the case, which output fields may ask for the true value of the target; null when there is none
  MCScore::MCStatus ScoreInputs(const double* values, unsigned outcome, const ScoreCaseRecord* record,
                                ScoreResult& result) {
    if (!frame_.outputs.IsEmpty()) return ScoreWithOutputs(values, outcome, record, result);
    result.Reset();
    return Predict(values, outcome, result) ? MCScore::MCStatus() : PredictDefault(result);
  }

  /// Sets a number as the prediction.
  void SetNumber(ScoreResult& result, double prediction);

  const ModelFrame& GetFrame() const { return frame_; }

 private:
  MCScore::MCStatus ScoreWithOutputs(const double* values, unsigned outcome, const ScoreCaseRecord* record,
                                     ScoreResult& result);
  MCScore::MCStatus PredictDefault(ScoreResult& result);
  MCScore::MCStatus RefuseCase(const ScoreCaseRecord& record, ScoreResult& result);

  ModelFrame frame_;
  CaseVector& inputs_;
  NumericValue prediction_;                      ///< per case, kept so that scoring allocates nothing
  std::vector<const ScoreDictVar*> predictors_;  ///< kept from the first case that is refused
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_VECTORMODEL_H
