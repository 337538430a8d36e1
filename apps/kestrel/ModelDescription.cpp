#include "apps/kestrel/ModelDescription.h"

#include <iterator>
#include <set>
#include <unordered_set>

#include "apps/kestrel/DerivedInputs.h"
#include "apps/kestrel/ExpressionText.h"
#include "apps/kestrel/PredictionColumns.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/model/ScoreModel.h"
#include "kestrel/model/ScoreVersionInfo.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "kestrel/translate/ResultVar.h"

namespace kestrel_program {
namespace {

using namespace MCKestrel_800;

/// By the numbers of ScoreModel::VarRole.
constexpr const char* kRoles[] = {"unused", "target",           "predictor",       "supplementary",
                                  "order",  "frequency weight", "analysis weight", "group"};

/// By the numbers of ScoreResultField::ResultFeature.
constexpr const char* kFeatures[] = {"",
                                     "predictedValue",
                                     "predictedDisplayValue",
                                     "probability",
                                     "residual",
                                     "standardError",
                                     "clusterId",
                                     "clusterAffinity",
                                     "entityId",
                                     "entityAffinity",
                                     "warning",
                                     "ruleValue",
                                     "standardDeviation"};

/// By the numbers of DateTimeType, as documents write them.
constexpr const char* kDateTimeTypes[] = {
    "dateTime",
    "date",
    "time",
    "dateTime",
    "dateDaysSince[0]",
    "dateDaysSince[1960]",
    "dateDaysSince[1970]",
    "dateDaysSince[1980]",
    "timeSeconds",
    "dateTimeSecondsSince[0]",
    "dateTimeSecondsSince[1960]",
    "dateTimeSecondsSince[1970]",
    "dateTimeSecondsSince[1980]",
};

template <std::size_t kSize>
std::string NameOf(int number, const char* const (&names)[kSize]) {
  return number >= 0 && static_cast<std::size_t>(number) < kSize ? names[number] : std::to_string(number);
}

std::string TypeOf(const ScoreDictVar& variable) {
  switch (variable.GetVarType()) {
    case ScoreDictVar::STRING_VAR:
      return "text";
    case ScoreDictVar::kDATETIME_VAR:
      return NameOf(variable.GetDateTimeType(), kDateTimeTypes);
    default:
      return variable.GetNumericDataType() == ScoreDictVar::kInteger ? "integer" : "number";
  }
}

std::string LevelOf(const ScoreDictVar& variable) {
  constexpr const char* kLevels[] = {"continuous", "ordinal", "nominal"};
  return NameOf(variable.GetMLevel(), kLevels);
}

FieldDescription Describe(const ScoreDictVar& variable) {
  FieldDescription field;
  field.name = variable.GetName();
  field.label = variable.GetLabel();
  field.type = TypeOf(variable);
  field.level = LevelOf(variable);
  const ScoreValueLabelSet* labels = variable.GetValueLabels();
  if (labels != nullptr && variable.GetMLevel() != ScoreDictVar::kContinuous) {
    for (const ScoreValueLabel* label : labels->GetAllValueLabels()) {
      if (label->GetValue() == nullptr) continue;
      const std::string value = TextOf(*label->GetValue());
      field.categories.push_back({value, label->GetLabel() == value ? std::string() : label->GetLabel()});
    }
  }
  if (const ScoreMissingValueSet* missing = variable.GetMissingValues()) {
    for (const ScoreValueRange* range : missing->GetMissingValues())
      field.missing.push_back(RangeText(*range));
  }
  return field;
}

/// Their names are those of the derived fields, in the document's order.
std::vector<FieldDescription> DescribeDerived(const TransformationDictionary& dictionary,
                                              const ExpressionText& expressions) {
  std::vector<FieldDescription> fields;
  for (const std::string& name : dictionary.GetDerivedVarNames()) {
    const auto* variable = dynamic_cast<const TransformVar*>(dictionary.GetVar(name));
    if (variable == nullptr) continue;
    fields.push_back(Describe(*variable));
    fields.back().expression = expressions.Of(*variable);
  }
  return fields;
}

std::vector<OutputDescription> DescribeOutputs(const ScoreModel& model) {
  std::vector<OutputDescription> outputs;
  const ScoreDictionary* dictionary = model.GetResultDictionary();
  if (dictionary == nullptr) return outputs;
  for (const std::string& name : dictionary->GetVarNames()) {
    const ScoreDictVar* variable = dictionary->GetVar(name);
    if (variable == nullptr) continue;
    const auto* field = dynamic_cast<const ResultVar*>(variable);
    const ScoreValue* value = variable->GetDefValue();
    outputs.push_back({name, variable->GetLabel(), TypeOf(*variable),
                       field == nullptr ? std::string() : NameOf(field->GetFeature(), kFeatures),
                       value == nullptr ? std::string() : TextOf(*value)});
  }
  return outputs;
}

}  // namespace

ModelDescription::ModelDescription(const ScoreModel& model, const ExpressionText& expressions)
    : kind(model.GetModelKind()), outputs(DescribeOutputs(model)) {
  if (const TransformationDictionary* transformations = model.GetTransformationDictionary())
    derived = DescribeDerived(*transformations, expressions);
  if (const ScoreVersionInfo* info = model.GetVersionInfo()) version = info->GetVersionInfo();
  const ScoreDictVar* target_variable = model.GetTargetVar();
  if (target_variable != nullptr) {
    has_target = true;
    target = Describe(*target_variable);
    target.role = NameOf(model.GetVarRole(target_variable), kRoles);
  }
  std::unordered_set<std::string> read;
  for (const ScoreDictVar* variable : model.GetPredictors())
    read.insert(variable->GetName());
  const ScoreDictionary* dictionary = model.GetDictionary();
  if (dictionary == nullptr) return;
  std::set<std::string> seen;
  for (const std::string& name : dictionary->GetVarNames()) {
    const ScoreDictVar* variable = dictionary->GetVar(name);
    if (variable == nullptr || variable == target_variable || !seen.insert(name).second) continue;
    const int role = model.GetVarRole(name);
    const bool is_read = read.count(name) != 0;
    if (!is_read && (role < 0 || role == ScoreModel::kUnused)) continue;
    FieldDescription field = Describe(*variable);
    field.role = role < 0 ? "predictor" : NameOf(role, kRoles);
    field.is_read = is_read;
    inputs.push_back(std::move(field));
  }
}

ModelDescription::ModelDescription(const ScoreDictionary& dictionary,
                                   const TransformationDictionary& transformations,
                                   const ExpressionText& expressions)
    : derived(DescribeDerived(transformations, expressions)) {
  std::unordered_set<const ScoreDictVar*> read;
  for (const ScoreDictVar* variable :
       FindDerivedInputs(transformations.GetDerivedVarNames(), transformations, dictionary))
    read.insert(variable);
  for (const std::string& name : dictionary.GetVarNames()) {
    const ScoreDictVar* variable = dictionary.GetVar(name);
    if (variable == nullptr) continue;
    inputs.push_back(Describe(*variable));
    inputs.back().role = "data field";
    inputs.back().is_read = read.count(variable) != 0;
  }
}

ModelDescription::ModelDescription(const ScoreDictionary& legacy) : is_legacy(true) {
  for (const std::string& name : legacy.GetVarNames()) {
    const ScoreDictVar* variable = legacy.GetVar(name);
    if (variable == nullptr) continue;
    inputs.push_back(Describe(*variable));
    inputs.back().role = "data field";
  }
}

ModelDescription::~ModelDescription() = default;

}  // namespace kestrel_program
