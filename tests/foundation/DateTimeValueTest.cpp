#include "kestrel/foundation/DateTimeValue.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <memory>
#include <random>
#include <string>

#include "kestrel/foundation/StringValue.h"
#include "tests/support/CommaLocale.h"

namespace MCKestrel_800 {
namespace {

constexpr double kSysmis = NumericValue::gSysmisValue;
// Inside a value's class the name kDateTime means the kind of value.
constexpr DateTimeType kDateAndTime = DateTimeType::kDateTime;
constexpr DateTimeType kDay = DateTimeType::kDate;

struct TextRow {
  const char* text;
  DateTimeType type;
  double seconds;
  const char* why;
};

constexpr TextRow kTexts[] = {
    {"1970-01-01", kDay, 0.0, "the epoch"},
    {"1970-01-02", kDay, 86400.0, "a day later"},
    {"1969-12-31", kDay, -86400.0, "a day before"},
    {"2000-02-29", kDay, 951782400.0, "a leap day"},
    {"1900-02-29", kDay, kSysmis, "no leap year"},
    {"2013-13-01", kDay, kSysmis, "no such month"},
    {"2013-00-01", kDay, kSysmis, "no such month"},
    {"2013-01-00", kDay, kSysmis, "no such day"},
    {"2013-04-31", kDay, kSysmis, "no such day"},
    {" 1970 - 01 - 02 ", kDay, 86400.0, "blanks anywhere"},
    {"1970-1-2", kDay, 86400.0, "no padding"},
    {"0000-01-01", kDay, -62167219200.0, "the year zero"},
    {"1970-01", kDay, kSysmis, "two parts"},
    {"1970-01-01-01", kDay, kSysmis, "four parts"},
    {"1970--01", kDay, kSysmis, "an empty part"},
    {"-1970-01-01", kDay, kSysmis, "the sign is a separator"},
    {"1970/01/01", kDay, kSysmis, "another separator"},
    {"1970-01-0x", kDay, kSysmis, "no digit"},
    {"1970-01-01T00:00:00", kDay, kSysmis, "more than a date"},
    {"", kDay, kSysmis, "an empty text"},
    {"   ", kDay, kSysmis, "blanks alone"},
    {"23:59:59", kTime, 86399.0, "the last second"},
    {"00:00:00", kTime, 0.0, "midnight"},
    {"24:00:00", kTime, kSysmis, "no such hour"},
    {"23:60:00", kTime, kSysmis, "no such minute"},
    {"23:59:60", kTime, kSysmis, "no such second"},
    {"12:30", kTime, kSysmis, "seconds are required"},
    {"1:2:3", kTime, 3723.0, "no padding"},
    {"12:30:00.5", kTime, kSysmis, "no fractions"},
    {"", kTime, kSysmis, "an empty text"},
    {"1970-01-01T01:00:00", kDateAndTime, 3600.0, "an hour"},
    {"1970-01-01 01:00:00", kDateAndTime, kSysmis, "no T"},
    {"1969-12-31T23:59:59", kDateAndTime, -1.0, "a second before"},
    {"1970-01-01T", kDateAndTime, kSysmis, "half of it"},
    {"T01:00:00", kDateAndTime, kSysmis, "half of it"},
    {"1970-01-01T25:00:00", kDateAndTime, kSysmis, "a bad half"},
    {"1970-13-01T01:00:00", kDateAndTime, kSysmis, "a bad half"},
    {"1970-01-01T01:00:00T", kDateAndTime, kSysmis, "two T"},
    {"", kDateAndTime, kSysmis, "an empty text"},
    {"0", kDateDaysSince1960, -315619200.0, "days since 1960"},
    {"10", kTimeSeconds, 10.0, "seconds since midnight"},
    {"abc", kDateDaysSince1970, kSysmis, "no number"},
    {"", kDateDaysSince1970, kSysmis, "an empty text"},
    {"0", kDateDaysSince0, -719528.0 * 86400.0, "days since the year 0"},
    {"1.5abc", kDateDaysSince1970, 129600.0, "a number at the start"},
    {" 1e1", kDateDaysSince1980, 3662.0 * 86400.0, "a number with an exponent"},
    {"0", kDateTimeSecondsSince0, -62167219200.0, "seconds since the year 0"},
    {"0", kDateTimeSecondsSince1960, -315619200.0, "seconds since 1960"},
    {"-2.5", kDateTimeSecondsSince1970, -2.5, "seconds since 1970"},
    {"0", kDateTimeSecondsSince1980, 315532800.0, "seconds since 1980"},
    {"1,5", kTimeSeconds, 1.0, "a comma ends the number"},
    {"1e999", kTimeSeconds, NumericValue::gInfinity, "too large"},
    {"12:30:00", kTimeSeconds, 12.0, "the number at the start of a time"},
    {"1970-01-01", kNoDateTime, kSysmis, "no type"},
    {"1", kNoDateTime, kSysmis, "no type"},
    {"1", static_cast<DateTimeType>(13), kSysmis, "no such type"},
    {"1970-01-01\t", kDay, kSysmis, "a tab is no blank"},
    {"19 70-0 1-01", kDay, 0.0, "blanks anywhere, even between digits"},
    {"+1970-01-01", kDay, kSysmis, "a sign is no digit"},
    {"10000-01-01", kDay, 253402300800.0, "a year of five digits"},
    {" 0 1 : 0 2 : 0 3 ", kTime, 3723.0, "blanks anywhere"},
    {"-1:00:00", kTime, kSysmis, "no sign"},
    {"1::3", kTime, kSysmis, "an empty part"},
    {"1:2:3:4", kTime, kSysmis, "four parts"},
    {"99999999999999999999:00:00", kTime, kSysmis, "an hour beyond every integer"},
    {"1970-01-01 T 01:00:00", kDateAndTime, 3600.0, "blanks around the T"},
    {"1970-01-01t01:00:00", kDateAndTime, kSysmis, "a small t"},
    {"1970-01-01T  ", kDateAndTime, kSysmis, "a blank half"},
    {"T", kDateAndTime, kSysmis, "no half at all"},
    {"1970-01-01T01:00", kDateAndTime, kSysmis, "seconds are required"},
    {"1970-01-01T01:00:00Z", kDateAndTime, kSysmis, "no zones"},
};

TEST(DateTimeValue, ReadsTexts) {
  for (const TextRow& row : kTexts) {
    const DateTimeValue value(std::string(row.text), row.type);
    EXPECT_EQ(value.GetDouble(), row.seconds) << row.text << ": " << row.why;
    // An empty text parses as a date or time, and is one that is not there.
    const bool empty = *row.text == '\0' && row.type >= kDay && row.type <= kDateAndTime;
    EXPECT_EQ(DateTimeValue::IsValidDateTime(row.text, row.type), empty || row.seconds != kSysmis)
        << row.text;
  }
}

TEST(DateTimeValue, CountsInEachUnitAndEpoch) {
  struct Row {
    DateTimeType type;
    double number, seconds;
  };
  constexpr Row kRows[] = {
      {kDay, 12.0, 12.0},
      {kTime, 12.0, 12.0},
      {kDateAndTime, 12.5, 12.5},
      {kTimeSeconds, 12.0, 12.0},
      {kDateTimeSecondsSince1970, 12.0, 12.0},
      {kDateDaysSince0, 719528.0, 0.0},
      {kDateDaysSince1960, 3653.0, 0.0},
      {kDateDaysSince1960, 0.0, -315619200.0},
      {kDateDaysSince1970, 1.5, 129600.0},
      {kDateDaysSince1980, 0.0, 315532800.0},
      {kDateTimeSecondsSince0, 62167219200.0, 0.0},
      {kDateTimeSecondsSince1960, 315619200.0, 0.0},
      {kDateTimeSecondsSince1980, 0.0, 315532800.0},
  };
  for (const Row& row : kRows) {
    const DateTimeValue value(row.number, row.type);
    EXPECT_EQ(value.GetDouble(), row.seconds) << row.type;
    EXPECT_EQ(value.GetDoubleValue(row.type), row.number) << row.type;
    const std::unique_ptr<ScoreValue> number(value.GetValue(row.type));
    EXPECT_EQ(number->GetType(), ScoreValue::kNumeric);
    EXPECT_EQ(number->GetDouble(), row.number);
    EXPECT_TRUE(DateTimeValue(kSysmis, row.type).IsSystemMissingValue()) << row.type;
    EXPECT_EQ(DateTimeValue(kSysmis, row.type).GetDoubleValue(row.type), kSysmis) << row.type;
  }
  for (const int type : {0, 13, -1, 1000}) {
    EXPECT_TRUE(DateTimeValue(1.0, static_cast<DateTimeType>(type)).IsSystemMissingValue()) << type;
    EXPECT_EQ(DateTimeValue(1.0, kDateVal).GetDoubleValue(static_cast<DateTimeType>(type)), kSysmis) << type;
  }
}

TEST(DateTimeValue, MapsTypesToKinds) {
  constexpr DateTimeValType kKinds[] = {kDateTimeVal, kDateVal,     kTimeVal,     kDateTimeVal, kDateVal,
                                        kDateVal,     kDateVal,     kDateVal,     kTimeVal,     kDateTimeVal,
                                        kDateTimeVal, kDateTimeVal, kDateTimeVal, kDateTimeVal};
  for (int type = 0; type <= 13; ++type) {
    EXPECT_EQ(DateTimeValue::GetValType(static_cast<DateTimeType>(type)), kKinds[type]) << type;
  }
  EXPECT_EQ(DateTimeValue::GetDateTimeType(kDateVal), kDay);
  EXPECT_EQ(DateTimeValue::GetDateTimeType(kTimeVal), kTime);
  EXPECT_EQ(DateTimeValue::GetDateTimeType(kDateTimeVal), kDateAndTime);
  EXPECT_EQ(DateTimeValue::GetDateTimeType(static_cast<DateTimeValType>(7)), kDateAndTime);
}

TEST(DateTimeValue, WritesWhatItReads) {
  for (const TextRow& row : kTexts) {
    if (row.seconds == kSysmis || row.type > kDateAndTime) continue;
    const DateTimeValue value(std::string(row.text), row.type);
    const DateTimeValue again(value.GetString(), row.type);
    EXPECT_EQ(again.GetDouble(), row.seconds) << value.GetString();
  }
  EXPECT_EQ(DateTimeValue(86400.0, kDateVal).GetString(), "1970-01-02");
  EXPECT_EQ(DateTimeValue(3723.0, kTimeVal).GetString(), "01:02:03");
  EXPECT_EQ(DateTimeValue(90123.0, kDateTimeVal).GetString(), "1970-01-02T01:02:03");
  EXPECT_EQ(DateTimeValue(-62167219200.0, kDateVal).GetString(), "0000-01-01");
  EXPECT_EQ(DateTimeValue().GetString(), "Undefined");
  EXPECT_EQ(DateTimeValue().GetNumericString(), "Undefined");
  EXPECT_EQ(DateTimeValue(3723.0, kTimeVal).GetNumericString(), "3723");
}

TEST(DateTimeValue, ExtractsComponents) {
  struct Row {
    double seconds, year, month, day, hour, minute, second;
  };
  constexpr Row kRows[] = {
      {0.0, 1970, 1, 1, 0, 0, 0},
      {90123.0, 1970, 1, 2, 1, 2, 3},
      {-1.0, 1970, 1, 1, 23, 59, 59},  // days are cut toward zero, the time of day counts upwards
      {-86400.0, 1969, 12, 31, 0, 0, 0},
      {951782400.0 + 86399.9, 2000, 2, 29, 23, 59, 59},
      {kSysmis, kSysmis, kSysmis, kSysmis, kSysmis, kSysmis, kSysmis},
  };
  for (const Row& row : kRows) {
    const DateTimeValue value(row.seconds, kDateTimeVal);
    EXPECT_EQ(value.ExtractYear(), row.year) << row.seconds;
    EXPECT_EQ(value.ExtractMonth(), row.month) << row.seconds;
    EXPECT_EQ(value.ExtractDay(), row.day) << row.seconds;
    EXPECT_EQ(value.ExtractHour(), row.hour) << row.seconds;
    EXPECT_EQ(value.ExtractMinute(), row.minute) << row.seconds;
    EXPECT_EQ(value.ExtractSecond(), row.second) << row.seconds;
  }
}

TEST(DateTimeValue, CutsDaysTowardZeroAndTheTimeOfDayDownwards) {
  struct Row {
    double seconds;
    int64_t y, m, d, h, min, s;
  };
  constexpr Row kRows[] = {
      {-0.5, 1970, 1, 1, 0, 0, 0},        {-86399.0, 1970, 1, 1, 0, 0, 1},
      {-86400.0, 1969, 12, 31, 0, 0, 0},  {-86401.0, 1969, 12, 31, 23, 59, 59},
      {-172800.0, 1969, 12, 30, 0, 0, 0}, {86399.999, 1970, 1, 1, 23, 59, 59},
      {-62167219200.0, 0, 1, 1, 0, 0, 0}, {kSysmis, 1970, 1, 1, 0, 0, 0},
      {NAN, 1970, 1, 1, 0, 0, 0},
  };
  for (const Row& row : kRows) {
    int64_t y = 0, m = 0, d = 0, h = 0, min = 0, s = 0;
    DateTimeValue::ExtractDate(row.seconds, y, m, d);
    DateTimeValue::ExtractTime(row.seconds, h, min, s);
    EXPECT_TRUE(y == row.y && m == row.m && d == row.d) << row.seconds << ": " << y << '-' << m << '-' << d;
    EXPECT_TRUE(h == row.h && min == row.min && s == row.s)
        << row.seconds << ": " << h << ':' << min << ':' << s;
  }
}

TEST(DateTimeValue, WritesEveryTimeAsATextThatReadsBack) {
  std::mt19937_64 random(20000229);
  // The years 0 to 9999.
  std::uniform_int_distribution<int64_t> anySecond(-62167219200, 253402300799);
  for (int i = 0; i < 20000; ++i) {
    const double seconds = static_cast<double>(anySecond(random));
    const std::string both = DateTimeValue(seconds, kDateTimeVal).GetString();
    ASSERT_EQ(both.size(), 19u) << both;
    ASSERT_EQ(DateTimeValue(both, kDateAndTime).GetDouble(), seconds) << both;
    const std::string date = DateTimeValue(seconds, kDateVal).GetString();
    const std::string time = DateTimeValue(seconds, kTimeVal).GetString();
    ASSERT_EQ(date + "T" + time, both);
    const double midnight = DateTimeValue(date, kDay).GetDouble();
    ASSERT_EQ(midnight, std::floor(seconds / 86400.0) * 86400.0) << date;
    ASSERT_EQ(DateTimeValue(time, kTime).GetDouble(), seconds - midnight) << time;
  }
}

TEST(DateTimeValue, WritesPaddedTextsWhateverTheSecondsAndTheLocale) {
  struct Row {
    double seconds;
    DateTimeValType kind;
    const char* text;
  };
  const Row kRows[] = {
      {-1.0, kDateTimeVal, "1969-12-31T23:59:59"},
      {-0.25, kDateTimeVal, "1969-12-31T23:59:59"},
      {1.75, kDateTimeVal, "1970-01-01T00:00:01"},
      {-1.0, kDateVal, "1969-12-31"},
      {-1.0, kTimeVal, "23:59:59"},
      {90000.0, kTimeVal, "01:00:00"},
      {253402300800.0, kDateVal, "10000-01-01"},
      {-62167219201.0, kDateTimeVal, "-0001-12-31T23:59:59"},
      {kSysmis, kDateVal, "Undefined"},
      {kSysmis, kTimeVal, "Undefined"},
      {NAN, kDateVal, "Undefined"},
      {NumericValue::gInfinity, kDateTimeVal, "Undefined"},
      {-NumericValue::gInfinity, kTimeVal, "Undefined"},
  };
  const kestrel_tests::CommaLocale comma;
  for (const Row& row : kRows)
    EXPECT_EQ(DateTimeValue(row.seconds, row.kind).GetString(), row.text) << row.seconds;
  EXPECT_EQ(DateTimeValue(1234567.5, kDateTimeVal).GetNumericString(), "1.23457e+06");
  EXPECT_EQ(DateTimeValue("2.5", kTimeSeconds).GetDouble(), 2.5);
}

TEST(DateTimeValue, AnswersForEveryNumberOfSeconds) {
  for (const double seconds : {1e300, -1e300, 1e19, -1e19, 9.3e18, -9.3e18, 1e15, -1e15}) {
    const DateTimeValue value(seconds, kDateTimeVal);
    EXPECT_TRUE(seconds > 0 ? value.ExtractYear() > 30000000 : value.ExtractYear() < -30000000) << seconds;
    EXPECT_TRUE(value.ExtractMonth() >= 1 && value.ExtractMonth() <= 12) << seconds;
    EXPECT_TRUE(value.ExtractDay() >= 1 && value.ExtractDay() <= 31) << seconds;
    EXPECT_TRUE(value.ExtractHour() >= 0 && value.ExtractHour() < 24) << seconds;
    EXPECT_TRUE(value.ExtractMinute() >= 0 && value.ExtractMinute() < 60) << seconds;
    EXPECT_TRUE(value.ExtractSecond() >= 0 && value.ExtractSecond() < 60) << seconds;
    EXPECT_EQ(value.GetString().find("Undefined"), std::string::npos) << seconds;
    EXPECT_EQ(value.GetInt(),
              seconds > 0 ? std::numeric_limits<int>::max() : std::numeric_limits<int>::min());
  }
}

TEST(DateTimeValue, HasNoPartsWhenItIsNoMoment) {
  const DateTimeValue now(0.0, kDateTimeVal);
  for (const double seconds : {kSysmis, std::nan(""), NumericValue::gInfinity, -NumericValue::gInfinity}) {
    const DateTimeValue value(seconds, kDateTimeVal);
    EXPECT_EQ(value.ExtractYear(), kSysmis);
    EXPECT_EQ(value.ExtractMonth(), kSysmis);
    EXPECT_EQ(value.ExtractDay(), kSysmis);
    EXPECT_EQ(value.ExtractHour(), kSysmis);
    EXPECT_EQ(value.ExtractMinute(), kSysmis);
    EXPECT_EQ(value.ExtractSecond(), kSysmis);
    EXPECT_EQ(value.ComputeDurationSeconds(now), kSysmis);
    EXPECT_EQ(now.ComputeDurationYears(value), kSysmis);
    EXPECT_EQ(value.ComputeDurationDays(value), kSysmis);
  }
  const DateTimeValue none(std::nan(""), kDateVal);
  EXPECT_FALSE(none.IsSystemMissingValue());
  EXPECT_EQ(none.GetInt(), 0);
  EXPECT_FALSE(none == none);
  EXPECT_FALSE(none < now);
  EXPECT_FALSE(none >= now);
  EXPECT_TRUE(std::isnan(DateTimeValue(std::nan(""), kDateDaysSince1960).GetDouble()));
}

TEST(DateTimeValue, ComputesDurations) {
  const DateTimeValue later(365.25 * 86400.0, kDateTimeVal), earlier(0.0, kDateTimeVal), missing;
  EXPECT_EQ(later.ComputeDurationSeconds(earlier), 31557600.0);
  EXPECT_EQ(later.ComputeDurationMinutes(earlier), 525960.0);
  EXPECT_EQ(later.ComputeDurationHours(earlier), 8766.0);
  EXPECT_EQ(later.ComputeDurationDays(earlier), 365.25);
  EXPECT_EQ(later.ComputeDurationMonths(earlier), 12.0);
  EXPECT_EQ(later.ComputeDurationYears(earlier), 1.0);
  EXPECT_EQ(earlier.ComputeDurationYears(later), -1.0);
  for (const DateTimeValue* other : {&earlier, &later}) {
    EXPECT_EQ(missing.ComputeDurationSeconds(*other), kSysmis);
    EXPECT_EQ(other->ComputeDurationSeconds(missing), kSysmis);
    EXPECT_EQ(other->ComputeDurationMinutes(missing), kSysmis);
    EXPECT_EQ(other->ComputeDurationHours(missing), kSysmis);
    EXPECT_EQ(other->ComputeDurationDays(missing), kSysmis);
    EXPECT_EQ(other->ComputeDurationMonths(missing), kSysmis);
    EXPECT_EQ(other->ComputeDurationYears(missing), kSysmis);
  }
}

TEST(DateTimeValue, ComparesSecondsOfDatesOnly) {
  const DateTimeValue one(1.0, kDateVal), same(1.0, kTimeVal), two(2.0, kDateVal), missing;
  const NumericValue number(1.0);
  const StringValue text("1");
  EXPECT_TRUE(one == same);
  EXPECT_TRUE(one.Equal(&same, true, false));
  EXPECT_FALSE(one.Equal(&two, false, false));
  EXPECT_FALSE(one.Equal(nullptr, false, false));
  EXPECT_TRUE(one < two);
  EXPECT_TRUE(one <= same);
  EXPECT_TRUE(two > one);
  EXPECT_TRUE(same >= one);
  EXPECT_TRUE(missing == DateTimeValue());
  for (const ScoreValue* other :
       {static_cast<const ScoreValue*>(&number), static_cast<const ScoreValue*>(&text),
        static_cast<const ScoreValue*>(&missing)}) {
    EXPECT_FALSE(one == *other);
    EXPECT_FALSE(one < *other);
    EXPECT_FALSE(one <= *other);
    EXPECT_FALSE(one > *other);
    EXPECT_FALSE(one >= *other);
  }
}

TEST(DateTimeValue, TakesOverDatesOnly) {
  DateTimeValue value(1.0, kDateVal);
  const DateTimeValue other(5.0, kTimeVal);
  const NumericValue number(9.0);
  value.SetValue(&number);
  value.SetValue(nullptr);
  EXPECT_EQ(value.GetDouble(), 1.0);
  value.SetValue(&other);
  EXPECT_EQ(value.GetDouble(), 5.0);
  EXPECT_EQ(value.GetDateTimeType(), kTimeVal);
  value.SetDateTimeValue(7.0, kDateVal);
  EXPECT_EQ(value.GetDateTimeType(), kDateVal);
  value.SetDateTimeValue(1.0, kDateDaysSince1970);
  EXPECT_EQ(value.GetDouble(), 86400.0);
  value.SetDateTimeType(kDateTimeVal);
  EXPECT_EQ(value.GetDateTimeType(), kDateTimeVal);
  EXPECT_EQ(value.GetInt(), 86400);
  EXPECT_EQ(value.GetType(), 5);
  const std::unique_ptr<ScoreValue> clone(value.Clone()), copy(value.GetValue());
  EXPECT_TRUE(*clone == value);
  EXPECT_TRUE(*copy == value);
}

/// A date of a host's own class: only its seconds are known.
class ForeignDate : public NumericValue {
 public:
  using NumericValue::NumericValue;
  ValueType GetType() const override { return ScoreValue::kDateTime; }
};

TEST(DateTimeValue, AsksClassesOfOthersForTheirSeconds) {
  DateTimeValue value(1.0, kTimeVal);
  const ForeignDate foreign(5.0), missing;
  EXPECT_TRUE(value < foreign);
  value.SetValue(&foreign);
  EXPECT_TRUE(value == foreign);
  EXPECT_EQ(value.GetDateTimeType(), kTimeVal) << "it has no kind to take over";
  value.SetValue(&missing);
  EXPECT_TRUE(value.IsSystemMissingValue());
}

TEST(DateTimeValue, AssignsAlsoToItself) {
  DateTimeValue value(5.0, kTimeVal), other;
  other = value;
  const DateTimeValue& same = other;
  other = same;
  other.SetValue(&other);
  EXPECT_EQ(other.GetDouble(), 5.0);
  EXPECT_EQ(other.GetDateTimeType(), kTimeVal);
}

TEST(DateTimeValue, ParsesPartsAndLeavesThemAloneForAnEmptyText) {
  int64_t y = 1, m = 2, d = 3, h = 4, min = 5, s = 6;
  EXPECT_TRUE(DateTimeValue::ParseDate("", y, m, d));
  EXPECT_TRUE(y == 1 && m == 2 && d == 3);
  EXPECT_TRUE(DateTimeValue::ParseTime("", h, min, s));
  EXPECT_TRUE(h == 4 && min == 5 && s == 6);
  EXPECT_TRUE(DateTimeValue::ParseDateTime("", y, m, d, h, min, s));
  EXPECT_TRUE(y == 0 && m == 0 && d == 0 && h == 0 && min == 0 && s == 0);
  h = 9;
  EXPECT_FALSE(DateTimeValue::ParseDateTime("1970-01-02T25:00:00", y, m, d, h, min, s));
  EXPECT_TRUE(y == 0 && m == 0 && d == 0 && h == 0) << "nothing is left of half a text";
  y = 7;
  EXPECT_FALSE(DateTimeValue::ParseDate("1970-13-01", y, m, d));
  EXPECT_EQ(y, 7);
  EXPECT_TRUE(DateTimeValue::ParseDate("99999999999999999999999-01-01", y, m, d));
  EXPECT_EQ(y, Calendar::kFarthest) << "no year beyond that";
  double number = 0.0;
  EXPECT_TRUE(DateTimeValue::ParseDouble("2.5", number));
  EXPECT_EQ(number, 2.5);
  EXPECT_TRUE(DateTimeValue::ParseDouble(" -1e2 apples", number));
  EXPECT_EQ(number, -100.0);
  EXPECT_FALSE(DateTimeValue::ParseDouble("x", number));
  EXPECT_FALSE(DateTimeValue::ParseDouble("", number));
  EXPECT_EQ(number, -100.0);
}

TEST(DateTimeValue, TrimsACharacterAtBothEnds) {
  EXPECT_EQ(DateTimeValue::TrimString("xxabxcxx", 'x'), "abxc");
  EXPECT_EQ(DateTimeValue::TrimString("xxx", 'x'), "");
  EXPECT_EQ(DateTimeValue::TrimString("", 'x'), "");
  EXPECT_EQ(DateTimeValue::TrimString("  a b ", ' '), "a b");
  EXPECT_EQ(DateTimeValue::TrimString("ab", 'x'), "ab");
}

TEST(DateTimeValue, HasTheCalendarsConstants) {
  EXPECT_EQ(DateTimeValue::fJan_1_1970_JulianDay, 2440588);
  EXPECT_EQ(DateTimeValue::fSeconds_Per_Day, 86400);
  constexpr int64_t kLengths[] = {0, 31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
  constexpr int64_t kBefore[] = {0, 0, 31, 59, 90, 120, 151, 181, 212, 243, 273, 304, 334};
  for (int month = 0; month <= 12; ++month) {
    EXPECT_EQ(DateTimeValue::fDaysInMonth[month], kLengths[month]) << month;
    EXPECT_EQ(DateTimeValue::fDaysBeforeMonth[month], kBefore[month]) << month;
    EXPECT_EQ(DateTimeValue::DaysInMonth(2023, month), kLengths[month]) << month;
    EXPECT_EQ(DateTimeValue::DaysBeforeMonth(2024, month), kBefore[month] + (month > 2 ? 1 : 0)) << month;
  }
  EXPECT_TRUE(DateTimeValue::IsLeapYear(2000));
  EXPECT_EQ(DateTimeValue::DaysInYear(2024), 366);
  EXPECT_EQ(DateTimeValue::DaysInYear(2023), 365);
  EXPECT_EQ(DateTimeValue::NumberOfLeapYear(2024, 2020), 1);
  EXPECT_EQ(DateTimeValue::DaysBetweenYear(1971, 1970), -365);
}

TEST(DateTimeValue, JudgesDatesAndTimes) {
  struct Row {
    int64_t a, b, c;
    bool date, time;
  };
  constexpr Row kRows[] = {
      {2023, 2, 28, true, false}, {2023, 2, 29, false, false}, {2024, 2, 29, true, false},
      {-400, 2, 29, true, false}, {2023, 0, 1, false, false},  {2023, 13, 1, false, false},
      {2023, 1, 0, false, false}, {2023, 1, 32, false, false}, {0, 0, 0, false, true},
      {23, 59, 59, false, true},  {24, 0, 0, false, false},    {0, 60, 0, false, false},
      {0, 0, 60, false, false},   {-1, 0, 0, false, false},    {0, -1, 0, false, false},
      {0, 0, -1, false, false},   {1, 1, 1, true, true},
  };
  for (const Row& row : kRows) {
    EXPECT_EQ(DateTimeValue::IsValidDate(row.a, row.b, row.c), row.date)
        << row.a << ' ' << row.b << ' ' << row.c;
    EXPECT_EQ(DateTimeValue::IsValidTime(row.a, row.b, row.c), row.time)
        << row.a << ' ' << row.b << ' ' << row.c;
  }
}

}  // namespace
}  // namespace MCKestrel_800
