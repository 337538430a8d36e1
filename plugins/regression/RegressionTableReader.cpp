#include "plugins/regression/RegressionTableReader.h"

#include <xercesc/dom/DOMElement.hpp>

#include <utility>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/translate/BaseTranslator.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {
namespace {

using xercesc::DOMElement;
using Tags = PMMLTagText;

double ReadNumber(const DOMElement* element, const XMLCh* text) {
  try {
    return BaseTranslator::VerifyDouble(text);
  } catch (const KestrelException& fault) {
    // The same words, with the place that the conversion does not know.
    FailAt(element, KestrelException::kConversion, fault.GetErrorMessage());
  }
}

double ReadRequiredNumber(const DOMElement* element, const char* attribute) {
  return ReadNumber(element, BaseTranslator::GetAttributeForced(element, attribute));
}

double ReadNumberOr(const DOMElement* element, const char16_t* attribute, double absent) {
  const XMLCh* text = FindAttribute(element, attribute);
  return IsEmpty(text) ? absent : ReadNumber(element, text);
}

/// A value of the variable that it accepts as a category.
std::unique_ptr<ScoreValue> MakeCategory(const DOMElement* element, const ScoreDictVar& variable,
                                         const XMLCh* text) {
  std::unique_ptr<ScoreValue> value;
  try {
    value.reset(BaseTranslator::CarefullyMakeVarValue(&variable, text));
  } catch (const KestrelException&) {
    // Reported below, with the field's name.
  }
  if (value == nullptr || !variable.IsValidValue(value.get())) {
    FailOnField(element, KestrelException::kInvalidValue, variable.GetName(), ": invalid value!");
  }
  return value;
}

}  // namespace

RegressionTable RegressionTableReader::Read(const DOMElement* element, bool needs_category) const {
  RegressionTable table;
  if (needs_category) table.category = ReadCategory(element);
  table.intercept = ReadNumberOr(element, Tags::XML_ATT_INTERCEPT, 0.0);
  for (const DOMElement* child : ChildElements(element)) {
    if (ElementIs(child, Tags::XML_ELE_EXTENSION)) continue;
    if (ElementIs(child, Tags::XML_ELE_NUMERIC_PREDICTOR)) {
      table.terms.push_back(ReadNumericPredictor(child));
    } else if (ElementIs(child, Tags::XML_ELE_CATEGORICAL_PREDICTOR)) {
      table.terms.push_back(ReadCategoricalPredictor(child));
    } else if (ElementIs(child, Tags::XML_ELE_PREDICTOR_TERM)) {
      table.terms.push_back(ReadPredictorTerm(child));
    } else {
      FailAt(child, KestrelException::kStructure, Narrow(child->getTagName()) + ": Invalid element!");
    }
  }
  return table;
}

std::unique_ptr<ScoreValue> RegressionTableReader::ReadCategory(const DOMElement* element) const {
  const XMLCh* text = BaseTranslator::GetAttributeForced(element, PMMLModelTags::XML_ATT_PPC_TARGET_CAT);
  if (target_ == nullptr) return std::make_unique<StringValue>(Narrow(text));
  return MakeCategory(element, *target_, text);
}

RegressionTerm RegressionTableReader::ReadNumericPredictor(const DOMElement* element) const {
  RegressionTerm term;
  term.kind = RegressionTerm::Kind::kNumeric;
  term.factors.emplace_back().field = FindNumber(element, PMMLModelTags::XML_ATT_NAME);
  term.exponent = ReadNumberOr(element, Tags::XML_ATT_EXPONENT, 1.0);
  term.coefficient = ReadRequiredNumber(element, PMMLModelTags::XML_ATT_COEFFICIENT);
  return term;
}

RegressionTerm RegressionTableReader::ReadCategoricalPredictor(const DOMElement* element) const {
  RegressionTerm term;
  term.kind = RegressionTerm::Kind::kCategorical;
  const MiningField* field = FindField(element, PMMLModelTags::XML_ATT_NAME);
  term.factors.emplace_back().field = field;
  const XMLCh* text = BaseTranslator::GetAttributeForced(element, PMMLModelTags::XML_ATT_VALUE);
  term.value = MakeCategory(element, *field->variable, text);
  term.coefficient = ReadRequiredNumber(element, PMMLModelTags::XML_ATT_COEFFICIENT);
  return term;
}

RegressionTerm RegressionTableReader::ReadPredictorTerm(const DOMElement* element) const {
  RegressionTerm term;
  term.kind = RegressionTerm::Kind::kProduct;
  term.coefficient = ReadRequiredNumber(element, PMMLModelTags::XML_ATT_COEFFICIENT);
  for (const DOMElement* child : ChildElements(element)) {
    if (ElementIs(child, Tags::XML_ELE_EXTENSION)) continue;
    if (!ElementIs(child, Tags::XML_ELE_FIELDREF)) {
      FailAt(child, KestrelException::kStructure, Narrow(child->getTagName()) + ": Invalid element!");
    }
    term.factors.push_back(ReadFieldRef(child));
  }
  if (term.factors.empty()) {
    FailAt(element, KestrelException::kStructure, "<FieldRef> is required in <PredictorTerm>!!");
  }
  return term;
}

RegressionTerm::Factor RegressionTableReader::ReadFieldRef(const DOMElement* element) const {
  RegressionTerm::Factor factor;
  factor.field = FindNumber(element, PMMLModelTags::XML_ATT_FIELD);
  factor.map_missing_to = ReadNumberOr(element, Tags::XML_ATT_MISSREPVALUE, factor.map_missing_to);
  return factor;
}

const MiningField* RegressionTableReader::FindField(const DOMElement* element, const char* attribute) const {
  const std::string name = Narrow(BaseTranslator::GetAttributeForced(element, attribute));
  if (name.empty()) {
    FailAt(element, KestrelException::kStructure,
           "<" + Narrow(element->getTagName()) + ">'s " + attribute + " can't be null string !!");
  }
  const MiningField* field = schema_.FindInput(name);
  if (field == nullptr) {
    FailAt(element, KestrelException::kUnknownVariable,
           "Variable " + name + " not among the active fields of the MiningSchema!");
  }
  return field;
}

const MiningField* RegressionTableReader::FindNumber(const DOMElement* element, const char* attribute) const {
  const MiningField* field = FindField(element, attribute);
  if (field->variable->GetVarType() == ScoreDictVar::STRING_VAR) {
    FailOnField(element, KestrelException::kInvalidType, field->name, ": Invalid Variable Type");
  }
  return field;
}

}  // namespace MCKestrel_800
