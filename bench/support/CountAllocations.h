// Counts every allocation of the program, the library and the plug-ins. To be included in one source of a
// program.

#ifndef KESTREL_BENCH_SUPPORT_COUNTALLOCATIONS_H
#define KESTREL_BENCH_SUPPORT_COUNTALLOCATIONS_H

#include <cmath>
#include <cstddef>
#include <cstdlib>
#include <new>

namespace kestrel_bench {

inline std::size_t allocations = 0;

/// Allocations per case. The benchmark library allocates a few times of its own between its rounds, whatever
/// the number of cases: what is below a thousandth is cut off.
inline double AllocationsPerCase(std::size_t before, std::size_t cases) {
  return std::floor(1000.0 * static_cast<double>(allocations - before) / static_cast<double>(cases)) / 1000.0;
}

}  // namespace kestrel_bench

[[gnu::noinline]] void* operator new(std::size_t size) {
  ++kestrel_bench::allocations;
  if (void* memory = std::malloc(size)) return memory;
  throw std::bad_alloc();
}
[[gnu::noinline]] void operator delete(void* memory) noexcept {
  std::free(memory);
}
[[gnu::noinline]] void operator delete(void* memory, std::size_t) noexcept {
  std::free(memory);
}

#endif  // KESTREL_BENCH_SUPPORT_COUNTALLOCATIONS_H
