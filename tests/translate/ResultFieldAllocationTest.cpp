// Shows that output fields that are written case after case allocate nothing after the first one. A program
// of its own, because it counts every allocation of the process.

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/translate/ResultField.h"
#include "tests/support/AllocationCount.h"

namespace {

using namespace MCKestrel_800;
using kestrel_tests::CountAllocations;

TEST(ResultFieldAllocation, CasesNeedNoneAfterTheFirst) {
  const std::vector<StringValue> texts = {StringValue(std::string(100, 'a')),
                                          StringValue(std::string(90, 'b')), StringValue("c")};
  const std::string number = "the probability of the first category";
  const std::string value = "the predicted category, as a value";
  const std::string text = "the predicted category, as a text";
  const std::string moment = "when it is expected";
  ResultField fields;
  size_t after_first = 0;
  for (size_t i = 0; i < 999; ++i) {
    const StringValue& category = texts[i % texts.size()];
    const DateTimeValue expected(static_cast<double>(i), kDateTimeVal);
    fields.ClearValues();
    fields.SetResultValue(number, static_cast<double>(i));
    fields.SetResultValue(value, &category);
    fields.SetResultValue(text, category.GetText());
    fields.SetResultValue(moment, &expected);
    if (i == 0) after_first = CountAllocations();
  }
  EXPECT_EQ(CountAllocations(), after_first);
  EXPECT_EQ(fields.GetResultValue(number)->GetDouble(), 998.0);
  EXPECT_EQ(*fields.GetResultValue(value), texts[2]);
  EXPECT_EQ(*fields.GetResultValue(text), texts[2]);
  EXPECT_EQ(fields.GetResultValue(moment)->GetDouble(), 998.0);
}

}  // namespace
