#include "kestrel/math/Logarithm.h"

#include <cmath>
#include <limits>

#include "kestrel/math/DoubleDouble.h"
#include "kestrel/math/SaddlePoint.h"

namespace MCMath_800 {

namespace {

/// ln x for a positive finite x.
DoubleDouble LongLogarithm(double x) {
  // Denormal and very large numbers are brought to where the table of logarithms serves.
  constexpr double kStep = 0x1p100;
  constexpr DoubleDouble kLogOfStep = {0x1.1542457337d43p+6, -0x1.e3948c376279dp-50};
  if (x < std::numeric_limits<double>::min()) return Log(x * kStep) - kLogOfStep;
  if (x > 0x1p900) return Log(x / kStep) + kLogOfStep;
  // As small as a result may be next to 1, it has all its digits this way; the difference is exact.
  if (x > 0.99 && x < 1.01) return LogOfOnePlus(x - 1.0);
  return Log(x);
}

}  // namespace

double DecimalLogarithm(double x) {
  if (!(x > 0.0 && x <= std::numeric_limits<double>::max())) return std::log10(x);
  // 1 / ln 10.
  constexpr DoubleDouble kScale = {0x1.bcb7b1526e50ep-2, 0x1.95355baaafad3p-57};
  const DoubleDouble log = LongLogarithm(x) * kScale;
  return log.high + log.low;
}

}  // namespace MCMath_800
