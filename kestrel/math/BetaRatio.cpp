// The choice of methods follows A. R. DiDonato and A. H. Morris, "Algorithm 708: significant digit
// computation of the incomplete beta function ratios", ACM TOMS 18 (1992) 360-373. Powers and sums are
// arranged anew: powers by their deviance from the mean, sums with terms of one sign.

#include "kestrel/math/BetaRatio.h"

#include <algorithm>
#include <cmath>

#include "kestrel/math/ErrorFunction.h"
#include "kestrel/math/GammaRatio.h"
#include "kestrel/math/MCPower.h"
#include "kestrel/math/SaddlePoint.h"

namespace MCMath_800 {
namespace {

constexpr double kTwoPi = 6.28318530717958647693;
constexpr double kTwoOverSqrtPi = 1.12837916709551257390;
constexpr double kPrecision = MCPower::gMachineEpsilon / 4.0;

// Far more terms than any sum below needs where it is used; the limit is there for the reader's peace.
constexpr int kTermLimit = 2000;

// Up to here the continued fraction takes less time than the expansion's coefficients.
constexpr double kNormalShape = 1000.0;

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
         GuardedExpMinus(-(LogOf(y, x) * b + LogGammaGrowth(a, b)));
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

// 1 + t_1 + t_1 t_2 + ..., summed with what the additions round off. Every factor t has the same number in
// it: what that has beyond a double moves the n-th product by n times as much.
class PowerSum {
 public:
  explicit PowerSum(DoubleDouble common) : excess_(common.low / common.high) {}

  bool Counts() const { return term_ > kPrecision * sum_.high; }
  void Add(double factor) {
    term_ *= factor;
    index_ += 1.0;
    const DoubleDouble sum = AddExactly(sum_.high, term_);
    sum_ = {sum.high, sum_.low + sum.low};
    moment_ += index_ * term_;
  }
  double Value() const { return sum_.high + (sum_.low + excess_ * moment_); }

 private:
  double excess_;
  double term_ = 1.0;
  double index_ = 0.0;
  double moment_ = 0.0;
  DoubleDouble sum_ = 1.0;
};

// I_x(a, b) - I_x(a + count, b), from the recurrence in a; with enough terms it is I_x(a, b) itself. For b <=
// 1, or x below the mean.
double ForwardSum(const BetaCase& c, int count) {
  PowerSum sum(c.at.x);
  double n = c.a;
  for (int i = 1; i < count && sum.Counts(); ++i) {
    sum.Add(c.at.x.high * ((n + c.b) / (n + 1.0)));
    n += 1.0;
  }
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
    sum.Add(inverse.high * (b / (c.a + b - 1.0)));
    b -= 1.0;
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
  const GammaShare gamma = FindGammaShare(exact_z, b, true);
  if (gamma.power == 0.0) return 0.0;
  const double scale = gamma.power * std::exp(LogGammaGrowth(b, a) - b * std::log1p(shift.high / a));
  const double v = 0.25 / nu / nu;
  const double square = 0.25 * log_x * log_x;
  double coefficients[kTerms];
  double weights[kTerms];
  double j = gamma.ratio / gamma.power;
  double sum = j;
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
    if (std::fabs(term) <= kPrecision * sum) break;
  }
  return scale * sum;
}

// The continued fraction of section 4, for a, b > 1 and x below the mean.
double Fraction(const BetaCase& c) {
  const double power = c.Power();
  if (power == 0.0) return 0.0;
  const double a = c.a;
  const double b = c.b;
  const double x = c.at.x.high;
  const double first = 1.0 - c.at.deviation.high;
  double inverse = 1.0 / (a + 1.0);
  double above = 0.0, below = 1.0;
  double next_above = 1.0, next_below = a * first * inverse;
  for (int i = 1; i < kTermLimit; ++i) {
    const double n = i;
    const double step = n * ((b - n) * x) * inverse;
    const double alpha = (a + n - 1.0) * inverse * ((a + b + n - 1.0) * x) * step;
    inverse = 1.0 / (a + 2.0 * n + 1.0);
    const double beta = n + step + (a + n) * inverse * (first + n * (1.0 + c.at.y.high));
    const double new_above = alpha * above + beta * next_above;
    const double new_below = alpha * below + beta * next_below;
    // Two convergents agree when their cross products do; a division only when the numbers grow.
    const double left = new_above * next_below;
    const bool agree = std::fabs(left - next_above * new_below) <= 2.0 * kPrecision * left;
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
  return power * (next_above / next_below);
}

// The coefficients d_n of the expansion below, one by one; they depend on the shapes alone.
class NormalCoefficients {
 public:
  static constexpr int kCount = 22;

  NormalCoefficients(double a, double b) {
    const double large = std::max(a, b);
    ratio_ = std::min(a, b) / large;
    even_ = 2.0 / (1.0 + ratio_);
    odd_ = 2.0 * ((b - a) / large);
    a_[0] = odd_ / 3.0;
    c_[0] = -0.5 * a_[0];
    d_[0] = -c_[0];
  }

  double First() const { return d_[0]; }

  /// d_n and d_n+1, for n = 2, 4, ... in turn.
  void Next(int n, double& even, double& odd) {
    ratio_power_ *= ratio_ * ratio_;
    a_[n - 1] = even_ * (1.0 + ratio_ * ratio_power_) / (n + 2.0);
    ratio_sum_ += ratio_power_;
    a_[n] = odd_ * ratio_sum_ / (n + 3.0);
    even = Add(n);
    odd = Add(n + 1);
  }

 private:
  double Add(int i) {
    double b[kCount];
    const double r = -0.5 * (i + 1.0);
    b[0] = r * a_[0];
    for (int m = 2; m <= i; ++m) {
      double inner = 0.0;
      for (int j = 1; j < m; ++j)
        inner += (j * r - (m - j)) * a_[j - 1] * b[m - j - 1];
      b[m - 1] = r * a_[m - 1] + inner / m;
    }
    c_[i - 1] = b[i - 1] / (i + 1.0);
    double inner = c_[i - 1];
    for (int j = 1; j < i; ++j)
      inner += d_[i - j - 1] * c_[j - 1];
    d_[i - 1] = -inner;
    return d_[i - 1];
  }

  double ratio_;
  double ratio_power_ = 1.0;
  double ratio_sum_ = 1.0;
  double even_;
  double odd_;
  double a_[kCount];
  double c_[kCount];
  double d_[kCount];
};

// The asymptotic expansion for large a and b near the mean, section 10.
double NormalExpansion(const BetaCase& c) {
  constexpr double kStep = 0.35355339059327376220;  // 2^(-3/2)
  const double a = c.a;
  const double b = c.b;
  const DoubleDouble exact_deviance = BetaDeviance(c.at, a, b);
  const double deviance = exact_deviance.high;
  const double correction = StirlingError(a) + StirlingError(b) - StirlingError(a + b);
  const double z = std::sqrt(deviance);
  const double width = std::sqrt(std::max(a, b) / std::min(a, b) / (a + b));
  NormalCoefficients coefficients(a, b);
  double even_integral = 0.5 / kTwoOverSqrtPi * ScaledErfc(z);
  double odd_integral = kStep;
  double even_power = 0.5 * z / kStep;
  double odd_power = 2.0 * deviance;
  double weight = width;
  double sum = even_integral + coefficients.First() * width * odd_integral;
  for (int n = 2; n < NormalCoefficients::kCount; n += 2) {
    double even, odd;
    coefficients.Next(n, even, odd);
    even_integral = kStep * even_power + (n - 1.0) * even_integral;
    odd_integral = kStep * odd_power + n * odd_integral;
    even_power *= 2.0 * deviance;
    odd_power *= 2.0 * deviance;
    weight *= width;
    const double first = even * weight * even_integral;
    weight *= width;
    const double second = odd * weight * odd_integral;
    sum += first + second;
    if (std::fabs(first) + std::fabs(second) <= kPrecision * sum) break;
  }
  return kTwoOverSqrtPi * GuardedExpMinus(exact_deviance + correction) * sum;
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
    if (c.at.x.high < 0.1 && c.b * c.at.x.high <= 0.7 && std::pow(c.at.x.high * c.b, c.a) <= 0.7) {
      return {ForwardSum(c, kTermLimit), false};
    }
    return {ExpandLargeA(c.Reflected()), true};
  }
  if (c.a >= std::min(0.2, c.b) || std::pow(c.at.x.high, c.a) <= 0.9)
    return {ForwardSum(c, kTermLimit), false};
  if (c.at.x.high >= 0.3) return {ForwardSum(c.Reflected(), kTermLimit), true};
  return {ExpandLargeA(c.Reflected()), true};
}

// a, b > 1, x below the mean.
double FindLargeShape(const BetaCase& c) {
  const double small = std::min(c.a, c.b);
  if (c.b < 40.0) {
    if (c.b * c.at.x.high <= 0.7) return ForwardSum(c, kTermLimit);
    // Down to the last part of b that is above 0.
    const int steps = static_cast<int>(std::ceil(c.b)) - 1;
    const double sum = BackwardSum(c, steps);
    const BetaCase rest = {{c.at.x, c.at.y, c.at.deviation - c.at.x * steps}, c.a, c.b - steps};
    return sum + (c.at.x.high <= 0.7 ? ForwardSum(rest, kTermLimit) : ExpandLargeA(rest));
  }
  if (small <= kNormalShape || -c.at.deviation.high > 0.03 * small) return Fraction(c);
  return NormalExpansion(c);
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
  return std::sqrt(a / (a + b) * (b / kTwoPi)) * GuardedExpMinus(BetaDeviance(point, a, b) + correction);
}

double BetaRatio(const BetaPoint& point, double a, double b, bool upper) {
  const Tail tail = FindTail({point, a, b});
  const double ratio = std::min(1.0, tail.ratio);
  return tail.is_upper == upper ? ratio : 1.0 - ratio;
}

}  // namespace MCMath_800
