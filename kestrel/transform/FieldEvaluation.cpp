#include "kestrel/transform/FieldEvaluation.h"

#include <cmath>
#include <string>

#include "kestrel/foundation/Locale.h"
#include "kestrel/predicates/ScoreValueRange.h"
#include "kestrel/transform/SourceField.h"

namespace MCKestrel_800 {
namespace {

FieldEvaluation::Storage StorageOf(const TransformVar& field) {
  switch (field.GetVarType()) {
    case ScoreDictVar::kNUMERIC_VAR:
      return FieldEvaluation::Storage::kNumber;
    case ScoreDictVar::kDATETIME_VAR:
      return FieldEvaluation::Storage::kDateTime;
    default:
      return FieldEvaluation::Storage::kText;
  }
}

// How much of a text is left at a width in bytes: not half a character, where texts are UTF-8.
std::size_t CutSize(const std::string& text, std::size_t width) {
  if (MCXML_800::qUTF8mode() == 0) return width;
  std::size_t size = width;
  while (size > 0 && (static_cast<unsigned char>(text[size]) & 0xC0) == 0x80)
    --size;
  return size;
}

bool IsSysmisOfNumericField(const SourceField& source) {
  const ScoreDictVar* const variable = source.GetVariable();
  return variable != nullptr && variable->GetVarType() == ScoreDictVar::kNUMERIC_VAR && source.HasValue() &&
         source.GetValue()->IsSystemMissingValue();
}

}  // namespace

FieldEvaluation::Replacement::Replacement(const ScoreValue* value) : is_set(value != nullptr) {
  if (value == nullptr) return;
  number = NumberOf(*value);
  text = StringValue(value->GetString());
}

FieldEvaluation::FieldEvaluation(const TransformVar& field)
    : field_(field),
      storage_(StorageOf(field)),
      result_(&number_),
      missing_(field.GetRecodeMissValueRep()),
      default_(field.GetRecodeDefaultValue()),
      sysmis_(field.GetRecodeSysmisValueRep()),
      curve_(field.GetOrig(), field.GetNorm(), field.GetSlopes(), field.GetIntercepts(),
             field.GetOutlierTreatment()),
      bins_(field.GetBins()),
      encodings_(field.GetAllEncodedValues()) {
  if (storage_ == Storage::kText) result_ = &text_;
  if (storage_ == Storage::kDateTime) {
    result_ = &date_;
    if (field.GetDateTimeType() != kNoDateTime) {
      date_.SetDateTimeType(DateTimeValue::GetValType(field.GetDateTimeType()));
    }
  }
}

void FieldEvaluation::SetMissing() {
  TakeNumber(NumericValue::gSysmisValue);
  if (IsText()) {
    text_.SetString(std::string());
    text_.SetLength(0);
  }
}

void FieldEvaluation::TakeNumber(double number) {
  if (!std::isfinite(number)) number = NumericValue::gSysmisValue;
  if (storage_ == Storage::kNumber) {
    number_.SetDoubleValue(number);
  } else if (storage_ == Storage::kDateTime) {
    date_.SetDateTimeValue(number, date_.GetDateTimeType());
  }
}

void FieldEvaluation::TakeText(const StringValue& text) {
  text_.SetString(text.GetText());
  text_.SetLength(text.GetLength());
  CutText();
}

void FieldEvaluation::Take(const ScoreValue* value) {
  if (value == nullptr) return;
  result_->SetValue(value);
  if (!IsText()) return;
  text_.SetLength(static_cast<int32_t>(text_.GetText().size()));
  CutText();
}

void FieldEvaluation::CutText() {
  const int width = field_.GetWidth();
  const std::string& text = text_.GetText();
  if (width < 0 || static_cast<std::size_t>(width) >= text.size()) return;
  cut_.assign(text, 0, CutSize(text, static_cast<std::size_t>(width)));
  text_.SetString(cut_);
  text_.SetLength(width);
}

void FieldEvaluation::Compute(const SourceField& source) {
  if (field_.GetTransExpression() == TransExpression::kConstant) {
    ComputeConstant();
    return;
  }
  SetMissing();
  switch (field_.GetTransExpression()) {
    case TransExpression::kFieldRef:
      ComputeFieldRef(source);
      break;
    case TransExpression::kNormContinuous:
      ComputeNorm(source);
      break;
    case TransExpression::kNormDiscrete:
    case TransExpression::kMapValues:
      Take(Encode(source));
      break;
    case TransExpression::kDiscretize:
      Take(Bin(source));
      break;
    default:
      break;
  }
}

// Once, and kept for every later case.
void FieldEvaluation::ComputeConstant() {
  if (is_constant_done_) return;
  is_constant_done_ = true;
  const std::string& text = field_.GetConstString();
  if (storage_ == Storage::kNumber) {
    TakeNumber(NumericValue(text).GetDouble());
  } else if (storage_ == Storage::kDateTime) {
    date_.FromString(text, field_.GetDateTimeType());
  } else {
    TakeText(StringValue(text));
  }
}

void FieldEvaluation::ComputeFieldRef(const SourceField& source) {
  if (!source.HasValue()) return;
  const bool is_replaced = source.IsMissing() && missing_.is_set;
  Take(is_replaced ? field_.GetRecodeMissValueRep() : source.GetValue());
}

void FieldEvaluation::ComputeNorm(const SourceField& source) {
  if (storage_ != Storage::kNumber || !source.HasValue()) return;
  if (source.IsMissing()) {
    TakeNumber(missing_.number);
  } else if (source.GetKind() == SourceField::Kind::kNumber) {
    TakeNumber(curve_.Compute(source.GetNumber()));
  } else {
    TakeNumber(curve_.Compute(source.GetValue()->GetDouble()));
  }
}

const ScoreValue* FieldEvaluation::Encode(const SourceField& source) {
  if (!source.HasValue()) return RecodeAbsent(false);
  const std::size_t row = encodings_.Find(source);
  if (row == EncodingTable::kNone) return Recode(source, IsText());
  return field_.GetAllEncodedValues()[row].value.get();
}

const ScoreValue* FieldEvaluation::Bin(const SourceField& source) {
  const SourceField::Kind kind = source.GetKind();
  if (kind != SourceField::Kind::kNumber && kind != SourceField::Kind::kDateTime) return RecodeAbsent(true);
  const std::size_t bin = bins_.Find(source.GetNumber());
  if (bin == BinTable::kNone) return Recode(source, IsText());
  const ScoreValue* const value = field_.GetBins()[bin].value.get();
  return value == nullptr ? source.GetValue() : value;
}

const ScoreValue* FieldEvaluation::RecodeAbsent(bool uses_text) {
  if (IsText()) {
    recoded_text_.SetString(uses_text ? missing_.text.GetText() : std::string());
    return &recoded_text_;
  }
  return RecodedNumber(missing_.number);
}

const ScoreValue* FieldEvaluation::Recode(const SourceField& source, bool is_string) {
  return is_string ? RecodeText(source) : RecodeNumber(source);
}

const ScoreValue* FieldEvaluation::RecodeText(const SourceField& source) {
  const Replacement* replacement = &default_;
  bool copies = field_.IsRecodeElseCopy();
  if (source.IsMissing()) {
    replacement = sysmis_.is_set && IsSysmisOfNumericField(source) ? &sysmis_ : &missing_;
    copies = copies || field_.IsRecodeMissingCopy();
  }
  if (replacement->is_set) {
    recoded_text_.SetString(replacement->text.GetText());
  } else if (!copies || !source.HasValue()) {
    recoded_text_.SetString(std::string());
  } else if (source.GetKind() == SourceField::Kind::kText) {
    recoded_text_.SetString(source.GetText()->GetText());
  } else {
    recoded_text_.SetString(source.GetValue()->GetString());
  }
  return &recoded_text_;
}

const ScoreValue* FieldEvaluation::RecodeNumber(const SourceField& source) {
  bool copies = field_.IsRecodeElseCopy() && source.HasValue();
  if (source.IsMissing()) {
    copies = copies || (field_.IsRecodeMissingCopy() && source.HasValue());
    if (sysmis_.HasNumber() && IsSysmisOfNumericField(source)) return RecodedNumber(sysmis_.number);
    if (missing_.HasNumber()) return RecodedNumber(missing_.number);
  } else if (default_.is_set) {
    return RecodedNumber(default_.number);
  }
  return RecodedNumber(copies ? NumberOf(*source.GetValue()) : NumericValue::gSysmisValue);
}

// As a value that a result of the field's type takes.
const ScoreValue* FieldEvaluation::RecodedNumber(double number) {
  if (storage_ == Storage::kDateTime) {
    recoded_date_.SetDateTimeValue(number, date_.GetDateTimeType());
    return &recoded_date_;
  }
  recoded_number_.SetDoubleValue(number);
  return &recoded_number_;
}

}  // namespace MCKestrel_800
