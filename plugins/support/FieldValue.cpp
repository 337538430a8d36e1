#include "plugins/support/FieldValue.h"

#include <string>
#include <typeinfo>

#include "kestrel/dictionary/ScoreValueLabelSet.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumberText.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"

namespace MCKestrel_800 {
namespace {

double NumberOfText(const std::string& text) {
  double number;
  return ParseDouble(text.data(), text.data() + text.size(), number) ? number : NumericValue::gSysmisValue;
}

}  // namespace

// Only the library's own text is read in place: hosts may have value classes of their own.
double NumberOf(const ScoreValue& value, const ScoreDictVar& variable) {
  if (value.GetType() == ScoreValue::kDateTime && variable.GetDateTimeType() != kNoDateTime) {
    return DateTimeValue(value.GetDouble(), kDateTimeVal).GetDoubleValue(variable.GetDateTimeType());
  }
  if (value.GetType() != ScoreValue::kString) return value.GetDouble();
  if (typeid(value) != typeid(StringValue)) return NumberOfText(value.GetString());
  return NumberOfText(static_cast<const StringValue&>(value).GetText());
}

bool IsEmptyText(const ScoreValue& value) {
  return value.GetType() == ScoreValue::kString && value.GetString().empty();
}

ValueRules::Verdict VerdictOfMissingText(const ScoreDictVar& variable) {
  const ScoreValueLabelSet* const labels = variable.GetValueLabels();
  const bool lists_categories =
      labels != nullptr && labels->Size() > 0 && variable.GetMLevel() != ScoreDictVar::kContinuous;
  return variable.IsDerivedVariable() && !lists_categories ? ValueRules::kValid : ValueRules::kInvalid;
}

}  // namespace MCKestrel_800
