// The built program `kestrel`, as tests run it.

#ifndef KESTREL_TESTS_APPS_KESTRELPROGRAM_H
#define KESTREL_TESTS_APPS_KESTRELPROGRAM_H

#include <string>
#include <vector>

#include "tests/support/RunProgram.h"
#include "tests/support/TempFolder.h"

namespace kestrel_tests {

inline std::string KestrelPath() {
  return BuiltProgram("bin/kestrel");
}

inline std::string DataPath(const std::string& name) {
  return std::string(KESTREL_SOURCE_DIR) + "/tests/data/program/" + name;
}

/// The text with every `from` written as `to`.
inline std::string Replaced(std::string text, const std::string& from, const std::string& to) {
  for (std::size_t at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size()))
    text.replace(at, from.size(), to);
  return text;
}

/// Runs the program. In arguments "D/" at the start is the folder of test data and "T/" the given folder; in
/// what comes back those folders' paths are written so as well.
inline ProgramOutcome RunKestrel(const TempFolder& folder, std::vector<std::string> arguments,
                                 const RunOptions& options = {}) {
  const std::string data = DataPath("");
  const std::string temporary = folder.GetPath().u8string() + "/";
  for (std::string& argument : arguments) {
    if (argument.compare(0, 2, "D/") == 0) argument = data + argument.substr(2);
    if (argument.compare(0, 2, "T/") == 0) argument = temporary + argument.substr(2);
  }
  ProgramOutcome outcome = RunProgram(KestrelPath(), arguments, options);
  for (std::string* text : {&outcome.output, &outcome.errors})
    *text = Replaced(Replaced(*text, data, "D/"), temporary, "T/");
  return outcome;
}

/// The same with a text on the standard input.
inline ProgramOutcome RunKestrel(const std::vector<std::string>& arguments, const std::string& input = {}) {
  const TempFolder folder;
  RunOptions options;
  options.input = input;
  return RunKestrel(folder, arguments, options);
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_APPS_KESTRELPROGRAM_H
