#include "kestrel/model/BaseModel.h"

#include <algorithm>
#include <iterator>
#include <vector>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/dictionary/ScoreValueProbability.h"
#include "kestrel/dictionary/ScoreValueProbabilitySet.h"
#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/model/ScoreClsResult.h"
#include "kestrel/model/ScoreResult.h"
#include "kestrel/model/ScoreVersionInfo.h"
#include "kestrel/transform/TransformationDictionary.h"

namespace MCKestrel_800 {
namespace {

/// The result kinds in which a missing case's category probabilities are recorded.
constexpr int kKindsWithProbabilities[] = {0, 2, 3, 4, 6, 10, 15, 18, 20, 21, 24, 26};

bool RecordsProbabilities(int kind) {
  return std::find(std::begin(kKindsWithProbabilities), std::end(kKindsWithProbabilities), kind) !=
         std::end(kKindsWithProbabilities);
}

}  // namespace

// Defined here too, so that hosts and plug-ins can take its address.
constexpr long BaseModel::kNoPrediction;

BaseModel::~BaseModel() {
  delete version_;
  roles_.clear();
  delete dictionary_;
  delete transformations_;
  delete result_dictionary_;
}

void BaseModel::SetScoreDictionary(ScoreDictionary* dictionary) {
  dictionary_ = dictionary;
}

void BaseModel::SetTransformationScoreDictionary(TransformationDictionary* dictionary) {
  transformations_ = dictionary;
}

void BaseModel::SetResultScoreDictionary(ScoreDictionary* dictionary) {
  result_dictionary_ = dictionary;
}

bool BaseModel::SetVarRole(const std::string& name, VarRole role) {
  if (name.empty()) return false;
  const bool known = (dictionary_ != nullptr && dictionary_->GetVar(name) != nullptr) ||
                     (transformations_ != nullptr && transformations_->GetVar(name) != nullptr);
  if (!known) return false;
  if (role == kTarget) target_name_ = name;
  roles_[name] = role;
  return true;
}

bool BaseModel::SetVarRole(const ScoreDictVar* variable, VarRole role) {
  return variable != nullptr && SetVarRole(variable->GetName(), role);
}

void BaseModel::SetMissingValuePolicy(MVPolicy policy) {
  policy_ = policy;
}

void BaseModel::SetVersionInfo(ScoreVersionInfo* version) {
  version_ = version;
}

int BaseModel::GetVarRole(const std::string& name) const {
  const auto found = roles_.find(name);
  return name.empty() || found == roles_.end() ? -1 : found->second;
}

int BaseModel::GetVarRole(const ScoreDictVar* variable) const {
  return variable != nullptr ? GetVarRole(variable->GetName()) : -1;
}

const ScoreVersionInfo* BaseModel::GetVersionInfo() const {
  return version_;
}

const ScoreDictVar* BaseModel::GetTargetVar() const {
  if (dictionary_ == nullptr || target_name_.empty()) return nullptr;
  return static_cast<const ScoreDictionary*>(dictionary_)->GetVar(target_name_);
}

const ScoreDictionary* BaseModel::GetDictionary() const {
  return dictionary_;
}

TransformationDictionary* BaseModel::GetTransformationDictionary() const {
  return transformations_;
}

ScoreDictionary* BaseModel::GetResultDictionary() const {
  return result_dictionary_;
}

BaseModel::MVPolicy BaseModel::GetMissingValuePolicy() const {
  return policy_;
}

MCScore::MCStatus BaseModel::HandleMissingValue(ScoreResult* result) {
  if (result == nullptr) return MCScore::MCStatus();
  const ScoreDictVar* target = GetTargetVar();
  if (target == nullptr) return MCScore::MCStatus(kNoPrediction, false);
  if (target->GetMLevel() != ScoreDictVar::kContinuous) return PredictMostProbable(*target, *result);
  const ScoreValue* default_value = target->GetDefValue();
  if (default_value == nullptr) return MCScore::MCStatus(kNoPrediction, false);
  result->SetPrediction(default_value);
  return MCScore::MCStatus();
}

MCScore::MCStatus BaseModel::PredictMostProbable(const ScoreDictVar& target, ScoreResult& result) const {
  const ScoreValueProbabilitySet* probabilities = target.GetValueProbabilities();
  if (probabilities == nullptr) {
    result.SetPrediction(nullptr);
    return MCScore::MCStatus(kNoPrediction, false);
  }
  ScoreClsResult* categories = nullptr;
  if (RecordsProbabilities(result.GetResultKind()) && !SuppressCategoryProbabilities()) {
    categories = dynamic_cast<ScoreClsResult*>(&result);
  }
  // From 0.0 on, so that an impossible category never wins; strictly above, so that the first of equals does.
  const ScoreValueProbability* winner = nullptr;
  double highest = 0.0;
  for (const ScoreValueProbability* entry : probabilities->GetAllValueProbabilities()) {
    if (entry->GetProbability() > highest) {
      highest = entry->GetProbability();
      winner = entry;
    }
    if (categories != nullptr) categories->AddCategoryProbability(entry->GetValue(), entry->GetProbability());
  }
  if (winner != nullptr) {
    result.SetPrediction(winner->GetValue());
    result.SetProbability(highest);
  }
  return MCScore::MCStatus();
}

}  // namespace MCKestrel_800
