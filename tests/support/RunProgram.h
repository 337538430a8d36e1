// Runs a program as a shell would and catches what it says.

#ifndef KESTREL_TESTS_SUPPORT_RUNPROGRAM_H
#define KESTREL_TESTS_SUPPORT_RUNPROGRAM_H

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

#include "tests/support/FileText.h"
#include "tests/support/TempFolder.h"
#if defined(_WIN32)
#include "tests/support/ChildProcess_windows.h"
#else
#include "tests/support/ChildProcess_posix.h"
#endif

namespace kestrel_tests {

/// The path of a program that was built, given as in "tools/print_functions".
inline std::string BuiltProgram(const std::string& place) {
#if defined(_WIN32)
  // All lie together, beside the libraries.
  return KESTREL_BINARY_DIR "/bin/" + place.substr(place.rfind('/') + 1) + ".exe";
#else
  return KESTREL_BINARY_DIR "/" + place;
#endif
}

struct RunOptions {
  /// What the program finds on its standard input.
  std::string input;
  /// Where its streams go instead of being caught, as open file descriptors; -1 to catch them. They stay the
  /// caller's.
  int input_descriptor = -1;
  int output_descriptor = -1;
  int error_descriptor = -1;
  /// "NAME=value" texts that go before those of this process.
  std::vector<std::string> environment;
};

struct ProgramOutcome {
  int exit_code = -1;  ///< -1 when a signal ended it
  int signal = 0;
  std::string output;
  std::string errors;
};

/// A program on its way. Its process is ended and waited for when the object goes.
class RunningProgram {
 public:
  RunningProgram(const std::string& path, const std::vector<std::string>& arguments,
                 const RunOptions& options = {})
      : process_(Words(path, arguments), options.environment,
                 {{options.input_descriptor, folder_.Write("input", options.input)},
                  {options.output_descriptor, folder_.PathOf("output")},
                  {options.error_descriptor, folder_.PathOf("errors")}}) {}

  ChildProcess& GetProcess() { return process_; }

  ProgramOutcome Wait() {
    ProgramOutcome outcome;
    process_.Wait(outcome.exit_code, outcome.signal);
    for (const char* name : {"output", "errors"}) {
      if (!std::filesystem::exists(folder_.GetPath() / name)) continue;
      (name[0] == 'o' ? outcome.output : outcome.errors) = FileText(folder_.PathOf(name));
    }
    return outcome;
  }

 private:
  static std::vector<std::string> Words(const std::string& path, const std::vector<std::string>& arguments) {
    std::vector<std::string> words = {path};
    words.insert(words.end(), arguments.begin(), arguments.end());
    return words;
  }

  TempFolder folder_;
  ChildProcess process_;
};

inline ProgramOutcome RunProgram(const std::string& path, const std::vector<std::string>& arguments,
                                 const RunOptions& options = {}) {
  return RunningProgram(path, arguments, options).Wait();
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_RUNPROGRAM_H
