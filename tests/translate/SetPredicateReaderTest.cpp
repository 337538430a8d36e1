// What a SimpleSetPredicate says of a value.

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/dictionary/ValueLabelSet.h"
#include "kestrel/predicates/DiscreteSplit.h"
#include "kestrel/predicates/SetPredicate.h"
#include "tests/support/PredicateFields.h"
#include "tests/support/PredicateText.h"

namespace {

using kestrel_test::Answers;
using kestrel_test::kPredicateFields;
using kestrel_test::ReadIndexedDictionary;
using kestrel_test::ReadPredicate;
using kestrel_test::ReplaceEncoder;
using namespace MCKestrel_800;

struct Row {
  const char* why;
  const char* field;
  const char* meaning;
  const char* array;
  const char* probes;
  std::vector<double> values;  ///< of a field with an encoder: the codes
};

const Row kRows[] = {
    {"isIn",
     "col",
     "isIn",
     "<Array n='2' type='string'>red blue</Array>",
     "red:T green:F blue:T pink:U none:U -:U",
     {0, 2}},
    {"isNotIn",
     "col",
     "isNotIn",
     "<Array n='2' type='string'>red blue</Array>",
     "red:F green:T blue:F pink:U none:U -:U",
     {0, 2}},
    {"isNotIn of the middle",
     "col",
     "isNotIn",
     "<Array type='string'>green</Array>",
     "red:T green:F blue:T",
     {1}},
    {"isNotIn of all",
     "col",
     "isNotIn",
     "<Array type='string'>blue red green</Array>",
     "red:F green:F blue:F -:U",
     {2, 0, 1}},
    {"isIn of all",
     "col",
     "isIn",
     "<Array type='string'>blue red green</Array>",
     "red:T green:T blue:T -:U",
     {2, 0, 1}},
    {"values may be repeated",
     "col",
     "isIn",
     "<Array n='3'>red red blue</Array>",
     "red:T green:F blue:T",
     {0, 0, 2}},
    {"repeated values of the others",
     "col",
     "isNotIn",
     "<Array n='3'>red red blue</Array>",
     "red:F green:T blue:F",
     {0, 0, 2}},
    {"trailing blanks do not count", "col", "isIn", "<Array>\"red  \"</Array>", "red:T green:F", {0}},
    {"kept blanks count", "exact", "isIn", "<Array>\"a \" b</Array>", "a_:T a:F b:T -:U", {1, 2}},
    {"kept blanks count in the others",
     "exact",
     "isNotIn",
     "<Array>\"a \" b</Array>",
     "a_:F a:T b:F -:U",
     {1, 2}},
    {"whole numbers",
     "nr",
     "isIn",
     "<Array n='2' type='int'>1 +2</Array>",
     "1:T 2:T 3:F 4:U -9:U -:U",
     {1, 2}},
    {"numbers as numbers", "nr", "isIn", "<Array type='real'>1.0 2e0</Array>", "1:T 2:T 3:F", {1, 2}},
    {"numbers as texts", "nr", "isNotIn", "<Array type='string'>1 \"2\"</Array>", "1:F 2:F 3:T", {1, 2}},
    {"an array without type", "nr", "isIn", "<Array>3</Array>", "1:F 2:F 3:T", {0}},
    {"ordered texts", "size", "isIn", "<Array>high low</Array>", "low:T mid:F high:T huge:F -:U", {2, 0}},
    {"ordered texts, the others",
     "size",
     "isNotIn",
     "<Array>high low</Array>",
     "low:F mid:T high:F huge:F -:U",
     {2, 0}},
    {"ordered numbers",
     "rank",
     "isNotIn",
     "<Array type='real'>20 10.0</Array>",
     "30:T 10:F 20:F 15:F -9:U -:U",
     {2, 1}},
    {"dates in their field's unit",
     "date",
     "isIn",
     "<Array type='int'>100 300</Array>",
     "100:T 200:F 300:T -:U",
     {0, 2}},
    {"the first array counts",
     "col",
     "isIn",
     "<Extension/><Array>red</Array><Array>blue</Array>",
     "red:T blue:F",
     {0}},
};

std::string ElementOf(const Row& row) {
  return std::string("<SimpleSetPredicate field='") + row.field + "' booleanOperator='" + row.meaning + "'>" +
         row.array + "</SimpleSetPredicate>";
}

TEST(SetPredicateReader, TellsWhatIsInASet) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (const Row& row : kRows) {
    const auto predicate = ReadPredicate(ElementOf(row), *dictionary);
    EXPECT_EQ(Answers(*predicate, *dictionary, row.field, row.probes), row.probes) << row.why;
    ASSERT_EQ(predicate->GetPredType(), ScorePredicate::kSet) << row.why;
    const auto& set = static_cast<const SetPredicate&>(*predicate);
    EXPECT_EQ(set.GetArrayData(), row.values) << row.why;
    EXPECT_EQ(set.GetPredicateOperator() == SetPredicate::kIsIn, std::string(row.meaning) == "isIn")
        << row.why;
    EXPECT_EQ(set.GetSplit()->GetSplitVar(), dictionary->GetVar(row.field)) << row.why;
    EXPECT_EQ(set.GetSplit()->GetMissvalMap(), -1) << row.why;
  }
}

TEST(SetPredicateReader, TellsItWithoutAnEncoder) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (ScoreDictVar* variable : dictionary->GetScoreDictVars())
    ReplaceEncoder(*variable, nullptr);
  for (const Row& row : kRows) {
    const auto predicate = ReadPredicate(ElementOf(row), *dictionary);
    EXPECT_EQ(Answers(*predicate, *dictionary, row.field, row.probes), row.probes) << row.why;
  }
}

TEST(SetPredicateReader, TellsItBesideOtherCodesOfTheEncoder) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (ScoreDictVar* variable : dictionary->GetScoreDictVars()) {
    if (variable->GetEncoder() != nullptr) variable->GetEncoder()->Encode("123456");
  }
  for (const Row& row : kRows) {
    const auto predicate = ReadPredicate(ElementOf(row), *dictionary);
    EXPECT_EQ(Answers(*predicate, *dictionary, row.field, row.probes), row.probes) << row.why;
    EXPECT_EQ(static_cast<const SetPredicate&>(*predicate).GetArrayData(), row.values) << row.why;
  }
}

TEST(SetPredicateReader, KeepsTheNumbersOfAFieldWithoutEncoder) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  ReplaceEncoder(*dictionary->GetVar("nr"), nullptr);
  const auto predicate = ReadPredicate(
      "<SimpleSetPredicate field='nr' booleanOperator='isIn'><Array>3 1</Array></SimpleSetPredicate>",
      *dictionary);
  EXPECT_EQ(static_cast<const SetPredicate&>(*predicate).GetArrayData(), (std::vector<double>{3, 1}));
}

// Two infinite categories are not found equal when the dictionary is read; they have one code.
TEST(SetPredicateReader, TakesAListWithInfiniteCategories) {
  const auto dictionary = ReadIndexedDictionary(kestrel_test::DictionaryOf(
      1,
      "<DataField name='x' optype='ordinal' dataType='double'><Value value='1e999'/><Value value='1'/>"
      "<Value value='1e999'/><Value value='2'/></DataField>"));
  const auto others = ReadPredicate(
      "<SimpleSetPredicate field='x' booleanOperator='isNotIn'><Array>1e999</Array></SimpleSetPredicate>",
      *dictionary);
  EXPECT_EQ(Answers(*others, *dictionary, "x", "1:T 2:T inf:F 3:F -:U"), "1:T 2:T inf:F 3:F -:U");
  const auto behind =
      ReadPredicate("<SimplePredicate field='x' operator='greaterThan' value='1'/>", *dictionary);
  EXPECT_EQ(Answers(*behind, *dictionary, "x", "1:F 2:T inf:F -:U"), "1:F 2:T inf:F -:U");
}

TEST(SetPredicateReader, LooksFieldsUpInTheDerivedDictionaryToo) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  BaseDictionary derived;
  derived.AddVar("colour", dictionary->GetVar("col")->Clone());
  const auto predicate = ReadPredicate(
      "<SimpleSetPredicate field='colour' booleanOperator='isIn'><Array>red</Array></SimpleSetPredicate>",
      *dictionary, false, &derived);
  EXPECT_EQ(predicate->GetSplit()->GetSplitVar(), derived.GetVar("colour"));
}

// The set lies in shuffled order over a long list: codes become few runs, whatever their order.
TEST(SetPredicateReader, KeepsALongSetAsRuns) {
  constexpr int kCategories = 5000;
  std::string values, array;
  for (int i = 0; i < kCategories; ++i) {
    values += "<Value value='c" + std::to_string(i) + "'/>";
    const int shuffled = i * 2503 % kCategories;
    if (shuffled != 1234) array += "c" + std::to_string(shuffled) + (i % 10 == 0 ? " \n" : " ");
  }
  const auto dictionary = ReadIndexedDictionary(kestrel_test::DictionaryOf(
      1, "<DataField name='x' optype='categorical' dataType='string'>" + values + "</DataField>"));
  for (const bool isIn : {true, false}) {
    const auto predicate = ReadPredicate(
        std::string("<SimpleSetPredicate field='x' booleanOperator='") + (isIn ? "isIn" : "isNotIn") +
            "'><Array n='4999' type='string'>" + array + "</Array></SimpleSetPredicate>",
        *dictionary);
    const auto& split = static_cast<const DiscreteSplit&>(*predicate->GetSplit());
    EXPECT_EQ(split.GetCodes().GetRuns().size(), isIn ? 2u : 1u);
    const char* probes = isIn ? "c0:T c1233:T c1234:F c1235:T c4999:T c5000:U"
                              : "c0:F c1233:F c1234:T c1235:F c4999:F c5000:U";
    EXPECT_EQ(Answers(*predicate, *dictionary, "x", probes), probes);
  }
}

}  // namespace
