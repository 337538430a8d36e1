// What becomes of answers that cannot be written, of interruptions and of the line that shows progress.

#include <gtest/gtest.h>
#include <stdlib.h>

#include <array>
#include <chrono>
#include <thread>

#include "tests/apps/KestrelProgram.h"
#include "tests/support/FileText.h"

namespace kestrel_tests {
namespace {

/// A file descriptor that is closed in the end.
class Descriptor {
 public:
  explicit Descriptor(int number) : number_(number) { EXPECT_NE(number, -1); }
  ~Descriptor() { Close(); }
  Descriptor(const Descriptor&) = delete;
  Descriptor& operator=(const Descriptor&) = delete;
  int Get() const { return number_; }
  void Close() {
    if (number_ != -1) close(number_);
    number_ = -1;
  }

 private:
  int number_;
};

std::string LongTable() {
  std::string table = "x\n";
  for (int i = 0; i < 200'000; ++i)
    table += std::to_string(i) + "\n";
  return table;
}

const std::vector<std::string> kCommands[] = {{"score", "D/line.xml"},
                                              {"check", "D/line.xml"},
                                              {"describe", "D/line.xml"},
                                              {"--help"},
                                              {"--version"},
                                              {"copy-table"},
                                              {"derive", "D/derived.xml", "--fields", "twice"}};

TEST(KestrelStreams, ReportAFullDisk) {
  const TempFolder folder;
  const Descriptor full(open("/dev/full", O_WRONLY));
  for (const std::vector<std::string>& command : kCommands) {
    RunOptions options;
    options.input = "x\n1\n";
    options.output_descriptor = full.Get();
    const ProgramOutcome outcome = RunKestrel(folder, command, options);
    EXPECT_EQ(outcome.exit_code, 5) << command[0];
    EXPECT_EQ(outcome.errors, "kestrel: standard output: writing failed: No space left on device\n")
        << command[0];
  }
}

TEST(KestrelStreams, ReportAReaderThatWentAway) {
  const TempFolder folder;
  for (const std::vector<std::string>& command : kCommands) {
    std::array<int, 2> ends{};
    ASSERT_EQ(pipe(ends.data()), 0);
    Descriptor reader(ends[0]);
    const Descriptor writer(ends[1]);
    reader.Close();
    RunOptions options;
    options.input = LongTable();
    options.output_descriptor = writer.Get();
    const ProgramOutcome outcome = RunKestrel(folder, command, options);
    EXPECT_EQ(outcome.signal, 0) << command[0];
    EXPECT_EQ(outcome.exit_code, 5) << command[0];
    EXPECT_EQ(outcome.errors, "kestrel: standard output: writing failed: Broken pipe\n") << command[0];
  }
}

TEST(KestrelStreams, LeaveNoFileBehindWhenInterrupted) {
  for (const int signal_number : {SIGINT, SIGTERM, SIGHUP}) {
    const TempFolder folder;
    std::array<int, 2> ends{};
    ASSERT_EQ(pipe(ends.data()), 0);
    const Descriptor reader(ends[0]);
    // The child must not hold the end that is written to, or it would never see the end of its input.
    const Descriptor writer(ends[1]);
    ASSERT_EQ(fcntl(writer.Get(), F_SETFD, FD_CLOEXEC), 0);
    // More than the program reads at once, so that it is in the middle of the table when it waits for more.
    const std::string out = folder.PathOf("out.csv");
    RunOptions options;
    options.input_descriptor = reader.Get();
    RunningProgram program(KestrelPath(), {"score", DataPath("line.xml"), "-o", out}, options);
    const std::string table = LongTable();
    ASSERT_EQ(write(writer.Get(), table.data(), table.size()), static_cast<ssize_t>(table.size()));
    const auto count_files = [&folder] {
      return std::distance(std::filesystem::directory_iterator(folder.GetPath()), {});
    };
    for (int i = 0; i < 500 && count_files() == 0; ++i)
      std::this_thread::sleep_for(std::chrono::milliseconds(20));
    EXPECT_EQ(count_files(), 1);
    EXPECT_FALSE(std::filesystem::exists(std::filesystem::u8path(out)));
    program.Send(signal_number);
    EXPECT_EQ(program.Wait().signal, signal_number);
    EXPECT_EQ(count_files(), 0);
  }
}

TEST(KestrelStreams, ShowProgressOnATerminalOnly) {
  const TempFolder folder;
  const int master = posix_openpt(O_RDWR | O_NOCTTY);
  if (master == -1) GTEST_SKIP() << "this system gives out no terminals (is /dev/pts mounted?)";
  const Descriptor terminal(master);
  ASSERT_EQ(grantpt(terminal.Get()) | unlockpt(terminal.Get()), 0);
  std::array<char, 100> name{};
  ASSERT_EQ(ptsname_r(terminal.Get(), name.data(), name.size()), 0);
  const Descriptor screen(open(name.data(), O_RDWR | O_NOCTTY));
  std::array<int, 2> ends{};
  ASSERT_EQ(pipe(ends.data()), 0);
  const Descriptor reader(ends[0]);
  Descriptor writer(ends[1]);
  ASSERT_EQ(fcntl(writer.Get(), F_SETFD, FD_CLOEXEC), 0);
  RunOptions options;
  options.input_descriptor = reader.Get();
  options.error_descriptor = screen.Get();
  RunningProgram program(KestrelPath(), {"score", DataPath("line.xml")}, options);
  const std::string table = LongTable();
  ASSERT_EQ(write(writer.Get(), table.data(), table.size()), static_cast<ssize_t>(table.size()));
  // The line comes at most twice a second.
  std::this_thread::sleep_for(std::chrono::milliseconds(1200));
  const std::string rows = table.substr(2);
  ASSERT_EQ(write(writer.Get(), rows.data(), rows.size()), static_cast<ssize_t>(rows.size()));
  writer.Close();
  EXPECT_EQ(program.Wait().exit_code, 0);
  std::array<char, 4096> shown{};
  const ssize_t size = read(terminal.Get(), shown.data(), shown.size());
  ASSERT_GT(size, 0);
  const std::string text(shown.data(), static_cast<std::size_t>(size));
  EXPECT_EQ(text.front(), '\r');
  EXPECT_NE(text.find(" cases, "), std::string::npos) << text;
  EXPECT_NE(text.find(" a second"), std::string::npos) << text;
  EXPECT_EQ(text.back(), '\r') << "the line is wiped in the end";

  options = RunOptions();
  options.input = table;
  EXPECT_EQ(RunKestrel(folder, {"score", "D/line.xml"}, options).errors, "");
}

}  // namespace
}  // namespace kestrel_tests
