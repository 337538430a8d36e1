// Interruption, as Windows has it.

#include <gtest/gtest.h>

#include "tests/apps/StreamRuns.h"

namespace kestrel_tests {
namespace {

TEST(KestrelStreams, LeaveNoFileBehindWhenInterrupted) {
  // Console events reach the programs of one console alone.
  const bool has_console = AllocConsole() != 0 || GetConsoleCP() != 0;
  ASSERT_TRUE(has_console) << "error " << GetLastError();
  UnfinishedRun run;
  ASSERT_TRUE(run.GetProgram().GetProcess().Interrupt()) << "error " << GetLastError();
  EXPECT_EQ(run.GetProgram().Wait().exit_code, static_cast<int>(STATUS_CONTROL_C_EXIT));
  EXPECT_EQ(run.CountFiles(), 0);
}

}  // namespace
}  // namespace kestrel_tests
