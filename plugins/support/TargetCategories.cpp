#include "plugins/support/TargetCategories.h"

#include <xercesc/dom/DOMElement.hpp>

#include <utility>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/BaseTranslator.h"
#include "kestrel/translate/ReaderFault.h"

namespace MCKestrel_800 {

TargetCategories::TargetCategories(const ScoreDictVar* target)
    : text_("target", ScoreDictVar::STRING_VAR),
      target_(target == nullptr ? text_ : *target),
      rules_(target_) {
  const ScoreValueLabelSet* labels = target_.GetValueLabels();
  if (labels == nullptr || target_.GetMLevel() == ScoreDictVar::kContinuous) return;
  for (const ScoreValueLabel* label : labels->GetAllValueLabels())
    values_.emplace_back(label->GetValue()->Clone());
}

int TargetCategories::Find(const xercesc::DOMElement* element, const std::string& text) {
  const auto found = numbers_.find(text);
  if (found != numbers_.end()) return found->second;
  const int number = Add(element, text);
  numbers_.emplace(text, number);
  return number;
}

int TargetCategories::Add(const xercesc::DOMElement* element, const std::string& text) {
  std::unique_ptr<ScoreValue> value;
  try {
    value.reset(BaseTranslator::CarefullyMakeVarValue(&target_, text));
  } catch (const KestrelException&) {
    // Reported below, with the field's name.
  }
  const int number = value == nullptr || !target_.IsValidValue(value.get()) ? ValueRules::kUnknown
                                                                            : rules_.AddCategory(*value);
  if (number == ValueRules::kUnknown) {
    FailOnField(element, KestrelException::kInvalidValue, target_.GetName(), ": invalid value!");
  }
  if (number == GetCount()) values_.push_back(std::move(value));
  return number;
}

}  // namespace MCKestrel_800
