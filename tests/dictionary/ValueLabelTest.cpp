#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "kestrel/dictionary/ValueLabelSet.h"
#include "kestrel/dictionary/ValueLbl.h"
#include "tests/dictionary/TestValues.h"

namespace MCKestrel_800 {
namespace {

TEST(ValueLbl, SetValueLabelTakesBothOrNothing) {
  ValueLbl label(NewNumber(1), "one");
  EXPECT_FALSE(label.SetValueLabel(nullptr, "two"));
  const std::unique_ptr<ScoreValue> refused(NewNumber(2));
  EXPECT_FALSE(label.SetValueLabel(refused.get(), ""));
  EXPECT_EQ(label.GetLabel(), "one");
  EXPECT_EQ(label.GetValue()->GetDouble(), 1);
  EXPECT_TRUE(label.SetValueLabel(NewText("2"), "two"));
  EXPECT_EQ(label.GetLabel(), "two");
  EXPECT_EQ(label.GetValue()->GetString(), "2");
}

TEST(ValueLbl, SetValueLabelMayBeGivenTheValueItHolds) {
  ScoreValue* value = NewNumber(1);
  ValueLbl label(value, "one");
  EXPECT_TRUE(label.SetValueLabel(value, "uno"));
  EXPECT_EQ(label.GetLabel(), "uno");
  EXPECT_EQ(label.GetValue()->GetDouble(), 1);
}

TEST(ValueLbl, SetLabelRefusesAnEmptyLabel) {
  ValueLbl label(NewNumber(1), "one");
  EXPECT_FALSE(label.SetLabel(""));
  EXPECT_EQ(label.GetLabel(), "one");
  EXPECT_TRUE(label.SetLabel("uno"));
  EXPECT_EQ(label.GetLabel(), "uno");
}

TEST(ValueLbl, ComparesAsItsValuesDoWhateverTheLabels) {
  const ValueLbl one(NewNumber(1), "z");
  const ValueLbl alsoOne(NewNumber(1), "a");
  const ValueLbl two(NewNumber(2), "b");
  EXPECT_TRUE(one == alsoOne);
  EXPECT_FALSE(one == two);
  EXPECT_TRUE(two > one);
  EXPECT_FALSE(one > alsoOne);
  EXPECT_TRUE(one < two);
  EXPECT_FALSE(two < one);
  EXPECT_TRUE(one <= alsoOne);
  EXPECT_FALSE(two <= one);
  EXPECT_TRUE(one >= alsoOne);
  EXPECT_FALSE(one >= two);
}

TEST(ValueLbl, WithoutValueComparesFalseWithEverything) {
  const ValueLbl none(nullptr, "none");
  const ValueLbl one(NewNumber(1), "one");
  for (const ValueLbl* other : {&none, &one}) {
    EXPECT_FALSE(none == *other);
    EXPECT_FALSE(none > *other || none < *other || none <= *other || none >= *other);
    EXPECT_FALSE(*other == none);
  }
}

TEST(ValueLbl, CopiesAreDeepAndSelfAssignmentKeepsTheValue) {
  ValueLbl label(NewNumber(1), "one");
  const ValueLbl copy(label);
  const std::unique_ptr<ScoreValueLabel> clone(label.Clone());
  ValueLbl assigned(NewText("x"), "x");
  assigned = label;
  label.SetValueLabel(NewNumber(9), "nine");
  for (const ScoreValueLabel* other : std::vector<const ScoreValueLabel*>{&copy, clone.get(), &assigned}) {
    EXPECT_EQ(other->GetLabel(), "one");
    EXPECT_EQ(other->GetValue()->GetDouble(), 1);
  }
  const ValueLbl& same = label;
  label = same;
  EXPECT_EQ(label.GetValue()->GetDouble(), 9);
  EXPECT_EQ(label.GetLabel(), "nine");
}

TEST(ValueLbl, DisplaysValueAndLabel) {
  EXPECT_EQ(DisplayOf(ValueLbl(NewNumber(1.5), "half")), "Value: 1.5;  Label: half\n");
  EXPECT_EQ(DisplayOf(ValueLbl(NewText("a"), "")), "Value: a;  Label: \n");
  EXPECT_EQ(DisplayOf(ValueLbl(nullptr, "none")), "Value: NULL;  Label: none\n");
}

TEST(ValueLabelSet, AppendsWithoutLookingForDuplicates) {
  ValueLabelSet set;
  EXPECT_FALSE(set.Add(nullptr));
  EXPECT_TRUE(set.Add(new ValueLbl(NewNumber(1), "first")));
  EXPECT_TRUE(set.Add(new ValueLbl(NewNumber(1), "second")));
  ASSERT_EQ(set.Size(), 2u);
  EXPECT_EQ(set.GetAllValueLabels()[0]->GetLabel(), "first");
  EXPECT_EQ(set.GetAllValueLabels()[1]->GetLabel(), "second");
  const NumericValue one(1);
  EXPECT_EQ(set.GetLabelOfValue(&one), "first");
}

TEST(ValueLabelSet, FindsByTheRulesOfTheValues) {
  ValueLabelSet set;
  set.Add(new ValueLbl(nullptr, "no value"));
  set.Add(new ValueLbl(NewText("ab"), "text"));
  set.Add(new ValueLbl(NewNumber(0.1), "tenth"));
  struct Row {
    std::shared_ptr<ScoreValue> value;
    const char* label;
    const char* why;
  };
  const Row rows[] = {
      {nullptr, "", "null is in no set"},
      {std::make_shared<StringValue>("ab  "), "text", "trailing blanks do not count"},
      {std::make_shared<StringValue>(" ab"), "", "leading blanks count"},
      {std::make_shared<NumericValue>(0.1 + 1e-16), "tenth", "numbers are equal within the tolerance"},
      {std::make_shared<NumericValue>(0.11), "", "and not beyond it"},
      {std::make_shared<StringValue>("0.1"), "", "a text is no number"},
  };
  for (const Row& row : rows) {
    EXPECT_EQ(set.GetLabelOfValue(row.value.get()), row.label) << row.why;
    EXPECT_EQ(set.Contains(row.value.get()), *row.label != '\0') << row.why;
  }
}

TEST(ValueLabelSet, RemovesTheFirstEqualElement) {
  ValueLabelSet set;
  set.Add(new ValueLbl(NewNumber(1), "first"));
  set.Add(new ValueLbl(NewNumber(2), "two"));
  set.Add(new ValueLbl(NewNumber(1), "second"));
  const ValueLbl one(NewNumber(1), "whatever");
  const ValueLbl three(NewNumber(3), "first");
  EXPECT_FALSE(set.Remove(nullptr));
  EXPECT_FALSE(set.Remove(&three));
  EXPECT_TRUE(set.Remove(&one));
  ASSERT_EQ(set.Size(), 2u);
  EXPECT_EQ(set.GetLabelOfValue(one.GetValue()), "second");
  // The argument may be the element itself.
  EXPECT_TRUE(set.Remove(set.GetAllValueLabels()[1]));
  EXPECT_FALSE(set.Contains(one.GetValue()));
  EXPECT_EQ(set.Size(), 1u);
}

TEST(ValueLabelSet, CopiesAreDeep) {
  ValueLabelSet set;
  set.Add(new ValueLbl(NewNumber(1), "one"));
  const std::unique_ptr<ScoreValueLabelSet> clone(set.Clone());
  const ValueLabelSet copy(set);
  ValueLabelSet assigned;
  assigned.Add(new ValueLbl(NewNumber(7), "seven"));
  assigned = set;
  set.GetAllValueLabels()[0]->SetLabel("changed");
  const ValueLabelSet& same = set;
  set = same;
  EXPECT_EQ(set.Size(), 1u);
  const NumericValue one(1);
  EXPECT_EQ(set.GetLabelOfValue(&one), "changed");
  EXPECT_EQ(clone->GetLabelOfValue(&one), "one");
  EXPECT_EQ(copy.GetLabelOfValue(&one), "one");
  EXPECT_EQ(assigned.GetLabelOfValue(&one), "one");
  EXPECT_EQ(assigned.Size(), 1u);
}

TEST(ValueLabelSet, DisplaysItsLabelsInOrder) {
  ValueLabelSet set;
  EXPECT_EQ(DisplayOf(set), "Start ScoreValueLabelSet Display:\nEnd of ScoreValueLabelSet Display.\n\n");
  set.Add(new ValueLbl(NewText("b"), "B"));
  set.Add(new ValueLbl(NewText("a"), "A"));
  EXPECT_EQ(DisplayOf(set),
            "Start ScoreValueLabelSet Display:\nValue: b;  Label: B\nValue: a;  Label: A\n"
            "End of ScoreValueLabelSet Display.\n\n");
}

}  // namespace
}  // namespace MCKestrel_800
