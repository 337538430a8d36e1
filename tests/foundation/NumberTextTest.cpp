#include "kestrel/foundation/NumberText.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cctype>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <memory>
#include <random>
#include <sstream>
#include <string>

#include "tests/support/CommaLocale.h"

namespace MCKestrel_800 {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();

struct Row {
  const char* text;
  bool whole;  ///< ParseDouble takes it
  double value;
};

constexpr Row kRows[] = {
    {"0", true, 0.0},
    {"-0", true, -0.0},
    {"12", true, 12.0},
    {"+3", true, 3.0},
    {"-1.5e3", true, -1500.0},
    {".5", true, 0.5},
    {"5.", true, 5.0},
    {"1E-2", true, 0.01},
    {"1e999", true, kInfinity},
    {"-1e999", true, -kInfinity},
    {"1e-999", true, 0.0},
    {"0e999", true, 0.0},
    {"0.0000000001e-999", true, 0.0},
    {"1000000000000000000000000e300", true, kInfinity},
    {"4.9406564584124654e-324", true, 5e-324},
    {"1e99999999999999999999", true, kInfinity},
    {"1e-99999999999999999999", true, 0.0},
    {"0.1", true, 0.1},
    {"1.7976931348623157e308", true, 1.7976931348623157e308},
    {"", false, 0},
    {" 1", false, 0},
    {"1 ", false, 0},
    {"+-1", false, 0},
    {"--1", false, 0},
    {"++1", false, 0},
    {"-", false, 0},
    {"+", false, 0},
    {".", false, 0},
    {"e5", false, 0},
    {"1e", false, 0},
    {"1e+", false, 0},
    {"1.2.3", false, 0},
    {"1,5", false, 0},
    {"1_000", false, 0},
    {"0x10", false, 0},
    {"inf", false, 0},
    {"-inf", false, 0},
    {"nan", false, 0},
    {"infinity", false, 0},
    {"abc", false, 0},
    {"1abc", false, 0},
};

TEST(NumberText, ParsesWholeTextsAlone) {
  for (const bool comma : {false, true}) {
    std::unique_ptr<kestrel_tests::CommaLocale> locale;
    if (comma) locale = std::make_unique<kestrel_tests::CommaLocale>();
    for (const Row& row : kRows) {
      double value = 77.0;
      const std::string text(row.text);
      EXPECT_EQ(ParseDouble(text.data(), text.data() + text.size(), value), row.whole) << row.text;
      EXPECT_EQ(value, row.whole ? row.value : 77.0) << row.text;
      EXPECT_EQ(std::signbit(value), row.whole && std::signbit(row.value)) << row.text;
    }
  }
}

/// Whether C's atof reads an infinity; some C libraries do not know it by its name.
bool IsInfinityToC(const std::string& text) {
  size_t at = std::min(text.find_first_not_of(" \t\n\v\f\r"), text.size());
  if (text[at] == '+') ++at;
  std::string name = text.substr(at, 3);
  for (char& c : name)
    c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
  return name == "inf" || std::atof(text.c_str()) == kInfinity;
}

/// The same answer and the same number left behind as with a standard stream, and the same infinity as in C.
/// Both references run in the classic locale.
void ExpectAsStandardLibrary(const std::string& text) {
  std::istringstream in(text);
  in.imbue(std::locale::classic());
  double wanted = 0.0, value = 77.0;
  const bool reads = static_cast<bool>(in >> wanted);
  EXPECT_EQ(ReadDouble(text, value), reads) << '"' << text << '"';
  EXPECT_EQ(value, wanted) << '"' << text << '"';
  EXPECT_EQ(std::signbit(value), std::signbit(wanted)) << '"' << text << '"';
  EXPECT_EQ(StartsWithInfinity(text), IsInfinityToC(text)) << '"' << text << '"';
}

TEST(NumberText, ReadsFromTheStartAsAStreamDoes) {
  for (const Row& row : kRows)
    ExpectAsStandardLibrary(row.text);
  for (const char* text : {"inf",
                           "+INF",
                           "-inf",
                           " infinity",
                           "Information",
                           "in",
                           "+-inf",
                           "NaN",
                           "nan(1)",
                           "1e-400",
                           "-1e-400",
                           "2.2250738585072011e-308",
                           "1e999e",
                           "1e999e+",
                           "-1e999x",
                           "1.8e308 ",
                           "0e99999",
                           "1e4294967297",
                           "1'000",
                           "1..2",
                           "-.",
                           "-.e1",
                           ".5e-1",
                           "00012",
                           "1e0000000000000000000000001",
                           "1e",
                           "1e+",
                           "5e-324",
                           "  1.5abc",
                           "\t\n2",
                           "\v\f\r3",
                           "- 3",
                           "1e5e3",
                           "1.5e5.3",
                           "1e+5-",
                           "1-2",
                           "1e-",
                           "5.e3",
                           ".e3",
                           "12345678901234567890123456789",
                           "0.00000000000000000000000000001",
                           "1e308",
                           "1e309",
                           "1 2",
                           "\xC2\xA0"
                           "1",
                           "\xEF\xBC\x91",
                           "1\xC2\xA0"}) {
    ExpectAsStandardLibrary(text);
  }
}

TEST(NumberText, ReadsVeryLongTextsAsAStreamDoes) {
  const std::string nines(400, '9'), zeros(400, '0');
  // Exactly half-way between 1 and the next double, to which a hair more rounds.
  const std::string middle = "1.00000000000000011102230246251565404236316680908203125";
  for (const std::string& text :
       {nines, "-" + nines, nines + "e", nines + "e-390", "0." + zeros + "1", "0." + zeros + "1e401",
        "1" + zeros + "e-400", "." + zeros, zeros, "0." + nines, "1." + zeros + "1", middle,
        middle + zeros + "1", middle.substr(0, middle.size() - 1) + "4" + nines}) {
    ExpectAsStandardLibrary(text);
  }
}

TEST(NumberText, StopsAtANulAsAStreamDoes) {
  ExpectAsStandardLibrary(std::string("1.5\0007", 5));
  ExpectAsStandardLibrary(std::string("\0001", 2));
}

TEST(NumberText, LeavesHexadecimalDigitsAlone) {
  double value = 77.0;
  EXPECT_TRUE(ReadDouble("0x1p1024", value));
  EXPECT_EQ(value, 0.0);
  EXPECT_FALSE(StartsWithInfinity("0x1p1024"));
}

TEST(NumberText, ReadsRandomNumbersBackToTheLastBit) {
  std::mt19937_64 random(19700101);
  for (int i = 0; i < 20000; ++i) {
    const uint64_t bits = random();
    double number = 0.0;
    std::memcpy(&number, &bits, sizeof number);
    if (!std::isfinite(number)) continue;
    char text[64];
    std::snprintf(text, sizeof text, i % 2 == 0 ? "%.17g" : "%.25e", number);
    double read = 0.0, parsed = 0.0;
    EXPECT_TRUE(ReadDouble(text, read)) << text;
    EXPECT_TRUE(ParseDouble(text, text + std::strlen(text), parsed)) << text;
    EXPECT_EQ(read, number) << text;
    EXPECT_EQ(parsed, number) << text;
    std::ostringstream out;
    out.imbue(std::locale::classic());
    out << number;
    EXPECT_EQ(FormatSixDigits(number), out.str());
  }
}

TEST(NumberText, TheLongestSixDigitsFitTheirRoom) {
  for (const double number : {-1.23457e-308, -1.7976931348623157e308, -0.000123457, -std::nan("")}) {
    char room[kSixDigitsRoom];
    const size_t length = FormatSixDigits(number, room);
    EXPECT_LE(length, 13u);
    EXPECT_EQ(std::string(room, length), FormatSixDigits(number));
  }
}

TEST(NumberText, ReadsRandomTextsAsAStreamDoes) {
  std::mt19937 random(20261121);
  constexpr char kLetters[] = "0123456789..eE+- ,x";
  std::uniform_int_distribution<size_t> letter(0, sizeof kLetters - 2), length(0, 9);
  for (int i = 0; i < 20000; ++i) {
    std::string text;
    for (size_t n = length(random); n > 0; --n)
      text += kLetters[letter(random)];
    ExpectAsStandardLibrary(text);
  }
}

TEST(NumberText, WritesSixDigitsAsAStreamDoes) {
  const double kNumbers[] = {
      0.0,  -0.0,  1.0,     0.1,    1.0 / 3, 123456.0,  1234567.0,  999999.5,     1e-4,
      1e-5, 1e100, -2.5e-7, 5e-324, 100000,  kInfinity, -kInfinity, std::nan(""), 1.7976931348623157e308};
  for (const double number : kNumbers) {
    std::ostringstream out;
    out.imbue(std::locale::classic());
    out << number;
    EXPECT_EQ(FormatSixDigits(number), out.str());
    const kestrel_tests::CommaLocale comma;
    EXPECT_EQ(FormatSixDigits(number), out.str());
  }
}

TEST(NumberText, TheShortestTextGivesTheNumberBack) {
  struct ShortestRow {
    double number;
    const char* want;
  };
  constexpr ShortestRow kShortest[] = {
      {0.0, "0"},         {-0.0, "-0"},
      {0.1, "0.1"},       {1.0 / 3.0, "0.3333333333333333"},
      {100.0, "100"},     {1e22, "1e+22"},
      {5e-324, "5e-324"}, {-1.2345678901234567e-308, "-1.2345678901234567e-308"}};
  for (const ShortestRow& row : kShortest) {
    char room[kShortestRoom];
    const std::string text(room, FormatShortest(row.number, room));
    EXPECT_EQ(text, row.want);
    double back = 1.0;
    ASSERT_TRUE(ParseDouble(text.data(), text.data() + text.size(), back));
    EXPECT_EQ(back, row.number);
  }
}

}  // namespace
}  // namespace MCKestrel_800
