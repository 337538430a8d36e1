// The system's words for what just went wrong.

#ifndef KESTREL_APPS_KESTREL_SYSTEMREASON_H
#define KESTREL_APPS_KESTREL_SYSTEMREASON_H

#include <cerrno>
#include <string>
#include <system_error>

namespace kestrel_program {

/// ": " and the reason that errno holds; empty when it holds none. Set errno to 0 before the operation.
inline std::string SystemReason() {
  return errno == 0 ? std::string() : ": " + std::generic_category().message(errno);
}

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_SYSTEMREASON_H
