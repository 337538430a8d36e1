// Sums of powers, whose terms follow from each other.

#ifndef KESTREL_MATH_POWERSUM_H
#define KESTREL_MATH_POWERSUM_H

#include "kestrel/math/DoubleDouble.h"
#include "kestrel/math/MCPower.h"

namespace MCMath_800 {

/// Terms below this share of their sum do not count.
constexpr double kPowerSumPrecision = MCPower::gMachineEpsilon / 4.0;

/// 1 + t_1 + t_1 t_2 + ..., summed with what the additions round off. Every factor t has the same number in
// it: what that has beyond a double moves the n-th product by n times as much.
class PowerSum {
 public:
  explicit PowerSum(DoubleDouble common) : excess_(common.low / common.high) {}

  bool Counts() const { return term_ > kPowerSumPrecision * sum_.high; }
  void Add(double factor) {
    term_ *= factor;
    index_ += 1.0;
    const DoubleDouble sum = AddExactly(sum_.high, term_);
    sum_ = {sum.high, sum_.low + sum.low};
    moment_ += index_ * term_;
  }
  double Value() const { return sum_.high + (sum_.low + excess_ * moment_); }

 private:
  double excess_;
  double term_ = 1.0;
  double index_ = 0.0;
  double moment_ = 0.0;
  DoubleDouble sum_ = 1.0;
};

}  // namespace MCMath_800

#endif  // KESTREL_MATH_POWERSUM_H
