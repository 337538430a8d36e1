// The one function through which every load of a document goes, and the parsed document that it gives.

#ifndef KESTREL_TRANSLATE_DOCUMENTREADER_H
#define KESTREL_TRANSLATE_DOCUMENTREADER_H

#include <xercesc/util/XercesDefs.hpp>

#include <cstddef>
#include <iosfwd>
#include <memory>

#include "kestrel/platform/Export.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMDocument;
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

class KestrelException;

/// What a document may ask for before it is refused. The defaults are far above what honest documents need.
struct DocumentLimits {
  size_t maxInputBytes = size_t{256} << 20;   ///< of the document itself
  size_t baseMemoryBytes = size_t{64} << 20;  ///< memory that every document may use
  size_t memoryPerInputByte = 100;            ///< and this much for each of its bytes
  size_t baseAllocations = 1000000;           ///< requests for memory that every document may make
  size_t allocationsPerInputByte = 2;         ///< and so many for each of its bytes
  size_t reserveBytes = size_t{16} << 20;     ///< granted beyond that until the parser can be stopped safely
  size_t reserveAllocations = 100000;         ///< the same in requests
  size_t maxDepth = 512;                      ///< elements inside one another
  size_t maxAttributes = 256;                 ///< of one element
  size_t maxNames = 4096;                     ///< distinct element and attribute names
};

/// A document's tree together with the memory that it lives in. Destroying it frees everything at once, so no
/// node and no wide text may be kept longer. Text made of whitespace alone has no node where it stands beside
/// an element; it is kept where it is all that an element holds. Comments and entity references have no
/// nodes, so an element's text is in one piece but for CDATA sections.
class KESTREL_API ParsedDocument {
 public:
  ~ParsedDocument();
  ParsedDocument(const ParsedDocument&) = delete;
  ParsedDocument& operator=(const ParsedDocument&) = delete;

  /// The root element; never null, its tag never empty.
  xercesc::DOMElement* GetRoot() const;
  xercesc::DOMDocument* GetDocument() const;
  /// Bytes of memory that the tree was given, for tests and benchmarks.
  size_t GetMemoryBytes() const;

 private:
  class Impl;
  friend KESTREL_API std::unique_ptr<ParsedDocument> ReadDocument(std::istream& in,
                                                                  const DocumentLimits& limits);
  explicit ParsedDocument(std::unique_ptr<Impl> impl);
  std::unique_ptr<Impl> impl_;
};

/// Reads a whole document from the stream and parses it. Opens no file and no connection whatever the
/// document names. in  left at its end with its exception mask as it was; need not be seekable. Errors:
/// KestrelException, with line and column for a malformed document:
///   code 2 "Could not read model file"  the stream failed;
///   code 6 "Invalid XML file!!"         malformed, larger or asking for more than the limits allow, or using
///                                       something that lies outside it;
///   code 4                              nothing in it that could be a document, or no root element;
///   code 5                              the parser could not be initialised, in this call or an earlier one.
/// Threads: any number of calls at once, the process's first ones included.
KESTREL_API std::unique_ptr<ParsedDocument> ReadDocument(std::istream& in, const DocumentLimits& limits);
KESTREL_API std::unique_ptr<ParsedDocument> ReadDocument(std::istream& in);

/// Whether ReadDocument threw this because the document has no root element, which loaders word differently.
KESTREL_API bool IsWithoutRoot(const KestrelException& fault);

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_DOCUMENTREADER_H
