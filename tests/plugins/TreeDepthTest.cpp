// Trees as deep as a document can be: read, scored and destroyed on stacks that hosts give to threads; and
// how often a case comes to a node.

#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <string>
#include <vector>

#include "tests/plugins/TreeText.h"
#include "tests/support/ExpectFault.h"
#include "tests/support/SmallStack.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

constexpr size_t kMegabyte = 1 << 20;
/// Elements inside one another that a document may have; a Node stands in TreeModel in PMML and holds its
/// predicate.
constexpr int kElements = 512;
constexpr int kNodes = kElements - 3;

/// A compound stands in a Node in a Node; the innermost holds simple ones.
constexpr int kCompounds = kElements - 5;

constexpr const char* kStrategies[] = {"none",         "lastPrediction",     "nullPrediction",
                                       "defaultChild", "weightedConfidence", "aggregateNodes"};

/// So many nodes one inside the other, each but the first with a leaf beside it. What is not above 0 goes
/// down, and down again.
std::string Chain(int nodes) {
  const std::string distribution = Counts("1", "3", "0");
  std::string open, close;
  for (int i = 1; i < nodes; ++i) {
    const std::string child = i + 1 < nodes ? " defaultChild='n" + std::to_string(i + 1) + "'" : "";
    open += "<Node id='n" + std::to_string(i) + "' recordCount='2'" + child + ">" + AtMost("x", "0") +
            distribution;
    close = "</Node><Node recordCount='1'>" + Above("x", "0") + Counts("1", "0", "0") + "</Node>" + close;
  }
  return Node("id='n0' defaultChild='n1'", "<True/>" + distribution + open + close);
}

/// Forks at every level, with leaves at the end.
std::string FullTree(int levels, const std::string& predicate) {
  const std::string counts = Counts("1", "0", "0");
  if (levels == 1) return Node("recordCount='1'", predicate + counts);
  return Node("recordCount='1'", predicate + counts + FullTree(levels - 1, AtMost("x", "0")) +
                                     FullTree(levels - 1, Above("x", "0")));
}

/// A node whose predicate is compounds inside compounds, as many as there may be.
std::string DeepPredicate(const std::string& boolean_operator, int compounds) {
  std::string predicate = AtMost("x", "0");
  for (int i = 0; i < compounds; ++i)
    predicate = Compound(boolean_operator, AtMost("z", "0") + predicate);
  return Node("score='red'", "<True/>" + Node("score='green'", predicate) + Node("score='blue'", "<True/>"));
}

TEST(TreeDepth, TheDeepestTreeFitsEveryStack) {
  const std::string tree = Chain(kNodes);
  for (const size_t stack : {8 * kMegabyte, kMegabyte}) {
    kestrel_test::RunOnStack(stack, [&] {
      for (const char* strategy : kStrategies) {
        const auto model = BuildClassifier(std::string("missingValueStrategy='") + strategy + "'", tree);
        EXPECT_EQ(model->GetTree().table.GetDepth(), kNodes);
        EXPECT_EQ(ScoreOf(*model, {{"x", -1.0}}), "green 0.75 n" + std::to_string(kNodes - 1)) << strategy;
        const std::string missing = ScoreOf(*model, {});
        EXPECT_EQ(missing == "90027",
                  strategy == std::string("none") || strategy == std::string("nullPrediction"))
            << strategy << ": " << missing;
      }
    });
  }
}

TEST(TreeDepth, OneLevelMoreIsRefused) {
  kestrel_test::RunOnStack(kMegabyte, [] {
    ExpectFault([] { BuildClassifier("", Chain(kNodes + 1)); }, 6, "Invalid XML file!!");
  });
}

struct DeepRow {
  const char* boolean_operator;
  Cell z;  ///< leaves the answer to the innermost predicate
};

const DeepRow kDeepRows[] = {{"or", 1.0}, {"and", -1.0}, {"xor", 1.0}, {"surrogate", {}}};

TEST(TreeDepth, TheDeepestPredicateFitsEveryStack) {
  for (const size_t stack : {8 * kMegabyte, kMegabyte}) {
    kestrel_test::RunOnStack(stack, [&] {
      for (const DeepRow& row : kDeepRows) {
        const auto model = BuildClassifier("", DeepPredicate(row.boolean_operator, kCompounds));
        EXPECT_EQ(ScoreOf(*model, {{"x", -1.0}, {"z", row.z}}), "green 1 #2") << row.boolean_operator;
        EXPECT_EQ(ScoreOf(*model, {{"x", 1.0}, {"z", row.z}}), "blue 1 #3") << row.boolean_operator;
        EXPECT_EQ(ScoreOf(*model, {}), "blue 1 #3") << row.boolean_operator;
      }
      ExpectFault([] { BuildClassifier("", DeepPredicate("or", kCompounds + 1)); }, 6, "Invalid XML file!!");
    });
  }
}

/// The path of a case without values, which is all of the tree's nodes when every test is undecided.
std::vector<std::string> PathThrough(TreeModel& model) {
  ClsResult result;
  result.GetEntities().SetPathWanted(true);
  const CaseRecord record = RecordOf({});
  EXPECT_TRUE(model.Score(&record, &result).IsOK());
  std::vector<std::string> path;
  for (size_t i = 0; i < result.GetEntities().GetPathLength(); ++i)
    path.push_back(result.GetEntities().GetPathId(i));
  return path;
}

TEST(TreeDepth, NoNodeIsVisitedTwice) {
  const struct {
    const char* why;
    std::string tree;
    size_t nodes;
  } kRows[] = {{"a chain of forks", Chain(kNodes), 2 * kNodes - 1},
               {"forks below forks", FullTree(11, "<True/>"), (1 << 11) - 1}};
  for (const auto& row : kRows) {
    for (const char* strategy : {"weightedConfidence", "aggregateNodes"}) {
      const auto model = BuildClassifier(std::string("missingValueStrategy='") + strategy + "'", row.tree);
      std::vector<std::string> path = PathThrough(*model);
      EXPECT_EQ(path.size(), row.nodes) << row.why << ", " << strategy;
      std::sort(path.begin(), path.end());
      EXPECT_EQ(std::unique(path.begin(), path.end()), path.end()) << row.why << ", " << strategy;
    }
  }
}

}  // namespace
}  // namespace kestrel_tests
