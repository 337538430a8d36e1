// Builds models of every kind over derived fields from short texts, and shows what they predict as texts.

#ifndef KESTREL_TESTS_PLUGINS_DERIVEDMODELTEXT_H
#define KESTREL_TESTS_PLUGINS_DERIVEDMODELTEXT_H

#include <gtest/gtest.h>

#include <charconv>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "kestrel/model/Results.h"
#include "plugins/rule_set/RuleSetTranslator.h"
#include "plugins/tree/TreeModel.h"
#include "plugins/tree/TreeTranslator.h"
#include "tests/plugins/ModelText.h"

namespace kestrel_tests {

/// A derived field. `type` is a dataType with an optype in front of it, such as "continuous double".
inline std::string Derived(const std::string& name, const std::string& type, const std::string& expression) {
  const std::size_t blank = type.find(' ');
  return "<DerivedField name='" + name + "' optype='" + type.substr(0, blank) + "' dataType='" +
         type.substr(blank + 1) + "'>" + expression + "</DerivedField>";
}

inline std::string FieldRef(const std::string& field, const std::string& attributes = std::string()) {
  return "<FieldRef field='" + field + "' " + attributes + "/>";
}
inline std::string NormContinuous(const std::string& field, const std::string& points,
                                  const std::string& attributes = std::string()) {
  return "<NormContinuous field='" + field + "' " + attributes + ">" + points + "</NormContinuous>";
}
inline std::string LinearNorm(const std::string& orig, const std::string& norm) {
  return "<LinearNorm orig='" + orig + "' norm='" + norm + "'/>";
}
inline std::string NormDiscrete(const std::string& field, const std::string& value,
                                const std::string& attributes = std::string()) {
  return "<NormDiscrete field='" + field + "' value='" + value + "' " + attributes + "/>";
}
inline std::string Apply(const std::string& function, const std::string& arguments) {
  return "<Apply function='" + function + "'>" + arguments + "</Apply>";
}
inline std::string Constant(const std::string& text) {
  return "<Constant dataType='double'>" + text + "</Constant>";
}
/// `field` in three bins: "low" below `from`, "mid" up to `to`, "high" above.
inline std::string Bins(const std::string& field, const std::string& from, const std::string& to,
                        const std::string& attributes = std::string()) {
  return "<Discretize field='" + field + "' " + attributes +
         "><DiscretizeBin binValue='low'><Interval closure='openOpen' rightMargin='" + from +
         "'/></DiscretizeBin><DiscretizeBin binValue='mid'><Interval closure='closedClosed' leftMargin='" +
         from + "' rightMargin='" + to +
         "'/></DiscretizeBin><DiscretizeBin binValue='high'><Interval closure='openOpen' leftMargin='" + to +
         "'/></DiscretizeBin></Discretize>";
}
/// A table from the categories a, b and c of `field` to three values.
inline std::string Map(const std::string& field, const std::string& a, const std::string& b,
                       const std::string& c, const std::string& attributes = std::string()) {
  const auto row = [](const std::string& from, const std::string& to) {
    return "<row><from>" + from + "</from><to>" + to + "</to></row>";
  };
  return "<MapValues outputColumn='to' " + attributes + "><FieldColumnPair field='" + field +
         "' column='from'/><InlineTable>" + row("a", a) + row("b", b) + row("c", c) +
         "</InlineTable></MapValues>";
}

/// What stands around the part of a model that is its own.
struct DerivedDocument {
  std::string global;                 ///< fields of the TransformationDictionary
  std::string local;                  ///< fields of the LocalTransformations
  std::string fields = TestInputs();  ///< of the mining schema, but for the target
  std::string target = "y";

  std::string Frame() const {
    return "<MiningSchema>" + fields + "<MiningField name='" + target +
           "' usageType='target'/></MiningSchema>" +
           (local.empty() ? "" : "<LocalTransformations>" + local + "</LocalTransformations>");
  }
  std::string With(const std::string& model) const {
    return "<PMML version='4.4'>" + kestrel_test::DictionaryOf(9, TestFields()) +
           (global.empty() ? "" : "<TransformationDictionary>" + global + "</TransformationDictionary>") +
           model + "</PMML>";
  }
  /// A regression of y on the terms.
  std::string Regression(const std::string& terms) const {
    return With("<RegressionModel functionName='regression'>" + Frame() + "<RegressionTable intercept='0'>" +
                terms + "</RegressionTable></RegressionModel>");
  }
  /// A tree that predicts 1 where the predicate is true, 0 where it is false and nothing where it is unknown.
  std::string Tree(const std::string& predicate) const {
    return With("<TreeModel functionName='regression' missingValueStrategy='nullPrediction'>" + Frame() +
                "<Node score='9'><True/><Node score='1'>" + predicate +
                "</Node><Node score='0'><True/></Node></Node></TreeModel>");
  }
  /// A rule that predicts 1 where the predicate is true, and 0 by default.
  std::string Rules(const std::string& predicate) const {
    return With(
        "<RuleSetModel functionName='regression'>" + Frame() +
        "<RuleSet defaultScore='0'><RuleSelectionMethod criterion='firstHit'/><SimpleRule score='1'>" +
        predicate + "</SimpleRule></RuleSet></RuleSetModel>");
  }
};

/// Builds the model of a document, whichever of the three kinds it is.
inline std::unique_ptr<MCKestrel_800::ScoreModel> BuildAny(const std::string& document) {
  const auto parsed = kestrel_test::ReadTree(document);
  std::unique_ptr<MCKestrel_800::ModelTranslator> translator =
      std::make_unique<MCKestrel_800::RegressionTranslator>();
  if (document.find("<TreeModel") != std::string::npos) {
    translator = std::make_unique<MCKestrel_800::TreeTranslator>();
  } else if (document.find("<RuleSetModel") != std::string::npos) {
    translator = std::make_unique<MCKestrel_800::RuleSetTranslator>();
  }
  return std::unique_ptr<MCKestrel_800::ScoreModel>(
      translator->ParseFromTree(parsed->GetRoot(), std::string()));
}

using Case = std::vector<std::pair<std::string, Cell>>;

/// The prediction as the shortest text of its number; of a status that is no OK the code, and for a refused
/// input its position behind it.
inline std::string ScoreOf(MCKestrel_800::ScoreModel& model, const MCKestrel_800::ScoreCaseRecord& record) {
  const std::unique_ptr<MCKestrel_800::ScoreResult> result(model.MakeResult());
  const MCScore::MCStatus status = model.Score(&record, result.get());
  if (!status.IsOK()) {
    std::string text = std::to_string(status.GetErrorCode());
    if (status.GetErrorCode() == 90025) text += "/" + std::to_string(status.GetDiscreteDatum(0));
    return text;
  }
  const MCKestrel_800::ScoreValue* const prediction = result->GetPrediction();
  if (prediction == nullptr) return "-";
  if (prediction->GetType() != MCKestrel_800::ScoreValue::kNumeric) return prediction->GetString();
  char text[32];
  return std::string(text, std::to_chars(std::begin(text), std::end(text), prediction->GetDouble()).ptr);
}
inline std::string ScoreOf(MCKestrel_800::ScoreModel& model, const Case& cells) {
  return ScoreOf(model, RecordOf(cells));
}
inline std::string ScoreOf(const std::string& document, const Case& cells) {
  return ScoreOf(*BuildAny(document), cells);
}

inline std::string Number(const std::string& field, const std::string& coefficient = "1") {
  return "<NumericPredictor name='" + field + "' coefficient='" + coefficient + "'/>";
}
inline std::string Category(const std::string& field, const std::string& value,
                            const std::string& coefficient = "1") {
  return "<CategoricalPredictor name='" + field + "' value='" + value + "' coefficient='" + coefficient +
         "'/>";
}
inline std::string Compare(const std::string& field, const std::string& operator_text,
                           const std::string& value) {
  return "<SimplePredicate field='" + field + "' operator='" + operator_text + "' value='" + value + "'/>";
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_PLUGINS_DERIVEDMODELTEXT_H
