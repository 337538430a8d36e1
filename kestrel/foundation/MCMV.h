// The missing number under the name that numerical code uses.

#ifndef KESTREL_FOUNDATION_MCMV_H
#define KESTREL_FOUNDATION_MCMV_H

#include <limits>

#include "kestrel/platform/Export.h"

namespace MCCommon_800 {

/// The missing value of numerical functions: the same double as `NumericValue::gSysmisValue`.
class KESTREL_API MCMV {
 public:
  static constexpr double gMissingValue = std::numeric_limits<double>::lowest();

  static constexpr double Missing() { return gMissingValue; }
  static constexpr bool IsMissing(double v) { return v == gMissingValue; }
};

}  // namespace MCCommon_800

#endif  // KESTREL_FOUNDATION_MCMV_H
