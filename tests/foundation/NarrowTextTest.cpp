#include "kestrel/foundation/NarrowText.h"

#include <gtest/gtest.h>

#include <string>

namespace {

using namespace MCXML_800;

class NarrowText : public testing::Test {
 protected:
  void SetUp() override {
    before_ = qUTF8mode();
    SetUTF8mode(1);
  }
  void TearDown() override { SetUTF8mode(before_); }

 private:
  int before_ = 0;
};

struct Row {
  std::u16string wide;
  std::string narrow;
  const char* why;
};

const Row kBothWays[] = {
    {u"", "", "empty"},
    {u"a", "a", "one character"},
    {u"PetalLength1", "PetalLength1", "ASCII"},
    {std::u16string(1, u'\0') + u"a", std::string("\0a", 2), "a zero is a character"},
    {u"\u007F\u0080", "\x7F\xC2\x80", "the end of ASCII"},
    {u"Gr\u00F6\u00DFe",
     "Gr\xC3\xB6\xC3\x9F"
     "e",
     "two bytes"},
    {u"\u07FF\u0800", "\xDF\xBF\xE0\xA0\x80", "the end of two bytes"},
    {u"\uFFFF\U00010000", "\xEF\xBF\xBF\xF0\x90\x80\x80", "the end of three bytes"},
    {u"\U0001F600x\U0010FFFF", "\xF0\x9F\x98\x80x\xF4\x8F\xBF\xBF", "pairs"},
};

TEST_F(NarrowText, ThereAndBack) {
  for (const Row& row : kBothWays) {
    SCOPED_TRACE(row.why);
    EXPECT_EQ(Utf16ToNarrow(row.wide.data(), row.wide.size()), row.narrow);
    EXPECT_EQ(NarrowToUtf16(row.narrow), row.wide);
  }
}

const std::string kRep = "\xEF\xBF\xBD";

TEST_F(NarrowText, HalfPairsBecomeTheReplacementCharacter) {
  const Row rows[] = {
      {{0xD83D}, kRep, "first half alone"},
      {{0xDE00}, kRep, "second half alone"},
      {{u'a', 0xD83D, u'b'}, "a" + kRep + "b", "first half within"},
      {{0xDE00, 0xD83D}, kRep + kRep, "the wrong way round"},
      {{0xD83D, 0xD83D, 0xDE00}, kRep + "\xF0\x9F\x98\x80", "a half before a pair"},
      {{u'a', u'b', u'c', u'd', 0xD83D}, "abcd" + kRep, "behind a word of ASCII"},
  };
  for (const Row& row : rows) {
    SCOPED_TRACE(row.why);
    EXPECT_EQ(Utf16ToNarrow(row.wide.data(), row.wide.size()), row.narrow);
  }
}

TEST_F(NarrowText, MalformedBytesBecomeTheReplacementCharacter) {
  const Row rows[] = {
      {u"\uFFFD\uFFFD", "\xC0\x80", "overlong"},
      {u"a\uFFFD", "a\xE2\x82", "cut by the end"},
      {u"\uFFFDa",
       "\xE2\x82"
       "a",
       "cut by a character"},
      {u"\uFFFD\uFFFD\uFFFD", "\xED\xA0\x80", "a surrogate"},
      {u"abcdefgh\uFFFDz", "abcdefgh\xFFz", "behind a word of ASCII"},
  };
  for (const Row& row : rows) {
    SCOPED_TRACE(row.why);
    EXPECT_EQ(NarrowToUtf16(row.narrow), row.wide);
  }
}

/// The ASCII part is taken in words and in blocks: the first other character may stand at any place in them.
TEST_F(NarrowText, AsciiMayEndAnywhere) {
  for (size_t ascii = 0; ascii < 600; ascii < 40 ? ++ascii : ascii += 13) {
    for (const size_t after : {size_t{0}, size_t{1}, size_t{7}, size_t{300}}) {
      const std::u16string wide = std::u16string(ascii, u'x') + u"\u00E9" + std::u16string(after, u'y');
      const std::string narrow = std::string(ascii, 'x') + "\xC3\xA9" + std::string(after, 'y');
      ASSERT_EQ(Utf16ToNarrow(wide.data(), wide.size()), narrow) << ascii << " " << after;
      ASSERT_EQ(NarrowToUtf16(narrow), wide) << ascii << " " << after;
    }
    ASSERT_EQ(Utf16ToNarrow(std::u16string(ascii, u'x').data(), ascii), std::string(ascii, 'x'));
    ASSERT_EQ(NarrowToUtf16(std::string(ascii, 'x')), std::u16string(ascii, u'x'));
  }
}

/// Pairs may straddle the blocks in which the rest is taken.
TEST_F(NarrowText, LongTextsBeyondAscii) {
  for (size_t shift = 0; shift < 3; ++shift) {
    std::u16string wide(shift, u'\u00E9');
    std::string narrow;
    for (size_t i = 0; i < shift; ++i)
      narrow += "\xC3\xA9";
    for (int i = 0; i < 3000; ++i) {
      wide += u"\U0001F600";
      narrow += "\xF0\x9F\x98\x80";
    }
    EXPECT_TRUE(Utf16ToNarrow(wide.data(), wide.size()) == narrow) << shift;
    EXPECT_TRUE(NarrowToUtf16(narrow) == wide) << shift;
  }
}

TEST_F(NarrowText, AppendKeepsWhatIsThere) {
  std::string out = "before ";
  AppendUtf16AsNarrow(u"a\u00E9", 2, out);
  EXPECT_EQ(out, "before a\xC3\xA9");
  AppendUtf16AsNarrow(nullptr, 0, out);
  AppendUtf16AsNarrow(u"b", 1, out);
  EXPECT_EQ(out,
            "before a\xC3\xA9"
            "b");
  EXPECT_EQ(Utf16ToNarrow(nullptr, 0), "");
  EXPECT_EQ(NarrowToUtf16({}), u"");
}

TEST_F(NarrowText, TheFirstByteBeyondAsciiIsNone) {
  EXPECT_EQ(NarrowToUtf16("a\x80"), u"a\uFFFD");
  EXPECT_EQ(NarrowToUtf16("a\x7F"), u"a\u007F");
  EXPECT_EQ(Utf16ToNarrow(u"a\x80", 2), "a\xC2\x80");
}

}  // namespace
