// Builds rule set models from short texts and shows their results as texts.

#ifndef KESTREL_TESTS_PLUGINS_RULESETTEXT_H
#define KESTREL_TESTS_PLUGINS_RULESETTEXT_H

#include <memory>
#include <sstream>
#include <string>

#include "kestrel/model/ResultEntities.h"
#include "kestrel/model/Results.h"
#include "kestrel/model/ScoreModel.h"
#include "plugins/rule_set/RuleSetTranslator.h"
#include "tests/plugins/ModelText.h"

namespace kestrel_tests {

/// A RuleSetModel element that has the inputs x, z, n and g of TestFields active and one target (none when it
/// is empty).
inline std::string RuleSetModelOf(const std::string& attributes, const std::string& target,
                                  const std::string& rule_set) {
  const std::string target_field =
      target.empty() ? "" : "<MiningField name='" + target + "' usageType='target'/>";
  return "<RuleSetModel " + attributes +
         "><MiningSchema><MiningField name='x'/><MiningField name='z'/><MiningField name='n'/><MiningField "
         "name='g'/>" +
         target_field + "</MiningSchema>" + rule_set + "</RuleSetModel>";
}

/// A RuleSet element with one selection method.
inline std::string RuleSetOf(const std::string& criterion, const std::string& attributes,
                             const std::string& rules) {
  return "<RuleSet " + attributes + "><RuleSelectionMethod criterion='" + criterion + "'/>" + rules +
         "</RuleSet>";
}

/// A model with TestFields whose rules classify.
inline std::string RuleSetDocument(const std::string& criterion, const std::string& target,
                                   const std::string& attributes, const std::string& rules) {
  return DocumentOf(
      RuleSetModelOf("functionName='classification'", target, RuleSetOf(criterion, attributes, rules)));
}

inline std::unique_ptr<MCKestrel_800::ScoreModel> BuildRuleSet(const std::string& document) {
  const auto tree = kestrel_test::ReadTree(document);
  MCKestrel_800::RuleSetTranslator translator;
  return std::unique_ptr<MCKestrel_800::ScoreModel>(translator.ParseFromTree(tree->GetRoot(), std::string()));
}

inline const std::string kXAbove1 = "<SimplePredicate field='x' operator='greaterThan' value='1'/>";
inline const std::string kGIsA = "<SimplePredicate field='g' operator='equal' value='a'/>";

/// A rule with a predicate.
inline std::string If(const std::string& predicate, const std::string& attributes) {
  return "<SimpleRule " + attributes + ">" + predicate + "</SimpleRule>";
}

/// A rule that always fires.
inline std::string Rule(const std::string& attributes) {
  return If("<True/>", attributes);
}

/// A rule that fires where x is above a number.
inline std::string RuleAbove(const std::string& number, const std::string& attributes) {
  return If("<SimplePredicate field='x' operator='greaterThan' value='" + number + "'/>", attributes);
}

/// A model whose rules predict the number y.
inline std::unique_ptr<MCKestrel_800::ScoreModel> BuildRegression(const std::string& criterion,
                                                                  const std::string& attributes,
                                                                  const std::string& rules) {
  return BuildRuleSet(
      DocumentOf(RuleSetModelOf("functionName='regression'", "y", RuleSetOf(criterion, attributes, rules))));
}

/// A result that wants to know the deciding rule.
template <typename Result>
class Telling : public Result {
 public:
  Telling() { Result::GetEntities().SetDecidingIdWanted(true); }
};

/// The prediction, its probability and the deciding rule, such as "yes 0.5 r1"; "-" where there is none.
inline std::string ShowResult(MCKestrel_800::ScoreResult& result) {
  std::ostringstream out;
  const MCKestrel_800::ScoreValue* prediction = result.GetPrediction();
  const std::string& id = MCKestrel_800::ResultEntities::Of(&result)->GetDecidingId();
  out << (prediction == nullptr ? "-" : prediction->GetString()) << ' ' << result.GetProbability() << ' '
      << (id.empty() ? "-" : id);
  return out.str();
}

/// The rules on a result's path, each with a blank in front.
inline std::string ShowPath(MCKestrel_800::ScoreResult& result) {
  const MCKestrel_800::ResultEntities& entities = *MCKestrel_800::ResultEntities::Of(&result);
  std::string path;
  for (size_t i = 0; i < entities.GetPathLength(); ++i)
    path += " " + entities.GetPathId(i);
  return path;
}

/// The categories of a classification's result with their probabilities, such as " yes=0.5 no=0.5".
inline std::string ShowCategories(const MCKestrel_800::ClsResult& result) {
  std::ostringstream out;
  for (size_t i = 0; i < result.GetCategoryCount(); ++i)
    out << ' ' << result.GetCategory(i)->GetString() << '=' << result.GetProbability(i);
  return out.str();
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_PLUGINS_RULESETTEXT_H
