// The model of a PMML RuleSetModel: rules that fire or not, and a choice among those that do.

#ifndef KESTREL_PLUGINS_RULE_SET_RULESETMODEL_H
#define KESTREL_PLUGINS_RULE_SET_RULESETMODEL_H

#include <memory>
#include <string>
#include <vector>

#include "plugins/rule_set/RuleSelector.h"
#include "plugins/rule_set/RuleSet.h"
#include "plugins/support/CaseVector.h"
#include "plugins/support/VectorModel.h"

namespace MCKestrel_800 {

class ResultEntities;

/// Scores cases by rules; see VectorModel for what that comes to when data are missing or invalid.
///
/// RuleSelector says which rule decides; its score is the prediction and its confidence the prediction's
/// probability. When no rule fires, the default score is predicted with the default confidence (a probability
/// of 0 where the document gives none). Without a default score there is no prediction. A missing value is no
/// failure: the predicates that it leaves unknown do not fire.
///
/// The probabilities of a classification's categories are the shares of all weights by the criterion
/// weightedSum, and by the others the distribution that the deciding rule, or for the default score the rule
/// set, has. Where there are none the predicted category stands alone, with the prediction's confidence, if
/// there is one.
///
/// The result's deciding entity, when wanted, is the rule; the default score has none. Its path, when wanted,
/// are all rules that fire, also those that the criterion does not look at.
class RuleSetModel : public VectorModel {
 public:
  /// What a document says, compiled.
  struct Definition {
    std::unique_ptr<CaseVector> inputs;  ///< sealed
    std::unique_ptr<RuleSet> rule_set;
  };

  /// dictionaries  taken over, whatever happens; frame and definition speak of their variables.
  RuleSetModel(ModelDictionaries dictionaries, ModelFrame frame, Definition definition);
  ~RuleSetModel() override;

  std::string GetModelKind() const override;
  /// Opens with "Start RuleSetModel Display:" and closes with "End of RuleSetModel Display.". A rule is told
  /// without its predicate.
  void Display(std::ostream& out) const override;

 protected:
  bool Predict(const double* values, unsigned outcome, ScoreResult& result) override;
  bool DecidesByRules() const override;

 private:
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
