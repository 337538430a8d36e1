// The expressions of derived fields that read one field, and what they say about missing and unmatched
// values. Tables of values and bins are read in files of their own.

#include <memory>
#include <string>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/ValueMatcher.h"
#include "kestrel/translate/DerivedValues.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/VerifiedText.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

using xercesc::DOMElement;
using Tag = PMMLTagText;

std::string FieldNameOf(const DOMElement* expression) {
  return Narrow(RequiredAttribute(expression, Tag::XML_ATT_FIELD));
}

/// The line from each point to the next. A jump has no slope that would lead anywhere.
void AddSegments(TransformVar& variable) {
  const std::vector<double>& orig = variable.GetOrig();
  const std::vector<double>& norm = variable.GetNorm();
  for (size_t i = 0; i + 1 < orig.size(); ++i) {
    const double width = orig[i + 1] - orig[i];
    if (orig[i + 1] == orig[i]) {
      variable.AddNormInfo(1.0, 0.0);
    } else {
      variable.AddNormInfo((norm[i + 1] - norm[i]) / width,
                           (norm[i] * orig[i + 1] - orig[i] * norm[i + 1]) / width);
    }
  }
}

bool IsNumeric(const TransformVar& variable) {
  return variable.GetVarType() == ScoreDictVar::kNUMERIC_VAR;
}

[[noreturn]] void FailOnExtension(const DOMElement* extension, const char* text) {
  FailAt(extension, KestrelException::kUnsupported, text);
}

void ReadElseCopy(const DOMElement* extension, TransformVar& variable) {
  if (variable.GetRecodeDefaultValue() != nullptr) {
    FailOnExtension(extension, "defaultValue value is defined already!!");
  }
  variable.SetRecodeElseCopy(true);
}

void ReadMissingCopy(const DOMElement* extension, TransformVar& variable) {
  if (variable.GetRecodeMissValueRep() != nullptr) {
    FailOnExtension(extension, "mapMissingTo value is defined already!!");
  }
  variable.SetRecodeMissingCopy(true);
}

void ReadSysmisReplacement(const DOMElement* extension, TransformVar& variable) {
  if (variable.GetRecodeSysmisValueRep() != nullptr) {
    FailOnExtension(extension, "mapSysmisTo value is defined already!!");
  }
  const XMLCh* const text = RequiredAttribute(extension, Tag::XML_ATT_EXT_VALUE);
  variable.SetRecodeSysmisValue(MakeValueAt(extension, variable, text).release());
}

void ReadMissingSysmis(const DOMElement* extension, TransformVar& variable) {
  if (!IsNumeric(variable)) FailOnExtension(extension, "Only numeric derived variable is allowed!!");
  if (variable.GetRecodeMissValueRep() != nullptr || variable.IsRecodeMissingCopy() ||
      variable.GetRecodeSysmisValueRep() != nullptr) {
    FailOnExtension(extension, "mapMissing replacement value is defined already!!");
  }
  variable.SetRecodeMissValueTo(new NumericValue);
}

struct RecodeRow {
  const char16_t* name;
  void (*read)(const DOMElement* extension, TransformVar& variable);
};

constexpr RecodeRow kRecodes[] = {
    {Tag::XML_ATT_TRAN_EXT_NAME_ELSECOPY, ReadElseCopy},
    {Tag::XML_ATT_TRAN_EXT_NAME_MISSINGCOPY, ReadMissingCopy},
    {Tag::XML_ATT_TRAN_EXT_NAME_MAPSYSMISTO, ReadSysmisReplacement},
    {Tag::XML_ATT_TRAN_EXT_NAME_RECODEMISSINGSISMIS, ReadMissingSysmis},
};

/// Reads a child that has nothing to say but in extensions.
void ReadOtherChild(const DOMElement* child, TransformVar& variable) {
  if (!ElementIs(child, Tag::XML_ELE_EXTENSION)) FailOnElement(child);
  PMMLTranslator::HandleVEXAExtensions(child, &variable);
}

void ReadOtherChildren(const DOMElement* expression, TransformVar& variable) {
  for (const DOMElement* child : ChildElements(expression))
    ReadOtherChild(child, variable);
}

}  // namespace

std::string PMMLTranslator::HandleNormContinuous(DOMElement* element, TransformVar* variable,
                                                 const ScoreDictionary* dictionary,
                                                 const ScoreDictionary* derived) {
  std::string name = FieldNameOf(element);
  const ScoreDictVar* const source = FindField(dictionary, derived, name);
  if (source == nullptr || source->GetMLevel() != ScoreDictVar::kContinuous) {
    FailOnField(element, KestrelException::kStructure, name, ": must predefined as continuous type");
  }
  const XMLCh* const missing = Attribute(element, Tag::XML_ATT_MISSREPVALUE);
  if (!IsEmpty(missing)) variable->SetRecodeMissValueTo(new NumericValue(VerifyDoubleAt(element, missing)));
  variable->SetOutlierTreatMent(AttributeText(element, Tag::XML_ATT_MININGFIELD_OUTLIERS));
  for (const DOMElement* child : ChildElements(element)) {
    if (ElementIs(child, Tag::XML_ELE_LINEARNORM)) {
      const double orig = VerifyDoubleAt(child, RequiredAttribute(child, Tag::XML_ATT_ORIG));
      variable->AddLinearNorm(orig, VerifyDoubleAt(child, RequiredAttribute(child, Tag::XML_ATT_NORM)));
    } else {
      ReadOtherChild(child, *variable);
    }
  }
  if (variable->GetOrig().size() < 2) {
    FailAt(element, KestrelException::kStructure, "At least two <LinearNorm>s are required!!");
  }
  AddSegments(*variable);
  return name;
}

std::string PMMLTranslator::HandleNormDiscrete(DOMElement* element, TransformVar* variable,
                                               const ScoreDictionary* dictionary,
                                               const ScoreDictionary* derived) {
  std::string name = FieldNameOf(element);
  const ScoreDictVar* const source = FindField(dictionary, derived, name);
  if (source == nullptr || source->GetMLevel() == ScoreDictVar::kContinuous) {
    FailOnField(element, KestrelException::kStructure, name,
                ": must predefined as categorical or ordinal type");
  }
  // "method" has one meaning, which is the only one that there is.
  auto value = MakeValueAt(element, *source, RequiredAttribute(element, Tag::XML_ATT_VALUE));
  auto matcher = std::make_unique<ValueMatcher>(value.release());
  variable->AddEncodingMap(matcher.release(), new NumericValue(1.0));
  variable->SetRecodeDefaultValue(new NumericValue(0.0));
  ReadMissingReplacement(element, *variable);
  ReadOtherChildren(element, *variable);
  return name;
}

std::string PMMLTranslator::HandleFieldRef(DOMElement* element, TransformVar* variable,
                                           const ScoreDictionary* dictionary,
                                           const ScoreDictionary* derived) {
  std::string name = FieldNameOf(element);
  const ScoreDictVar* const source = RequireField(element, dictionary, derived, name);
  if (auto value = ReadFieldReplacement(element, *source, variable->GetName()); value != nullptr) {
    variable->SetRecodeMissValueTo(value.release());
  }
  ReadOtherChildren(element, *variable);
  return name;
}

ScoreValue* PMMLTranslator::HandelConstant(const DOMElement* element) {
  std::string text;
  HandelConstant(element, text);
  const XMLCh* const data_type = Attribute(element, Tag::XML_ATT_DATATYPE);
  if (Equals(data_type, Tag::XML_VAL_STRING)) return new StringValue(text);
  const DateTimeType type = ParseDateTimeType(data_type);
  if (type != kNoDateTime) return new DateTimeValue(text, type);
  return new NumericValue(text);
}

void PMMLTranslator::HandelConstant(const DOMElement* element, std::string& text) {
  text = ElementNarrowText(element);
  if (text.empty()) FailAt(element, KestrelException::kMissingElement, "Constant value is required!");
}

void PMMLTranslator::HandleVEXAExtensions(const DOMElement* extension, TransformVar* variable) {
  const XMLCh* const name = Attribute(extension, Tag::XML_ATT_EXT_NAME);
  for (const RecodeRow& row : kRecodes) {
    if (Equals(name, row.name)) row.read(extension, *variable);
  }
}

}  // namespace MCKestrel_800
