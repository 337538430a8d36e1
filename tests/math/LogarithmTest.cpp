// The logarithm to base 10 to the last bit, on every system.

#include "kestrel/math/Logarithm.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace {

using MCMath_800::DecimalLogarithm;

struct Row {
  double x;
  double logarithm;
};

// Computed with 60 digits (mpmath) and rounded once.
constexpr Row kRows[] = {
    {0x1p-1074, -0x1.434e6420f4374p+8},
    {0x1.8p-1060, -0x1.3eea6b963a932p+8},
    {0x1p-1022, -0x1.33a7146f72a42p+8},
    {1e-300, -0x1.2c00000000000p+8},
    {1e-9, -0x1.2000000000000p+3},
    {0.001, -0x1.8000000000000p+1},
    {0.1, -0x1p+0},
    {0.2, -0x1.65df657b04300p-1},
    {0.5, -0x1.34413509f79ffp-2},
    {0.7, -0x1.3d3d3d21ccf04p-3},
    {0.99, -0x1.1e0d4874f92f2p-8},
    {0x1.fffffffffffffp-1, -0x1.bcb7b1526e50fp-55},
    {0x1.0000000000001p+0, 0x1.bcb7b1526e50dp-54},
    {1.01, 0x1.1b349f11fb5bfp-8},
    {1.6, 0x1.a209a84fbcff8p-3},
    {2.0, 0x1.34413509f79ffp-2},
    {2.5, 0x1.977d95ec10c02p-2},
    {2.718281828459045, 0x1.bcb7b1526e50ep-2},
    {3.0, 0x1.e8927964fd5fdp-2},
    {7.9, 0x1.cb95c732312ddp-1},
    {10.0, 0x1p+0},
    {1000.0, 0x1.8000000000000p+1},
    {1e15, 0x1.e000000000000p+3},
    {1e22, 0x1.6000000000000p+4},
    {123456.789, 0x1.45db61a282512p+2},
    {0x1p900, 0x1.0eed4f9dc2a39p+8},
    {1e299, 0x1.2b00000000000p+8},
    {1e300, 0x1.2c00000000000p+8},
    {0x1.fffffffffffffp+1023, 0x1.34413509f79ffp+8},
};

TEST(DecimalLogarithm, IsRoundedOnce) {
  for (const Row& row : kRows)
    EXPECT_EQ(DecimalLogarithm(row.x), row.logarithm) << row.x;
}

TEST(DecimalLogarithm, IsExactForPowersOfTen) {
  // Every power of ten that is a double.
  double power = 1.0;
  for (int exponent = 0; exponent <= 22; ++exponent, power *= 10.0)
    EXPECT_EQ(DecimalLogarithm(power), exponent);
}

// Numbers on both sides go different ways there.
TEST(DecimalLogarithm, GoesOnWhereTheRangesMeet) {
  constexpr double kInfinity = std::numeric_limits<double>::infinity();
  for (const double edge : {std::numeric_limits<double>::min(), 0.99, 1.01, 0x1p900}) {
    const double middle = DecimalLogarithm(edge);
    const double step = std::nextafter(edge, kInfinity) / edge - 1.0;
    const double most = std::fabs(middle) * 0x1p-52 + step;
    EXPECT_NEAR(DecimalLogarithm(std::nextafter(edge, 0.0)), middle, most) << edge;
    EXPECT_NEAR(DecimalLogarithm(std::nextafter(edge, kInfinity)), middle, most) << edge;
  }
}

TEST(DecimalLogarithm, OfWhatHasNoneIsTheLibrarys) {
  constexpr double kInfinity = std::numeric_limits<double>::infinity();
  EXPECT_EQ(DecimalLogarithm(0.0), -kInfinity);
  EXPECT_EQ(DecimalLogarithm(kInfinity), kInfinity);
  EXPECT_TRUE(std::isnan(DecimalLogarithm(-1.0)));
  EXPECT_TRUE(std::isnan(DecimalLogarithm(std::numeric_limits<double>::quiet_NaN())));
}

}  // namespace
