#include "plugins/rule_set/RuleSetReader.h"

#include <xercesc/dom/DOMElement.hpp>

#include <cmath>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"
#include "plugins/support/Attributes.h"
#include "plugins/support/PredicateReader.h"

namespace MCKestrel_800 {
namespace {

using xercesc::DOMElement;
using Tags = PMMLTagText;

[[noreturn]] void FailOnElement(const DOMElement* element) {
  FailAt(element, KestrelException::kStructure, Narrow(element->getTagName()) + ": Invalid element!");
}

// The statistics of training that play no part in scoring.
void CheckCounts(const DOMElement* element) {
  ReadNumberOr(element, Tags::XML_ATT_RULESET_RECOUNT, 0.0);
  ReadNumberOr(element, Tags::XML_ATT_RULESET_NBCORRECT, 0.0);
}

}  // namespace

void RuleSetReader::Read(DOMElement* element) {
  CheckCounts(element);
  ReadSelection(element);
  ReadRules(element);
  ReadDefault(element);
  // The scores of rules come first in the list of scores, because ties go by it.
  if (is_classification_) {
    for (const Pending& pending : pending_)
      rule_set_.rules.SetDistribution(pending.rule, ReadDistribution(pending.element));
    rule_set_.default_distribution = ReadDistribution(element);
  }
  rule_set_.rules.Seal();
  rule_set_.distributions.Seal();
}

void RuleSetReader::ReadSelection(const DOMElement* element) {
  // Of several methods, the first is the one that the document's author prefers.
  const DOMElement* method = FirstChild(element, Tags::XML_ELE_RULESET_RULESELECMETHOD);
  if (method == nullptr) {
    FailAt(element, KestrelException::kMissingElement, "Node is missing --- RuleSelectionMethod ---");
  }
  const std::string criterion =
      Narrow(BaseTranslator::GetAttributeForced(method, PMMLModelTags::XML_ATT_RULESET_RULESELECMETHOD));
  if (!FindRuleSelection(criterion, rule_set_.selection)) {
    FailOnAttribute(method, Tags::XML_ATT_RULESET_RULESELECMETHOD, criterion);
  }
}

// Rules may be nested as deep as elements may be, so the way back up is kept here and not on the stack.
void RuleSetReader::ReadRules(DOMElement* rule_set) {
  struct Level {
    int compound;
    const DOMElement* predicate;
    DOMElement* next;
  };
  std::vector<Level> levels = {{RuleTable::kNone, nullptr, FirstChild(rule_set)}};
  while (!levels.empty()) {
    Level& level = levels.back();
    DOMElement* const element = level.next;
    if (element == nullptr) {
      if (level.compound != RuleTable::kNone) rule_set_.rules.Close(level.compound);
      levels.pop_back();
      continue;
    }
    level.next = NextSibling(element);
    if (ElementIs(element, Tags::XML_ELE_RULESET_RULE_SIMPLE)) {
      ReadSimpleRule(element);
    } else if (ElementIs(element, Tags::XML_ELE_RULESET_RULE_COMP)) {
      DOMElement* const predicate = FindPredicate(element);
      const int compound = AddRule(predicate, RuleTable::Rule(), std::string());
      levels.push_back({compound, predicate, FirstChild(element)});
    } else if (element != level.predicate && !IsExtension(element)) {
      const bool is_part = levels.size() == 1 && (ElementIs(element, Tags::XML_ELE_RULESET_RULESELECMETHOD) ||
                                                  ElementIs(element, Tags::XML_ELE_SCOREDISTRIBUTION));
      if (!is_part) FailOnElement(element);
    }
  }
}

void RuleSetReader::ReadSimpleRule(DOMElement* element) {
  DOMElement* const predicate = FindPredicate(element);
  bool has_distribution = false;
  for (const DOMElement* child : ChildElements(element)) {
    if (ElementIs(child, Tags::XML_ELE_SCOREDISTRIBUTION)) {
      has_distribution = true;
    } else if (child != predicate && !IsExtension(child)) {
      FailOnElement(child);
    }
  }
  CheckCounts(element);
  RuleTable::Rule rule;
  BaseTranslator::GetAttributeForced(element, PMMLModelTags::XML_ATT_SCORE);
  rule.score = FindScore(element, Tags::XML_ATT_SCORE);
  rule.weight = ReadNumberOr(element, Tags::XML_ATT_SIMPLERULE_WEIGHT, rule.weight);
  rule.confidence = ReadNumberOr(element, Tags::XML_ATT_SIMPLERULE_CONF, rule.confidence);
  const int number = AddRule(predicate, rule, AttributeText(element, Tags::XML_ATT_SIMPLERULE_ID));
  if (has_distribution) pending_.push_back({element, number});
}

int RuleSetReader::FindScore(const DOMElement* element, const char16_t* attribute) {
  if (is_classification_) return rule_set_.scores.FindCategory(element, AttributeText(element, attribute));
  return rule_set_.scores.FindNumber(ReadNumber(element, attribute));
}

int RuleSetReader::AddRule(DOMElement* predicate, const RuleTable::Rule& rule, const std::string& id) {
  return rule_set_.rules.Add(ReadCondition(predicate, inputs_, rule_set_.rules.GetConditions()), rule, id);
}

void RuleSetReader::ReadDefault(DOMElement* element) {
  if (!IsEmpty(Attribute(element, Tags::XML_ATT_RULESET_DEFAULTSCORE))) {
    rule_set_.default_score = FindScore(element, Tags::XML_ATT_RULESET_DEFAULTSCORE);
  }
  rule_set_.default_confidence =
      ReadNumberOr(element, Tags::XML_ATT_RULESET_DEFAULTCONF, rule_set_.default_confidence);
}

// The probabilities when all are given; else the shares of the record counts.
int RuleSetReader::ReadDistribution(DOMElement* element) {
  PMMLTranslator::SetLeafNodeStats(element, stats_);
  double total = 0.0;
  bool has_probabilities = true;
  for (const LeafNodeStats& stats : stats_) {
    total += stats.record_count;
    has_probabilities &= !NumericValue::IsSystemMissingValue(stats.probability);
  }
  std::vector<DistributionTable::Share> shares;
  auto stats = stats_.begin();
  for (const DOMElement* child : ChildElements(element, Tags::XML_ELE_SCOREDISTRIBUTION)) {
    const int score = rule_set_.scores.FindCategory(child, stats->value);
    const auto place = static_cast<std::size_t>(score);
    if (distributions_of_scores_.size() <= place) distributions_of_scores_.resize(place + 1, nullptr);
    if (distributions_of_scores_[place] == element) {
      FailAt(child, KestrelException::kStructure, "\"" + stats->value + "\": Duplicated Category Value!");
    }
    distributions_of_scores_[place] = element;
    shares.push_back({score, has_probabilities ? stats->probability : stats->record_count / total});
    ++stats;
  }
  // Without records there is nothing to have shares of.
  const bool has_shares = has_probabilities || (total > 0.0 && std::isfinite(total));
  if (shares.empty() || !has_shares) return DistributionTable::kNone;
  return rule_set_.distributions.Add(shares);
}

}  // namespace MCKestrel_800
