#include "kestrel/foundation/ExtNameStr.h"

#include <gtest/gtest.h>

#include <clocale>
#include <fstream>
#include <iterator>
#include <string>

#include "kestrel/foundation/Locale.h"
#include "kestrel/platform/Environment.h"
#include "tests/support/TempFolder.h"

namespace {

using namespace MCXML_800;
using kestrel_tests::TempFolder;

const std::string kName =
    "folder/Gr\xC3\xB6\xC3\x9F"
    "e \xF0\x9F\x98\x80.xml";

class ExtNameStrTest : public testing::Test {
 protected:
  void SetUp() override { before_ = qUTF8mode(); }
  void TearDown() override { SetUTF8mode(before_); }

 private:
  int before_ = 0;
};

TEST_F(ExtNameStrTest, GivesEveryForm) {
  SetUTF8mode(1);
  const ExtNameStr name(kName);
  EXPECT_FALSE(name.Empty());
  EXPECT_EQ(name.GetU8(), kName);
  EXPECT_STREQ(name.GetU8Z(), kName.c_str());
  EXPECT_STREQ(name.GetGenericZ(), kName.c_str());
  const VEXAMBU16String wide = name.GetU16();
  EXPECT_EQ(std::u16string(wide.begin(), wide.end()), u"folder/Gr\u00F6\u00DFe \U0001F600.xml");
  EXPECT_EQ(VEXAMBU16String(name.GetU16Z()), wide);
  EXPECT_EQ(name.ErrorCode(), kVEXAMBOk);
  EXPECT_EQ(ExtNameStr::FromU16(wide).GetU8(), kName);
  EXPECT_EQ(ExtNameStr::FromU16(std::u16string(wide.begin(), wide.end())).GetU8(), kName);
  EXPECT_EQ(ExtNameStr::FromGeneric(kName).GetU8(), kName);
  if (MCKestrel_800::NarrowTextIsUtf8ByDefault()) {
    EXPECT_EQ(name.GetSystem(), kName);
    EXPECT_STREQ(name.GetSystemZ(), kName.c_str());
    EXPECT_EQ(ExtNameStr::FromSystem(kName).GetU8(), kName);
  }
}

TEST_F(ExtNameStrTest, AsciiIsTheSameEverywhere) {
  for (const int mode : {0, 1}) {
    SetUTF8mode(mode);
    const ExtNameStr name("model.xml");
    EXPECT_EQ(name.GetCP(), "model.xml");
    EXPECT_STREQ(name.GetCPZ(), "model.xml");
    EXPECT_EQ(name.GetSystem(), "model.xml");
    EXPECT_STREQ(name.GetGenericZ(), "model.xml");
    EXPECT_EQ(ExtNameStr::FromCP("model.xml").GetU8(), "model.xml");
    EXPECT_EQ(ExtNameStr::FromSystem("model.xml").GetU8(), "model.xml");
    EXPECT_EQ(name.ErrorCode(), kVEXAMBOk);
  }
}

TEST_F(ExtNameStrTest, EmptyAndNull) {
  for (const ExtNameStr& name :
       {ExtNameStr(), ExtNameStr(static_cast<const char*>(nullptr)), ExtNameStr("")}) {
    EXPECT_TRUE(name.Empty());
    EXPECT_STREQ(name.GetU8Z(), "");
    EXPECT_STREQ(name.GetCPZ(), "");
    EXPECT_STREQ(name.GetSystemZ(), "");
    EXPECT_STREQ(name.GetGenericZ(), "");
    EXPECT_EQ(name.GetU16Z()[0], 0);
    EXPECT_EQ(name.ErrorCode(), kVEXAMBOk);
    std::ifstream in;
    EXPECT_FALSE(name.Open(in));
  }
}

TEST_F(ExtNameStrTest, ErrorCodeIsThatOfTheLastConversion) {
  const std::string locale = std::setlocale(LC_CTYPE, nullptr);
  std::setlocale(LC_CTYPE, "C");
  // Neither ASCII nor any code page of Windows has this character.
  const ExtNameStr name("a\xF0\x9F\x98\x80");
  EXPECT_EQ(name.ErrorCode(), kVEXAMBOk);
  EXPECT_EQ(name.GetCP().substr(0, 1), "a");
  EXPECT_EQ(name.ErrorCode(), kVEXAMBSubstituted);
  name.GetU8();
  EXPECT_EQ(name.ErrorCode(), kVEXAMBOk);
  SetUTF8mode(0);
  EXPECT_EQ(std::string(name.GetGenericZ()).substr(0, 1), "a");
  EXPECT_EQ(name.ErrorCode(), kVEXAMBSubstituted);
  name.GetU16();
  EXPECT_EQ(name.ErrorCode(), kVEXAMBOk);
  EXPECT_EQ(ExtNameStr::FromU16(std::u16string{0xD83D}).ErrorCode(), kVEXAMBSubstituted);
  const ExtNameStr malformed("a\xFF");
  malformed.GetU16Z();
  EXPECT_EQ(malformed.ErrorCode(), kVEXAMBSubstituted);
  std::setlocale(LC_CTYPE, locale.c_str());
}

TEST_F(ExtNameStrTest, ACopyHasItsOwnBuffers) {
  const ExtNameStr one("one");
  const char* const text = one.GetU8Z();
  ExtNameStr two(one);
  two = ExtNameStr("two");
  EXPECT_STREQ(text, "one");
  EXPECT_STREQ(two.GetSystemZ(), "two");
  ExtNameStr three(std::move(two));
  EXPECT_EQ(three.GetU8(), "two");
  three = one;
  EXPECT_EQ(three.GetSystem(), "one");
}

TEST_F(ExtNameStrTest, OpensFilesWithNamesInUtf8) {
  const TempFolder folder;
  for (const char* leaf : {"plain.xml",
                           "Gr\xC3\xB6\xC3\x9F"
                           "e.xml",
                           "\xE8\xA1\xA8 \xF0\x9F\x98\x80.xml"}) {
    SCOPED_TRACE(leaf);
    const ExtNameStr name(folder.Write(leaf, "a\r\nb"));
    for (const int mode : {0, 1}) {
      SetUTF8mode(mode);
      std::ifstream in;
      ASSERT_TRUE(name.Open(in));
      EXPECT_EQ(std::string(std::istreambuf_iterator<char>(in), {}), "a\r\nb") << "byte by byte";
      // A stream that has been read to its end may be used again.
      ASSERT_TRUE(name.Open(in));
      EXPECT_EQ(in.get(), 'a');
    }
  }
}

TEST_F(ExtNameStrTest, OpensNothingElse) {
  const TempFolder folder;
  const std::string path = folder.Write("there", "text");
  const std::string zero = path + '\0';
  for (const std::string& name : {path + "not", zero, zero + "more", std::string("\xFF\xFE")}) {
    std::ifstream in;
    EXPECT_FALSE(ExtNameStr(name).Open(in)) << name;
    EXPECT_FALSE(in.is_open());
    EXPECT_TRUE(in.fail());
  }
}

/// To Linux a name is bytes, and whatever they are, the file opens.
TEST_F(ExtNameStrTest, NamesThatAreNoUtf8ReachLinuxUnchanged) {
  if (!MCKestrel_800::NarrowTextIsUtf8ByDefault()) GTEST_SKIP() << "names are UTF-16 on this system";
  const TempFolder folder;
  const std::string path = (folder.GetPath() /
                            "Gr\xF6\xDF"
                            "e")
                               .u8string();
  std::ofstream(path) << "text";
  const ExtNameStr name(path);
  EXPECT_EQ(name.GetSystem(), path);
  std::ifstream in;
  EXPECT_TRUE(name.Open(in));
}

}  // namespace
