#include "kestrel/transform/ApplyNodeStats.h"

#include <algorithm>
#include <cstddef>

namespace MCKestrel_800 {

namespace {

using Value = std::unique_ptr<ScoreValue>;

Value CopyOf(const Value& value) {
  return Value(value == nullptr ? nullptr : value->Clone());
}

/// A value set to itself stays.
void Replace(Value& held, ScoreValue* value) {
  if (held.get() != value) held.reset(value);
}

bool AreEqual(const Value& a, const Value& b) {
  return a == nullptr || b == nullptr ? a == b : *a == *b;
}

bool AreEqualArrays(const std::vector<Value>& a, const std::vector<Value>& b) {
  return std::equal(a.begin(), a.end(), b.begin(), b.end(), AreEqual);
}

}  // namespace

ApplyNodeStats::ApplyNodeStats() = default;

ApplyNodeStats::ApplyNodeStats(const ApplyNodeStats& other)
    : node_id_(other.node_id_),
      parameter_name_(other.parameter_name_),
      value_(CopyOf(other.value_)),
      function_(other.function_),
      variable_(other.variable_),
      var_index_(other.var_index_),
      const_node_(other.const_node_),
      invalid_value_treatment_(other.invalid_value_treatment_),
      missing_replacement_(CopyOf(other.missing_replacement_)),
      field_missing_replacement_(CopyOf(other.field_missing_replacement_)) {
  arrays_.reserve(other.arrays_.size());
  for (const std::vector<Value>& array : other.arrays_) {
    arrays_.emplace_back();
    arrays_.back().reserve(array.size());
    for (const Value& value : array)
      arrays_.back().push_back(CopyOf(value));
  }
}

ApplyNodeStats& ApplyNodeStats::operator=(const ApplyNodeStats& other) {
  // Everything that can fail comes before the first change.
  ApplyNodeStats copy(other);
  node_id_.swap(copy.node_id_);
  parameter_name_.swap(copy.parameter_name_);
  value_.swap(copy.value_);
  function_ = copy.function_;
  variable_ = copy.variable_;
  var_index_ = copy.var_index_;
  const_node_ = copy.const_node_;
  arrays_.swap(copy.arrays_);
  invalid_value_treatment_ = copy.invalid_value_treatment_;
  missing_replacement_.swap(copy.missing_replacement_);
  field_missing_replacement_.swap(copy.field_missing_replacement_);
  return *this;
}

ApplyNodeStats::~ApplyNodeStats() = default;

void ApplyNodeStats::SetNodeID(const std::string& id) {
  node_id_ = id;
}

void ApplyNodeStats::SetParameterName(const std::string& name) {
  parameter_name_ = name;
}

void ApplyNodeStats::SetValue(ScoreValue* value) {
  Replace(value_, value);
}

void ApplyNodeStats::AddArray(const std::vector<ScoreValue*>& values) {
  std::vector<Value> array;
  array.reserve(values.size());
  arrays_.emplace_back();
  // Nothing fails from here on, so that each value has one owner at any time.
  for (ScoreValue* value : values)
    array.emplace_back(value);
  arrays_.back().swap(array);
}

std::vector<const ScoreValue*> ApplyNodeStats::GetArray(int index) const {
  std::vector<const ScoreValue*> values;
  if (index < 0 || index >= GetNumberOfArray()) return values;
  const std::vector<Value>& array = arrays_[static_cast<std::size_t>(index)];
  values.reserve(array.size());
  for (const Value& value : array)
    values.push_back(value.get());
  return values;
}

void ApplyNodeStats::ClearArray() {
  arrays_.clear();
}

void ApplyNodeStats::SetRecodeMissValueTo(ScoreValue* value) {
  Replace(missing_replacement_, value);
}

void ApplyNodeStats::SetFieldrefRecodeMissValueTo(ScoreValue* value) {
  Replace(field_missing_replacement_, value);
}

bool ApplyNodeStats::operator==(const ApplyNodeStats& other) const {
  return function_ == other.function_ && const_node_ == other.const_node_ &&
         parameter_name_ == other.parameter_name_ &&
         invalid_value_treatment_ == other.invalid_value_treatment_ && AreEqual(value_, other.value_) &&
         AreEqual(missing_replacement_, other.missing_replacement_) &&
         AreEqual(field_missing_replacement_, other.field_missing_replacement_) &&
         std::equal(arrays_.begin(), arrays_.end(), other.arrays_.begin(), other.arrays_.end(),
                    AreEqualArrays);
}

}  // namespace MCKestrel_800
