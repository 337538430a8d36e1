// Reads the RuleSetModel of a PMML document.

#ifndef KESTREL_PLUGINS_RULE_SET_RULESETTRANSLATOR_H
#define KESTREL_PLUGINS_RULE_SET_RULESETTRANSLATOR_H

#include <memory>

#include "plugins/support/ModelTranslator.h"

namespace MCKestrel_800 {

/// Builds models from the `RuleSet` in a `RuleSetModel`. Errors, all KestrelException with the place in the
/// document: those of ModelTranslator and RuleSetReader; code 4 for a model without `RuleSet`.
class RuleSetTranslator : public ModelTranslator {
 public:
  RuleSetTranslator();

 protected:
  std::unique_ptr<ScoreModel> BuildModel(xercesc::DOMElement* element,
                                         ModelDictionaries dictionaries) override;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_RULE_SET_RULESETTRANSLATOR_H
