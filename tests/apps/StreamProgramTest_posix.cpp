// Full disks, signals and the line that shows progress, as POSIX systems have them.

#include <gtest/gtest.h>
#include <signal.h>
#include <stdlib.h>

#include <array>

#include "tests/apps/StreamRuns.h"

namespace kestrel_tests {
namespace {

TEST(KestrelStreams, ReportAFullDisk) {
  const TempFolder folder;
  const Descriptor full(open("/dev/full", O_WRONLY));
  for (const std::vector<std::string>& command : kStreamCommands) {
    RunOptions options;
    options.input = "x\n1\n";
    options.output_descriptor = full.Get();
    const ProgramOutcome outcome = RunKestrel(folder, command, options);
    EXPECT_EQ(outcome.exit_code, 5) << command[0];
    EXPECT_EQ(outcome.errors, "kestrel: standard output: writing failed: No space left on device\n")
        << command[0];
  }
}

TEST(KestrelStreams, LeaveNoFileBehindWhenInterrupted) {
  for (const int signal_number : {SIGINT, SIGTERM, SIGHUP}) {
    UnfinishedRun run;
    run.GetProgram().GetProcess().Send(signal_number);
    EXPECT_EQ(run.GetProgram().Wait().signal, signal_number);
    EXPECT_EQ(run.CountFiles(), 0);
  }
}

TEST(KestrelStreams, ShowProgressOnATerminal) {
  const int master = posix_openpt(O_RDWR | O_NOCTTY);
  if (master == -1) GTEST_SKIP() << "this system gives out no terminals (is /dev/pts mounted?)";
  const Descriptor terminal(master);
  ASSERT_EQ(grantpt(terminal.Get()) | unlockpt(terminal.Get()), 0);
  std::array<char, 100> name{};
  ASSERT_EQ(ptsname_r(terminal.Get(), name.data(), name.size()), 0);
  const Descriptor screen(open(name.data(), O_RDWR | O_NOCTTY));
  Pipe pipe = MakePipe();
  RunOptions options;
  options.input_descriptor = pipe.reader.Get();
  options.error_descriptor = screen.Get();
  RunningProgram program(KestrelPath(), {"score", DataPath("line.xml")}, options);
  const std::string table = LongTable();
  pipe.writer.Write(table);
  // The line comes at most twice a second.
  std::this_thread::sleep_for(std::chrono::milliseconds(1200));
  pipe.writer.Write(table.substr(2));
  pipe.writer.Close();
  EXPECT_EQ(program.Wait().exit_code, 0);
  std::array<char, 4096> shown{};
  const ssize_t size = read(terminal.Get(), shown.data(), shown.size());
  ASSERT_GT(size, 0);
  const std::string text(shown.data(), static_cast<std::size_t>(size));
  EXPECT_EQ(text.front(), '\r');
  EXPECT_NE(text.find(" cases, "), std::string::npos) << text;
  EXPECT_NE(text.find(" a second"), std::string::npos) << text;
  EXPECT_EQ(text.back(), '\r') << "the line is wiped in the end";
}

}  // namespace
}  // namespace kestrel_tests
