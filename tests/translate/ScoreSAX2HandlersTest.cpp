#include "kestrel/translate/ScoreSAX2Handlers.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <xercesc/framework/MemBufInputSource.hpp>
#include <xercesc/sax/SAXParseException.hpp>
#include <xercesc/sax2/SAX2XMLReader.hpp>
#include <xercesc/sax2/XMLReaderFactory.hpp>

#include "kestrel/translate/ParserPlatform.h"
#include "kestrel/translate/XmlText.h"

namespace {

using MCKestrel_800::ScoreSAX2Handlers;
using MCKestrel_800::ToXMLCh;

constexpr int kRanToItsEnd = -1;

// The state that a scan for `tag` ends with.
int Scan(const std::string& tag, const std::string& text, bool nameSpaces) {
  MCKestrel_800::RequireParser();
  const std::unique_ptr<xercesc::SAX2XMLReader> reader(xercesc::XMLReaderFactory::createXMLReader());
  reader->setFeature(xercesc::XMLUni::fgSAX2CoreValidation, false);
  reader->setFeature(xercesc::XMLUni::fgXercesLoadExternalDTD, false);
  reader->setFeature(xercesc::XMLUni::fgXercesDisableDefaultEntityResolution, true);
  reader->setFeature(xercesc::XMLUni::fgSAX2CoreNameSpaces, nameSpaces);
  ScoreSAX2Handlers handlers(tag);
  reader->setContentHandler(&handlers);
  reader->setErrorHandler(&handlers);
  const xercesc::MemBufInputSource source(reinterpret_cast<const XMLByte*>(text.data()), text.size(), "text");
  try {
    reader->parse(source);
  } catch (const ScoreSAX2Handlers::HandlerState& state) {
    return state;
  }
  return kRanToItsEnd;
}

TEST(ScoreSAX2Handlers, StopsAtTheFirstAnswer) {
  const struct {
    const char* why;
    const char* text;
    int state;
  } rows[] = {
      {"there", "<PMML><KNN/></PMML>", 0},
      {"there, and faulty afterwards", "<PMML><KNN/></oops>", 0},
      {"the root", "<KNN/>", 0},
      {"deep", "<PMML><a><b><KNN x='1'>", 0},
      {"not there", "<PMML><a/></PMML>", 4},
      {"another case", "<PMML><knn/></PMML>", 4},
      {"as an attribute", "<PMML KNN='KNN'>KNN</PMML>", 4},
      {"after PMML ended", "<x><PMML></PMML><KNN/></x>", 4},
      {"faulty before", "<PMML><a></b><KNN/></PMML>", 2},
      {"empty", "", 2},
      {"another root without it", "<x/>", kRanToItsEnd},
  };
  for (const auto& row : rows) {
    for (bool nameSpaces : {false, true})
      EXPECT_EQ(Scan("KNN", row.text, nameSpaces), row.state) << row.why;
  }
}

TEST(ScoreSAX2Handlers, PrefixesDoNotHide) {
  const std::string text = "<p:PMML xmlns:p='urn:x'><p:KNN/></p:PMML>";
  EXPECT_EQ(Scan("KNN", text, true), 0);
  EXPECT_EQ(Scan("p:KNN", text, true), 0);
  EXPECT_EQ(Scan("Other", text, true), 4);
}

TEST(ScoreSAX2Handlers, ReportsTheParsersComplaints) {
  MCKestrel_800::RequireParser();
  ScoreSAX2Handlers handlers("x");
  const xercesc::SAXParseException complaint(ToXMLCh(u"m"), ToXMLCh(u""), ToXMLCh(u""), 1, 1);
  const auto stateOf = [](auto call) {
    try {
      call();
    } catch (const ScoreSAX2Handlers::HandlerState& state) {
      return static_cast<int>(state);
    }
    return kRanToItsEnd;
  };
  EXPECT_EQ(stateOf([&] { handlers.warning(complaint); }), 1);
  EXPECT_EQ(stateOf([&] { handlers.error(complaint); }), 2);
  EXPECT_EQ(stateOf([&] { handlers.fatalError(complaint); }), 2);
}

}  // namespace
