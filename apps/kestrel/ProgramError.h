// How a command gives up.

#ifndef KESTREL_APPS_KESTREL_PROGRAMERROR_H
#define KESTREL_APPS_KESTREL_PROGRAMERROR_H

#include <string>
#include <utility>

#include "apps/kestrel/ExitCode.h"

namespace kestrel_program {

/// Thrown by any part, caught in main alone, which prints "kestrel: " and the text and ends with the code.
class ProgramError {
 public:
  ProgramError(ExitCode code, std::string text) : code_(code), text_(std::move(text)) {}

  ExitCode GetCode() const { return code_; }
  const std::string& GetText() const { return text_; }

 private:
  ExitCode code_;
  std::string text_;
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_PROGRAMERROR_H
