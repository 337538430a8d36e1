// The non-central t, chi-square and F distribution.

#include <algorithm>
#include <cmath>

#include "kestrel/foundation/MCMV.h"
#include "kestrel/math/BetaRatio.h"
#include "kestrel/math/GammaRatio.h"
#include "kestrel/math/MCDistFun.h"
#include "kestrel/math/NonCentralSum.h"

namespace MCMath_800 {

namespace {

using MCCommon_800::MCMV;

constexpr double kLargestNc = 1e9;
constexpr double kLargestNcT = 3e4;
constexpr double kLargestX = 1e140;

bool IsDf(double df) {
  return df >= 0.01 && df <= 1e10;
}

/// P(Z + nc > x S) for x, nc < 0 with their signs taken off, that is P(Z < -x S - nc), where S^2 is a
/// chi-square over its df. The series of the other signs would cancel here, the integral over ln S (D. B.
/// Owen 1968, "A survey of properties and applications of the noncentral t-distribution") does not. It is
/// summed by the trapezoidal rule, which converges exponentially since the integrand fades at both ends.
double StudentAcrossZero(double x, double df, double nc) {
  const double half = 0.5 * df;
  // Where the integrand peaks, and how sharply.
  const double lean = x * nc;
  const double both = df + x * x;
  const double peak = 2.0 * df / (lean + std::sqrt(lean * lean + 4.0 * df * both));
  const double centre = std::log(peak);
  const double curvature = 2.0 * both * peak * peak + lean * peak;
  // Few degrees of freedom fade slowly to the left; the variable is bent to make them end.
  const double bend = df < 8.0 ? 1.0 : 0.0;
  // A wide integrand's step is bound by the strip around the axis in which it fades, a narrow one's by its
  // width: either way the rule is right to twelve digits.
  const double step = 1.0 / std::sqrt((bend == 0.0 ? 44.0 : 80.0) + curvature / 0.65);
  const double scale = 2.0 * GammaPower(half, half);
  const auto term = [&](double w) {
    const double tail = bend == 0.0 ? 0.0 : std::exp(-w);
    const double v = centre + w - bend * tail;
    const double fade = std::expm1(2.0 * v) - 2.0 * v;
    return std::exp(-half * fade) * MCDistFun::CdfStdNorm(-x * std::exp(v) - nc) * (1.0 + bend * tail);
  };
  double sum = term(0.0);
  for (const double way : {step, -step}) {
    double before = sum;
    constexpr int kNodeLimit = 400;
    for (int node = 1; node <= kNodeLimit; ++node) {
      const double value = term(node * way);
      sum += value;
      if (value <= 1e-17 * sum && value <= before) break;
      before = value;
    }
  }
  return scale * step * sum;
}

/// P(T <= x), or P(T > x). x > 0.
double StudentTail(double x, double df, double nc, bool upper) {
  if (nc == 0.0) return upper ? MCDistFun::SigT(x, df) : MCDistFun::CdfT(x, df);
  if (nc < 0.0) {
    const double above = StudentAcrossZero(x, df, -nc);
    return upper ? above : 1.0 - above;
  }
  const double square = x * (x / df);
  const double lambda = 0.5 * nc * nc;
  // Whichever tail is the smaller, about.
  const bool above = x > nc;
  double tail = 0.0;
  const double y = 1.0 / (1.0 + square);
  if (square > 0.0 && lambda > 0.0) tail = NonCentralStudent(square * y, y, 0.5 * df, lambda, above);
  if (square == 0.0 && above) tail = MCDistFun::CdfStdNorm(nc);
  if (square > 0.0 && lambda == 0.0) {
    tail = above ? MCDistFun::SigT(x, df) : MCDistFun::CdfT(x, df) - 0.5;
  }
  if (!above) tail += MCDistFun::CdfStdNorm(-nc);
  return above == upper ? tail : 1.0 - tail;
}

double TTail(double x, double df, double nc, bool upper) {
  if (x > 0.0) return StudentTail(x, df, nc, upper);
  if (x < 0.0) return StudentTail(-x, df, -nc, !upper);
  return MCDistFun::CdfStdNorm(upper ? nc : -nc);
}

/// x > 0.
double ChiTail(double x, double df, double nc, bool upper) {
  const double half = 0.5 * x;
  const double lambda = 0.5 * nc;
  if (half == 0.0) return upper ? 1.0 : 0.0;
  if (lambda == 0.0) return GammaRatio(half, 0.5 * df, upper);
  const bool above = x > df + nc;
  const double tail = NonCentralGamma(half, 0.5 * df, lambda, above);
  return above == upper ? tail : 1.0 - tail;
}

/// A sum of many terms may end a unit in the last place outside.
double AsProbability(double p) {
  return std::isfinite(p) ? std::min(std::max(p, 0.0), 1.0) : MCMV::gMissingValue;
}

/// The non-centrality at which the decreasing function tail(nc, upper) has P(below) = p, between low and
/// high: the secant method on the normal quantile of the probability, which is nearly a straight line, inside
/// a bracket that is halved, on the scale of asinh, when the secant leaves it. Missing when there is none.
/// start, slope  a first approximation, and the change of the quantile with nc there
template <class Tail>
double FindNonCentrality(double p, double low, double high, double start, double slope, const Tail& tail) {
  constexpr int kStepLimit = 100;
  const bool upper = p > 0.5;
  const double target = MCDistFun::IdfStdNorm(upper ? 1.0 - p : p);
  const auto distance = [&](double nc) {
    const double share = std::min(std::max(tail(nc, upper), 1e-307), 1.0 - 1e-16);
    const double away = MCDistFun::IdfStdNorm(share) - target;
    return upper ? -away : away;
  };
  // The central distribution tells the side.
  const double central = distance(0.0);
  if (central == 0.0) return 0.0;
  (central > 0.0 ? low : high) = 0.0;
  double at = std::min(std::max(start, low), high);
  double away = distance(at);
  // A bad start has a bad slope.
  if (std::fabs(away) > 0.5 && at != 0.0 && (away - central) / at < 0.0) slope = (away - central) / at;
  double before = 1.0;
  for (int step = 0; step < kStepLimit; ++step) {
    const double unit = 1.0 + std::fabs(target);
    if (std::fabs(away) <= 1e-15 * unit) return at;
    (away > 0.0 ? low : high) = at;
    double next = at - away / slope;
    const bool inside = next > low && next < high;
    // The error after a secant step is about the product of the last two. So close, more steps would search
    // in the probability's own rounding.
    const bool close = std::fabs(away) <= 1e-10 * unit;
    if (step > 0 && (close || (std::fabs(away * before) <= 1e-15 && std::fabs(away) <= 1e-6)))
      return inside ? next : at;
    if (!inside) next = std::sinh(0.5 * (std::asinh(low) + std::asinh(high)));
    if (next == at || !(next > low && next < high)) break;
    before = away;
    const double moved = next - at;
    at = next;
    away = distance(at);
    const double secant = (away - before) / moved;
    if (secant < 0.0 && std::fabs(away - before) > 1e-9) slope = secant;
  }
  return std::fabs(away) < 1e-8 * (1.0 + std::fabs(target)) ? at : MCMV::gMissingValue;
}

/// A first non-centrality of a chi-square over df1 divided by one over df2: both are taken as normal. x is
/// the point times df1.
double FirstNonCentrality(double x, double df1, double share2, double quantile, double& slope) {
  double mean = std::max(x, df1);
  double spread = 1.0;
  for (int i = 0; i < 6; ++i) {
    spread = std::sqrt(2.0 * (2.0 * mean - df1) + 2.0 * mean * mean * share2);
    mean = std::max(df1, x - quantile * spread);
  }
  slope = -1.0 / spread;
  return mean - df1;
}

bool IsNc(double nc) {
  return nc >= 0.0 && nc <= kLargestNc;
}

}  // namespace

double MCDistFun::NonCentralCdfT(double x, double df, double nc) {
  if (!(std::fabs(x) <= kLargestX) || !IsDf(df) || !(std::fabs(nc) <= kLargestNcT))
    return MCMV::gMissingValue;
  return AsProbability(TTail(x, df, nc, false));
}

double MCDistFun::NonCentralCdfChi(double x, double df, double nc) {
  if (!std::isfinite(x) || !IsDf(df) || !IsNc(nc)) return MCMV::gMissingValue;
  return x <= 0.0 ? 0.0 : AsProbability(ChiTail(x, df, nc, false));
}

double MCDistFun::NonCentralCdfF(double x, double df1, double df2, double nc, bool upper) {
  if (!std::isfinite(x) || !IsDf(df1) || !IsDf(df2) || !IsNc(nc)) return MCMV::gMissingValue;
  if (x <= 0.0) return upper ? 1.0 : 0.0;
  const double ratio = x * (df1 / df2);
  long err = 0;
  const double share = ncdbet(ratio, 0.5 * df1, 0.5 * df2, nc, upper, err);
  return err == 0 ? share : MCMV::gMissingValue;
}

double MCDistFun::FindNCParamT(double x, double df, double p) {
  if (!(std::fabs(x) <= kLargestX) || !IsDf(df) || !(p > 0.0 && p < 1.0)) return MCMV::gMissingValue;
  const double spread = std::hypot(1.0, x / std::sqrt(2.0 * df));
  const double start = x - IdfStdNorm(p) * spread;
  return FindNonCentrality(p, -kLargestNcT, kLargestNcT, start, -1.0 / spread,
                           [&](double nc, bool upper) { return TTail(x, df, nc, upper); });
}

double MCDistFun::FindNCParamChi(double x, double df, double p) {
  if (!std::isfinite(x) || x <= 0.0 || !IsDf(df) || !(p > 0.0 && p < 1.0)) return MCMV::gMissingValue;
  const double central = ChiTail(x, df, 0.0, false);
  if (p >= central) return p == central ? 0.0 : MCMV::gMissingValue;
  double slope = 0.0;
  const double start = FirstNonCentrality(x, df, 0.0, IdfStdNorm(p), slope);
  return FindNonCentrality(p, 0.0, kLargestNc, start, slope,
                           [&](double nc, bool upper) { return ChiTail(x, df, nc, upper); });
}

double MCDistFun::FindNCParamF(double x, double df1, double df2, double p) {
  if (!std::isfinite(x) || x <= 0.0 || !IsDf(df1) || !IsDf(df2) || !(p > 0.0 && p < 1.0))
    return MCMV::gMissingValue;
  const double ratio = x * (df1 / df2);
  long err = 0;
  const auto tail = [&](double nc, bool upper) {
    return ncdbet(ratio, 0.5 * df1, 0.5 * df2, nc, upper, err);
  };
  const double central = tail(0.0, false);
  if (p >= central) return p == central ? 0.0 : MCMV::gMissingValue;
  double slope = 0.0;
  const double start = FirstNonCentrality(x * df1, df1, 1.0 / df2, IdfStdNorm(p), slope);
  const double nc = FindNonCentrality(p, 0.0, kLargestNc, start, slope, tail);
  return err == 0 ? nc : MCMV::gMissingValue;
}

double MCDistFun::ncdbet(const double& ratio, const double& a, const double& b, const double& nc, bool upper,
                         long& err) {
  const double y = 1.0 / (1.0 + ratio);
  const double x = ratio * y;
  if (ratio == 0.0) return upper ? 1.0 : 0.0;
  if (y == 0.0 || !std::isfinite(x)) return upper ? 0.0 : 1.0;
  const double lambda = 0.5 * nc;
  if (lambda == 0.0) return BetaRatio({x, y, b * x - a * y}, a, b, upper);
  // Whichever tail is the smaller, about.
  const bool above = ratio * b > a + lambda;
  const double tail = NonCentralBeta(x, y, a, b, lambda, above);
  if (!std::isfinite(tail)) err = 1;
  return AsProbability(above == upper ? tail : 1.0 - tail);
}

}  // namespace MCMath_800
