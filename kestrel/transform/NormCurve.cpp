#include "kestrel/transform/NormCurve.h"

#include <algorithm>
#include <cmath>

namespace MCKestrel_800 {
namespace {

// Points that are no numbers are in no order.
bool IsAscending(const std::vector<double>& numbers) {
  const auto descends = [](double left, double right) { return !(left <= right); };
  return std::adjacent_find(numbers.begin(), numbers.end(), descends) == numbers.end();
}

}  // namespace

NormCurve::NormCurve(const std::vector<double>& orig, const std::vector<double>& norm,
                     const std::vector<double>& slopes, const std::vector<double>& intercepts,
                     ScoreDictVar::OutlierHandleMethod outliers)
    : orig_(orig),
      norm_(norm),
      has_range_(orig.size() >= 2),
      is_ascending_(IsAscending(orig)),
      outliers_(outliers) {
  // Lists that do not belong together are no segments.
  if (slopes.size() == intercepts.size() && !orig.empty()) {
    lines_.reserve(slopes.size());
    for (std::size_t i = 0; i < slopes.size(); ++i)
      lines_.push_back({slopes[i], intercepts[i]});
  }
  if (orig.empty()) return;
  const auto [lowest, highest] = std::minmax_element(orig.begin(), orig.end());
  lowest_ = *lowest;
  highest_ = *highest;
  if (!has_range_ || !is_ascending_) return;
  inner_ = NumberSearch({orig.begin() + 1, orig.end() - 1});
  if (lines_.size() < 2 || lines_.size() + 1 != orig.size()) return;
  const double farthest = std::max(std::fabs(lowest_), std::fabs(highest_));
  for (const Line& line : lines_) {
    if (!std::isfinite(farthest * std::fabs(line.slope) + std::fabs(line.intercept))) return;
  }
  plain_lowest_ = lowest_;
  plain_highest_ = highest_;
}

double NormCurve::ComputeOther(double x) const {
  if (!IsOutOfContRange(x)) return CalculateNormValue(x);
  // Outliers treated as missing go on as those left as they are.
  return outliers_ == ScoreDictVar::kAsExtremeValues ? CalculateNormAsExtremeValues(x) : CalculateNormAsIs(x);
}

double NormCurve::CalculateNormValue(double x) const {
  if (lines_.empty()) return x;
  std::size_t segment = 0;
  if (orig_.size() >= 2 && lines_.size() >= 2) segment = FindSegment(x);
  return segment < lines_.size() ? lines_[segment].At(x) : x;
}

// The first segment that holds x with both its ends; the number of segments when there is none.
std::size_t NormCurve::FindSegment(double x) const {
  const std::size_t segments = orig_.size() - 1;
  const double* const orig = orig_.data();
  if (!is_ascending_) {
    std::size_t i = 0;
    while (i < segments && !(orig[i] <= x && x <= orig[i + 1]))
      ++i;
    return i;
  }
  // In ascending points it ends at the first point, but the very first, that is not below x.
  const std::size_t i = inner_.FirstNotBelow(x);
  return orig[i] <= x && x <= orig[i + 1] ? i : segments;
}

bool NormCurve::IsNearerToLowest(double x) const {
  return std::fabs(x - lowest_) <= std::fabs(x - highest_);
}

double NormCurve::CalculateNormAsIs(double x) const {
  if (orig_.size() < 2 || lines_.size() < 2) return x;
  return (IsNearerToLowest(x) ? lines_.front() : lines_.back()).At(x);
}

double NormCurve::CalculateNormAsExtremeValues(double x) const {
  if (orig_.empty() || orig_.size() != norm_.size()) return x;
  return IsNearerToLowest(x) ? norm_.front() : norm_.back();
}

}  // namespace MCKestrel_800
