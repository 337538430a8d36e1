// Reads lists, children and attributes of one document's elements, each either required or not.

#ifndef KESTREL_TRANSLATE_DOMELEMUTILITY_H
#define KESTREL_TRANSLATE_DOMELEMUTILITY_H

#include <cstddef>
#include <string>
#include <xercesc/util/XercesDefs.hpp>

#include "kestrel/platform/Export.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
class DOMNodeList;
XERCES_CPP_NAMESPACE_END

namespace MCXML_800 {
class PliantTranscoder;
}

namespace MCKestrel_800 {

class PMMLTranslator;

/// A helper bound to one translator and one transcoder; neither is owned, both must outlive it. Either may be
/// null.
///
/// `forced` says that what is asked for must be there: when it is not, the operation throws code 4 with the
/// message of BaseTranslator's forced helper instead of returning nothing. It does not change what is
/// returned for a null element, an empty name or a missing translator. What is returned belongs to the
/// document. KestrelExceptions from below pass with their code, message and place.
class KESTREL_API DOMElemUtility {
 public:
  DOMElemUtility(PMMLTranslator* translator, MCXML_800::PliantTranscoder* transcoder);
  virtual ~DOMElemUtility();

  /// All descendants with the tag; null for a null element, an empty tag and an empty list.
  xercesc::DOMNodeList* GetDOMNodeList(xercesc::DOMElement* element, const std::string& tag, bool forced);
  /// The index-th descendant with the tag; null when there is no translator, element, tag or so many of them.
  xercesc::DOMElement* GetElemFromNodeList(xercesc::DOMElement* element, const std::string& tag, size_t index,
                                           bool forced);
  /// The number of descendants with the tag; 0 on the same conditions. Counts anew at each call.
  size_t GetNodeListLength(xercesc::DOMElement* element, const std::string& tag, bool forced);

  /// An attribute as BaseTranslator::VerifyInt reads it; -1 without translator, element or name. An absent
  /// attribute reads as the empty text, which is no integer (code 3).
  int GetAttributeToInt(xercesc::DOMElement* element, const std::string& name, bool forced);
  /// An attribute transcoded with the helper's transcoder, or to the library's narrow text when it has none;
  /// empty without element or name, and for an absent attribute.
  std::string GetAttributeToString(xercesc::DOMElement* element, const std::string& name, bool forced);
  /// An attribute as BaseTranslator::VerifyDouble reads it; 0.0 without translator, element or name. An
  /// absent attribute reads as the empty text, which is no number (code 3).
  double GetAttributeToDouble(xercesc::DOMElement* element, const std::string& name, bool forced);

  /// The first child element with the tag; null for a null element, an empty tag and when there is none.
  xercesc::DOMElement* GetChildElemByName(xercesc::DOMElement* element, const std::string& tag, bool forced);

 private:
  PMMLTranslator* translator_;
  MCXML_800::PliantTranscoder* transcoder_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_DOMELEMUTILITY_H
