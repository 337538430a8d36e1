// Distribution functions, their inverses and upper tails: what probabilities and significances are made of.

#ifndef KESTREL_MATH_MCDISTFUN_H
#define KESTREL_MATH_MCDISTFUN_H

#include "kestrel/platform/Export.h"

namespace MCMath_800 {

/// Cumulative distribution functions (Cdf), their inverses (Idf) and upper-tail significances (Sig).
///
/// Every function gives a finite double for any arguments. Arguments outside the domain that stand with each
/// function, a NaN, an infinite parameter, and a result that is too large give the missing value of `MCMV`.
/// An infinite x is a point like others: it gives the limit, 0 or 1. The missing value as an argument is the
/// number that it is. Upper tails are computed as such, so that a small one has all its digits; the figures
/// are in docs/accuracy.md. Nothing throws or allocates; any number of threads may call at once.
class KESTREL_API MCDistFun {
 public:
  // --- The normal distribution. sd > 0; 0 < p < 1. ---
  static double CdfStdNorm(double x);
  static double CdfNorm(double x, double mean, double sd);
  /// p = 0.5 gives exactly 0, or the mean.
  static double IdfStdNorm(double p);
  static double IdfNorm(double p, double mean, double sd);

  // --- Student's t. df > 0; 0 < p < 1. ---
  static double CdfT(double x, double df);
  static double IdfT(double p, double df);
  static double SigT(double x, double df);

  // --- Chi-square. df > 0; 0 <= p < 1. x <= 0 gives 0 (SigChi: 1). ---
  static double CdfChi(double x, double df);
  static double IdfChi(double p, double df);
  static double SigChi(double x, double df);

  // --- F. df1, df2 > 0; 0 <= p < 1. x <= 0 gives 0 (SigF: 1). ---
  static double CdfF(double x, double df1, double df2);
  static double IdfF(double p, double df1, double df2);
  static double SigF(double x, double df1, double df2);

  // --- Beta. a, b > 0; 0 <= p <= 1. x <= 0 gives 0, x >= 1 gives 1. ---
  static double CdfBeta(double x, double a, double b);
  static double IdfBeta(double p, double a, double b);

  // --- Gamma. shape, rate > 0; 0 <= p < 1. x <= 0 gives 0. ---
  static double CdfGam(double x, double shape, double rate);
  static double IdfGam(double p, double shape, double rate);

  /// The logarithm of the gamma function at x > 0.
  static double vexadnlgam(double x);

 private:
  // The tests' way to the workers.
  friend struct DistFunWorkers;

  // Workers expect arguments in the domain. Those with an error code set it: 0, or 1 when there is no finite
  // answer.
  static double probit(const double& p);
  static double prbnrm(const double& z);
  static double derf(const double& x);
  static double derfc(const double& x);

  static double dnlgam(const double& x, long& err);
  /// ln of the binomial coefficient n over k, 0 <= k <= n; neither need be whole.
  static double dnlbnc(const double& n, const double& k, long& err);

  /// The incomplete gamma ratio P(shape, x), or Q = 1 - P.
  static double gammad(const double& x, const double& shape, bool upper, long& err);
  static double cdfexp(const double& x, const double& rate, long& err);
  /// A first approximation to the chi-square quantile, for vexaidfchi.
  static double idfchb(const double& p, const double& df);
  static double vexaidfchi(const double& p, const double& df, long& err);

  /// The incomplete beta ratio I_x(a, b), or its complement. x + y = 1, deviation = b * x - a * y: the caller
  /// has them with more digits than x alone can carry.
  static double cbtaux(const double& x, const double& y, const double& deviation, const double& a,
                       const double& b, bool upper, long& err);
  static double cdfbet(const double& x, const double& a, const double& b, long& err);
  static double betinv(const double& p, const double& a, const double& b, long& err);

  /// P(T > size), size >= 0.
  static double vexasigt(const double& size, const double& df, long& err);
  static double vexacdft(const double& x, const double& df, long& err);
  static double vexaidft(const double& p, const double& df, long& err);
  /// The share of the F distribution below f, or above it.
  static double vexaratf(const double& f, const double& df1, const double& df2, bool upper, long& err);
  static double vexacdff(const double& x, const double& df1, const double& df2, long& err);
  static double vexaidff(const double& p, const double& df1, const double& df2, long& err);
};

}  // namespace MCMath_800

#endif  // KESTREL_MATH_MCDISTFUN_H
