// One output field of a model.

#ifndef KESTREL_TRANSLATE_RESULTVAR_H
#define KESTREL_TRANSLATE_RESULTVAR_H

#include <string>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/platform/Export.h"
#include "kestrel/translate/ScoreResultField.h"

namespace MCKestrel_800 {

/// A variable of the output dictionary: a variable like any other, with what it tells of a result. Its
/// default value is the one that the document gives it: of a probability, the category that is meant.
class KESTREL_API ResultVar : public DictVar {
 public:
  using ResultFeature = ScoreResultField::ResultFeature;

  /// Without a feature.
  ResultVar(const std::string& name, VariableType type);
  ResultVar(const ResultVar& other);
  ResultVar& operator=(const ResultVar& other);
  ~ResultVar() override;

  ResultVar* Clone() const override;

  void SetFeature(ResultFeature feature) { feature_ = feature; }
  ResultFeature GetFeature() const { return feature_; }

 private:
  ResultFeature feature_ = ScoreResultField::kNoFeature;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_RESULTVAR_H
