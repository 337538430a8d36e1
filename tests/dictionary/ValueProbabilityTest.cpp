#include <gtest/gtest.h>

#include <limits>
#include <memory>

#include "kestrel/dictionary/ValueProbability.h"
#include "kestrel/dictionary/ValueProbabilitySet.h"
#include "tests/dictionary/TestValues.h"

namespace MCKestrel_800 {
namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

TEST(ValueProbability, TakesProbabilitiesFromZeroToOneAlone) {
  struct Row {
    double probability;
    bool taken;
  };
  const Row rows[] = {
      {0.0, true},        {1.0, true},      {0.5, true},   {-0.0, true},
      {1.0000001, false}, {-0.0001, false}, {kNaN, false}, {std::numeric_limits<double>::infinity(), false}};
  for (const Row& row : rows) {
    ValueProbability element(NewNumber(1), 0.25);
    EXPECT_EQ(element.SetProbability(row.probability), row.taken) << row.probability;
    EXPECT_EQ(element.GetProbability(), row.taken ? row.probability : 0.25) << row.probability;

    std::unique_ptr<ScoreValue> value(NewNumber(2));
    EXPECT_EQ(element.SetValueProbability(value.get(), row.probability), row.taken) << row.probability;
    EXPECT_EQ(element.GetValue()->GetDouble(), row.taken ? 2 : 1) << row.probability;
    if (row.taken) static_cast<void>(value.release());
    EXPECT_EQ(ValueProbability(nullptr, row.probability).GetProbability(), row.taken ? row.probability : 0.0);
  }
}

TEST(ValueProbability, RefusesANullValue) {
  ValueProbability element(NewNumber(1), 0.25);
  EXPECT_FALSE(element.SetValueProbability(nullptr, 0.5));
  EXPECT_EQ(element.GetProbability(), 0.25);
  EXPECT_EQ(element.GetValue()->GetDouble(), 1);
}

TEST(ValueProbability, ComparesAsItsValuesDo) {
  const ValueProbability one(NewNumber(1), 0.9);
  const ValueProbability alsoOne(NewNumber(1), 0.1);
  const ValueProbability two(NewNumber(2), 0.1);
  const ValueProbability none(nullptr, 0.1);
  EXPECT_TRUE(one == alsoOne && one <= alsoOne && one >= alsoOne);
  EXPECT_TRUE(one < two && one <= two && two > one && two >= one);
  EXPECT_FALSE(one == two || one > two || one >= two || two < one || two <= one);
  EXPECT_FALSE(none == none || none < one || none > one || none <= one || none >= one || one == none);
}

TEST(ValueProbability, CopiesAreDeep) {
  ValueProbability element(NewNumber(1), 0.5);
  const ValueProbability copy(element);
  const std::unique_ptr<ScoreValueProbability> clone(element.Clone());
  ValueProbability assigned(nullptr, 0);
  assigned = element;
  element.SetValueProbability(NewNumber(3), 0.75);
  const ValueProbability& same = element;
  element = same;
  EXPECT_EQ(element.GetValue()->GetDouble(), 3);
  EXPECT_EQ(copy.GetValue()->GetDouble(), 1);
  EXPECT_EQ(clone->GetValue()->GetDouble(), 1);
  EXPECT_EQ(assigned.GetValue()->GetDouble(), 1);
  EXPECT_EQ(assigned.GetProbability(), 0.5);
}

TEST(ValueProbability, DisplaysTheProbabilityInSixDigitsWhateverTheStreamsLocale) {
  const ValueProbability element(NewText("a"), 0.123456789);
  EXPECT_EQ(DisplayOf(element), "Value: a;  Probability: 0.123457\n");
  EXPECT_EQ(DisplayInForeignLocale(element), "Value: a;  Probability: 0.123457\n");
  EXPECT_EQ(DisplayOf(ValueProbability(nullptr, 1)), "Value: NULL;  Probability: 1\n");
}

TEST(ValueProbabilitySet, AnswersWithTheFirstElementOfAValue) {
  ValueProbabilitySet set;
  const NumericValue one(1);
  const NumericValue two(2);
  EXPECT_EQ(set.GetProbabilityOfValue(&one), 0.0);
  EXPECT_FALSE(set.Add(nullptr));
  EXPECT_TRUE(set.Add(new ValueProbability(NewNumber(1), 0.25)));
  EXPECT_TRUE(set.Add(new ValueProbability(NewNumber(1), 0.75)));
  EXPECT_EQ(set.Size(), 2u);
  EXPECT_EQ(set.GetAllValueProbabilities()[1]->GetProbability(), 0.75);
  EXPECT_EQ(set.GetProbabilityOfValue(&one), 0.25);
  EXPECT_EQ(set.GetProbabilityOfValue(&two), 0.0);
  EXPECT_EQ(set.GetProbabilityOfValue(nullptr), 0.0);
  EXPECT_TRUE(set.Contains(&one));
  EXPECT_FALSE(set.Contains(&two));
  EXPECT_FALSE(set.Contains(nullptr));
  const ValueProbability first(NewNumber(1), 0);
  const ValueProbability absent(NewNumber(2), 0);
  EXPECT_FALSE(set.Remove(nullptr));
  EXPECT_FALSE(set.Remove(&absent));
  EXPECT_TRUE(set.Remove(&first));
  EXPECT_EQ(set.GetProbabilityOfValue(&one), 0.75);
}

TEST(ValueProbabilitySet, CopiesAreDeepAndDisplayInOrder) {
  ValueProbabilitySet set;
  set.Add(new ValueProbability(NewNumber(2), 0.5));
  set.Add(new ValueProbability(NewNumber(1), 0.25));
  const std::unique_ptr<ScoreValueProbabilitySet> clone(set.Clone());
  ValueProbabilitySet assigned;
  assigned = set;
  set.GetAllValueProbabilities()[0]->SetProbability(1);
  const char* text =
      "Start ScoreValueProbabilitySet Display:\nValue: 2;  Probability: 0.5\nValue: 1;  Probability: 0.25\n"
      "End of ScoreValueProbabilitySet Display.\n\n";
  EXPECT_EQ(DisplayOf(*clone), text);
  EXPECT_EQ(DisplayOf(assigned), text);
}

}  // namespace
}  // namespace MCKestrel_800
