#include "apps/kestrel/KeptColumns.h"

#include <gtest/gtest.h>

#include "apps/kestrel/InputFile.h"
#include "apps/kestrel/ProgramError.h"
#include "apps/kestrel/ShownText.h"
#include "apps/kestrel/TableReader.h"
#include "tests/support/TempFolder.h"

namespace kestrel_tests {
namespace {

using namespace kestrel_program;
using Names = std::vector<std::string>;
using Columns = std::vector<std::size_t>;

class KeptColumns : public testing::Test {
 protected:
  TempFolder folder_;
  InputFile input_{folder_.Write("t.csv", "a,b,\"c,d\",e\n")};
  TableReader table_{input_, 0};
};

TEST_F(KeptColumns, AreFoundByName) {
  EXPECT_EQ(FindKeptColumns(table_, {}), Columns());
  EXPECT_EQ(FindKeptColumns(table_, {"b"}), Columns({1}));
  EXPECT_EQ(FindKeptColumns(table_, {"e,a"}), Columns({3, 0}));
  EXPECT_EQ(FindKeptColumns(table_, {"e", "a,b"}), Columns({3, 0, 1}));
  EXPECT_EQ(FindKeptColumns(table_, {"c,d"}), Columns({2})) << "a name with a comma in it";
}

TEST_F(KeptColumns, AreRefusedWhenTheyAreNotThereOrAskedForTwice) {
  const std::pair<Names, const char*> rows[] = {
      {{"x"}, "--keep: the table has no column \"x\"; the columns are a, b, c,d, e"},
      {{"a,"}, "--keep: the table has no column \"\"; the columns are a, b, c,d, e"},
      {{"A"},
       "--keep: the table has no column \"A\"; the columns are a, b, c,d, e\n  hint: upper and lower case "
       "count; there is a"},
      {{"a,b,a"}, "--keep: the column \"a\" is asked for twice"},
      {{"a", "a"}, "--keep: the column \"a\" is asked for twice"},
  };
  for (const auto& [asked, want] : rows) {
    try {
      FindKeptColumns(table_, asked);
      ADD_FAILURE() << want;
    } catch (const ProgramError& fault) {
      EXPECT_EQ(fault.GetCode(), kUsage);
      EXPECT_EQ(fault.GetText(), want);
    }
  }
}

TEST(NameOutputColumns, GivesEveryColumnANameOfItsOwn) {
  EXPECT_EQ(NameOutputColumns({}, {"p", "q"}), Names({"p", "q"}));
  EXPECT_EQ(NameOutputColumns({"a", "p"}, {"p", "q"}), Names({"a", "p", "p_2", "q"}));
  EXPECT_EQ(NameOutputColumns({"p", "p_2"}, {"p"}), Names({"p", "p_2", "p_3"}));
  EXPECT_EQ(NameOutputColumns({"", "a", ""}, {}), Names({"", "a", "_2"}));
  EXPECT_EQ(NameOutputColumns({}, {"probability", "probability"}), Names({"probability", "probability_2"}));
}

TEST(ShownText, HoldsPrintableUtf8Alone) {
  const std::pair<const char*, const char*> rows[] = {
      {"\xC3\xA4\xE2\x82\xAC\xF0\x9F\x8C\x8D", "\xC3\xA4\xE2\x82\xAC\xF0\x9F\x8C\x8D"},
      {"a\xC2\x9B[2J", "a??[2J"},          // a terminal takes it as an escape sequence
      {"M\xFCnchen", "M?nchen"},           // Latin-1
      {"cut off \xE2\x82", "cut off ??"},  // the third byte is not there
      {"\xC0\xAF", "??"},                  // longer than it need be
      {"\xE0\x9F\xBF", "???"},
      {"\xED\xA0\x80", "???"},  // half a surrogate pair
      {"\xF0\x8F\xBF\xBF", "????"},
      {"\xF4\x90\x80\x80", "????"},  // beyond the last character
      {"\xF5\xFF\x80", "???"},
  };
  for (const auto& [text, want] : rows)
    EXPECT_EQ(ShownText(text), want);
}

TEST(ShownText, IsOneShortLine) {
  EXPECT_EQ(ShownText("abc"), "abc");
  EXPECT_EQ(ShownText("a\nb\x1B[2J\x7F"), "a?b?[2J?");
  EXPECT_EQ(ShownText(std::string(100, 'x')), std::string(60, 'x') + "...");
  EXPECT_EQ(ShownText(std::string(59, 'x') + "\xC3\xA4"
                                             "z"),
            std::string(59, 'x') + "...")
      << "cut at a character";
}

}  // namespace
}  // namespace kestrel_tests
