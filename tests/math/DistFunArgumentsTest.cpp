// What every distribution function gives for arguments that are no numbers, or the missing value, in every
// place.

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "kestrel/foundation/MCMV.h"
#include "kestrel/math/MCDistFun.h"

namespace {

using MCMath_800::MCDistFun;

constexpr double kMissing = MCCommon_800::MCMV::gMissingValue;
constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

double Percentile(const double* a) {
  double values[] = {a[0], 2.0, 5.0};
  double weights[] = {a[1], 1.0, 1.0};
  return MCDistFun::GPTile(3, values, weights, a[2]);
}

double MedianCoverage(const double* a) {
  double values[] = {a[0], 2.0, 3.0, 4.0, 5.0, 6.0, 7.0};
  double lower = kNaN, upper = kNaN;
  const double coverage = MCDistFun::Mednci(7, values, a[1], lower, upper);
  EXPECT_TRUE(std::isfinite(lower) && std::isfinite(upper));
  EXPECT_EQ(lower == kMissing, coverage == kMissing);
  EXPECT_EQ(upper == kMissing, coverage == kMissing);
  return coverage;
}

using Counting = double (*)(double, double, double, long&);

template <Counting function>
double Counted(const double* a) {
  long err = -1;
  const double value = function(a[0], a[1], a[2], err);
  EXPECT_EQ(err, value == kMissing ? 1 : 0);
  return value;
}

double Hyper(const double* a) {
  long err = -1;
  const double value = MCDistFun::CDFHyper(a[0], a[1], a[2], a[3], err);
  EXPECT_EQ(err, value == kMissing ? 1 : 0);
  return value;
}

struct ArgumentRow {
  const char* name;
  double (*call)(const double* a);
  int count;
  /// Inside the domain.
  double inside[4];
  /// The first argument at minus infinity and at infinity; any other gives the missing value there.
  double at_low;
  double at_high;
  /// The missing value in each place.
  double at_missing[4];
};

constexpr double kNo = kMissing;

const ArgumentRow kRows[] = {
    {"CdfStdNorm", [](const double* a) { return MCDistFun::CdfStdNorm(a[0]); }, 1, {0.4}, 0, 1, {0}},
    // As a mean the missing value is a number, too, far below x.
    {"CdfNorm",
     [](const double* a) { return MCDistFun::CdfNorm(a[0], a[1], a[2]); },
     3,
     {0.4, 0.1, 2},
     0,
     1,
     {0, 1, kNo}},
    {"IdfStdNorm", [](const double* a) { return MCDistFun::IdfStdNorm(a[0]); }, 1, {0.4}, kNo, kNo, {kNo}},
    {"IdfNorm",
     [](const double* a) { return MCDistFun::IdfNorm(a[0], a[1], a[2]); },
     3,
     {0.4, 0.1, 2},
     kNo,
     kNo,
     {kNo, kNo, kNo}},
    {"CdfT", [](const double* a) { return MCDistFun::CdfT(a[0], a[1]); }, 2, {0.4, 3}, 0, 1, {0, kNo}},
    {"IdfT", [](const double* a) { return MCDistFun::IdfT(a[0], a[1]); }, 2, {0.4, 3}, kNo, kNo, {kNo, kNo}},
    {"SigT", [](const double* a) { return MCDistFun::SigT(a[0], a[1]); }, 2, {0.4, 3}, 1, 0, {1, kNo}},
    {"CdfChi", [](const double* a) { return MCDistFun::CdfChi(a[0], a[1]); }, 2, {0.4, 3}, 0, 1, {0, kNo}},
    {"IdfChi",
     [](const double* a) { return MCDistFun::IdfChi(a[0], a[1]); },
     2,
     {0.4, 3},
     kNo,
     kNo,
     {kNo, kNo}},
    {"SigChi", [](const double* a) { return MCDistFun::SigChi(a[0], a[1]); }, 2, {0.4, 3}, 1, 0, {1, kNo}},
    {"CdfF",
     [](const double* a) { return MCDistFun::CdfF(a[0], a[1], a[2]); },
     3,
     {0.4, 3, 4},
     0,
     1,
     {0, kNo, kNo}},
    {"IdfF",
     [](const double* a) { return MCDistFun::IdfF(a[0], a[1], a[2]); },
     3,
     {0.4, 3, 4},
     kNo,
     kNo,
     {kNo, kNo, kNo}},
    {"SigF",
     [](const double* a) { return MCDistFun::SigF(a[0], a[1], a[2]); },
     3,
     {0.4, 3, 4},
     1,
     0,
     {1, kNo, kNo}},
    {"CdfBeta",
     [](const double* a) { return MCDistFun::CdfBeta(a[0], a[1], a[2]); },
     3,
     {0.4, 3, 4},
     0,
     1,
     {0, kNo, kNo}},
    {"IdfBeta",
     [](const double* a) { return MCDistFun::IdfBeta(a[0], a[1], a[2]); },
     3,
     {0.4, 3, 4},
     kNo,
     kNo,
     {kNo, kNo, kNo}},
    {"CdfGam",
     [](const double* a) { return MCDistFun::CdfGam(a[0], a[1], a[2]); },
     3,
     {0.4, 3, 4},
     0,
     1,
     {0, kNo, kNo}},
    {"CdfGam, exponential",
     [](const double* a) { return MCDistFun::CdfGam(a[0], 1.0, a[1]); },
     2,
     {0.4, 4},
     0,
     1,
     {0, kNo}},
    {"IdfGam",
     [](const double* a) { return MCDistFun::IdfGam(a[0], a[1], a[2]); },
     3,
     {0.4, 3, 4},
     kNo,
     kNo,
     {kNo, kNo, kNo}},
    {"PdfBin", Counted<MCDistFun::PdfBin>, 3, {2, 7, 0.3}, 0, 0, {0, kNo, kNo}},
    {"CdfBin", Counted<MCDistFun::CdfBin>, 3, {2, 7, 0.3}, 0, 1, {0, kNo, kNo}},
    {"IdfBin", Counted<MCDistFun::IdfBin>, 3, {0.4, 7, 0.3}, kNo, kNo, {kNo, kNo, kNo}},
    {"CDFHyper", Hyper, 4, {2, 20, 7, 9}, 0, 1, {0, kNo, kNo, kNo}},
    {"NonCentralCdfT",
     [](const double* a) { return MCDistFun::NonCentralCdfT(a[0], a[1], a[2]); },
     3,
     {0.4, 3, 1},
     0,
     1,
     {0, kNo, kNo}},
    {"NonCentralCdfChi",
     [](const double* a) { return MCDistFun::NonCentralCdfChi(a[0], a[1], a[2]); },
     3,
     {0.4, 3, 1},
     0,
     1,
     {0, kNo, kNo}},
    {"NonCentralCdfF",
     [](const double* a) { return MCDistFun::NonCentralCdfF(a[0], a[1], a[2], a[3]); },
     4,
     {0.4, 3, 4, 1},
     0,
     1,
     {0, kNo, kNo, kNo}},
    {"NonCentralCdfF, above",
     [](const double* a) { return MCDistFun::NonCentralCdfF(a[0], a[1], a[2], a[3], true); },
     4,
     {0.4, 3, 4, 1},
     1,
     0,
     {1, kNo, kNo, kNo}},
    // No parameter takes a whole distribution to one side.
    {"FindNCParamT",
     [](const double* a) { return MCDistFun::FindNCParamT(a[0], a[1], a[2]); },
     3,
     {2, 3, 0.3},
     kNo,
     kNo,
     {kNo, kNo, kNo}},
    {"FindNCParamChi",
     [](const double* a) { return MCDistFun::FindNCParamChi(a[0], a[1], a[2]); },
     3,
     {6, 3, 0.3},
     kNo,
     kNo,
     {kNo, kNo, kNo}},
    {"FindNCParamF",
     [](const double* a) { return MCDistFun::FindNCParamF(a[0], a[1], a[2], a[3]); },
     4,
     {2, 3, 4, 0.3},
     kNo,
     kNo,
     {kNo, kNo, kNo, kNo}},
    // Cases with the missing value do not count.
    {"GPTile", Percentile, 3, {1, 1, 0.5}, kNo, kNo, {3.5, 3.5, kNo}},
    {"Mednci", MedianCoverage, 2, {1, 0.5}, kNo, kNo, {0.78125, kNo}},
    {"vexadnlgam", [](const double* a) { return MCDistFun::vexadnlgam(a[0]); }, 1, {2.5}, kNo, kNo, {kNo}},
};

double With(const ArgumentRow& row, int place, double argument) {
  double arguments[4] = {row.inside[0], row.inside[1], row.inside[2], row.inside[3]};
  arguments[place] = argument;
  return row.call(arguments);
}

TEST(MCDistFunArguments, InfinitiesGiveLimitsOrTheMissingValue) {
  for (const ArgumentRow& row : kRows) {
    EXPECT_NE(row.call(row.inside), kMissing) << row.name;
    EXPECT_EQ(With(row, 0, -kInfinity), row.at_low) << row.name;
    EXPECT_EQ(With(row, 0, kInfinity), row.at_high) << row.name;
    for (int place = 1; place < row.count; ++place) {
      EXPECT_EQ(With(row, place, -kInfinity), kMissing) << row.name << ", place " << place;
      EXPECT_EQ(With(row, place, kInfinity), kMissing) << row.name << ", place " << place;
    }
  }
}

TEST(MCDistFunArguments, NoNumberGivesTheMissingValue) {
  for (const ArgumentRow& row : kRows) {
    for (int place = 0; place < row.count; ++place)
      EXPECT_EQ(With(row, place, kNaN), kMissing) << row.name << ", place " << place;
  }
}

TEST(MCDistFunArguments, TheMissingValueIsANumberFarBelow) {
  for (const ArgumentRow& row : kRows) {
    for (int place = 0; place < row.count; ++place) {
      const double value = With(row, place, kMissing);
      if (row.at_missing[place] == kMissing) {
        EXPECT_EQ(value, kMissing) << row.name << ", place " << place;
      } else {
        EXPECT_NEAR(value, row.at_missing[place], 1e-14) << row.name << ", place " << place;
      }
    }
  }
}

}  // namespace
