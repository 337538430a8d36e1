// The functions behind the names of normalisations, in the forms that probabilities are made of: below,
// above, between and in proportion.

#ifndef KESTREL_PLUGINS_REGRESSION_LINKFUNCTIONS_H
#define KESTREL_PLUGINS_REGRESSION_LINKFUNCTIONS_H

#include <cstddef>

#include "plugins/regression/Normalization.h"

namespace MCKestrel_800 {

// F is
//   none     y                      logit    1 / (1 + exp(-y))        probit   Phi(y)
//   cloglog  1 - exp(-exp(y))       loglog   exp(-exp(-y))            cauchit  1/2 + atan(y) / pi
//   exp      exp(y)
// for every finite y. Of "none" and "exp" F may leave [0, 1], and of "exp" it may be infinite. Each form is
// computed without subtracting nearly equal numbers, so that small probabilities keep their digits: relative
// error below 1e-12 as long as the result is a normal number. `method` must be one that IsCumulative accepts;
// for others the result is NaN. Nothing throws.

/// F(y).
double LinkBelow(Normalization method, double y);

/// 1 - F(y).
double LinkAbove(Normalization method, double y);

/// F(high) - F(low); negative when high is the smaller one.
double LinkBetween(Normalization method, double low, double high);

/// Writes F(y_j) / sum F(y_i) for each of the `count` values, at least one. Nothing overflows, and shares
/// that are not below 1e-100 keep their digits where every F is too small for a number. With "exp" this is
/// softmax. Not for "none".
void LinkShares(Normalization method, const double* values, std::size_t count, double* shares);

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_REGRESSION_LINKFUNCTIONS_H
