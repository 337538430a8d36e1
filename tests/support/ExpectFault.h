// Checking that something throws a KestrelException with a code and a text.

#ifndef KESTREL_TESTS_SUPPORT_EXPECTFAULT_H
#define KESTREL_TESTS_SUPPORT_EXPECTFAULT_H

#include <gtest/gtest.h>

#include <string>

#include "kestrel/foundation/KestrelException.h"

namespace kestrel_tests {

/// Runs `action` and expects a KestrelException with exactly this code and text.
template <typename Action>
void ExpectFault(Action action, int code, const std::string& message,
                 const std::string& why = std::string()) {
  try {
    action();
    ADD_FAILURE() << "nothing was thrown; expected \"" << message << "\" " << why;
  } catch (const MCKestrel_800::KestrelException& fault) {
    EXPECT_EQ(fault.GetErrorCode(), code) << why;
    EXPECT_EQ(fault.GetErrorMessage(), message) << why;
  }
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_EXPECTFAULT_H
