#include "plugins/regression/LinkFunctions.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace MCKestrel_800 {
namespace {

constexpr double kPi = 3.14159265358979323846;
constexpr double kSqrtHalf = 0.70710678118654752440;
constexpr double kDensityAtZero = 0.39894228040143267794;

// exp(-y) may overflow to infinity, which gives the right 0.
double LogitBelow(double y) {
  return 1.0 / (1.0 + std::exp(-y));
}

double ProbitBelow(double y) {
  return 0.5 * std::erfc(-y * kSqrtHalf);
}

double CloglogBelow(double y) {
  return -std::expm1(-std::exp(y));
}

double CloglogAbove(double y) {
  return std::exp(-std::exp(y));
}

// atan(y) comes close to -pi/2 for small y; the reciprocal's arc tangent is the small difference itself.
double CauchitBelow(double y) {
  return y < 0.0 ? std::atan(-1.0 / y) / kPi : 0.5 + std::atan(y) / kPi;
}

// The functions below expect low <= high.

double LogitBetween(double low, double high) {
  return LogitBelow(high) * LogitBelow(-low) * -std::expm1(low - high);
}

// The integral of the normal density over a short interval, by the ten-point Gauss-Legendre rule. Nodes and
// weights come from arbitrary-precision arithmetic.
double IntegrateDensity(double low, double high) {
  constexpr double kNodes[] = {0.97390652851717172008, 0.86506336668898451073, 0.67940956829902440623,
                               0.43339539412924719080, 0.14887433898163121088};
  constexpr double kWeights[] = {0.066671344308688137594, 0.14945134915058059315, 0.21908636251598204400,
                                 0.26926671930999635509, 0.29552422471475287017};
  const double half = 0.5 * (high - low);
  const double middle = low + half;
  double sum = 0.0;
  for (int i = 0; i < 5; ++i) {
    const double left = middle - half * kNodes[i];
    const double right = middle + half * kNodes[i];
    sum += kWeights[i] * (std::exp(-0.5 * left * left) + std::exp(-0.5 * right * right));
  }
  return kDensityAtZero * half * sum;
}

double ProbitBetween(double low, double high) {
  // Within this width the density changes little, so the tails' difference would cancel and the rule is
  // exact.
  if ((high - low) * std::fmax(1.0, std::fmax(std::fabs(low), std::fabs(high))) <= 1.0) {
    return IntegrateDensity(low, high);
  }
  if (low > 0.0) return 0.5 * (std::erfc(low * kSqrtHalf) - std::erfc(high * kSqrtHalf));
  if (high < 0.0) return 0.5 * (std::erfc(-high * kSqrtHalf) - std::erfc(-low * kSqrtHalf));
  return 0.5 * (std::erf(high * kSqrtHalf) + std::erf(-low * kSqrtHalf));
}

double CloglogBetween(double low, double high) {
  const double base = std::exp(low);
  if (std::isinf(base)) return 0.0;
  const double step = high - low < 1.0 ? base * std::expm1(high - low) : std::exp(high) - base;
  return std::exp(-base) * -std::expm1(-step);
}

// The larger of the two carries the size, so that nothing overflows but a difference that is too large
// itself.
double ExpBetween(double low, double high) {
  return low == high ? 0.0 : std::exp(high) * -std::expm1(low - high);
}

double CauchitBetween(double low, double high) {
  const double product = low * high;
  if (product <= -1.0) return (std::atan(high) - std::atan(low)) / kPi;
  if (product > 1e100) return (high - low) / low / high / kPi;
  return std::atan((high - low) / (1.0 + product)) / kPi;
}

double BetweenOrdered(Normalization method, double low, double high) {
  switch (method) {
    case Normalization::kNone:
      return high - low;
    case Normalization::kLogit:
      return LogitBetween(low, high);
    case Normalization::kProbit:
      return ProbitBetween(low, high);
    case Normalization::kCloglog:
      return CloglogBetween(low, high);
    case Normalization::kLoglog:
      return CloglogBetween(-high, -low);
    case Normalization::kCauchit:
      return CauchitBetween(low, high);
    case Normalization::kExp:
      return ExpBetween(low, high);
    default:
      return std::numeric_limits<double>::quiet_NaN();
  }
}

// Below this value of F what is left of its digits might not do for a ratio, and the tail's shape is simple.
constexpr double kTail = 1e-200;

// Phi(y) * |y| / density(y), which tends to 1; for y < -30, as it is in the tail.
double MillsFactor(double y) {
  const double u = 1.0 / y / y;
  return 1.0 - u * (1.0 - 3.0 * u * (1.0 - 5.0 * u * (1.0 - 7.0 * u * (1.0 - 9.0 * u * (1.0 - 11.0 * u)))));
}

// F(y) / F(largest) for y <= largest, both in the tail; of "exp", whose shape is the same everywhere, for any
// two. Logarithms are subtracted before they get large.
double TailRatio(Normalization method, double y, double largest) {
  if (y == largest) return 1.0;
  switch (method) {
    case Normalization::kProbit:
      return std::exp((largest - y) * (0.5 * largest + 0.5 * y)) * (largest / y) *
             (MillsFactor(y) / MillsFactor(largest));
    case Normalization::kLoglog:
      return std::exp(-std::exp(-largest) * std::expm1(largest - y));
    case Normalization::kCauchit:
      return largest / y;
    default:
      return std::exp(y - largest);
  }
}

}  // namespace

double LinkBelow(Normalization method, double y) {
  switch (method) {
    case Normalization::kNone:
      return y;
    case Normalization::kLogit:
      return LogitBelow(y);
    case Normalization::kProbit:
      return ProbitBelow(y);
    case Normalization::kCloglog:
      return CloglogBelow(y);
    case Normalization::kLoglog:
      return CloglogAbove(-y);
    case Normalization::kCauchit:
      return CauchitBelow(y);
    case Normalization::kExp:
      return std::exp(y);
    default:
      return std::numeric_limits<double>::quiet_NaN();
  }
}

double LinkAbove(Normalization method, double y) {
  switch (method) {
    case Normalization::kNone:
      return 1.0 - y;
    case Normalization::kCloglog:
      return CloglogAbove(y);
    case Normalization::kLoglog:
      return CloglogBelow(-y);
    case Normalization::kExp:
      return -std::expm1(y);
    default:
      // The other distributions are symmetric about zero.
      return LinkBelow(method, -y);
  }
}

double LinkBetween(Normalization method, double low, double high) {
  return low <= high ? BetweenOrdered(method, low, high) : -BetweenOrdered(method, high, low);
}

void LinkShares(Normalization method, const double* values, std::size_t count, double* shares) {
  const double largest = *std::max_element(values, values + count);
  const bool by_ratio = method == Normalization::kExp || LinkBelow(method, largest) < kTail;
  double sum = 0.0;
  for (std::size_t j = 0; j < count; ++j) {
    shares[j] = by_ratio ? TailRatio(method, values[j], largest) : LinkBelow(method, values[j]);
    sum += shares[j];
  }
  for (std::size_t j = 0; j < count; ++j)
    shares[j] /= sum;
}

}  // namespace MCKestrel_800
