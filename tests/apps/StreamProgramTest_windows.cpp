// Interruption, as Windows has it.

#include <gtest/gtest.h>

#include "tests/apps/StreamRuns.h"

namespace kestrel_tests {
namespace {

TEST(KestrelStreams, LeaveNoFileBehindWhenInterrupted) {
  UnfinishedRun run;
  if (!run.GetProgram().GetProcess().Interrupt()) GTEST_SKIP() << "there is no console to interrupt it in";
  EXPECT_EQ(run.GetProgram().Wait().exit_code, static_cast<int>(STATUS_CONTROL_C_EXIT));
  EXPECT_EQ(run.CountFiles(), 0);
}

}  // namespace
}  // namespace kestrel_tests
