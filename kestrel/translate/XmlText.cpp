#include "kestrel/translate/XmlText.h"

#include <xercesc/dom/DOMAttr.hpp>
#include <xercesc/util/XMLString.hpp>
#include <xercesc/util/XMLUni.hpp>

#include "kestrel/foundation/NarrowText.h"

namespace MCKestrel_800 {

namespace {

// Calls `use` with the text of every text node below `element`, in document order. Walks without recursion.
template <typename Use>
void ForEachText(const xercesc::DOMNode* element, Use use) {
  const xercesc::DOMNode* node = element != nullptr ? element->getFirstChild() : nullptr;
  while (node != nullptr) {
    const xercesc::DOMNode::NodeType type = node->getNodeType();
    if (type == xercesc::DOMNode::TEXT_NODE || type == xercesc::DOMNode::CDATA_SECTION_NODE)
      use(node->getNodeValue());
    const xercesc::DOMNode* next = node->getFirstChild();
    while (next == nullptr && node != element) {
      next = node->getNextSibling();
      if (next == nullptr) node = node->getParentNode();
    }
    node = next;
  }
}

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

xercesc::DOMElement* FirstDescendant(const xercesc::DOMElement* element, const char16_t* tag) {
  const xercesc::DOMNode* node = element != nullptr ? element->getFirstChild() : nullptr;
  while (node != nullptr) {
    if (ElementIs(node, tag)) return static_cast<xercesc::DOMElement*>(const_cast<xercesc::DOMNode*>(node));
    const xercesc::DOMNode* next = node->getFirstChild();
    while (next == nullptr && node != element) {
      next = node->getNextSibling();
      if (next == nullptr) node = node->getParentNode();
    }
    node = next;
  }
  return nullptr;
}

std::u16string ElementText(const xercesc::DOMNode* element) {
  std::u16string result;
  ForEachText(element, [&result](const XMLCh* text) { result += ToUtf16(text); });
  return result;
}

std::string ElementNarrowText(const xercesc::DOMNode* element) {
  const std::u16string text = ElementText(element);
  return MCXML_800::Utf16ToNarrow(text.data(), text.size());
}

}  // namespace MCKestrel_800
