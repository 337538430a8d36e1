#include "kestrel/math/SaddlePoint.h"

#include <cmath>
#include <cstdint>
#include <cstring>
#include <limits>

#include "kestrel/math/GammaCoefficients.h"
#include "kestrel/math/LogTable.h"
#include "kestrel/math/MCPower.h"
#include "kestrel/math/Polynomial.h"

namespace MCMath_800 {

namespace {

// Below this the series of the logarithm needs no table.
constexpr double kNear = 0x1p-8;

// Above this nobody needs the digits, and scaling would leave the range.
constexpr double kLargest = 1e300;

// (ln(1 + r) - r + r^2 / 2) / r^3, whose further terms are below 2^-65 of r^2 for |r| < 1.2 * 2^-8.
constexpr double kNearSeries[] = {1.0 / 3.0, -1.0 / 4.0, 1.0 / 5.0, -1.0 / 6.0,
                                  1.0 / 7.0, -1.0 / 8.0, 1.0 / 9.0};

/// r - ln(1 + r) for such an r: half a square without rounding, and the rest.
inline DoubleDouble NearDeviance(HeadAndTail r) {
  const double sum = r.head + r.tail;
  return {0.5 * r.head * r.head,
          r.tail * (r.head + 0.5 * r.tail) - sum * (sum * sum) * Polynomial(kNearSeries, sum)};
}

double Scaled(double number, int exponent) {
  const std::uint64_t bits = static_cast<std::uint64_t>(1023 + exponent) << 52;
  double power;
  std::memcpy(&power, &bits, sizeof power);
  return number * power;
}

/// Where in the table a normal number stands, and the power of two that brings it there.
struct Place {
  const LogEntry* entry;
  int exponent;
};

Place PlaceOf(double number) {
  std::uint64_t bits;
  std::memcpy(&bits, &number, sizeof bits);
  // Moves the beginning of the table to the beginning of a binade.
  bits += 0x000A000000000000;
  return {&kLogTable[bits >> 45 & 127], static_cast<int>(bits >> 52) - 1023};
}

/// A number as (1 + rest) / c times a power of two: c has so few bits that its product with a head is exact.
struct Reduced {
  DoubleDouble log;  ///< Of the power of two over c.
  HeadAndTail rest;
};

/// z normal and below 1e300.
inline Reduced Reduce(DoubleDouble z) {
  const Place place = PlaceOf(z.high);
  const HeadAndTail scaled = Split({Scaled(z.high, -place.exponent), Scaled(z.low, -place.exponent)});
  const double c = place.entry->reciprocal;
  const DoubleDouble log = AddExactly(place.exponent * kLn2High, place.entry->high);
  return {{log.high, log.low + (place.exponent * kLn2Low + place.entry->low)},
          Split({scaled.head * c - 1.0, scaled.tail * c})};
}

}  // namespace

DoubleDouble Log(DoubleDouble z) {
  constexpr double kSmallest = std::numeric_limits<double>::min();
  if (!(z.high >= kSmallest && z.high < kLargest)) return std::log(z.high);
  const Reduced reduced = Reduce(z);
  const DoubleDouble near = NearDeviance(reduced.rest);
  const DoubleDouble head = AddExactly(reduced.log.high, reduced.rest.head);
  const DoubleDouble sum = AddExactly(head.high, -near.high);
  return AddOrdered(sum.high, sum.low + (head.low + reduced.log.low + (reduced.rest.tail - near.low)));
}

DoubleDouble LogOfOnePlus(DoubleDouble u) {
  return u - LogDeviance(Split(u));
}

DoubleDouble LogDeviance(HeadAndTail u) {
  DoubleDouble main = 0.0;
  HeadAndTail rest = u;
  if (u.head > -0.3125 && u.head < 0.375) {
    if (!(std::fabs(u.head) < kNear)) {
      // u - ln(1 + u) = (u - rest + ln c) + (rest - ln(1 + rest)), where 1 + rest = c (1 + u) and u - rest =
      // (1 - c) (1 + u). In what follows 1 + u.head and the products of its few bits are exact.
      const double head = 1.0 + u.head;
      const LogEntry& entry = *PlaceOf(head).entry;
      const double c = entry.reciprocal;
      const double other = 1.0 - c;
      rest = Split({head * c - 1.0, u.tail * c});
      main = AddExactly(head * other, -entry.high);
      main.low += u.tail * other - entry.low;
    }
  } else {
    if (!(u.head > -1.0 && u.head < kLargest))
      return u.head > 0.0 ? u.head : std::numeric_limits<double>::infinity();
    const DoubleDouble z = AddExactly(1.0, u.head);
    const Reduced reduced = Reduce(AddOrdered(z.high, z.low + u.tail));
    rest = reduced.rest;
    const DoubleDouble first = AddExactly(u.head, -reduced.log.high);
    main = AddExactly(first.high, -rest.head);
    main.low += first.low + ((u.tail - reduced.log.low) - rest.tail);
  }
  const DoubleDouble near = NearDeviance(rest);
  const DoubleDouble sum = AddExactly(main.high, near.high);
  return AddOrdered(sum.high, sum.low + (main.low + near.low));
}

double LogDeviance(double u) {
  // ln(1 + u) = 2 atanh(r), and u - 2 r = r u. Between these limits |r| is at most 1/3.
  if (u >= -0.5 && u <= 1.0) {
    const double r = u / (2.0 + u);
    const double s = r * r;
    return r * (u - 2.0 * s * Polynomial(kLogSeries, s));
  }
  return u - std::log1p(u);
}

double GuardedExpMinus(DoubleDouble x) {
  return x.high <= -MCPower::gMachineMinExp ? ExpMinus(x) : 0.0;
}

double ExpMinus(DoubleDouble x) {
  // Where e^-x has come to 0. No number is what a product beyond the format leaves.
  if (!(x.high < 746.0)) return 0.0;
  const double main = std::exp(-x.high);
  return std::isinf(main) ? main : main - main * x.low;
}

// The name and the use of this function are C. Loader's, "Fast and accurate computation of binomial
// probabilities" (2000). Large a take Stirling's series, small ones a shift by one.
double StirlingError(double a) {
  const double v = 1.0 / a;
  if (a >= 10.0) return v * Polynomial(kStirlingSeries, v * v);
  if (a >= 3.0) return v / 12.0 * (Polynomial(kStirlingFar, v) / Polynomial(kStirlingFarDivisor, v));
  if (a >= 1.0) return v / 12.0 * (Polynomial(kStirlingNear, v) / Polynomial(kStirlingNearDivisor, v));
  return StirlingError(a + 1.0) + (a + 0.5) * (std::log1p(a) - std::log(a)) - 1.0;
}

double StirlingErrorOfCount(double m) {
  if (m < 16.0) return kStirlingOfCount[static_cast<int>(m)];
  // As much of Stirling's series as counts from 16 on.
  constexpr double kSeries[] = {kStirlingSeries[0], kStirlingSeries[1], kStirlingSeries[2],
                                kStirlingSeries[3], kStirlingSeries[4], kStirlingSeries[5]};
  const double v = 1.0 / m;
  return v * Polynomial(kSeries, v * v);
}

}  // namespace MCMath_800
