#include "kestrel/model/Results.h"

#include <typeinfo>
#include <utility>

namespace MCKestrel_800 {
namespace {

/// The value as a `Value` when it is exactly one. A class derived from it may hold more, which an assignment
/// would lose. Descriptions are compared by address, which takes no look at names; one that had two would
/// only mean a clone.
template <typename Value>
const Value* AsExactly(const ScoreValue& value) {
  return &typeid(value) == &typeid(Value) ? static_cast<const Value*>(&value) : nullptr;
}

}  // namespace

ResultValue::ResultValue() = default;
ResultValue::~ResultValue() = default;
ResultValue::ResultValue(ResultValue&&) noexcept = default;
ResultValue& ResultValue::operator=(ResultValue&&) noexcept = default;

// Assigning to a variant that holds the same class assigns to the object in it, so a text's room is used
// again. Categories come in the same order case after case: mostly the text is there already.
void ResultValue::Assign(const ScoreValue& value) {
  if (const NumericValue* number = AsExactly<NumericValue>(value)) {
    Assign(number->GetDouble());
  } else if (const StringValue* text = AsExactly<StringValue>(value)) {
    const auto* const held = std::get_if<StringValue>(&held_);
    const bool is_there =
        held != nullptr && held->GetLength() == text->GetLength() && held->GetText() == text->GetText();
    if (!is_there) held_ = *text;
  } else if (const DateTimeValue* moment = AsExactly<DateTimeValue>(value)) {
    held_ = *moment;
  } else {
    held_ = std::unique_ptr<ScoreValue>(value.Clone());
  }
}

const ScoreValue* ResultValue::Get() const {
  if (const auto* number = std::get_if<NumericValue>(&held_)) return number;
  if (const auto* text = std::get_if<StringValue>(&held_)) return text;
  if (const auto* moment = std::get_if<DateTimeValue>(&held_)) return moment;
  if (const auto* other = std::get_if<std::unique_ptr<ScoreValue>>(&held_)) return other->get();
  return nullptr;
}

ClsResult::ClsResult() = default;
ClsResult::~ClsResult() = default;

void ClsResult::SetPrediction(const ScoreValue* value) {
  if (value != nullptr) prediction_.Assign(*value);
  has_prediction_ = value != nullptr;
}

const ScoreValue* ClsResult::GetPrediction() const {
  return has_prediction_ ? prediction_.Get() : nullptr;
}

void ClsResult::Reset() {
  has_prediction_ = false;
  probability_ = 0.0;
  count_ = 0;
  entities_.Reset();
  if (output_fields_.GetLayoutStamp() != 0) output_fields_.ClearValues();
}

void ClsResult::SetProbability(double probability) {
  probability_ = probability;
}
double ClsResult::GetProbability() const {
  return probability_;
}
int ClsResult::GetResultKind() const {
  return 0;
}

void ClsResult::AddCategoryProbability(const ScoreValue* category, double probability) {
  if (category == nullptr) return;
  if (count_ < entries_.size()) {
    entries_[count_].category.Assign(*category);
    entries_[count_].probability = probability;
  } else {
    // Copied before the entries move: the category may be one of them.
    Entry entry;
    entry.category.Assign(*category);
    entry.probability = probability;
    entries_.push_back(std::move(entry));
  }
  ++count_;
}

double ClsResult::GetCategoryProbability(const ScoreValue* category) const {
  if (category == nullptr) return 0.0;
  for (size_t i = 0; i < count_; ++i) {
    if (*entries_[i].category.Get() == *category) return entries_[i].probability;
  }
  return 0.0;
}

size_t ClsResult::GetCategoryCount() const {
  return count_;
}

const ScoreValue* ClsResult::GetCategory(size_t index) const {
  return index < count_ ? entries_[index].category.Get() : nullptr;
}

double ClsResult::GetProbability(size_t index) const {
  return index < count_ ? entries_[index].probability : 0.0;
}

RegResult::RegResult() : standard_error_(NumericValue::gSysmisValue) {}
RegResult::~RegResult() = default;

void RegResult::SetPrediction(const ScoreValue* value) {
  if (value != nullptr) prediction_.Assign(*value);
  has_prediction_ = value != nullptr;
}

const ScoreValue* RegResult::GetPrediction() const {
  return has_prediction_ ? prediction_.Get() : nullptr;
}

void RegResult::Reset() {
  has_prediction_ = false;
  probability_ = 0.0;
  standard_error_ = NumericValue::gSysmisValue;
  entities_.Reset();
  if (output_fields_.GetLayoutStamp() != 0) output_fields_.ClearValues();
}

void RegResult::SetProbability(double probability) {
  probability_ = probability;
}
double RegResult::GetProbability() const {
  return probability_;
}
int RegResult::GetResultKind() const {
  return 1;
}
void RegResult::SetStandardError(double error) {
  standard_error_ = error;
}
double RegResult::GetStandardError() const {
  return standard_error_;
}

// Found like ResultEntities::Of, for the same reason.
ResultField* OutputFieldsOf(ScoreResult* result) {
  if (result == nullptr) return nullptr;
  const std::type_info* const type = &typeid(*result);
  if (type == &typeid(ClsResult)) return &static_cast<ClsResult*>(result)->GetOutputFields();
  if (type == &typeid(RegResult)) return &static_cast<RegResult*>(result)->GetOutputFields();
  if (auto* classification = dynamic_cast<ClsResult*>(result)) return &classification->GetOutputFields();
  if (auto* regression = dynamic_cast<RegResult*>(result)) return &regression->GetOutputFields();
  return nullptr;
}

}  // namespace MCKestrel_800
