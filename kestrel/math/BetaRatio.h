// The incomplete beta function, and the power term in front of its series.

#ifndef KESTREL_MATH_BETARATIO_H
#define KESTREL_MATH_BETARATIO_H

#include "kestrel/math/DoubleDouble.h"

namespace MCMath_800 {

/// Where a beta distribution is asked, with more digits than x alone can carry: near x = 1 the distance y
/// counts, for large a and b the distance from the mean, and in far tails the last digits of all three.
struct BetaPoint {
  DoubleDouble x;          ///< Above 0 and below 1 unless rounded to it.
  DoubleDouble y;          ///< 1 - x.
  DoubleDouble deviation;  ///< b * x - a * y: 0 where x is the mean a / (a + b).
};

// All for finite a, b and a + b, a, b > 0 and 0 < x, y.

/// The point of an x that is exact as it stands.
BetaPoint MakeBetaPoint(double x, double a, double b);

/// ln B(a, b).
double LogBeta(double a, double b);

/// x^a y^b / B(a, b), the beta density times x * y. 0 when it is too small.
double BetaPower(const BetaPoint& point, double a, double b);

/// I_x(a, b), the share of the beta distribution below x, or the share above it.
double BetaRatio(const BetaPoint& point, double a, double b, bool upper);

}  // namespace MCMath_800

#endif  // KESTREL_MATH_BETARATIO_H
