#include "kestrel/dictionary/CaseRecord.h"

#include <algorithm>
#include <memory>
#include <ostream>
#include <typeinfo>

#include "kestrel/dictionary/LayoutStamp.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"

namespace MCKestrel_800 {

namespace {

// Room that a caller asks for in advance is made up to this many slots; a wrong count must not exhaust the
// memory.
constexpr std::size_t kMaxReserve = 65536;

}  // namespace

ScoreCaseRecord::~ScoreCaseRecord() = default;

CaseRecord::CaseRecord(int n) : stamp_(NewLayoutStamp()) {
  if (n <= 0) return;
  const std::size_t room = std::min(static_cast<std::size_t>(n), kMaxReserve);
  values_.reserve(room);
  numbers_.reserve(room);
}

// Through the other constructor, so that the destructor runs when a value cannot be cloned.
CaseRecord::CaseRecord(const CaseRecord& other) : CaseRecord() {
  positions_ = other.positions_;
  stamp_ = other.stamp_;
  values_.resize(other.values_.size(), nullptr);
  numbers_.resize(other.values_.size(), nullptr);
  size_ = values_.size();
  for (std::size_t position = 0; position < values_.size(); ++position) {
    const ScoreValue* value = other.values_[position];
    if (value != nullptr) Put(position, value->Clone());
  }
}

CaseRecord& CaseRecord::operator=(const CaseRecord& other) {
  if (this == &other) return *this;
  CaseRecord copy(other);
  positions_.swap(copy.positions_);
  values_.swap(copy.values_);
  numbers_.swap(copy.numbers_);
  size_ = copy.size_;
  stamp_ = copy.stamp_;
  return *this;
}

CaseRecord::~CaseRecord() {
  for (ScoreValue* value : values_)
    delete value;
}

bool CaseRecord::HasSlot(int index) const {
  // A negative index becomes a number beyond every size.
  return static_cast<std::size_t>(index) < size_;
}

void CaseRecord::Put(std::size_t position, ScoreValue* value) {
  values_[position] = value;
  const bool isNumber = value != nullptr && typeid(*value) == typeid(NumericValue);
  numbers_[position] = isNumber ? static_cast<NumericValue*>(value) : nullptr;
}

void CaseRecord::Add(const std::string& name, ScoreValue* value) {
  const auto [it, isNew] = positions_.emplace(name, static_cast<int>(values_.size()));
  if (isNew) {
    values_.push_back(nullptr);
    numbers_.push_back(nullptr);
    size_ = values_.size();
    stamp_ = NewLayoutStamp();
  }
  Put(static_cast<std::size_t>(it->second), value);
}

bool CaseRecord::SetValue(int index, const std::string& text) {
  if (!HasSlot(index)) return false;
  const auto position = static_cast<std::size_t>(index);
  ScoreValue* value = values_[position];
  if (value == nullptr) {
    Put(position, new StringValue(text));
    return true;
  }
  if (typeid(*value) == typeid(StringValue)) {
    static_cast<StringValue*>(value)->SetString(text);
    return true;
  }
  // A date/time refuses a text as a number does: in which form it would have to be read is not known here.
  if (value->GetType() != ScoreValue::kString) return false;
  const StringValue source(text);
  value->SetValue(&source);
  return true;
}

bool CaseRecord::SetValue(const std::string& name, const std::string& text) {
  return SetValue(GetIndex(name), text);
}

bool CaseRecord::SetValue(int index, double value, DateTimeType type) {
  if (!HasSlot(index)) return false;
  const auto position = static_cast<std::size_t>(index);
  ScoreValue* held = values_[position];
  if (held == nullptr) {
    Put(position, new DateTimeValue(value, type));
    return true;
  }
  if (typeid(*held) == typeid(DateTimeValue)) {
    static_cast<DateTimeValue*>(held)->SetDateTimeValue(value, type);
    return true;
  }
  if (held->GetType() != ScoreValue::kDateTime) return false;
  const DateTimeValue source(value, type);
  held->SetValue(&source);
  return true;
}

bool CaseRecord::SetValue(const std::string& name, double value, DateTimeType type) {
  return SetValue(GetIndex(name), value, type);
}

bool CaseRecord::SetValue(int index, double value) {
  if (!HasSlot(index)) return false;
  const auto position = static_cast<std::size_t>(index);
  if (NumericValue* number = numbers_[position]) {
    number->SetDoubleValue(value);
    return true;
  }
  return SetOtherNumber(position, value);
}

bool CaseRecord::SetOtherNumber(std::size_t position, double value) {
  ScoreValue* held = values_[position];
  if (held == nullptr) {
    Put(position, new NumericValue(value));
    return true;
  }
  if (held->GetType() != ScoreValue::kNumeric) return false;
  const NumericValue source(value);
  held->SetValue(&source);
  return true;
}

bool CaseRecord::SetValue(const std::string& name, double value) {
  return SetValue(GetIndex(name), value);
}

bool CaseRecord::SetMissingValue(int index) {
  if (!HasSlot(index)) return false;
  const auto position = static_cast<std::size_t>(index);
  if (NumericValue* number = numbers_[position]) {
    number->SetDoubleValue(NumericValue::gSysmisValue);
    return true;
  }
  return SetOtherMissing(position);
}

bool CaseRecord::SetOtherMissing(std::size_t position) {
  ScoreValue* held = values_[position];
  if (held == nullptr) return false;
  if (typeid(*held) == typeid(StringValue)) {
    static_cast<StringValue*>(held)->SetString(std::string());
  } else if (held->GetType() == ScoreValue::kNumeric) {
    const NumericValue missing;
    held->SetValue(&missing);
  } else if (auto* date = dynamic_cast<DateTimeValue*>(held)) {
    date->SetDateTimeValue(NumericValue::gSysmisValue, date->GetDateTimeType());
  } else if (held->GetType() == ScoreValue::kDateTime) {
    const DateTimeValue missing;
    held->SetValue(&missing);
  } else {
    const StringValue missing;
    held->SetValue(&missing);
  }
  return true;
}

bool CaseRecord::SetMissingValue(const std::string& name) {
  return SetMissingValue(GetIndex(name));
}

void CaseRecord::Remove(const std::string& name) {
  const int index = GetIndex(name);
  if (!HasSlot(index)) return;
  const auto position = static_cast<std::size_t>(index);
  delete values_[position];
  Put(position, nullptr);
}

const ScoreValue* CaseRecord::Get(int index) const {
  return HasSlot(index) ? values_[static_cast<std::size_t>(index)] : nullptr;
}

const ScoreValue* CaseRecord::Get(const std::string& name) const {
  return Get(GetIndex(name));
}

void CaseRecord::SetUpNameIndexMap(const std::vector<std::string>& names) {
  values_.reserve(names.size());
  numbers_.reserve(names.size());
}

void CaseRecord::SetUpNameIndexMap(const std::vector<ScoreDictVar*>& vars) {
  values_.reserve(vars.size());
  numbers_.reserve(vars.size());
}

bool CaseRecord::HasMap() const {
  return true;
}

int CaseRecord::GetIndex(const std::string& name) const {
  const auto it = positions_.find(name);
  return it == positions_.end() ? -1 : it->second;
}

std::size_t CaseRecord::Size() const {
  return values_.size();
}

std::vector<std::string> CaseRecord::GetVarNames() const {
  std::vector<std::string> names;
  names.reserve(values_.size());
  for (const auto& [name, position] : positions_)
    names.push_back(name);
  names.resize(values_.size());
  return names;
}

const std::vector<ScoreValue*>& CaseRecord::GetAllValues() const {
  return values_;
}

void CaseRecord::Display(std::ostream& os) const {
  os << "Start ScoreCaseRecord Display:\n";
  for (const auto& [name, position] : positions_) {
    os << "Var Name: " << name;
    const ScoreValue* value = values_[static_cast<std::size_t>(position)];
    if (value != nullptr) os << "; Var Value: " << value->GetString();
    os << "\n";
  }
  os << "End of ScoreCaseRecord Display.\n\n";
}

unsigned long long CaseRecord::GetLayoutStamp() const {
  return stamp_;
}

}  // namespace MCKestrel_800
