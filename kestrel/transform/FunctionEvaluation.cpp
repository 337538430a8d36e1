#include "kestrel/transform/FunctionEvaluation.h"

#include <algorithm>
#include <limits>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/math/Logarithm.h"
#include "kestrel/math/MCDistFun.h"

namespace MCKestrel_800 {

namespace {

using MCMath_800::MCDistFun;

constexpr double kMissing = NumericValue::gSysmisValue;

// ---- One or two numbers.

/// Whether x can be cut to a 32-bit integer by "round", "trunc" and "mod". False for no number.
bool IsWithinInt32(double x) {
  return x > -2147483648.0 && x < 2147483647.0;
}

/// Toward 0. Through an integer, so that no negative zero remains.
double Truncate(double x) {
  return static_cast<double>(static_cast<int32_t>(x));
}

/// To the integer part of the exponent, by repeated squaring.
double Power(double base, double exponent) {
  const double whole = std::trunc(exponent);
  if (IsMissingNumber(base) || IsMissingNumber(whole) || std::isnan(base) || std::isnan(whole)) {
    return kMissing;
  }
  // From 2^53 on all doubles are even, and no base but 1 and -1 keeps a number in sight beyond 2^63.
  constexpr double kLargest = 9223372036854775808.0;
  double power = 1.0;
  for (auto rest = static_cast<uint64_t>(std::min(std::fabs(whole), kLargest)); rest > 0; rest >>= 1) {
    if ((rest & 1) != 0) power *= base;
    base *= base;
  }
  return NumberOrMissing(whole < 0.0 ? 1.0 / power : power);
}

double Exponential(double x) {
  if (IsMissingNumber(x) || std::isnan(x) || x > 709.0) return kMissing;
  return x > -708.0 ? std::exp(x) : 0.0;
}

double Modulo(double x, double y) {
  if (y == 0.0 || IsMissingNumber(y) || IsMissingNumber(x)) return kMissing;
  const double quotient = x / y;
  return IsWithinInt32(quotient) ? NumberOrMissing(x - Truncate(quotient) * y) : kMissing;
}

double Round(double x) {
  if (!IsWithinInt32(x)) return kMissing;
  const double whole = Truncate(x);
  if (std::fabs(x) - std::fabs(whole) < 0.5) return whole;
  return x > 0.0 ? whole + 1.0 : whole - 1.0;
}

// ---- Lists. The missing value makes room for "none so far" wherever arguments are skipped.

struct List {
  const double* first;
  std::size_t count;

  const double* begin() const { return first; }
  const double* end() const { return first + count; }
  bool HasMissing() const { return std::any_of(begin(), end(), IsMissingNumber); }
};

template <class Combine>
double Fold(const List& list, const Combine& combine) {
  bool is_empty = true;
  double result = kMissing;
  for (const double x : list) {
    if (IsMissingNumber(x)) continue;
    result = is_empty ? x : combine(result, x);
    is_empty = false;
  }
  return NumberOrMissing(result);
}

double Sum(const List& list) {
  return Fold(list, [](double sum, double x) { return sum + x; });
}

double Product(const List& list) {
  return Fold(list, [](double product, double x) { return product * x; });
}

// What is no number stays, since no comparison with it holds.
double Smallest(const List& list) {
  return Fold(list, [](double least, double x) { return least < x || std::isnan(least) ? least : x; });
}

double Largest(const List& list) {
  return Fold(list, [](double most, double x) { return most > x || std::isnan(most) ? most : x; });
}

double Mean(const List& list) {
  const auto count =
      static_cast<double>(list.count) - static_cast<double>(std::count(list.begin(), list.end(), kMissing));
  if (count == 0.0) return kMissing;
  const double sum = Sum(list);
  if (!IsMissingNumber(sum)) return sum / count;
  // The sum is too large, the mean need not be.
  double mean = 0.0;
  for (const double x : list) {
    if (!IsMissingNumber(x)) mean += x / count;
  }
  return NumberOrMissing(mean);
}

/// The sum of squares in units of the largest one, so that none overflows.
double StandardDeviation(const List& list) {
  const double mean = Mean(list);
  if (IsMissingNumber(mean)) return kMissing;
  double scale = 0.0, sum = 1.0, count = 0.0;
  for (const double x : list) {
    if (IsMissingNumber(x)) continue;
    count += 1.0;
    const double d = std::fabs(x - mean);
    if (d == 0.0) continue;
    if (d > scale) {
      const double ratio = scale / d;
      sum = 1.0 + sum * (ratio * ratio);
      scale = d;
    } else {
      const double ratio = d / scale;
      sum += ratio * ratio;
    }
  }
  return count <= 1.0 ? kMissing : NumberOrMissing(scale * std::sqrt(sum / (count - 1.0)));
}

double Median(const List& list, std::vector<double>& scratch) {
  scratch.clear();
  for (const double x : list) {
    // Nothing can be sorted around what is no number.
    if (std::isnan(x)) return kMissing;
    if (!IsMissingNumber(x)) scratch.push_back(x);
  }
  if (scratch.empty()) return kMissing;
  const auto middle = scratch.begin() + static_cast<std::ptrdiff_t>(scratch.size() / 2);
  std::nth_element(scratch.begin(), middle, scratch.end());
  if (scratch.size() % 2 == 1) return NumberOrMissing(*middle);
  const double low = *std::max_element(scratch.begin(), middle);
  const double sum = low + *middle;
  return std::isfinite(sum) ? sum / 2.0 : NumberOrMissing(low / 2.0 + *middle / 2.0);
}

double NormalDensity(double x, double mean, double sd) {
  if (!(sd > 0.0)) return kMissing;
  const double z = (x - mean) / sd;
  const double density = std::fabs(z) > 37.61 ? 0.0 : std::exp(-0.5 * z * z) / std::sqrt(6.283185307179586);
  return NumberOrMissing(density / sd);
}

double ApplyNormal(const List& list, TransformFunction function) {
  if (list.count != 3 || list.HasMissing()) return kMissing;
  const double x = list.first[0], mean = list.first[1], sd = list.first[2];
  if (function == kCdfNormalFunction) return MCDistFun::CdfNorm(x, mean, sd);
  if (function == kIdfNormalFunction) return MCDistFun::IdfNorm(x, mean, sd);
  return NormalDensity(x, mean, sd);
}

double ApplyArithmetic(const List& list, TransformFunction function) {
  if (list.count != 2) return kMissing;
  const double x = list.first[0], y = list.first[1];
  if (function == kMinusFunction) return MinusNumbers(x, y);
  if (function == kMultiplyFunction) return MultiplyNumbers(x, y);
  return DivideNumbers(x, y);
}

bool Compare(const List& list, TransformFunction function) {
  if (list.count != 2) return false;
  const double x = list.first[0], y = list.first[1];
  switch (function) {
    case kLessThanFunction:
      return x < y;
    case kLessOrEqualFunction:
      return x <= y;
    case kGreaterThanFunction:
      return x > y;
    default:
      return x >= y;
  }
}

bool IsTruth(double x) {
  return x != 0.0;
}

// ---- Texts.

bool IsBlank(char c) {
  return c == ' ' || c == '\t';
}
// Of ASCII letters alone: what others are depends on the locale, and single bytes of UTF-8 are none.
char ToLower(char c) {
  return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}
char ToUpper(char c) {
  return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c;
}

/// Takes over a trimmed text; the length loses what the text has lost.
void TakeTrimmed(const StringValue& value, const char* begin, const char* end, std::string& text,
                 int32_t& length) {
  text.assign(begin, end);
  const auto removed = static_cast<int32_t>(value.GetText().size() - text.size());
  length = std::max(LengthOf(value), int32_t{0}) - removed;
}

}  // namespace

double ApplyTransFunction(double x, double y, TransformFunction function) {
  switch (function) {
    case kPlusFunction:
      return PlusNumbers(x, y);
    case kPowFunction:
      return Power(x, y);
    case kAbsFunction:
      return IsMissingNumber(x) ? kMissing : NumberOrMissing(std::fabs(x));
    case kExpFunction:
      return Exponential(x);
    case kLog10Function:
      return x > 0.0 ? NumberOrMissing(MCMath_800::DecimalLogarithm(x)) : kMissing;
    case kLnFunction:
      return x > 0.0 ? NumberOrMissing(std::log(x)) : kMissing;
    case kModFunction:
      return Modulo(x, y);
    case kRoundFunction:
      return Round(x);
    case kSqrtFunction:
      return x >= 0.0 ? NumberOrMissing(std::sqrt(x)) : kMissing;
    case kTruncFunction:
      return IsWithinInt32(x) ? Truncate(x) : kMissing;
    case kCdfNormFunction:
      return IsMissingNumber(x) ? kMissing : MCDistFun::CdfStdNorm(x);
    case kThresholdFunction:
      return x > y ? 1.0 : 0.0;
    case kFloorFunction:
      return NumberOrMissing(std::floor(x));
    case kCeilFunction:
      return NumberOrMissing(std::ceil(x));
    default:
      return 0.0;
  }
}

double ApplyAccumulateFunction(const double* arguments, std::size_t count, TransformFunction function,
                               std::vector<double>& scratch) {
  const List list = {arguments, count};
  switch (function) {
    case kMinusFunction:
    case kMultiplyFunction:
    case kDivideFunction:
      return ApplyArithmetic(list, function);
    case kCdfNormalFunction:
    case kIdfNormalFunction:
    case kPdfNormalFunction:
      return ApplyNormal(list, function);
    case kMaxFunction:
      return Largest(list);
    case kMeanFunction:
      return Mean(list);
    case kMinFunction:
      return Smallest(list);
    case kSdFunction:
      return StandardDeviation(list);
    case kSumFunction:
      return Sum(list);
    case kVarianceFunction: {
      const double sd = StandardDeviation(list);
      return MultiplyNumbers(sd, sd);
    }
    case kLessThanFunction:
    case kLessOrEqualFunction:
    case kGreaterThanFunction:
    case kGreaterOrEqualFunction:
      return Compare(list, function) ? 1.0 : 0.0;
    case kAndFunction:
      return count > 0 && std::all_of(list.begin(), list.end(), IsTruth) ? 1.0 : 0.0;
    case kOrFunction:
      return std::any_of(list.begin(), list.end(), IsTruth) ? 1.0 : 0.0;
    case kNotFunction:
      return count == 1 && arguments[0] == 0.0 ? 1.0 : 0.0;
    case kMedianFunction:
      return Median(list, scratch);
    case kProductFunction:
      return Product(list);
    default:
      return kMissing;
  }
}

double ApplyAccumulateFunction(const double* arguments, std::size_t count, TransformFunction function) {
  std::vector<double> scratch;
  return ApplyAccumulateFunction(arguments, count, function, scratch);
}

double ApplyDateTimeFunction(double seconds, double subtracted, TransformFunction function) {
  constexpr double kSecondsPerDay = 86400.0;
  if (IsMissingNumber(seconds) || IsMissingNumber(subtracted)) return kMissing;
  const DateTimeValue moment(seconds, kDateTimeVal);
  const double difference = seconds - subtracted;
  switch (function) {
    case kDateYearsDifferenceFunction:
      return NumberOrMissing(difference / kSecondsPerDay / 365.25);
    case kDateMonthsDifferenceFunction:
      return NumberOrMissing(difference / kSecondsPerDay / 30.4375);
    case kDateDaysDifferenceFunction:
      return NumberOrMissing(difference / kSecondsPerDay);
    case kYearFromDateFunction:
      return moment.ExtractYear();
    case kMonthFromDateFunction:
      return moment.ExtractMonth();
    case kDayFromDateFunction:
      return moment.ExtractDay();
    case kTimeHoursDifferenceFunction:
      return NumberOrMissing(difference / 3600.0);
    case kTimeMinutesDifferenceFunction:
      return NumberOrMissing(difference / 60.0);
    case kTimeSecondsDifferenceFunction:
      return NumberOrMissing(difference);
    case kHourFromTimeFunction:
      return moment.ExtractHour();
    case kMinuteFromTimeFunction:
      return moment.ExtractMinute();
    case kSecondFromTimeFunction:
      return moment.ExtractSecond();
    default:
      return kMissing;
  }
}

double HandleOutlier(double x, int method, double c, double a, double b, double n) {
  for (const double argument : {x, c, a, b, n}) {
    if (IsMissingNumber(argument)) return kMissing;
  }
  const double width = a * b / std::sqrt(n);
  const double lower = c - width;
  const double upper = c + width;
  if (x < lower) return method == ScoreDictVar::kAsExtremeValues ? NumberOrMissing(lower) : kMissing;
  if (x > upper) return method == ScoreDictVar::kAsExtremeValues ? NumberOrMissing(upper) : kMissing;
  return NumberOrMissing(x);
}

std::size_t NearestMean(double t, const double* means, const double* variances, std::size_t count) {
  std::size_t nearest = 0;
  double least = std::numeric_limits<double>::quiet_NaN();
  for (std::size_t i = 0; i < count; ++i) {
    const double distance = std::fabs(t - means[i]) / std::sqrt(variances[i]);
    if (distance < least || (std::isnan(least) && !std::isnan(distance))) {
      nearest = i;
      least = distance;
    }
  }
  return nearest;
}

int32_t LengthOf(const StringValue& value) {
  if (value.GetLength() != 0) return value.GetLength();
  constexpr std::size_t kLongest = std::numeric_limits<int32_t>::max();
  return static_cast<int32_t>(std::min(value.GetText().size(), kLongest));
}

int32_t AddLengths(int32_t a, int32_t b) {
  const int64_t sum = int64_t{a} + b;
  return static_cast<int32_t>(
      std::clamp<int64_t>(sum, std::numeric_limits<int32_t>::min(), std::numeric_limits<int32_t>::max()));
}

void ApplyTextFunction(const StringValue& value, TransformFunction function, std::string& text,
                       int32_t& length) {
  const std::string& source = value.GetText();
  const char* begin = source.data();
  const char* end = begin + source.size();
  switch (function) {
    case kLowerFunction:
    case kLowercaseFunction:
      text.resize(source.size());
      std::transform(begin, end, text.begin(), ToLower);
      length = LengthOf(value);
      return;
    case kUppercaseFunction:
      text.resize(source.size());
      std::transform(begin, end, text.begin(), ToUpper);
      length = LengthOf(value);
      return;
    case kLtrimFunction:
      TakeTrimmed(value, std::find_if_not(begin, end, IsBlank), end, text, length);
      return;
    case kRtrimFunction:
      while (end != begin && IsBlank(end[-1]))
        --end;
      TakeTrimmed(value, begin, end, text, length);
      return;
    default:
      text.clear();
      length = 0;
  }
}

void ApplySubstring(const StringValue& value, double start, std::string& text, int32_t& length) {
  const std::string& source = value.GetText();
  const double position = std::trunc(start);
  length = std::max(LengthOf(value), int32_t{0});
  text.clear();
  if (source.empty()) {
    length = 0;
  } else if (position >= 1.0 && position < static_cast<double>(source.size())) {
    text.assign(source, static_cast<std::size_t>(position) - 1);
    length = static_cast<int32_t>(position);
  }
}

void AppendText(const StringValue& value, std::string& text, int32_t& length) {
  text += value.GetText();
  length = AddLengths(length, LengthOf(value));
}

bool AreEqualValues(const ScoreValue& first, const ScoreValue& second) {
  return first.GetType() == second.GetType() && first == second;
}

bool IsAmong(const ScoreValue& value, const std::vector<const ScoreValue*>& values) {
  return std::any_of(values.begin(), values.end(), [&value](const ScoreValue* candidate) {
    return candidate != nullptr && value == *candidate;
  });
}

}  // namespace MCKestrel_800
