// Part of each program that counts allocations, so that none finds no allocations because it sees none.

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "tests/support/AllocationCount.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

TEST(AllocationCount, SeesTheProgram) {
  const size_t before = CountAllocations();
  const std::vector<int> some(100);
  EXPECT_GT(CountAllocations(), before) << some.size();
}

TEST(AllocationCount, SeesTheLibrary) {
  const NumericValue number(1.0);
  const size_t before = CountAllocations();
  const std::unique_ptr<ScoreValue> copy(number.Clone());
  EXPECT_GT(CountAllocations(), before) << copy->GetDouble();
}

// The memory of a text is asked for by the standard library on behalf of the library.
TEST(AllocationCount, SeesTheStandardLibrary) {
  const StringValue text(std::string(100, 'x'));
  const size_t before = CountAllocations();
  const std::unique_ptr<ScoreValue> copy(text.Clone());
  EXPECT_GE(CountAllocations() - before, 2u) << copy->GetString();
}

TEST(AllocationCount, StandsStillByItself) {
  const size_t before = CountAllocations();
  EXPECT_EQ(CountAllocations(), before);
}

}  // namespace
}  // namespace kestrel_tests
