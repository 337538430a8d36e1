// The model of a PMML RuleSetModel: rules that fire or not, and a choice among those that do.

#ifndef KESTREL_PLUGINS_RULE_SET_RULESETMODEL_H
#define KESTREL_PLUGINS_RULE_SET_RULESETMODEL_H

#include <memory>
#include <string>
#include <vector>

#include "kestrel/model/BaseModel.h"
#include "plugins/rule_set/RuleSelector.h"
#include "plugins/rule_set/RuleSet.h"
#include "plugins/support/CaseVector.h"
#include "plugins/support/ModelTranslator.h"

namespace MCKestrel_800 {

class ResultEntities;

/// Scores cases by rules. Keeps nothing of the document. Serves one case at a time.
///
/// RuleSelector says which rule decides; its score is the prediction and its confidence the prediction's
/// probability. When no rule fires, the default score is predicted with the default confidence (a probability
/// of 0 where the document gives none). Without a default score the missing-value policy settles the case: no
/// prediction and the error status 90027, or the target's default. A missing value is no failure: the
/// predicates that it leaves unknown do not fire. A value that the mining schema refuses gives the error
/// status of ScoringStatus.h and no prediction.
///
/// The probabilities of a classification's categories are the shares of all weights by the criterion
/// weightedSum, and by the others the distribution that the deciding rule, or for the default score the rule
/// set, has. Where there are none the predicted category stands alone, with the prediction's confidence, if
/// there is one.
///
/// The result's deciding entity, when wanted, is the rule; the default score has none. Its path, when wanted,
/// are all rules that fire, also those that the criterion does not look at.
class RuleSetModel : public BaseModel {
 public:
  /// What a document says, compiled.
  struct Definition {
    ModelFrame frame;
    std::unique_ptr<CaseVector> inputs;  ///< sealed
    std::unique_ptr<RuleSet> rule_set;
  };

  /// dictionaries  taken over, whatever happens; the definition speaks of their variables.
  RuleSetModel(ModelDictionaries dictionaries, Definition definition);
  ~RuleSetModel() override;

  MCScore::MCStatus Score(const ScoreCaseRecord* record, ScoreResult* result) override;
  /// The data fields that the predicates use, in the order in which the document first names them; those that
  /// a derived field is computed from stand in its place.
  std::vector<const ScoreDictVar*> GetPredictors() const override;
  /// A RegResult or, for a classification, a ClsResult.
  ScoreResult* MakeResult() const override;
  std::string GetModelKind() const override;
  /// Always false.
  bool SuppressCategoryProbabilities() const override;
  /// Opens with "Start RuleSetModel Display:" and closes with "End of RuleSetModel Display.". A rule is told
  /// without its predicate.
  void Display(std::ostream& out) const override;

 private:
  bool Decide(const double* values, ScoreResult& result);
  void TellRules(const RuleSelector::Choice& choice, const double* values, ResultEntities& entities) const;
  bool FindProbabilities(const RuleSelector::Choice& choice);
  void TellCategories(const RuleSelector::Choice& choice, ScoreResult& result);
  void DisplayRule(int rule, std::ostream& out) const;

  const Definition definition_;
  const RuleSet& rule_set_;
  RuleSelector selector_;
  std::vector<double> probabilities_;  ///< per case, kept so that scoring allocates nothing
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_RULE_SET_RULESETMODEL_H
