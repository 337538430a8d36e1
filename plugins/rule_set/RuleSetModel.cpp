#include "plugins/rule_set/RuleSetModel.h"

#include <ostream>
#include <utility>

#include "kestrel/foundation/NumberText.h"
#include "kestrel/model/ResultEntities.h"
#include "kestrel/model/Results.h"
#include "kestrel/translate/PMMLModelTags.h"

namespace MCKestrel_800 {

RuleSetModel::RuleSetModel(ModelDictionaries dictionaries, ModelFrame frame, Definition definition)
    : VectorModel(std::move(dictionaries), std::move(frame), *definition.inputs),
      definition_(std::move(definition)),
      rule_set_(*definition_.rule_set),
      selector_(rule_set_.selection, rule_set_.rules, static_cast<std::size_t>(rule_set_.scores.GetCount())) {
  if (GetFrame().is_classification) {
    probabilities_.resize(static_cast<std::size_t>(rule_set_.scores.GetCount()));
  }
}

RuleSetModel::~RuleSetModel() = default;

// False when no rule fires and there is no default score.
bool RuleSetModel::Predict(const double* values, unsigned, ScoreResult& result) {
  RuleSelector::Choice choice = selector_.Choose(values);
  if (choice.rule == RuleTable::kNone) {
    if (rule_set_.default_score == RuleTable::kNone) return false;
    choice.score = rule_set_.default_score;
    choice.confidence = rule_set_.default_confidence;
  }
  result.SetPrediction(&rule_set_.scores.Get(choice.score));
  if (!NumericValue::IsSystemMissingValue(choice.confidence)) result.SetProbability(choice.confidence);
  ResultEntities* const entities = ResultEntities::Of(&result);
  if (entities != nullptr && entities->IsDecidingIdWanted()) TellRules(choice, values, *entities);
  if (GetFrame().is_classification) TellCategories(choice, result);
  return true;
}

void RuleSetModel::TellRules(const RuleSelector::Choice& choice, const double* values,
                             ResultEntities& entities) const {
  if (choice.rule == RuleTable::kNone) return;
  entities.SetDecidingId(rule_set_.rules.GetId(choice.rule));
  if (!entities.IsPathWanted()) return;
  rule_set_.rules.VisitFiring(values, [this, &entities](int rule) {
    entities.AddToPath(rule_set_.rules.GetId(rule));
    return true;
  });
}

void RuleSetModel::TellCategories(const RuleSelector::Choice& choice, ScoreResult& result) {
  // Kind 0 is what MakeResult gives; another kind has no place for the single categories.
  if (result.GetResultKind() != 0) return;
  auto& classification = static_cast<ScoreClsResult&>(result);
  if (FindProbabilities(choice)) {
    for (std::size_t score = 0; score < probabilities_.size(); ++score) {
      classification.AddCategoryProbability(&rule_set_.scores.Get(static_cast<int>(score)),
                                            probabilities_[score]);
    }
  } else if (!NumericValue::IsSystemMissingValue(choice.confidence)) {
    classification.AddCategoryProbability(&rule_set_.scores.Get(choice.score), choice.confidence);
  }
}

// False when there are none for this case.
bool RuleSetModel::FindProbabilities(const RuleSelector::Choice& choice) {
  int distribution = rule_set_.default_distribution;
  if (choice.rule != RuleTable::kNone) {
    if (rule_set_.selection == RuleSelection::kWeightedSum) return selector_.FillShares(probabilities_);
    distribution = rule_set_.rules.Get(choice.rule).distribution;
  }
  if (distribution == DistributionTable::kNone) return false;
  rule_set_.distributions.Fill(distribution, probabilities_);
  return true;
}

bool RuleSetModel::DecidesByRules() const {
  return true;
}

std::string RuleSetModel::GetModelKind() const {
  return PMMLModelTags::XML_ELE_RULESETMODEL;
}

void RuleSetModel::Display(std::ostream& out) const {
  out << "Start RuleSetModel Display:\n";
  out << "Function = " << (GetFrame().is_classification ? "classification" : "regression")
      << "; Criterion = " << RuleSelectionText(rule_set_.selection);
  if (!GetTargetName().empty()) out << "; Target = " << GetTargetName();
  out << "\n";
  if (rule_set_.default_score != RuleTable::kNone) {
    out << "Default score = " << rule_set_.scores.Get(rule_set_.default_score).GetString();
    if (!NumericValue::IsSystemMissingValue(rule_set_.default_confidence))
      out << "; Confidence = " << FormatSixDigits(rule_set_.default_confidence);
    out << "\n";
  }
  for (int rule = 0; rule < rule_set_.rules.GetCount(); ++rule)
    DisplayRule(rule, out);
  out << "End of RuleSetModel Display.\n\n";
}

void RuleSetModel::DisplayRule(int number, std::ostream& out) const {
  const RuleTable::Rule& rule = rule_set_.rules.Get(number);
  if (rule.score == RuleTable::kNone) {
    out << "\tCompoundRule; Rules inside = " << rule_set_.rules.GetNext(number) - number - 1 << "\n";
    return;
  }
  out << "\tSimpleRule " << rule_set_.rules.GetId(number)
      << "; Score = " << rule_set_.scores.Get(rule.score).GetString()
      << "; Weight = " << FormatSixDigits(rule.weight)
      << "; Confidence = " << FormatSixDigits(rule.confidence) << "\n";
}

}  // namespace MCKestrel_800
