// One field of a MiningSchema: what it is to the model and how its odd values are treated.

#ifndef KESTREL_PLUGINS_SUPPORT_MININGFIELD_H
#define KESTREL_PLUGINS_SUPPORT_MININGFIELD_H

#include <limits>
#include <memory>
#include <string>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/model/ScoreModel.h"

namespace MCKestrel_800 {

/// A `MiningField` as the document gives it, its texts checked and its values made.
struct MiningField {
  /// What happens to a value that the field's variable does not accept.
  enum class InvalidTreatment {
    kReturnInvalid,  ///< the case is refused with an error status
    kAsIs,           ///< the value is used all the same
    kAsMissing,      ///< the value counts as missing
    kAsValue         ///< `invalid_replacement` takes its place
  };

  std::string name;
  /// The field's variable; belongs to a dictionary that the schema was read with.
  const ScoreDictVar* variable = nullptr;
  ScoreModel::VarRole role = ScoreModel::kPredictor;

  /// What happens to a number outside `low_value` to `high_value`; only continuous fields have outliers.
  ScoreDictVar::OutlierHandleMethod outliers = ScoreDictVar::kAsIs;
  double low_value = -std::numeric_limits<double>::infinity();
  double high_value = std::numeric_limits<double>::infinity();

  /// Takes the place of a missing value; null when there is none. Of the variable's own type.
  std::unique_ptr<ScoreValue> missing_replacement;
  /// A missing value makes the case invalid; then `missing_replacement` is not used.
  bool missing_is_invalid = false;

  InvalidTreatment invalid = InvalidTreatment::kReturnInvalid;
  /// Set exactly when `invalid` is kAsValue.
  std::unique_ptr<ScoreValue> invalid_replacement;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_MININGFIELD_H
