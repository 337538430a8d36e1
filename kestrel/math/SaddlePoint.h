// The parts of binomial, Poisson, gamma and beta terms that would cancel when written with factorials and
// powers.

#ifndef KESTREL_MATH_SADDLEPOINT_H
#define KESTREL_MATH_SADDLEPOINT_H

#include "kestrel/math/DoubleDouble.h"

namespace MCMath_800 {

// A probability of 1e-300 has an exponent near 700, whose last digit as a double is the probability's
// thirteenth. The logarithms below therefore have two doubles, right to 2^-64 of the result and better.

/// ln z for z > 0; to 2^-78 where the result is smaller than 1. Minus infinity at 0.
DoubleDouble Log(DoubleDouble z);
/// ln(1 + u) for u > -1.
DoubleDouble LogOfOnePlus(DoubleDouble u);
/// u - ln(1 + u) for u > -1: what a power loses on its way from the mean.
DoubleDouble LogDeviance(HeadAndTail u);
/// The same to a few units in the last place of a double. Infinite at u = -1.
double LogDeviance(double u);

/// From here to -1 a distance over the count, though right to 2^-79, has too few digits of the mean.
constexpr double kFarBelow = -0.99;

/// count ln(count / mean) + mean - count for count >= 1, where distance = mean - count is known better than
/// the subtraction gives it. mean  a function that gives it; it is seldom needed.
template <class Mean>
DoubleDouble Deviance(const Mean& mean, DoubleDouble distance, double count) {
  const HeadAndTail n = Split(count);
  const double inverse = 1.0 / count;
  const double head = HeadOf(distance.high * inverse);
  const double tail = ((distance.high - head * n.head) - head * n.tail + distance.low) * inverse;
  if (head < kFarBelow) return distance - Log(mean() / count) * count;
  const HeadAndTail deviance = Split(LogDeviance({head, tail}));
  return AddOrdered(deviance.head * n.head, deviance.head * n.tail + deviance.tail * count);
}
template <class Mean>
DoubleDouble Deviance(const Mean& mean, DoubleDouble distance, DoubleDouble count) {
  const DoubleDouble u = distance / count;
  if (u.high < kFarBelow) return distance - Log(mean() / count) * count;
  return LogDeviance(Split(u)) * count;
}

/// exp(-x); 0 when x is past the exponential's limit, or no number.
double GuardedExpMinus(DoubleDouble x);
/// The same down to the smallest numbers that there are: what is added to something larger may be one.
double ExpMinus(DoubleDouble x);

/// ln Gamma(a) - ((a - 1/2) ln a - a + ln(2 pi) / 2), the error of Stirling's formula, for a > 0.
double StirlingError(double a);
/// The same for a whole number, or for any from 16 on; 0 at 0. Random counts mislead it less.
double StirlingErrorOfCount(double m);

}  // namespace MCMath_800

#endif  // KESTREL_MATH_SADDLEPOINT_H
