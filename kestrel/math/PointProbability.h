// Probabilities of single counts, by Loader's saddle-point expansion.

#ifndef KESTREL_MATH_POINTPROBABILITY_H
#define KESTREL_MATH_POINTPROBABILITY_H

#include <cstdint>

namespace MCMath_800 {

/// The largest count: up to 2^53 every whole number is a double of its own.
constexpr double kLargestCount = 9007199254740992.0;

/// Whether n is a whole number from 0 to kLargestCount.
inline bool IsCount(double n) {
  // The conversion there and back is shorter than std::floor.
  return n >= 0.0 && n <= kLargestCount && static_cast<double>(static_cast<std::int64_t>(n)) == n;
}

/// The probability of k successes in n trials, k <= n both counts, 0 < prob < 1. 0 when it is too small.
double BinomialProbability(double k, double n, double prob);

/// A draw without replacement as a table of four cells. They may lie between whole numbers, which gives the
/// smooth curve through the probabilities.
struct FourFold {
  double drawnSuccesses;
  double leftSuccesses;
  double drawnFailures;
  double leftFailures;
};

/// The probability of the table, given its margins. 0 when it is too small.
double HypergeometricProbability(const FourFold& table);

/// The probability of the table's number of drawn successes or any smaller one, given its margins. Counts
/// with no other than the table below them give the probability of the table. Meant for the lower tail: above
/// the mean it takes the road through more and more terms, and digits are lost.
double HypergeometricLowerTail(const FourFold& table);

}  // namespace MCMath_800

#endif  // KESTREL_MATH_POINTPROBABILITY_H
