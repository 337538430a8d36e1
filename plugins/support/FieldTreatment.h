// A mining field's treatment of a case's value, for those that read the value itself: the derived fields.

#ifndef KESTREL_PLUGINS_SUPPORT_FIELDTREATMENT_H
#define KESTREL_PLUGINS_SUPPORT_FIELDTREATMENT_H

#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/foundation/StringValue.h"
#include "plugins/support/MiningField.h"
#include "plugins/support/ValueRules.h"

namespace MCKestrel_800 {

/// Gives a value as the mining schema makes it. The rules are those that a CaseVector's slots follow; tests
/// hold the two against each other.
///
/// A value that is missing by itself and not replaced stays as it is. One that the treatment makes missing,
/// an empty text that stands for a missing one, and no value at all become the system-missing number
/// (date/time) or, of a text, nothing; of a derived field's text the empty one, which is missing there. A
/// number that is given for a date/time becomes one.
///
/// Serves one case at a time. The field and its variable must outlive the treatment.
class FieldTreatment {
 public:
  explicit FieldTreatment(const MiningField& field);
  FieldTreatment(const FieldTreatment&) = delete;
  FieldTreatment& operator=(const FieldTreatment&) = delete;

  const MiningField& GetField() const { return field_; }

  /// value    the case's; null when it has none.
  /// treated  set to the value itself, or to one that is the treatment's or the field's and valid until the
  ///          next call; null for none.
  /// False when the value makes the case invalid.
  bool Treat(const ScoreValue* value, const ScoreValue*& treated);

 private:
  bool TreatMissing(const ScoreValue* otherwise, const ScoreValue*& treated) const;
  bool TreatInvalid(const ScoreValue& value, const ScoreValue*& treated);
  bool TreatNumber(double number, const ScoreValue*& treated);
  const ScoreValue* HoldNumber(double number);

  const MiningField& field_;
  ValueRules rules_;
  const ValueRules::Verdict verdict_of_missing_text_;
  const bool is_text_;
  const bool is_date_;
  const bool has_outliers_;
  const ScoreValue* missing_;  ///< what takes the place of a value that the treatment makes missing
  NumericValue number_;
  DateTimeValue date_;
  const NumericValue missing_number_;
  const DateTimeValue missing_date_;
  const StringValue missing_text_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_FIELDTREATMENT_H
