#include "plugins/support/CaseVector.h"

#include <algorithm>
#include <cmath>
#include <cstring>

#include "kestrel/dictionary/ScoreCaseRecord.h"
#include "kestrel/foundation/NumberText.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"

namespace MCKestrel_800 {
namespace {

// The number that a value stands for; a text counts when all of it is a number.
double NumberOf(const ScoreValue& value) {
  if (value.GetType() != ScoreValue::kString) return value.GetDouble();
  const std::string& text = static_cast<const StringValue&>(value).GetText();
  double number;
  return ParseDouble(text.data(), text.data() + text.size(), number) ? number : NumericValue::gSysmisValue;
}

/// Values by position from the array that a record with a layout stamp shows.
struct ArraySource {
  const ScoreValue* const* values;
  const ScoreValue* At(int position) const { return values[position]; }
};

/// Values by position from a record that promises nothing.
struct RecordSource {
  const ScoreCaseRecord& record;
  const ScoreValue* At(int position) const { return record.Get(position); }
};

}  // namespace

CaseVector::CaseVector() = default;
CaseVector::~CaseVector() = default;

int CaseVector::AddNumber(const MiningField& field, double map_missing_to) {
  return AddSlot(field, false, map_missing_to);
}

int CaseVector::AddCategory(const MiningField& field) {
  return AddSlot(field, true, std::numeric_limits<double>::quiet_NaN());
}

int CaseVector::AddSlot(const MiningField& field, bool is_category, double map_missing_to) {
  char bits[sizeof map_missing_to];
  std::memcpy(bits, &map_missing_to, sizeof bits);
  std::string key = field.name + (is_category ? "c" : "n");
  key.append(bits, sizeof bits);
  const int number = GetSlotCount();
  const auto [found, is_new] = slot_numbers_.emplace(std::move(key), number);
  if (!is_new) return found->second;
  const auto [place, is_new_field] = field_positions_.emplace(&field, static_cast<int>(fields_.size()));
  if (is_new_field) {
    fields_.push_back(&field);
    rules_.push_back(std::make_unique<ValueRules>(*field.variable));
  }
  slots_.emplace_back();
  treatments_.push_back({&field, rules_[place->second].get(), is_category, map_missing_to, place->second});
  return number;
}

int CaseVector::AddCategoryValue(int slot, const ScoreValue& value) {
  return treatments_[slot].rules->AddCategory(value);
}

int CaseVector::GetCodeCount(int slot) const {
  return treatments_[slot].rules->GetCodeCount();
}

void CaseVector::Seal() {
  for (const std::unique_ptr<ValueRules>& rules : rules_)
    rules->Seal();
  for (int i = 0; i < GetSlotCount(); ++i)
    Prepare(i);
  values_.assign(slots_.size(), NumericValue::gSysmisValue);
  slot_numbers_.clear();
  field_positions_.clear();
}

void CaseVector::Prepare(int number) {
  Slot& slot = slots_[number];
  Treatment& treatment = treatments_[number];
  const MiningField& field = *treatment.field;
  const ScoreDictVar& variable = *field.variable;
  const auto place = [&](const ScoreValue& value) {
    return treatment.is_category ? static_cast<double>(treatment.rules->FindCode(value)) : value.GetDouble();
  };
  treatment.is_text = variable.GetVarType() == ScoreDictVar::STRING_VAR;
  treatment.has_outliers =
      variable.GetMLevel() == ScoreDictVar::kContinuous && field.outliers != ScoreDictVar::kAsIs;
  slot.missing_value = treatment.is_category ? kMissingCategory : NumericValue::gSysmisValue;
  if (!std::isnan(treatment.map_missing_to)) slot.missing_value = treatment.map_missing_to;
  if (field.missing_replacement != nullptr) slot.missing_value = place(*field.missing_replacement);
  if (slot.missing_value == NumericValue::gSysmisValue) slot.missing_outcome = kMissingNumber;
  if (field.invalid_replacement != nullptr) treatment.invalid_value = place(*field.invalid_replacement);
  slot.is_plain = !treatment.is_category && !treatment.has_outliers && !field.missing_is_invalid &&
                  treatment.rules->TakesEveryNumber();
}

unsigned CaseVector::Fill(const ScoreCaseRecord& record) {
  const unsigned long long stamp = record.GetLayoutStamp();
  if (stamp == 0) {
    layout_stamp_ = 0;
    LookUpPositions(record);
    return FillFrom(RecordSource{record});
  }
  const std::vector<ScoreValue*>& values = record.GetAllValues();
  if (stamp != layout_stamp_ || values.size() < static_cast<std::size_t>(positions_end_)) {
    LookUpPositions(record);
    layout_stamp_ = stamp;
  }
  return FillFrom(ArraySource{values.data()});
}

void CaseVector::LookUpPositions(const ScoreCaseRecord& record) {
  const int size = static_cast<int>(record.Size());
  positions_end_ = 0;
  for (int i = 0; i < GetSlotCount(); ++i) {
    const int position = record.GetIndex(treatments_[i].field->name);
    slots_[i].position = position < size ? position : -1;
    positions_end_ = std::max(positions_end_, slots_[i].position + 1);
  }
}

template <typename Source>
unsigned CaseVector::FillFrom(const Source& source) {
  unsigned outcome = kComplete;
  double* out = values_.data();
  const int count = GetSlotCount();
  const Slot* slots = slots_.data();
  for (int i = 0; i < count; ++i) {
    const Slot& slot = slots[i];
    const ScoreValue* value = slot.position < 0 ? nullptr : source.At(slot.position);
    if (slot.is_plain) {
      // An empty slot reads like a system-missing number, so that no branch depends on which values are
      // missing.
      if (value == nullptr) value = &NumericValue::SYSMIS;
      if (value->GetType() == ScoreValue::kNumeric) {
        const double number = value->GetDouble();
        const bool is_missing = number == NumericValue::gSysmisValue;
        out[i] = is_missing ? slot.missing_value : number;
        outcome |= is_missing ? slot.missing_outcome : 0u;
        continue;
      }
    }
    outcome |= FillTreated(i, value);
    if ((outcome & kInvalidInput) != 0) return outcome;
  }
  return outcome;
}

unsigned CaseVector::FillTreated(int number, const ScoreValue* value) {
  const Treatment& treatment = treatments_[number];
  if (value == nullptr) return FillMissing(number);
  int code = ValueRules::kUnknown;
  ValueRules::Verdict verdict;
  if (treatment.is_text && value->GetType() == ScoreValue::kString) {
    const std::string& text = static_cast<const StringValue*>(value)->GetText();
    verdict = treatment.rules->JudgeText(text, code);
    if (verdict == ValueRules::kInvalid && text.empty()) verdict = ValueRules::kMissing;
  } else {
    verdict = treatment.rules->Judge(value);
    if (verdict == ValueRules::kValid && !treatment.has_outliers) {
      if (!treatment.is_category) return FillNumber(number, NumberOf(*value));
      code = treatment.rules->FindCode(*value);
    }
  }
  if (verdict == ValueRules::kMissing) return FillMissing(number);
  if (verdict == ValueRules::kInvalid) return FillInvalid(number, *value);
  if (treatment.has_outliers) return FillNumber(number, NumberOf(*value));
  values_[number] = code;
  return kComplete;
}

// A valid number, into a slot of either kind.
unsigned CaseVector::FillNumber(int number, double value) {
  const Treatment& treatment = treatments_[number];
  if (value == NumericValue::gSysmisValue) return FillMissing(number);
  if (treatment.has_outliers) {
    const MiningField& field = *treatment.field;
    if (value < field.low_value || value > field.high_value) {
      if (field.outliers == ScoreDictVar::kAsMissingValues) return FillMissing(number);
      value = value < field.low_value ? field.low_value : field.high_value;
    }
  }
  values_[number] = treatment.is_category ? treatment.rules->FindCode(NumericValue(value)) : value;
  return kComplete;
}

unsigned CaseVector::FillMissing(int number) {
  if (treatments_[number].field->missing_is_invalid) return RefuseCase(number);
  values_[number] = slots_[number].missing_value;
  return slots_[number].missing_outcome;
}

unsigned CaseVector::FillInvalid(int number, const ScoreValue& value) {
  const Treatment& treatment = treatments_[number];
  switch (treatment.field->invalid) {
    case MiningField::InvalidTreatment::kAsMissing:
      return FillMissing(number);
    case MiningField::InvalidTreatment::kAsValue:
      values_[number] = treatment.invalid_value;
      return kComplete;
    case MiningField::InvalidTreatment::kAsIs:
      if (treatment.is_category) {
        values_[number] = treatment.rules->FindCode(value);
        return kComplete;
      }
      values_[number] = NumberOf(value);
      return values_[number] == NumericValue::gSysmisValue ? FillMissing(number) : kComplete;
    default:
      return RefuseCase(number);
  }
}

unsigned CaseVector::RefuseCase(int number) {
  invalid_slot_ = number;
  return kInvalidInput;
}

int CaseVector::GetInvalidField() const {
  return treatments_[invalid_slot_].field_position;
}

}  // namespace MCKestrel_800
