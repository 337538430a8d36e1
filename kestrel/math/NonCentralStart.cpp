// The approximations are O. E. Barndorff-Nielsen's r* (1986, "Inference on full or partial parameters based
// on the standardized signed log likelihood ratio"), for whose saddle points there are closed forms: see S.
// Broda and M. S. Paolella (2007, "Saddlepoint approximations for the doubly noncentral t distribution") and
// R. W. Butler and M. S. Paolella (2002, "Calculating the density and distribution function for the singly
// and doubly noncentral F").

#include "kestrel/math/NonCentralStart.h"

#include <algorithm>
#include <cmath>

#include "kestrel/math/NonCentralSaddle.h"

namespace MCMath_800 {

namespace {

/// The normal quantile of a probability, about, and its derivative in the parameter.
struct Score {
  double value;
  double slope;
};

/// r is the root of twice the exponent that the probability has lost, q what the density's shape makes of it.
double Corrected(double r, double q) {
  return r + std::log(q / r) / r;
}

/// Below this root the correction's quotients cancel.
constexpr double kSmallRoot = 1e-3;

/// Chi-square against its bound.
struct QuotientModel {
  ChiQuotient quotient;

  Score At(double nc) const {
    const ChiSaddle saddle = FindSaddle(quotient, nc);
    const double w = saddle.w, part = saddle.part;
    const double slant = quotient.df1 + nc * w;
    // The second and third cumulant, in units of 2 w^2 and 8 w^3.
    const double variance = slant + nc * w + slant * part;
    const double third = slant + 2.0 * nc * w - slant * part * part;
    const double deviation = std::sqrt(2.0 * variance);
    const double r = std::copysign(std::sqrt(saddle.deviance), saddle.u);
    const double slope = -0.5 * saddle.u / r;
    if (std::fabs(r) < kSmallRoot) return {r + 2.0 / 3.0 * third / (variance * deviation), slope};
    return {Corrected(r, 0.5 * saddle.u * deviation), slope};
  }
};

/// t, whose numerator's square is chi-square with one degree of freedom.
struct StudentModel {
  double x;
  double df;

  Score At(double nc) const {
    const double lean = x * nc;
    const double both = df + x * x;
    const double root = std::sqrt(lean * lean + 4.0 * df * both);
    const double s = lean > 0.0 ? 0.5 * (lean + root) / both : 2.0 * df / (root - lean);
    // x s - nc, and the same where x s has lost its digits.
    const double a = x * x > df ? df * ((1.0 - s) * (1.0 + s)) / (s * x) : x * s - nc;
    const double square = a * a + df * SaddleDeviance((s - 1.0) * (s + 1.0), s * s);
    const double r = std::copysign(std::sqrt(square), a);
    // The correction changes little on the way out of its gap.
    if (std::fabs(r) < kSmallRoot) {
      const double slope = -1.0 / std::hypot(1.0, x / std::sqrt(2.0 * df));
      const double aside = -4.0 * kSmallRoot / slope;
      return {At(nc + aside).value - slope * aside, slope};
    }
    return {Corrected(r, s * a * std::sqrt((both + df / (s * s)) / (2.0 * df))), -a / r};
  }
};

/// Newton's method inside a bracket, which it halves on the scale of asinh where it leaves it.
template <class Model>
double Solve(const Model& model, double z, double low, double high, double start) {
  constexpr int kStepLimit = 40;
  // The approximation itself is no better.
  constexpr double kClose = 1e-3;
  double at = std::min(std::max(start, low), high);
  for (int step = 0; step < kStepLimit; ++step) {
    const Score score = model.At(at);
    const double away = score.value - z;
    if (std::fabs(away) < kClose) return at;
    (away > 0.0 ? low : high) = at;
    double next = at - away / score.slope;
    if (!(next > low && next < high)) next = std::sinh(0.5 * (std::asinh(low) + std::asinh(high)));
    if (next == at) break;
    at = next;
  }
  return at;
}

}  // namespace

double StartStudentParameter(double z, double x, double df) {
  // Squares of larger numbers are no numbers.
  constexpr double kFarX = 1e140;
  x = std::min(std::max(x, -kFarX), kFarX);
  const double spread = std::hypot(1.0, x / std::sqrt(2.0 * df));
  return Solve(StudentModel{x, df}, z, -kLargestStudentParameter, kLargestStudentParameter, x - z * spread);
}

double StartChiParameter(double z, double x, double df) {
  const double m = std::sqrt(std::max(x - 0.5 * df, 0.0)) - z;
  return Solve(QuotientModel{ChiAgainstNumber(df, x)}, z, 0.0, kLargestChiParameter, m * m - 0.5 * df);
}

double StartFParameter(double z, double ratio, double df1, double df2) {
  const double m = std::sqrt(std::max(ratio * df2 - 0.5 * df1, 0.0)) - z;
  return Solve(QuotientModel{ChiAgainstChi(df1, df2, ratio)}, z, 0.0, kLargestChiParameter,
               m * m - 0.5 * df1);
}

}  // namespace MCMath_800
