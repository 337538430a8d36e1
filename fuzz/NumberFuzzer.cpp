// Bytes as numbers, dates and times, held against the standard library's streams.

#include <algorithm>
#include <clocale>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <locale>
#include <sstream>
#include <string>

#include "fuzz/Check.h"
#include "kestrel/foundation/Calendar.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"

namespace {

using namespace MCKestrel_800;
using kestrel_fuzz::Check;

bool SameBits(double a, double b) {
  return std::memcmp(&a, &b, sizeof a) == 0;
}

/// What a stream reads; where it fails, infinity if C's function reads that, else the missing value.
double NumberOfStream(const std::string& text) {
  std::istringstream in(text);
  in.imbue(std::locale::classic());
  double number = 0.0;
  if (in >> number) return number;
  return std::strtod(text.c_str(), nullptr) == std::numeric_limits<double>::infinity()
             ? NumericValue::gInfinity
             : NumericValue::gSysmisValue;
}

/// Days from 1970-01-01, by counting eras of 400 years that begin in March.
long long DaysOf(long long year, long long month, long long day) {
  if (month <= 2) --year;
  const long long era = (year >= 0 ? year : year - 399) / 400;
  const long long yearOfEra = year - 400 * era;
  const long long dayOfYear = (153 * (month + (month > 2 ? -3 : 9)) + 2) / 5 + day - 1;
  return 146097 * era + 365 * yearOfEra + yearOfEra / 4 - yearOfEra / 100 + dayOfYear - 719468;
}

bool ReadThree(const std::string& text, char separator, long long (&numbers)[3]) {
  std::istringstream in(text);
  in.imbue(std::locale::classic());
  char first = 0, second = 0;
  return in >> numbers[0] >> first >> numbers[1] >> second >> numbers[2] && first == separator &&
         second == separator && in.peek() == std::istringstream::traits_type::eof();
}

/// Seconds of a text by a stream; the missing value when it is none.
double SecondsOfStream(const std::string& date, const std::string& time) {
  double seconds = 0.0;
  long long numbers[3];
  if (!date.empty()) {
    if (!ReadThree(date, '-', numbers)) return NumericValue::gSysmisValue;
    numbers[0] = std::min<long long>(numbers[0], Calendar::kFarthest);
    if (!DateTimeValue::IsValidDate(numbers[0], numbers[1], numbers[2])) return NumericValue::gSysmisValue;
    seconds += static_cast<double>(DaysOf(numbers[0], numbers[1], numbers[2])) * 86400.0;
  }
  if (!time.empty()) {
    if (!ReadThree(time, ':', numbers)) return NumericValue::gSysmisValue;
    if (numbers[0] > 23 || numbers[1] > 59 || numbers[2] > 59) return NumericValue::gSysmisValue;
    seconds += static_cast<double>(3600 * numbers[0] + 60 * numbers[1] + numbers[2]);
  }
  return seconds;
}

void CheckNumbers(const std::string& text) {
  const double number = NumberOfStream(text);
  const NumericValue value(text);
  Check(SameBits(value.GetDouble(), number), "a number is what a stream reads");
  for (int type = kDateDaysSince0; type <= kDateTimeSecondsSince1980; ++type) {
    const DateTimeType dateType = static_cast<DateTimeType>(type);
    DateTimeValue ofText(text, dateType), ofNumber(number, dateType);
    Check(SameBits(ofText.GetDouble(), ofNumber.GetDouble()), "a number of days is what a stream reads");
    Check(!ofText.GetString().empty(), "a value has a text");
  }
}

/// Dates of the usual digits; the rest is for the sanitizers.
void CheckDates(const std::string& text) {
  for (const DateTimeType type : {DateTimeType::kDate, kTime, DateTimeType::kDateTime}) {
    const DateTimeValue value(text, type);
    const DateTimeValue again(value.GetString(), type);
    Check(text.empty() || value.IsSystemMissingValue() != DateTimeValue::IsValidDateTime(text, type),
          "what parses has a value");
    // Beyond that a double does not hold single seconds.
    if (value.GetDouble() < 9e15)
      Check(SameBits(again.GetDouble(), value.GetDouble()), "a date's text reads back");
  }
  std::string plain;
  for (const char c : text) {
    if (c != ' ') plain += c;
  }
  if (plain.empty() || plain.size() > 25 || plain.find_first_not_of("0123456789-:T") != std::string::npos)
    return;
  // A stream takes signs, which no part of a date has.
  if (plain.find("--") != std::string::npos || plain[0] == '-' || plain.find(":-") != std::string::npos)
    return;
  // Nor does a stream cut a year that its integer does not hold.
  if (plain.find_first_not_of("0123456789") > 18) return;
  const size_t split = plain.find('T');
  if (split == std::string::npos) {
    Check(DateTimeValue(text, DateTimeType::kDate).GetDouble() == SecondsOfStream(plain, ""), "a date");
    Check(DateTimeValue(text, kTime).GetDouble() == SecondsOfStream("", plain), "a time");
  } else if (split > 0 && split + 1 < plain.size() && plain[split + 1] != '-') {
    const double seconds = SecondsOfStream(plain.substr(0, split), plain.substr(split + 1));
    Check(DateTimeValue(text, DateTimeType::kDateTime).GetDouble() == seconds, "a date with a time");
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  std::setlocale(LC_ALL, "C");
  const std::string text(reinterpret_cast<const char*>(data), size);
  CheckNumbers(text);
  CheckDates(text);
  return 0;
}
