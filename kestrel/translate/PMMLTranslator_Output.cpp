// The Output element: the fields that a document asks for beside the prediction.

#include <memory>
#include <string>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/translate/FieldRules.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/ResultVar.h"
#include "kestrel/translate/VerifiedText.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

using xercesc::DOMElement;
using Tag = PMMLTagText;
using Feature = ScoreResultField::ResultFeature;

constexpr char16_t kOutputFieldTag[] = u"OutputField";

/// The two elements that say the same, each with the words of its own time.
enum class FieldKind { kResultField, kOutputField };

struct FeatureRow {
  const char16_t* text;
  Feature feature;
  bool only_output_field = false;
};

constexpr FeatureRow kFeatures[] = {
    {Tag::XML_ATT_VAL_MINING_PREDICTEDVALUE, Feature::kPredictedValue},
    {Tag::XML_ATT_VAL_MINING_PREDICTEDDispVALUE, Feature::kPredictedDisplayValue},
    {Tag::XML_ATT_VAL_MINING_PROBABILITY, Feature::kProbability},
    {Tag::XML_ATT_VAL_MINING_RESIDUAL, Feature::kResidual},
    {Tag::XML_ATT_VAL_MINING_STANDARDERROR, Feature::kStandardError},
    {Tag::XML_ATT_VAL_MINING_CLUSTERID, Feature::kClusterId},
    {Tag::XML_ATT_VAL_MINING_CLUSTERAFFINITY, Feature::kClusterAffinity},
    // Documents in use mean the display value with it.
    {Tag::XML_VAL_OT_CATEGORICAL, Feature::kPredictedDisplayValue},
    {Tag::XML_ATT_VAL_MINING_ENTITYID, Feature::kEntityId},
    {Tag::XML_ATT_VAL_MINING_ENTITYIDAFFINITY, Feature::kEntityAffinity},
    {Tag::XML_ATT_VAL_MINING_WARNING, Feature::kWarning},
    {Tag::XML_ATT_VAL_MINING_RULEVALUE, Feature::kRuleValue},
    {Tag::XML_ATT_VAL_MINING_STANDARDDEVIATION, Feature::kStandardDeviation},
    // Later names: of an entity's affinity, and of what is told of a rule.
    {u"affinity", Feature::kEntityAffinity, true},
    {u"antecedent", Feature::kRuleValue, true},
    {u"consequent", Feature::kRuleValue, true},
    {u"rule", Feature::kRuleValue, true},
    {u"ruleId", Feature::kRuleValue, true},
    {u"confidence", Feature::kRuleValue, true},
    {u"support", Feature::kRuleValue, true},
    {u"lift", Feature::kRuleValue, true},
    {u"leverage", Feature::kRuleValue, true},
    {u"", Feature::kNoFeature},
};

/// What an OutputField may ask for that no model here can tell. To say so helps more than to call it a
/// mistake.
constexpr const char16_t* kOtherFeatures[] = {
    u"transformedValue", u"decision", u"reasonCode", u"confidenceIntervalLower", u"confidenceIntervalUpper",
};

std::string ReadName(const DOMElement* field, const ScoreDictionary& others) {
  std::string name = Narrow(RequiredAttribute(field, Tag::XML_ATT_VAL_MINING_NAME));
  if (name.empty()) {
    FailAt(field, KestrelException::kStructure,
           "<" + Narrow(field->getNodeName()) + ">'s name can't be null string !!");
  }
  // A dictionary takes a name that it has without a word, and lists it twice.
  if (others.GetVar(name) != nullptr) {
    FailOnField(field, KestrelException::kUnknownVariable, name,
                ": Invalid Variable Name -- alreay in the dictionary");
  }
  return name;
}

void ReadType(const DOMElement* field, ResultVar& variable) {
  if (const XMLCh* const text = FindAttribute(field, Tag::XML_ATT_VAL_MINING_OPTYPE)) {
    ScoreDictVar::MeasureLevel level{};
    if (!FindMeasureLevel(text, level)) {
      FailOnField(field, KestrelException::kInvalidType, variable.GetName(), ": Invalid Variable Type");
    }
    variable.SetMLevel(level);
  }
  if (Equals(Attribute(field, Tag::XML_ATT_DATATYPE), Tag::XML_VAL_STRING)) {
    variable.SetVarType(ScoreDictVar::STRING_VAR);
  }
}

[[noreturn]] void FailOnFeature(const DOMElement* field, FieldKind kind, const std::string& name,
                                const XMLCh* text) {
  for (const char16_t* other : kOtherFeatures) {
    if (kind != FieldKind::kOutputField || !Equals(text, other)) continue;
    FailOnField(field, KestrelException::kUnsupported, name,
                ": feature -- " + Narrow(text) + ": Not supported!");
  }
  FailOnField(field, KestrelException::kInvalidType, name, ": Invalid feature Type");
}

Feature ReadFeature(const DOMElement* field, FieldKind kind, const std::string& name) {
  const bool may_be_absent = kind == FieldKind::kOutputField;
  const XMLCh* const text = may_be_absent ? FindAttribute(field, Tag::XML_ATT_VAL_MINING_FEATURE)
                                          : RequiredAttribute(field, Tag::XML_ATT_VAL_MINING_FEATURE);
  if (text == nullptr) return Feature::kPredictedValue;
  for (const FeatureRow& row : kFeatures) {
    if (row.only_output_field && kind != FieldKind::kOutputField) continue;
    if (Equals(text, row.text)) return row.feature;
  }
  FailOnFeature(field, kind, name, text);
}

/// A value of the variable's type where the text is one. Of a probability it is a category, which may be any
/// text although the field itself is a number.
std::unique_ptr<ScoreValue> MakeFieldValue(const ResultVar& variable, const XMLCh* text) {
  if (variable.IsString()) return std::make_unique<StringValue>(Narrow(text));
  try {
    return std::make_unique<NumericValue>(BaseTranslator::VerifyDouble(text));
  } catch (const KestrelException&) {
    return std::make_unique<StringValue>(Narrow(text));
  }
}

}  // namespace

ResultVar& PMMLTranslator::ParseResultField(const DOMElement* field, ScoreDictionary& into) {
  const FieldKind kind =
      ElementIs(field, kOutputFieldTag) ? FieldKind::kOutputField : FieldKind::kResultField;
  const std::string name = ReadName(field, into);
  auto variable = std::make_unique<ResultVar>(name, ScoreDictVar::kNUMERIC_VAR);
  variable->SetLabel(AttributeText(field, Tag::XML_ATT_DATAFIELD_DISPLAYNAME));
  ReadType(field, *variable);
  variable->SetFeature(ReadFeature(field, kind, name));
  if (const XMLCh* const text = FindAttribute(field, Tag::XML_ATT_VALUE_VALUE)) {
    variable->SetDefValue(MakeFieldValue(*variable, text).release());
  }
  into.AddVar(name, variable.get());
  return *variable.release();
}

ScoreDictionary* PMMLTranslator::ParseResultDictionary(const DOMElement* output) {
  auto dictionary = std::make_unique<BaseDictionary>();
  for (const DOMElement* field : ChildElements(output, Tag::XML_ELE_VAL_RESULTFIELD))
    ParseResultField(field, *dictionary);
  return dictionary.release();
}

}  // namespace MCKestrel_800
