// The kinds of date and time that documents know, in which unit and from which epoch each counts.

#ifndef KESTREL_FOUNDATION_DATETIMETYPE_H
#define KESTREL_FOUNDATION_DATETIMETYPE_H

namespace MCKestrel_800 {

/// How a field writes its dates and times.
enum DateTimeType : int {
  kNoDateTime = 0,
  kDate = 1,                       ///< year-month-day
  kTime = 2,                       ///< hour:minute:second
  kDateTime = 3,                   ///< date, "T", time
  kDateDaysSince0 = 4,             ///< days since 1 January of the year 0
  kDateDaysSince1960 = 5,          ///< days since 1 January 1960
  kDateDaysSince1970 = 6,          ///< days since 1 January 1970
  kDateDaysSince1980 = 7,          ///< days since 1 January 1980
  kTimeSeconds = 8,                ///< seconds since midnight
  kDateTimeSecondsSince0 = 9,      ///< seconds since 1 January of the year 0
  kDateTimeSecondsSince1960 = 10,  ///< seconds since 1 January 1960
  kDateTimeSecondsSince1970 = 11,  ///< seconds since 1 January 1970
  kDateTimeSecondsSince1980 = 12,  ///< seconds since 1 January 1980
};

/// What a date/time value holds.
enum DateTimeValType : int { kDateVal = 0, kTimeVal = 1, kDateTimeVal = 2 };

}  // namespace MCKestrel_800

#endif  // KESTREL_FOUNDATION_DATETIMETYPE_H
