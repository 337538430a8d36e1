#include "kestrel/math/NonCentralSum.h"

#include <algorithm>
#include <cmath>

#include "kestrel/math/BetaRatio.h"
#include "kestrel/math/GammaRatio.h"

namespace MCMath_800 {

namespace {

/// What a term adds to the sum at least before the rest is left out.
double NegligibleAt(SumCare care) {
  return care == SumCare::kRough ? 1e-8 : 1e-17;
}

/// Above it, drops and shares have all their digits. What is below belongs to sums of less than 1e-300.
constexpr double kSmall = 1e-306;

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
  /// The u at which Growth(start + u) * lambda / (u + 1) falls below 1.
  double Peak(double start, double lambda) const {
    return 2.0 * lambda * x_ / (start + std::sqrt(start * start + 4.0 * lambda * x_));
  }

 private:
  double x_;
};

class BetaFamily {
 public:
  BetaFamily(DoubleDouble odds, double b)
      : odds_(odds), far_(DoubleDouble(1.0) / (odds + 1.0)), near_(odds * far_), x_(near_.high), b_(b) {}
  double Drop(double s) const { return BetaPower(Point(s), s, b_) / s; }
  double Growth(double s) const { return x_ * (s + b_) / (s + 1.0); }
  double Shrinkage(double s) const { return (s + 1.0) / (x_ * (s + b_)); }
  double Ratio(double s, bool upper) const { return BetaRatio(Point(s), s, b_, upper); }
  double Peak(double start, double lambda) const {
    const double lead = start - lambda * x_;
    const double product = lambda * x_ * (start + b_);
    const double root = std::sqrt(lead * lead + 4.0 * product);
    return lead > 0.0 ? 2.0 * product / (lead + root) : 0.5 * (root - lead);
  }

 private:
  BetaPoint Point(double s) const { return {near_, far_, (odds_ * b_ - s) * far_}; }

  DoubleDouble odds_;
  DoubleDouble far_;
  DoubleDouble near_;
  double x_;
  double b_;
};

/// w(u) P(start + u) with w(u) = e^-lambda lambda^u / Gamma(u + 1), u = first, first + 1, ...
template <class Family>
class Mixture {
 public:
  Mixture(const Family& family, double start, double lambda, SumCare care)
      : family_(family),
        start_(start),
        lambda_(lambda),
        per_lambda_(1.0 / lambda),
        peak_(family.Peak(start, lambda)),
        negligible_(NegligibleAt(care)) {}

  MixtureShare Sum(double first, bool upper) const {
    const double u = first + std::floor(std::max(0.0, peak_ - first));
    // A large start has a last digit that shows: the drop is taken from the rounded place to the right one.
    const DoubleDouble place = AddExactly(start_, u);
    const double moved = 1.0 + place.low * std::log(family_.Growth(place.high));
    const double scale = Weight(u) * family_.Drop(place.high) * moved;
    if (!(scale > 0.0)) return {0.0, 0.0, 0.0};
    return Scaled(upper ? UpperRun(first, u) : LowerRun(first, u), scale);
  }

 private:
  /// The sums over the shares, the drops and the drops times u.
  struct Moments {
    double share = 0.0;
    double drop = 0.0;
    double lean = 0.0;

    void Add(double product, double u) {
      drop += product;
      lean += product * u;
    }
  };

  MixtureShare Scaled(const Moments& sum, double scale) const {
    return {scale * sum.share, scale * sum.drop, scale * (sum.lean * per_lambda_)};
  }

  double Weight(double u) const { return GammaPower(lambda_, u + 1.0) * per_lambda_; }

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
    for (int i = 0; i < kTermLimit && term > negligible_ * sum; ++i) {
      term *= family_.Growth(s + i);
      sum += term;
    }
    return sum;
  }

  /// From the last term that counts down: each share is the one above it plus a drop, so nothing cancels.
  /// Everything is in units of the weight and the drop at u.
  Moments LowerRun(double first, double u) const {
    double weight = 1.0, drop = 1.0, at = u;
    while (weight * drop > negligible_) {
      weight *= lambda_ / (at + 1.0);
      drop *= family_.Growth(start_ + at);
      at += 1.0;
    }
    double share = drop * LowerQuotient(at);
    Moments sum;
    sum.share = weight * share;
    sum.Add(weight * drop, at);
    while (at > first && (at > u || weight * share > negligible_ * sum.share)) {
      weight *= at * per_lambda_;
      at -= 1.0;
      drop *= family_.Shrinkage(start_ + at);
      share += drop;
      sum.share += weight * share;
      sum.Add(weight * drop, at);
    }
    return sum;
  }

  /// The same from the first term that counts up.
  Moments UpperRun(double first, double u) const {
    double weight = 1.0, drop = 1.0, at = u;
    while (at > first && weight * drop > negligible_) {
      weight *= at * per_lambda_;
      at -= 1.0;
      drop *= family_.Shrinkage(start_ + at);
    }
    const double exact = family_.Drop(start_ + at);
    double share = exact > kSmall ? drop * (family_.Ratio(start_ + at, true) / exact) : 0.0;
    Moments sum;
    sum.share = weight * share;
    sum.Add(weight * drop, at);
    while (at <= u || weight * share > negligible_ * sum.share) {
      share += drop;
      weight *= lambda_ / (at + 1.0);
      drop *= family_.Growth(start_ + at);
      at += 1.0;
      sum.share += weight * share;
      sum.Add(weight * drop, at);
    }
    return sum;
  }

  Family family_;
  double start_;
  double lambda_;
  double per_lambda_;
  double peak_;
  double negligible_;
};

template <class Family>
MixtureShare SumOf(const Family& family, double a, double lambda, bool upper, SumCare care) {
  if (lambda < kSmallestPoissonMean) {
    const double drop = family.Drop(a);
    return {family.Ratio(a, upper), drop, drop * family.Growth(a)};
  }
  return Mixture<Family>(family, a, lambda, care).Sum(0.0, upper);
}

}  // namespace

// The order of the sum is D. Benton and K. Krishnamoorthy's, "Computing discrete mixtures of continuous
// distributions" (2003), with the start moved from the weights' centre to the largest product, which is
// elsewhere in the tails.
MixtureShare NonCentralGamma(double x, double a, double lambda, bool upper, SumCare care) {
  return SumOf(GammaFamily(x), a, lambda, upper, care);
}

MixtureShare NonCentralBeta(DoubleDouble odds, double a, double b, double lambda, bool upper, SumCare care) {
  return SumOf(BetaFamily(odds, b), a, lambda, upper, care);
}

MixtureShare NonCentralStudent(DoubleDouble odds, double b, double lambda, bool upper, SumCare care) {
  const Mixture<BetaFamily> mixture(BetaFamily(odds, b), 0.5, lambda, care);
  const MixtureShare even = mixture.Sum(0.0, upper), odd = mixture.Sum(0.5, upper);
  return {0.5 * (even.share + odd.share), 0.5 * (even.drop + odd.drop), 0.5 * (even.next + odd.next)};
}

}  // namespace MCMath_800
