#include "kestrel/translate/ReaderFault.h"

#include <xercesc/dom/DOMAttr.hpp>

#include "kestrel/translate/TreeParser.h"

namespace MCKestrel_800 {

namespace {

// The element at or above the node that knows its place; null in a tree that was not read by us.
const TreeElement* FindPlace(const xercesc::DOMNode* node) {
  while (node != nullptr) {
    if (const auto* element = dynamic_cast<const TreeElement*>(node)) return element;
    node = node->getNodeType() == xercesc::DOMNode::ATTRIBUTE_NODE
               ? static_cast<const xercesc::DOMAttr*>(node)->getOwnerElement()
               : node->getParentNode();
  }
  return nullptr;
}

}  // namespace

void Fail(KestrelException::ExceptionCode code, const std::string& message) {
  throw KestrelException(code, message);
}

void FailAt(const xercesc::DOMNode* where, KestrelException::ExceptionCode code, const std::string& message) {
  KestrelException fault(code, message);
  if (const TreeElement* const element = FindPlace(where))
    fault.SetPlace(element->GetLine(), element->GetColumn());
  throw fault;
}

void FailOnField(const xercesc::DOMNode* where, KestrelException::ExceptionCode code,
                 const std::string& field, const std::string& text) {
  FailAt(where, code, field + text);
}

}  // namespace MCKestrel_800
