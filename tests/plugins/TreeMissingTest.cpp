// What trees do with cases that they cannot decide: the strategies for missing values, the penalty, and nodes
// none of whose children is true.

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "tests/plugins/TreeText.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

const std::string kNoPrediction = "90027";

struct Strategy {
  const char* name;
  const char* why;
};

constexpr Strategy kStrategies[] = {
    {"none", "it counts as false"},
    {"lastPrediction", "the node above predicts"},
    {"nullPrediction", "no prediction"},
    {"defaultChild", "the child that the node names"},
    {"weightedConfidence", "all that are not false, by their record counts"},
    {"aggregateNodes", "the counts of all leaves that can be reached"},
};

/// Two splits, one below the other. The nodes' own record counts are other weights than their distributions.
std::string BinaryTree() {
  const std::string young = Node("id='young' recordCount='12'", AtMost("z", "5") + Counts("4", "0", "0"));
  const std::string old = Node("id='old' recordCount='4'", Above("z", "5") + Counts("1", "3", "0"));
  const std::string low = Node("id='low' recordCount='8' defaultChild='old'",
                               AtMost("x", "5") + Counts("5", "3", "0") + young + old);
  const std::string high = Node("id='high' recordCount='8'", Above("x", "5") + Counts("2", "2", "4"));
  return Node("id='top' defaultChild='high'", "<True/>" + Counts("7", "5", "4") + low + high);
}

/// Three children, of which the last takes what is left.
std::string WideTree() {
  return Node("id='top' defaultChild='b'",
              "<True/>" + Counts("5", "8", "3") +
                  Node("id='a' recordCount='4'", Is("g", "a") + Counts("4", "0", "0")) +
                  Node("id='b' recordCount='8'", AtMost("x", "5") + Counts("0", "8", "0")) +
                  Node("id='c' recordCount='8'", "<True/>" + Counts("1", "0", "3")));
}

/// A child that is always true stands before the one that may be undecided.
std::string TrueFirstTree() {
  return Node("id='top' defaultChild='b'",
              "<True/>" + Counts("1", "1", "2") +
                  Node("id='a' recordCount='1'", "<True/>" + Counts("1", "0", "0")) +
                  Node("id='b' recordCount='1'", AtMost("x", "5") + Counts("0", "1", "0")));
}

struct StrategyRow {
  const char* why;
  std::string tree;
  Case cells;
  std::string want[6];  ///< by kStrategies
};

std::vector<StrategyRow> StrategyRows() {
  const std::string sure = "red 1 young";
  return {
      {"nothing is missing", BinaryTree(), {{"x", 1.0}, {"z", 1.0}}, {sure, sure, sure, sure, sure, sure}},
      {"at the root's children",
       BinaryTree(),
       {{"z", 1.0}},
       {kNoPrediction, "red 0.4375 top", kNoPrediction, "blue 0.5 high", "red 0.625 -", "red 0.5 -"}},
      {"one level deeper",
       BinaryTree(),
       {{"x", 1.0}},
       {kNoPrediction, "red 0.625 low", kNoPrediction, "green 0.75 old", "red 0.8125 -", "red 0.625 -"}},
      {"at both levels",
       BinaryTree(),
       {},
       {kNoPrediction, "red 0.4375 top", kNoPrediction, "blue 0.5 high", "red 0.53125 -", "red 0.4375 -"}},
      {"a field that the way does not ask for",
       BinaryTree(),
       {{"x", 9.0}},
       {"blue 0.5 high", "blue 0.5 high", "blue 0.5 high", "blue 0.5 high", "blue 0.5 high",
        "blue 0.5 high"}},
      {"a true child before the undecided one",
       WideTree(),
       {{"g", "a"}},
       {"red 1 a", "red 1 a", "red 1 a", "red 1 a", "red 1 a", "red 1 a"}},
      {"a child that is always true before it",
       TrueFirstTree(),
       {},
       {"red 1 a", "red 1 a", "red 1 a", "red 1 a", "red 1 a", "red 1 a"}},
      {"a true child behind the undecided one",
       WideTree(),
       {{"g", "b"}},
       {"blue 0.75 c", "green 0.5 top", kNoPrediction, "green 1 b", "green 0.5 -",
        "green 0.6666666666666666 -"}},
      {"two true children behind it",
       WideTree(),
       {{"x", 1.0}},
       {"green 1 b", "green 0.5 top", kNoPrediction, "green 1 b", "green 0.4 -", "green 0.5 -"}},
      {"a false child between the two; equal votes go to the target's first category",
       WideTree(),
       {{"x", 9.0}},
       {"blue 0.75 c", "green 0.5 top", kNoPrediction, "green 1 b", "red 0.5 -", "red 0.625 -"}},
      {"several undecided ones and a true one",
       WideTree(),
       {},
       {"blue 0.75 c", "green 0.5 top", kNoPrediction, "green 1 b", "green 0.4 -", "green 0.5 -"}},
  };
}

TEST(TreeMissing, EachStrategyHasItsWay) {
  for (const StrategyRow& row : StrategyRows()) {
    for (size_t i = 0; i < std::size(kStrategies); ++i) {
      const auto model = BuildClassifier(
          std::string("missingValueStrategy='") + kStrategies[i].name + "' missingValuePenalty='1'",
          row.tree);
      EXPECT_EQ(ScoreOf(*model, row.cells), row.want[i])
          << row.why << ", " << kStrategies[i].name << ": " << kStrategies[i].why;
    }
  }
}

TEST(TreeMissing, TheStrategyIsNoneWhenItIsNotGiven) {
  const auto model = BuildClassifier("", WideTree());
  EXPECT_EQ(ScoreOf(*model, {{"g", "b"}}), "blue 0.75 c");
}

TEST(TreeMissing, CategoriesOfJoinedNodesAreTheJoinedOnes) {
  const struct {
    const char* strategy;
    const char* want;
  } kRows[] = {{"weightedConfidence", " red=0.125 green=0.5 blue=0.375"},
               {"aggregateNodes", " red=0.08333333333333333 green=0.6666666666666666 blue=0.25"}};
  for (const auto& row : kRows) {
    const auto model =
        BuildClassifier(std::string("missingValueStrategy='") + row.strategy + "'", WideTree());
    ClsResult result;
    const CaseRecord record = RecordOf({{"g", "b"}});
    ASSERT_TRUE(model->Score(&record, &result).IsOK()) << row.strategy;
    EXPECT_EQ(ShowCategories(result), row.want);
  }
}

// ---- Joined predictions: which nodes have a say, and what it weighs.

struct JoinedRow {
  const char* why;
  const char* attributes;
  std::string children;
  Case cells;
  const char* want;
};

/// Below a root, two children on g of which the first has a child of its own on z.
std::string Unfinished(const std::string& a_records, const std::string& b_records) {
  return Node("id='a' recordCount='" + a_records + "'",
              Is("g", "a") + Counts("3", "1", "0") +
                  Node("id='a1' recordCount='2'", AtMost("z", "5") + Counts("2", "0", "0"))) +
         Node("id='b' recordCount='" + b_records + "'", Is("g", "b") + Counts("0", "1", "3"));
}

const JoinedRow kJoinedRows[] = {
    {"a branch that ends without prediction has no weight",
     "missingValueStrategy='weightedConfidence'",
     Unfinished("4", "8"),
     {{"z", 9.0}},
     "blue 0.75 -"},
    {"it has one when its last node predicts",
     "missingValueStrategy='weightedConfidence' noTrueChildStrategy='returnLastPrediction'",
     Unfinished("24", "8"),
     {{"z", 9.0}},
     "red 0.5625 -"},
    {"a branch that ends without prediction has no records",
     "missingValueStrategy='aggregateNodes'",
     Unfinished("4", "8"),
     {{"z", 9.0}},
     "blue 0.75 -"},
    {"it has them when its last node predicts",
     "missingValueStrategy='aggregateNodes' noTrueChildStrategy='returnLastPrediction'",
     Unfinished("4", "8"),
     {{"z", 9.0}},
     "red 0.375 -"},
    {"weights of nothing make no prediction",
     "missingValueStrategy='weightedConfidence'",
     Unfinished("0", "0"),
     {{"z", 1.0}},
     "90027"},
    {"neither do leaves without records",
     "missingValueStrategy='aggregateNodes'",
     Node("id='a' recordCount='1'", Is("g", "a") + Counts("0", "0", "0")) +
         Node("id='b' recordCount='1'", Is("g", "b") + Counts("0", "0", "0")),
     {},
     "90027"},
    {"no branch predicts",
     "missingValueStrategy='weightedConfidence'",
     Node("id='a' recordCount='1'", Is("g", "a") + Node("recordCount='1' score='red'", AtMost("z", "5"))) +
         Node("id='b' recordCount='1'", Is("g", "b") + Node("recordCount='1' score='red'", AtMost("z", "5"))),
     {{"z", 9.0}},
     "90027"},
    {"confidences are what is weighed",
     "missingValueStrategy='weightedConfidence'",
     Node("recordCount='1'", Is("g", "a") + Count("red", "1", "confidence='0.25'")) +
         Node("recordCount='1'", Is("g", "b") + Count("green", "1", "confidence='0.5'")),
     {},
     "green 0.25 -"},
    {"a score without distribution is sure",
     "missingValueStrategy='weightedConfidence'",
     Node("recordCount='1' score='blue'", Is("g", "a")) +
         Node("recordCount='3'", Is("g", "b") + Counts("3", "1", "0")),
     {},
     "red 0.5625 -"},
    {"a distribution's sum stands in for the node's record count",
     "missingValueStrategy='weightedConfidence'",
     Node("", Is("g", "a") + Counts("3", "0", "0")) + Node("", Is("g", "b") + Counts("0", "0", "1")),
     {},
     "red 0.75 -"},
    {"the default child counts only in the strategy of that name",
     "missingValueStrategy='weightedConfidence' missingValuePenalty='0.5'",
     Unfinished("4", "4"),
     {{"z", 1.0}},
     "red 0.5 -"},
};

TEST(TreeMissing, JoinsWhatCanBeReached) {
  for (const JoinedRow& row : kJoinedRows) {
    const auto model = BuildClassifier(row.attributes, Node("id='top'", "<True/>" + row.children));
    EXPECT_EQ(ScoreOf(*model, row.cells), row.want) << row.why;
  }
}

TEST(TreeMissing, JoinedNumbersAreWeightedMeans) {
  const std::string leaves =
      Node("score='10' recordCount='1'", Is("g", "a")) +
      Node("score='30' recordCount='3'", Is("g", "b") + Node("score='20' recordCount='2'", AtMost("z", "5")) +
                                             Node("score='50' recordCount='6'", Above("z", "5")));
  const struct {
    const char* why;
    const char* strategy;
    Case cells;
    const char* want;
  } kRows[] = {
      {"the child's weight, the grandchild's number", "weightedConfidence", {{"z", 1.0}}, "17.5 -"},
      {"a mean within a mean", "weightedConfidence", {}, "34.375 -"},  // (10 + 3 * (40 + 300) / 8) / 4
      {"the leaf's weight and number", "aggregateNodes", {{"z", 1.0}}, "16.666666666666668 -"},
      {"all leaves", "aggregateNodes", {}, "38.888888888888886 -"},  // (10 + 40 + 300) / 9
  };
  for (const auto& row : kRows) {
    const auto model = BuildEstimator(std::string("missingValueStrategy='") + row.strategy + "'",
                                      Node("", "<True/>" + leaves));
    EXPECT_EQ(ScoreOf(*model, row.cells), row.want) << row.why;
  }
}

TEST(TreeMissing, ANodeWithoutScoreHasNoPartInAMean) {
  const std::string tree = Node(
      "", "<True/>" + Node("score='10' recordCount='1'", Is("g", "a")) +
              Node("recordCount='3'", Is("g", "b") + Node("score='20' recordCount='2'", AtMost("z", "5"))));
  for (const char* strategy : {"weightedConfidence", "aggregateNodes"}) {
    const auto model = BuildEstimator(
        std::string("missingValueStrategy='") + strategy + "' noTrueChildStrategy='returnLastPrediction'",
        tree);
    EXPECT_EQ(ScoreOf(*model, {{"z", 9.0}}), "10 -") << strategy;
    EXPECT_EQ(ScoreOf(*model, {{"g", "b"}, {"z", 9.0}}), "90027") << strategy;
  }
}

TEST(TreeMissing, JoinedNumbersThatNoNumberHoldsAreNone) {
  const struct {
    const char* why;
    const char* strategy;
    const char* leaf;  ///< the attributes of each of two
    const char* want;
  } kRows[] = {
      {"record counts whose sum is too large", "weightedConfidence", "score='1' recordCount='1e308'",
       "90027"},
      {"the same, added up", "aggregateNodes", "score='1' recordCount='1e308'", "90027"},
      {"a product that is too large", "aggregateNodes", "score='1e200' recordCount='1e200'", "90027"},
      {"a mean needs no such product", "weightedConfidence", "score='1e200' recordCount='1e200'", "1e+200 -"},
  };
  for (const auto& row : kRows) {
    const auto model =
        BuildEstimator(std::string("missingValueStrategy='") + row.strategy + "'",
                       Node("", "<True/>" + Node(row.leaf, Is("g", "a")) + Node(row.leaf, Is("g", "b"))));
    EXPECT_EQ(ScoreOf(*model, {}), row.want) << row.why;
  }
}

TEST(TreeMissing, ABranchOfSuchCountsHasNoPart) {
  const std::string large = "score='1' recordCount='1e308'";
  const auto model =
      BuildEstimator("missingValueStrategy='weightedConfidence'",
                     Node("", "<True/>" +
                                  Node("recordCount='1'", Is("g", "a") + Node(large, AtMost("z", "5")) +
                                                              Node(large, Above("z", "5"))) +
                                  Node("recordCount='1' score='5'", Is("g", "b"))));
  EXPECT_EQ(ScoreOf(*model, {}), "5 -");
  EXPECT_EQ(ScoreOf(*model, {{"z", 1.0}}), "3 -");
}

// ---- The penalty.

/// A split on x with z standing in for it.
std::string BySurrogate(const std::string& operator_text) {
  return Compound("surrogate", Simple("x", operator_text, "5") + Simple("z", operator_text, "5"));
}

struct PenaltyRow {
  const char* why;
  const char* attributes;
  std::string tree;
  Case cells;
  const char* want;
};

/// Two levels that x decides, or z in its place. Below the low side it is asked whether r is below the
/// middle.
std::string SurrogateTree() {
  return Node("id='top' defaultChild='high'",
              "<True/>" +
                  Node("id='low' defaultChild='deep'",
                       BySurrogate("lessOrEqual") +
                           Node("id='deep'", BySurrogate("lessThan") + Counts("3", "1", "0")) +
                           Node("id='flat'", BySurrogate("greaterOrEqual") + Counts("1", "3", "0"))) +
                  Node("id='high'", BySurrogate("greaterThan") + Counts("0", "1", "3")));
}

const PenaltyRow kPenaltyRows[] = {
    {"nothing is missing", "", SurrogateTree(), {{"x", 1.0}, {"z", 9.0}}, "red 0.75 deep"},
    {"one surrogate", "", SurrogateTree(), {{"z", 9.0}}, "blue 0.375 high"},
    {"a surrogate at each of two levels", "", SurrogateTree(), {{"z", 1.0}}, "red 0.1875 deep"},
    {"one default child", "missingValueStrategy='defaultChild'", SurrogateTree(), {}, "blue 0.375 high"},
    {"a default child at each of two levels",
     "missingValueStrategy='defaultChild'",
     Node("defaultChild='low'",
          "<True/>" +
              Node("id='low' defaultChild='deep'",
                   AtMost("x", "5") + Node("id='deep'", Is("g", "a") + Counts("3", "1", "0"))) +
              Node("id='high' score='blue'", Above("x", "5"))),
     {},
     "red 0.1875 deep"},
    {"a surrogate and then a default child",
     "missingValueStrategy='defaultChild'",
     Node("defaultChild='low'",
          "<True/>" +
              Node("id='low' defaultChild='deep'",
                   BySurrogate("lessOrEqual") + Node("id='deep'", Is("g", "a") + Counts("3", "1", "0")))),
     {{"z", 1.0}},
     "red 0.1875 deep"},
    {"a default child that is true by itself",
     "missingValueStrategy='defaultChild'",
     Node("defaultChild='b'", "<True/>" + Node("id='a' score='red'", Is("g", "a")) +
                                  Node("id='b'", "<True/>" + Counts("0", "1", "3"))),
     {},
     "blue 0.375 b"},
    {"a surrogate of the root",
     "",
     Node("id='top'", BySurrogate("lessThan") + Counts("3", "1", "0")),
     {{"z", 1.0}},
     "red 0.375 top"},
    {"the last prediction costs nothing",
     "missingValueStrategy='lastPrediction'",
     Node("id='top'", "<True/>" + Counts("3", "1", "0") + Node("score='red'", Is("g", "a"))),
     {},
     "red 0.75 top"},
    {"what counts as false costs nothing",
     "",
     Node("",
          "<True/>" + Node("score='red'", Is("g", "a")) + Node("id='b'", "<True/>" + Counts("0", "1", "3"))),
     {},
     "blue 0.75 b"},
    {"a surrogate that is false costs nothing",
     "",
     Node("", "<True/>" + Node("score='red'", BySurrogate("lessThan")) +
                  Node("id='b'", "<True/>" + Counts("0", "1", "3"))),
     {{"z", 9.0}},
     "blue 0.75 b"},
    {"a surrogate inside an and is no surrogate of the node",
     "",
     Node("", "<True/>" + Node("id='a'", Compound("and", BySurrogate("lessThan") + Is("g", "a")) +
                                             Counts("3", "1", "0"))),
     {{"z", 1.0}, {"g", "a"}},
     "red 0.75 a"},
    {"a surrogate's confidence is what is lowered",
     "",
     Node("id='top'", BySurrogate("lessThan") + Count("red", "1", "confidence='0.25'")),
     {{"z", 1.0}},
     "red 0.125 top"},
    {"joined votes are lowered by what came before them",
     "missingValueStrategy='aggregateNodes'",
     Node("", BySurrogate("lessThan") + Node("", Is("g", "a") + Counts("3", "0", "0")) +
                  Node("", Is("g", "b") + Counts("0", "1", "0"))),
     {{"z", 1.0}},
     "red 0.375 -"},
    {"and not by what is on their branches",
     "missingValueStrategy='aggregateNodes'",
     Node("", "<True/>" + Node("", Is("g", "a") + Node("", BySurrogate("lessThan") + Counts("3", "0", "0"))) +
                  Node("", Is("g", "b") + Counts("0", "1", "0"))),
     {{"z", 1.0}},
     "red 0.75 -"},
};

TEST(TreeMissing, ThePenaltyIsTakenForEachSubstitution) {
  for (const PenaltyRow& row : kPenaltyRows) {
    const auto model = BuildClassifier(std::string("missingValuePenalty='0.5' ") + row.attributes, row.tree);
    EXPECT_EQ(ScoreOf(*model, row.cells), row.want) << row.why;
  }
}

TEST(TreeMissing, ThePenaltyLeavesTheCategoriesAlone) {
  const auto model = BuildClassifier("missingValuePenalty='0.5'", SurrogateTree());
  ClsResult result;
  const CaseRecord record = RecordOf({{"z", 1.0}});
  ASSERT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(ShowResult(result), "red 0.1875 -");
  EXPECT_EQ(ShowCategories(result), " red=0.75 green=0.25 blue=0");
}

TEST(TreeMissing, ThePenaltyMayTakeAll) {
  const auto model = BuildClassifier("missingValuePenalty='0'", SurrogateTree());
  EXPECT_EQ(ScoreOf(*model, {{"x", 1.0}}), "red 0.75 deep");
  EXPECT_EQ(ScoreOf(*model, {{"z", 1.0}}), "red 0 deep");
}

// ---- No child is true.

struct NoTrueChildRow {
  const char* why;
  std::string tree;
  Case cells;
  const char* last;  ///< with returnLastPrediction; without, there is no prediction
};

const NoTrueChildRow kNoTrueChildRows[] = {
    {"of two children, none is true",
     Node("id='top' score='red'",
          "<True/>" + Node("score='green'", AtMost("x", "1")) + Node("score='green'", Above("x", "5"))),
     {{"x", 3.0}},
     "red 1 top"},
    {"of several, none is true",
     Node("id='top' score='red'", "<True/>" + Node("score='green'", Is("x", "1")) +
                                      Node("score='green'", Is("x", "2")) +
                                      Node("score='green'", Is("x", "3"))),
     {{"x", 4.0}},
     "red 1 top"},
    {"the only one is not true",
     Node("id='top' score='red'", "<True/>" + Node("score='green'", Is("g", "a"))),
     {{"g", "b"}},
     "red 1 top"},
    {"further down",
     Node("id='top' score='red'",
          "<True/>" + Node("id='low' score='blue'", AtMost("x", "5") + Node("score='green'", Is("g", "a"))) +
              Node("score='green'", Above("x", "5"))),
     {{"x", 1.0}, {"g", "b"}},
     "blue 1 low"},
    {"a node without a score predicts nothing either",
     Node("id='top' score='red'",
          "<True/>" + Node("id='low'", AtMost("x", "5") + Node("score='green'", Is("g", "a")))),
     {{"x", 1.0}, {"g", "b"}},
     "90027"},
    {"what is not decided counts as false",
     Node("id='top' score='red'",
          "<True/>" + Node("score='green'", Is("g", "a")) + Node("score='green'", AtMost("x", "5"))),
     {},
     "red 1 top"},
    {"a distribution is a score",
     Node("id='top'", "<True/>" + Counts("1", "3", "0") + Node("score='green'", Is("g", "a"))),
     {{"g", "b"}},
     "green 0.75 top"},
};

TEST(TreeMissing, NoTrueChildGivesTheLastPredictionOrNone) {
  for (const NoTrueChildRow& row : kNoTrueChildRows) {
    for (const char* attributes : {"", "noTrueChildStrategy='returnNullPrediction'"}) {
      EXPECT_EQ(ScoreOf(*BuildClassifier(attributes, row.tree), row.cells), kNoPrediction) << row.why;
    }
    const auto model = BuildClassifier("noTrueChildStrategy='returnLastPrediction'", row.tree);
    EXPECT_EQ(ScoreOf(*model, row.cells), row.last) << row.why;
  }
}

TEST(TreeMissing, LastPredictionOfANodeWithoutScoreIsNone) {
  const std::string tree = Node("", "<True/>" + Node("score='red'", Is("g", "a")));
  EXPECT_EQ(ScoreOf(*BuildClassifier("missingValueStrategy='lastPrediction'", tree), {}), kNoPrediction);
  const std::string numbers = Node("", "<True/>" + Node("score='1'", Is("g", "a")));
  EXPECT_EQ(ScoreOf(*BuildEstimator("missingValueStrategy='lastPrediction'", numbers), {}), kNoPrediction);
}

// ---- The root, which is nobody's child.

struct RootRow {
  const char* why;
  std::string predicate;
  Case cells;
  const char* want;
};

const RootRow kRootRows[] = {
    {"true", Is("g", "a"), {{"g", "a"}}, "red 1 top"},
    {"false", Is("g", "a"), {{"g", "b"}}, "90027"},
    {"always false", "<False/>", {}, "90027"},
    {"not decided", Is("g", "a"), {}, "90027"},
    {"a compound of nothing", "<CompoundPredicate booleanOperator='xor'/>", {}, "90027"},
    {"true by a surrogate", BySurrogate("lessThan"), {{"z", 1.0}}, "red 1 top"},
    {"false by a surrogate", BySurrogate("lessThan"), {{"z", 9.0}}, "90027"},
};

TEST(TreeMissing, TheRootIsTrueOrThereIsNoPrediction) {
  for (const RootRow& row : kRootRows) {
    for (const Strategy& strategy : kStrategies) {
      const std::string distribution =
          strategy.name == std::string("aggregateNodes") ? Counts("1", "0", "0") : "";
      const auto model = BuildClassifier(std::string("missingValueStrategy='") + strategy.name +
                                             "' noTrueChildStrategy='returnLastPrediction'",
                                         Node("id='top' score='red'", row.predicate + distribution));
      EXPECT_EQ(ScoreOf(*model, row.cells), row.want) << row.why << ", " << strategy.name;
    }
  }
}

TEST(TreeMissing, ACompoundOfNothingIsNeverDecided) {
  for (const char* boolean_operator : {"or", "and", "xor", "surrogate"}) {
    const std::string tree =
        Node("id='top' score='red' defaultChild='b'",
             "<True/>" + Node("id='a' score='green'", Compound(boolean_operator, "<Extension/>")) +
                 Node("id='b' score='blue'", "<True/>"));
    EXPECT_EQ(ScoreOf(*BuildClassifier("", tree), {}), "blue 1 b") << boolean_operator;
    EXPECT_EQ(ScoreOf(*BuildClassifier("missingValueStrategy='lastPrediction'", tree), {}), "red 1 top")
        << boolean_operator;
    EXPECT_EQ(ScoreOf(*BuildClassifier("missingValueStrategy='nullPrediction'", tree), {}), kNoPrediction)
        << boolean_operator;
    EXPECT_EQ(ScoreOf(*BuildClassifier("missingValueStrategy='defaultChild'", tree), {}), "blue 1 b")
        << boolean_operator;
  }
}

}  // namespace
}  // namespace kestrel_tests
