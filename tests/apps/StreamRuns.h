// What the tests of the program's streams run.

#ifndef KESTREL_TESTS_APPS_STREAMRUNS_H
#define KESTREL_TESTS_APPS_STREAMRUNS_H

#include <gtest/gtest.h>

#include <chrono>
#include <string>
#include <thread>
#include <vector>

#include "tests/apps/KestrelProgram.h"
#include "tests/support/StreamEnds.h"

namespace kestrel_tests {

inline std::string LongTable() {
  std::string table = "x\n";
  for (int i = 0; i < 200'000; ++i)
    table += std::to_string(i) + "\n";
  return table;
}

/// Every command that writes to the standard output; those that read a table read it from the standard input.
inline const std::vector<std::string> kStreamCommands[] = {{"score", "D/line.xml"},
                                                           {"check", "D/line.xml"},
                                                           {"describe", "D/line.xml"},
                                                           {"--help"},
                                                           {"--version"},
                                                           {"copy-table"},
                                                           {"derive", "D/derived.xml", "--fields", "twice"}};

/// A run that is in the middle of a table: it has begun its output file and waits for more input.
class UnfinishedRun {
 public:
  UnfinishedRun()
      : program_(KestrelPath(), {"score", DataPath("line.xml"), "-o", OutputPath()},
                 OptionsFor(pipe_.reader.Get())) {
    // More than the program reads at once.
    pipe_.writer.Write(LongTable());
    for (int i = 0; i < 500 && CountFiles() == 0; ++i)
      std::this_thread::sleep_for(std::chrono::milliseconds(20));
    EXPECT_EQ(CountFiles(), 1);
    EXPECT_FALSE(std::filesystem::exists(std::filesystem::u8path(OutputPath())));
  }

  RunningProgram& GetProgram() { return program_; }
  std::string OutputPath() const { return folder_.PathOf("out \xC3\xA4.csv"); }
  long CountFiles() const {
    return static_cast<long>(std::distance(std::filesystem::directory_iterator(folder_.GetPath()), {}));
  }

 private:
  static RunOptions OptionsFor(int input) {
    RunOptions options;
    options.input_descriptor = input;
    return options;
  }

  TempFolder folder_;
  Pipe pipe_ = MakePipe();
  RunningProgram program_;
};

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_APPS_STREAMRUNS_H
