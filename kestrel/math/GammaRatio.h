// The incomplete gamma function, and the power term in front of its series.

#ifndef KESTREL_MATH_GAMMARATIO_H
#define KESTREL_MATH_GAMMARATIO_H

namespace MCMath_800 {

// All for finite x > 0 and a > 0.

/// x^a e^-x / Gamma(a), the gamma density times x; a Poisson probability is this over a. 0 when it is too
/// small.
double GammaPower(double x, double a);
/// The same where x is known with more digits than x has: deviation = x - a.
double GammaPower(double x, double deviation, double a);

/// P(a, x), the share of the gamma distribution below x, or the share above it.
double GammaRatio(double x, double a, bool upper);
double GammaRatio(double x, double deviation, double a, bool upper);

}  // namespace MCMath_800

#endif  // KESTREL_MATH_GAMMARATIO_H
