// Narrow text is in the process's code page until the host asks for UTF-8.

#ifndef NOMINMAX
#define NOMINMAX
#endif
#include <windows.h>
// windows.h goes first: the next headers need its types.
#include <gtest/gtest.h>

#include <clocale>
#include <string>

#include "kestrel/foundation/ExtNameStr.h"
#include "kestrel/foundation/Locale.h"
#include "kestrel/foundation/MultibyteConversions.h"
#include "kestrel/platform/Environment.h"

namespace {

using namespace MCXML_800;

std::string InCodePage(const std::u16string& text) {
  char narrow[64] = {};
  const int size =
      WideCharToMultiByte(CP_ACP, 0, reinterpret_cast<const wchar_t*>(text.data()),
                          static_cast<int>(text.size()), narrow, sizeof narrow, nullptr, nullptr);
  return std::string(narrow, static_cast<size_t>(size));
}

TEST(WindowsText, IsInTheCodePageByItself) {
  ASSERT_EQ(qUTF8mode(), 0);
  EXPECT_EQ(MCKestrel_800::CodePageNumber(), static_cast<long>(GetACP()));
  const std::u16string wide = u"Z\u00FCrich 20\u00B0";
  std::string narrow;
  EXPECT_EQ(VEXAMBU16ToGeneric(wide, narrow), kVEXAMBOk);
  EXPECT_EQ(narrow, InCodePage(wide));
  std::u16string back;
  EXPECT_EQ(VEXAMBGenericToU16(narrow, back), kVEXAMBOk);
  EXPECT_EQ(back, wide);
  std::string utf8;
  EXPECT_EQ(VEXAMBGenericToU8(narrow, utf8), kVEXAMBOk);
  EXPECT_EQ(utf8, "Z\xC3\xBCrich 20\xC2\xB0");
}

TEST(WindowsText, OfFileNamesIsGivenInBoth) {
  const ExtNameStr name("\xC3\xA4.xml");
  EXPECT_EQ(std::string(name.GetU8Z()), "\xC3\xA4.xml");
  EXPECT_EQ(std::string(name.GetCPZ()), InCodePage(u"\u00E4.xml"));
  EXPECT_EQ(std::string(name.GetGenericZ()), InCodePage(u"\u00E4.xml"));
}

TEST(WindowsText, LoadingTakesTheUsersLocale) {
  EXPECT_STRNE(std::setlocale(LC_CTYPE, nullptr), "C");
}

}  // namespace
