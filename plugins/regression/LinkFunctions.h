// The distribution functions behind the link names, in the three forms that probabilities are made of: below,
// above and between.

#ifndef KESTREL_PLUGINS_REGRESSION_LINKFUNCTIONS_H
#define KESTREL_PLUGINS_REGRESSION_LINKFUNCTIONS_H

#include "plugins/regression/Normalization.h"

namespace MCKestrel_800 {

// F is
//   none     y                      logit    1 / (1 + exp(-y))        probit   Phi(y)
//   cloglog  1 - exp(-exp(y))       loglog   exp(-exp(-y))            cauchit  1/2 + atan(y) / pi
// for every finite y. Each form is computed without subtracting nearly equal numbers, so that small
// probabilities keep their digits: relative error below 1e-12 as long as the result is a normal number.
// `method` must be one that IsCumulative accepts; for others the result is NaN. Nothing throws.

/// F(y).
double LinkBelow(Normalization method, double y);

/// 1 - F(y).
double LinkAbove(Normalization method, double y);

/// F(high) - F(low); negative when high is the smaller one.
double LinkBetween(Normalization method, double low, double high);

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_REGRESSION_LINKFUNCTIONS_H
