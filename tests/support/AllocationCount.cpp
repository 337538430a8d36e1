// Counts by operators that replace those of the whole process; AllocationCount_windows.cpp is for where they
// cannot. They stand in a source of their own: inlined, they look to the compiler like a mix of two ways to
// allocate.

#include "tests/support/AllocationCount.h"

#include <atomic>
#include <cstdlib>
#include <new>

namespace {

std::atomic<size_t> allocations{0};

}  // namespace

void* operator new(size_t size) {
  allocations.fetch_add(1, std::memory_order_relaxed);
  if (void* memory = std::malloc(size != 0 ? size : 1)) return memory;
  throw std::bad_alloc();
}
void operator delete(void* memory) noexcept {
  std::free(memory);
}
void operator delete(void* memory, size_t) noexcept {
  std::free(memory);
}

namespace kestrel_tests {

size_t CountAllocations() {
  return allocations.load(std::memory_order_relaxed);
}

}  // namespace kestrel_tests
