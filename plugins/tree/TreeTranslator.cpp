#include "plugins/tree/TreeTranslator.h"

#include <xercesc/dom/DOMElement.hpp>

#include <utility>

#include "kestrel/translate/PMMLModelTags.h"
#include "plugins/support/PredicateInputs.h"
#include "plugins/tree/NodeReader.h"
#include "plugins/tree/TreeModel.h"

namespace MCKestrel_800 {

TreeTranslator::TreeTranslator() : ModelTranslator(PMMLModelTags::XML_ELE_TREEMODEL) {}

std::unique_ptr<ScoreModel> TreeTranslator::BuildModel(xercesc::DOMElement* element,
                                                       ModelDictionaries dictionaries) {
  ModelFrame frame = ReadFrame(element, dictionaries);
  TreeOptions options;
  options.is_classification = frame.is_classification;
  options.Read(element);
  auto tree = std::make_unique<Tree>(options, frame.target_variable);
  PredicateInputs inputs(frame.schema, dictionaries, tree->inputs);
  auto* const root =
      static_cast<xercesc::DOMElement*>(GetChildByTagForced(element, PMMLModelTags::XML_ELE_NODE));
  NodeReader(inputs, *tree).Read(root);
  tree->inputs.Seal(frame.schema, *dictionaries.data, dictionaries.derived.get());
  tree->table.Seal(tree->inputs);
  return std::make_unique<TreeModel>(std::move(dictionaries), std::move(frame), std::move(tree));
}

}  // namespace MCKestrel_800
