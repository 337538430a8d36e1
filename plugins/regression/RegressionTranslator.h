// Reads the RegressionModel of a PMML document.

#ifndef KESTREL_PLUGINS_REGRESSION_REGRESSIONTRANSLATOR_H
#define KESTREL_PLUGINS_REGRESSION_REGRESSIONTRANSLATOR_H

#include <memory>

#include "plugins/support/ModelTranslator.h"

namespace MCKestrel_800 {

/// Builds models from the `RegressionTable`s of a `RegressionModel` element.
///
/// Errors, all KestrelException with the place in the document where it is known, beside those of
/// ModelTranslator, RegressionTableReader and CategoryPlan:
///   code 1   a regression with more than one table;
///   code 4   no `RegressionTable`;
///   code 5   a `normalizationMethod` that does not fit the function;
///   code 6   an unknown `normalizationMethod`.
class RegressionTranslator : public ModelTranslator {
 public:
  RegressionTranslator();

 protected:
  std::unique_ptr<ScoreModel> BuildModel(xercesc::DOMElement* element,
                                         ModelDictionaries dictionaries) override;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_REGRESSION_REGRESSIONTRANSLATOR_H
