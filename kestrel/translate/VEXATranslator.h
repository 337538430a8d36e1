// Reads the dictionary of documents in the older format, whose root is "vexa-ml".

#ifndef KESTREL_TRANSLATE_VEXATRANSLATOR_H
#define KESTREL_TRANSLATE_VEXATRANSLATOR_H

#include <xercesc/util/XercesDefs.hpp>

#include <string>

#include "kestrel/platform/Export.h"
#include "kestrel/translate/BaseTranslator.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

class ScoreDictVar;
class ScoreDictionary;

/// The reader of a "dictionary" element. Errors: KestrelException at the first fault, with line and column
/// where they are known. Keeps no state.
class KESTREL_API VEXATranslator : public BaseTranslator {
 public:
  VEXATranslator();
  VEXATranslator(const VEXATranslator& other);
  VEXATranslator& operator=(const VEXATranslator&) = delete;
  ~VEXATranslator() override;

  using BaseTranslator::ParseFromTree;
  /// No models: always null.
  ScoreModel* ParseFromTree(xercesc::DOMElement* root, const std::string& arg) override;

  /// dictionaryElement  belongs to the caller; null is an error (code 1).
  /// Returns a new dictionary, never null or empty, that the caller deletes, with its variables in the
  /// document's order. Categorical variables have their encoder, with codes in the order of their values.
  ScoreDictionary* ParseDictionary(xercesc::DOMElement* dictionaryElement);

  /// Gives a nominal or ordinal variable its category encoder, unless it has one, and encodes its value
  /// labels in their order. Returns false, doing nothing, for null and for a continuous variable.
  bool SetupCatEncoder(ScoreDictVar* var);
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_VEXATRANSLATOR_H
