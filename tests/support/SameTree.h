// Comparing the tree that readers get with the one that the parser builds by itself.

#ifndef KESTREL_TESTS_SUPPORT_SAMETREE_H
#define KESTREL_TESTS_SUPPORT_SAMETREE_H

#include <gtest/gtest.h>

#include <string>
#include <xercesc/dom/DOM.hpp>
#include <xercesc/framework/MemBufInputSource.hpp>
#include <xercesc/parsers/XercesDOMParser.hpp>

#include "kestrel/translate/XmlText.h"

namespace kestrel_tests {

/// A document parsed by the parser as it comes. Only for texts that name nothing outside.
class StockTree {
 public:
  explicit StockTree(const std::string& text) {
    parser_.setCreateEntityReferenceNodes(false);
    parser_.setCreateCommentNodes(false);
    parser_.setLoadExternalDTD(false);
    parser_.setDisableDefaultEntityResolution(true);
    parser_.setValidationScheme(xercesc::XercesDOMParser::Val_Never);
    const xercesc::MemBufInputSource source(reinterpret_cast<const XMLByte*>(text.data()), text.size(),
                                            "text");
    try {
      parser_.parse(source);
    } catch (const xercesc::DOMException&) {
      thrown_ = true;
    }
  }
  /// Null when the document is not well-formed.
  const xercesc::DOMElement* GetRoot() {
    if (thrown_ || parser_.getErrorCount() != 0 || parser_.getDocument() == nullptr) return nullptr;
    return parser_.getDocument()->getDocumentElement();
  }

 private:
  xercesc::XercesDOMParser parser_;
  bool thrown_ = false;
};

// Compares two trees by all that the public interface tells; white space between elements and comments do not
// count.
/// The node or the first one after it that counts: an element, or text that is not just whitespace beside
/// another node.
inline const xercesc::DOMNode* SkipUncounted(const xercesc::DOMNode* node) {
  while (node != nullptr && node->getNodeType() != xercesc::DOMNode::ELEMENT_NODE &&
         (node->getNodeType() != xercesc::DOMNode::TEXT_NODE ||
          (MCKestrel_800::Narrow(node->getNodeValue()).find_first_not_of(" \n\t") == std::string::npos &&
           (node->getPreviousSibling() != nullptr || node->getNextSibling() != nullptr)))) {
    node = node->getNextSibling();
  }
  return node;
}

inline void ExpectSameAttributes(const xercesc::DOMNode* ours, const xercesc::DOMNode* stock) {
  const xercesc::DOMNamedNodeMap* const left = ours->getAttributes();
  const xercesc::DOMNamedNodeMap* const right = stock->getAttributes();
  ASSERT_EQ(left == nullptr, right == nullptr);
  if (left == nullptr) return;
  ASSERT_EQ(left->getLength(), right->getLength());
  for (XMLSize_t i = 0; i < left->getLength(); ++i) {
    const auto* const a = static_cast<xercesc::DOMAttr*>(left->item(i));
    const auto* const b = static_cast<xercesc::DOMAttr*>(right->item(i));
    EXPECT_EQ(MCKestrel_800::Narrow(a->getName()), MCKestrel_800::Narrow(b->getName()));
    EXPECT_EQ(MCKestrel_800::Narrow(a->getValue()), MCKestrel_800::Narrow(b->getValue()));
    EXPECT_EQ(MCKestrel_800::Narrow(a->getTextContent()), MCKestrel_800::Narrow(b->getTextContent()));
    EXPECT_EQ(a->getSpecified(), b->getSpecified());
    EXPECT_EQ(a->getOwnerElement(), ours);
  }
}

/// Compares a tree of ours with one that the parser built in its own way, by all that the public interface
/// tells. Whitespace between elements, comments and processing instructions do not count.
inline void ExpectSameTree(const xercesc::DOMNode* ours, const xercesc::DOMNode* stock) {
  EXPECT_EQ(MCKestrel_800::Narrow(ours->getNodeName()), MCKestrel_800::Narrow(stock->getNodeName()));
  EXPECT_EQ(MCKestrel_800::Narrow(ours->getNodeValue()), MCKestrel_800::Narrow(stock->getNodeValue()));
  EXPECT_EQ(ours->getNodeType(), stock->getNodeType());
  ExpectSameAttributes(ours, stock);
  const xercesc::DOMNode* a = ours->getFirstChild();
  const xercesc::DOMNode* b = SkipUncounted(stock->getFirstChild());
  const xercesc::DOMNode* previous = nullptr;
  while (a != nullptr && b != nullptr) {
    EXPECT_EQ(a->getParentNode(), ours);
    EXPECT_EQ(a->getPreviousSibling(), previous);
    ExpectSameTree(a, b);
    previous = a;
    a = a->getNextSibling();
    b = SkipUncounted(b->getNextSibling());
  }
  EXPECT_EQ(a, nullptr);
  EXPECT_EQ(b, nullptr);
  EXPECT_EQ(ours->getLastChild(), previous);
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_SAMETREE_H
