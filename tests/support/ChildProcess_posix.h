// A program that runs beside the test, on systems with POSIX processes. ChildProcess_windows.h is the other
// one.

#ifndef KESTREL_TESTS_SUPPORT_CHILDPROCESS_POSIX_H
#define KESTREL_TESTS_SUPPORT_CHILDPROCESS_POSIX_H

#include <fcntl.h>
#include <gtest/gtest.h>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <string>
#include <vector>

extern char** environ;

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
  ChildProcess(std::vector<std::string> words, std::vector<std::string> variables,
               const StreamGoal (&streams)[3]) {
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    for (int stream = 0; stream < 3; ++stream) {
      const StreamGoal& goal = streams[stream];
      if (goal.descriptor != -1) {
        posix_spawn_file_actions_adddup2(&actions, goal.descriptor, stream);
      } else {
        const int flags = stream == 0 ? O_RDONLY : O_WRONLY | O_CREAT;
        posix_spawn_file_actions_addopen(&actions, stream, goal.path.c_str(), flags, 0600);
      }
    }
    std::vector<char*> environment = Pointers(variables);
    environment.pop_back();
    for (char** variable = environ; *variable != nullptr; ++variable) {
      if (!IsGiven(*variable, variables)) environment.push_back(*variable);
    }
    environment.push_back(nullptr);
    const int failure = posix_spawn(&process_, words[0].c_str(), &actions, nullptr, Pointers(words).data(),
                                    environment.data());
    posix_spawn_file_actions_destroy(&actions);
    EXPECT_EQ(failure, 0) << words[0] << " could not be started";
    if (failure != 0) process_ = -1;
  }
  ~ChildProcess() {
    if (process_ == -1) return;
    Send(SIGKILL);
    int exit_code = 0;
    int signal_number = 0;
    Wait(exit_code, signal_number);
  }
  ChildProcess(const ChildProcess&) = delete;
  ChildProcess& operator=(const ChildProcess&) = delete;

  void Send(int signal_number) const {
    if (process_ != -1) kill(process_, signal_number);
  }

  /// Sets one of the two; the other one stays as it is.
  void Wait(int& exit_code, int& signal_number) {
    if (process_ == -1) return;
    int status = 0;
    EXPECT_EQ(waitpid(process_, &status, 0), process_);
    process_ = -1;
    if (WIFEXITED(status)) exit_code = WEXITSTATUS(status);
    if (WIFSIGNALED(status)) signal_number = WTERMSIG(status);
  }

 private:
  static std::vector<char*> Pointers(std::vector<std::string>& texts) {
    std::vector<char*> pointers;
    for (std::string& text : texts)
      pointers.push_back(&text[0]);
    pointers.push_back(nullptr);
    return pointers;
  }

  static bool IsGiven(const std::string& variable, const std::vector<std::string>& variables) {
    const std::string name = variable.substr(0, variable.find('=') + 1);
    for (const std::string& given : variables) {
      if (given.compare(0, name.size(), name) == 0) return true;
    }
    return false;
  }

  pid_t process_ = -1;
};

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_CHILDPROCESS_POSIX_H
