// Inverting a distribution whose density is log-concave in the logarithm of x, as gamma's is, or beta's in
// that of the odds x / (1 - x). Then the logarithms of both tails are concave, and Newton's method on the
// smaller tail is safe from any start; Halley's correction makes it cubic.

#ifndef KESTREL_MATH_QUANTILESEARCH_H
#define KESTREL_MATH_QUANTILESEARCH_H

#include <cmath>
#include <limits>

#include "kestrel/math/DoubleDouble.h"

namespace MCMath_800 {

/// A distribution at a point x.
struct QuantilePoint {
  double ratio;  ///< The share below x, or above it.
  double power;  ///< The density in ln x.
  double slope;  ///< The derivative of ln power in ln x.
};

/// The x > 0 whose share is target, 0 < target <= 1/2.
/// start  where to begin; taken as it is outside 1e-290 to 1e290, where the leading power is all there is to
/// x. reach  the inverse of the distribution's width in ln x, at least 1. evaluate  gives the QuantilePoint
/// of an x. At most 200 steps, at the edge of the format; elsewhere two to six. What the last step adds comes
/// beside x, so that what is made of it is rounded once.
template <class Evaluate>
DoubleDouble SearchLongQuantile(double start, double target, double reach, bool upper,
                                const Evaluate& evaluate) {
  constexpr int kStepLimit = 200;
  constexpr double kInfinity = std::numeric_limits<double>::infinity();
  // What is left after a step of this size is its cube.
  constexpr double kLastStep = 1e-6;
  double low = 0.0;
  double high = kInfinity;
  double x = start;
  for (int i = 0; i < kStepLimit && x > 1e-290 && x < 1e290; ++i) {
    const QuantilePoint point = evaluate(x);
    if (point.ratio == target) break;
    ((point.ratio < target) == upper ? high : low) = x;
    const double rate = point.power / point.ratio;
    const double newton = std::log(point.ratio / target) / (upper ? -rate : rate);
    const double curvature = upper ? point.slope + rate : point.slope - rate;
    const double correction = 1.0 - 0.5 * newton * curvature;
    const double step = -newton / (correction < 0.5 ? 0.5 : correction > 2.0 ? 2.0 : correction);
    double next = x * std::exp(step);
    if (std::fabs(step) * reach < kLastStep) return AddOrdered(x, x * std::expm1(step));
    // Also when a tail was too small to step by.
    if (!(next > low && next < high)) {
      next = high == kInfinity ? 16.0 * x : low == 0.0 ? x / 16.0 : std::sqrt(low) * std::sqrt(high);
    }
    if (next == x || next == low || next == high) break;
    x = next;
  }
  return x;
}

/// The same, rounded.
template <class Evaluate>
double SearchQuantile(double start, double target, double reach, bool upper, const Evaluate& evaluate) {
  return SearchLongQuantile(start, target, reach, upper, evaluate).high;
}

}  // namespace MCMath_800

#endif  // KESTREL_MATH_QUANTILESEARCH_H
