// The order of the virtual operations that model libraries and hosts are built against.

#include <gtest/gtest.h>

#include <vector>

#include "kestrel/predicates/ScorePredicate.h"
#include "kestrel/predicates/ScoreSplitVar.h"
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

TEST(OperationOrder, OfSplits) {
  using OfNumber = int (ScoreSplitVar::*)(double) const;
  using OfValue = int (ScoreSplitVar::*)(const ScoreValue*) const;
  const std::vector<long> numbers = {
      OperationNumber(&ScoreSplitVar::Clone),
      OperationNumber(&ScoreSplitVar::SetSplitVar),
      OperationNumber(&ScoreSplitVar::SetMissvalMap),
      OperationNumber(&ScoreSplitVar::GetSplitVar),
      OperationNumber(&ScoreSplitVar::GetSplitName),
      OperationNumber(&ScoreSplitVar::GetSplitLabel),
      OperationNumber(&ScoreSplitVar::GetSplitType),
      OperationNumber(&ScoreSplitVar::GetSplitVarType),
      OperationNumber(&ScoreSplitVar::GetSplitMLevel),
      OperationNumber(&ScoreSplitVar::GetMissvalMap),
      OperationNumber(static_cast<OfNumber>(&ScoreSplitVar::GetSplitChildIndex)),
      OperationNumber(static_cast<OfValue>(&ScoreSplitVar::GetSplitChildIndex)),
      OperationNumber(&ScoreSplitVar::Display),
  };
  EXPECT_EQ(numbers, InOrder(numbers.size()));
}

TEST(OperationOrder, OfPredicates) {
  using Result = ScorePredicate::PredicateResult;
  using OfVector = Result (ScorePredicate::*)(const std::vector<double>&) const;
  using OfRecords = Result (ScorePredicate::*)(const ScoreCaseRecord*, const ScoreCaseRecord*) const;
  const std::vector<long> numbers = {
      OperationNumber(&ScorePredicate::Clone),
      OperationNumber(static_cast<OfVector>(&ScorePredicate::Evaluate)),
      OperationNumber(static_cast<OfRecords>(&ScorePredicate::Evaluate)),
      OperationNumber(&ScorePredicate::GetPredType),
      OperationNumber(&ScorePredicate::IsDerivedPredictor),
      OperationNumber(&ScorePredicate::SetSplit),
      OperationNumber(&ScorePredicate::GetSplit),
      OperationNumber(&ScorePredicate::Display),
  };
  EXPECT_EQ(numbers, InOrder(numbers.size()));
}

}  // namespace

#endif
