// Shows that a result that is filled case after case allocates nothing after the first one. A program of its
// own, because it counts every allocation of the process.

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "kestrel/model/Results.h"
#include "tests/support/AllocationCount.h"

namespace {

using namespace MCKestrel_800;
using kestrel_tests::CountAllocations;

TEST(ResultAllocation, RegressionCasesNeedNone) {
  RegResult result;
  NumericValue number;
  const size_t before = CountAllocations();
  for (int i = 0; i < 1000; ++i) {
    result.Reset();
    number.SetDoubleValue(i);
    result.SetPrediction(&number);
    result.SetStandardError(0.5);
  }
  EXPECT_EQ(CountAllocations(), before);
  EXPECT_EQ(result.GetPrediction()->GetDouble(), 999.0);
}

template <typename Value>
void ExpectNoneAfterTheFirstCase(const std::vector<Value>& categories) {
  ClsResult result;
  size_t after_first = 0;
  for (int i = 0; i < 1000; ++i) {
    result.Reset();
    for (const Value& category : categories)
      result.AddCategoryProbability(&category, 0.125);
    result.SetPrediction(&categories[i % 2]);
    result.SetProbability(0.125);
    if (i == 1) after_first = CountAllocations();
  }
  EXPECT_EQ(CountAllocations(), after_first);
  EXPECT_EQ(result.GetCategoryCount(), categories.size());
}

TEST(ResultAllocation, ClassificationCasesNeedNoneAfterTheFirst) {
  ExpectNoneAfterTheFirstCase<NumericValue>({NumericValue(1.0), NumericValue(2.0), NumericValue(3.0)});
  ExpectNoneAfterTheFirstCase<StringValue>({StringValue("yes"), StringValue("no")});
  ExpectNoneAfterTheFirstCase<StringValue>(
      {StringValue(std::string(100, 'a')), StringValue(std::string(90, 'b'))});
  ExpectNoneAfterTheFirstCase<DateTimeValue>(
      {DateTimeValue(0.0, kDateVal), DateTimeValue(86400.0, kDateVal)});
}

template <typename Result>
void ExpectPathsNeedNoneAfterTheLongest(const std::string& id) {
  Result result;
  ResultEntities* entities = ResultEntities::Of(&result);
  entities->SetPathWanted(true);
  size_t after_first = 0;
  for (int i = 0; i < 1000; ++i) {
    result.Reset();
    const int length = 20 - i % 20;
    for (int node = 0; node < length; ++node)
      entities->AddToPath(id);
    entities->SetDecidingId(id);
    if (i == 0) after_first = CountAllocations();
  }
  EXPECT_EQ(CountAllocations(), after_first);
  EXPECT_EQ(entities->GetDecidingId(), id);
}

TEST(ResultAllocation, PathsNeedNoneAfterTheLongest) {
  for (const std::string& id : {std::string("n1"), std::string(100, 'n')}) {
    ExpectPathsNeedNoneAfterTheLongest<ClsResult>(id);
    ExpectPathsNeedNoneAfterTheLongest<RegResult>(id);
  }
}

}  // namespace
