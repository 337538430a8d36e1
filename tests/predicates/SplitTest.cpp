#include <gtest/gtest.h>

#include <cmath>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/predicates/DiscreteSplit.h"
#include "kestrel/predicates/ScaleSplit.h"
#include "tests/predicates/TestPredicates.h"
#include "tests/support/CommaLocale.h"

namespace MCKestrel_800 {
namespace {

TEST(SplitVar, ForwardsToItsVariable) {
  const auto color = MakeColor(ScoreDictVar::kNominal, false);
  const auto age = MakeAge();
  ScaleSplit split(color.get());
  EXPECT_EQ(split.GetSplitVar(), color.get());
  EXPECT_EQ(split.GetSplitName(), "color");
  EXPECT_EQ(split.GetSplitLabel(), "Color");
  EXPECT_EQ(split.GetSplitType(), 1);
  EXPECT_EQ(split.GetSplitMLevel(), 2);
  split.SetSplitVar(age.get());
  EXPECT_EQ(split.GetSplitVar(), age.get());
  EXPECT_EQ(split.GetSplitName(), "age");
  EXPECT_EQ(split.GetSplitLabel(), "Age in years");
  EXPECT_EQ(split.GetSplitType(), 0);
  EXPECT_EQ(split.GetSplitMLevel(), 0);
}

TEST(SplitVar, WithoutAVariableTellsNothing) {
  const StringValue red("red");
  const NumericValue one(1), missing;
  DiscreteSplit discrete;
  discrete.PutSplit(new StringValue("red"), 3);
  discrete.PutSplit(1.0, 4);
  ScaleSplit scale;
  scale.PutSplit(new Range(0.0, 2.0, true, true), 5);
  for (const ScoreSplitVar* split :
       {static_cast<const ScoreSplitVar*>(&discrete), static_cast<const ScoreSplitVar*>(&scale)}) {
    EXPECT_EQ(split->GetSplitVar(), nullptr);
    EXPECT_EQ(split->GetSplitName(), "");
    EXPECT_EQ(split->GetSplitLabel(), "");
    EXPECT_EQ(split->GetSplitType(), -1);
    EXPECT_EQ(split->GetSplitMLevel(), -1);
    EXPECT_EQ(split->GetMissvalMap(), -1);
  }
  EXPECT_EQ(discrete.GetSplitChildIndex(&red), 3);
  EXPECT_EQ(discrete.GetSplitChildIndex(1.0), 4);
  EXPECT_EQ(scale.GetSplitChildIndex(&one), 5);
  EXPECT_EQ(scale.GetSplitChildIndex(&missing), -1);
  EXPECT_EQ(DisplayOf(discrete),
            "SplitVarName = ; Var type: Ordinal\nMissing Value index: -1\nValue = red; Index = 3\n\n");
}

TEST(SplitVar, KnowsItsKind) {
  EXPECT_EQ(ScaleSplit().GetSplitVarType(), 0);
  EXPECT_EQ(DiscreteSplit().GetSplitVarType(), 1);
}

TEST(DiscreteSplit, FindsValues) {
  struct Row {
    const char* why;
    bool isText, noSpaceTrim;
    std::shared_ptr<ScoreValue> value;
    int child;
  };
  const auto text = [](const char* t) { return std::make_shared<StringValue>(t); };
  const auto number = [](double x) { return std::make_shared<NumericValue>(x); };
  const Row kRows[] = {
      {"null is missing", true, false, nullptr, 9},
      {"a text", true, false, text("red"), 0},
      {"trailing blanks do not count", true, false, text("red  "), 0},
      {"unless the variable says so", true, true, text("red  "), -1},
      {"then the exact text is found", true, true, text("red "), 2},
      {"the first equal one wins", true, false, text("red "), 0},
      {"leading blanks count", true, false, text(" red"), -1},
      {"case counts", true, false, text("Red"), -1},
      {"the empty text is compared like any other", true, false, text(""), -1},
      {"what the variable calls missing is compared like any other", true, false, text("none"), 3},
      {"a number is no text", true, false, number(1), -1},
      {"a number", false, false, number(1), 4},
      {"within the tolerance", false, false, number(1 + 1e-15), 4},
      {"beyond the tolerance", false, false, number(1 + 1e-13), -1},
      {"the missing number is compared like any other", false, false, number(kSysmis), 5},
      {"a text among numbers", false, false, text("1"), -1},
      {"null among numbers", false, false, nullptr, 9},
  };
  for (const Row& row : kRows) {
    const auto variable = row.isText ? MakeColor(ScoreDictVar::kNominal, false) : MakeAge();
    variable->SetNoSpaceTrim(row.noSpaceTrim);
    DiscreteSplit split(variable.get());
    split.SetMissvalMap(9);
    if (row.isText) {
      split.PutSplit(new StringValue("red"), 0);
      split.PutSplit(new StringValue("blue"), 1);
      split.PutSplit(new StringValue("red "), 2);
      split.PutSplit(new StringValue("none"), 3);
    } else {
      split.PutSplit(new NumericValue(1), 4);
      split.PutSplit(new NumericValue(), 5);
    }
    EXPECT_EQ(split.GetSplitChildIndex(row.value.get()), row.child) << row.why;
  }
}

TEST(DiscreteSplit, FindsCodes) {
  struct Row {
    const char* why;
    ScoreDictVar::MeasureLevel level;
    double x;
    int child;
  };
  const Row kRows[] = {
      {"a code", ScoreDictVar::kNominal, 2, 1},
      {"a code of a run", ScoreDictVar::kNominal, 11, 2},
      {"an unknown code", ScoreDictVar::kNominal, 5, -1},
      {"no whole code", ScoreDictVar::kNominal, 2.0000001, -1},
      {"a negative code of a nominal variable is missing", ScoreDictVar::kNominal, -1, 9},
      {"any negative one, though it is mapped", ScoreDictVar::kNominal, -2, 9},
      {"minus zero is not negative", ScoreDictVar::kNominal, -0.0, 0},
      {"a negative code of an ordinal variable is a code", ScoreDictVar::kOrdinal, -2, 3},
      {"and may be unknown", ScoreDictVar::kOrdinal, -1, -1},
      {"a number of a continuous variable", ScoreDictVar::kContinuous, -2, 3},
      {"the missing number is no code", ScoreDictVar::kContinuous, kSysmis, -1},
      {"NaN", ScoreDictVar::kNominal, std::nan(""), -1},
  };
  for (const Row& row : kRows) {
    const auto variable = MakeColor(row.level, false);
    DiscreteSplit split(variable.get());
    split.SetMissvalMap(9);
    split.PutSplit(0.0, 0);
    split.PutSplit(2.0, 1);
    split.PutSplit(2.0, 8);
    split.PutSplit(-2.0, 3);
    split.PutCodes(10, 12, 2);
    EXPECT_EQ(split.GetSplitChildIndex(row.x), row.child) << row.why;
  }
}

TEST(DiscreteSplit, ListsItsValues) {
  DiscreteSplit split;
  EXPECT_TRUE(split.GetSplitValues().empty());
  EXPECT_TRUE(split.GetSplitValuesFirst().empty());
  EXPECT_TRUE(split.GetSplitValuesForIndex(0).empty());
  auto *const a = new StringValue("a"), *const b = new StringValue("b"), *const c = new StringValue("c");
  split.PutSplit(a, 0);
  split.PutSplit(b, 1);
  split.PutSplit(static_cast<ScoreValue*>(nullptr), 1);
  split.PutSplit(c, 0);
  EXPECT_EQ(split.GetSplitValues(), (std::vector<ScoreValue*>{a, b, c})) << "null is refused";
  EXPECT_EQ(split.GetSplitValuesFirst(), std::vector<ScoreValue*>{a});
  EXPECT_EQ(split.GetSplitValuesForIndex(0), (std::vector<ScoreValue*>{a, c}));
  EXPECT_EQ(split.GetSplitValuesForIndex(1), std::vector<ScoreValue*>{b});
  EXPECT_TRUE(split.GetSplitValuesForIndex(2).empty());
}

TEST(DiscreteSplit, KeepsTheBoundsOfItsCategories) {
  DiscreteSplit split;
  int start = 5, end = 5;
  split.GetStartAndEndIndex(start, end);
  EXPECT_EQ(std::make_pair(start, end), std::make_pair(-1, -1));
  split.SetStartAndEndIndex(2, 4);
  split.GetStartAndEndIndex(start, end);
  EXPECT_EQ(std::make_pair(start, end), std::make_pair(2, 4));
}

TEST(DiscreteSplit, CopiesDeeply) {
  const auto color = MakeColor(ScoreDictVar::kNominal, false);
  auto split = Red(color.get(), 7);
  split->SetStartAndEndIndex(1, 2);
  const DiscreteSplit copy(*split);
  const std::unique_ptr<DiscreteSplit> clone(split->Clone());
  DiscreteSplit assigned;
  assigned.PutSplit(new StringValue("x"), 0);
  assigned = *split;
  DiscreteSplit& self = assigned;
  assigned = self;
  const std::string shown = DisplayOf(*split);
  const ScoreValue* const held = split->GetSplitValues()[0];
  split.reset();
  const StringValue red("red");
  for (const DiscreteSplit* other :
       {&copy, const_cast<const DiscreteSplit*>(clone.get()), const_cast<const DiscreteSplit*>(&assigned)}) {
    EXPECT_EQ(DisplayOf(*other), shown);
    EXPECT_NE(other->GetSplitValues()[0], held);
    EXPECT_EQ(other->GetSplitVar(), color.get());
    EXPECT_EQ(other->GetMissvalMap(), 7);
    EXPECT_EQ(other->GetSplitChildIndex(&red), 0);
    EXPECT_EQ(other->GetSplitChildIndex(0.0), 0);
    EXPECT_EQ(other->GetSplitChildIndex(1.0), -1);
  }
}

TEST(DiscreteSplit, Displays) {
  const auto color = MakeColor(ScoreDictVar::kNominal, false);
  auto split = Red(color.get());
  split->PutSplit(new NumericValue(1234.5), 1000);
  EXPECT_EQ(DisplayOf(*split),
            "SplitVarName = color; Var type: Categorical\n"
            "Missing Value index: -1\n"
            "Value = red; Index = 0\n"
            "Value = 1234.5; Index = 1000\n"
            "\n");
  color->SetMLevel(ScoreDictVar::kOrdinal);
  split->SetMissvalMap(2000);
  split->SetStartAndEndIndex(0, 3000);
  const kestrel_tests::CommaLocale comma;
  EXPECT_EQ(DisplayOf(*split),
            "SplitVarName = color; Var type: Ordinal\n"
            "Missing Value index: 2000\n"
            "Split value index starts from  0 to 3000\n"
            "Value = red; Index = 0\n"
            "Value = 1234.5; Index = 1000\n"
            "\n");
  for (const auto& [start, end] : {std::make_pair(0, -1), std::make_pair(-1, 0)}) {
    split->SetStartAndEndIndex(start, end);
    EXPECT_EQ(DisplayOf(*split).find("Split value index"), std::string::npos) << "both have to be there";
  }
}

TEST(ScaleSplit, FindsNumbersAndValues) {
  struct Row {
    const char* why;
    double x;
    int byNumber, byValue;
  };
  const Row kRows[] = {
      {"in the first range", 5, 0, 0},
      {"the first of two wins", 15, 0, 0},
      {"in the second alone", 25, 1, 1},
      {"an end that is not included", 30, -1, -1},
      {"an end that is included, within the tolerance", 20 * (1 + 1e-15), 0, 0},
      {"beyond the tolerance", 20 * (1 + 1e-13), 1, 1},
      {"in none", 40, -1, -1},
      {"a single value", 50, 2, 2},
      {"the missing number", kSysmis, 9, 9},
      {"what the variable calls missing is known of values alone", 99, 3, 9},
      {"NaN", std::nan(""), -1, -1},
      {"infinity", kInfinity, -1, -1},
  };
  const auto age = MakeAge();
  ScaleSplit split(age.get());
  split.SetMissvalMap(9);
  split.PutSplit(new Range(0.0, 20.0, true, true), 0);
  split.PutSplit(new Range(10.0, 30.0, true, false), 1);
  split.PutSplit(new Range(new NumericValue(50)), 2);
  split.PutSplit(new Range(90.0, kInfinity, false, false), 3);
  for (const Row& row : kRows) {
    EXPECT_EQ(split.GetSplitChildIndex(row.x), row.byNumber) << row.why;
    const NumericValue value(row.x);
    EXPECT_EQ(split.GetSplitChildIndex(&value), row.byValue) << row.why;
  }
  EXPECT_EQ(split.GetSplitChildIndex(static_cast<const ScoreValue*>(nullptr)), 9);
  const StringValue text("5");
  EXPECT_EQ(split.GetSplitChildIndex(&text), -1);
}

TEST(Splits, WithoutEntriesSendMissingValuesAlone) {
  const auto age = MakeAge();
  const auto color = MakeColor(ScoreDictVar::kNominal, false);
  ScaleSplit scale(age.get());
  DiscreteSplit discrete(color.get());
  const NumericValue five(5), missing(99);
  const StringValue red("red");
  const ScoreValue* const absent = nullptr;
  for (const int child : {-1, 4}) {
    scale.SetMissvalMap(child);
    discrete.SetMissvalMap(child);
    EXPECT_EQ(scale.GetSplitChildIndex(&five), -1);
    EXPECT_EQ(scale.GetSplitChildIndex(5.0), -1);
    EXPECT_EQ(scale.GetSplitChildIndex(&missing), child);
    EXPECT_EQ(scale.GetSplitChildIndex(absent), child);
    EXPECT_EQ(scale.GetSplitChildIndex(kSysmis), child);
    EXPECT_EQ(discrete.GetSplitChildIndex(&red), -1);
    EXPECT_EQ(discrete.GetSplitChildIndex(0.0), -1);
    EXPECT_EQ(discrete.GetSplitChildIndex(absent), child);
    EXPECT_EQ(discrete.GetSplitChildIndex(-2.0), child);
  }
}

TEST(ScaleSplit, ListsItsRanges) {
  ScaleSplit split;
  EXPECT_EQ(split.GetSplitValueRangeFirst(), nullptr);
  EXPECT_EQ(split.GetSplitValueRangeForIndex(0), nullptr);
  EXPECT_EQ(split.GetRangeCount(), 0u);
  auto *const a = new Range(0.0, 1.0, true, true), *const b = new Range(1.0, 2.0, true, true),
              *const c = new Range(2.0, 3.0, true, true);
  split.PutSplit(a, 5);
  split.PutSplit(static_cast<ScoreValueRange*>(nullptr), 5);
  split.PutSplit(b, 6);
  split.PutSplit(c, 6);
  EXPECT_EQ(split.GetSplitValueRangeFirst(), a);
  EXPECT_EQ(split.GetSplitValueRangeForIndex(5), a);
  EXPECT_EQ(split.GetSplitValueRangeForIndex(6), b) << "the first of a child";
  EXPECT_EQ(split.GetSplitValueRangeForIndex(7), nullptr);
  ASSERT_EQ(split.GetRangeCount(), 3u) << "null is refused";
  EXPECT_EQ(&split.GetRange(2), c);
}

TEST(ScaleSplit, CopiesDeeply) {
  const auto age = MakeAge();
  auto split = Below(age.get(), 18, 7);
  const ScaleSplit copy(*split);
  const std::unique_ptr<ScaleSplit> clone(split->Clone());
  ScaleSplit assigned;
  assigned.PutSplit(new Range(0.0, 1.0, true, true), 0);
  assigned = *split;
  ScaleSplit& self = assigned;
  assigned = self;
  const std::string shown = DisplayOf(*split);
  const ScoreValueRange* const held = split->GetSplitValueRangeFirst();
  split.reset();
  for (const ScaleSplit* other :
       {&copy, const_cast<const ScaleSplit*>(clone.get()), const_cast<const ScaleSplit*>(&assigned)}) {
    EXPECT_EQ(DisplayOf(*other), shown);
    EXPECT_NE(other->GetSplitValueRangeFirst(), held);
    EXPECT_EQ(other->GetSplitVar(), age.get());
    EXPECT_EQ(other->GetMissvalMap(), 7);
    EXPECT_EQ(other->GetSplitChildIndex(17.0), 0);
    EXPECT_EQ(other->GetSplitChildIndex(18.0), -1);
  }
}

TEST(ScaleSplit, Displays) {
  const auto age = MakeAge();
  ScaleSplit split(age.get());
  split.SetMissvalMap(1000);
  EXPECT_EQ(DisplayOf(split), "SplitVarName = age\nMissing Value index: 1000\n\n");
  split.PutSplit(new Range(0.0, 10.5, true, false), 2000);
  split.PutSplit(new Range(new NumericValue(20)), 1);
  const kestrel_tests::CommaLocale comma;
  EXPECT_EQ(DisplayOf(split),
            "SplitVarName = age\n"
            "Missing Value index: 1000\n"
            "Index = 2000\n"
            "  Start Range Display   \n"
            "MinValue: 0;  MaxValue: 10.5; High End not included; lower End included\n"
            " End of Range Display\n\n"
            "Index = 1\n"
            "  Start Range Display   \n"
            "MinValue: 20;  MaxValue: 20; High End included; lower End included\n"
            " End of Range Display\n\n"
            "\n");
}

}  // namespace
}  // namespace MCKestrel_800
