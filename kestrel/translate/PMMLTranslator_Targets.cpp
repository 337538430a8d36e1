// The Targets element: what it adds to the variables that it names.

#include <memory>
#include <string>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/dictionary/ValueLabelSet.h"
#include "kestrel/dictionary/ValueLbl.h"
#include "kestrel/dictionary/ValueProbability.h"
#include "kestrel/dictionary/ValueProbabilitySet.h"
#include "kestrel/translate/DerivedValues.h"
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

/// The categories of one target, until they are handed to its variable.
class TargetValues {
 public:
  explicit TargetValues(ScoreDictVar& variable) : variable_(variable) {}

  void Read(const DOMElement* target);

 private:
  void ReadValue(const DOMElement* element);
  std::unique_ptr<ScoreValue> MakeCategory(const DOMElement* element) const;
  void AddPrior(const DOMElement* element, const ScoreValue& category);
  void Attach();

  ScoreDictVar& variable_;
  std::unique_ptr<ValueLabelSet> labels_ = std::make_unique<ValueLabelSet>();
  std::unique_ptr<ValueProbabilitySet> priors_ = std::make_unique<ValueProbabilitySet>();
};

void TargetValues::Read(const DOMElement* target) {
  for (const DOMElement* child : ChildElements(target, Tag::XML_ELE_TARGETVALUE))
    ReadValue(child);
  // A target may stand there for what is not read, without a word on the categories.
  if (labels_->Size() == 0) return;
  CheckFlagCategories(target, variable_, labels_->Size());
  Attach();
}

void TargetValues::ReadValue(const DOMElement* element) {
  std::unique_ptr<ScoreValue> category = MakeCategory(element);
  if (IsListed(*labels_, variable_, *category)) {
    FailOnField(element, KestrelException::kStructure, variable_.GetName(), ": Duplicated Category Value!");
  }
  // The variable still has its old labels: a number that a data field lists inside a missing interval stays a
  // category.
  if (variable_.IsMissingValue(category.get())) {
    FailOnField(element, KestrelException::kInconsistentDictionary, variable_.GetName(),
                ": category value is defined as both valid and invalid/missing");
  }
  AddPrior(element, *category);
  auto label =
      std::make_unique<ValueLbl>(category.get(), AttributeText(element, Tag::XML_ATT_VALUE_DISPLAYVALUE));
  category.release();
  labels_->Add(label.get());
  label.release();
}

std::unique_ptr<ScoreValue> TargetValues::MakeCategory(const DOMElement* element) const {
  const XMLCh* const text = RequiredAttribute(element, Tag::XML_ATT_VALUE_VALUE);
  std::unique_ptr<ScoreValue> value;
  try {
    value.reset(BaseTranslator::CarefullyMakeVarValue(&variable_, text));
  } catch (const KestrelException&) {
    value.reset();
  }
  if (value == nullptr) {
    FailOnField(element, KestrelException::kInvalidValue, variable_.GetName(), ": invalid value!");
  }
  return value;
}

void TargetValues::AddPrior(const DOMElement* element, const ScoreValue& category) {
  const XMLCh* const text = FindAttribute(element, Tag::XML_ATT_PRIORPROBABILITY);
  if (text == nullptr) return;
  auto prior = std::make_unique<ValueProbability>(category.Clone(), 0.0);
  bool is_probability = false;
  try {
    is_probability = prior->SetProbability(BaseTranslator::VerifyDouble(text));
  } catch (const KestrelException&) {
    is_probability = false;
  }
  if (!is_probability) {
    FailOnField(element, KestrelException::kConversion, variable_.GetName(), ": invalid prior probability!");
  }
  priors_->Add(prior.get());
  prior.release();
}

void TargetValues::Attach() {
  const std::unique_ptr<ScoreValueLabelSet> old_labels(variable_.GetValueLabels());
  const std::unique_ptr<ScoreValueProbabilitySet> old_priors(variable_.GetValueProbabilities());
  const std::unique_ptr<ScoreEncoder> old_encoder(variable_.GetEncoder());
  variable_.SetValueLabels(labels_.release());
  variable_.SetValueProbabilities(priors_.release());
  variable_.SetEmptyCateValues(false);
  variable_.SetEncoder(nullptr);
  PMMLTranslator::SetupCatEncoder(&variable_);
}

void ReadDefault(const DOMElement* target, ScoreDictVar& variable) {
  const DOMElement* const first = FirstChild(target, Tag::XML_ELE_TARGETVALUE);
  const XMLCh* const text = Attribute(first, Tag::XML_ATT_DEFAULTVALUE);
  if (IsEmpty(text)) return;
  auto value = MakeValueAt(first, variable, text);
  const std::unique_ptr<ScoreValue> old(variable.GetDefValue());
  variable.SetDefValue(value.release());
}

ScoreDictVar& RequireTarget(const DOMElement* target, ScoreDictionary& dictionary) {
  const std::string name = Narrow(RequiredAttribute(target, Tag::XML_ATT_FIELD));
  if (name.empty()) {
    FailAt(target, KestrelException::kStructure, "<Target>'s name can't be null string !!");
  }
  ScoreDictVar* const variable = dictionary.GetVar(name);
  if (variable == nullptr) {
    FailOnField(target, KestrelException::kUnknownVariable, name,
                ": Invalid Field Name -- does not  in the dictionary");
  }
  return *variable;
}

void CheckLevel(const DOMElement* target, const ScoreDictVar& variable) {
  const XMLCh* const text = FindAttribute(target, Tag::XML_ATT_DATAFIELD_OPTYPE);
  if (text == nullptr) return;
  ScoreDictVar::MeasureLevel level{};
  if (!FindMeasureLevel(text, level)) {
    FailOnField(target, KestrelException::kInvalidType, variable.GetName(), ": Invalid Variable Type");
  }
  if (level != variable.GetMLevel()) {
    FailOnField(target, KestrelException::kInvalidType, variable.GetName(),
                ": Invalid Variable Type, does not match the variable type in data dictionary");
  }
}

void ReadTarget(const DOMElement* target, ScoreDictionary& dictionary) {
  ScoreDictVar& variable = RequireTarget(target, dictionary);
  CheckLevel(target, variable);
  switch (variable.GetMLevel()) {
    case ScoreDictVar::kContinuous:
      ReadDefault(target, variable);
      return;
    case ScoreDictVar::kOrdinal:
    case ScoreDictVar::kNominal:
      TargetValues(variable).Read(target);
      return;
  }
  // No document comes this far with another level; a program's dictionary may.
  FailAt(target, KestrelException::kStructure, "Invalid Variable Type!");
}

}  // namespace

void PMMLTranslator::HandleTargets(const DOMElement* targets, ScoreDictionary* dictionary) {
  if (targets == nullptr) return;
  if (dictionary == nullptr) FailAt(targets, KestrelException::kStructure, "<DataDictionary is required !!");
  for (const DOMElement* target : ChildElements(targets, Tag::XML_ELE_TARGET))
    ReadTarget(target, *dictionary);
}

}  // namespace MCKestrel_800
