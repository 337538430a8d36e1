// Which rule decides, and with which probabilities.

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "tests/plugins/RuleSetText.h"

namespace {

using namespace MCKestrel_800;
using namespace kestrel_tests;

using Cells = std::vector<std::pair<std::string, Cell>>;
constexpr double kSysmis = NumericValue::gSysmisValue;

struct ChoiceRow {
  const char* why;
  const char* criterion;
  const char* attributes;  ///< of the rule set
  std::string rules;
  Cells cells;
  const char* result;  ///< see ShowResult
  const char* path;    ///< see ShowPath
};

// The target m has the categories red, green and blue.
const ChoiceRow kChoices[] = {
    {"the first rule that fires",
     "firstHit",
     "",
     RuleAbove("5", "id='r1' score='red'") + RuleAbove("1", "id='r2' score='green' confidence='0.75'") +
         RuleAbove("0", "id='r3' score='blue' weight='9' confidence='0.5'"),
     {{"x", 2.0}},
     "green 0.75 r2",
     " r2 r3"},
    {"confidence and weight are 1 when absent",
     "firstHit",
     "",
     Rule("id='r1' score='red'"),
     {},
     "red 1 r1",
     " r1"},
    {"and when empty",
     "weightedSum",
     "",
     Rule("id='r1' score='red' weight='' confidence=''"),
     {},
     "red 1 r1",
     " r1"},
    {"rules without identifier are numbered among those that predict",
     "firstHit",
     "",
     If("<False/>", "id='r1' score='red'") + "<CompoundRule><True/>" + If("<False/>", "score='red'") +
         "</CompoundRule>" + Rule("score='blue'") + Rule("id='' score='green'"),
     {},
     "blue 1 #3",
     " #3 #4"},

    {"the highest weight",
     "weightedMax",
     "",
     Rule("id='r1' score='red' weight='0.5' confidence='0.25'") +
         Rule("id='r2' score='green' weight='2' confidence='0.5'") + Rule("id='r3' score='blue'"),
     {},
     "green 0.5 r2",
     " r1 r2 r3"},
    {"of equal weights the first",
     "weightedMax",
     "",
     Rule("id='r1' score='blue' weight='0.5'") + Rule("id='r2' score='green' weight='2' confidence='0.5'") +
         Rule("id='r3' score='red' weight='2'"),
     {},
     "green 0.5 r2",
     " r1 r2 r3"},
    {"the highest weight may be negative",
     "weightedMax",
     "",
     Rule("id='r1' score='blue' weight='-3'") + Rule("id='r2' score='green' weight='-2'"),
     {},
     "green 1 r2",
     " r1 r2"},
    {"a rule that does not fire has no weight",
     "weightedMax",
     "",
     RuleAbove("5", "id='r1' score='red' weight='9'") + Rule("id='r2' score='green' weight='-2'"),
     {{"x", 2.0}},
     "green 1 r2",
     " r2"},

    {"the highest sum of weights",
     "weightedSum",
     "",
     Rule("id='r1' score='red' weight='2' confidence='0.5'") +
         Rule("id='r2' score='green' weight='1.5' confidence='0.5'") +
         Rule("id='r3' score='green' weight='1.75' confidence='0.75'") + Rule("id='r4' score='blue'"),
     {},
     "green 0.3125 r3",
     " r1 r2 r3 r4"},
    {"of the winner's rules with equal weights the first",
     "weightedSum",
     "",
     Rule("id='r1' score='green' weight='1'") + Rule("id='r2' score='green' weight='1'"),
     {},
     "green 1 r1",
     " r1 r2"},
    {"equal sums: the target's list, not the document",
     "weightedSum",
     "",
     Rule("id='r1' score='blue' weight='2' confidence='0.5'") + Rule("id='r2' score='green' weight='1'") +
         Rule("id='r3' score='green' weight='1'"),
     {},
     "green 0.666667 r2",
     " r1 r2 r3"},
    {"all sums are negative",
     "weightedSum",
     "",
     Rule("id='r1' score='red' weight='-2'") + Rule("id='r2' score='blue' weight='-1'"),
     {},
     "blue 0.5 r2",
     " r1 r2"},
    {"weights of 0 win, too",
     "weightedSum",
     "",
     Rule("id='r1' score='blue' weight='0' confidence='0.5'"),
     {},
     "blue 0.5 r1",
     " r1"},
    {"a negative weight takes away",
     "weightedSum",
     "",
     Rule("id='r1' score='red' weight='2'") + Rule("id='r2' score='red' weight='-1.5'") +
         Rule("id='r3' score='blue' weight='1' confidence='0.75'"),
     {},
     "blue 0.25 r3",
     " r1 r2 r3"},

    {"no rule fires",
     "firstHit",
     "defaultScore='blue' defaultConfidence='0.25'",
     RuleAbove("5", "id='r1' score='red'"),
     {{"x", 2.0}},
     "blue 0.25 -",
     ""},
    {"a default without confidence",
     "weightedMax",
     "defaultScore='blue'",
     RuleAbove("5", "id='r1' score='red'"),
     {{"x", 2.0}},
     "blue 0 -",
     ""},
    {"no rule at all",
     "weightedSum",
     "defaultScore='blue' defaultConfidence='0.5'",
     "",
     {},
     "blue 0.5 -",
     ""},
    {"the default does not compete",
     "weightedSum",
     "defaultScore='red' defaultConfidence='0.25'",
     Rule("id='r1' score='blue' weight='-5' confidence='0.5'"),
     {},
     "blue 0.5 r1",
     " r1"},

    {"a missing value leaves a rule unknown, which does not fire",
     "firstHit",
     "",
     RuleAbove("1", "id='r1' score='red'") + Rule("id='r2' score='green'"),
     {{"x", kSysmis}},
     "green 1 r2",
     " r2"},
    {"a predicate may ask for missing values",
     "firstHit",
     "",
     If("<SimplePredicate field='x' operator='isMissing'/>", "id='r1' score='red'"),
     {{"x", {}}},
     "red 1 r1",
     " r1"},
    {"a surrogate's answer is an answer",
     "firstHit",
     "",
     If("<CompoundPredicate booleanOperator='surrogate'>" + kXAbove1 + kGIsA + "</CompoundPredicate>",
        "id='r1' score='red'"),
     {{"x", {}}, {"g", "a"}},
     "red 1 r1",
     " r1"},
    {"a surrogate's no is a no",
     "firstHit",
     "defaultScore='blue'",
     If("<CompoundPredicate booleanOperator='surrogate'>" + kXAbove1 + kGIsA + "</CompoundPredicate>",
        "id='r1' score='red'"),
     {{"x", {}}, {"g", "b"}},
     "blue 0 -",
     ""},
    {"a compound predicate of nothing is never decided",
     "firstHit",
     "",
     If("<CompoundPredicate booleanOperator='xor'/>", "id='r1' score='red'") + Rule("id='r2' score='green'"),
     {},
     "green 1 r2",
     " r2"},
    {"a set of codes",
     "firstHit",
     "",
     If("<SimpleSetPredicate field='n' booleanOperator='isIn'><Array type='int' n='2'>1 3</Array>"
        "</SimpleSetPredicate>",
        "id='r1' score='red'"),
     {{"n", 3.0}},
     "red 1 r1",
     " r1"},

    {"rules inside a compound that is true",
     "weightedSum",
     "",
     "<CompoundRule>" + kXAbove1 + Rule("id='r1' score='green'") + Rule("id='r2' score='green'") +
         "</CompoundRule>" + Rule("id='r3' score='blue' weight='1.5'"),
     {{"x", 2.0}},
     "green 0.666667 r1",
     " r1 r2 r3"},
    {"rules inside one that is not",
     "weightedSum",
     "",
     "<CompoundRule>" + kXAbove1 + Rule("id='r1' score='green'") + Rule("id='r2' score='green'") +
         "</CompoundRule>" + Rule("id='r3' score='blue' weight='1.5'"),
     {{"x", 1.0}},
     "blue 1 r3",
     " r3"},
    {"an unknown compound is not true",
     "firstHit",
     "",
     "<CompoundRule>" + kXAbove1 + Rule("id='r1' score='green'") + "</CompoundRule>" +
         Rule("id='r2' score='blue'"),
     {{"x", {}}},
     "blue 1 r2",
     " r2"},
    {"compounds in compounds",
     "firstHit",
     "",
     "<CompoundRule>" + kXAbove1 + "<CompoundRule>" + kGIsA + Rule("id='r1' score='red'") +
         "</CompoundRule><CompoundRule><True/><CompoundRule><False/>" + Rule("id='r2' score='red'") +
         "</CompoundRule>" + Rule("id='r3' score='green'") + "</CompoundRule>" +
         Rule("id='r4' score='blue'") + "</CompoundRule>" + Rule("id='r5' score='red'"),
     {{"x", 2.0}, {"g", "b"}},
     "green 1 r3",
     " r3 r4 r5"},
    {"a compound without rules",
     "firstHit",
     "",
     "<CompoundRule><True/></CompoundRule>" + Rule("id='r1' score='red'"),
     {},
     "red 1 r1",
     " r1"},
    {"a compound's predicate may stand behind its rules",
     "firstHit",
     "",
     "<CompoundRule>" + Rule("id='r1' score='red'") + "<False/></CompoundRule>" +
         Rule("id='r2' score='blue'"),
     {},
     "blue 1 r2",
     " r2"},
    {"extensions everywhere",
     "firstHit",
     "",
     "<Extension/><X-Rules/><CompoundRule><x-more/><True/><SimpleRule id='r1' score='red'><Extension/><True/>"
     "<Extension/></SimpleRule><Extension/></CompoundRule>",
     {},
     "red 1 r1",
     " r1"},
    {"of several selection methods the first",
     "firstHit",
     "",
     "<RuleSelectionMethod criterion='weightedMax'/><RuleSelectionMethod/>" + Rule("id='r1' score='red'") +
         Rule("id='r2' score='blue' weight='2'"),
     {},
     "red 1 r1",
     " r1 r2"},
    {"counts of training cases play no part",
     "firstHit",
     "recordCount='100' nbCorrect='60'",
     Rule("id='r1' score='red' recordCount='10' nbCorrect='1'"),
     {},
     "red 1 r1",
     " r1"},
};

TEST(RuleSetChoice, ChoosesAmongTheRulesThatFire) {
  for (const ChoiceRow& row : kChoices) {
    SCOPED_TRACE(row.why);
    const auto model = BuildRuleSet(RuleSetDocument(row.criterion, "m", row.attributes, row.rules));
    Telling<ClsResult> result;
    result.GetEntities().SetPathWanted(true);
    const CaseRecord record = RecordOf(row.cells);
    EXPECT_TRUE(model->Score(&record, &result).IsOK());
    EXPECT_EQ(ShowResult(result), row.result);
    EXPECT_EQ(ShowPath(result), row.path);
    result.GetEntities().SetPathWanted(false);
    EXPECT_TRUE(model->Score(&record, &result).IsOK());
    EXPECT_EQ(ShowResult(result), row.result) << "without a path";
    EXPECT_EQ(ShowPath(result), "");
    result.GetEntities().SetDecidingIdWanted(false);
    EXPECT_TRUE(model->Score(&record, &result).IsOK());
    EXPECT_EQ(result.GetEntities().GetDecidingId(), "") << "not wanted";
  }
}

struct TieRow {
  const char* why;
  const char* target;
  std::string rules;
  const char* prediction;
};

const TieRow kTies[] = {
    {"an ordinal target's order", "o", Rule("score='high'") + Rule("score='mid'"), "mid"},
    {"a target without list: the document's order", "t", Rule("score='q'") + Rule("score='p'"), "q"},
    {"no target: the document's order", "", Rule("score='q'") + Rule("score='p'"), "q"},
    {"the order of rules, not that of distributions", "t",
     "<SimpleRule score='q' weight='0.5'><True/><ScoreDistribution value='r' recordCount='1'/>"
     "</SimpleRule>" +
         Rule("score='p'") + Rule("score='r'"),
     "p"},
    {"texts that differ in trailing blanks are one class", "t",
     Rule("score='p'") + Rule("score='q '") + Rule("score='q'"), "q "},
    {"a continuous target has classes by number", "y",
     Rule("score='2'") + Rule("score='1.50'") + Rule("score='1.5'"), "1.5"},
};

TEST(RuleSetChoice, TiesOfSumsGoToTheFirstClass) {
  for (const TieRow& row : kTies) {
    SCOPED_TRACE(row.why);
    const auto model = BuildRuleSet(RuleSetDocument("weightedSum", row.target, "", row.rules));
    Telling<ClsResult> result;
    const CaseRecord record(0);
    ASSERT_TRUE(model->Score(&record, &result).IsOK());
    EXPECT_EQ(result.GetPrediction()->GetString(), row.prediction);
  }
}

std::string Counts(const std::string& red, const std::string& blue) {
  return "<ScoreDistribution value='blue' recordCount='" + blue +
         "'/><ScoreDistribution value='red' recordCount='" + red + "'/>";
}

struct CategoryRow {
  const char* why;
  const char* criterion;
  const char* attributes;
  std::string rules;
  const char* categories;  ///< see ShowCategories
};

const CategoryRow kCategories[] = {
    {"shares of all weights", "weightedSum", "",
     Rule("score='blue' weight='1'") + Rule("score='red' weight='5'") + Rule("score='blue' weight='2'"),
     " red=0.625 green=0 blue=0.375"},
    {"distributions play no part in sums", "weightedSum", "",
     "<SimpleRule score='red'><True/>" + Counts("1", "3") + "</SimpleRule>", " red=1 green=0 blue=0"},
    {"weights of 0 have no shares", "weightedSum", "", Rule("score='blue' weight='0' confidence='0.5'"),
     " blue=0.5"},
    {"nor has a negative sum", "weightedSum", "",
     Rule("score='blue' weight='3' confidence='0.5'") + Rule("score='red' weight='-1'"), " blue=0.25"},
    {"nor a sum that is no number", "weightedSum", "",
     Rule("score='blue' weight='1.5e308' confidence='0.5'") + Rule("score='blue' weight='1.5e308'"),
     " blue=0.75"},

    {"a distribution of counts", "firstHit", "",
     "<SimpleRule score='red' confidence='0.5'><True/>" + Counts("1", "3") + "</SimpleRule>",
     " red=0.25 green=0 blue=0.75"},
    {"a distribution of probabilities", "weightedMax", "",
     Rule("score='green'") +
         "<SimpleRule score='red' weight='2'><True/><ScoreDistribution value='red' recordCount='1' "
         "probability='0.5'/><ScoreDistribution value='green' recordCount='9' probability='0.375'/>"
         "</SimpleRule>",
     " red=0.5 green=0.375 blue=0"},
    {"probabilities count when all have one", "firstHit", "",
     "<SimpleRule score='red'><True/><ScoreDistribution value='red' recordCount='1' probability='0.5'/>"
     "<ScoreDistribution value='green' recordCount='3'/></SimpleRule>",
     " red=0.25 green=0.75 blue=0"},
    {"a distribution without records is none", "firstHit", "",
     "<SimpleRule score='red' confidence='0.5'><True/>" + Counts("0", "0") + "</SimpleRule>", " red=0.5"},
    {"counts that sum to no number are none", "firstHit", "",
     "<SimpleRule score='red' confidence='0.5'><True/>" + Counts("1.5e308", "1.5e308") + "</SimpleRule>",
     " red=0.5"},
    {"no distribution", "firstHit", "", Rule("score='red' confidence='0.75'"), " red=0.75"},
    {"that of the deciding rule", "firstHit", "",
     Rule("score='red' confidence='0.75'") + "<SimpleRule score='red'><True/>" + Counts("1", "3") +
         "</SimpleRule>",
     " red=0.75"},

    {"the rule set's for the default score", "firstHit", "defaultScore='green' defaultConfidence='0.25'",
     Counts("1", "3") + If("<False/>", "score='red'"), " red=0.25 green=0 blue=0.75"},
    {"by sums, too", "weightedSum", "defaultScore='green'", Counts("1", "3") + If("<False/>", "score='red'"),
     " red=0.25 green=0 blue=0.75"},
    {"but not for rules", "firstHit", "defaultScore='green'",
     Counts("1", "3") + Rule("score='red' confidence='0.5'"), " red=0.5"},
    {"a default without distribution", "firstHit", "defaultScore='green' defaultConfidence='0.25'", "",
     " green=0.25"},
    {"a default of which nothing is known", "firstHit", "defaultScore='green'", "", ""},
};

TEST(RuleSetChoice, GivesProbabilitiesOfCategories) {
  for (const CategoryRow& row : kCategories) {
    SCOPED_TRACE(row.why);
    const auto model = BuildRuleSet(RuleSetDocument(row.criterion, "m", row.attributes, row.rules));
    Telling<ClsResult> result;
    const CaseRecord record(0);
    ASSERT_TRUE(model->Score(&record, &result).IsOK());
    EXPECT_EQ(ShowCategories(result), row.categories);
  }
}

TEST(RuleSetChoice, ListsCategoriesOfATargetWithoutListAsTheyCome) {
  const std::string rules =
      "<ScoreDistribution value='s' recordCount='1'/><ScoreDistribution value='p' recordCount='3'/>"
      "<SimpleRule score='q'><False/><ScoreDistribution value='r' recordCount='2'/></SimpleRule>" +
      If("<False/>", "score='p'");
  for (const char* target : {"t", ""}) {
    const auto model = BuildRuleSet(RuleSetDocument("firstHit", target, "defaultScore='u'", rules));
    Telling<ClsResult> result;
    const CaseRecord record(0);
    ASSERT_TRUE(model->Score(&record, &result).IsOK());
    EXPECT_EQ(ShowCategories(result), " q=0 p=0.75 u=0 r=0 s=0.25");
  }
}

const ChoiceRow kRegressions[] = {
    {"the first rule that fires",
     "firstHit",
     "",
     RuleAbove("5", "id='r1' score='1.5'") + RuleAbove("1", "id='r2' score='-2.5e3' confidence='0.75'"),
     {{"x", 2.0}},
     "-2500 0.75 r2",
     " r2"},
    {"the highest weight",
     "weightedMax",
     "",
     Rule("id='r1' score='1' weight='0.5'") + Rule("id='r2' score='2' weight='2' confidence='0.5'"),
     {},
     "2 0.5 r2",
     " r1 r2"},
    {"equal numbers are one class",
     "weightedSum",
     "",
     Rule("id='r1' score='1'") + Rule("id='r2' score='20.0' weight='0.75' confidence='0.5'") +
         Rule("id='r3' score='2e1' weight='0.5'"),
     {},
     "20 0.5 r2",
     " r1 r2 r3"},
    {"equal sums: the document's order",
     "weightedSum",
     "",
     Rule("id='r1' score='3'") + Rule("id='r2' score='2'"),
     {},
     "3 0.5 r1",
     " r1 r2"},
    {"no rule fires",
     "firstHit",
     "defaultScore='7' defaultConfidence='0.25'",
     RuleAbove("1", "id='r1' score='1'"),
     {{"x", 0.0}},
     "7 0.25 -",
     ""},
    {"distributions play no part",
     "firstHit",
     "",
     "<ScoreDistribution value='a' recordCount='1'/><SimpleRule id='r1' score='0'><True/><ScoreDistribution "
     "value='b'/></SimpleRule>",
     {},
     "0 1 r1",
     " r1"},
};

TEST(RuleSetChoice, PredictsNumbers) {
  for (const ChoiceRow& row : kRegressions) {
    SCOPED_TRACE(row.why);
    const auto model = BuildRegression(row.criterion, row.attributes, row.rules);
    Telling<RegResult> result;
    result.GetEntities().SetPathWanted(true);
    const CaseRecord record = RecordOf(row.cells);
    EXPECT_TRUE(model->Score(&record, &result).IsOK());
    EXPECT_EQ(ShowResult(result), row.result);
    EXPECT_EQ(ShowPath(result), row.path);
  }
}

TEST(RuleSetChoice, PredictsTheRulesOwnDigits) {
  // Equal by the tolerance of numbers, and still two predictions.
  const auto model =
      BuildRegression("firstHit", "", RuleAbove("1", "score='1'") + Rule("score='1.000000000000001'"));
  Telling<RegResult> result;
  CaseRecord record = RecordOf({{"x", 0.0}});
  ASSERT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(result.GetPrediction()->GetDouble(), 1.000000000000001);
}

}  // namespace
