#include "kestrel/foundation/Calendar.h"

#include <gtest/gtest.h>

#include <limits>

namespace MCKestrel_800 {
namespace {

using namespace Calendar;

TEST(Calendar, KnowsLeapYearsBeforeAndAfterTheYearZero) {
  for (const int64_t year : {2000, 2024, 1600, 0, -4, -400, 4})
    EXPECT_TRUE(IsLeapYear(year)) << year;
  for (const int64_t year : {1900, 2100, 2023, -100, -1, 1, -300})
    EXPECT_FALSE(IsLeapYear(year)) << year;
}

TEST(Calendar, KnowsMonths) {
  EXPECT_EQ(DaysInMonth(2023, 2), 28);
  EXPECT_EQ(DaysInMonth(2024, 2), 29);
  EXPECT_EQ(DaysInMonth(2024, 12), 31);
  EXPECT_EQ(DaysInMonth(2024, 0), 0);
  EXPECT_EQ(DaysInMonth(2024, 13), 0);
  EXPECT_EQ(DaysBeforeMonth(2023, 3), 59);
  EXPECT_EQ(DaysBeforeMonth(2024, 3), 60);
  EXPECT_EQ(DaysBeforeMonth(2024, 2), 31);
  EXPECT_EQ(DaysBeforeMonth(2024, -1), 0);
  EXPECT_EQ(kDaysInMonth[0], 0);
  EXPECT_EQ(kDaysBeforeMonth[12], 334);
}

TEST(Calendar, CountsLeapYearsBetweenYears) {
  EXPECT_EQ(NumberOfLeapYear(2000, 2000), 0);
  EXPECT_EQ(NumberOfLeapYear(2000, 2001), 1);
  EXPECT_EQ(NumberOfLeapYear(2001, 2000), 1);
  EXPECT_EQ(NumberOfLeapYear(-5, 5), 3);  // -4, 0, 4
  int64_t counted = 0;
  for (int64_t year = -1000; year < 3000; ++year) {
    EXPECT_EQ(NumberOfLeapYear(-1000, year), counted) << year;
    counted += IsLeapYear(year) ? 1 : 0;
  }
}

TEST(Calendar, CountsDaysBetweenYears) {
  EXPECT_EQ(DaysBetweenYear(1970, 1971), 365);
  EXPECT_EQ(DaysBetweenYear(1971, 1970), -365);
  EXPECT_EQ(DaysBetweenYear(0, 1970), 719528);
  EXPECT_EQ(DaysBetweenYear(1960, 1970), 3653);
  EXPECT_EQ(DaysBetweenYear(1970, 1980), 3652);
  EXPECT_EQ(DaysBetweenYear(5, 5), 0);
}

/// Walks the calendar a day at a time by rules of its own, so that nothing under test checks itself.
class DayCounter {
 public:
  explicit DayCounter(int64_t year) : year_(year) {}

  void Next() {
    if (++day_ <= Length()) return;
    day_ = 1;
    if (++month_ <= 12) return;
    month_ = 1;
    ++year_;
  }
  int64_t Year() const { return year_; }
  int64_t Month() const { return month_; }
  int64_t Day() const { return day_; }

 private:
  int64_t Length() const {
    if (month_ == 2) return year_ % 400 == 0 || (year_ % 4 == 0 && year_ % 100 != 0) ? 29 : 28;
    return month_ == 4 || month_ == 6 || month_ == 9 || month_ == 11 ? 30 : 31;
  }

  int64_t year_, month_ = 1, day_ = 1;
};

TEST(Calendar, FindsTheDateOfEveryDay) {
  // 25 cycles of 400 years (146,097 days each) reach from the year -8030 to 1970.
  constexpr int64_t kFirst = -25 * 146097;
  DayCounter counter(1970 - 25 * 400);
  for (int64_t days = kFirst; counter.Year() < 10000; ++days, counter.Next()) {
    int64_t y = 0, m = 0, d = 0;
    DateOfDays(days, y, m, d);
    ASSERT_TRUE(y == counter.Year() && m == counter.Month() && d == counter.Day())
        << days << " gives " << y << '-' << m << '-' << d;
    if (d != 1) continue;
    ASSERT_EQ(DaysBetweenYear(1970, y) + DaysBeforeMonth(y, m), days) << y << '-' << m;
  }
}

TEST(Calendar, StartsTheJulianDaysAtTheirEpoch) {
  int64_t y = 0, m = 0, d = 0;
  DateOfDays(-kJan_1_1970_JulianDay, y, m, d);
  // Noon of 1 January 4713 BC in the Julian calendar.
  EXPECT_TRUE(y == -4713 && m == 11 && d == 24) << y << '-' << m << '-' << d;
}

TEST(Calendar, StaysInsideItsNumbersForEveryArgument) {
  constexpr int64_t kLowest = std::numeric_limits<int64_t>::min(),
                    kHighest = std::numeric_limits<int64_t>::max();
  int64_t y = 0, m = 0, d = 0;
  for (const int64_t extreme : {kLowest, kLowest + 1, kHighest}) {
    IsLeapYear(extreme);
    DaysInMonth(extreme, 2);
    DaysBeforeMonth(extreme, 3);
    NumberOfLeapYear(extreme, 0);
    NumberOfLeapYear(kLowest, kHighest);
    DateOfDays(extreme, y, m, d);
  }
  for (const int64_t days : {kLowest, -kFarthest, kFarthest, kHighest}) {
    DateOfDays(days, y, m, d);
    EXPECT_TRUE(m >= 1 && m <= 12 && d >= 1 && d <= DaysInMonth(y, m)) << y << '-' << m << '-' << d;
  }
  EXPECT_EQ(DaysBetweenYear(kLowest, kHighest), DaysBetweenYear(-kFarthest, kFarthest));
}

}  // namespace
}  // namespace MCKestrel_800
