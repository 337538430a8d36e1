#include "kestrel/foundation/StringValue.h"

#include <gtest/gtest.h>

#include <limits>
#include <memory>
#include <string>
#include <type_traits>
#include <utility>

#include "kestrel/foundation/NumericValue.h"
#include "tests/support/CommaLocale.h"

namespace MCKestrel_800 {
namespace {

TEST(StringValue, IsEmptyByDefaultAndNeverMissing) {
  const StringValue value;
  EXPECT_EQ(value.GetString(), "");
  EXPECT_EQ(value.GetLength(), 0);
  EXPECT_FALSE(value.IsSystemMissingValue());
  EXPECT_EQ(value.GetType(), ScoreValue::kString);
  EXPECT_EQ(StringValue::MAX_STRING, 255);
  EXPECT_EQ(StringValue(static_cast<const char*>(nullptr)).GetString(), "");
}

TEST(StringValue, ComparesWithoutTrailingBlanks) {
  struct Row {
    const char *a, *b;
    int order;
    const char* why;
  };
  const Row kRows[] = {
      {"ab", "ab", 0, "the same"},
      {"ab  ", "ab", 0, "trailing blanks"},
      {"ab", "ab   ", 0, "trailing blanks on the other side"},
      {"", "   ", 0, "blanks alone are an empty text"},
      {" ab", "ab", -1, "leading blanks count"},
      {"ab\t", "ab", 1, "a tab is no blank"},
      {"ab", "ac", -1, "byte order"},
      {"ab", "abc", -1, "shorter is less"},
      {"B", "a", -1, "upper case is less"},
      {"\xC3\xA9", "z", 1, "bytes are unsigned"},
  };
  for (const Row& row : kRows) {
    const StringValue a(row.a), b(row.b);
    EXPECT_EQ(a == b, row.order == 0) << row.why;
    EXPECT_EQ(b == a, row.order == 0) << row.why;
    EXPECT_EQ(a < b, row.order < 0) << row.why;
    EXPECT_EQ(a > b, row.order > 0) << row.why;
    EXPECT_EQ(a <= b, row.order <= 0) << row.why;
    EXPECT_EQ(a >= b, row.order >= 0) << row.why;
    EXPECT_EQ(a.Equal(&b, false, false), row.order == 0) << row.why;
    EXPECT_EQ(a.Equal(&b, true, true), std::string(row.a) == row.b) << row.why;
  }
}

TEST(StringValue, ComparesWithTextsOnly) {
  const StringValue one("1");
  const NumericValue number(1.0);
  EXPECT_FALSE(one == number);
  EXPECT_FALSE(one < number);
  EXPECT_FALSE(one <= number);
  EXPECT_FALSE(one > number);
  EXPECT_FALSE(one >= number);
  EXPECT_FALSE(one.Equal(&number, false, false));
  EXPECT_FALSE(one.Equal(nullptr, false, false));
}

TEST(StringValue, ReadsNumbersFromItsStart) {
  struct Row {
    const char* text;
    int integer;
    double number;
  };
  const Row kRows[] = {
      {"12", 12, 12.0},
      {" -3.75 miles", -3, -3.75},
      {"+7", 7, 7.0},
      {"abc", 0, 0.0},
      {"", 0, 0.0},
      {"-", 0, 0.0},
      {"2147483647", 2147483647, 2147483647.0},
      {"2147483648", std::numeric_limits<int>::max(), 2147483648.0},
      {"-2147483648", std::numeric_limits<int>::min(), -2147483648.0},
      {"-99999999999999999999", std::numeric_limits<int>::min(), -1e20},
      {"1,5", 1, 1.0},
      {"\t\n 8", 8, 8.0},
      {"\v\f\r8", 8, 8.0},
      {"- 3", 0, 0.0},
      {"+-3", 0, 0.0},
      {"1e3", 1, 1000.0},
      {".5", 0, 0.5},
      {"inf", 0, 0.0},
      {"1e999", 1, std::numeric_limits<double>::max()},
      {"-1e999", -1, -std::numeric_limits<double>::max()},
  };
  for (const bool comma : {false, true}) {
    std::unique_ptr<kestrel_tests::CommaLocale> locale;
    if (comma) locale = std::make_unique<kestrel_tests::CommaLocale>();
    for (const Row& row : kRows) {
      EXPECT_EQ(StringValue(row.text).GetInt(), row.integer) << row.text;
      EXPECT_EQ(StringValue(row.text).GetDouble(), row.number) << row.text;
    }
  }
}

TEST(StringValue, KeepsItsLengthApartFromItsText) {
  StringValue value("abc");
  EXPECT_EQ(value.GetLength(), 3);
  value.SetString("abcdef");
  EXPECT_EQ(value.GetString(), "abcdef");
  EXPECT_EQ(value.GetLength(), 3);
  value.SetLength(8);
  EXPECT_EQ(value.GetLength(), 8);
  const StringValue copy(value);
  EXPECT_EQ(copy.GetLength(), 8);
}

TEST(StringValue, TakesOverTextsAndForgetsItsOwnForAnythingElse) {
  StringValue value("abc");
  const StringValue other("xyz");
  value.SetValue(&other);
  EXPECT_EQ(value.GetString(), "xyz");
  const NumericValue number(1.0);
  value.SetValue(&number);
  EXPECT_EQ(value.GetString(), "");
  value.SetString("abc");
  value.SetValue(nullptr);
  EXPECT_EQ(value.GetString(), "");
}

/// A text of a host's own class: only what the interface says of it is known.
class ShoutedText : public StringValue {
 public:
  using StringValue::StringValue;
  std::string GetString() const override { return StringValue::GetString() + "!"; }
};

TEST(StringValue, AsksClassesOfOthersForTheirText) {
  const ShoutedText shouted("ab");
  StringValue value("ab!");
  EXPECT_TRUE(value == shouted);
  EXPECT_TRUE(value.Equal(&shouted, true, false));
  EXPECT_TRUE(StringValue("ab") < shouted);
  value.SetValue(&shouted);
  EXPECT_EQ(value.GetString(), "ab!");
}

TEST(StringValue, KeepsNulsAndItselfIntact) {
  const std::string text("a\0b  ", 5);
  StringValue value(text);
  EXPECT_EQ(value.GetLength(), 5);
  EXPECT_TRUE(value == StringValue(std::string("a\0b", 3)));
  EXPECT_FALSE(value == StringValue("a"));
  value.SetValue(&value);
  EXPECT_EQ(value.GetString(), text);
}

TEST(StringValue, AssignsTextAndLength) {
  StringValue value("abc"), other;
  value.SetLength(9);
  other = value;
  EXPECT_EQ(other.GetString(), "abc");
  EXPECT_EQ(other.GetLength(), 9);
  const StringValue& same = other;
  other = same;
  EXPECT_EQ(other.GetString(), "abc");
}

TEST(StringValue, MovesWithItsLength) {
  StringValue from("a text that is too long to lie in the string object itself");
  from.SetLength(8);
  const StringValue to(std::move(from));
  EXPECT_EQ(to.GetString(), "a text that is too long to lie in the string object itself");
  EXPECT_EQ(to.GetLength(), 8);
  EXPECT_TRUE(std::is_nothrow_move_assignable_v<StringValue>);
}

TEST(StringValue, CopiesBelongToTheCaller) {
  const StringValue value("abc");
  const std::unique_ptr<ScoreValue> clone(value.Clone()), copy(value.GetValue());
  EXPECT_EQ(clone->GetString(), "abc");
  EXPECT_EQ(copy->GetString(), "abc");
}

}  // namespace
}  // namespace MCKestrel_800
