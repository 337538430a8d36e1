// What becomes of answers that cannot be written.

#include <gtest/gtest.h>

#include <algorithm>

#include "tests/apps/StreamRuns.h"
#include "tests/support/SystemFiles.h"

namespace kestrel_tests {
namespace {

TEST(KestrelStreams, ReportAnOutputThatCannotBeWritten) {
  const TempFolder folder;
  const std::string path = folder.Write("for reading alone", "");
  const Descriptor reader(open(path.c_str(), O_RDONLY));
  for (const std::vector<std::string>& command : kStreamCommands) {
    RunOptions options;
    options.input = "x\n1\n";
    options.output_descriptor = reader.Get();
    const ProgramOutcome outcome = RunKestrel(folder, command, options);
    EXPECT_EQ(outcome.exit_code, 5) << command[0];
    EXPECT_EQ(outcome.errors, "kestrel: standard output: writing failed: Bad file descriptor\n")
        << command[0];
  }
}

TEST(KestrelStreams, ReportAReaderThatWentAway) {
  const TempFolder folder;
  for (const std::vector<std::string>& command : kStreamCommands) {
    Pipe pipe = MakePipe();
    pipe.reader.Close();
    RunOptions options;
    options.input = LongTable();
    options.output_descriptor = pipe.writer.Get();
    const ProgramOutcome outcome = RunKestrel(folder, command, options);
    EXPECT_EQ(outcome.signal, 0) << command[0];
    EXPECT_EQ(outcome.exit_code, 5) << command[0];
    std::vector<std::string> accepted;
    for (const std::string& reason : BrokenPipeReasons())
      accepted.push_back("kestrel: standard output: writing failed: " + reason + "\n");
    EXPECT_NE(std::find(accepted.begin(), accepted.end(), outcome.errors), accepted.end())
        << command[0] << ": " << outcome.errors;
  }
}

TEST(KestrelStreams, ShowNoProgressInAFile) {
  const TempFolder folder;
  RunOptions options;
  options.input = LongTable();
  EXPECT_EQ(RunKestrel(folder, {"score", "D/line.xml"}, options).errors, "");
}

}  // namespace
}  // namespace kestrel_tests
