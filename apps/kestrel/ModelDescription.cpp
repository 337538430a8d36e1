#include "apps/kestrel/ModelDescription.h"

#include <iterator>
#include <set>
#include <unordered_set>

#include "apps/kestrel/PredictionColumns.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/model/ScoreModel.h"
#include "kestrel/model/ScoreVersionInfo.h"

namespace kestrel_program {
namespace {

using namespace MCKestrel_800;

/// By the numbers of ScoreModel::VarRole.
constexpr const char* kRoles[] = {"unused", "target",           "predictor",       "supplementary",
                                  "order",  "frequency weight", "analysis weight", "group"};

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

std::string EndOf(const ScoreValue* end, const char* unbounded) {
  if (end == nullptr || end->IsSystemMissingValue()) return unbounded;
  const std::string text = TextOf(*end);
  return text == "inf" || text == "-inf" ? unbounded : text;
}

/// A single value, or an interval with brackets at the ends that belong to it.
std::string RangeText(const ScoreValueRange& range) {
  const ScoreValue* low = range.GetMin();
  const ScoreValue* high = range.GetMax();
  if (low != nullptr && high != nullptr && *low == *high) return TextOf(*low);
  return (range.GetLowEnd() ? "[" : "(") + EndOf(low, "-inf") + ", " + EndOf(high, "inf") +
         (range.GetHighEnd() ? "]" : ")");
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

}  // namespace

ModelDescription::ModelDescription(const ScoreModel& model) : kind(model.GetModelKind()) {
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

ModelDescription::~ModelDescription() = default;

}  // namespace kestrel_program
