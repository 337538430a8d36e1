#include "kestrel/foundation/PliantTranscoder.h"

#include <gtest/gtest.h>

#include <string>
#include <xercesc/util/PlatformUtils.hpp>
#include <xercesc/util/XMLString.hpp>

#include "kestrel/foundation/MultibyteConversions.h"
#include "kestrel/foundation/MultibyteText.h"

namespace {

using namespace MCXML_800;

class PliantTranscoderTest : public testing::Test {
 protected:
  // Not undone: others may use the parser library in this process, too.
  static void SetUpTestSuite() { xercesc::XMLPlatformUtils::Initialize(); }
};

std::u16string Decode(const PliantTranscoder& transcoder, const std::string& text) {
  XMLCh* made = transcoder.ChangeChar2XML(text.data(), text.size());
  if (made == nullptr) return u"(null)";
  const std::u16string result(reinterpret_cast<const char16_t*>(made));
  xercesc::XMLString::release(&made);
  return result;
}

std::string Encode(const PliantTranscoder& transcoder, const std::u16string& text) {
  std::string out = "before";
  if (!transcoder.transcodeTo(reinterpret_cast<const XMLCh*>(text.data()), text.size(), out))
    return "(refused)";
  return out;
}

struct EncodingRow {
  const char* encoding;
  std::string bytes;
  std::u16string text;
};

const EncodingRow kEncodings[] = {
    {"UTF-8", "a\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80", u"a\u00E9\u20AC\U0001F600"},
    {"CP1252",
     "Gr\xF6\xDF"
     "e \x80",
     u"Gr\u00F6\u00DFe \u20AC"},
    {"windows-1252",
     "Gr\xF6\xDF"
     "e \x80",
     u"Gr\u00F6\u00DFe \u20AC"},
    {"ISO-8859-1", "\xE9\xFF", u"\u00E9\u00FF"},
    {"US-ASCII", "abc", u"abc"},
    {"Shift_JIS", "\x83\x5C\x95\x5C\xB1z", u"\u30BD\u8868\uFF71z"},
    {"GBK", "\xD6\xD0\x81\x5C", u"\u4E2D\u4E57"},
    {"Big5",
     "\xA5\x5C"
     "a",
     u"\u529Fa"},
    {"EUC-KR", "\xC7\xD1", u"\uD55C"},
    {"EUC-JP", "\x8F\xB0\xA1\xA4\xA2", u"\u4E02\u3042"},
    {"GB18030",
     "\xD6\xD0\x90\x30\x81\x30"
     "a",
     u"\u4E2D\U00010000a"},
    {"KOI8-R", "\xC1\xC2", u"\u0430\u0431"},
    {"UTF-16LE", std::string("a\0\x3D\xD8\x00\xDE", 6), u"a\U0001F600"},
    {"UTF-16BE", std::string("\0a\xD8\x3D\xDE\x00", 6), u"a\U0001F600"},
};

TEST_F(PliantTranscoderTest, ThereAndBack) {
  for (const EncodingRow& row : kEncodings) {
    SCOPED_TRACE(row.encoding);
    const PliantTranscoder transcoder(row.encoding);
    ASSERT_TRUE(transcoder.IsValid());
    EXPECT_EQ(Decode(transcoder, row.bytes), row.text);
    EXPECT_EQ(Encode(transcoder, row.text), row.bytes);
  }
}

/// Texts of more than a block, with characters across every block's end.
TEST_F(PliantTranscoderTest, TextsOfAnyLength) {
  for (const EncodingRow& row : kEncodings) {
    const PliantTranscoder transcoder(row.encoding);
    const size_t letter = std::string(row.encoding).compare(0, 6, "UTF-16") == 0 ? 2 : 1;
    for (size_t shift = 0; shift < 4; ++shift) {
      SCOPED_TRACE(std::string(row.encoding) + " after " + std::to_string(shift));
      std::string bytes;
      std::u16string text;
      for (size_t i = 0; i < shift; ++i) {
        text += u'x';
        bytes += letter == 1 ? "x" : row.encoding[6] == 'L' ? std::string("x\0", 2) : std::string("\0x", 2);
      }
      while (text.size() < 20000) {
        bytes += row.bytes;
        text += row.text;
      }
      EXPECT_TRUE(Decode(transcoder, bytes) == text);
      EXPECT_TRUE(Encode(transcoder, text) == bytes);
    }
  }
}

TEST_F(PliantTranscoderTest, LengthsAroundTheBlockSize) {
  const PliantTranscoder transcoder("UTF-8");
  for (const size_t length : {1022u, 1023u, 1024u, 1025u, 4079u, 4080u, 4081u, 4095u, 4096u, 4097u, 8192u}) {
    std::u16string text(length, u'a');
    std::string bytes(length, 'a');
    EXPECT_TRUE(Encode(transcoder, text) == bytes) << length;
    EXPECT_TRUE(Decode(transcoder, bytes) == text) << length;
    text += u"\u20AC";
    bytes += "\xE2\x82\xAC";
    EXPECT_TRUE(Encode(transcoder, text) == bytes) << length;
    EXPECT_TRUE(Decode(transcoder, bytes) == text) << length;
  }
}

TEST_F(PliantTranscoderTest, UnknownEncodingsRefuse) {
  const char* const names[] = {"no-such-encoding", "", nullptr, "ISO-2022-JP", "HZ", "UTF-7", "SCSU"};
  for (const char* name : names) {
    SCOPED_TRACE(name == nullptr ? "null" : name);
    const PliantTranscoder transcoder(name);
    EXPECT_FALSE(transcoder.IsValid());
    std::string out = "before";
    EXPECT_FALSE(transcoder.transcodeTo(reinterpret_cast<const XMLCh*>(u"a"), out));
    EXPECT_EQ(out, "");
    EXPECT_EQ(transcoder.ChangeChar2XML("a"), nullptr);
  }
}

TEST_F(PliantTranscoderTest, NullAndEmptyTexts) {
  const PliantTranscoder transcoder(std::string("CP1252"));
  std::string out = "before";
  EXPECT_TRUE(transcoder.transcodeTo(nullptr, out));
  EXPECT_EQ(out, "");
  out = "before";
  EXPECT_TRUE(transcoder.transcodeTo(reinterpret_cast<const XMLCh*>(u""), out));
  EXPECT_EQ(out, "");
  EXPECT_EQ(transcoder.ChangeChar2XML(nullptr), nullptr);
  EXPECT_EQ(Decode(transcoder, ""), u"");
}

TEST_F(PliantTranscoderTest, ZerosInsideATextAreKept) {
  const PliantTranscoder transcoder("CP1252");
  EXPECT_EQ(Encode(transcoder, std::u16string(u"a\0b", 3)), std::string("a\0b", 3));
  XMLCh* made = transcoder.ChangeChar2XML("a\0b", 3);
  EXPECT_EQ(std::u16string(reinterpret_cast<const char16_t*>(made), 4), std::u16string(u"a\0b\0", 4));
  xercesc::XMLString::release(&made);
}

struct MalformedRow {
  const char* encoding;
  std::string bytes;
  std::u16string text;
  const char* why;
};

const MalformedRow kMalformed[] = {
    {"UTF-8", "a\xC3(", u"a\uFFFD(", "no trail byte"},
    {"UTF-8", "a\xE2\x82", u"a\uFFFD", "cut by the end"},
    {"UTF-8", "\xC0\x80z", u"\uFFFD\uFFFDz", "overlong"},
    {"UTF-8", "\xED\xA0\x80", u"\uFFFD\uFFFD\uFFFD", "a surrogate"},
    {"US-ASCII",
     "a\xE9"
     "b",
     u"a\uFFFD"
     u"b",
     "beyond ASCII"},
    {"Shift_JIS", "\x83\x83\x83", u"\u30E3\uFFFD", "a lead byte at the end"},
    {"Shift_JIS", "\x81 a", u"\uFFFD a", "a lead byte before a blank"},
    {"EUC-JP", "\x8F\xB0", u"\uFFFD", "two of three bytes"},
    {"GB18030", "\x90\x30\x81", u"\uFFFD0\uFFFD", "three of four bytes"},
    {"UTF-16LE", std::string("a\0b", 3), u"a\uFFFD", "half a unit"},
};

TEST_F(PliantTranscoderTest, MalformedBytesBecomeTheReplacementCharacter) {
  for (const MalformedRow& row : kMalformed) {
    SCOPED_TRACE(std::string(row.encoding) + ": " + row.why);
    const PliantTranscoder transcoder(row.encoding);
    EXPECT_EQ(Decode(transcoder, row.bytes), row.text);
    // Nothing of it is left for the next text.
    for (const EncodingRow& good : kEncodings) {
      if (std::string(good.encoding) == row.encoding) {
        EXPECT_EQ(Decode(transcoder, good.bytes), good.text);
      }
    }
  }
}

TEST_F(PliantTranscoderTest, ASubstituteThatIsInTheTextStays) {
  EXPECT_EQ(Decode(PliantTranscoder("KOI8-R"), "a\x1A"), u"a\x1A");
  EXPECT_EQ(Decode(PliantTranscoder("UTF-8"), "a\x1A"), u"a\x1A");
}

TEST_F(PliantTranscoderTest, WhatTheEncodingLacksIsSubstituted) {
  const PliantTranscoder latin("ISO-8859-1"), utf8("UTF-8"), japanese("Shift_JIS");
  EXPECT_EQ(Encode(utf8, {0xD83D, u'a'}),
            "\xEF\xBF\xBD"
            "a");
  EXPECT_EQ(Encode(utf8, {u'a', 0xD83D}), "a\xEF\xBF\xBD");
  EXPECT_EQ(Encode(utf8, {0xDE00}), "\xEF\xBF\xBD");
  for (const std::u16string& text : {std::u16string(u"a\u4E2Db"), std::u16string{u'a', 0xD83D, u'b'}}) {
    const std::string out = Encode(latin, text);
    EXPECT_EQ(out.size(), 3u);
    EXPECT_EQ(out.front(), 'a');
    EXPECT_EQ(out.back(), 'b');
  }
  EXPECT_EQ(Encode(japanese, {u'a', 0xD83D}).substr(0, 1), "a");
  EXPECT_EQ(Encode(japanese, u"b"), "b") << "nothing is left of the half pair";
}

}  // namespace
