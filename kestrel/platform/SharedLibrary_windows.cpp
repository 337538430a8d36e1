// Library loading on Windows.

#ifndef NOMINMAX
#define NOMINMAX
#endif
#define WIN32_LEAN_AND_MEAN
#include <windows.h>

#include "kestrel/platform/SharedLibrary.h"

namespace MCKestrel_800 {
namespace {

/// The system's words for an error, without the line end that it puts behind them.
std::string TakeSystemText(DWORD error) {
  char* buffer = nullptr;
  const DWORD length = FormatMessageA(
      FORMAT_MESSAGE_ALLOCATE_BUFFER | FORMAT_MESSAGE_FROM_SYSTEM | FORMAT_MESSAGE_IGNORE_INSERTS, nullptr,
      error, MAKELANGID(LANG_NEUTRAL, SUBLANG_DEFAULT), reinterpret_cast<char*>(&buffer), 0, nullptr);
  std::string text(length != 0 ? buffer : "", length);
  LocalFree(buffer);
  while (!text.empty() && (text.back() == '\r' || text.back() == '\n' || text.back() == ' '))
    text.pop_back();
  return text.empty() ? "System error " + std::to_string(error) : text;
}

/// The folder of the library that this code is in, with its last separator; empty when the system does not
/// tell.
std::wstring GetCoreFolder() {
  HMODULE core = nullptr;
  if (!GetModuleHandleExW(
          GET_MODULE_HANDLE_EX_FLAG_FROM_ADDRESS | GET_MODULE_HANDLE_EX_FLAG_UNCHANGED_REFCOUNT,
          reinterpret_cast<LPCWSTR>(&GetCoreFolder), &core)) {
    return std::wstring();
  }
  std::wstring path(MAX_PATH, L'\0');
  for (;;) {
    const DWORD length = GetModuleFileNameW(core, path.data(), static_cast<DWORD>(path.size()));
    if (length == 0) return std::wstring();
    if (length < path.size()) {
      path.resize(length);
      break;
    }
    path.resize(path.size() * 2);
  }
  const size_t end = path.find_last_of(L"\\/");
  return end == std::wstring::npos ? std::wstring() : path.substr(0, end + 1);
}

std::wstring Widen(const std::string& name) {
  const int size = static_cast<int>(name.size());
  std::wstring wide(name.size(), L'\0');
  const int length = MultiByteToWideChar(CP_ACP, 0, name.data(), size, wide.data(), size);
  wide.resize(length > 0 ? static_cast<size_t>(length) : 0);
  return wide;
}

/// The system looks beside the program, not beside the core, so the core's own folder is tried first. Only a
/// library that is not there at all is then looked for elsewhere: a broken one must not give way to a
/// stranger of its name.
HMODULE OpenLibrary(const std::string& name, DWORD& error) {
  const bool bare = name.find_first_of("\\/:") == std::string::npos;
  const std::wstring folder = bare ? GetCoreFolder() : std::wstring();
  const std::wstring path = folder + Widen(name);
  HMODULE module = nullptr;
  if (!folder.empty() && GetFileAttributesW(path.c_str()) != INVALID_FILE_ATTRIBUTES) {
    module = LoadLibraryExW(path.c_str(), nullptr, LOAD_WITH_ALTERED_SEARCH_PATH);
  } else {
    module = LoadLibraryA(name.c_str());
  }
  if (module == nullptr) error = GetLastError();
  return module;
}

/// Keeps the system from stopping a host with a message box when a library is damaged.
class QuietErrors {
 public:
  QuietErrors() { SetThreadErrorMode(SEM_FAILCRITICALERRORS | SEM_NOOPENFILEERRORBOX, &before_); }
  ~QuietErrors() { SetThreadErrorMode(before_, nullptr); }
  QuietErrors(const QuietErrors&) = delete;
  QuietErrors& operator=(const QuietErrors&) = delete;

 private:
  DWORD before_ = 0;
};

}  // namespace

const char* SharedLibrary::GetUsualPlace() {
  return "the folder of kestrel.dll";
}

const char* SharedLibrary::GetSuffix() {
  return ".dll";
}

bool SharedLibrary::Load() {
  if (handle_ != nullptr) return true;
  QuietErrors quiet;
  DWORD error = 0;
  handle_ = OpenLibrary(file_name_, error);
  if (handle_ == nullptr) last_error_ = TakeSystemText(error);
  return handle_ != nullptr;
}

void* SharedLibrary::FindSymbol(const char* name) {
  if (handle_ == nullptr) {
    last_error_ = "The library is not loaded.";
    return nullptr;
  }
  void* symbol = reinterpret_cast<void*>(GetProcAddress(static_cast<HMODULE>(handle_), name));
  if (symbol == nullptr) last_error_ = TakeSystemText(GetLastError());
  return symbol;
}

}  // namespace MCKestrel_800
