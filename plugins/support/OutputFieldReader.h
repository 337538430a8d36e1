// Reads the output fields of a model element.

#ifndef KESTREL_PLUGINS_SUPPORT_OUTPUTFIELDREADER_H
#define KESTREL_PLUGINS_SUPPORT_OUTPUTFIELDREADER_H

#include <xercesc/util/XercesDefs.hpp>

#include "plugins/support/OutputFields.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

class ResultVar;
class ScoreDictVar;
class ScoreDictionary;

/// Errors: those of OutputFields::Read.
class OutputFieldReader {
 public:
  /// target  may be null.
  OutputFieldReader(const ScoreDictVar* target, bool is_classification)
      : target_(target), is_classification_(is_classification) {}

  /// Reads an `OutputField` or `ResultField` and adds its variable to the dictionary.
  OutputField Read(const xercesc::DOMElement* element, ScoreDictionary& results) const;

 private:
  void CheckPlace(const xercesc::DOMElement* element, const std::string& name) const;
  void ReadCategory(const xercesc::DOMElement* element, OutputField& field) const;
  void SetType(const OutputField& field, ResultVar& variable) const;
  bool TellsText(const OutputField& field) const;

  const ScoreDictVar* target_;
  bool is_classification_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_OUTPUTFIELDREADER_H
