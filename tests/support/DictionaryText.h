// Reads a DataDictionary from text, the way a plug-in does: through the document reader and a translator.

#ifndef KESTREL_TESTS_SUPPORT_DICTIONARYTEXT_H
#define KESTREL_TESTS_SUPPORT_DICTIONARYTEXT_H

#include <memory>
#include <sstream>
#include <string>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/translate/DocumentReader.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/XmlText.h"

namespace kestrel_test {

/// The least that a plug-in's translator has: it builds no model.
class DictionaryTranslator : public MCKestrel_800::PMMLTranslator {
 public:
  using PMMLTranslator::ParseFromTree;
  MCKestrel_800::ScoreModel* ParseFromTree(xercesc::DOMElement*, const std::string&) override {
    return nullptr;
  }
};

inline std::unique_ptr<MCKestrel_800::ParsedDocument> ReadTree(const std::string& xml) {
  std::istringstream in(xml);
  return MCKestrel_800::ReadDocument(in);
}

/// The dictionary of a document whose root is the DataDictionary or has it as a child.
inline std::unique_ptr<MCKestrel_800::ScoreDictionary> ReadDictionary(const std::string& xml) {
  const auto document = ReadTree(xml);
  xercesc::DOMElement* root = document->GetRoot();
  xercesc::DOMElement* dictionary = root;
  if (!MCKestrel_800::ElementIs(root, u"DataDictionary")) {
    dictionary = MCKestrel_800::FirstChild(root, u"DataDictionary");
  }
  DictionaryTranslator translator;
  return std::unique_ptr<MCKestrel_800::ScoreDictionary>(translator.ParseDictionary(dictionary, false));
}

/// The text of a DataDictionary element around its fields.
inline std::string DictionaryOf(int numberOfFields, const std::string& fields) {
  return "<DataDictionary numberOfFields=\"" + std::to_string(numberOfFields) + "\">" + fields +
         "</DataDictionary>";
}

/// The one variable of a dictionary of one field, as a copy that outlives the dictionary. The field's name is
/// "x".
inline std::unique_ptr<MCKestrel_800::DictVar> ReadField(const std::string& field) {
  const auto dictionary = ReadDictionary(DictionaryOf(1, field));
  const MCKestrel_800::ScoreDictVar* variable = dictionary->GetVar("x");
  if (variable == nullptr) return nullptr;
  return std::make_unique<MCKestrel_800::DictVar>(static_cast<const MCKestrel_800::DictVar&>(*variable));
}

}  // namespace kestrel_test

#endif  // KESTREL_TESTS_SUPPORT_DICTIONARYTEXT_H
