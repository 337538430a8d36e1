// The tails of the non-central t, chi-square and F distribution, and how they change with the parameter.

#ifndef KESTREL_MATH_NONCENTRALTAIL_H
#define KESTREL_MATH_NONCENTRALTAIL_H

#include "kestrel/math/NonCentralSaddle.h"
#include "kestrel/math/NonCentralSum.h"

namespace MCMath_800 {

// The share below x, or above it (`upper`), for arguments inside the limits that MCDistFun states; x may be
// infinite.

NonCentralTail FindStudentTail(double x, double df, double nc, bool upper, SumCare care);

/// x > 0.
NonCentralTail FindChiTail(double x, double df, double nc, bool upper, SumCare care);

/// The non-central beta distribution at odds / (1 + odds), odds >= 0; a and b are half the degrees of
/// freedom.
NonCentralTail FindBetaTail(DoubleDouble odds, double a, double b, double nc, bool upper, SumCare care);

}  // namespace MCMath_800

#endif  // KESTREL_MATH_NONCENTRALTAIL_H
