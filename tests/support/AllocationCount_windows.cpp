// Counts on Windows, where operators of the program replace nobody else's. A module calls the C library
// through the table of addresses that the loader fills in for its imports; the entries for memory are led to
// functions that count and pass on.

#ifndef NOMINMAX
#define NOMINMAX
#endif
#define WIN32_LEAN_AND_MEAN
#include <windows.h>
// windows.h goes first: the next header needs its types. Version 2 of it is in a library that all programs
// have.
#define PSAPI_VERSION 2
#include <gtest/gtest.h>
#include <psapi.h>

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <cwchar>

#include "tests/support/AllocationCount.h"

namespace {

std::atomic<size_t> allocations{0};

enum Function : size_t { kMalloc, kCalloc, kRealloc, kFunctions };

/// C libraries that the modules of a process use side by side: the system's and a compiler's.
constexpr size_t kRuntimes = 2;

/// Where the functions are; 0 as long as no module with that C library was seen. Memory goes back to the C
/// library that it came from, so each needs counting functions of its own.
uintptr_t originals[kFunctions][kRuntimes];

template <size_t kRuntime>
void* CountingMalloc(size_t size) {
  allocations.fetch_add(1, std::memory_order_relaxed);
  return reinterpret_cast<void* (*)(size_t)>(originals[kMalloc][kRuntime])(size);
}

template <size_t kRuntime>
void* CountingCalloc(size_t count, size_t size) {
  allocations.fetch_add(1, std::memory_order_relaxed);
  return reinterpret_cast<void* (*)(size_t, size_t)>(originals[kCalloc][kRuntime])(count, size);
}

template <size_t kRuntime>
void* CountingRealloc(void* memory, size_t size) {
  allocations.fetch_add(1, std::memory_order_relaxed);
  return reinterpret_cast<void* (*)(void*, size_t)>(originals[kRealloc][kRuntime])(memory, size);
}

struct Row {
  const char* name;
  uintptr_t counting[kRuntimes];
};

template <typename Pointer>
uintptr_t AddressOf(Pointer function) {
  return reinterpret_cast<uintptr_t>(function);
}

/// In the order of `Function`.
const Row kRows[kFunctions] = {
    {"malloc", {AddressOf(&CountingMalloc<0>), AddressOf(&CountingMalloc<1>)}},
    {"calloc", {AddressOf(&CountingCalloc<0>), AddressOf(&CountingCalloc<1>)}},
    {"realloc", {AddressOf(&CountingRealloc<0>), AddressOf(&CountingRealloc<1>)}},
};

/// What a module shall call in place of `address`: the same function, counted.
uintptr_t CountingFor(size_t function, uintptr_t address) {
  for (size_t runtime = 0; runtime < kRuntimes; ++runtime) {
    uintptr_t& original = originals[function][runtime];
    const uintptr_t counting = kRows[function].counting[runtime];
    if (original == 0) original = address;
    if (address == original || address == counting) return counting;
  }
  ADD_FAILURE() << "There are more C libraries than are counted";
  return address;
}

/// The entries lie in memory that only the loader is meant to write.
void Replace(ULONGLONG* entry, uintptr_t address) {
  DWORD protection = 0;
  if (!VirtualProtect(entry, sizeof *entry, PAGE_READWRITE, &protection)) {
    ADD_FAILURE() << "An import cannot be replaced: error " << GetLastError();
    return;
  }
  *entry = address;
  VirtualProtect(entry, sizeof *entry, protection, &protection);
}

template <typename Part>
Part* PartAt(HMODULE module, uintptr_t offset) {
  return reinterpret_cast<Part*>(reinterpret_cast<uintptr_t>(module) + offset);
}

/// `names` and `entries` run side by side, up to an entry of zeros.
void CountImports(HMODULE module, const IMAGE_THUNK_DATA64* names, IMAGE_THUNK_DATA64* entries) {
  for (; names->u1.AddressOfData != 0; ++names, ++entries) {
    if (IMAGE_SNAP_BY_ORDINAL64(names->u1.Ordinal)) continue;
    const auto name_at = names->u1.AddressOfData + offsetof(IMAGE_IMPORT_BY_NAME, Name);
    const char* const name = PartAt<const char>(module, name_at);
    for (size_t function = 0; function < kFunctions; ++function) {
      if (std::strcmp(name, kRows[function].name) != 0) continue;
      const uintptr_t counting = CountingFor(function, entries->u1.Function);
      if (counting != entries->u1.Function) Replace(&entries->u1.Function, counting);
    }
  }
}

void CountModule(HMODULE module) {
  const auto* const header =
      PartAt<IMAGE_NT_HEADERS64>(module, PartAt<IMAGE_DOS_HEADER>(module, 0)->e_lfanew);
  const DWORD imports = header->OptionalHeader.DataDirectory[IMAGE_DIRECTORY_ENTRY_IMPORT].VirtualAddress;
  if (imports == 0) return;
  const auto* library = PartAt<IMAGE_IMPORT_DESCRIPTOR>(module, imports);
  for (; library->FirstThunk != 0; ++library) {
    // Some linkers leave the names out, and the loader has put the addresses in the place of the others.
    if (library->OriginalFirstThunk == 0) continue;
    CountImports(module, PartAt<IMAGE_THUNK_DATA64>(module, library->OriginalFirstThunk),
                 PartAt<IMAGE_THUNK_DATA64>(module, library->FirstThunk));
  }
}

bool IsOfTheSystem(HMODULE module) {
  wchar_t folder[MAX_PATH];
  const UINT length = GetSystemWindowsDirectoryW(folder, MAX_PATH);
  wchar_t path[MAX_PATH] = {};
  // A path that is too long is cut off, which leaves enough of it.
  GetModuleFileNameW(module, path, MAX_PATH);
  return _wcsnicmp(path, folder, length) == 0 && path[length] == L'\\';
}

/// The modules that were loaded since the last call are new; the others are found as they were left.
void CountAllModules() {
  HMODULE modules[1024];
  DWORD bytes = 0;
  if (!EnumProcessModules(GetCurrentProcess(), modules, sizeof modules, &bytes) || bytes > sizeof modules) {
    ADD_FAILURE() << "The modules cannot be listed: " << bytes << " bytes, error " << GetLastError();
    return;
  }
  for (size_t i = 0; i < bytes / sizeof(HMODULE); ++i) {
    if (!IsOfTheSystem(modules[i])) CountModule(modules[i]);
  }
}

}  // namespace

namespace kestrel_tests {

size_t CountAllocations() {
  CountAllModules();
  return allocations.load(std::memory_order_relaxed);
}

}  // namespace kestrel_tests
