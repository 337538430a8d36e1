#include "plugins/support/OutputFieldReader.h"

#include <xercesc/dom/DOMElement.hpp>

#include <memory>
#include <string>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/ResultVar.h"
#include "kestrel/translate/XmlText.h"
#include "plugins/support/Attributes.h"

namespace MCKestrel_800 {
namespace {

using xercesc::DOMElement;
using Tags = PMMLTagText;
using Feature = ScoreResultField;
using RuleFeature = OutputField::RuleFeature;

constexpr Word<RuleFeature> kRuleFeatures[] = {
    {"consequent", RuleFeature::kConsequent},
    {"rule", RuleFeature::kId},
    {"ruleId", RuleFeature::kId},
    {"confidence", RuleFeature::kConfidence},
    {"antecedent", RuleFeature::kOther},
    {"support", RuleFeature::kOther},
    {"lift", RuleFeature::kOther},
    {"leverage", RuleFeature::kOther},
    {"affinity", RuleFeature::kOther},
};

// Older documents say it beside the feature "ruleValue", newer ones with the feature itself.
RuleFeature ReadRuleFeature(const DOMElement* element) {
  const std::string feature = AttributeText(element, Tags::XML_ATT_VAL_MINING_FEATURE);
  if (const Word<RuleFeature>* word = FindWord(kRuleFeatures, feature)) return word->meaning;
  const XMLCh* text = FindAttribute(element, u"ruleFeature");
  if (text == nullptr) return RuleFeature::kConsequent;
  const Word<RuleFeature>* word = FindWord(kRuleFeatures, Narrow(text));
  if (word == nullptr) FailOnAttribute(element, u"ruleFeature", Narrow(text));
  return word->meaning;
}

}  // namespace

OutputField OutputFieldReader::Read(const DOMElement* element, ScoreDictionary& results) const {
  ResultVar& variable = PMMLTranslator::ParseResultField(element, results);
  OutputField field;
  field.name = variable.GetName();
  field.feature = variable.GetFeature();
  CheckPlace(element, field.name);
  if (field.feature == Feature::kRuleValue) field.rule_feature = ReadRuleFeature(element);
  if (field.feature == Feature::kProbability || field.feature == Feature::kResidual) {
    ReadCategory(element, field);
  }
  if (IsEmpty(Attribute(element, Tags::XML_ATT_DATATYPE))) SetType(field, variable);
  field.is_text = variable.GetVarType() == ScoreDictVar::STRING_VAR;
  return field;
}

// A field may ask for what belongs to another target, or to another answer than the first one.
void OutputFieldReader::CheckPlace(const DOMElement* element, const std::string& name) const {
  const std::string target = AttributeText(element, u"targetField");
  if (!target.empty() && (target_ == nullptr || target != target_->GetName())) {
    FailOnField(element, KestrelException::kUnsupported, name,
                ": targetField -- " + target + ": Not supported!");
  }
  const std::string rank = AttributeText(element, u"rank");
  if (!rank.empty() && rank != "1") {
    FailOnField(element, KestrelException::kUnsupported, name, ": rank -- " + rank + ": Not supported!");
  }
}

// Read from the attribute and not from the variable, whose default value is of the variable's own type.
void OutputFieldReader::ReadCategory(const DOMElement* element, OutputField& field) const {
  const std::string text = AttributeText(element, Tags::XML_ATT_VALUE);
  if (text.empty() || !is_classification_) return;
  if (target_ == nullptr) {
    field.category = std::make_unique<StringValue>(text);
    return;
  }
  try {
    field.category.reset(BaseTranslator::CarefullyMakeVarValue(target_, text));
  } catch (const KestrelException&) {
    // Reported below, with the field's name.
  }
  if (field.category == nullptr || !target_->IsValidValue(field.category.get())) {
    FailOnField(element, KestrelException::kInvalidValue, field.name, ": invalid value!");
  }
}

void OutputFieldReader::SetType(const OutputField& field, ResultVar& variable) const {
  if (!TellsText(field)) return;
  variable.SetVarType(ScoreDictVar::STRING_VAR);
  if (variable.GetMLevel() == ScoreDictVar::kContinuous) variable.SetMLevel(ScoreDictVar::kNominal);
}

bool OutputFieldReader::TellsText(const OutputField& field) const {
  const bool is_text_target =
      target_ != nullptr ? target_->GetVarType() == ScoreDictVar::STRING_VAR : is_classification_;
  switch (field.feature) {
    case Feature::kPredictedValue:
      return is_text_target;
    case Feature::kRuleValue:
      return field.rule_feature == RuleFeature::kId ||
             (field.rule_feature == RuleFeature::kConsequent && is_text_target);
    case Feature::kPredictedDisplayValue:
    case Feature::kClusterId:
    case Feature::kEntityId:
    case Feature::kWarning:
      return true;
    default:
      return false;
  }
}

}  // namespace MCKestrel_800
