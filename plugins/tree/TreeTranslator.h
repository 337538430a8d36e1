// Reads the TreeModel of a PMML document.

#ifndef KESTREL_PLUGINS_TREE_TREETRANSLATOR_H
#define KESTREL_PLUGINS_TREE_TREETRANSLATOR_H

#include <memory>

#include "plugins/support/ModelTranslator.h"

namespace MCKestrel_800 {

/// Builds trees from a `TreeModel` element. Errors: those of ModelTranslator, TreeOptions and NodeReader;
/// code 4 for a `TreeModel` without `Node`.
class TreeTranslator : public ModelTranslator {
 public:
  TreeTranslator();

 protected:
  std::unique_ptr<ScoreModel> BuildModel(xercesc::DOMElement* element,
                                         ModelDictionaries dictionaries) override;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_TREE_TREETRANSLATOR_H
