#include "plugins/support/TargetCategories.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "tests/plugins/ModelText.h"
#include "tests/support/ExpectFault.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

/// The fields of TestFields, and one number with its missing value.
std::unique_ptr<ScoreDictionary> Fields() {
  return kestrel_test::ReadDictionary(kestrel_test::DictionaryOf(
      10, std::string(TestFields()) +
              "<DataField name='u' optype='categorical' dataType='double'>"
              "<Value value='0.5'/><Value value='-9' property='missing'/></DataField>"));
}

std::string All(const TargetCategories& categories) {
  std::string all;
  for (int i = 0; i < categories.GetCount(); ++i)
    all += (i == 0 ? "" : " ") + categories.Get(i).GetString();
  return all;
}

struct Asked {
  const char* text;
  int number;
};

struct FindRow {
  const char* why;
  const char* target;  ///< null for none
  Asked asked[4];
  const char* all;  ///< the categories afterwards
};

constexpr FindRow kFinds[] = {
    {"listed texts in their order",
     "m",
     {{"blue", 2}, {"red", 0}, {"green", 1}, {"blue", 2}},
     "red green blue"},
    {"trailing blanks do not count",
     "m",
     {{"blue  ", 2}, {"blue", 2}, {"red ", 0}, {"green", 1}},
     "red green blue"},
    {"listed numbers, however they are written", "n", {{"3", 2}, {"1.0", 0}, {"2e0", 1}, {"+3", 2}}, "1 2 3"},
    {"numbers that differ by rounding",
     "n",
     {{"1.0000000000000002", 0}, {"2.9999999999999996", 2}, {"2", 1}, {"1", 0}},
     "1 2 3"},
    {"ordinal texts", "o", {{"high", 2}, {"low", 0}, {"mid", 1}, {"high", 2}}, "low mid high"},
    {"texts without list: as they come", "t", {{"b", 0}, {"a", 1}, {"b ", 0}, {"", 2}}, "b a "},
    {"numbers without list: as they come",
     "y",
     {{"2.50", 0}, {"-1", 1}, {"2.5", 0}, {"1e3", 2}},
     "2.5 -1 1000"},
    {"no target: texts as they come",
     nullptr,
     {{"2.50", 0}, {"2.5", 1}, {"2.50 ", 0}, {"x", 2}},
     "2.50 2.5 x"},
};

TEST(TargetCategories, AreNumbered) {
  const auto dictionary = Fields();
  for (const FindRow& row : kFinds) {
    TargetCategories categories(row.target == nullptr ? nullptr : dictionary->GetVar(row.target));
    for (const Asked& asked : row.asked)
      EXPECT_EQ(categories.Find(nullptr, asked.text), asked.number) << row.why << ": " << asked.text;
    EXPECT_EQ(All(categories), row.all) << row.why;
  }
}

TEST(TargetCategories, OfAListAreThereFromTheStart) {
  const auto dictionary = Fields();
  EXPECT_EQ(All(TargetCategories(dictionary->GetVar("m"))), "red green blue");
  EXPECT_EQ(TargetCategories(dictionary->GetVar("n")).Get(1).GetType(), ScoreValue::kNumeric);
  EXPECT_EQ(TargetCategories(dictionary->GetVar("t")).GetCount(), 0);
  EXPECT_EQ(TargetCategories(nullptr).GetCount(), 0);
}

struct RefusedRow {
  const char* why;
  const char* target;
  const char* text;
};

constexpr RefusedRow kRefused[] = {
    {"a text that is not listed", "m", "violet"},
    {"a text of another case", "m", "Red"},
    {"the empty text where it is not listed", "m", ""},
    {"a number that is not listed", "n", "4"},
    {"a number that differs from a listed one by more than rounding", "n", "1.0000000001"},
    {"a text where numbers are listed", "n", "one"},
    {"a missing value", "u", "-9"},
    {"a text for a number without list", "y", "much"},
    {"the empty text for a number", "y", ""},
    {"the number that means missing", "y", "-1.7976931348623157e308"},
};

TEST(TargetCategories, RefuseWhatIsNone) {
  const auto dictionary = Fields();
  const auto parsed = kestrel_test::ReadTree("<PMML>\n<Node/></PMML>");
  const xercesc::DOMElement* element = FirstChild(parsed->GetRoot(), u"Node");
  for (const RefusedRow& row : kRefused) {
    TargetCategories categories(dictionary->GetVar(row.target));
    const int count = categories.GetCount();
    try {
      categories.Find(element, row.text);
      ADD_FAILURE() << row.why;
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetErrorCode(), 7) << row.why;
      EXPECT_EQ(fault.GetErrorMessage(), std::string(row.target) + ": invalid value!") << row.why;
      EXPECT_EQ(fault.GetLine(), 2u) << row.why;
    }
    EXPECT_EQ(categories.GetCount(), count) << row.why;
  }
}

}  // namespace
}  // namespace kestrel_tests
