#include "plugins/rule_set/RuleScores.h"

#include "plugins/rule_set/FiniteNumber.h"

namespace MCKestrel_800 {

int RuleScores::Find(const xercesc::DOMElement* element, const std::string& text) {
  if (is_classification_) return categories_.Find(element, text);
  const double number = ReadFiniteNumber(element, text);
  const auto [found, is_new] = positions_.emplace(number, GetCount());
  if (is_new) numbers_.emplace_back(number);
  return found->second;
}

}  // namespace MCKestrel_800
