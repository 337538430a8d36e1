#include "kestrel/predicates/Range.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <memory>
#include <sstream>
#include <vector>

#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "tests/support/CommaLocale.h"

namespace MCKestrel_800 {
namespace {

constexpr double kSysmis = NumericValue::gSysmisValue;
constexpr double kInfinity = NumericValue::gInfinity;

NumericValue* Number(double x) {
  return new NumericValue(x);
}
StringValue* Text(const char* text) {
  return new StringValue(text);
}

TEST(Range, HoldsNumbersByItsEndsAndFlags) {
  struct Row {
    double min, max;
    bool low, high;
    double x;
    bool inside;
    const char* why;
  };
  const Row kRows[] = {
      {5, 5, false, false, 5, true, "a single value ignores the flags"},
      {5, 5, true, true, 5 + 1e-14, true, "a single value has the tolerance"},
      {5, 5, true, true, 5.1, false, "a single value is one value"},
      {0, 10, true, false, 0, true, "the low end is included"},
      {0, 10, true, false, 10, false, "the high end is not"},
      {0, 10, true, false, 9.999999999999, true, "just inside"},
      {0, 10, false, true, 0, false, "the low end is not included"},
      {0, 10, false, true, 10, true, "the high end is"},
      {0, 10, true, true, 10 + 1e-13, true, "within the tolerance of an included end"},
      {1, 10, true, true, 1 - 1e-14, true, "within the tolerance of an included end"},
      {1, 10, false, false, 1 + 1e-14, true, "strictly inside, near an excluded end"},
      {1, 10, false, false, 1 - 1e-14, false, "outside, near an excluded end"},
      {0, 10, true, true, -1, false, "below"},
      {0, 10, true, true, 11, false, "above"},
      {-kInfinity, kInfinity, true, true, 1e300, true, "everything"},
      {-kInfinity, kInfinity, true, true, kSysmis, false, "but the missing value"},
      {-kInfinity, kInfinity, true, true, -kInfinity, false, "an infinity equals no end"},
      {kSysmis, 10, true, true, -1e307, true, "a missing minimum reaches down"},
      {10, 0, true, true, 5, false, "ends the wrong way round hold nothing inside"},
      {10, 0, true, true, 10, true, "but their included ends"},
      {0, 10, true, true, NAN, false, "no number is nowhere"},
  };
  for (const Row& row : kRows) {
    const Range range(row.min, row.max, row.low, row.high);
    EXPECT_EQ(range.IsInRange(row.x), row.inside) << row.why;
    const NumericValue value(row.x);
    EXPECT_EQ(range.IsInRange(&value), row.inside) << row.why;
  }
}

TEST(Range, HoldsAnyNumbersByTheRule) {
  // The test of a range takes short cuts around the tolerance of its ends; none may change the answer.
  const double kMost = std::numeric_limits<double>::max(), kLeast = std::numeric_limits<double>::denorm_min();
  std::vector<double> numbers = {-kInfinity, kInfinity, NAN,    kSysmis, kMost,
                                 0,          -0.0,      kLeast, -kLeast, 1e-310};
  for (const double number : {5.0, -5.0, 1e-300, 1e300, 10.0}) {
    for (const double factor : {1.0, 1 + 1e-15, 1 - 1e-15, 1 + 1e-13, 1 + 1e-7, 1 + 1e-5, 1 - 1e-5})
      numbers.push_back(number * factor);
  }
  for (const double min : numbers) {
    for (const double max : numbers) {
      for (const int flags : {0, 1, 2, 3}) {
        const bool low = flags % 2 == 1, high = flags > 1;
        const Range range(min, max, low, high);
        const Range copy(range);
        for (const double x : numbers) {
          const bool atEnd =
              (low && NumericValue::IsEqual(x, min)) || (high && NumericValue::IsEqual(x, max));
          const bool inside =
              min == max ? NumericValue::IsEqual(x, min) : x != kSysmis && (atEnd || (min < x && x < max));
          ASSERT_EQ(range.IsInRange(x), inside) << x << " in " << min << ".." << max << ", flags " << flags;
          ASSERT_EQ(copy.IsInRange(x), inside) << "copy: " << x << " in " << min << ".." << max;
        }
      }
    }
  }
}

TEST(Range, TwoMissingNumbersAreASingleValue) {
  const Range range(kSysmis, kSysmis, false, false);
  EXPECT_TRUE(range.IsInRange(kSysmis)) << "the number that is tested against is kept as it was given";
  EXPECT_EQ(range.GetMin()->GetDouble(), -kInfinity);
  EXPECT_EQ(range.GetMax()->GetDouble(), kSysmis);
  const NumericValue missing;
  EXPECT_FALSE(range.IsInRange(&missing)) << "but not in the value object";
}

TEST(Range, NoNumberAtAnEndHoldsNothing) {
  for (const Range& range :
       {Range(NAN, 10.0, true, true), Range(0.0, NAN, true, true), Range(NAN, NAN, true, true)}) {
    for (const double x : {5.0, 100.0, -100.0, kSysmis, kInfinity, std::nan("")})
      EXPECT_FALSE(range.IsInRange(x)) << x;
  }
}

TEST(Range, KeepsAMissingMinimumAsMinusInfinityInTheValueAlone) {
  const Range range(kSysmis, 1.0, true, true);
  EXPECT_EQ(range.GetMin()->GetDouble(), -kInfinity);
  EXPECT_EQ(range.GetMax()->GetDouble(), 1.0);
}

TEST(Range, FillsAbsentEndsWithInfinities) {
  const Range low(nullptr, Number(3), false, true), high(Number(3), nullptr, true, false),
      both(static_cast<ScoreValue*>(nullptr), nullptr, false, false);
  EXPECT_EQ(low.GetMin()->GetDouble(), -kInfinity);
  EXPECT_EQ(high.GetMax()->GetDouble(), kInfinity);
  EXPECT_TRUE(low.IsInRange(-1e300));
  EXPECT_FALSE(low.IsInRange(4));
  EXPECT_TRUE(high.IsInRange(3));
  EXPECT_TRUE(high.IsInRange(1e300));
  EXPECT_TRUE(both.IsInRange(0.0));
}

TEST(Range, TakesAMissingMinimumButNotMaximumForAnInfinity) {
  const Range range(Number(kSysmis), Number(kSysmis), true, true);
  EXPECT_EQ(range.GetMin()->GetDouble(), -kInfinity);
  EXPECT_EQ(range.GetMax()->GetDouble(), kSysmis);
  EXPECT_FALSE(range.IsInRange(0.0));
  EXPECT_FALSE(range.IsInRange(-1e307)) << "nothing lies below a missing maximum";
  EXPECT_FALSE(range.IsInRange(kSysmis)) << "nor is it inside, though its end is included";
}

TEST(Range, OneMissingObjectForBothEndsHoldsNothing) {
  // Both ends become minus infinity, which equals nothing.
  NumericValue* const value = Number(kSysmis);
  const Range range(value, value, true, true);
  EXPECT_EQ(range.GetMax()->GetDouble(), -kInfinity);
  EXPECT_FALSE(range.IsInRange(-kInfinity));
  EXPECT_FALSE(range.IsInRange(kSysmis));
  EXPECT_FALSE(range.IsInRange(0.0));
}

TEST(Range, OneObjectForBothEndsIsASingleValue) {
  NumericValue* const value = Number(7);
  const Range range(value, value, false, false);
  EXPECT_NE(range.GetMin(), range.GetMax());
  EXPECT_TRUE(range.IsInRange(7));
  EXPECT_FALSE(range.IsInRange(7.1));
}

TEST(Range, EqualEndsAreASingleValue) {
  const Range range(Text("ab"), Text("ab  "), false, false);
  const StringValue same("ab"), other("b");
  EXPECT_TRUE(range.IsInRange(&same));
  EXPECT_FALSE(range.IsInRange(&other));
}

TEST(Range, SingleValuesCompareByTheValuesOwnRules) {
  const Range text(Text("no answer"));
  const StringValue padded("no answer  "), other("No answer");
  EXPECT_TRUE(text.IsInRange(&padded));
  EXPECT_FALSE(text.IsInRange(&other));
  EXPECT_TRUE(text.GetLowEnd());
  EXPECT_TRUE(text.GetHighEnd());
  const Range date(new DateTimeValue(5.0, kDateVal));
  const DateTimeValue same(5.0, kTimeVal);
  const NumericValue number(5.0);
  EXPECT_TRUE(date.IsInRange(&same));
  EXPECT_FALSE(date.IsInRange(&number));
  EXPECT_TRUE(date.IsInRange(5.0)) << "a single date is found by its seconds";
  EXPECT_FALSE(date.IsInRange(6.0));
  const Range equalEnds(new DateTimeValue(5.0, kDateVal), new DateTimeValue(5.0, kDateVal), false, false);
  EXPECT_TRUE(equalEnds.IsInRange(&same));
  EXPECT_TRUE(equalEnds.IsInRange(5.0));
  EXPECT_FALSE(equalEnds.IsInRange(6.0));
  EXPECT_FALSE(text.IsInRange(0.0)) << "a text is no number";
  const Range five(Number(5));
  const StringValue word("5");
  EXPECT_TRUE(five.IsInRange(5.0));
  EXPECT_FALSE(five.IsInRange(&word));
  EXPECT_FALSE(five.IsInRange(static_cast<const ScoreValue*>(nullptr)));
}

TEST(Range, ASingleMissingOrAbsentValueBecomesMinusInfinity) {
  const Range missing(Number(kSysmis)), absent(static_cast<ScoreValue*>(nullptr));
  for (const Range* range : {&missing, &absent}) {
    EXPECT_EQ(range->GetMin()->GetDouble(), -kInfinity);
    EXPECT_EQ(range->GetMax()->GetDouble(), -kInfinity);
    EXPECT_NE(range->GetMin(), range->GetMax());
    EXPECT_FALSE(range->IsInRange(kSysmis));
    EXPECT_FALSE(range->IsInRange(0.0));
  }
}

TEST(Range, HoldsNothingButNumbersBetweenItsEnds) {
  const Range range(0, 10, true, true);
  const StringValue text("5");
  const DateTimeValue date(5.0, kDateVal);
  const NumericValue missing;
  EXPECT_FALSE(range.IsInRange(&text));
  EXPECT_FALSE(range.IsInRange(&date));
  EXPECT_FALSE(range.IsInRange(&missing));
  EXPECT_FALSE(range.IsInRange(static_cast<const ScoreValue*>(nullptr)));
  const Range texts(Text("a"), Text("c"), true, true);
  const StringValue between("b");
  EXPECT_FALSE(texts.IsInRange(&between));
}

TEST(Range, ReplacesEndsWithoutDeletingTheOldOnes) {
  Range range(0, 10, true, true);
  const std::unique_ptr<const ScoreValue> oldMin(range.GetMin()), oldMax(range.GetMax());
  range.SetMin(nullptr);
  EXPECT_EQ(range.GetMin(), oldMin.get());
  range.SetMin(Number(4));
  range.SetMax(Number(6));
  EXPECT_TRUE(range.IsInRange(5));
  EXPECT_FALSE(range.IsInRange(3));
  EXPECT_FALSE(range.IsInRange(7));

  const std::unique_ptr<const ScoreValue> four(range.GetMin());
  range.SetMin(Number(kSysmis));
  EXPECT_EQ(range.GetMin()->GetDouble(), -kInfinity);
  EXPECT_TRUE(range.IsInRange(-1e300));

  const std::unique_ptr<const ScoreValue> lowest(range.GetMin());
  range.SetMin(Number(6));
  EXPECT_TRUE(range.IsInRange(6 + 1e-14)) << "the ends are equal now";
  const std::unique_ptr<const ScoreValue> six(range.GetMax());
  range.SetMax(Number(kSysmis));
  EXPECT_EQ(range.GetMax()->GetDouble(), kSysmis) << "a missing maximum stays";
  const std::unique_ptr<const ScoreValue> missing(range.GetMax());
  range.SetMax(nullptr);
  EXPECT_EQ(range.GetMax(), nullptr);
}

TEST(Range, TextEndsLeaveTheNumbersThatAreTestedAgainst) {
  Range range(0, 10, true, true);
  const std::unique_ptr<const ScoreValue> oldMin(range.GetMin()), oldMax(range.GetMax());
  range.SetMin(Text("a"));
  range.SetMax(Text("b"));
  EXPECT_TRUE(range.IsInRange(5));
  EXPECT_FALSE(range.IsInRange(11));
  const Range unset(Text("a"), Text("b"), true, true);
  EXPECT_TRUE(unset.IsInRange(1e300)) << "ends that were never numbers are infinite";
}

TEST(Range, LosesItsUpperEndButNotTheNumberForIt) {
  Range range(0, 10, true, true);
  const std::unique_ptr<const ScoreValue> oldMax(range.GetMax());
  range.SetMax(nullptr);
  EXPECT_TRUE(range.IsInRange(10));
  EXPECT_FALSE(range.IsInRange(11));
  const Range copy(range);
  EXPECT_EQ(copy.GetMax(), nullptr);
  EXPECT_TRUE(copy == range);
  EXPECT_FALSE(copy == Range(0, 10, true, true));
  std::ostringstream out;
  copy.Display(out);
  EXPECT_EQ(out.str(),
            "  Start Range Display   \n"
            "MinValue: 0;  MaxValue: NULL; High End included; lower End included\n"
            " End of Range Display\n\n");
}

TEST(Range, MayBeGivenOneObjectForBothEnds) {
  Range range(0, 10, false, false);
  const std::unique_ptr<const ScoreValue> oldMin(range.GetMin()), oldMax(range.GetMax());
  NumericValue* const value = Number(3);
  range.SetMin(value);
  range.SetMax(value);
  EXPECT_TRUE(range.IsInRange(3));
  EXPECT_FALSE(range.IsInRange(4));
  const Range copy(range);
  EXPECT_NE(copy.GetMin(), copy.GetMax());
  range = Range(1, 2, true, true);
  EXPECT_TRUE(range.IsInRange(1.5));
}

TEST(Range, AnOpenRangeEqualsNothingSinceNoInfinityDoes) {
  const Range open(-kInfinity, 10, true, true);
  const std::unique_ptr<ScoreValueRange> clone(open.Clone());
  EXPECT_FALSE(*clone == open);
}

TEST(Range, EqualsByEndsAndFlags) {
  const Range range(0, 10, true, false);
  EXPECT_TRUE(range == Range(0, 10, true, false));
  EXPECT_TRUE(range == Range(0, 10 + 1e-13, true, false));
  EXPECT_FALSE(range == Range(1, 10, true, false));
  EXPECT_FALSE(range == Range(0, 11, true, false));
  EXPECT_FALSE(range == Range(0, 10, false, false));
  EXPECT_FALSE(range == Range(0, 10, true, true));
  EXPECT_FALSE(range == Range(Text("0"), Text("10"), true, false));
}

TEST(Range, CopiesDeeply) {
  Range range(0, 10, true, false), other(Text("x"));
  const Range copy(range);
  EXPECT_TRUE(copy == range);
  EXPECT_NE(copy.GetMin(), range.GetMin());
  const std::unique_ptr<ScoreValueRange> clone(range.Clone());
  EXPECT_TRUE(*clone == range);
  other = range;
  EXPECT_TRUE(other == range);
  EXPECT_TRUE(other.IsInRange(5));
  Range& self = other;
  other = self;
  EXPECT_TRUE(other == range);
}

TEST(Range, DisplaysItsEnds) {
  struct Row {
    Range range;
    const char* text;
  };
  const Row kRows[] = {
      {Range(0, 10.5, true, false),
       "  Start Range Display   \n"
       "MinValue: 0;  MaxValue: 10.5; High End not included; lower End included\n"
       " End of Range Display\n\n"},
      {Range(Text("a"), Text("b"), false, true),
       "  Start Range Display   \n"
       "MinValue: a;  MaxValue: b; High End included; lower End not included\n"
       " End of Range Display\n\n"},
      {Range(1.0 / 3, kSysmis, true, true),
       "  Start Range Display   \n"
       "MinValue: 0.333333;  MaxValue: -1.79769e+308; High End included; lower End included\n"
       " End of Range Display\n\n"},
      {Range(static_cast<ScoreValue*>(nullptr), nullptr, false, false),
       "  Start Range Display   \n"
       "MinValue: -inf;  MaxValue: inf; High End not included; lower End not included\n"
       " End of Range Display\n\n"},
      {Range(new DateTimeValue(86400.0, kDateVal)),
       "  Start Range Display   \n"
       "MinValue: 86400;  MaxValue: 86400; High End included; lower End included\n"
       " End of Range Display\n\n"},
  };
  const kestrel_tests::CommaLocale comma;
  for (const Row& row : kRows) {
    std::ostringstream out;
    out.precision(3);
    row.range.Display(out);
    EXPECT_EQ(out.str(), row.text);
  }
}

}  // namespace
}  // namespace MCKestrel_800
