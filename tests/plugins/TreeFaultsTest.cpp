// What is said of documents of trees that cannot be read: code, full text and line.

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "tests/plugins/TreeBroken.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

struct FaultRow {
  const char* why;
  const char* what;  ///< the text of the document that is replaced where it first stands
  const char* with;
  int code;
  const char* text;
  unsigned line;  ///< where the start tag of the element at fault ends
};

constexpr FaultRow kFaults[] = {
    // The model element.
    {"another function", "functionName=\"classification\"", "functionName=\"clustering\"", 5,
     "functionName -- clustering: Not supported!", 28},
    {"no function", "functionName=\"classification\" ", "", 4,
     "Attribute functionName is missing from Node \"TreeModel\"", 28},
    {"a regression of a text", "functionName=\"classification\"", "functionName=\"regression\"", 11,
     "risk: Invalid Variable Type", 28},
    {"not to be scored", "isScorable=\"true\"", "isScorable=\"false\"", 5,
     "TreeModel is marked as not scorable!", 28},
    {"an unknown strategy for missing values", "missingValueStrategy=\"defaultChild\"",
     "missingValueStrategy=\"useDefault\"", 6, "invalid missingValueStrategy -- useDefault", 28},
    {"an empty one", "missingValueStrategy=\"defaultChild\"", "missingValueStrategy=\"\"", 6,
     "invalid missingValueStrategy -- ", 28},
    {"letters of another case", "missingValueStrategy=\"defaultChild\"",
     "missingValueStrategy=\"DefaultChild\"", 6, "invalid missingValueStrategy -- DefaultChild", 28},
    {"an unknown strategy for no true child", "noTrueChildStrategy=\"returnLastPrediction\"",
     "noTrueChildStrategy=\"lastPrediction\"", 6, "invalid noTrueChildStrategy -- lastPrediction", 28},
    {"an unknown characteristic", "splitCharacteristic=\"multiSplit\"", "splitCharacteristic=\"binary\"", 6,
     "invalid splitCharacteristic -- binary", 28},
    {"a penalty that is no number", "missingValuePenalty=\"0.75\"", "missingValuePenalty=\"0,75\"", 3,
     "0,75Invalid double string -- ", 28},
    {"a penalty above 1", "missingValuePenalty=\"0.75\"", "missingValuePenalty=\"1.5\"", 6,
     "invalid missingValuePenalty -- 1.5", 28},
    {"a negative penalty", "missingValuePenalty=\"0.75\"", "missingValuePenalty=\"-0.1\"", 6,
     "invalid missingValuePenalty -- -0.1", 28},
    {"an infinite penalty", "missingValuePenalty=\"0.75\"", "missingValuePenalty=\"1e999\"", 6,
     "invalid missingValuePenalty -- 1e999", 28},

    // Nodes and what is in them.
    {"a node without predicate", "<True/>", "", 4, "<Node> has no predicate!", 37},
    {"a node with two", "<True/>", "<True/>\n<False/>", 1, "<Node> has more than one predicate!", 40},
    {"an embedded regression", "<Partition name=\"abroad\"/>", "<Regression/>", 5,
     "Regression in <Node>: Not supported!", 60},
    {"an embedded tree", "<Partition name=\"abroad\"/>", "<DecisionTree/>", 5,
     "DecisionTree in <Node>: Not supported!", 60},
    {"another element", "<Partition name=\"abroad\"/>", "<Value name=\"abroad\"/>", 1,
     "Value: Invalid element!", 60},
    {"a prefix makes another element", "<False/>", "<p:False xmlns:p=\"u\"/>", 1, "p:False: Invalid element!",
     82},
    {"a record count that is no number", "recordCount=\"30\"", "recordCount=\"many\"", 3,
     "manyInvalid double string -- ", 43},
    {"a negative record count", "recordCount=\"30\"", "recordCount=\"-1\"", 6, "invalid recordCount -- -1",
     43},
    {"an infinite record count", "recordCount=\"30\"", "recordCount=\"1e999\"", 6,
     "invalid recordCount -- 1e999", 43},
    {"a leaf without score", "<Node id=\"abroad\" score=\"middle\"", "<Node id=\"abroad\"", 4,
     "<Node> without children has no score!", 58},
    {"a score that is no category", "<Node id=\"abroad\" score=\"middle\"",
     "<Node id=\"abroad\" score=\"none\"", 7, "risk: invalid value!", 58},
    {"an empty score", "<Node id=\"abroad\" score=\"middle\"", "<Node id=\"abroad\" score=\"\"", 7,
     "risk: invalid value!", 58},
    {"no default child", "id=\"rich\" recordCount=\"30\" defaultChild=\"abroad\"",
     "id=\"rich\" recordCount=\"30\"", 4, "defaultChild is required for missingValueStrategy defaultChild!",
     43},
    {"an empty default child", "defaultChild=\"abroad\"", "defaultChild=\"\"", 4,
     "defaultChild is required for missingValueStrategy defaultChild!", 43},
    {"a default child that is none", "defaultChild=\"abroad\"", "defaultChild=\"away\"", 6,
     "invalid defaultChild -- away", 43},
    {"a default child two levels down", "defaultChild=\"poor\"", "defaultChild=\"home\"", 6,
     "invalid defaultChild -- home", 37},
    {"a node as its own default child", "defaultChild=\"abroad\"", "defaultChild=\"rich\"", 6,
     "invalid defaultChild -- rich", 43},
    {"no record count for a weight", "missingValueStrategy=\"defaultChild\"",
     "missingValueStrategy=\"weightedConfidence\"", 4,
     "recordCount is required for missingValueStrategy weightedConfidence!", 71},
    {"no distribution of a leaf to add up", "missingValueStrategy=\"defaultChild\"",
     "missingValueStrategy=\"aggregateNodes\"", 4,
     "ScoreDistribution is required for missingValueStrategy aggregateNodes!", 58},

    // Distributions.
    {"a category that is none", "value=\"low\" recordCount=\"15\"", "value=\"none\" recordCount=\"15\"", 7,
     "risk: invalid value!", 55},
    {"a category twice", "value=\"high\" recordCount=\"5\"", "value=\"low\" recordCount=\"5\"", 1,
     "\"low\": Duplicated Category Value!", 56},
    {"a category twice, once with a blank", "value=\"high\" recordCount=\"5\"",
     "value=\"low \" recordCount=\"5\"", 1, "\"low \": Duplicated Category Value!", 56},
    {"an entry without value", "value=\"low\" recordCount=\"15\"", "recordCount=\"15\"", 4,
     "Attribute value is missing from Node \"ScoreDistribution\"", 55},
    {"an entry without count", "value=\"low\" recordCount=\"15\"", "value=\"low\"", 4,
     "Attribute recordCount is missing from Node \"ScoreDistribution\"", 55},
    {"a negative count", "recordCount=\"15\"", "recordCount=\"-15\"", 6,
     "ScoreDistribution: invalid recordCount -- -15", 55},
    {"a confidence above 1", "confidence=\"0.5\"", "confidence=\"50\"", 6,
     "ScoreDistribution: invalid confidence -- 50", 41},

    // Predicates: where they stand in the tree is told, whatever they are nested in.
    {"a field that is none", "field=\"since\"", "field=\"Since\"", 8, "Since: Invalid Split Variable!", 72},
    {"the target as a field", "field=\"since\" operator=\"lessThan\" value=\"10000\"",
     "field=\"risk\" operator=\"equal\" value=\"low\"", 8,
     "Variable risk not among the active fields of the MiningSchema!", 72},
    {"a field that is not active", "usageType=\"active\"", "usageType=\"supplementary\"", 8,
     "Variable since not among the active fields of the MiningSchema!", 72},
    {"a field that is not active, inside a compound", "<MiningField name=\"income\"",
     "<MiningField usageType=\"group\" name=\"income\"", 8,
     "Variable income not among the active fields of the MiningSchema!", 44},
    {"a field that is not in the schema", "<MiningField name=\"since\" usageType=\"active\"/>", "", 8,
     "Variable since not among the active fields of the MiningSchema!", 72},
    {"an operator that is none", "operator=\"greaterOrEqual\"", "operator=\"atLeast\"", 5,
     "atLeast: Not supported!", 46},
    {"a bound that is no number", "value=\"5000\"", "value=\"5.000,00\"", 3,
     "5.000,00Invalid double string -- ", 45},
    {"an order of categories that have none", "operator=\"notEqual\"", "operator=\"lessThan\"", 9,
     "Invalid operator!!", 59},
    {"a set's value that is none", "Paris Rome", "Paris Bonn", 3, "In valid split value!", 53},
    {"a compound of no kind", "booleanOperator=\"and\"", "booleanOperator=\"not\"", 11,
     "not: Invalid Boolean Operator for the Compound Predicate", 66},
};

TEST(TreeFaults, HaveTheirCodeTextAndLine) {
  for (const FaultRow& row : kFaults) {
    const Outcome outcome = LoadTree(Replaced(TreeText(), row.what, row.with), row.why);
    EXPECT_EQ(outcome.code, row.code) << row.why;
    EXPECT_EQ(outcome.text, row.text) << row.why;
    EXPECT_EQ(outcome.line, row.line) << row.why << ", column " << outcome.column;
    EXPECT_GT(outcome.column, 0u) << row.why;
  }
}

struct CutRow {
  const char* why;
  const char* first;  ///< what stands from here ...
  const char* last;   ///< ... up to here is replaced
  const char* with;
  int code;
  const char* text;
  unsigned line;
};

constexpr CutRow kCuts[] = {
    {"no dictionary", "  <DataDictionary", "  <TreeModel", "", 1, "<DataDictionary is required !!", 2},
    {"no mining schema", "    <MiningSchema>", "    <Node", "", 4, "Node is missing --- MiningSchema ---",
     28},
    {"no nodes", "    <Node", "  </TreeModel>", "", 4, "Node is missing --- Node ---", 28},
    {"the model inside another element", "  <TreeModel", "</PMML>", "<MiningModel><TreeModel/></MiningModel>",
     4, "Node is missing --- TreeModel ---", 2},
    {"a leaf alone without score", "    <Node", "  </TreeModel>", "<Node><True/></Node>", 4,
     "<Node> without children has no score!", 37},
    {"a target that is not in the dictionary", "targetFieldName=", "    <Node",
     "targetFieldName=\"hazard\"><MiningSchema><MiningField name=\"age\"/></MiningSchema>\n", 8,
     "Variable hazard not in the dictionary!", 28},
    {"several targets without a choice", "targetFieldName=", "    <Node",
     "><MiningSchema><MiningField name=\"age\" usageType=\"target\"/><MiningField name=\"risk\" "
     "usageType=\"predicted\"/></MiningSchema>\n",
     1, "TreeModel has more than one target!", 28},
};

TEST(TreeFaults, LacksOfWholeElementsHaveThem) {
  for (const CutRow& row : kCuts) {
    const std::string text = TreeText();
    const size_t from = text.find(row.first);
    const size_t to = text.find(row.last, from);
    ASSERT_TRUE(from != std::string::npos && to != std::string::npos) << row.why;
    const Outcome outcome = LoadTree(text.substr(0, from) + row.with + text.substr(to), row.why);
    EXPECT_EQ(outcome.code, row.code) << row.why;
    EXPECT_EQ(outcome.text, row.text) << row.why;
    EXPECT_EQ(outcome.line, row.line) << row.why << ", column " << outcome.column;
  }
}

struct NumberRow {
  const char* why;
  const char* attributes;  ///< of the model
  const char* node;
  int code;
  const char* text;
};

// The leaf of a tree that predicts numbers.
constexpr NumberRow kNumbers[] = {
    {"no score", "", "", 4, "<Node> without children has no score!"},
    {"an empty score", "", "score=\"\"", 4, "<Node> without children has no score!"},
    {"the number that means missing", "", "score=\"-1.7976931348623157e308\"", 6,
     "invalid score -- -1.7976931348623157e308"},
    {"a score that is no number", "", "score=\"low\"", 3, "lowInvalid double string -- "},
    {"an infinite score", "", "score=\"-1e999\"", 6, "invalid score -- -1e999"},
    {"no record count for a weight", "missingValueStrategy=\"weightedConfidence\"", "score=\"1\"", 4,
     "recordCount is required for missingValueStrategy weightedConfidence!"},
    {"no record count for a mean", "missingValueStrategy=\"aggregateNodes\"", "score=\"1\"", 4,
     "recordCount is required for missingValueStrategy aggregateNodes!"},
};

TEST(TreeFaults, OfRegressionsHaveThem) {
  for (const NumberRow& row : kNumbers) {
    const std::string document =
        std::string(
            "<PMML><DataDictionary numberOfFields=\"1\"><DataField name=\"y\" optype=\"continuous\"/>"
            "</DataDictionary>\n<TreeModel functionName=\"regression\" ") +
        row.attributes + "><MiningSchema><MiningField name=\"y\" usageType=\"target\"/></MiningSchema>\n" +
        "<Node score=\"0\">\n<True/>\n<Node " + row.node + "><True/></Node></Node></TreeModel></PMML>";
    const Outcome outcome = LoadTree(document, row.why);
    EXPECT_EQ(outcome.code, row.code) << row.why;
    EXPECT_EQ(outcome.text, row.text) << row.why;
    EXPECT_EQ(outcome.line, 5u) << row.why;
  }
}

// Nothing is asked of a node that its strategy does not need.
TEST(TreeFaults, AttributesOfOtherStrategiesAreNotLookedAt) {
  for (const char* strategy : {"none", "lastPrediction", "nullPrediction"}) {
    std::string document = Replaced(TreeText(), "missingValueStrategy=\"defaultChild\"",
                                    std::string("missingValueStrategy=\"") + strategy + "\"");
    document = Replaced(document, "defaultChild=\"abroad\"", "defaultChild=\"no child's\"");
    const Outcome outcome = LoadTree(document, strategy);
    EXPECT_EQ(outcome.code, kLoaded) << strategy << ": " << outcome.text;
  }
}

}  // namespace
}  // namespace kestrel_tests
