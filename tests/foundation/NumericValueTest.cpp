#include "kestrel/foundation/NumericValue.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <cstring>
#include <limits>
#include <memory>
#include <string>

#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/MCMV.h"
#include "kestrel/foundation/StringValue.h"
#include "tests/support/CommaLocale.h"

namespace MCKestrel_800 {
namespace {

constexpr double kSysmis = NumericValue::gSysmisValue;
constexpr double kInfinity = NumericValue::gInfinity;
const double kNaN = std::nan("");

uint64_t Bits(double x) {
  uint64_t bits = 0;
  std::memcpy(&bits, &x, sizeof bits);
  return bits;
}

TEST(NumericValue, ConstantsHaveTheirBitPatterns) {
  EXPECT_EQ(Bits(NumericValue::gSysmisValue), 0xFFEFFFFFFFFFFFFFu);
  EXPECT_EQ(Bits(NumericValue::gInfinity), 0x7FF0000000000000u);
  EXPECT_EQ(NumericValue::fEpsilon, 2.22045e-14);
  EXPECT_EQ(NumericValue::SYSMIS.GetDouble(), kSysmis);
  EXPECT_EQ(NumericValue::GetSysmisValue(), kSysmis);
  EXPECT_EQ(NumericValue::GetInfinity(), kInfinity);
  EXPECT_EQ(Bits(MCCommon_800::MCMV::gMissingValue), Bits(kSysmis));
  EXPECT_EQ(MCCommon_800::MCMV::Missing(), kSysmis);
  EXPECT_TRUE(MCCommon_800::MCMV::IsMissing(kSysmis));
  EXPECT_FALSE(MCCommon_800::MCMV::IsMissing(0.0));
  EXPECT_FALSE(MCCommon_800::MCMV::IsMissing(kNaN));
}

TEST(NumericValue, IsSystemMissingByDefault) {
  const NumericValue value;
  EXPECT_TRUE(value.IsSystemMissingValue());
  EXPECT_EQ(value.GetString(), "Undefined");
  EXPECT_EQ(value.GetType(), ScoreValue::kNumeric);
  EXPECT_TRUE(NumericValue::IsSystemMissingValue(kSysmis));
  EXPECT_FALSE(NumericValue::IsSystemMissingValue(std::nextafter(kSysmis, 0.0)));
}

TEST(NumericValue, EqualityIsRelative) {
  struct Row {
    double a, b;
    bool equal;
    const char* why;
  };
  const Row kRows[] = {
      {0.0, 0.0, true, "both zero"},
      {0.0, -0.0, true, "both zero, of either sign"},
      {0.0, 1e-300, false, "nothing is near zero but zero"},
      {1e20, 1e20 + 1e5, true, "relative tolerance"},
      {1.0, 1.0 + 2.2e-14, true, "just inside"},
      {1.0, 1.0 + 2.3e-14, false, "just outside"},
      {-1.0, -1.0 - 2.2e-14, true, "negative, inside"},
      {1.0, -1.0, false, "signs count"},
      {kSysmis, kSysmis, true, "missing equals missing"},
      {kSysmis, 0.0, false, "missing equals nothing else"},
      {0.0, kSysmis, false, "missing equals nothing else"},
      {kSysmis, std::nextafter(kSysmis, 0.0), false, "no tolerance around missing"},
      {kInfinity, kInfinity, false, "an infinity equals nothing"},
      {-kInfinity, -kInfinity, false, "an infinity equals nothing"},
      {kInfinity, 1.0, false, "an infinity equals nothing"},
      {kNaN, kNaN, false, "no number equals nothing"},
      {kNaN, 1.0, false, "no number equals nothing"},
      {kSysmis, kNaN, false, "missing equals nothing else"},
      {-kInfinity, kSysmis, false, "missing equals nothing else"},
      {1.7e308, -1.7e308, false, "a difference that overflows"},
      {1e-300, 1e-300, true, "a small number"},
      {5e-324, 5e-324, false, "no difference is below the tolerance of zero of the smallest numbers"},
  };
  for (const Row& row : kRows) {
    EXPECT_EQ(NumericValue::IsEqual(row.a, row.b), row.equal) << row.why;
    EXPECT_EQ(NumericValue::IsEqual(row.b, row.a), row.equal) << row.why;
    EXPECT_EQ(NumericValue(row.a) == NumericValue(row.b), row.equal) << row.why;
    EXPECT_EQ(NumericValue(row.b) == NumericValue(row.a), row.equal) << row.why;
  }
}

TEST(NumericValue, OrderIsAbsolute) {
  struct Row {
    double a, b;
    bool less, lessOrEqual;
    const char* why;
  };
  const Row kRows[] = {
      {1.0, 2.0, true, true, "plainly less"},
      {2.0, 1.0, false, false, "plainly greater"},
      {1.0, 1.0, false, true, "the same"},
      {0.0, 0.9e-14, false, true, "within the tolerance"},
      {0.0, 1.1e-14, true, true, "beyond the tolerance"},
      {1e20, 1e20 + 1e5, true, true, "equal by the relative rule, less by the absolute one"},
      {kSysmis, 1.0, false, false, "missing is not less"},
      {1.0, kSysmis, false, false, "nothing is less than missing"},
      {kSysmis, kSysmis, false, false, "nor than itself"},
      {-kInfinity, kInfinity, true, true, "infinities are ordered"},
      {kInfinity, kInfinity, false, false, "an infinity has no order to itself"},
      {kSysmis, kInfinity, false, false, "missing is not less than infinity"},
      {-kInfinity, kSysmis, false, false, "nor minus infinity less than missing"},
      {-2.0, -1.0, true, true, "negative numbers"},
      {kNaN, kNaN, false, false, "no number has no order"},
      {kNaN, 1.0, false, false, "no number has no order"},
      {1.0, kNaN, false, false, "no number has no order"},
  };
  for (const Row& row : kRows) {
    const NumericValue a(row.a), b(row.b);
    EXPECT_EQ(a < b, row.less) << row.why;
    EXPECT_EQ(b > a, row.less) << row.why;
    EXPECT_EQ(a <= b, row.lessOrEqual) << row.why;
    EXPECT_EQ(b >= a, row.lessOrEqual) << row.why;
    EXPECT_EQ(NumberLess(row.a, row.b), row.less) << row.why;
    EXPECT_EQ(NumberLessOrEqual(row.a, row.b), row.lessOrEqual) << row.why;
  }
}

TEST(NumericValue, ComparesWithNumbersOnly) {
  const NumericValue one(1.0);
  const StringValue text("1");
  const DateTimeValue date(1.0, kDateVal);
  for (const ScoreValue* other :
       {static_cast<const ScoreValue*>(&text), static_cast<const ScoreValue*>(&date)}) {
    EXPECT_FALSE(one == *other);
    EXPECT_FALSE(one < *other);
    EXPECT_FALSE(one <= *other);
    EXPECT_FALSE(one > *other);
    EXPECT_FALSE(one >= *other);
  }
}

TEST(NumericValue, EqualIsTrueWhateverTheArguments) {
  const NumericValue one(1.0), two(2.0);
  const StringValue text("x");
  EXPECT_TRUE(one.Equal(&two, true, false));
  EXPECT_TRUE(one.Equal(&two, false, true));
  EXPECT_TRUE(one.Equal(&text, true, true));
  EXPECT_TRUE(one.Equal(nullptr, false, false));
}

TEST(NumericValue, ReadsTextsWhateverTheLocale) {
  struct Row {
    const char* text;
    double value;
  };
  const Row kRows[] = {
      {"", kSysmis},
      {"abc", kSysmis},
      {"1.5", 1.5},
      {"1.5abc", 1.5},
      {"  2", 2.0},
      {"1,5", 1.0},
      {"1e999", kInfinity},
      {"-1e999", kSysmis},
      {"1e-400", 0.0},
      {"inf", kInfinity},
      {"+Infinity", kInfinity},
      {"-inf", kSysmis},
      {"nan", kSysmis},
      {"1e", kSysmis},
      {"-", kSysmis},
      {" ", kSysmis},
      {"0x10", 0.0},
      {"1e+", kSysmis},
      {".5", 0.5},
      {"5.", 5.0},
      {"+3", 3.0},
      {"- 3", kSysmis},
      {"1_000", 1.0},
      {"\xEF\xBC\x91", kSysmis},
      {"Infix", kInfinity},
      {"-1.7976931348623157e308", kSysmis},
  };
  for (const bool comma : {false, true}) {
    std::unique_ptr<kestrel_tests::CommaLocale> locale;
    if (comma) locale = std::make_unique<kestrel_tests::CommaLocale>();
    for (const Row& row : kRows)
      EXPECT_EQ(NumericValue(std::string(row.text)).GetDouble(), row.value) << row.text;
    NumericValue again(7.0);
    again.FromString("none");
    EXPECT_TRUE(again.IsSystemMissingValue());
  }
}

TEST(NumericValue, WritesSixDigits) {
  struct Row {
    double value;
    const char* text;
  };
  const Row kRows[] = {
      {1.0, "1"},         {1.0 / 3, "0.333333"},  {1234567.0, "1.23457e+06"},
      {-2.5, "-2.5"},     {kSysmis, "Undefined"}, {-kInfinity, "Undefined"},
      {kInfinity, "inf"}, {kNaN, "nan"},          {std::nextafter(kSysmis, 0.0), "-1.79769e+308"},
      {12345.0, "12345"}, {1234.5, "1234.5"},     {0.0, "0"},
      {1e-5, "1e-05"}};
  for (const bool comma : {false, true}) {
    std::unique_ptr<kestrel_tests::CommaLocale> locale;
    if (comma) locale = std::make_unique<kestrel_tests::CommaLocale>();
    for (const Row& row : kRows)
      EXPECT_EQ(NumericValue(row.value).GetString(), row.text);
  }
}

TEST(NumericValue, GivesIntegersTruncatedAndClamped) {
  struct Row {
    double value;
    int integer;
  };
  const Row kRows[] = {{2.9, 2},
                       {-2.9, -2},
                       {1e300, std::numeric_limits<int>::max()},
                       {-1e300, std::numeric_limits<int>::min()},
                       {2147483647.9, std::numeric_limits<int>::max()},
                       {2147483648.0, std::numeric_limits<int>::max()},
                       {-2147483648.9, std::numeric_limits<int>::min()},
                       {-2147483649.0, std::numeric_limits<int>::min()},
                       {-0.9, 0},
                       {-kInfinity, std::numeric_limits<int>::min()},
                       {kSysmis, std::numeric_limits<int>::min()},
                       {kInfinity, std::numeric_limits<int>::max()},
                       {kNaN, 0}};
  for (const Row& row : kRows)
    EXPECT_EQ(NumericValue(row.value).GetInt(), row.integer) << row.value;
}

TEST(NumericValue, AssignsTheNumberAlsoToItself) {
  NumericValue value(1.5), other;
  other = value;
  EXPECT_EQ(other.GetDouble(), 1.5);
  const NumericValue& same = other;
  other = same;
  EXPECT_EQ(other.GetDouble(), 1.5);
  other.SetValue(&other);
  EXPECT_EQ(other.GetDouble(), 1.5);
}

TEST(NumericValue, TakesOverNumbersOnly) {
  NumericValue value(1.0);
  const NumericValue two(2.0);
  const StringValue text("3");
  value.SetValue(&two);
  EXPECT_EQ(value.GetDouble(), 2.0);
  value.SetValue(&text);
  EXPECT_EQ(value.GetDouble(), 2.0);
  const DateTimeValue date(5.0, kDateVal);
  value.SetValue(&date);
  EXPECT_EQ(value.GetDouble(), 2.0);
  value.SetValue(nullptr);
  EXPECT_EQ(value.GetDouble(), 2.0);
  value.SetDoubleValue(4.0);
  EXPECT_EQ(value.GetDouble(), 4.0);
}

TEST(NumericValue, CopiesBelongToTheCaller) {
  const NumericValue value(2.5);
  const std::unique_ptr<ScoreValue> clone(value.Clone()), copy(value.GetValue());
  EXPECT_EQ(clone->GetDouble(), 2.5);
  EXPECT_EQ(copy->GetDouble(), 2.5);
  EXPECT_NE(clone.get(), &value);
}

}  // namespace
}  // namespace MCKestrel_800
