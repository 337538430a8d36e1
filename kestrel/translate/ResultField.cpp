#include "kestrel/translate/ResultField.h"

#include <cstdint>
#include <memory>
#include <set>
#include <typeinfo>
#include <utility>

#include "kestrel/dictionary/LayoutStamp.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/foundation/StringValue.h"

namespace MCKestrel_800 {

namespace {

/// The value when it is exactly a `Value`; null otherwise, and for null. A class derived from it may hold
/// more, which writing over it would leave as it was.
template <typename Value>
Value* AsExactly(ScoreValue* value) {
  return value != nullptr && typeid(*value) == typeid(Value) ? static_cast<Value*>(value) : nullptr;
}

/// Copies a value over another one of the same class, one of the library's own; false when they are not.
template <typename Value>
bool AssignExactly(const ScoreValue& from, ScoreValue* to) {
  Value* const target = AsExactly<Value>(to);
  if (target == nullptr || typeid(from) != typeid(Value)) return false;
  *target = static_cast<const Value&>(from);
  return true;
}

bool AssignInPlace(const ScoreValue& from, ScoreValue* to) {
  return AssignExactly<NumericValue>(from, to) || AssignExactly<StringValue>(from, to) ||
         AssignExactly<DateTimeValue>(from, to);
}

void WriteText(StringValue& value, const std::string& text) {
  value.SetString(text);
  value.SetLength(static_cast<int32_t>(text.size()));
}

/// A date/time keeps what kind of one it is.
void MakeMissing(ScoreValue& value) {
  if (auto* const text = AsExactly<StringValue>(&value)) {
    WriteText(*text, std::string());
  } else if (auto* const moment = AsExactly<DateTimeValue>(&value)) {
    moment->SetDateTimeValue(NumericValue::GetSysmisValue(), moment->GetDateTimeType());
  } else if (value.GetType() == ScoreValue::kString) {
    const StringValue none;
    value.SetValue(&none);
  } else if (value.GetType() == ScoreValue::kDateTime) {
    const DateTimeValue none;
    value.SetValue(&none);
  } else {
    value.SetValue(&NumericValue::SYSMIS);
  }
}

}  // namespace

ResultField::ResultField() = default;

// Through the other constructor, so that the destructor runs when a value cannot be cloned.
ResultField::ResultField(const ResultField& other) : ResultField() {
  for (const auto& [name, value] : other.values_)
    AddResultField(name, value != nullptr ? value->Clone() : nullptr);
}

ResultField& ResultField::operator=(const ResultField& other) {
  if (this == &other) return *this;
  ResultField copy(other);
  const bool had_fields = stamp_ != 0;
  values_.swap(copy.values_);
  stamp_ = had_fields && values_.empty() ? NewLayoutStamp() : copy.stamp_;
  return *this;
}

ResultField::~ResultField() {
  DeleteValues();
}

void ResultField::DeleteValues() {
  for (auto& [name, value] : values_) {
    delete value;
    value = nullptr;
  }
}

void ResultField::SetMapResultValue(const ValueMap& values) {
  if (&values == &values_ || (values.empty() && values_.empty())) return;
  ValueMap taken(values);
  std::set<const ScoreValue*> kept;
  for (const auto& [name, value] : taken)
    kept.insert(value);
  for (auto& [name, value] : values_) {
    if (kept.count(value) != 0) value = nullptr;
  }
  DeleteValues();
  values_ = std::move(taken);
  stamp_ = NewLayoutStamp();
}

const ResultField::ValueMap& ResultField::GetMapResultValue() const {
  return values_;
}

const ScoreValue* ResultField::GetResultValue(const std::string& name) const {
  const auto found = values_.find(name);
  return found != values_.end() ? found->second : nullptr;
}

ScoreValue* ResultField::GetValueForWriting(const std::string& name) {
  const auto found = values_.find(name);
  return found != values_.end() ? found->second : nullptr;
}

/// Where a field's value is kept; a name that is not there gets a place without one.
ScoreValue*& ResultField::Slot(const std::string& name) {
  const auto [place, added] = values_.try_emplace(name, nullptr);
  if (added) stamp_ = NewLayoutStamp();
  return place->second;
}

void ResultField::Replace(ScoreValue*& slot, ScoreValue* value) {
  if (slot == value) return;
  stamp_ = NewLayoutStamp();
  delete slot;
  slot = value;
}

void ResultField::SetResultValue(const std::string& name, const ScoreValue* value) {
  ScoreValue*& slot = Slot(name);
  if (value == nullptr) {
    Replace(slot, nullptr);
  } else if (value != slot && !AssignInPlace(*value, slot)) {
    Replace(slot, value->Clone());
  }
}

void ResultField::SetResultValue(const std::string& name, const std::string& text) {
  ScoreValue*& slot = Slot(name);
  if (auto* const held = AsExactly<StringValue>(slot)) {
    WriteText(*held, text);
  } else {
    Replace(slot, new StringValue(text));
  }
}

void ResultField::SetResultValue(const std::string& name, double number) {
  ScoreValue*& slot = Slot(name);
  if (auto* const held = AsExactly<NumericValue>(slot)) {
    held->SetDoubleValue(number);
  } else {
    Replace(slot, new NumericValue(number));
  }
}

int ResultField::GetResultType(const std::string& /*name*/) const {
  return 0;
}

void ResultField::AddResultField(const std::string& name, ScoreValue* value) {
  // Ours at once, so that it does not leak when there is no memory for the name.
  std::unique_ptr<ScoreValue> owned(value);
  ScoreValue*& slot = Slot(name);
  Replace(slot, owned.release());
}

std::vector<std::string> ResultField::GetResultFields() const {
  std::vector<std::string> names;
  names.reserve(values_.size());
  for (const auto& field : values_)
    names.push_back(field.first);
  return names;
}

std::size_t ResultField::GetResultSize() const {
  return values_.size();
}

void ResultField::ClearValues() {
  for (const auto& [name, value] : values_) {
    if (value != nullptr) MakeMissing(*value);
  }
}

}  // namespace MCKestrel_800
