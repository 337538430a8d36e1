#include "kestrel/transform/ApplySteps.h"

#include <algorithm>
#include <limits>
#include <string_view>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/transform/BuiltinFunctions.h"
#include "kestrel/transform/FunctionEvaluation.h"
#include "kestrel/transform/SourceField.h"

namespace MCKestrel_800 {
namespace ApplySteps {
namespace {

Next Give(Step step, double result) {
  *step.out = result;
  return &step + 1;
}

// The system-missing value itself may come out of arithmetic, and is missing then.
Next GiveOperand(Step step, double result) {
  return Give(step, result <= std::numeric_limits<double>::max() ? AsOperand(result) : kMissingOperand);
}

// The result of a test, or of its opposite.
Next GiveTest(Step step, bool holds, TransformFunction opposite) {
  return Give(step, holds != (step.function == opposite) ? 1.0 : 0.0);
}

const StringValue& TextOf(Step step, std::size_t index = 0) {
  return **step.detail->texts[index];
}

// Whether a kind that the case has decided is this one.
bool IsKind(double number, FunctionValueKind kind) {
  return number == static_cast<double>(kind);
}

bool AreEqualTexts(Step step) {
  return WithoutTrailingBlanks(TextOf(step).GetText()) == WithoutTrailingBlanks(TextOf(step, 1).GetText());
}

// What equals a number lies next to where it would stand itself.
bool IsListed(const std::vector<double>& listed, double x) {
  const auto above = std::lower_bound(listed.begin(), listed.end(), x);
  return (above != listed.end() && NumericValue::IsEqual(*above, x)) ||
         (above != listed.begin() && NumericValue::IsEqual(*(above - 1), x));
}

bool IsListed(const std::vector<std::string>& listed, const StringValue& value) {
  const std::string_view text = WithoutTrailingBlanks(value.GetText());
  const auto found = std::lower_bound(listed.begin(), listed.end(), text);
  return found != listed.end() && *found == text;
}

}  // namespace

Next Add(Step step) {
  return GiveOperand(step, *step.x + *step.y);
}

Next Subtract(Step step) {
  return GiveOperand(step, *step.x - *step.y);
}

Next Multiply(Step step) {
  return GiveOperand(step, *step.x * *step.y);
}

Next Divide(Step step) {
  return GiveOperand(step, *step.x / *step.y);
}

Next ToOperand(Step step) {
  return Give(step, AsOperand(*step.x));
}

Next FromOperand(Step step) {
  return Give(step, NumberOrMissing(*step.x));
}

Next Scalar(Step step) {
  return Give(step, ApplyTransFunction(*step.x, *step.y, step.function));
}

Next List(Step step) {
  ApplyDetail& detail = *step.detail;
  for (std::size_t i = 0; i < detail.values.size(); ++i)
    detail.values[i] = *detail.numbers[i];
  return Give(step, ApplyAccumulateFunction(detail.values.data(), detail.values.size(), step.function,
                                            detail.scratch));
}

Next DateTime(Step step) {
  return Give(step, ApplyDateTimeFunction(*step.x, *step.y, step.function));
}

Next Outlier(Step step) {
  const std::vector<const double*>& from = step.detail->numbers;
  const double method = *from[1];
  return Give(step,
              HandleOutlier(*from[0], NumericValue(method).GetInt(), *from[2], *from[3], *from[4], *from[5]));
}

Next ChangeText(Step step) {
  std::int32_t length = 0;
  ApplyDetail& detail = *step.detail;
  ApplyTextFunction(TextOf(step), step.function, detail.text, length);
  detail.text_out->SetString(detail.text);
  detail.text_out->SetLength(length);
  return &step + 1;
}

Next Substring(Step step) {
  std::int32_t length = 0;
  ApplyDetail& detail = *step.detail;
  ApplySubstring(TextOf(step), *step.x, detail.text, length);
  detail.text_out->SetString(detail.text);
  detail.text_out->SetLength(length);
  return &step + 1;
}

Next Concat(Step step) {
  std::int32_t length = 0;
  ApplyDetail& detail = *step.detail;
  detail.text.clear();
  for (const ApplyText text : detail.texts)
    AppendText(**text, detail.text, length);
  detail.text_out->SetString(detail.text);
  detail.text_out->SetLength(length);
  return &step + 1;
}

Next CompareNumbers(Step step) {
  return GiveTest(step, NumericValue::IsEqual(*step.x, *step.y), kNotEqualFunction);
}

Next CompareTexts(Step step) {
  return GiveTest(step, AreEqualTexts(step), kNotEqualFunction);
}

Next FindNumber(Step step) {
  return GiveTest(step, IsListed(step.detail->listed_numbers, *step.x), kIsNotInFunction);
}

Next FindText(Step step) {
  return GiveTest(step, IsListed(step.detail->listed_texts, TextOf(step)), kIsNotInFunction);
}

Next CompareValues(Step step) {
  const std::vector<const double*>& numbers = step.detail->numbers;
  bool are_equal = *numbers[0] == *numbers[2];
  if (are_equal) {
    are_equal = IsKind(*numbers[0], FunctionValueKind::kText)
                    ? AreEqualTexts(step)
                    : NumericValue::IsEqual(*numbers[1], *numbers[3]);
  }
  return GiveTest(step, are_equal, kNotEqualFunction);
}

Next FindValue(Step step) {
  const ApplyDetail& detail = *step.detail;
  const double kind = *detail.numbers[0];
  const double number = *detail.numbers[1];
  const bool is_listed = IsKind(kind, FunctionValueKind::kText) ? IsListed(detail.listed_texts, TextOf(step))
                         : IsKind(kind, FunctionValueKind::kDateTime)
                             ? IsListed(detail.listed_seconds, number)
                             : IsListed(detail.listed_numbers, number);
  return GiveTest(step, is_listed, kIsNotInFunction);
}

Next TestMissing(Step step) {
  return GiveTest(step, step.detail->source->IsMissing(), kIsNotMissingFunction);
}

Next TestSysmis(Step step) {
  return GiveTest(step, IsMissingNumber(*step.x), kIsNotMissingFunction);
}

Next Length(Step step) {
  return Give(step, LengthOf(TextOf(step)));
}

Next ReadText(Step step) {
  return Give(step, NumberIn(TextOf(step).GetText()));
}

Next ImputeNumber(Step step) {
  const ApplyDetail& detail = *step.detail;
  if (!detail.source->IsMissing()) return Give(step, *step.x);
  if (IsMissingNumber(*step.y)) return Give(step, NumericValue::gSysmisValue);
  const std::size_t nearest =
      NearestMean(*step.y, detail.values.data(), detail.variances.data(), detail.values.size());
  return Give(step, detail.category_numbers[nearest]);
}

Next ImputeText(Step step) {
  const ApplyDetail& detail = *step.detail;
  static const StringValue kEmpty;
  // The empty text is what a record's missing text holds, whatever the field's rules say.
  if (!detail.source->IsMissing() && !TextOf(step).GetText().empty()) {
    *detail.place_out = &TextOf(step);
  } else if (IsMissingNumber(*step.y)) {
    *detail.place_out = &kEmpty;
  } else {
    *detail.place_out = &detail.category_texts[NearestMean(*step.y, detail.values.data(),
                                                           detail.variances.data(), detail.values.size())];
  }
  return &step + 1;
}

Next ReplaceSysmis(Step step) {
  return Give(step, IsMissingNumber(*step.x) ? *step.y : *step.x);
}

Next ReplaceSysmisNumber(Step step) {
  const bool is_number = IsKind(*step.detail->numbers[0], FunctionValueKind::kNumber);
  return Give(step, is_number && IsMissingNumber(*step.x) ? *step.y : *step.x);
}

Next ReplaceMissingNumber(Step step) {
  return Give(step, step.detail->source->IsMissing() ? *step.y : *step.x);
}

Next ReplaceMissingText(Step step) {
  *step.detail->place_out = &TextOf(step, step.detail->source->IsMissing() ? 1 : 0);
  return &step + 1;
}

Next Copy(Step step) {
  return Give(step, *step.x);
}

Next CopyText(Step step) {
  *step.detail->place_out = &TextOf(step);
  return &step + 1;
}

Next SkipUnlessOne(Step step) {
  return IsTrueCondition(*step.x) ? &step + 1 : &step + 1 + step.skip;
}

Next Skip(Step step) {
  return &step + 1 + step.skip;
}

}  // namespace ApplySteps
}  // namespace MCKestrel_800
