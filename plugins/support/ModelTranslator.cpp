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

/// Root elements of documents that may hold a model and are no PMML.
constexpr const char16_t* kOlderRoots[] = {u"vexa-ml", u"Tree", u"AssocLattice",
                                           u"SequentialAssociationLattice"};

DOMElement* RequiredDictionary(DOMElement* root) {
  if (DOMElement* const dictionary = FirstChild(root, Tags::XML_ELE_DATADICTIONARY)) return dictionary;
  for (const char16_t* const tag : kOlderRoots) {
    if (!ElementIs(root, tag)) continue;
    FailAt(root, KestrelException::kUnsupported,
           "<" + Narrow(root->getTagName()) + ">: models of the older document format are not supported!");
  }
  // Said here and not by ParseDictionary, which cannot know where the element should stand.
  FailAt(root, KestrelException::kStructure, "<DataDictionary is required !!");
}

bool ReadIsClassification(const DOMElement* element) {
  const XMLCh* function = BaseTranslator::GetAttributeForced(element, PMMLModelTags::XML_ATT_FUNCTIONNAME);
  if (Equals(function, Tags::XML_VAL_MINING_CLASSIFICATION)) return true;
  if (Equals(function, Tags::XML_VAL_MINING_REGRESSION)) return false;
  FailAt(element, KestrelException::kUnsupported, "functionName -- " + Narrow(function) + ": Not supported!");
}

// Adds the derived fields of an element, which may be null, to those that are there.
void ReadDerivedFields(DOMElement* element, ModelDictionaries& dictionaries) {
  if (FirstChild(element, Tags::XML_ELE_DERIVEDFIELD) == nullptr) return;
  if (dictionaries.derived == nullptr) dictionaries.derived = std::make_unique<TransformationDictionary>();
  PMMLTranslator::HandleTransformationDictionary(element, dictionaries.data.get(),
                                                 dictionaries.derived.get());
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
  ModelDictionaries dictionaries;
  dictionaries.data.reset(ParseDictionary(RequiredDictionary(root), false));
  ReadDerivedFields(FirstChild(root, Tags::XML_ELE_TRANSFORMATION), dictionaries);
  std::unique_ptr<ScoreModel> model = BuildModel(RequiredChild(root, tag_), std::move(dictionaries));
  const std::string version = AttributeText(root, Tags::XML_ATT_VERSION);
  model->SetVersionInfo(version.empty() ? new VersionInfo : new VersionInfo(version));
  return model.release();
}

ScoreModel* ModelTranslator::ParseFromTree(DOMElement* modelElement, ScoreDictionary* dictionary,
                                           ScoreDictionary* resultDictionary, const std::string&) {
  if (dictionary == nullptr) Fail(KestrelException::kStructure, "<DataDictionary is required !!");
  ModelDictionaries dictionaries;
  dictionaries.data.reset(dictionary->Clone());
  std::unique_ptr<ScoreModel> model = BuildModel(modelElement, std::move(dictionaries));
  if (resultDictionary != nullptr && model->GetResultDictionary() == nullptr) {
    model->SetResultScoreDictionary(resultDictionary->Clone());
  }
  return model.release();
}

ModelFrame ModelTranslator::ReadFrame(DOMElement* element, ModelDictionaries& dictionaries) {
  if (Equals(Attribute(element, Tags::XML_ATT_RM_IS_SCORABLE), u"false")) {
    FailAt(element, KestrelException::kUnsupported,
           Narrow(element->getTagName()) + " is marked as not scorable!");
  }
  ModelFrame frame;
  frame.is_classification = ReadIsClassification(element);
  ScoreDictionary& dictionary = *dictionaries.data;
  frame.schema = MiningSchema::Read(RequiredChild(element, PMMLModelTags::XML_ELE_MININGSCHEMA), &dictionary,
                                    dictionaries.derived.get());
  HandleTargets(FirstChild(element, Tags::XML_ELE_TARGETS), &dictionary);
  // Behind the schema, because its optypes count for them.
  ReadDerivedFields(FirstChild(element, Tags::XML_ELE_LOCALTRANSFORMATIONS), dictionaries);
  if (dictionaries.derived != nullptr) {
    dictionaries.derived->SetUpDerivedCaseRecord();
    frame.schema.AddDerivedFields(*dictionaries.derived);
  }
  frame.target = ReadTarget(element, frame.schema, dictionary);
  if (!frame.target.empty()) frame.target_variable = dictionary.GetVar(frame.target);
  if (!frame.is_classification && frame.target_variable != nullptr &&
      frame.target_variable->GetVarType() == ScoreDictVar::STRING_VAR) {
    FailOnField(element, KestrelException::kInvalidType, frame.target, ": Invalid Variable Type");
  }
  frame.outputs =
      OutputFields::Read(element, frame.target_variable, frame.is_classification, dictionaries.results);
  return frame;
}

}  // namespace MCKestrel_800
