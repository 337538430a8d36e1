#include "plugins/rule_set/RuleSetTranslator.h"

#include <xercesc/dom/DOMElement.hpp>

#include <utility>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "plugins/rule_set/RuleSetModel.h"
#include "plugins/rule_set/RuleSetReader.h"

namespace MCKestrel_800 {

RuleSetTranslator::RuleSetTranslator() : ModelTranslator(PMMLModelTags::XML_ELE_RULESETMODEL) {}

std::unique_ptr<ScoreModel> RuleSetTranslator::BuildModel(xercesc::DOMElement* element,
                                                          std::unique_ptr<ScoreDictionary> dictionary) {
  RuleSetModel::Definition definition;
  definition.frame = ReadFrame(element, *dictionary);
  const ModelFrame& frame = definition.frame;
  definition.inputs = std::make_unique<CaseVector>();
  definition.rule_set = std::make_unique<RuleSet>(frame.is_classification, frame.target_variable);
  PredicateInputs inputs(frame.schema, *dictionary, *definition.inputs);
  RuleSetReader reader(frame.is_classification, *dictionary, inputs, *definition.rule_set);
  reader.Read(
      static_cast<xercesc::DOMElement*>(GetChildByTagForced(element, PMMLModelTags::XML_ELE_RULESET)));
  definition.inputs->Seal();
  return std::make_unique<RuleSetModel>(std::move(dictionary), std::move(definition));
}

}  // namespace MCKestrel_800
