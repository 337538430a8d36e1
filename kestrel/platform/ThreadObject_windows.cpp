#ifndef NOMINMAX
#define NOMINMAX
#endif
#define WIN32_LEAN_AND_MEAN
#include <windows.h>

#include "kestrel/platform/ThreadObject.h"

namespace MCKestrel_800 {

// The system's fiber-local storage is thread-local storage that calls back when a thread ends.
ThreadSlot::ThreadSlot(void (*destroy)(void*)) : index_(FlsAlloc(destroy)) {}

ThreadSlot::~ThreadSlot() {
  if (index_ != FLS_OUT_OF_INDEXES) FlsFree(index_);
}

void* ThreadSlot::Get() const {
  return index_ != FLS_OUT_OF_INDEXES ? FlsGetValue(index_) : nullptr;
}

bool ThreadSlot::Set(void* pointer) {
  return index_ != FLS_OUT_OF_INDEXES && FlsSetValue(index_, pointer) != 0;
}

}  // namespace MCKestrel_800
