// Derived fields: their attributes, their one expression and what stands beside it.

#include <algorithm>
#include <memory>
#include <string>

#include "kestrel/dictionary/MissingValueSet.h"
#include "kestrel/dictionary/ValueLabelSet.h"
#include "kestrel/dictionary/ValueLbl.h"
#include "kestrel/predicates/Range.h"
#include "kestrel/transform/FunctionTree.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/TransformationDictionary.h"
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

/// What an expression's reader is given.
struct Expression {
  DOMElement* element;
  TransformVar* variable;
  const ScoreDictionary* dictionary;
  const ScoreDictionary* derived;
};

std::string ReadConstant(const Expression& expression) {
  std::string text;
  PMMLTranslator::HandelConstant(expression.element, text);
  expression.variable->SetConstString(text);
  return std::string();
}

std::string ReadApply(const Expression& expression) {
  expression.variable->SetRoot(PMMLTranslator::HandleApply(expression.element, expression.variable,
                                                           expression.dictionary, expression.derived));
  return std::string();
}

std::string RefuseAggregate(const Expression& expression) {
  FailOnField(expression.element, KestrelException::kUnsupported, expression.variable->GetName(),
              ": Not supported!");
}

template <std::string (*Read)(DOMElement*, TransformVar*, const ScoreDictionary*, const ScoreDictionary*)>
std::string ReadWith(const Expression& expression) {
  return Read(expression.element, expression.variable, expression.dictionary, expression.derived);
}

struct ExpressionRow {
  const char16_t* tag;
  TransExpression kind;
  std::string (*read)(const Expression& expression);
};

constexpr ExpressionRow kExpressions[] = {
    {Tag::XML_ELE_APPLY, TransExpression::kApply, ReadApply},
    {Tag::XML_ELE_AGGREGATE, TransExpression::kConstant, RefuseAggregate},
    {Tag::XML_ELE_DISCRETIZE, TransExpression::kDiscretize, ReadWith<PMMLTranslator::HandleDiscritize>},
    {Tag::XML_ELE_MAPVALUES, TransExpression::kMapValues, ReadWith<PMMLTranslator::HandleMapValues>},
    {Tag::XML_ELE_FIELDREF, TransExpression::kFieldRef, ReadWith<PMMLTranslator::HandleFieldRef>},
    {Tag::XML_ELE_CONSTANT, TransExpression::kConstant, ReadConstant},
    {Tag::XML_ELE_NORMCONTINUOUS, TransExpression::kNormContinuous,
     ReadWith<PMMLTranslator::HandleNormContinuous>},
    {Tag::XML_ELE_NORMDISCRETE, TransExpression::kNormDiscrete, ReadWith<PMMLTranslator::HandleNormDiscrete>},
};

const ExpressionRow* FindExpression(const DOMElement* element) {
  for (const ExpressionRow& row : kExpressions) {
    if (ElementIs(element, row.tag)) return &row;
  }
  return nullptr;
}

std::string ReadName(const DOMElement* field) {
  std::string name = Narrow(RequiredAttribute(field, Tag::XML_ATT_DATAFIELD_NAME));
  if (name.empty()) FailAt(field, KestrelException::kStructure, "Variable name can't be empty string!");
  return name;
}

void ReadLevel(const DOMElement* field, TransformVar& variable) {
  const XMLCh* const text = Attribute(field, Tag::XML_ATT_DATAFIELD_OPTYPE);
  if (IsEmpty(text)) FailAt(field, KestrelException::kInvalidType, "opType is required!!");
  ScoreDictVar::MeasureLevel level{};
  if (!FindMeasureLevel(text, level)) {
    FailOnField(field, KestrelException::kInvalidType, variable.GetName(), ": Invalid Variable Type");
  }
  variable.SetMLevel(level);
}

/// As of data fields: what names no other type is a number.
void ReadDataType(const DOMElement* field, TransformVar& variable) {
  const XMLCh* const text = Attribute(field, Tag::XML_ATT_DATATYPE);
  if (Equals(text, Tag::XML_VAL_STRING)) {
    if (variable.GetMLevel() == ScoreDictVar::kContinuous) {
      FailOnField(field, KestrelException::kInvalidType, variable.GetName(),
                  ": Invalid Variable dataType -- string variable can't be continuous!!");
    }
    variable.SetVarType(ScoreDictVar::STRING_VAR);
  } else if (Equals(text, Tag::XML_VAL_INTEGER)) {
    variable.SetNumericDataType(ScoreDictVar::kInteger);
  } else if (Equals(text, Tag::XML_VAL_DOUBLE)) {
    variable.SetNumericDataType(ScoreDictVar::kDouble);
  } else if (const DateTimeType type = PMMLTranslator::ParseDateTimeType(text); type != kNoDateTime) {
    variable.SetVarType(ScoreDictVar::kDATETIME_VAR);
    variable.SetDateTimeType(type);
  }
}

/// The one expression of a field.
DOMElement* RequireExpression(const DOMElement* field) {
  DOMElement* expression = nullptr;
  for (DOMElement* child : ChildElements(field)) {
    if (ElementIs(child, Tag::XML_ELE_EXTENSION) || ElementIs(child, Tag::XML_ELE_VALUE)) continue;
    if (FindExpression(child) == nullptr) {
      FailAt(child, KestrelException::kStructure, "Invalid EXPRESSION");
    }
    if (expression != nullptr) {
      FailAt(child, KestrelException::kStructure, "Only one EXPRESSION is allowed");
    }
    expression = child;
  }
  if (expression == nullptr) FailAt(field, KestrelException::kStructure, "Invalid EXPRESSION");
  return expression;
}

void ReadWidth(const DOMElement* where, const XMLCh* text, TransformVar& variable) {
  if (variable.IsString()) variable.SetWidth(VerifyIntAt(where, text));
}

void ReadExtension(DOMElement* extension, TransformVar& variable) {
  const XMLCh* const name = Attribute(extension, Tag::XML_ATT_EXT_NAME);
  if (Equals(name, Tag::XML_ATT_TRAN_EXT_NAME_MISSINGVALUES)) {
    PMMLTranslator::handleDerivedVarMissingValue(extension, &variable);
    return;
  }
  if (Equals(name, Tag::XML_VAL_NAME_WIDTH) || Equals(name, Tag::XML_ATT_TRAN_EXT_NAME_STRINGLENGTH)) {
    ReadWidth(extension, Attribute(extension, Tag::XML_ATT_EXT_VALUE), variable);
  }
  PMMLTranslator::HandleVEXAExtensions(extension, &variable);
  PMMLTranslator::HandleValueList(extension, &variable);
  PMMLTranslator::ParseUsageTypeExtension(extension, &variable);
}

/// A label may stand inside a missing interval, where it wins; declared missing by itself it is a
/// contradiction.
void RefuseLabelsThatAreMissing(const DOMElement* field, const TransformVar& variable) {
  const ScoreValueLabelSet* const labels = variable.GetValueLabels();
  const ScoreMissingValueSet* const missing = variable.GetMissingValues();
  if (labels == nullptr || missing == nullptr) return;
  for (const ScoreValueRange* range : missing->GetMissingValues()) {
    if (!(*range->GetMin() == *range->GetMax()) || !labels->Contains(range->GetMin())) continue;
    FailOnField(field, KestrelException::kStructure, variable.GetName(),
                ": category value is defined as both valid and invalid/missing!!!");
  }
}

std::unique_ptr<TransformVar> ReadDerivedField(DOMElement* field, const ScoreDictionary* dictionary,
                                               const ScoreDictionary* derived) {
  auto variable = std::make_unique<TransformVar>(ReadName(field), ScoreDictVar::kNUMERIC_VAR);
  const XMLCh* const label = Attribute(field, Tag::XML_ATT_DATAFIELD_DISPLAYNAME);
  if (!IsEmpty(label)) variable->SetLabel(Narrow(label));
  ReadLevel(field, *variable);
  ReadDataType(field, *variable);
  for (const char16_t* name : {Tag::XML_ATT_WIDTH, Tag::XML_ATT_TRAN_EXT_NAME_STRINGLENGTH}) {
    const XMLCh* const width = Attribute(field, name);
    if (!IsEmpty(width)) ReadWidth(field, width, *variable);
  }

  DOMElement* const expression = RequireExpression(field);
  const ExpressionRow& row = *FindExpression(expression);
  const std::string source = row.read({expression, variable.get(), dictionary, derived});
  variable->AddFieldNameAndTransExpression(source, row.kind);

  // After the expression, whose attributes an extension may contradict wherever it stands.
  for (DOMElement* child : ChildElements(field, Tag::XML_ELE_EXTENSION))
    ReadExtension(child, *variable);
  PMMLTranslator::HandleValueList(field, variable.get());
  RefuseLabelsThatAreMissing(field, *variable);
  NoteCategories(*variable);
  if (variable->GetMLevel() != ScoreDictVar::kContinuous) {
    if (variable->GetValueLabels() == nullptr) variable->SetEmptyCateValues(true);
    PMMLTranslator::SetupCatEncoder(variable.get());
  }
  return variable;
}

struct PropertyRow {
  const char16_t* text;
  bool is_missing;
};

constexpr PropertyRow kProperties[] = {
    {Tag::XML_VAL_PROP_VALID, false},
    {Tag::XML_VAL_PROP_INVALID, true},
    {Tag::XML_VAL_PROP_MISSING, true},
    // A value without the attribute, or with an empty one, is valid.
    {u"", false},
};

bool IsMissingProperty(const DOMElement* element) {
  const XMLCh* const property = Attribute(element, Tag::XML_ATT_VALUE_PROPERTY);
  for (const PropertyRow& row : kProperties) {
    if (Equals(property, row.text)) return row.is_missing;
  }
  FailAt(element, KestrelException::kInvalidDocument, "InValid property value!");
}

ScoreMissingValueSet& MissingValuesOf(ScoreDictVar& variable) {
  if (variable.GetMissingValues() == nullptr) variable.SetMissingValues(new MissingValueSet);
  return *variable.GetMissingValues();
}

std::unique_ptr<ScoreValue> ReadValue(const DOMElement* element, const ScoreDictVar& variable) {
  return MakeValueAt(element, variable, RequiredAttribute(element, Tag::XML_ATT_VALUE_VALUE));
}

void AddMissing(std::unique_ptr<ScoreValue> value, ScoreDictVar& variable) {
  auto range = std::make_unique<Range>(value.get());
  static_cast<void>(value.release());
  // The same value given twice is refused by the set and stays ours.
  if (MissingValuesOf(variable).Add(range.get())) static_cast<void>(range.release());
}

void AddLabel(const DOMElement* element, std::unique_ptr<ScoreValue> value, ScoreDictVar& variable) {
  if (variable.GetValueLabels() == nullptr) variable.SetValueLabels(new ValueLabelSet);
  if (variable.GetValueLabels()->Contains(value.get())) return;
  auto label =
      std::make_unique<ValueLbl>(value.get(), AttributeText(element, Tag::XML_ATT_VALUE_DISPLAYVALUE));
  static_cast<void>(value.release());
  variable.GetValueLabels()->Add(label.release());
}

}  // namespace

TransformationDictionary* PMMLTranslator::HandleTransformationDictionary(DOMElement* element,
                                                                         const ScoreDictionary* dictionary,
                                                                         TransformationDictionary* into) {
  InitFunctionMap();
  std::unique_ptr<TransformationDictionary> made;
  if (into == nullptr) {
    made = std::make_unique<TransformationDictionary>();
    into = made.get();
  }
  for (DOMElement* child : ChildElements(element, Tag::XML_ELE_DERIVEDFIELD)) {
    std::unique_ptr<TransformVar> variable = ReadDerivedField(child, dictionary, into);
    const std::string name = variable->GetName();
    if (FindField(dictionary, into, name) != nullptr) {
      FailOnField(child, KestrelException::kStructure, name, ": Redefinition!");
    }
    into->AddVar(name, variable.get());
    static_cast<void>(variable.release());
    into->AddDerievedVarName(name);
  }
  static_cast<void>(made.release());
  return into;
}

void PMMLTranslator::HandleValueList(const DOMElement* parent, ScoreDictVar* variable) {
  for (const DOMElement* child : ChildElements(parent, Tag::XML_ELE_VALUE)) {
    const bool is_missing = IsMissingProperty(child);
    std::unique_ptr<ScoreValue> value = ReadValue(child, *variable);
    if (is_missing) {
      AddMissing(std::move(value), *variable);
    } else {
      AddLabel(child, std::move(value), *variable);
    }
  }
}

void PMMLTranslator::handleDerivedVarMissingValue(const DOMElement* parent, ScoreDictVar* variable) {
  double lower = -NumericValue::GetInfinity();
  double upper = NumericValue::GetInfinity();
  int lowers = 0;
  int uppers = 0;
  for (const DOMElement* child : ChildElements(parent)) {
    if (ElementIs(child, Tag::XML_ELE_VALUE)) {
      AddMissing(ReadValue(child, *variable), *variable);
    } else if (ElementIs(child, Tag::XML_ELE_INTERVAL)) {
      FailAt(child, KestrelException::kStructure, "InterVal is not allowed!!");
    } else if (!ElementIs(child, Tag::XML_ELE_EXTENSION)) {
      FailOnElement(child);
    } else if (Equals(Attribute(child, Tag::XML_ATT_EXT_NAME), Tag::XML_VAL_NAME_MSLO)) {
      lower = VerifyDoubleAt(child, Attribute(child, Tag::XML_ATT_EXT_VALUE));
      ++lowers;
    } else if (Equals(Attribute(child, Tag::XML_ATT_EXT_NAME), Tag::XML_VAL_NAME_MSUP)) {
      upper = VerifyDoubleAt(child, Attribute(child, Tag::XML_ATT_EXT_VALUE));
      ++uppers;
    }
  }
  const int flags = std::min(lowers, 2) + 10 * std::min(uppers, 2);
  if (flags == 0) return;
  try {
    HandleVEXAMissingInterval(&MissingValuesOf(*variable), flags, lower, upper);
  } catch (const KestrelException& fault) {
    FailAt(parent, KestrelException::kUnsupported, fault.GetErrorMessage());
  }
}

}  // namespace MCKestrel_800
