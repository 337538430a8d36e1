#include "kestrel/foundation/MultibyteText.h"

#include <gtest/gtest.h>

#include <clocale>
#include <cstdlib>
#include <cstring>
#include <iterator>
#include <string>
#include <vector>

#include "kestrel/foundation/Locale.h"
#include "tests/foundation/TextKinds.h"

namespace {

using namespace MCXML_800;
using kestrel_tests::MakeKind;
using kestrel_tests::TextKind;

/// The default converter's code page differs between systems.
class DefaultIsUtf8 {
 public:
  DefaultIsUtf8() { SetUTF8mode(1); }
  ~DefaultIsUtf8() { SetUTF8mode(before_); }
  DefaultIsUtf8(const DefaultIsUtf8&) = delete;
  DefaultIsUtf8& operator=(const DefaultIsUtf8&) = delete;

 private:
  int before_ = qUTF8mode();
};

enum Kind { kGood, kUnassigned, kMalformed };

struct Piece {
  std::string bytes;
  char32_t code_point;
  Kind kind = kGood;
};

struct WalkRow {
  const char* text_kind;
  const char* why;
  std::vector<Piece> pieces;
  const char* locale = nullptr;  // for _C
};

const WalkRow kWalkRows[] = {
    {"_8",
     "one to four bytes",
     {{"A", 'A'}, {"\xC3\xA9", 0xE9}, {"\xE2\x82\xAC", 0x20AC}, {"\xF0\x9F\x98\x80", 0x1F600}, {"z", 'z'}}},
    {"_8",
     "first and last of each length",
     {{"\x7F", 0x7F},
      {"\xC2\x80", 0x80},
      {"\xDF\xBF", 0x7FF},
      {"\xE0\xA0\x80", 0x800},
      {"\xEF\xBF\xBF", 0xFFFF},
      {"\xF0\x90\x80\x80", 0x10000},
      {"\xF4\x8F\xBF\xBF", 0x10FFFF}}},
    {"_8",
     "overlong",
     {{"\xC0", 0xFFFD, kMalformed},
      {"\x80", 0xFFFD, kMalformed},
      {"\xE0", 0xFFFD, kMalformed},
      {"\x80", 0xFFFD, kMalformed},
      {"\xAF", 0xFFFD, kMalformed},
      {"/", '/'}}},
    {"_8",
     "surrogate",
     {{"\xED", 0xFFFD, kMalformed}, {"\xA0", 0xFFFD, kMalformed}, {"\x80", 0xFFFD, kMalformed}, {"a", 'a'}}},
    {"_8",
     "beyond the last code point",
     {{"\xF4", 0xFFFD, kMalformed},
      {"\x90", 0xFFFD, kMalformed},
      {"\x80", 0xFFFD, kMalformed},
      {"\x80", 0xFFFD, kMalformed},
      {"\xF5", 0xFFFD, kMalformed},
      {"\xFF", 0xFFFD, kMalformed}}},
    {"_8",
     "cut by another character",
     {{"\xE2\x82", 0xFFFD, kMalformed},
      {"A", 'A'},
      {"\xF0\x9F\x98", 0xFFFD, kMalformed},
      {"\xC3\xA9", 0xE9}}},
    {"_8", "cut by the end", {{"a", 'a'}, {"\xF0\x9F\x98", 0xFFFD, kMalformed}}},
    {"_8",
     "trail bytes alone",
     {{"\x80", 0xFFFD, kMalformed},
      {"\xBF", 0xFFFD, kMalformed},
      {"\xBF", 0xFFFD, kMalformed},
      {"\xBF", 0xFFFD, kMalformed},
      {"\xBF", 0xFFFD, kMalformed},
      {"x", 'x'}}},
    {"UTF-8",
     "a converter for UTF-8 walks alike",
     {{"\xC3\xA9", 0xE9}, {"\xE2\x82", 0xFFFD, kMalformed}, {"A", 'A'}}},
    {"default", "so does the default one", {{"\xC3\xA9", 0xE9}, {"\xF0\x9F\x98\x80", 0x1F600}, {"A", 'A'}}},
    {"windows-31j",
     "trail byte that is a backslash",
     {{"\x83\x5C", 0x30BD}, {"\\", '\\'}, {"\x95\x5C", 0x8868}, {"n", 'n'}}},
    {"windows-31j",
     "trail bytes that look like lead bytes, odd",
     {{"\x83\x83", 0x30E3}, {"\x83\x83", 0x30E3}, {"\x88\x9F", 0x4E9C}}},
    {"windows-31j",
     "and after a single byte",
     {{"\xB1", 0xFF71}, {"\x83\x83", 0x30E3}, {"\xB1", 0xFF71}, {"\x89\xD4", 0x82B1}, {"A", 'A'}}},
    {"windows-31j",
     "a lead byte before a blank, and before the end",
     {{"\x81", 0xFFFD, kMalformed}, {" ", ' '}, {"\x83\x83", 0x30E3}, {"\x83", 0xFFFD, kMalformed}}},
    {"windows-31j",
     "no such character",
     {{"\x85\x40", 0xFFFD, kUnassigned}, {"A", 'A'}, {"\xFD", 0xFFFD, kUnassigned}}},
    {"windows-31j", "private use", {{"\xF0\x40", 0xE000}, {"1", '1'}}},
    {"GBK",
     "trail bytes like ASCII and like lead bytes",
     {{"\xD6\xD0", 0x4E2D}, {"\x81\x5C", 0x4E57}, {"\\", '\\'}, {"\x81\x40", 0x4E02}, {"\xCE\xC4", 0x6587}}},
    {"KS_C_5601-1987",
     "the extended characters too",
     {{"\xC7\xD1", 0xD55C}, {"\x8C\x63", 0xB620}, {"c", 'c'}, {"\x81\x41", 0xAC02}}},
    {"Big5",
     "trail byte that is a backslash",
     {{"\xA5\x5C", 0x529F}, {"\xB3\x5C", 0x8A31}, {"\xA4\xA4", 0x4E2D}}},
    {"cp1252",
     "every byte is a character",
     {{"\x80", 0x20AC}, {"\xE9", 0xE9}, {"\x83", 0x192}, {"\x83", 0x192}}},
    {"ISO-8859-1", "every byte is a character", {{"\xFF", 0xFF}, {"\x81", 0x81}}},
    {"US-ASCII", "the upper half is none", {{"a", 'a'}, {"\xE9", 0xFFFD, kMalformed}, {"b", 'b'}}},
    {"GB18030",
     "four bytes with digits",
     {{"1", '1'},
      {"\x90\x30\x81\x30", 0x10000},
      {"0", '0'},
      {"\x81\x30\x81\x30", 0x80},
      {"\xD6\xD0", 0x4E2D}}},
    {"GB18030",
     "cut by a blank",
     {{"\x81", 0xFFFD, kMalformed}, {"0", '0'}, {" ", ' '}, {"\xD6\xD0", 0x4E2D}}},
    {"EUC-JP",
     "two and three bytes",
     {{"\xA4\xA2", 0x3042}, {"\x8F\xB0\xA1", 0x4E02}, {"\x8E\xB1", 0xFF71}, {"\\", '\\'}}},
    {"_C",
     "UTF-8",
     {{"A", 'A'}, {"\xC3\xA9", 0xE9}, {"\xE2\x82\xAC", 0x20AC}, {"\xE2\x82\xAC", 0x20AC}, {"x", 'x'}},
     "C.UTF-8"},
    {"_C",
     "UTF-8 cut",
     {{"\xE2", 0xFFFD, kMalformed}, {"\x82", 0xFFFD, kMalformed}, {"A", 'A'}, {"\xE2", 0xFFFD, kMalformed}},
     "C.UTF-8"},
    {"_C", "the C locale", {{"A", 'A'}, {"\\", '\\'}, {"z", 'z'}}, "C"},
    {"_C",
     "932",
     {{"\x83\x5C", 0x30BD},
      {"\x83\x83", 0x30E3},
      {"\x83\x83", 0x30E3},
      {"\xB1", 0xFF71},
      {"\x88\x9F", 0x4E9C},
      {"A", 'A'}},
     "ja_JP.WINDOWS-31J"},
    {"_C",
     "932 of the Windows runtime",
     {{"\x83\x5C", 0x30BD}, {"\x83\x83", 0x30E3}, {"\x83\x83", 0x30E3}, {"A", 'A'}},
     ".932"},
    {"_C",
     "GBK",
     {{"\xD6\xD0", 0x4E2D}, {"\x81\x5C", 0x4E57}, {"\\", '\\'}, {"\xCE\xC4", 0x6587}},
     "zh_CN.GBK"},
    {"_C", "three bytes", {{"\xA4\xA2", 0x3042}, {"\x8F\xB0\xA1", 0x4E02}, {"\\", '\\'}}, "ja_JP.EUC-JP"},
    {"_C", "Latin 1", {{"\xE9", 0xE9}, {"\x83", 0x83}, {"A", 'A'}}, "en_US.ISO-8859-1"},
};

/// Puts another character locale in place. `known` tells whether the system has it.
class CharacterLocale {
 public:
  explicit CharacterLocale(const char* name) : before_(std::setlocale(LC_CTYPE, nullptr)) {
    known = name == nullptr || std::setlocale(LC_CTYPE, name) != nullptr;
  }
  ~CharacterLocale() { std::setlocale(LC_CTYPE, before_.c_str()); }
  CharacterLocale(const CharacterLocale&) = delete;
  CharacterLocale& operator=(const CharacterLocale&) = delete;
  bool known;

 private:
  std::string before_;
};

std::string Join(const std::vector<Piece>& pieces) {
  std::string text;
  for (const Piece& piece : pieces)
    text += piece.bytes;
  return text;
}

void CheckForwards(const TextKind& kind, const WalkRow& row) {
  const std::string text = Join(row.pieces);
  const char* at = text.c_str();
  for (const Piece& piece : row.pieces) {
    const size_t left = static_cast<size_t>(text.c_str() + text.size() - at);
    const int bytes = static_cast<int>(piece.bytes.size());
    EXPECT_EQ(kind.Mblen(at, left), piece.kind == kMalformed ? -1 : bytes);
    if (piece.kind != kMalformed) {
      EXPECT_EQ(kind.Mblen(at, piece.bytes.size()), bytes) << "with nothing behind it";
      for (size_t cut = 1; cut < piece.bytes.size(); ++cut)
        EXPECT_EQ(kind.Mblen(at, cut), -1) << "cut to " << cut;
    }
    EXPECT_EQ(kind.Mbclen(at), piece.bytes.size());
    EXPECT_EQ(kind.U32Get(at), piece.code_point);
    if (piece.kind == kGood) {
      EXPECT_EQ(kind.IsLeadByte(static_cast<unsigned char>(piece.bytes[0])), piece.bytes.size() > 1);
    }
    ASSERT_EQ(kind.Strinc(at), at + piece.bytes.size());
    at += piece.bytes.size();
  }
  EXPECT_EQ(kind.Strinc(at), at);
  EXPECT_EQ(kind.Mbclen(at), 0u);
  EXPECT_EQ(kind.Mblen(at, 1), 0);
  EXPECT_EQ(kind.U32Get(at), 0u);
}

void CheckBackwards(const TextKind& kind, const WalkRow& row) {
  const std::string text = Join(row.pieces);
  std::vector<size_t> starts;
  size_t end = 0;
  for (const Piece& piece : row.pieces) {
    starts.push_back(end);
    // Every byte of the character leads to its start.
    for (size_t i = 0; i < piece.bytes.size(); ++i)
      EXPECT_EQ(kind.FindStart(text.c_str(), text.size(), end + i), end) << "byte " << i;
    const size_t start = end;
    end += piece.bytes.size();
    EXPECT_EQ(kind.PreviousIndex(text.c_str(), end), start);
    EXPECT_EQ(kind.AnsiPrev(text.c_str(), text.c_str() + end), text.c_str() + start);
  }
  EXPECT_EQ(kind.FindStart(text.c_str(), text.size(), text.size()), text.size());
  EXPECT_EQ(kind.FindStarts(text.c_str(), text.size()), starts);
  EXPECT_EQ(kind.PreviousIndex(text.c_str(), 0), 0u);
  EXPECT_EQ(kind.AnsiPrev(text.c_str(), text.c_str()), text.c_str());
}

void CheckCopies(const TextKind& kind, const WalkRow& row) {
  const std::string text = Join(row.pieces);
  for (size_t size = 0; size <= text.size() + 3; ++size) {
    SCOPED_TRACE("size " + std::to_string(size));
    size_t whole = 0;
    for (const Piece& piece : row.pieces) {
      if (whole + piece.bytes.size() > size) break;
      whole += piece.bytes.size();
    }
    std::string buffer(size + 1, '#');
    EXPECT_EQ(kind.Strncpy(buffer.data(), text.c_str(), size), buffer.data());
    EXPECT_EQ(buffer, text.substr(0, whole) + std::string(size - whole, '\0') + "#");
  }
}

void CheckSearches(const TextKind& kind, const WalkRow& row) {
  const std::string text = Join(row.pieces);
  for (const Piece& piece : row.pieces) {
    const char *first = nullptr, *last = nullptr;
    size_t at = 0, untilBytes = std::string::npos;
    for (const Piece& other : row.pieces) {
      if (other.kind == kGood && other.code_point == piece.code_point) {
        last = text.c_str() + at;
        if (first == nullptr) first = last;
      }
      if (other.bytes == piece.bytes && untilBytes == std::string::npos) untilBytes = at;
      at += other.bytes.size();
    }
    EXPECT_EQ(kind.Strchr(text.c_str(), piece.code_point), first);
    EXPECT_EQ(kind.Strrchr(text.c_str(), piece.code_point), last);
    EXPECT_EQ(kind.Strcspn(text.c_str(), piece.bytes.c_str()), untilBytes);
  }
  EXPECT_EQ(kind.Strchr(text.c_str(), 0), text.c_str() + text.size());
  EXPECT_EQ(kind.Strrchr(text.c_str(), 0), text.c_str() + text.size());
  EXPECT_EQ(kind.Strchr(text.c_str(), 0x2603), nullptr);
  EXPECT_EQ(kind.Strcspn(text.c_str(), ""), text.size());
}

TEST(MultibyteText, WalksBothWaysOverTheSameCharacters) {
  const DefaultIsUtf8 mode;
  int walked = 0;
  for (const WalkRow& row : kWalkRows) {
    SCOPED_TRACE(std::string(row.text_kind) + ": " + row.why);
    const CharacterLocale locale(row.locale);
    if (!locale.known) continue;
    const auto kind = MakeKind(row.text_kind);
    CheckForwards(*kind, row);
    CheckBackwards(*kind, row);
    CheckCopies(*kind, row);
    CheckSearches(*kind, row);
    ++walked;
  }
  EXPECT_GE(walked, 25) << "all but those whose locale the system lacks";
}

// Run with the locales that the build has made; see CMakeLists.txt.
TEST(MultibyteText, AllLocalesOfTheTestAreThere) {
  if (std::getenv("LOCPATH") == nullptr) GTEST_SKIP() << "no locales were made for the test";
  for (const WalkRow& row : kWalkRows) {
    if (row.locale == nullptr || row.locale[0] == '.') continue;
    EXPECT_TRUE(CharacterLocale(row.locale).known) << row.locale;
  }
}

TEST(MultibyteText, NullAndEmptyTextsAreTheEnd) {
  for (const char* name : {"_8", "_C", "windows-31j", "default"}) {
    SCOPED_TRACE(name);
    const auto kind = MakeKind(name);
    for (const char* text : {static_cast<const char*>(nullptr), ""}) {
      EXPECT_EQ(kind->Mblen(text, 5), 0);
      EXPECT_EQ(kind->Mbclen(text), 0u);
      EXPECT_EQ(kind->U32Get(text), 0u);
      EXPECT_EQ(kind->Strinc(text), text);
      EXPECT_EQ(kind->AnsiPrev(text, text), text);
      EXPECT_EQ(kind->FindStart(text, 0, 0), 0u);
      EXPECT_TRUE(kind->FindStarts(text, 0).empty());
      EXPECT_EQ(kind->Strchr(text, 'a'), nullptr);
      EXPECT_EQ(kind->Strrchr(text, 'a'), nullptr);
      EXPECT_EQ(kind->Strcspn(text, "a"), 0u);
      EXPECT_EQ(kind->Strcspn("abc", text), 3u);
      EXPECT_EQ(kind->Qstricmp(text, ""), 0);
      EXPECT_LT(kind->Qstricmp(text, "a"), 0);
      EXPECT_GT(kind->Strnicmp("a", text, 9), 0);
      char buffer[4] = "###";
      kind->Strncpy(buffer, text, 3);
      EXPECT_EQ(std::memcmp(buffer, "\0\0\0", 4), 0);
    }
    EXPECT_EQ(kind->Mblen("abc", 0), 0);
    EXPECT_EQ(kind->Strncpy(nullptr, "abc", 3), nullptr);
  }
}

TEST(MultibyteText, PositionsWithinACharacterGiveThatCharacter) {
  const std::string text = "a\xE2\x82\xAC";
  EXPECT_EQ(VEXAMBPreviousIndex_8(text.c_str(), 2), 1u);
  EXPECT_EQ(VEXAMBPreviousIndex_8(text.c_str(), 3), 1u);
  EXPECT_EQ(MakeKind("windows-31j")->PreviousIndex("a\x83\x5C", 2), 1u);
}

TEST(MultibyteText, TextsWithALengthMayHoldZeros) {
  const std::string text("a\0\xC3\xA9\0", 5);
  EXPECT_EQ(VEXAMBFindStarts_8(text.data(), text.size()), (std::vector<size_t>{0, 1, 2, 4}));
  EXPECT_EQ(VEXAMBPreviousIndex_8(text.data(), 2), 1u);
  const auto kind = MakeKind("GBK");
  const std::string chinese("a\0\xD6\xD0\0", 5);
  EXPECT_EQ(kind->FindStarts(chinese.data(), chinese.size()), (std::vector<size_t>{0, 1, 2, 4}));
  EXPECT_EQ(kind->FindStart(chinese.data(), chinese.size(), 3), 2u);
}

struct CompareRow {
  const char* text_kind;
  const char* left;
  const char* right;
  size_t size;  // npos: the whole texts
  int sign;
  const char* why;
};

constexpr size_t kWhole = static_cast<size_t>(-1);

const CompareRow kCompareRows[] = {
    {"_8", "PMML", "pmml", kWhole, 0, "ASCII case"},
    {"_8", "\xC3\x84rger", "\xC3\xA4RGER", kWhole, 0, "case beyond ASCII"},
    {"_8", "a", "b", kWhole, -1, "order"},
    {"_8", "Z", "a", kWhole, 1, "order after folding"},
    {"_8", "ab", "abc", kWhole, -1, "the shorter comes first"},
    {"_8", "abcX", "ABCy", 3, 0, "only the first bytes"},
    {"_8", "abcX", "ABCy", 4, -1, "and the difference behind them"},
    {"_8", "a\xC3\xA9", "a\xC3\xA8", 2, 0, "a character that is cut does not count"},
    {"_8", "a\xC3\xA9", "a\xC3\xA8", 3, 1, "whole it does"},
    {"_8", "abc", "xyz", 0, 0, "no bytes"},
    {"_8", "a\xFF", "a\xFE", kWhole, 1, "malformed bytes differ from each other"},
    {"_8", "a\xFF", "a\xEF\xBF\xBD", kWhole, 1, "and from the replacement character"},
    {"_8", "\xEF\xBF\xBF", "\xF0\x90\x80\x80", kWhole, -1, "code points beyond U+FFFF come last"},
    {"windows-31j", "\x83\x5C", "\x83\x7C", kWhole, -1, "a trail byte has no case"},
    {"windows-31j", "\x83\x41", "\x83\x61", kWhole, -1, "not even as a letter"},
    {"windows-31j",
     "\x83\x5C"
     "a",
     "\x83\x5C"
     "A",
     kWhole, 0, "letters behind it have"},
    {"windows-31j", "\x85\x40", "\x85\x41", kWhole, -1, "characters without code points differ"},
    {"cp1251", "\xD1", "\xF1", kWhole, 0, "Cyrillic case"},
    {"default", "\xC3\x84", "\xC3\xA4", kWhole, 0, "the default converter"},
    {"_C", "PMML", "pmml", kWhole, 0, "ASCII case in every locale"},
    {"_C", "abcX", "ABCy", 3, 0, "only the first bytes"},
};

int Sign(int value) {
  return (value > 0) - (value < 0);
}

TEST(MultibyteText, ComparesWithoutCase) {
  const DefaultIsUtf8 mode;
  for (const CompareRow& row : kCompareRows) {
    SCOPED_TRACE(std::string(row.text_kind) + ": " + row.why);
    const auto kind = MakeKind(row.text_kind);
    EXPECT_EQ(Sign(kind->Strnicmp(row.left, row.right, row.size)), row.sign);
    EXPECT_EQ(Sign(kind->Strnicmp(row.right, row.left, row.size)), -row.sign);
    if (row.size != kWhole) continue;
    EXPECT_EQ(Sign(kind->Qstricmp(row.left, row.right)), row.sign);
    EXPECT_EQ(Sign(kind->Qstricmp(row.right, row.left)), -row.sign);
  }
}

TEST(MultibyteText, FindsNoBackslashInsideACharacter) {
  const auto kind = MakeKind("windows-31j");
  const char* const path = "C:\\\x83\x5C\x95\x5C.txt";
  EXPECT_EQ(kind->Strchr(path, '\\'), path + 2);
  EXPECT_EQ(kind->Strrchr(path, '\\'), path + 2);
  EXPECT_EQ(kind->Strrchr(path, 0x8868), path + 5);
  EXPECT_EQ(kind->Strcspn(path + 3, "\\."), 4u);
}

TEST(MultibyteText, SetsHoldManyCharacters) {
  EXPECT_EQ(VEXAMBstrcspn_8("abc\xE2\x82\xAC", "\xC3\xA9\xE2\x82\xACxyz"), 3u);
  EXPECT_EQ(VEXAMBstrcspn_8("a\xC3\xA8", "\xC3\xA9"), 3u) << "a shared lead byte is no shared character";
  EXPECT_EQ(VEXAMBstrcspn_8("ab\xFF", "\xFF"), 2u);
  EXPECT_EQ(VEXAMBstrcspn_8("ab\xFF", "\xFE"), 3u);
}

/// What has no blanks or line ends in it offers no safe place, so only the walk from the start is right.
TEST(MultibyteText, LongRunsOfLeadBytesKeepTheirParity) {
  for (const char* name : {"windows-31j", "GBK", "KS_C_5601-1987", "Big5"}) {
    SCOPED_TRACE(name);
    const auto kind = MakeKind(name);
    const std::string pair = std::string(name) == "windows-31j" ? "\x83\x83" : "\xC7\xD1";
    std::string text;
    for (int i = 0; i < 5000; ++i)
      text += pair;
    for (const char* before : {"", "a", "ab"}) {
      const std::string whole = before + text;
      EXPECT_EQ(kind->PreviousIndex(whole.c_str(), whole.size()), whole.size() - 2);
      EXPECT_EQ(kind->FindStart(whole.c_str(), whole.size(), whole.size() - 1), whole.size() - 2);
      EXPECT_EQ(kind->FindStart(whole.c_str(), whole.size(), whole.size() - 2), whole.size() - 2);
      EXPECT_EQ(kind->FindStarts(whole.c_str(), whole.size()).size(), std::strlen(before) + 5000);
    }
  }
}

/// Whatever the bytes: walking forwards, backwards and finding starts agree.
TEST(MultibyteText, AgreesWithItselfOnArbitraryBytes) {
  const unsigned char alphabet[] = {0x00, 0x20, 0x30, 0x39, 0x41, 0x5C, 0x7F, 0x80, 0x81, 0x83,
                                    0x8E, 0x8F, 0x90, 0xA0, 0xA1, 0xB1, 0xBF, 0xC0, 0xC3, 0xD6,
                                    0xE2, 0xED, 0xF0, 0xF4, 0xFC, 0xFD, 0xFE, 0xFF};
  const struct {
    const char* text_kind;
    const char* locale;
  } kinds[] = {{"_8", nullptr},
               {"windows-31j", nullptr},
               {"GBK", nullptr},
               {"KS_C_5601-1987", nullptr},
               {"Big5", nullptr},
               {"GB18030", nullptr},
               {"EUC-JP", nullptr},
               {"cp1252", nullptr},
               {"_C", "C.UTF-8"},
               {"_C", "C"},
               {"_C", "ja_JP.WINDOWS-31J"},
               {"_C", "zh_CN.GBK"},
               {"_C", "ja_JP.EUC-JP"},
               {"_C", ".932"}};
  unsigned random = 1;
  for (const auto& row : kinds) {
    const CharacterLocale locale(row.locale);
    if (!locale.known) continue;
    const std::string name = row.text_kind + std::string(row.locale == nullptr ? "" : row.locale);
    const auto kind = MakeKind(row.text_kind);
    for (int round = 0; round < 4000; ++round) {
      std::string text;
      for (int i = 0; i < 12; ++i) {
        random = random * 1664525u + 1013904223u;
        text += static_cast<char>(alphabet[(random >> 16) % std::size(alphabet)]);
      }
      const std::vector<size_t> starts = kind->FindStarts(text.data(), text.size());
      for (size_t i = 0; i < starts.size(); ++i) {
        const size_t end = i + 1 < starts.size() ? starts[i + 1] : text.size();
        bool agrees = kind->PreviousIndex(text.data(), end) == starts[i];
        for (size_t at = starts[i]; at < end; ++at)
          agrees = agrees && kind->FindStart(text.data(), text.size(), at) == starts[i];
        // A terminated text ends where a zero comes first.
        const char* const here = text.c_str() + starts[i];
        agrees = agrees && (*here == 0 || kind->Mbclen(here) == end - starts[i]);
        ASSERT_TRUE(agrees) << name << " " << testing::PrintToString(text) << " at " << starts[i];
      }
    }
  }
}

/// Each of these looks at a few bytes, or once at all; were one to measure the text at each step, this would
/// take minutes.
TEST(MultibyteText, LongTextsTakeTimeByTheirLength) {
  for (const char* name : {"_8", "_C", "windows-31j", "GB18030"}) {
    SCOPED_TRACE(name);
    const auto kind = MakeKind(name);
    std::string text;
    while (text.size() < (1u << 20))
      text += "field one, field two\n";
    size_t forwards = 0, backwards = 0;
    for (const char* at = text.c_str(); *at != 0; at = kind->Strinc(at)) {
      ++forwards;
      if (kind->U32Get(at) == 0 || kind->Mbclen(at) == 0) FAIL();
    }
    for (size_t at = text.size(); at > 0; at = kind->PreviousIndex(text.c_str(), at))
      ++backwards;
    EXPECT_EQ(forwards, text.size());
    EXPECT_EQ(backwards, text.size());
    EXPECT_EQ(kind->Strcspn(text.c_str(), "|\xC7"), text.size());
    EXPECT_EQ(kind->Strrchr(text.c_str(), '|'), nullptr);
    EXPECT_EQ(kind->Qstricmp(text.c_str(), text.c_str()), 0);
  }
}

/// A caller's converter keeps its own way of treating errors, and starts anew.
TEST(MultibyteText, ConvertersComeBackAsTheyWere) {
  UConverter* const converter = VEXAMBConverterNew_C("windows-31j");
  const auto before = VEXAMBU32Get_A(converter, "\x83\x5C");
  EXPECT_EQ(VEXAMBmblen_A(converter, "\x83", 1), -1);
  EXPECT_EQ(VEXAMBU32Get_A(converter, "\x5C"), U'\\') << "not the end of the character before";
  EXPECT_EQ(VEXAMBU32Get_A(converter, "\x83\x5C"), before);
  VEXAMBConverterDelete(converter);
}

TEST(MultibyteText, OpensConvertersByNameInEachKindOfText) {
  const std::string longName(200, 'x');
  const std::string longWide = [] {
    std::string name;
    for (int i = 0; i < 200; ++i)
      name += "\xE2\x82\xAC";
    return name;
  }();
  struct Row {
    const char* name;
    bool opens;
  };
  const Row rows[] = {
      {"windows-31j", true},     {"GBK", true},   {"cp1252", true},   {"utf8", true},
      {nullptr, true},           {"", false},     {"no", false},      {longName.c_str(), false},
      {longWide.c_str(), false}, {"\xFF", false}, {"\xC3\xA9", false}};
  for (const Row& row : rows) {
    UConverter* const made[] = {VEXAMBConverterNew_C(row.name), VEXAMBConverterNew_A(nullptr, row.name),
                                VEXAMBConverterNew_8(row.name)};
    for (UConverter* converter : made) {
      EXPECT_EQ(converter != nullptr, row.opens) << (row.name == nullptr ? "null" : row.name);
      VEXAMBConverterDelete(converter);
    }
  }
}

/// The name is cut to 59 bytes before it is looked up. ICU takes no notice of blanks and hyphens in names, so
/// a name may be filled up to any length.
TEST(MultibyteText, NamesOfConvertersAreCutAt59Bytes) {
  const std::string filler = "utf" + std::string(55, '-');
  const auto opens = [](const std::string& name) {
    UConverter* const converter = VEXAMBConverterNew_8(name.c_str());
    VEXAMBConverterDelete(converter);
    return converter != nullptr;
  };
  EXPECT_TRUE(opens(filler + "8"));
  EXPECT_TRUE(opens(filler + "8garbage")) << "what is beyond does not count";
  EXPECT_FALSE(opens(filler + "-8")) << "nor does what is needed";
}

}  // namespace
