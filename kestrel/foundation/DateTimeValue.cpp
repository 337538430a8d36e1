#include "kestrel/foundation/DateTimeValue.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <string_view>

#include "kestrel/foundation/NumberText.h"

namespace MCKestrel_800 {

namespace {

constexpr double kDay = 86400.0;

/// How a numeric type counts: stored seconds = (number + shift) * unit.
struct NumericForm {
  double unit;
  double shift;
};

/// By DateTimeType; a unit of 0 means that there is no such type.
constexpr NumericForm kForms[] = {
    {0.0, 0.0},             // none
    {1.0, 0.0},             // date
    {1.0, 0.0},             // time
    {1.0, 0.0},             // dateTime
    {kDay, -719528.0},      // dateDaysSince[0]
    {kDay, -3653.0},        // dateDaysSince[1960]
    {kDay, 0.0},            // dateDaysSince[1970]
    {kDay, 3652.0},         // dateDaysSince[1980]
    {1.0, 0.0},             // timeSeconds
    {1.0, -62167219200.0},  // dateTimeSecondsSince[0]
    {1.0, -315619200.0},    // dateTimeSecondsSince[1960]
    {1.0, 0.0},             // dateTimeSecondsSince[1970]
    {1.0, 315532800.0},     // dateTimeSecondsSince[1980]
};

const NumericForm* FormOf(DateTimeType type) {
  return type >= kDate && type <= kDateTimeSecondsSince1980 ? &kForms[type] : nullptr;
}

/// Whether the seconds stand for a point in time: not undefined, not infinite, and a number.
bool IsMoment(double seconds) {
  return std::isfinite(seconds) && !NumericValue::IsSystemMissingValue(seconds);
}

/// Seconds cut toward zero to an integer; what no calendar reaches is clamped, and what is undefined or no
/// number is 0.
int64_t WholeSeconds(double seconds) {
  if (std::isnan(seconds) || NumericValue::IsSystemMissingValue(seconds)) return 0;
  constexpr double kFarthest = 9e18;
  return static_cast<int64_t>(std::clamp(seconds, -kFarthest, kFarthest));
}

/// Reads three integers separated by a character. Blanks count nowhere; every piece needs a digit.
bool ReadThree(std::string_view text, char separator, int64_t (&numbers)[3]) {
  size_t piece = 0;
  bool digits = false;
  int64_t number = 0;
  for (const char c : text) {
    if (c == ' ') continue;
    if (c == separator) {
      if (!digits || piece == 2) return false;
      numbers[piece++] = number;
      number = 0;
      digits = false;
    } else if (c >= '0' && c <= '9') {
      number = std::min(10 * number + (c - '0'), Calendar::kFarthest);
      digits = true;
    } else {
      return false;
    }
  }
  if (!digits || piece != 2) return false;
  numbers[2] = number;
  return true;
}

bool ReadDate(std::string_view text, int64_t (&numbers)[3]) {
  return ReadThree(text, '-', numbers) && DateTimeValue::IsValidDate(numbers[0], numbers[1], numbers[2]);
}
bool ReadTime(std::string_view text, int64_t (&numbers)[3]) {
  return ReadThree(text, ':', numbers) && DateTimeValue::IsValidTime(numbers[0], numbers[1], numbers[2]);
}

int64_t SecondsOfDay(int64_t seconds) {
  const int64_t t = seconds % Calendar::kSeconds_Per_Day;
  return t < 0 ? t + Calendar::kSeconds_Per_Day : t;
}

void SplitTime(int64_t t, int64_t& h, int64_t& m, int64_t& s) {
  h = t / 3600;
  m = (t - 3600 * h) / 60;
  s = t - 3600 * h - 60 * m;
}

/// Year, month or day (0, 1, 2) of the seconds, and hour, minute or second; missing when there are none.
double DatePart(double seconds, int part) {
  if (!IsMoment(seconds)) return NumericValue::gSysmisValue;
  int64_t parts[3];
  DateTimeValue::ExtractDate(seconds, parts[0], parts[1], parts[2]);
  return static_cast<double>(parts[part]);
}
double TimePart(double seconds, int part) {
  if (!IsMoment(seconds)) return NumericValue::gSysmisValue;
  int64_t parts[3];
  DateTimeValue::ExtractTime(seconds, parts[0], parts[1], parts[2]);
  return static_cast<double>(parts[part]);
}

/// A duration in seconds in a longer unit; a missing one stays missing.
double InUnits(double seconds, double unit) {
  return NumericValue::IsSystemMissingValue(seconds) ? seconds : seconds / unit;
}

int64_t DaysSince1970(int64_t y, int64_t m, int64_t d) {
  return Calendar::DaysBetweenYear(1970, y) + Calendar::DaysBeforeMonth(y, m) + d - 1;
}

}  // namespace

// Defined here too, so that hosts and plug-ins can take their address.
constexpr int64_t DateTimeValue::fJan_1_1970_JulianDay;
constexpr int64_t DateTimeValue::fSeconds_Per_Day;
constexpr const int64_t (&DateTimeValue::fDaysInMonth)[13];
constexpr const int64_t (&DateTimeValue::fDaysBeforeMonth)[13];

DateTimeValue::DateTimeValue(double number, DateTimeType type) {
  SetDateTimeValue(number, type);
}
DateTimeValue::DateTimeValue(const std::string& text, DateTimeType type) : kind_(GetValType(type)) {
  FromString(text, type);
}
DateTimeValue::~DateTimeValue() = default;

void DateTimeValue::SetValue(const ScoreValue* other) {
  if (other == nullptr || other->GetType() != ScoreValue::kDateTime) return;
  seconds_ = other->GetDouble();
  if (const auto* date = dynamic_cast<const DateTimeValue*>(other)) kind_ = date->kind_;
}

ScoreValue* DateTimeValue::GetValue() const {
  return Clone();
}
ScoreValue* DateTimeValue::Clone() const {
  return new DateTimeValue(*this);
}

bool DateTimeValue::operator==(const ScoreValue& other) const {
  return other.GetType() == ScoreValue::kDateTime && NumericValue::IsEqual(seconds_, other.GetDouble());
}
bool DateTimeValue::Equal(const ScoreValue* other, bool, bool) const {
  return other != nullptr && *this == *other;
}
bool DateTimeValue::operator>(const ScoreValue& other) const {
  return other.GetType() == ScoreValue::kDateTime && NumberLess(other.GetDouble(), seconds_);
}
bool DateTimeValue::operator<(const ScoreValue& other) const {
  return other.GetType() == ScoreValue::kDateTime && NumberLess(seconds_, other.GetDouble());
}
bool DateTimeValue::operator<=(const ScoreValue& other) const {
  return other.GetType() == ScoreValue::kDateTime && NumberLessOrEqual(seconds_, other.GetDouble());
}
bool DateTimeValue::operator>=(const ScoreValue& other) const {
  return other.GetType() == ScoreValue::kDateTime && NumberLessOrEqual(other.GetDouble(), seconds_);
}

int DateTimeValue::GetInt() const {
  return NumericValue(seconds_).GetInt();
}

std::string DateTimeValue::GetString() const {
  if (!IsMoment(seconds_)) return "Undefined";
  int64_t y = 0, mon = 0, d = 0, h = 0, min = 0, s = 0;
  // Rounded downwards, unlike the extraction of a date, so that the text of a time before 1970 reads back.
  const int64_t seconds = WholeSeconds(std::floor(seconds_));
  const int64_t t = SecondsOfDay(seconds);
  SplitTime(t, h, min, s);
  Calendar::DateOfDays((seconds - t) / fSeconds_Per_Day, y, mon, d);
  char date[48], time[40];
  std::snprintf(date, sizeof date, "%s%04lld-%02d-%02d", y < 0 ? "-" : "",
                static_cast<long long>(y < 0 ? -y : y), static_cast<int>(mon), static_cast<int>(d));
  std::snprintf(time, sizeof time, "%02d:%02d:%02d", static_cast<int>(h), static_cast<int>(min),
                static_cast<int>(s));
  if (kind_ == kDateVal) return date;
  if (kind_ == kTimeVal) return time;
  return std::string(date) + "T" + time;
}

void DateTimeValue::SetDateTimeValue(double seconds, DateTimeValType kind) {
  seconds_ = seconds;
  kind_ = kind;
}

void DateTimeValue::SetDateTimeValue(double number, DateTimeType type) {
  kind_ = GetValType(type);
  FromNumeric(number, type);
}

double DateTimeValue::GetDoubleValue(DateTimeType type) const {
  const NumericForm* form = FormOf(type);
  if (form == nullptr || IsSystemMissingValue()) return NumericValue::gSysmisValue;
  return seconds_ / form->unit - form->shift;
}

ScoreValue* DateTimeValue::GetValue(DateTimeType type) const {
  return new NumericValue(GetDoubleValue(type));
}

std::string DateTimeValue::GetNumericString() const {
  return NumericValue(seconds_).GetString();
}

void DateTimeValue::FromNumeric(double number, DateTimeType type) {
  const NumericForm* form = FormOf(type);
  seconds_ = form == nullptr || NumericValue::IsSystemMissingValue(number)
                 ? NumericValue::gSysmisValue
                 : (number + form->shift) * form->unit;
}

void DateTimeValue::FromString(const std::string& text, DateTimeType type) {
  seconds_ = NumericValue::gSysmisValue;
  if (text.empty()) return;
  int64_t y = 0, mon = 0, d = 0, h = 0, min = 0, s = 0;
  if (type == kDate) {
    if (ParseDate(text, y, mon, d)) seconds_ = static_cast<double>(DaysSince1970(y, mon, d)) * kDay;
  } else if (type == kTime) {
    if (ParseTime(text, h, min, s)) seconds_ = static_cast<double>((h * 60 + min) * 60 + s);
  } else if (type == DateTimeType::kDateTime) {
    if (ParseDateTime(text, y, mon, d, h, min, s)) {
      seconds_ =
          static_cast<double>(DaysSince1970(y, mon, d)) * kDay + static_cast<double>((h * 60 + min) * 60 + s);
    }
  } else {
    FromNumeric(NumericValue(text).GetDouble(), type);
  }
}

double DateTimeValue::ExtractYear() const {
  return DatePart(seconds_, 0);
}
double DateTimeValue::ExtractMonth() const {
  return DatePart(seconds_, 1);
}
double DateTimeValue::ExtractDay() const {
  return DatePart(seconds_, 2);
}
double DateTimeValue::ExtractHour() const {
  return TimePart(seconds_, 0);
}
double DateTimeValue::ExtractMinute() const {
  return TimePart(seconds_, 1);
}
double DateTimeValue::ExtractSecond() const {
  return TimePart(seconds_, 2);
}

double DateTimeValue::ComputeDurationSeconds(const DateTimeValue& other) const {
  if (!IsMoment(seconds_) || !IsMoment(other.seconds_)) return NumericValue::gSysmisValue;
  return seconds_ - other.seconds_;
}
double DateTimeValue::ComputeDurationMinutes(const DateTimeValue& other) const {
  return InUnits(ComputeDurationSeconds(other), 60.0);
}
double DateTimeValue::ComputeDurationHours(const DateTimeValue& other) const {
  return InUnits(ComputeDurationSeconds(other), 3600.0);
}
double DateTimeValue::ComputeDurationDays(const DateTimeValue& other) const {
  return InUnits(ComputeDurationSeconds(other), kDay);
}
double DateTimeValue::ComputeDurationMonths(const DateTimeValue& other) const {
  return InUnits(ComputeDurationDays(other), 30.4375);
}
double DateTimeValue::ComputeDurationYears(const DateTimeValue& other) const {
  return InUnits(ComputeDurationDays(other), 365.25);
}

DateTimeValType DateTimeValue::GetValType(DateTimeType type) {
  switch (type) {
    case DateTimeType::kDate:
    case kDateDaysSince0:
    case kDateDaysSince1960:
    case kDateDaysSince1970:
    case kDateDaysSince1980:
      return kDateVal;
    case kTime:
    case kTimeSeconds:
      return kTimeVal;
    default:
      return kDateTimeVal;
  }
}

DateTimeType DateTimeValue::GetDateTimeType(DateTimeValType kind) {
  return kind == kDateVal ? DateTimeType::kDate : kind == kTimeVal ? kTime : DateTimeType::kDateTime;
}

bool DateTimeValue::IsValidDate(int64_t y, int64_t m, int64_t d) {
  return m >= 1 && m <= 12 && d >= 1 && d <= Calendar::DaysInMonth(y, m);
}

bool DateTimeValue::IsValidTime(int64_t h, int64_t m, int64_t s) {
  return h >= 0 && h < 24 && m >= 0 && m < 60 && s >= 0 && s < 60;
}

bool DateTimeValue::IsValidDateTime(const std::string& text, DateTimeType type) {
  int64_t y = 0, mon = 0, d = 0, h = 0, min = 0, s = 0;
  double number = 0.0;
  switch (type) {
    case DateTimeType::kDate:
      return ParseDate(text, y, mon, d);
    case kTime:
      return ParseTime(text, h, min, s);
    case DateTimeType::kDateTime:
      return ParseDateTime(text, y, mon, d, h, min, s);
    default:
      return FormOf(type) != nullptr && ParseDouble(text, number);
  }
}

void DateTimeValue::ExtractDate(double seconds, int64_t& y, int64_t& m, int64_t& d) {
  Calendar::DateOfDays(WholeSeconds(seconds) / fSeconds_Per_Day, y, m, d);
}

void DateTimeValue::ExtractTime(double seconds, int64_t& h, int64_t& m, int64_t& s) {
  SplitTime(SecondsOfDay(WholeSeconds(seconds)), h, m, s);
}

std::string DateTimeValue::TrimString(const std::string& text, char c) {
  const size_t first = text.find_first_not_of(c);
  if (first == std::string::npos) return std::string();
  return text.substr(first, text.find_last_not_of(c) - first + 1);
}

bool DateTimeValue::ParseDate(const std::string& text, int64_t& y, int64_t& m, int64_t& d) {
  if (text.empty()) return true;
  int64_t numbers[3];
  if (!ReadDate(text, numbers)) return false;
  y = numbers[0];
  m = numbers[1];
  d = numbers[2];
  return true;
}

bool DateTimeValue::ParseTime(const std::string& text, int64_t& h, int64_t& m, int64_t& s) {
  if (text.empty()) return true;
  int64_t numbers[3];
  if (!ReadTime(text, numbers)) return false;
  h = numbers[0];
  m = numbers[1];
  s = numbers[2];
  return true;
}

bool DateTimeValue::ParseDateTime(const std::string& text, int64_t& y, int64_t& mon, int64_t& d, int64_t& h,
                                  int64_t& min, int64_t& s) {
  y = mon = d = h = min = s = 0;
  if (text.empty()) return true;
  const size_t split = text.find('T');
  if (split == std::string::npos) return false;
  const std::string_view date = std::string_view(text).substr(0, split);
  const std::string_view time = std::string_view(text).substr(split + 1);
  // Unlike a whole text, a half must not be empty: "T01:00:00" has no day to count from.
  int64_t day[3], clock[3];
  if (!ReadDate(date, day) || !ReadTime(time, clock)) return false;
  y = day[0];
  mon = day[1];
  d = day[2];
  h = clock[0];
  min = clock[1];
  s = clock[2];
  return true;
}

bool DateTimeValue::ParseDouble(const std::string& text, double& number) {
  NumericValue read(text);
  if (read.IsSystemMissingValue()) return false;
  number = read.GetDouble();
  return true;
}

}  // namespace MCKestrel_800
