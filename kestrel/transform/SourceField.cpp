#include "kestrel/transform/SourceField.h"

#include <cmath>
#include <limits>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/ScoreMissingValueSet.h"
#include "kestrel/foundation/NumberText.h"
#include "kestrel/transform/TransformVar.h"

namespace MCKestrel_800 {
namespace {

const StringValue& EmptyText() {
  static const StringValue empty;
  return empty;
}

// A host's own class of variables is asked about each value.
bool TakesEveryValue(const ScoreDictVar* variable) {
  if (variable == nullptr) return true;
  if (typeid(*variable) != typeid(DictVar) && typeid(*variable) != typeid(TransformVar)) return false;
  const ScoreMissingValueSet* missing = variable->GetMissingValues();
  return missing == nullptr || missing->Size() == 0;
}

}  // namespace

double NumberIn(const std::string& text) {
  const std::size_t first = text.find_first_not_of(' ');
  if (first == std::string::npos) return NumericValue::gSysmisValue;
  const std::size_t last = text.find_last_not_of(' ');
  double number;
  const bool is_number = ParseDouble(text.data() + first, text.data() + last + 1, number);
  return is_number && std::isfinite(number) ? number : NumericValue::gSysmisValue;
}

double NumberOf(const ScoreValue& value) {
  if (value.GetType() != ScoreValue::kString) return value.GetDouble();
  if (typeid(value) == typeid(StringValue)) return NumberIn(static_cast<const StringValue&>(value).GetText());
  return NumberIn(value.GetString());
}

SourceField::SourceField(const ScoreDictVar* variable)
    : variable_(variable),
      takes_every_value_(TakesEveryValue(variable)),
      missing_number_(variable == nullptr || variable->GetVarType() != ScoreDictVar::STRING_VAR
                          ? NumericValue::gSysmisValue
                          : std::numeric_limits<double>::quiet_NaN()),
      text_(&EmptyText()) {}

void SourceField::SetNew(const ScoreValue* value) {
  number_ = NumericValue::gSysmisValue;
  operand_ = kMissingOperand;
  seconds_ = NumericValue::gSysmisValue;
  text_ = &EmptyText();
  kind_ = Kind::kNone;
  is_missing_ = true;
  plain_type_ = nullptr;
  if (value == nullptr) return;
  if (typeid(*value) == typeid(NumericValue) || typeid(*value) == typeid(StringValue)) {
    plain_type_ = &typeid(*value);
    kind_ = value->GetType() == ScoreValue::kNumeric ? Kind::kNumber : Kind::kText;
    Set(value);
  } else {
    SetOther(*value);
    AskForMissing();
  }
}

// Dates, and values of a host's own class.
void SourceField::SetOther(const ScoreValue& value) {
  kind_ = Kind::kOther;
  switch (value.GetType()) {
    case ScoreValue::kNumeric:
      kind_ = Kind::kNumber;
      number_ = value.GetDouble();
      break;
    case ScoreValue::kDateTime:
      kind_ = Kind::kDateTime;
      number_ = seconds_ = value.GetDouble();
      break;
    case ScoreValue::kString:
      kind_ = Kind::kText;
      copied_text_ = StringValue(value.GetString());
      text_ = &copied_text_;
      break;
    default:
      break;
  }
  operand_ = AsOperand(number_);
}

void SourceField::AskForMissing() {
  is_missing_ = variable_ == nullptr ? value_->IsSystemMissingValue() : variable_->IsMissingValue(value_);
}

const ValueKey& SourceField::GetKey() const {
  if (!has_key_) {
    key_ = MakeValueKey(value_);
    has_key_ = true;
  }
  return key_;
}

}  // namespace MCKestrel_800
