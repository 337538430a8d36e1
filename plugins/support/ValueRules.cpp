#include "plugins/support/ValueRules.h"

#include <algorithm>
#include <typeinfo>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/predicates/Range.h"

namespace MCKestrel_800 {
namespace {

bool IsNumber(const ScoreValue* value) {
  return value != nullptr && value->GetType() == ScoreValue::kNumeric;
}

bool IsText(const ScoreValue* value) {
  return value != nullptr && value->GetType() == ScoreValue::kString;
}

// Whether it is the library's own text, whose characters can be read in place. Hosts may have classes of
// their own, which call themselves texts and are asked for a copy.
bool IsOwnText(const ScoreValue& value) {
  return typeid(value) == typeid(StringValue);
}

bool IsDate(const ScoreValue* value) {
  return value != nullptr && value->GetType() == ScoreValue::kDateTime;
}

}  // namespace

ValueRules::ValueRules(const ScoreDictVar& variable)
    : variable_(variable),
      type_(variable.GetVarType()),
      missing_texts_(false),
      texts_(variable.GetNoSpaceTrim()) {
  if (type_ != ScoreDictVar::kNUMERIC_VAR && type_ != ScoreDictVar::STRING_VAR) compiled_ = false;
  CompileMissingValues();
  CompileLabels();
}

void ValueRules::CompileMissingValues() {
  const ScoreMissingValueSet* missing = variable_.GetMissingValues();
  if (missing == nullptr) return;
  for (const ScoreValueRange* range : missing->GetMissingValues()) {
    if (range != nullptr && !AddRange(*range)) compiled_ = false;
  }
}

// False for a range whose rule cannot be told from its ends.
bool ValueRules::AddRange(const ScoreValueRange& range) {
  if (dynamic_cast<const Range*>(&range) == nullptr) return false;
  const ScoreValue* low = range.GetMin();
  const ScoreValue* high = range.GetMax();
  if (IsText(low) && IsText(high)) {
    // A text is inside a range of texts only when both ends are the same text.
    if (*low == *high) missing_texts_.Add(low->GetString(), 0);
    return type_ == ScoreDictVar::STRING_VAR;
  }
  if (!IsNumber(low) || !IsNumber(high)) return false;
  const double from = low->GetDouble();
  const double to = high->GetDouble();
  // Whether nearly equal ends make a single value depends on how the range was made.
  if (from != to && NumericValue::IsEqual(from, to)) return false;
  ranges_.push_back({from, to, range.GetLowEnd(), range.GetHighEnd(), from == to});
  return true;
}

void ValueRules::CompileLabels() {
  const ScoreValueLabelSet* labels = variable_.GetValueLabels();
  if (labels == nullptr || labels->Size() == 0) return;
  lists_categories_ = variable_.GetMLevel() != ScoreDictVar::kContinuous;
  const ScoreEncoder* encoder = variable_.GetEncoder();
  int position = 0;
  for (const ScoreValueLabel* label : labels->GetAllValueLabels()) {
    const ScoreValue* value = label == nullptr ? nullptr : label->GetValue();
    int code = encoder == nullptr ? kUnknown : encoder->EncodeConst(value);
    if (code < 0) code = position;
    ++position;
    if (type_ == ScoreDictVar::STRING_VAR ? !IsText(value) : !IsNumber(value)) compiled_ = false;
    // Numbers and dates are never equal, so a numeric variable finds no date.
    if (type_ != ScoreDictVar::STRING_VAR &&
        (IsNumber(value) || (IsDate(value) && type_ != ScoreDictVar::kNUMERIC_VAR))) {
      labelled_.Add(value->GetDouble(), code);
      if (lists_categories_) numbers_.Add(value->GetDouble(), code);
    } else if (type_ == ScoreDictVar::STRING_VAR && value != nullptr) {
      // Encoders take any value of a text variable by its text.
      if (lists_categories_) texts_.Add(value->GetString(), code);
    } else {
      continue;
    }
    if (lists_categories_) code_count_ = std::max(code_count_, code + 1);
  }
}

int ValueRules::AddCategory(const ScoreValue& value) {
  const bool is_text = IsText(&value);
  if (is_text != (type_ == ScoreDictVar::STRING_VAR)) return kUnknown;
  if (lists_categories_) return FindCode(value);
  const int code =
      is_text ? texts_.Add(value.GetString(), code_count_) : numbers_.Add(value.GetDouble(), code_count_);
  code_count_ = std::max(code_count_, code + 1);
  return code;
}

void ValueRules::Seal() {
  numbers_.Seal();
  labelled_.Seal();
}

ValueRules::Verdict ValueRules::Judge(const ScoreValue* value) const {
  if (value == nullptr) return kMissing;
  if (compiled_) {
    if (type_ == ScoreDictVar::STRING_VAR) {
      if (IsOwnText(*value)) return JudgeText(static_cast<const StringValue*>(value)->GetText());
    } else if (IsNumber(value)) {
      return JudgeNumber(value->GetDouble());
    }
  }
  return Ask(*value);
}

ValueRules::Verdict ValueRules::Ask(const ScoreValue& value) const {
  if (variable_.IsMissingValue(&value)) return kMissing;
  return variable_.IsValidValue(&value) ? kValid : kInvalid;
}

int ValueRules::FindCode(const ScoreValue& value) const {
  if (type_ != ScoreDictVar::STRING_VAR) return numbers_.Find(value.GetDouble());
  if (IsOwnText(value)) return texts_.Find(static_cast<const StringValue&>(value).GetText());
  return texts_.Find(value.GetString());
}

ValueRules::Verdict ValueRules::JudgeNumber(double number) const {
  if (NumericValue::IsSystemMissingValue(number)) return kMissing;
  for (const NumberRange& range : ranges_) {
    if (!range.Contains(number)) continue;
    if (labelled_.Find(number) == kUnknown) return kMissing;
    break;
  }
  if (!lists_categories_) return kValid;
  return numbers_.Find(number) == kUnknown ? kInvalid : kValid;
}

ValueRules::Verdict ValueRules::JudgeText(std::string_view text) const {
  int code;
  return JudgeText(text, code);
}

ValueRules::Verdict ValueRules::JudgeText(std::string_view text, int& code) const {
  code = kUnknown;
  if (!missing_texts_.IsEmpty() && missing_texts_.Find(text) != kUnknown) return kMissing;
  code = texts_.Find(text);
  return lists_categories_ && code == kUnknown ? kInvalid : kValid;
}

bool ValueRules::NumberRange::Contains(double number) const {
  if (single) return NumericValue::IsEqual(number, low);
  if (low < number && number < high) return true;
  return (low_included && NumericValue::IsEqual(number, low)) ||
         (high_included && NumericValue::IsEqual(number, high));
}

}  // namespace MCKestrel_800
