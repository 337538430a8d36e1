// Predicate objects from any predicate element, for tests that ask objects what compiled conditions say.

#ifndef KESTREL_TESTS_PLUGINS_TREEPREDICATES_H
#define KESTREL_TESTS_PLUGINS_TREEPREDICATES_H

#include <memory>

#include "kestrel/predicates/ConstantPredicates.h"
#include "tests/support/PredicateText.h"

namespace kestrel_tests {

/// Null for a compound of nothing. `derived` may be null.
inline std::unique_ptr<MCKestrel_800::ScorePredicate> ReadAnyPredicate(
    xercesc::DOMElement* element, const MCKestrel_800::ScoreDictionary& dictionary,
    const MCKestrel_800::ScoreDictionary* derived = nullptr) {
  if (MCKestrel_800::ElementIs(element, u"True")) return std::make_unique<MCKestrel_800::TruePredicate>();
  if (MCKestrel_800::ElementIs(element, u"False")) return std::make_unique<MCKestrel_800::FalsePredicate>();
  return kestrel_test::ReadPredicateElement(element, dictionary, false, derived);
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_PLUGINS_TREEPREDICATES_H
