// The deepest predicate that a document may hold is read, asked, copied and deleted on the stacks that hosts
// have.

#include <gtest/gtest.h>

#include <memory>
#include <sstream>
#include <string>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/DocumentReader.h"
#include "tests/support/HostileDocuments.h"
#include "tests/support/PredicateFields.h"
#include "tests/support/PredicateText.h"
#include "tests/support/SmallStack.h"

namespace {

using kestrel_test::kPredicateFields;
using kestrel_test::ReadIndexedDictionary;
using kestrel_test::ReadPredicate;
using kestrel_test::RunOnStack;
using kestrel_tests::Repeat;
using namespace MCKestrel_800;

// The first leaves each level one kilobyte, beside what lies below the predicate.
constexpr size_t kStacks[] = {size_t{640} << 10, size_t{1} << 20, size_t{8} << 20};

/// Predicates `depth` elements deep: compounds around a simple predicate on "num". With a neighbour at each
/// level none of the compounds can be left out.
std::string Nested(size_t depth, const std::string& boolOperator, bool hasNeighbours) {
  const std::string simple = "<SimplePredicate field='num' operator='lessThan' value='5'/>";
  return Repeat("<CompoundPredicate booleanOperator='" + boolOperator + "'>" + (hasNeighbours ? simple : ""),
                depth - 1) +
         simple + Repeat("</CompoundPredicate>", depth - 1);
}

TEST(DeepPredicates, AreReadAskedCopiedAndDeleted) {
  const size_t depth = DocumentLimits().maxDepth;
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (const size_t stack : kStacks) {
    for (const char* boolOperator : {"or", "and", "xor", "surrogate"}) {
      const std::string document = Nested(depth, boolOperator, true);
      RunOnStack(stack, [&] {
        const auto read = ReadPredicate(document, *dictionary);
        const std::unique_ptr<ScorePredicate> predicate(read->Clone());
        std::ostringstream shown;
        predicate->Display(shown);
        EXPECT_EQ(shown.str(), "Compound Predicate: \n");
        EXPECT_FALSE(predicate->IsDerivedPredictor());
        const std::string probes = boolOperator[0] == 'x' ? "4:F 6:F -:U" : "4:T 6:F -:U";
        EXPECT_EQ(kestrel_test::Answers(*predicate, *dictionary, "num", probes), probes) << boolOperator;
      });
    }
  }
}

TEST(DeepPredicates, OfSingleChildrenBecomeTheInnermost) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (const size_t stack : kStacks) {
    RunOnStack(stack, [&] {
      const auto predicate = ReadPredicate(Nested(DocumentLimits().maxDepth, "xor", false), *dictionary);
      EXPECT_EQ(predicate->GetPredType(), ScorePredicate::kSimple);
    });
  }
}

// The exception passes every level, and each deletes what it had.
TEST(DeepPredicates, WithAFaultInTheInnermostAreRefused) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  std::string document = Nested(DocumentLimits().maxDepth, "and", true);
  document.replace(document.rfind("num"), 3, "nil");
  for (const size_t stack : kStacks) {
    RunOnStack(stack, [&] {
      try {
        ReadPredicate(document, *dictionary);
        ADD_FAILURE() << "nothing was thrown";
      } catch (const KestrelException& fault) {
        EXPECT_EQ(fault.GetErrorMessage(), "nil: Invalid Split Variable!");
      }
    });
  }
}

TEST(DeepPredicates, BeyondTheLimitAreRefused) {
  const auto dictionary = ReadIndexedDictionary(kPredicateFields);
  for (const size_t stack : kStacks) {
    RunOnStack(stack, [&] {
      for (const bool hasNeighbours : {true, false}) {
        try {
          ReadPredicate(Nested(DocumentLimits().maxDepth + 1, "and", hasNeighbours), *dictionary);
          ADD_FAILURE() << "nothing was thrown";
        } catch (const KestrelException& fault) {
          EXPECT_EQ(fault.GetErrorCode(), 6);
          EXPECT_EQ(fault.GetErrorMessage(), "Invalid XML file!!");
        }
      }
    });
  }
}

}  // namespace
