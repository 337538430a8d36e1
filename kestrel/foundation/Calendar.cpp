#include "kestrel/foundation/Calendar.h"

#include <algorithm>

namespace MCKestrel_800 {
namespace Calendar {

namespace {

int64_t Cut(int64_t x) {
  return std::clamp(x, -kFarthest, kFarthest);
}

/// Rounded downwards; b is positive.
int64_t FloorDivide(int64_t a, int64_t b) {
  return a / b - (a % b < 0 ? 1 : 0);
}

/// What FloorDivide leaves: never negative.
int64_t FloorRemainder(int64_t a, int64_t b) {
  const int64_t rest = a % b;
  return rest < 0 ? rest + b : rest;
}

/// Leap years before the year, counted from the year 1 and downwards below it.
int64_t LeapYearsBefore(int64_t year) {
  const int64_t y = year - 1;
  return FloorDivide(y, 4) - FloorDivide(y, 100) + FloorDivide(y, 400);
}

bool IsMonth(int64_t month) {
  return month >= 1 && month <= 12;
}

}  // namespace

bool IsLeapYear(int64_t year) {
  return (year % 4 == 0 && year % 100 != 0) || year % 400 == 0;
}

int64_t DaysInMonth(int64_t year, int64_t month) {
  if (!IsMonth(month)) return 0;
  return kDaysInMonth[month] + (month == 2 && IsLeapYear(year) ? 1 : 0);
}

int64_t DaysBeforeMonth(int64_t year, int64_t month) {
  if (!IsMonth(month)) return 0;
  return kDaysBeforeMonth[month] + (month > 2 && IsLeapYear(year) ? 1 : 0);
}

int64_t NumberOfLeapYear(int64_t a, int64_t b) {
  return LeapYearsBefore(Cut(std::max(a, b))) - LeapYearsBefore(Cut(std::min(a, b)));
}

int64_t DaysBetweenYear(int64_t a, int64_t b) {
  const int64_t first = Cut(std::min(a, b)), last = Cut(std::max(a, b));
  const int64_t days = 365 * (last - first) + NumberOfLeapYear(first, last);
  return a > b ? -days : days;
}

void DateOfDays(int64_t days, int64_t& year, int64_t& month, int64_t& day) {
  const int64_t J = Cut(days) + kJan_1_1970_JulianDay;
  const int64_t f = J + 1401 + FloorDivide(FloorDivide(4 * J + 274277, 146097) * 3, 4) - 38;
  const int64_t e = 4 * f + 3;
  const int64_t g = FloorRemainder(e, 1461) / 4;
  const int64_t h = 5 * g + 2;
  day = (h % 153) / 5 + 1;
  month = (h / 153 + 2) % 12 + 1;
  year = FloorDivide(e, 1461) - 4716 + (14 - month) / 12;
}

}  // namespace Calendar
}  // namespace MCKestrel_800
