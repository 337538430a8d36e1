#include "kestrel/foundation/CodePages.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>

#include "kestrel/foundation/MultibyteConversions.h"
#include "kestrel/foundation/MultibyteText.h"

namespace {

using namespace MCXML_800;

struct NameRow {
  long code_page;
  const char* opened_by;
  const char* standard;
  const char* why;
};

const NameRow kNameRows[] = {
    {932, "windows-31j", "Shift_JIS", "listed"},
    {936, "GBK", "GBK", "listed"},
    {949, "KS_C_5601-1987", "EUC-KR", "listed; the standard's name stands for fewer characters"},
    {950, "Big5", "Big5", "listed"},
    {1250, "cp1250", "windows-1250", "listed"},
    {1251, "cp1251", "windows-1251", "listed"},
    {1252, "cp1252", "windows-1252", "listed"},
    {1253, "cp1253", "windows-1253", "listed"},
    {1254, "cp1254", "windows-1254", "listed"},
    {1255, "cp1255", "windows-1255", "listed"},
    {1256, "cp1256", "windows-1256", "listed"},
    {1257, "cp1257", "windows-1257", "listed"},
    {1258, "cp1258", "windows-1258", "listed"},
    {28591, "ISO-8859-1", "ISO_8859-1:1987", "listed"},
    {65001, "UTF-8", "UTF-8", "listed"},
    {20866, "windows-20866", "KOI8-R", "by the first pattern"},
    {874, "windows-874", "windows-874", "by the first pattern, without a standard name"},
    {850, "windows-850", "IBM850", "by the first pattern"},
    {37, "cp037", "IBM037", "by the second pattern, with three digits at least"},
};

TEST(CodePages, HaveNames) {
  size_t listed = 0;
  for (const NameRow& row : kNameRows) {
    SCOPED_TRACE(std::to_string(row.code_page) + ": " + row.why);
    EXPECT_EQ(FindConverterName(row.code_page), row.opened_by);
    std::string name = "before";
    EXPECT_EQ(VEXAMBCodePageName(row.code_page, name), 0);
    EXPECT_EQ(name, row.standard);
    UConverter* const converter = VEXAMBConverterNewForCodePage(row.code_page);
    EXPECT_NE(converter, nullptr);
    VEXAMBConverterDelete(converter);
    for (const CodePage& entry : GetCodePages()) {
      if (entry.number != row.code_page) continue;
      EXPECT_STREQ(entry.converter, row.opened_by);
      ++listed;
    }
  }
  EXPECT_EQ(GetCodePages().count, 15u);
  EXPECT_EQ(listed, GetCodePages().count) << "every listed code page has a row here";
}

TEST(CodePages, UnknownNumbersHaveNone) {
  for (const long number : {0L, 1L, 1361L, 99999L, -1L, -37L, -1252L, LONG_MAX, LONG_MIN}) {
    SCOPED_TRACE(number);
    std::string name = "before";
    EXPECT_NE(VEXAMBCodePageName(number, name), 0);
    EXPECT_EQ(name, "");
    EXPECT_EQ(FindConverterName(number), "");
    EXPECT_EQ(VEXAMBConverterNewForCodePage(number), nullptr);
  }
}

/// Named by the standard alone, 949 would lose these.
TEST(CodePages, ConvertersKnowAllCharactersOfTheirCodePage) {
  UConverter* const converter = VEXAMBConverterNewForCodePage(949);
  std::u16string wide;
  EXPECT_EQ(VEXAMBGenericToU16(converter, "\x8C\x63\x81\x41", wide), kVEXAMBOk);
  EXPECT_EQ(wide, u"\xB620\xAC02");
  VEXAMBConverterDelete(converter);
}

}  // namespace
