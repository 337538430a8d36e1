#include "kestrel/math/GammaRatio.h"

#include <algorithm>
#include <cmath>

#include "kestrel/math/ErrorFunction.h"
#include "kestrel/math/GammaCoefficients.h"
#include "kestrel/math/MCPower.h"
#include "kestrel/math/Polynomial.h"
#include "kestrel/math/PowerSum.h"
#include "kestrel/math/SaddlePoint.h"

namespace MCMath_800 {
namespace {

constexpr double kTwoPi = 6.28318530717958647693;
constexpr double kHalfLogTwoPi = 0.91893853320467274178;
constexpr double kPrecision = MCPower::gMachineEpsilon / 4.0;

// Far more terms than any series below needs where it is used; the limit is there for the reader's peace.
constexpr int kTermLimit = 1000;

// From here on Temme's expansion in 1/a has all its digits.
constexpr double kTemmeShape = 20.0;

// Below this, Q for a < 1 is put together from the series; the continued fraction is slow near 0.
constexpr double kSmallX = 1.1;

// The power series of P(a, x) over the power term: sum of x^n / (a (a + 1) ... (a + n)).
double LowerSeries(DoubleDouble x, double a) {
  PowerSum sum(x);
  for (int i = 1; i < kTermLimit && sum.Counts(); ++i)
    sum.Add(x.high / (a + i));
  return sum.Value() / a;
}

// Legendre's continued fraction of Q(a, x) over the power term, summed as W. Gautschi does: "A computational
// procedure for incomplete gamma functions", ACM TOMS 5 (1979) 466-481. For x above a, or above 1.
double UpperFraction(double x, double a) {
  const double first = x + 1.0 - a;
  double rho = 0.0;
  double term = 1.0;
  DoubleDouble sum = 1.0;
  for (int i = 1; i < kTermLimit && std::fabs(term) > kPrecision * sum.high; ++i) {
    const double step = first + 2 * i;
    const double tau = i * (i - a) * (1.0 + rho);
    rho = tau / ((step - 2.0) * step - tau);
    term *= rho;
    const DoubleDouble next = AddOrdered(sum.high, term);
    sum = {next.high, sum.low + next.low};
  }
  return (sum.high + sum.low) / first;
}

// ln Gamma(1 + y) for 0 <= y <= 1, with all digits beside its zeros.
double LogGamma1(double y) {
  return y * (y - 1.0) * (Polynomial(kLogGamma1, y) / Polynomial(kLogGamma1Divisor, y));
}

// Q(a, x) for a < 1 and small x, without taking a P close to 1 from 1: A. R. DiDonato and A. H. Morris,
// "Computation of the incomplete gamma function ratios and their inverse", ACM TOMS 12 (1986) 377-393,
// equation 11.
double UpperOfSmallShape(double x, double a) {
  // Two doubles, since in the end only a small part of the series is left.
  DoubleDouble power = x;
  DoubleDouble series = 0.0;
  for (int n = 1; n < kTermLimit; ++n) {
    const DoubleDouble term = power / AddExactly(a, n);
    series = series + term;
    if (std::fabs(term.high) <= kPrecision * series.high) break;
    power = power * -x / (n + 1.0);
  }
  // x^a / Gamma(1 + a) - 1
  const double grown = std::expm1(a * std::log(x) - LogGamma1(a));
  const DoubleDouble lost = series * a;
  return (lost - grown).high + grown * lost.high;
}

// The sum of Temme's expansion: N. M. Temme, "The asymptotic expansion of the incomplete gamma functions",
// SIAM J. Math. Anal. 10 (1979) 757-766.
double TemmeSum(double eta, double a) {
  const double v = 1.0 / a;
  double sum = 0.0;
  // Past 200 the last terms do not count.
  if (a < 200.0) {
    sum = Polynomial(kTemme9, eta);
    sum = sum * v + Polynomial(kTemme8, eta);
    sum = sum * v + Polynomial(kTemme7, eta);
    sum = sum * v + Polynomial(kTemme6, eta);
    sum = sum * v + Polynomial(kTemme5, eta);
  }
  sum = sum * v + Polynomial(kTemme4, eta);
  sum = sum * v + Polynomial(kTemme3, eta);
  sum = sum * v + Polynomial(kTemme2, eta);
  sum = sum * v + Polynomial(kTemme1, eta);
  return sum * v + Polynomial(kTemme0, eta);
}

double Choose(double ratio, bool is_upper, bool upper) {
  return is_upper == upper ? ratio : 1.0 - ratio;
}

// Both tails have the exponential as a factor, so that small ones keep their digits.
GammaShare ShareByTemme(double deviation, double a, DoubleDouble deviance, bool upper) {
  const double eta = std::copysign(std::sqrt(2.0 * deviance.high / a), deviation);
  const double exponential = GuardedExpMinus(deviance);
  const double scale = std::sqrt(kTwoPi * a);
  const double sum = TemmeSum(eta, a) / scale;
  const double half = 0.5 * ScaledErfc(std::sqrt(deviance.high));
  const bool above = deviation > 0.0;
  const double tail = exponential * (above ? half + sum : half - sum);
  return {Choose(tail, above, upper), exponential * a / scale * std::exp(-StirlingError(a))};
}

// Q(a, x) for a <= 1, given e^-x.
GammaShare UpperShare(double x, double a, double exponential) {
  const double power = a * ReciprocalGamma1(a) * std::pow(x, a) * exponential;
  if (a < 1.0 && x < kSmallX) return {std::max(0.0, UpperOfSmallShape(x, a)), power};
  if (a == 0.5) return {exponential * ScaledErfc(std::sqrt(x)), power};
  return {power * UpperFraction(x, a), power};
}

}  // namespace

double ReciprocalGamma1(double a) {
  return Polynomial(kReciprocalGamma, a);
}

double LogGamma(double a) {
  if (a < 1.0) return LogGamma1(a) - std::log(a);
  if (a < 2.0) return LogGamma1(a - 1.0);
  if (a < 10.0) {
    double product = 1.0;
    while (a > 3.0) {
      a -= 1.0;
      product *= a;
    }
    const double z = a - 2.0;
    const double core = z * (1.0 + z) * (Polynomial(kLogGamma2, z) / Polynomial(kLogGamma2Divisor, z));
    return product == 1.0 ? core : core + std::log(product);
  }
  return (a - 0.5) * (std::log(a) - 1.0) + (kHalfLogTwoPi - 0.5 + StirlingError(a));
}

double GammaPower(DoubleDouble x, double a) {
  if (a < 1.0) return a * ReciprocalGamma1(a) * std::pow(x.high, a) * GuardedExpMinus(x);
  return std::sqrt(a / kTwoPi) * GuardedExpMinus(Deviance([&] { return x; }, x - a, a) + StirlingError(a));
}

GammaShare FindGammaShare(DoubleDouble x, double a, bool upper) {
  if (a >= kTemmeShape) {
    const DoubleDouble deviation = x - a;
    const DoubleDouble deviance = Deviance([&] { return x; }, deviation, a);
    if (deviance.high <= 0.5 * kTemmeReach * kTemmeReach * a)
      return ShareByTemme(deviation.high, a, deviance, upper);
  }
  const double at = x.high;
  if (a < 1.0 && upper) return UpperShare(at, a, GuardedExpMinus(x));
  const double power = GammaPower(x, a);
  if (at < std::max(a, kSmallX))
    return {Choose(std::min(1.0, power * LowerSeries(x, a)), false, upper), power};
  if (power == 0.0) return {upper ? 0.0 : 1.0, power};
  return {Choose(power * UpperFraction(at, a), true, upper), power};
}

GammaShare FindSmallShare(DoubleDouble x, double a) {
  return UpperShare(x.high, a, ExpMinus(x));
}

double GammaRatio(DoubleDouble x, double a, bool upper) {
  return FindGammaShare(x, a, upper).ratio;
}

}  // namespace MCMath_800
