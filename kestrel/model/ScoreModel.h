// The interface between a host program and a model: everything a host does with a model goes through it, and
// every model library implements it.

#ifndef KESTREL_MODEL_SCOREMODEL_H
#define KESTREL_MODEL_SCOREMODEL_H

#include <iosfwd>
#include <string>
#include <vector>

#include "kestrel/foundation/MCStatus.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

class ScoreCaseRecord;
class ScoreDictVar;
class ScoreDictionary;
class ScoreResult;
class ScoreVersionInfo;
class TransformationDictionary;

/// A model that scores cases. The order of the operations is part of the interface, because model libraries
/// are built apart from the core.
///
/// A model is filled on one thread by the translator that builds it and belongs to whoever got it from the
/// factory, who deletes it. It scores one case at a time: several threads need a model each.
class KESTREL_API ScoreModel {
 public:
  /// What a variable is to the model.
  enum VarRole : int {
    kUnused = 0,
    kTarget = 1,
    kPredictor = 2,
    kSupplementary = 3,
    kOrder = 4,
    kFrequencyWeight = 5,
    kAnalysisWeight = 6,
    kGroup = 7
  };

  /// What the model predicts for a case that it cannot score because values are missing.
  enum MVPolicy : int {
    kNullPrediction = 0,    ///< no prediction
    kDefaultPrediction = 1  ///< the target's default value, or its most probable category
  };

  ScoreModel() = default;
  ScoreModel(const ScoreModel&) = delete;
  ScoreModel& operator=(const ScoreModel&) = delete;
  virtual ~ScoreModel();

  /// The four setters of dictionaries and version take the object over. They do not delete one that was set
  /// before: whoever replaces an object deletes the old one.
  virtual void SetScoreDictionary(ScoreDictionary* dictionary) = 0;
  virtual void SetTransformationScoreDictionary(TransformationDictionary* dictionary) = 0;
  virtual void SetResultScoreDictionary(ScoreDictionary* dictionary) = 0;

  /// Gives a variable its role. False, and nothing changed, for an empty name or one that is in neither the
  /// data dictionary nor the transformation dictionary. The variable given the target role becomes the
  /// model's target.
  virtual bool SetVarRole(const std::string& name, VarRole role) = 0;
  /// The same by the variable's name; false for null.
  virtual bool SetVarRole(const ScoreDictVar* variable, VarRole role) = 0;

  virtual void SetMissingValuePolicy(MVPolicy policy) = 0;
  virtual void SetVersionInfo(ScoreVersionInfo* version) = 0;

  /// Scores one case and fills `result`, which must be of the kind that MakeResult gives. Both stay the
  /// caller's. What kept the case from being scored is told by the status; nothing is thrown.
  virtual MCScore::MCStatus Score(const ScoreCaseRecord* record, ScoreResult* result) = 0;

  /// The variable's role, or -1 when it has none.
  virtual int GetVarRole(const std::string& name) const = 0;
  virtual int GetVarRole(const ScoreDictVar* variable) const = 0;

  /// The model's version; null when none was set. Belongs to the model.
  virtual const ScoreVersionInfo* GetVersionInfo() const = 0;

  /// The variables that the model reads from a case, in the model's own order. They belong to its
  /// dictionaries.
  virtual std::vector<const ScoreDictVar*> GetPredictors() const = 0;

  /// The variable that the model predicts; null when it has none. Belongs to the data dictionary.
  virtual const ScoreDictVar* GetTargetVar() const = 0;

  /// The model's dictionaries; null when not set. They belong to the model.
  virtual const ScoreDictionary* GetDictionary() const = 0;
  virtual TransformationDictionary* GetTransformationDictionary() const = 0;
  virtual ScoreDictionary* GetResultDictionary() const = 0;

  /// A new, empty result of the kind that Score fills. The caller owns it and should use it for many cases:
  /// what it holds is kept from case to case, so that scoring allocates nothing.
  virtual ScoreResult* MakeResult() const = 0;

  virtual MVPolicy GetMissingValuePolicy() const = 0;

  /// The tag of the model's element, such as "TreeModel".
  virtual std::string GetModelKind() const = 0;

  /// True when the probabilities of the single categories are not recorded in results.
  virtual bool SuppressCategoryProbabilities() const = 0;

  /// Writes the model as text, for people.
  virtual void Display(std::ostream& out) const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_MODEL_SCOREMODEL_H
