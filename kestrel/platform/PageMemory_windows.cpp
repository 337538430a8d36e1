#include <cstdlib>

#include "kestrel/platform/PageMemory.h"

namespace MCKestrel_800 {

// Large pages need a privilege that hosts do not have.
void* AllocatePages(size_t bytes) noexcept {
  return std::malloc(bytes);
}

void FreePages(void* memory, size_t) noexcept {
  std::free(memory);
}

}  // namespace MCKestrel_800
