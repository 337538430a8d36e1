// The proleptic Gregorian calendar on 64-bit integers: leap years, days between years, and back from seconds.

#ifndef KESTREL_FOUNDATION_CALENDAR_H
#define KESTREL_FOUNDATION_CALENDAR_H

#include <cstdint>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {
namespace Calendar {

/// The Julian day number of 1 January 1970, and the seconds of a day.
constexpr int64_t kJan_1_1970_JulianDay = 2440588;
constexpr int64_t kSeconds_Per_Day = 86400;
/// By month, 1 to 12, of a common year.
inline constexpr int64_t kDaysInMonth[13] = {0, 31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
inline constexpr int64_t kDaysBeforeMonth[13] = {0, 0, 31, 59, 90, 120, 151, 181, 212, 243, 273, 304, 334};
/// Years and days beyond this are cut to it, so that no calculation overflows.
constexpr int64_t kFarthest = 1'000'000'000'000'000;

KESTREL_API bool IsLeapYear(int64_t year);
/// Days of the month; 0 for a month outside 1 to 12.
KESTREL_API int64_t DaysInMonth(int64_t year, int64_t month);
/// Days of the year before the month; 0 for a month outside 1 to 12.
KESTREL_API int64_t DaysBeforeMonth(int64_t year, int64_t month);
/// Leap years y with min(a, b) <= y < max(a, b).
KESTREL_API int64_t NumberOfLeapYear(int64_t a, int64_t b);
/// Days from 1 January of a to 1 January of b; negative when a is later.
KESTREL_API int64_t DaysBetweenYear(int64_t a, int64_t b);

/// The date of a number of days since 1970, by Richards' method for Julian day numbers (E. G. Richards, in
/// Explanatory Supplement to the Astronomical Almanac, 3rd edition, 2013, chapter 15). Its divisions are
/// integral and round downwards, so that it holds before the year -4716 as well, where the dividends turn
/// negative.
KESTREL_API void DateOfDays(int64_t days, int64_t& year, int64_t& month, int64_t& day);

}  // namespace Calendar
}  // namespace MCKestrel_800

#endif  // KESTREL_FOUNDATION_CALENDAR_H
