#include "kestrel/foundation/PliantString.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>
#include <xercesc/util/XMLString.hpp>

#include "kestrel/foundation/Locale.h"

namespace {

using MCXML_800::PliantString;

class PliantStringTest : public testing::Test {
 protected:
  void SetUp() override {
    before_ = MCXML_800::qUTF8mode();
    MCXML_800::SetUTF8mode(1);
  }
  void TearDown() override { MCXML_800::SetUTF8mode(before_); }

 private:
  int before_ = 0;
};

const char* const kNullNarrow = nullptr;
const char16_t* const kNullWide = nullptr;

TEST_F(PliantStringTest, ComesFromEveryForm) {
  const PliantString expected(u"a\u00E9\U0001F600");
  const std::string narrow = "a\xC3\xA9\xF0\x9F\x98\x80";
  EXPECT_EQ(PliantString(narrow), expected);
  EXPECT_EQ(PliantString(narrow.c_str()), expected);
  EXPECT_EQ(PliantString(std::u16string(u"a\u00E9\U0001F600")), expected);
  PliantString text;
  EXPECT_TRUE(text.empty());
  EXPECT_EQ(text.assign(narrow), expected);
  EXPECT_EQ(text.assign(narrow.c_str()), expected);
  EXPECT_EQ(text.assign(narrow.data(), 3), PliantString(u"a\u00E9"));
  EXPECT_EQ(text.assign(expected), expected);
  EXPECT_EQ(text.assign(expected, 1), PliantString(u"\u00E9\U0001F600"));
  EXPECT_EQ(text.assign(expected, 0, 2), PliantString(u"a\u00E9"));
  EXPECT_EQ(text.assign(expected, 9), PliantString());
  EXPECT_EQ(text.assign(u"wide"), PliantString("wide"));
  EXPECT_EQ(text.assign(u"wide", 2), PliantString("wi"));
  EXPECT_EQ(text.assign(std::u16string(u"w")), PliantString("w"));
  EXPECT_EQ(text.assignUTF8(narrow), expected);
  EXPECT_EQ(text.assignUTF8(narrow.c_str()), expected);
  EXPECT_EQ(text.assignUTF8(narrow.data(), 1), PliantString("a"));
  EXPECT_EQ(text = narrow, expected);
  EXPECT_EQ(text = narrow.c_str(), expected);
  EXPECT_EQ(text = u"w", PliantString("w"));
  EXPECT_EQ(text = std::u16string(u"w"), PliantString("w"));
  EXPECT_EQ(text = expected, expected);
}

TEST_F(PliantStringTest, GivesEveryForm) {
  const PliantString text(u"a\u00E9\U0001F600");
  EXPECT_EQ(text.toUTF8(), "a\xC3\xA9\xF0\x9F\x98\x80");
  EXPECT_EQ(text.toGeneric(), "a\xC3\xA9\xF0\x9F\x98\x80");
  EXPECT_EQ(text.length(), 4u) << "the last character has two units";
  const XMLCh* const wide = text.xc_str();
  EXPECT_EQ(xercesc::XMLString::stringLen(wide), 4u);
  EXPECT_EQ(std::u16string(text.xc_str()), u"a\u00E9\U0001F600");
  EXPECT_EQ(PliantString().xc_str()[0], 0);
}

TEST_F(PliantStringTest, NullTextsAreEmpty) {
  PliantString text("before");
  EXPECT_TRUE(PliantString(kNullNarrow).empty());
  EXPECT_TRUE(PliantString(kNullWide).empty());
  EXPECT_TRUE(text.assign(kNullNarrow).empty());
  EXPECT_TRUE(text.assign(kNullNarrow, 3).empty());
  EXPECT_TRUE(text.assign(kNullWide).empty());
  EXPECT_TRUE(text.assign(kNullWide, 3).empty());
  EXPECT_TRUE(text.assignUTF8(kNullNarrow).empty());
  EXPECT_TRUE(text.append(kNullNarrow).append(kNullWide).append(kNullWide, 2).append(kNullNarrow, 2).empty());
  EXPECT_TRUE(text.equals(kNullNarrow));
  EXPECT_TRUE(text.equals(kNullWide));
}

TEST_F(PliantStringTest, MalformedBytesAreReplaced) {
  EXPECT_EQ(PliantString("a\xFF"), PliantString(u"a\uFFFD"));
  EXPECT_EQ(PliantString().assignUTF8("\xE2\x82"), PliantString(u"\uFFFD"));
  EXPECT_EQ(PliantString(std::u16string{0xD83D}).toUTF8(), "\xEF\xBF\xBD");
}

TEST_F(PliantStringTest, ZerosInsideAreKept) {
  const std::string zero("a\0b", 3);
  EXPECT_EQ(PliantString(zero).length(), 3u);
  EXPECT_EQ(PliantString(zero).toUTF8(), zero);
  EXPECT_EQ(PliantString("x").append(zero).append(u"\0", 1).length(), 5u);
  EXPECT_EQ(PliantString().assignUTF8(zero).toGeneric(), zero);
}

TEST_F(PliantStringTest, Appends) {
  PliantString text("a");
  text.append("b")
      .append("cde", 1)
      .append(std::string("d"))
      .append(u"e")
      .append(u"fgh", 1)
      .append(std::u16string(u"g"));
  text.append(PliantString("h"))
      .append(PliantString("hij"), 1)
      .append(PliantString("xkx"), 1, 1)
      .append(2, u'!');
  EXPECT_EQ(text.toUTF8(), "abcdefghijk!!");
  text.append(PliantString("abc"), 7);
  text += "?";
  EXPECT_EQ(text.toUTF8(), "abcdefghijk!!?");
  text.clear();
  EXPECT_TRUE(text.empty());
}

TEST_F(PliantStringTest, ItsOwnPartsMayBeGiven) {
  PliantString text("abc");
  text.append(text);
  EXPECT_EQ(text, "abcabc");
  text.append(text, 1, 2);
  EXPECT_EQ(text, "abcabcbc");
  text.append(text.xc_str() + 6);
  EXPECT_EQ(text, "abcabcbcbc");
  text.assign(text, 3, 3);
  EXPECT_EQ(text, "abc");
  text.assign(text.xc_str() + 1);
  EXPECT_EQ(text, "bc");
  PliantString& same = text;
  text = same;
  EXPECT_EQ(text, "bc");
  EXPECT_EQ(text.replaceSubstring(text, text), 1u);
  EXPECT_EQ(text, "bc");
}

TEST_F(PliantStringTest, CopiesAndMoves) {
  PliantString one("one");
  PliantString two(one);
  two.append("!");
  EXPECT_EQ(one, "one");
  const PliantString three(std::move(two));
  EXPECT_EQ(three, "one!");
  one = PliantString("x");
  EXPECT_EQ(one, "x");
}

struct OrderRow {
  std::u16string left;
  std::u16string right;
  const char* why;
};

/// The left comes before the right.
const OrderRow kOrder[] = {
    {u"", u"a", "empty first"},
    {u"a", u"b", "by unit"},
    {u"a", u"ab", "the shorter first"},
    {u"Z", u"a", "capitals first"},
    {u"z", u"\u00E9", "beyond ASCII"},
    {u"\uFFFF", u"\U00010000", "pairs stand for the highest code points"},
    {u"\U00010000", u"\U00010001", "the second half decides"},
    {u"\U0001F600", u"\U0010FFFF", "the first half decides"},
};

TEST_F(PliantStringTest, OrdersByCodePoint) {
  for (const OrderRow& row : kOrder) {
    SCOPED_TRACE(row.why);
    const PliantString left(row.left), right(row.right);
    EXPECT_LT(left.compare(right), 0);
    EXPECT_GT(right.compare(left), 0);
    EXPECT_EQ(left.compare(left), 0);
    EXPECT_TRUE(left < right && left <= right && left != right && !(left == right));
    EXPECT_TRUE(right > left && right >= left && !(right < left) && !(right <= left));
    EXPECT_TRUE(left <= left && left >= left && left == left);
    EXPECT_LT(left.toUTF8().compare(right.toUTF8()), 0) << "as the bytes in UTF-8";
  }
}

TEST_F(PliantStringTest, EqualsEveryForm) {
  const PliantString text(u"\u00E9");
  EXPECT_TRUE(text.equals(PliantString("\xC3\xA9")));
  EXPECT_TRUE(text.equals("\xC3\xA9"));
  EXPECT_TRUE(text.equals(u"\u00E9"));
  EXPECT_FALSE(text.equals("e"));
  EXPECT_FALSE(text.equals(u"\u00E9x"));
  EXPECT_TRUE(text == "\xC3\xA9");
  EXPECT_TRUE("\xC3\xA9" == text);
  EXPECT_TRUE(text != u"e");
}

struct IntegerRow {
  const char* text;
  bool reads;
  int value;
};

const IntegerRow kIntegers[] = {
    {"0", true, 0},
    {"42", true, 42},
    {"-42", true, -42},
    {"+42", true, 42},
    {"007", true, 7},
    {" \t42\r\n", true, 42},
    {"2147483647", true, INT_MAX},
    {"-2147483648", true, INT_MIN},
    {"2147483648", false, 0},
    {"-2147483649", false, 0},
    {"99999999999999999999", false, 0},
    {"", false, 0},
    {" ", false, 0},
    {"+", false, 0},
    {"-", false, 0},
    {"+-1", false, 0},
    {"--1", false, 0},
    {"++1", false, 0},
    {"1.5", false, 0},
    {"1e3", false, 0},
    {"0x10", false, 0},
    {"4 2", false, 0},
    {"- 1", false, 0},
    {"\xD9\xA1", false, 0},
    {"1\xC2\xA0", false, 0},
};

TEST_F(PliantStringTest, ConvertsToInteger) {
  for (const IntegerRow& row : kIntegers) {
    int value = 77;
    EXPECT_EQ(PliantString(row.text).convertToInteger(value), row.reads) << row.text;
    EXPECT_EQ(value, row.reads ? row.value : 77) << row.text;
  }
}

TEST_F(PliantStringTest, TruncatesBetweenCharacters) {
  const struct {
    size_t length;
    std::u16string result;
  } rows[] = {
      {0, u""}, {1, u"a"}, {2, u"a"}, {3, u"a\U0001F600"}, {4, u"a\U0001F600b"}, {99, u"a\U0001F600b"}};
  for (const auto& row : rows) {
    PliantString text(u"a\U0001F600b");
    EXPECT_EQ(text.truncateString(row.length), PliantString(row.result)) << row.length;
  }
  PliantString half(std::u16string{u'a', 0xDE00, 0xDE00});
  EXPECT_EQ(half.truncateString(2).length(), 2u) << "a half without its first stands alone";
}

struct ReplaceRow {
  const char* text;
  const char* from;
  const char* to;
  size_t count;
  const char* result;
};

const ReplaceRow kReplace[] = {
    {"a.b.c", ".", "::", 2, "a::b::c"},
    {"aaa", "a", "", 3, ""},
    {"aaa", "aa", "b", 1, "ba"},
    {"abc", "x", "y", 0, "abc"},
    {"abc", "", "y", 0, "abc"},
    {"", "a", "b", 0, ""},
    {"abab", "ab", "abab", 2, "abababab"},
    {"aab", "ab", "x", 1, "ax"},
    {"aabaabaaab", "aabaaa", "-", 1, "aab-b"},
    {"\xC3\xA9\xC3\xA8", "\xC3\xA8", "e", 1,
     "\xC3\xA9"
     "e"},
};

TEST_F(PliantStringTest, ReplacesSubstrings) {
  for (const ReplaceRow& row : kReplace) {
    SCOPED_TRACE(std::string(row.text) + " " + row.from);
    PliantString text(row.text);
    EXPECT_EQ(text.ContainsString(row.from), row.count > 0 || *row.from == 0);
    EXPECT_EQ(text.replaceSubstring(row.from, row.to), row.count);
    EXPECT_EQ(text.toUTF8(), row.result);
  }
}

/// A search that starts over at every place would take the product of the lengths here: minutes.
TEST_F(PliantStringTest, FindsWhatAPlainSearchFinds) {
  const auto text = [](unsigned bits, size_t length) {
    std::u16string made;
    for (size_t i = 0; i < length; ++i)
      made += (bits >> i) % 2 == 0 ? u'a' : u'b';
    return made;
  };
  for (size_t partLength = 1; partLength <= 6; ++partLength) {
    for (unsigned part = 0; part < 1u << partLength; ++part) {
      const std::u16string searched = text(part, partLength);
      const PliantString asPliant(searched);
      for (unsigned whole = 0; whole < 1u << 10; ++whole) {
        const std::u16string in = text(whole, 10);
        ASSERT_EQ(PliantString(in).ContainsString(asPliant), in.find(searched) != std::u16string::npos)
            << part << " of " << partLength << " in " << whole;
      }
    }
  }
}

TEST_F(PliantStringTest, RepeatedTextsAreSearchedInTheirLength) {
  const PliantString part(std::u16string(100000, u'a') + u"b");
  PliantString text(std::u16string(1000000, u'a'));
  EXPECT_FALSE(text.ContainsString(part));
  text.append("b");
  EXPECT_TRUE(text.ContainsString(part));
  EXPECT_EQ(text.replaceSubstring(part, ""), 1u);
  EXPECT_EQ(text.length(), 900000u);
}

}  // namespace
