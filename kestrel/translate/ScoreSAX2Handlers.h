// Scans a document for one element without building its tree.

#ifndef KESTREL_TRANSLATE_SCORESAX2HANDLERS_H
#define KESTREL_TRANSLATE_SCORESAX2HANDLERS_H

#include <string>
#include <xercesc/framework/XMLFormatter.hpp>
#include <xercesc/sax2/DefaultHandler.hpp>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// Handlers for a SAX2 reader that stop the parse, by throwing a HandlerState, as soon as the answer is
/// known. An element matches by its name without prefix, or by its whole name. When the parser reports
/// several things, the first one decides; a warning that precedes an error gives kWarning.
class KESTREL_API ScoreSAX2Handlers : public xercesc::DefaultHandler, private xercesc::XMLFormatTarget {
 public:
  enum HandlerState : int {
    kFound = 0,     ///< the element is there
    kWarning = 1,   ///< the parser warned before it was found
    kError = 2,     ///< the document is faulty before it was found
    kNotFound = 4,  ///< "PMML" ended without it
  };

  explicit ScoreSAX2Handlers(const std::string& wantedTag);
  ~ScoreSAX2Handlers() override;

  void startElement(const XMLCh* const uri, const XMLCh* const localName, const XMLCh* const qualifiedName,
                    const xercesc::Attributes& attributes) override;
  void endElement(const XMLCh* const uri, const XMLCh* const localName,
                  const XMLCh* const qualifiedName) override;
  void warning(const xercesc::SAXParseException& exception) override;
  void error(const xercesc::SAXParseException& exception) override;
  void fatalError(const xercesc::SAXParseException& exception) override;

 private:
  // A scan writes nothing.
  void writeChars(const XMLByte* const bytes, const XMLSize_t count,
                  xercesc::XMLFormatter* const formatter) override;

  std::string wantedTag_;
  std::u16string wantedTag16_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_SCORESAX2HANDLERS_H
