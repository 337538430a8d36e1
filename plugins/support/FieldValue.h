// What a value means in the field that it is given for.

#ifndef KESTREL_PLUGINS_SUPPORT_FIELDVALUE_H
#define KESTREL_PLUGINS_SUPPORT_FIELDVALUE_H

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/ScoreValue.h"
#include "plugins/support/ValueRules.h"

namespace MCKestrel_800 {

/// The number that a value of the variable stands for: of a date/time the number in the variable's unit, of a
/// text the number that all of it reads as, the system-missing value when it reads as none.
double NumberOf(const ScoreValue& value, const ScoreDictVar& variable);

bool IsEmptyText(const ScoreValue& value);

/// What the variable says of the empty text where it stands for a missing value: that it is invalid, because
/// it is not one of the categories that the field lists (it is what ScoreCaseRecord::SetMissingValue leaves
/// behind); of a derived field that lists none, that it is valid.
ValueRules::Verdict VerdictOfMissingText(const ScoreDictVar& variable);

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_FIELDVALUE_H
