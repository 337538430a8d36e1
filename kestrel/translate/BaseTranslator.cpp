#include "kestrel/translate/BaseTranslator.h"

#include <memory>
#include <xercesc/dom/DOMAttr.hpp>
#include <xercesc/dom/DOMDocument.hpp>
#include <xercesc/dom/DOMElement.hpp>
#include <xercesc/dom/DOMNodeList.hpp>
#include <xercesc/util/XMLString.hpp>
#include <xercesc/util/XMLUni.hpp>

#include "kestrel/foundation/NarrowText.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

// Deletes a wide text that the parser's string functions made.
struct ReleaseWide {
  void operator()(XMLCh* text) const { xercesc::XMLString::release(&text); }
};
using OwnedWide = std::unique_ptr<XMLCh, ReleaseWide>;

std::string MissingNode(const std::string& tag) {
  return "Node is missing --- " + tag + " ---";
}

xercesc::DOMNode* FindChild(xercesc::DOMNode* node, const XMLCh* tag) {
  return FirstChild(node, tag != nullptr ? ToUtf16(tag) : u"");
}

}  // namespace

BaseTranslator::BaseTranslator() = default;
BaseTranslator::BaseTranslator(const BaseTranslator& other) = default;
BaseTranslator& BaseTranslator::operator=(const BaseTranslator& other) = default;
BaseTranslator::~BaseTranslator() = default;

ScoreModel* BaseTranslator::ParseFromTree(xercesc::DOMElement*, xercesc::DOMElement*, const std::string&) {
  return nullptr;
}

ScoreModel* BaseTranslator::ParseFromTree(xercesc::DOMElement*, ScoreDictionary*, ScoreDictionary*,
                                          const std::string&) {
  return nullptr;
}

ScoreModel* BaseTranslator::ParseFromTree(const std::string&, const std::string&) {
  return nullptr;
}

ScoreModel* BaseTranslator::ParseFromTree(std::istream&, const std::string&) {
  return nullptr;
}

ScoreModel* BaseTranslator::ParseFromTree(std::istream&, const std::string&, const std::string&) {
  return nullptr;
}

bool BaseTranslator::IsEqual(const XMLCh* wide, const std::string& narrow) {
  return Equals(wide, MCXML_800::NarrowToUtf16(narrow).c_str());
}

xercesc::DOMNode* BaseTranslator::GetFirstChildElt(xercesc::DOMNode* node) {
  return FirstChild(node);
}

xercesc::DOMNode* BaseTranslator::GetNextSiblingElt(xercesc::DOMNode* node) {
  return NextSibling(node);
}

xercesc::DOMNode* BaseTranslator::GetChildByTag(xercesc::DOMNode* node, const std::string& tag) {
  return FirstChild(node, MCXML_800::NarrowToUtf16(tag).c_str());
}

xercesc::DOMNode* BaseTranslator::GetChildTag(xercesc::DOMNode* node, XMLCh* tag) {
  const OwnedWide owned(tag);
  return FindChild(node, tag);
}

xercesc::DOMNode* BaseTranslator::GetChildByTagForced(xercesc::DOMNode* node, const std::string& tag) {
  xercesc::DOMNode* const child = GetChildByTag(node, tag);
  if (child == nullptr) FailAt(node, KestrelException::kMissingElement, MissingNode(tag));
  return child;
}

xercesc::DOMNode* BaseTranslator::GetChildTagForced(xercesc::DOMNode* node, XMLCh* tag) {
  const OwnedWide owned(tag);
  xercesc::DOMNode* const child = FindChild(node, tag);
  // The tag first, as hosts know this message.
  if (child == nullptr) FailAt(node, KestrelException::kMissingElement, Narrow(tag) + "Node is missing --- ");
  return child;
}

xercesc::DOMNodeList* BaseTranslator::GetElementsByTagName(const xercesc::DOMDocument* document,
                                                           const std::string& tag) {
  if (document == nullptr) Fail(KestrelException::kMissingElement, MissingNode(tag));
  return document->getElementsByTagName(ToXMLCh(MCXML_800::NarrowToUtf16(tag).c_str()));
}

xercesc::DOMNodeList* BaseTranslator::GetElementsByTagName(const xercesc::DOMElement* element,
                                                           const std::string& tag) {
  if (element == nullptr) Fail(KestrelException::kMissingElement, MissingNode(tag));
  return element->getElementsByTagName(ToXMLCh(MCXML_800::NarrowToUtf16(tag).c_str()));
}

const XMLCh* BaseTranslator::GetAttribute(const xercesc::DOMElement* element, const std::string& name) {
  return Attribute(element, MCXML_800::NarrowToUtf16(name).c_str());
}

const XMLCh* BaseTranslator::GetAttributeForced(const xercesc::DOMElement* element, const std::string& name) {
  const XMLCh* const value = FindAttribute(element, MCXML_800::NarrowToUtf16(name).c_str());
  if (value == nullptr) {
    const std::string tag = element != nullptr ? Narrow(element->getTagName()) : std::string();
    FailAt(element, KestrelException::kMissingElement,
           "Attribute " + name + " is missing from Node \"" + tag + "\"");
  }
  return value;
}

}  // namespace MCKestrel_800
