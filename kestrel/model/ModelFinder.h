// Finding out which model a document holds.

#ifndef KESTREL_MODEL_MODELFINDER_H
#define KESTREL_MODEL_MODELFINDER_H

#include <xercesc/util/XercesDefs.hpp>

#include <string>
#include <vector>

#include "kestrel/platform/Export.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

/// A model found in a document.
struct FoundModel {
  std::string tag;                     ///< the tag that names the model's library
  const xercesc::DOMElement* element;  ///< where it stands, for messages; belongs to the document
};

/// The model of a document. The root's tag decides whether the names are searched for or the model is known
/// from it. Of the names searched for, the first on the list that is the tag of an element anywhere in the
/// document wins, whatever the order of the elements; repeated names and names that are no tags do no harm.
/// Throws code 5 "Unsupported Model found!" for another root and when no name is found.
KESTREL_API FoundModel FindModel(const xercesc::DOMElement* root, const std::vector<std::string>& names);

/// The model of one element, by its own tag or the newer tag that stands for it, which must be one of the
/// names. Throws code 5 "Empty Node!!" for null and code 5 "Unsupported Model found!" for a tag that is not
/// on the list.
KESTREL_API FoundModel ModelOfElement(const xercesc::DOMElement* element,
                                      const std::vector<std::string>& names);

}  // namespace MCKestrel_800

#endif  // KESTREL_MODEL_MODELFINDER_H
