#include "kestrel/platform/PageMemory.h"

#include <cstdint>
#include <cstdlib>

#include <sys/mman.h>

namespace MCKestrel_800 {

namespace {

// From here on memory comes in large pages. What is smaller comes from the heap, which has pages that were
// used before.
constexpr size_t kLargePageBytes = size_t{2} << 20;

// The largest page that systems use for ordinary memory: what is given back must be whole pages.
constexpr size_t kMostPageBytes = size_t{64} << 10;

size_t WholePages(size_t bytes) {
  return (bytes + kMostPageBytes - 1) / kMostPageBytes * kMostPageBytes;
}

// A large page begins on its own boundary, so more is taken than needed and the ends are given back.
void* MapAligned(size_t bytes) {
  const size_t taken = bytes + kLargePageBytes;
  if (taken < bytes) return nullptr;
  void* const mapped = mmap(nullptr, taken, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
  if (mapped == MAP_FAILED) return nullptr;
  char* const first = static_cast<char*>(mapped);
  const size_t skipped =
      (kLargePageBytes - reinterpret_cast<uintptr_t>(first) % kLargePageBytes) % kLargePageBytes;
  if (skipped != 0) munmap(first, skipped);
  if (skipped != kLargePageBytes) munmap(first + skipped + bytes, kLargePageBytes - skipped);
#if defined(MADV_HUGEPAGE)
  madvise(first + skipped, bytes, MADV_HUGEPAGE);  // a wish: where it is not granted all works as before
#endif
  return first + skipped;
}

}  // namespace

void* AllocatePages(size_t bytes) noexcept {
  return bytes >= kLargePageBytes ? MapAligned(WholePages(bytes)) : std::malloc(bytes);
}

void FreePages(void* memory, size_t bytes) noexcept {
  if (bytes >= kLargePageBytes) {
    munmap(memory, WholePages(bytes));
  } else {
    std::free(memory);
  }
}

}  // namespace MCKestrel_800
