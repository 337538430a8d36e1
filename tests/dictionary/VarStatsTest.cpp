#include "kestrel/dictionary/VarStats.h"

#include <gtest/gtest.h>

#include <limits>
#include <memory>

#include "tests/dictionary/TestValues.h"

namespace MCKestrel_800 {
namespace {

TEST(VarStats, StartsWithTheWidestLimits) {
  const VarStats stats;
  EXPECT_EQ(stats.GetMin(), -1.7976931348623157e308);
  EXPECT_EQ(stats.GetMax(), std::numeric_limits<double>::max());
  EXPECT_EQ(stats.GetMean(), 0.0);
  EXPECT_EQ(stats.GetStddev(), 1.0);
  EXPECT_EQ(stats.GetMissingReplacement(), nullptr);
}

TEST(VarStats, HoldsWhatItIsGiven) {
  VarStats stats(1, 2, 3, 4);
  EXPECT_EQ(stats.GetMin(), 1);
  EXPECT_EQ(stats.GetMax(), 2);
  EXPECT_EQ(stats.GetMean(), 3);
  EXPECT_EQ(stats.GetStddev(), 4);
  stats.SetMin(10);
  stats.SetMax(20);
  stats.SetMean(30);
  stats.SetStddev(40);
  EXPECT_EQ(stats.GetMin(), 10);
  EXPECT_EQ(stats.GetMax(), 20);
  EXPECT_EQ(stats.GetMean(), 30);
  EXPECT_EQ(stats.GetStddev(), 40);
}

TEST(VarStats, KeepsACloneOfTheReplacement) {
  VarStats stats;
  NumericValue value(5);
  stats.SetMissingReplacement(&value);
  value.SetDoubleValue(6);
  ASSERT_NE(stats.GetMissingReplacement(), nullptr);
  EXPECT_EQ(stats.GetMissingReplacement()->GetDouble(), 5);
  stats.SetMissingReplacement(stats.GetMissingReplacement());
  EXPECT_EQ(stats.GetMissingReplacement()->GetDouble(), 5);
  stats.SetMissingReplacement(&value);
  EXPECT_EQ(stats.GetMissingReplacement()->GetDouble(), 6);
  stats.SetMissingReplacement(nullptr);
  EXPECT_EQ(stats.GetMissingReplacement(), nullptr);
}

TEST(VarStats, CopiesAreDeep) {
  VarStats stats(1, 2, 3, 4);
  const NumericValue five(5);
  stats.SetMissingReplacement(&five);
  const std::unique_ptr<ScoreVarStats> clone(stats.Clone());
  VarStats assigned;
  assigned.SetMissingReplacement(&five);
  assigned = stats;
  stats.SetMissingReplacement(nullptr);
  const VarStats& same = assigned;
  assigned = same;
  for (const ScoreVarStats* copy : std::vector<const ScoreVarStats*>{clone.get(), &assigned}) {
    EXPECT_EQ(copy->GetMin(), 1);
    EXPECT_EQ(copy->GetMax(), 2);
    EXPECT_EQ(copy->GetMean(), 3);
    EXPECT_EQ(copy->GetStddev(), 4);
    ASSERT_NE(copy->GetMissingReplacement(), nullptr);
    EXPECT_EQ(copy->GetMissingReplacement()->GetDouble(), 5);
  }
}

}  // namespace
}  // namespace MCKestrel_800
