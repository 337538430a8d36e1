// Non-central t, chi-square and F: edges, identities between them, and the search for the parameter. The
// reference values are in tests/data/math/noncentral_*.csv.

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
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

TEST(NonCentral, GivesReferenceValues) {
  struct Row {
    const char* why;
    double value, want, digits;
  };
  // mpmath, 25 digits.
  const Row kRows[] = {
      {"t, both signs alike", MCDistFun::NonCentralCdfT(3.02313, 33.5, 3.0803), 0.4698709742765841024412138,
       1e-14},
      {"t across zero", MCDistFun::NonCentralCdfT(-0.01231364, 5.95348, 0.012268),
       1.0 - MCDistFun::NonCentralCdfT(0.01231364, 5.95348, -0.012268), 1e-12},
      {"t below a negative parameter", MCDistFun::NonCentralCdfT(-1.455133, 16.3596, -1.9711),
       0.6991600311918548094552705, 1e-14},
      {"t above a negative parameter", MCDistFun::NonCentralCdfT(0.1949274, 48844.9, 0.14531),
       0.519785958369346911703419, 1e-13},
      {"t, far lower tail", MCDistFun::NonCentralCdfT(-21.41134, 24164.6, -0.017789),
       6.60593821082961595655962e-101, 1e-10},
      {"t, farther", MCDistFun::NonCentralCdfT(-61299930000.0, 20.8637, 0.86639),
       6.441771815956448058451119e-215, 1e-10},
      {"chi-square", MCDistFun::NonCentralCdfChi(741.0085, 678.769, 0.45426), 0.9500636557189442604615252,
       1e-14},
      {"chi-square, large parameters", MCDistFun::NonCentralCdfChi(109662.7, 100000.0, 9664.8),
       0.4988735942824718082570681, 1e-12},
      {"chi-square, far lower tail", MCDistFun::NonCentralCdfChi(25205.15, 32189.7, 1789.7),
       2.815339300930645541028145e-286, 1e-10},
      {"F", MCDistFun::NonCentralCdfF(1.238296, 2173.84, 30629.2, 517.78), 0.5045865352109125218038437,
       1e-12},
      {"F, many terms", MCDistFun::NonCentralCdfF(2.946115, 3945.23, 645.637, 7772.2),
       0.4382980305089065957222037, 1e-12},
      {"F, few degrees of freedom", MCDistFun::NonCentralCdfF(6231.493, 0.301546, 9.71155, 1339.1),
       0.7085834053381466597485127, 1e-12},
  };
  for (const Row& row : kRows)
    EXPECT_NEAR(row.value, row.want, row.digits * row.want) << row.why;
}

// Where exponents are large, sums long, or the smaller side is not the one beyond the mean.
TEST(NonCentral, KeepsAllDigits) {
  struct Row {
    const char* why;
    double value, want;
  };
  // mpmath, 25 digits.
  const Row kRows[] = {
      {"t across zero, far tail", MCDistFun::NonCentralCdfT(-48.56055, 654.714, 0.066867),
       3.7517526286606329371454e-220},
      {"t by an integral, far tail", MCDistFun::NonCentralCdfT(16.21802, 3514.29, 49.827),
       6.972233006375596218175666e-239},
      {"t, far tail", MCDistFun::NonCentralCdfT(6.573181, 15296.9, 37.093), 1.370195632428939562423715e-204},
      {"t, few degrees of freedom", MCDistFun::NonCentralCdfT(50.88224, 0.673804, 47.633),
       0.308189601683692959324524},
      {"chi-square, many terms", MCDistFun::NonCentralCdfChi(4371.018, 3911.77, 466.45),
       0.4737768461090652675340649},
      {"F, hundreds of terms near x = 1", MCDistFun::NonCentralCdfF(1185.723, 0.357723, 0.155985, 398.91),
       0.1555596866352762630213954},
      {"F, heavy upper tail", MCDistFun::NonCentralCdfF(7.446715, 30, 0.194541, 195.63),
       0.169939934273052628157184},
      {"F, heavier", MCDistFun::NonCentralCdfF(207.4917, 4.03256, 0.12094, 832.68),
       0.1316942124930466630714622},
      {"F, the other side by its sum", MCDistFun::NonCentralCdfF(3.122418, 49566, 0.111673, 328.85),
       0.1776010084706902945043235},
  };
  for (const Row& row : kRows)
    EXPECT_NEAR(row.value, row.want, 2e-15 * row.want) << row.why;
}

// With so few degrees of freedom below, the share above the mean is near 0.85: what is left of 1 has six
// times its error.
TEST(NonCentral, KeepsAllDigitsOfTheSmallerSideOfASkewDistribution) {
  struct Row {
    double x, df1, df2, nc, want;
  };
  // mpmath, 25 digits.
  const Row kRows[] = {
      {3.016161, 2486.71, 0.15027, 5013.6, 0.1485171966631845029571015},
      {1.55017, 3747.52, 0.174254, 8358.3, 0.111618118456710087170872},
      {262.86, 6.5, 0.1, 1358.7, 0.1272503801912024460564121},
      {368.2601, 18.415, 0.204589, 6762.5, 0.1744480442220499475918992},
      {88.30927, 326.38, 0.10603, 9745.8, 0.1681013986420509712223407},
      {245.9782, 0.5, 0.118265, 161.98, 0.1169767282440506790179387},
      {0.0001130421, 5434.51, 0.106683, 3090.4, 7.1649498415569128245367e-293},
  };
  for (const Row& row : kRows) {
    const double share = MCDistFun::NonCentralCdfF(row.x, row.df1, row.df2, row.nc);
    EXPECT_NEAR(share, row.want, 1.1e-15 * row.want) << row.x;
    const double above = MCDistFun::NonCentralCdfF(row.x, row.df1, row.df2, row.nc, true);
    EXPECT_NEAR(above, 1.0 - row.want, 2e-16) << row.x;
  }
}

// Around the mean both sides come from one line of integration, elsewhere from another each: no step shows
// where one ends. Eighth differences at such a distance are nothing but rounding errors, the shares'
// own and what x's last digit makes of them.
TEST(NonCentral, IsSmoothAcrossTheMean) {
  constexpr double kDifference[] = {1, -8, 28, -56, 70, -56, 28, -8, 1};
  constexpr int kPoints = 600;
  for (const double df2 : {0.05, 0.3, 4.0, 2000.0}) {
    for (const double nc : {700.0, 9000.0}) {
      const double df1 = 12.0;
      const double scale = std::min(1.0, std::sqrt(2.0 / df2 + 4.0 / nc));
      const double rounding = 256.0 * 0x1p-53 * (2.0 + 0.4 / scale);
      std::vector<double> shares;
      for (int i = 0; i < kPoints; ++i) {
        const double x = (1.0 + nc / df1) * std::exp(0.005 * scale * (i - kPoints / 2));
        shares.push_back(MCDistFun::NonCentralCdfF(x, df1, df2, nc));
        const double above = MCDistFun::NonCentralCdfF(x, df1, df2, nc, true);
        EXPECT_NEAR(shares.back() + above, 1.0, 1e-15) << x << " " << df2 << " " << nc;
        if (i < 8) continue;
        double difference = 0.0;
        for (int k = 0; k <= 8; ++k)
          difference += kDifference[k] * shares[i - k];
        EXPECT_NEAR(difference, 0.0, rounding) << x << " " << df2 << " " << nc;
      }
    }
  }
}

TEST(NonCentral, IsTheCentralDistributionAtZero) {
  for (const double df : {0.5, 3.0, 250.0}) {
    for (const double x : {0.1, 1.0, 7.0}) {
      EXPECT_NEAR(MCDistFun::NonCentralCdfChi(x, df, 0.0), MCDistFun::CdfChi(x, df), 1e-15);
      EXPECT_NEAR(MCDistFun::NonCentralCdfT(x, df, 0.0), MCDistFun::CdfT(x, df), 1e-15);
      EXPECT_NEAR(MCDistFun::NonCentralCdfT(-x, df, 0.0), MCDistFun::CdfT(-x, df), 1e-15);
      EXPECT_NEAR(MCDistFun::NonCentralCdfF(x, df, 8.0, 0.0), MCDistFun::CdfF(x, df, 8.0), 1e-15);
      EXPECT_NEAR(MCDistFun::NonCentralCdfChi(x, df, 1e-300), MCDistFun::CdfChi(x, df), 1e-15);
      EXPECT_NEAR(MCDistFun::NonCentralCdfT(x, df, 1e-300), MCDistFun::CdfT(x, df), 1e-15);
    }
  }
}

// With one degree of freedom chi-square is the square of a shifted normal number, and F that of a t.
TEST(NonCentral, AgreesAcrossFamilies) {
  for (const double nc : {0.01, 0.7, 3.0, 20.0, 300.0, 9000.0}) {
    for (const double away : {-5.0, -1.0, 0.0, 2.0}) {
      const double x = nc + away;
      if (x <= 0.0) continue;
      const double square = MCDistFun::NonCentralCdfChi(x * x, 1.0, nc * nc);
      const double normal = MCDistFun::CdfStdNorm(x - nc) - MCDistFun::CdfStdNorm(-x - nc);
      EXPECT_NEAR(square, normal, 1e-10 * normal) << nc << " " << away;
      for (const double df : {0.3, 5.0, 80.0, 1e6}) {
        const double t = MCDistFun::NonCentralCdfT(x, df, nc) - MCDistFun::NonCentralCdfT(-x, df, nc);
        const double f = MCDistFun::NonCentralCdfF(x * x, 1.0, df, nc * nc);
        EXPECT_NEAR(t, f, 1e-10) << nc << " " << away << " " << df;
        const double above = MCDistFun::NonCentralCdfF(x * x, 1.0, df, nc * nc, true);
        EXPECT_NEAR(f + above, 1.0, 1e-12) << nc << " " << away << " " << df;
      }
    }
  }
}

TEST(NonCentral, RisesWithXAndFallsWithTheParameter) {
  for (const double df : {0.1, 2.0, 40.0, 1e5}) {
    for (const double nc : {0.5, 30.0, 1000.0, 2e5}) {
      double before = 0.0;
      for (double x = 0.25 * (df + nc); x < 4.0 * (df + nc); x *= 1.1) {
        const double share = MCDistFun::NonCentralCdfChi(x, df, nc);
        EXPECT_GE(share, before * (1.0 - 1e-11)) << x << " " << df << " " << nc;
        EXPECT_LE(MCDistFun::NonCentralCdfChi(x, df, nc * 1.01), share * (1.0 + 1e-11))
            << x << " " << df << " " << nc;
        before = share;
      }
      EXPECT_GT(before, 0.5);
    }
  }
}

TEST(NonCentral, RefusesWhatIsOutsideTheDomain) {
  struct Row {
    const char* why;
    double value;
  };
  const Row kRows[] = {
      {"t: NaN as x", MCDistFun::NonCentralCdfT(kNaN, 3, 1)},
      {"t: no degree of freedom", MCDistFun::NonCentralCdfT(1, 0, 1)},
      {"t: NaN as df", MCDistFun::NonCentralCdfT(1, kNaN, 1)},
      {"t: too many degrees of freedom", MCDistFun::NonCentralCdfT(1, 1.1e10, 1)},
      {"t: parameter past its limit", MCDistFun::NonCentralCdfT(1, 3, -3.1e4)},
      {"t: NaN as parameter", MCDistFun::NonCentralCdfT(1, 3, kNaN)},
      {"chi-square: negative parameter", MCDistFun::NonCentralCdfChi(1, 3, -1e-9)},
      {"chi-square: parameter past its limit", MCDistFun::NonCentralCdfChi(1, 3, 1.1e9)},
      {"chi-square: NaN as x", MCDistFun::NonCentralCdfChi(kNaN, 3, 1)},
      {"chi-square: infinite df", MCDistFun::NonCentralCdfChi(1, kInfinity, 1)},
      {"F: negative df1", MCDistFun::NonCentralCdfF(1, -3, 4, 1)},
      {"F: no df2", MCDistFun::NonCentralCdfF(1, 3, 0, 1)},
      {"F: NaN as parameter", MCDistFun::NonCentralCdfF(1, 3, 4, kNaN)},
      {"search t: p is 0", MCDistFun::FindNCParamT(1, 3, 0.0)},
      {"search t: p is 1", MCDistFun::FindNCParamT(1, 3, 1.0)},
      {"search t: p is too small to search by", MCDistFun::FindNCParamT(1, 3, 1e-310)},
      {"search t: out of reach", MCDistFun::FindNCParamT(1e10, 1e9, 0.5)},
      {"search chi-square: p above the central one", MCDistFun::FindNCParamChi(1, 3, 0.9)},
      {"search chi-square: out of reach", MCDistFun::FindNCParamChi(1e300, 3, 0.5)},
      {"search F: out of reach", MCDistFun::FindNCParamF(1e300, 3, 1e9, 0.5)},
      {"search chi-square: x is 0", MCDistFun::FindNCParamChi(0, 3, 0.5)},
      {"search chi-square: NaN as p", MCDistFun::FindNCParamChi(5, 3, kNaN)},
      {"search F: p above the central one", MCDistFun::FindNCParamF(0.1, 3, 5, 0.9)},
      {"search F: no df1", MCDistFun::FindNCParamF(2, 0, 5, 0.1)},
  };
  for (const Row& row : kRows)
    EXPECT_EQ(row.value, kMissing) << row.why;
  EXPECT_EQ(MCDistFun::NonCentralCdfChi(0, 3, 1), 0.0);
  EXPECT_EQ(MCDistFun::NonCentralCdfF(-1, 3, 4, 1), 0.0);
  EXPECT_EQ(MCDistFun::NonCentralCdfF(-1, 3, 4, 1, true), 1.0);
}

// Every x has a share, also where squares and products overflow.
TEST(NonCentral, ReachesTheEndsOfTheLine) {
  for (const double df : {0.01, 3.0, 1e3, 1e10}) {
    for (const double nc : {0.0, 1e-300, 1e-5, 2.0, 300.0, 2e4}) {
      double t = 0.0, chi = 0.0, f = 0.0, negative = 1.0;
      for (double x = 1e-300; x < 1e305; x *= 1e5) {
        const double up[] = {MCDistFun::NonCentralCdfT(x, df, nc), MCDistFun::NonCentralCdfChi(x, df, nc),
                             MCDistFun::NonCentralCdfF(x, 4.0, df, nc)};
        const double down = MCDistFun::NonCentralCdfT(-x, df, nc);
        for (const double share : {up[0], up[1], up[2], down})
          ASSERT_TRUE(share >= 0.0 && share <= 1.0) << x << " " << df << " " << nc << ": " << share;
        EXPECT_GE(up[0], t * (1.0 - 1e-12)) << "t at " << x << " " << df << " " << nc;
        EXPECT_GE(up[1], chi * (1.0 - 1e-12)) << "chi-square at " << x << " " << df << " " << nc;
        EXPECT_GE(up[2], f * (1.0 - 1e-12)) << "F at " << x << " " << df << " " << nc;
        EXPECT_LE(down, negative * (1.0 + 1e-12)) << "t at " << -x << " " << df << " " << nc;
        t = up[0];
        chi = up[1];
        f = up[2];
        negative = down;
      }
      EXPECT_EQ(chi, 1.0) << df << " " << nc;
    }
  }
}

// Far out a tail of t falls with the power df of x.
TEST(NonCentral, FollowsThePowerLawPastTheSquareOfNumbers) {
  for (const double df : {0.01, 0.3, 1.0}) {
    for (const double nc : {-3.0, 0.0, 0.5, 20.0}) {
      const double near = MCDistFun::NonCentralCdfT(-1e130, df, nc);
      const double far = MCDistFun::NonCentralCdfT(-1e250, df, nc);
      EXPECT_NEAR(far, near * std::pow(1e-120, df), 1e-12 * far) << df << " " << nc;
    }
  }
  EXPECT_NEAR(MCDistFun::NonCentralCdfT(-1e200, 0.3, MCDistFun::FindNCParamT(-1e200, 0.3, 1e-62)), 1e-62,
              1e-74);
}

TEST(NonCentral, SearchTurnsTheProbabilityBack) {
  for (const double df : {0.2, 3.0, 25.0, 4000.0}) {
    for (const double x : {0.5, 4.0, 60.0}) {
      const double central = MCDistFun::CdfChi(x, df);
      const double centralF = MCDistFun::CdfF(x, df, 12.0);
      for (const double share : {1e-9, 0.01, 0.2, 0.7, 0.999}) {
        const double p = share * central;
        if (p > 1e-290) {
          const double nc = MCDistFun::FindNCParamChi(x, df, p);
          EXPECT_NEAR(MCDistFun::NonCentralCdfChi(x, df, nc), p, 1e-12 * p) << x << " " << df << " " << p;
        }
        const double pF = share * centralF;
        const double ncF = MCDistFun::FindNCParamF(x, df, 12.0, pF);
        EXPECT_NEAR(MCDistFun::NonCentralCdfF(x, df, 12.0, ncF), pF, 1e-12 * pF) << x << " " << df;
        for (const double sign : {-1.0, 1.0}) {
          const double ncT = MCDistFun::FindNCParamT(sign * x, df, share);
          EXPECT_NEAR(MCDistFun::NonCentralCdfT(sign * x, df, ncT), share, 2e-12 * share)
              << sign * x << " " << df << " " << share;
        }
      }
    }
  }
  EXPECT_EQ(MCDistFun::FindNCParamChi(4.0, 3.0, MCDistFun::NonCentralCdfChi(4.0, 3.0, 0.0)), 0.0);
}

TEST(NonCentral, NoBitPatternGivesInfinityOrNaNAndNothingAllocates) {
  kestrel_tests::BitPatterns patterns(21);
  const size_t before = kestrel_tests::CountAllocations();
  for (int i = 0; i < 100000; ++i) {
    const double a = patterns.Next(), b = patterns.Next(), c = patterns.Next(), d = patterns.Next();
    ASSERT_TRUE(std::isfinite(MCDistFun::NonCentralCdfT(a, b, c))) << a << " " << b << " " << c;
    ASSERT_TRUE(std::isfinite(MCDistFun::NonCentralCdfChi(a, b, c))) << a << " " << b << " " << c;
    ASSERT_TRUE(std::isfinite(MCDistFun::NonCentralCdfF(a, b, c, d)))
        << a << " " << b << " " << c << " " << d;
    ASSERT_TRUE(std::isfinite(MCDistFun::FindNCParamT(a, b, c))) << a << " " << b << " " << c;
    ASSERT_TRUE(std::isfinite(MCDistFun::FindNCParamChi(a, b, c))) << a << " " << b << " " << c;
    ASSERT_TRUE(std::isfinite(MCDistFun::FindNCParamF(a, b, c, d))) << a << " " << b << " " << c << " " << d;
  }
  EXPECT_EQ(kestrel_tests::CountAllocations(), before);
}

}  // namespace
