// Builds tree models from short texts and shows their results as texts.

#ifndef KESTREL_TESTS_PLUGINS_TREETEXT_H
#define KESTREL_TESTS_PLUGINS_TREETEXT_H

#include <charconv>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "kestrel/model/ResultEntities.h"
#include "kestrel/model/Results.h"
#include "kestrel/model/ScoreModel.h"
#include "plugins/tree/TreeModel.h"
#include "plugins/tree/TreeTranslator.h"
#include "tests/plugins/ModelText.h"

namespace kestrel_tests {

/// A dictionary with TestFields and two more: the date d and the ordinal number r, whose categories 10, 20
/// and 5 stand in this order.
inline std::string TreeDictionary() {
  return kestrel_test::DictionaryOf(
      11, std::string(TestFields()) +
              "<DataField name='d' optype='continuous' dataType='date'/>"
              "<DataField name='r' optype='ordinal' dataType='integer'>"
              "<Value value='10'/><Value value='20'/><Value value='5'/></DataField>");
}

/// A mining schema that has all inputs active, the ordinal text o among them, but for the one that is the
/// target (none when it is empty).
inline std::string TreeSchema(const std::string& target) {
  std::string fields;
  for (const std::string name : {"x", "z", "n", "g", "t", "o", "d", "r"}) {
    if (name != target) fields += "<MiningField name='" + name + "'/>";
  }
  if (!target.empty()) fields += "<MiningField name='" + target + "' usageType='target'/>";
  return "<MiningSchema>" + fields + "</MiningSchema>";
}

/// A TreeModel element; `attributes` beside the function's name.
inline std::string TreeModelOf(const std::string& function, const std::string& attributes,
                               const std::string& schema, const std::string& nodes) {
  return "<TreeModel functionName='" + function + "' " + attributes + ">" + schema + nodes + "</TreeModel>";
}

inline std::string TreeDocument(const std::string& model) {
  return "<PMML version='4.4'>" + TreeDictionary() + model + "</PMML>";
}

inline std::unique_ptr<MCKestrel_800::TreeModel> BuildTree(const std::string& document) {
  const auto parsed = kestrel_test::ReadTree(document);
  MCKestrel_800::TreeTranslator translator;
  return std::unique_ptr<MCKestrel_800::TreeModel>(
      static_cast<MCKestrel_800::TreeModel*>(translator.ParseFromTree(parsed->GetRoot(), std::string())));
}

/// A tree that predicts m: red, green or blue.
inline std::unique_ptr<MCKestrel_800::TreeModel> BuildClassifier(const std::string& attributes,
                                                                 const std::string& nodes) {
  return BuildTree(TreeDocument(TreeModelOf("classification", attributes, TreeSchema("m"), nodes)));
}

/// A tree that predicts the number y.
inline std::unique_ptr<MCKestrel_800::TreeModel> BuildEstimator(const std::string& attributes,
                                                                const std::string& nodes) {
  return BuildTree(TreeDocument(TreeModelOf("regression", attributes, TreeSchema("y"), nodes)));
}

/// A node; `inside` begins with its predicate.
inline std::string Node(const std::string& attributes, const std::string& inside) {
  return "<Node " + attributes + ">" + inside + "</Node>";
}

inline std::string Simple(const std::string& field, const std::string& operator_text,
                          const std::string& value) {
  return "<SimplePredicate field='" + field + "' operator='" + operator_text + "' value='" + value + "'/>";
}

inline std::string AtMost(const std::string& field, const std::string& value) {
  return Simple(field, "lessOrEqual", value);
}

inline std::string Above(const std::string& field, const std::string& value) {
  return Simple(field, "greaterThan", value);
}

inline std::string Is(const std::string& field, const std::string& value) {
  return Simple(field, "equal", value);
}

inline std::string Compound(const std::string& boolean_operator, const std::string& parts) {
  return "<CompoundPredicate booleanOperator='" + boolean_operator + "'>" + parts + "</CompoundPredicate>";
}

/// One entry of a ScoreDistribution; `attributes` beside value and recordCount.
inline std::string Count(const std::string& value, const std::string& count,
                         const std::string& attributes = std::string()) {
  return "<ScoreDistribution value='" + value + "' recordCount='" + count + "' " + attributes + "/>";
}

/// Numbers for the categories red, green and blue.
inline std::string Counts(const std::string& red, const std::string& green, const std::string& blue) {
  return Count("red", red) + Count("green", green) + Count("blue", blue);
}

/// A number as the shortest text that reads as the same.
inline std::string NumberText(double number) {
  char text[32];
  return std::string(text, std::to_chars(std::begin(text), std::end(text), number).ptr);
}

/// The prediction, its probability in a classification, and the deciding node, such as "red 0.5 n1"; "-"
/// where there is none.
inline std::string ShowResult(MCKestrel_800::ScoreResult& result) {
  const MCKestrel_800::ScoreValue* prediction = result.GetPrediction();
  const std::string& id = MCKestrel_800::ResultEntities::Of(&result)->GetDecidingId();
  if (prediction == nullptr) return id.empty() ? "-" : "- " + id;
  std::string text = prediction->GetType() == MCKestrel_800::ScoreValue::kNumeric
                         ? NumberText(prediction->GetDouble())
                         : prediction->GetString();
  if (result.GetResultKind() == 0) text += " " + NumberText(result.GetProbability());
  return text + " " + (id.empty() ? "-" : id);
}

/// The nodes on a result's path, each with a blank in front.
inline std::string ShowPath(MCKestrel_800::ScoreResult& result) {
  const MCKestrel_800::ResultEntities& entities = *MCKestrel_800::ResultEntities::Of(&result);
  std::string path;
  for (size_t i = 0; i < entities.GetPathLength(); ++i)
    path += " " + entities.GetPathId(i);
  return path;
}

/// The categories of a classification's result with their probabilities, such as " red=0.5 green=0.5".
inline std::string ShowCategories(const MCKestrel_800::ClsResult& result) {
  std::string text;
  for (size_t i = 0; i < result.GetCategoryCount(); ++i)
    text += " " + result.GetCategory(i)->GetString() + "=" + NumberText(result.GetProbability(i));
  return text;
}

using Case = std::vector<std::pair<std::string, Cell>>;

/// An empty result that wants to know the deciding node.
inline std::unique_ptr<MCKestrel_800::ScoreResult> MakeResultOf(const MCKestrel_800::ScoreModel& model) {
  std::unique_ptr<MCKestrel_800::ScoreResult> result(model.MakeResult());
  MCKestrel_800::ResultEntities::Of(result.get())->SetDecidingIdWanted(true);
  return result;
}

/// Scores a case; the status's code stands for a result when it is no OK.
inline std::string ScoreOf(MCKestrel_800::ScoreModel& model, const Case& cells) {
  const auto result = MakeResultOf(model);
  const MCKestrel_800::CaseRecord record = RecordOf(cells);
  const MCScore::MCStatus status = model.Score(&record, result.get());
  EXPECT_EQ(status.IsOK(), result->GetPrediction() != nullptr);
  return status.IsOK() ? ShowResult(*result) : std::to_string(status.GetErrorCode());
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_PLUGINS_TREETEXT_H
