#include "kestrel/transform/TransformationDictionary.h"

#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/transform/DerivationPlan.h"
#include "kestrel/transform/TransformVar.h"

namespace MCKestrel_800 {
namespace {

constexpr int kFirstRoom = 10;

ScoreValue* NewEmptyValue(const ScoreDictVar& variable) {
  switch (variable.GetVarType()) {
    case ScoreDictVar::STRING_VAR:
      return new StringValue;
    case ScoreDictVar::kDATETIME_VAR:
      return new DateTimeValue(NumericValue::gSysmisValue, kDateTimeVal);
    default:
      return new NumericValue;
  }
}

}  // namespace

TransformationDictionary::TransformationDictionary() = default;

TransformationDictionary::TransformationDictionary(const TransformationDictionary& other)
    : BaseDictionary(other),
      computed_(other.computed_),
      derived_names_(other.derived_names_),
      is_set_up_(other.is_set_up_),
      wanted_names_(other.wanted_names_),
      has_wanted_names_(other.has_wanted_names_) {
  if (other.derived_record_ == nullptr) return;
  derived_record_ = std::make_unique<CaseRecord>(*other.derived_record_);
  initial_record_ = std::make_unique<CaseRecord>(*other.initial_record_);
}

TransformationDictionary& TransformationDictionary::operator=(const TransformationDictionary& other) {
  if (this == &other) return *this;
  TransformationDictionary copy(other);
  BaseDictionary::operator=(copy);
  derived_record_ = std::move(copy.derived_record_);
  initial_record_ = std::move(copy.initial_record_);
  computed_ = std::move(copy.computed_);
  derived_names_ = std::move(copy.derived_names_);
  is_set_up_ = copy.is_set_up_;
  wanted_names_ = std::move(copy.wanted_names_);
  has_wanted_names_ = copy.has_wanted_names_;
  plan_.reset();
  return *this;
}

TransformationDictionary::~TransformationDictionary() = default;

TransformationDictionary* TransformationDictionary::Clone() const {
  return new TransformationDictionary(*this);
}

void TransformationDictionary::AddDerievedVarName(const std::string& name) {
  derived_names_.push_back(name);
  plan_.reset();
}

std::vector<std::string> TransformationDictionary::GetDerivedVarNames() const {
  return derived_names_;
}

void TransformationDictionary::SetUpDerivedCaseRecord() {
  if (is_set_up_) return;
  derived_record_ = std::make_unique<CaseRecord>(kFirstRoom);
  initial_record_ = std::make_unique<CaseRecord>(kFirstRoom);
  Reset();
  for (const std::string& name : derived_names_) {
    ScoreDictVar* const variable = GetVar(name);
    // A name that is listed twice has its place already, and its value.
    if (variable == nullptr || derived_record_->GetIndex(name) >= 0) continue;
    std::unique_ptr<ScoreValue> value(NewEmptyValue(*variable));
    initial_record_->Add(name, value->Clone());
    derived_record_->Add(name, value.release());
    variable->SetValueIndex(derived_record_->GetIndex(name));
  }
  is_set_up_ = true;
  plan_.reset();
}

void TransformationDictionary::Reset() {
  computed_.assign(derived_names_.size(), 0);
}

void TransformationDictionary::SetWantedVars(const std::vector<std::string>& names) {
  wanted_names_ = names;
  has_wanted_names_ = true;
  plan_.reset();
  if (derived_record_ != nullptr) *derived_record_ = *initial_record_;
}

// All variables are planned, since any of them may be asked for by itself; chosen is what is wanted.
DerivationPlan& TransformationDictionary::PlanFor(const ScoreDictionary* dictionary) {
  if (plan_ != nullptr && plan_->IsFor(dictionary, this)) return *plan_;
  plan_.reset();
  std::vector<const TransformVar*> fields;
  for (const ScoreDictVar* variable : GetScoreDictVars()) {
    if (const auto* field = dynamic_cast<const TransformVar*>(variable)) fields.push_back(field);
  }
  plan_ = std::make_unique<DerivationPlan>(fields, dictionary, this);
  ChooseOutputs();
  return *plan_;
}

void TransformationDictionary::ChooseOutputs() {
  std::vector<DerivationPlan::Output> outputs;
  chosen_.assign(derived_names_.size(), 0);
  if (derived_record_ != nullptr) {
    const std::vector<ScoreValue*>& values = derived_record_->GetAllValues();
    for (const std::string& name : has_wanted_names_ ? wanted_names_ : derived_names_) {
      const int index = derived_record_->GetIndex(name);
      const auto* field = dynamic_cast<const TransformVar*>(GetVar(name));
      if (field == nullptr || index < 0) continue;
      ScoreValue* const value = values[static_cast<std::size_t>(index)];
      // A host may have changed the type since the record was set up.
      if (value->GetType() != field->GetResultType()) continue;
      outputs.push_back({field, value});
      chosen_[static_cast<std::size_t>(index)] = 1;
    }
  }
  plan_->Choose(outputs);
}

const CaseRecord* TransformationDictionary::GetValuesForDerivedVars(const ScoreCaseRecord* record,
                                                                    const ScoreDictionary* dictionary) {
  if (record == nullptr || derived_record_ == nullptr) return derived_record_.get();
  PlanFor(dictionary).Compute(record);
  computed_ = chosen_;
  return derived_record_.get();
}

const ScoreValue* TransformationDictionary::GetVarValue(const std::string& name) const {
  return derived_record_ == nullptr ? nullptr : derived_record_->Get(name);
}

bool TransformationDictionary::IsVarValueComputed(const ScoreDictVar* var) const {
  if (var == nullptr) return false;
  const int index = var->GetValueIndex();
  return index >= 0 && static_cast<std::size_t>(index) < computed_.size() &&
         computed_[static_cast<std::size_t>(index)] != 0;
}

void TransformationDictionary::MarkComputed(const ScoreDictVar* var) {
  if (var == nullptr) return;
  const int index = var->GetValueIndex();
  if (index < 0 || static_cast<std::size_t>(index) >= computed_.size()) return;
  computed_[static_cast<std::size_t>(index)] = 1;
}

void TransformationDictionary::AddVarCaseValue(const ScoreDictVar* var, const std::string& name,
                                               const ScoreValue* value) {
  if (!is_set_up_ || value == nullptr) return;
  switch (value->GetType()) {
    case ScoreValue::kString:
      AddVarCaseValue(var, name, value->GetString());
      break;
    case ScoreValue::kDateTime: {
      const auto* date = dynamic_cast<const DateTimeValue*>(value);
      AddVarCaseValue(var, name, value->GetDouble(),
                      date == nullptr ? kDateTimeVal : date->GetDateTimeType());
      break;
    }
    default:
      AddVarCaseValue(var, name, value->GetDouble());
  }
}

void TransformationDictionary::AddVarCaseValue(const ScoreDictVar* var, const std::string& name,
                                               const std::string& text) {
  if (is_set_up_ && derived_record_->SetValue(name, text)) MarkComputed(var);
}

void TransformationDictionary::AddVarCaseValue(const ScoreDictVar* var, const std::string& name,
                                               double number) {
  if (is_set_up_ && derived_record_->SetValue(name, number)) MarkComputed(var);
}

void TransformationDictionary::AddVarCaseValue(const ScoreDictVar* var, const std::string& name,
                                               double seconds, DateTimeValType kind) {
  if (!is_set_up_) return;
  const int index = derived_record_->GetIndex(name);
  if (index < 0) return;
  ScoreValue* const value = derived_record_->GetAllValues()[static_cast<std::size_t>(index)];
  if (value == nullptr || value->GetType() != ScoreValue::kDateTime) return;
  const DateTimeValue date(seconds, kind);
  value->SetValue(&date);
  MarkComputed(var);
}

}  // namespace MCKestrel_800
