// First approximations to the parameter of a non-central distribution, where its search begins.

#ifndef KESTREL_MATH_NONCENTRALSTART_H
#define KESTREL_MATH_NONCENTRALSTART_H

namespace MCMath_800 {

/// The limits of the parameters: t's either way, that of chi-square and F.
constexpr double kLargestStudentParameter = 3e4;
constexpr double kLargestChiParameter = 1e9;

// The parameter at which the share below x is that of the normal distribution below z, by the saddle-point
// approximation to the share: within a quarter of z for a tenth of a degree of freedom, much better for many
// degrees of freedom. Inside those limits.

/// x other than 0.
double StartStudentParameter(double z, double x, double df);
/// x > 0.
double StartChiParameter(double z, double x, double df);
/// ratio = x df1 / df2 > 0.
double StartFParameter(double z, double ratio, double df1, double df2);

}  // namespace MCMath_800

#endif  // KESTREL_MATH_NONCENTRALSTART_H
