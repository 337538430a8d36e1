#include "plugins/regression/RegressionTranslator.h"

#include <xercesc/dom/DOMElement.hpp>

#include <utility>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/model/VersionInfo.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"
#include "plugins/regression/RegressionTableReader.h"

namespace MCKestrel_800 {
namespace {

using xercesc::DOMElement;
using Tags = PMMLTagText;

DOMElement* RequiredChild(DOMElement* parent, const char* tag) {
  return static_cast<DOMElement*>(BaseTranslator::GetChildByTagForced(parent, tag));
}

bool ReadIsClassification(const DOMElement* element) {
  const XMLCh* function = BaseTranslator::GetAttributeForced(element, PMMLModelTags::XML_ATT_FUNCTIONNAME);
  if (Equals(function, Tags::XML_VAL_MINING_CLASSIFICATION)) return true;
  if (Equals(function, Tags::XML_VAL_MINING_REGRESSION)) return false;
  FailAt(element, KestrelException::kUnsupported, "functionName -- " + Narrow(function) + ": Not supported!");
}

Normalization ReadNormalization(const DOMElement* element) {
  Normalization method = Normalization::kNone;
  const XMLCh* text = FindAttribute(element, Tags::XML_ATT_NORMMATHOD);
  if (text != nullptr && !FindNormalization(Narrow(text), method)) {
    FailAt(element, KestrelException::kInvalidDocument, "invalid normalizationMethod -- " + Narrow(text));
  }
  return method;
}

// The target's name; empty when the document names none.
std::string ReadTarget(const DOMElement* element, const MiningSchema& schema,
                       const ScoreDictionary& dictionary) {
  std::string attribute = AttributeText(element, Tags::XML_ATT_TAGFIELDNAME);
  const MiningField* chosen = schema.Find(attribute);
  if (chosen != nullptr && chosen->role == ScoreModel::kTarget) return attribute;
  const MiningField* target = nullptr;
  for (const MiningField& field : schema.GetFields()) {
    if (field.role != ScoreModel::kTarget) continue;
    if (target != nullptr) {
      FailAt(element, KestrelException::kStructure, "RegressionModel has more than one target!");
    }
    target = &field;
  }
  if (target != nullptr) return target->name;
  if (attribute.empty()) return attribute;
  if (dictionary.GetVar(attribute) == nullptr) {
    FailAt(element, KestrelException::kUnknownVariable, "Variable " + attribute + " not in the dictionary!");
  }
  return attribute;
}

std::vector<RegressionTable> ReadTables(const DOMElement* element, const RegressionTableReader& reader,
                                        bool is_classification) {
  std::vector<RegressionTable> tables;
  for (const DOMElement* child : ChildElements(element, Tags::XML_ELE_REGTABLE)) {
    if (!is_classification && !tables.empty()) {
      FailAt(child, KestrelException::kStructure, "Only one RegressionTable is allowed for regression!");
    }
    tables.push_back(reader.Read(child, is_classification));
  }
  if (tables.empty()) {
    FailAt(element, KestrelException::kMissingElement, "Node is missing --- RegressionTable ---");
  }
  return tables;
}

}  // namespace

ScoreModel* RegressionTranslator::ParseFromTree(DOMElement* root, const std::string&) {
  DOMElement* const dictionaryElement = FirstChild(root, Tags::XML_ELE_DATADICTIONARY);
  // Said here and not by ParseDictionary, which cannot know where the element should stand.
  if (dictionaryElement == nullptr) {
    FailAt(root, KestrelException::kStructure, "<DataDictionary is required !!");
  }
  std::unique_ptr<ScoreDictionary> dictionary(ParseDictionary(dictionaryElement, false));
  std::unique_ptr<RegressionModel> model =
      BuildModel(RequiredChild(root, PMMLModelTags::XML_ELE_REGMODEL), std::move(dictionary));
  const std::string version = AttributeText(root, Tags::XML_ATT_VERSION);
  model->SetVersionInfo(version.empty() ? new VersionInfo : new VersionInfo(version));
  return model.release();
}

ScoreModel* RegressionTranslator::ParseFromTree(DOMElement* modelElement, ScoreDictionary* dictionary,
                                                ScoreDictionary* resultDictionary, const std::string&) {
  if (dictionary == nullptr) Fail(KestrelException::kStructure, "<DataDictionary is required !!");
  std::unique_ptr<RegressionModel> model =
      BuildModel(modelElement, std::unique_ptr<ScoreDictionary>(dictionary->Clone()));
  if (resultDictionary != nullptr) model->SetResultScoreDictionary(resultDictionary->Clone());
  return model.release();
}

std::unique_ptr<RegressionModel> RegressionTranslator::BuildModel(
    DOMElement* element, std::unique_ptr<ScoreDictionary> dictionary) {
  if (Equals(Attribute(element, Tags::XML_ATT_RM_IS_SCORABLE), u"false")) {
    FailAt(element, KestrelException::kUnsupported, "RegressionModel is marked as not scorable!");
  }
  RegressionModel::Definition definition;
  definition.is_classification = ReadIsClassification(element);
  definition.normalization = ReadNormalization(element);
  definition.schema =
      MiningSchema::Read(RequiredChild(element, PMMLModelTags::XML_ELE_MININGSCHEMA), dictionary.get());
  const std::string target = ReadTarget(element, definition.schema, *dictionary);
  const ScoreDictVar* variable = target.empty() ? nullptr : dictionary->GetVar(target);
  if (!definition.is_classification && variable != nullptr &&
      variable->GetVarType() == ScoreDictVar::STRING_VAR) {
    FailOnField(element, KestrelException::kInvalidType, target, ": Invalid Variable Type");
  }
  definition.tables =
      ReadTables(element, RegressionTableReader(definition.schema, variable), definition.is_classification);
  try {
    return std::make_unique<RegressionModel>(std::move(dictionary), std::move(definition), target);
  } catch (const KestrelException& fault) {
    FailAt(element, static_cast<KestrelException::ExceptionCode>(fault.GetErrorCode()),
           fault.GetErrorMessage());
  }
}

}  // namespace MCKestrel_800
