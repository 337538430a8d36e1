// What a SimplePredicate says of a value: every operator on every kind of field, on records and on flat
// vectors.

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/dictionary/ScoreCatNumericEncoder.h"
#include "kestrel/dictionary/ScoreCatStringEncoder.h"
#include "kestrel/predicates/DiscreteSplit.h"
#include "kestrel/predicates/ScaleSplit.h"
#include "kestrel/predicates/ScoreValueRange.h"
#include "kestrel/predicates/SimplePredicate.h"
#include "tests/support/PredicateFields.h"
#include "tests/support/PredicateText.h"

namespace {

using kestrel_test::Answers;
using kestrel_test::kPredicateFields;
using kestrel_test::ReadIndexedDictionary;
using kestrel_test::ReadPredicate;
using kestrel_test::ReplaceEncoder;
using namespace MCKestrel_800;

/// The probes are values with what is expected: true, false or unknown; "-" is a missing value and "_" a
/// blank.
struct Row {
  const char* why;
  const char* field;
  const char* comparison;
  const char* probes;
};

std::string ElementOf(const Row& row) {
  return std::string("<SimplePredicate field='") + row.field + "' " + row.comparison + "/>";
}

constexpr Row kNumberRows[] = {
    {"equal", "num", "operator='equal' value='5'", "5:T 4.9:F 5.1:F -:U 99:U"},
    {"equal within the tolerance", "num", "operator='equal' value='5'",
     "5.00000000000001:T 4.99999999999999:T 5.0000000000002:F"},
    {"notEqual leaves out the number itself", "num", "operator='notEqual' value='5'",
     "5:F 4.9:T 5.1:T -1e300:T 1e300:T -:U 99:U"},
    {"lessThan", "num", "operator='lessThan' value='5'", "4.9:T 5:F 5.1:F -1e300:T -:U 99:U"},
    {"lessOrEqual", "num", "operator='lessOrEqual' value='5'", "4.9:T 5:T 5.00000000000001:T 5.1:F -:U"},
    {"greaterThan", "num", "operator='greaterThan' value='5'", "4.9:F 5:F 5.1:T 1e300:T -:U 99:U"},
    {"greaterOrEqual", "num", "operator='greaterOrEqual' value='5'",
     "4.9:F 5:T 4.99999999999999:T 5.1:T -:U"},
    {"isMissing", "num", "operator='isMissing'", "5:F 0:F -:T 99:T"},
    {"isNotMissing", "num", "operator='isNotMissing'", "5:T 0:T -1e300:T 1e300:T -:U 99:U"},
    {"equal to the empty text asks whether it is missing", "num", "operator='equal' value=''",
     "5:F 0:F -:T 99:T"},
    {"an absent value is like an empty one", "num", "operator='equal'", "5:F -:T"},
    {"a value that is missing itself", "num", "operator='greaterOrEqual' value='99'", "98:F 100:T 99:U"},
    {"signs, points and exponents", "num", "operator='lessThan' value='-1.5e1'", "-15:F -15.1:T -14:F"},
    {"blanks on one side", "num", "operator='equal' value=' 5'", "5:T 4:F"},
    {"zero has no sign", "num", "operator='equal' value='-0'", "0:T 1e-300:F"},
    {"less than a number beyond all", "num", "operator='lessThan' value='1e999'", "0:T 1e300:T -:U"},
    {"greater than a number beyond all", "num", "operator='greaterThan' value='1e999'", "0:F 1e300:F -:U"},
    {"greater than or equal to a number below all", "num", "operator='greaterOrEqual' value='-1e999'",
     "0:T -1e300:T -:U"},
    {"not equal to a number beyond all", "num", "operator='notEqual' value='1e999'", "0:T 1e300:T -:U"},
    {"equal to a number beyond all", "num", "operator='equal' value='-1e999'", "0:F -1e300:F -:U"},
    {"labels of a continuous field mean nothing", "labelled", "operator='greaterThan' value='1.5'",
     "1:F 2:T 1.7:T -:U"},
};

constexpr Row kCategoryRows[] = {
    // Nominal texts
    {"equal", "col", "operator='equal' value='green'", "green:T red:F blue:F pink:U none:U -:U"},
    {"trailing blanks do not count", "col", "operator='equal' value='green  '", "green:T green_:T red:F"},
    {"notEqual takes every other category", "col", "operator='notEqual' value='green'",
     "red:T green:F blue:T pink:U none:U -:U"},
    {"notEqual to the first category", "col", "operator='notEqual' value='red'", "red:F green:T blue:T"},
    {"notEqual to the last category", "col", "operator='notEqual' value='blue'", "red:T green:T blue:F"},
    {"isMissing", "col", "operator='isMissing'", "red:F blue:F pink:T none:T -:T"},
    {"isNotMissing takes every category", "col", "operator='isNotMissing'",
     "red:T green:T blue:T pink:U -:U"},
    {"equal to the empty text asks whether it is missing", "col", "operator='equal' value=''",
     "red:F blue:F pink:T none:T -:T"},
    {"kept blanks count", "exact", "operator='equal' value='a '", "a_:T a:F b:F a__:U"},
    {"kept blanks count in the others, too", "exact", "operator='notEqual' value='a '", "a_:F a:T b:T -:U"},
    // Nominal numbers
    {"equal to a number", "nr", "operator='equal' value='1'", "1:T 2:F 3:F 4:U -9:U -:U"},
    {"a number is its value, not its text", "nr", "operator='equal' value='+1.0e0'", "1:T 2:F 3:F"},
    {"notEqual to a number", "nr", "operator='notEqual' value='1'", "1:F 2:T 3:T 4:U -:U"},
    {"a missing number category", "nr", "operator='isMissing'", "1:F 3:F 4:T -9:T -:T"},
    {"a number category that is there", "nr", "operator='isNotMissing'", "1:T 3:T 4:U -9:U -:U"},
    // Ordinal texts: a value that is none of the categories is false, not missing
    {"equal in an ordered field", "size", "operator='equal' value='mid'", "low:F mid:T high:F huge:F -:U"},
    {"notEqual in an ordered field", "size", "operator='notEqual' value='mid'",
     "low:T mid:F high:T huge:F -:U"},
    {"lessThan by position", "size", "operator='lessThan' value='high'", "low:T mid:T high:F huge:F -:U"},
    {"lessThan the second", "size", "operator='lessThan' value='mid'", "low:T mid:F high:F"},
    {"lessOrEqual by position", "size", "operator='lessOrEqual' value='mid'",
     "low:T mid:T high:F huge:F -:U"},
    {"lessOrEqual the first", "size", "operator='lessOrEqual' value='low'", "low:T mid:F high:F"},
    {"lessOrEqual the last", "size", "operator='lessOrEqual' value='high'", "low:T mid:T high:T huge:F"},
    {"greaterThan by position", "size", "operator='greaterThan' value='low'",
     "low:F mid:T high:T huge:F -:U"},
    {"greaterThan the last but one", "size", "operator='greaterThan' value='mid'", "low:F mid:F high:T"},
    {"greaterOrEqual by position", "size", "operator='greaterOrEqual' value='mid'",
     "low:F mid:T high:T huge:F -:U"},
    {"greaterOrEqual the first", "size", "operator='greaterOrEqual' value='low'",
     "low:T mid:T high:T huge:F"},
    {"greaterOrEqual the last", "size", "operator='greaterOrEqual' value='high'", "low:F mid:F high:T"},
    {"isMissing in an ordered field", "size", "operator='isMissing'", "low:F high:F huge:F -:T"},
    {"isNotMissing in an ordered field", "size", "operator='isNotMissing'", "low:T high:T huge:F -:U"},
    {"the empty text in an ordered field", "size", "operator='equal' value=''", "low:F high:F huge:F -:T"},
    {"one category and no other", "only", "operator='notEqual' value='x'", "x:F y:F -:U"},
    {"one category up to itself", "only", "operator='lessOrEqual' value='x'", "x:T y:F -:U"},
    // Ordinal numbers, listed as 30, 10, 20
    {"the order is the list's", "rank", "operator='lessThan' value='20'", "30:T 10:T 20:F 15:F -9:U -:U"},
    {"behind the first of the list", "rank", "operator='greaterThan' value='30'", "30:F 10:T 20:T"},
    {"equal to an ordered number", "rank", "operator='equal' value='10'", "30:F 10:T 20:F 15:F -:U"},
    {"notEqual to an ordered number", "rank", "operator='notEqual' value='10'", "30:T 10:F 20:T 15:F -:U"},
    {"ordered dates", "date", "operator='lessOrEqual' value='200'", "100:T 200:T 300:F 150:F -:U"},
    {"a date is a number in its field's unit", "date", "operator='equal' value='300'", "100:F 300:T 400:F"},
};

constexpr Row kOrdinalAsScaleRows[] = {
    {"lessThan by number", "rank", "operator='lessThan' value='20'", "10:T 20:F 30:F 15:T -9:U -:U"},
    {"a number between the categories", "rank", "operator='greaterThan' value='12.5'",
     "10:F 20:T 12.6:T -:U"},
    {"equal by number", "rank", "operator='equal' value='15'", "15:T 10:F -:U"},
    {"notEqual by number", "rank", "operator='notEqual' value='10'", "10:F 15:T 30:T -:U"},
    {"isMissing by number", "rank", "operator='isMissing'", "10:F 15:F -9:T -:T"},
    {"isNotMissing by number", "rank", "operator='isNotMissing'", "10:T 15:T -9:U -:U"},
    {"texts have no numbers", "size", "operator='lessThan' value='high'", "low:T mid:T high:F huge:F -:U"},
};

void ExpectAnswers(const ScoreDictionary& dictionary, const Row& row, bool ordinalAsScale = false) {
  const auto predicate = ReadPredicate(ElementOf(row), dictionary, ordinalAsScale);
  EXPECT_EQ(Answers(*predicate, dictionary, row.field, row.probes, ordinalAsScale), row.probes)
      << row.field << ": " << row.why;
}

TEST(SimplePredicateReader, ComparesNumbers) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (const Row& row : kNumberRows)
    ExpectAnswers(*dictionary, row);
}

TEST(SimplePredicateReader, ComparesCategories) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (const Row& row : kCategoryRows)
    ExpectAnswers(*dictionary, row);
}

TEST(SimplePredicateReader, ComparesOrdinalNumbersAsNumbersWhenAsked) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (const Row& row : kOrdinalAsScaleRows)
    ExpectAnswers(*dictionary, row, true);
}

TEST(SimplePredicateReader, OtherFieldsDoNotMindOrdinalNumbersAsNumbers) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (const Row& row : kNumberRows)
    ExpectAnswers(*dictionary, row, true);
  for (const Row& row : kCategoryRows) {
    if (std::string(row.field) != "rank" && std::string(row.field) != "date") {
      ExpectAnswers(*dictionary, row, true);
    }
  }
}

// Programs make such dictionaries; documents do not.
TEST(SimplePredicateReader, ComparesCategoriesWithoutAnEncoder) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (ScoreDictVar* variable : dictionary->GetScoreDictVars())
    ReplaceEncoder(*variable, nullptr);
  for (const Row& row : kCategoryRows)
    ExpectAnswers(*dictionary, row);
}

TEST(SimplePredicateReader, ComparesCategoriesWhoseEncoderHasAnotherOrder) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (ScoreDictVar* variable : dictionary->GetScoreDictVars()) {
    if (variable->GetMLevel() != ScoreDictVar::kOrdinal) continue;
    const auto& labels = variable->GetValueLabels()->GetAllValueLabels();
    std::unique_ptr<ScoreEncoder> encoder(variable->GetEncoder()->Clone());
    ReplaceEncoder(*variable, variable->GetVarType() == ScoreDictVar::STRING_VAR
                                  ? static_cast<ScoreEncoder*>(new ScoreCatStringEncoder)
                                  : new ScoreCatNumericEncoder);
    for (size_t i = labels.size(); i-- > 0;)
      variable->GetEncoder()->Encode(labels[i]->GetValue());
  }
  for (const Row& row : kCategoryRows)
    ExpectAnswers(*dictionary, row);
}

// A value that is encoded but not listed is no category: the others of "notEqual" do not take it in.
TEST(SimplePredicateReader, LeavesOutWhatAnEncoderKnowsBesideTheList) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  dictionary->GetVar("col")->GetEncoder()->Encode("pink");
  dictionary->GetVar("size")->GetEncoder()->Encode("huge");
  const Row rows[] = {
      {"notEqual", "col", "operator='notEqual' value='red'", "green:T blue:T pink:F red:F -:U"},
      {"isNotMissing", "col", "operator='isNotMissing'", "green:T blue:T pink:F -:U"},
      {"equal", "col", "operator='equal' value='blue'", "green:F blue:T pink:F -:U"},
      {"greaterThan", "size", "operator='greaterThan' value='low'", "low:F mid:T high:T huge:F -:U"},
  };
  for (const Row& row : rows)
    ExpectAnswers(*dictionary, row);
}

TEST(SimplePredicateReader, KeepsTheLongListOfAField) {
  std::string values;
  for (int i = 0; i < 1000; ++i)
    values += "<Value value='c" + std::to_string(i) + "'/>";
  const auto dictionary = ReadIndexedDictionary(kestrel_test::DictionaryOf(
      1, "<DataField name='long' optype='ordinal' dataType='string'>" + values + "</DataField>"));
  const Row rows[] = {
      {"notEqual", "long", "operator='notEqual' value='c500'",
       "c0:T c499:T c500:F c501:T c999:T c1000:F -:U"},
      {"lessThan", "long", "operator='lessThan' value='c500'", "c0:T c499:T c500:F c999:F -:U"},
      {"greaterOrEqual", "long", "operator='greaterOrEqual' value='c500'", "c0:F c499:F c500:T c999:T -:U"},
      {"isNotMissing", "long", "operator='isNotMissing'", "c0:T c999:T c1000:F -:U"},
  };
  for (const Row& row : rows) {
    ExpectAnswers(*dictionary, row);
    const auto predicate = ReadPredicate(ElementOf(row), *dictionary);
    const auto& split = static_cast<const DiscreteSplit&>(*predicate->GetSplit());
    EXPECT_LE(split.GetCodes().GetRuns().size(), 2u) << row.why;
    EXPECT_TRUE(split.GetSplitValues().empty()) << row.why;
  }
}

struct PartsRow {
  const char* why;
  const char* field;
  const char* comparison;
  SimplePredicate::SimplePredOperator meaning;
  const char* text;
  double number;
  bool missing;
  int missvalMap;
  int start, end;  ///< of a discrete split
};

constexpr double kNoNumber = NumericValue::gSysmisValue;

constexpr PartsRow kPartsRows[] = {
    {"a number", "num", "operator='lessThan' value='5.50'", SimplePredicate::kLessThan, "5.50", 5.5, false,
     -1, -1, -1},
    {"isMissing", "num", "operator='isMissing'", SimplePredicate::kIsMissing, "", kNoNumber, true, 0, -1, -1},
    {"isNotMissing", "num", "operator='isNotMissing'", SimplePredicate::kIsNotMissing, "", kNoNumber, false,
     -1, -1, -1},
    {"equal to the empty text", "num", "operator='equal' value=''", SimplePredicate::kEqual, "", kNoNumber,
     true, 0, -1, -1},
    {"a text's number is its code", "col", "operator='notEqual' value='blue'", SimplePredicate::kNotEqual,
     "blue", 2.0, false, -1, -1, -1},
    {"a category's number is its code", "nr", "operator='equal' value='2'", SimplePredicate::kEqual, "2", 2.0,
     false, -1, -1, -1},
    {"isMissing of categories", "col", "operator='isMissing'", SimplePredicate::kIsMissing, "", kNoNumber,
     true, 0, -1, -1},
    {"the empty text of categories", "col", "operator='equal' value=''", SimplePredicate::kEqual, "",
     kNoNumber, true, 0, -1, -1},
    {"isNotMissing of categories", "size", "operator='isNotMissing'", SimplePredicate::kIsNotMissing, "",
     kNoNumber, false, -1, -1, -1},
    {"below", "size", "operator='lessThan' value='high'", SimplePredicate::kLessThan, "high", 2.0, false, -1,
     0, 1},
    {"up to", "size", "operator='lessOrEqual' value='mid'", SimplePredicate::kLessOrEqual, "mid", 1.0, false,
     -1, 0, 1},
    {"above", "size", "operator='greaterThan' value='low'", SimplePredicate::kGreaterThan, "low", 0.0, false,
     -1, 1, 2},
    {"from", "rank", "operator='greaterOrEqual' value='10'", SimplePredicate::kGreaterOrEqual, "10", 1.0,
     false, -1, 1, 2},
    {"all but one are no interval", "size", "operator='notEqual' value='mid'", SimplePredicate::kNotEqual,
     "mid", 1.0, false, -1, -1, -1},
};

TEST(SimplePredicateReader, KeepsOperatorAndValue) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (const PartsRow& row : kPartsRows) {
    const auto predicate = ReadPredicate(ElementOf({row.why, row.field, row.comparison, ""}), *dictionary);
    ASSERT_EQ(predicate->GetPredType(), ScorePredicate::kSimple) << row.why;
    const auto& simple = static_cast<const SimplePredicate&>(*predicate);
    EXPECT_EQ(simple.GetPredicateOperator(), row.meaning) << row.why;
    EXPECT_EQ(simple.GetPredValueByString(), row.text) << row.why;
    EXPECT_EQ(simple.GetPredValueByDouble(), row.number) << row.why;
    EXPECT_EQ(simple.IsMissingValue(), row.missing) << row.why;
    EXPECT_EQ(simple.GetSplit()->GetMissvalMap(), row.missvalMap) << row.why;
    EXPECT_EQ(simple.GetSplit()->GetSplitVar(), dictionary->GetVar(row.field)) << row.why;
    int start = -1, end = -1;
    if (simple.GetSplit()->GetSplitVarType() == ScoreSplitVar::kDiscrete) {
      static_cast<const DiscreteSplit&>(*simple.GetSplit()).GetStartAndEndIndex(start, end);
    }
    EXPECT_EQ(start, row.start) << row.why;
    EXPECT_EQ(end, row.end) << row.why;
  }
}

// An encoder that learned a text from a predicate would change what a case with that value is.
TEST(SimplePredicateReader, TeachesTheEncoderNothing) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (const bool ordinalAsScale : {false, true}) {
    for (const char* element : {"<SimplePredicate field='col' operator='isMissing'/>",
                                "<SimplePredicate field='col' operator='isNotMissing'/>",
                                "<SimplePredicate field='col' operator='equal' value=''/>",
                                "<SimplePredicate field='nr' operator='isMissing'/>",
                                "<SimplePredicate field='size' operator='equal' value='mid  '/>",
                                "<SimplePredicate field='date' operator='lessThan' value='200'/>",
                                "<SimplePredicate field='rank' operator='equal' value='20.0'/>"}) {
      ReadPredicate(element, *dictionary, ordinalAsScale);
    }
  }
  ReadPredicate("<SimplePredicate field='rank' operator='lessThan' value='12.5'/>", *dictionary, true);
  for (const ScoreDictVar* variable : dictionary->GetScoreDictVars()) {
    if (variable->GetEncoder() == nullptr) continue;
    EXPECT_EQ(variable->GetEncoder()->GetNumberOfCategories(), variable->GetNumberOfCats())
        << variable->GetName();
  }
}

TEST(SimplePredicateReader, KeepsATextThatIsNoCategory) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  const auto between =
      ReadPredicate("<SimplePredicate field='rank' operator='lessThan' value='12.5'/>", *dictionary, true);
  EXPECT_EQ(static_cast<const SimplePredicate&>(*between).GetPredValueByString(), "12.5");
  EXPECT_EQ(static_cast<const SimplePredicate&>(*between).GetPredValueByDouble(), 12.5);
  EXPECT_EQ(between->GetSplit()->GetSplitName(), "rank");
  const auto date =
      ReadPredicate("<SimplePredicate field='date' operator='equal' value='200'/>", *dictionary);
  EXPECT_EQ(static_cast<const SimplePredicate&>(*date).GetPredValueByString(), "200");
  EXPECT_EQ(date->GetSplit()->GetSplitName(), "date");
}

TEST(SimplePredicateReader, MakesRangesAsTheOperatorSays) {
  const double infinity = NumericValue::GetInfinity();
  struct RangeRow {
    const char* comparison;
    size_t count;
    double low, high;
    bool lowEnd, highEnd;
  };
  const RangeRow rows[] = {
      {"operator='equal' value='5'", 1, 5, 5, true, true},
      {"operator='notEqual' value='5'", 2, -infinity, 5, false, false},
      {"operator='lessThan' value='5'", 1, -infinity, 5, false, false},
      {"operator='lessOrEqual' value='5'", 1, -infinity, 5, false, true},
      {"operator='greaterThan' value='5'", 1, 5, infinity, false, false},
      {"operator='greaterOrEqual' value='5'", 1, 5, infinity, true, false},
      {"operator='greaterOrEqual' value='-1e999'", 1, -infinity, infinity, false, false},
      {"operator='isNotMissing'", 1, -infinity, infinity, false, false},
      {"operator='isMissing'", 0, 0, 0, false, false},
  };
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (const RangeRow& row : rows) {
    const auto predicate = ReadPredicate(ElementOf({"", "num", row.comparison, ""}), *dictionary);
    ASSERT_EQ(predicate->GetSplit()->GetSplitVarType(), ScoreSplitVar::kScale) << row.comparison;
    const auto& split = static_cast<const ScaleSplit&>(*predicate->GetSplit());
    ASSERT_EQ(split.GetRangeCount(), row.count) << row.comparison;
    if (row.count == 0) continue;
    const ScoreValueRange& range = *split.GetSplitValueRangeForIndex(0);
    EXPECT_EQ(range.GetMin()->GetDouble(), row.low) << row.comparison;
    EXPECT_EQ(range.GetMax()->GetDouble(), row.high) << row.comparison;
    EXPECT_EQ(range.GetLowEnd(), row.lowEnd) << row.comparison;
    EXPECT_EQ(range.GetHighEnd(), row.highEnd) << row.comparison;
    if (row.count == 1) continue;
    EXPECT_EQ(split.GetRange(1).GetMin()->GetDouble(), 5) << row.comparison;
    EXPECT_EQ(split.GetRange(1).GetMax()->GetDouble(), infinity) << row.comparison;
    EXPECT_FALSE(split.GetRange(1).GetLowEnd()) << row.comparison;
  }
}

TEST(SimplePredicateReader, LooksFieldsUpInTheDerivedDictionaryToo) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  BaseDictionary derived;
  derived.AddVar("made", new DictVar("made", ScoreDictVar::kNUMERIC_VAR));
  derived.AddVar("num", new DictVar("num", ScoreDictVar::kNUMERIC_VAR));
  const auto own = ReadPredicate("<SimplePredicate field='made' operator='lessThan' value='5'/>", *dictionary,
                                 false, &derived);
  EXPECT_EQ(own->GetSplit()->GetSplitVar(), derived.GetVar("made"));
  const auto both = ReadPredicate("<SimplePredicate field='num' operator='lessThan' value='5'/>", *dictionary,
                                  false, &derived);
  EXPECT_EQ(both->GetSplit()->GetSplitVar(), dictionary->GetVar("num")) << "the data field comes first";
  CaseRecord record;
  record.Add("made", new NumericValue(4.0));
  EXPECT_EQ(own->Evaluate(&record, nullptr), ScorePredicate::PredTrue);
}

}  // namespace
