// The built-in functions by family, in the form in which they are computed case by case: no allocation, but
// for texts that are longer than all before them.

#ifndef KESTREL_TRANSFORM_FUNCTIONEVALUATION_H
#define KESTREL_TRANSFORM_FUNCTIONEVALUATION_H

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <string>
#include <vector>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/transform/TransformFunction.h"

namespace MCKestrel_800 {

// Numbers are finite or the system-missing value; so is every result, whatever the arguments. What is too
// large for a number, or no number, is missing.

inline bool IsMissingNumber(double x) {
  return NumericValue::IsSystemMissingValue(x);
}
inline double NumberOrMissing(double x) {
  return std::fabs(x) <= std::numeric_limits<double>::max() ? x : NumericValue::gSysmisValue;
}

// The missing value is the lowest number: when one of two is missing, the smaller one is. What else compares
// that way is minus infinity or no number at all, and its results are missing, too.
inline bool IsEitherMissing(double x, double y) {
  return (x < y ? x : y) <= NumericValue::gSysmisValue;
}

inline double PlusNumbers(double x, double y) {
  return IsEitherMissing(x, y) ? NumericValue::gSysmisValue : NumberOrMissing(x + y);
}
inline double MinusNumbers(double x, double y) {
  return IsEitherMissing(x, y) ? NumericValue::gSysmisValue : NumberOrMissing(x - y);
}
inline double MultiplyNumbers(double x, double y) {
  return IsEitherMissing(x, y) ? NumericValue::gSysmisValue : NumberOrMissing(x * y);
}
inline double DivideNumbers(double x, double y) {
  return y == 0.0 || IsEitherMissing(x, y) ? NumericValue::gSysmisValue : NumberOrMissing(x / y);
}

/// The functions of the scalar family; y counts for those of two arguments. 0 for every other code.
double ApplyTransFunction(double x, double y, TransformFunction function);

/// The functions of the list family, "not" and the comparisons of numbers included. A number of arguments
/// that the function does not take gives the missing value, or 0 where the result is 1 or 0. The missing
/// value for every other code. scratch  what the median sorts in; its content is not looked at, its memory is
/// kept for the next case.
double ApplyAccumulateFunction(const double* arguments, std::size_t count, TransformFunction function,
                               std::vector<double>& scratch);
/// The same; the median allocates.
double ApplyAccumulateFunction(const double* arguments, std::size_t count, TransformFunction function);

/// The functions of the date/time family. `seconds` are those of a DateTimeValue, `subtracted` is 0 for the
/// functions of one argument. Missing when either is, and for every other code.
double ApplyDateTimeFunction(double seconds, double subtracted, TransformFunction function);

/// Whether "if" takes its second argument: x is 1, within the tolerance of numbers.
inline bool IsTrueCondition(double x) {
  return NumericValue::IsEqual(x, 1.0);
}

/// `method` is one of ScoreDictVar::OutlierHandleMethod. Missing when one of the numbers is.
double HandleOutlier(double x, int method, double c, double a, double b, double n);

/// The first i with the smallest |t - means[i]| / sqrt(variances[i]); a distance that is no number is none.
/// count  of both lists, at least 1
std::size_t NearestMean(double t, const double* means, const double* variances, std::size_t count);

// ---- Texts. What is written to must not be what is read from; its memory is used again.

/// The declared length of a text, or its size when nobody declared one: texts that a case record's slot was
/// filled with come without.
int32_t LengthOf(const StringValue& value);
/// The sum, clamped to what fits.
int32_t AddLengths(int32_t a, int32_t b);

/// The functions of one text: lower, lowercase, uppercase, ltrim, rtrim. An empty text for every other code.
void ApplyTextFunction(const StringValue& value, TransformFunction function, std::string& text,
                       int32_t& length);
/// "substr". The length becomes the start when there is something to return, and stays the text's when not.
void ApplySubstring(const StringValue& value, double start, std::string& text, int32_t& length);
/// "concat", argument by argument, from an empty text and a length of 0.
void AppendText(const StringValue& value, std::string& text, int32_t& length);

// ---- Values of any kind.

/// "equal": of the same kind, and the first says that it equals the second.
bool AreEqualValues(const ScoreValue& first, const ScoreValue& second);
/// "isIn": the value says that it equals one of those; null ones equal nothing.
bool IsAmong(const ScoreValue& value, const std::vector<const ScoreValue*>& values);

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_FUNCTIONEVALUATION_H
