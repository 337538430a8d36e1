// Documents broken in every small way: reading one gives its dictionary or a KestrelException with a code and
// a text, never anything else.

#include <gtest/gtest.h>

#include <exception>
#include <fstream>
#include <map>
#include <memory>
#include <set>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NarrowText.h"
#include "tests/support/DictionaryText.h"
#include "tests/support/XmlMutants.h"

namespace {

using kestrel_test::DictionaryOf;
using kestrel_test::DictionaryTranslator;
using kestrel_test::Mutant;
using kestrel_test::ReadTree;
using namespace MCKestrel_800;

constexpr int kRead = 0;      // the document was read
constexpr int kEscaped = -1;  // something other than our exception came out

struct Outcome {
  int code = kRead;
  std::string text;
};

/// Reads a document's dictionary as a plug-in would; a root without one gives the reader nothing.
Outcome Read(const std::string& document) {
  try {
    const auto tree = ReadTree(document);
    DictionaryTranslator translator;
    const std::unique_ptr<ScoreDictionary> dictionary(
        translator.ParseDictionary(FirstChild(tree->GetRoot(), u"DataDictionary"), false));
    if (dictionary == nullptr || dictionary->Size() == 0) return {kEscaped, "an empty dictionary"};
    return {kRead, ""};
  } catch (const KestrelException& fault) {
    return {fault.GetErrorCode(), fault.GetErrorMessage()};
  } catch (const std::exception& other) {
    return {kEscaped, other.what()};
  } catch (...) {
    return {kEscaped, "an exception of an unknown kind"};
  }
}

bool IsOrderly(const Outcome& outcome) {
  if (outcome.code == kRead) return true;
  return outcome.code >= 1 && outcome.code <= 12 && !outcome.text.empty();
}

std::string DocumentText(const std::string& name) {
  std::ifstream in(std::string(KESTREL_SOURCE_DIR) + "/tests/data/documents/" + name, std::ios::binary);
  std::ostringstream text;
  text << in.rdbuf();
  return text.str();
}

struct Sample {
  const char* name;
  size_t step;  ///< every how many-th element and attribute is broken: all of the short documents
};

void PrintTo(const Sample& sample, std::ostream* out) {
  *out << sample.name;
}

constexpr Sample kSamples[] = {{"heating_small.xml", 1},
                               {"heating_fields.xml", 1},
                               {"heating_extensions.xml", 1},
                               {"heating_wide.xml", 9}};

class BrokenDocuments : public testing::TestWithParam<Sample> {
 protected:
  /// Reads every mutant; returns how often each code came out.
  std::map<int, size_t> ReadAll(const std::vector<Mutant>& mutants) {
    std::map<int, size_t> codes;
    for (const Mutant& mutant : mutants) {
      const Outcome outcome = Read(mutant.document);
      EXPECT_TRUE(IsOrderly(outcome)) << mutant.why << ": " << outcome.code << ' ' << outcome.text;
      ++codes[outcome.code];
    }
    return codes;
  }
};

TEST_P(BrokenDocuments, AreGoodBeforeTheyAreBroken) {
  EXPECT_EQ(Read(DocumentText(GetParam().name)).code, kRead);
}

TEST_P(BrokenDocuments, CutOffAreNoDocuments) {
  const std::vector<Mutant> mutants = kestrel_test::Truncated(DocumentText(GetParam().name), 50);
  ASSERT_GT(mutants.size(), 20u);
  for (const auto& [code, count] : ReadAll(mutants)) {
    EXPECT_TRUE(code == 4 || code == 6) << code << " came " << count << " times";
  }
}

TEST_P(BrokenDocuments, WithBrokenAttributesAreReadOrRefused) {
  const std::vector<Mutant> mutants =
      kestrel_test::WithBrokenAttributes(DocumentText(GetParam().name), GetParam().step);
  ASSERT_GT(mutants.size(), 50u);
  const std::map<int, size_t> codes = ReadAll(mutants);
  for (const int expected : {4, 11})
    EXPECT_TRUE(codes.count(expected)) << expected;
}

TEST_P(BrokenDocuments, WithBrokenElementsAreReadOrRefused) {
  const std::vector<Mutant> mutants =
      kestrel_test::WithBrokenElements(DocumentText(GetParam().name), GetParam().step);
  ASSERT_GT(mutants.size(), 50u);
  const std::map<int, size_t> codes = ReadAll(mutants);
  for (const int expected : {1, 6})
    EXPECT_TRUE(codes.count(expected)) << expected;
}

INSTANTIATE_TEST_SUITE_P(Samples, BrokenDocuments, testing::ValuesIn(kSamples), [](const auto& sample) {
  std::string name = sample.param.name;
  return name.substr(0, name.find('.'));
});

TEST(BrokenDocument, OfEachKindIsAmongThem) {
  std::set<int> codes;
  size_t count = 0;
  for (const Sample& sample : kSamples) {
    const std::string text = DocumentText(sample.name);
    for (const auto& mutants :
         {kestrel_test::Truncated(text, 50), kestrel_test::WithBrokenAttributes(text, 3),
          kestrel_test::WithBrokenElements(text, 3)}) {
      count += mutants.size();
      for (const Mutant& mutant : mutants)
        codes.insert(Read(mutant.document).code);
    }
  }
  EXPECT_GT(count, 150u);
  EXPECT_EQ(codes, (std::set<int>{0, 1, 3, 4, 5, 6, 7, 8, 11, 12}));
}

/// The text in UTF-16 with the bytes of each character in the given order.
std::string Utf16(const std::string& text, bool bigEndian, bool byteOrderMark) {
  std::u16string wide = MCXML_800::NarrowToUtf16(text);
  if (byteOrderMark) wide.insert(wide.begin(), u'\uFEFF');
  std::string bytes;
  for (const char16_t unit : wide) {
    const char high = static_cast<char>(unit >> 8);
    const char low = static_cast<char>(unit & 0xFF);
    bytes += bigEndian ? high : low;
    bytes += bigEndian ? low : high;
  }
  return bytes;
}

std::string Replaced(std::string text, const std::string& what, const std::string& with) {
  const size_t at = text.find(what);
  if (at == std::string::npos) return text;
  return text.replace(at, what.size(), with);
}

/// A small document with one text that is not ASCII; `declaration` stands in front of it.
std::string Town(const std::string& declaration, const std::string& town) {
  return declaration +
         "<PMML version=\"4.4\"><DataDictionary numberOfFields=\"1\"><DataField name=\"town\" "
         "optype=\"categorical\" "
         "dataType=\"string\"><Value value=\"" +
         town + "\"/></DataField></DataDictionary></PMML>";
}

std::string Declared(const std::string& encoding) {
  return "<?xml version=\"1.0\" encoding=\"" + encoding + "\"?>";
}

struct BytesRow {
  const char* why;
  std::string document;
  int code;  ///< what must come out; kAnyFault where only the refusal matters
};

constexpr int kAnyFault = -2;

std::vector<BytesRow> ByteRows() {
  const std::string utf8 = Town(Declared("UTF-8"), "K\xC3\xB6ln");
  const std::string utf16 = Town(Declared("UTF-16"), "K\xC3\xB6ln");
  const std::string cut = Utf16(utf16, false, true);
  const std::string bom = "\xEF\xBB\xBF";
  const std::string nul(1, '\0');
  return {
      {"UTF-8", utf8, kRead},
      {"UTF-8 without a declaration", Town("", "K\xC3\xB6ln"), kRead},
      {"UTF-8 with a byte order mark", bom + utf8, kRead},
      {"a byte order mark alone", bom, 4},
      {"two byte order marks", bom + bom + utf8, kAnyFault},
      {"ISO 8859-1", Town(Declared("ISO-8859-1"), "K\xF6ln"), kRead},
      {"Windows 1252", Town(Declared("windows-1252"), "K\xF6ln \x80"), kRead},
      {"declared UTF-8 but ISO 8859-1", Town(Declared("UTF-8"), "K\xF6ln"), kAnyFault},
      {"not declared and ISO 8859-1", Town("", "K\xF6ln"), kAnyFault},
      {"an overlong form", Town(Declared("UTF-8"), "\xC0\xAF"), kAnyFault},
      {"half a surrogate pair in UTF-8", Town(Declared("UTF-8"), "\xED\xA0\x80"), kAnyFault},
      {"a cut character", Town(Declared("UTF-8"), "K\xC3"), kAnyFault},
      {"declared US-ASCII but UTF-8", Town(Declared("US-ASCII"), "K\xC3\xB6ln"), kAnyFault},
      {"an unknown encoding", Town(Declared("KLINGON"), "Koeln"), kAnyFault},
      {"an encoding without a name", Town(Declared(""), "Koeln"), kAnyFault},
      {"an encoding with a very long name", Town(Declared(std::string(100000, 'x')), "Koeln"), kAnyFault},
      {"UTF-16, little end first", Utf16(utf16, false, true), kRead},
      {"UTF-16, big end first", Utf16(utf16, true, true), kRead},
      {"UTF-16 without its mark", Utf16(utf16, false, false), kRead},
      {"UTF-16 without mark and declaration", Utf16(Town("", "Koeln"), false, false), kAnyFault},
      {"UTF-16 cut in the middle", cut.substr(0, cut.size() / 2 / 2 * 2), kAnyFault},
      {"UTF-16 cut inside a character", cut.substr(0, cut.size() / 2 / 2 * 2 + 1), kAnyFault},
      {"a UTF-16 mark alone", "\xFF\xFE", kAnyFault},
      {"UTF-16 declared UTF-8", Utf16(utf8, false, true), kAnyFault},
      {"nothing", "", 4},
      {"blanks", "   \n\t ", kAnyFault},
      {"a NUL alone", nul, kAnyFault},
      {"many NULs", std::string(4096, '\0'), kAnyFault},
      {"a NUL in a value", Town("", "Ko" + nul + "eln"), kAnyFault},
      {"a NUL in front", nul + utf8, kAnyFault},
      {"a NUL between elements", Replaced(utf8, "<DataField", nul + "<DataField"), kAnyFault},
      {"a control character", Town("", "Ko\x01ln"), kAnyFault},
      {"a reference to a control character", Town("", "Ko&#1;ln"), kAnyFault},
      {"a reference to a tab", Town("", "Ko&#9;ln"), kRead},
      {"an unknown entity", Town("", "&koeln;"), kAnyFault},
      {"another version of XML", Replaced(utf8, "version=\"1.0\"", "version=\"2.0\""), kAnyFault},
      {"a version of XML that never was", Replaced(utf8, "version=\"1.0\"", "version=\"1.5\""), kAnyFault},
      {"a blank before the declaration", " " + utf8, kAnyFault},
      {"text before the root", "x" + Town("", "Koeln"), kAnyFault},
      {"text after the root", utf8 + "x", 6},
      {"a second root", utf8 + "<PMML/>", 6},
      {"blanks and a comment after the root", utf8 + "\n<!-- end -->\n", kRead},
      {"a declaration alone", Declared("UTF-8"), kAnyFault},
      {"JSON", "{\"PMML\": {}}", kAnyFault},
      {"packed bytes", std::string("PK\x03\x04\x14\x00\x00\x00\x08\x00", 10), kAnyFault},
      {"a root alone", "<PMML/>", 1},
      {"another root without a dictionary", "<html><body/></html>", 1},
      {"another root with a dictionary",
       Replaced(Replaced(Town("", "Koeln"), "PMML", "Other"), "/PMML", "/Other"), kRead},
      {"a dictionary as the root", DictionaryOf(1, "<DataField name='x' optype='continuous'/>"), 1},
      {"an empty dictionary", "<PMML>" + DictionaryOf(0, "") + "</PMML>", 1},
      {"a text instead of fields", "<PMML>" + DictionaryOf(0, "nothing") + "</PMML>", 1},
      {"an attribute given twice", Replaced(utf8, "name=\"town\"", "name=\"town\" name=\"city\""), kAnyFault},
      {"an attribute without quotes", Replaced(utf8, "name=\"town\"", "name=town"), kAnyFault},
      {"an attribute without a value", Replaced(utf8, "name=\"town\"", "name"), kAnyFault},
      {"single quotes", Replaced(utf8, "name=\"town\"", "name='town'"), kRead},
      {"a less-than sign in a value", Town("", "a<b"), kAnyFault},
      {"a namespace prefix", Replaced(utf8, "<DataField", "<p:DataField"), kAnyFault},
      {"a lower-case tag", Replaced(Replaced(utf8, "<DataField", "<datafield"), "</DataField", "</datafield"),
       1},
  };
}

TEST(BrokenDocument, OfTheseBytesIsReadOrRefused) {
  for (const BytesRow& row : ByteRows()) {
    const Outcome outcome = Read(row.document);
    EXPECT_TRUE(IsOrderly(outcome)) << row.why << ": " << outcome.code << ' ' << outcome.text;
    if (row.code == kAnyFault) {
      EXPECT_NE(outcome.code, kRead) << row.why;
    } else {
      EXPECT_EQ(outcome.code, row.code) << row.why << ": " << outcome.text;
    }
  }
}

TEST(BrokenDocument, DeclaringVeryManyFieldsCostsNothing) {
  for (const char* count : {"2147483647", "4294967297", "999999999999999999999999", "-2147483648", "1e9"}) {
    const std::string document =
        Replaced(Town("", "Koeln"), "numberOfFields=\"1\"", std::string("numberOfFields=\"") + count + "\"");
    const Outcome outcome = Read(document);
    EXPECT_TRUE(outcome.code == 12 || outcome.code == 3) << count << ": " << outcome.code;
  }
}

TEST(BrokenDocument, WithVeryDeepExtensionsIsReadOrRefused) {
  for (const size_t depth : {100u, 500u, 600u, 100000u}) {
    std::string extensions;
    for (size_t i = 0; i < depth; ++i)
      extensions += "<Extension name='width' value='1'>";
    for (size_t i = 0; i < depth; ++i)
      extensions += "</Extension>";
    const Outcome outcome = Read(
        "<PMML>" + DictionaryOf(1, "<DataField name='x' optype='continuous'>" + extensions + "</DataField>") +
        "</PMML>");
    EXPECT_EQ(outcome.code, depth <= 500 ? kRead : 6) << depth << ": " << outcome.text;
  }
}

}  // namespace
