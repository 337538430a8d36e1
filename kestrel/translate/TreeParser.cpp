#include "kestrel/translate/TreeParser.h"

#include <xercesc/dom/impl/DOMAttrMapImpl.hpp>
#include <xercesc/dom/impl/DOMDocumentImpl.hpp>
#include <xercesc/framework/XMLAttr.hpp>
#include <xercesc/framework/XMLElementDecl.hpp>
#include <xercesc/framework/XMLErrorCodes.hpp>
#include <xercesc/internal/ReaderMgr.hpp>
#include <xercesc/internal/XMLScanner.hpp>
#include <xercesc/util/XMLExceptMsgs.hpp>

#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

// 16 are usual at the greatest number of names.
constexpr unsigned kMaxNamesInBucket = 256;

bool IsWhitespace(const XMLCh* text, XMLSize_t length) {
  for (XMLSize_t i = 0; i < length; ++i) {
    const XMLCh c = text[i];
    if (c != u' ' && c != u'\n' && c != u'\t' && c != u'\r') return false;
  }
  return true;
}

// Entities used as none may be. Before the root element the parser stops at them without a word about why,
// and the document would pass for an empty one.
bool IsEntityMisuse(unsigned int code) {
  switch (code) {
    case xercesc::XMLErrs::NoExtRefsInAttValue:
    case xercesc::XMLErrs::NoUnparsedEntityRefs:
    case xercesc::XMLErrs::PERefInMarkupInIntSubset:
    case xercesc::XMLErrs::RecursiveEntity:
      return true;
    default:
      return false;
  }
}

bool IsMalformedUtf8(unsigned int code, const XMLCh* domain) {
  return code >= xercesc::XMLExcepts::UTF8_FormatError &&
         code <= xercesc::XMLExcepts::UTF8_Exceeds_BytesLimit &&
         xercesc::XMLString::equals(domain, xercesc::XMLUni::fgExceptDomain);
}

}  // namespace

void TreeAttribute::SetText(xercesc::DOMDocumentImpl* document, const XMLCh* value) {
  text_ = new (document, xercesc::DOMMemoryManager::TEXT_OBJECT) xercesc::DOMTextImpl(document, value);
  text_->fNode.fOwnerNode = this;
  text_->fNode.isOwned(true);
  text_->fNode.isFirstChild(true);
  text_->fChild.previousSibling = text_;
  fParent.fFirstChild = text_;
}

// Whoever changes the attribute gets the general answer, unless the change leaves one text of ours.
const XMLCh* TreeAttribute::getValue() const {
  if (text_ != nullptr && fParent.fFirstChild == text_ && text_->fChild.nextSibling == nullptr) {
    return text_->fCharacterData.getNodeValue();
  }
  return DOMAttrImpl::getValue();
}

size_t TreeParser::NameCounter::Add(const XMLCh* pooledName) {
  const size_t mask = slots_.size() - 1;
  size_t slot = (reinterpret_cast<size_t>(pooledName) >> 3) * 0x9E3779B97F4A7C15u >> 20 & mask;
  while (slots_[slot] != nullptr) {
    if (slots_[slot] == pooledName) return count_;
    slot = (slot + 1) & mask;
  }
  slots_[slot] = pooledName;
  if (++count_ * 2 > slots_.size()) Grow();
  return count_;
}

void TreeParser::NameCounter::Grow() {
  std::vector<const XMLCh*> old(slots_.size() * 2, nullptr);
  old.swap(slots_);
  count_ = 0;
  for (const XMLCh* name : old) {
    if (name != nullptr) Add(name);
  }
}

TreeParser::TreeParser(LoadArena* arena, const DocumentLimits& limits)
    : XercesDOMParser(nullptr, arena), arena_(arena), limits_(limits) {
  setLoadExternalDTD(false);
  setValidationScheme(Val_Never);
  setDisableDefaultEntityResolution(true);
  setCreateEntityReferenceNodes(false);
  setCreateCommentNodes(false);
  // Connected directly: an error handler would make the parser throw, and a resolver would have to answer.
  getScanner()->setErrorReporter(this);
  getScanner()->setEntityHandler(this);
  open_.reserve(32);
}

TreeParser::~TreeParser() = default;

// Not asked of the parser, whose readers are gone when an exception has come out of it.
void TreeParser::NoteLastElement() {
  if (errorLine_ != 0) return;
  errorLine_ = elementLine_;
  errorColumn_ = elementColumn_;
}

void TreeParser::CountName(const XMLCh* pooledName) {
  const size_t before = names_.GetCount();
  const size_t count = names_.Add(pooledName);
  if (count == before) return;
  // Names chosen to fall into one of the parser's buckets make every look-up walk past all of them.
  const bool isCrowded =
      ++namesInBucket_[xercesc::XMLString::hash(pooledName, kNameBuckets)] > kMaxNamesInBucket;
  if (isCrowded || count > limits_.maxNames) throw LimitReached();
}

void TreeParser::startElement(const xercesc::XMLElementDecl& declaration, const unsigned int uriId,
                              const XMLCh* const prefix,
                              const xercesc::RefVectorOf<xercesc::XMLAttr>& attributes,
                              const XMLSize_t attributeCount, const bool isEmpty, const bool isRoot) {
  xercesc::ReaderMgr::LastExtEntityInfo place;
  getScanner()->getReaderMgr()->getLastExtEntityInfo(place);
  elementLine_ = place.lineNumber;
  elementColumn_ = place.colNumber;
  CheckQuota();
  if (open_.size() >= limits_.maxDepth || attributeCount > limits_.maxAttributes) throw LimitReached();
  pendingWhitespace_.clear();
  // Not through createElement, which checks the name again. The node is larger than its kind, so it must not
  // come from what was freed of that kind.
  TreeElement* const element =
      new (fDocument) TreeElement(fDocument, declaration.getFullName(), elementLine_, elementColumn_);
  CountName(element->getTagName());
  if (attributeCount != 0) AddAttributes(element, attributes, attributeCount);
  if (open_.empty()) {
    fDocument->appendChild(element);
  } else {
    Link(open_.back(), element, element->fNode, element->fChild);
    open_.back().openText = nullptr;
  }
  open_.push_back({element, nullptr, nullptr, nullptr, nullptr});
  if (isEmpty) endElement(declaration, uriId, isRoot, prefix);
}

void TreeParser::AddAttributes(TreeElement* element, const xercesc::RefVectorOf<xercesc::XMLAttr>& attributes,
                               XMLSize_t count) {
  xercesc::DOMAttrMapImpl* const map = element->fAttributes;
  map->reserve(count);
  for (XMLSize_t i = 0; i < count; ++i) {
    const xercesc::XMLAttr* const source = attributes.elementAt(i);
    TreeAttribute* const attribute = new (fDocument) TreeAttribute(fDocument, source->getName());
    CountName(attribute->fName);
    attribute->SetText(fDocument, source->getValue());
    attribute->fNode.isSpecified(source->getSpecified());
    map->setNamedItemFast(attribute);
  }
}

// The tree keeps a list's last node as the first one's previous sibling.
void TreeParser::Link(OpenElement& parent, xercesc::DOMNode* node, xercesc::DOMNodeImpl& nodePart,
                      xercesc::DOMChildNode& childPart) {
  nodePart.fOwnerNode = parent.element;
  nodePart.isOwned(true);
  if (parent.firstChild == nullptr) {
    parent.element->fParent.fFirstChild = node;
    nodePart.isFirstChild(true);
    parent.firstChild = &childPart;
  } else {
    parent.lastChild->nextSibling = node;
    childPart.previousSibling = parent.lastNode;
  }
  parent.firstChild->previousSibling = node;
  parent.lastChild = &childPart;
  parent.lastNode = node;
}

void TreeParser::docCharacters(const XMLCh* const text, const XMLSize_t length, const bool isCData) {
  CheckQuota();
  if (open_.empty() || length == 0) return;
  if (open_.back().openText == nullptr && !isCData && IsWhitespace(text, length)) {
    pendingWhitespace_.append(ToUtf16(text), length);
    return;
  }
  if (!pendingWhitespace_.empty()) {
    AddText(ToXMLCh(pendingWhitespace_.data()), pendingWhitespace_.size());
    pendingWhitespace_.clear();
  }
  AddText(text, length);
}

void TreeParser::ignorableWhitespace(const XMLCh* const text, const XMLSize_t length, const bool isCData) {
  docCharacters(text, length, isCData);
}

void TreeParser::AddText(const XMLCh* text, XMLSize_t length) {
  OpenElement& parent = open_.back();
  if (parent.openText != nullptr) {
    parent.openText->appendDataFast(text, length);
    return;
  }
  xercesc::DOMTextImpl* const node =
      new (fDocument, xercesc::DOMMemoryManager::TEXT_OBJECT) xercesc::DOMTextImpl(fDocument, text, length);
  Link(parent, node, node->fNode, node->fChild);
  parent.openText = node;
}

void TreeParser::endElement(const xercesc::XMLElementDecl&, const unsigned int, const bool,
                            const XMLCh* const) {
  CloseElement();
}

void TreeParser::CloseElement() {
  if (!pendingWhitespace_.empty()) {
    if (open_.back().firstChild == nullptr) {
      AddText(ToXMLCh(pendingWhitespace_.data()), pendingWhitespace_.size());
    }
    pendingWhitespace_.clear();
  }
  open_.pop_back();
}

void TreeParser::elementDecl(const xercesc::DTDElementDecl& declaration, const bool isIgnored) {
  CheckQuota();
  XercesDOMParser::elementDecl(declaration, isIgnored);
}

void TreeParser::attDef(const xercesc::DTDElementDecl& element, const xercesc::DTDAttDef& attribute,
                        const bool isIgnored) {
  CheckQuota();
  XercesDOMParser::attDef(element, attribute, isIgnored);
}

void TreeParser::entityDecl(const xercesc::DTDEntityDecl& declaration, const bool isParameter,
                            const bool isIgnored) {
  CheckQuota();
  XercesDOMParser::entityDecl(declaration, isParameter, isIgnored);
}

void TreeParser::notationDecl(const xercesc::XMLNotationDecl& declaration, const bool isIgnored) {
  CheckQuota();
  XercesDOMParser::notationDecl(declaration, isIgnored);
}

void TreeParser::error(const unsigned int code, const XMLCh* const domain,
                       const xercesc::XMLErrorReporter::ErrTypes type, const XMLCh* const, const XMLCh* const,
                       const XMLCh* const, const XMLFileLoc line, const XMLFileLoc column) {
  if (type == xercesc::XMLErrorReporter::ErrType_Warning) return;
  if (IsEntityMisuse(code) && xercesc::XMLString::equals(domain, xercesc::XMLUni::fgXMLErrDomain)) {
    entityRefused_ = true;
  }
  if (errorLine_ != 0) return;
  errorLine_ = line;
  errorColumn_ = column;
  utf8Malformed_ = IsMalformedUtf8(code, domain);
}

// Default resolution is off, so no answer means that the parser reports an error and opens nothing.
xercesc::InputSource* TreeParser::resolveEntity(xercesc::XMLResourceIdentifier*) {
  entityRefused_ = true;
  return nullptr;
}

}  // namespace MCKestrel_800
