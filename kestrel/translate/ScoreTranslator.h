// What the model factory asks a model plug-in for: an object that turns a document into a model.

#ifndef KESTREL_TRANSLATE_SCORETRANSLATOR_H
#define KESTREL_TRANSLATE_SCORETRANSLATOR_H

#include <xercesc/util/XercesDefs.hpp>

#include <iosfwd>
#include <string>

#include "kestrel/platform/Export.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

class ScoreDictionary;
class ScoreModel;

/// Builds a model from a document. Plug-ins hand one out through their entry point; the factory deletes it.
///
/// All operations return a new model that the caller deletes, or null when the translator does not offer that
/// form. Elements belong to the caller's document and are not kept. `arg` is the host's own argument, passed
/// on unread. Errors: KestrelException for a document that cannot be read. Threads: one translator serves one
/// load at a time.
class KESTREL_API ScoreTranslator {
 public:
  virtual ~ScoreTranslator();

  /// Builds a model from its element and a second element of the same document.
  virtual ScoreModel* ParseFromTree(xercesc::DOMElement* modelElement, xercesc::DOMElement* otherElement,
                                    const std::string& arg) = 0;

  /// Builds a model from its element over dictionaries that were read before. They stay the caller's.
  virtual ScoreModel* ParseFromTree(xercesc::DOMElement* modelElement, ScoreDictionary* dictionary,
                                    ScoreDictionary* resultDictionary, const std::string& arg) = 0;

  /// Builds a model from a file. `fileName` is UTF-8.
  virtual ScoreModel* ParseFromTree(const std::string& fileName, const std::string& arg) = 0;

  /// Builds a model from a stream. The stream stays the caller's.
  virtual ScoreModel* ParseFromTree(std::istream& in, const std::string& arg) = 0;

  /// Builds a model from a document's root element: the form that the factory calls, which every plug-in
  /// offers.
  virtual ScoreModel* ParseFromTree(xercesc::DOMElement* root, const std::string& arg) = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_SCORETRANSLATOR_H
