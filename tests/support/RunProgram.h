// Runs a program as a shell would and catches what it says.

#ifndef KESTREL_TESTS_SUPPORT_RUNPROGRAM_H
#define KESTREL_TESTS_SUPPORT_RUNPROGRAM_H

#include <fcntl.h>
#include <gtest/gtest.h>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <string>
#include <vector>

#include "tests/support/FileText.h"
#include "tests/support/TempFolder.h"

extern char** environ;

namespace kestrel_tests {

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
                 const RunOptions& options = {}) {
    const std::string input = folder_.Write("input", options.input);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    Redirect(actions, 0, options.input_descriptor, input, O_RDONLY);
    Redirect(actions, 1, options.output_descriptor, folder_.PathOf("output"), O_WRONLY | O_CREAT);
    Redirect(actions, 2, options.error_descriptor, folder_.PathOf("errors"), O_WRONLY | O_CREAT);
    std::vector<std::string> words = {path};
    words.insert(words.end(), arguments.begin(), arguments.end());
    std::vector<std::string> environment = options.environment;
    std::vector<char*> environment_pointers = Pointers(environment);
    environment_pointers.pop_back();
    for (char** variable = environ; *variable != nullptr; ++variable) {
      if (!IsGiven(*variable, environment)) environment_pointers.push_back(*variable);
    }
    environment_pointers.push_back(nullptr);
    const int failure = posix_spawn(&process_, path.c_str(), &actions, nullptr, Pointers(words).data(),
                                    environment_pointers.data());
    posix_spawn_file_actions_destroy(&actions);
    EXPECT_EQ(failure, 0) << path << " could not be started";
    if (failure != 0) process_ = -1;
  }
  ~RunningProgram() {
    if (process_ == -1) return;
    Send(SIGKILL);
    Wait();
  }
  RunningProgram(const RunningProgram&) = delete;
  RunningProgram& operator=(const RunningProgram&) = delete;

  void Send(int signal_number) const {
    if (process_ != -1) kill(process_, signal_number);
  }

  ProgramOutcome Wait() {
    ProgramOutcome outcome;
    if (process_ == -1) return outcome;
    int status = 0;
    EXPECT_EQ(waitpid(process_, &status, 0), process_);
    process_ = -1;
    if (WIFEXITED(status)) outcome.exit_code = WEXITSTATUS(status);
    if (WIFSIGNALED(status)) outcome.signal = WTERMSIG(status);
    for (const char* name : {"output", "errors"}) {
      if (!std::filesystem::exists(folder_.GetPath() / name)) continue;
      (name[0] == 'o' ? outcome.output : outcome.errors) = FileText(folder_.PathOf(name));
    }
    return outcome;
  }

 private:
  static void Redirect(posix_spawn_file_actions_t& actions, int stream, int descriptor,
                       const std::string& path, int flags) {
    if (descriptor != -1) {
      posix_spawn_file_actions_adddup2(&actions, descriptor, stream);
    } else {
      posix_spawn_file_actions_addopen(&actions, stream, path.c_str(), flags, 0600);
    }
  }

  static std::vector<char*> Pointers(std::vector<std::string>& texts) {
    std::vector<char*> pointers;
    for (std::string& text : texts)
      pointers.push_back(&text[0]);
    pointers.push_back(nullptr);
    return pointers;
  }

  static bool IsGiven(const std::string& variable, const std::vector<std::string>& environment) {
    const std::string name = variable.substr(0, variable.find('=') + 1);
    for (const std::string& given : environment) {
      if (given.compare(0, name.size(), name) == 0) return true;
    }
    return false;
  }

  TempFolder folder_;
  pid_t process_ = -1;
};

inline ProgramOutcome RunProgram(const std::string& path, const std::vector<std::string>& arguments,
                                 const RunOptions& options = {}) {
  return RunningProgram(path, arguments, options).Wait();
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_RUNPROGRAM_H
