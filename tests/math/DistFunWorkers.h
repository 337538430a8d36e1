// The workers of the distribution functions, for their own tests.

#ifndef KESTREL_TESTS_MATH_DISTFUNWORKERS_H
#define KESTREL_TESTS_MATH_DISTFUNWORKERS_H

#include "kestrel/math/MCDistFun.h"

namespace MCMath_800 {

struct DistFunWorkers {
  static double derf(double x) { return MCDistFun::derf(x); }
  static double derfc(double x) { return MCDistFun::derfc(x); }
  static double probit(double p) { return MCDistFun::probit(p); }
  static double dnlbnc(double n, double k, long& err) { return MCDistFun::dnlbnc(n, k, err); }
  static double gammad(double x, double shape, bool upper, long& err) {
    return MCDistFun::gammad(x, shape, upper, err);
  }
};

}  // namespace MCMath_800

#endif  // KESTREL_TESTS_MATH_DISTFUNWORKERS_H
