// The incomplete gamma function, and the power term in front of its series.

#ifndef KESTREL_MATH_GAMMARATIO_H
#define KESTREL_MATH_GAMMARATIO_H

#include "kestrel/math/DoubleDouble.h"

namespace MCMath_800 {

// All for finite x > 0 and a > 0.

/// 1 / Gamma(1 + a) for 0 <= a <= 1.
double ReciprocalGamma1(double a);
/// ln Gamma(a); infinite when it is too large.
double LogGamma(double a);

/// x^a e^-x / Gamma(a), the gamma density times x; a Poisson probability is this over a. 0 when it is too
/// small.
double GammaPower(DoubleDouble x, double a);

/// P(a, x), the share of the gamma distribution below x, or the share above it, with the power term beside
/// it.
struct GammaShare {
  double ratio;
  double power;
};
GammaShare FindGammaShare(DoubleDouble x, double a, bool upper);

/// The share above x for a <= 1, where parts too small for a result of their own count.
GammaShare FindSmallShare(DoubleDouble x, double a);

double GammaRatio(DoubleDouble x, double a, bool upper);

}  // namespace MCMath_800

#endif  // KESTREL_MATH_GAMMARATIO_H
