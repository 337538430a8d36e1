#include "kestrel/dictionary/DictVar.h"

#include <memory>
#include <ostream>
#include <typeinfo>

#include "kestrel/dictionary/MissingValueSet.h"
#include "kestrel/dictionary/ValueLabelSet.h"
#include "kestrel/dictionary/ValueLbl.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"

namespace MCKestrel_800 {

namespace {

/// The set, when it is exactly of our own class. A class derived from ours may answer differently, so it is
/// asked through the interface.
template <class Own, class Interface>
const Own* AsOwn(const Interface* set) {
  return set != nullptr && typeid(*set) == typeid(Own) ? static_cast<const Own*>(set) : nullptr;
}

}  // namespace

ScoreDictVar::~ScoreDictVar() = default;

DictVar::DictVar(const std::string& name, VariableType type) : name_(name), varType_(type) {}

// Through the other constructor, so that the destructor runs when an owned object cannot be cloned.
DictVar::DictVar(const DictVar& other) : DictVar(other.name_, other.varType_) {
  CopyFields(other);
  CopyOwned(other);
}

DictVar& DictVar::operator=(const DictVar& other) {
  if (this == &other) return *this;
  DeleteOwned();
  CopyFields(other);
  CopyOwned(other);
  return *this;
}

DictVar::~DictVar() {
  DeleteOwned();
}

void DictVar::CopyFields(const DictVar& other) {
  name_ = other.name_;
  label_ = other.label_;
  varType_ = other.varType_;
  dateTimeType_ = other.dateTimeType_;
  numericDataType_ = other.numericDataType_;
  mLevel_ = other.mLevel_;
  decimals_ = other.decimals_;
  width_ = other.width_;
  valueIndex_ = other.valueIndex_;
  encodedValueIndex_ = other.encodedValueIndex_;
  noSpaceTrim_ = other.noSpaceTrim_;
  emptyStringOK_ = other.emptyStringOK_;
  xMeasure_ = other.xMeasure_;
  flagVariable_ = other.flagVariable_;
  usageTypeEnabled_ = other.usageTypeEnabled_;
  outlierHandleMethod_ = other.outlierHandleMethod_;
  emptyCateValues_ = other.emptyCateValues_;
  flagTypeTrueValue_ = other.flagTypeTrueValue_;
}

void DictVar::CopyOwned(const DictVar& other) {
  if (other.missingValues_ != nullptr) SetMissingValues(other.missingValues_->Clone());
  if (other.valueLabels_ != nullptr) SetValueLabels(other.valueLabels_->Clone());
  if (other.varStats_ != nullptr) SetVarStats(other.varStats_->Clone());
  if (other.defValue_ != nullptr) SetDefValue(other.defValue_->Clone());
  if (other.valueProbabilities_ != nullptr) SetValueProbabilities(other.valueProbabilities_->Clone());
  if (other.encoder_ != nullptr) SetEncoder(other.encoder_->Clone());
}

void DictVar::DeleteOwned() {
  delete missingValues_;
  delete valueLabels_;
  delete varStats_;
  delete defValue_;
  delete valueProbabilities_;
  delete encoder_;
  missingValues_ = nullptr;
  valueLabels_ = nullptr;
  varStats_ = nullptr;
  defValue_ = nullptr;
  valueProbabilities_ = nullptr;
  encoder_ = nullptr;
  indexedMissingValues_ = nullptr;
  indexedValueLabels_ = nullptr;
}

DictVar* DictVar::Clone() const {
  return new DictVar(*this);
}

bool DictVar::operator==(const ScoreDictVar& other) const {
  return name_ == other.GetName();
}

bool DictVar::IsNumericLike() const {
  return varType_ == kNUMERIC_VAR || varType_ == kDATETIME_VAR;
}

bool DictVar::IsString() const {
  return varType_ == STRING_VAR;
}

bool DictVar::IsInMissingRange(const ScoreValue* value) const {
  if (indexedMissingValues_ != nullptr) return indexedMissingValues_->HoldsValue(value);
  for (const ScoreValueRange* range : missingValues_->GetMissingValues()) {
    if (range != nullptr && range->IsInRange(value)) return true;
  }
  return false;
}

bool DictVar::IsMissingValue(const ScoreValue* value) const {
  if (value == nullptr) return true;
  const bool numericLike = IsNumericLike();
  if (numericLike && value->IsSystemMissingValue()) return true;
  if (missingValues_ == nullptr || !IsInMissingRange(value)) return false;
  // A number that is given a label is a category, also where a missing interval covers it.
  if (!numericLike || valueLabels_ == nullptr) return true;
  if (indexedValueLabels_ != nullptr) return !indexedValueLabels_->ContainsEqualTo(value);
  for (const ScoreValueLabel* label : valueLabels_->GetAllValueLabels()) {
    const ScoreValue* labelled = label == nullptr ? nullptr : label->GetValue();
    if (labelled != nullptr && *value == *labelled) return false;
  }
  return true;
}

bool DictVar::IsCategory(const ScoreValue* value) const {
  if (indexedValueLabels_ != nullptr) {
    return IsString() ? indexedValueLabels_->ContainsEqual(value, noSpaceTrim_, emptyStringOK_)
                      : indexedValueLabels_->ContainsEqualTo(value);
  }
  for (const ScoreValueLabel* label : valueLabels_->GetAllValueLabels()) {
    const ScoreValue* labelled = label == nullptr ? nullptr : label->GetValue();
    if (labelled == nullptr) continue;
    if (IsString() ? labelled->Equal(value, noSpaceTrim_, emptyStringOK_) : *value == *labelled) return true;
  }
  return false;
}

bool DictVar::IsValidValue(const ScoreValue* value) const {
  if (IsMissingValue(value)) return false;
  // A set without entries says no more than no set: it is there because an entry was refused.
  if (valueLabels_ == nullptr || valueLabels_->Size() == 0) {
    if (varType_ != kNUMERIC_VAR) return true;
    const ScoreValue::ValueType type = value->GetType();
    return type == ScoreValue::kNumeric || type == ScoreValue::kDateTime;
  }
  return mLevel_ == kContinuous || IsCategory(value);
}

bool DictVar::SetName(const std::string& name) {
  if (name.empty()) return false;
  name_ = name;
  return true;
}

void DictVar::SetLabel(const std::string& label) {
  label_ = label;
}

void DictVar::SetVarType(VariableType type) {
  varType_ = type;
}

void DictVar::SetMLevel(MeasureLevel level) {
  mLevel_ = level;
}

void DictVar::SetFormat(int decimals, int width) {
  decimals_ = decimals;
  width_ = width;
}

void DictVar::SetDecimal(int decimals) {
  decimals_ = decimals;
}

void DictVar::SetWidth(int width) {
  width_ = width;
}

const std::string& DictVar::GetName() const {
  return name_;
}

const std::string& DictVar::GetLabel() const {
  return label_;
}

DictVar::VariableType DictVar::GetVarType() const {
  return varType_;
}

DictVar::MeasureLevel DictVar::GetMLevel() const {
  return mLevel_;
}

int DictVar::GetDecimal() const {
  return decimals_;
}

int DictVar::GetWidth() const {
  return width_;
}

ScoreVarStats* DictVar::GetVarStats() const {
  return varStats_;
}

void DictVar::SetVarStats(ScoreVarStats* stats) {
  varStats_ = stats;
}

ScoreValueLabelSet* DictVar::GetValueLabels() const {
  return valueLabels_;
}

std::string DictVar::GetLabelOfValue(const ScoreValue* value) const {
  return valueLabels_ == nullptr ? std::string() : valueLabels_->GetLabelOfValue(value);
}

ScoreMissingValueSet* DictVar::GetMissingValues() const {
  return missingValues_;
}

void DictVar::SetMissingValues(ScoreMissingValueSet* missingValues) {
  missingValues_ = missingValues;
  indexedMissingValues_ = AsOwn<MissingValueSet>(missingValues);
}

void DictVar::SetValueLabels(ScoreValueLabelSet* valueLabels) {
  valueLabels_ = valueLabels;
  indexedValueLabels_ = AsOwn<ValueLabelSet>(valueLabels);
}

ScoreValue* DictVar::ToMyValue(const std::string& text) const {
  if (varType_ == kNUMERIC_VAR) return new NumericValue(text);
  if (varType_ == STRING_VAR) return new StringValue(text);
  return nullptr;
}

void DictVar::Display(std::ostream& os) const {
  os << "Start ScoreDictVar Display:\n";
  os << "Var Name = " << name_ << "; Var Lable = " << label_ << "; ";
  if (varType_ == STRING_VAR) os << "Var Type = STRING_VAR; ";
  if (varType_ == kNUMERIC_VAR) os << "Var Type = kNUMERIC_VAR; ";
  switch (mLevel_) {
    case kContinuous:
      os << "Var level =  Continuous; ";
      break;
    case kOrdinal:
      os << "Var level =  Ordinal; ";
      break;
    case kNominal:
      os << "Var level =  Nominal; ";
      break;
    default:
      os << "Var level = unknown;";
  }
  os << "\n";
  if (valueLabels_ != nullptr) valueLabels_->Display(os);
  if (missingValues_ != nullptr) missingValues_->Display(os);
  if (!xMeasure_.empty()) os << "x-Measure: " << xMeasure_ << "\n";
  os << "End of ScoreDictVar Display.\n\n";
}

int DictVar::GetNumberOfCats() const {
  if (mLevel_ == kContinuous) return 1;
  return valueLabels_ == nullptr ? 0 : static_cast<int>(valueLabels_->Size());
}

void DictVar::SetValueIndex(int index) {
  valueIndex_ = index;
}

void DictVar::SetEncodedValueIndex(int index) {
  encodedValueIndex_ = index;
}

int DictVar::GetValueIndex() const {
  return valueIndex_;
}

int DictVar::GetEncodedValueIndex() const {
  return encodedValueIndex_;
}

void DictVar::SetNoSpaceTrim(bool noSpaceTrim) {
  if (IsString()) noSpaceTrim_ = noSpaceTrim;
}

bool DictVar::GetNoSpaceTrim() const {
  return noSpaceTrim_;
}

void DictVar::SetEmptyStringOK(bool emptyStringOK) {
  if (IsString()) emptyStringOK_ = emptyStringOK;
}

bool DictVar::GetEmptyStringOK() const {
  return emptyStringOK_;
}

const std::string& DictVar::GetXMeasure() const {
  return xMeasure_;
}

void DictVar::SetXMeasure(const std::string& xMeasure) {
  xMeasure_ = xMeasure;
}

bool DictVar::SetFlagVariable(bool flag) {
  if (mLevel_ != kOrdinal && mLevel_ != kNominal) return false;
  flagVariable_ = flag;
  return true;
}

bool DictVar::IsFlagVariable() const {
  return flagVariable_;
}

void DictVar::SetOutlierHandleMethod(int method) {
  outlierHandleMethod_ = method;
}

int DictVar::GetOutlierHandleMethod() const {
  return outlierHandleMethod_;
}

bool DictVar::IsDerivedVariable() const {
  return false;
}

void DictVar::SetDateTimeType(DateTimeType type) {
  dateTimeType_ = type;
}

DictVar::DateTimeType DictVar::GetDateTimeType() const {
  return dateTimeType_;
}

void DictVar::SetDefValue(ScoreValue* value) {
  defValue_ = value;
}

ScoreValue* DictVar::GetDefValue() const {
  return defValue_;
}

void DictVar::SetValueProbabilities(ScoreValueProbabilitySet* probabilities) {
  valueProbabilities_ = probabilities;
}

ScoreValueProbabilitySet* DictVar::GetValueProbabilities() const {
  return valueProbabilities_;
}

ScoreEncoder* DictVar::GetEncoder() {
  return encoder_;
}

const ScoreEncoder* DictVar::GetEncoder() const {
  return encoder_;
}

void DictVar::SetEncoder(ScoreEncoder* encoder) {
  encoder_ = encoder;
}

void DictVar::SetEmptyCateValues(bool empty) {
  emptyCateValues_ = empty;
}

bool DictVar::IsEmptyCateValues() const {
  return emptyCateValues_;
}

bool DictVar::AddScoreValueLabel(ScoreValue* value, const std::string& label) {
  if (valueLabels_ == nullptr) SetValueLabels(new ValueLabelSet);
  if (value == nullptr || label.empty()) return false;
  std::unique_ptr<ScoreValue> owned(value);
  if (valueLabels_->Contains(value)) return false;
  auto added = std::make_unique<ValueLbl>(nullptr, label);
  added->SetValueLabel(owned.release(), label);
  if (!valueLabels_->Add(added.get())) return false;
  static_cast<void>(added.release());
  return true;
}

void DictVar::SetNumericDataType(NumericDataType type) {
  numericDataType_ = type;
}

DictVar::NumericDataType DictVar::GetNumericDataType() const {
  return numericDataType_;
}

bool DictVar::IsUsageTypeEnable() const {
  return usageTypeEnabled_;
}

void DictVar::SetUsageType(bool enabled) {
  usageTypeEnabled_ = enabled;
}

void DictVar::SetFalgTypeTrueValue(const std::string& value) {
  flagTypeTrueValue_ = value;
}

std::string DictVar::GetFalgTypeTrueValue() const {
  return flagTypeTrueValue_;
}

}  // namespace MCKestrel_800
