// A date, a time of day or a date with a time as a value: one number of seconds.

#ifndef KESTREL_FOUNDATION_DATETIMEVALUE_H
#define KESTREL_FOUNDATION_DATETIMEVALUE_H

#include <cstdint>
#include <string>

#include "kestrel/foundation/Calendar.h"
#include "kestrel/foundation/DateTimeType.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// Seconds since 1970-01-01 00:00:00, or since midnight for a time of day; the system-missing number when
/// undefined. Texts that do not parse leave a value undefined.
///
///   DateTimeValue born("1970-01-02", DateTimeType::kDate);    // 86400 seconds
///   DateTimeValue seen(20000.0, kDateDaysSince1970);          // 20,000 days
///   seen.ComputeDurationYears(born)                           // 54.75...
class KESTREL_API DateTimeValue : public ScoreValue {
 public:
  static constexpr int64_t fJan_1_1970_JulianDay = Calendar::kJan_1_1970_JulianDay;
  static constexpr int64_t fSeconds_Per_Day = Calendar::kSeconds_Per_Day;
  /// By month, 1 to 12, of a common year; index 0 holds 0.
  static constexpr const int64_t (&fDaysInMonth)[13] = Calendar::kDaysInMonth;
  /// Days of a common year before the month.
  static constexpr const int64_t (&fDaysBeforeMonth)[13] = Calendar::kDaysBeforeMonth;

  /// An undefined date with a time.
  DateTimeValue() = default;
  DateTimeValue(const DateTimeValue& other) = default;
  DateTimeValue& operator=(const DateTimeValue& other) = default;
  /// Takes the seconds as they are.
  DateTimeValue(double seconds, DateTimeValType kind) : seconds_(seconds), kind_(kind) {}
  /// Takes a number in the type's unit and epoch.
  DateTimeValue(double number, DateTimeType type);
  /// Reads a text of the type.
  DateTimeValue(const std::string& text, DateTimeType type);
  ~DateTimeValue() override;

  /// Takes over the seconds of another date/time value, and the kind where the other's class has one; does
  /// nothing with a value that is no date/time.
  void SetValue(const ScoreValue* other) override;
  ScoreValue* GetValue() const override;
  ScoreValue* Clone() const override;
  /// Seconds are equal by NumericValue::IsEqual; false for values of other classes.
  bool operator==(const ScoreValue& other) const override;
  /// The same as operator==.
  bool Equal(const ScoreValue* other, bool exact, bool emptyStringOK) const override;
  /// Ordered as numbers are; false when either is undefined.
  bool operator>(const ScoreValue& other) const override;
  bool operator<(const ScoreValue& other) const override;
  bool operator<=(const ScoreValue& other) const override;
  bool operator>=(const ScoreValue& other) const override;
  bool IsSystemMissingValue() const override { return NumericValue::IsSystemMissingValue(seconds_); }
  /// The seconds, truncated and clamped to int.
  int GetInt() const override;
  /// The seconds.
  double GetDouble() const override { return seconds_; }
  /// ISO 8601 (1970-01-02, 01:02:03, or both joined by "T"), which FromString reads back from the year 0 on;
  /// fractions of a second are cut off downwards. "Undefined" when undefined, infinite or no number.
  std::string GetString() const override;
  ValueType GetType() const override { return ScoreValue::kDateTime; }

  void SetDateTimeValue(double seconds, DateTimeValType kind);
  void SetDateTimeValue(double number, DateTimeType type);
  /// Whether it is a date, a time or both.
  DateTimeValType GetDateTimeType() const { return kind_; }
  void SetDateTimeType(DateTimeValType kind) { kind_ = kind; }

  /// The seconds as a number in the type's unit and epoch, not truncated. System-missing when undefined or
  /// when there is no such type.
  double GetDoubleValue(DateTimeType type) const;
  /// The same as a new NumericValue that the caller owns.
  ScoreValue* GetValue(DateTimeType type) const;
  /// The seconds as text, six significant digits; "Undefined" when undefined.
  std::string GetNumericString() const;

  /// Sets the seconds from a number in the type's unit and epoch, or from a text of the type.
  void FromNumeric(double number, DateTimeType type);
  void FromString(const std::string& text, DateTimeType type);

  /// Components; system-missing when undefined, infinite or no number. Days are cut toward zero, so the day
  /// before 1970 counts as 1 January but for its first second, while the time of day always counts upwards.
  /// Beyond 9e18 seconds all dates are one.
  double ExtractYear() const;
  double ExtractMonth() const;
  double ExtractDay() const;
  double ExtractHour() const;
  double ExtractMinute() const;
  double ExtractSecond() const;

  /// This value minus the other; system-missing when either is undefined, infinite or no number. A month
  /// is 30.4375 days, a year 365.25.
  double ComputeDurationSeconds(const DateTimeValue& other) const;
  double ComputeDurationMinutes(const DateTimeValue& other) const;
  double ComputeDurationHours(const DateTimeValue& other) const;
  double ComputeDurationDays(const DateTimeValue& other) const;
  double ComputeDurationMonths(const DateTimeValue& other) const;
  double ComputeDurationYears(const DateTimeValue& other) const;

  /// What a value of the type holds, and the type that holds just that.
  static DateTimeValType GetValType(DateTimeType type);
  static DateTimeType GetDateTimeType(DateTimeValType kind);

  static bool IsLeapYear(int64_t y) { return Calendar::IsLeapYear(y); }
  static int64_t DaysInYear(int64_t y) { return Calendar::IsLeapYear(y) ? 366 : 365; }
  static int64_t DaysInMonth(int64_t y, int64_t m) { return Calendar::DaysInMonth(y, m); }
  static int64_t DaysBeforeMonth(int64_t y, int64_t m) { return Calendar::DaysBeforeMonth(y, m); }
  static int64_t NumberOfLeapYear(int64_t a, int64_t b) { return Calendar::NumberOfLeapYear(a, b); }
  static int64_t DaysBetweenYear(int64_t a, int64_t b) { return Calendar::DaysBetweenYear(a, b); }
  static bool IsValidDate(int64_t y, int64_t m, int64_t d);
  static bool IsValidTime(int64_t h, int64_t m, int64_t s);
  /// Whether the text parses as a date/time of the type. The empty text does for dates and times, although it
  /// leaves a value undefined, and does not for numbers.
  static bool IsValidDateTime(const std::string& text, DateTimeType type);
  /// Date and time of day of seconds since 1970. Undefined seconds and no number count as 0.
  static void ExtractDate(double seconds, int64_t& y, int64_t& m, int64_t& d);
  static void ExtractTime(double seconds, int64_t& h, int64_t& m, int64_t& s);

  /// The text without that character at both ends.
  static std::string TrimString(const std::string& text, char c);
  /// Three integers separated by "-" (":" for a time), blanks allowed anywhere. Dates need a month of 1 to 12
  /// and a day of that month, times all three parts in their ranges. An empty text is accepted and changes
  /// nothing.
  static bool ParseDate(const std::string& text, int64_t& y, int64_t& m, int64_t& d);
  static bool ParseTime(const std::string& text, int64_t& h, int64_t& m, int64_t& s);
  /// Date and time split at the first "T". An empty text is accepted; all fields are 0 then, and on failure.
  static bool ParseDateTime(const std::string& text, int64_t& y, int64_t& mon, int64_t& d, int64_t& h,
                            int64_t& min, int64_t& s);
  /// Reads a number as NumericValue does; false when the text holds none.
  static bool ParseDouble(const std::string& text, double& number);

 private:
  double seconds_ = NumericValue::gSysmisValue;
  DateTimeValType kind_ = kDateTimeVal;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_FOUNDATION_DATETIMEVALUE_H
