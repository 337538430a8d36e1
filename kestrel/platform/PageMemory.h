// Large pieces of memory straight from the system, for data that is built once and dropped whole.

#ifndef KESTREL_PLATFORM_PAGEMEMORY_H
#define KESTREL_PLATFORM_PAGEMEMORY_H

#include <cstddef>

namespace MCKestrel_800 {

/// Returns `bytes` bytes aligned for any object, in large pages where the system has them to give, since a
/// big document's tree otherwise spends a fifth of its time on page faults. Null when there are none left.
/// The content is undefined. Give the memory back with FreePages and the same size.
void* AllocatePages(size_t bytes) noexcept;
void FreePages(void* memory, size_t bytes) noexcept;

}  // namespace MCKestrel_800

#endif  // KESTREL_PLATFORM_PAGEMEMORY_H
