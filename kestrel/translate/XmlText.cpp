#include "kestrel/translate/XmlText.h"

#include <xercesc/dom/DOMAttr.hpp>
#include <xercesc/util/XMLString.hpp>
#include <xercesc/util/XMLUni.hpp>

#include "kestrel/foundation/NarrowText.h"

namespace MCKestrel_800 {

namespace {

xercesc::DOMElement* ElementAtOrAfter(const xercesc::DOMNode* node, const char16_t* tag) {
  for (; node != nullptr; node = node->getNextSibling()) {
    if (node->getNodeType() != xercesc::DOMNode::ELEMENT_NODE) continue;
    if (tag == nullptr || Equals(node->getNodeName(), tag)) {
      return static_cast<xercesc::DOMElement*>(const_cast<xercesc::DOMNode*>(node));
    }
  }
  return nullptr;
}

}  // namespace

std::string Narrow(const XMLCh* text) {
  if (IsEmpty(text)) return std::string();
  return MCXML_800::Utf16ToNarrow(ToUtf16(text), xercesc::XMLString::stringLen(text));
}

const XMLCh* FindAttribute(const xercesc::DOMElement* element, const char16_t* name) {
  if (element == nullptr) return nullptr;
  const xercesc::DOMAttr* const attribute = element->getAttributeNode(ToXMLCh(name));
  return attribute != nullptr ? attribute->getValue() : nullptr;
}

const XMLCh* Attribute(const xercesc::DOMElement* element, const char16_t* name) {
  const XMLCh* const value = FindAttribute(element, name);
  return value != nullptr ? value : xercesc::XMLUni::fgZeroLenString;
}

std::string AttributeText(const xercesc::DOMElement* element, const char16_t* name) {
  return Narrow(FindAttribute(element, name));
}

xercesc::DOMElement* FirstChild(const xercesc::DOMNode* node) {
  return FirstChild(node, nullptr);
}

xercesc::DOMElement* FirstChild(const xercesc::DOMNode* node, const char16_t* tag) {
  return node != nullptr ? ElementAtOrAfter(node->getFirstChild(), tag) : nullptr;
}

xercesc::DOMElement* NextSibling(const xercesc::DOMNode* node) {
  return NextSibling(node, nullptr);
}

xercesc::DOMElement* NextSibling(const xercesc::DOMNode* node, const char16_t* tag) {
  return node != nullptr ? ElementAtOrAfter(node->getNextSibling(), tag) : nullptr;
}

xercesc::DOMNode* NextInTree(const xercesc::DOMNode* node, const xercesc::DOMNode* top) {
  if (node == nullptr) return nullptr;
  if (xercesc::DOMNode* const child = node->getFirstChild()) return child;
  while (node != nullptr && node != top) {
    if (xercesc::DOMNode* const sibling = node->getNextSibling()) return sibling;
    node = node->getParentNode();
  }
  return nullptr;
}

xercesc::DOMElement* FirstDescendant(const xercesc::DOMElement* element, const char16_t* tag) {
  for (xercesc::DOMNode* node = NextInTree(element, element); node != nullptr;
       node = NextInTree(node, element)) {
    if (ElementIs(node, tag)) return static_cast<xercesc::DOMElement*>(node);
  }
  return nullptr;
}

std::u16string ElementText(const xercesc::DOMNode* element) {
  std::u16string result;
  for (const xercesc::DOMNode* node = NextInTree(element, element); node != nullptr;
       node = NextInTree(node, element)) {
    const xercesc::DOMNode::NodeType type = node->getNodeType();
    if (type == xercesc::DOMNode::TEXT_NODE || type == xercesc::DOMNode::CDATA_SECTION_NODE) {
      result += ToUtf16(node->getNodeValue());
    }
  }
  return result;
}

std::string ElementNarrowText(const xercesc::DOMNode* element) {
  const std::u16string text = ElementText(element);
  return MCXML_800::Utf16ToNarrow(text.data(), text.size());
}

}  // namespace MCKestrel_800
