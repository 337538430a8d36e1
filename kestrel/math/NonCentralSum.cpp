#include "kestrel/math/NonCentralSum.h"

#include <algorithm>
#include <cmath>

#include "kestrel/math/BetaRatio.h"
#include "kestrel/math/GammaRatio.h"

namespace MCMath_800 {

namespace {

/// What a term adds to the sum at least before the rest is left out.
constexpr double kNegligible = 1e-17;
/// Above it, drops and shares have all their digits. What is below belongs to sums of less than 1e-300.
constexpr double kSmall = 1e-303;

/// The distribution functions P(s) of a gamma distribution as its shape s grows by ones. What P loses from s
/// to s + 1 is its drop.
class GammaFamily {
 public:
  explicit GammaFamily(double x) : x_(x) {}
  double Drop(double s) const { return GammaPower(x_, s) / s; }
  /// Drop(s + 1) / Drop(s).
  double Growth(double s) const { return x_ / (s + 1.0); }
  /// 1 / Growth(s), in one division that need not wait for another.
  double Shrinkage(double s) const { return (s + 1.0) / x_; }
  double Ratio(double s, bool upper) const { return GammaRatio(x_, s, upper); }
  /// What the second derivative of ln Drop is, without its sign.
  double Curvature(double s) const { return 1.0 / s; }
  /// The u at which Growth(start + u) * lambda / (u + 1) falls below 1.
  double Peak(double start, double lambda) const {
    return 2.0 * lambda * x_ / (start + std::sqrt(start * start + 4.0 * lambda * x_));
  }

 private:
  double x_;
};

class BetaFamily {
 public:
  BetaFamily(double x, double y, double b) : x_(x), y_(y), b_(b) {}
  double Drop(double s) const { return BetaPower(Point(s), s, b_) / s; }
  double Growth(double s) const { return x_ * (s + b_) / (s + 1.0); }
  double Shrinkage(double s) const { return (s + 1.0) / (x_ * (s + b_)); }
  double Ratio(double s, bool upper) const { return BetaRatio(Point(s), s, b_, upper); }
  double Curvature(double s) const { return b_ / (s * (s + b_)); }
  double Peak(double start, double lambda) const {
    const double lead = start - lambda * x_;
    const double product = lambda * x_ * (start + b_);
    const double root = std::sqrt(lead * lead + 4.0 * product);
    return lead > 0.0 ? 2.0 * product / (lead + root) : 0.5 * (root - lead);
  }

 private:
  BetaPoint Point(double s) const { return {x_, y_, b_ * x_ - s * y_}; }

  double x_;
  double y_;
  double b_;
};

/// w(u) P(start + u) with w(u) = e^-lambda lambda^u / Gamma(u + 1), u = first, first + 1, ...
template <class Family>
class Mixture {
 public:
  Mixture(const Family& family, double start, double lambda)
      : family_(family), start_(start), lambda_(lambda), peak_(family.Peak(start, lambda)) {
    const double u = peak_ + 1.0;
    width_ = 1.0 / std::sqrt(1.0 / u + family.Curvature(start + u));
  }

  /// About how many terms count.
  double Length() const { return 8.7 * (width_ + std::sqrt(peak_ + 1.0)); }

  double Sum(double first, bool upper) const {
    const double u = first + std::floor(std::max(0.0, peak_ - first));
    const double scale = Weight(u) * family_.Drop(start_ + u);
    if (!(scale > 0.0)) return 0.0;
    return scale * (upper ? UpperRun(first, u) : LowerRun(first, u));
  }

  /// The sum of the whole smooth curve: the trapezoidal rule, whose error falls off like e^-(2 pi^2) to the
  /// power (width / step)^2 (Trefethen and Weideman 2014, "The exponentially convergent trapezoidal rule").
  double Integral(bool upper) const {
    const double step = 0.8 * width_;
    double sum = Term(peak_, upper);
    for (const double way : {step, -step}) {
      double before = sum;
      for (double u = peak_ + way; u > 0.0; u += way) {
        const double term = Term(u, upper);
        sum += term;
        // The largest term need not be the first.
        if (term <= 1e-14 * sum && term <= before) break;
        before = term;
      }
    }
    return step * sum;
  }

 private:
  double Weight(double u) const { return GammaPower(lambda_, u + 1.0) / lambda_; }
  double Term(double u, bool upper) const { return Weight(u) * family_.Ratio(start_ + u, upper); }

  /// The share at u over its drop. Where both are too small for a quotient the drops' sum has few terms.
  double LowerQuotient(double u) const {
    const double s = start_ + u;
    const double growth = family_.Growth(s);
    if (growth > 0.8) {
      const double drop = family_.Drop(s);
      if (drop > kSmall) return family_.Ratio(s, false) / drop;
    }
    double sum = 1.0, term = 1.0;
    constexpr int kTermLimit = 2000;
    for (int i = 0; i < kTermLimit && term > kNegligible * sum; ++i) {
      term *= family_.Growth(s + i);
      sum += term;
    }
    return sum;
  }

  /// From the last term that counts down: each share is the one above it plus a drop, so nothing cancels.
  /// Everything is in units of the weight and the drop at u.
  double LowerRun(double first, double u) const {
    double weight = 1.0, drop = 1.0, at = u;
    while (weight * drop > kNegligible) {
      weight *= lambda_ / (at + 1.0);
      drop *= family_.Growth(start_ + at);
      at += 1.0;
    }
    double share = drop * LowerQuotient(at);
    double sum = weight * share;
    while (at > first && (at > u || weight * share > kNegligible * sum)) {
      weight *= at / lambda_;
      at -= 1.0;
      drop *= family_.Shrinkage(start_ + at);
      share += drop;
      sum += weight * share;
    }
    return sum;
  }

  /// The same from the first term that counts up.
  double UpperRun(double first, double u) const {
    double weight = 1.0, drop = 1.0, at = u;
    while (at > first && weight * drop > kNegligible) {
      weight *= at / lambda_;
      at -= 1.0;
      drop *= family_.Shrinkage(start_ + at);
    }
    const double exact = family_.Drop(start_ + at);
    double share = exact > kSmall ? drop * (family_.Ratio(start_ + at, true) / exact) : 0.0;
    double sum = weight * share;
    while (at <= u || weight * share > kNegligible * sum) {
      share += drop;
      weight *= lambda_ / (at + 1.0);
      drop *= family_.Growth(start_ + at);
      at += 1.0;
      sum += weight * share;
    }
    return sum;
  }

  Family family_;
  double start_;
  double lambda_;
  double peak_;
  double width_;
};

/// From here on the quadrature, some thirty distribution functions, is the shorter way.
constexpr double kManyTerms = 2000.0;

template <class Family>
double SumOf(const Family& family, double a, double lambda, bool upper) {
  const Mixture<Family> mixture(family, a, lambda);
  return mixture.Length() > kManyTerms ? mixture.Integral(upper) : mixture.Sum(0.0, upper);
}

}  // namespace

// The order of the sum is D. Benton and K. Krishnamoorthy's, "Computing discrete mixtures of continuous
// distributions" (2003), with the start moved from the weights' centre to the largest product, which is
// elsewhere in the tails.
double NonCentralGamma(double x, double a, double lambda, bool upper) {
  return SumOf(GammaFamily(x), a, lambda, upper);
}

double NonCentralBeta(double x, double y, double a, double b, double lambda, bool upper) {
  return SumOf(BetaFamily(x, y, b), a, lambda, upper);
}

double NonCentralStudent(double x, double y, double b, double lambda, bool upper) {
  const Mixture<BetaFamily> mixture(BetaFamily(x, y, b), 0.5, lambda);
  if (2.0 * mixture.Length() > kManyTerms) return mixture.Integral(upper);
  return 0.5 * (mixture.Sum(0.0, upper) + mixture.Sum(0.5, upper));
}

}  // namespace MCMath_800
