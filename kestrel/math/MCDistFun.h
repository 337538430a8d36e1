// Distribution functions, their inverses and upper tails: what probabilities and significances are made of.

#ifndef KESTREL_MATH_MCDISTFUN_H
#define KESTREL_MATH_MCDISTFUN_H

#include "kestrel/platform/Export.h"

namespace MCMath_800 {

struct BetaPoint;
struct DoubleDouble;

/// Cumulative distribution functions (Cdf), their inverses (Idf) and upper-tail significances (Sig).
///
/// Every function gives a finite double for any arguments. Arguments outside the domain that stand with each
/// function, a NaN, an infinite parameter, and a result that is too large give the missing value of `MCMV`.
/// An infinite x is a point like others in every distribution function and significance: it gives the limit,
/// 0 or 1. The missing value as an argument is the number that it is. Upper tails are computed as such, so
/// that a small one has all its digits; the figures are in docs/accuracy.md. Nothing throws or allocates; any
/// number of threads may call at once.
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

  // --- Counts. n, total, successes and draws are whole numbers from 0 to 2^53, 0 <= prob <= 1. err is 0, or
  // 1 with the missing value: an argument outside the domain. ---
  /// The probability of x successes in n trials; 0 for an x that is no count from 0 to n.
  static double PdfBin(double x, double n, double prob, long& err);
  /// Of at most x successes.
  static double CdfBin(double x, double n, double prob, long& err);
  /// The smallest count whose CdfBin reaches p, 0 <= p <= 1.
  static double IdfBin(double p, double n, double prob, long& err);
  /// Of at most x successes among `draws` out of `total` without replacement; successes, draws <= total.
  static double CDFHyper(double x, double total, double successes, double draws, long& err);

  // --- Non-central distributions. 0.01 <= df <= 1e10; 0 <= nc <= 1e9, for t from -3e4 to 3e4. Everything
  // else is missing. ---
  static double NonCentralCdfT(double x, double df, double nc);
  static double NonCentralCdfChi(double x, double df, double nc);
  /// upper  gives the share above x, the power of an F test, with all its digits where it is small.
  static double NonCentralCdfF(double x, double df1, double df2, double nc, bool upper = false);
  /// The nc at which the distribution function at x, a finite number, is p, 2.3e-308 <= p < 1. Missing when
  /// there is none: chi-square and F take only a p up to that of nc = 0. At most 100 steps, as a rule two.
  static double FindNCParamT(double x, double df, double p);
  static double FindNCParamChi(double x, double df, double p);
  static double FindNCParamF(double x, double df1, double df2, double p);

  /// How a percentile lies between the ordered values. Numbered as by R. J. Hyndman and Y. Fan, "Sample
  /// quantiles in statistical packages" (1996). W is the sum of the weights, and a value of weight w stands
  /// for w equal values.
  enum PercentileMethod {
    kEmpirical = 1,             ///< The first value whose cumulative weight reaches W p.
    kEmpiricalAverage = 2,      ///< The same, but where it is reached exactly halfway to the next value.
    kClosest = 3,               ///< The value closest to the position W p; of two, the one of even rank.
    kWeightedAverage = 4,       ///< Between the values around the position W p.
    kWeightedAverageHalf = 5,   ///< ... W p + 1/2.
    kWeightedAveragePlus = 6,   ///< ... (W + 1) p.
    kWeightedAverageMinus = 7,  ///< ... (W - 1) p + 1.
    kMedianUnbiased = 8,        ///< ... (W + 1/3) p + 1/3.
    kNormalUnbiased = 9,        ///< ... (W + 1/4) p + 3/8.
    kTukeyHinges = 10           ///< J. W. Tukey's hinges and the median; p is 0.25, 0.5 or 0.75.
  };

  // --- Samples of n >= 1 values, sorted in place: asked again they cost one pass. Nothing is copied. Cases
  // with the missing value do not count. A NaN or an infinity among them, or no case that counts, gives the
  // missing value. ---
  /// The percentile at the share p, 0 <= p <= 1.
  /// weights  n numbers >= 0, moved along with their values; null: 1 each. A missing one does not count.
  static double GPTile(long n, double* values, double* weights, double p,
                       PercentileMethod method = kWeightedAveragePlus);
  /// The confidence interval of the median that holds for any continuous distribution: from the r-th smallest
  /// value to the r-th largest, r as large as the level allows. Returns the exact probability with which such
  /// intervals hold the median, at least `level`, 0 < level < 1.
  /// lower, upper  overwritten; missing, as is the result, when the sample is too small for the level.
  static double Mednci(long n, double* values, double level, double& lower, double& upper);

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

  /// The incomplete beta ratio I_x(a, b), or its complement.
  static double cbtaux(const BetaPoint& point, const double& a, const double& b, bool upper, long& err);
  static double cdfbet(const double& x, const double& a, const double& b, long& err);
  static double betinv(const double& p, const double& a, const double& b, long& err);

  /// The non-central beta distribution at odds / (1 + odds), or above it; nc is the numerator's.
  static double ncdbet(const DoubleDouble& odds, const double& a, const double& b, const double& nc,
                       bool upper, long& err);

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
