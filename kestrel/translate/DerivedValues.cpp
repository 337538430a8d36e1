#include "kestrel/translate/DerivedValues.h"

#include <cmath>
#include <xercesc/dom/DOMElement.hpp>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/dictionary/ValueLabelSet.h"
#include "kestrel/dictionary/ValueLbl.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/translate/BaseTranslator.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/VerifiedText.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

using xercesc::DOMElement;
using Tag = PMMLTagText;

std::unique_ptr<ScoreValue> MakeDateTimeAt(const DOMElement* element, DateTimeType type, const XMLCh* text) {
  // Data fields write their values as numbers in their unit; what people write in tables is a date.
  const std::string narrow = Narrow(text);
  if (!narrow.empty() && DateTimeValue::IsValidDateTime(narrow, type)) {
    return std::make_unique<DateTimeValue>(narrow, type);
  }
  return std::make_unique<DateTimeValue>(VerifyDoubleAt(element, text), type);
}

/// The categories of one field while they are looked for.
class CategoryNotes {
 public:
  explicit CategoryNotes(const TransformVar& variable) : variable_(variable) {}

  /// Notes a value that the field can have; null, and one that is missing, is none.
  void Add(const ScoreValue* value);
  void AddReplacements();
  /// Null when they are not known.
  std::unique_ptr<ValueLabelSet> Take() { return is_known_ ? std::move(labels_) : nullptr; }

 private:
  bool IsMissing(const ScoreValue& value) const;
  bool FitsType(const ScoreValue& value) const;
  bool IsCut(const ScoreValue& value) const;

  const TransformVar& variable_;
  std::unique_ptr<ValueLabelSet> labels_ = std::make_unique<ValueLabelSet>();
  bool is_known_ = true;
};

bool CategoryNotes::IsMissing(const ScoreValue& value) const {
  if (variable_.IsMissingValue(&value)) return true;
  if (value.GetType() == ScoreValue::kString) return static_cast<const StringValue&>(value).GetText().empty();
  return !std::isfinite(value.GetDouble());
}

/// The numbers of a NormDiscrete do not become texts or dates.
bool CategoryNotes::FitsType(const ScoreValue& value) const {
  switch (variable_.GetVarType()) {
    case ScoreDictVar::kNUMERIC_VAR:
      return value.GetType() == ScoreValue::kNumeric;
    case ScoreDictVar::kDATETIME_VAR:
      return value.GetType() == ScoreValue::kDateTime;
    default:
      return value.GetType() == ScoreValue::kString;
  }
}

bool CategoryNotes::IsCut(const ScoreValue& value) const {
  if (!variable_.IsString() || variable_.GetWidth() < 0) return false;
  return static_cast<const StringValue&>(value).GetText().size() > static_cast<size_t>(variable_.GetWidth());
}

void CategoryNotes::Add(const ScoreValue* value) {
  if (value == nullptr || IsMissing(*value)) return;
  if (!FitsType(*value) || IsCut(*value)) {
    is_known_ = false;
    return;
  }
  if (labels_->Contains(value)) return;
  std::unique_ptr<ScoreValue> copy(value->Clone());
  auto label = std::make_unique<ValueLbl>(copy.get(), std::string());
  static_cast<void>(copy.release());
  labels_->Add(label.release());
}

void CategoryNotes::AddReplacements() {
  Add(variable_.GetRecodeDefaultValue());
  Add(variable_.GetRecodeMissValueRep());
  Add(variable_.GetRecodeSysmisValueRep());
}

std::unique_ptr<ValueLabelSet> CategoriesOf(const TransformVar& variable) {
  if (variable.IsRecodeElseCopy() || variable.IsRecodeMissingCopy()) return nullptr;
  CategoryNotes notes(variable);
  switch (variable.GetTransExpression()) {
    case TransExpression::kConstant: {
      const std::string& text = variable.GetConstString();
      if (variable.IsString()) {
        const StringValue value(text);
        notes.Add(&value);
      } else if (variable.GetVarType() == ScoreDictVar::kDATETIME_VAR) {
        const DateTimeValue value(text, variable.GetDateTimeType());
        notes.Add(&value);
      } else {
        const NumericValue value(text);
        notes.Add(&value);
      }
      return notes.Take();
    }
    case TransExpression::kNormDiscrete: {
      // In the order of the numbers: a document lists neither.
      const NumericValue no(0.0), yes(1.0);
      notes.Add(&no);
      notes.Add(&yes);
      break;
    }
    case TransExpression::kMapValues:
      for (const TransformVar::Encoding& row : variable.GetAllEncodedValues())
        notes.Add(row.value.get());
      break;
    case TransExpression::kDiscretize:
      for (const TransformVar::Bin& bin : variable.GetBins()) {
        if (bin.value == nullptr) return nullptr;
        notes.Add(bin.value.get());
      }
      break;
    default:
      return nullptr;
  }
  notes.AddReplacements();
  return notes.Take();
}

}  // namespace

const ScoreDictVar* FindField(const ScoreDictionary* dictionary, const ScoreDictionary* derived,
                              const std::string& name) {
  const ScoreDictVar* variable = dictionary != nullptr ? dictionary->GetVar(name) : nullptr;
  if (variable == nullptr && derived != nullptr) variable = derived->GetVar(name);
  return variable;
}

const ScoreDictVar* RequireField(const DOMElement* element, const ScoreDictionary* dictionary,
                                 const ScoreDictionary* derived, const std::string& name) {
  const ScoreDictVar* const variable = FindField(dictionary, derived, name);
  if (variable == nullptr) FailOnField(element, KestrelException::kUnknownVariable, name, ": not predefined");
  return variable;
}

std::unique_ptr<ScoreValue> ReadFieldReplacement(const DOMElement* reference, const ScoreDictVar& source,
                                                 const std::string& derivedField) {
  const XMLCh* const text = Attribute(reference, Tag::XML_ATT_MISSREPVALUE);
  if (IsEmpty(text)) return nullptr;
  try {
    return MakeValueAt(reference, source, text);
  } catch (const KestrelException&) {
    FailOnField(reference, KestrelException::kUnknownVariable, derivedField,
                ": has to have the same type as " + source.GetName());
  }
}

std::unique_ptr<ScoreValue> MakeValueAt(const DOMElement* element, const ScoreDictVar& variable,
                                        const XMLCh* text) {
  switch (variable.GetVarType()) {
    case ScoreDictVar::kNUMERIC_VAR:
      return std::make_unique<NumericValue>(VerifyDoubleAt(element, text));
    case ScoreDictVar::kDATETIME_VAR:
      return MakeDateTimeAt(element, variable.GetDateTimeType(), text);
    default:
      return std::make_unique<StringValue>(Narrow(text));
  }
}

void ReadMissingReplacement(const DOMElement* expression, TransformVar& variable) {
  const XMLCh* const text = Attribute(expression, Tag::XML_ATT_MISSREPVALUE);
  if (!IsEmpty(text)) variable.SetRecodeMissValueTo(MakeValueAt(expression, variable, text).release());
}

void ReadDefaultValue(const DOMElement* expression, TransformVar& variable) {
  const XMLCh* const text = Attribute(expression, Tag::XML_ATT_DEFAULTVALUE);
  if (!IsEmpty(text)) variable.SetRecodeDefaultValue(MakeValueAt(expression, variable, text).release());
}

void RequireNumericTarget(const DOMElement* extension, const TransformVar& variable) {
  if (variable.GetVarType() == ScoreDictVar::kNUMERIC_VAR) return;
  FailAt(extension, KestrelException::kUnsupported, "Only numeric type derived variable is allowed!");
}

void FailOnElement(const DOMElement* element) {
  FailAt(element, KestrelException::kStructure, Narrow(element->getNodeName()) + ": Invalid element!");
}

void NoteCategories(TransformVar& variable) {
  if (variable.GetMLevel() == ScoreDictVar::kContinuous || variable.GetValueLabels() != nullptr) return;
  if (auto labels = CategoriesOf(variable); labels != nullptr) variable.SetValueLabels(labels.release());
}

}  // namespace MCKestrel_800
