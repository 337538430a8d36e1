// The piecewise linear function of a NormContinuous field, laid out for computing.

#ifndef KESTREL_TRANSFORM_NORMCURVE_H
#define KESTREL_TRANSFORM_NORMCURVE_H

#include <cstddef>
#include <limits>
#include <vector>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/transform/NumberSearch.h"

namespace MCKestrel_800 {

/// Points, segments and outlier treatment as a document gives them; incomplete ones leave numbers as they
/// are.
class NormCurve {
 public:
  NormCurve(const std::vector<double>& orig, const std::vector<double>& norm,
            const std::vector<double>& slopes, const std::vector<double>& intercepts,
            ScoreDictVar::OutlierHandleMethod outliers);

  double Compute(double x) const { return IsPlainAt(x) ? ComputePlain(x) : ComputeOther(x); }
  /// Whether there is but a line to be found, and the number on that line, which is finite.
  bool IsPlainAt(double x) const { return plain_lowest_ <= x && x <= plain_highest_; }
  double ComputePlain(double x) const { return lines_[inner_.FirstNotBelow(x)].At(x); }

 private:
  double ComputeOther(double x) const;
  bool IsOutOfContRange(double x) const { return has_range_ && (x > highest_ || x < lowest_); }
  double CalculateNormValue(double x) const;
  double CalculateNormAsIs(double x) const;
  double CalculateNormAsExtremeValues(double x) const;
  std::size_t FindSegment(double x) const;
  bool IsNearerToLowest(double x) const;

  struct Line {
    double slope;
    double intercept;
    double At(double x) const { return x * slope + intercept; }
  };

  // First what every case needs.
  std::vector<Line> lines_;
  /// Where the points ascend, each two of them have a line and no line leaves the numbers; nowhere when there
  /// is no such place.
  double plain_lowest_ = std::numeric_limits<double>::infinity();
  double plain_highest_ = -std::numeric_limits<double>::infinity();
  NumberSearch inner_;  ///< of ascending points: all but the first and the last one
  std::vector<double> orig_;
  std::vector<double> norm_;
  bool has_range_;
  bool is_ascending_;
  double lowest_ = 0.0;
  double highest_ = 0.0;
  ScoreDictVar::OutlierHandleMethod outliers_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_NORMCURVE_H
