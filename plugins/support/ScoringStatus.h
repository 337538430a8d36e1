// The codes with which models say why a case was not scored, beside the one that the core has for missing
// data.

#ifndef KESTREL_PLUGINS_SUPPORT_SCORINGSTATUS_H
#define KESTREL_PLUGINS_SUPPORT_SCORINGSTATUS_H

namespace MCKestrel_800 {

// A status code is 90001 plus the position of its name in the table of status names (see
// MCScore::StatusName), which gives the core's 90027 its name as well. All of these are errors (severity -1).

/// "kE_NULLARG": the record or the result is null. Nothing was read or written.
constexpr long kNullArgumentStatus = 90007;

/// "kE_INVALID_VALUE": a value was refused by its field's treatment of invalid or missing values. Discrete
/// datum 0 is the position of the field's variable in the model's GetPredictors(). The prediction is null.
constexpr long kInvalidValueStatus = 90025;

/// "kE_MISSINGVAR": there is no prediction because data are missing.
constexpr long kNoPredictionStatus = 90027;

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_SCORINGSTATUS_H
