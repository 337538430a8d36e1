#include "plugins/support/FieldTreatment.h"

#include "plugins/support/FieldValue.h"

namespace MCKestrel_800 {

FieldTreatment::FieldTreatment(const MiningField& field)
    : field_(field),
      rules_(*field.variable),
      verdict_of_missing_text_(VerdictOfMissingText(*field.variable)),
      is_text_(field.variable->GetVarType() == ScoreDictVar::STRING_VAR),
      is_date_(field.variable->GetVarType() == ScoreDictVar::kDATETIME_VAR &&
               field.variable->GetDateTimeType() != kNoDateTime),
      has_outliers_(field.variable->GetMLevel() == ScoreDictVar::kContinuous &&
                    field.outliers != ScoreDictVar::kAsIs),
      missing_(&missing_number_) {
  rules_.Seal();
  if (field.variable->GetVarType() == ScoreDictVar::kDATETIME_VAR) missing_ = &missing_date_;
  if (is_text_) missing_ = field.variable->IsDerivedVariable() ? &missing_text_ : nullptr;
}

bool FieldTreatment::Treat(const ScoreValue* value, const ScoreValue*& treated) {
  treated = value;
  const ValueRules::Verdict verdict = rules_.Judge(value);
  if (verdict == ValueRules::kMissing) return TreatMissing(value == nullptr ? missing_ : value, treated);
  if (is_text_ && verdict == verdict_of_missing_text_ && IsEmptyText(*value)) {
    return TreatMissing(missing_, treated);
  }
  if (verdict == ValueRules::kInvalid) return TreatInvalid(*value, treated);
  if (has_outliers_ || (is_date_ && value->GetType() != ScoreValue::kDateTime)) {
    return TreatNumber(NumberOf(*value, *field_.variable), treated);
  }
  return true;
}

bool FieldTreatment::TreatMissing(const ScoreValue* otherwise, const ScoreValue*& treated) const {
  treated = field_.missing_replacement == nullptr ? otherwise : field_.missing_replacement.get();
  return !field_.missing_is_invalid;
}

bool FieldTreatment::TreatInvalid(const ScoreValue& value, const ScoreValue*& treated) {
  switch (field_.invalid) {
    case MiningField::InvalidTreatment::kAsMissing:
      return TreatMissing(missing_, treated);
    case MiningField::InvalidTreatment::kAsValue:
      treated = field_.invalid_replacement.get();
      return true;
    case MiningField::InvalidTreatment::kAsIs: {
      // Where a number is needed, a text is the number that it reads as.
      if (is_text_ || value.GetType() != ScoreValue::kString) return true;
      const double number = NumberOf(value, *field_.variable);
      if (number == NumericValue::gSysmisValue) return TreatMissing(missing_, treated);
      treated = HoldNumber(number);
      return true;
    }
    default:
      return false;
  }
}

// The number that a valid value stands for.
bool FieldTreatment::TreatNumber(double number, const ScoreValue*& treated) {
  if (number == NumericValue::gSysmisValue) return TreatMissing(missing_, treated);
  if (has_outliers_ && (number < field_.low_value || number > field_.high_value)) {
    if (field_.outliers == ScoreDictVar::kAsMissingValues) return TreatMissing(missing_, treated);
    treated = HoldNumber(number < field_.low_value ? field_.low_value : field_.high_value);
  } else if (is_date_ && treated->GetType() != ScoreValue::kDateTime) {
    treated = HoldNumber(number);
  }
  return true;
}

const ScoreValue* FieldTreatment::HoldNumber(double number) {
  if (is_date_) {
    date_.SetDateTimeValue(number, field_.variable->GetDateTimeType());
    return &date_;
  }
  number_.SetDoubleValue(number);
  return &number_;
}

}  // namespace MCKestrel_800
