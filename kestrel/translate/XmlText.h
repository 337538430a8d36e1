// What all readers share when they look at parser text: comparing names, fetching attributes, walking
// children.

#ifndef KESTREL_TRANSLATE_XMLTEXT_H
#define KESTREL_TRANSLATE_XMLTEXT_H

#include <xercesc/dom/DOMElement.hpp>

#include <string>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

// The parser's character may be a type of its own on other compilers; its values are UTF-16 everywhere.
static_assert(sizeof(XMLCh) == sizeof(char16_t), "parser text must be UTF-16");

inline const char16_t* ToUtf16(const XMLCh* text) {
  return reinterpret_cast<const char16_t*>(text);
}
inline const XMLCh* ToXMLCh(const char16_t* text) {
  return reinterpret_cast<const XMLCh*>(text);
}

/// Parser text as narrow text (UTF-8 on Linux); empty for null.
KESTREL_API std::string Narrow(const XMLCh* text);

/// Whether a text is empty or null.
inline bool IsEmpty(const XMLCh* text) {
  return text == nullptr || *text == 0;
}

/// Exact comparison; null equals the empty text, as an absent attribute does.
inline bool Equals(const XMLCh* left, const char16_t* right) {
  if (left == nullptr) return *right == 0;
  while (*left != 0 && static_cast<char16_t>(*left) == *right) {
    ++left;
    ++right;
  }
  return static_cast<char16_t>(*left) == *right;
}

/// Whether `node` is an element with the tag; false for null.
inline bool ElementIs(const xercesc::DOMNode* node, const char16_t* tag) {
  return node != nullptr && node->getNodeType() == xercesc::DOMNode::ELEMENT_NODE &&
         Equals(node->getNodeName(), tag);
}

/// An attribute's value, which belongs to the document. Absent, or a null element: the empty text for
/// Attribute, null for FindAttribute.
KESTREL_API const XMLCh* Attribute(const xercesc::DOMElement* element, const char16_t* name);
KESTREL_API const XMLCh* FindAttribute(const xercesc::DOMElement* element, const char16_t* name);
inline bool HasAttribute(const xercesc::DOMElement* element, const char16_t* name) {
  return FindAttribute(element, name) != nullptr;
}

/// An attribute's value as narrow text; empty when it is absent.
KESTREL_API std::string AttributeText(const xercesc::DOMElement* element, const char16_t* name);

/// The first child element, or the next sibling element, with any tag or the one given; null when there is
/// none.
KESTREL_API xercesc::DOMElement* FirstChild(const xercesc::DOMNode* node);
KESTREL_API xercesc::DOMElement* FirstChild(const xercesc::DOMNode* node, const char16_t* tag);
KESTREL_API xercesc::DOMElement* NextSibling(const xercesc::DOMNode* node);
KESTREL_API xercesc::DOMElement* NextSibling(const xercesc::DOMNode* node, const char16_t* tag);

/// The node after `node` in document order below `top`, of which `top` itself comes before all; null after
/// the last one. Walks up and along instead of recursing, so that depth costs no stack.
KESTREL_API xercesc::DOMNode* NextInTree(const xercesc::DOMNode* node, const xercesc::DOMNode* top);

/// The first descendant element in document order with the tag, found without a live node list; null when
/// there is none.
KESTREL_API xercesc::DOMElement* FirstDescendant(const xercesc::DOMElement* element, const char16_t* tag);

/// The text of all descendants joined, since comments and CDATA sections may cut it in pieces.
KESTREL_API std::u16string ElementText(const xercesc::DOMNode* element);
KESTREL_API std::string ElementNarrowText(const xercesc::DOMNode* element);

/// The child elements of a node for a range-based for, with any tag or the one given. The tree must not
/// change meanwhile.
///   for (xercesc::DOMElement* child : ChildElements(parent)) ...
class ChildElements {
 public:
  class Iterator {
   public:
    Iterator(xercesc::DOMElement* element, const char16_t* tag) : element_(element), tag_(tag) {}
    xercesc::DOMElement* operator*() const { return element_; }
    Iterator& operator++() {
      element_ = tag_ != nullptr ? NextSibling(element_, tag_) : NextSibling(element_);
      return *this;
    }
    bool operator!=(const Iterator& other) const { return element_ != other.element_; }

   private:
    xercesc::DOMElement* element_;
    const char16_t* tag_;
  };

  explicit ChildElements(const xercesc::DOMNode* parent, const char16_t* tag = nullptr)
      : parent_(parent), tag_(tag) {}
  Iterator begin() const {
    return Iterator(tag_ != nullptr ? FirstChild(parent_, tag_) : FirstChild(parent_), tag_);
  }
  Iterator end() const { return Iterator(nullptr, tag_); }

 private:
  const xercesc::DOMNode* parent_;
  const char16_t* tag_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_XMLTEXT_H
