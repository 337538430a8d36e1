// The normal, gamma and beta families against reference values, themselves and each other.

#include <gtest/gtest.h>

#include <cmath>
#include <map>
#include <string>

#include "kestrel/foundation/MCMV.h"
#include "kestrel/foundation/NumberText.h"
#include "kestrel/math/MCDistFun.h"
#include "tests/math/DistFunWorkers.h"
#include "tests/support/PlainTable.h"

namespace {

using MCKestrel_800::ParseDouble;
using MCMath_800::DistFunWorkers;
using MCMath_800::MCDistFun;

constexpr double kMissing = MCCommon_800::MCMV::gMissingValue;
constexpr double kEps = 2.220446049250313e-16;
constexpr double kPi = 3.14159265358979323846;

double ToNumber(const std::string& text) {
  double number = 0.0;
  EXPECT_TRUE(text.empty() || ParseDouble(text.data(), text.data() + text.size(), number)) << text;
  return number;
}

double LogBinomial(double n, double k, double) {
  long err = 7;
  const double value = DistFunWorkers::dnlbnc(n, k, err);
  EXPECT_EQ(err, 0);
  return value;
}

using Function = double (*)(double, double, double);

const std::map<std::string, Function>& Functions() {
  static const std::map<std::string, Function> functions = {
      {"derf", [](double x, double, double) { return DistFunWorkers::derf(x); }},
      {"derfc", [](double x, double, double) { return DistFunWorkers::derfc(x); }},
      {"dnlbnc", LogBinomial},
      {"vexadnlgam", [](double x, double, double) { return MCDistFun::vexadnlgam(x); }},
      {"CdfStdNorm", [](double x, double, double) { return MCDistFun::CdfStdNorm(x); }},
      {"IdfStdNorm", [](double p, double, double) { return MCDistFun::IdfStdNorm(p); }},
      {"CdfChi", [](double x, double df, double) { return MCDistFun::CdfChi(x, df); }},
      {"SigChi", [](double x, double df, double) { return MCDistFun::SigChi(x, df); }},
      {"CdfT", [](double x, double df, double) { return MCDistFun::CdfT(x, df); }},
      {"SigT", [](double x, double df, double) { return MCDistFun::SigT(x, df); }},
      {"CdfF", MCDistFun::CdfF},
      {"SigF", MCDistFun::SigF},
      {"CdfBeta", MCDistFun::CdfBeta},
      {"CdfGam", MCDistFun::CdfGam},
  };
  return functions;
}

// The reference values were computed with at least 60 digits by make_family_values.py beside the table.
TEST(MCDistFun, AgreesWithReferenceValues) {
  const kestrel_tests::PlainTable table =
      kestrel_tests::ReadPlainTable(KESTREL_SOURCE_DIR "/tests/data/math/family_values.csv");
  ASSERT_GT(table.rows.size(), 800u);
  std::map<std::string, int> rows;
  for (const std::vector<std::string>& row : table.rows) {
    const auto function = Functions().find(row[0]);
    ASSERT_NE(function, Functions().end()) << row[0];
    const double expected = ToNumber(row[4]);
    const double actual = function->second(ToNumber(row[1]), ToNumber(row[2]), ToNumber(row[3]));
    EXPECT_NEAR(actual, expected, 2e-15 * std::fabs(expected))
        << row[0] << " of " << row[1] << ", " << row[2] << ", " << row[3];
    ++rows[row[0]];
  }
  for (const auto& function : Functions())
    EXPECT_GT(rows[function.first], 0) << function.first;
}

TEST(MCDistFun, NormalFunctionsAgreeAcrossTheirRanges) {
  for (double x = -37.5; x < 9.0; x += 0.01) {
    const double below = DistFunWorkers::derfc(-x / std::sqrt(2.0)) / 2.0;
    // The quotient is rounded, which its square carries into the tail.
    EXPECT_NEAR(MCDistFun::CdfStdNorm(x), below, (4.0 + x * x) * kEps * below) << x;
    EXPECT_NEAR(DistFunWorkers::derf(x) + DistFunWorkers::derfc(x), 1.0, 4.0 * kEps) << x;
    EXPECT_EQ(DistFunWorkers::derf(-x), -DistFunWorkers::derf(x)) << x;
  }
  EXPECT_EQ(DistFunWorkers::derf(0.0), 0.0);
  EXPECT_EQ(DistFunWorkers::derfc(0.0), 1.0);
  EXPECT_EQ(DistFunWorkers::derf(6.9), 1.0);
  EXPECT_EQ(DistFunWorkers::derfc(27.0), 0.0);
  EXPECT_EQ(DistFunWorkers::derfc(-27.0), 2.0);
  EXPECT_EQ(MCDistFun::CdfNorm(5.0, 3.0, 2.0), MCDistFun::CdfStdNorm(1.0));
  EXPECT_EQ(MCDistFun::IdfNorm(0.975, 3.0, 2.0), MCDistFun::IdfStdNorm(0.975) * 2.0 + 3.0);
}

TEST(MCDistFun, ClosedFormsHold) {
  for (const double x : {1e-12, 0.003, 0.4, 1.0, 2.75, 30.0, 1e5, 1e200}) {
    EXPECT_DOUBLE_EQ(MCDistFun::SigT(x, 1.0), std::atan(1.0 / x) / kPi) << x;
    EXPECT_NEAR(MCDistFun::SigT(-x, 1.0), 0.5 + std::atan(x) / kPi, kEps) << x;
    // df = 2: 1/2 - x / (2 sqrt(2 + x^2)), put so that nothing cancels.
    const double root = std::hypot(std::sqrt(2.0), x);
    const double tail = 1.0 / (root * (root + x));
    if (tail > 0.0) {
      EXPECT_NEAR(MCDistFun::SigT(x, 2.0), tail, 8.0 * kEps * tail) << x;
    }
    if (x > 700.0) continue;
    EXPECT_NEAR(MCDistFun::SigChi(2.0 * x, 2.0), std::exp(-x), 4.0 * kEps * std::exp(-x)) << x;
    EXPECT_NEAR(MCDistFun::SigChi(2.0 * x, 4.0), std::exp(-x) * (1.0 + x),
                (8.0 + x) * kEps * std::exp(-x) * (1.0 + x))
        << x;
    EXPECT_NEAR(MCDistFun::CdfGam(x, 1.0, 0.5), -std::expm1(-0.5 * x), kEps * -std::expm1(-0.5 * x)) << x;
  }
  EXPECT_DOUBLE_EQ(MCDistFun::CdfGam(2.0, 1.0, 0.5), 1.0 - std::exp(-1.0));
  for (const double x : {1e-100, 1e-9, 0.1, 0.5, 0.9375}) {
    // A power's exponent carries so many roundings of its size.
    const double tolerance = (8.0 - 2.0 * std::log(x)) * kEps;
    EXPECT_NEAR(MCDistFun::CdfBeta(x, 1.0, 1.0), x, tolerance * x) << x;
    EXPECT_NEAR(MCDistFun::CdfBeta(x, 2.0, 1.0), x * x, tolerance * x * x) << x;
    const double power = -std::expm1(2.5 * std::log1p(-x));
    EXPECT_NEAR(MCDistFun::CdfBeta(x, 1.0, 2.5), power, tolerance * power) << x;
  }
}

TEST(MCDistFun, TailsAddUpAndDistributionsMeet) {
  for (double log_df = -1.0; log_df <= 7.0; log_df += 0.17) {
    const double df = std::pow(10.0, log_df);
    for (const double p : {1e-12, 0.01, 0.3, 0.5, 0.8, 0.999}) {
      const double chi = MCDistFun::IdfChi(p, df);
      EXPECT_NEAR(MCDistFun::CdfChi(chi, df) + MCDistFun::SigChi(chi, df), 1.0, 2.0 * kEps)
          << chi << " " << df;
      EXPECT_NEAR(MCDistFun::CdfGam(chi, 0.5 * df, 0.5), MCDistFun::CdfChi(chi, df), 4.0 * kEps)
          << chi << " " << df;
      const double f = MCDistFun::IdfF(p, df, 7.5);
      EXPECT_NEAR(MCDistFun::CdfF(f, df, 7.5) + MCDistFun::SigF(f, df, 7.5), 1.0, 2.0 * kEps)
          << f << " " << df;
      // t^2 has an F distribution with 1 degree of freedom above.
      const double t = -MCDistFun::IdfT(0.5 * p, df);
      const double two_sided = 2.0 * MCDistFun::SigT(t, df);
      EXPECT_NEAR(MCDistFun::SigF(t * t, 1.0, df), two_sided, 20.0 * kEps * two_sided) << t << " " << df;
    }
  }
}

// The functions must never turn back; where a method hands over to the next they may stand still to rounding.
TEST(MCDistFun, DistributionsRiseAcrossTheirMethods) {
  for (double log_df = -1.0; log_df <= 7.0; log_df += 0.31) {
    const double df = std::pow(10.0, log_df);
    double last_chi = 0.0, last_f = 0.0, last_t = 0.0, last_beta = 0.0;
    for (int i = 1; i < 1500; ++i) {
      const double chi = MCDistFun::CdfChi(df * std::exp(0.004 * (i - 1000)), df);
      EXPECT_GE(chi, last_chi * (1.0 - 2e-15)) << df << " step " << i;
      last_chi = chi;
      const double f = MCDistFun::CdfF(std::exp(0.004 * (i - 1000)), df, 33.0);
      EXPECT_GE(f, last_f * (1.0 - 2e-15)) << df << " step " << i;
      last_f = f;
      const double t = MCDistFun::CdfT(0.02 * (i - 1000), df);
      EXPECT_GE(t, last_t * (1.0 - 2e-15)) << df << " step " << i;
      last_t = t;
      const double beta = MCDistFun::CdfBeta(i / 1500.0, df, 250.0);
      EXPECT_GE(beta, last_beta * (1.0 - 2e-15)) << df << " step " << i;
      last_beta = beta;
    }
  }
}

// How far a quantile's own rounding moves its logarithmic probability: the width in ln x is at least
// sqrt(shape).
double RoundTripTolerance(double p, double shape) {
  const double deviance = -std::log(p < 0.5 ? p : 1.0 - p);
  return 1e-14 + kEps * std::sqrt(2.0 * deviance * shape);
}

TEST(MCDistFun, InversesLeadBack) {
  for (double log_df = -1.0; log_df <= 7.0; log_df += 0.13) {
    const double df = std::pow(10.0, log_df);
    for (const double p : {1e-290, 1e-100, 1e-20, 1e-7, 0.003, 0.2, 0.4999, 0.6, 0.97, 0.9999999}) {
      SCOPED_TRACE(std::to_string(p) + " with " + std::to_string(df));
      const double tolerance = RoundTripTolerance(p, df);
      const double chi = MCDistFun::IdfChi(p, df);
      if (chi > 1e-300) {
        EXPECT_NEAR(MCDistFun::CdfChi(chi, df), p, tolerance * p);
      }
      const double gamma = MCDistFun::IdfGam(p, df, 3.7);
      if (gamma > 1e-300) {
        EXPECT_NEAR(MCDistFun::CdfGam(gamma, df, 3.7), p, tolerance * p);
      }
      const double f = MCDistFun::IdfF(p, df, 12.5);
      if (f > 1e-290) {
        EXPECT_NEAR(MCDistFun::CdfF(f, df, 12.5), p, tolerance * p);
      }
      const double t = MCDistFun::IdfT(p, df);
      if (t != kMissing) {
        EXPECT_NEAR(MCDistFun::CdfT(t, df), p, RoundTripTolerance(p, 1000.0) * p);
      }
      const double beta = MCDistFun::IdfBeta(p, df, 40.25);
      // Beside 1 the quantile has too few digits of its own.
      if (beta > 1e-290 && beta < 0.9) {
        EXPECT_NEAR(MCDistFun::CdfBeta(beta, df, 40.25), p, tolerance * p);
      }
    }
  }
}

// There the normal approximation that the search starts from lies hundreds of powers of ten away.
TEST(MCDistFun, FindsQuantilesInTheFarTailsOfShapesCloseToOne) {
  const struct {
    double found, expected;
    const char* why;
  } rows[] = {
      {MCDistFun::IdfBeta(1.7844122867831902e-259, 1.08855, 27.4173), 7.534422e-240, "beta"},
      {MCDistFun::IdfBeta(2.398276742341017e-262, 1.13795, 4.33831), 2.991555e-231, "beta, small shapes"},
      {MCDistFun::IdfF(1.2264911584754121e-296, 2.12627, 364817), 4.429916e-279, "F, many df"},
      {MCDistFun::IdfF(7.672876663251049e-262, 2.02024, 21153), 3.151004e-259, "F"},
  };
  for (const auto& row : rows) {
    // As many digits as the shapes are given with.
    EXPECT_NEAR(row.found, row.expected, 2e-5 * row.expected) << row.why;
  }
  EXPECT_NEAR(MCDistFun::CdfBeta(MCDistFun::IdfBeta(1e-259, 1.08855, 27.4173), 1.08855, 27.4173), 1e-259,
              1e-271);
  EXPECT_NEAR(MCDistFun::CdfF(MCDistFun::IdfF(1e-296, 2.12627, 364817), 2.12627, 364817), 1e-296, 1e-308);
}

TEST(MCDistFun, TailQuantilesOfTheNormalLeadBack) {
  for (double log_p = -307.0; log_p < -0.31; log_p += 0.37) {
    const double p = std::pow(10.0, log_p);
    EXPECT_NEAR(MCDistFun::CdfStdNorm(MCDistFun::IdfStdNorm(p)), p, 1e-12 * p);
  }
}

// A sum of logarithms of the binomial's factors, each exact to rounding.
TEST(MCDistFun, LogBinomialCoefficientsFollowTheirRecurrence) {
  long err = 7;
  EXPECT_EQ(DistFunWorkers::dnlbnc(10.0, 0.0, err), 0.0);
  EXPECT_EQ(err, 0);
  EXPECT_EQ(DistFunWorkers::dnlbnc(10.0, 10.0, err), 0.0);
  double sum = 0.0;
  for (int k = 1; k <= 60; ++k) {
    sum += std::log((1000.0 - k + 1.0) / k);
    EXPECT_NEAR(DistFunWorkers::dnlbnc(1000.0, k, err), sum, 1e-14 * sum) << k;
  }
}

}  // namespace
