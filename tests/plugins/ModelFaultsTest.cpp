// What is said about the faults that documents of regression models have most: code, full text and line.

#include <gtest/gtest.h>

#include <string>

#include "tests/plugins/BrokenModel.h"

namespace kestrel_tests {
namespace {

constexpr char kUnsupportedModel[] = "Unsupported Model found!";

struct FaultRow {
  const char* why;
  const char* path;
  const char* what;  ///< the text of the document that is replaced where it first stands
  const char* with;
  int code;
  const char* text;
  unsigned line;  ///< where the start tag of the element at fault ends
};

constexpr FaultRow kFaults[] = {
    {"not well-formed: a tag without end", kOrders, "<Value value=\"no\"/>", "<Value value=\"no\"", 6,
     "Invalid XML file!!", 26},
    {"end tags that do not fit", kOrders, "</MiningSchema>", "</MiningShema>", 6, "Invalid XML file!!", 47},
    {"the document ends early", kOrders, "</PMML>\n", "", 6, "Invalid XML file!!", 62},
    {"an attribute twice", kOrders, "coefficient=\"3\"", "coefficient=\"3\" coefficient=\"4\"", 6,
     "Invalid XML file!!", 52},
    {"an entity that is not declared", kOrders, "value=\"Rome\"/>", "value=\"&rome;\"/>", 6,
     "Invalid XML file!!", 18},

    {"no number of fields", kOrders, " numberOfFields=\"7\"", "", 12,
     "Attribute \"numberOfFields\": Null string is an invalid integer string!", 4},
    {"another number of fields", kOrders, "numberOfFields=\"7\"", "numberOfFields=\"8\"", 12,
     "Number of Variables in the Dictionary does not match with numberOfFields!", 4},
    {"a number of fields that is none", kOrders, "numberOfFields=\"7\"", "numberOfFields=\"7.0\"", 3,
     "7.0Invalid integer string -- ", 4},
    {"a field twice", kOrders, "name=\"income\" optype", "name=\"age\" optype", 8,
     "age: Invalid Variable Name -- alreay in the dictionary", 10},
    {"a field without name", kOrders, "name=\"town\" optype", "optype", 4,
     "Attribute name is missing from Node \"DataField\"", 15},
    {"a field with an empty name", kOrders, "name=\"town\" optype", "name=\"\" optype", 1,
     "<DataField>'s name can't be null string !!", 15},
    {"no optype", kOrders, "optype=\"ordinal\" ", "", 11, "opType can't be null!!", 28},
    {"an unknown optype", kOrders, "optype=\"ordinal\"", "optype=\"scale\"", 11,
     "scale: Invalid Variable Type", 28},
    {"a continuous text", kOrders, "continuous\" dataType=\"double\"", "continuous\" dataType=\"string\"", 11,
     "string variable can't be continuous!!", 10},
    {"a property that there is not", kOrders, "property=\"missing\"", "property=\"absent\"", 6,
     "InValid property value!", 8},
    {"a value without value", kOrders, "<Value value=\"2\"/>", "<Value/>", 4,
     "Attribute value is missing from Node \"Value\"", 30},
    {"a category that is no number", kOrders, "<Value value=\"2\"/>", "<Value value=\"two\"/>", 7,
     "two: invalid value!", 30},
    {"a category twice", kOrders, "<Value value=\"2\"/>", "<Value value=\"1\"/>", 1,
     "\"1\": Duplicated Category Value!", 30},
    {"a category both valid and missing", kOrders, "value=\"?\"", "value=\"Rome\"", 1,
     "\"Rome\": defined as both Valid and Invalid value!", 15},
    {"a flag with one category", kOrders, "      <Value value=\"yes\"/>\n", "", 12,
     "Flag variable has to have two categories!", 22},
    {"a margin that is no number", kOrders, "leftMargin=\"0\"", "leftMargin=\"0 years\"", 3,
     "0 yearsInvalid double string -- ", 7},
    {"two intervals", kOrders, "<Value value=\"999\" property=\"missing\"/>",
     "<Interval closure=\"openOpen\"/>", 5, "Only One InterVal Element allowed here!", 8},
    {"two invalid ranges", kOrders, "name=\"decimals\"", "name=\"invalidRangeUpper\"", 5,
     "Only one \"invalidRangeLower\" or \"invalidRangeUpper\" is allowed!", 10},
    {"an element that no field has", kOrders, "<Value value=\"Oslo\" property=\"valid\"/>",
     "<Wert value=\"Oslo\"/>", 1, "Wert: Invalid element!", 19},

    {"another function", kOrders, "functionName=\"regression\"", "functionName=\"clustering\"", 5,
     "functionName -- clustering: Not supported!", 37},
    {"no function", kOrders, "functionName=\"regression\" ", "", 4,
     "Attribute functionName is missing from Node \"RegressionModel\"", 37},
    {"an unknown normalization", kOrders, "normalizationMethod=\"none\"", "normalizationMethod=\"sigmoid\"",
     6, "invalid normalizationMethod -- sigmoid", 37},
    {"an empty normalization", kOrders, "normalizationMethod=\"none\"", "normalizationMethod=\"\"", 6,
     "invalid normalizationMethod -- ", 37},
    {"shares in a regression", kOrders, "normalizationMethod=\"none\"", "normalizationMethod=\"simplemax\"",
     5, "simplemax normalization: Not supported for regression!", 37},
    {"not to be scored", kOrders, "isScorable=\"true\"", "isScorable=\"false\"", 5,
     "RegressionModel is marked as not scorable!", 37},

    {"a mining field that is no field", kOrders, "<MiningField name=\"since\"", "<MiningField name=\"Since\"",
     8, "Variable Since not in the dictionary!", 45},
    {"a mining field twice", kOrders, "<MiningField name=\"since\"", "<MiningField name=\"age\"", 1,
     "age: Duplicated MiningField!", 45},
    {"another element among mining fields", kOrders, "<MiningField name=\"since\" importance=\"0.1\"/>",
     "<Since/>", 1, "<MiningField> or <Extension> is required here!!", 45},
    {"an unknown usage", kOrders, "usageType=\"active\"", "usageType=\"input\"", 6,
     "income: invalid usageType -- input", 41},
    {"a margin of outliers with a comma", kOrders, "highValue=\"1e6\"", "highValue=\"1,5\"", 3,
     "income: invalid highValue -- 1,5", 41},
    {"margins of outliers the wrong way", kOrders, "lowValue=\"18\"", "lowValue=\"180\"", 6,
     "age: lowValue is above highValue", 40},
    {"a replacement that is no number", kOrders, "missingValueReplacement=\"40\"",
     "missingValueReplacement=\"many\"", 7, "age: invalid missingValueReplacement -- many", 40},
    {"a replacement that is required", kOrders, " invalidValueReplacement=\"no\"", "", 6,
     "member: invalidValueReplacement is required", 43},

    {"an intercept with a comma", kOrders, "intercept=\"12.5\"", "intercept=\"12,5\"", 3,
     "12,5Invalid double string -- ", 48},
    {"a predictor that is no field", kOrders, "<NumericPredictor name=\"age\"",
     "<NumericPredictor name=\"Age\"", 8, "Variable Age not among the active fields of the MiningSchema!",
     49},
    {"a predictor that is not active", kOrders, "usageType=\"active\"", "usageType=\"supplementary\"", 8,
     "Variable income not among the active fields of the MiningSchema!", 50},
    {"a predictor without name", kOrders, "<NumericPredictor name=\"income\"", "<NumericPredictor", 4,
     "Attribute name is missing from Node \"NumericPredictor\"", 50},
    {"a predictor with an empty name", kOrders, "<NumericPredictor name=\"income\"",
     "<NumericPredictor name=\"\"", 1, "<NumericPredictor>'s name can't be null string !!", 50},
    {"a text as a number", kOrders, "<NumericPredictor name=\"income\"", "<NumericPredictor name=\"town\"",
     11, "town: Invalid Variable Type", 50},
    {"a coefficient that is no number", kOrders, "coefficient=\"1.5e-3\"", "coefficient=\"small\"", 3,
     "smallInvalid double string -- ", 50},
    {"an empty coefficient", kOrders, "coefficient=\"1.5e-3\"", "coefficient=\"\"", 3,
     "Invalid double string -- ", 50},
    {"no coefficient", kOrders, " coefficient=\"1.5e-3\"", "", 4,
     "Attribute coefficient is missing from Node \"NumericPredictor\"", 50},
    {"an exponent with a comma", kOrders, "exponent=\"2\"", "exponent=\"2,0\"", 3,
     "2,0Invalid double string -- ", 49},
    {"a category of no field", kOrders, "value=\"Oslo\" coefficient", "value=\"Bern\" coefficient", 7,
     "town: invalid value!", 53},
    {"no category", kOrders, "value=\"Oslo\" coefficient", "coefficient", 4,
     "Attribute value is missing from Node \"CategoricalPredictor\"", 53},
    {"a factor that is no field", kOrders, "<FieldRef field=\"age\"", "<FieldRef field=\"edad\"", 8,
     "Variable edad not among the active fields of the MiningSchema!", 57},
    {"a product of nothing", kOrders,
     "<FieldRef field=\"age\"/>\n        <FieldRef field=\"income\" mapMissingTo=\"0\"/>", "", 1,
     "<FieldRef> is required in <PredictorTerm>!!", 56},
    {"another element in a product", kOrders, "<FieldRef field=\"age\"", "<Constant field=\"age\"", 1,
     "Constant: Invalid element!", 57},
    {"another element in a table", kOrders, "<CategoricalPredictor name=\"rating\" ",
     "<Predictor name=\"rating\" ", 1, "Predictor: Invalid element!", 55},
    {"two tables", kOrders, "    </RegressionTable>", "    </RegressionTable>\n<RegressionTable/>", 1,
     "Only one RegressionTable is allowed for regression!", 61},

    {"a category of no target", kTitanic, "targetCategory=\"Yes\"", "targetCategory=\"yes\"", 7,
     "Survived: invalid value!", 31},
    {"no target category", kTitanic, " targetCategory=\"Yes\"", "", 4,
     "Attribute targetCategory is missing from Node \"RegressionTable\"", 31},
    {"a target category twice", kTitanic, "targetCategory=\"No\"", "targetCategory=\"Yes\"", 1,
     "\"Yes\": Duplicated Category Value!", 24},
    {"a text as the target of a regression", kTitanic, "functionName=\"classification\"",
     "functionName=\"regression\"", 11, "Survived: Invalid Variable Type", 24},
    {"a category without table", kIris, "<Value value=\"virginica\"/>",
     "<Value value=\"virginica\"/><Value value=\"pumila\"/>", 1,
     "\"pumila\": RegressionTable is required for each category!", 15},
    {"an ordinal category without table", kHousing, "<Value value=\"Medium\"/>",
     "<Value value=\"Medium\"/><Value value=\"So so\"/>", 1,
     "\"So so\": RegressionTable is required for each category!", 26},
};

TEST(BrokenModel, FaultsHaveTheirCodeTextAndLine) {
  for (const FaultRow& row : kFaults) {
    const std::string document = Replaced(DocumentText(row.path), row.what, row.with);
    const Outcome outcome = LoadAndScore(document, {}, row.why);
    EXPECT_EQ(outcome.code, row.code) << row.why;
    EXPECT_EQ(outcome.text, row.text) << row.why;
    EXPECT_EQ(outcome.line, row.line) << row.why << ", column " << outcome.column;
    EXPECT_GT(outcome.column, 0u) << row.why;
  }
}

/// The document without what stands from `first` up to `last`; `with` takes its place.
std::string Cut(const std::string& text, const std::string& first, const std::string& last,
                const std::string& with) {
  const size_t from = text.find(first);
  const size_t to = text.find(last, from);
  EXPECT_TRUE(from != std::string::npos && to != std::string::npos) << first << " ... " << last;
  return to == std::string::npos ? text : text.substr(0, from) + with + text.substr(to);
}

struct CutRow {
  const char* why;
  const char* first;
  const char* last;
  const char* with;
  int code;
  const char* text;
  unsigned line;
};

constexpr CutRow kCuts[] = {
    // Nothing in the document stands where the dictionary should: the fault is the root's.
    {"no dictionary", "  <DataDictionary", "  <RegressionModel", "", 1, "<DataDictionary is required !!", 2},
    {"an empty dictionary", "    <DataField", "  </DataDictionary", "", 1, "<DataDictionary is EMPTY!!", 4},
    {"the dictionary inside another element", "  <DataDictionary", "  <RegressionModel",
     "<Box><DataDictionary numberOfFields=\"1\"><DataField name=\"x\" "
     "optype=\"continuous\"/></DataDictionary></Box>",
     1, "<DataDictionary is required !!", 2},
    {"no mining schema", "    <MiningSchema>", "    <RegressionTable", "", 4,
     "Node is missing --- MiningSchema ---", 37},
    {"an empty mining schema", "      <MiningField", "    </MiningSchema>", "", 1,
     "<MiningSchema> is EMPTY!!", 38},
    {"no table", "    <RegressionTable", "  </RegressionModel>", "", 4,
     "Node is missing --- RegressionTable ---", 37},
    {"no model", "  <RegressionModel", "</PMML>", "", 5, kUnsupportedModel, 2},
    {"a model of another kind", "  <RegressionModel", "</PMML>", "<TreeModel/>", 5, kUnsupportedModel, 2},
    {"the model inside another element", "  <RegressionModel", "</PMML>",
     "<MiningModel><RegressionModel/></MiningModel>", 4, "Node is missing --- RegressionModel ---", 2},
    {"a model alone", "  <RegressionModel", "</PMML>", "<RegressionModel/>", 4,
     "Attribute functionName is missing from Node \"RegressionModel\"", 36},
    {"a target that is not in the dictionary", " targetFieldName=\"amount\"",
     "\n      <MiningField name=\"age\"", " targetFieldName=\"sum\">\n    <MiningSchema>", 0, "2132", 0},
    {"several targets", "importance=\"0.1\"", "/>\n      <MiningField name=\"amount\"",
     "usageType=\"target\"", 8, "Variable since not among the active fields of the MiningSchema!", 51},
    {"an end tag alone", "<?xml", "</PMML>", "", 4,
     "\nInvalid XML document or no dtd file avaible in current directory", 1},
    {"a root of another kind", "<PMML", "</PMML>", "<Pmml/>", 6, "Invalid XML file!!", 2},
};

TEST(BrokenModel, LacksOfWholeElementsHaveTheirCodeTextAndLine) {
  const Sample orders = Samples().front();
  for (const CutRow& row : kCuts) {
    const std::string document = Cut(DocumentText(kOrders), row.first, row.last, row.with);
    const Outcome outcome = LoadAndScore(document, orders.cells, row.why);
    EXPECT_EQ(outcome.code, row.code) << row.why;
    EXPECT_EQ(outcome.text, row.text) << row.why;
    EXPECT_EQ(outcome.line, row.line) << row.why << ", column " << outcome.column;
  }
}

TEST(BrokenModel, ColumnIsBehindTheStartTag) {
  const std::string document = Replaced(DocumentText(kOrders), "coefficient=\"1.5e-3\"", "coefficient=\"\"");
  const Outcome outcome = LoadAndScore(document, {}, "");
  EXPECT_EQ(outcome.line, 50u);
  EXPECT_EQ(outcome.column,
            std::string("      <NumericPredictor name=\"income\" coefficient=\"\"/>").size() + 1);
}

}  // namespace
}  // namespace kestrel_tests
