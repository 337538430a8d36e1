// Tests of the results that hosts read.

#include "kestrel/model/Results.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

namespace {

using namespace MCKestrel_800;

/// A value of a class that the library does not know, with more in it than its base.
class TaggedText : public StringValue {
 public:
  TaggedText(const std::string& text, int tag) : StringValue(text), tag_(tag) {}
  ScoreValue* Clone() const override { return new TaggedText(*this); }
  int GetInt() const override { return tag_; }

 private:
  int tag_;
};

template <typename Result>
class AnyResult : public testing::Test {
 protected:
  Result result_;
};

using BothResults = testing::Types<ClsResult, RegResult>;
TYPED_TEST_SUITE(AnyResult, BothResults);

TYPED_TEST(AnyResult, StartsEmpty) {
  EXPECT_EQ(this->result_.GetPrediction(), nullptr);
  EXPECT_EQ(this->result_.GetProbability(), 0.0);
}

TYPED_TEST(AnyResult, CopiesThePrediction) {
  auto& result = this->result_;
  {
    NumericValue number(2.5);
    result.SetPrediction(&number);
    number.SetDoubleValue(99.0);
  }
  ASSERT_NE(result.GetPrediction(), nullptr);
  EXPECT_EQ(result.GetPrediction()->GetType(), ScoreValue::kNumeric);
  EXPECT_EQ(result.GetPrediction()->GetDouble(), 2.5);
}

TYPED_TEST(AnyResult, HoldsValuesOfEveryKindInTurn) {
  const NumericValue number(1.0);
  const NumericValue missing;
  StringValue text("yes");
  text.SetLength(8);
  const StringValue empty;
  const DateTimeValue moment(3600.0, kTimeVal);
  const TaggedText tagged("no", 7);
  const ScoreValue* values[] = {&number, &text,  &number, &moment,  &tagged,
                                &text,   &empty, &moment, &missing, &tagged};
  auto& result = this->result_;
  for (const ScoreValue* value : values) {
    result.SetPrediction(value);
    const ScoreValue* held = result.GetPrediction();
    ASSERT_NE(held, nullptr);
    EXPECT_NE(held, value);
    EXPECT_EQ(held->GetType(), value->GetType());
    EXPECT_EQ(held->GetString(), value->GetString());
    EXPECT_EQ(held->GetInt(), value->GetInt()) << "a value of another class is held whole";
    EXPECT_EQ(held->IsSystemMissingValue(), value->IsSystemMissingValue());
  }
  result.SetPrediction(&text);
  EXPECT_EQ(static_cast<const StringValue*>(result.GetPrediction())->GetLength(), 8)
      << "the declared width too";
  result.SetPrediction(&moment);
  EXPECT_EQ(static_cast<const DateTimeValue*>(result.GetPrediction())->GetDateTimeType(), kTimeVal);
}

TYPED_TEST(AnyResult, TakesTheDeclaredWidthOfATextThatItHoldsAlready) {
  auto& result = this->result_;
  StringValue text("yes");
  for (const int width : {3, 8, 0}) {
    text.SetLength(width);
    result.SetPrediction(&text);
    EXPECT_EQ(static_cast<const StringValue*>(result.GetPrediction())->GetLength(), width);
  }
}

TYPED_TEST(AnyResult, ClearsThePredictionForNull) {
  auto& result = this->result_;
  const StringValue text("yes");
  result.SetPrediction(nullptr);
  EXPECT_EQ(result.GetPrediction(), nullptr);
  result.SetPrediction(&text);
  result.SetPrediction(nullptr);
  EXPECT_EQ(result.GetPrediction(), nullptr);
  result.SetPrediction(&text);
  EXPECT_EQ(*result.GetPrediction(), text);
}

TYPED_TEST(AnyResult, TakesItsOwnPredictionAgain) {
  auto& result = this->result_;
  for (const char* text : {"a", "a text that is too long to lie inside the object itself"}) {
    const StringValue value(text);
    result.SetPrediction(&value);
    result.SetPrediction(result.GetPrediction());
    EXPECT_EQ(result.GetPrediction()->GetString(), text);
  }
  const TaggedText tagged("no", 7);
  result.SetPrediction(&tagged);
  result.SetPrediction(result.GetPrediction());
  EXPECT_EQ(result.GetPrediction()->GetInt(), 7);
}

TYPED_TEST(AnyResult, IsEmptyAfterReset) {
  auto& result = this->result_;
  const NumericValue number(2.5);
  result.SetPrediction(&number);
  result.SetProbability(0.75);
  EXPECT_EQ(result.GetProbability(), 0.75);
  result.Reset();
  EXPECT_EQ(result.GetPrediction(), nullptr);
  EXPECT_EQ(result.GetProbability(), 0.0);
}

TEST(ClsResult, IsOfKind0) {
  EXPECT_EQ(ClsResult().GetResultKind(), 0);
}

TEST(RegResult, IsOfKind1) {
  EXPECT_EQ(RegResult().GetResultKind(), 1);
}

TEST(RegResult, TakesANumberWithoutAValueObject) {
  RegResult result;
  const StringValue text("yes");
  for (const double number : {2.5, -1.0, NumericValue::gSysmisValue}) {
    result.SetNumber(number);
    ASSERT_NE(result.GetPrediction(), nullptr);
    EXPECT_EQ(result.GetPrediction()->GetType(), ScoreValue::kNumeric);
    EXPECT_EQ(result.GetPrediction()->GetDouble(), number);
    EXPECT_EQ(result.GetPrediction()->IsSystemMissingValue(), number == NumericValue::gSysmisValue);
    result.SetPrediction(&text);
    EXPECT_EQ(*result.GetPrediction(), text);
    result.Reset();
    EXPECT_EQ(result.GetPrediction(), nullptr);
  }
}

TEST(RegResult, HoldsTheStandardErrorUntilReset) {
  RegResult result;
  EXPECT_EQ(result.GetStandardError(), NumericValue::gSysmisValue);
  result.SetStandardError(0.5);
  EXPECT_EQ(result.GetStandardError(), 0.5);
  result.Reset();
  EXPECT_EQ(result.GetStandardError(), NumericValue::gSysmisValue);
}

TEST(ClsResult, KeepsCategoriesInTheOrderInWhichTheyCame) {
  ClsResult result;
  const StringValue b("b");
  const StringValue a("a");
  const NumericValue one(1.0);
  result.AddCategoryProbability(&b, 0.25);
  result.AddCategoryProbability(&a, 0.5);
  result.AddCategoryProbability(&one, 0.125);
  ASSERT_EQ(result.GetCategoryCount(), 3u);
  EXPECT_EQ(*result.GetCategory(0), b);
  EXPECT_EQ(result.GetProbability(0), 0.25);
  EXPECT_EQ(*result.GetCategory(1), a);
  EXPECT_EQ(result.GetProbability(1), 0.5);
  EXPECT_EQ(*result.GetCategory(2), one);
  EXPECT_EQ(result.GetProbability(2), 0.125);
  EXPECT_EQ(result.GetCategory(3), nullptr);
  EXPECT_EQ(result.GetProbability(3), 0.0);
}

TEST(ClsResult, FindsTheProbabilityOfACategory) {
  ClsResult result;
  const StringValue yes("yes");
  const StringValue no("no");
  const NumericValue one(1.0);
  result.AddCategoryProbability(&yes, 0.25);
  result.AddCategoryProbability(&one, 0.5);
  result.AddCategoryProbability(&yes, 0.75);
  const StringValue yes_and_blanks("yes  ");
  EXPECT_EQ(result.GetCategoryProbability(&yes), 0.25) << "the first of equal ones";
  EXPECT_EQ(result.GetCategoryProbability(&yes_and_blanks), 0.25) << "trailing blanks do not count";
  EXPECT_EQ(result.GetCategoryProbability(&one), 0.5);
  EXPECT_EQ(result.GetCategoryProbability(&no), 0.0) << "unknown";
  EXPECT_EQ(result.GetCategoryProbability(nullptr), 0.0) << "null";
}

TEST(ClsResult, IgnoresANullCategory) {
  ClsResult result;
  result.AddCategoryProbability(nullptr, 0.5);
  EXPECT_EQ(result.GetCategoryCount(), 0u);
}

TEST(ClsResult, ShowsNothingOfEarlierCases) {
  ClsResult result;
  const StringValue yes("yes");
  const StringValue no("no");
  const NumericValue one(1.0);
  result.AddCategoryProbability(&yes, 0.25);
  result.AddCategoryProbability(&no, 0.75);
  result.Reset();
  EXPECT_EQ(result.GetCategoryCount(), 0u);
  EXPECT_EQ(result.GetCategory(0), nullptr);
  EXPECT_EQ(result.GetProbability(0), 0.0);
  EXPECT_EQ(result.GetCategoryProbability(&yes), 0.0);
  result.AddCategoryProbability(&one, 0.5);
  EXPECT_EQ(result.GetCategoryCount(), 1u);
  EXPECT_EQ(*result.GetCategory(0), one) << "of another kind than before";
  EXPECT_EQ(result.GetCategory(1), nullptr);
  EXPECT_EQ(result.GetCategoryProbability(&no), 0.0);
}

TEST(ClsResult, AddsACategoryOfItsOwn) {
  ClsResult result;
  const StringValue text("a text that is too long to lie inside the object itself");
  result.AddCategoryProbability(&text, 1.0);
  for (int i = 0; i < 100; ++i)
    result.AddCategoryProbability(result.GetCategory(0), 0.0);
  EXPECT_EQ(result.GetCategoryCount(), 101u);
  EXPECT_EQ(*result.GetCategory(100), text);
}

TEST(ClsResult, GivesMissingValuesBackAsMissing) {
  ClsResult result;
  const NumericValue missing;
  result.AddCategoryProbability(&missing, 0.5);
  EXPECT_TRUE(result.GetCategory(0)->IsSystemMissingValue());
  EXPECT_EQ(result.GetCategoryProbability(&missing), 0.5);
}

TYPED_TEST(AnyResult, HoldsOutputFieldsThatResetLeavesWithoutValues) {
  ResultField& outputs = this->result_.GetOutputFields();
  EXPECT_EQ(outputs.GetResultSize(), 0u);
  outputs.SetResultValue("number", 2.5);
  outputs.SetResultValue("text", std::string("b"));
  EXPECT_EQ(OutputFieldsOf(&this->result_), &outputs);
  this->result_.Reset();
  EXPECT_TRUE(outputs.GetResultValue("number")->IsSystemMissingValue());
  EXPECT_EQ(outputs.GetResultValue("text")->GetString(), "");
}

TEST(OutputFieldsOf, KnowsTheLibrarysResultsAndWhatDerivesFromThem) {
  class OwnCls : public ClsResult {};
  class OwnReg : public RegResult {};
  OwnCls classification;
  OwnReg regression;
  EXPECT_EQ(OutputFieldsOf(&classification), &classification.GetOutputFields());
  EXPECT_EQ(OutputFieldsOf(&regression), &regression.GetOutputFields());
  EXPECT_EQ(OutputFieldsOf(nullptr), nullptr);
}

}  // namespace
