// A program that runs beside the test, on Windows. ChildProcess_posix.h is the other one.

#ifndef KESTREL_TESTS_SUPPORT_CHILDPROCESS_WINDOWS_H
#define KESTREL_TESTS_SUPPORT_CHILDPROCESS_WINDOWS_H

#ifndef NOMINMAX
#define NOMINMAX
#endif
#include <windows.h>
// windows.h goes first: the next headers need its types.
#include <gtest/gtest.h>
#include <io.h>

#include <filesystem>
#include <map>
#include <string>
#include <vector>

namespace kestrel_tests {

/// Where one of a program's three standard streams leads: to an open file descriptor, or else to a file.
struct StreamGoal {
  int descriptor = -1;
  std::string path;  ///< UTF-8
};

/// Ended and waited for when the object goes.
class ChildProcess {
 public:
  /// `words` begins with the program's path; `variables` are "NAME=value" texts that go before the test's
  /// own.
  ChildProcess(const std::vector<std::string>& words, const std::vector<std::string>& variables,
               const StreamGoal (&streams)[3]) {
    STARTUPINFOW start{};
    start.cb = sizeof start;
    start.dwFlags = STARTF_USESTDHANDLES;
    HANDLE* const handles[] = {&start.hStdInput, &start.hStdOutput, &start.hStdError};
    for (int stream = 0; stream < 3; ++stream)
      *handles[stream] = Inheritable(streams[stream], stream == 0);
    std::wstring command;
    for (const std::string& word : words)
      command += (command.empty() ? L"" : L" ") + Quoted(Wide(word));
    std::wstring environment = Environment(variables);
    const BOOL started = CreateProcessW(Wide(words[0]).c_str(), command.data(), nullptr, nullptr, TRUE,
                                        CREATE_UNICODE_ENVIRONMENT | CREATE_NEW_PROCESS_GROUP,
                                        environment.data(), nullptr, &start, &process_);
    EXPECT_TRUE(started) << words[0] << " could not be started: error " << GetLastError();
    for (HANDLE* handle : handles)
      CloseHandle(*handle);
  }
  ~ChildProcess() {
    if (process_.hProcess == nullptr) return;
    TerminateProcess(process_.hProcess, 1);
    int exit_code = 0;
    int signal_number = 0;
    Wait(exit_code, signal_number);
  }
  ChildProcess(const ChildProcess&) = delete;
  ChildProcess& operator=(const ChildProcess&) = delete;

  /// What Ctrl+Break does; false when there is no console to do it in.
  bool Interrupt() const { return GenerateConsoleCtrlEvent(CTRL_BREAK_EVENT, process_.dwProcessId) != 0; }

  /// Programs end with a code here, whatever ended them.
  void Wait(int& exit_code, int&) {
    if (process_.hProcess == nullptr) return;
    EXPECT_EQ(WaitForSingleObject(process_.hProcess, INFINITE), WAIT_OBJECT_0);
    DWORD code = 0;
    EXPECT_TRUE(GetExitCodeProcess(process_.hProcess, &code));
    exit_code = static_cast<int>(code);
    CloseHandle(process_.hProcess);
    CloseHandle(process_.hThread);
    process_ = {};
  }

 private:
  static std::wstring Wide(const std::string& utf8) { return std::filesystem::u8path(utf8).wstring(); }

  static HANDLE Inheritable(const StreamGoal& goal, bool is_read) {
    HANDLE handle = INVALID_HANDLE_VALUE;
    if (goal.descriptor != -1) {
      const HANDLE own = reinterpret_cast<HANDLE>(_get_osfhandle(goal.descriptor));
      EXPECT_TRUE(DuplicateHandle(GetCurrentProcess(), own, GetCurrentProcess(), &handle, 0, TRUE,
                                  DUPLICATE_SAME_ACCESS));
      return handle;
    }
    SECURITY_ATTRIBUTES inherited{sizeof(SECURITY_ATTRIBUTES), nullptr, TRUE};
    handle = CreateFileW(Wide(goal.path).c_str(), is_read ? GENERIC_READ : GENERIC_WRITE,
                         FILE_SHARE_READ | FILE_SHARE_WRITE, &inherited,
                         is_read ? OPEN_EXISTING : OPEN_ALWAYS, FILE_ATTRIBUTE_NORMAL, nullptr);
    EXPECT_NE(handle, INVALID_HANDLE_VALUE) << goal.path;
    return handle;
  }

  /// As programs take their command line apart: a backslash counts as itself unless a quote follows.
  static std::wstring Quoted(const std::wstring& word) {
    std::wstring quoted = L"\"";
    size_t backslashes = 0;
    for (const wchar_t c : word) {
      if (c == L'"') quoted.append(backslashes + 1, L'\\');
      backslashes = c == L'\\' ? backslashes + 1 : 0;
      quoted += c;
    }
    return quoted.append(backslashes, L'\\') + L"\"";
  }

  static std::wstring Environment(const std::vector<std::string>& variables) {
    std::map<std::wstring, std::wstring> merged;
    const auto put = [&merged](const std::wstring& variable) {
      // Windows keeps the current folders of its drives under names that begin with the sign.
      merged[variable.substr(0, variable.find(L'=', 1))] = variable;
    };
    wchar_t* const block = GetEnvironmentStringsW();
    for (const wchar_t* at = block; *at != L'\0'; at += std::wstring(at).size() + 1)
      put(at);
    FreeEnvironmentStringsW(block);
    for (const std::string& variable : variables)
      put(Wide(variable));
    std::wstring environment;
    for (const auto& [name, variable] : merged)
      environment += variable + L'\0';
    return environment + L'\0';
  }

  PROCESS_INFORMATION process_{};
};

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_CHILDPROCESS_WINDOWS_H
