#include "kestrel/math/MCPower.h"

#include <cmath>

#include "kestrel/foundation/MCMV.h"

namespace MCMath_800 {

using MCCommon_800::MCMV;

namespace {

// 1/3 as a double is not quite one third: so far may a root's exponent be off.
constexpr double kRootTolerance = 32.0;

}  // namespace

// Defined here too, so that hosts and plug-ins can take their address.
constexpr double MCPower::gMachineEpsilon;
constexpr int MCPower::gMachineMaxInt;
constexpr double MCPower::gMachineMaxExp;
constexpr double MCPower::gMachineMinExp;

double MCPower::MaxExp() {
  return gMachineMaxExp;
}

double MCPower::MinExp() {
  return gMachineMinExp;
}

int MCPower::MaxInt() {
  return gMachineMaxInt;
}

double MCPower::MEpsilon() {
  return gMachineEpsilon;
}

bool MCPower::ExpOverflow(double x) {
  return x > gMachineMaxExp;
}

bool MCPower::ExpUnderflow(double x) {
  return x < gMachineMinExp;
}

bool MCPower::IsInteger(double x) {
  return x <= gMachineMaxInt && std::floor(x) == x;
}

bool MCPower::IsEvenInteger(double x) {
  return IsInteger(x) && std::floor(x / 2.0) == x / 2.0;
}

bool MCPower::IsOddInteger(double x) {
  const double y = x / 2.0 + 0.5;
  return IsInteger(x) && std::floor(y) == y;
}

bool MCPower::AlmostEqual(double a, double b, double k) {
  if (a == 0.0) return b == 0.0;
  if (b == 0.0 || (a < 0.0) != (b < 0.0)) return false;
  const double d = std::fabs(a) - std::fabs(b);
  return std::fabs(d) / (d < 0.0 ? std::fabs(b) : std::fabs(a)) <= k * gMachineEpsilon;
}

bool MCPower::IsOneOverOddInteger(double e, double k) {
  if (e == 0.0) return false;
  const double r = 1.0 / e;
  if (r > gMachineMaxInt) return false;
  const double y = r / 2.0 + 0.5;
  return AlmostEqual(y, std::floor(y + 0.5), k);
}

bool MCPower::IsOneOverEvenInteger(double e, double k) {
  if (e == 0.0) return false;
  const double r = 1.0 / e;
  if (r > gMachineMaxInt) return false;
  return AlmostEqual(r / 2.0, std::floor(r / 2.0 + 0.5), k);
}

MCPower::PowerStatus MCPower::Exponent(double x, double& result) {
  if (ExpUnderflow(x)) {
    result = 0.0;
    return PowerUnderflow;
  }
  if (ExpOverflow(x) || std::isnan(x)) {
    result = MCMV::gMissingValue;
    return PowerOverflow;
  }
  result = std::exp(x);
  return PowerOk;
}

MCPower::PowerStatus MCPower::Power(double base, double exponent, double& result) {
  result = MCMV::gMissingValue;
  if (base == 0.0) {
    // A NaN exponent must not pass for a negative one.
    if (std::isnan(exponent)) return PowerOverflow;
    if (exponent < 0.0) return PowerZeroNegExp;
    result = exponent == 0.0 ? 1.0 : 0.0;
    return exponent == 0.0 ? PowerZeroZero : PowerOk;
  }
  if (base > 0.0 || std::isnan(base)) {
    if (exponent != 0.0) return Exponent(std::log(base) * exponent, result);
    // NaN to the power 0 would be the only way for a NaN to end in a number.
    if (std::isnan(base)) return PowerOverflow;
    result = 1.0;
    return PowerOk;
  }
  if (exponent == 0.0) {
    result = 1.0;
    return PowerNegBaseZeroExp;
  }
  if (IsEvenInteger(exponent)) return Exponent(std::log(-base) * exponent, result);
  if (!IsOddInteger(exponent) && !IsOneOverOddInteger(exponent, kRootTolerance))
    return PowerNegBaseNotInteger;
  const PowerStatus status = Exponent(std::log(-base) * exponent, result);
  if (MCMV::IsMissing(result)) return exponent > 0.0 ? PowerNegOverflow : status;
  result = -result;
  return status;
}

double MCPower::Multiply(double a, double b) {
  if (MCMV::IsMissing(a) || MCMV::IsMissing(b)) return MCMV::gMissingValue;
  const double product = a * b;
  return std::isfinite(product) ? product : MCMV::gMissingValue;
}

}  // namespace MCMath_800
