// The replaced functions stand in a file of their own: seen together with their callers they would be
// inlined, and the compiler would take the pair of new and free for a mistake.

#include "tests/dictionary/AllocationCounter.h"

#include <atomic>
#include <cstdlib>
#include <new>

namespace {
std::atomic<long> allocations{0};
}

void* operator new(std::size_t size) {
  allocations.fetch_add(1, std::memory_order_relaxed);
  void* memory = std::malloc(size == 0 ? 1 : size);
  if (memory == nullptr) throw std::bad_alloc();
  return memory;
}
void operator delete(void* memory) noexcept {
  std::free(memory);
}
void operator delete(void* memory, std::size_t) noexcept {
  std::free(memory);
}

namespace MCKestrel_800 {

long AllocationsSoFar() {
  return allocations.load();
}

}  // namespace MCKestrel_800
