#include "kestrel/transform/FieldEvaluation.h"

#include <cmath>
#include <string>
#include <typeinfo>
#include <utility>

#include "kestrel/foundation/Locale.h"
#include "kestrel/predicates/ScoreValueRange.h"

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
      compute_(&FieldEvaluation::ComputeNothing),
      result_(&number_),
      missing_(field.GetRecodeMissValueRep()),
      default_(field.GetRecodeDefaultValue()),
      sysmis_(field.GetRecodeSysmisValueRep()),
      curve_(field.GetOrig(), field.GetNorm(), field.GetSlopes(), field.GetIntercepts(),
             field.GetOutlierTreatment()),
      bins_(field.GetBins()),
      encodings_(field.GetAllEncodedValues()) {
  if (storage_ == Storage::kText) result_ = &text_;
  if (storage_ == Storage::kDateTime) result_ = &date_;
  if (field.GetDateTimeType() != kNoDateTime) date_kind_ = DateTimeValue::GetValType(field.GetDateTimeType());
  date_.SetDateTimeType(date_kind_);
  switch (field.GetTransExpression()) {
    case TransExpression::kConstant:
      compute_ = &FieldEvaluation::ComputeConstant;
      ReadConstant();
      break;
    case TransExpression::kFieldRef:
      compute_ = &FieldEvaluation::ComputeFieldRef;
      break;
    case TransExpression::kNormContinuous:
      if (storage_ == Storage::kNumber) compute_ = &FieldEvaluation::ComputeNorm;
      break;
    case TransExpression::kNormDiscrete:
    case TransExpression::kMapValues:
      compute_ = &FieldEvaluation::ComputeEncoding;
      for (const TransformVar::Encoding& row : field.GetAllEncodedValues())
        PrepareRow(row.value.get(), false);
      break;
    case TransExpression::kDiscretize:
      compute_ = &FieldEvaluation::ComputeBin;
      for (const TransformVar::Bin& bin : field.GetBins())
        PrepareRow(bin.value.get(), bin.value == nullptr);
      break;
    default:
      break;
  }
  if (storage_ == Storage::kNumber && row_copies_.empty()) given_numbers_ = row_numbers_.size();
}

// A constant is the first row of its field.
void FieldEvaluation::ReadConstant() {
  const std::string& text = field_.GetConstString();
  if (storage_ == Storage::kNumber) {
    const NumericValue number(text);
    PrepareRow(&number, false);
  } else if (storage_ == Storage::kDateTime) {
    const DateTimeValue date(text, field_.GetDateTimeType());
    PrepareRow(&date, false);
  } else {
    const StringValue value(text);
    PrepareRow(&value, false);
  }
}

// What the value makes of a result that takes it.
void FieldEvaluation::PrepareRow(const ScoreValue* value, bool copies_input) {
  if (copies_input || !row_copies_.empty()) {
    row_copies_.resize(row_numbers_.size() + row_texts_.size(), false);
    row_copies_.push_back(copies_input);
  }
  if (IsText()) {
    StringValue result;
    if (value != nullptr) Take(value, result);
    row_texts_.push_back(std::move(result));
    return;
  }
  const ScoreValue::ValueType type =
      storage_ == Storage::kNumber ? ScoreValue::kNumeric : ScoreValue::kDateTime;
  const bool fits = value != nullptr && value->GetType() == type && std::isfinite(value->GetDouble());
  row_numbers_.push_back(fits ? value->GetDouble() : NumericValue::gSysmisValue);
}

void FieldEvaluation::GiveMissing(ScoreValue& to) {
  if (IsText()) {
    GiveString(std::string(), to);
  } else {
    GiveNumber(NumericValue::gSysmisValue, to);
  }
}

void FieldEvaluation::GiveSeconds(double seconds, ScoreValue& to) const {
  static_cast<DateTimeValue&>(to).SetDateTimeValue(NumberOrMissing(seconds), date_kind_);
}

void FieldEvaluation::GiveText(const StringValue& text, ScoreValue& to) {
  GiveString(text.GetText(), to);
  StringValue& result = static_cast<StringValue&>(to);
  // A text that was cut has the width as its length, any other that of its own.
  if (result.GetText().size() == text.GetText().size()) result.SetLength(text.GetLength());
}

void FieldEvaluation::GiveString(const std::string& text, ScoreValue& to) {
  StringValue& result = static_cast<StringValue&>(to);
  const int width = field_.GetWidth();
  if (width < 0 || static_cast<std::size_t>(width) >= text.size()) {
    result.SetString(text);
    result.SetLength(static_cast<int32_t>(text.size()));
    return;
  }
  cut_.assign(text, 0, CutSize(text, static_cast<std::size_t>(width)));
  result.SetString(cut_);
  result.SetLength(width);
}

void FieldEvaluation::GiveOtherRow(std::size_t row, const SourceField& source, ScoreValue& to) {
  if (row >= row_numbers_.size() + row_texts_.size()) {
    Take(Recode(source, IsText()), to);
  } else if (!row_copies_.empty() && row_copies_[row]) {
    Take(source.GetValue(), to);
  } else if (storage_ == Storage::kNumber) {
    static_cast<NumericValue&>(to).SetDoubleValue(row_numbers_[row]);
  } else if (storage_ == Storage::kText) {
    static_cast<StringValue&>(to).SetString(row_texts_[row].GetText());
    static_cast<StringValue&>(to).SetLength(row_texts_[row].GetLength());
  } else {
    GiveNumber(row_numbers_[row], to);
  }
}

// A value of another kind than the result leaves it missing.
void FieldEvaluation::Take(const ScoreValue* value, ScoreValue& to) {
  const ScoreValue::ValueType type = value->GetType();
  if (type != to.GetType()) {
    GiveMissing(to);
  } else if (type == ScoreValue::kDateTime && field_.GetDateTimeType() == kNoDateTime) {
    to.SetValue(value);  // a field without a kind of its own takes the value's
  } else if (type != ScoreValue::kString) {
    GiveNumber(value->GetDouble(), to);
  } else if (typeid(*value) == typeid(StringValue)) {
    GiveString(static_cast<const StringValue*>(value)->GetText(), to);
  } else {
    GiveString(value->GetString(), to);
  }
}

void FieldEvaluation::ComputeNothing(const SourceField&, ScoreValue& to) {
  GiveMissing(to);
}

void FieldEvaluation::ComputeConstant(const SourceField& source, ScoreValue& to) {
  GiveRow(0, source, to);
}

void FieldEvaluation::ComputeFieldRef(const SourceField& source, ScoreValue& to) {
  if (!source.HasValue()) {
    GiveMissing(to);
  } else {
    Take(source.IsMissing() && missing_.is_set ? field_.GetRecodeMissValueRep() : source.GetValue(), to);
  }
}

void FieldEvaluation::ComputeOtherNorm(const SourceField& source, ScoreValue& to) {
  double number;
  if (source.IsNumber()) {
    number = curve_.Compute(source.GetNumber());
  } else if (source.IsMissing()) {
    number = source.HasValue() ? missing_.number : NumericValue::gSysmisValue;
  } else {
    number = NumberOf(*source.GetValue());
    if (!NumericValue::IsSystemMissingValue(number)) number = curve_.Compute(number);
  }
  static_cast<NumericValue&>(to).SetDoubleValue(NumberOrMissing(number));
}

// row  the bin that holds the value, where that could be seen at once.
void FieldEvaluation::ComputeOtherBin(std::size_t row, const SourceField& source, ScoreValue& to) {
  const SourceField::Kind kind = source.GetKind();
  if (row != BinTable::kNone) {
    GiveOtherRow(row, source, to);
  } else if (kind == SourceField::Kind::kNumber || kind == SourceField::Kind::kDateTime) {
    GiveRow(bins_.Find(source.GetNumber()), source, to);
  } else {
    Take(RecodeAbsent(true), to);
  }
}

void FieldEvaluation::ComputeEncoding(const SourceField& source, ScoreValue& to) {
  if (source.HasValue()) {
    GiveRow(encodings_.Find(source), source, to);
  } else {
    Take(RecodeAbsent(false), to);
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
    recoded_date_.SetDateTimeValue(number, date_kind_);
    return &recoded_date_;
  }
  recoded_number_.SetDoubleValue(number);
  return &recoded_number_;
}

}  // namespace MCKestrel_800
