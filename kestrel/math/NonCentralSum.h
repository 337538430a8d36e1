// Sums of gamma and beta distribution functions with Poisson weights: what non-central distributions are.

#ifndef KESTREL_MATH_NONCENTRALSUM_H
#define KESTREL_MATH_NONCENTRALSUM_H

namespace MCMath_800 {

/// The largest Poisson mean that the sums are meant for.
constexpr double kLargestPoissonMean = 5e8;

// All for finite a, b > 0 and 0 < lambda <= kLargestPoissonMean. `upper` asks for the complements of the
// distribution functions. Up to some hundred terms are added one by one, from the most important ones to both
// sides; from there on a quadrature takes their place, so that the cost does not grow with lambda.

/// The sum over j = 0, 1, ... of Poisson(j; lambda) P(a + j, x), x > 0.
double NonCentralGamma(double x, double a, double lambda, bool upper);

/// The sum over j of Poisson(j; lambda) I_x(a + j, b), for x, y > 0 with x + y = 1.
double NonCentralBeta(double x, double y, double a, double b, double lambda, bool upper);

/// Half the sum over k = 0, 1, ... of w(k / 2) I_x((k + 1) / 2, b) with w(u) = e^-lambda lambda^u / Gamma(u +
/// 1), the share of a non-central t distribution between 0 and the point, or above it.
double NonCentralStudent(double x, double y, double b, double lambda, bool upper);

}  // namespace MCMath_800

#endif  // KESTREL_MATH_NONCENTRALSUM_H
