// The operations that make up the reading of splits, each by itself as plug-ins call them.

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreCatStringEncoder.h"
#include "kestrel/dictionary/ValueLabelSet.h"
#include "kestrel/dictionary/ValueLbl.h"
#include "kestrel/predicates/DiscreteSplit.h"
#include "tests/support/PredicateFields.h"
#include "tests/support/PredicateText.h"

namespace {

using kestrel_test::kPredicateFields;
using kestrel_test::ReadDictionary;
using kestrel_test::ReadTree;
using kestrel_test::ReplaceEncoder;
using namespace MCKestrel_800;
using T = PMMLTranslator;

struct IntervalRow {
  const char16_t* operatorText;
  double low, high;
  bool included;
};

constexpr double kInfinity = NumericValue::gInfinity;

constexpr IntervalRow kIntervals[] = {
    {u"greaterThan", 5, kInfinity, false},
    {u"greaterOrEqual", 5, kInfinity, true},
    {u"lessThan", -kInfinity, 5, false},
    {u"lessOrEqual", -kInfinity, 5, true},
    {u"equal", 5, 5, true},
    {u"notEqual", 5, 5, false},
};

TEST(SplitParts, AnOperatorMakesAnInterval) {
  for (const IntervalRow& row : kIntervals) {
    double low = 0.0, high = 0.0;
    bool included = !row.included;
    T::GetScaleSplitValue(nullptr, ToXMLCh(u"5"), ToXMLCh(row.operatorText), low, high, included);
    EXPECT_EQ(low, row.low) << Narrow(ToXMLCh(row.operatorText));
    EXPECT_EQ(high, row.high) << Narrow(ToXMLCh(row.operatorText));
    EXPECT_EQ(included, row.included) << Narrow(ToXMLCh(row.operatorText));
  }
}

struct OrdinalRow {
  const char16_t* operatorText;
  const char16_t* value;
  std::string codes;  ///< the children of the codes 0 to 2
  int start, end;
};

const OrdinalRow kOrdinals[] = {
    {u"greaterThan", u"low", "-77", 1, 2}, {u"greaterOrEqual", u"mid", "-77", 1, 2},
    {u"lessThan", u"high", "77-", 0, 1},   {u"lessOrEqual", u"high", "777", 0, 2},
    {u"equal", u"mid", "-7-", 1, 1},       {u"notEqual", u"mid", "7-7", -1, -1},
};

TEST(SplitParts, AnOrdinalIntervalGoesToItsChild) {
  const auto dictionary = ReadDictionary(kPredicateFields);
  for (const OrdinalRow& row : kOrdinals) {
    const std::string why = Narrow(ToXMLCh(row.operatorText));
    DiscreteSplit split(dictionary->GetVar("size"));
    T::HandleOrdinalVariable(nullptr, dictionary->GetVar("size"), &split, ToXMLCh(row.value),
                             ToXMLCh(row.operatorText), 7);
    std::string codes;
    for (int code = 0; code < 3; ++code)
      codes += split.GetSplitChildIndex(code) == 7 ? '7' : '-';
    EXPECT_EQ(codes, row.codes) << why;
    int start = 0, end = 0;
    split.GetStartAndEndIndex(start, end);
    EXPECT_EQ(start, row.start) << why;
    EXPECT_EQ(end, row.end) << why;
  }
}

TEST(SplitParts, SeveralCategoriesGoToSeveralChildren) {
  const auto dictionary = ReadDictionary(kPredicateFields);
  const ScoreDictVar* col = dictionary->GetVar("col");
  DiscreteSplit split(col);
  T::SetDiscreteSplitValue(nullptr, col, &split, ToXMLCh(u"blue"), 4);
  T::SetDiscreteSplitValue(nullptr, col, &split, ToXMLCh(u"red"), 5);
  T::SetDiscreteSplitValue(nullptr, col, &split, ToXMLCh(u"blue"), 6);
  EXPECT_EQ(split.GetSplitChildIndex(0.0), 5);
  EXPECT_EQ(split.GetSplitChildIndex(1.0), -1);
  EXPECT_EQ(split.GetSplitChildIndex(2.0), 4) << "the first child stays";
}

TEST(SplitParts, WithoutAnEncoderValuesAndPositionsAreEntered) {
  const auto dictionary = ReadDictionary(kPredicateFields);
  ScoreDictVar* nr = dictionary->GetVar("nr");
  ReplaceEncoder(*nr, nullptr);
  DiscreteSplit split(nr);
  T::SetDiscreteSplitValue(nullptr, nr, &split, ToXMLCh(u"1"), 0);
  ASSERT_EQ(split.GetSplitValues().size(), 1u);
  EXPECT_EQ(split.GetSplitValues()[0]->GetDouble(), 1.0);
  EXPECT_NE(split.GetSplitValues()[0], nr->GetValueLabels()->GetAllValueLabels()[1]->GetValue())
      << "a split has values of its own";
  EXPECT_EQ(split.GetSplitChildIndex(1.0), 0) << "1 is the second in the list";
  EXPECT_EQ(split.GetSplitChildIndex(0.0), -1);
}

TEST(SplitParts, AnOrdinalValueHasItsPosition) {
  const auto dictionary = ReadDictionary(kPredicateFields);
  const ScoreDictVar* rank = dictionary->GetVar("rank");
  EXPECT_EQ(T::GetIndexOfOrdinalValue(nullptr, rank, NumericValue(30.0)), 0);
  EXPECT_EQ(T::GetIndexOfOrdinalValue(nullptr, rank, NumericValue(20.0)), 2);
  EXPECT_EQ(T::GetIndexOfOrdinalValue(nullptr, rank, NumericValue(15.0)), -1);
  // An encoder that was filled in another order is no guide to the list's.
  ScoreDictVar* size = dictionary->GetVar("size");
  ReplaceEncoder(*size, new ScoreCatStringEncoder({"high", "mid", "low"}));
  EXPECT_EQ(T::GetIndexOfOrdinalValue(nullptr, size, StringValue("low")), 0);
  EXPECT_EQ(T::GetIndexOfOrdinalValue(nullptr, size, StringValue("high")), 2);
}

struct ValidRow {
  const char* field;
  const char* text;
  bool valid;
};

constexpr ValidRow kValid[] = {
    {"col", "red", true},   {"col", "red ", true},
    {"col", " red", false}, {"col", "Red", false},
    {"col", "", false},     {"col", "none", false},
    {"exact", "a", true},   {"exact", "a ", true},
    {"exact", "b ", false}, {"nr", "3", true},
    {"nr", "3.0", true},    {"nr", "+3e0", true},
    {"nr", " 3", true},     {"nr", "3.0000000000000004", false},
    {"nr", "3x", false},    {"nr", "", false},
    {"nr", "three", false}, {"nr", "-9", false},
    {"rank", "10", true},   {"rank", "15", false},
    {"size", "mid", true},  {"date", "200", true},
    {"date", "201", false},
};

TEST(SplitParts, ATextIsACategoryOrNot) {
  const auto dictionary = ReadDictionary(kPredicateFields);
  for (const bool hasEncoders : {true, false}) {
    for (const ValidRow& row : kValid) {
      EXPECT_EQ(T::IsValidScoreValue(nullptr, dictionary->GetVar(row.field), row.text), row.valid)
          << row.field << " \"" << row.text << "\" " << hasEncoders;
    }
    for (ScoreDictVar* variable : dictionary->GetScoreDictVars())
      ReplaceEncoder(*variable, nullptr);
  }
}

std::string TextsOf(const std::vector<const ScoreValue*>& values) {
  std::string texts;
  for (const ScoreValue* value : values)
    texts += (texts.empty() ? "" : " ") + value->GetString();
  return texts;
}

TEST(SplitParts, RemoveLeavesTheOthersInTheirOrder) {
  const auto dictionary = ReadDictionary(kPredicateFields);
  for (const bool hasEncoders : {true, false}) {
    const auto rest = [&](const char* field, const std::vector<std::string>& toRemove) {
      return TextsOf(T::Remove(nullptr, dictionary->GetVar(field), toRemove));
    };
    EXPECT_EQ(rest("col", {"green"}), "red blue") << hasEncoders;
    EXPECT_EQ(rest("col", {}), "red green blue") << hasEncoders;
    EXPECT_EQ(rest("col", {"blue", "red", "green", "red"}), "") << hasEncoders;
    EXPECT_EQ(rest("nr", {"1.0"}), "3 2") << hasEncoders;
    EXPECT_EQ(rest("exact", {"a "}), "a b") << hasEncoders;
    for (ScoreDictVar* variable : dictionary->GetScoreDictVars())
      ReplaceEncoder(*variable, nullptr);
  }
}

// A program's list may have holes.
TEST(SplitParts, ALabelWithoutValueIsPassedOver) {
  DictVar variable("made", ScoreDictVar::STRING_VAR);
  variable.SetMLevel(ScoreDictVar::kOrdinal);
  auto* labels = new ValueLabelSet;
  labels->Add(new ValueLbl(new StringValue("a"), "A"));
  labels->Add(new ValueLbl(nullptr, "nothing"));
  labels->Add(new ValueLbl(new StringValue("b"), "B"));
  labels->Add(new ValueLbl(new StringValue("a "), "A again"));
  variable.SetValueLabels(labels);
  EXPECT_EQ(T::GetIndexOfOrdinalValue(nullptr, &variable, StringValue("b")), 1);
  EXPECT_EQ(TextsOf(T::Remove(nullptr, &variable, {"a"})), "b");
  DiscreteSplit split(&variable);
  T::HandleOrdinalVariable(nullptr, &variable, &split, ToXMLCh(u"a"), ToXMLCh(u"notEqual"), 0);
  EXPECT_EQ(split.GetSplitChildIndex(2.0), 0) << "the third in the list";
  EXPECT_EQ(split.GetSplitValues().size(), 1u);
}

TEST(SplitParts, ReportWhatTheElementSays) {
  const auto dictionary = ReadDictionary(kPredicateFields);
  const auto tree = ReadTree("<SimplePredicate operator='lessThan' value=' 5'/>");
  std::string operatorText = "before", valueText = "before";
  bool missing = true;
  const std::unique_ptr<ScoreSplitVar> scale(
      T::HandleNodeScaleSplit(tree->GetRoot(), dictionary->GetVar("num"), operatorText, valueText, missing));
  EXPECT_EQ(scale->GetSplitVarType(), ScoreSplitVar::kScale);
  EXPECT_EQ(operatorText, "lessThan");
  EXPECT_EQ(valueText, " 5");
  EXPECT_FALSE(missing);
  const auto absent = ReadTree("<SimplePredicate operator='isMissing'/>");
  const std::unique_ptr<ScoreSplitVar> discrete(T::HandleNodeDiscreteSplit(
      absent->GetRoot(), dictionary->GetVar("col"), operatorText, valueText, missing));
  EXPECT_EQ(discrete->GetSplitVarType(), ScoreSplitVar::kDiscrete);
  EXPECT_EQ(operatorText, "isMissing");
  EXPECT_EQ(valueText, "");
  EXPECT_TRUE(missing);
  const auto set = ReadTree("<a><Array>blue red</Array></a>");
  std::vector<double> values;
  const std::unique_ptr<ScoreSplitVar> ofSet(
      T::HandleArrayDiscreteSplit(set->GetRoot(), dictionary->GetVar("col"), ToXMLCh(u"isNotIn"), values));
  EXPECT_EQ(values, (std::vector<double>{2, 0}));
  EXPECT_EQ(ofSet->GetSplitChildIndex(1.0), 0);
}

}  // namespace
