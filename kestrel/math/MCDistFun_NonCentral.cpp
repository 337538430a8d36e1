// The non-central t, chi-square and F distribution.

#include <algorithm>
#include <cmath>
#include <limits>

#include "kestrel/foundation/MCMV.h"
#include "kestrel/math/MCDistFun.h"
#include "kestrel/math/NonCentralStart.h"
#include "kestrel/math/NonCentralTail.h"

namespace MCMath_800 {

namespace {

using MCCommon_800::MCMV;

bool IsDf(double df) {
  return df >= 0.01 && df <= 1e10;
}

/// A sum of many terms may end a unit in the last place outside.
double AsProbability(double p) {
  return std::isfinite(p) ? std::min(std::max(p, 0.0), 1.0) : MCMV::gMissingValue;
}

/// Where a search still looks, and whether its ends have been seen.
struct Bracket {
  double low;
  double high;
  bool low_seen = false;
  bool high_seen = false;

  void Narrow(double at, bool root_above) {
    (root_above ? low : high) = at;
    (root_above ? low_seen : high_seen) = true;
  }
  bool Holds(double at) const { return at >= low && at <= high; }
  /// Where to look instead of at a point outside: at the end that nobody has seen, or halfway on the scale of
  /// asinh.
  double Inside(double at) const {
    if (at < low && !low_seen) return low;
    if (at > high && !high_seen) return high;
    return std::sinh(0.5 * (std::asinh(low) + std::asinh(high)));
  }
};

/// The non-centrality in the bracket at which the share below is p. tail(nc, upper, care) gives the share,
/// which falls with nc, or the share above.
///
/// Halley's method on the logarithm of the smaller tail. The error after a step is about its cube, so that
/// rough shares do until one more step is the last: one whose own error changes p by less than p's last
/// digit.
template <class Tail>
double FindNonCentrality(double p, Bracket bracket, double start, const Tail& tail) {
  constexpr int kStepLimit = 100;
  constexpr double kRounding = 0x1p-53;
  // About what a rough share may be wrong by, with a margin, and the step after which a full one is worth it.
  constexpr double kDoubt = 0.02;
  constexpr double kClose = 1e-6;
  const bool upper = p > 0.5;
  const double target = upper ? 1.0 - p : p;
  // The normal distribution's, about: what turns a change of ln p into deviations.
  const double hazard = std::max(1.0, -MCDistFun::IdfStdNorm(target));
  double at = start;
  SumCare care = SumCare::kRough;
  for (int step = 0; step < kStepLimit && bracket.low < bracket.high; ++step) {
    const NonCentralTail point = tail(at, upper, care);
    const double away = point.share > 0.0 ? std::log(point.share / target) : -1.0;
    const bool full = care == SumCare::kFull;
    if (full && away == 0.0) return at;
    if (full || std::fabs(away) > kDoubt) bracket.Narrow(at, (away > 0.0) != upper);
    const double rate = point.slope / point.share;
    const double skew = 0.5 * away * (point.bend / (point.slope * rate) - 1.0);
    const double next = at - away / rate / std::min(std::max(1.0 - skew, 0.5), 2.0);
    // What the step leaves of `away`.
    const double rest = std::fabs(away) * (4.0 * skew * skew + 0.25 * (away / hazard) * (away / hazard));
    if (full && rest < kRounding) return std::min(std::max(next, bracket.low), bracket.high);
    if (rest < kClose) care = SumCare::kFull;
    const double inside = bracket.Holds(next) ? next : bracket.Inside(next);
    if (inside == at) {
      if (full) return bracket.Holds(next) ? at : MCMV::gMissingValue;
      care = SumCare::kFull;
    }
    at = inside;
  }
  return MCMV::gMissingValue;
}

/// Smaller probabilities are no normal numbers: too few digits to search by.
bool IsSearchable(double p) {
  return p >= std::numeric_limits<double>::min() && p < 1.0;
}

bool IsNc(double nc) {
  return nc >= 0.0 && nc <= kLargestChiParameter;
}

}  // namespace

double MCDistFun::NonCentralCdfT(double x, double df, double nc) {
  if (std::isnan(x) || !IsDf(df) || !(std::fabs(nc) <= kLargestStudentParameter)) return MCMV::gMissingValue;
  return AsProbability(FindStudentTail(x, df, nc, false, SumCare::kFull).share);
}

double MCDistFun::NonCentralCdfChi(double x, double df, double nc) {
  if (std::isnan(x) || !IsDf(df) || !IsNc(nc)) return MCMV::gMissingValue;
  return x <= 0.0 ? 0.0 : AsProbability(FindChiTail(x, df, nc, false, SumCare::kFull).share);
}

double MCDistFun::NonCentralCdfF(double x, double df1, double df2, double nc, bool upper) {
  if (std::isnan(x) || !IsDf(df1) || !IsDf(df2) || !IsNc(nc)) return MCMV::gMissingValue;
  if (x <= 0.0) return upper ? 1.0 : 0.0;
  const DoubleDouble odds = DoubleDouble(df1) / df2 * x;
  long err = 0;
  const double share = ncdbet(odds, 0.5 * df1, 0.5 * df2, nc, upper, err);
  return err == 0 ? share : MCMV::gMissingValue;
}

double MCDistFun::FindNCParamT(double x, double df, double p) {
  if (!std::isfinite(x) || !IsDf(df) || !IsSearchable(p)) return MCMV::gMissingValue;
  const double z = IdfStdNorm(p);
  if (x == 0.0) return -z;
  return FindNonCentrality(
      p, {-kLargestStudentParameter, kLargestStudentParameter}, StartStudentParameter(z, x, df),
      [&](double nc, bool upper, SumCare care) { return FindStudentTail(x, df, nc, upper, care); });
}

double MCDistFun::FindNCParamChi(double x, double df, double p) {
  if (!std::isfinite(x) || x <= 0.0 || !IsDf(df) || !IsSearchable(p)) return MCMV::gMissingValue;
  const double central = FindChiTail(x, df, 0.0, false, SumCare::kFull).share;
  if (p >= central) return p == central ? 0.0 : MCMV::gMissingValue;
  return FindNonCentrality(
      p, {0.0, kLargestChiParameter}, StartChiParameter(IdfStdNorm(p), x, df),
      [&](double nc, bool upper, SumCare care) { return FindChiTail(x, df, nc, upper, care); });
}

double MCDistFun::FindNCParamF(double x, double df1, double df2, double p) {
  if (!std::isfinite(x) || x <= 0.0 || !IsDf(df1) || !IsDf(df2) || !IsSearchable(p))
    return MCMV::gMissingValue;
  const DoubleDouble odds = DoubleDouble(df1) / df2 * x;
  const double a = 0.5 * df1, b = 0.5 * df2;
  const double central = FindBetaTail(odds, a, b, 0.0, false, SumCare::kFull).share;
  if (p >= central) return p == central ? 0.0 : MCMV::gMissingValue;
  return FindNonCentrality(
      p, {0.0, kLargestChiParameter}, StartFParameter(IdfStdNorm(p), odds.high, df1, df2),
      [&](double nc, bool upper, SumCare care) { return FindBetaTail(odds, a, b, nc, upper, care); });
}

double MCDistFun::ncdbet(const DoubleDouble& odds, const double& a, const double& b, const double& nc,
                         bool upper, long& err) {
  const double share = FindBetaTail(odds, a, b, nc, upper, SumCare::kFull).share;
  if (!std::isfinite(share)) err = 1;
  return AsProbability(share);
}

}  // namespace MCMath_800
