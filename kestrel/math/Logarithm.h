// The logarithm that the C libraries do not agree on.

#ifndef KESTREL_MATH_LOGARITHM_H
#define KESTREL_MATH_LOGARITHM_H

namespace MCMath_800 {

/// The logarithm to base 10, rounded once from more digits than a double has, so that it is the same on every
/// system and exact for powers of ten. For what is no positive finite number, the C library's answer: minus
/// infinity for 0, infinity for infinity, else no number.
double DecimalLogarithm(double x);

}  // namespace MCMath_800

#endif  // KESTREL_MATH_LOGARITHM_H
