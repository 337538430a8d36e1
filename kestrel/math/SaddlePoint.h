// The parts of binomial, Poisson, gamma and beta terms that would cancel when written with factorials and
// powers.

#ifndef KESTREL_MATH_SADDLEPOINT_H
#define KESTREL_MATH_SADDLEPOINT_H

namespace MCMath_800 {

/// u - ln(1 + u) for u > -1, to a few units in the last place: what a power loses on its way from the mean.
/// Infinite at u = -1.
double LogDeviance(double u);

/// ln Gamma(a) - ((a - 1/2) ln a - a + ln(2 pi) / 2), the error of Stirling's formula, for a > 0.
double StirlingError(double a);

/// A product without rounding: high + low is a * b. Right while a * b and its last digit are normal numbers.
struct ExactProduct {
  double high;
  double low;
};
ExactProduct MultiplyExactly(double a, double b);

}  // namespace MCMath_800

#endif  // KESTREL_MATH_SADDLEPOINT_H
