// Powers that never end in an infinity or a NaN, and the limits of the machine's numbers that go with them.

#ifndef KESTREL_MATH_MCPOWER_H
#define KESTREL_MATH_MCPOWER_H

#include "kestrel/platform/Export.h"

namespace MCMath_800 {

/// Raises numbers to real powers. Every outcome is a value and a status; what is undefined or cannot be
/// represented is the missing value of `MCMV`. A NaN argument counts as something that cannot be represented.
/// Nothing throws or allocates; any number of threads may call at once.
class KESTREL_API MCPower {
 public:
  enum PowerStatus {
    PowerOk = 0,           ///< The result is valid.
    PowerUnderflow = 1,    ///< The exponential's argument was below gMachineMinExp; the result is 0.
    PowerOverflow = 2,     ///< The exponential's argument was above gMachineMaxExp or a NaN; missing.
    PowerNegOverflow = 3,  ///< The magnitude of a negative result overflowed; missing.
    PowerNegBaseNotInteger =
        4,  ///< Negative base, exponent neither an integer nor one over an odd one; missing.
    PowerNegBaseZeroExp = 5,  ///< Negative base to the power 0; the result is 1.
    PowerZeroNegExp = 6,      ///< Zero to a negative power; missing.
    PowerZeroZero = 7         ///< Zero to the power 0; the result is 1.
  };

  static constexpr double gMachineEpsilon = 2.220446049250313e-16;
  static constexpr int gMachineMaxInt = 2147483647;
  /// The largest and the smallest argument that the exponential takes.
  static constexpr double gMachineMaxExp = 709.0;
  static constexpr double gMachineMinExp = -708.39;

  static double MaxExp();
  static double MinExp();
  static int MaxInt();
  static double MEpsilon();

  /// Whether the exponential of x is too large, or so small that it counts as 0. Neither holds for a NaN.
  static bool ExpOverflow(double x);
  static bool ExpUnderflow(double x);

  /// Whole numbers up to gMachineMaxInt. There is no lower limit: every large negative double is a whole
  /// number.
  static bool IsInteger(double x);
  static bool IsEvenInteger(double x);
  static bool IsOddInteger(double x);

  /// Whether a and b differ by at most k machine epsilons of the larger magnitude. Zero equals zero alone.
  static bool AlmostEqual(double a, double b, double k);
  /// Whether e is 1/n for an odd (even) whole number n, to k machine epsilons.
  static bool IsOneOverOddInteger(double e, double k);
  static bool IsOneOverEvenInteger(double e, double k);

  /// e to the power x: PowerOk, PowerUnderflow with 0, or PowerOverflow with the missing value.
  static PowerStatus Exponent(double x, double& result);

  /// base to the power exponent, always as exp(exponent * ln|base|).
  /// A negative base takes whole exponents and odd roots: Power(-8, 1.0 / 3) is -2.
  /// result  overwritten: a finite number, or the missing value.
  static PowerStatus Power(double base, double exponent, double& result);

  /// a * b; the missing value when a factor is missing, or when the product is not a finite number.
  /// A product that is too small is rounded towards 0, as everywhere in the arithmetic.
  static double Multiply(double a, double b);
};

}  // namespace MCMath_800

#endif  // KESTREL_MATH_MCPOWER_H
