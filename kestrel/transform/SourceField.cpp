#include "kestrel/transform/SourceField.h"

#include <cmath>
#include <typeinfo>

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
      misses_sysmis_(variable == nullptr || variable->GetVarType() != ScoreDictVar::STRING_VAR),
      text_(&EmptyText()) {}

void SourceField::Set(const ScoreValue* value) {
  value_ = value;
  has_key_ = false;
  has_code_ = false;
  if (value != nullptr && typeid(*value) == typeid(NumericValue)) {
    number_ = static_cast<const NumericValue*>(value)->NumericValue::GetDouble();
    is_missing_ =
        takes_every_value_ ? misses_sysmis_ && number_ == NumericValue::gSysmisValue : AsksForMissing(*value);
    if (kind_ == Kind::kNumber) return;
    kind_ = Kind::kNumber;
    seconds_ = NumericValue::gSysmisValue;
    text_ = &EmptyText();
    return;
  }
  if (value != nullptr && typeid(*value) == typeid(StringValue)) {
    text_ = static_cast<const StringValue*>(value);
    is_missing_ = !takes_every_value_ && AsksForMissing(*value);
    if (kind_ == Kind::kText) return;
    kind_ = Kind::kText;
    number_ = NumericValue::gSysmisValue;
    seconds_ = NumericValue::gSysmisValue;
    return;
  }
  number_ = NumericValue::gSysmisValue;
  seconds_ = NumericValue::gSysmisValue;
  text_ = &EmptyText();
  kind_ = Kind::kNone;
  is_missing_ = true;
  if (value != nullptr) SetOther(*value);
}

// Dates, and values of a host's own class.
void SourceField::SetOther(const ScoreValue& value) {
  is_missing_ = AsksForMissing(value);
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
}

bool SourceField::AsksForMissing(const ScoreValue& value) const {
  return variable_ == nullptr ? value.IsSystemMissingValue() : variable_->IsMissingValue(&value);
}

const ValueKey& SourceField::GetKey() const {
  if (!has_key_) {
    key_ = MakeValueKey(value_);
    has_key_ = true;
  }
  return key_;
}

}  // namespace MCKestrel_800
