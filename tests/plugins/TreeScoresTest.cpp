// What the nodes of a tree predict: scores, distributions, and the categories of the target.

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/ValueProbability.h"
#include "kestrel/dictionary/ValueProbabilitySet.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "tests/plugins/TreeText.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

/// The result of the empty case with its categories.
std::string ShowAll(ScoreModel& model) {
  ClsResult result;
  const CaseRecord record = RecordOf({});
  if (!model.Score(&record, &result).IsOK()) return "-";
  const std::string shown = ShowResult(result);
  return shown.substr(0, shown.rfind(' ')) + " |" + ShowCategories(result);
}

struct ScoreRow {
  const char* why;
  const char* attributes;  ///< of the only node
  std::string distribution;
  const char* want;
};

const ScoreRow kScoreRows[] = {
    {"a score alone is sure", "score='green'", "", "green 1 | red=0 green=1 blue=0"},
    {"counts make shares", "", Counts("1", "5", "2"), "green 0.625 | red=0.125 green=0.625 blue=0.25"},
    {"in the order of the target", "", Count("blue", "1") + Count("green", "1") + Count("red", "2"),
     "red 0.5 | red=0.5 green=0.25 blue=0.25"},
    {"of equal counts the document's first wins", "", Count("blue", "2") + Count("red", "2"),
     "blue 0.5 | red=0.5 green=0 blue=0.5"},
    {"a category without entry has no share", "", Count("blue", "4"), "blue 1 | red=0 green=0 blue=1"},
    {"counts need not be whole", "", Count("red", "0.5") + Count("blue", "1.5"),
     "blue 0.75 | red=0.25 green=0 blue=0.75"},
    {"the score wins against the counts", "score='red'", Counts("1", "5", "2"),
     "red 0.125 | red=0.125 green=0.625 blue=0.25"},
    {"a score that the distribution leaves out has no share", "score='red'", Count("blue", "4"),
     "red 0 | red=0 green=0 blue=1"},
    {"the node's own record count is no part of the shares", "recordCount='100'", Counts("1", "3", "0"),
     "green 0.75 | red=0.25 green=0.75 blue=0"},
    {"no records: the document's first", "", Count("blue", "0") + Count("red", "0"),
     "blue 0 | red=0 green=0 blue=0"},
    {"probabilities stand as they are given", "",
     Count("red", "9", "probability='0.25'") + Count("green", "1", "probability='0.5'"),
     "red 0.25 | red=0.25 green=0.5 blue=0"},
    {"they stand where there are no records", "",
     Count("red", "0", "probability='0.25'") + Count("green", "0", "probability='0.75'"),
     "red 0.25 | red=0.25 green=0.75 blue=0"},
    {"and for the score", "score='green'",
     Count("red", "9", "probability='0.25'") + Count("green", "1", "probability='0.75'"),
     "green 0.75 | red=0.25 green=0.75 blue=0"},
    {"some without probability: shares", "", Count("red", "3", "probability='0.5'") + Count("green", "1"),
     "red 0.75 | red=0.75 green=0.25 blue=0"},
    {"the winner's confidence stands for its share", "",
     Count("red", "3", "confidence='0.5'") + Count("green", "1", "confidence='0.125'"),
     "red 0.5 | red=0.75 green=0.25 blue=0"},
    {"the score's", "score='green'",
     Count("red", "3", "confidence='0.5'") + Count("green", "1", "confidence='0.125'"),
     "green 0.125 | red=0.75 green=0.25 blue=0"},
    {"another's does not", "", Count("red", "3") + Count("green", "1", "confidence='0.125'"),
     "red 0.75 | red=0.75 green=0.25 blue=0"},
    {"beside probabilities", "",
     Count("red", "3", "confidence='0.5' probability='0.375'") +
         Count("green", "1", "confidence='1' probability='0.625'"),
     "red 0.5 | red=0.375 green=0.625 blue=0"},
    {"a text is the same with trailing blanks", "score='red  '", Count("green ", "1") + Count("red", "1"),
     "red 0.5 | red=0.5 green=0.5 blue=0"},
};

TEST(TreeScores, ComeFromScoreAndDistribution) {
  for (const ScoreRow& row : kScoreRows) {
    const auto model = BuildClassifier("", Node(row.attributes, "<True/>" + row.distribution));
    EXPECT_EQ(ShowAll(*model), row.want) << row.why;
  }
}

TEST(TreeScores, MayStandAnywhereInTheNode) {
  const auto model =
      BuildClassifier("", Node("", Count("red", "1") + "<True/><Extension/>" + Count("blue", "3")));
  EXPECT_EQ(ShowAll(*model), "blue 0.75 | red=0.25 green=0 blue=0.75");
}

struct TargetRow {
  const char* why;
  const char* target;
  std::string nodes;
  const char* want;
};

const TargetRow kTargetRows[] = {
    {"numbers, however they are written", "n",
     Node("score='2.0'", "<True/>" + Count("1", "1") + Count("2e0", "3")), "2 0.75 | 1=0.25 2=0.75 3=0"},
    {"an ordinal target", "o", Node("", "<True/>" + Count("high", "1") + Count("low", "3")),
     "low 0.75 | low=0.75 mid=0 high=0.25"},
    {"ordinal numbers in their order", "r", Node("", "<True/>" + Count("5", "1") + Count("10", "1")),
     "5 0.5 | 10=0.5 20=0 5=0.5"},
    {"a text without list: as the nodes name them first", "t",
     Node("score='q'", "<True/>" + Node("score='s'", Is("x", "1")) +
                           Node("score='p'", "<True/>" + Count("r", "1") + Count("p", "3"))),
     "p 0.75 | q=0 s=0 r=0.25 p=0.75"},
    {"no target: texts", "", Node("", "<True/>" + Count("2.0", "1") + Count("2", "3")),
     "2 0.75 | 2.0=0.25 2=0.75"},
    {"a continuous target: its numbers", "y", Node("", "<True/>" + Count("2.5", "1") + Count("1", "3")),
     "1 0.75 | 2.5=0.25 1=0.75"},
};

TEST(TreeScores, CategoriesAreTheTargets) {
  for (const TargetRow& row : kTargetRows) {
    const auto model =
        BuildTree(TreeDocument(TreeModelOf("classification", "", TreeSchema(row.target), row.nodes)));
    EXPECT_EQ(ShowAll(*model), row.want) << row.why;
  }
}

TEST(TreeScores, CategoriesAreOfTheTargetsType) {
  const auto model = BuildTree(TreeDocument(TreeModelOf(
      "classification", "", TreeSchema("n"), Node("", "<True/>" + Count("1", "1") + Count("3", "3")))));
  ClsResult result;
  const CaseRecord record = RecordOf({});
  ASSERT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(result.GetPrediction()->GetType(), ScoreValue::kNumeric);
  const NumericValue one(1.0), three(3.0);
  EXPECT_EQ(result.GetCategoryProbability(&one), 0.25);
  EXPECT_EQ(result.GetCategoryProbability(&three), 0.75);
}

TEST(TreeScores, ATargetOfTheAttributesCountsLikeOneOfTheSchema) {
  const auto model = BuildTree(TreeDocument(TreeModelOf("classification", "targetFieldName='m'",
                                                        TreeSchema(""), Node("score='green'", "<True/>"))));
  EXPECT_EQ(ShowAll(*model), "green 1 | red=0 green=1 blue=0");
}

TEST(TreeScores, NumbersStandAsTheyAreWritten) {
  const struct {
    const char* score;
    double want;
  } kRows[] = {{"0", 0.0},
               {"-2.5", -2.5},
               {"1e-300", 1e-300},
               {"1e308", 1e308},
               {"4.9406564584124654e-324", 4.9406564584124654e-324},
               {" 7", 7.0}};
  for (const auto& row : kRows) {
    const auto model = BuildEstimator("", Node(std::string("score='") + row.score + "'", "<True/>"));
    RegResult result;
    const CaseRecord record = RecordOf({});
    ASSERT_TRUE(model->Score(&record, &result).IsOK()) << row.score;
    EXPECT_EQ(result.GetPrediction()->GetDouble(), row.want);
  }
}

TEST(TreeScores, ARegressionHasNoUseForDistributions) {
  const auto model = BuildEstimator("", Node("score='1'", "<True/>" + Counts("1", "2", "3")));
  EXPECT_EQ(ScoreOf(*model, {}), "1 #1");
}

TEST(TreeScores, ADefaultOfTheTargetTakesTheirPlace) {
  const auto model = BuildClassifier("", Node("score='red'", Is("g", "a")));
  auto* probabilities = new ValueProbabilitySet;
  probabilities->Add(new ValueProbability(new StringValue("green"), 0.25));
  probabilities->Add(new ValueProbability(new StringValue("blue"), 0.75));
  const_cast<ScoreDictVar*>(model->GetTargetVar())->SetValueProbabilities(probabilities);
  EXPECT_EQ(ScoreOf(*model, {{"g", "b"}}), "blue 0.75 -");
  EXPECT_EQ(ScoreOf(*model, {{"g", "a"}}), "red 1 #1");
  model->SetMissingValuePolicy(ScoreModel::kNullPrediction);
  EXPECT_EQ(ScoreOf(*model, {{"g", "b"}}), "90027");
}

// ---- From a case's value to what predicates see of it.

struct TreatmentRow {
  const char* why;
  const char* field;
  const char* attributes;  ///< of its MiningField
  Cell cell;
  const char* want;  ///< missing, satisfied, present or none of these; or the status's code
};

const TreatmentRow kTreatmentRows[] = {
    {"an invalid category is refused", "g", "", "violet", "90025"},
    {"refused when told so", "g", "invalidValueTreatment='returnInvalid'", "violet", "90025"},
    {"missing", "g", "invalidValueTreatment='asMissing'", "violet", "missing"},
    {"used as it is, a nominal one counts as missing", "g", "invalidValueTreatment='asIs'", "violet",
     "missing"},
    {"replaced", "g", "invalidValueTreatment='asValue' invalidValueReplacement='b'", "violet", "satisfied"},
    {"a valid one is untouched", "g", "invalidValueTreatment='asMissing'", "b", "satisfied"},
    {"a missing category", "g", "", {}, "missing"},
    {"a missing category is replaced", "g", "missingValueReplacement='b'", {}, "satisfied"},
    {"replaced by another", "g", "missingValueReplacement='c'", {}, "present"},
    {"a missing category is refused", "g", "missingValueTreatment='returnInvalid'", {}, "90025"},
    {"the empty text is missing", "g", "", "", "missing"},
    {"an invalid ordinal value is refused", "o", "", "top", "90025"},
    {"used as it is, an ordinal one is none of the values", "o", "invalidValueTreatment='asIs'", "top",
     "none"},
    {"an invalid ordinal one as missing", "o", "invalidValueTreatment='asMissing'", "top", "missing"},
    {"an invalid ordinal one replaced", "o", "invalidValueTreatment='asValue' invalidValueReplacement='high'",
     "top", "satisfied"},
    {"a valid ordinal value", "o", "", "low", "present"},
    {"an ordinal number that is no category", "r", "invalidValueTreatment='asIs'", 15.0, "none"},
    {"an ordinal number", "r", "", 20.0, "satisfied"},
    {"a coded category that is none", "n", "invalidValueTreatment='asIs'", 15.0, "missing"},
    {"a number", "x", "", 1.0, "satisfied"},
    {"a missing number", "x", "", NumericValue::gSysmisValue, "missing"},
    {"no value", "x", "", {}, "missing"},
    {"a missing number is replaced", "x", "missingValueReplacement='3'", {}, "satisfied"},
    {"a missing number is refused", "x", "missingValueTreatment='returnInvalid'", {}, "90025"},
    {"a text in a number's place", "x", "", "1", "90025"},
    {"used as it is, it is the number that it reads as", "x", "invalidValueTreatment='asIs'", "1",
     "satisfied"},
    {"or missing", "x", "invalidValueTreatment='asIs'", "one", "missing"},
    {"an outlier as the margin", "x", "outliers='asExtremeValues' highValue='5'", 9.0, "satisfied"},
    {"an outlier as missing", "x", "outliers='asMissingValues' highValue='5'", 9.0, "missing"},
    {"an outlier as it is", "x", "highValue='5'", 9.0, "present"},
    {"a date as a number in its unit", "d", "", 900.0, "satisfied"},
    {"a missing date", "d", "", {}, "missing"},
};

/// A test of each kind of field that some of its values pass.
std::string SatisfiedBy(const std::string& field) {
  if (field == "x") return AtMost("x", "5");
  if (field == "d") return Simple("d", "lessThan", "1000");
  if (field == "g") return Is("g", "b");
  if (field == "n") return Is("n", "2");
  return Simple(field, "greaterOrEqual", field == "o" ? "mid" : "20");
}

TEST(TreeScores, ValuesAreTreatedAsTheSchemaSays) {
  for (const TreatmentRow& row : kTreatmentRows) {
    const std::string field = row.field;
    const std::string schema = "<MiningSchema><MiningField name='" + field + "' " + row.attributes +
                               "/><MiningField name='t' usageType='target'/></MiningSchema>";
    const auto model = BuildTree(TreeDocument(TreeModelOf(
        "classification", "", schema,
        Node("",
             "<True/>" +
                 Node("score='missing'", "<SimplePredicate field='" + field + "' operator='isMissing'/>") +
                 Node("score='satisfied'", SatisfiedBy(field)) +
                 Node("score='present'", "<SimplePredicate field='" + field + "' operator='isNotMissing'/>") +
                 Node("score='none'", "<True/>")))));
    const std::string shown = ScoreOf(*model, {{field, row.cell}});
    EXPECT_EQ(shown.substr(0, shown.find(' ')), row.want) << row.why;
  }
}

TEST(TreeScores, ADateOfAHostCountsInItsFieldsUnit) {
  const auto model = BuildEstimator(
      "",
      Node("", "<True/>" + Node("score='1'", Simple("d", "equal", "86400")) + Node("score='2'", "<True/>")));
  CaseRecord record(1);
  record.Add("d", new DateTimeValue(86400.0, kDateTimeVal));
  RegResult result;
  ASSERT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(result.GetPrediction()->GetDouble(), 1.0);
}

TEST(TreeScores, AFieldThatNoPredicateNamesRefusesNoCase) {
  const auto model = BuildEstimator("", Node("", "<True/>" + Node("score='1'", AtMost("x", "5"))));
  EXPECT_EQ(ScoreOf(*model, {{"x", 1.0}, {"g", "violet"}}), "1 #2");
}

}  // namespace
}  // namespace kestrel_tests
