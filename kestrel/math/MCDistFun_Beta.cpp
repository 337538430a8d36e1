// The beta distribution, and those that come down to it: Student's t and F.

#include <algorithm>
#include <cmath>
#include <limits>

#include "kestrel/foundation/MCMV.h"
#include "kestrel/math/BetaRatio.h"
#include "kestrel/math/MCDistFun.h"
#include "kestrel/math/QuantileSearch.h"
#include "kestrel/math/SaddlePoint.h"

namespace MCMath_800 {

using MCCommon_800::MCMV;

namespace {

constexpr double kPi = 3.14159265358979323846;

bool IsParameter(double value) {
  return value > 0.0 && std::isfinite(value);
}

double Finish(double value, long err) {
  return err == 0 && std::isfinite(value) ? value : MCMV::gMissingValue;
}

// Half of the degrees of freedom; above 0 also where the half of the smallest number is not.
double HalfOf(double df) {
  return std::max(0.5 * df, std::numeric_limits<double>::denorm_min());
}

// The point whose odds x / y are given, which have the digits of the smaller of x and y.
BetaPoint PointOfOdds(DoubleDouble odds, double a, double b) {
  const DoubleDouble y = DoubleDouble(1.0) / (odds + 1.0);
  return {odds * y, y, (odds * b - a) * y};
}

// f df1 / df2, in an order that keeps it in range where it can.
DoubleDouble OddsOfF(double f, double df1, double df2) {
  const double quotient = f / df2;
  if (quotient > 1e-290 && quotient < 1e290) return DoubleDouble(f) / df2 * df1;
  return MultiplyExactly(f, df1) / df2;
}

// Beyond this logarithm of the odds the leading power of that end is all there is to the beta distribution.
constexpr double kExtremeLogOdds = -600.0;

// 1 / (a B(a, b)), the factor of the leading power x^a, for a < 3.
double LeadingFactor(double a, double b) {
  double factor = 1.0;
  for (; a >= 1.0; a -= 1.0)
    factor *= (a - 1.0 + b) / a;
  return a == 0.0 ? factor : factor * (BetaPower({1.0, 1.0, 0.0}, a, b) / a);
}

// ln x for I_x(a, b) = p by the leading power alone. At the edge of the format that is the answer.
DoubleDouble LeadingLogOdds(double p, double a, double b) {
  if (a < 3.0) return (Log(p) - Log(LeadingFactor(a, b))) / a;
  return (std::log(p) + std::log(a) + LogBeta(a, b)) / a;
}

// The odds by that power in a far tail, 0 elsewhere and where the other power, y^(b - 1), is more than a
// tenth of it as a logarithm.
double LeadingOdds(double p, double a, double b) {
  constexpr double kFarTail = 1e-30;
  if (p > kFarTail) return 0.0;
  const double log_x = LeadingLogOdds(p, a, b).high;
  const double y = -std::expm1(log_x);
  if (!(y > 0.0) || std::fabs((b - 1.0) * std::log(y)) > -0.1 * a * log_x) return 0.0;
  return std::clamp(std::exp(log_x) / y, 1e-280, 1e280);
}

// After G. W. Cran, K. J. Martin and G. E. Thomas, "Remark AS R19 and algorithm AS 109", Applied Statistics
// 26 (1977) 111-114: a normal approximation for shapes above 1, and the leading power of the nearer end for
// others. The approximation is kept inside what is searched: in far tails of shapes close to 1 it lies many
// powers of ten outside, from where the search would not begin.
double StartOdds(double p, double q, double a, double b) {
  if (a > 1.0 && b > 1.0) {
    const double leading = LeadingOdds(p < q ? p : q, p < q ? a : b, p < q ? b : a);
    if (leading > 0.0) return p < q ? leading : 1.0 / leading;
    const double z = p < q ? MCDistFun::IdfStdNorm(p) : -MCDistFun::IdfStdNorm(q);
    const double lambda = (z * z - 3.0) / 6.0;
    const double ra = 1.0 / (2.0 * a - 1.0);
    const double rb = 1.0 / (2.0 * b - 1.0);
    const double h = 2.0 / (ra + rb);
    const double root = std::sqrt(std::max(0.0, h + lambda));
    const double w = z * root / h + (rb - ra) * (lambda + 5.0 / 6.0 - 2.0 / (3.0 * h));
    return std::clamp(a / b * std::exp(2.0 * w), 1e-280, 1e280);
  }
  // The two halves of the distribution as if each were a power.
  const double left = std::exp(a * std::log(a / (a + b))) / a;
  const double right = std::exp(b * std::log(b / (a + b))) / b;
  const double whole = left + right;
  if (p < left / whole) {
    const DoubleDouble extreme = LeadingLogOdds(p, a, b);
    if (extreme.high < kExtremeLogOdds) return GuardedExpMinus(-extreme);
    const double x = std::exp(std::min(-1e-3, (std::log(a * whole) + std::log(p)) / a));
    return x / (1.0 - x);
  }
  const DoubleDouble extreme = LeadingLogOdds(q, b, a);
  if (extreme.high < kExtremeLogOdds) return GuardedExpMinus(extreme);
  const double y = std::exp(std::min(-1e-3, (std::log(b * whole) + std::log(q)) / b));
  return (1.0 - y) / y;
}

// t^2 / df for the two-sided probability p of Student's t: G. W. Hill, "Algorithm 396: Student's
// t-quantiles", Comm. ACM 13 (1970) 619-620, for df above 1. leading is the logarithm of the leading power,
// which is where Hill starts, too.
double HillSquare(double p, double df, double leading) {
  const double a = 1.0 / (df - 0.5);
  const double b = 48.0 / (a * a);
  double c = ((20700.0 * a / b - 98.0) * a - 16.0) * a + 96.36;
  const double d = ((94.5 / (b + c) - 3.0) / b + 1.0) * std::sqrt(0.5 * kPi * a) * df;
  double y = std::exp(leading);
  if (y > 0.05 + a) {
    const double x = MCDistFun::IdfStdNorm(0.5 * p);
    y = x * x;
    if (df < 5.0) c += 0.3 * (df - 4.5) * (x + 0.6);
    c += (((0.05 * d * x - 5.0) * x - 7.0) * x - 2.0) * x + b;
    y = (((((0.4 * y + 6.3) * y + 36.0) * y + 94.5) / c - y - 3.0) / b + 1.0) * x;
    return std::expm1(a * y * y);
  }
  return ((1.0 / (((df + 6.0) / (df * y) - 0.089 * d - 0.822) * (df + 2.0) * 3.0) + 0.5 / (df + 4.0)) * y -
          1.0) *
             (df + 1.0) / (df + 2.0) +
         1.0 / y;
}

// Where the format ends the low part is no number.
double Rounded(DoubleDouble number) {
  return std::isfinite(number.low) ? number.high + number.low : number.high;
}

// The odds x / y at which I_x(a, b) = p; p + q = 1, and the smaller of them is exact.
DoubleDouble FindOdds(double p, double q, double a, double b, double start) {
  const bool upper = q < p;
  const double reach = std::max(1.0, std::sqrt(a * (b / (a + b))));
  return SearchLongQuantile(start, upper ? q : p, reach, upper, [&](double odds) {
    const BetaPoint point = PointOfOdds(odds, a, b);
    return QuantilePoint{BetaRatio(point, a, b, upper), BetaPower(point, a, b), -point.deviation.high};
  });
}

}  // namespace

double MCDistFun::cbtaux(const BetaPoint& point, const double& a, const double& b, bool upper, long& err) {
  err = 0;
  if (point.x.high <= 0.0) return upper ? 1.0 : 0.0;
  if (point.y.high <= 0.0) return upper ? 0.0 : 1.0;
  const double ratio = BetaRatio(point, a, b, upper);
  if (!std::isfinite(ratio)) err = 1;
  return ratio;
}

double MCDistFun::cdfbet(const double& x, const double& a, const double& b, long& err) {
  return cbtaux(MakeBetaPoint(x, a, b), a, b, false, err);
}

double MCDistFun::betinv(const double& p, const double& a, const double& b, long& err) {
  const DoubleDouble odds = FindOdds(p, 1.0 - p, a, b, StartOdds(p, 1.0 - p, a, b));
  err = std::isnan(odds.high) ? 1 : 0;
  if (std::isinf(odds.high)) return 1.0;
  const DoubleDouble one = 1.0;
  return odds.high <= 1.0 ? Rounded(odds / (one + odds)) : Rounded(one - one / (one + odds));
}

// P(T > size) for size >= 0: half of I_w(df/2, 1/2), w = df / (df + size^2). w and its complement are formed
// without subtraction, so that any df and size keep their digits; so is the distance from the mean.
double MCDistFun::vexasigt(const double& size, const double& df, long& err) {
  err = 0;
  if (df == 1.0) return std::atan2(1.0, size) / kPi;
  const double a = HalfOf(df);
  const double log_odds = 2.0 * (0.5 * std::log(df) - std::log(size));
  if (log_odds < kExtremeLogOdds) {
    // The leading power (df / size^2)^a / (a B(a, 1/2)); of many df it is too small for a double.
    const double power = std::pow(size, -df);
    return power == 0.0 ? 0.0 : 0.5 * power * std::pow(df, a) * (BetaPower({1.0, 1.0, 0.0}, a, 0.5) / a);
  }
  // Whichever way round nothing is too large or too small before it has to be.
  const DoubleDouble square =
      size > 1e100 ? DoubleDouble(size) / df * size : MultiplyExactly(size, size) / df;
  const DoubleDouble w = DoubleDouble(1.0) / (square + 1.0);
  const DoubleDouble deviation = AddExactly(1.0, -size) * w * AddExactly(1.0, size) * 0.5;
  return 0.5 * cbtaux({w, w * square, deviation}, a, 0.5, false, err);
}

double MCDistFun::vexacdft(const double& x, const double& df, long& err) {
  const double tail = vexasigt(std::fabs(x), df, err);
  return x < 0.0 ? tail : 1.0 - tail;
}

double MCDistFun::vexaidft(const double& p, const double& df, long& err) {
  const double tail = p < 0.5 ? p : 1.0 - p;
  const double a = HalfOf(df);
  const DoubleDouble extreme = LeadingLogOdds(2.0 * tail, a, 0.5);
  double size;
  if (df == 1.0) {
    size = tail > 0.25 ? std::tan(kPi * (0.5 - tail)) : 1.0 / std::tan(kPi * tail);
  } else if (extreme.high < kExtremeLogOdds) {
    constexpr double kInfinity = std::numeric_limits<double>::infinity();
    size = std::isinf(extreme.high) ? kInfinity : GuardedExpMinus((extreme - Log(df)) * 0.5);
  } else {
    const double twice = 2.0 * tail;
    const double square = df > 1.0 && df < 1e9 ? HillSquare(twice, df, extreme.high) : 0.0;
    const double start = square > 0.0 ? 1.0 / square : StartOdds(twice, 1.0 - twice, a, 0.5);
    size = std::sqrt(df / FindOdds(twice, 1.0 - twice, a, 0.5, start).high);
  }
  err = std::isfinite(size) ? 0 : 1;
  return p < 0.5 ? -size : size;
}

// Of x = df1 f / (df1 f + df2) the distance from the mean is formed of f - 1, which near the mean is exact.
double MCDistFun::vexaratf(const double& f, const double& df1, const double& df2, bool upper, long& err) {
  const DoubleDouble odds = OddsOfF(f, df1, df2);
  if (!std::isfinite(odds.high)) return upper ? 0.0 : 1.0;
  const DoubleDouble y = DoubleDouble(1.0) / (odds + 1.0);
  return cbtaux({odds * y, y, y * AddExactly(f, -1.0) * (0.5 * df1)}, HalfOf(df1), HalfOf(df2), upper, err);
}

double MCDistFun::vexacdff(const double& f, const double& df1, const double& df2, long& err) {
  return vexaratf(f, df1, df2, false, err);
}

double MCDistFun::vexaidff(const double& p, const double& df1, const double& df2, long& err) {
  const double a = HalfOf(df1);
  const double b = HalfOf(df2);
  const double f = Rounded(FindOdds(p, 1.0 - p, a, b, StartOdds(p, 1.0 - p, a, b)) * df2 / df1);
  err = std::isfinite(f) ? 0 : 1;
  return f;
}

double MCDistFun::CdfT(double x, double df) {
  if (std::isnan(x) || !IsParameter(df)) return MCMV::gMissingValue;
  if (x == 0.0) return 0.5;
  long err = 0;
  const double p = vexacdft(x, df, err);
  return Finish(p, err);
}

double MCDistFun::SigT(double x, double df) {
  if (std::isnan(x) || !IsParameter(df)) return MCMV::gMissingValue;
  if (x == 0.0) return 0.5;
  long err = 0;
  const double p = vexacdft(-x, df, err);
  return Finish(p, err);
}

double MCDistFun::IdfT(double p, double df) {
  if (!(p > 0.0 && p < 1.0) || !IsParameter(df)) return MCMV::gMissingValue;
  if (p == 0.5) return 0.0;
  long err = 0;
  const double x = vexaidft(p, df, err);
  return Finish(x, err);
}

double MCDistFun::CdfF(double x, double df1, double df2) {
  if (std::isnan(x) || !IsParameter(df1) || !IsParameter(df2)) return MCMV::gMissingValue;
  if (x <= 0.0) return 0.0;
  if (std::isinf(x)) return 1.0;
  long err = 0;
  const double p = vexacdff(x, df1, df2, err);
  return Finish(p, err);
}

double MCDistFun::SigF(double x, double df1, double df2) {
  if (std::isnan(x) || !IsParameter(df1) || !IsParameter(df2)) return MCMV::gMissingValue;
  if (x <= 0.0) return 1.0;
  if (std::isinf(x)) return 0.0;
  long err = 0;
  const double p = vexaratf(x, df1, df2, true, err);
  return Finish(p, err);
}

double MCDistFun::IdfF(double p, double df1, double df2) {
  if (!(p >= 0.0 && p < 1.0) || !IsParameter(df1) || !IsParameter(df2)) return MCMV::gMissingValue;
  if (p == 0.0) return 0.0;
  long err = 0;
  const double x = vexaidff(p, df1, df2, err);
  return Finish(x, err);
}

double MCDistFun::CdfBeta(double x, double a, double b) {
  if (std::isnan(x) || !IsParameter(a) || !IsParameter(b)) return MCMV::gMissingValue;
  if (x <= 0.0) return 0.0;
  if (x >= 1.0) return 1.0;
  long err = 0;
  const double p = cdfbet(x, a, b, err);
  return Finish(p, err);
}

double MCDistFun::IdfBeta(double p, double a, double b) {
  if (!(p >= 0.0 && p <= 1.0) || !IsParameter(a) || !IsParameter(b)) return MCMV::gMissingValue;
  if (p == 0.0 || p == 1.0) return p;
  long err = 0;
  const double x = betinv(p, a, b, err);
  return Finish(x, err);
}

}  // namespace MCMath_800
