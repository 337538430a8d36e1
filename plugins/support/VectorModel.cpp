#include "plugins/support/VectorModel.h"

#include <typeinfo>
#include <utility>

#include "kestrel/model/ResultEntities.h"
#include "kestrel/model/Results.h"
#include "plugins/support/ScoringStatus.h"

namespace MCKestrel_800 {

using MCScore::MCStatus;

VectorModel::VectorModel(ModelDictionaries dictionaries, ModelFrame frame, CaseVector& inputs)
    : frame_(std::move(frame)), inputs_(inputs) {
  dictionaries.GiveTo(*this);
  frame_.schema.SetRoles(*this);
  if (!frame_.target.empty()) SetVarRole(frame_.target, kTarget);
}

VectorModel::~VectorModel() = default;

MCStatus VectorModel::Score(const ScoreCaseRecord* record, ScoreResult* result) {
  if (record == nullptr || result == nullptr) return MCStatus(kNullArgumentStatus, false);
  const unsigned outcome = inputs_.Fill(*record);
  if ((outcome & CaseVector::kInvalidInput) != 0) return RefuseCase(*record, *result);
  return ScoreInputs(inputs_.GetValues(), outcome, record, *result);
}

MCStatus VectorModel::ScoreWithOutputs(const double* values, unsigned outcome, const ScoreCaseRecord* record,
                                       ScoreResult& result) {
  if (frame_.outputs.TellEntities()) {
    if (ResultEntities* entities = ResultEntities::Of(&result)) entities->SetDecidingIdWanted(true);
  }
  ScoredCase scored;
  scored.record = record;
  scored.is_decided_by_rule = DecidesByRules();
  MCStatus status;
  result.Reset();
  if (!Predict(values, outcome, result)) {
    status = PredictDefault(result);
    scored.basis =
        result.GetPrediction() != nullptr ? ScoredCase::Basis::kDefault : ScoredCase::Basis::kNothing;
  }
  frame_.outputs.Write(scored, result);
  return status;
}

MCStatus VectorModel::PredictDefault(ScoreResult& result) {
  if (GetMissingValuePolicy() != kDefaultPrediction) return MCStatus(kNoPredictionStatus, false);
  return HandleMissingValue(&result);
}

MCStatus VectorModel::RefuseCase(const ScoreCaseRecord& record, ScoreResult& result) {
  result.Reset();
  const int field = inputs_.GetInvalidField();
  MCStatus status(kInvalidValueStatus, false);
  status.SetDiscreteDatum(0, field);
  if (!frame_.outputs.IsEmpty()) {
    ScoredCase scored;
    scored.record = &record;
    scored.basis = ScoredCase::Basis::kRefused;
    if (predictors_.empty()) predictors_ = inputs_.GetPredictors();
    if (static_cast<std::size_t>(field) < predictors_.size()) {
      scored.refused_field = predictors_[static_cast<std::size_t>(field)];
    }
    frame_.outputs.Write(scored, result);
  }
  return status;
}

// Mostly the result is of the class that MakeResult gives, which takes a number as it is.
void VectorModel::SetNumber(ScoreResult& result, double prediction) {
  if (&typeid(result) == &typeid(RegResult)) return static_cast<RegResult&>(result).SetNumber(prediction);
  prediction_.SetDoubleValue(prediction);
  result.SetPrediction(&prediction_);
}

std::vector<const ScoreDictVar*> VectorModel::GetPredictors() const {
  return inputs_.GetPredictors();
}

ScoreResult* VectorModel::MakeResult() const {
  if (frame_.is_classification) return new ClsResult;
  return new RegResult;
}

bool VectorModel::SuppressCategoryProbabilities() const {
  return false;
}

bool VectorModel::DecidesByRules() const {
  return false;
}

}  // namespace MCKestrel_800
