#include "kestrel/foundation/NumberText.h"

#include <gtest/gtest.h>

#include <cmath>
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

/// What a standard stream with the classic locale reads; false when it reads no number.
bool StreamReads(const std::string& text, double& value) {
  std::istringstream in(text);
  in.imbue(std::locale::classic());
  return static_cast<bool>(in >> value);
}

void ExpectAsStream(const std::string& text) {
  double wanted = 0.0, value = 77.0;
  const bool reads = StreamReads(text, wanted);
  EXPECT_EQ(ReadDouble(text, value), reads) << '"' << text << '"';
  if (!reads) return;
  EXPECT_EQ(value, wanted) << '"' << text << '"';
}

TEST(NumberText, ReadsFromTheStartAsAStreamDoes) {
  for (const Row& row : kRows)
    ExpectAsStream(row.text);
  for (const char* text :
       {"  1.5abc", "\t\n2", "\v\f\r3", "- 3", "1e5e3", "1.5e5.3", "1e+5-", "1-2", "1e-", "5.e3", ".e3",
        "12345678901234567890123456789", "0.00000000000000000000000000001", "1e308", "1e309", "1 2",
        "\xC2\xA0"
        "1",
        "\xEF\xBC\x91", "1\xC2\xA0"}) {
    ExpectAsStream(text);
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
    ExpectAsStream(text);
  }
}

TEST(NumberText, TellsWhatIsTooLarge) {
  double value = 0.0;
  bool tooLarge = false;
  EXPECT_FALSE(ReadDouble("1e999", value, &tooLarge));
  EXPECT_TRUE(tooLarge);
  EXPECT_EQ(value, kInfinity);
  tooLarge = false;
  EXPECT_FALSE(ReadDouble("abc", value, &tooLarge));
  EXPECT_FALSE(tooLarge);
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

}  // namespace
}  // namespace MCKestrel_800
