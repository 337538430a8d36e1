#include "kestrel/math/MCPower.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "kestrel/foundation/MCMV.h"
#include "tests/math/BitPatterns.h"

namespace {

using MCMath_800::MCPower;

constexpr double kMissing = MCCommon_800::MCMV::gMissingValue;
constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kLargest = std::numeric_limits<double>::max();
constexpr double kEps = MCPower::gMachineEpsilon;

TEST(MCPower, ConstantsAreTheMachines) {
  static_assert(MCPower::gMachineEpsilon == std::numeric_limits<double>::epsilon());
  static_assert(MCPower::gMachineMaxInt == 2147483647);
  static_assert(MCPower::gMachineMaxExp == 709.0);
  static_assert(MCPower::gMachineMinExp == -708.39);
  EXPECT_EQ(MCPower::MaxExp(), MCPower::gMachineMaxExp);
  EXPECT_EQ(MCPower::MinExp(), MCPower::gMachineMinExp);
  EXPECT_EQ(MCPower::MaxInt(), MCPower::gMachineMaxInt);
  EXPECT_EQ(MCPower::MEpsilon(), MCPower::gMachineEpsilon);
}

TEST(MCPower, StatusCodesAreFixed) {
  EXPECT_EQ(MCPower::PowerOk, 0);
  EXPECT_EQ(MCPower::PowerUnderflow, 1);
  EXPECT_EQ(MCPower::PowerOverflow, 2);
  EXPECT_EQ(MCPower::PowerNegOverflow, 3);
  EXPECT_EQ(MCPower::PowerNegBaseNotInteger, 4);
  EXPECT_EQ(MCPower::PowerNegBaseZeroExp, 5);
  EXPECT_EQ(MCPower::PowerZeroNegExp, 6);
  EXPECT_EQ(MCPower::PowerZeroZero, 7);
}

struct LimitRow {
  const char* why;
  double x;
  bool overflow;
  bool underflow;
};

constexpr LimitRow kLimitRows[] = {
    // why                       x                 overflow underflow
    {"the upper limit is in", 709.0, false, false},
    {"above the upper limit", 709.0000000000001, true, false},
    {"the lower limit is in", -708.39, false, false},
    {"below the lower limit", -708.3900000000001, false, true},
    {"zero", 0.0, false, false},
    {"infinity", kInfinity, true, false},
    {"minus infinity", -kInfinity, false, true},
    {"no number", kNaN, false, false},
};

TEST(MCPower, TellsWhatTheExponentialTakes) {
  for (const LimitRow& row : kLimitRows) {
    SCOPED_TRACE(row.why);
    EXPECT_EQ(MCPower::ExpOverflow(row.x), row.overflow);
    EXPECT_EQ(MCPower::ExpUnderflow(row.x), row.underflow);
  }
}

struct IntegerRow {
  const char* why;
  double x;
  bool integer;
  bool even;
  bool odd;
};

constexpr IntegerRow kIntegerRows[] = {
    // why                                          x         integer even   odd
    {"zero is even", 0.0, true, true, false},
    {"so is its negative", -0.0, true, true, false},
    {"one", 1.0, true, false, true},
    {"two", 2.0, true, true, false},
    {"minus one", -1.0, true, false, true},
    {"minus four", -4.0, true, true, false},
    {"a fraction", 2.5, false, false, false},
    {"a negative fraction", -0.5, false, false, false},
    {"the largest is in", 2147483647.0, true, false, true},
    {"one more is out", 2147483648.0, false, false, false},
    {"there is no lower limit", -2147483649.0, true, false, true},
    {"a large negative number is both, for want of digits", -1e300, true, true, true},
    {"the smallest number", -5e-324, false, false, false},
    {"minus infinity passes, as the upper limit alone is tested", -kInfinity, true, true, true},
    {"infinity", kInfinity, false, false, false},
    {"no number", kNaN, false, false, false},
};

TEST(MCPower, TellsWholeNumbers) {
  for (const IntegerRow& row : kIntegerRows) {
    SCOPED_TRACE(row.why);
    EXPECT_EQ(MCPower::IsInteger(row.x), row.integer);
    EXPECT_EQ(MCPower::IsEvenInteger(row.x), row.even);
    EXPECT_EQ(MCPower::IsOddInteger(row.x), row.odd);
  }
}

struct AlmostRow {
  const char* why;
  double a;
  double b;
  double k;
  bool equal;
};

constexpr AlmostRow kAlmostRows[] = {
    {"within ten epsilons of 32", 1.0, 1.0 + 10 * kEps, 32.0, true},
    {"other signs", 1.0, -1.0, 1000.0, false},
    {"nothing but zero equals zero", 0.0, 1e-300, 1.0, false},
    {"the other way round", 1e-300, 0.0, 1.0, false},
    {"zeros of either sign", 0.0, -0.0, 0.0, true},
    {"the larger magnitude is the measure, when it is a", 2.0, 2.0 - 4 * kEps, 2.0, true},
    {"the larger magnitude is the measure, when it is b", 2.0 - 4 * kEps, 2.0, 2.0, true},
    {"one epsilon more", 2.0, 2.0 - 5 * kEps, 2.0, false},
    {"negative numbers", -1.0, -1.0 - 2 * kEps, 2.0, true},
    {"negative numbers further apart", -1.0, -1.0 - 4 * kEps, 2.0, false},
    {"equal with no tolerance", 3.5, 3.5, 0.0, true},
    {"very large", kLargest, kLargest, 0.0, true},
    {"infinities have no difference", kInfinity, kInfinity, 1e300, false},
    {"no number as a", kNaN, 1.0, 1e300, false},
    {"no number as b", 1.0, kNaN, 1e300, false},
    {"no number against zero", 0.0, kNaN, 1e300, false},
    {"no tolerance that is a number", 1.0, 1.0, kNaN, false},
};

TEST(MCPower, ComparesWithinEpsilons) {
  for (const AlmostRow& row : kAlmostRows) {
    SCOPED_TRACE(row.why);
    EXPECT_EQ(MCPower::AlmostEqual(row.a, row.b, row.k), row.equal);
  }
}

struct RootRow {
  const char* why;
  double e;
  double k;
  bool odd;
  bool even;
};

constexpr RootRow kRootRows[] = {
    {"zero has no reciprocal", 0.0, 32.0, false, false},
    {"one is one over one", 1.0, 32.0, true, false},
    {"minus one", -1.0, 32.0, true, false},
    {"a third", 1.0 / 3.0, 32.0, true, false},
    {"a third, rounded otherwise", 1.0 / 3.0 + 4 * kEps, 32.0, true, false},
    {"too far from a third", 1.0 / 3.0 + 64 * kEps, 32.0, false, false},
    {"minus a fifth", -0.2, 32.0, true, false},
    {"a half", 0.5, 32.0, false, true},
    {"minus a quarter", -0.25, 32.0, false, true},
    {"two thirds", 2.0 / 3.0, 32.0, false, false},
    {"a reciprocal that is too large", 1e-10, 32.0, false, false},
    {"a reciprocal that is infinite", 5e-324, 32.0, false, false},
    {"a large negative reciprocal is both, for want of digits", -1e-300, 32.0, true, true},
    {"a negative reciprocal that is infinite", -5e-324, 32.0, false, false},
    // Its reciprocal is 0, which the even form takes for a whole number.
    {"infinity", kInfinity, 32.0, false, true},
    {"no number", kNaN, 32.0, false, false},
};

TEST(MCPower, TellsRoots) {
  for (const RootRow& row : kRootRows) {
    SCOPED_TRACE(row.why);
    EXPECT_EQ(MCPower::IsOneOverOddInteger(row.e, row.k), row.odd);
    EXPECT_EQ(MCPower::IsOneOverEvenInteger(row.e, row.k), row.even);
  }
}

struct ExponentRow {
  const char* why;
  double x;
  MCPower::PowerStatus status;
  double result;
};

constexpr ExponentRow kExponentRows[] = {
    {"zero", 0.0, MCPower::PowerOk, 1.0},
    {"one", 1.0, MCPower::PowerOk, 2.718281828459045},
    {"the upper limit is taken", 709.0, MCPower::PowerOk, 8.218407461554972e307},
    {"above it", 709.0000000000001, MCPower::PowerOverflow, kMissing},
    {"the lower limit is taken", -708.39, MCPower::PowerOk, 2.2394014988804678e-308},
    {"below it", -708.4, MCPower::PowerUnderflow, 0.0},
    {"infinity", kInfinity, MCPower::PowerOverflow, kMissing},
    {"minus infinity", -kInfinity, MCPower::PowerUnderflow, 0.0},
    {"no number", kNaN, MCPower::PowerOverflow, kMissing},
};

TEST(MCPower, ExponentGuardsItsArgument) {
  for (const ExponentRow& row : kExponentRows) {
    SCOPED_TRACE(row.why);
    double result = 7.0;
    EXPECT_EQ(MCPower::Exponent(row.x, result), row.status);
    EXPECT_DOUBLE_EQ(result, row.result);
  }
}

struct PowerRow {
  const char* why;
  double base;
  double exponent;
  MCPower::PowerStatus status;
  double result;
  double tolerance;  // relative; of an exponential, its argument's rounding
};

constexpr PowerRow kPowerRows[] = {
    {"zero to the zero", 0.0, 0.0, MCPower::PowerZeroZero, 1.0, 0.0},
    {"zero to a positive power", 0.0, 2.5, MCPower::PowerOk, 0.0, 0.0},
    {"zero to a negative power", 0.0, -1.0, MCPower::PowerZeroNegExp, kMissing, 0.0},
    {"negative zero is zero", -0.0, -1.0, MCPower::PowerZeroNegExp, kMissing, 0.0},
    {"zero to no number", 0.0, kNaN, MCPower::PowerOverflow, kMissing, 0.0},
    {"a negative base to the zero", -2.0, 0.0, MCPower::PowerNegBaseZeroExp, 1.0, 0.0},
    {"a positive base to the zero", 2.0, 0.0, MCPower::PowerOk, 1.0, 0.0},
    {"a positive base to the negative zero", 2.0, -0.0, MCPower::PowerOk, 1.0, 0.0},
    {"infinity to the zero", kInfinity, 0.0, MCPower::PowerOk, 1.0, 0.0},
    {"no number to the zero", kNaN, 0.0, MCPower::PowerOverflow, kMissing, 0.0},
    {"a plain power", 2.0, 10.0, MCPower::PowerOk, 1024.0, 1e-14},
    {"a plain root", 2.0, 0.5, MCPower::PowerOk, 1.4142135623730951, 1e-15},
    {"a negative power", 4.0, -1.5, MCPower::PowerOk, 0.125, 1e-15},
    {"one to any power", 1.0, 1e300, MCPower::PowerOk, 1.0, 0.0},
    {"an even power of a negative base", -2.0, 2.0, MCPower::PowerOk, 4.0, 1e-15},
    {"an odd power of a negative base", -2.0, 3.0, MCPower::PowerOk, -8.0, 1e-15},
    {"a negative odd power", -2.0, -3.0, MCPower::PowerOk, -0.125, 1e-15},
    {"a negative even power", -2.0, -2.0, MCPower::PowerOk, 0.25, 1e-15},
    {"an odd root", -8.0, 1.0 / 3.0, MCPower::PowerOk, -2.0, 1e-15},
    {"a negative odd root", -8.0, -1.0 / 3.0, MCPower::PowerOk, -0.5, 1e-15},
    {"an even root", -8.0, 0.5, MCPower::PowerNegBaseNotInteger, kMissing, 0.0},
    {"a fraction of a negative base", -8.0, 2.0 / 3.0, MCPower::PowerNegBaseNotInteger, kMissing, 0.0},
    {"a whole number past the limit", -8.0, 2147483648.0, MCPower::PowerNegBaseNotInteger, kMissing, 0.0},
    {"no number as the power of a negative base", -8.0, kNaN, MCPower::PowerNegBaseNotInteger, kMissing, 0.0},
    {"too large", 10.0, 400.0, MCPower::PowerOverflow, kMissing, 0.0},
    {"too small", 10.0, -400.0, MCPower::PowerUnderflow, 0.0, 0.0},
    {"too large and negative", -10.0, 401.0, MCPower::PowerNegOverflow, kMissing, 0.0},
    {"too large and even", -10.0, 400.0, MCPower::PowerOverflow, kMissing, 0.0},
    {"too small and odd", -10.0, -401.0, MCPower::PowerUnderflow, 0.0, 0.0},
    {"a negative power of a tiny negative base", -1e-200, -3.0, MCPower::PowerOverflow, kMissing, 0.0},
    {"infinity", kInfinity, 2.0, MCPower::PowerOverflow, kMissing, 0.0},
    {"one over infinity", kInfinity, -2.0, MCPower::PowerUnderflow, 0.0, 0.0},
    {"an infinite power", 2.0, kInfinity, MCPower::PowerOverflow, kMissing, 0.0},
    {"an infinite power of a fraction", 0.5, kInfinity, MCPower::PowerUnderflow, 0.0, 0.0},
    {"a negative infinite power", 2.0, -kInfinity, MCPower::PowerUnderflow, 0.0, 0.0},
    {"one to an infinite power is undefined here", 1.0, kInfinity, MCPower::PowerOverflow, kMissing, 0.0},
    {"minus infinity cubed", -kInfinity, 3.0, MCPower::PowerNegOverflow, kMissing, 0.0},
    {"minus infinity squared", -kInfinity, 2.0, MCPower::PowerOverflow, kMissing, 0.0},
    {"no number as base", kNaN, 2.0, MCPower::PowerOverflow, kMissing, 0.0},
    {"no number as power", 2.0, kNaN, MCPower::PowerOverflow, kMissing, 0.0},
};

TEST(MCPower, RaisesByTheRules) {
  for (const PowerRow& row : kPowerRows) {
    SCOPED_TRACE(row.why);
    double result = 7.0;
    EXPECT_EQ(MCPower::Power(row.base, row.exponent, result), row.status);
    if (row.result == kMissing) {
      EXPECT_EQ(result, kMissing);
    } else {
      EXPECT_NEAR(result, row.result, row.tolerance * std::fabs(row.result));
    }
  }
}

struct ProductRow {
  const char* why;
  double a;
  double b;
  double product;
};

constexpr ProductRow kProductRows[] = {
    {"a product", 3.0, -2.5, -7.5},
    {"too large", 1e200, 1e200, kMissing},
    {"too large and negative", -1e200, 1e200, kMissing},
    {"too small", 1e-200, 1e-200, 0.0},
    {"nothing times infinity", 0.0, kInfinity, kMissing},
    {"infinity", 2.0, kInfinity, kMissing},
    {"no number", kNaN, 1.0, kMissing},
    {"a missing factor", kMissing, 0.5, kMissing},
    {"a missing second factor", 0.0, kMissing, kMissing},
};

TEST(MCPower, MultipliesGuarded) {
  for (const ProductRow& row : kProductRows) {
    SCOPED_TRACE(row.why);
    EXPECT_EQ(MCPower::Multiply(row.a, row.b), row.product);
  }
}

TEST(MCPower, AnyBitsGiveAFiniteNumber) {
  kestrel_tests::BitPatterns patterns(20240801);
  for (int i = 0; i < 1000000; ++i) {
    const double a = patterns.Next();
    const double b = patterns.Next();
    double result = kNaN;
    const MCPower::PowerStatus status = MCPower::Power(a, b, result);
    ASSERT_TRUE(std::isfinite(result)) << a << " to the " << b;
    const bool missing = status == MCPower::PowerOverflow || status == MCPower::PowerNegOverflow ||
                         status == MCPower::PowerNegBaseNotInteger || status == MCPower::PowerZeroNegExp;
    ASSERT_EQ(result == kMissing, missing) << a << " to the " << b;
    double exponential = kNaN;
    MCPower::Exponent(a, exponential);
    ASSERT_TRUE(std::isfinite(exponential)) << a;
    ASSERT_TRUE(std::isfinite(MCPower::Multiply(a, b))) << a << " times " << b;
    // These need only return; the sanitizers watch them.
    MCPower::AlmostEqual(a, b, 32.0);
    MCPower::IsOneOverOddInteger(a, b);
    MCPower::IsOneOverEvenInteger(a, b);
  }
}

}  // namespace
