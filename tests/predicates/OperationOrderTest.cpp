// The order of the virtual operations that model libraries and hosts are built against.

#include <gtest/gtest.h>

#include <vector>

#include "kestrel/predicates/ScoreValueRange.h"
#include "tests/support/OperationNumber.h"

#if defined(__x86_64__)

namespace {

using kestrel_tests::InOrder;
using kestrel_tests::OperationNumber;
using namespace MCKestrel_800;

TEST(OperationOrder, OfRanges) {
  using OfNumber = bool (ScoreValueRange::*)(double) const;
  using OfValue = bool (ScoreValueRange::*)(const ScoreValue*) const;
  const std::vector<long> numbers = {
      OperationNumber(&ScoreValueRange::operator==),
      OperationNumber(&ScoreValueRange::Clone),
      OperationNumber(&ScoreValueRange::SetMin),
      OperationNumber(&ScoreValueRange::SetMax),
      OperationNumber(static_cast<OfNumber>(&ScoreValueRange::IsInRange)),
      OperationNumber(static_cast<OfValue>(&ScoreValueRange::IsInRange)),
      OperationNumber(&ScoreValueRange::GetMin),
      OperationNumber(&ScoreValueRange::GetMax),
      OperationNumber(&ScoreValueRange::GetHighEnd),
      OperationNumber(&ScoreValueRange::GetLowEnd),
      OperationNumber(&ScoreValueRange::Display),
  };
  EXPECT_EQ(numbers, InOrder(numbers.size()));
}

}  // namespace

#endif
