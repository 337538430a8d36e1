#include "kestrel/translate/ScoreSAX2Handlers.h"

#include "kestrel/foundation/NarrowText.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {

namespace {

bool NameIs(const XMLCh* localName, const XMLCh* qualifiedName, const char16_t* tag) {
  return Equals(qualifiedName, tag) || (!IsEmpty(localName) && Equals(localName, tag));
}

}  // namespace

ScoreSAX2Handlers::ScoreSAX2Handlers(const std::string& wantedTag)
    : wantedTag_(wantedTag), wantedTag16_(MCXML_800::NarrowToUtf16(wantedTag)) {}

ScoreSAX2Handlers::~ScoreSAX2Handlers() = default;

void ScoreSAX2Handlers::startElement(const XMLCh* const, const XMLCh* const localName,
                                     const XMLCh* const qualifiedName, const xercesc::Attributes&) {
  if (NameIs(localName, qualifiedName, wantedTag16_.c_str())) throw kFound;
}

void ScoreSAX2Handlers::endElement(const XMLCh* const, const XMLCh* const localName,
                                   const XMLCh* const qualifiedName) {
  if (NameIs(localName, qualifiedName, PMMLTagText::XML_ELE_PMML)) throw kNotFound;
}

void ScoreSAX2Handlers::warning(const xercesc::SAXParseException&) {
  throw kWarning;
}

void ScoreSAX2Handlers::error(const xercesc::SAXParseException&) {
  throw kError;
}

void ScoreSAX2Handlers::fatalError(const xercesc::SAXParseException&) {
  throw kError;
}

void ScoreSAX2Handlers::writeChars(const XMLByte* const, const XMLSize_t, xercesc::XMLFormatter* const) {}

}  // namespace MCKestrel_800
