// Boost.Math's answer to each judged function: an independent implementation to compare with.

#ifndef KESTREL_BENCH_ACCURACY_BOOSTFUNCTIONS_H
#define KESTREL_BENCH_ACCURACY_BOOSTFUNCTIONS_H

namespace kestrel_bench {

struct BoostFunction {
  /// As in the list of judged functions.
  const char* name;
  /// As it comes: it computes in long double and rounds.
  double (*standard)(const double* arguments);
  /// In double alone, as Kestrel does.
  double (*plain)(const double* arguments);
};

/// Null when Boost.Math has no such function.
const BoostFunction* FindBoostFunction(const char* name);

}  // namespace kestrel_bench

#endif  // KESTREL_BENCH_ACCURACY_BOOSTFUNCTIONS_H
