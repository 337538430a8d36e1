#include "apps/kestrel/OutputFile.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "apps/kestrel/ProgramError.h"
#include "kestrel/platform/Terminal.h"
#include "tests/support/FileText.h"
#include "tests/support/SystemFiles.h"
#include "tests/support/TempFolder.h"

namespace kestrel_tests {
namespace {

namespace fs = std::filesystem;
using kestrel_program::OutputFile;
using kestrel_program::ProgramError;

std::size_t CountFiles(const TempFolder& folder) {
  return static_cast<std::size_t>(
      std::distance(fs::directory_iterator(folder.GetPath()), fs::directory_iterator()));
}

void Write(const std::string& path, const std::string& text) {
  OutputFile output(path);
  output.GetBuffer() += text;
  output.Finish();
}

TEST(OutputFile, AppearsWhenItIsComplete) {
  const TempFolder folder;
  const std::string path = folder.PathOf("out \xC3\xA4.csv");
  OutputFile output(path);
  output.GetBuffer() += "first\n";
  output.FlushIfFull();
  EXPECT_FALSE(fs::exists(fs::u8path(path)));
  output.GetBuffer() += "second\n";
  output.Finish();
  EXPECT_EQ(FileText(path), "first\nsecond\n");
  EXPECT_EQ(CountFiles(folder), 1u);
}

TEST(OutputFile, WritesWhatIsMoreThanABlockInOrder) {
  const TempFolder folder;
  const std::string path = folder.PathOf("out");
  std::string want;
  OutputFile output(path);
  for (int i = 0; i < 200'000; ++i) {
    output.GetBuffer() += std::to_string(i) + "\n";
    want += std::to_string(i) + "\n";
    output.FlushIfFull();
    ASSERT_LT(output.GetBuffer().size(), 300'000u);
  }
  output.Finish();
  EXPECT_EQ(FileText(path), want);
}

TEST(OutputFile, LeavesWhatIsThereUntilItIsComplete) {
  const TempFolder folder;
  const std::string path = folder.Write("out", "old");
  OutputFile output(path);
  output.GetBuffer().assign(1'000'000, 'x');
  output.FlushIfFull();
  EXPECT_EQ(FileText(path), "old");
  output.Finish();
  EXPECT_EQ(FileText(path).size(), 1'000'000u);
}

TEST(OutputFile, LeavesNothingWhenItIsGivenUp) {
  const TempFolder folder;
  const std::string old = folder.Write("old", "old");
  for (const std::string& path : {old, folder.PathOf("new")}) {
    OutputFile output(path);
    output.GetBuffer().assign(1'000'000, 'x');
    output.FlushIfFull();
    EXPECT_EQ(CountFiles(folder), 2u);
  }
  EXPECT_EQ(FileText(old), "old");
  EXPECT_EQ(CountFiles(folder), 1u);
}

TEST(OutputFile, FollowsLinksAndKeepsPermissions) {
  const TempFolder folder;
  fs::create_directory(folder.GetPath() / "elsewhere");
  const std::string target = folder.Write("elsewhere/target", "old");
  fs::permissions(fs::u8path(target), fs::perms::owner_read | fs::perms::owner_write);
  const std::string link = folder.PathOf("link");
  if (!MakeLink(fs::u8path(target), fs::u8path(link))) GTEST_SKIP() << "there are no links here";
  Write(link, "new");
  EXPECT_TRUE(fs::is_symlink(fs::u8path(link)));
  EXPECT_EQ(FileText(target), "new");
  EXPECT_EQ(fs::status(fs::u8path(target)).permissions(), fs::perms::owner_read | fs::perms::owner_write);
}

TEST(OutputFile, WritesIntoADeviceInsteadOfReplacingIt) {
  Write(NullDevice(), "text");
  EXPECT_TRUE(MCKestrel_800::IsDevice(NullDevice()));
}

struct FaultRow {
  const char* why;
  std::string path;
  std::string want;
};

TEST(OutputFile, SaysWhyItCannotBeWritten) {
  const TempFolder folder;
  const std::string nowhere = folder.PathOf("absent/out");
  const std::string itself = folder.GetPath().u8string();
  std::vector<FaultRow> rows = {
      {"no such folder", nowhere, nowhere + ": cannot be written: No such file or directory"},
      {"a folder", itself, itself + ": this is a folder; the name of a file is expected"},
  };
  if (const std::string full = FullDevice(); !full.empty())
    rows.push_back({"a full disk", full, full + ": writing failed: No space left on device"});
  for (const FaultRow& row : rows) {
    try {
      Write(row.path, "text");
      ADD_FAILURE() << row.why;
    } catch (const ProgramError& fault) {
      EXPECT_EQ(fault.GetCode(), kestrel_program::kInputOutput);
      EXPECT_EQ(fault.GetText(), row.want) << row.why;
    }
  }
  EXPECT_EQ(CountFiles(folder), 0u);
}

}  // namespace
}  // namespace kestrel_tests
