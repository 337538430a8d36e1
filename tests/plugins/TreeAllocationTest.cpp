// Shows that scoring by a tree allocates nothing after the first cases. A program of its own, because it
// counts every allocation of the process.

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "tests/plugins/TreeText.h"
#include "tests/support/AllocationCount.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

/// Too long to be kept in a text object itself.
const std::string kLongId = "an identifier that is too long to be kept in place: ";

/// A compound of so many parts, of which the last decides.
std::string Long(const std::string& boolean_operator, int parts, const std::string& last) {
  const bool is_surrogate = boolean_operator == "surrogate";
  const std::string part = boolean_operator == "and" ? Above("z", "-100") : Above("z", "100");
  std::string inside;
  for (int i = 1; i < parts; ++i)
    inside += is_surrogate ? "<SimplePredicate field='d' operator='lessThan' value='0'/>" : part;
  return Compound(boolean_operator, inside + last);
}

std::string Tree(bool is_regression) {
  const auto node = [is_regression](const std::string& id, const std::string& more,
                                    const std::string& inside) {
    const std::string score = is_regression ? "score='2.5'" : "";
    return Node("id='" + kLongId + id + "' recordCount='3' " + score + more,
                inside + (is_regression ? "" : Counts("1", "2", "3")));
  };
  const auto default_child = [](const std::string& id) { return " defaultChild='" + kLongId + id + "'"; };
  return node("top", default_child("c"),
              "<True/>" +
                  node("a", default_child("a2"),
                       Compound("and", AtMost("x", "5") + Long("or", 64, Is("g", "a"))) +
                           node("a1", "", Long("xor", 64, AtMost("x", "1"))) +
                           node("a2", "", Long("surrogate", 64, Above("x", "1")))) +
                  node("b", "", Long("and", 64, Is("n", "2"))) +
                  node("c", "", Simple("o", "greaterThan", "low")));
}

std::vector<CaseRecord> Records() {
  const double missing = NumericValue::gSysmisValue;
  const std::string text = "a text that is too long to be kept in place";
  std::vector<CaseRecord> records;
  for (const Case& cells : std::vector<Case>{
           {{"x", 1.0}, {"z", 2.0}, {"n", 3.0}, {"g", "a"}, {"o", "mid"}, {"d", 100.0}},
           {{"x", 3.0}, {"z", 2.0}, {"n", 3.0}, {"g", "a"}, {"o", "mid"}, {"d", missing}},
           {{"g", "b "}, {"x", 9.0}, {"z", missing}, {"n", 2.0}, {"o", "high"}},
           {{"x", missing}, {"z", missing}, {"n", {}}, {"g", {}}, {"o", {}}, {"d", {}}},
           {{"x", 3.0}, {"z", missing}, {"n", 1.0}, {"g", "a"}, {"o", "low"}, {"d", {}}},
           {{"x", 3.0}, {"z", 2.0}, {"n", 1.0}, {"g", text}, {"o", "low"}, {"d", {}}},
       })
    records.push_back(RecordOf(cells));
  return records;
}

constexpr const char* kStrategies[] = {"none",         "lastPrediction",     "nullPrediction",
                                       "defaultChild", "weightedConfidence", "aggregateNodes"};

TEST(TreeAllocation, NoneAfterTheFirstCases) {
  const std::vector<CaseRecord> records = Records();
  for (const char* strategy : kStrategies) {
    for (const bool is_regression : {false, true}) {
      const std::string attributes = std::string("missingValueStrategy='") + strategy +
                                     "' missingValuePenalty='0.5' noTrueChildStrategy='returnLastPrediction'";
      const auto model =
          is_regression ? BuildEstimator(attributes, Tree(true)) : BuildClassifier(attributes, Tree(false));
      for (const bool has_path : {false, true}) {
        const auto result = MakeResultOf(*model);
        ResultEntities::Of(result.get())->SetPathWanted(has_path);
        int scored = 0;
        for (const CaseRecord& record : records)
          model->Score(&record, result.get());
        const size_t before = CountAllocations();
        for (int i = 0; i < 100; ++i) {
          for (const CaseRecord& record : records)
            scored += model->Score(&record, result.get()).IsOK() ? 1 : 0;
        }
        EXPECT_EQ(CountAllocations(), before) << strategy << ' ' << is_regression << ' ' << has_path;
        EXPECT_GE(scored, 200) << strategy;
      }
    }
  }
}

// Each case is another way through the tree; what the first ones leave is room enough for all.
TEST(TreeAllocation, NoneForAFlatVector) {
  const auto model = BuildClassifier("missingValueStrategy='weightedConfidence'", Tree(false));
  std::vector<double> missing;
  for (const ScoreDictVar* variable : model->GetPredictors())
    missing.push_back(variable->GetMLevel() == ScoreDictVar::kContinuous ? NumericValue::gSysmisValue : -2.0);
  const auto result = MakeResultOf(*model);
  std::vector<double> values(missing.size());
  // One that several nodes predict and one that a node does.
  ASSERT_TRUE(model->ScoreVector(missing.data(), result.get()).IsOK());
  ASSERT_TRUE(model->ScoreVector(values.data(), result.get()).IsOK());
  const size_t before = CountAllocations();
  int scored = 0;
  for (unsigned present = 0; present < 1u << missing.size(); ++present) {
    for (size_t i = 0; i < missing.size(); ++i)
      values[i] = (present >> i & 1) != 0 ? 0.0 : missing[i];
    scored += model->ScoreVector(values.data(), result.get()).IsOK() ? 1 : 0;
  }
  EXPECT_EQ(CountAllocations(), before);
  EXPECT_GT(scored, 10);
}

}  // namespace
}  // namespace kestrel_tests
