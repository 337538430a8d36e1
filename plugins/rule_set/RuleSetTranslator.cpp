#include "plugins/rule_set/RuleSetTranslator.h"

#include <xercesc/dom/DOMElement.hpp>

#include <utility>

#include "kestrel/translate/PMMLModelTags.h"
#include "plugins/rule_set/RuleSetModel.h"
#include "plugins/rule_set/RuleSetReader.h"

namespace MCKestrel_800 {

RuleSetTranslator::RuleSetTranslator() : ModelTranslator(PMMLModelTags::XML_ELE_RULESETMODEL) {}

std::unique_ptr<ScoreModel> RuleSetTranslator::BuildModel(xercesc::DOMElement* element,
                                                          ModelDictionaries dictionaries) {
  ModelFrame frame = ReadFrame(element, dictionaries);
  RuleSetModel::Definition definition;
  definition.inputs = std::make_unique<CaseVector>();
  definition.rule_set = std::make_unique<RuleSet>(frame.is_classification, frame.target_variable);
  PredicateInputs inputs(frame.schema, dictionaries, *definition.inputs);
  RuleSetReader reader(frame.is_classification, inputs, *definition.rule_set);
  reader.Read(
      static_cast<xercesc::DOMElement*>(GetChildByTagForced(element, PMMLModelTags::XML_ELE_RULESET)));
  definition.inputs->Seal(frame.schema, *dictionaries.data, dictionaries.derived.get());
  return std::make_unique<RuleSetModel>(std::move(dictionaries), std::move(frame), std::move(definition));
}

}  // namespace MCKestrel_800
