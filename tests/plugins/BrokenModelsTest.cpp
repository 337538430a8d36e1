// Documents of regression models broken in every small way, from bytes to a scored case: loading one gives a
// model that scores, or a KestrelException with a code, a text and the place, never anything else.

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <memory>
#include <set>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NarrowText.h"
#include "kestrel/model/ModelFactory.h"
#include "tests/plugins/BrokenModel.h"
#include "tests/support/XmlMutants.h"

namespace kestrel_tests {
namespace {

using kestrel_test::Mutant;
using kestrel_test::XmlMap;
using namespace MCKestrel_800;

/// Whether a fault can have no place: nothing in the document is to blame.
bool HasNoPlace(const Outcome& outcome) {
  return outcome.text == "\nInput XML is not parseable into a document";
}

void ExpectOrderly(const Outcome& outcome, const std::string& document, const std::string& why) {
  if (outcome.code == kLoaded) return;
  EXPECT_TRUE(outcome.code >= 1 && outcome.code <= 12 && outcome.code != KestrelException::kReserved)
      << why << ": " << outcome.code << ' ' << outcome.text;
  EXPECT_FALSE(outcome.text.empty()) << why;
  if (HasNoPlace(outcome)) return;
  const auto lines = static_cast<unsigned>(1 + std::count(document.begin(), document.end(), '\n'));
  EXPECT_TRUE(outcome.line >= 1 && outcome.line <= lines) << why << ": line " << outcome.line;
  EXPECT_GE(outcome.column, 1u) << why;
}

/// Each attribute set to each of the values in turn.
std::vector<Mutant> WithAttributesSetTo(const std::string& text, const std::vector<std::string>& values) {
  std::vector<Mutant> mutants;
  const XmlMap map(text);
  for (const XmlMap::Attribute& attribute : map.Attributes()) {
    for (const std::string& value : values) {
      std::string changed = text;
      changed.replace(attribute.valueStart, attribute.valueEnd - attribute.valueStart, value);
      mutants.push_back(
          {attribute.name + " at byte " + std::to_string(attribute.start) + " set to " + value, changed});
    }
  }
  return mutants;
}

class BrokenModels : public testing::TestWithParam<Sample> {
 protected:
  std::string Text() const { return DocumentText(GetParam().path); }

  /// Loads every mutant and scores with those that load; returns how often each code came out.
  std::map<int, size_t> TryAll(const std::vector<Mutant>& mutants) const {
    std::map<int, size_t> codes;
    for (const Mutant& mutant : mutants) {
      const Outcome outcome = LoadAndScore(mutant.document, GetParam().cells, mutant.why);
      ExpectOrderly(outcome, mutant.document, mutant.why);
      ++codes[outcome.code];
    }
    return codes;
  }
};

TEST_P(BrokenModels, ScoreBeforeTheyAreBroken) {
  const Outcome outcome = LoadAndScore(Text(), GetParam().cells, GetParam().name);
  EXPECT_EQ(outcome.code, kLoaded) << outcome.line << ": " << outcome.text;
  EXPECT_EQ(outcome.text, GetParam().prediction);
}

TEST_P(BrokenModels, CutOffAreNoDocuments) {
  const std::vector<Mutant> mutants = kestrel_test::Truncated(Text(), 50);
  ASSERT_GT(mutants.size(), 30u);
  for (const auto& [code, count] : TryAll(mutants)) {
    EXPECT_TRUE(code == 4 || code == 6) << code << " came " << count << " times";
  }
}

TEST_P(BrokenModels, WithBrokenAttributesLoadOrAreRefused) {
  const std::vector<Mutant> mutants = kestrel_test::WithBrokenAttributes(Text(), 1);
  ASSERT_GT(mutants.size(), 120u);
  const std::map<int, size_t> codes = TryAll(mutants);
  for (const int expected : {kLoaded, 3, 4, 5, 6, 8, 11, 12})
    EXPECT_TRUE(codes.count(expected)) << expected;
}

TEST_P(BrokenModels, WithNumbersInEveryAttributeLoadOrAreRefused) {
  const std::vector<Mutant> mutants = WithAttributesSetTo(Text(), {"6", "-1e308", "1,5", "1e999", " 2 "});
  ASSERT_GT(mutants.size(), 200u);
  const std::map<int, size_t> codes = TryAll(mutants);
  for (const int expected : {kLoaded, 3, 5, 6, 8, 11, 12})
    EXPECT_TRUE(codes.count(expected)) << expected;
}

TEST_P(BrokenModels, WithBrokenElementsLoadOrAreRefused) {
  const std::vector<Mutant> mutants = kestrel_test::WithBrokenElements(Text(), 1);
  ASSERT_GT(mutants.size(), 70u);
  const std::map<int, size_t> codes = TryAll(mutants);
  for (const int expected : {kLoaded, 1, 4, 6, 8, 12})
    EXPECT_TRUE(codes.count(expected)) << expected;
}

TEST_P(BrokenModels, WithTwoElementsExchangedLoadOrAreRefused) {
  const std::string text = Text();
  const XmlMap map(text);
  std::vector<Mutant> mutants;
  for (size_t i = 1; i < map.Elements().size(); ++i) {
    const XmlMap::Element& first = map.Elements()[i];
    const XmlMap::Element& second = map.Elements()[(i * 7) % map.Elements().size()];
    if (second.start < first.end) continue;
    mutants.push_back({first.name + " at byte " + std::to_string(first.start) + " exchanged with " +
                           second.name + " at byte " + std::to_string(second.start),
                       text.substr(0, first.start) + text.substr(second.start, second.end - second.start) +
                           text.substr(first.end, second.start - first.end) +
                           text.substr(first.start, first.end - first.start) + text.substr(second.end)});
  }
  ASSERT_GT(mutants.size(), 3u);
  TryAll(mutants);
}

INSTANTIATE_TEST_SUITE_P(Samples, BrokenModels, testing::ValuesIn(Samples()),
                         [](const auto& sample) { return std::string(sample.param.name); });

TEST(BrokenModel, OfEachKindIsAmongThem) {
  std::set<int> codes;
  size_t count = 0;
  for (const Sample& sample : Samples()) {
    const std::string text = DocumentText(sample.path);
    for (const auto& mutants :
         {kestrel_test::Truncated(text, 50), kestrel_test::WithBrokenAttributes(text, 1),
          kestrel_test::WithBrokenElements(text, 1)}) {
      count += mutants.size();
      for (const Mutant& mutant : mutants)
        codes.insert(LoadAndScore(mutant.document, sample.cells, mutant.why).code);
    }
  }
  EXPECT_GT(count, 900u);
  EXPECT_EQ(codes, (std::set<int>{kLoaded, 1, 3, 4, 5, 6, 7, 8, 11, 12}));
}

constexpr char kUnsupportedModel[] = "Unsupported Model found!";

struct RootRow {
  const char* why;
  const char* root;
  int code;
  const char* text;
};

constexpr RootRow kRoots[] = {
    {"lower case", "pmml", 5, kUnsupportedModel},
    {"a web page", "html", 5, kUnsupportedModel},
    {"a prefix", "p:PMML xmlns:p=\"http://www.dmg.org/PMML-4_4\"", 5, kUnsupportedModel},
    {"the model itself", "RegressionModel", 5, kUnsupportedModel},
    {"a tree", "Tree", 4, "Node is missing --- TreeModel ---"},
};

struct OlderRow {
  const char* why;
  const char* document;
  const char* text;
  unsigned line;
};

constexpr OlderRow kOlder[] = {
    {"a tree", "<?xml version='1.0'?>\n<Tree><Node/></Tree>",
     "<Tree>: models of the older document format are not supported!", 2},
    {"a tree in the older format", "<vexa-ml>\n<dictionary/><TreeModel/></vexa-ml>",
     "<vexa-ml>: models of the older document format are not supported!", 1},
    {"a regression in the older format", "<vexa-ml>\n<RegressionModel/></vexa-ml>",
     "<vexa-ml>: models of the older document format are not supported!", 1},
    {"the older format's own regression", "<vexa-ml>\n<regression-model/></vexa-ml>",
     "Doesn't Support GeneralRegressionModel  Model: No Required dll or lib available!", 2},
    {"a lattice", "<AssocLattice>\n<TreeModel/></AssocLattice>",
     "<AssocLattice>: models of the older document format are not supported!", 1},
    {"a sequence", "<SequentialAssociationLattice>\n<RegressionModel/></SequentialAssociationLattice>",
     "<SequentialAssociationLattice>: models of the older document format are not supported!", 1},
    {"a lattice of another kind", "<AssocLattice>\n<AssociationModelLattice/></AssocLattice>",
     "Doesn't Support AssociationModel  Model: No Required dll or lib available!", 2},
    {"a lattice without a model", "<AssocLattice/>", kUnsupportedModel, 1},
};

TEST(BrokenModel, OlderDocumentsAreRefused) {
  for (const OlderRow& row : kOlder) {
    std::istringstream in(row.document);
    try {
      const std::unique_ptr<ScoreModel> model(ModelFactory::MakeModelFromXML(
          in, {"TreeModel", "RegressionModel", "AssociationModelLattice"}, std::string()));
      ADD_FAILURE() << row.why;
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetErrorCode(), 5) << row.why;
      EXPECT_EQ(fault.GetErrorMessage(), row.text) << row.why;
      EXPECT_EQ(fault.GetLine(), row.line) << row.why;
    }
  }
}

// The root's name alone does no harm.
TEST(BrokenModel, AnOlderRootMayHoldADataDictionary) {
  for (const char* root : {"vexa-ml", "AssocLattice", "SequentialAssociationLattice"}) {
    std::string document = Replaced(DocumentText(kOrders), "<PMML", std::string("<") + root);
    document = Replaced(document, "</PMML>", std::string("</") + root + ">");
    const Sample orders = Samples().front();
    const Outcome outcome = LoadAndScore(document, orders.cells, root);
    EXPECT_EQ(outcome.code, kLoaded) << root << ": " << outcome.text;
    EXPECT_EQ(outcome.text, orders.prediction) << root;
  }
}

TEST(BrokenModel, OtherRootsAreRefused) {
  for (const RootRow& row : kRoots) {
    const std::string tag = row.root;
    std::string document = Replaced(DocumentText(kOrders), "<PMML", "<" + tag);
    document = Replaced(document, "</PMML>", "</" + tag.substr(0, tag.find(' ')) + ">");
    const Outcome outcome = LoadAndScore(document, {}, row.why);
    EXPECT_EQ(outcome.code, row.code) << row.why;
    EXPECT_EQ(outcome.text, row.text) << row.why;
    EXPECT_EQ(outcome.line, 2u) << row.why;
  }
}

TEST(BrokenModel, WithoutItsLibraryTellsWhy) {
  const std::string document = Replaced(DocumentText(kOrders), "<RegressionModel", "<NoSuchModel");
  std::istringstream in(Replaced(document, "</RegressionModel>", "</NoSuchModel>"));
  try {
    ModelFactory::MakeModelFromXML(in, {"NoSuchModel"}, std::string());
    ADD_FAILURE();
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetErrorCode(), 5);
    EXPECT_EQ(fault.GetErrorMessage(),
              "Doesn't Support NoSuchModel  Model: No Required dll or lib available!");
    EXPECT_EQ(fault.GetLine(), 37u);
  }
  EXPECT_NE(ModelFactory::GetLastLoadError().find("NoSuchModel800r"), std::string::npos)
      << ModelFactory::GetLastLoadError();
}

/// A model whose prediction is 3 for the town of Cologne and 1 for every other; `town` in the document's own
/// bytes.
std::string TownModel(const std::string& encoding, const std::string& town) {
  return "<?xml version=\"1.0\"" + (encoding.empty() ? "" : " encoding=\"" + encoding + "\"") +
         "?>\n<PMML version=\"4.4\"><DataDictionary numberOfFields=\"1\"><DataField name=\"town\" "
         "optype=\"categorical\" dataType=\"string\"><Value value=\"" +
         town +
         "\"/><Value value=\"Bonn\"/></DataField></DataDictionary><RegressionModel "
         "functionName=\"regression\">"
         "<MiningSchema><MiningField name=\"town\"/></MiningSchema><RegressionTable intercept=\"1\">"
         "<CategoricalPredictor name=\"town\" value=\"" +
         town + "\" coefficient=\"2\"/></RegressionTable></RegressionModel></PMML>";
}

/// The bytes of a UTF-8 text in UTF-16, low byte first unless `bigEndian`.
std::string Utf16(const std::string& text, bool bigEndian) {
  std::string bytes;
  for (const char16_t unit : u"\uFEFF" + MCXML_800::NarrowToUtf16(text)) {
    const char low = static_cast<char>(unit & 0xFF);
    const char high = static_cast<char>(unit >> 8);
    bytes += bigEndian ? high : low;
    bytes += bigEndian ? low : high;
  }
  return bytes;
}

constexpr char kNoRoot[] = "\nInvalid XML document or no dtd file avaible in current directory";

struct EncodingRow {
  const char* why;
  std::string document;
  int code;
};

/// The parser decodes a document in large blocks: what it cannot decode in the first one leaves no root
/// element (code 4), what comes later leaves a document that is not well-formed (code 6).
std::vector<EncodingRow> EncodingRows() {
  const std::string utf8 = "K\xC3\xB6ln";
  const std::string latin1 = "K\xF6ln";
  return {
      {"UTF-8", TownModel("UTF-8", utf8), kLoaded},
      {"UTF-8 with its mark", "\xEF\xBB\xBF" + TownModel("UTF-8", utf8), kLoaded},
      {"no encoding", TownModel("", utf8), kLoaded},
      {"ISO 8859-1", TownModel("ISO-8859-1", latin1), kLoaded},
      {"Windows 1252", TownModel("windows-1252", latin1), kLoaded},
      {"a character reference", TownModel("US-ASCII", "K&#246;ln"), kLoaded},
      {"UTF-16, low byte first", Utf16(TownModel("UTF-16", utf8), false), kLoaded},
      {"UTF-16, high byte first", Utf16(TownModel("UTF-16", utf8), true), kLoaded},
      {"ISO 8859-1 that says UTF-8", TownModel("UTF-8", latin1), 4},
      {"ISO 8859-1 that says nothing", TownModel("", latin1), 4},
      {"UTF-8 that says US-ASCII", TownModel("US-ASCII", utf8), 6},
      {"UTF-8 that says UTF-16", TownModel("UTF-16", utf8), kLoaded},
      {"UTF-16 that says UTF-8", Utf16(TownModel("UTF-8", utf8), false), 4},
      {"ISO 8859-1 that says UTF-8, far down the document",
       Replaced(TownModel("UTF-8", "Koeln"), "<Value",
                "<!--" + std::string(200000, ' ') + latin1 + "--><Value"),
       6},
      {"an unknown encoding", TownModel("KLINGON", utf8), 4},
      {"half a character", TownModel("UTF-8", "K\xC3"), 4},
  };
}

TEST(BrokenModel, EncodingsAreReadOrRefused) {
  for (const EncodingRow& row : EncodingRows()) {
    const Outcome outcome = LoadAndScore(row.document, {{"town", "K\xC3\xB6ln"}}, row.why);
    EXPECT_EQ(outcome.code, row.code) << row.why << ": " << outcome.text;
    const char* refusal = row.code == 4 ? kNoRoot : "Invalid XML file!!";
    EXPECT_EQ(outcome.text, row.code == kLoaded ? "3" : refusal) << row.why;
  }
}

}  // namespace
}  // namespace kestrel_tests
