// The parser behind every load: builds the tree that readers walk, keeps its limits and notes what goes wrong
// where.

#ifndef KESTREL_TRANSLATE_TREEPARSER_H
#define KESTREL_TRANSLATE_TREEPARSER_H

#include <string>
#include <vector>
#include <xercesc/dom/impl/DOMAttrImpl.hpp>
#include <xercesc/dom/impl/DOMElementImpl.hpp>
#include <xercesc/dom/impl/DOMTextImpl.hpp>
#include <xercesc/parsers/XercesDOMParser.hpp>

#include "kestrel/translate/DocumentReader.h"
#include "kestrel/translate/LoadArena.h"

namespace MCKestrel_800 {

/// An element that knows where its start tag ended.
class TreeElement final : public xercesc::DOMElementImpl {
 public:
  TreeElement(xercesc::DOMDocument* document, const XMLCh* name, XMLFileLoc line, XMLFileLoc column)
      : DOMElementImpl(document, name),
        line_(static_cast<unsigned>(line)),
        column_(static_cast<unsigned>(column)) {}
  unsigned GetLine() const { return line_; }
  unsigned GetColumn() const { return column_; }

 private:
  unsigned line_;
  unsigned column_;
};

/// An attribute that finds its one text without asking the node for its type, which costs more than all else
/// that reading an attribute does.
class TreeAttribute final : public xercesc::DOMAttrImpl {
 public:
  TreeAttribute(xercesc::DOMDocument* document, const XMLCh* name) : DOMAttrImpl(document, name) {}
  /// Makes the attribute's one child; once, on a new attribute.
  void SetText(xercesc::DOMDocumentImpl* document, const XMLCh* value);
  const XMLCh* getValue() const override;
  const XMLCh* getNodeValue() const override { return getValue(); }

 private:
  xercesc::DOMTextImpl* text_ = nullptr;
};

/// Thrown through the parser when a document goes past a limit.
struct LimitReached {};

/// A DOM parser that links the nodes itself: the parser's own way asks each node several times what it is,
/// and that is half the time of a parse. It leaves out what no reader looks at: whitespace between elements,
/// comments, processing instructions; CDATA sections become part of the text around them, and entity
/// references are replaced by their text. Elements are not found by identifier (`getElementById`).
class TreeParser final : public xercesc::XercesDOMParser {
 public:
  /// The parser lives in the arena's memory too: create it with `new (arena)`.
  TreeParser(LoadArena* arena, const DocumentLimits& limits);
  ~TreeParser() override;
  TreeParser(const TreeParser&) = delete;
  TreeParser& operator=(const TreeParser&) = delete;

  /// Whether the document used an entity that lies outside it, or one in a way that none may be. Nothing was
  /// read.
  bool IsEntityRefused() const { return entityRefused_; }
  /// The place of the first error; 0 when there was none, or it has no place.
  XMLFileLoc GetErrorLine() const { return errorLine_; }
  XMLFileLoc GetErrorColumn() const { return errorColumn_; }
  /// Whether the first error is that the text is no UTF-8. Its place is then only near: the parser decodes a
  /// large part at a time, and stands at the start of that part or wherever it asked for more.
  bool IsUtf8Malformed() const { return utf8Malformed_; }
  /// Takes the place of the last element for the first error's, unless that is known: for faults that come
  /// without one.
  void NoteLastElement();

  void startElement(const xercesc::XMLElementDecl& declaration, const unsigned int uriId,
                    const XMLCh* const prefix, const xercesc::RefVectorOf<xercesc::XMLAttr>& attributes,
                    const XMLSize_t attributeCount, const bool isEmpty, const bool isRoot) override;
  void endElement(const xercesc::XMLElementDecl& declaration, const unsigned int uriId, const bool isRoot,
                  const XMLCh* const prefix) override;
  void docCharacters(const XMLCh* const text, const XMLSize_t length, const bool isCData) override;
  void ignorableWhitespace(const XMLCh* const text, const XMLSize_t length, const bool isCData) override;
  void docComment(const XMLCh* const) override { CheckQuota(); }
  void docPI(const XMLCh* const, const XMLCh* const) override { CheckQuota(); }
  void startEntityReference(const xercesc::XMLEntityDecl&) override { CheckQuota(); }
  void endEntityReference(const xercesc::XMLEntityDecl&) override {}

  // Declarations are kept as the base class keeps them; each is a point where the parser can be stopped.
  void elementDecl(const xercesc::DTDElementDecl& declaration, const bool isIgnored) override;
  void attDef(const xercesc::DTDElementDecl& element, const xercesc::DTDAttDef& attribute,
              const bool isIgnored) override;
  void entityDecl(const xercesc::DTDEntityDecl& declaration, const bool isParameter,
                  const bool isIgnored) override;
  void notationDecl(const xercesc::XMLNotationDecl& declaration, const bool isIgnored) override;

  void error(const unsigned int code, const XMLCh* const domain,
             const xercesc::XMLErrorReporter::ErrTypes type, const XMLCh* const text,
             const XMLCh* const systemId, const XMLCh* const publicId, const XMLFileLoc line,
             const XMLFileLoc column) override;
  xercesc::InputSource* resolveEntity(xercesc::XMLResourceIdentifier* resource) override;

 private:
  // An element whose end tag has not come yet, and the ends of its list of children.
  struct OpenElement {
    xercesc::DOMElementImpl* element;
    xercesc::DOMChildNode* firstChild;
    xercesc::DOMChildNode* lastChild;
    xercesc::DOMNode* lastNode;
    xercesc::DOMTextImpl* openText;  // the last child when it is text, which more text is added to
  };

  // Counts distinct names by the address of the one copy that the document keeps of each.
  class NameCounter {
   public:
    NameCounter() : slots_(256, nullptr) {}
    /// Returns the number of names, this one included.
    size_t Add(const XMLCh* pooledName);
    size_t GetCount() const { return count_; }

   private:
    void Grow();
    std::vector<const XMLCh*> slots_;
    size_t count_ = 0;
  };

  void CheckQuota() const {
    if (arena_->IsRefused()) throw LimitReached();
  }
  void CountName(const XMLCh* pooledName);
  void AddAttributes(TreeElement* element, const xercesc::RefVectorOf<xercesc::XMLAttr>& attributes,
                     XMLSize_t count);
  static void Link(OpenElement& parent, xercesc::DOMNode* node, xercesc::DOMNodeImpl& nodePart,
                   xercesc::DOMChildNode& childPart);
  void AddText(const XMLCh* text, XMLSize_t length);
  void CloseElement();

  const LoadArena* arena_;
  DocumentLimits limits_;
  std::vector<OpenElement> open_;
  // Whitespace that is only worth a node if text follows, or if the element turns out to hold nothing else.
  std::u16string pendingWhitespace_;
  NameCounter names_;
  static constexpr size_t kNameBuckets = 257;  // of the document's own table of names
  unsigned namesInBucket_[kNameBuckets] = {};
  bool entityRefused_ = false;
  bool utf8Malformed_ = false;
  XMLFileLoc elementLine_ = 0;
  XMLFileLoc elementColumn_ = 0;
  XMLFileLoc errorLine_ = 0;
  XMLFileLoc errorColumn_ = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_TREEPARSER_H
