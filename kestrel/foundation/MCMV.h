// The missing number under the name that numerical code uses.

#ifndef KESTREL_FOUNDATION_MCMV_H
#define KESTREL_FOUNDATION_MCMV_H

#include <limits>

namespace MCCommon_800 {

/// The missing value of numerical functions: the same double as `NumericValue::gSysmisValue`.
class MCMV {
 public:
  static constexpr double gMissingValue = std::numeric_limits<double>::lowest();

  static constexpr double Missing() { return gMissingValue; }
  static constexpr bool IsMissing(double v) { return v == gMissingValue; }
};

}  // namespace MCCommon_800

#endif  // KESTREL_FOUNDATION_MCMV_H
