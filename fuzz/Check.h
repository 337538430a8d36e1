// How a fuzz target says that something is wrong.

#ifndef KESTREL_FUZZ_CHECK_H
#define KESTREL_FUZZ_CHECK_H

#include <cstdio>
#include <cstdlib>

namespace kestrel_fuzz {

/// Ends the process when it does not hold, which libFuzzer and the replay both see. Stays in release builds.
inline void Check(bool holds, const char* what) {
  if (holds) return;
  std::fprintf(stderr, "fuzz: does not hold: %s\n", what);
  std::abort();
}

}  // namespace kestrel_fuzz

#endif  // KESTREL_FUZZ_CHECK_H
