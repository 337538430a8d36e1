// Documents are read into the process's code page until the host asks for UTF-8.

#ifndef NOMINMAX
#define NOMINMAX
#endif
#include <windows.h>
// windows.h goes first: the next headers need its types.
#include <gtest/gtest.h>

#include <string>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/Locale.h"
#include "tests/support/DictionaryText.h"

namespace {

const char kSize[] =
    "Gr\xC3\xB6\xC3\x9F"
    "e";

std::string SizeInCodePage() {
  char narrow[16] = {};
  WideCharToMultiByte(CP_ACP, 0, L"Gr\u00F6\u00DFe", -1, narrow, sizeof narrow, nullptr, nullptr);
  return narrow;
}

TEST(CodePageDocuments, GiveNamesInTheCodePageOrInUtf8) {
  const int before = MCXML_800::qUTF8mode();
  const std::string text = kestrel_test::DictionaryOf(
      1, "<DataField name=\"" + std::string(kSize) + "\" optype=\"continuous\" dataType=\"double\"/>");
  for (const int mode : {0, 1}) {
    MCXML_800::SetUTF8mode(mode);
    const auto dictionary = kestrel_test::ReadDictionary(text);
    EXPECT_NE(dictionary->GetVar(mode == 0 ? SizeInCodePage() : kSize), nullptr) << "mode " << mode;
    EXPECT_EQ(dictionary->GetVar(mode == 0 ? kSize : SizeInCodePage()), nullptr) << "mode " << mode;
  }
  MCXML_800::SetUTF8mode(before);
}

}  // namespace
