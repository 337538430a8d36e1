// Binomial and hypergeometric counts: reference values, edges, identities.

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <random>

#include "kestrel/foundation/MCMV.h"
#include "kestrel/math/MCDistFun.h"
#include "tests/math/BitPatterns.h"
#include "tests/support/AllocationCount.h"

namespace {

using MCMath_800::MCDistFun;

constexpr double kMissing = MCCommon_800::MCMV::gMissingValue;
constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kTooMany = 9007199254740994.0;  // 2^53 + 2

double Pdf(double x, double n, double prob) {
  long err = -1;
  const double p = MCDistFun::PdfBin(x, n, prob, err);
  EXPECT_EQ(err, p == kMissing ? 1 : 0);
  return p;
}
double Cdf(double x, double n, double prob) {
  long err = -1;
  const double p = MCDistFun::CdfBin(x, n, prob, err);
  EXPECT_EQ(err, p == kMissing ? 1 : 0);
  return p;
}
double Idf(double p, double n, double prob) {
  long err = -1;
  const double k = MCDistFun::IdfBin(p, n, prob, err);
  EXPECT_EQ(err, k == kMissing ? 1 : 0);
  return k;
}
double Hyper(double x, double total, double successes, double draws) {
  long err = -1;
  const double p = MCDistFun::CDFHyper(x, total, successes, draws, err);
  EXPECT_EQ(err, p == kMissing ? 1 : 0);
  return p;
}

TEST(Binomial, GivesPointProbabilities) {
  struct Row {
    const char* why;
    double x, n, prob, want, digits;
  };
  // Fractions of small whole numbers; the larger ones are in tests/data/math/binomial.csv.
  const Row kRows[] = {
      {"a fair coin", 2, 4, 0.5, 0.375, 1e-15},
      {"no trial", 0, 0, 0.3, 1.0, 0.0},
      {"no success", 0, 3, 0.5, 0.125, 1e-15},
      {"successes only", 3, 3, 0.5, 0.125, 1e-15},
      {"certain success", 7, 7, 1.0, 1.0, 0.0},
      {"certain success leaves no failure", 6, 7, 1.0, 0.0, 0.0},
      {"certain failure", 0, 7, 0.0, 1.0, 0.0},
      {"between counts", 1.5, 7, 0.5, 0.0, 0.0},
      {"below the counts", -1, 7, 0.5, 0.0, 0.0},
      {"above the counts", 8, 7, 0.5, 0.0, 0.0},
      {"too small for a double", 1e6, 2e6, 1e-10, 0.0, 0.0},
      {"prob is no probability", 1, 7, 1.0000001, kMissing, 0.0},
      {"a negative prob", 1, 7, -1e-300, kMissing, 0.0},
      {"half a trial", 1, 7.5, 0.5, kMissing, 0.0},
      {"fewer than no trials", 1, -1, 0.5, kMissing, 0.0},
      {"more trials than counts", 1, kTooMany, 0.5, kMissing, 0.0},
      {"NaN as x", kNaN, 7, 0.5, kMissing, 0.0},
      {"NaN as n", 1, kNaN, 0.5, kMissing, 0.0},
      {"NaN as prob", 1, 7, kNaN, kMissing, 0.0},
      {"infinite x", kInfinity, 7, 0.5, 0.0, 0.0},
      {"infinite n", 1, kInfinity, 0.5, kMissing, 0.0},
  };
  for (const Row& row : kRows) {
    EXPECT_NEAR(Pdf(row.x, row.n, row.prob), row.want, row.digits * std::fabs(row.want)) << row.why;
  }
}

TEST(Binomial, AddsProbabilitiesUp) {
  for (const double n : {1.0, 2.0, 17.0, 250.0}) {
    for (const double prob : {1e-9, 0.01, 0.3, 0.5, 0.75, 0.999999}) {
      double sum = 0.0;
      for (double k = 0.0; k < n; k += 1.0) {
        sum += Pdf(k, n, prob);
        const double share = Cdf(k, n, prob);
        // The sum here gathers rounding, too. Below 1e-290 a lost term counts.
        const double digits = 4e-15 + 1e-17 * k;
        if (sum > 1e-290) {
          EXPECT_NEAR(share, sum, digits * sum) << k << " of " << n << " at " << prob;
        }
        EXPECT_EQ(Cdf(k + 0.5, n, prob), share) << "between counts the share stays";
      }
      EXPECT_EQ(Cdf(n, n, prob), 1.0);
      EXPECT_EQ(Cdf(-0.5, n, prob), 0.0);
    }
  }
}

TEST(Binomial, RefusesWhatIsOutsideTheDomain) {
  EXPECT_EQ(Cdf(1, 7, kNaN), kMissing);
  EXPECT_EQ(Cdf(kNaN, 7, 0.5), kMissing);
  EXPECT_EQ(Cdf(1, 7, 2.0), kMissing);
  EXPECT_EQ(Cdf(1, 6.5, 0.5), kMissing);
  EXPECT_EQ(Idf(-0.1, 7, 0.5), kMissing);
  EXPECT_EQ(Idf(1.1, 7, 0.5), kMissing);
  EXPECT_EQ(Idf(kNaN, 7, 0.5), kMissing);
  EXPECT_EQ(Idf(0.5, -7, 0.5), kMissing);
  EXPECT_EQ(Idf(0.5, 7, kInfinity), kMissing);
}

TEST(Binomial, InverseIsTheSmallestCountThatReachesP) {
  for (const double n : {0.0, 1.0, 2.0, 10.0, 97.0, 5000.0, 1e7, 9007199254740992.0}) {
    for (const double prob : {0.0, 1e-15, 1e-3, 0.25, 0.5, 0.9, 1.0}) {
      for (const double p : {0.0, 1e-300, 1e-20, 1e-4, 0.1, 0.5, 0.9, 0.99999, 1.0 - 0x1p-50, 1.0}) {
        const double k = Idf(p, n, prob);
        ASSERT_GE(k, 0.0);
        ASSERT_LE(k, n);
        EXPECT_GE(Cdf(k, n, prob), p) << n << " " << prob << " " << p;
        // Where steps are below the last digit neighbours are equal, and rounding decides.
        if (k > 0.0 && n < 1e8 && p < 0.999) {
          EXPECT_LT(Cdf(k - 1.0, n, prob), p) << n << " " << prob << " " << p;
        }
      }
    }
  }
}

// Also where p is a share itself, or a last digit beside it, and neighbouring counts differ by little more.
TEST(Binomial, InverseKeepsTheRuleAtEveryShare) {
  std::mt19937_64 random(1947);
  std::uniform_real_distribution<double> uniform(0.0, 1.0);
  for (int i = 0; i < 10000; ++i) {
    const double n = std::floor(std::exp(uniform(random) * std::log(i % 3 == 0   ? 1e15
                                                                    : i % 3 == 1 ? 1e7
                                                                                 : 200.0)));
    const double prob = i % 2 == 0 ? uniform(random) : std::exp(-25.0 * uniform(random));
    const double away = (2.0 * uniform(random) - 1.0) * (i % 5 == 0 ? 36.0 : 4.0);
    const double x = std::floor(n * prob + away * std::sqrt(n * prob * (1.0 - prob)));
    const double share = Cdf(std::min(std::max(x, 0.0), n), n, prob);
    for (const double p :
         {share, std::nextafter(share, 0.0), std::nextafter(share, 1.0), share * (1.0 - 1e-13)}) {
      if (!(p > 0.0 && p < 1.0)) continue;
      const double k = Idf(p, n, prob);
      ASSERT_GE(Cdf(k, n, prob), p) << n << " " << prob << " " << p;
      ASSERT_LT(Cdf(k - 1.0, n, prob), p) << n << " " << prob << " " << p;
    }
  }
}

TEST(Binomial, InverseTurnsTheSharesOfSmallSamplesBack) {
  for (const double n : {1.0, 12.0, 60.0}) {
    for (const double prob : {0.02, 0.5, 0.7}) {
      for (double k = 0.0; k <= n && Cdf(k - 1.0, n, prob) < 1.0 - 1e-12; k += 1.0)
        EXPECT_EQ(Idf(Cdf(k, n, prob), n, prob), k) << n << " " << prob;
    }
  }
}

TEST(Hypergeometric, GivesShares) {
  struct Row {
    const char* why;
    double x, total, successes, draws, want, digits;
  };
  const Row kRows[] = {
      {"one of two", 0, 2, 1, 1, 0.5, 1e-15},
      {"two red of five in two draws: none", 0, 5, 2, 2, 0.3, 2e-15},
      {"at most one of them", 1, 5, 2, 2, 0.9, 2e-15},
      {"all", 2, 5, 2, 2, 1.0, 0.0},
      {"between counts", 1.9, 5, 2, 2, 0.9, 2e-15},
      {"fewer than must be drawn", 1, 5, 4, 3, 0.0, 0.0},
      {"the fewest", 2, 5, 4, 3, 0.6, 2e-15},
      {"no success there is", 0, 5, 0, 3, 1.0, 0.0},
      {"no draw", 0, 5, 3, 0, 1.0, 0.0},
      {"an empty urn", 0, 0, 0, 0, 1.0, 0.0},
      {"below the counts", -1, 5, 2, 2, 0.0, 0.0},
      {"more draws than there are", 1, 5, 2, 6, kMissing, 0.0},
      {"more successes than there are", 1, 5, 6, 2, kMissing, 0.0},
      {"half a draw", 1, 5, 2, 1.5, kMissing, 0.0},
      {"a negative total", 1, -5, 2, 2, kMissing, 0.0},
      {"too many", 1, kTooMany, 2, 2, kMissing, 0.0},
      {"NaN as x", kNaN, 5, 2, 2, kMissing, 0.0},
      {"NaN as total", 1, kNaN, 2, 2, kMissing, 0.0},
      {"NaN as successes", 1, 5, kNaN, 2, kMissing, 0.0},
      {"NaN as draws", 1, 5, 2, kNaN, kMissing, 0.0},
      {"infinite x", -kInfinity, 5, 2, 2, 0.0, 0.0},
      {"a far tail (mpmath, 45 digits)", 0, 154393, 129369, 86, 9.6268135145911815e-69, 2e-15},
  };
  for (const Row& row : kRows) {
    EXPECT_NEAR(Hyper(row.x, row.total, row.successes, row.draws), row.want, row.digits * row.want)
        << row.why;
  }
}

// The two ways to count a draw, and the two ways to draw: exact identities, across every road of the sum.
TEST(Hypergeometric, IsSymmetric) {
  for (const double total : {10.0, 1000.0, 1e6, 1e9, 4503599627370496.0}) {
    for (const double part : {0.01, 0.3, 0.5, 0.9}) {
      const double successes = std::floor(total * part);
      const double draws = std::floor(total * 0.4);
      const double deviation = std::sqrt(total * 0.24 * part * (1.0 - part));
      for (const double away : {-6.0, -2.0, -0.1, 0.0, 0.5, 3.0, 8.0}) {
        const double x = std::floor(draws * part + away * deviation);
        const double share = Hyper(x, total, successes, draws);
        const double swapped = Hyper(x, total, draws, successes);
        EXPECT_NEAR(share, swapped, 4e-15 * share) << total << " " << part << " " << away;
        const double failures = Hyper(draws - x - 1.0, total, total - successes, draws);
        EXPECT_NEAR(share + failures, 1.0, 2e-15) << total << " " << part << " " << away;
      }
    }
  }
}

TEST(Discrete, NoBitPatternGivesInfinityOrNaNAndNothingAllocates) {
  kestrel_tests::BitPatterns patterns(20);
  long err = 0;
  const size_t before = kestrel_tests::CountAllocations();
  for (int i = 0; i < 200000; ++i) {
    const double a = patterns.Next(), b = patterns.Next(), c = patterns.Next(), d = patterns.Next();
    ASSERT_TRUE(std::isfinite(MCDistFun::PdfBin(a, b, c, err))) << a << " " << b << " " << c;
    ASSERT_TRUE(std::isfinite(MCDistFun::CdfBin(a, b, c, err))) << a << " " << b << " " << c;
    ASSERT_TRUE(std::isfinite(MCDistFun::IdfBin(a, b, c, err))) << a << " " << b << " " << c;
    ASSERT_TRUE(std::isfinite(MCDistFun::CDFHyper(a, b, c, d, err))) << a << " " << b << " " << c << " " << d;
  }
  EXPECT_EQ(kestrel_tests::CountAllocations(), before);
}

}  // namespace
