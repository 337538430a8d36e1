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

/// a / b, of quotients that are multiplied by the hundred: in one division.
DoubleDouble Quotient(DoubleDouble a, DoubleDouble b) {
  const double inverse = 1.0 / b.high;
  const double quotient = a.high * inverse;
  const DoubleDouble back = MultiplyExactly(quotient, b.high);
  return {quotient, ((a.high - back.high) - back.low + a.low - quotient * b.low) * inverse};
}

/// What products leave in the second double grows.
double Rounded(DoubleDouble a) {
  return a.high + a.low;
}

/// a + b, whose second double may be as large as several roundings.
DoubleDouble Total(DoubleDouble a, DoubleDouble b) {
  const DoubleDouble sum = AddExactly(a.high, b.high);
  return {sum.high, sum.low + (a.low + b.low)};
}

// The same for rough sums, which have one double.
double Total(double a, double b) {
  return a + b;
}
double Quotient(double a, double b) {
  return a / b;
}
double Rounded(double a) {
  return a;
}
double As(DoubleDouble number, double) {
  return number.high;
}
DoubleDouble As(DoubleDouble number, DoubleDouble) {
  return number;
}

/// The distribution functions P(s) of a gamma distribution as its shape s grows by ones. What P loses from s
/// to s + 1 is its drop.
class GammaFamily {
 public:
  explicit GammaFamily(double x) : x_(x), per_x_(DoubleDouble(1.0) / x) {}
  double Drop(double s) const { return GammaPower(x_, s) / s; }
  /// Drop(s + 1) / Drop(s).
  double Growth(double s) const { return x_ / (s + 1.0); }
  /// The largest from there on.
  double LargestGrowth(double s) const { return Growth(s); }
  /// The same as Growth, given s + 1, with all its digits.
  template <class Number>
  Number GrowthBefore(Number next) const {
    return Quotient(Number(x_), next);
  }
  /// 1 / Growth(s), given s + 1.
  template <class Number>
  Number ShrinkageFrom(Number next) const {
    return As(per_x_, next) * next;
  }
  double Ratio(double s, bool upper) const { return GammaRatio(x_, s, upper); }
  /// The u at which Growth(start + u) * lambda / (u + 1) falls below 1.
  double Peak(double start, double lambda) const {
    return 2.0 * lambda * x_ / (start + std::sqrt(start * start + 4.0 * lambda * x_));
  }

 private:
  double x_;
  DoubleDouble per_x_;
};

class BetaFamily {
 public:
  BetaFamily(DoubleDouble odds, double b)
      : odds_(odds),
        far_(DoubleDouble(1.0) / (odds + 1.0)),
        near_(odds * far_),
        per_near_((odds + 1.0) / odds),
        less_(AddExactly(b, -1.0)),
        excess_(near_ * less_),
        lack_(per_near_ * -less_),
        x_(near_.high),
        b_(b) {}
  double Drop(double s) const { return BetaPower(Point(s), s, b_) / s; }
  double Growth(double s) const { return x_ * (s + b_) / (s + 1.0); }
  double LargestGrowth(double s) const { return std::max(x_, Growth(s)); }
  // Quotients of s + b and s + 1 as 1 and a rest.
  template <class Number>
  Number GrowthBefore(Number next) const {
    return Total(As(near_, next), Quotient(As(excess_, next), next));
  }
  template <class Number>
  Number ShrinkageFrom(Number next) const {
    return Total(As(per_near_, next), Quotient(As(lack_, next), Total(next, As(less_, next))));
  }
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
  DoubleDouble per_near_;
  DoubleDouble less_;
  DoubleDouble excess_;
  DoubleDouble lack_;
  double x_;
  double b_;
};

/// Adds up, with what the additions round off.
class CarefulSum {
 public:
  void Add(double number) {
    const DoubleDouble sum = AddExactly(sum_.high, number);
    sum_ = {sum.high, sum_.low + sum.low};
  }
  void Add(DoubleDouble number) {
    const DoubleDouble sum = AddExactly(sum_.high, number.high);
    sum_ = {sum.high, sum_.low + (sum.low + number.low)};
  }
  double Value() const { return sum_.high + sum_.low; }

 private:
  DoubleDouble sum_;
};

/// w(u) P(start + u) with w(u) = e^-lambda lambda^u / Gamma(u + 1), u = first, first + 1, ...
///
/// Weights and drops follow from those at the largest product, everything in units of these. Their rounding
/// errors would gather over hundreds of steps: for full care they have two doubles.
template <class Family, class Number>
class Mixture {
 public:
  Mixture(const Family& family, double start, DoubleDouble lambda, SumCare care)
      : family_(family),
        start_(start),
        lambda_(lambda),
        step_lambda_(As(lambda, Number())),
        per_lambda_(As(DoubleDouble(1.0) / lambda, Number())),
        peak_(family.Peak(start, lambda.high)),
        negligible_(NegligibleAt(care)) {}

  MixtureShare Sum(double first, bool upper) const {
    const double u = first + std::floor(std::max(0.0, peak_ - first));
    const double drop = DropAt(u);
    const double weight = GammaPower(lambda_, u + 1.0) * Rounded(per_lambda_);
    const double scale = weight * drop;
    if (!(scale > 0.0)) return {0.0, 0.0, 0.0};
    const Moments sum = upper ? UpperRun(first, u, drop) : LowerRun(first, u, drop);
    return {scale * sum.share.Value(), scale * sum.drop, scale * (sum.lean * Rounded(per_lambda_))};
  }

 private:
  /// The sums over the shares, the drops and the drops times u.
  struct Moments {
    CarefulSum share;
    double drop = 0.0;
    double lean = 0.0;

    void Add(double product, double u) {
      drop += product;
      lean += product * u;
    }
  };

  /// A weight and a drop on their way from term to term.
  struct Place {
    double at;
    Number weight = 1.0;
    Number drop = 1.0;

    double Product() const { return Rounded(weight) * Rounded(drop); }
  };
  DoubleDouble ShapeAt(double u) const { return AddExactly(start_, u); }
  Number StepShape(double u) const { return As(ShapeAt(u), Number()); }
  void StepUp(Place& place) const {
    place.at += 1.0;
    place.weight = place.weight * Quotient(step_lambda_, Number(place.at));
    place.drop = place.drop * family_.GrowthBefore(StepShape(place.at));
  }
  void StepDown(Place& place) const {
    place.weight = place.weight * (per_lambda_ * place.at);
    place.drop = place.drop * family_.ShrinkageFrom(StepShape(place.at));
    place.at -= 1.0;
  }

  /// The drop at u. A large start has a last digit that shows: it is taken from the rounded place to the
  /// right one.
  double DropAt(double u) const {
    const DoubleDouble s = ShapeAt(u);
    const double drop = family_.Drop(s.high);
    return s.low == 0.0 ? drop : drop * (1.0 + s.low * std::log(family_.Growth(s.high)));
  }
  /// The share at u, which falls by about the drop half a step before per step.
  double RatioAt(double u, double drop, bool upper) const {
    const DoubleDouble s = ShapeAt(u);
    const double ratio = family_.Ratio(s.high, upper);
    if (s.low == 0.0) return ratio;
    const double moved = s.low * drop / std::sqrt(family_.Growth(s.high));
    return upper ? ratio + moved : ratio - moved;
  }

  /// The share at the place. `unit` is that of the drops. Where both are too small for a quotient the drops'
  /// sum has few terms.
  double LowerShare(const Place& place, double unit) const {
    const double s = start_ + place.at;
    const double drop = Rounded(place.drop) * unit;
    if (family_.LargestGrowth(s) > 0.8 && drop > kSmall) return RatioAt(place.at, drop, false) / unit;
    double sum = 1.0, term = 1.0;
    constexpr int kTermLimit = 2000;
    for (int i = 0; i < kTermLimit && term > negligible_ * sum; ++i) {
      term *= family_.Growth(s + i);
      sum += term;
    }
    return Rounded(place.drop) * sum;
  }

  // Each share is the one above it plus a drop, so nothing cancels.
  Moments LowerRun(double first, double u, double unit) const {
    // Up from u: as every drop is in all shares up to its place, it is counted with all their weights.
    Moments sum;
    CarefulSum weights, share;
    Place place = {u};
    weights.Add(1.0);
    while (place.Product() > negligible_) {
      sum.Add(place.Product(), place.at);
      sum.share.Add(Rounded(place.drop) * weights.Value());
      share.Add(place.drop);
      StepUp(place);
      weights.Add(place.weight);
    }
    const double last = LowerShare(place, unit);
    sum.Add(place.Product(), place.at);
    sum.share.Add(last * weights.Value());
    share.Add(last);
    // Down from u.
    place = {u};
    while (place.at > first && Rounded(place.weight) * share.Value() > negligible_ * sum.share.Value()) {
      StepDown(place);
      share.Add(place.drop);
      sum.share.Add(Rounded(place.weight) * share.Value());
      sum.Add(place.Product(), place.at);
    }
    return sum;
  }

  // The same with the shares above, which are those below them plus the drops between.
  Moments UpperRun(double first, double u, double unit) const {
    Moments sum;
    CarefulSum weights, share;
    Place place = {u};
    while (place.at > first && place.Product() > negligible_) {
      sum.Add(place.Product(), place.at);
      weights.Add(place.weight);
      StepDown(place);
      sum.share.Add(Rounded(place.drop) * weights.Value());
      share.Add(place.drop);
    }
    const double drop = Rounded(place.drop) * unit;
    const double lowest = drop > kSmall ? RatioAt(place.at, drop, true) / unit : 0.0;
    weights.Add(place.weight);
    sum.Add(place.Product(), place.at);
    sum.share.Add(lowest * weights.Value());
    share.Add(lowest);
    place = {u};
    while (Rounded(place.weight) * share.Value() > negligible_ * sum.share.Value()) {
      share.Add(place.drop);
      StepUp(place);
      sum.share.Add(Rounded(place.weight) * share.Value());
      sum.Add(place.Product(), place.at);
    }
    return sum;
  }

  Family family_;
  double start_;
  DoubleDouble lambda_;
  Number step_lambda_;
  Number per_lambda_;
  double peak_;
  double negligible_;
};

template <class Family>
MixtureShare SumOf(const Family& family, double a, DoubleDouble lambda, bool upper, SumCare care) {
  if (lambda.high < kSmallestPoissonMean) {
    const double drop = family.Drop(a);
    return {family.Ratio(a, upper), drop, drop * family.Growth(a)};
  }
  if (care == SumCare::kRough) return Mixture<Family, double>(family, a, lambda, care).Sum(0.0, upper);
  return Mixture<Family, DoubleDouble>(family, a, lambda, care).Sum(0.0, upper);
}

template <class Number>
MixtureShare HalfSteps(DoubleDouble odds, double b, DoubleDouble lambda, bool upper, SumCare care) {
  const Mixture<BetaFamily, Number> mixture(BetaFamily(odds, b), 0.5, lambda, care);
  const MixtureShare even = mixture.Sum(0.0, upper), odd = mixture.Sum(0.5, upper);
  return {0.5 * (even.share + odd.share), 0.5 * (even.drop + odd.drop), 0.5 * (even.next + odd.next)};
}

}  // namespace

// The order of the sum is D. Benton and K. Krishnamoorthy's, "Computing discrete mixtures of continuous
// distributions" (2003), with the start moved from the weights' centre to the largest product, which is
// elsewhere in the tails.
MixtureShare NonCentralGamma(double x, double a, DoubleDouble lambda, bool upper, SumCare care) {
  return SumOf(GammaFamily(x), a, lambda, upper, care);
}

MixtureShare NonCentralBeta(DoubleDouble odds, double a, double b, DoubleDouble lambda, bool upper,
                            SumCare care) {
  return SumOf(BetaFamily(odds, b), a, lambda, upper, care);
}

MixtureShare NonCentralStudent(DoubleDouble odds, double b, DoubleDouble lambda, bool upper, SumCare care) {
  if (care == SumCare::kRough) return HalfSteps<double>(odds, b, lambda, upper, care);
  return HalfSteps<DoubleDouble>(odds, b, lambda, upper, care);
}

}  // namespace MCMath_800
