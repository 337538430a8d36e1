// Percentiles of samples and the median's confidence interval.

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <random>
#include <vector>

#include "kestrel/foundation/MCMV.h"
#include "kestrel/math/MCDistFun.h"
#include "tests/math/BitPatterns.h"
#include "tests/support/AllocationCount.h"

namespace {

using MCMath_800::MCDistFun;

constexpr double kMissing = MCCommon_800::MCMV::gMissingValue;
constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

double Tile(std::vector<double> values, double p, MCDistFun::PercentileMethod method) {
  return MCDistFun::GPTile(static_cast<long>(values.size()), values.data(), nullptr, p, method);
}
double WeightedTile(std::vector<double> values, std::vector<double> weights, double p,
                    MCDistFun::PercentileMethod method) {
  return MCDistFun::GPTile(static_cast<long>(values.size()), values.data(), weights.data(), p, method);
}

TEST(Percentile, FollowsEachDefinition) {
  // By hand from Hyndman and Fan's definitions; ten values, out of order.
  const std::vector<double> ten = {70, 10, 50, 30, 90, 20, 60, 40, 100, 80};
  struct Row {
    const char* why;
    MCDistFun::PercentileMethod method;
    double p, want;
  };
  const Row kRows[] = {
      {"reached exactly", MCDistFun::kEmpirical, 0.3, 30},
      {"reached by the next", MCDistFun::kEmpirical, 0.25, 30},
      {"the smallest", MCDistFun::kEmpirical, 0.0, 10},
      {"the largest", MCDistFun::kEmpirical, 1.0, 100},
      {"halfway where reached exactly", MCDistFun::kEmpiricalAverage, 0.3, 35},
      {"no average between", MCDistFun::kEmpiricalAverage, 0.25, 30},
      {"no average past the end", MCDistFun::kEmpiricalAverage, 1.0, 100},
      {"no average before the start", MCDistFun::kEmpiricalAverage, 0.0, 10},
      {"closest below", MCDistFun::kClosest, 0.32, 30},
      {"closest above", MCDistFun::kClosest, 0.38, 40},
      {"a tie goes to the even rank above", MCDistFun::kClosest, 0.35, 40},
      {"a tie goes to the even rank below", MCDistFun::kClosest, 0.25, 20},
      {"W p", MCDistFun::kWeightedAverage, 0.25, 25},
      {"W p below the first", MCDistFun::kWeightedAverage, 0.05, 10},
      {"W p + 1/2", MCDistFun::kWeightedAverageHalf, 0.25, 30},
      {"(W + 1) p", MCDistFun::kWeightedAveragePlus, 0.25, 27.5},
      {"(W + 1) p past the last", MCDistFun::kWeightedAveragePlus, 0.95, 100},
      {"(W - 1) p + 1", MCDistFun::kWeightedAverageMinus, 0.25, 32.5},
      {"(W - 1) p + 1 at the end", MCDistFun::kWeightedAverageMinus, 1.0, 100},
      {"median unbiased", MCDistFun::kMedianUnbiased, 0.25, 10.0 * (10.0 / 4.0 + 5.0 / 12.0)},
      {"normal unbiased", MCDistFun::kNormalUnbiased, 0.25, 10.0 * (2.5 + 0.4375)},
      {"lower hinge", MCDistFun::kTukeyHinges, 0.25, 30},
      {"median", MCDistFun::kTukeyHinges, 0.5, 55},
      {"upper hinge", MCDistFun::kTukeyHinges, 0.75, 80},
      {"there is no other hinge", MCDistFun::kTukeyHinges, 0.3, kMissing},
      {"no such definition", static_cast<MCDistFun::PercentileMethod>(0), 0.3, kMissing},
      {"p above 1", MCDistFun::kEmpirical, 1.01, kMissing},
      {"p below 0", MCDistFun::kEmpirical, -0.01, kMissing},
      {"NaN as p", MCDistFun::kEmpirical, kNaN, kMissing},
  };
  for (const Row& row : kRows)
    EXPECT_NEAR(Tile(ten, row.p, row.method), row.want, 1e-13 * std::fabs(row.want)) << row.why;
  const std::vector<double> nine = {1, 2, 3, 4, 5, 6, 7, 8, 9};
  EXPECT_EQ(Tile(nine, 0.25, MCDistFun::kTukeyHinges), 3.0);
  EXPECT_EQ(Tile(nine, 0.75, MCDistFun::kTukeyHinges), 7.0);
}

TEST(Percentile, TakesAWholeNumberOfHundredthsForWhatItIs) {
  std::vector<double> hundred;
  for (int i = 1; i <= 100; ++i)
    hundred.push_back(i);
  for (int i = 1; i <= 100; ++i)
    EXPECT_EQ(Tile(hundred, i / 100.0, MCDistFun::kEmpirical), i);
}

TEST(Percentile, WeightsStandForEqualValues) {
  std::mt19937 random(7);
  for (int round = 0; round < 200; ++round) {
    std::vector<double> values, weights, spread;
    for (int i = 0; i < 1 + round % 17; ++i) {
      values.push_back(static_cast<double>(random() % 12));
      weights.push_back(static_cast<double>(random() % 4));
      spread.insert(spread.end(), static_cast<size_t>(weights.back()), values.back());
    }
    if (spread.empty()) continue;
    for (int method = MCDistFun::kEmpirical; method <= MCDistFun::kTukeyHinges; ++method) {
      for (const double p : {0.0, 0.1, 0.25, 0.5, 0.63, 0.75, 1.0}) {
        const auto which = static_cast<MCDistFun::PercentileMethod>(method);
        EXPECT_NEAR(WeightedTile(values, weights, p, which), Tile(spread, p, which), 1e-12)
            << method << " " << p << " round " << round;
      }
    }
  }
}

TEST(Percentile, SpreadsLightValuesOverTheirWholeWeight) {
  // W p = 0.75: halfway through the second value's weight of 0.5.
  EXPECT_DOUBLE_EQ(WeightedTile({1, 2, 3}, {0.5, 0.5, 0.5}, 0.5, MCDistFun::kWeightedAverage), 1.5);
}

TEST(Percentile, KeepsWeightsWithTheirValues) {
  std::vector<double> values = {5, 3, 9, 1, 7}, weights = {0.5, 0.3, 0.9, 0.1, 0.7};
  MCDistFun::GPTile(5, values.data(), weights.data(), 0.5);
  EXPECT_EQ(values, (std::vector<double>{1, 3, 5, 7, 9}));
  EXPECT_EQ(weights, (std::vector<double>{0.1, 0.3, 0.5, 0.7, 0.9}));
}

TEST(Percentile, LeavesOutMissingCasesAndRefusesBadOnes) {
  EXPECT_EQ(Tile({kMissing, 4, 2, kMissing, 6}, 0.5, MCDistFun::kWeightedAveragePlus), 4.0);
  EXPECT_EQ(WeightedTile({1, 4, 2, 6}, {kMissing, 1, 1, 1}, 0.0, MCDistFun::kEmpirical), 2.0);
  EXPECT_EQ(WeightedTile({1, 4, 2, 6}, {0.0, 1, 1, 1}, 0.0, MCDistFun::kEmpirical), 2.0);
  struct Row {
    const char* why;
    double value;
  };
  const auto method = MCDistFun::kWeightedAverage;
  const Row kRows[] = {
      {"no case", MCDistFun::GPTile(0, nullptr, nullptr, 0.5)},
      {"a negative count", MCDistFun::GPTile(-3, nullptr, nullptr, 0.5)},
      {"missing cases only", Tile({kMissing, kMissing}, 0.5, method)},
      {"a NaN among the values", Tile({1, kNaN, 3}, 0.5, method)},
      {"an infinity among the values", Tile({1, kInfinity, 3}, 0.5, method)},
      {"a NaN among the weights", WeightedTile({1, 2}, {1, kNaN}, 0.5, method)},
      {"a negative weight", WeightedTile({1, 2}, {1, -1}, 0.5, method)},
      {"weights of nothing", WeightedTile({1, 2}, {0, 0}, 0.5, method)},
      {"weights that overflow", WeightedTile({1, 2}, {1.7e308, 1.7e308}, 0.5, method)},
  };
  for (const Row& row : kRows)
    EXPECT_EQ(row.value, kMissing) << row.why;
}

struct Interval {
  double coverage, lower, upper;
};
Interval MedianInterval(std::vector<double> values, double level) {
  Interval found{0.0, 0.0, 0.0};
  found.coverage =
      MCDistFun::Mednci(static_cast<long>(values.size()), values.data(), level, found.lower, found.upper);
  return found;
}

TEST(MedianInterval, TakesTheExactRanks) {
  struct Row {
    const char* why;
    int n;
    double level, coverage;
    int rank;
  };
  // 1 - 2 P(X < rank), X binomial with n trials and prob 1/2, by hand.
  const Row kRows[] = {
      {"six values reach 95 %", 6, 0.95, 1.0 - 2.0 / 64.0, 1},
      {"ten values", 10, 0.95, 1.0 - 2.0 * 11.0 / 1024.0, 2},
      {"a level that is met exactly", 3, 0.75, 0.75, 1},
      {"met exactly at a higher rank", 5, 0.625, 0.625, 2},
      {"a low level leaves the middle values", 4, 0.3, 0.375, 2},
      {"a sample of 100", 100, 0.95, 0.9647997997822952, 40},
  };
  for (const Row& row : kRows) {
    std::vector<double> values;
    for (int i = row.n; i >= 1; --i)
      values.push_back(i);
    const Interval found = MedianInterval(values, row.level);
    EXPECT_NEAR(found.coverage, row.coverage, 1e-14) << row.why;
    EXPECT_EQ(found.lower, row.rank) << row.why;
    EXPECT_EQ(found.upper, row.n + 1 - row.rank) << row.why;
  }
}

TEST(MedianInterval, KeepsTheLevelWithTheLargestRank) {
  for (int n = 6; n < 400; n += 7) {
    std::vector<double> values;
    for (int i = 1; i <= n; ++i)
      values.push_back(i);
    for (const double level : {0.5, 0.9, 0.95, 0.96}) {
      const Interval found = MedianInterval(values, level);
      long err = 0;
      EXPECT_GE(found.coverage, level * (1.0 - 1e-15));
      EXPECT_LT(1.0 - 2.0 * MCDistFun::CdfBin(found.lower, n, 0.5, err), level) << n << " " << level;
    }
  }
}

TEST(MedianInterval, RefusesWhatGivesNone) {
  struct Row {
    const char* why;
    std::vector<double> values;
    double level;
  };
  const Row kRows[] = {
      {"too few values for the level", {1, 2, 3, 4, 5}, 0.95},
      {"missing values do not count", {kMissing, 1, 2, 3, 4, 5}, 0.95},
      {"a NaN", {1, 2, 3, kNaN, 5, 6, 7}, 0.5},
      {"an infinity", {1, 2, 3, -kInfinity, 5, 6, 7}, 0.5},
      {"a level of 1", {1, 2, 3, 4, 5, 6, 7}, 1.0},
      {"a level of 0", {1, 2, 3, 4, 5, 6, 7}, 0.0},
      {"NaN as the level", {1, 2, 3, 4, 5, 6, 7}, kNaN},
      {"no value", {}, 0.5},
  };
  for (const Row& row : kRows) {
    const Interval found = MedianInterval(row.values, row.level);
    EXPECT_EQ(found.coverage, kMissing) << row.why;
    EXPECT_EQ(found.lower, kMissing) << row.why;
    EXPECT_EQ(found.upper, kMissing) << row.why;
  }
}

TEST(Sample, NoBitPatternGivesInfinityOrNaNAndNothingAllocates) {
  kestrel_tests::BitPatterns patterns(22);
  double values[9], weights[9];
  const size_t before = kestrel_tests::CountAllocations();
  for (int i = 0; i < 100000; ++i) {
    for (int j = 0; j < 9; ++j) {
      do {
        values[j] = patterns.Next();
      } while (i % 2 == 0 && !std::isfinite(values[j]));
      do {
        weights[j] = patterns.Next();
      } while (i % 2 == 0 && !(weights[j] >= 0.0 && weights[j] < kInfinity));
    }
    const double p = i % 4 < 2 ? patterns.Next() : 0.01 * (i % 101);
    const auto method = static_cast<MCDistFun::PercentileMethod>(i % 12);
    ASSERT_TRUE(std::isfinite(MCDistFun::GPTile(9, values, weights, p, method))) << i;
    double lower = kNaN, upper = kNaN;
    ASSERT_TRUE(std::isfinite(MCDistFun::Mednci(9, values, p, lower, upper))) << i;
    ASSERT_TRUE(std::isfinite(lower) && std::isfinite(upper)) << i;
  }
  EXPECT_EQ(kestrel_tests::CountAllocations(), before);
}

TEST(Percentile, SortsLargeSamplesWithWeights) {
  std::mt19937 random(9);
  std::vector<double> values, weights;
  for (int i = 0; i < 20000; ++i) {
    values.push_back(static_cast<double>(random() % 5000));
    weights.push_back(values.back() + 1.0);
  }
  MCDistFun::GPTile(20000, values.data(), weights.data(), 0.5);
  EXPECT_TRUE(std::is_sorted(values.begin(), values.end()));
  for (size_t i = 0; i < values.size(); ++i)
    ASSERT_EQ(weights[i], values[i] + 1.0);
}

}  // namespace
