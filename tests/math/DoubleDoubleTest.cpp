// Sums, products and quotients of two doubles, held against results that are known to every bit.

#include <gtest/gtest.h>

#include <cmath>

#include "kestrel/math/DoubleDouble.h"

namespace {

using MCMath_800::AddExactly;
using MCMath_800::AddOrdered;
using MCMath_800::DoubleDouble;
using MCMath_800::HeadAndTail;
using MCMath_800::HeadOf;
using MCMath_800::MultiplyExactly;
using MCMath_800::Split;

void ExpectParts(DoubleDouble actual, double high, double low, const char* why) {
  EXPECT_EQ(actual.high, high) << why;
  EXPECT_EQ(actual.low, low) << why;
}

TEST(DoubleDouble, AddsWithoutRounding) {
  ExpectParts(AddExactly(1.0, 0x1p-60), 1.0, 0x1p-60, "the smaller second");
  ExpectParts(AddExactly(0x1p-60, 1.0), 1.0, 0x1p-60, "the smaller first");
  ExpectParts(AddOrdered(1.0, -0x1p-60), 1.0, -0x1p-60, "a difference");
  ExpectParts(AddExactly(0x1p53, 1.0), 0x1p53, 1.0, "half a unit");
  ExpectParts(AddExactly(1e300, -1e300), 0.0, 0.0, "nothing left");
}

TEST(DoubleDouble, MultipliesWithoutRounding) {
  ExpectParts(MultiplyExactly(0x1p40 + 1.0, 0x1p40 - 1.0), 0x1p80, -1.0, "(2^40 + 1) (2^40 - 1)");
  ExpectParts(MultiplyExactly(0x1p27 + 1.0, 0x1p27 + 1.0), 0x1p54 + 0x1p28, 1.0, "(2^27 + 1)^2");
  ExpectParts(MultiplyExactly(1.0 + 0x1p-52, 1.0 + 0x1p-52), 1.0 + 0x1p-51, 0x1p-104, "(1 + 2^-52)^2");
  ExpectParts(MultiplyExactly(1e300, 0x1p10), 1e300 * 0x1p10, 0.0, "near the end of the format");
  const DoubleDouble difference = DoubleDouble(0x1p40, 0x1p-20) * DoubleDouble(0x1p40, -0x1p-20) - 0x1p80;
  EXPECT_EQ(difference.high, 0.0) << "2^-40 is beyond the digits that are kept";
}

TEST(DoubleDouble, DividesWithTwiceTheDigits) {
  const DoubleDouble third = DoubleDouble(1.0) / 3.0;
  EXPECT_EQ(third.high, 1.0 / 3.0);
  // 1/3 as a double is (1 - 2^-54) / 3.
  EXPECT_EQ(third.low, 0x1p-54 / 3.0);
  for (const double divisor : {3.0, 7.0, 0.1, 1e-5, 123456789.0, 1.0 + 0x1p-52}) {
    const DoubleDouble rest = DoubleDouble(1.0) / divisor * divisor - 1.0;
    EXPECT_LE(std::fabs(rest.high + rest.low), 0x1p-100) << divisor;
    const DoubleDouble both = DoubleDouble(divisor, divisor * 0x1p-55);
    const DoubleDouble rest_of_both = DoubleDouble(5.0) / both * both - 5.0;
    EXPECT_LE(std::fabs(rest_of_both.high + rest_of_both.low), 5.0 * 0x1p-100) << divisor;
  }
}

TEST(DoubleDouble, SplitsIntoAHeadWhoseProductsAreExact) {
  for (const double number : {1.0 / 3.0, -1e-300 / 7.0, 1e300 / 7.0, 12345.678901234567}) {
    const double head = HeadOf(number);
    EXPECT_LE(std::fabs(number - head), std::ldexp(std::fabs(number), -25)) << number;
    int exponent = 0;
    const double bits = std::ldexp(std::frexp(head, &exponent), 26);
    EXPECT_EQ(std::floor(bits), bits) << number;
    const HeadAndTail parts = Split({number, number * 0x1p-54});
    EXPECT_EQ(parts.head, head);
    EXPECT_EQ(parts.tail, (number - head) + number * 0x1p-54);
  }
}

}  // namespace
