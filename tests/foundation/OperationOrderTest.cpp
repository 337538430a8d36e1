// The order of the virtual operations that model libraries and hosts are built against.

#include <gtest/gtest.h>

#include <vector>

#include "kestrel/foundation/ScoreValue.h"
#include "tests/support/OperationNumber.h"

#if defined(__x86_64__)

namespace {

using kestrel_tests::InOrder;
using kestrel_tests::OperationNumber;
using namespace MCKestrel_800;

TEST(OperationOrder, OfValues) {
  const std::vector<long> numbers = {
      OperationNumber(&ScoreValue::SetValue),   OperationNumber(&ScoreValue::GetValue),
      OperationNumber(&ScoreValue::Clone),      OperationNumber(&ScoreValue::operator==),
      OperationNumber(&ScoreValue::Equal),      OperationNumber(&ScoreValue::operator>),
      OperationNumber(&ScoreValue::operator<),  OperationNumber(&ScoreValue::operator<=),
      OperationNumber(&ScoreValue::operator>=), OperationNumber(&ScoreValue::IsSystemMissingValue),
      OperationNumber(&ScoreValue::GetInt),     OperationNumber(&ScoreValue::GetDouble),
      OperationNumber(&ScoreValue::GetString),  OperationNumber(&ScoreValue::GetType),
  };
  EXPECT_EQ(numbers, InOrder(numbers.size()));
}

}  // namespace

#endif
