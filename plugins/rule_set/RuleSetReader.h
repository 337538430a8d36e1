// Reads the `RuleSet` element of a document.

#ifndef KESTREL_PLUGINS_RULE_SET_RULESETREADER_H
#define KESTREL_PLUGINS_RULE_SET_RULESETREADER_H

#include <xercesc/util/XercesDefs.hpp>

#include <string>
#include <vector>

#include "kestrel/translate/LeafNodeStats.h"
#include "plugins/rule_set/RuleSet.h"
#include "plugins/support/PredicateInputs.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

/// Reads one rule set. Its predicates are compiled one by one and dropped.
///
/// Errors, all KestrelException with the place in the document, beside those of the readers of predicates and
/// of `ScoreDistribution` elements and of TargetCategories:
///   code 1   an element that does not belong here, a rule with several predicates, a category twice in a
///            distribution;
///   code 3   a number that is none, such as a regression's `score`;
///   code 4   no `RuleSelectionMethod`, or one without `criterion`; a rule without predicate, a `SimpleRule`
///            without `score`;
///   code 6   an unknown `criterion`, a number that is not finite;
///   code 8   a predicate's field that is neither one of the active fields nor a derived field.
class RuleSetReader {
 public:
  /// All must outlive the reader. `inputs` gets the slots of the predicates' fields and may be sealed
  /// afterwards.
  RuleSetReader(bool is_classification, PredicateInputs& inputs, RuleSet& rule_set)
      : is_classification_(is_classification), inputs_(inputs), rule_set_(rule_set) {}

  /// To be called once.
  void Read(xercesc::DOMElement* element);

 private:
  /// A rule whose distribution is read when all scores of rules are known.
  struct Pending {
    xercesc::DOMElement* element;
    int rule;
  };

  void ReadSelection(const xercesc::DOMElement* element);
  void ReadRules(xercesc::DOMElement* rule_set);
  void ReadSimpleRule(xercesc::DOMElement* element);
  void ReadDefault(xercesc::DOMElement* element);
  int ReadDistribution(xercesc::DOMElement* element);
  int FindScore(const xercesc::DOMElement* element, const char16_t* attribute);
  int AddRule(xercesc::DOMElement* predicate, const RuleTable::Rule& rule, const std::string& id);

  const bool is_classification_;
  PredicateInputs& inputs_;
  RuleSet& rule_set_;
  std::vector<Pending> pending_;
  std::vector<LeafNodeStats> stats_;
  std::vector<const xercesc::DOMElement*> distributions_of_scores_;  ///< by score: the last that names it
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_RULE_SET_RULESETREADER_H
