#include "kestrel/foundation/Locale.h"

#include <gtest/gtest.h>

#include <clocale>
#include <cstdlib>
#include <string>

#include "kestrel/foundation/CodePages.h"
#include "kestrel/foundation/MultibyteConversions.h"
#include "kestrel/foundation/MultibyteText.h"
#include "kestrel/foundation/NarrowText.h"
#include "kestrel/platform/Environment.h"

namespace {

using namespace MCXML_800;

std::string EnvironmentText(const char* name) {
  const char* const value = std::getenv(name);
  return value == nullptr ? "(unset)" : value;
}

struct LoadRow {
  const char* environment;  // LC_ALL when the process starts
  bool en_us_known;
  const char* locale;
  const char* afterwards;  // LC_ALL
};

const LoadRow kLoadRows[] = {
    {"C", false, "C", "en_US"},
    {"C", true, "en_US", "en_US"},
    {"POSIX", true, "en_US", "en_US"},
    {"no_SUCH", true, "en_US", "en_US"},
    {"C.UTF-8", true, "C.UTF-8", "C.UTF-8"},
    {"ja_JP.EUC-JP", true, "ja_JP.EUC-JP", "ja_JP.EUC-JP"},
};

/// What loading has done cannot be done again in the process: each row is a run of its own, whose environment
/// CMakeLists.txt sets.
TEST(Locale, LoadingSetsItOnce) {
  const char* const number = std::getenv("KESTREL_LOCALE_ROW");
  if (number == nullptr) GTEST_SKIP() << "the environment was not made for it";
  const LoadRow& row = kLoadRows[std::atoi(number)];
  SCOPED_TRACE(row.environment);
  EXPECT_STREQ(std::setlocale(LC_CTYPE, nullptr), row.locale);
  EXPECT_STREQ(std::setlocale(LC_NUMERIC, nullptr), row.locale) << "the whole locale";
  EXPECT_EQ(EnvironmentText("LC_ALL"), row.afterwards);
  std::setlocale(LC_ALL, "C");
  EnableLocale();
  EXPECT_STREQ(std::setlocale(LC_ALL, nullptr), "C") << "once is enough";
}

/// Sets the mode and the character locale back.
class Utf8Mode : public testing::Test {
 protected:
  void SetUp() override {
    mode_ = qUTF8mode();
    locale_ = std::setlocale(LC_CTYPE, nullptr);
  }
  void TearDown() override {
    std::setlocale(LC_CTYPE, locale_.c_str());
    SetUTF8mode(mode_);
  }

 private:
  int mode_ = 0;
  std::string locale_;
};

TEST_F(Utf8Mode, IsTheSystemsFromTheStart) {
  EXPECT_EQ(qUTF8mode(), MCKestrel_800::NarrowTextIsUtf8ByDefault() ? 1 : 0);
}

TEST_F(Utf8Mode, IsZeroOrOne) {
  SetUTF8mode(42);
  EXPECT_EQ(qUTF8mode(), 1);
  SetUTF8mode(0);
  EXPECT_EQ(qUTF8mode(), 0);
}

TEST_F(Utf8Mode, AChangeMakesANewDefaultConverter) {
  EXPECT_GE(VEXAMBDefaultConverterID(), 1);
  std::setlocale(LC_CTYPE, "C");
  SetUTF8mode(1);
  const int id = VEXAMBDefaultConverterID();
  SetUTF8mode(1);
  EXPECT_EQ(VEXAMBDefaultConverterID(), id) << "nothing has changed";
  SetUTF8mode(0);
  EXPECT_EQ(VEXAMBDefaultConverterID(), id + 1);
  SetUTF8mode(0);
  EXPECT_EQ(VEXAMBDefaultConverterID(), id + 1);
  SetUTF8mode(1);
  EXPECT_EQ(VEXAMBDefaultConverterID(), id + 2);
}

TEST_F(Utf8Mode, UTF8WhateverTheLocale) {
  SetUTF8mode(1);
  for (const char* locale : {"C", "C.UTF-8", "ja_JP.WINDOWS-31J", "en_US.ISO-8859-1", ".1252"}) {
    if (std::setlocale(LC_CTYPE, locale) == nullptr) continue;
    SCOPED_TRACE(locale);
    SetUTF8mode(1);
    EXPECT_EQ(Utf16ToNarrow(u"\u00E9", 1), "\xC3\xA9");
    EXPECT_EQ(NarrowToUtf16("\xC3\xA9"), u"\u00E9");
    EXPECT_EQ(VEXAMBU32Get_A(nullptr, "\xC3\xA9"), 0xE9u);
    std::string out;
    EXPECT_EQ(VEXAMBU16ToGeneric(std::u16string(u"\U0001F600"), out), kVEXAMBOk);
    EXPECT_EQ(out, "\xF0\x9F\x98\x80");
  }
}

struct CodePageRow {
  const char* locale;
  const char* narrow;
  std::u16string wide;
};

const CodePageRow kCodePageRows[] = {
    {"ja_JP.WINDOWS-31J", "a\x83\x5C\\\xB1", u"a\u30BD\\\uFF71"},
    {"ja_JP.EUC-JP", "a\x8F\xB0\xA1", u"a\u4E02"},
    {"zh_CN.GBK", "\xD6\xD0\x81\x5C", u"\u4E2D\u4E57"},
    {"en_US.ISO-8859-1",
     "Gr\xF6\xDF"
     "e",
     u"Gr\u00F6\u00DFe"},
    {"C.UTF-8", "Gr\xC3\xB6", u"Gr\u00F6"},
};

TEST_F(Utf8Mode, OffOnLinuxItIsTheLocalesCodePage) {
  if (MCKestrel_800::CodePageNumber() != 0) GTEST_SKIP() << "code pages are not the locale's on this system";
  for (const CodePageRow& row : kCodePageRows) {
    SCOPED_TRACE(row.locale);
    if (std::setlocale(LC_CTYPE, row.locale) == nullptr) continue;
    SetUTF8mode(0);
    EXPECT_EQ(Utf16ToNarrow(row.wide.data(), row.wide.size()), row.narrow);
    EXPECT_EQ(NarrowToUtf16(row.narrow), row.wide);
    std::string out;
    std::u16string wide;
    EXPECT_EQ(VEXAMBU16ToGeneric(row.wide, out), kVEXAMBOk);
    EXPECT_EQ(out, row.narrow);
    EXPECT_EQ(VEXAMBGenericToU16(row.narrow, wide), kVEXAMBOk);
    EXPECT_EQ(wide, row.wide);
    EXPECT_EQ(VEXAMBU32Get_A(nullptr, row.narrow), row.wide[0]);
    EXPECT_EQ(VEXAMBFindStarts_A(nullptr, row.narrow, std::string(row.narrow).size()).size(),
              row.wide.size());
  }
}

TEST_F(Utf8Mode, OffOnWindowsItIsTheProcessesCodePage) {
  const long number = MCKestrel_800::CodePageNumber();
  if (number == 0) GTEST_SKIP() << "code pages have no numbers on this system";
  SetUTF8mode(0);
  UConverter* const converter = VEXAMBConverterNewForCodePage(number);
  ASSERT_NE(converter, nullptr);
  for (const std::u16string& wide : {std::u16string(u"Gr\u00F6\u00DFe"), std::u16string(u"\u30BD")}) {
    std::string expected;
    VEXAMBU16ToGeneric(converter, wide, expected);
    EXPECT_EQ(Utf16ToNarrow(wide.data(), wide.size()), expected);
  }
  VEXAMBConverterDelete(converter);
}

/// ASCII is all that the C locale's code page has.
TEST_F(Utf8Mode, OffInTheCLocaleLosesNothingUnnoticed) {
  if (MCKestrel_800::CodePageNumber() != 0) GTEST_SKIP() << "code pages are not the locale's on this system";
  std::setlocale(LC_CTYPE, "C");
  SetUTF8mode(0);
  std::string out;
  EXPECT_EQ(VEXAMBU16ToGeneric(std::u16string(u"a\u00E9"
                                              u"b"),
                               out),
            kVEXAMBSubstituted);
  EXPECT_EQ(out,
            "a\x1A"
            "b");
  EXPECT_EQ(Utf16ToNarrow(u"a\u00E9"
                          u"b",
                          3),
            "a\x1A"
            "b");
  EXPECT_EQ(NarrowToUtf16("a\xE9"
                          "b"),
            u"a\uFFFDb");
}

}  // namespace
