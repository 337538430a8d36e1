// Distribution functions where intermediate results leave the format, or nearly, while the result does not.

#include <gtest/gtest.h>

#include <cmath>

#include "kestrel/foundation/MCMV.h"
#include "kestrel/math/MCDistFun.h"

namespace {

using MCMath_800::MCDistFun;

constexpr double kMissing = MCCommon_800::MCMV::gMissingValue;

// The values were computed with mpmath, 40 digits.
TEST(DistFunEdge, KeepsItsDigitsWherePartsOfAResultAreTooSmall) {
  const struct {
    const char* why;
    double value, expected;
  } rows[] = {
      {"the last of three steps is below the normal numbers", MCDistFun::CdfBeta(0.5, 1020.0, 3.25),
       4.3404648197522778929e-302},
      {"the same beside 1", MCDistFun::CdfBeta(0.738, 2337.0, 3.25), 3.2645296133573074919e-303},
      {"a part and a half", MCDistFun::CdfBeta(0.738, 2300.0, 1.5), 9.3850846505527635127e-303},
      {"odds near the end of the format",
       MCDistFun::CdfF(1.1755382575160867e+301, 6.8773642200660145e-14, 1.1623289298336589e-19),
       1.6900762097870524478e-6},
      {"a quotient beyond it, odds inside", MCDistFun::SigF(1.1e303, 6e-67, 0.0138),
       9.8035298725336404591e-67},
      {"a quotient beyond it the other way", MCDistFun::SigF(1e-300, 3.0, 1e-200), 1.0},
      {"the upper tail of a small shape", MCDistFun::IdfGam(0.997, 0.005, 1.0), 0.46947926501152130721},
  };
  for (const auto& row : rows)
    EXPECT_NEAR(row.value, row.expected, 2e-15 * row.expected) << row.why;
}

TEST(DistFunEdge, TellsTheSidesOfAMeanBeside1) {
  // The beta distribution is narrower than a unit in the last place of x; x is 1.2 % of 1 - mean below it, or
  // 0.01 % above.
  EXPECT_EQ(MCDistFun::CdfBeta(0.99999999999999967, 1.3474463933750624e+258, 4.4364449302955494e+242), 0.0);
  EXPECT_EQ(MCDistFun::CdfBeta(0.99999999999970224, 4.5061458980597502e+232, 1.3418997578011918e+220), 1.0);
}

TEST(DistFunEdge, TakesAsManyDegreesOfFreedomAsThereAre) {
  // With so many t is normal; the square of x leaves the format, its quotient by df does not.
  EXPECT_EQ(MCDistFun::CdfT(-1.5249991873269134e+231, 2.6331632542201074e+306), 0.0);
  EXPECT_EQ(MCDistFun::SigT(3.2449679431321667e+282, 1.2836550084475334e+306), 0.0);
  EXPECT_NEAR(MCDistFun::SigT(1.5, 1.2836550084475334e+306), MCDistFun::CdfStdNorm(-1.5), 1e-15);
}

TEST(DistFunEdge, PutsQuantilesAtTheEndOfTheFormat) {
  EXPECT_EQ(MCDistFun::IdfBeta(0.44788739676632855, 1.8253825604672876e+83, 1.7358391982700955e-08), 1.0);
  EXPECT_EQ(MCDistFun::IdfT(3.9018641310086452e-85, 2.2443465892275746e-307), kMissing);
  // x^shape / Gamma(1 + shape) is all there is to the distribution.
  const double x = MCDistFun::IdfGam(2.0619823977631433e-251, 0.836429, 1.0);
  EXPECT_NEAR(std::log(x), (std::log(2.0619823977631433e-251) + std::lgamma(1.836429)) / 0.836429, 1e-12);
  EXPECT_NEAR(MCDistFun::CdfGam(x, 0.836429, 1.0), 2.0619823977631433e-251, 2e-15 * 2.0619823977631433e-251);
}

}  // namespace
