// Models with output fields and targets, and what output fields tell, as texts.

#ifndef KESTREL_TESTS_PLUGINS_OUTPUTTEXT_H
#define KESTREL_TESTS_PLUGINS_OUTPUTTEXT_H

#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NumberText.h"
#include "kestrel/model/Results.h"
#include "plugins/tree/TreeTranslator.h"
#include "tests/plugins/RuleSetText.h"
#include "tests/support/ExpectFault.h"

namespace kestrel_tests {

using Cells = std::vector<std::pair<std::string, Cell>>;

constexpr double kSysmis = MCKestrel_800::NumericValue::gSysmisValue;

inline std::string Field(const std::string& attributes) {
  return "<OutputField " + attributes + "/>";
}

inline std::string Output(const std::string& fields) {
  return "<Output>" + fields + "</Output>";
}

/// y = 1 + 2x.
inline std::string RegressionDocument(const std::string& output, const std::string& more = "") {
  return DocumentOf(
      "<RegressionModel functionName='regression'><MiningSchema><MiningField name='x'/>"
      "<MiningField name='y' usageType='target'/></MiningSchema>" +
      output + more +
      "<RegressionTable intercept='1'><NumericPredictor name='x' coefficient='2'/></RegressionTable>"
      "</RegressionModel>");
}

/// P(yes) = 1 / (1 + exp(-x)), of k.
inline std::string LogisticDocument(const std::string& output, const std::string& more = "") {
  return DocumentOf(
      "<RegressionModel functionName='classification' normalizationMethod='logit'><MiningSchema>"
      "<MiningField name='x'/><MiningField name='k' usageType='target'/></MiningSchema>" +
      output + more +
      "<RegressionTable intercept='0' targetCategory='yes'><NumericPredictor name='x' coefficient='1'/>"
      "</RegressionTable><RegressionTable intercept='0' targetCategory='no'/></RegressionModel>");
}

/// x above 1 is "yes" by 3 to 1 with a confidence of 0.7; else "no", at a leaf without identifier.
inline std::string TreeDocument(const std::string& output, const std::string& more = "") {
  return DocumentOf(
      "<TreeModel functionName='classification' missingValueStrategy='nullPrediction'><MiningSchema>"
      "<MiningField name='x'/><MiningField name='k' usageType='target'/></MiningSchema>" +
      output + more + "<Node id='root'><True/><Node id='high' score='yes'>" + kXAbove1 +
      "<ScoreDistribution value='yes' recordCount='3' confidence='0.7'/>"
      "<ScoreDistribution value='no' recordCount='1' confidence='0.3'/></Node>"
      "<Node score='no'><SimplePredicate field='x' operator='lessOrEqual' value='1'/></Node></Node>"
      "</TreeModel>");
}

/// x above 1 fires "r1", which says "yes" with a confidence of 0.9; without a rule there is no prediction.
inline std::string RulesDocument(const std::string& output, const std::string& more = "") {
  const std::string rule_set =
      RuleSetOf("firstHit", "",
                "<SimpleRule id='r1' score='yes' confidence='0.9'>" + kXAbove1 +
                    "</SimpleRule>"
                    "<SimpleRule score='no' confidence='0.6'><SimplePredicate field='x' "
                    "operator='lessThan' value='-5'/></SimpleRule>");
  return DocumentOf(RuleSetModelOf("functionName='classification'", "k", output + more + rule_set));
}

enum class Kind { kRegression, kLogistic, kTree, kRules };

inline std::unique_ptr<MCKestrel_800::ScoreModel> BuildTree(const std::string& document) {
  const auto tree = kestrel_test::ReadTree(document);
  MCKestrel_800::TreeTranslator translator;
  return std::unique_ptr<MCKestrel_800::ScoreModel>(translator.ParseFromTree(tree->GetRoot(), std::string()));
}

inline std::unique_ptr<MCKestrel_800::ScoreModel> Build(Kind kind, const std::string& output,
                                                        const std::string& more = "") {
  switch (kind) {
    case Kind::kRegression:
      return BuildModel(RegressionDocument(output, more));
    case Kind::kLogistic:
      return BuildModel(LogisticDocument(output, more));
    case Kind::kRules:
      return BuildRuleSet(RulesDocument(output, more));
    case Kind::kTree:
      break;
  }
  return BuildTree(TreeDocument(output, more));
}

/// "number 2.5", "text yes", "missing number" or "missing text".
inline std::string Show(const MCKestrel_800::ScoreValue* value) {
  if (value == nullptr) return "nothing";
  if (value->GetType() == MCKestrel_800::ScoreValue::kString) {
    return value->GetString().empty() ? "missing text" : "text " + value->GetString();
  }
  if (value->IsSystemMissingValue()) return "missing number";
  char text[MCKestrel_800::kShortestRoom];
  return "number " + std::string(text, MCKestrel_800::FormatShortest(value->GetDouble(), text));
}

inline const Cells kHigh = {{"x", 2.0}};
inline const Cells kLow = {{"x", -1.0}};
inline const Cells kNone = {{"x", kSysmis}};

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_PLUGINS_OUTPUTTEXT_H
