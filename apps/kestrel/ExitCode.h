// What the program tells the shell.

#ifndef KESTREL_APPS_KESTREL_EXITCODE_H
#define KESTREL_APPS_KESTREL_EXITCODE_H

namespace kestrel_program {

enum ExitCode : int {
  kDone = 0,
  kSomeCasesFailed = 1,
  kUsage = 2,
  kDocument = 3,
  kData = 4,
  kInputOutput = 5,
};

/// The same for people: the end of every help text.
constexpr const char* kExitCodesHelp =
    "Exit codes:\n"
    "  0  done\n"
    "  1  done, but some cases have no answer because they could not be read or scored\n"
    "  2  the command line is not right\n"
    "  3  the model's document cannot be used\n"
    "  4  the table cannot be used\n"
    "  5  a file or stream could not be read or written, or the memory did not suffice";

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_EXITCODE_H
