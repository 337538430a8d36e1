// Reads the RegressionModel of a PMML document.

#ifndef KESTREL_PLUGINS_REGRESSION_REGRESSIONTRANSLATOR_H
#define KESTREL_PLUGINS_REGRESSION_REGRESSIONTRANSLATOR_H

#include <memory>
#include <string>

#include "kestrel/translate/PMMLTranslator.h"
#include "plugins/regression/RegressionModel.h"

namespace MCKestrel_800 {

/// Builds models from `DataDictionary`, `MiningSchema` and the `RegressionTable`s. `TransformationDictionary`
/// and `LocalTransformations` are not read: a predictor that names a derived field is an error. `modelType`,
/// `modelName` and `algorithmName` play no part. `targetFieldName` names the target where the mining schema
/// has none, or chooses among several.
///
/// Errors, all KestrelException, with the place in the document where it is known, beside those of the
/// readers of dictionary, mining schema and tables and of CategoryPlan:
///   code 1   a regression with more than one table, several targets without a choice;
///   code 4   no `RegressionModel` as a child of the root, no `MiningSchema`, no `RegressionTable`, no
///            `functionName`;
///   code 5   another function than regression and classification, a model marked as not scorable, a
///            `normalizationMethod` that does not fit the function;
///   code 6   an unknown `normalizationMethod`;
///   code 8   `targetFieldName` is needed and not in the dictionary;
///   code 11  a regression whose target is a text.
class RegressionTranslator : public PMMLTranslator {
 public:
  using PMMLTranslator::ParseFromTree;

  /// root  the document's root element, or any element with the dictionary and the model as children.
  /// arg   without meaning. Returns a new model that the caller deletes.
  ScoreModel* ParseFromTree(xercesc::DOMElement* root, const std::string& arg) override;

  /// Builds the model of one element with a dictionary at hand. The model gets copies of the dictionaries;
  /// the result dictionary may be null. Returns a new model that the caller deletes.
  ScoreModel* ParseFromTree(xercesc::DOMElement* modelElement, ScoreDictionary* dictionary,
                            ScoreDictionary* resultDictionary, const std::string& arg) override;

 private:
  static std::unique_ptr<RegressionModel> BuildModel(xercesc::DOMElement* element,
                                                     std::unique_ptr<ScoreDictionary> dictionary);
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_REGRESSION_REGRESSIONTRANSLATOR_H
