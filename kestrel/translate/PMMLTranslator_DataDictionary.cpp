// The DataDictionary element: its fields, their attributes and extensions. What a field's values say is read
// in PMMLTranslator_Fields.cpp.

#include <memory>
#include <string>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/ScoreCatNumericEncoder.h"
#include "kestrel/dictionary/ScoreCatStringEncoder.h"
#include "kestrel/dictionary/ScoreValueLabel.h"
#include "kestrel/dictionary/ScoreValueLabelSet.h"
#include "kestrel/translate/FieldRules.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/VerifiedText.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

using xercesc::DOMElement;
using xercesc::DOMNode;
using Tag = PMMLTagText;

// Names of extensions that only data fields know.
constexpr char16_t kNoSpaceTrim[] = u"noSpaceTrim";
constexpr char16_t kEmptyStringOk[] = u"emptyStringOk";
constexpr char16_t kMeasure[] = u"measure";

struct DateTimeRow {
  const char16_t* text;
  DateTimeType type;
};

constexpr DateTimeRow kDateTimeTypes[] = {
    {Tag::XML_VAL_DATE, kDate},
    {Tag::XML_VAL_TIME, kTime},
    {Tag::XML_VAL_DATETIME, kDateTime},
    {Tag::XML_VAL_DATEDAYSSINCE_0, kDateDaysSince0},
    {Tag::XML_VAL_DATEDAYSSINCE_1960, kDateDaysSince1960},
    {Tag::XML_VAL_DATEDAYSSINCE_1970, kDateDaysSince1970},
    {Tag::XML_VAL_DATEDAYSSINCE_1980, kDateDaysSince1980},
    {Tag::XML_VAL_TIMESECONDS, kTimeSeconds},
    {Tag::XML_VAL_DATETIMESECONDSSINCE_0, kDateTimeSecondsSince0},
    {Tag::XML_VAL_DATETIMESECONDSSINCE_1960, kDateTimeSecondsSince1960},
    {Tag::XML_VAL_DATETIMESECONDSSINCE_1970, kDateTimeSecondsSince1970},
    {Tag::XML_VAL_DATETIMESECONDSSINCE_1980, kDateTimeSecondsSince1980},
};

/// What a field's own attributes and its extensions say before its type is settled.
struct FieldSettings {
  const XMLCh* storageType = nullptr;
  bool noSpaceTrim = false;
  // Documents in use rely on every text field accepting the empty text, so the extension can only confirm it.
  bool emptyStringOk = true;
};

void ReadOpType(const DOMElement* field, ScoreDictVar& variable) {
  const XMLCh* text = Attribute(field, Tag::XML_ATT_DATAFIELD_OPTYPE);
  if (IsEmpty(text)) FailAt(field, KestrelException::kInvalidType, "opType can't be null!!");
  ScoreDictVar::MeasureLevel level{};
  if (!FindMeasureLevel(text, level)) {
    FailAt(field, KestrelException::kInvalidType, Narrow(text) + ": Invalid Variable Type");
  }
  variable.SetMLevel(level);
}

void ReadMeasure(const DOMElement* extension, const XMLCh* value, ScoreDictVar& variable) {
  variable.SetXMeasure(Narrow(value));
  if (!Equals(value, Tag::XML_VAL_FLAG)) return;
  if (!variable.SetFlagVariable(true)) {
    FailAt(extension, KestrelException::kInvalidType, "flag type only valid for categorical variables!");
  }
}

void ReadExtension(DOMElement* extension, FieldSettings& settings, ScoreDictVar& variable) {
  const XMLCh* name = Attribute(extension, Tag::XML_ATT_EXT_NAME);
  const XMLCh* value = Attribute(extension, Tag::XML_ATT_EXT_VALUE);
  if (Equals(name, kNoSpaceTrim)) {
    if (Equals(value, Tag::XML_ATT_EXT_VALUE_VALUE_TRUE)) settings.noSpaceTrim = true;
  } else if (Equals(name, kEmptyStringOk)) {
    if (Equals(value, Tag::XML_ATT_EXT_VALUE_VALUE_TRUE)) settings.emptyStringOk = true;
  } else if (Equals(name, Tag::XML_ELE_XMEASURE) || Equals(name, kMeasure)) {
    ReadMeasure(extension, value, variable);
  } else if (Equals(name, Tag::XML_ATT_STORAGETYPE)) {
    // The field's own attribute wins, as does the first of several extensions.
    if (IsEmpty(settings.storageType)) settings.storageType = value;
  }
  PMMLTranslator::ParseUsageTypeExtension(extension, &variable);
}

/// Reads all extensions below a field, at any depth.
void ReadExtensions(DOMElement* field, FieldSettings& settings, ScoreDictVar& variable) {
  for (DOMNode* node = NextInTree(field, field); node != nullptr; node = NextInTree(node, field)) {
    if (ElementIs(node, Tag::XML_ELE_EXTENSION)) {
      ReadExtension(static_cast<DOMElement*>(node), settings, variable);
    }
  }
}

void SetVariableType(const DOMElement* field, const FieldSettings& settings, ScoreDictVar& variable) {
  if (Equals(settings.storageType, Tag::XML_VAL_STRING)) {
    variable.SetVarType(ScoreDictVar::STRING_VAR);
    return;
  }
  const XMLCh* dataType = Attribute(field, Tag::XML_ATT_DATATYPE);
  if (Equals(dataType, Tag::XML_VAL_STRING)) {
    variable.SetVarType(ScoreDictVar::STRING_VAR);
  } else if (Equals(dataType, Tag::XML_VAL_INTEGER)) {
    variable.SetNumericDataType(ScoreDictVar::kInteger);
  } else if (Equals(dataType, Tag::XML_VAL_DOUBLE)) {
    variable.SetNumericDataType(ScoreDictVar::kDouble);
  } else if (const DateTimeType type = PMMLTranslator::ParseDateTimeType(dataType); type != kNoDateTime) {
    variable.SetVarType(ScoreDictVar::kDATETIME_VAR);
    variable.SetDateTimeType(type);
  }
}

/// Reads all of a field but its name into its variable.
void ReadDataField(DOMElement* field, DictVar& variable) {
  const XMLCh* label = Attribute(field, Tag::XML_ATT_DATAFIELD_DISPLAYNAME);
  if (!IsEmpty(label)) variable.SetLabel(Narrow(label));
  ReadOpType(field, variable);

  FieldSettings settings;
  settings.storageType = Attribute(field, Tag::XML_ATT_STORAGETYPE);
  ReadExtensions(field, settings, variable);
  SetVariableType(field, settings, variable);
  variable.SetNoSpaceTrim(settings.noSpaceTrim);
  variable.SetEmptyStringOK(settings.emptyStringOk);

  if (variable.GetMLevel() == ScoreDictVar::kContinuous) {
    if (variable.GetVarType() == ScoreDictVar::STRING_VAR) {
      FailAt(field, KestrelException::kInvalidType, "string variable can't be continuous!!");
    }
    PMMLTranslator::ParseContinuousValues(field, &variable);
  } else {
    PMMLTranslator::ParseCategoricalValues(field, &variable);
    PMMLTranslator::SetupCatEncoder(&variable);
  }
}

/// Adds a variable for a field to the dictionary, which owns it from here on.
DictVar& AddVariable(const DOMElement* field, BaseDictionary& dictionary) {
  const XMLCh* wideName = RequiredAttribute(field, Tag::XML_ATT_DATAFIELD_NAME);
  if (IsEmpty(wideName)) {
    FailAt(field, KestrelException::kStructure, "<DataField>'s name can't be null string !!");
  }
  const std::string name = Narrow(wideName);
  auto variable = std::make_unique<DictVar>(name, ScoreDictVar::kNUMERIC_VAR);
  // A dictionary that does not grow had the name already and left the variable to us. Asking it first would
  // search its map twice, which large dictionaries feel.
  const std::size_t sizeBefore = dictionary.Size();
  dictionary.AddVar(name, variable.get());
  if (dictionary.Size() == sizeBefore) {
    FailOnField(field, KestrelException::kUnknownVariable, name,
                ": Invalid Variable Name -- alreay in the dictionary");
  }
  return *variable.release();
}

void CheckNumberOfFields(const DOMElement* dictionary, size_t count) {
  const XMLCh* declared = Attribute(dictionary, Tag::XML_ATT_DATADICT_NUMBEROFFIELDS);
  if (IsEmpty(declared)) {
    FailAt(dictionary, KestrelException::kInconsistentDictionary,
           "Attribute \"numberOfFields\": Null string is an invalid integer string!");
  }
  if (static_cast<long long>(VerifyIntAt(dictionary, declared)) != static_cast<long long>(count)) {
    FailAt(dictionary, KestrelException::kInconsistentDictionary,
           "Number of Variables in the Dictionary does not match with numberOfFields!");
  }
}

}  // namespace

ScoreDictionary* PMMLTranslator::ParseDictionary(DOMNode* dataDictionary, bool /*reserved*/) {
  if (dataDictionary == nullptr || dataDictionary->getNodeType() != DOMNode::ELEMENT_NODE) {
    FailAt(dataDictionary, KestrelException::kStructure, "<DataDictionary is required !!");
  }
  auto dictionary = std::make_unique<BaseDictionary>();
  for (DOMElement* child : ChildElements(dataDictionary)) {
    if (ElementIs(child, Tag::XML_ELE_EXTENSION)) continue;
    if (!ElementIs(child, Tag::XML_ELE_DATAFIELD)) {
      FailAt(child, KestrelException::kStructure, "<DataField> or <Extension> is required here!!");
    }
    ReadDataField(child, AddVariable(child, *dictionary));
  }
  const DOMElement* element = static_cast<const DOMElement*>(dataDictionary);
  if (dictionary->Size() == 0) FailAt(element, KestrelException::kStructure, "<DataDictionary is EMPTY!!");
  CheckNumberOfFields(element, dictionary->Size());
  return dictionary.release();
}

DateTimeType PMMLTranslator::ParseDateTimeType(const XMLCh* dataType) {
  if (IsEmpty(dataType)) return kNoDateTime;
  for (const DateTimeRow& row : kDateTimeTypes) {
    if (Equals(dataType, row.text)) return row.type;
  }
  return kNoDateTime;
}

void PMMLTranslator::ParseUsageTypeExtension(DOMElement* extension, ScoreDictVar* variable) {
  if (variable == nullptr) return;
  for (const DOMElement* child : ChildElements(extension, Tag::XML_ATT_EXTENSION_USAGETYPE)) {
    if (Equals(Attribute(child, Tag::XML_ATT_EXT_VALUE), Tag::XML_VAL_USAGETYPE_DISABLE)) {
      variable->SetUsageType(false);
    }
  }
}

bool PMMLTranslator::SetupCatEncoder(ScoreDictVar* variable) {
  if (variable == nullptr) return false;
  const ScoreDictVar::MeasureLevel level = variable->GetMLevel();
  if (level != ScoreDictVar::kNominal && level != ScoreDictVar::kOrdinal) return false;
  // Small on purpose: a dictionary may hold very many fields, and most have few categories.
  constexpr int kInitialCapacity = 2;
  if (variable->GetEncoder() == nullptr) {
    if (variable->GetVarType() == ScoreDictVar::STRING_VAR) {
      auto encoder = std::make_unique<ScoreCatStringEncoder>(kInitialCapacity);
      encoder->SetNoSpaceTrim(variable->GetNoSpaceTrim());
      encoder->SetEmptyStringOK(variable->GetEmptyStringOK());
      variable->SetEncoder(encoder.release());
    } else {
      variable->SetEncoder(new ScoreCatNumericEncoder(kInitialCapacity));
    }
  }
  const ScoreValueLabelSet* labels = variable->GetValueLabels();
  if (labels == nullptr) return true;
  ScoreEncoder* encoder = variable->GetEncoder();
  for (const ScoreValueLabel* label : labels->GetAllValueLabels())
    encoder->Encode(label->GetValue());
  return true;
}

}  // namespace MCKestrel_800
