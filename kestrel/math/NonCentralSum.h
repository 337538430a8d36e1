// Sums of gamma and beta distribution functions with Poisson weights: what non-central distributions are.

#ifndef KESTREL_MATH_NONCENTRALSUM_H
#define KESTREL_MATH_NONCENTRALSUM_H

#include "kestrel/math/DoubleDouble.h"

namespace MCMath_800 {

/// The largest Poisson mean that the sums are meant for.
constexpr double kLargestPoissonMean = 5e8;
/// A smaller one is as good as 0.
constexpr double kSmallestPoissonMean = 1e-290;

/// A sum and what its change with lambda is made of.
struct MixtureShare {
  double share;
  /// What the share loses, or its complement gains, per lambda.
  double drop;
  /// The same, each distribution function taken one later: the drop itself grows by next - drop per lambda.
  double next;
};

/// How close a result has to be.
enum class SumCare {
  kFull,  ///< To the last digits.
  kRough  ///< To five digits or so, in about half the time.
};

// All for finite a, b > 0 and 0 <= lambda <= kLargestPoissonMean. `upper` asks for the complements of the
// distribution functions. The terms that count are added one by one, from the most important ones to both
// sides: their number grows with the root of where the largest is.

/// The sum over j = 0, 1, ... of Poisson(j; lambda) P(a + j, x), x > 0.
MixtureShare NonCentralGamma(double x, double a, DoubleDouble lambda, bool upper, SumCare care);

/// The sum over j of Poisson(j; lambda) I_x(a + j, b), for odds = x / (1 - x) > 0.
MixtureShare NonCentralBeta(DoubleDouble odds, double a, double b, DoubleDouble lambda, bool upper,
                            SumCare care);

/// Half the sum over k = 0, 1, ... of w(k / 2) I_x((k + 1) / 2, b) with w(u) = e^-lambda lambda^u / Gamma(u +
/// 1), the share of a non-central t distribution between 0 and the point, or above it. drop and next are half
/// the sums over the drops as above. lambda >= kSmallestPoissonMean.
MixtureShare NonCentralStudent(DoubleDouble odds, double b, DoubleDouble lambda, bool upper, SumCare care);

}  // namespace MCMath_800

#endif  // KESTREL_MATH_NONCENTRALSUM_H
