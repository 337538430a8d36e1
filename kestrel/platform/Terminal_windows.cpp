#ifndef NOMINMAX
#define NOMINMAX
#endif
#include <windows.h>
// windows.h goes first: the next headers need its types.
#include <fcntl.h>
#include <io.h>
#include <shellapi.h>

#include <cerrno>
#include <mutex>

#include "kestrel/platform/Terminal.h"

namespace MCKestrel_800 {
namespace {

// The system calls RemoveAndEnd on a thread of its own.
std::mutex watch_guard;
std::wstring watched_path;

// The process ends when this returns.
BOOL WINAPI RemoveAndEnd(DWORD) {
  RemoveWatchedFile();
  return FALSE;
}

/// What the C library would say of the system's error, for the errors of opening a file.
int ErrnoOf(DWORD error) {
  switch (error) {
    case ERROR_FILE_NOT_FOUND:
    case ERROR_PATH_NOT_FOUND:
    case ERROR_INVALID_NAME:
    case ERROR_BAD_PATHNAME:
    case ERROR_BAD_NETPATH:
      return ENOENT;
    case ERROR_ACCESS_DENIED:
    case ERROR_SHARING_VIOLATION:
      return EACCES;
    case ERROR_TOO_MANY_OPEN_FILES:
      return EMFILE;
    case ERROR_FILENAME_EXCED_RANGE:
      return ENAMETOOLONG;
    case ERROR_DISK_FULL:
    case ERROR_HANDLE_DISK_FULL:
      return ENOSPC;
    case ERROR_WRITE_PROTECT:
      return EROFS;
    default:
      return EIO;
  }
}

std::wstring FromUtf8(const std::string& text) {
  const int size = static_cast<int>(text.size());
  std::wstring wide(text.size(), L'\0');
  const int length = MultiByteToWideChar(CP_UTF8, 0, text.data(), size, wide.data(), size);
  wide.resize(length > 0 ? static_cast<size_t>(length) : 0);
  return wide;
}

std::string ToUtf8(const wchar_t* text) {
  const int size = WideCharToMultiByte(CP_UTF8, 0, text, -1, nullptr, 0, nullptr, nullptr);
  if (size <= 1) return std::string();
  std::string utf8(static_cast<size_t>(size), '\0');
  WideCharToMultiByte(CP_UTF8, 0, text, -1, &utf8[0], size, nullptr, nullptr);
  utf8.pop_back();
  return utf8;
}

}  // namespace

void RemoveWatchedFile() noexcept {
  const std::lock_guard<std::mutex> lock(watch_guard);
  if (!watched_path.empty()) DeleteFileW(watched_path.c_str());
}

void PrepareStandardStreams() {
  for (std::FILE* stream : {stdin, stdout, stderr})
    _setmode(_fileno(stream), _O_BINARY);
  SetConsoleOutputCP(CP_UTF8);
}

std::vector<std::string> GetUtf8Arguments(int argc, const char* const* argv) {
  int count = 0;
  wchar_t** const wide = CommandLineToArgvW(GetCommandLineW(), &count);
  if (wide == nullptr) {
    return argc > 1 ? std::vector<std::string>(argv + 1, argv + argc) : std::vector<std::string>();
  }
  std::vector<std::string> arguments;
  for (int i = 1; i < count; ++i)
    arguments.push_back(ToUtf8(wide[i]));
  LocalFree(wide);
  return arguments;
}

bool IsTerminal(std::FILE* stream) {
  return _isatty(_fileno(stream)) != 0;
}

void IgnoreLibrariesOfCurrentFolder() {
  SetDllDirectoryW(L"");
}

// Names such as NUL are devices in every folder; their full path says so.
bool IsDevice(const std::string& path) {
  std::wstring full(32767, L'\0');
  const DWORD length =
      GetFullPathNameW(FromUtf8(path).c_str(), static_cast<DWORD>(full.size()), full.data(), nullptr);
  return length < full.size() && full.compare(0, 4, L"\\\\.\\") == 0;
}

// The C library opens files without the sharing that removing needs.
std::FILE* OpenForWriting(const std::string& path) {
  const HANDLE handle =
      CreateFileW(FromUtf8(path).c_str(), GENERIC_WRITE, FILE_SHARE_READ | FILE_SHARE_DELETE, nullptr,
                  CREATE_ALWAYS, FILE_ATTRIBUTE_NORMAL, nullptr);
  if (handle == INVALID_HANDLE_VALUE) {
    errno = ErrnoOf(GetLastError());
    return nullptr;
  }
  const int descriptor = _open_osfhandle(reinterpret_cast<intptr_t>(handle), _O_BINARY);
  if (descriptor == -1) {
    CloseHandle(handle);
    return nullptr;
  }
  std::FILE* const file = _fdopen(descriptor, "wb");
  if (file == nullptr) _close(descriptor);
  return file;
}

void RemoveWhenInterrupted(const std::string& path) {
  static const BOOL installed = SetConsoleCtrlHandler(RemoveAndEnd, TRUE);
  static_cast<void>(installed);
  const std::lock_guard<std::mutex> lock(watch_guard);
  watched_path = FromUtf8(path);
}

}  // namespace MCKestrel_800
