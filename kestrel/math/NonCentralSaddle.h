// Where the exponent of a non-central chi-square or F distribution has its saddle point, and the distribution
// by an integral through it.

#ifndef KESTREL_MATH_NONCENTRALSADDLE_H
#define KESTREL_MATH_NONCENTRALSADDLE_H

#include "kestrel/math/NonCentralSum.h"

namespace MCMath_800 {

/// The question whether chi-square with df1 degrees of freedom and some parameter is below a bound: a number,
/// or `odds` times a central chi-square of df2.
struct ChiQuotient {
  double df1;
  double df2;          ///< 0 for a number.
  DoubleDouble odds;   ///< 0 for a number.
  DoubleDouble bound;  ///< df2 odds, the mean of the bound, or the number.
  double y;            ///< 1 / (1 + odds)
};

ChiQuotient ChiAgainstNumber(double df, double x);
/// 0 <= odds <= 1e290.
ChiQuotient ChiAgainstChi(double df1, double df2, DoubleDouble odds);

/// The saddle point t of the cumulant function, as that of chi-square less its bound.
struct ChiSaddle {
  double u;         ///< 2 t / (1 - 2 t); 0 where the bound is the mean, below it for smaller bounds. Never 0.
  double w;         ///< 1 + u, with its own digits
  double part;      ///< how far the bound's own spread counts: (df1 + nc w) / df2, or 0
  double deviance;  ///< twice what the probability's logarithm loses, about: of two good digits at least
};
ChiSaddle FindSaddle(const ChiQuotient& quotient, double nc);

/// u - ln(w) for w = 1 + u > 0 with its own digits.
double SaddleDeviance(double u, double w);

/// A probability with its first two derivatives in the parameter.
struct NonCentralTail {
  double share;
  double slope;
  double bend;
};

/// Whether the saddle point is so close to the pole that the integral may go through that: either side is as
/// exact then.
bool IsCloseToPole(const ChiQuotient& quotient, double nc, const ChiSaddle& saddle);

/// Whether the integral may be taken on the other side of the pole than the saddle point is. With few degrees
/// of freedom below, another singularity comes too close there.
bool ReachesBothSides(const ChiQuotient& quotient, double nc, const ChiSaddle& saddle);

/// The share above the bound (`upper`) or below it; more exact on the side of u's sign. For nc w of at least
/// sixty, so that the integrand fades before it comes to its singularities. nc has two doubles, since t's is
/// a square.
NonCentralTail IntegrateSaddle(const ChiQuotient& quotient, DoubleDouble nc, const ChiSaddle& saddle,
                               bool upper, SumCare care);

}  // namespace MCMath_800

#endif  // KESTREL_MATH_NONCENTRALSADDLE_H
