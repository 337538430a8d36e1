// The error texts of libraries that cannot be used are the system's own words.

#ifndef NOMINMAX
#define NOMINMAX
#endif
#include <windows.h>
// windows.h goes first: the next headers need its types.
#include <gtest/gtest.h>

#include "kestrel/platform/SharedLibrary.h"
#include "tests/support/TempFolder.h"

namespace {

using kestrel_tests::TempFolder;
using MCKestrel_800::SharedLibrary;

std::string SystemWords(DWORD error) {
  char words[1024] = {};
  DWORD length = FormatMessageA(FORMAT_MESSAGE_FROM_SYSTEM | FORMAT_MESSAGE_IGNORE_INSERTS, nullptr, error, 0,
                                words, sizeof words, nullptr);
  while (length > 0 && std::isspace(static_cast<unsigned char>(words[length - 1])))
    --length;
  return std::string(words, length);
}

TEST(SharedLibrary, FailsInTheSystemsWords) {
  const TempFolder folder;
  struct Row {
    std::string name;
    DWORD error;
    const char* why;
  };
  const Row rows[] = {
      {"kestrel_absent_library.dll", ERROR_MOD_NOT_FOUND, "absent, by bare name"},
      {folder.PathOf("kestrel absent.dll"), ERROR_MOD_NOT_FOUND, "absent, by path"},
      {folder.Write("no library.dll", "This is no library.\n"), ERROR_BAD_EXE_FORMAT, "a text file"},
      {KESTREL_STUB_NEEDS_ABSENT, ERROR_MOD_NOT_FOUND, "needs one that is absent"},
  };
  for (const Row& row : rows) {
    SharedLibrary library(row.name);
    EXPECT_FALSE(library.Load()) << row.why;
    EXPECT_EQ(library.GetLastErrorText(), SystemWords(row.error)) << row.why;
  }
  SharedLibrary library(KESTREL_STUB_LIBRARY);
  ASSERT_TRUE(library.Load());
  EXPECT_EQ(library.FindSymbol("NoSuchName"), nullptr);
  EXPECT_EQ(library.GetLastErrorText(), SystemWords(ERROR_PROC_NOT_FOUND));
}

// The system's error mode is the host's again after a library was refused.
TEST(SharedLibrary, LeavesTheErrorModeAlone) {
  const DWORD before = GetThreadErrorMode();
  EXPECT_FALSE(SharedLibrary("kestrel_absent_library.dll").Load());
  EXPECT_EQ(GetThreadErrorMode(), before);
}

}  // namespace
