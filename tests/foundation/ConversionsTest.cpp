#include "kestrel/foundation/MultibyteConversions.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "kestrel/foundation/CodePages.h"
#include "kestrel/foundation/Locale.h"
#include "kestrel/foundation/MultibyteText.h"

namespace {

using namespace MCXML_800;

struct DeleteConverter {
  void operator()(UConverter* converter) const { VEXAMBConverterDelete(converter); }
};
using Converter = std::unique_ptr<UConverter, DeleteConverter>;

Converter Open(long codePage) {
  return Converter(VEXAMBConverterNewForCodePage(codePage));
}

/// Generic text is UTF-8 for as long as it lives, on every system.
class Conversions : public testing::Test {
 protected:
  void SetUp() override {
    before_ = qUTF8mode();
    SetUTF8mode(1);
  }
  void TearDown() override { SetUTF8mode(before_); }

 private:
  int before_ = 0;
};

struct SampleRow {
  long code_page;
  const char* bytes;
  const char16_t* text;
};

const SampleRow kSamples[] = {
    {932, "\x83\x5C\x95\x5C\x8F\x5C\x94\x5C\x5C\x20\xB1\x89\xD4", u"\u30bd\u8868\u5341\u80fd\\ \uff71\u82b1"},
    {936, "\xD6\xD0\xCE\xC4\x81\x40\xC9\xCF\x81\x5C", u"\u4e2d\u6587\u4e02\u4e0a\u4e57"},
    {949, "\xC7\xD1\xB1\xDB\x20\x8C\x63\x81\x41", u"\ud55c\uae00 \ub620\uac02"},
    {950, "\xA5\x5C\xB3\x5C\xA4\xA4", u"\u529f\u8a31\u4e2d"},
    {1250, "P\xF8\xEDli\x9A \x9Elu\x9Dou\xE8k\xFD", u"P\u0159\u00edli\u0161 \u017elu\u0165ou\u010dk\u00fd"},
    {1251, "\xD1\xFA\xE5\xF8\xFC \xE5\xF9\xB8", u"\u0421\u044a\u0435\u0448\u044c \u0435\u0449\u0451"},
    {1252,
     "Gr\xF6\xDF"
     "e 12 \x80",
     u"Gr\u00f6\u00dfe 12 \u20ac"},
    {1253, "\xCE\xE5\xF3\xEA\xE5\xF0\xDC\xE6\xF9", u"\u039e\u03b5\u03c3\u03ba\u03b5\u03c0\u03ac\u03b6\u03c9"},
    {1254, "\xDEi\xFEli \xF0\xFD", u"\u015ei\u015fli \u011f\u0131"},
    {1255, "\xF9\xEC\xE5\xED", u"\u05e9\u05dc\u05d5\u05dd"},
    {1256, "\xE3\xD1\xCD\xC8\xC7", u"\u0645\u0631\u062d\u0628\u0627"},
    {1257, "\xC0\xFEuolas", u"\u0104\u017euolas"},
    {1258, "\xD0\xE3ng \xF5\xFD \xFE", u"\u0110\u0103ng \u01a1\u01b0 \u20ab"},
    {28591,
     "Gr\xF6\xDF"
     "e \xFF",
     u"Gr\u00f6\u00dfe \u00ff"},
    {65001, "\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80", u"\u00e9\u20ac\U0001f600"},
};

TEST_F(Conversions, EveryCodePageThereAndBack) {
  EXPECT_EQ(std::size(kSamples), GetCodePages().count);
  for (const SampleRow& row : kSamples) {
    SCOPED_TRACE(row.code_page);
    const Converter converter = Open(row.code_page);
    ASSERT_NE(converter, nullptr);
    std::u16string wide;
    std::string narrow, utf8, back;
    EXPECT_EQ(VEXAMBGenericToU16(converter.get(), row.bytes, wide), kVEXAMBOk);
    EXPECT_EQ(wide, row.text);
    EXPECT_EQ(VEXAMBU16ToGeneric(converter.get(), wide, narrow), kVEXAMBOk);
    EXPECT_EQ(narrow, row.bytes);

    VEXAMBU16String units;
    EXPECT_EQ(VEXAMBGenericToU16(converter.get(), row.bytes, units), kVEXAMBOk);
    EXPECT_EQ(std::u16string(units.begin(), units.end()), row.text);
    EXPECT_EQ(VEXAMBU16ToGeneric(converter.get(), units, narrow), kVEXAMBOk);
    EXPECT_EQ(narrow, row.bytes);

    EXPECT_EQ(VEXAMBGenericToU8(converter.get(), row.bytes, utf8), kVEXAMBOk);
    EXPECT_EQ(VEXAMBU8ToGeneric(converter.get(), utf8, back), kVEXAMBOk);
    EXPECT_EQ(back, row.bytes);
    EXPECT_EQ(VEXAMBU8ToCodePage(converter.get(), utf8, back), kVEXAMBOk);
    EXPECT_EQ(back, row.bytes);

    // The generic side is UTF-8 here, so this is the same text.
    std::string generic;
    EXPECT_EQ(VEXAMBCodePageToGeneric(converter.get(), row.bytes, generic), kVEXAMBOk);
    EXPECT_EQ(generic, utf8);
    EXPECT_EQ(VEXAMBGenericToCodePage(converter.get(), generic, back), kVEXAMBOk);
    EXPECT_EQ(back, row.bytes);
  }
}

/// A code page may write a character in two ways, so the bytes need not come back, but the text must.
TEST_F(Conversions, EveryCharacterOfEveryCodePageComesBack) {
  for (const CodePage& entry : GetCodePages()) {
    SCOPED_TRACE(entry.number);
    const Converter converter = Open(entry.number);
    int clean = 0;
    for (int first = 0; first < 256; ++first) {
      for (int second = 0; second < 256; ++second) {
        const std::string bytes{static_cast<char>(first), static_cast<char>(second)};
        std::u16string text, again;
        if (VEXAMBGenericToU16(converter.get(), bytes, text) != kVEXAMBOk) continue;
        ++clean;
        std::string back;
        ASSERT_EQ(VEXAMBU16ToGeneric(converter.get(), text, back), kVEXAMBOk) << first << " " << second;
        VEXAMBGenericToU16(converter.get(), back, again);
        ASSERT_EQ(again, text) << first << " " << second;
      }
    }
    EXPECT_GT(clean, 128 * 128);
  }
}

struct ReplaceRow {
  long from;  // 16: UTF-16
  long to;
  std::u16string wide;
  std::string narrow;
  std::string result;
  const char* why;
};

constexpr long k16 = 16;

std::string Rep(int count) {
  std::string text;
  for (int i = 0; i < count; ++i)
    text += "\xEF\xBF\xBD";
  return text;
}

const ReplaceRow kReplaceRows[] = {
    {k16, 65001, {0xD83D}, "", Rep(1), "half a pair at the end"},
    {k16, 65001, {0xDE00, u'a'}, "", Rep(1) + "a", "the second half alone"},
    {k16, 65001, {0xD83D, 0xD83D, 0xDE00}, "", Rep(1) + "\xF0\x9F\x98\x80", "a half before a pair"},
    {k16,
     1252,
     {0xD83D, u'a'},
     "",
     "\x1A"
     "a",
     "half a pair in a code page"},
    {k16,
     1252,
     {0xD83D, 0xDE00, u'a'},
     "",
     "\x1A"
     "a",
     "a character that the code page lacks"},
    {k16, 1252, {u'a', 0xD83D}, "", "a\x1A", "half a pair at the end of it"},
    {k16, 932, {0x20AC}, "", "\xFC\xFC", "the substitute of 932"},
    {k16, 1252, {u'a', 0x200D, u'b'}, "", "ab", "an ignorable character is left out, but not unnoticed"},
    {65001, 65001, {}, "a\xC0\x80z", "a" + Rep(2) + "z", "overlong"},
    {65001, 65001, {}, "\xE0\x80\xAF", Rep(3), "overlong of three bytes"},
    {65001, 65001, {}, "\xED\xA0\x80", Rep(3), "a surrogate in UTF-8"},
    {65001, 65001, {}, "\xF4\x90\x80\x80", Rep(4), "beyond the last code point"},
    {65001,
     65001,
     {},
     "\xE2\x82"
     "A",
     Rep(1) + "A",
     "cut by another character"},
    {65001, 65001, {}, "A\xF0\x9F\x98", "A" + Rep(1), "cut by the end"},
    {65001, 65001, {}, "\xFF\xFE", Rep(2), "bytes that UTF-8 never has"},
    {65001, 1252, {}, "a\xE4\xB8\xAD", "a\x1A", "a character that the code page lacks"},
    {65001, 28591, {}, "\xE2\x82\xAC", "\x1A", "the euro sign in Latin 1"},
    {932, 65001, {}, "\x83\x83\x81 A", "\xE3\x83\xA3" + Rep(1) + " A", "a lead byte before a blank"},
    {932, 65001, {}, "A\x83", "A" + Rep(1), "a lead byte at the end"},
    {932,
     65001,
     {},
     "\x85\x40"
     "A",
     Rep(1) + "A",
     "no such character"},
};

TEST_F(Conversions, WhatCannotBeConvertedIsReplacedAndReported) {
  for (const ReplaceRow& row : kReplaceRows) {
    SCOPED_TRACE(row.why);
    std::string utf8, result;
    int status = kVEXAMBOk;
    const Converter to = Open(row.to);
    if (row.from == k16) {
      status = VEXAMBU16ToGeneric(to.get(), row.wide, result);
    } else if (row.from == 65001) {
      status = VEXAMBU8ToCodePage(to.get(), row.narrow, result);
    } else {
      const Converter from = Open(row.from);
      status = VEXAMBGenericToU8(from.get(), row.narrow, result);
    }
    EXPECT_EQ(status, kVEXAMBSubstituted);
    EXPECT_EQ(result, row.result);
  }
}

/// Runs one buffer form on UTF-8 text.
struct BufferForm {
  const char* name;
  int (*run)(UConverter*, const char*, size_t, char*, size_t, size_t*);
};

const BufferForm kBufferForms[] = {
    {"CodePagetoGeneric", VEXAMBCodePagetoGeneric},
    {"GenerictoCodePage", VEXAMBGenerictoCodePage},
    {"Genericto8", VEXAMBGenericto8},
    {"8toGeneric", VEXAMB8toGeneric},
    {"U8ToCodePage", VEXAMBU8ToCodePage},
};

struct BufferRow {
  const char* text;
  size_t length;
  size_t size;
  int status;
  const char* result;
  const char* why;
};

const BufferRow kBufferRows[] = {
    {"a\xE2\x82\xAC"
     "b",
     5, 6, kVEXAMBOk,
     "a\xE2\x82\xAC"
     "b",
     "exact fit"},
    {"a\xE2\x82\xAC"
     "b",
     5, 100, kVEXAMBOk,
     "a\xE2\x82\xAC"
     "b",
     "room to spare"},
    {"a\xE2\x82\xAC"
     "b",
     5, 5, kVEXAMBBufferTooSmall, "a\xE2\x82\xAC", "one too small"},
    {"a\xE2\x82\xAC"
     "b",
     5, 4, kVEXAMBBufferTooSmall, "a", "a character is not split"},
    {"a\xE2\x82\xAC"
     "b",
     5, 3, kVEXAMBBufferTooSmall, "a", "nor here"},
    {"a\xE2\x82\xAC"
     "b",
     5, 2, kVEXAMBBufferTooSmall, "a", "room for one"},
    {"a\xE2\x82\xAC"
     "b",
     5, 1, kVEXAMBBufferTooSmall, "", "room for the zero alone"},
    {"\xF0\x9F\x98\x80", 4, 4, kVEXAMBBufferTooSmall, "", "a pair is not split"},
    {"\xF0\x9F\x98\x80", 4, 5, kVEXAMBOk, "\xF0\x9F\x98\x80", "and fits whole"},
    {"a\xE2\x82\xAC"
     "b",
     kVEXAMBTerminated, 6, kVEXAMBOk,
     "a\xE2\x82\xAC"
     "b",
     "terminated"},
    {"", 0, 1, kVEXAMBOk, "", "empty"},
    {"", kVEXAMBTerminated, 4, kVEXAMBOk, "", "empty and terminated"},
    {nullptr, 0, 4, kVEXAMBOk, "", "null and empty"},
    {nullptr, kVEXAMBTerminated, 4, kVEXAMBOk, "", "null"},
    {nullptr, 3, 4, kVEXAMBBadArgument, "", "null with a length"},
    {"\xFF", 1, 9, kVEXAMBSubstituted, "\xEF\xBF\xBD", "malformed"},
    {"\xFF"
     "a",
     2, 4, kVEXAMBBufferTooSmall, "\xEF\xBF\xBD", "malformed and cut"},
};

TEST_F(Conversions, BufferFormsKeepToTheirRoom) {
  for (const BufferForm& form : kBufferForms) {
    for (const BufferRow& row : kBufferRows) {
      SCOPED_TRACE(std::string(form.name) + ": " + row.why);
      std::vector<char> buffer(row.size + 1, '#');
      size_t length = 77;
      EXPECT_EQ(form.run(nullptr, row.text, row.length, buffer.data(), row.size, &length), row.status);
      EXPECT_STREQ(buffer.data(), row.result);
      EXPECT_EQ(length, std::string(row.result).size());
      EXPECT_EQ(buffer[row.size], '#') << "the byte behind the buffer";
      EXPECT_EQ(form.run(nullptr, row.text, row.length, buffer.data(), row.size, nullptr), row.status);
    }
  }
}

TEST_F(Conversions, BufferFormsTellTheLengthWithoutABuffer) {
  for (const BufferForm& form : kBufferForms) {
    SCOPED_TRACE(form.name);
    char byte = '#';
    for (char* const out : {static_cast<char*>(nullptr), &byte}) {
      for (const size_t size : {size_t{0}, size_t{9}}) {
        if (out != nullptr && size != 0) continue;
        size_t length = 77;
        EXPECT_EQ(form.run(nullptr,
                           "a\xE2\x82\xAC"
                           "b",
                           5, out, size, &length),
                  kVEXAMBBufferTooSmall);
        EXPECT_EQ(length, 5u);
        EXPECT_EQ(form.run(nullptr, "a", 1, out, size, nullptr), kVEXAMBBufferTooSmall);
      }
    }
    EXPECT_EQ(byte, '#');
  }
}

TEST_F(Conversions, BufferFormsEmptyTheBufferAlsoWhenTheyRefuse) {
  char narrow[] = "before";
  unsigned short wide[] = {'x', 'y', 0};
  size_t length = 9;
  EXPECT_EQ(VEXAMBGenericto8(nullptr, nullptr, 3, narrow, sizeof narrow, &length), kVEXAMBBadArgument);
  EXPECT_STREQ(narrow, "");
  EXPECT_EQ(length, 0u);
  narrow[0] = 'b';
  length = 9;
  EXPECT_EQ(VEXAMB16toGeneric(nullptr, nullptr, 3, narrow, sizeof narrow, &length), kVEXAMBBadArgument);
  EXPECT_STREQ(narrow, "");
  EXPECT_EQ(length, 0u);
  length = 9;
  EXPECT_EQ(VEXAMBGenericto16(nullptr, nullptr, 3, wide, 3, &length), kVEXAMBBadArgument);
  EXPECT_EQ(wide[0], 0);
  EXPECT_EQ(length, 0u);
}

TEST_F(Conversions, ZerosInsideATextAreKept) {
  const std::string text("a\0\xC3\xA9\0", 5);
  for (const BufferForm& form : kBufferForms) {
    SCOPED_TRACE(form.name);
    char buffer[8] = "#######";
    size_t length = 0;
    EXPECT_EQ(form.run(nullptr, text.data(), text.size(), buffer, sizeof buffer, &length), kVEXAMBOk);
    EXPECT_EQ(std::string(buffer, length), text);
    EXPECT_EQ(buffer[length], 0);
    EXPECT_EQ(form.run(nullptr, text.data(), text.size(), buffer, 4, &length), kVEXAMBBufferTooSmall);
    EXPECT_EQ(std::string(buffer, length), text.substr(0, 2)) << "what was written counts past a zero";
  }
  std::string out;
  EXPECT_EQ(VEXAMBGenericToU8(text, out), kVEXAMBOk);
  EXPECT_EQ(out, text);
}

TEST_F(Conversions, CodePagesAreCutBetweenCharacters) {
  const Converter japanese = Open(932);
  const std::string utf8 =
      "\xE3\x82\xBD\xE3\x82\xBD"
      "a";  // 5 bytes in 932
  const struct {
    size_t size;
    const char* result;
  } rows[] = {{6,
               "\x83\x5C\x83\x5C"
               "a"},
              {5, "\x83\x5C\x83\x5C"},
              {4, "\x83\x5C"},
              {3, "\x83\x5C"},
              {2, ""},
              {1, ""}};
  for (const auto& row : rows) {
    SCOPED_TRACE(row.size);
    char buffer[8];
    size_t length = 0;
    const int status = row.size == 6 ? kVEXAMBOk : kVEXAMBBufferTooSmall;
    EXPECT_EQ(VEXAMBU8ToCodePage(japanese.get(), utf8.data(), utf8.size(), buffer, row.size, &length),
              status);
    EXPECT_STREQ(buffer, row.result);
    EXPECT_EQ(VEXAMBGenerictoCodePage(japanese.get(), utf8.data(), utf8.size(), buffer, row.size, &length),
              status);
    EXPECT_STREQ(buffer, row.result);
    const unsigned short wide[] = {0x30BD, 0x30BD, 'a', 0};
    EXPECT_EQ(VEXAMB16toGeneric(japanese.get(), wide, 3, buffer, row.size, &length), status);
    EXPECT_STREQ(buffer, row.result);
    EXPECT_EQ(VEXAMB16toGeneric(japanese.get(), wide, kVEXAMBTerminated, buffer, row.size, nullptr), status);
    EXPECT_STREQ(buffer, row.result);
  }
  EXPECT_EQ(VEXAMB16toGeneric(nullptr, nullptr, 2, nullptr, 0, nullptr), kVEXAMBBadArgument);
}

TEST_F(Conversions, Utf16IsCutBetweenPairs) {
  const std::string utf8 =
      "a\xF0\x9F\x98\x80"
      "b";  // 4 units
  const struct {
    size_t size;
    int status;
    std::u16string result;
  } rows[] = {{5, kVEXAMBOk, u"a\U0001F600b"},
              {4, kVEXAMBBufferTooSmall, u"a\U0001F600"},
              {3, kVEXAMBBufferTooSmall, u"a"},
              {2, kVEXAMBBufferTooSmall, u"a"},
              {1, kVEXAMBBufferTooSmall, u""}};
  for (const auto& row : rows) {
    SCOPED_TRACE(row.size);
    std::vector<unsigned short> buffer(row.size + 1, '#');
    size_t length = 77;
    EXPECT_EQ(VEXAMBGenericto16(nullptr, utf8.data(), utf8.size(), buffer.data(), row.size, &length),
              row.status);
    EXPECT_EQ(std::u16string(buffer.begin(), buffer.begin() + static_cast<std::ptrdiff_t>(length)),
              row.result);
    EXPECT_EQ(buffer[length], 0);
    EXPECT_EQ(buffer[row.size], '#');
  }
  size_t length = 77;
  EXPECT_EQ(VEXAMBGenericto16(nullptr, utf8.c_str(), kVEXAMBTerminated, nullptr, 0, &length),
            kVEXAMBBufferTooSmall);
  EXPECT_EQ(length, 4u);
  EXPECT_EQ(VEXAMBGenericto16(nullptr, nullptr, 1, nullptr, 0, &length), kVEXAMBBadArgument);
  EXPECT_EQ(length, 0u);
}

TEST_F(Conversions, TheResultMayBeTheInput) {
  const Converter latin = Open(28591);
  std::string text =
      "Gr\xF6\xDF"
      "e";
  EXPECT_EQ(VEXAMBCodePageToGeneric(latin.get(), text, text), kVEXAMBOk);
  EXPECT_EQ(text,
            "Gr\xC3\xB6\xC3\x9F"
            "e");
  EXPECT_EQ(VEXAMBGenericToCodePage(latin.get(), text, text), kVEXAMBOk);
  EXPECT_EQ(text,
            "Gr\xF6\xDF"
            "e");
  EXPECT_EQ(VEXAMBU8ToGeneric("", text), kVEXAMBOk);
  EXPECT_EQ(text, "") << "and is replaced, not added to";
}

TEST_F(Conversions, FormsWithoutAConverterTakeTheDefault) {
  std::string narrow;
  std::u16string wide;
  VEXAMBU16String units;
  EXPECT_EQ(VEXAMBU8ToGeneric("\xC3\xA9", narrow), kVEXAMBOk);
  EXPECT_EQ(narrow, "\xC3\xA9");
  EXPECT_EQ(VEXAMBGenericToU16(narrow, wide), kVEXAMBOk);
  EXPECT_EQ(wide, u"\u00E9");
  EXPECT_EQ(VEXAMBGenericToU16(narrow, units), kVEXAMBOk);
  EXPECT_EQ(units, VEXAMBU16String(1, 0xE9));
  EXPECT_EQ(VEXAMBU16ToGeneric(wide, narrow), kVEXAMBOk);
  EXPECT_EQ(narrow, "\xC3\xA9");
  EXPECT_EQ(VEXAMBU16ToGeneric(units, narrow), kVEXAMBOk);
  EXPECT_EQ(narrow, "\xC3\xA9");
}

TEST_F(Conversions, TranscodeGenericAllocates) {
  unsigned short* wide = nullptr;
  ASSERT_EQ(VEXAMBTranscodeGeneric(nullptr, "a\xF0\x9F\x98\x80", &wide), kVEXAMBOk);
  EXPECT_EQ(VEXAMBU16String(wide), (VEXAMBU16String{'a', 0xD83D, 0xDE00}));
  char* narrow = nullptr;
  ASSERT_EQ(VEXAMBTranscodeGeneric(nullptr, wide, &narrow), kVEXAMBOk);
  EXPECT_STREQ(narrow, "a\xF0\x9F\x98\x80");
  delete[] wide;
  delete[] narrow;

  const Converter japanese = Open(932);
  ASSERT_EQ(VEXAMBTranscodeGeneric(japanese.get(), "\x83\x5C\x83", &wide), kVEXAMBSubstituted);
  EXPECT_EQ(VEXAMBU16String(wide), (VEXAMBU16String{0x30BD, 0xFFFD}));
  delete[] wide;

  wide = reinterpret_cast<unsigned short*>(&narrow);
  EXPECT_EQ(VEXAMBTranscodeGeneric(nullptr, static_cast<const char*>(nullptr), &wide), kVEXAMBOk);
  EXPECT_EQ(wide, nullptr);
  EXPECT_EQ(VEXAMBTranscodeGeneric(nullptr, static_cast<const unsigned short*>(nullptr), &narrow), kVEXAMBOk);
  EXPECT_EQ(narrow, nullptr);
  EXPECT_EQ(VEXAMBTranscodeGeneric(nullptr, "a", nullptr), kVEXAMBBadArgument);
}

/// Blocks of the conversion end anywhere in the text, also within characters.
TEST_F(Conversions, LongTexts) {
  for (const SampleRow& row : kSamples) {
    const Converter converter = Open(row.code_page);
    for (size_t shift = 0; shift < 4; ++shift) {
      std::string bytes(shift, 'x');
      std::u16string text(shift, u'x');
      while (bytes.size() < 10000) {
        bytes += row.bytes;
        text += row.text;
      }
      std::u16string wide;
      std::string back;
      EXPECT_EQ(VEXAMBGenericToU16(converter.get(), bytes, wide), kVEXAMBOk) << row.code_page;
      EXPECT_TRUE(wide == text) << row.code_page;
      EXPECT_EQ(VEXAMBU16ToGeneric(converter.get(), wide, back), kVEXAMBOk) << row.code_page;
      EXPECT_TRUE(back == bytes) << row.code_page;
    }
  }
}

/// A converter starts anew, whatever the call before ended in.
TEST_F(Conversions, CallsDoNotDisturbEachOther) {
  const Converter japanese = Open(932);
  std::u16string wide;
  EXPECT_EQ(VEXAMBGenericToU16(japanese.get(), "\x83", wide), kVEXAMBSubstituted);
  EXPECT_EQ(VEXAMBGenericToU16(japanese.get(), "\x5C", wide), kVEXAMBOk);
  EXPECT_EQ(wide, u"\\");
  std::string narrow;
  EXPECT_EQ(VEXAMBU16ToGeneric(japanese.get(), std::u16string(1, 0xD83D), narrow), kVEXAMBSubstituted);
  EXPECT_EQ(VEXAMBU16ToGeneric(japanese.get(), std::u16string(u"a"), narrow), kVEXAMBOk);
  EXPECT_EQ(narrow, "a");
}

/// Every thread has its own clone of the default converter.
TEST_F(Conversions, ThreadsMayConvertAtOnce) {
  for (const int mode : {1, 0}) {
    SetUTF8mode(mode);
    std::vector<int> wrong(8, 0);
    std::vector<std::thread> threads;
    for (int& faults : wrong) {
      threads.emplace_back([&faults] {
        std::string text;
        for (int i = 0; i < 300; ++i)
          text += "field" + std::to_string(i) + " ";
        for (int i = 0; i < 300; ++i) {
          std::u16string wide;
          std::string back;
          faults += VEXAMBGenericToU16(text, wide) != kVEXAMBOk;
          faults += VEXAMBU16ToGeneric(wide, back) != kVEXAMBOk;
          faults += back != text;
          faults += VEXAMBFindStart_A(nullptr, text.data(), text.size(), text.size() / 2) != text.size() / 2;
        }
      });
    }
    for (std::thread& thread : threads)
      thread.join();
    EXPECT_EQ(wrong, std::vector<int>(8, 0)) << "mode " << mode;
  }
}

}  // namespace
