// The way of a case through a tree and what the model tells of itself and of the result.

#include "plugins/tree/TreeModel.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/ScoreVersionInfo.h"
#include "tests/plugins/TreeText.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

constexpr double kSysmis = NumericValue::gSysmisValue;
constexpr double kInfinity = std::numeric_limits<double>::infinity();
const double kNan = std::nan("");
constexpr double kLargest = std::numeric_limits<double>::max();

const std::string kSet =
    "<SimpleSetPredicate field='g' booleanOperator='isIn'><Array n='2' type='string'>a c</Array>"
    "</SimpleSetPredicate>";
const std::string kNotSet =
    "<SimpleSetPredicate field='g' booleanOperator='isNotIn'><Array n='2' type='string'>a c</Array>"
    "</SimpleSetPredicate>";

std::string IsMissing(const std::string& field) {
  return "<SimplePredicate field='" + field + "' operator='isMissing'/>";
}

std::string IsNotMissing(const std::string& field) {
  return "<SimplePredicate field='" + field + "' operator='isNotMissing'/>";
}

/// A root of value 0 and children with the values 1, 2, ... in their order.
std::string Children(const std::vector<std::string>& predicates) {
  std::string nodes = "<True/>";
  for (size_t i = 0; i < predicates.size(); ++i)
    nodes += Node("score='" + std::to_string(i + 1) + "'", predicates[i]);
  return Node("score='0'", nodes);
}

struct WayRow {
  const char* why;
  std::string tree;
  Case cells;
  const char* want;
};

const WayRow kWayRows[] = {
    {"a root alone", Node("score='2.5'", "<True/>"), {}, "2.5 #1"},
    {"the left of a binary split", Children({AtMost("x", "5"), Above("x", "5")}), {{"x", 5.0}}, "1 #2"},
    {"the right of a binary split", Children({AtMost("x", "5"), Above("x", "5")}), {{"x", 5.5}}, "2 #3"},
    {"a binary split the other way round",
     Children({Above("x", "5"), AtMost("x", "5")}),
     {{"x", 5.5}},
     "1 #2"},
    {"its second child", Children({Above("x", "5"), AtMost("x", "5")}), {{"x", 5.0}}, "2 #3"},
    {"less and at least",
     Children({Simple("x", "lessThan", "5"), Simple("x", "greaterOrEqual", "5")}),
     {{"x", 5.0}},
     "2 #3"},
    {"at least and less",
     Children({Simple("x", "greaterOrEqual", "5"), Simple("x", "lessThan", "5")}),
     {{"x", 5.0}},
     "1 #2"},
    {"a second child for the rest", Children({AtMost("x", "5"), "<True/>"}), {{"x", 5.5}}, "2 #3"},
    {"which takes what is missing, too", Children({AtMost("x", "5"), "<True/>"}), {}, "2 #3"},
    {"a second child on another field",
     Children({AtMost("x", "5"), Above("z", "5")}),
     {{"x", 9.0}, {"z", 9.0}},
     "2 #3"},
    {"a gap between the two", Children({AtMost("x", "1"), Above("x", "5")}), {{"x", 3.0}}, "90027"},
    {"the first where both are true", Children({AtMost("x", "5"), Above("x", "1")}), {{"x", 3.0}}, "1 #2"},
    {"the second of two that overlap", Children({AtMost("x", "5"), Above("x", "1")}), {{"x", 7.0}}, "2 #3"},
    {"two tests of one side", Children({AtMost("x", "1"), AtMost("x", "5")}), {{"x", 3.0}}, "2 #3"},
    {"the first of several", Children({Is("x", "1"), Is("x", "2"), Is("x", "3")}), {{"x", 1.0}}, "1 #2"},
    {"the last of several", Children({Is("x", "1"), Is("x", "2"), Is("x", "3")}), {{"x", 3.0}}, "3 #4"},
    {"all but one number", Children({Simple("x", "notEqual", "2"), "<True/>"}), {{"x", 3.0}}, "1 #2"},
    {"and that one", Children({Simple("x", "notEqual", "2"), "<True/>"}), {{"x", 2.0}}, "2 #3"},
    {"a split of three",
     Children({AtMost("x", "1"), AtMost("x", "5"), Above("x", "5")}),
     {{"x", 9.0}},
     "3 #4"},
    {"a child that never applies", Children({"<False/>", AtMost("x", "5")}), {{"x", 1.0}}, "2 #3"},
    {"a category", Children({Is("g", "a"), Simple("g", "notEqual", "a")}), {{"g", "a"}}, "1 #2"},
    {"another category", Children({Is("g", "a"), Simple("g", "notEqual", "a")}), {{"g", "c"}}, "2 #3"},
    {"trailing blanks do not count", Children({Is("g", "a"), "<True/>"}), {{"g", "a  "}}, "1 #2"},
    {"a set", Children({kSet, kNotSet}), {{"g", "c"}}, "1 #2"},
    {"its complement", Children({kSet, kNotSet}), {{"g", "b"}}, "2 #3"},
    {"a set, and one of what it leaves out", Children({kSet, Is("g", "b")}), {{"g", "b"}}, "2 #3"},
    {"a set and the rest", Children({kSet, "<True/>"}), {{"g", "b"}}, "2 #3"},
    {"a set and a rest that takes what is missing", Children({kSet, "<True/>"}), {}, "2 #3"},
    {"a set and a part of the rest", Children({Is("g", "a"), Is("g", "b")}), {{"g", "c"}}, "90027"},
    {"a coded category", Children({Is("n", "2"), "<True/>"}), {{"n", 2.0}}, "1 #2"},
    {"an ordinal text below",
     Children({Simple("o", "lessThan", "high"), Is("o", "high")}),
     {{"o", "mid"}},
     "1 #2"},
    {"an ordinal text at the top",
     Children({Simple("o", "lessThan", "high"), Is("o", "high")}),
     {{"o", "high"}},
     "2 #3"},
    {"ordinal numbers are compared by their places: 10, 20, 5",
     Children({Above("r", "10"), "<True/>"}),
     {{"r", 5.0}},
     "1 #2"},
    {"the first place is not above itself", Children({Above("r", "10"), "<True/>"}), {{"r", 10.0}}, "2 #3"},
    {"a date counts in its field's unit",
     Children({Above("d", "1000"), AtMost("d", "1000")}),
     {{"d", 1001.0}},
     "1 #2"},
    {"a missing number is found", Children({IsMissing("x"), AtMost("x", "5")}), {}, "1 #2"},
    {"a present number is not missing", Children({IsMissing("x"), AtMost("x", "5")}), {{"x", 1.0}}, "2 #3"},
    {"a present number", Children({IsNotMissing("x"), "<True/>"}), {{"x", 1.0}}, "1 #2"},
    {"a missing number is not decided to be present", Children({IsNotMissing("x"), "<True/>"}), {}, "2 #3"},
    {"a missing category is found", Children({IsMissing("g"), kSet}), {}, "1 #2"},
    {"a present category is not missing", Children({IsMissing("g"), kSet}), {{"g", "a"}}, "2 #3"},
    {"a present category", Children({IsNotMissing("g"), "<True/>"}), {{"g", "c"}}, "1 #2"},
    {"both of an and",
     Children({Compound("and", AtMost("x", "5") + kSet), "<True/>"}),
     {{"x", 1.0}, {"g", "a"}},
     "1 #2"},
    {"one of an or", Children({Compound("or", AtMost("x", "5") + kSet), "<True/>"}), {{"g", "a"}}, "1 #2"},
    {"one of an xor",
     Children({Compound("xor", AtMost("x", "5") + kSet), "<True/>"}),
     {{"x", 9.0}, {"g", "a"}},
     "1 #2"},
    {"both of an xor",
     Children({Compound("xor", AtMost("x", "5") + kSet), "<True/>"}),
     {{"x", 1.0}, {"g", "a"}},
     "2 #3"},
    {"a surrogate",
     Children({Compound("surrogate", AtMost("x", "5") + kSet), "<True/>"}),
     {{"g", "a"}},
     "1 #2"},
    {"compounds inside compounds",
     Children({Compound("and", Compound("or", AtMost("x", "5") + kSet) + Is("n", "2")), "<True/>"}),
     {{"g", "a"}, {"n", 2.0}},
     "1 #2"},
    {"deeper",
     Node("", "<True/>" +
                  Node("", AtMost("x", "5") + Node("score='1'", AtMost("z", "5")) +
                               Node("score='2'", Above("z", "5"))) +
                  Node("score='3'", Above("x", "5"))),
     {{"x", 1.0}, {"z", 9.0}},
     "2 #4"},
    {"a child with one child",
     Node("", "<True/>" + Node("", AtMost("x", "5") + Node("score='1'", AtMost("x", "3")))),
     {{"x", 1.0}},
     "1 #3"},
    {"an only child that is true", Node("", "<True/>" + Node("score='1'", "<True/>")), {}, "1 #2"},
};

TEST(TreeModel, GoesDownToTheFirstChildThatIsTrue) {
  for (const WayRow& row : kWayRows)
    EXPECT_EQ(ScoreOf(*BuildEstimator("", row.tree), row.cells), row.want) << row.why;
}

// An infinity and what is no number are no missing values, and lie in no range.
TEST(TreeModel, NumbersThatAreNoneGoToTheRest) {
  struct Row {
    const char* why;
    std::string tree;
    const char* want;
  };
  const Row kRows[] = {
      {"neither side of a split", Children({AtMost("x", "5"), Above("x", "5")}), "90027"},
      {"the rest", Children({AtMost("x", "5"), "<True/>"}), "2 #3"},
      {"not present", Children({IsNotMissing("x"), "<True/>"}), "2 #3"},
      {"not missing", Children({IsMissing("x"), "<True/>"}), "2 #3"},
      {"not equal, and not different", Children({Is("x", "1"), Simple("x", "notEqual", "1"), "<True/>"}),
       "3 #4"},
  };
  for (const Row& row : kRows) {
    for (const double x : {kInfinity, -kInfinity, kNan}) {
      EXPECT_EQ(ScoreOf(*BuildEstimator("", row.tree), {{"x", x}}), row.want) << row.why << ", " << x;
      EXPECT_EQ(ScoreOf(*BuildEstimator("missingValueStrategy='lastPrediction'", row.tree), {{"x", x}}),
                row.want)
          << row.why << ", " << x;
    }
  }
}

TEST(TreeModel, TheLargestNumbersAreNumbers) {
  const auto model = BuildEstimator("", Children({AtMost("x", "5"), Above("x", "5")}));
  EXPECT_EQ(ScoreOf(*model, {{"x", kLargest}}), "2 #3");
  EXPECT_EQ(ScoreOf(*model, {{"x", -std::nextafter(kLargest, 0.0)}}), "1 #2");
  EXPECT_EQ(ScoreOf(*model, {{"x", kSysmis}}), "90027") << "its opposite is the missing one";
}

TEST(TreeModel, ElementsOfProducersArePassedOver) {
  const std::string extensions = "<Extension/><X-Note><Node/></X-Note><x-note/><Partition/>";
  const auto model = BuildEstimator(
      "", extensions + Node("", extensions + "<True/>" + extensions +
                                    Node("score='1' id='a'", AtMost("x", "5") + extensions) + extensions +
                                    Node("score='2' id='b'", extensions + "<True/>")));
  EXPECT_EQ(ScoreOf(*model, {{"x", 1.0}}), "1 a");
  EXPECT_EQ(ScoreOf(*model, {{"x", 9.0}}), "2 b");
}

// ---- What the model says.

constexpr char kTwoLevels[] =
    "<Node id='top' score='red'><True/><Node id='low' score='red' recordCount='4' defaultChild='deep'>"
    "<SimplePredicate field='z' operator='lessOrEqual' value='5'/><Node score='blue' recordCount='3' "
    "id='deep'><SimplePredicate field='x' operator='lessOrEqual' value='5'/></Node><Node score='green' "
    "recordCount='1'><SimplePredicate field='x' operator='greaterThan' value='5'/></Node></Node><Node "
    "score='green' recordCount='4'><SimplePredicate field='g' operator='equal' value='a'/></Node></Node>";

TEST(TreeModel, TellsWhatItIs) {
  const auto model = BuildTree(TreeDocument(
      TreeModelOf("classification",
                  "modelName='t' algorithmName='a' splitCharacteristic='multiSplit' "
                  "missingValueStrategy='aggregateNodes' "
                  "missingValuePenalty='0.75' noTrueChildStrategy='returnLastPrediction' isScorable='true'",
                  TreeSchema("m"),
                  Node("score='red'", "<True/>" + Node("", AtMost("z", "5") + Counts("1", "0", "0")) +
                                          Node("", Is("g", "a") + Counts("1", "0", "0"))))));
  EXPECT_EQ(model->GetModelKind(), "TreeModel");
  EXPECT_FALSE(model->SuppressCategoryProbabilities());
  EXPECT_EQ(model->GetTargetVar()->GetName(), "m");
  EXPECT_EQ(model->GetVarRole("m"), ScoreModel::kTarget);
  EXPECT_EQ(model->GetVarRole("x"), ScoreModel::kPredictor);
  EXPECT_EQ(model->GetVersionInfo()->GetVersionInfo(), "4.4");
  std::ostringstream shown;
  model->Display(shown);
  EXPECT_EQ(shown.str(),
            "Start TreeModel Display:\n"
            "Function = classification; Target = m\n"
            "Missing value strategy = aggregateNodes; Penalty = 0.75; No true child = returnLastPrediction\n"
            "Nodes = 3; Leaves = 2; Levels = 2\n"
            "End of TreeModel Display.\n\n");
}

TEST(TreeModel, DisplayShowsWhatHoldsWithoutAttributes) {
  std::ostringstream shown;
  BuildTree(TreeDocument(TreeModelOf("regression", "", TreeSchema(""), Node("score='1'", "<True/>"))))
      ->Display(shown);
  EXPECT_EQ(shown.str(),
            "Start TreeModel Display:\n"
            "Function = regression\n"
            "Missing value strategy = none; Penalty = 1; No true child = returnNullPrediction\n"
            "Nodes = 1; Leaves = 1; Levels = 1\n"
            "End of TreeModel Display.\n\n");
}

TEST(TreeModel, PredictorsStandInTheOrderOfThePredicates) {
  const auto model = BuildClassifier("", kTwoLevels);
  std::string names;
  for (const ScoreDictVar* variable : model->GetPredictors())
    names += variable->GetName();
  EXPECT_EQ(names, "zxg");
  EXPECT_TRUE(BuildEstimator("", Node("score='1'", "<True/>"))->GetPredictors().empty());
}

TEST(TreeModel, MakesTheResultOfItsFunction) {
  const std::unique_ptr<ScoreResult> classification(BuildClassifier("", kTwoLevels)->MakeResult());
  EXPECT_NE(dynamic_cast<ClsResult*>(classification.get()), nullptr);
  const std::unique_ptr<ScoreResult> regression(
      BuildEstimator("", Node("score='1'", "<True/>"))->MakeResult());
  EXPECT_NE(dynamic_cast<RegResult*>(regression.get()), nullptr);
}

TEST(TreeModel, FillsAResultOfAnotherKindAsFarAsItGoes) {
  RegResult result;
  const CaseRecord record = RecordOf({{"z", 1.0}, {"x", 9.0}});
  EXPECT_TRUE(BuildClassifier("", kTwoLevels)->Score(&record, &result).IsOK());
  EXPECT_EQ(result.GetPrediction()->GetString(), "green");
  EXPECT_EQ(result.GetProbability(), 1.0);
  const auto joined = BuildClassifier("missingValueStrategy='weightedConfidence'", kTwoLevels);
  const CaseRecord missing = RecordOf({{"z", 1.0}});
  EXPECT_TRUE(joined->Score(&missing, &result).IsOK());
  EXPECT_EQ(result.GetPrediction()->GetString(), "blue");
  EXPECT_EQ(result.GetProbability(), 0.75);
}

// ---- What is told of the way.

struct PathRow {
  const char* why;
  const char* strategy;
  Case cells;
  const char* result;
  const char* path;
};

const PathRow kPathRows[] = {
    {"down to a leaf", "none", {{"z", 1.0}, {"x", 1.0}}, "blue 1 deep", " top low deep"},
    {"a node without id", "none", {{"z", 1.0}, {"x", 9.0}}, "green 1 #4", " top low #4"},
    {"as far as there is a way", "none", {{"z", 9.0}, {"g", "b"}}, "-", " top"},
    {"as far as it is decided", "nullPrediction", {{"z", 1.0}}, "-", " top low"},
    {"to the node that predicts", "lastPrediction", {{"z", 1.0}}, "red 1 low", " top low"},
    {"by a default child", "defaultChild", {{"z", 1.0}}, "blue 1 deep", " top low deep"},
    {"a fork", "weightedConfidence", {{"z", 1.0}}, "blue 0.75 -", " top low deep #4"},
    {"a fork above a fork", "weightedConfidence", {}, "green 0.625 -", " top low deep #4 #5"},
    {"a fork with a branch that is decided",
     "weightedConfidence",
     {{"x", 1.0}},
     "green 0.5 -",
     " top low deep #5"},
};

/// kTwoLevels, complete for each strategy.
std::unique_ptr<TreeModel> TwoLevels(const std::string& strategy) {
  std::string tree = kTwoLevels;
  tree.replace(tree.find("id='top'"), 8, "id='top' defaultChild='low'");
  return BuildClassifier("missingValueStrategy='" + strategy + "'", tree);
}

TEST(TreeModel, NamesTheNodesOfTheWay) {
  for (const PathRow& row : kPathRows) {
    const auto model = TwoLevels(row.strategy);
    ClsResult result;
    result.GetEntities().SetPathWanted(true);
    const CaseRecord record = RecordOf(row.cells);
    for (int i = 0; i < 2; ++i) {
      model->Score(&record, &result);
      EXPECT_EQ(ShowResult(result), row.result) << row.why;
      EXPECT_EQ(ShowPath(result), row.path) << row.why;
    }
    result.GetEntities().SetPathWanted(false);
    result.GetEntities().SetDecidingIdWanted(true);
    model->Score(&record, &result);
    EXPECT_EQ(ShowResult(result), row.result) << row.why;
    EXPECT_EQ(ShowPath(result), "") << row.why;
  }
}

TEST(TreeModel, NamesNoNodesUnlessTheyAreWanted) {
  const auto model = TwoLevels("none");
  ClsResult result;
  const CaseRecord record = RecordOf({{"z", 1.0}, {"x", 1.0}});
  ASSERT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(ShowResult(result), "blue 1 -");
  EXPECT_EQ(ShowPath(result), "");
}

TEST(TreeModel, ARootThatIsNotTrueIsNoPartOfTheWay) {
  const auto model = BuildClassifier("", Node("id='top' score='red'", Is("g", "a")));
  ClsResult result;
  result.GetEntities().SetPathWanted(true);
  const CaseRecord record = RecordOf({{"g", "b"}});
  model->Score(&record, &result);
  EXPECT_EQ(ShowResult(result), "-");
  EXPECT_EQ(ShowPath(result), "");
}

// ---- Status codes and the policy.

TEST(TreeModel, NoPredictionFollowsThePolicy) {
  const auto model = BuildEstimator("", Node("", "<True/>" + Node("score='1'", Is("g", "a"))));
  const CaseRecord record = RecordOf({{"g", "b"}});
  RegResult result;
  for (const ScoreModel::MVPolicy policy : {ScoreModel::kNullPrediction, ScoreModel::kDefaultPrediction}) {
    model->SetMissingValuePolicy(policy);
    const NumericValue before(1.0);
    result.SetPrediction(&before);
    const MCScore::MCStatus status = model->Score(&record, &result);
    EXPECT_EQ(status.GetErrorCode(), 90027);
    EXPECT_TRUE(status.IsError());
    EXPECT_EQ(result.GetPrediction(), nullptr);
  }
  const_cast<ScoreDictVar*>(model->GetTargetVar())->SetDefValue(new NumericValue(12.5));
  EXPECT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(ShowResult(result), "12.5 -");
  model->SetMissingValuePolicy(ScoreModel::kNullPrediction);
  EXPECT_EQ(model->Score(&record, &result).GetErrorCode(), 90027);
  EXPECT_EQ(result.GetPrediction(), nullptr);
}

TEST(TreeModel, WithoutTargetThereIsNoDefault) {
  const auto model =
      BuildTree(TreeDocument(TreeModelOf("regression", "", TreeSchema(""), Node("score='1'", Is("g", "a")))));
  EXPECT_EQ(model->GetTargetVar(), nullptr);
  EXPECT_EQ(ScoreOf(*model, {}), "90027");
  EXPECT_EQ(ScoreOf(*model, {{"g", "a"}}), "1 #1");
}

TEST(TreeModel, RefusedValuesGiveAnErrorAndNoPrediction) {
  const auto model = BuildClassifier("", kTwoLevels);
  ClsResult result;
  result.GetEntities().SetDecidingIdWanted(true);
  CaseRecord record = RecordOf({{"z", 1.0}, {"x", 1.0}, {"g", "a"}});
  ASSERT_TRUE(model->Score(&record, &result).IsOK());
  record.SetValue("g", std::string("violet"));
  MCScore::MCStatus status = model->Score(&record, &result);
  EXPECT_EQ(status.GetErrorCode(), 90025);
  EXPECT_TRUE(status.IsError());
  EXPECT_EQ(status.GetDiscreteDatum(0), 2);
  EXPECT_EQ(model->GetPredictors()[2]->GetName(), "g");
  EXPECT_EQ(ShowResult(result), "-");
  EXPECT_EQ(result.GetCategoryCount(), 0u);
  EXPECT_EQ(model->Score(nullptr, &result).GetErrorCode(), 90007);
  EXPECT_TRUE(model->Score(nullptr, &result).IsError());
  EXPECT_EQ(model->Score(&record, nullptr).GetErrorCode(), 90007);
  record.SetValue("g", std::string("a"));
  EXPECT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(ShowResult(result), "blue 1 deep");
}

TEST(TreeModel, AResultServesCaseAfterCase) {
  const auto model = TwoLevels("weightedConfidence");
  ClsResult result;
  result.GetEntities().SetDecidingIdWanted(true);
  const CaseRecord leaf = RecordOf({{"z", 1.0}, {"x", 9.0}});
  const CaseRecord fork = RecordOf({{"z", 1.0}});
  const CaseRecord nothing = RecordOf({{"z", 9.0}, {"g", "b"}});
  for (int i = 0; i < 3; ++i) {
    EXPECT_TRUE(model->Score(&leaf, &result).IsOK());
    EXPECT_EQ(ShowResult(result) + ShowCategories(result), "green 1 #4 red=0 green=1 blue=0");
    EXPECT_TRUE(model->Score(&fork, &result).IsOK());
    EXPECT_EQ(ShowResult(result) + ShowCategories(result), "blue 0.75 - red=0 green=0.25 blue=0.75");
    EXPECT_FALSE(model->Score(&nothing, &result).IsOK());
    EXPECT_EQ(ShowResult(result) + ShowCategories(result), "-");
  }
}

// ---- Ways to build one.

TEST(TreeModel, BuildsFromAnElementAndADictionary) {
  const auto tree = kestrel_test::ReadTree(TreeModelOf("classification", "", TreeSchema("m"), kTwoLevels));
  const auto dictionary = kestrel_test::ReadDictionary(TreeDictionary());
  TreeTranslator translator;
  const std::unique_ptr<ScoreModel> model(
      translator.ParseFromTree(tree->GetRoot(), dictionary.get(), dictionary.get(), std::string()));
  EXPECT_NE(model->GetDictionary(), dictionary.get());
  EXPECT_NE(model->GetResultDictionary(), nullptr);
  EXPECT_EQ(ScoreOf(*model, {{"z", 1.0}, {"x", 1.0}}), "blue 1 deep");
}

// The second one reads other fields, in another order, from a dictionary that the first one has used.
TEST(TreeModel, TwoFromOneDictionaryKeepApart) {
  const auto first_tree =
      kestrel_test::ReadTree(TreeModelOf("classification", "", TreeSchema("m"), kTwoLevels));
  const auto second_tree = kestrel_test::ReadTree(TreeModelOf(
      "regression", "", TreeSchema("y"), Children({Is("n", "2"), AtMost("x", "5"), Is("g", "a")})));
  const auto dictionary = kestrel_test::ReadDictionary(TreeDictionary());
  TreeTranslator translator;
  const std::unique_ptr<ScoreModel> first(
      translator.ParseFromTree(first_tree->GetRoot(), dictionary.get(), nullptr, std::string()));
  const std::unique_ptr<ScoreModel> second(translator.ParseFromTree(
      second_tree->GetRoot(), const_cast<ScoreDictionary*>(first->GetDictionary()), nullptr, std::string()));
  for (int i = 0; i < 2; ++i) {
    EXPECT_EQ(ScoreOf(*first, {{"z", 1.0}, {"x", 9.0}}), "green 1 #4");
    EXPECT_EQ(ScoreOf(*second, {{"n", 2.0}}), "1 #2");
    EXPECT_EQ(ScoreOf(*second, {{"n", 1.0}, {"x", 1.0}}), "2 #3");
    EXPECT_EQ(ScoreOf(*second, {{"n", 1.0}, {"x", 9.0}, {"g", "a"}}), "3 #4");
  }
}

TEST(TreeModel, IsLoadedByTheFactory) {
  std::istringstream document(TreeDocument(TreeModelOf("classification", "", TreeSchema("m"), kTwoLevels)));
  const std::unique_ptr<ScoreModel> model(
      ModelFactory::MakeModelFromXML(document, {"TreeModel"}, std::string()));
  ASSERT_NE(model, nullptr);
  EXPECT_EQ(model->GetModelKind(), "TreeModel");
  EXPECT_EQ(ScoreOf(*model, {{"z", 1.0}, {"x", 1.0}}), "blue 1 deep");
}

// The vector has the inputs in the order of the predictors.
TEST(TreeModel, ScoresAFlatVectorLikeARecord) {
  const auto model = BuildClassifier("", kTwoLevels);
  const struct {
    Case cells;
    double values[3];
  } kRows[] = {
      {{{"z", 1.0}, {"x", 1.0}, {"g", "a"}}, {1.0, 1.0, 0.0}},
      {{{"z", 1.0}, {"x", 9.0}}, {1.0, 9.0, -2.0}},
      {{{"z", 9.0}, {"g", "a"}}, {9.0, kSysmis, 0.0}},
      {{{"z", 9.0}, {"g", "c"}}, {9.0, kSysmis, 2.0}},
      {{}, {kSysmis, kSysmis, -2.0}},
  };
  for (const auto& row : kRows) {
    ClsResult by_record, by_vector;
    by_record.GetEntities().SetPathWanted(true);
    by_vector.GetEntities().SetPathWanted(true);
    const CaseRecord record = RecordOf(row.cells);
    const MCScore::MCStatus record_status = model->Score(&record, &by_record);
    const MCScore::MCStatus vector_status = model->ScoreVector(row.values, &by_vector);
    EXPECT_EQ(record_status.GetErrorCode(), vector_status.GetErrorCode());
    EXPECT_EQ(ShowResult(by_record) + ShowPath(by_record), ShowResult(by_vector) + ShowPath(by_vector));
  }
}

}  // namespace
}  // namespace kestrel_tests
