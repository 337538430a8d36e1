#include "kestrel/math/NonCentralTail.h"

#include <algorithm>
#include <cmath>
#include <initializer_list>

#include "kestrel/math/ErrorFunction.h"
#include "kestrel/math/GammaRatio.h"
#include "kestrel/math/MCDistFun.h"
#include "kestrel/math/Polynomial.h"
#include "kestrel/math/SaddlePoint.h"

namespace MCMath_800 {

namespace {

constexpr double kRootTwo = 1.41421356237309504880;
constexpr double kRootTwoPi = 2.50662827463100050242;

/// Where the largest term's place, twice, makes the integral faster than the sum of all terms that count; t
/// takes two sums.
constexpr double kIntegralFrom = 120.0;
constexpr double kStudentIntegralFrom = 60.0;
/// The largest parameter whose sum takes no more time than a call may.
constexpr double kLongSumTo = 600.0;

/// So close to an end a distribution of squares is as good as a power; the sums' quotients are no numbers
/// there.
constexpr double kNearZero = 1e-280;
constexpr double kFarOdds = 1e280;

double NormalDensity(double z) {
  return std::exp(-0.5 * z * z) / kRootTwoPi;
}

/// The tail as it is, or what is left of 1.
NonCentralTail Turned(const NonCentralTail& tail, bool turn) {
  return turn ? NonCentralTail{1.0 - tail.share, -tail.slope, -tail.bend} : tail;
}

/// What is taken from 1 loses as many digits as it leaves; beyond this the other side is worth its time.
constexpr double kLargeShare = 0.6;

/// The median of a non-central chi-square, about (E. B. Wilson and M. M. Hilferty 1931, "The distribution of
/// chi-square").
double ChiMedian(double df, double nc) {
  const double mean = df + nc;
  const double root = std::max(0.0, 1.0 - 2.0 / 9.0 * (mean + nc) / (mean * mean));
  // A few hundredths of a degree of freedom have most of their share at next to nothing.
  if (nc == 0.0 && df < 0.8) return 2.0 * std::pow(0.5 / ReciprocalGamma1(0.5 * df), 2.0 / df);
  return mean * (root * root * root);
}

/// The share below, or above (`upper`), from a tail of either side. `above` is the side that is likely the
/// smaller; a skew distribution may prove it wrong, and is asked again if `both` sides are open.
template <class Side>
NonCentralTail FromSmaller(bool above, bool upper, bool both, const Side& side) {
  const NonCentralTail tail = side(above);
  if (both && tail.share > kLargeShare) return Turned(side(!above), above == upper);
  return Turned(tail, above != upper);
}

/// The tail of the smaller side as that of the other parameter of a mixture: nc is twice lambda.
NonCentralTail OfMixture(const MixtureShare& mixture, bool upper) {
  const double sign = upper ? 0.5 : -0.5;
  return {mixture.share, sign * mixture.drop, 0.5 * sign * (mixture.next - mixture.drop)};
}

/// The integral across zero: what the strip and the width ask of the inverse of the step's square, and where
/// the sum ends. All digits, or five.
struct Mesh {
  double strip;
  double bent_strip;
  double width;
  double negligible;
};
constexpr Mesh kFineMesh = {110.0, 160.0, 2.3, 1e-18};
constexpr Mesh kCoarseMesh = {10.0, 17.0, 0.65, 1e-6};

/// 2 (e^d - 1 - d) / d^2 in d.
constexpr double kExponentialSeries[] = {1.0,
                                         1.0 / 3,
                                         1.0 / 12,
                                         1.0 / 60,
                                         1.0 / 360,
                                         1.0 / 2520,
                                         1.0 / 20160,
                                         1.0 / 181440,
                                         1.0 / 1814400,
                                         1.0 / 19958400,
                                         1.0 / 239500800,
                                         1.0 / 3113510400.,
                                         1.0 / 43589145600.};

/// s^2 - 1 - ln s^2 for s > 0.
DoubleDouble SquareDeviance(double s) {
  if (s < 0.1) return MultiplyExactly(s, s) - 1.0 - Log(s) * 2.0;
  return LogDeviance(Split(MultiplyExactly(s, s) - 1.0));
}

/// What the integral across zero is taken of: minus its exponent where ln S is d from its peak. In the tails
/// the exponent is large: it has two doubles at the peak, and elsewhere only what is beyond that is computed.
class StudentExponent {
 public:
  StudentExponent(double x, double df, double nc) : df_(df) {
    const double lean = x * nc;
    peak_ = 2.0 * df / (lean + std::sqrt(lean * lean + 4.0 * df * (df + x * x)));
    const DoubleDouble reach = MultiplyExactly(x, peak_);
    const DoubleDouble z = reach + nc;
    const DoubleDouble squares = MultiplyExactly(peak_, peak_) * df + reach * reach;
    reach_ = reach.high;
    z_ = z.high;
    square_ = 0.5 * squares.high;
    // The peak is a rounded number.
    slant_ = (squares + reach * nc - df).high;
    least_ = (SquareDeviance(peak_) * df + z * z) * 0.5;
  }

  double Curvature() const { return 4.0 * square_ + reach_ * (z_ - reach_); }
  DoubleDouble Least() const { return least_; }

  struct Value {
    double beyond;
    double z;  ///< x S + nc
  };
  Value At(double d) const {
    const double grown = std::expm1(d);
    const double bent = std::fabs(d) < 0.3 ? 0.5 * d * d * Polynomial(kExponentialSeries, d) : grown - d;
    return {square_ * grown * grown + df_ * bent + slant_ * grown, z_ + reach_ * grown};
  }

 private:
  double df_;
  double peak_;
  double reach_;
  double z_;
  double square_;
  double slant_;
  DoubleDouble least_;
};

/// P(Z + nc > x S) for x, nc < 0 with their signs taken off, that is P(Z < -x S - nc), where S^2 is a
/// chi-square over its df. The series of the other signs would cancel here, the integral over ln S (D. B.
/// Owen 1968, "A survey of properties and applications of the noncentral t-distribution") does not. It is
/// summed by the trapezoidal rule, which converges exponentially since the integrand fades at both ends.
NonCentralTail StudentAcrossZero(double x, double df, double nc, SumCare care) {
  const Mesh mesh = care == SumCare::kRough ? kCoarseMesh : kFineMesh;
  const double half = 0.5 * df;
  const StudentExponent exponent(x, df, nc);
  // Few degrees of freedom fade slowly to the left; the variable is bent to make them end.
  const double bend = df < 8.0 ? 1.0 : 0.0;
  // A wide integrand's step is bound by the strip around the axis in which it fades, a narrow one's by its
  // width.
  const double wanted =
      1.0 / std::sqrt((bend == 0.0 ? mesh.strip : mesh.bent_strip) + mesh.width * exponent.Curvature());
  // Powers of it bend the variable: it is the rounded number, the step its logarithm.
  const double fall = std::exp(-wanted);
  const double step = -Log(fall).high;
  NonCentralTail sum = {0.0, 0.0, 0.0};
  // Adds the value at w and returns its share; tail = bend e^-w.
  const auto add = [&](double w, double tail) {
    const StudentExponent::Value value = exponent.At(w - tail);
    const double density = std::exp(-value.beyond) * (1.0 + tail);
    const double share = density * ScaledErfc(value.z / kRootTwo);
    sum.share += share;
    sum.slope -= density;
    sum.bend += value.z * density;
    return share;
  };
  const double first = add(0.0, bend);
  for (const bool right : {true, false}) {
    const double way = right ? step : -step;
    const DoubleDouble change = right ? DoubleDouble(fall) : DoubleDouble(1.0) / fall;
    double before = first;
    DoubleDouble tail = bend;
    constexpr int kNodeLimit = 400;
    for (int node = 1; node <= kNodeLimit; ++node) {
      tail = tail * change;
      const double value = add(node * way, tail.high + tail.low);
      if (value <= mesh.negligible * sum.share && value <= before) break;
      before = value;
    }
  }
  const double scale = GammaPower(half, half) * GuardedExpMinus(exponent.Least()) * step;
  const double density = scale * 2.0 / kRootTwoPi;
  return {scale * sum.share, density * sum.slope, density * sum.bend};
}

/// P(T <= x), or P(T > x) (`above`), for x, nc > 0: the share below 0 and a mixture beyond it.
NonCentralTail StudentMixture(double x, double df, double nc, DoubleDouble square, bool above, SumCare care) {
  const DoubleDouble lambda = MultiplyExactly(0.5 * nc, nc);
  const double edge = NormalDensity(nc) * std::exp(-0.5 * df * std::log1p(square.high));
  NonCentralTail tail = {0.0, -edge, nc * edge};
  if (square.high < kNearZero) {
    // Too close to 0 for anything to lie between.
    if (above) tail.share = MCDistFun::CdfStdNorm(nc);
  } else if (lambda.high < kSmallestPoissonMean) {
    tail.share = above ? MCDistFun::SigT(x, df) : MCDistFun::CdfT(x, df) - 0.5;
  } else {
    const MixtureShare mixture = NonCentralStudent(square, 0.5 * df, lambda, above, care);
    tail.share = mixture.share;
    tail.slope -= nc * mixture.drop;
    tail.bend += 2.0 * lambda.high * (mixture.drop - mixture.next) - mixture.drop;
  }
  if (above) return {tail.share, -tail.slope, -tail.bend};
  return {tail.share + MCDistFun::CdfStdNorm(-nc), tail.slope, tail.bend};
}

/// P(T <= x), or P(T > x), for x, nc > 0.
NonCentralTail StudentOneSide(double x, double df, double nc, bool upper, SumCare care) {
  const DoubleDouble square = MultiplyExactly(x, x) / df;
  const DoubleDouble nc_square = MultiplyExactly(nc, nc);
  const ChiQuotient quotient = ChiAgainstChi(1.0, df, square);
  const ChiSaddle saddle = FindSaddle(quotient, nc_square.high);
  if (nc_square.high * saddle.w >= kStudentIntegralFrom) {
    // P(T < -x) is too small to count: what is left is that T^2 has the non-central F distribution.
    const auto side = [&](bool above) {
      const NonCentralTail tail = IntegrateSaddle(quotient, nc_square, saddle, above, care);
      return NonCentralTail{tail.share, 2.0 * nc * tail.slope,
                            2.0 * tail.slope + 4.0 * nc_square.high * tail.bend};
    };
    if (IsCloseToPole(quotient, nc_square.high, saddle)) return side(upper);
    const bool both = care == SumCare::kFull && ReachesBothSides(quotient, nc_square.high, saddle);
    return FromSmaller(saddle.u > 0.0, upper, both, side);
  }
  const bool beyond = square.high * ChiMedian(df, 0.0) > nc_square.high;
  return FromSmaller(beyond, upper, care == SumCare::kFull,
                     [&](bool above) { return StudentMixture(x, df, nc, square, above, care); });
}

/// x > 0.
NonCentralTail StudentTail(double x, double df, double nc, bool upper, SumCare care) {
  if (nc > 0.0) return StudentOneSide(x, df, nc, upper, care);
  if (nc == 0.0) {
    const double edge = std::exp(-0.5 * df * std::log1p(x * (x / df))) / kRootTwoPi;
    return {upper ? MCDistFun::SigT(x, df) : MCDistFun::CdfT(x, df), upper ? edge : -edge, 0.0};
  }
  const NonCentralTail above = StudentAcrossZero(x, df, -nc, care);
  return Turned({above.share, -above.slope, above.bend}, !upper);
}

/// The tail at an end, which shrinks with a power of what is left to that end, or the rest of 1.
NonCentralTail PowerTail(const NonCentralTail& tail, double ratio, double power, bool turn) {
  const double share = std::pow(ratio, power);
  return Turned({share * tail.share, share * tail.slope, share * tail.bend}, turn);
}

/// Squares of larger numbers are no numbers.
constexpr double kFarX = 1e140;

/// Beyond kFarX either way, where a tail is as good as a power of x.
NonCentralTail FarStudentTail(double x, double df, double nc, bool upper, SumCare care) {
  const bool right = x > 0.0;
  const NonCentralTail tail = FindStudentTail(right ? kFarX : -kFarX, df, nc, right, care);
  return PowerTail(tail, kFarX / std::fabs(x), df, upper != right);
}

}  // namespace

NonCentralTail FindStudentTail(double x, double df, double nc, bool upper, SumCare care) {
  if (std::fabs(x) > kFarX) return FarStudentTail(x, df, nc, upper, care);
  if (x > 0.0) return StudentTail(x, df, nc, upper, care);
  if (x < 0.0) {
    const NonCentralTail tail = StudentTail(-x, df, -nc, !upper, care);
    return {tail.share, -tail.slope, tail.bend};
  }
  const double slope = NormalDensity(nc);
  const NonCentralTail above = {MCDistFun::CdfStdNorm(nc), slope, -nc * slope};
  return upper ? above : NonCentralTail{MCDistFun::CdfStdNorm(-nc), -slope, nc * slope};
}

NonCentralTail FindChiTail(double x, double df, double nc, bool upper, SumCare care) {
  const double half = 0.5 * x;
  if (half < kNearZero)
    return PowerTail(FindChiTail(2.0 * kNearZero, df, nc, false, care), half / kNearZero, 0.5 * df, upper);
  // So far out the share above is too small for any number.
  if (half > 1e4 + 50.0 * (df + nc)) return {upper ? 0.0 : 1.0, 0.0, 0.0};
  const double lambda = 0.5 * nc;
  const ChiQuotient quotient = ChiAgainstNumber(df, x);
  const ChiSaddle saddle = FindSaddle(quotient, nc);
  const bool integrates = nc * saddle.w >= kIntegralFrom;
  if (integrates && IsCloseToPole(quotient, nc, saddle))
    return IntegrateSaddle(quotient, nc, saddle, upper, care);
  const bool both = care == SumCare::kFull && (!integrates || ReachesBothSides(quotient, nc, saddle));
  return FromSmaller(saddle.u > 0.0, upper, both, [&](bool above) {
    if (integrates) return IntegrateSaddle(quotient, nc, saddle, above, care);
    return OfMixture(NonCentralGamma(half, 0.5 * df, lambda, above, care), above);
  });
}

NonCentralTail FindBetaTail(DoubleDouble odds, double a, double b, double nc, bool upper, SumCare care) {
  if (odds.high < kNearZero)
    return PowerTail(FindBetaTail(kNearZero, a, b, nc, false, care), odds.high / kNearZero, a, upper);
  if (odds.high > kFarOdds)
    return PowerTail(FindBetaTail(kFarOdds, a, b, nc, true, care), kFarOdds / odds.high, b, !upper);
  const ChiQuotient quotient = ChiAgainstChi(2.0 * a, 2.0 * b, odds);
  const ChiSaddle saddle = FindSaddle(quotient, nc);
  const bool integrates = nc * saddle.w >= kIntegralFrom;
  // Where the integral does not reach the other side a sum of not too many terms does.
  const bool full = care == SumCare::kFull;
  const bool reaches = ReachesBothSides(quotient, nc, saddle);
  const bool sums = !integrates || (full && !reaches && nc <= kLongSumTo);
  if (!sums && IsCloseToPole(quotient, nc, saddle)) return IntegrateSaddle(quotient, nc, saddle, upper, care);
  // The integral is best on the saddle point's side as long as that is not much the larger.
  const bool beyond = sums ? odds.high * ChiMedian(2.0 * b, 0.0) > ChiMedian(2.0 * a, nc) : saddle.u > 0.0;
  return FromSmaller(beyond, upper, full && (sums || reaches), [&](bool above) {
    if (integrates && (reaches || above == (saddle.u > 0.0)))
      return IntegrateSaddle(quotient, nc, saddle, above, care);
    return OfMixture(NonCentralBeta(odds, a, b, 0.5 * nc, above, care), above);
  });
}

}  // namespace MCMath_800
