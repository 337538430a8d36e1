// What all models have in common, so that a model library writes its algorithm and little else.

#ifndef KESTREL_MODEL_BASEMODEL_H
#define KESTREL_MODEL_BASEMODEL_H

#include <map>
#include <string>

#include "kestrel/foundation/MCStatus.h"
#include "kestrel/model/ScoreModel.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// A model's dictionaries, roles, target, missing-value policy and version. `Score`, `GetPredictors`,
/// `MakeResult`, `GetModelKind`, `SuppressCategoryProbabilities` and `Display` are left to the model.
///
/// Owns its dictionaries and its version record and deletes them. The setters store the pointer and do not
/// delete the object that was held before.
class KESTREL_API BaseModel : public ScoreModel {
 public:
  BaseModel() = default;
  ~BaseModel() override;

  void SetScoreDictionary(ScoreDictionary* dictionary) override;
  void SetTransformationScoreDictionary(TransformationDictionary* dictionary) override;
  void SetResultScoreDictionary(ScoreDictionary* dictionary) override;
  bool SetVarRole(const std::string& name, VarRole role) override;
  bool SetVarRole(const ScoreDictVar* variable, VarRole role) override;
  void SetMissingValuePolicy(MVPolicy policy) override;
  void SetVersionInfo(ScoreVersionInfo* version) override;

  int GetVarRole(const std::string& name) const override;
  int GetVarRole(const ScoreDictVar* variable) const override;
  const ScoreVersionInfo* GetVersionInfo() const override;
  /// The data dictionary's variable with the target's name, looked up at each call.
  const ScoreDictVar* GetTargetVar() const override;
  const ScoreDictionary* GetDictionary() const override;
  TransformationDictionary* GetTransformationDictionary() const override;
  ScoreDictionary* GetResultDictionary() const override;
  MVPolicy GetMissingValuePolicy() const override;

 protected:
  /// The status code of a case for which neither the model nor a default could give a prediction.
  static constexpr long kNoPrediction = 90027;

  /// Predicts without the case's values, for a case that cannot be scored because data are missing.
  ///
  /// A continuous target gives its default value. A categorical one gives its most probable category with
  /// that probability; of equally probable ones the first; and the probabilities of all categories are
  /// recorded when the result is of a kind that has them and the model does not suppress them. When no
  /// probability is above zero the prediction is left as it was, and the status is OK. An error with the code
  /// 90027 says that there is no target, no default or no probabilities; for a categorical target the
  /// prediction is then cleared. A null result is OK.
  MCScore::MCStatus HandleMissingValue(ScoreResult* result);

  /// The roles by variable name.
  const std::map<std::string, VarRole>& GetVarRoles() const { return roles_; }
  /// The target's name; empty when no variable has the target role.
  const std::string& GetTargetName() const { return target_name_; }

 private:
  MCScore::MCStatus PredictMostProbable(const ScoreDictVar& target, ScoreResult& result) const;

  ScoreDictionary* dictionary_ = nullptr;
  TransformationDictionary* transformations_ = nullptr;
  ScoreDictionary* result_dictionary_ = nullptr;
  ScoreVersionInfo* version_ = nullptr;
  std::map<std::string, VarRole> roles_;
  MVPolicy policy_ = kDefaultPrediction;
  std::string target_name_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_MODEL_BASEMODEL_H
