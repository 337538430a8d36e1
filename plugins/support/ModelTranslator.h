// What every model library's translator does the same way: the document's frame around the model element.

#ifndef KESTREL_PLUGINS_SUPPORT_MODELTRANSLATOR_H
#define KESTREL_PLUGINS_SUPPORT_MODELTRANSLATOR_H

#include <memory>
#include <string>

#include "kestrel/translate/PMMLTranslator.h"
#include "plugins/support/ModelDictionaries.h"
#include "plugins/support/ModelFrame.h"

namespace MCKestrel_800 {

class ScoreModel;

/// Reads `DataDictionary`, `TransformationDictionary` and a model element and leaves the model itself to the
/// derived class. The model's derived fields are those of the document and those of its own
/// `LocalTransformations`, which may read the former; of a name there is one. Fields of the mining schema are
/// data fields and derived fields of the document. The model's `Targets` change its dictionary before
/// anything else of the model is read. `modelName` and `algorithmName` play no part.
///
/// Errors, all KestrelException with the place in the document where it is known, beside those of the readers
/// of dictionary, derived fields, mining schema, targets and output fields:
///   code 1   no `DataDictionary`, several targets without a choice;
///   code 4   no model element as a child of the root, no `MiningSchema`, no `functionName`;
///   code 5   another function than regression and classification, a model marked as not scorable;
///   code 8   `targetFieldName` is needed and not in the dictionary;
///   code 11  a regression whose target is a text.
class ModelTranslator : public PMMLTranslator {
 public:
  using PMMLTranslator::ParseFromTree;

  /// tag  the model element's, which must live as long as the translator.
  explicit ModelTranslator(const char* tag) : tag_(tag) {}

  /// root  the document's root element, or any element with the dictionary and the model as children.
  /// arg   without meaning. Returns a new model that the caller deletes.
  ScoreModel* ParseFromTree(xercesc::DOMElement* root, const std::string& arg) override;

  /// Builds the model of one element with a dictionary at hand. The model gets copies of the dictionaries;
  /// the result dictionary may be null, and is left alone when the element has an `Output` of its own. Its
  /// derived fields are those of the element. Returns a new model that the caller deletes.
  ScoreModel* ParseFromTree(xercesc::DOMElement* modelElement, ScoreDictionary* dictionary,
                            ScoreDictionary* resultDictionary, const std::string& arg) override;

 protected:
  /// Reads the model element, with dictionaries that become the model's own once ReadFrame has completed
  /// them.
  virtual std::unique_ptr<ScoreModel> BuildModel(xercesc::DOMElement* element,
                                                 ModelDictionaries dictionaries) = 0;

  /// Reads the frame of a model element and adds its own derived fields to the dictionaries; the schema
  /// speaks of their variables. Afterwards `derived` is null when there are none, else set up for its first
  /// case.
  static ModelFrame ReadFrame(xercesc::DOMElement* element, ModelDictionaries& dictionaries);

 private:
  const char* tag_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_MODELTRANSLATOR_H
