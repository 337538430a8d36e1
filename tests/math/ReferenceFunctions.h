// Which function is judged by which column of the reference tables: one list for tests and the accuracy
// report.

#ifndef KESTREL_TESTS_MATH_REFERENCEFUNCTIONS_H
#define KESTREL_TESTS_MATH_REFERENCEFUNCTIONS_H

#include <string>
#include <vector>

namespace kestrel_tests {

/// The largest relative errors that are allowed.
struct AccuracyGoal {
  /// Where the result is `kBodyFrom` or more; an inverse has this one for all results.
  double body;
  double tail;
};

/// Probabilities below this are a tail.
constexpr double kBodyFrom = 1e-5;

/// The way back from an inverse's result.
struct WayBack {
  /// Which argument of the inverse is the probability.
  int place;
  /// The probability of a result; null for what is no inverse.
  double (*call)(const double* arguments, double result);
};

/// What a round trip may differ by beyond the rounding of the inverse's result.
constexpr double kTurnedBack = 1e-12;

struct ReferenceFunction {
  /// As reports print it, with arguments.
  const char* name;
  /// The table in tests/data/math/, without ".csv".
  const char* table;
  /// The columns that `call` takes, separated by spaces, and the one that it is judged by.
  const char* arguments;
  const char* result;
  double (*call)(const double* arguments);
  AccuracyGoal goal;
  WayBack back = {0, nullptr};
};

struct ReferencePoint {
  double arguments[5];
  /// Of 25 digits in the table; as many as a long double holds here, 19 on Linux.
  long double value;
};

const std::vector<ReferenceFunction>& ReferenceFunctions();

/// Every `step`th row of the function's table, those left out that have no value in its column or no first
/// argument.
std::vector<ReferencePoint> ReadReferencePoints(const ReferenceFunction& function, size_t step);

/// |value - point.value| / |point.value|; an infinity for a NaN. A right value of 0 has to be met exactly.
double RelativeError(double value, const ReferencePoint& point);

/// How many times the relative error of an inverse's p is found in its result; 0 for functions without a way
/// back.
double Condition(const ReferenceFunction& function, const ReferencePoint& point);

/// How far the probability of an inverse's result is from the one asked for.
struct RoundTrip {
  /// Relative to p.
  double difference;
  /// What half a unit in the result's last place makes of it: no double comes closer for sure.
  double rounding;
};

/// For functions with a way back.
RoundTrip TurnBack(const ReferenceFunction& function, const double* arguments);

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_MATH_REFERENCEFUNCTIONS_H
