// Bytes as a predicate element on a fixed dictionary: either a proper refusal, or a predicate that decides
// the same on records and on flat vectors, as do its copies, and that leaves the dictionary as it was.

#include <cstdint>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "fuzz/Check.h"
#include "fuzz/CheckFault.h"
#include "kestrel/dictionary/ScoreEncoder.h"
#include "kestrel/predicates/ScoreSplitVar.h"
#include "kestrel/translate/LeafNodeStats.h"
#include "tests/support/PredicateFields.h"
#include "tests/support/PredicateText.h"

namespace {

using namespace MCKestrel_800;
using kestrel_fuzz::Check;

ScoreDictionary& Fields() {
  static const std::unique_ptr<ScoreDictionary> fields =
      kestrel_test::ReadIndexedDictionary(kestrel_test::kPredicateFields);
  return *fields;
}

std::string Shown(const ScorePredicate& predicate) {
  std::ostringstream out;
  predicate.Display(out);
  if (predicate.GetSplit() != nullptr) predicate.GetSplit()->Display(out);
  return out.str();
}

/// A case that has one value; the dates stay missing, since records hold them in seconds and vectors in their
/// field's unit.
struct Case {
  const char* field;
  const char* value;
};

constexpr Case kCases[] = {{"num", "-"},   {"num", "5"},    {"num", "-1e300"}, {"num", "99"},
                           {"col", "red"}, {"col", "pink"}, {"exact", "a_"},   {"nr", "2"},
                           {"nr", "-9"},   {"size", "mid"}, {"size", "_"},     {"rank", "15"},
                           {"rank", "20"}, {"only", "x"},   {"bare", "a"}};

void CheckAnswers(const ScorePredicate& predicate, const ScorePredicate& copy) {
  for (const Case& one : kCases) {
    const auto answers = kestrel_test::Ask(predicate, Fields(), one.field, one.value);
    Check(answers.record == answers.vector, "both roads give one answer");
    const auto copied = kestrel_test::Ask(copy, Fields(), one.field, one.value);
    Check(copied.record == answers.record && copied.vector == answers.vector,
          "a copy answers like the original");
  }
}

void ReadAndAsk(xercesc::DOMElement* element, bool ordinalAsScale) {
  try {
    const auto predicate = kestrel_test::ReadPredicateElement(element, Fields(), ordinalAsScale);
    if (predicate == nullptr) return;
    const std::unique_ptr<ScorePredicate> copy(predicate->Clone());
    Check(Shown(*copy) == Shown(*predicate), "a copy displays itself like the original");
    // With numbers in the place of an ordinal's codes the vectors made here would be the wrong ones.
    if (!ordinalAsScale) CheckAnswers(*predicate, *copy);
  } catch (const KestrelException& fault) {
    kestrel_fuzz::CheckFault(fault);
    Check(fault.GetLine() != 0, "a fault of a predicate has its place");
  }
}

void CheckEncoders() {
  for (const ScoreDictVar* variable : Fields().GetScoreDictVars()) {
    const ScoreEncoder* const encoder = variable->GetEncoder();
    Check(encoder == nullptr || encoder->GetNumberOfCategories() == variable->GetNumberOfCats(),
          "an encoder learns nothing from predicates");
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  try {
    const auto tree = kestrel_test::ReadTree(std::string(reinterpret_cast<const char*>(data), size));
    ReadAndAsk(tree->GetRoot(), false);
    ReadAndAsk(tree->GetRoot(), true);
    CheckEncoders();
    std::vector<LeafNodeStats> stats;
    PMMLTranslator::SetLeafNodeStats(tree->GetRoot(), stats);
    for (const LeafNodeStats& entry : stats)
      Check(entry.record_count >= 0.0, "a count is not negative");
  } catch (const KestrelException& fault) {
    kestrel_fuzz::CheckFault(fault);
  }
  return 0;
}
