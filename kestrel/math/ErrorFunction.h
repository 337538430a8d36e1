// The error function in the scaled form that tails are made of.

#ifndef KESTREL_MATH_ERRORFUNCTION_H
#define KESTREL_MATH_ERRORFUNCTION_H

namespace MCMath_800 {

/// exp(a^2) erfc(a) for a >= 0, to one unit in the last place.
double ScaledErfc(double a);

}  // namespace MCMath_800

#endif  // KESTREL_MATH_ERRORFUNCTION_H
