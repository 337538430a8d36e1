#ifndef NOMINMAX
#define NOMINMAX
#endif
#include <windows.h>
// windows.h goes first: the next headers need its types.
#include <fcntl.h>
#include <io.h>
#include <shellapi.h>

#include <atomic>

#include "kestrel/platform/Terminal.h"

namespace MCKestrel_800 {
namespace {

std::atomic<bool> is_watching{false};
std::atomic<bool> was_interrupted{false};

// Runs on a thread of its own; the process ends when it returns.
BOOL WINAPI WaitForCleaning(DWORD) {
  was_interrupted = true;
  if (is_watching) Sleep(2000);
  return FALSE;
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

void RemoveWhenInterrupted(const std::string& path) {
  static const BOOL installed = SetConsoleCtrlHandler(WaitForCleaning, TRUE);
  is_watching = installed != 0 && !path.empty();
}

bool WasInterrupted() {
  return was_interrupted;
}

}  // namespace MCKestrel_800
