// Inverting a distribution whose density is log-concave in the search variable, as gamma's is in ln x and
// beta's in ln(x / (1 - x)). Then the logarithms of both tails are concave, and Newton's method on the
// smaller one is safe from any start; Halley's correction makes it cubic.

#ifndef KESTREL_MATH_QUANTILESEARCH_H
#define KESTREL_MATH_QUANTILESEARCH_H

#include <algorithm>
#include <cmath>

namespace MCMath_800 {

/// Steps of a search at most. Searches end after two to six; the limit is for arguments at the edge of the
/// format.
constexpr int kSearchLimit = 200;

/// What is left after a step of this size is its cube.
constexpr double kLastStep = 1e-6;

/// How far to go in the search variable so that ratio becomes target.
/// ratio  the share below the point, or above it (upper); power  the density there; slope  (ln density)'
/// there.
inline double FindStep(double ratio, double target, double power, double slope, bool upper) {
  const double rate = power / ratio;
  const double newton = std::log(ratio / target) / (upper ? -rate : rate);
  const double curvature = upper ? slope + rate : slope - rate;
  return -newton / std::clamp(1.0 - 0.5 * newton * curvature, 0.5, 2.0);
}

}  // namespace MCMath_800

#endif  // KESTREL_MATH_QUANTILESEARCH_H
