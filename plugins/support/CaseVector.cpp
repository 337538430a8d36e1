#include "plugins/support/CaseVector.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <typeinfo>

#include "kestrel/dictionary/ScoreCaseRecord.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "plugins/support/DerivedInputs.h"
#include "plugins/support/FieldValue.h"

namespace MCKestrel_800 {
namespace {

std::uint64_t BitsOf(double number) {
  std::uint64_t bits;
  std::memcpy(&bits, &number, sizeof bits);
  return bits;
}

// No other number has this pattern, so comparing the bits is comparing the numbers.
constexpr std::uint64_t kSysmisBits = 0xFFEFFFFFFFFFFFFFu;

}  // namespace

CaseVector::CaseVector() = default;
CaseVector::~CaseVector() = default;

int CaseVector::AddNumber(const MiningField& field, double map_missing_to) {
  return AddSlot(field, false, map_missing_to, kOtherCategory);
}

int CaseVector::AddCategory(const MiningField& field, double other_code) {
  return AddSlot(field, true, std::numeric_limits<double>::quiet_NaN(), other_code);
}

int CaseVector::AddSlot(const MiningField& field, bool is_category, double map_missing_to,
                        double other_code) {
  const double parts[] = {map_missing_to, other_code};
  char bits[sizeof parts];
  std::memcpy(bits, parts, sizeof bits);
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
  slots_.push_back(
      {&field, rules_[place->second].get(), is_category, map_missing_to, other_code, place->second});
  return number;
}

int CaseVector::AddCategoryValue(int slot, const ScoreValue& value) {
  return slots_[slot].rules->AddCategory(value);
}

int CaseVector::GetCodeCount(int slot) const {
  return slots_[slot].rules->GetCodeCount();
}

void CaseVector::Seal() {
  for (const std::unique_ptr<ValueRules>& rules : rules_)
    rules->Seal();
  for (Slot& slot : slots_)
    Prepare(slot);
  for (int i = 0; i < GetSlotCount(); ++i) {
    if (!slots_[i].is_plain) other_slots_.push_back(i);
  }
  plain_slots_.reserve(slots_.size());
  values_.assign(slots_.size(), NumericValue::gSysmisValue);
  slot_numbers_.clear();
  field_positions_.clear();
}

void CaseVector::Seal(const MiningSchema& schema, const ScoreDictionary& data,
                      TransformationDictionary* derived) {
  Seal();
  const bool reads_derived = std::any_of(fields_.begin(), fields_.end(), [&data](const MiningField* field) {
    return data.GetVar(field->name) == nullptr;
  });
  if (derived == nullptr || !reads_derived) return;
  derived_ = std::make_unique<DerivedInputs>(schema, data, *derived, fields_);
  for (Slot& slot : slots_)
    slot.position = derived_->GetPosition(slot.field_position);
  PlaceSlots();
}

void CaseVector::Prepare(Slot& slot) {
  const MiningField& field = *slot.field;
  const ScoreDictVar& variable = *field.variable;
  const auto place = [&slot](const ScoreValue& value) {
    return slot.is_category ? CodeValue(slot, slot.rules->FindCode(value))
                            : NumberOf(value, *slot.field->variable);
  };
  slot.is_text = variable.GetVarType() == ScoreDictVar::STRING_VAR;
  slot.verdict_of_missing_text = VerdictOfMissingText(variable);
  slot.has_outliers =
      variable.GetMLevel() == ScoreDictVar::kContinuous && field.outliers != ScoreDictVar::kAsIs;
  if (slot.is_category) slot.missing_value = kMissingCategory;
  if (!std::isnan(slot.map_missing_to)) slot.missing_value = slot.map_missing_to;
  if (field.missing_replacement != nullptr) slot.missing_value = place(*field.missing_replacement);
  if (slot.missing_value == NumericValue::gSysmisValue) slot.missing_outcome = kMissingNumber;
  if (field.invalid_replacement != nullptr) slot.invalid_value = place(*field.invalid_replacement);
  slot.is_plain =
      !slot.is_category && !slot.has_outliers && !field.missing_is_invalid && slot.rules->TakesEveryNumber();
}

double CaseVector::CodeValue(const Slot& slot, int code) {
  return code == ValueRules::kUnknown ? slot.other_code : code;
}

unsigned CaseVector::Fill(const ScoreCaseRecord& record) {
  if (derived_ != nullptr) return FillWithDerived(record);
  const unsigned long long stamp = record.GetLayoutStamp();
  if (stamp == 0) {
    layout_stamp_ = 0;
    LookUpPositions(record);
    return FillFrom(GatherValues(record));
  }
  const std::vector<ScoreValue*>& values = record.GetAllValues();
  if (stamp != layout_stamp_ || values.size() < static_cast<std::size_t>(positions_end_)) {
    LookUpPositions(record);
    layout_stamp_ = stamp;
  }
  return FillFrom(values.data());
}

// A record without a layout stamp promises nothing about its values as a whole.
const ScoreValue* const* CaseVector::GatherValues(const ScoreCaseRecord& record) {
  gathered_.assign(static_cast<std::size_t>(positions_end_), nullptr);
  for (const Slot& slot : slots_) {
    if (slot.position >= 0) gathered_[static_cast<std::size_t>(slot.position)] = record.Get(slot.position);
  }
  return gathered_.data();
}

// Positions are those among the values of DerivedInputs, where every field has one.
unsigned CaseVector::FillWithDerived(const ScoreCaseRecord& record) {
  if (derived_->Compute(record)) return FillFrom(derived_->GetValues());
  invalid_slot_ = kNoSlot;
  return kInvalidInput;
}

void CaseVector::LookUpPositions(const ScoreCaseRecord& record) {
  const int size = static_cast<int>(record.Size());
  positions_end_ = 0;
  for (Slot& slot : slots_) {
    const int position = record.GetIndex(slot.field->name);
    slot.position = position < size ? position : -1;
    positions_end_ = std::max(positions_end_, slot.position + 1);
  }
  PlaceSlots();
}

void CaseVector::PlaceSlots() {
  absent_outcome_ = kComplete;
  plain_slots_.clear();
  for (int i = 0; i < GetSlotCount(); ++i) {
    const Slot& slot = slots_[i];
    if (!slot.is_plain) continue;
    if (slot.position >= 0) {
      plain_slots_.push_back(
          {static_cast<std::size_t>(slot.position), static_cast<std::size_t>(i), BitsOf(slot.missing_value)});
    } else {
      values_[i] = slot.missing_value;
      absent_outcome_ |= slot.missing_outcome;
    }
  }
  missing_slots_.resize(plain_slots_.size() + 1);
}

unsigned CaseVector::FillFrom(const ScoreValue* const* record) {
  invalid_slot_ = GetSlotCount();
  unsigned outcome = absent_outcome_;
  const PlainSlot* const end = plain_slots_.data() + plain_slots_.size();
  const PlainSlot** missing_end = missing_slots_.data();
  for (const PlainSlot* slot = plain_slots_.data();; ++slot) {
    slot = CopyNumbers(slot, record, missing_end);
    if (slot == end) break;
    outcome |= FillTreated(static_cast<int>(slot->number), record[slot->position]);
  }
  for (const PlainSlot* const* slot = missing_slots_.data(); slot != missing_end; ++slot) {
    std::memcpy(&values_[(*slot)->number], &(*slot)->missing_bits, sizeof(double));
    if ((*slot)->missing_bits == kSysmisBits) outcome |= kMissingNumber;
  }
  for (const int number : other_slots_) {
    const int position = slots_[number].position;
    outcome |= FillTreated(number, position < 0 ? nullptr : record[position]);
  }
  return outcome;
}

// Copies numbers from the slot on and lists those that are missing. Stops at a value that is not of the
// library's own number class, or at the end. (Addresses of type descriptions are compared, which at worst
// stops at a number, too.)
//
// Which values of a case are missing is as good as random, so nothing here branches on a single one: every
// slot is written behind the list, which grows when the number was missing. The loop calls nothing, so that
// all it uses stays in registers.
const CaseVector::PlainSlot* CaseVector::CopyNumbers(const PlainSlot* slot, const ScoreValue* const* record,
                                                     const PlainSlot**& missing_end) {
  double* const values = values_.data();
  const PlainSlot* const end = plain_slots_.data() + plain_slots_.size();
  const PlainSlot** missing = missing_end;
  const std::type_info* const own_number = &typeid(NumericValue);
  for (; slot != end; ++slot) {
    const ScoreValue* const value = record[slot->position];
    if (value == nullptr || &typeid(*value) != own_number) break;
    const double number = static_cast<const NumericValue*>(value)->NumericValue::GetDouble();
    *missing = slot;
    missing += BitsOf(number) == kSysmisBits;
    values[slot->number] = number;
  }
  missing_end = missing;
  return slot;
}

unsigned CaseVector::FillTreated(int number, const ScoreValue* value) {
  const Slot& slot = slots_[number];
  if (value == nullptr) return FillMissing(number);
  int code = ValueRules::kUnknown;
  ValueRules::Verdict verdict;
  if (slot.is_text && typeid(*value) == typeid(StringValue)) {
    const std::string& text = static_cast<const StringValue*>(value)->GetText();
    verdict = slot.rules->JudgeText(text, code);
    if (verdict == slot.verdict_of_missing_text && text.empty()) verdict = ValueRules::kMissing;
  } else {
    verdict = slot.rules->Judge(value);
    if (verdict == ValueRules::kValid && !slot.has_outliers) {
      if (!slot.is_category) return FillNumber(number, NumberOf(*value, *slot.field->variable));
      code = slot.rules->FindCode(*value);
    }
    if (verdict == slot.verdict_of_missing_text && slot.is_text && IsEmptyText(*value)) {
      verdict = ValueRules::kMissing;
    }
  }
  if (verdict == ValueRules::kMissing) return FillMissing(number);
  if (verdict == ValueRules::kInvalid) return FillInvalid(number, *value);
  if (slot.has_outliers) return FillNumber(number, NumberOf(*value, *slot.field->variable));
  values_[number] = CodeValue(slot, code);
  return kComplete;
}

// A valid number, into a slot of either kind.
unsigned CaseVector::FillNumber(int number, double value) {
  const Slot& slot = slots_[number];
  if (value == NumericValue::gSysmisValue) return FillMissing(number);
  if (slot.has_outliers) {
    const MiningField& field = *slot.field;
    if (value < field.low_value || value > field.high_value) {
      if (field.outliers == ScoreDictVar::kAsMissingValues) return FillMissing(number);
      value = value < field.low_value ? field.low_value : field.high_value;
    }
  }
  values_[number] = slot.is_category ? CodeValue(slot, slot.rules->FindCode(NumericValue(value))) : value;
  return kComplete;
}

unsigned CaseVector::FillMissing(int number) {
  if (slots_[number].field->missing_is_invalid) return RefuseCase(number);
  values_[number] = slots_[number].missing_value;
  return slots_[number].missing_outcome;
}

unsigned CaseVector::FillInvalid(int number, const ScoreValue& value) {
  const Slot& slot = slots_[number];
  switch (slot.field->invalid) {
    case MiningField::InvalidTreatment::kAsMissing:
      return FillMissing(number);
    case MiningField::InvalidTreatment::kAsValue:
      values_[number] = slot.invalid_value;
      return kComplete;
    case MiningField::InvalidTreatment::kAsIs:
      if (slot.is_category) {
        values_[number] = CodeValue(slot, slot.rules->FindCode(value));
        return kComplete;
      }
      values_[number] = NumberOf(value, *slot.field->variable);
      return values_[number] == NumericValue::gSysmisValue ? FillMissing(number) : kComplete;
    default:
      return RefuseCase(number);
  }
}

unsigned CaseVector::RefuseCase(int number) {
  invalid_slot_ = std::min(invalid_slot_, number);
  return kInvalidInput;
}

std::vector<const ScoreDictVar*> CaseVector::GetPredictors() const {
  if (derived_ != nullptr) return derived_->GetDataFields();
  std::vector<const ScoreDictVar*> variables;
  for (const MiningField* field : fields_)
    variables.push_back(field->variable);
  return variables;
}

int CaseVector::GetInvalidField() const {
  if (invalid_slot_ == kNoSlot) return derived_->GetRefusedField();
  const int field = slots_[invalid_slot_].field_position;
  return derived_ == nullptr ? field : derived_->GetDataField(field);
}

}  // namespace MCKestrel_800
