// What is said of documents of rule sets that cannot be read: code, full text and place.

#include <gtest/gtest.h>

#include <string>

#include "tests/plugins/RuleSetText.h"
#include "tests/support/ExpectFault.h"

namespace {

using namespace MCKestrel_800;
using namespace kestrel_tests;

struct RuleRow {
  const char* why;
  std::string rules;
  int code;
  const char* message;
};

const RuleRow kRules[] = {
    {"no score", Rule("id='r1'"), 4, "Attribute score is missing from Node \"SimpleRule\""},
    {"a score that the target does not list", Rule("score='maybe'"), 7, "k: invalid value!"},
    {"an empty score", Rule("score=''"), 7, "k: invalid value!"},
    {"a weight that is no number", Rule("score='yes' weight='1,5'"), 3, "1,5Invalid double string -- "},
    {"an infinite weight", Rule("score='yes' weight='1e999'"), 6, "invalid weight -- 1e999"},
    {"a weight that means missing", Rule("score='yes' weight='-1.7976931348623157e308'"), 6,
     "invalid weight -- -1.7976931348623157e308"},
    {"a confidence that is no number", Rule("score='yes' confidence='high'"), 3,
     "highInvalid double string -- "},
    {"an infinite confidence", Rule("score='yes' confidence='-1e999'"), 6, "invalid confidence -- -1e999"},
    {"a count that is no number", Rule("score='yes' recordCount='many'"), 3, "manyInvalid double string -- "},
    {"a count of correct cases that is no number", Rule("score='yes' nbCorrect='all'"), 3,
     "allInvalid double string -- "},

    {"a rule without predicate", "<SimpleRule score='yes'/>", 4, "<SimpleRule> has no predicate!"},
    {"a compound without predicate", "<CompoundRule>" + Rule("score='yes'") + "</CompoundRule>", 4,
     "<CompoundRule> has no predicate!"},
    {"two predicates", "<SimpleRule score='yes'><True/><True/></SimpleRule>", 1,
     "<SimpleRule> has more than one predicate!"},
    {"a compound with two predicates", "<CompoundRule><True/><False/></CompoundRule>", 1,
     "<CompoundRule> has more than one predicate!"},
    {"a rule in a rule", "<SimpleRule score='yes'><True/>" + Rule("score='no'") + "</SimpleRule>", 1,
     "SimpleRule: Invalid element!"},
    {"another element in a rule", "<SimpleRule score='yes'><True/><Node/></SimpleRule>", 1,
     "Node: Invalid element!"},
    {"another element in a compound", "<CompoundRule><True/><Rule/></CompoundRule>", 1,
     "Rule: Invalid element!"},
    {"a distribution in a compound",
     "<CompoundRule><True/><ScoreDistribution value='yes' recordCount='1'/></CompoundRule>", 1,
     "ScoreDistribution: Invalid element!"},
    {"a selection method in a compound",
     "<CompoundRule><True/><RuleSelectionMethod criterion='firstHit'/></CompoundRule>", 1,
     "RuleSelectionMethod: Invalid element!"},
    {"another element among the rules", "<Node/>", 1, "Node: Invalid element!"},
    {"a predicate among the rules", "<True/>", 1, "True: Invalid element!"},

    {"a predicate of an unknown field",
     If("<SimplePredicate field='w' operator='equal' value='1'/>", "score='yes'"), 8,
     "w: Invalid Split Variable!"},
    {"a predicate of a field that is not active",
     If("<SimplePredicate field='y' operator='equal' value='1'/>", "score='yes'"), 8,
     "Variable y not among the active fields of the MiningSchema!"},
    {"a predicate of the target",
     If("<SimplePredicate field='k' operator='equal' value='yes'/>", "score='yes'"), 8,
     "Variable k not among the active fields of the MiningSchema!"},
    {"one deep inside",
     If("<CompoundPredicate booleanOperator='or'>" + kXAbove1 +
            "<SimplePredicate field='k' operator='equal' value='yes'/></CompoundPredicate>",
        "score='yes'"),
     8, "Variable k not among the active fields of the MiningSchema!"},
    {"a fault in a predicate",
     If("<CompoundPredicate booleanOperator='nor'>" + kXAbove1 + "</CompoundPredicate>", "score='yes'"), 11,
     "nor: Invalid Boolean Operator for the Compound Predicate"},

    {"a distribution of a score that there is not",
     "<SimpleRule score='yes'><True/><ScoreDistribution value='maybe' recordCount='1'/></SimpleRule>", 7,
     "k: invalid value!"},
    {"a distribution with a score twice",
     "<SimpleRule score='yes'><True/><ScoreDistribution value='no' recordCount='1'/><ScoreDistribution "
     "value='yes' recordCount='1'/><ScoreDistribution value='no' recordCount='1'/></SimpleRule>",
     1, "\"no\": Duplicated Category Value!"},
    {"the rule set's distribution with a score twice",
     "<ScoreDistribution value='no' recordCount='1'/><ScoreDistribution value='no' recordCount='1'/>", 1,
     "\"no\": Duplicated Category Value!"},
    {"a distribution without value",
     "<SimpleRule score='yes'><True/><ScoreDistribution recordCount='1'/></SimpleRule>", 4,
     "Attribute value is missing from Node \"ScoreDistribution\""},
};

TEST(RuleSetRefusals, Rules) {
  for (const RuleRow& row : kRules) {
    ExpectFault([&] { BuildRuleSet(RuleSetDocument("firstHit", "k", "", row.rules)); }, row.code, row.message,
                row.why);
  }
}

struct NumberRow {
  const char* why;
  const char* attributes;
  std::string rules;
  int code;
  const char* message;
};

const NumberRow kNumbers[] = {
    {"a score that is no number", "", Rule("score='yes'"), 3, "yesInvalid double string -- "},
    {"an empty score", "", Rule("score=''"), 3, "Invalid double string -- "},
    {"an infinite score", "", Rule("score='1e999'"), 6, "invalid score -- 1e999"},
    {"a score that means missing", "", Rule("score='-1.7976931348623157e308'"), 6,
     "invalid score -- -1.7976931348623157e308"},
    {"a default that is no number", "defaultScore='none'", "", 3, "noneInvalid double string -- "},
};

TEST(RuleSetRefusals, ScoresOfRegressions) {
  for (const NumberRow& row : kNumbers) {
    ExpectFault([&] { BuildRegression("firstHit", row.attributes, row.rules); }, row.code, row.message,
                row.why);
  }
}

const std::string kFirstHit = RuleSetOf("firstHit", "", "");

struct ModelRow {
  const char* why;
  std::string model;
  int code;
  const char* message;
};

std::string Classification(const std::string& rule_set) {
  return RuleSetModelOf("functionName='classification'", "k", rule_set);
}

const ModelRow kModels[] = {
    {"no function", RuleSetModelOf("", "k", kFirstHit), 4,
     "Attribute functionName is missing from Node \"RuleSetModel\""},
    {"another function", RuleSetModelOf("functionName='clustering'", "k", kFirstHit), 5,
     "functionName -- clustering: Not supported!"},
    {"not scorable", RuleSetModelOf("functionName='classification' isScorable='false'", "k", kFirstHit), 5,
     "RuleSetModel is marked as not scorable!"},
    {"no schema", "<RuleSetModel functionName='classification'>" + kFirstHit + "</RuleSetModel>", 4,
     "Node is missing --- MiningSchema ---"},
    {"a fault of the schema",
     "<RuleSetModel functionName='classification'><MiningSchema/>" + kFirstHit + "</RuleSetModel>", 1,
     "<MiningSchema> is EMPTY!!"},
    {"no rule set", Classification(""), 4, "Node is missing --- RuleSet ---"},
    {"no selection method", Classification("<RuleSet/>"), 4, "Node is missing --- RuleSelectionMethod ---"},
    {"a selection method without criterion", Classification("<RuleSet><RuleSelectionMethod/></RuleSet>"), 4,
     "Attribute criterion is missing from Node \"RuleSelectionMethod\""},
    {"an unknown criterion", Classification(RuleSetOf("lastHit", "", "")), 6, "invalid criterion -- lastHit"},
    {"a criterion in other letters", Classification(RuleSetOf("firsthit", "", "")), 6,
     "invalid criterion -- firsthit"},
    {"a default score that the target does not list",
     Classification(RuleSetOf("firstHit", "defaultScore='maybe'", "")), 7, "k: invalid value!"},
    {"a default confidence that is no number",
     Classification(RuleSetOf("firstHit", "defaultConfidence='low'", "")), 3, "lowInvalid double string -- "},
    {"an infinite default confidence", Classification(RuleSetOf("firstHit", "defaultConfidence='1e999'", "")),
     6, "invalid defaultConfidence -- 1e999"},
    {"a count that is no number", Classification(RuleSetOf("firstHit", "recordCount='-'", "")), 3,
     "-Invalid double string -- "},
    {"a count of correct cases that is no number", Classification(RuleSetOf("firstHit", "nbCorrect='-'", "")),
     3, "-Invalid double string -- "},
    {"a regression of a text", RuleSetModelOf("functionName='regression'", "k", kFirstHit), 11,
     "k: Invalid Variable Type"},
    {"two targets",
     "<RuleSetModel functionName='classification'><MiningSchema><MiningField name='k' usageType='target'/>"
     "<MiningField name='m' usageType='predicted'/></MiningSchema>" +
         kFirstHit + "</RuleSetModel>",
     1, "RuleSetModel has more than one target!"},
};

TEST(RuleSetRefusals, Models) {
  for (const ModelRow& row : kModels) {
    ExpectFault([&] { BuildRuleSet(DocumentOf(row.model)); }, row.code, row.message, row.why);
  }
}

TEST(RuleSetRefusals, Documents) {
  const std::string model = Classification(kFirstHit);
  const std::string dictionary = kestrel_test::DictionaryOf(9, TestFields());
  ExpectFault([&] { BuildRuleSet("<PMML>" + model + "</PMML>"); }, 1, "<DataDictionary is required !!");
  ExpectFault([&] { BuildRuleSet("<PMML>" + dictionary + "</PMML>"); }, 4,
              "Node is missing --- RuleSetModel ---");
  RuleSetTranslator translator;
  const auto tree = kestrel_test::ReadTree(model);
  ExpectFault([&] { translator.ParseFromTree(tree->GetRoot(), nullptr, nullptr, std::string()); }, 1,
              "<DataDictionary is required !!");
}

struct PlaceRow {
  const char* why;
  std::string rules;  ///< begins in line 1; the model's dictionary and schema stand there, too
  unsigned line;
};

const PlaceRow kPlaces[] = {
    {"a rule", "\n\n" + Rule("score='maybe'"), 3},
    {"a nested rule", "\n<CompoundRule>\n<True/>\n" + Rule("score='yes' weight='x'") + "</CompoundRule>", 4},
    {"a predicate",
     "\n<SimpleRule score='yes'>\n<SimplePredicate field='k' operator='equal' value='yes'/>"
     "</SimpleRule>",
     3},
    {"an element that does not belong there", "\n<SimpleRule score='yes'>\n<True/>\n<Node/></SimpleRule>", 4},
    {"a distribution",
     "\n<SimpleRule score='yes'><True/>\n<ScoreDistribution value='no' recordCount='1'/>\n"
     "<ScoreDistribution value='no' recordCount='1'/></SimpleRule>",
     4},
    {"a distribution of another score",
     "\n<SimpleRule score='yes'><True/>\n<ScoreDistribution value='maybe' recordCount='1'/></SimpleRule>", 3},
};

TEST(RuleSetRefusals, HaveAPlace) {
  for (const PlaceRow& row : kPlaces) {
    try {
      BuildRuleSet(RuleSetDocument("firstHit", "k", "", row.rules));
      ADD_FAILURE() << row.why;
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetLine(), row.line) << row.why << ": " << fault.GetErrorMessage();
      EXPECT_GT(fault.GetColumn(), 0u) << row.why;
    }
  }
}

}  // namespace
