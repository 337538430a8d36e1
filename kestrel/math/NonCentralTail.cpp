#include "kestrel/math/NonCentralTail.h"

#include <cmath>
#include <initializer_list>

#include "kestrel/math/ErrorFunction.h"
#include "kestrel/math/GammaRatio.h"
#include "kestrel/math/MCDistFun.h"
#include "kestrel/math/SaddlePoint.h"

namespace MCMath_800 {

namespace {

constexpr double kRootTwo = 1.41421356237309504880;
constexpr double kRootTwoPi = 2.50662827463100050242;

/// Where the largest term's place, twice, makes the integral faster than the sum of all terms that count; t
/// takes two sums.
constexpr double kIntegralFrom = 600.0;
constexpr double kStudentIntegralFrom = 250.0;

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

/// The tail of the smaller side as that of the other parameter of a mixture: nc is twice lambda.
NonCentralTail OfMixture(const MixtureShare& mixture, bool upper) {
  const double sign = upper ? 0.5 : -0.5;
  return {mixture.share, sign * mixture.drop, 0.5 * sign * (mixture.next - mixture.drop)};
}

/// The integral across zero: what the strip and the width ask of the inverse of the step's square, and where
/// the sum ends. Thirteen digits, or five.
struct Mesh {
  double strip;
  double bent_strip;
  double width;
  double negligible;
};
constexpr Mesh kFineMesh = {72.0, 105.0, 1.85, 1e-17};
constexpr Mesh kCoarseMesh = {10.0, 17.0, 0.65, 1e-6};

/// P(Z + nc > x S) for x, nc < 0 with their signs taken off, that is P(Z < -x S - nc), where S^2 is a
/// chi-square over its df. The series of the other signs would cancel here, the integral over ln S (D. B.
/// Owen 1968, "A survey of properties and applications of the noncentral t-distribution") does not. It is
/// summed by the trapezoidal rule, which converges exponentially since the integrand fades at both ends.
NonCentralTail StudentAcrossZero(double x, double df, double nc, SumCare care) {
  const Mesh mesh = care == SumCare::kRough ? kCoarseMesh : kFineMesh;
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
  // width: either way the rule is right to thirteen digits.
  const double step = 1.0 / std::sqrt((bend == 0.0 ? mesh.strip : mesh.bent_strip) + mesh.width * curvature);
  NonCentralTail sum = {0.0, 0.0, 0.0};
  // Adds the value at w and returns its share; tail = bend e^-w.
  const auto add = [&](double w, double tail) {
    const double v = centre + w - tail;
    const double s = std::exp(v);
    // s^2 - 1 - ln s^2
    const double fade = std::fabs(v) < 0.25 ? LogDeviance(std::expm1(2.0 * v)) : s * s - 1.0 - 2.0 * v;
    const double z = x * s + nc;
    const double density = std::exp(-half * fade - 0.5 * z * z) * (1.0 + tail);
    const double share = density * ScaledErfc(z / kRootTwo);
    sum.share += share;
    sum.slope -= density;
    sum.bend += z * density;
    return share;
  };
  const double first = add(0.0, bend);
  for (const double way : {step, -step}) {
    const double fall = std::exp(-way);
    double before = first, tail = bend;
    constexpr int kNodeLimit = 400;
    for (int node = 1; node <= kNodeLimit; ++node) {
      tail *= fall;
      const double value = add(node * way, tail);
      if (value <= mesh.negligible * sum.share && value <= before) break;
      before = value;
    }
  }
  const double scale = GammaPower(half, half) * step;
  const double density = scale * 2.0 / kRootTwoPi;
  return {scale * sum.share, density * sum.slope, density * sum.bend};
}

/// P(T <= x), or P(T > x), for x, nc > 0: the share below 0 and a mixture beyond it.
NonCentralTail StudentOneSide(double x, double df, double nc, bool upper, SumCare care) {
  const DoubleDouble square = MultiplyExactly(x, x) / df;
  const double lambda = 0.5 * nc * nc;
  const ChiQuotient quotient = ChiAgainstChi(1.0, df, square);
  const ChiSaddle saddle = FindSaddle(quotient, nc * nc);
  if (nc * nc * saddle.w >= kStudentIntegralFrom) {
    // P(T < -x) is too small to count: what is left is that T^2 has the non-central F distribution.
    const NonCentralTail tail = IntegrateSaddle(quotient, nc * nc, saddle, care);
    return Turned({tail.share, 2.0 * nc * tail.slope, 2.0 * tail.slope + 4.0 * nc * nc * tail.bend},
                  (saddle.u > 0.0) != upper);
  }
  // Whichever tail is the smaller, about.
  const bool above = x > nc;
  const double edge = NormalDensity(nc) * std::exp(-0.5 * df * std::log1p(square.high));
  NonCentralTail tail = {0.0, -edge, nc * edge};
  if (square.high < kNearZero) {
    // Too close to 0 for anything to lie between.
    if (above) tail.share = MCDistFun::CdfStdNorm(nc);
  } else if (lambda < kSmallestPoissonMean) {
    tail.share = above ? MCDistFun::SigT(x, df) : MCDistFun::CdfT(x, df) - 0.5;
  } else {
    const MixtureShare mixture = NonCentralStudent(square, 0.5 * df, lambda, above, care);
    tail.share = mixture.share;
    tail.slope -= nc * mixture.drop;
    tail.bend += 2.0 * lambda * (mixture.drop - mixture.next) - mixture.drop;
  }
  if (above) {
    tail.slope = -tail.slope;
    tail.bend = -tail.bend;
  } else {
    tail.share += MCDistFun::CdfStdNorm(-nc);
  }
  return Turned(tail, above != upper);
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
  // The smaller tail, about.
  const bool above = saddle.u > 0.0;
  if (nc * saddle.w >= kIntegralFrom)
    return Turned(IntegrateSaddle(quotient, nc, saddle, care), above != upper);
  return Turned(OfMixture(NonCentralGamma(half, 0.5 * df, lambda, above, care), above), above != upper);
}

NonCentralTail FindBetaTail(DoubleDouble odds, double a, double b, double nc, bool upper, SumCare care) {
  if (odds.high < kNearZero)
    return PowerTail(FindBetaTail(kNearZero, a, b, nc, false, care), odds.high / kNearZero, a, upper);
  if (odds.high > kFarOdds)
    return PowerTail(FindBetaTail(kFarOdds, a, b, nc, true, care), kFarOdds / odds.high, b, !upper);
  const ChiQuotient quotient = ChiAgainstChi(2.0 * a, 2.0 * b, odds);
  const ChiSaddle saddle = FindSaddle(quotient, nc);
  const bool above = saddle.u > 0.0;
  if (nc * saddle.w >= kIntegralFrom)
    return Turned(IntegrateSaddle(quotient, nc, saddle, care), above != upper);
  return Turned(OfMixture(NonCentralBeta(odds, a, b, 0.5 * nc, above, care), above), above != upper);
}

}  // namespace MCMath_800
