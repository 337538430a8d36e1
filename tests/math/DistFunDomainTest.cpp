// What the distribution functions give at the edges of their domains and beyond.

#include <gtest/gtest.h>

#include <atomic>
#include <cmath>
#include <limits>
#include <thread>
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
constexpr double kLargest = std::numeric_limits<double>::max();

using Function = double (*)(double, double, double);

// The second and third argument of functions that have fewer are not looked at.
double CdfStdNorm(double x, double, double) {
  return MCDistFun::CdfStdNorm(x);
}
double IdfStdNorm(double p, double, double) {
  return MCDistFun::IdfStdNorm(p);
}
double CdfT(double x, double df, double) {
  return MCDistFun::CdfT(x, df);
}
double SigT(double x, double df, double) {
  return MCDistFun::SigT(x, df);
}
double IdfT(double p, double df, double) {
  return MCDistFun::IdfT(p, df);
}
double CdfChi(double x, double df, double) {
  return MCDistFun::CdfChi(x, df);
}
double SigChi(double x, double df, double) {
  return MCDistFun::SigChi(x, df);
}
double IdfChi(double p, double df, double) {
  return MCDistFun::IdfChi(p, df);
}
double LogGamma(double x, double, double) {
  return MCDistFun::vexadnlgam(x);
}

constexpr Function kAll[] = {CdfStdNorm,
                             MCDistFun::CdfNorm,
                             IdfStdNorm,
                             MCDistFun::IdfNorm,
                             CdfT,
                             SigT,
                             IdfT,
                             CdfChi,
                             SigChi,
                             IdfChi,
                             MCDistFun::CdfF,
                             MCDistFun::SigF,
                             MCDistFun::IdfF,
                             MCDistFun::CdfBeta,
                             MCDistFun::IdfBeta,
                             MCDistFun::CdfGam,
                             MCDistFun::IdfGam,
                             LogGamma};

struct DomainRow {
  const char* why;
  Function function;
  double first;
  double second;
  double third;
  double expected;  // exactly
};

constexpr DomainRow kDomainRows[] = {
    {"the normal's middle", CdfStdNorm, 0.0, 0.0, 0.0, 0.5},
    {"its negative zero", CdfStdNorm, -0.0, 0.0, 0.0, 0.5},
    {"far below", CdfStdNorm, -40.0, 0.0, 0.0, 0.0},
    {"far above", CdfStdNorm, 40.0, 0.0, 0.0, 1.0},
    {"infinitely far below", CdfStdNorm, -kInfinity, 0.0, 0.0, 0.0},
    {"infinitely far above", CdfStdNorm, kInfinity, 0.0, 0.0, 1.0},
    {"the missing value is a number as x", CdfStdNorm, kMissing, 0.0, 0.0, 0.0},
    {"no number", CdfStdNorm, kNaN, 0.0, 0.0, kMissing},
    {"at the mean", MCDistFun::CdfNorm, 3.0, 3.0, 2.0, 0.5},
    {"no deviation", MCDistFun::CdfNorm, 1.0, 2.0, 0.0, kMissing},
    {"a negative deviation", MCDistFun::CdfNorm, 1.0, 2.0, -1.0, kMissing},
    {"an infinite deviation", MCDistFun::CdfNorm, 1.0, 2.0, kInfinity, kMissing},
    {"an infinite mean", MCDistFun::CdfNorm, 1.0, kInfinity, 1.0, kMissing},
    {"a distance that overflows", MCDistFun::CdfNorm, kLargest, -kLargest, 1e-10, 1.0},
    {"p = 0", IdfStdNorm, 0.0, 0.0, 0.0, kMissing},
    {"p = 1", IdfStdNorm, 1.0, 0.0, 0.0, kMissing},
    {"p = 1/2", IdfStdNorm, 0.5, 0.0, 0.0, 0.0},
    {"p below 0", IdfStdNorm, -0.1, 0.0, 0.0, kMissing},
    {"p is no number", IdfStdNorm, kNaN, 0.0, 0.0, kMissing},
    {"the mean exactly", MCDistFun::IdfNorm, 0.5, 7.0, 2.0, 7.0},
    {"a negative deviation for a quantile", MCDistFun::IdfNorm, 0.3, 7.0, -1.0, kMissing},
    {"p = 1 with a mean", MCDistFun::IdfNorm, 1.0, 7.0, 1.0, kMissing},
    {"a quantile that overflows", MCDistFun::IdfNorm, 0.999, 0.0, kLargest, kMissing},
    {"t in the middle", CdfT, 0.0, 3.5, 0.0, 0.5},
    {"t's significance in the middle", SigT, 0.0, 3.5, 0.0, 0.5},
    {"t without degrees of freedom", SigT, 1.0, 0.0, 0.0, kMissing},
    {"t with negative ones", CdfT, 1.0, -1.0, 0.0, kMissing},
    {"t with infinite ones", CdfT, 1.0, kInfinity, 0.0, kMissing},
    {"t of an infinite x", SigT, kInfinity, 2.0, 0.0, 0.0},
    {"t of a negative infinite x", SigT, -kInfinity, 2.0, 0.0, 1.0},
    {"t's quantile at 0", IdfT, 0.0, 3.0, 0.0, kMissing},
    {"t's quantile at 1", IdfT, 1.0, 3.0, 0.0, kMissing},
    {"t's quantile in the middle", IdfT, 0.5, 3.0, 0.0, 0.0},
    {"t's quantile that overflows", IdfT, 1e-300, 0.1, 0.0, kMissing},
    {"chi-square below its range", CdfChi, -1.0, 3.0, 0.0, 0.0},
    {"chi-square's significance at 0", SigChi, 0.0, 3.0, 0.0, 1.0},
    {"chi-square without degrees of freedom", CdfChi, 1.0, 0.0, 0.0, kMissing},
    {"the same below its range", CdfChi, -1.0, 0.0, 0.0, kMissing},
    {"chi-square's significance without them", SigChi, 1.0, -2.0, 0.0, kMissing},
    {"chi-square of infinity", CdfChi, kInfinity, 3.0, 0.0, 1.0},
    {"chi-square's significance of infinity", SigChi, kInfinity, 3.0, 0.0, 0.0},
    {"chi-square's quantile at 0", IdfChi, 0.0, 3.0, 0.0, 0.0},
    {"chi-square's quantile at 1", IdfChi, 1.0, 3.0, 0.0, kMissing},
    {"F below its range", MCDistFun::CdfF, -1.0, 3.0, 4.0, 0.0},
    {"F's significance at 0", MCDistFun::SigF, 0.0, 3.0, 4.0, 1.0},
    {"F without the first degrees of freedom", MCDistFun::SigF, 1.0, 0.0, 4.0, kMissing},
    {"F without the second", MCDistFun::CdfF, 1.0, 3.0, 0.0, kMissing},
    {"F of infinity", MCDistFun::CdfF, kInfinity, 3.0, 4.0, 1.0},
    {"F's quantile at 0", MCDistFun::IdfF, 0.0, 3.0, 4.0, 0.0},
    {"F's quantile at 1", MCDistFun::IdfF, 1.0, 3.0, 4.0, kMissing},
    {"beta below its range", MCDistFun::CdfBeta, -0.5, 3.0, 4.0, 0.0},
    {"beta at 1", MCDistFun::CdfBeta, 1.0, 3.0, 4.0, 1.0},
    {"beta above its range", MCDistFun::CdfBeta, 2.0, 3.0, 4.0, 1.0},
    {"beta without a shape", MCDistFun::CdfBeta, 0.5, 0.0, 4.0, kMissing},
    {"beta's quantile at 0", MCDistFun::IdfBeta, 0.0, 3.0, 4.0, 0.0},
    {"beta's quantile at 1", MCDistFun::IdfBeta, 1.0, 3.0, 4.0, 1.0},
    {"beta's quantile above 1", MCDistFun::IdfBeta, 1.1, 3.0, 4.0, kMissing},
    {"beta's quantile without a shape", MCDistFun::IdfBeta, 0.1, 3.0, -4.0, kMissing},
    {"gamma below its range", MCDistFun::CdfGam, -1.0, 3.0, 4.0, 0.0},
    {"gamma without a shape", MCDistFun::CdfGam, 1.0, 0.0, 4.0, kMissing},
    {"gamma without a rate", MCDistFun::CdfGam, 1.0, 3.0, 0.0, kMissing},
    {"gamma of infinity", MCDistFun::CdfGam, kInfinity, 3.0, 4.0, 1.0},
    {"exponential of infinity", MCDistFun::CdfGam, kInfinity, 1.0, 4.0, 1.0},
    {"gamma of a product that overflows", MCDistFun::CdfGam, 1e300, 3.0, 1e300, 1.0},
    {"gamma's quantile at 0", MCDistFun::IdfGam, 0.0, 3.0, 4.0, 0.0},
    {"gamma's quantile at 1", MCDistFun::IdfGam, 1.0, 3.0, 4.0, kMissing},
    {"gamma's quantile without a shape", MCDistFun::IdfGam, 0.5, 0.0, 4.0, kMissing},
    {"gamma's quantile that overflows", MCDistFun::IdfGam, 0.5, 3.0, 1e-310, kMissing},
    {"log-gamma at 1", LogGamma, 1.0, 0.0, 0.0, 0.0},
    {"log-gamma at 2", LogGamma, 2.0, 0.0, 0.0, 0.0},
    {"log-gamma at 0", LogGamma, 0.0, 0.0, 0.0, kMissing},
    {"log-gamma below 0", LogGamma, -1.5, 0.0, 0.0, kMissing},
    {"log-gamma too large", LogGamma, 1e307, 0.0, 0.0, kMissing},
    {"log-gamma of infinity", LogGamma, kInfinity, 0.0, 0.0, kMissing},
};

TEST(MCDistFun, EdgesOfDomainsGiveLimitsOrTheMissingValue) {
  for (const DomainRow& row : kDomainRows) {
    SCOPED_TRACE(row.why);
    EXPECT_EQ(row.function(row.first, row.second, row.third), row.expected);
  }
}

TEST(MCDistFun, NoNumberGivesTheMissingValueInAnyPlace) {
  for (const Function function :
       {MCDistFun::CdfNorm, MCDistFun::IdfNorm, MCDistFun::CdfF, MCDistFun::SigF, MCDistFun::IdfF,
        MCDistFun::CdfBeta, MCDistFun::IdfBeta, MCDistFun::CdfGam, MCDistFun::IdfGam}) {
    EXPECT_EQ(function(kNaN, 0.5, 0.5), kMissing);
    EXPECT_EQ(function(0.5, kNaN, 0.5), kMissing);
    EXPECT_EQ(function(0.5, 0.5, kNaN), kMissing);
  }
  for (const Function function : {CdfT, SigT, IdfT, CdfChi, SigChi, IdfChi}) {
    EXPECT_EQ(function(kNaN, 0.5, 0.0), kMissing);
    EXPECT_EQ(function(0.5, kNaN, 0.0), kMissing);
  }
}

TEST(MCDistFun, AnyBitsGiveAFiniteNumber) {
  kestrel_tests::BitPatterns patterns(20240802);
  for (int i = 0; i < 60000; ++i) {
    const double first = patterns.Next();
    const double second = patterns.Next();
    const double third = patterns.Next();
    int number = 0;
    for (const Function function : kAll) {
      ASSERT_TRUE(std::isfinite(function(first, second, third)))
          << "function " << number << " of " << first << ", " << second << ", " << third;
      ++number;
    }
  }
}

TEST(MCDistFun, ProbabilitiesAreNeverOutsideOfZeroToOne) {
  kestrel_tests::BitPatterns patterns(20240803);
  for (int i = 0; i < 60000; ++i) {
    const double first = patterns.Next();
    const double second = patterns.Next();
    const double third = patterns.Next();
    for (const Function function :
         {CdfStdNorm, CdfT, SigT, CdfChi, SigChi, MCDistFun::CdfNorm, MCDistFun::CdfF, MCDistFun::SigF,
          MCDistFun::CdfBeta, MCDistFun::CdfGam}) {
      const double p = function(first, second, third);
      ASSERT_TRUE(p == kMissing || (p >= 0.0 && p <= 1.0))
          << p << " of " << first << ", " << second << ", " << third;
    }
  }
}

TEST(MCDistFun, AllocatesNothing) {
  const size_t before = kestrel_tests::CountAllocations();
  double sum = 0.0;
  for (const Function function : kAll)
    sum += function(0.3, 150.5, 230.25) + function(0.3, 0.4, 3.0);
  EXPECT_EQ(kestrel_tests::CountAllocations(), before);
  EXPECT_TRUE(std::isfinite(sum));
}

// Every thread must come to the numbers of the first.
TEST(MCDistFun, ServesSeveralThreadsAtOnce) {
  const auto compute = [] {
    std::vector<double> numbers;
    kestrel_tests::BitPatterns patterns(20240804);
    for (int i = 0; i < 2000; ++i) {
      const double first = patterns.Next();
      const double second = patterns.Next();
      for (const Function function : kAll)
        numbers.push_back(function(first, second, 2.5));
    }
    return numbers;
  };
  const std::vector<double> expected = compute();
  std::atomic<int> differing{0};
  std::vector<std::thread> threads;
  for (int i = 0; i < 4; ++i)
    threads.emplace_back([&] { differing += compute() == expected ? 0 : 1; });
  for (std::thread& thread : threads)
    thread.join();
  EXPECT_EQ(differing, 0);
}

}  // namespace
