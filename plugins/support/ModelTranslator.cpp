#include "plugins/support/ModelTranslator.h"

#include <xercesc/dom/DOMElement.hpp>

#include <utility>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/model/ScoreModel.h"
#include "kestrel/model/VersionInfo.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"

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
      FailAt(element, KestrelException::kStructure,
             Narrow(element->getTagName()) + " has more than one target!");
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

}  // namespace

ScoreModel* ModelTranslator::ParseFromTree(DOMElement* root, const std::string&) {
  DOMElement* const dictionaryElement = FirstChild(root, Tags::XML_ELE_DATADICTIONARY);
  // Said here and not by ParseDictionary, which cannot know where the element should stand.
  if (dictionaryElement == nullptr) {
    FailAt(root, KestrelException::kStructure, "<DataDictionary is required !!");
  }
  std::unique_ptr<ScoreDictionary> dictionary(ParseDictionary(dictionaryElement, false));
  std::unique_ptr<ScoreModel> model = BuildModel(RequiredChild(root, tag_), std::move(dictionary));
  const std::string version = AttributeText(root, Tags::XML_ATT_VERSION);
  model->SetVersionInfo(version.empty() ? new VersionInfo : new VersionInfo(version));
  return model.release();
}

ScoreModel* ModelTranslator::ParseFromTree(DOMElement* modelElement, ScoreDictionary* dictionary,
                                           ScoreDictionary* resultDictionary, const std::string&) {
  if (dictionary == nullptr) Fail(KestrelException::kStructure, "<DataDictionary is required !!");
  std::unique_ptr<ScoreModel> model =
      BuildModel(modelElement, std::unique_ptr<ScoreDictionary>(dictionary->Clone()));
  if (resultDictionary != nullptr) model->SetResultScoreDictionary(resultDictionary->Clone());
  return model.release();
}

ModelFrame ModelTranslator::ReadFrame(DOMElement* element, ScoreDictionary& dictionary) {
  if (Equals(Attribute(element, Tags::XML_ATT_RM_IS_SCORABLE), u"false")) {
    FailAt(element, KestrelException::kUnsupported,
           Narrow(element->getTagName()) + " is marked as not scorable!");
  }
  ModelFrame frame;
  frame.is_classification = ReadIsClassification(element);
  frame.schema = MiningSchema::Read(RequiredChild(element, PMMLModelTags::XML_ELE_MININGSCHEMA), &dictionary);
  frame.target = ReadTarget(element, frame.schema, dictionary);
  if (!frame.target.empty()) frame.target_variable = dictionary.GetVar(frame.target);
  if (!frame.is_classification && frame.target_variable != nullptr &&
      frame.target_variable->GetVarType() == ScoreDictVar::STRING_VAR) {
    FailOnField(element, KestrelException::kInvalidType, frame.target, ": Invalid Variable Type");
  }
  return frame;
}

}  // namespace MCKestrel_800
