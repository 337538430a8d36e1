#include "kestrel/math/NonCentralSaddle.h"

#include <algorithm>
#include <cmath>
#include <complex>

#include "kestrel/math/Polynomial.h"
#include "kestrel/math/SaddlePoint.h"

namespace MCMath_800 {

namespace {

constexpr DoubleDouble kPi = {3.14159265358979323846, 1.2246467991473531772e-16};

using Complex = std::complex<double>;

/// (x - atan(x)) / x^3 in x^2.
constexpr double kArcSeries[] = {1.0 / 3,   -1.0 / 5, 1.0 / 7,   -1.0 / 9, 1.0 / 11,  -1.0 / 13, 1.0 / 15,
                                 -1.0 / 17, 1.0 / 19, -1.0 / 21, 1.0 / 23, -1.0 / 25, 1.0 / 27,  -1.0 / 29};

/// z - ln(1 + z), without the cancellation of small z, or of the square of large ones.
Complex Deviance(const Complex& z) {
  const double x = z.real(), y = z.imag();
  const double norm = x * x + y * y;
  const double stretch = 2.0 * x + norm;
  const bool near = std::fabs(stretch) <= 0.5;
  const double real = near ? 0.5 * (LogDeviance(stretch) - norm) : x - 0.5 * std::log1p(stretch);
  const double slant = y / (1.0 + x);
  if (x < -0.5 || std::fabs(slant) > 0.3) return {real, y - std::atan2(y, 1.0 + x)};
  const double square = slant * slant;
  return {real, slant * (x + square * Polynomial(kArcSeries, square))};
}

Complex Reciprocal(const Complex& z) {
  const double inverse = 1.0 / (z.real() * z.real() + z.imag() * z.imag());
  return {z.real() * inverse, -z.imag() * inverse};
}

/// The product of finite numbers: the operator looks for infinities.
double RealOfProduct(const Complex& a, const Complex& b) {
  return a.real() * b.real() - a.imag() * b.imag();
}
Complex Product(const Complex& a, const Complex& b) {
  return {RealOfProduct(a, b), a.real() * b.imag() + a.imag() * b.real()};
}

/// The line that the integral is taken on: t with 2 t / (1 - 2 t) = u at its real point.
struct Line {
  double u;  ///< 0 where the line leads through the pole
  double w;
  double part;
  double tilt;            ///< the cumulant function's slope in z, which is 0 at the saddle point
  DoubleDouble exponent;  ///< the cumulant function there, without its sign
};

/// The cumulant function's second derivative in z at the saddle point.
double SpreadAt(const ChiQuotient& q, double nc, const ChiSaddle& saddle) {
  return 0.5 * (q.df1 + q.df2 * saddle.part * saddle.part) + nc * saddle.w;
}

/// The cumulant function at 2 t / (1 - 2 t) = u, without its sign. Near the mean every term is small.
DoubleDouble ExponentAt(const ChiQuotient& q, DoubleDouble nc, double u) {
  const DoubleDouble w = AddExactly(1.0, u);
  const DoubleDouble v = q.odds * u / w;
  if (v.high > 1.0 || v.high < -0.5) return (Log(v + 1.0) * q.df2 - Log(w) * q.df1 - nc * u) * 0.5;
  const DoubleDouble mean = nc + q.df1;
  const DoubleDouble twice =
      LogDeviance(Split(u)) * q.df1 + DoubleDouble(u) / w * ((q.bound - mean) - mean * u);
  return (q.df2 > 0.0 ? twice - LogDeviance(Split(v)) * q.df2 : twice) * 0.5;
}

/// The line through the saddle point; through the pole at t = 0 when that is close, or a little beside it
/// when the saddle point is on its wrong side.
Line ChooseLine(const ChiQuotient& q, DoubleDouble exact_nc, const ChiSaddle& saddle, bool upper) {
  const double nc = exact_nc.high;
  Line line{};
  if (!IsCloseToPole(q, nc, saddle)) {
    // Not far towards the next singularities: below the pole there is one at u = -y.
    const double room = std::min(1.0 / std::max(saddle.part, 1e-300), upper ? 1.0 : q.y);
    const double gap = std::min(1.0 / std::sqrt(SpreadAt(q, nc, saddle)), 0.3 * room);
    if (std::fabs(saddle.u) >= gap && (saddle.u > 0.0) == upper)
      return {saddle.u, saddle.w, saddle.part, 0.0, ExponentAt(q, exact_nc, saddle.u)};
    line.u = upper ? gap : -gap;
    line.exponent = ExponentAt(q, exact_nc, line.u);
  }
  line.w = 1.0 + line.u;
  const double slant = q.df1 + nc * line.w;
  const double divisor = line.w + q.odds.high * line.u;
  const double below = (exact_nc + q.df1 - q.bound).high;
  line.part = q.df2 > 0.0 ? q.odds.high / divisor : 0.0;
  line.tilt = 0.5 * (below + line.u * (slant + nc + slant * q.odds.high)) / divisor;
  return line;
}

/// The places y = reach sinh(theta) of a trapezoidal rule, with their derivatives in theta, at a step's
/// multiples or, for `halved`, at its odd halves. Sines and cosines go on by their addition theorem: nothing
/// cancels. The step's sine is the rounded number, its cosine has what rounding leaves, or the two would
/// drift apart.
class SineSteps {
 public:
  SineSteps(double reach, double step, bool halved) : turn_(std::sinh(step)) {
    const DoubleDouble keep_square = MultiplyExactly(turn_, turn_) + 1.0;
    keep_ = std::sqrt(keep_square.high);
    keep_rest_ = (keep_square - MultiplyExactly(keep_, keep_)).high / (2.0 * keep_);
    step_ = Log(DoubleDouble(keep_, keep_rest_) + turn_);
    const double twice = 1.0 + keep_;
    y_ = halved ? -reach * turn_ / std::sqrt(2.0 * twice) : 0.0;
    rate_ = halved ? reach * std::sqrt(0.5 * twice) : reach;
  }

  void Next() {
    const double before = y_;
    y_ = keep_ * y_ + (turn_ * rate_ + keep_rest_ * y_);
    rate_ = keep_ * rate_ + (turn_ * before + keep_rest_ * rate_);
  }
  double Y() const { return y_; }
  double Rate() const { return rate_; }
  DoubleDouble Step() const { return step_; }

 private:
  double turn_;
  double keep_;
  double keep_rest_;
  DoubleDouble step_;
  double y_;
  double rate_;
};

}  // namespace

double SaddleDeviance(double u, double w) {
  return u > -0.5 ? LogDeviance(u) : u - std::log(w);
}

ChiQuotient ChiAgainstNumber(double df, double x) {
  return {df, 0.0, 0.0, x, 1.0};
}

ChiQuotient ChiAgainstChi(double df1, double df2, DoubleDouble odds) {
  return {df1, df2, odds, odds * df2, 1.0 / (1.0 + odds.high)};
}

// The saddle point solves a quadratic equation, of which the positive root w is taken; u has one of its own,
// so that nothing cancels.
ChiSaddle FindSaddle(const ChiQuotient& q, double nc) {
  const double x = q.odds.high * q.y;
  const double lead = q.df1 - nc * x;
  const double rest = x * q.df1 + q.bound.high * q.y;
  const double root = std::sqrt(lead * lead + 4.0 * nc * rest);
  const double above = (q.bound - AddExactly(q.df1, nc)).high;
  double u = 2.0 * (above * q.y) / (q.df1 + nc * (1.0 + q.y) + root);
  if (u == 0.0) u = 1e-20;
  const double w = lead > 0.0 ? 2.0 * rest / (lead + root) : 0.5 * (root - lead) / nc;
  double deviance = q.df1 * SaddleDeviance(u, w) + nc * u * u;
  if (q.df2 == 0.0) return {u, w, 0.0, deviance};
  const double part = (q.df1 + nc * w) / q.df2;
  deviance += q.df2 * SaddleDeviance(-u * part, w * part / q.odds.high);
  return {u, w, part, deviance};
}

bool IsCloseToPole(const ChiQuotient& q, double nc, const ChiSaddle& saddle) {
  // In deviations, and in the distance of the singularity below the pole: beyond these the line is too far
  // from the saddle point to converge as fast.
  return std::fabs(saddle.u) < 2.0 * q.y && saddle.u * saddle.u * SpreadAt(q, nc, saddle) < 0.25;
}

bool ReachesBothSides(const ChiQuotient& q, double nc, const ChiSaddle& saddle) {
  // The distance of that singularity in deviations at the pole; below a third the integral fails.
  const double x = q.odds.high * q.y;
  return saddle.u < 0.0 || std::sqrt(0.5 * q.df2 * x * x + (0.5 * q.df1 + nc) * q.y * q.y) > 0.35;
}

// The tail is an integral of e^K(t) / t over a path across the real axis, K the cumulant function (S. O. Rice
// 1980, "Distribution of quadratic forms in normal random variables - evaluation by numerical integration").
// With 1 - 2 t = (1 - z) / w the saddle point is at z = 0. The path z = i y - bend y^2 follows the steepest
// descent there, so that nothing oscillates. The trapezoidal rule in theta, y = reach sinh(theta), converges
// exponentially; the pole of 1 / t, which may be near, is taken out by its residue. Through the pole the rule
// has nodes on both sides of it, where what is infinite cancels, and each side has half the residue: whatever
// the share, only its distance from 1/2 is rounded.
NonCentralTail IntegrateSaddle(const ChiQuotient& q, DoubleDouble nc, const ChiSaddle& saddle, bool upper,
                               SumCare care) {
  const double digits = care == SumCare::kRough ? 15.0 : 36.0;
  const Line line = ChooseLine(q, nc, saddle, upper);
  const double pull = nc.high * line.w;
  const double spread = 0.5 * (q.df1 + q.df2 * line.part * line.part) + pull;
  const double scale = std::sqrt(spread);
  const double bend = (q.df2 * line.part * line.part * line.part - q.df1 - 3.0 * pull) / (6.0 * spread);
  // Where 1 - z, 1 + part z and u + z are 0, on the imaginary axis of y, or how far from it when beside it.
  const auto height = [bend](double z) {
    const double inside = 1.0 + 4.0 * bend * z;
    return inside > 0.0 ? 2.0 * std::fabs(z) / (1.0 + std::sqrt(inside)) : 0.5 / std::fabs(bend);
  };
  const double reach =
      0.85 * (line.part > 0.0 ? std::min(height(1.0), height(-1.0 / line.part)) : height(1.0));
  // Inside a strip of that width the integrand grows at most as e to the power of the square below.
  const double strip = std::min(0.7, 6.0 / (scale * reach));
  const double growth = scale * reach * strip;
  const bool through_pole = line.u == 0.0;
  SineSteps steps(reach, 2.0 * kPi.high * strip / (digits + growth * growth), through_pole);
  DoubleDouble share;
  double slope = 0.0, curve = 0.0;
  if (!through_pole) {
    share = 0.5 * reach / line.u;
    slope = 0.5 * reach;
    curve = 0.25 * reach * line.u;
  }
  constexpr int kNodeLimit = 500;
  for (int node = 0; node < kNodeLimit; ++node) {
    steps.Next();
    const double y = steps.Y();
    const Complex z(-bend * y * y, y);
    const Complex inverse = Reciprocal(1.0 - z);
    Complex exponent = 0.5 * (q.df1 * Deviance(-z) + pull * Product(Product(z, z), inverse)) + line.tilt * z;
    if (q.df2 > 0.0) exponent += 0.5 * q.df2 * Deviance(line.part * z);
    const double weight = steps.Rate() * std::exp(exponent.real());
    const Complex turned(weight * std::cos(exponent.imag()), weight * std::sin(exponent.imag()));
    const Complex power = Product(turned, {1.0, 2.0 * bend * y});
    const Complex change = Product(power, inverse);
    const DoubleDouble sum = AddExactly(share.high, RealOfProduct(power, Reciprocal(line.u + z)));
    share = {sum.high, share.low + sum.low};
    slope += change.real();
    curve += 0.5 * RealOfProduct(change, line.w * inverse - 1.0);
    if (exponent.real() < -digits) break;
  }
  const DoubleDouble front = steps.Step() / kPi * GuardedExpMinus(line.exponent);
  double residue = 0.5;
  if (!through_pole) {
    const double distance = std::asin(std::min(1.0, height(-line.u) / reach));
    residue = distance < strip ? -1.0 / std::expm1(2.0 * kPi.high * distance / steps.Step().high) : 0.0;
  }
  const double sign = upper ? 1.0 : -1.0;
  const double density = sign * 0.5 * front.high;
  return {(AddOrdered(share.high, share.low) * front * sign + residue).high, density * slope,
          density * curve};
}

}  // namespace MCMath_800
