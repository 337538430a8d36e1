// The binomial and the hypergeometric distribution.

#include <algorithm>
#include <cmath>

#include "kestrel/foundation/MCMV.h"
#include "kestrel/math/BetaRatio.h"
#include "kestrel/math/MCDistFun.h"
#include "kestrel/math/PointProbability.h"

namespace MCMath_800 {

namespace {

using MCCommon_800::MCMV;

double Refuse(long& err) {
  err = 1;
  return MCMV::gMissingValue;
}

/// Whether the arguments are a binomial distribution's.
bool IsBinomial(double n, double prob) {
  return IsCount(n) && prob >= 0.0 && prob <= 1.0;
}

/// The share of the counts from 0 to k, 0 <= k < n, 0 < prob < 1: that of the beta distribution of the
/// (k + 1)-th smallest of n uniform numbers above prob.
double BinomialShare(double k, double n, double prob) {
  return BetaRatio(MakeBetaPoint(prob, k + 1.0, n - k), k + 1.0, n - k, true);
}

/// The count at which the normal distribution, corrected for skewness (Cornish and Fisher 1938), reaches p.
double FirstCount(double p, double n, double prob) {
  // 1.0 is reached by rounding about here.
  constexpr double kLast = 8.3;
  const double normal = p == 1.0 ? kLast : MCDistFun::IdfStdNorm(p);
  const double variance = n * prob * (1.0 - prob);
  const double count = std::ceil(n * prob + normal * std::sqrt(variance) +
                                 (1.0 - 2.0 * prob) * (normal * normal - 1.0) / 6.0 - 0.5);
  return std::min(std::max(count, 0.0), n);
}

/// How far from k the share reaches p, by Newton's step: on the logarithm below the median, where the share
/// falls off faster than any line.
double NewtonStep(double p, double share, double probability) {
  if (share < 0.5) return share / probability * std::log(p / share);
  return (p - share) / probability;
}

/// The smallest count whose share reaches p, 0 < p <= 1: Newton's steps inside a bracket, and when rounding
/// keeps them from closing it, growing steps from its end that moved last, halving at most.
double SmallestCount(double p, double n, double prob) {
  constexpr int kNewtonSteps = 6;
  double low = 0.0, high = n;  // The share of high reaches p, that of low - 1 does not.
  double k = FirstCount(p, n, prob);
  double stride = 1.0;
  for (int step = 0; low < high; ++step) {
    k = std::min(std::max(k, low), high - 1.0);
    const double share = BinomialShare(k, n, prob);
    const double probability = BinomialProbability(k, n, prob);
    const bool reached = share >= p;
    if (reached) {
      high = k;
      // The share of k - 1 is known well enough, unless it is close to p.
      if (share - probability < p - 1e-9 * share) low = k;
    } else {
      low = k + 1.0;
    }
    if (step < kNewtonSteps && probability > 0.0 && share > 0.0) {
      k = std::ceil(k + NewtonStep(p, share, probability));
    } else {
      const double middle = low + std::floor((high - low) / 2.0);
      k = reached ? std::max(middle, high - stride) : std::min(middle, low + stride);
      stride *= 4.0;
    }
  }
  return low;
}

}  // namespace

double MCDistFun::PdfBin(double x, double n, double prob, long& err) {
  err = 0;
  if (!IsBinomial(n, prob) || std::isnan(x)) return Refuse(err);
  if (x > n || !IsCount(x)) return 0.0;
  if (prob == 0.0) return x == 0.0 ? 1.0 : 0.0;
  if (prob == 1.0) return x == n ? 1.0 : 0.0;
  return BinomialProbability(x, n, prob);
}

double MCDistFun::CdfBin(double x, double n, double prob, long& err) {
  err = 0;
  if (!IsBinomial(n, prob) || std::isnan(x)) return Refuse(err);
  if (x < 0.0) return 0.0;
  if (x >= n || prob == 0.0) return 1.0;
  if (prob == 1.0) return 0.0;
  return BinomialShare(std::floor(x), n, prob);
}

double MCDistFun::IdfBin(double p, double n, double prob, long& err) {
  err = 0;
  if (!IsBinomial(n, prob) || !(p >= 0.0 && p <= 1.0)) return Refuse(err);
  if (p == 0.0 || prob == 0.0) return 0.0;
  if (prob == 1.0) return n;
  return SmallestCount(p, n, prob);
}

double MCDistFun::CDFHyper(double x, double total, double successes, double draws, long& err) {
  err = 0;
  if (!IsCount(total) || !IsCount(successes) || !IsCount(draws) || successes > total || draws > total ||
      std::isnan(x))
    return Refuse(err);
  const double failures = total - successes;
  const double k = std::floor(x);
  if (k < 0.0 || k < draws - failures) return 0.0;
  if (k >= std::min(draws, successes)) return 1.0;
  const FourFold table{k, successes - k, draws - k, failures - (draws - k)};
  // k at most the mean. Above it the failures that are drawn have the smaller tail.
  if (k <= successes * (draws / total)) return HypergeometricLowerTail(table);
  return 1.0 - HypergeometricLowerTail(
                   {table.drawnFailures - 1.0, table.leftFailures + 1.0, k + 1.0, table.leftSuccesses - 1.0});
}

}  // namespace MCMath_800
