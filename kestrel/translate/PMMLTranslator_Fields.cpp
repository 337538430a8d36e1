// The children of one DataField: its valid and missing values, its display format and its invalid ranges.

#include <algorithm>
#include <memory>
#include <string>

#include "kestrel/dictionary/MissingValueSet.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ValueLabelSet.h"
#include "kestrel/dictionary/ValueLbl.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/predicates/Range.h"
#include "kestrel/translate/FieldRules.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/VerifiedText.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

using xercesc::DOMElement;
using Tag = PMMLTagText;

// The extension that names a flag's "true" value.
constexpr char16_t kFlagTypeTrueValue[] = u"flagTypeTrueValue";

enum class Property { kValid, kMissing };

struct PropertyRow {
  const char16_t* text;
  Property property;
};

constexpr PropertyRow kProperties[] = {
    {Tag::XML_VAL_PROP_VALID, Property::kValid},
    {Tag::XML_VAL_PROP_INVALID, Property::kMissing},
    {Tag::XML_VAL_PROP_MISSING, Property::kMissing},
    // A value without the attribute, or with an empty one, is valid.
    {u"", Property::kValid},
};

/// Whether a field has categories or a continuous range: where the two kinds of fields read differently.
enum class Kind { kCategorical, kContinuous };

/// What the children of one field add up to, until it is handed to the variable.
class FieldValues {
 public:
  FieldValues(Kind kind, DOMElement* field, ScoreDictVar& variable)
      : kind_(kind), field_(field), variable_(variable) {}

  void Read();

 private:
  void ReadChild(DOMElement* child);
  void ReadValue(const DOMElement* element);
  void ReadExtension(const DOMElement* extension);
  void AddMissing(const DOMElement* element, const XMLCh* text);
  void AddLabel(const DOMElement* element, const XMLCh* text);

  void AddInvalidRange();
  void RefuseLabelsThatAreMissing() const;
  void RefuseLabelsThatTheVariableMisses() const;
  void RefuseDuplicate() const;
  void CheckLevel() const;
  void StoreLabels();
  void StoreMissing();

  const Kind kind_;
  DOMElement* const field_;
  ScoreDictVar& variable_;
  std::unique_ptr<ValueLabelSet> labels_ = std::make_unique<ValueLabelSet>();
  std::unique_ptr<MissingValueSet> missing_ = std::make_unique<MissingValueSet>();
  // The labels pass to the variable before the last checks, which still look at them.
  const ValueLabelSet& labelView_ = *labels_;
  int lowerBounds_ = 0;
  int upperBounds_ = 0;
  double lower_ = -NumericValue::GetInfinity();
  double upper_ = NumericValue::GetInfinity();
  bool hasInterval_ = false;
  // The first valid value that is listed a second time: kept because other faults are reported before it.
  const DOMElement* duplicateElement_ = nullptr;
  const ScoreValue* duplicate_ = nullptr;
};

[[noreturn]] void FailOnValue(const DOMElement* where, const ScoreValue& value, const char* text) {
  FailAt(where, KestrelException::kStructure, "\"" + value.GetString() + "\"" + text);
}

void FieldValues::Read() {
  for (DOMElement* child : ChildElements(field_))
    ReadChild(child);
  AddInvalidRange();
  RefuseLabelsThatAreMissing();
  if (kind_ == Kind::kCategorical) {
    StoreLabels();
    CheckFlagCategories(field_, variable_, labelView_.Size());
    RefuseLabelsThatTheVariableMisses();
    RefuseDuplicate();
    StoreMissing();
    CheckLevel();
  } else {
    RefuseLabelsThatTheVariableMisses();
    RefuseDuplicate();
    StoreLabels();
    StoreMissing();
  }
}

void FieldValues::ReadChild(DOMElement* child) {
  if (ElementIs(child, Tag::XML_ELE_VALUE)) {
    ReadValue(child);
  } else if (ElementIs(child, Tag::XML_ELE_EXTENSION)) {
    ReadExtension(child);
  } else if (kind_ == Kind::kContinuous && ElementIs(child, Tag::XML_ELE_INTERVAL)) {
    if (hasInterval_) {
      FailAt(child, KestrelException::kUnsupported, "Only One InterVal Element allowed here!");
    }
    hasInterval_ = true;
    PMMLTranslator::handleInterval(&variable_, child, missing_.get(), 0);
  } else if (kind_ == Kind::kContinuous && ElementIs(child, Tag::XML_ELE_XDATAFIELD)) {
    PMMLTranslator::handleTreeInterval(FirstChild(child), missing_.get());
  } else {
    FailAt(child, KestrelException::kStructure, Narrow(child->getNodeName()) + ": Invalid element!");
  }
}

void FieldValues::ReadValue(const DOMElement* element) {
  const XMLCh* text = RequiredAttribute(element, Tag::XML_ATT_VALUE_VALUE);
  const XMLCh* property = Attribute(element, Tag::XML_ATT_VALUE_PROPERTY);
  for (const PropertyRow& row : kProperties) {
    if (!Equals(property, row.text)) continue;
    if (row.property == Property::kMissing) {
      AddMissing(element, text);
    } else {
      AddLabel(element, text);
    }
    return;
  }
  FailAt(element, KestrelException::kInvalidDocument, "InValid property value!");
}

void FieldValues::AddMissing(const DOMElement* element, const XMLCh* text) {
  std::unique_ptr<ScoreValue> value;
  try {
    value.reset(BaseTranslator::CarefullyMakeVarValue(&variable_, text));
  } catch (const KestrelException& fault) {
    const bool ownText = kind_ == Kind::kCategorical && variable_.GetVarType() == ScoreDictVar::kNUMERIC_VAR;
    FailAt(element, KestrelException::kConversion,
           ownText ? Narrow(text) + ": Invalid Numeric Categorical Value!" : fault.GetErrorMessage());
  }
  if (value == nullptr) return;
  auto range = std::make_unique<Range>(value.get());
  value.release();
  // The same value given twice is refused by the set and stays ours.
  if (missing_->Add(range.get())) range.release();
}

void FieldValues::AddLabel(const DOMElement* element, const XMLCh* text) {
  std::unique_ptr<ScoreValue> value;
  try {
    value.reset(BaseTranslator::CarefullyMakeVarValue(&variable_, text));
  } catch (const KestrelException& fault) {
    const bool ownText = kind_ == Kind::kContinuous || variable_.GetVarType() == ScoreDictVar::kNUMERIC_VAR;
    if (ownText) FailAt(element, KestrelException::kInvalidValue, Narrow(text) + ": invalid value!");
    FailAt(element, KestrelException::kConversion, fault.GetErrorMessage());
  }
  if (value == nullptr) return;
  if (duplicate_ == nullptr && IsListed(*labels_, variable_, *value)) {
    duplicateElement_ = element;
    duplicate_ = value.get();
  }
  // Not through the variable's own operation, which takes no value without a label.
  auto label =
      std::make_unique<ValueLbl>(value.get(), AttributeText(element, Tag::XML_ATT_VALUE_DISPLAYVALUE));
  value.release();
  labels_->Add(label.release());
}

void FieldValues::ReadExtension(const DOMElement* extension) {
  const XMLCh* name = Attribute(extension, Tag::XML_ATT_EXT_NAME);
  const XMLCh* value = Attribute(extension, Tag::XML_ATT_EXT_VALUE);
  if (Equals(name, Tag::XML_VAL_NAME_FORMAT)) {
    // Only checked: the library has no use for a producer's number of a display format.
    VerifyIntAt(extension, value);
  } else if (Equals(name, Tag::XML_VAL_NAME_WIDTH) || Equals(name, Tag::XML_ATT_TRAN_EXT_NAME_STRINGLENGTH)) {
    variable_.SetWidth(VerifyIntAt(extension, value));
  } else if (Equals(name, Tag::XML_VAL_NAME_DECIMAL)) {
    variable_.SetDecimal(VerifyIntAt(extension, value));
  } else if (Equals(name, Tag::XML_VAL_NAME_MSLO)) {
    lower_ = VerifyDoubleAt(extension, value);
    ++lowerBounds_;
  } else if (Equals(name, Tag::XML_VAL_NAME_MSUP)) {
    upper_ = VerifyDoubleAt(extension, value);
    ++upperBounds_;
  } else if (kind_ == Kind::kCategorical && Equals(name, kFlagTypeTrueValue)) {
    variable_.SetFalgTypeTrueValue(Narrow(value));
  }
}

void FieldValues::AddInvalidRange() {
  // More than two of a kind are as wrong as two; without the limit ten lower bounds would look like one upper
  // one.
  const int flags = std::min(lowerBounds_, 2) + 10 * std::min(upperBounds_, 2);
  try {
    PMMLTranslator::HandleVEXAMissingInterval(missing_.get(), flags, lower_, upper_);
  } catch (const KestrelException& fault) {
    FailAt(field_, KestrelException::kUnsupported, fault.GetErrorMessage());
  }
}

/// A label may stand inside a missing interval, where it wins. Declared missing by itself it is a
/// contradiction.
void FieldValues::RefuseLabelsThatAreMissing() const {
  if (missing_->Size() == 0 || labels_->Size() == 0) return;
  for (const ScoreValueRange* range : missing_->GetMissingValues()) {
    const ScoreValue* value = range->GetMin();
    if (!(*value == *range->GetMax()) || !labels_->Contains(value)) continue;
    FailOnValue(field_, *value,
                kind_ == Kind::kCategorical ? ": defined as both Valid and Invalid value!"
                                            : ": defined as both valid and invalid/missing value!");
  }
}

/// The missing values are not the variable's yet, so this finds the labels that are missing whatever a
/// document says: the system-missing value written out as a number.
void FieldValues::RefuseLabelsThatTheVariableMisses() const {
  for (const ScoreValueLabel* label : labelView_.GetAllValueLabels()) {
    if (!variable_.IsMissingValue(label->GetValue())) continue;
    FailOnField(field_, KestrelException::kInconsistentDictionary, variable_.GetName(),
                kind_ == Kind::kCategorical ? ": category value is defined as both valid and invalid/missing"
                                            : ": value is defined as both valid and invalid/missing");
  }
}

void FieldValues::RefuseDuplicate() const {
  if (duplicate_ == nullptr) return;
  FailOnValue(duplicateElement_, *duplicate_,
              kind_ == Kind::kCategorical ? ": Duplicated Category Value!" : ": Duplicated Value!");
}

/// No document comes this far with another level; a caller of ParseCategoricalValues may.
void FieldValues::CheckLevel() const {
  const ScoreDictVar::MeasureLevel level = variable_.GetMLevel();
  if (level != ScoreDictVar::kOrdinal && level != ScoreDictVar::kNominal) {
    FailAt(field_, KestrelException::kStructure, "Invalid Variable Type!");
  }
}

void FieldValues::StoreLabels() {
  if (kind_ == Kind::kCategorical && labels_->Size() == 0) variable_.SetEmptyCateValues(true);
  variable_.SetValueLabels(labels_.release());
}

void FieldValues::StoreMissing() {
  variable_.SetMissingValues(missing_.release());
}

}  // namespace

void PMMLTranslator::ParseCategoricalValues(DOMElement* field, ScoreDictVar* variable) {
  if (field != nullptr && variable != nullptr) FieldValues(Kind::kCategorical, field, *variable).Read();
}

void PMMLTranslator::ParseContinuousValues(DOMElement* field, ScoreDictVar* variable) {
  if (field != nullptr && variable != nullptr) FieldValues(Kind::kContinuous, field, *variable).Read();
}

}  // namespace MCKestrel_800
