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

TEST(Calendar, FindsTheDateOfEveryDay) {
  // Counted day by day from 1 January of the year -400, which is as many days before 1970 as given.
  int64_t year = -400, month = 1, day = 1;
  for (int64_t days = -DaysBetweenYear(-400, 1970); year < 2400; ++days) {
    int64_t y = 0, m = 0, d = 0;
    DateOfDays(days, y, m, d);
    ASSERT_TRUE(y == year && m == month && d == day) << days << " gives " << y << '-' << m << '-' << d;
    if (++day > DaysInMonth(year, month)) {
      day = 1;
      if (++month > 12) {
        month = 1;
        ++year;
      }
    }
  }
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
  EXPECT_EQ(DaysBetweenYear(kLowest, kHighest), DaysBetweenYear(-kFarthest, kFarthest));
}

}  // namespace
}  // namespace MCKestrel_800
