#include "kestrel/transform/TransformVar.h"

#include <ostream>
#include <unordered_set>
#include <utility>

#include "kestrel/dictionary/LayoutStamp.h"
#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/predicates/ScoreValueRange.h"
#include "kestrel/transform/ApplyProgram.h"
#include "kestrel/transform/DerivationPlan.h"
#include "kestrel/transform/FieldEvaluation.h"
#include "kestrel/transform/FunctionTree.h"
#include "kestrel/transform/SourceField.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "kestrel/transform/ValueMatcher.h"

namespace MCKestrel_800 {
namespace {

constexpr const char* kKindLabels[] = {"Constant\n",   "FieldRef\n",  "NormContinuous\n", "NormDiscrete\n",
                                       "Discretize\n", "MapValues\n", "Apply\n"};

template <class Object>
std::unique_ptr<Object> CloneOf(const std::unique_ptr<Object>& object) {
  return std::unique_ptr<Object>(object == nullptr ? nullptr : object->Clone());
}

}  // namespace

TransformVar::TransformVar(const std::string& name, VariableType type)
    : DictVar(name, type), definition_stamp_(NewLayoutStamp()) {}

TransformVar::TransformVar(const TransformVar& other) : DictVar(other), definition_stamp_(NewLayoutStamp()) {
  CopyDefinition(other);
}

TransformVar& TransformVar::operator=(const TransformVar& other) {
  if (this == &other) return *this;
  DictVar::operator=(other);
  CopyDefinition(other);
  ForgetEvaluation();
  return *this;
}

TransformVar::~TransformVar() = default;

void TransformVar::CopyDefinition(const TransformVar& other) {
  field_name_ = other.field_name_;
  kind_ = other.kind_;
  constant_ = other.constant_;
  orig_ = other.orig_;
  norm_ = other.norm_;
  slopes_ = other.slopes_;
  intercepts_ = other.intercepts_;
  outliers_ = other.outliers_;
  bins_.clear();
  bins_.reserve(other.bins_.size());
  for (const Bin& bin : other.bins_)
    bins_.push_back({CloneOf(bin.range), CloneOf(bin.value)});
  encodings_.clear();
  encodings_.reserve(other.encodings_.size());
  for (const Encoding& row : other.encodings_)
    encodings_.push_back({CloneOf(row.matcher), CloneOf(row.value)});
  missing_replacement_ = CloneOf(other.missing_replacement_);
  default_value_ = CloneOf(other.default_value_);
  sysmis_replacement_ = CloneOf(other.sysmis_replacement_);
  else_copy_ = other.else_copy_;
  missing_copy_ = other.missing_copy_;
  interval_copy_ = CloneOf(other.interval_copy_);
  root_ = CloneOf(other.root_);
}

TransformVar* TransformVar::Clone() const {
  return new TransformVar(*this);
}

void TransformVar::AddFieldNameAndTransExpression(const std::string& field, TransExpression kind) {
  field_name_ = field;
  kind_ = kind;
  ForgetEvaluation();
}

void TransformVar::SetConstString(const std::string& text) {
  constant_ = text;
  ForgetEvaluation();
}

void TransformVar::AddLinearNorm(double orig, double norm) {
  orig_.push_back(orig);
  norm_.push_back(norm);
  ForgetEvaluation();
}

void TransformVar::AddNormInfo(double slope, double intercept) {
  slopes_.push_back(slope);
  intercepts_.push_back(intercept);
  ForgetEvaluation();
}

void TransformVar::SetOutlierTreatMent(const std::string& treatment) {
  constexpr std::pair<const char*, OutlierHandleMethod> kTreatments[] = {
      {"asIs", kAsIs}, {"asMissingValues", kAsMissingValues}, {"asExtremeValues", kAsExtremeValues}};
  for (const auto& [text, method] : kTreatments) {
    if (treatment == text) outliers_ = method;
  }
  ForgetEvaluation();
}

void TransformVar::AddBinningValue(ScoreValueRange* range, ScoreValue* value) {
  std::unique_ptr<ScoreValueRange> owned_range(range);
  std::unique_ptr<ScoreValue> owned_value(value);
  bins_.push_back({std::move(owned_range), std::move(owned_value)});
  ForgetEvaluation();
}

void TransformVar::AddEncodingMap(ScoreValueMatcher* matcher, ScoreValue* value) {
  std::unique_ptr<ScoreValueMatcher> owned_matcher(matcher);
  std::unique_ptr<ScoreValue> owned_value(value);
  encodings_.push_back({std::move(owned_matcher), std::move(owned_value)});
  ForgetEvaluation();
}

void TransformVar::SetRecodeMissValueTo(ScoreValue* value) {
  missing_replacement_.reset(value);
  missing_copy_ = false;
  ForgetEvaluation();
}

void TransformVar::SetRecodeDefaultValue(ScoreValue* value) {
  default_value_.reset(value);
  else_copy_ = false;
  ForgetEvaluation();
}

void TransformVar::SetRecodeSysmisValue(ScoreValue* value) {
  sysmis_replacement_.reset(value);
  ForgetEvaluation();
}

void TransformVar::SetRecodeElseCopy(bool copy) {
  else_copy_ = copy;
  if (copy) default_value_.reset();
  ForgetEvaluation();
}

void TransformVar::SetRecodeMissingCopy(bool copy) {
  missing_copy_ = copy;
  if (copy) missing_replacement_.reset();
  ForgetEvaluation();
}

void TransformVar::SetRecodeIntervalCopy(ScoreValueRange* range) {
  interval_copy_.reset(range);
}

void TransformVar::SetRoot(FunctionTree* root) {
  root_.reset(root);
  ForgetEvaluation();
}

std::vector<std::string> TransformVar::GetSourceNames() const {
  std::vector<std::string> names;
  if (kind_ != TransExpression::kApply) {
    if (!field_name_.empty()) names.push_back(field_name_);
    return names;
  }
  if (root_ == nullptr) return names;
  std::unordered_set<std::string> seen;
  for (const FunctionTree* reference : ApplyProgram::FindReferences(*root_)) {
    const std::string& name = reference->GetNodeStats().GetParameterName();
    if (seen.insert(name).second) names.push_back(name);
  }
  return names;
}

FieldEvaluation& TransformVar::Evaluation() const {
  if (evaluation_ == nullptr) evaluation_ = std::make_unique<FieldEvaluation>(*this);
  return *evaluation_;
}

void TransformVar::ForgetEvaluation() {
  plan_.reset();
  evaluation_.reset();
  definition_stamp_ = NewLayoutStamp();
  DerivationPlan::NoteChange(definition_stamp_);
}

const ScoreValue* TransformVar::GetTransformedValue(const ScoreCaseRecord* record,
                                                    const ScoreDictionary* dictionary,
                                                    TransformationDictionary* transformations) {
  // The fields of a dictionary share one plan; a field on its own has a plan for itself and what it reads.
  if (transformations != nullptr && transformations->GetVar(GetName()) == this) {
    transformations->PlanFor(dictionary).ComputeOnly(*this, record);
    return &Evaluation().GetOwnResult();
  }
  if (plan_ == nullptr || !plan_->IsFor(dictionary, transformations)) {
    plan_.reset();
    plan_ =
        std::make_unique<DerivationPlan>(std::vector<const TransformVar*>{this}, dictionary, transformations);
  }
  plan_->ComputeOnly(*this, record);
  return &Evaluation().GetOwnResult();
}

ScoreValue::ValueType TransformVar::GetResultType() const {
  return Evaluation().GetOwnResult().GetType();
}

double TransformVar::GetNormValue(double x) {
  return Evaluation().Norm(x);
}

const ScoreValue* TransformVar::GetEncodedValue(const ScoreDictVar* variable, const ScoreValue* value) {
  SourceField source(variable);
  source.Set(value);
  return Evaluation().Encode(source);
}

const ScoreValue* TransformVar::GetBinningValue(const ScoreDictVar* variable, const ScoreValue* value) {
  SourceField source(variable);
  source.Set(value);
  return Evaluation().Bin(source);
}

const ScoreValue* TransformVar::HandleMissingAndInvalidValue(const ScoreDictVar* variable, bool is_string,
                                                             const ScoreValue* value) {
  SourceField source(variable);
  source.Set(value);
  return Evaluation().Recode(source, is_string);
}

void TransformVar::Display(std::ostream& os) const {
  os << "Start Display Parameters: \n\nEXPRESSION: " << kKindLabels[static_cast<int>(kind_)];
  if (kind_ == TransExpression::kDiscretize) {
    os << "Bin values\n";
    for (const Bin& bin : bins_) {
      if (bin.range != nullptr) bin.range->Display(os);
      if (bin.value != nullptr) os << bin.value->GetString();
      os << "\n";
    }
  }
  if (interval_copy_ != nullptr) {
    os << "recodeIntervalCopy";
    interval_copy_->Display(os);
  }
  if (kind_ == TransExpression::kNormDiscrete || kind_ == TransExpression::kMapValues) {
    os << "Original values and its encoded values\n";
    for (const Encoding& row : encodings_) {
      const auto* listed = dynamic_cast<const ValueMatcher*>(row.matcher.get());
      if (listed != nullptr && listed->GetValue() != nullptr) os << listed->GetValue()->GetString();
      os << ", ";
      if (row.value != nullptr) os << row.value->GetString();
      os << "; ";
    }
    os << "\n";
  }
  os << "End one TransformVar display\n\n";
}

}  // namespace MCKestrel_800
