// Hostile documents are refused in little time. HostileDocumentsTest_posix.cpp also watches memory, files and
// connections.

#include <gtest/gtest.h>

#include <ctime>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/translate/DocumentReader.h"
#include "tests/support/ExpectFault.h"
#include "tests/support/HostileDocuments.h"
#include "tests/support/TempFolder.h"

namespace {

using kestrel_tests::Bombs;
using kestrel_tests::ExpectFault;
using kestrel_tests::HostileDocument;
using kestrel_tests::OutsideReferences;
using kestrel_tests::Repeat;
using kestrel_tests::TempFolder;
using kestrel_tests::UnusedReferences;
using kestrel_tests::WithSubset;
using MCKestrel_800::ReadDocument;

#if defined(__SANITIZE_ADDRESS__)
constexpr bool kSanitized = true;
#else
constexpr bool kSanitized = false;
#endif

void Read(const std::string& text) {
  std::istringstream in(text);
  ReadDocument(in);
}

void ExpectRefused(const HostileDocument& document) {
  ExpectFault([&document] { Read(document.text); }, 6, "Invalid XML file!!", document.why);
}

TEST(HostileDocuments, BombsAreRefusedInLittleTime) {
  // Processor time, whatever else the machine does; half a second is usual.
  const double allowed = kSanitized ? 60.0 : 5.0;
  for (const HostileDocument& document : Bombs()) {
    const std::clock_t start = std::clock();
    ExpectRefused(document);
    const double taken = static_cast<double>(std::clock() - start) / CLOCKS_PER_SEC;
    EXPECT_LT(taken, allowed) << document.why;
  }
}

TEST(HostileDocuments, RefusalTellsThePlace) {
  try {
    Read("<PMML>\n" + Repeat("<a>\n", 600));
    FAIL() << "nothing was thrown";
  } catch (const MCKestrel_800::KestrelException& fault) {
    EXPECT_EQ(fault.GetLine(), 513u);
  }
}

// The parser takes such a model apart in a destructor that asks for memory, with the quota used up or not.
TEST(HostileDocuments, HugeContentModelsAreSurvived) {
  for (size_t parts = 100000; parts <= 400000; parts += 60000) {
    const std::string text = WithSubset("<!ELEMENT a (b" + Repeat(",b", parts) + ")>", "<PMML/>");
    try {
      Read(text);
    } catch (const MCKestrel_800::KestrelException& fault) {
      EXPECT_EQ(fault.GetErrorCode(), 6);
    }
  }
}

// What large but honest documents hold stays within the limits.
TEST(HostileDocuments, HonestDocumentsAreRead) {
  const HostileDocument honest[] = {
      {"512 elements inside one another", Repeat("<a>", 512) + Repeat("</a>", 512)},
      {"256 attributes", kestrel_tests::NumberedAttributes(256)},
      {"4,096 names", kestrel_tests::NumberedElements(4095)},
      {"200,000 character references", "<PMML>" + Repeat("&amp;&#65;", 100000) + "</PMML>"},
      {"2,000 uses of a small entity",
       WithSubset("<!ENTITY x \"text\">", "<PMML>" + Repeat("<a>&x;</a>", 2000) + "</PMML>")},
      {"an element declared 100,000 times", WithSubset(Repeat("<!ELEMENT a (b,(c|d)*)>", 100000), "<PMML/>")},
      {"300,000 empty elements", "<PMML>" + Repeat("<a/>", 300000) + "</PMML>"},
      {"an attribute of 20,000,000 letters", "<PMML a=\"" + std::string(20000000, 'x') + "\"/>"},
      {"a text of 20,000,000 letters", "<PMML>" + std::string(20000000, 'x') + "</PMML>"},
      {"a comment of 20,000,000 letters", "<PMML><!--" + std::string(20000000, 'x') + "--></PMML>"},
      {"a public document type", "<!DOCTYPE PMML PUBLIC \"PMML 2.0\" \"http://127.0.0.1/pmml.dtd\"><PMML/>"},
      {"a default attribute", WithSubset("<!ATTLIST PMML version CDATA \"2.0\">", "<PMML/>")},
  };
  for (const HostileDocument& document : honest)
    EXPECT_NO_THROW(Read(document.text)) << document.why;
}

/// A file by its path, by its address and by its name, as parsers may take them.
std::vector<std::string> TargetsIn(const TempFolder& folder) {
  const std::string path = folder.Write("secret", "<!ENTITY z 'secret'>");
  const std::string generic = folder.GetPath().generic_u8string() + "/secret";
  return {path,     "file://" + generic, "file:///" + generic, "file://localhost/" + generic,
          "secret", "./secret"};
}

TEST(HostileDocuments, UsedReferencesAreRefused) {
  const TempFolder folder;
  for (const std::string& target : TargetsIn(folder)) {
    for (const HostileDocument& document : OutsideReferences(target))
      ExpectRefused(document);
  }
}

TEST(HostileDocuments, UnusedReferencesAreIgnored) {
  const TempFolder folder;
  for (const std::string& target : TargetsIn(folder)) {
    for (const HostileDocument& document : UnusedReferences(target))
      EXPECT_NO_THROW(Read(document.text)) << document.why;
  }
}

}  // namespace
