#include "kestrel/dictionary/MissingValueSet.h"

#include <gtest/gtest.h>

#include <memory>

#include "tests/dictionary/TestValues.h"

namespace MCKestrel_800 {
namespace {

TEST(MissingValueSet, RefusesNullAndEqualRangesWithoutDeletingThem) {
  MissingValueSet set;
  EXPECT_FALSE(set.Add(nullptr));
  EXPECT_TRUE(set.Add(NewSingle(9)));
  EXPECT_TRUE(set.Add(new Range(1, 5, true, false)));
  const std::unique_ptr<Range> single(NewSingle(9));
  const std::unique_ptr<Range> interval(new Range(1, 5, true, false));
  EXPECT_FALSE(set.Add(single.get()));
  EXPECT_FALSE(set.Add(interval.get()));
  EXPECT_EQ(set.Size(), 2u);
  // Another inclusion of an end makes another range.
  EXPECT_TRUE(set.Add(new Range(1, 5, true, true)));
  EXPECT_TRUE(set.Add(NewSingle("9")));
  EXPECT_EQ(set.Size(), 4u);
}

TEST(MissingValueSet, ContainsComparesRangesNotValues) {
  MissingValueSet set;
  set.Add(new Range(1, 5, true, true));
  const Range same(1, 5, true, true);
  const Range inside(2, 3, true, true);
  EXPECT_TRUE(set.Contains(&same));
  EXPECT_FALSE(set.Contains(&inside));
  EXPECT_FALSE(set.Contains(nullptr));
}

TEST(MissingValueSet, RemovesAnEqualRange) {
  MissingValueSet set;
  set.Add(NewSingle(1));
  set.Add(NewSingle(2));
  const Range two(2, 2, true, true);
  EXPECT_FALSE(set.Remove(nullptr));
  EXPECT_TRUE(set.Remove(&two));
  EXPECT_FALSE(set.Remove(&two));
  EXPECT_EQ(set.Size(), 1u);
  // The argument may be the range itself.
  EXPECT_TRUE(set.Remove(set.GetMissingValues()[0]));
  EXPECT_EQ(set.Size(), 0u);
}

TEST(MissingValueSet, ListsItsRangesInOrder) {
  MissingValueSet set;
  set.Add(NewSingle(3));
  set.Add(NewSingle(1));
  const std::vector<const ScoreValueRange*> ranges = set.GetMissingValues();
  ASSERT_EQ(ranges.size(), 2u);
  EXPECT_EQ(ranges[0]->GetMin()->GetDouble(), 3);
  EXPECT_EQ(ranges[1]->GetMin()->GetDouble(), 1);
}

TEST(MissingValueSet, HoldsValuesByTheRulesOfItsRanges) {
  MissingValueSet set;
  set.Add(new Range(1, 5, true, false));
  set.Add(NewSingle(9));
  set.Add(NewSingle("n/a"));
  struct Row {
    std::shared_ptr<ScoreValue> value;
    bool held;
    const char* why;
  };
  const Row rows[] = {
      {nullptr, false, "null"},
      {std::make_shared<NumericValue>(1), true, "an included end"},
      {std::make_shared<NumericValue>(5), false, "an excluded end"},
      {std::make_shared<NumericValue>(3), true, "inside"},
      {std::make_shared<NumericValue>(9), true, "a single value"},
      {std::make_shared<NumericValue>(8), false, "outside"},
      {std::make_shared<StringValue>("n/a "), true, "trailing blanks do not count"},
      {std::make_shared<StringValue>("3"), false, "a text is in no interval of numbers"},
      {std::make_shared<DateTimeValue>(9.0, kDateVal), false, "a date is no number"},
      {std::make_shared<NumericValue>(), false, "the system-missing value"},
  };
  for (const Row& row : rows)
    EXPECT_EQ(set.HoldsValue(row.value.get()), row.held) << row.why;
}

TEST(MissingValueSet, EndsOfTwoKindsAreNoSingleValueHoweverManyRangesThereAre) {
  MissingValueSet set;
  for (int i = 100; i < 140; ++i)
    set.Add(NewSingle(i));
  // A text at the upper end leaves the range open to above.
  set.Add(new Range(NewNumber(5), NewText("5"), true, true));
  const NumericValue seven(7);
  const NumericValue four(4);
  EXPECT_TRUE(set.HoldsValue(&seven));
  EXPECT_FALSE(set.HoldsValue(&four));
}

TEST(MissingValueSet, CopiesAreDeepAndDisplayTheRanges) {
  MissingValueSet set;
  EXPECT_EQ(DisplayOf(set), " Begin MissingValueSet Display:\nEnd MissingValueSet Display.\n");
  set.Add(new Range(1, 9, true, false));
  set.Add(NewSingle(99));
  const std::unique_ptr<ScoreMissingValueSet> clone(set.Clone());
  MissingValueSet assigned;
  assigned.Add(NewSingle(7));
  assigned = set;
  const MissingValueSet& same = assigned;
  assigned = same;
  const Range ninetyNine(99, 99, true, true);
  EXPECT_TRUE(set.Remove(&ninetyNine));
  const std::string text =
      " Begin MissingValueSet Display:\n"
      "  Start Range Display   \nMinValue: 1;  MaxValue: 9; High End not included; lower End included\n"
      " End of Range Display\n\n"
      "  Start Range Display   \nMinValue: 99;  MaxValue: 99; High End included; lower End included\n"
      " End of Range Display\n\n"
      "End MissingValueSet Display.\n";
  EXPECT_EQ(DisplayOf(*clone), text);
  EXPECT_EQ(DisplayOf(assigned), text);
  EXPECT_EQ(set.Size(), 1u);
}

}  // namespace
}  // namespace MCKestrel_800
