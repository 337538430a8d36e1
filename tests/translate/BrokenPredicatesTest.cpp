// Predicates broken in every small way: reading one gives a predicate that can be asked, none, or a
// KestrelException, never anything else.

#include <gtest/gtest.h>

#include <exception>
#include <map>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/foundation/KestrelException.h"
#include "tests/support/PredicateFields.h"
#include "tests/support/PredicateText.h"
#include "tests/support/XmlMutants.h"

namespace {

using kestrel_test::Mutant;
using kestrel_test::ReadTree;
using namespace MCKestrel_800;

/// One of everything.
constexpr char kRich[] =
    "<CompoundPredicate booleanOperator=\"or\">"
    "<CompoundPredicate booleanOperator=\"and\"><True/>"
    "<SimplePredicate field=\"num\" operator=\"lessThan\" value=\"5\"/>"
    "<SimplePredicate field=\"num\" operator=\"isMissing\"/>"
    "<SimplePredicate field=\"day\" operator=\"notEqual\" value=\"-1e3\"/></CompoundPredicate>"
    "<CompoundPredicate booleanOperator=\"surrogate\">"
    "<SimplePredicate field=\"col\" operator=\"notEqual\" value=\"red\"/>"
    "<SimplePredicate field=\"nr\" operator=\"equal\" value=\"2\"/>"
    "<SimplePredicate field=\"size\" operator=\"isNotMissing\"/><False/></CompoundPredicate>"
    "<CompoundPredicate booleanOperator=\"xor\">"
    "<SimplePredicate field=\"size\" operator=\"greaterThan\" value=\"low\"/>"
    "<SimpleSetPredicate field=\"col\" booleanOperator=\"isIn\">"
    "<Array n=\"2\" type=\"string\">red green</Array></SimpleSetPredicate>"
    "<SimpleSetPredicate field=\"rank\" booleanOperator=\"isNotIn\">"
    "<Array n=\"1\" type=\"int\">20</Array></SimpleSetPredicate></CompoundPredicate>"
    "<Extension name=\"a\"><SimplePredicate/></Extension></CompoundPredicate>";

/// Asks a predicate in every way that has an answer whatever the predicate is.
bool IsInOrder(const ScorePredicate& predicate, const ScoreDictionary& dictionary) {
  const std::unique_ptr<ScorePredicate> copy(predicate.Clone());
  std::ostringstream shown, copyShown;
  predicate.Display(shown);
  copy->Display(copyShown);
  if (shown.str().empty() || shown.str() != copyShown.str()) return false;
  for (const char* field : {"num", "col", "nr", "size", "rank"}) {
    for (const char* value : {"-", "5", "red", "low", "20"}) {
      const auto first = kestrel_test::Ask(predicate, dictionary, field, value);
      const auto second = kestrel_test::Ask(*copy, dictionary, field, value);
      if (first.record != second.record || first.vector != second.vector) return false;
      if (first.record != first.vector) return false;
    }
  }
  return true;
}

/// Reads every mutant; returns how often each code came out, 0 for what was read.
std::map<int, size_t> ReadAll(const std::vector<Mutant>& mutants) {
  const auto dictionary = kestrel_test::ReadIndexedDictionary(kestrel_test::kPredicateFields);
  std::map<int, size_t> codes;
  for (const Mutant& mutant : mutants) {
    try {
      const auto tree = ReadTree(mutant.document);
      const auto predicate = kestrel_test::ReadPredicateElement(tree->GetRoot(), *dictionary);
      if (predicate != nullptr) {
        EXPECT_TRUE(IsInOrder(*predicate, *dictionary)) << mutant.why;
      }
      ++codes[0];
    } catch (const KestrelException& fault) {
      EXPECT_FALSE(fault.GetErrorMessage().empty()) << mutant.why;
      EXPECT_GT(fault.GetErrorCode(), 0) << mutant.why;
      ++codes[fault.GetErrorCode()];
    } catch (const std::exception& other) {
      ADD_FAILURE() << mutant.why << ": " << other.what();
    }
  }
  return codes;
}

void ExpectCodes(const std::map<int, size_t>& codes, const std::vector<int>& expected) {
  for (const int code : expected)
    EXPECT_TRUE(codes.count(code)) << code;
}

TEST(BrokenPredicates, AreGoodBeforeTheyAreBroken) {
  EXPECT_EQ(ReadAll({{"whole", kRich}}), (std::map<int, size_t>{{0, 1}}));
}

TEST(BrokenPredicates, CutOffAreNoDocuments) {
  for (const auto& [code, count] : ReadAll(kestrel_test::Truncated(kRich, 7)))
    EXPECT_TRUE(code == 4 || code == 6) << code << " came " << count << " times";
}

TEST(BrokenPredicates, WithBrokenAttributesAreReadOrRefused) {
  ExpectCodes(ReadAll(kestrel_test::WithBrokenAttributes(kRich, 1)), {0, 1, 3, 4, 5, 8, 9, 11});
}

TEST(BrokenPredicates, WithBrokenElementsAreReadOrRefused) {
  ExpectCodes(ReadAll(kestrel_test::WithBrokenElements(kRich, 1)), {0, 4, 6});
}

TEST(BrokenPredicates, WithAttributesOfOthersAreReadOrRefused) {
  const std::string text = kRich;
  const kestrel_test::XmlMap map(text);
  std::vector<Mutant> mutants;
  for (const auto& attribute : map.Attributes()) {
    for (const auto& other : map.Attributes()) {
      std::string changed = text;
      changed.replace(attribute.valueStart, attribute.valueEnd - attribute.valueStart,
                      text.substr(other.valueStart, other.valueEnd - other.valueStart));
      mutants.push_back({attribute.name + " at byte " + std::to_string(attribute.start) + " as " +
                             other.name + " at byte " + std::to_string(other.start),
                         changed});
    }
  }
  ExpectCodes(ReadAll(mutants), {0, 1, 3, 5, 8, 9, 11, 12});
}

}  // namespace
