// The tree is the one that the parser would build, and the verdict the one that it would give.

#include <gtest/gtest.h>

#include <string>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/DocumentReader.h"
#include "tests/support/ReadText.h"
#include "tests/support/SameTree.h"

namespace {

using kestrel_tests::ExpectSameTree;
using kestrel_tests::ReadText;
using kestrel_tests::StockTree;

constexpr char kModel[] =
    "<?xml version='1.0' encoding='UTF-8'?>\n<PMML version='4.1' xmlns='http://www.dmg.org/PMML-4_1'>\n"
    " <!-- c --><Header copyright='x'>\n  <Annotation>a b\n</Annotation>\n </Header>\n"
    " <DataDictionary numberOfFields='2'>\n  <DataField name='a' optype='categorical' dataType='string'>\n"
    "   <Value value='1'/>\n   <Value value=' &lt;2&#65; ' displayValue='\xC3\xA4'/>\n  </DataField>\n"
    "  <Array n='3' type='real'>1 2 3</Array> </DataDictionary>\n</PMML>\n";

TEST(DocumentTree, IsTheOneThatTheParserWouldBuild) {
  const char* const documents[] = {
      kModel,
      "<a>text<b>more</b>text<b/><b></b> <c z='1' y='2' x='3' m='4'/>end</a>",
      "<!DOCTYPE a [<!ATTLIST b d CDATA 'default' e CDATA #FIXED 'f'><!ELEMENT a ANY>]><a><b/><b "
      "d='own'/></a>",
      "<!DOCTYPE a [<!ENTITY e '<c x=\"1\">y</c>'>]><a>&e;<b>&e;&e;</b></a>",
      "<a b='\xC3\xA4\xE2\x82\xAC\xF0\x9F\x98\x80'>\xC3\xA4\xF0\x9F\x98\x80</a>",
      "<a><b/></a>",
  };
  for (const std::string text : documents) {
    const auto ours = ReadText(text);
    StockTree stock(text);
    SCOPED_TRACE(text);
    ASSERT_NE(stock.GetRoot(), nullptr);
    ExpectSameTree(ours->GetRoot(), stock.GetRoot());
  }
}

// Every byte of a document set to each of several others: what the parser takes for well-formed is read, all
// else refused.
TEST(DocumentTree, VerdictIsTheParsersForEveryMutant) {
  const std::string model = kModel;
  const std::string replacements = "<>&'\"/ x=!-?;\x01\x80\xFF]";
  size_t read = 0, refused = 0;
  for (size_t at = 0; at < model.size(); ++at) {
    for (const char replacement : replacements) {
      std::string mutant = model;
      if (mutant[at] == replacement) continue;
      mutant[at] = replacement;
      StockTree stock(mutant);
      SCOPED_TRACE(mutant);
      try {
        const auto ours = ReadText(mutant);
        ++read;
        if (stock.GetRoot() == nullptr) {
          ADD_FAILURE() << "read though malformed";
        }
      } catch (const MCKestrel_800::KestrelException& fault) {
        ++refused;
        EXPECT_TRUE(fault.GetErrorCode() == 4 || fault.GetErrorCode() == 6);
        EXPECT_EQ(stock.GetRoot(), nullptr) << "refused though well-formed";
      }
    }
  }
  EXPECT_GT(read, 1000u);
  EXPECT_GT(refused, 1000u);
}

}  // namespace
