#include "kestrel/math/SaddlePoint.h"

#include <cmath>

#include "kestrel/math/GammaCoefficients.h"
#include "kestrel/math/Polynomial.h"

namespace MCMath_800 {

double LogDeviance(double u) {
  // ln(1 + u) = 2 atanh(r), and u - 2 r = r u. Between these limits |r| is at most 1/3.
  if (u >= -0.5 && u <= 1.0) {
    const double r = u / (2.0 + u);
    const double s = r * r;
    return r * (u - 2.0 * s * Polynomial(kLogSeries, s));
  }
  return u - std::log1p(u);
}

// The name and the use of this function are C. Loader's, "Fast and accurate computation of binomial
// probabilities" (2000). Large a take Stirling's series, small ones a shift by one.
double StirlingError(double a) {
  if (a >= 10.0) {
    const double v = 1.0 / a;
    return v * Polynomial(kStirlingSeries, v * v);
  }
  if (a >= 3.0) {
    const double v = 1.0 / a;
    return v / 12.0 * (Polynomial(kStirlingFar, v) / Polynomial(kStirlingFarDivisor, v));
  }
  if (a >= 1.0) {
    const double v = 1.0 / a;
    return v / 12.0 * (Polynomial(kStirlingNear, v) / Polynomial(kStirlingNearDivisor, v));
  }
  return StirlingError(a + 1.0) + (a + 0.5) * (std::log1p(a) - std::log(a)) - 1.0;
}

ExactProduct MultiplyExactly(double a, double b) {
  const double high = a * b;
  return {high, std::fma(a, b, -high)};
}

}  // namespace MCMath_800
