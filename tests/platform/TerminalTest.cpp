// Unfinished files and interruption.

#include "kestrel/platform/Terminal.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <filesystem>

#include "tests/support/FileText.h"
#include "tests/support/SystemFiles.h"
#include "tests/support/TempFolder.h"

namespace {

using kestrel_tests::FileText;
using kestrel_tests::TempFolder;
using namespace MCKestrel_800;

void Put(std::FILE* file, const std::string& text) {
  ASSERT_NE(file, nullptr);
  EXPECT_EQ(std::fwrite(text.data(), 1, text.size(), file), text.size());
}

TEST(Terminal, OpensFilesForWritingByteForByte) {
  const TempFolder folder;
  const std::string path = folder.Write("\xC3\xA4 \xE6\xBC\xA2.csv", "much longer than what comes now");
  std::FILE* const file = OpenForWriting(path);
  Put(file, std::string("a\nb\r\n\0\x1A", 7));
  EXPECT_EQ(std::fclose(file), 0);
  EXPECT_EQ(FileText(path), std::string("a\nb\r\n\0\x1A", 7));
}

TEST(Terminal, TellsWhyAFileCannotBeOpened) {
  const TempFolder folder;
  errno = 0;
  EXPECT_EQ(OpenForWriting(folder.PathOf("absent/file")), nullptr);
  EXPECT_EQ(errno, ENOENT);
  errno = 0;
  EXPECT_EQ(OpenForWriting(folder.GetPath().u8string()), nullptr);
  EXPECT_TRUE(errno == EISDIR || errno == EACCES) << errno;
}

TEST(Terminal, KnowsDevices) {
  const TempFolder folder;
  EXPECT_TRUE(IsDevice(kestrel_tests::NullDevice()));
  EXPECT_FALSE(IsDevice(folder.PathOf("absent")));
  EXPECT_FALSE(IsDevice(folder.Write("file \xC3\xA4", "text")));
  EXPECT_FALSE(IsDevice(folder.GetPath().u8string()));
  EXPECT_FALSE(IsDevice(""));
}

TEST(Terminal, RemovesTheWatchedFileWhileItIsOpen) {
  const TempFolder folder;
  const std::string path = folder.PathOf("unfinished \xC3\xA4");
  std::FILE* const file = OpenForWriting(path);
  RemoveWhenInterrupted(path);
  Put(file, "half");
  RemoveWatchedFile();
  std::fclose(file);
  RemoveWhenInterrupted(std::string());
  EXPECT_FALSE(std::filesystem::exists(std::filesystem::u8path(path)));
}

TEST(Terminal, LeavesFilesAloneThatAreNotWatchedAnyMore) {
  const TempFolder folder;
  const std::string path = folder.Write("finished", "whole");
  RemoveWhenInterrupted(path);
  RemoveWhenInterrupted(std::string());
  RemoveWatchedFile();
  EXPECT_EQ(FileText(path), "whole");
}

}  // namespace
