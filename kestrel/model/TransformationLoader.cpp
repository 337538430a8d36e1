// The lighter way into a document: its dictionaries alone, without any model library.

#include <fstream>
#include <memory>
#include <xercesc/dom/DOMElement.hpp>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/ExtNameStr.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "kestrel/translate/DocumentReader.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

using Tag = PMMLTagText;

/// The readers of dictionaries need a translator, and one that builds no model will do.
class DictionaryTranslator : public PMMLTranslator {
 public:
  using PMMLTranslator::ParseFromTree;
  ScoreModel* ParseFromTree(xercesc::DOMElement* /*root*/, const std::string& /*arg*/) override {
    return nullptr;
  }
};

std::unique_ptr<ParsedDocument> ReadTree(std::istream& in) {
  try {
    return ReadDocument(in);
  } catch (const KestrelException& fault) {
    if (!IsWithoutRoot(fault)) throw;
    KestrelException own(KestrelException::kMissingElement,
                         "\nInvalid Input XML document or no dtd file avaible in current directory");
    own.SetPlace(fault.GetLine(), fault.GetColumn());
    throw own;
  }
}

}  // namespace

TransformationDictionary* ModelFactory::GetTransformationDictionaryFromXML(std::istream& in,
                                                                           ScoreDictionary*& dictionaryOut,
                                                                           const std::string& /*reserved*/) {
  dictionaryOut = nullptr;
  const std::unique_ptr<ParsedDocument> document = ReadTree(in);
  xercesc::DOMElement* const root = document->GetRoot();
  if (!ElementIs(root, Tag::XML_ELE_PMML)) {
    FailAt(root, KestrelException::kUnsupported, "Unsupported Model found!");
  }
  DictionaryTranslator translator;
  std::unique_ptr<ScoreDictionary> dictionary(
      translator.ParseDictionary(FirstChild(root, Tag::XML_ELE_DATADICTIONARY), false));
  std::unique_ptr<TransformationDictionary> derived(PMMLTranslator::HandleTransformationDictionary(
      FirstChild(root, Tag::XML_ELE_TRANSFORMATION), dictionary.get(), nullptr));
  derived->SetUpDerivedCaseRecord();
  dictionaryOut = dictionary.release();
  return derived.release();
}

TransformationDictionary* ModelFactory::GetTransformationDictionaryFromXML(const std::string& fileName,
                                                                           ScoreDictionary*& dictionaryOut,
                                                                           const std::string& reserved) {
  dictionaryOut = nullptr;
  std::ifstream in;
  if (!MCXML_800::ExtNameStr(fileName).Open(in)) Fail(KestrelException::kFile, "Could not open model file");
  return GetTransformationDictionaryFromXML(in, dictionaryOut, reserved);
}

}  // namespace MCKestrel_800
