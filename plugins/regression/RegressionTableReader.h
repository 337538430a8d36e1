// Reads the `RegressionTable` elements of a document.

#ifndef KESTREL_PLUGINS_REGRESSION_REGRESSIONTABLEREADER_H
#define KESTREL_PLUGINS_REGRESSION_REGRESSIONTABLEREADER_H

#include <xercesc/util/XercesDefs.hpp>

#include <string>

#include "plugins/regression/RegressionTable.h"
#include "plugins/support/MiningSchema.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

/// Reads tables of one model. The schema and the target must outlive the tables that are read.
///
/// Errors, all KestrelException with the place in the document:
///   code 1   an element that does not belong here, a predictor without name, a `PredictorTerm` without
///            `FieldRef`;
///   code 3   a number that is none;
///   code 4   an attribute that is required (`name`, `field`, `coefficient`, `value`, a classification's
///            `targetCategory`) and absent;
///   code 7   a `targetCategory` or a `CategoricalPredictor`'s value that is no value of its field, or not
///            one of the categories that the field lists;
///   code 8   a predictor that is neither one of the active fields nor a derived field;
///   code 11  a text field where a number is needed.
class RegressionTableReader {
 public:
  /// target  the model's target, or null: then categories are texts.
  RegressionTableReader(const MiningSchema& schema, const ScoreDictVar* target)
      : schema_(schema), target_(target) {}

  /// Reads one element. With `needs_category` a table without `targetCategory` is an error; otherwise the
  /// attribute is not looked at.
  RegressionTable Read(const xercesc::DOMElement* element, bool needs_category) const;

 private:
  RegressionTerm ReadNumericPredictor(const xercesc::DOMElement* element) const;
  RegressionTerm ReadCategoricalPredictor(const xercesc::DOMElement* element) const;
  RegressionTerm ReadPredictorTerm(const xercesc::DOMElement* element) const;
  RegressionTerm::Factor ReadFieldRef(const xercesc::DOMElement* element) const;
  const MiningField* FindField(const xercesc::DOMElement* element, const char* attribute) const;
  const MiningField* FindNumber(const xercesc::DOMElement* element, const char* attribute) const;
  std::unique_ptr<ScoreValue> ReadCategory(const xercesc::DOMElement* element) const;

  const MiningSchema& schema_;
  const ScoreDictVar* target_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_REGRESSION_REGRESSIONTABLEREADER_H
