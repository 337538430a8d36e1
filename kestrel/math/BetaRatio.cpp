// The choice of methods follows A. R. DiDonato and A. H. Morris, "Algorithm 708: significant digit
// computation of the incomplete beta function ratios", ACM TOMS 18 (1992) 360-373. Powers and sums are
// arranged anew: powers by their deviance from the mean, sums with terms of one sign.

#include "kestrel/math/BetaRatio.h"

#include <algorithm>
#include <cmath>

#include "kestrel/math/ErrorFunction.h"
#include "kestrel/math/GammaRatio.h"
#include "kestrel/math/MCPower.h"
#include "kestrel/math/PowerSum.h"
#include "kestrel/math/SaddlePoint.h"

namespace MCMath_800 {
namespace {

constexpr double kTwoPi = 6.28318530717958647693;

// Far more terms than any sum below needs where it is used; the limit is there for the reader's peace.
constexpr int kTermLimit = 2000;

// Up to here the continued fraction takes less time than the expansion's coefficients.
constexpr double kNormalShape = 20.0;

// A point with its parameters, so that both can be turned round: I_x(a, b) = 1 - I_y(b, a).
struct BetaCase {
  BetaPoint at;
  double a;
  double b;

  BetaCase Reflected() const { return {{at.y, at.x, -at.deviation}, b, a}; }
  double Power() const { return BetaPower(at, a, b); }
};

// The logarithm of x when y = 1 - x may be small, from whichever has the digits.
DoubleDouble LogOf(DoubleDouble x, DoubleDouble y) {
  return y.high < 0.375 ? LogOfOnePlus(-y) : Log(x);
}

// (a + b - 1/2) ln(1 + a / b) - a + StirlingError(a + b) - StirlingError(b), which is ln(Gamma(a + b) /
// Gamma(b)) - a ln b: small for b above a.
double LogGammaGrowth(double a, double b) {
  return (a + b - 0.5) * std::log1p(a / b) - a + (StirlingError(a + b) - StirlingError(b));
}

double PowerOfSmallA(DoubleDouble x, DoubleDouble y, double a, double b) {
  return a * ReciprocalGamma1(a) * std::pow(b * x.high, a) *
         ExpMinus(-(LogOf(y, x) * b + LogGammaGrowth(a, b)));
}

double PowerOfSmallBoth(double x, double y, double a, double b) {
  const double sum = a + b;
  const double gamma = sum <= 1.0 ? ReciprocalGamma1(sum) : ReciprocalGamma1(sum - 1.0) / sum;
  return a * (b / sum) * (ReciprocalGamma1(a) * ReciprocalGamma1(b) / gamma) * std::pow(x, a) *
         std::pow(y, b);
}

// What x^a y^b loses on its way from the mean, as a logarithm.
DoubleDouble BetaDeviance(const BetaPoint& point, double a, double b) {
  return Deviance([&] { return point.x * AddExactly(a, b); }, point.deviation, a) +
         Deviance([&] { return point.y * AddExactly(a, b); }, -point.deviation, b);
}

// I_x(a, b) - I_x(a + count, b), from the recurrence in a; with enough terms it is I_x(a, b) itself. For b <=
// 1, or x below the mean.
double ForwardSum(const BetaCase& c, int count) {
  PowerSum sum(c.at.x);
  const double x = c.at.x.high;
  const double excess = x * (c.b - 1.0);
  // x (n + b) / (n + 1) with fewer roundings.
  for (int i = 1; i < count && sum.Counts(); ++i)
    sum.Add(x + excess / (c.a + i));
  return c.Power() / c.a * sum.Value();
}

// I_x(a, b) - I_x(a, b - count), from the recurrence in b. Taken from the far end, where the terms are
// largest: the nearest may be too small for a double while the sum is not.
double BackwardSum(const BetaCase& c, int count) {
  double b = c.b - 1.0;
  const BetaPoint last = {c.at.x, c.at.y, c.at.deviation - c.at.x};
  const DoubleDouble inverse = DoubleDouble(1.0) / c.at.y;
  PowerSum sum(inverse);
  for (int i = 1; i < count && sum.Counts(); ++i) {
    const double less = b - 1.0;
    sum.Add(inverse.high * (b / (c.a + less)));
    b = less;
  }
  return BetaPower(last, c.a, c.b - 1.0) / (c.b - 1.0) * sum.Value();
}

// I_x(a + steps, b) by the expansion for a > b, b <= 1, a >= 15 in incomplete gamma functions, section 9 of
// the paper.
double LargeAExpansion(const BetaCase& c, int steps) {
  constexpr int kTerms = 30;
  const double a = c.a + steps;
  const double b = c.b;
  const DoubleDouble shift = AddExactly(b, -1.0) * 0.5;
  const DoubleDouble exact_nu = AddExactly(c.a, steps) + shift;
  const DoubleDouble exact_log = LogOf(c.at.x, c.at.y);
  const DoubleDouble exact_z = -(exact_log * exact_nu);
  const double nu = exact_nu.high;
  const double log_x = exact_log.high;
  const double z = exact_z.high;
  if (!(z > 0.0)) return 1.0;
  const GammaShare gamma = FindSmallShare(exact_z, b);
  if (gamma.power == 0.0) return 0.0;
  const double scale = std::exp(LogGammaGrowth(b, a) - b * std::log1p(shift.high / a));
  const double v = 0.25 / nu / nu;
  const double square = 0.25 * log_x * log_x;
  double coefficients[kTerms];
  double weights[kTerms];
  const double first = gamma.ratio / gamma.power;
  double j = first;
  double sum = 0.0;
  double t = 1.0;
  double coefficient = 1.0;
  for (int n = 1; n <= kTerms; ++n) {
    const double b2 = b + 2.0 * (n - 1);
    j = (b2 * (b2 + 1.0) * j + (z + b2 + 1.0) * t) * v;
    t *= square;
    coefficient /= 2.0 * n * (2.0 * n + 1.0);
    coefficients[n - 1] = coefficient;
    double s = 0.0;
    for (int i = 1; i < n; ++i)
      s += (i * b - n) * coefficients[i - 1] * weights[n - i - 1];
    weights[n - 1] = (b - 1.0) * coefficient + s / n;
    const double term = weights[n - 1] * j;
    sum += term;
    if (std::fabs(term) <= kPowerSumPrecision * first) break;
  }
  return scale * (gamma.ratio + gamma.power * sum);
}

// The continued fraction of section 4, for a, b > 1 and x below the mean: beta_0 + alpha_1 / (beta_1 + ...).
class FractionTerms {
 public:
  explicit FractionTerms(const BetaCase& c)
      : a_(c.a), b_(c.b), x_(c.at.x.high), y_(c.at.y.high), first_(1.0 - c.at.deviation.high) {}

  struct Term {
    double alpha;
    double beta;
  };
  Term At(double n) const {
    const double divisor = a_ + (2.0 * n - 1.0);
    const double step = n * ((b_ - n) * x_) / divisor;
    return {(a_ + (n - 1.0)) * ((a_ + b_ + (n - 1.0)) * x_ / divisor) * step,
            n + step + (a_ + n) / (a_ + (2.0 * n + 1.0)) * (first_ + n * (1.0 + y_))};
  }
  double First() const { return a_ / (a_ + 1.0) * first_; }

 private:
  double a_;
  double b_;
  double x_;
  double y_;
  double first_;
};

// The fraction from beta_start on, by its convergents.
double FractionFrom(const FractionTerms& terms, int start, double beta) {
  double above = 0.0, below = 1.0;
  double next_above = 1.0, next_below = beta;
  for (int n = start + 1; n < kTermLimit; ++n) {
    const FractionTerms::Term term = terms.At(n);
    const double new_above = term.alpha * above + term.beta * next_above;
    const double new_below = term.alpha * below + term.beta * next_below;
    // Two convergents agree when their cross products do; a division only when the numbers grow.
    const double left = new_above * next_below;
    const bool agree = std::fabs(left - next_above * new_below) <= 2.0 * kPowerSumPrecision * left;
    above = next_above;
    below = next_below;
    next_above = new_above;
    next_below = new_below;
    if (agree) break;
    if (next_below > 1e30) {
      const double shrink = 1.0 / next_below;
      above *= shrink;
      below *= shrink;
      next_above *= shrink;
      next_below = 1.0;
    }
  }
  return next_below / next_above;
}

// Convergents gather rounding errors that the levels of a fraction fade out: the first levels, which count
// most, are put on top of them.
double Fraction(const BetaCase& c) {
  const double power = c.Power();
  if (power == 0.0) return 0.0;
  constexpr int kLevels = 6;
  const FractionTerms terms(c);
  double alpha[kLevels + 1], beta[kLevels + 1];
  beta[0] = terms.First();
  for (int n = 1; n <= kLevels; ++n) {
    const FractionTerms::Term term = terms.At(n);
    alpha[n] = term.alpha;
    beta[n] = term.beta;
  }
  double value = FractionFrom(terms, kLevels, beta[kLevels]);
  for (int n = kLevels; n >= 1; --n)
    value = beta[n - 1] + alpha[n] / value;
  return power / value;
}

// The expansion near the mean for a and b that are not small. With the mean m = a / (a + b), M = a b / (a +
// b) and the deviance M w^2 / 2 as the variable, where w has the sign of t - m,
//   I_x(a, b) = sqrt(M / (2 pi)) e^-correction * integral of e^(-M w^2 / 2) g(w) over w up to that of x,
// g(w) = w / s(w), s = (t - m) / (m (1 - m)), and s s' = w (1 + (1 - 2 m) s - m (1 - m) s^2), which gives the
// power series of s^2, s and g one after the other. Compare N. M. Temme, "The uniform asymptotic expansion of
// a class of integrals related to cumulative distribution functions", SIAM J. Math. Anal. 13 (1982) 239-253.
class NormalSeries {
 public:
  static constexpr int kCount = 24;

  // With w turned round, since x is below the mean.
  NormalSeries(double a, double b) : skewness_((a - b) / (a + b)), variance_(a / (a + b) * (b / (a + b))) {}

  /// g_n, for n = 1, 2, ... in turn.
  double Next(int n) {
    // s_n+1 from the square's coefficient of w^(n+2).
    square_[n + 2] = 2.0 / (n + 2) * (skewness_ * s_[n] - variance_ * square_[n]);
    double s = 0.5 * square_[n + 2];
    for (int i = 2; 2 * i < n + 2; ++i)
      s -= s_[i] * s_[n + 2 - i];
    if (n % 2 == 0) s -= 0.5 * s_[n / 2 + 1] * s_[n / 2 + 1];
    s_[n + 1] = s;
    double g = -s;
    for (int i = 1; i < n; ++i)
      g -= g_[i] * s_[n + 1 - i];
    g_[n] = g;
    return g;
  }

 private:
  double skewness_;
  double variance_;
  double square_[kCount + 3] = {0.0, 0.0, 1.0};
  double s_[kCount + 2] = {0.0, 1.0};
  double g_[kCount + 1] = {1.0};
};

double NormalExpansion(const BetaCase& c) {
  const double a = c.a;
  const double b = c.b;
  const DoubleDouble deviance = BetaDeviance(c.at, a, b);
  const double correction = StirlingError(a) + StirlingError(b) - StirlingError(a + b);
  const double size = a / (a + b) * b;
  const double inverse = 1.0 / size;
  const double w = std::sqrt(2.0 * deviance.high * inverse);
  NormalSeries series(a, b);
  // Integrals of sqrt(M / (2 pi)) w^n e^(-M w^2 / 2) over the exponential at the lower end, begun with n = 0.
  double before = 0.5 * ScaledErfc(std::sqrt(deviance.high));
  double power = std::sqrt(size / kTwoPi);
  double integral = power * inverse;
  double sum = before;
  // Every other term is 0 when a = b.
  double last = sum;
  for (int n = 1; n <= NormalSeries::kCount; ++n) {
    const double term = series.Next(n) * integral;
    sum += term;
    if (std::fabs(last) + std::fabs(term) <= kPowerSumPrecision * sum) break;
    last = term;
    power *= w;
    const double next = (power + n * before) * inverse;
    before = integral;
    integral = next;
  }
  return ExpMinus(deviance + correction) * sum;
}

// The expansion for large a after as many steps of the recurrence as it takes to get there.
double ExpandLargeA(const BetaCase& c) {
  if (c.a > 15.0) return LargeAExpansion(c, 0);
  constexpr int kSteps = 20;
  return ForwardSum(c, kSteps) + LargeAExpansion(c, kSteps);
}

struct Tail {
  double ratio;
  bool is_upper;
};

// min(a, b) <= 1, x <= 1/2.
Tail FindSmallShape(const BetaCase& c) {
  if (c.a > 1.0 || c.b > 1.0) {
    if (c.b <= 1.0) return {ForwardSum(c, kTermLimit), false};
    if (c.at.x.high >= 0.29) return {ForwardSum(c.Reflected(), kTermLimit), true};
    // With x so small the sum in x is short, and its result is not so close to 1 that the rest would be lost.
    if (c.at.x.high < 0.3 && c.b * c.at.x.high <= 0.7 && std::pow(c.at.x.high * c.b, c.a) <= 0.6) {
      return {ForwardSum(c, kTermLimit), false};
    }
    return {ExpandLargeA(c.Reflected()), true};
  }
  if (c.a >= std::min(0.2, c.b) || std::pow(c.at.x.high, c.a) <= 0.7)
    return {ForwardSum(c, kTermLimit), false};
  if (c.at.x.high >= 0.3) return {ForwardSum(c.Reflected(), kTermLimit), true};
  return {ExpandLargeA(c.Reflected()), true};
}

// a, b > 1, x below the mean.
double FindLargeShape(const BetaCase& c) {
  const double small = std::min(c.a, c.b);
  const double x = c.at.x.high;
  if (c.b * x <= 0.7 || (c.a < 20.0 && x <= 0.5)) return ForwardSum(c, kTermLimit);
  if (small > kNormalShape && -c.at.deviation.high <= 0.4 * small) return NormalExpansion(c);
  if (c.b < 40.0) {
    // Down to the last part of b that is above 0.
    const int steps = static_cast<int>(std::ceil(c.b)) - 1;
    const double sum = BackwardSum(c, steps);
    const BetaCase rest = {{c.at.x, c.at.y, c.at.deviation - c.at.x * steps}, c.a, c.b - steps};
    return sum + (c.at.x.high <= 0.7 ? ForwardSum(rest, kTermLimit) : ExpandLargeA(rest));
  }
  return Fraction(c);
}

Tail FindTail(const BetaCase& c) {
  if (std::min(c.a, c.b) > 1.0) {
    return c.at.deviation.high <= 0.0 ? Tail{FindLargeShape(c), false}
                                      : Tail{FindLargeShape(c.Reflected()), true};
  }
  if (c.at.x.high <= 0.5) return FindSmallShape(c);
  const Tail tail = FindSmallShape(c.Reflected());
  return {tail.ratio, !tail.is_upper};
}

}  // namespace

BetaPoint MakeBetaPoint(double x, double a, double b) {
  return {x, AddExactly(1.0, -x), MultiplyExactly(a, x) - a + MultiplyExactly(b, x)};
}

double LogBeta(double a, double b) {
  const double small = std::min(a, b);
  const double large = std::max(a, b);
  if (large < 1.0) return LogGamma(a) + LogGamma(b) - LogGamma(a + b);
  return LogGamma(small) - small * std::log(large) - LogGammaGrowth(small, large);
}

double BetaPower(const BetaPoint& point, double a, double b) {
  if (a < 1.0 && b < 1.0) return PowerOfSmallBoth(point.x.high, point.y.high, a, b);
  if (a < 1.0) return PowerOfSmallA(point.x, point.y, a, b);
  if (b < 1.0) return PowerOfSmallA(point.y, point.x, b, a);
  const double correction = StirlingError(a) + StirlingError(b) - StirlingError(a + b);
  return std::sqrt(a / (a + b) * (b / kTwoPi)) * ExpMinus(BetaDeviance(point, a, b) + correction);
}

double BetaRatio(const BetaPoint& point, double a, double b, bool upper) {
  const Tail tail = FindTail({point, a, b});
  const double ratio = std::min(1.0, tail.ratio);
  return tail.is_upper == upper ? ratio : 1.0 - ratio;
}

}  // namespace MCMath_800
