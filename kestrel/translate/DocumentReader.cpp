#include "kestrel/translate/DocumentReader.h"

#include <xercesc/dom/DOMDocument.hpp>
#include <xercesc/dom/DOMException.hpp>
#include <xercesc/util/OutOfMemoryException.hpp>
#include <xercesc/util/XMLException.hpp>

#include "kestrel/translate/LoadArena.h"
#include "kestrel/translate/ParserPlatform.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/StreamBlocks.h"
#include "kestrel/translate/TreeParser.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

constexpr char kInvalid[] = "Invalid XML file!!";
constexpr char kNoDocument[] = "\nInput XML is not parseable into a document";
constexpr char kNoRoot[] = "\nInvalid XML document or no dtd file avaible in current directory";
constexpr char kEmptyRootTag[] = "\nInvalid XML document: root tag name is empty!!";
constexpr char kUnreadable[] = "Could not read model file";

}  // namespace

// The order matters: the parser's memory is the arena's, and so is the tree's, which is never released node
// by node.
class ParsedDocument::Impl {
 public:
  Impl(size_t inputBytes, const DocumentLimits& limits)
      : arena_(limits.baseMemoryBytes + limits.memoryPerInputByte * inputBytes,
               limits.baseAllocations + limits.allocationsPerInputByte * inputBytes, limits.reserveBytes,
               limits.reserveAllocations) {}
  ~Impl() {
    arena_.LiftQuota();  // for what the parser's destructors ask for
    delete parser_;
  }
  Impl(const Impl&) = delete;
  Impl& operator=(const Impl&) = delete;

  void Parse(const StreamBlocks& text, const DocumentLimits& limits);
  xercesc::DOMDocument* GetDocument() const { return document_; }
  size_t GetMemoryBytes() const { return arena_.GetPeakBytes(); }

 private:
  enum class Ended { kNormally, kAtLimit, kByException };
  Ended Run(const StreamBlocks& text, std::string& message);
  void FindErrorPlace(const StreamBlocks& text);
  [[noreturn]] void Refuse(KestrelException::ExceptionCode code, const std::string& message) const;

  LoadArena arena_;
  TreeParser* parser_ = nullptr;
  xercesc::DOMDocument* document_ = nullptr;
  StreamBlocks::Place errorPlace_;
};

void ParsedDocument::Impl::FindErrorPlace(const StreamBlocks& text) {
  if (parser_ == nullptr) return;
  if (parser_->IsUtf8Malformed()) errorPlace_ = text.FindMalformedUtf8();
  if (errorPlace_.line != 0) return;
  errorPlace_.line = static_cast<size_t>(parser_->GetErrorLine());
  errorPlace_.column = static_cast<size_t>(parser_->GetErrorColumn());
}

void ParsedDocument::Impl::Refuse(KestrelException::ExceptionCode code, const std::string& message) const {
  KestrelException fault(code, message);
  fault.SetPlace(static_cast<unsigned>(errorPlace_.line), static_cast<unsigned>(errorPlace_.column));
  throw fault;
}

// Whatever flies out of the parser stops here: some of its exceptions have no base class, and their texts may
// live in the arena.
ParsedDocument::Impl::Ended ParsedDocument::Impl::Run(const StreamBlocks& text, std::string& message) {
  try {
    const BlockInputSource source(text, &arena_);
    parser_->parse(source);
    return Ended::kNormally;
  } catch (const LimitReached&) {
    parser_->NoteLastElement();
    return Ended::kAtLimit;
  } catch (const xercesc::OutOfMemoryException&) {
    parser_->NoteLastElement();
    return Ended::kAtLimit;
  } catch (const xercesc::DOMException& e) {
    message = Narrow(e.getMessage());
  } catch (...) {
  }
  parser_->NoteLastElement();
  return Ended::kByException;
}

void ParsedDocument::Impl::Parse(const StreamBlocks& text, const DocumentLimits& limits) {
  std::string message;
  Ended ended = Ended::kAtLimit;
  try {
    parser_ = new (&arena_) TreeParser(&arena_, limits);
    ended = Run(text, message);
  } catch (const xercesc::OutOfMemoryException&) {  // the parser itself did not fit the quota
  }
  FindErrorPlace(text);
  if (ended == Ended::kByException) {
    Refuse(KestrelException::kInvalidDocument, message.empty() ? kInvalid : message);
  }
  if (ended == Ended::kAtLimit || arena_.IsRefused() || parser_->IsEntityRefused()) {
    Refuse(KestrelException::kInvalidDocument, kInvalid);
  }
  document_ = parser_->getDocument();
  if (document_ == nullptr) Refuse(KestrelException::kMissingElement, kNoDocument);
  const xercesc::DOMElement* const root = document_->getDocumentElement();
  if (root == nullptr) Refuse(KestrelException::kMissingElement, kNoRoot);
  if (IsEmpty(root->getTagName())) Refuse(KestrelException::kMissingElement, kEmptyRootTag);
  if (parser_->getErrorCount() != 0 || text.HasNulCharacter())
    Refuse(KestrelException::kInvalidDocument, kInvalid);
  arena_.LiftQuota();
}

ParsedDocument::ParsedDocument(std::unique_ptr<Impl> impl) : impl_(std::move(impl)) {}

ParsedDocument::~ParsedDocument() = default;

xercesc::DOMDocument* ParsedDocument::GetDocument() const {
  return impl_->GetDocument();
}

xercesc::DOMElement* ParsedDocument::GetRoot() const {
  return impl_->GetDocument()->getDocumentElement();
}

size_t ParsedDocument::GetMemoryBytes() const {
  return impl_->GetMemoryBytes();
}

std::unique_ptr<ParsedDocument> ReadDocument(std::istream& in, const DocumentLimits& limits) {
  RequireParser();
  StreamBlocks text;
  switch (text.Read(in, limits.maxInputBytes)) {
    case StreamBlocks::Outcome::kComplete:
      break;
    case StreamBlocks::Outcome::kFailed:
      Fail(KestrelException::kFile, kUnreadable);
    case StreamBlocks::Outcome::kTooLarge:
      Fail(KestrelException::kInvalidDocument, kInvalid);
  }
  std::unique_ptr<ParsedDocument::Impl> impl(new ParsedDocument::Impl(text.GetSize(), limits));
  impl->Parse(text, limits);
  return std::unique_ptr<ParsedDocument>(new ParsedDocument(std::move(impl)));
}

std::unique_ptr<ParsedDocument> ReadDocument(std::istream& in) {
  return ReadDocument(in, DocumentLimits());
}

bool IsWithoutRoot(const KestrelException& fault) {
  return fault.GetErrorCode() == KestrelException::kMissingElement && fault.GetErrorMessage() == kNoRoot;
}

}  // namespace MCKestrel_800
