// Tests of opening libraries at run time.

#include "kestrel/platform/SharedLibrary.h"

#include <gtest/gtest.h>

#include <fstream>
#include <string>

namespace {

using MCKestrel_800::SharedLibrary;

const std::string kSuffix = SharedLibrary::GetSuffix();

TEST(SharedLibrary, AddsTheSuffixOnce) {
  struct Row {
    std::string name;
    std::string expected;
    const char* why;
  };
  std::string upper = kSuffix;
  for (char& c : upper)
    c = static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
  const Row rows[] = {
      {"TreeModel800r", "TreeModel800r" + kSuffix, "no suffix yet"},
      {"TreeModel800r" + kSuffix, "TreeModel800r" + kSuffix, "there already"},
      {"TreeModel800r" + upper, "TreeModel800r" + upper, "case does not count"},
      {"a" + kSuffix, "a" + kSuffix, "one letter is enough of a name"},
      {kSuffix, kSuffix + kSuffix, "the suffix alone is a name without a suffix"},
      {upper, upper + kSuffix, "so it is in capitals"},
      {"", kSuffix, "an empty name"},
      {"so", "so" + kSuffix, "shorter than the suffix"},
      {"TreeModel" + kSuffix + "x", "TreeModel" + kSuffix + "x" + kSuffix, "the suffix is not at the end"},
      {"TreeModel" + kSuffix.substr(1), "TreeModel" + kSuffix.substr(1) + kSuffix, "without its point"},
  };
  for (const Row& row : rows)
    EXPECT_EQ(SharedLibrary::WithSuffix(row.name), row.expected) << row.why;
}

TEST(SharedLibrary, StartsEmpty) {
  SharedLibrary library("anything");
  EXPECT_FALSE(library.IsLoaded());
  EXPECT_EQ(library.GetFileName(), "anything");
  EXPECT_EQ(library.GetLastErrorText(), "");
}

TEST(SharedLibrary, TellsWhyItCouldNotLoad) {
  const std::string text_file = testing::TempDir() + "kestrel_no_library" + kSuffix;
  std::ofstream(text_file) << "This is no library.\n";
  struct Row {
    std::string name;
    const char* why;
  };
  const Row rows[] = {
      {"kestrel_absent_library" + kSuffix, "absent, by bare name"},
      {testing::TempDir() + "kestrel_absent_library" + kSuffix, "absent, by path"},
      {text_file, "a text file"},
      {testing::TempDir(), "a folder"},
      {KESTREL_STUB_NEEDS_ABSENT, "a library that needs one that is absent"},
  };
  for (const Row& row : rows) {
    SharedLibrary library(row.name);
    EXPECT_FALSE(library.Load()) << row.why;
    EXPECT_FALSE(library.IsLoaded()) << row.why;
    EXPECT_NE(library.GetLastErrorText(), "") << row.why;
    EXPECT_EQ(library.FindSymbol("GiveNumber"), nullptr) << row.why;
    EXPECT_NE(library.GetLastErrorText(), "") << row.why;
  }
}

TEST(SharedLibrary, FindsExportedNames) {
  SharedLibrary library(KESTREL_STUB_LIBRARY);
  EXPECT_EQ(library.FindSymbol("GiveNumber"), nullptr) << "nothing is loaded before Load";
  EXPECT_NE(library.GetLastErrorText(), "");
  ASSERT_TRUE(library.Load()) << library.GetLastErrorText();
  EXPECT_TRUE(library.IsLoaded());
  EXPECT_TRUE(library.Load()) << "a second time changes nothing";
  void* symbol = library.FindSymbol("GiveNumber");
  ASSERT_NE(symbol, nullptr) << library.GetLastErrorText();
  EXPECT_EQ(reinterpret_cast<int (*)()>(symbol)(), 800);
}

TEST(SharedLibrary, TellsThatANameIsMissing) {
  SharedLibrary library(KESTREL_STUB_LIBRARY);
  ASSERT_TRUE(library.Load()) << library.GetLastErrorText();
  EXPECT_EQ(library.GetLastErrorText(), "");
  EXPECT_EQ(library.FindSymbol("NoSuchName"), nullptr);
  EXPECT_NE(library.GetLastErrorText(), "");
  EXPECT_TRUE(library.IsLoaded()) << "the library itself is sound";
}

TEST(SharedLibrary, StaysLoadedWhenTheHolderGoes) {
  int (*count)() = nullptr;
  {
    SharedLibrary library(KESTREL_STUB_LIBRARY);
    ASSERT_TRUE(library.Load()) << library.GetLastErrorText();
    count = reinterpret_cast<int (*)()>(library.FindSymbol("CountCalls"));
    ASSERT_NE(count, nullptr);
  }
  const int first = count();
  EXPECT_EQ(count(), first + 1) << "the code can still be called";
  SharedLibrary again(KESTREL_STUB_LIBRARY);
  ASSERT_TRUE(again.Load());
  auto* same = reinterpret_cast<int (*)()>(again.FindSymbol("CountCalls"));
  EXPECT_EQ(same(), first + 2) << "it is the same library with the same state";
}

}  // namespace
