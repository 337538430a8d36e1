#include "kestrel/foundation/DateTimeValue.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <memory>

#include "kestrel/foundation/StringValue.h"

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
    {"1970-01-01", kNoDateTime, kSysmis, "no type"},
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

TEST(DateTimeValue, AnswersForEveryNumberOfSeconds) {
  for (const double seconds :
       {1e300, -1e300, 1e19, -1e19, std::nan(""), NumericValue::gInfinity, -NumericValue::gInfinity}) {
    const DateTimeValue value(seconds, kDateTimeVal);
    EXPECT_TRUE(std::isfinite(value.ExtractYear()));
    EXPECT_GE(value.ExtractHour(), 0.0);
    EXPECT_LT(value.ExtractHour(), 24.0);
    EXPECT_FALSE(value.GetString().empty());
    value.GetInt();
  }
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

TEST(DateTimeValue, ParsesPartsAndLeavesThemAloneForAnEmptyText) {
  int64_t y = 1, m = 2, d = 3, h = 4, min = 5, s = 6;
  EXPECT_TRUE(DateTimeValue::ParseDate("", y, m, d));
  EXPECT_TRUE(y == 1 && m == 2 && d == 3);
  EXPECT_TRUE(DateTimeValue::ParseTime("", h, min, s));
  EXPECT_TRUE(h == 4 && min == 5 && s == 6);
  EXPECT_TRUE(DateTimeValue::ParseDateTime("", y, m, d, h, min, s));
  EXPECT_TRUE(y == 0 && m == 0 && d == 0 && h == 0 && min == 0 && s == 0);
  EXPECT_TRUE(DateTimeValue::ParseDate("99999999999999999999999-01-01", y, m, d));
  double number = 0.0;
  EXPECT_TRUE(DateTimeValue::ParseDouble("2.5", number));
  EXPECT_EQ(number, 2.5);
  EXPECT_FALSE(DateTimeValue::ParseDouble("x", number));
}

TEST(DateTimeValue, TrimsACharacterAtBothEnds) {
  EXPECT_EQ(DateTimeValue::TrimString("xxabxcxx", 'x'), "abxc");
  EXPECT_EQ(DateTimeValue::TrimString("xxx", 'x'), "");
  EXPECT_EQ(DateTimeValue::TrimString("", 'x'), "");
}

TEST(DateTimeValue, HasTheCalendarsConstants) {
  EXPECT_EQ(DateTimeValue::fJan_1_1970_JulianDay, 2440588);
  EXPECT_EQ(DateTimeValue::fSeconds_Per_Day, 86400);
  EXPECT_EQ(DateTimeValue::fDaysInMonth[2], 28);
  EXPECT_EQ(DateTimeValue::fDaysBeforeMonth[12], 334);
  EXPECT_EQ(DateTimeValue::DaysInYear(2024), 366);
  EXPECT_EQ(DateTimeValue::DaysInYear(2023), 365);
  EXPECT_TRUE(DateTimeValue::IsValidTime(0, 0, 0));
  EXPECT_FALSE(DateTimeValue::IsValidTime(-1, 0, 0));
  EXPECT_FALSE(DateTimeValue::IsValidDate(2023, 2, 29));
}

}  // namespace
}  // namespace MCKestrel_800
