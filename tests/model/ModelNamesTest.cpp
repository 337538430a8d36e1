// Tests of reading the names file.

#include "kestrel/model/ModelNames.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

#include "tests/support/ExpectFault.h"
#include "tests/support/TempFolder.h"

namespace {

using kestrel_tests::ExpectFault;
using kestrel_tests::TempFolder;
using MCKestrel_800::ReadModelNames;

using Names = std::vector<std::string>;

/// Makes the folder current for as long as it lives.
class CurrentFolder {
 public:
  explicit CurrentFolder(const std::filesystem::path& folder) : before_(std::filesystem::current_path()) {
    std::filesystem::current_path(folder);
  }
  ~CurrentFolder() { std::filesystem::current_path(before_); }

 private:
  std::filesystem::path before_;
};

TEST(ModelNames, SplitsTheFileIntoTags) {
  const std::string long_name(40000, 'x');
  const std::string across(4094, 'y');
  const std::string long_line(32766, ' ');
  struct Row {
    std::string content;
    Names expected;
    const char* why;
  };
  const Row rows[] = {
      {"TreeModel, RegressionModel\tNaiveBayesModel",
       {"TreeModel", "RegressionModel", "NaiveBayesModel"},
       "a comma and a blank, then a tab"},
      {"", {}, "an empty file"},
      {" ,\t\n\r\n , ", {}, "separators alone"},
      {"A\nB\r\nC\rD", {"A", "B", "C", "D"}, "line ends of every system"},
      {"A,,B,", {"A", "B"}, "empty fields"},
      {"B\nA\nB\n", {"B", "A", "B"}, "the order stays, and so do repeated tags"},
      {"A\n\n\nB", {"A", "B"}, "empty lines"},
      {"a;b", {"a;b"}, "a semicolon does not separate"},
      {"a\vb\fc", {"a\vb\fc"}, "nor do other control characters"},
      {"\xEF\xBB\xBFTreeModel", {"TreeModel"}, "an editor's UTF-8 mark is no part of the first tag"},
      {"\xEF\xBB\xBF", {}, "the mark alone"},
      {"\xEF\xBB", {"\xEF\xBB"}, "half a mark is none"},
      {"AB", {"AB"}, "shorter than the mark"},
      {"A \xEF\xBB\xBF", {"A", "\xEF\xBB\xBF"}, "a mark elsewhere is text"},
      {"Mod\xC3\xA8le", {"Mod\xC3\xA8le"}, "bytes beyond ASCII stay as they are"},
      {long_name, {long_name}, "a tag longer than the longest line of other programs"},
      {long_line + "AB C", {"AB", "C"}, "a tag across the 32767th character of a line"},
      {across + " Z", {across, "Z"}, "a tag that ends where a block does"},
      {std::string(3, ' ') + std::string(4095, ' ') + "AB\n", {"AB"}, "a tag across the end of a block"},
      {std::string("A\0B C", 5), {std::string("A\0B", 3), "C"}, "a zero byte is text"},
  };
  const TempFolder folder;
  for (const Row& row : rows) {
    Names names = {"left from before"};
    ReadModelNames(folder.Write("names.txt", row.content), names);
    EXPECT_EQ(names, row.expected) << row.why;
  }
}

TEST(ModelNames, HasNoLimitOfNames) {
  std::string content;
  Names expected;
  for (int i = 0; i < 50000; ++i) {
    expected.push_back("Model" + std::to_string(i));
    content += expected.back() + (i % 1000 == 0 ? "\n" : ",");
  }
  const TempFolder folder;
  Names names;
  ReadModelNames(folder.Write("names.txt", content), names);
  EXPECT_EQ(names, expected);
}

TEST(ModelNames, ReadsTheStandardFileOfTheCurrentFolderForAnEmptyPath) {
  const TempFolder folder;
  folder.Write("modeldll.txt", "TreeModel NeuralNetwork\n");
  const CurrentFolder current(folder.GetPath());
  Names names;
  ReadModelNames("", names);
  EXPECT_EQ(names, (Names{"TreeModel", "NeuralNetwork"}));
}

TEST(ModelNames, TakesAUtf8Path) {
  const TempFolder folder;
  Names names;
  ReadModelNames(folder.Write("n\xC3\xA4m\xC3\xA9s \xE6\xA8\xA1.txt", "TreeModel"), names);
  EXPECT_EQ(names, Names{"TreeModel"});
}

TEST(ModelNames, ThrowsForAFileThatCannotBeRead) {
  const TempFolder folder;
  const CurrentFolder current(folder.GetPath());
  const std::string file = folder.Write("names.txt", "TreeModel");
  struct Row {
    std::string path;
    const char* why;
  };
  const Row rows[] = {
      {folder.PathOf("absent.txt"), "absent"},
      {"", "no standard file in the current folder"},
      {folder.GetPath().u8string(), "a folder"},
      {file + std::string("\0x", 2), "a name that ends early must not open another file"},
      {folder.PathOf("absent/names.txt"), "in an absent folder"},
  };
  for (const Row& row : rows) {
    Names names = {"left from before"};
    ExpectFault([&] { ReadModelNames(row.path, names); }, 2, "Could not open model names file", row.why);
    EXPECT_EQ(names, Names()) << row.why;
  }
}

}  // namespace
