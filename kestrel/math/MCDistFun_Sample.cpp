// Percentiles of a sample, and a confidence interval of its median.

#include <algorithm>
#include <cmath>

#include "kestrel/foundation/MCMV.h"
#include "kestrel/math/MCDistFun.h"

namespace MCMath_800 {

namespace {

using MCCommon_800::MCMV;

/// Values with their weights, ordered side by side. Without weights each case counts once.
class Cases {
 public:
  Cases(long n, double* values, double* weights) : n_(n), values_(values), weights_(weights) {}

  long Count() const { return n_; }
  double Value(long i) const { return values_[i]; }
  /// 0 for a case that does not count.
  double Weight(long i) const {
    if (MCMV::IsMissing(values_[i])) return 0.0;
    if (weights_ == nullptr) return 1.0;
    return MCMV::IsMissing(weights_[i]) ? 0.0 : weights_[i];
  }

  /// Whether every value and every weight is a number that a sample can have.
  bool AreUsable() const {
    for (long i = 0; i < n_; ++i) {
      if (!std::isfinite(values_[i]) || !std::isfinite(Weight(i)) || Weight(i) < 0.0) return false;
      if (weights_ != nullptr && !std::isfinite(weights_[i])) return false;
    }
    return true;
  }

  /// A heap sort where the weights have to move along: in place, and never slower than n log n.
  void Sort() {
    if (std::is_sorted(values_, values_ + n_)) return;
    if (weights_ == nullptr) {
      std::sort(values_, values_ + n_);
      return;
    }
    for (long root = n_ / 2; root-- > 0;)
      Sink(root, n_);
    for (long end = n_; --end > 0;) {
      Swap(0, end);
      Sink(0, end);
    }
  }

 private:
  void Swap(long i, long j) {
    std::swap(values_[i], values_[j]);
    std::swap(weights_[i], weights_[j]);
  }
  void Sink(long root, long end) {
    // Counted so that no index passes end, where long may be 32 bits.
    while (root <= (end - 2) / 2 && end >= 2) {
      long child = 2 * root + 1;
      if (child < end - 1 && values_[child] < values_[child + 1]) ++child;
      if (values_[root] >= values_[child]) return;
      Swap(root, child);
      root = child;
    }
  }

  long n_;
  double* values_;
  double* weights_;
};

/// Where a position between 0 and the sum of the weights falls: between two neighbouring distinct values.
struct Place {
  double below;    ///< The largest value whose cumulative weight does not exceed the position.
  double above;    ///< The next larger value; the same where there is none.
  double reached;  ///< The cumulative weight of `below`.
  double beyond;   ///< The position minus that.
  double weight;   ///< The weight of `above`.
};

Place FindPlace(const Cases& cases, double position) {
  // Products such as 100 * 0.07 are a few units off the whole number that is meant.
  const double slack = 4.0 * 2.220446049250313e-16 * position;
  Place place{0.0, 0.0, 0.0, 0.0, 0.0};
  bool any = false;
  double sum = 0.0;
  long i = 0;
  while (i < cases.Count()) {
    const double value = cases.Value(i);
    double weight = 0.0;
    for (; i < cases.Count() && cases.Value(i) == value; ++i)
      weight += cases.Weight(i);
    if (weight == 0.0) continue;
    if (!any) place.below = value;
    any = true;
    place.above = value;
    place.weight = weight;
    if (sum + weight > position + slack) break;
    sum += weight;
    place.below = value;
    place.reached = sum;
  }
  const double beyond = position - place.reached;
  place.beyond = beyond > slack ? beyond : 0.0;
  return place;
}

/// The straight line from `below` to `above` over the first unit of the latter's weight, or over all of it
/// when there is less. A value of weight 3 is three equal values, of which the second and the third follow an
/// equal one.
double Interpolate(const Place& place) {
  const double share = place.weight > 0.0 ? place.beyond / std::min(place.weight, 1.0) : 0.0;
  if (share <= 0.0) return place.below;
  if (share >= 1.0) return place.above;
  return (1.0 - share) * place.below + share * place.above;
}

double Closest(const Place& place) {
  const double share = place.weight > 0.0 ? place.beyond / std::min(place.weight, 1.0) : 0.0;
  const bool evenRank = std::fmod(place.reached, 2.0) == 0.0;
  // Below the first value there is no rank to be even.
  return share > 0.5 || (share == 0.5 && !(evenRank && place.reached > 0.0)) ? place.above : place.below;
}

/// The position of Tukey's hinge or the median, or a negative number for other shares.
double HingePosition(double sum, double p) {
  const double depth = std::floor((sum + 3.0) / 2.0) / 2.0;
  if (p == 0.25) return depth;
  if (p == 0.5) return (sum + 1.0) / 2.0;
  return p == 0.75 ? sum + 1.0 - depth : -1.0;
}

/// The position sum * p + start + slope * p of the definitions that interpolate.
struct Line {
  MCDistFun::PercentileMethod method;
  double start;
  double slope;
};
constexpr Line kLines[] = {
    {MCDistFun::kWeightedAverage, 0.0, 0.0},
    {MCDistFun::kWeightedAverageHalf, 0.5, 0.0},
    {MCDistFun::kWeightedAveragePlus, 0.0, 1.0},
    {MCDistFun::kWeightedAverageMinus, 1.0, -1.0},
    {MCDistFun::kMedianUnbiased, 1.0 / 3.0, 1.0 / 3.0},
    {MCDistFun::kNormalUnbiased, 0.375, 0.25},
};

double Percentile(const Cases& cases, double sum, double p, MCDistFun::PercentileMethod method) {
  for (const Line& line : kLines) {
    if (line.method == method)
      return Interpolate(FindPlace(cases, std::max(0.0, sum * p + (line.start + line.slope * p))));
  }
  if (method == MCDistFun::kTukeyHinges) {
    const double position = HingePosition(sum, p);
    return position < 0.0 ? MCMV::gMissingValue : Interpolate(FindPlace(cases, position));
  }
  const Place place = FindPlace(cases, sum * p);
  switch (method) {
    case MCDistFun::kEmpirical:
      return place.beyond > 0.0 ? place.above : place.below;
    case MCDistFun::kEmpiricalAverage:
      // Halves, since the sum of two large values may be none.
      if (place.beyond > 0.0) return place.above;
      return place.reached > 0.0 ? 0.5 * place.below + 0.5 * place.above : place.below;
    case MCDistFun::kClosest:
      return Closest(place);
    default:
      return MCMV::gMissingValue;
  }
}

/// The share of the binomial distribution with prob 1/2 from `rank` to n - rank, 1 <= rank <= n / 2 or so: by
/// its two tails, or, where little is left of 1, by what lies between them.
double MiddleShare(double n, double rank) {
  long err = 0;
  const double tails = 2.0 * MCDistFun::CdfBin(rank - 1.0, n, 0.5, err);
  if (tails <= 0.5) return 1.0 - tails;
  double k = std::floor(n / 2.0);
  double probability = MCDistFun::PdfBin(k, n, 0.5, err);
  // Even n have one count in the middle, odd ones two.
  double sum = k + k == n ? 0.5 * probability : probability;
  for (; k > rank; k -= 1.0) {
    probability *= k / (n - k + 1.0);
    sum += probability;
  }
  return 2.0 * sum;
}

}  // namespace

double MCDistFun::GPTile(long n, double* values, double* weights, double p, PercentileMethod method) {
  if (n <= 0 || values == nullptr || !(p >= 0.0 && p <= 1.0)) return MCMV::gMissingValue;
  Cases cases(n, values, weights);
  if (!cases.AreUsable()) return MCMV::gMissingValue;
  cases.Sort();
  double sum = 0.0;
  for (long i = 0; i < n; ++i)
    sum += cases.Weight(i);
  if (!(sum > 0.0) || !std::isfinite(sum)) return MCMV::gMissingValue;
  return Percentile(cases, sum, p, method);
}

double MCDistFun::Mednci(long n, double* values, double level, double& lower, double& upper) {
  lower = upper = MCMV::gMissingValue;
  if (n <= 0 || values == nullptr || !(level > 0.0 && level < 1.0)) return MCMV::gMissingValue;
  Cases cases(n, values, nullptr);
  if (!cases.AreUsable()) return MCMV::gMissingValue;
  // The missing value is the smallest number there is, so that cases without a value come first.
  cases.Sort();
  long first = 0;
  while (first < n && MCMV::IsMissing(values[first]))
    ++first;
  const long count = n - first;
  if (count < 1) return MCMV::gMissingValue;
  // The rank r gives 1 - 2 P(X < r): the largest that keeps the level, give or take its rounding.
  const double tail = (1.0 - level) / 2.0 * (1.0 + 8.0 * 2.220446049250313e-16);
  long err = 0;
  double rank = IdfBin(tail, static_cast<double>(count), 0.5, err);
  if (err != 0) return MCMV::gMissingValue;
  if (CdfBin(rank, static_cast<double>(count), 0.5, err) <= tail) rank += 1.0;
  if (rank < 1.0) return MCMV::gMissingValue;
  const long place = static_cast<long>(rank);
  lower = values[first + place - 1];
  upper = values[n - place];
  return MiddleShare(static_cast<double>(count), rank);
}

}  // namespace MCMath_800
