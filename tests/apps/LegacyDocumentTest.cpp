// What the program says of documents in the older format, whose dictionary alone it can read.

#include <gtest/gtest.h>

#include <nlohmann/json.hpp>

#include "kestrel/platform/SharedLibrary.h"
#include "tests/apps/KestrelProgram.h"
#include "tests/support/FileText.h"

namespace kestrel_tests {
namespace {

constexpr char kDictionary[] =
    "<dictionary>\n"
    "<variable name='age' storage-type='NUMERIC' measurement-level='CONTINUOUS' label='age in years'>"
    "<missing-values><category value='-1'/><range><category value='900'/><category value='999'/></range>"
    "</missing-values></variable>\n"
    "<variable name='town' storage-type='STRING' measurement-level='NOMINAL'><categories>"
    "<category value='r' display-value='Rome'/><category value='b'/></categories></variable>\n"
    "<variable name='rank' storage-type='NUMERIC' measurement-level='ORDINAL'/>\n"
    "</dictionary>";

constexpr char kDescription[] =
    "kind:    none, the dictionary of a document in the older format (vexa-ml) alone\n"
    "version: -\n"
    "target:\n"
    "  none\n"
    "inputs: 3\n"
    "  name  type    level       role        missing values  categories\n"
    "  age   number  continuous  data field  -1, [900, 999]  -\n"
    "  town  text    nominal     data field  -               r (Rome), b\n"
    "  rank  number  ordinal     data field  -               -\n";

std::string Legacy(const std::string& model = std::string()) {
  return "<vexa-ml>" + std::string(kDictionary) + model + "</vexa-ml>\n";
}

TEST(KestrelDescribe, ShowsTheDictionaryOfTheOlderFormat) {
  const TempFolder folder;
  folder.Write("m.xml", Legacy());
  RunOptions options;
  options.input = Legacy();
  for (const char* path : {"T/m.xml", "-"}) {
    const ProgramOutcome outcome = RunKestrel(folder, {"describe", path}, options);
    EXPECT_EQ(outcome.exit_code, 0) << path;
    EXPECT_EQ(outcome.output, kDescription) << path;
    EXPECT_EQ(outcome.errors, "") << path;
  }
}

TEST(KestrelDescribe, WritesTheDictionaryOfTheOlderFormatAsJson) {
  const ProgramOutcome outcome = RunKestrel({"describe", "-", "--json"}, Legacy());
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  const nlohmann::json document = nlohmann::json::parse(outcome.output);
  EXPECT_TRUE(document["kind"].is_null());
  EXPECT_EQ(document["format"], "vexa-ml");
  EXPECT_TRUE(document["target"].is_null());
  EXPECT_EQ(document["derived"], nlohmann::json::array());
  ASSERT_EQ(document["inputs"].size(), 3u);
  EXPECT_EQ(document["inputs"][0], nlohmann::json::parse(R"({
    "name": "age", "label": "age in years", "type": "number", "level": "continuous", "role": "data field",
    "read": false, "categories": [], "missing": ["-1", "[900, 999]"]})"));
  EXPECT_EQ(document["inputs"][1]["categories"],
            nlohmann::json::parse(R"([{"value": "r", "label": "Rome"}, {"value": "b"}])"));
  const nlohmann::json model = nlohmann::json::parse(RunKestrel({"describe", "D/line.xml", "--json"}).output);
  EXPECT_EQ(model.count("format"), 0u);
}

TEST(KestrelCheck, SaysThatADictionaryOfTheOlderFormatIsGood) {
  const ProgramOutcome outcome = RunKestrel({"check", "-"}, Legacy());
  EXPECT_EQ(outcome.exit_code, 0);
  EXPECT_EQ(outcome.output, "standard input: good: 3 fields, no model\n");
  EXPECT_EQ(outcome.errors, "");
}

struct ModelRow {
  const char* why;
  const char* model;
  const char* refusal;
};

const ModelRow kModels[] = {
    {"a model whose library reads PMML alone", "<TreeModel/>",
     "standard input:1:10: <vexa-ml>: models of the older document format are not supported! (code 5)\n"
     "  hint: no library that is installed reads models of the older format (vexa-ml); export the model as "
     "PMML\n"},
    {"a model without a library", "<regression-model/>",
     "standard input:5:33: Doesn't Support GeneralRegressionModel  Model: No Required dll or lib available! "
     "(code 5)\n"
     "  the system says: GeneralRegressionModel800r"},
    {"a library that reads PMML's elements, and a fault in them",
     "<DataDictionary numberOfFields='1'/><TreeModel/>",
     "standard input:5:50: <DataDictionary is EMPTY!! (code 1)\n"},
};

TEST(KestrelDescribe, SaysWhyAModelOfTheOlderFormatCannotBeScored) {
  for (const ModelRow& row : kModels) {
    ProgramOutcome outcome = RunKestrel({"describe", "-"}, Legacy(row.model));
    EXPECT_EQ(outcome.exit_code, 0) << row.why;
    EXPECT_EQ(outcome.output, kDescription) << row.why;
    EXPECT_EQ(outcome.errors.find("kestrel: the model cannot be scored: " + std::string(row.refusal)), 0u)
        << row.why << "\n"
        << outcome.errors;
    outcome = RunKestrel({"check", "-"}, Legacy(row.model));
    EXPECT_EQ(outcome.exit_code, 3) << row.why;
    EXPECT_EQ(outcome.output, "standard input: dictionary of 3 fields\n") << row.why;
    EXPECT_EQ(outcome.errors.find("kestrel: " + std::string(row.refusal)), 0u) << row.why << "\n"
                                                                               << outcome.errors;
  }
}

TEST(KestrelCheck, TellsOfTheOlderFormatWhereALibraryIsMissing) {
  const ProgramOutcome outcome = RunKestrel({"check", "-"}, Legacy("<regression-model/>"));
  EXPECT_NE(outcome.errors.find("\n  hint: no library that is installed reads models of the older format"),
            std::string::npos)
      << outcome.errors;
  EXPECT_EQ(outcome.errors.find(MCKestrel_800::SharedLibrary::GetUsualPlace()), std::string::npos)
      << outcome.errors;
}

// A model that a library reads is a model, whatever its root is called.
TEST(KestrelDescribe, ShowsTheModelOfTheOlderFormatThatALibraryReads) {
  std::string document = Replaced(FileText(DataPath("line.xml")), "<PMML", "<vexa-ml");
  document = Replaced(document, "</PMML>", std::string(kDictionary) + "</vexa-ml>");
  ProgramOutcome outcome = RunKestrel({"describe", "-"}, document);
  EXPECT_EQ(outcome.exit_code, 0);
  EXPECT_EQ(outcome.output.find("kind:    RegressionModel\n"), 0u) << outcome.output;
  EXPECT_EQ(outcome.errors, "");
  outcome = RunKestrel({"check", "-"}, document);
  EXPECT_EQ(outcome.output, "standard input: good: RegressionModel with 1 input, target y\n");
}

struct BrokenRow {
  const char* why;
  const char* from;  ///< what is changed in the document
  const char* to;
  const char* want;
};

const BrokenRow kBroken[] = {
    {"a level in lower case", "'ORDINAL'", "'ordinal'",
     ":4:75: Invalid measurement-level attribute!! (code 11)\n"
     "  hint: accepted is CONTINUOUS, NOMINAL or ORDINAL, in upper case\n"},
    {"a name twice", "'rank'", "'age'",
     ":4:74: age is duplicated!!! (code 8)\n  hint: every variable needs a name of its own\n"},
    {"not well-formed", "</dictionary>", "",
     ":5:3: Invalid XML file!! (code 6)\n"
     "  hint: up to here it is well-formed XML; what follows is not, needs something outside of the "
     "document, or is beyond the limits in docs/documents.md\n"},
    {"no dictionary", "dictionary", "variables",
     ":1:10: Unsupported Model found! (code 5)\n"
     "  hint: accepted is a PMML element with a model such as RegressionModel directly in it; with --models, "
     "one that the list names\n"},
};

TEST(KestrelCheck, SaysWhatIsWrongWithADictionaryOfTheOlderFormat) {
  for (const BrokenRow& row : kBroken) {
    for (const char* command : {"check", "describe"}) {
      const ProgramOutcome outcome = RunKestrel({command, "-"}, Replaced(Legacy(), row.from, row.to));
      EXPECT_EQ(outcome.exit_code, 3) << row.why;
      EXPECT_EQ(outcome.output, "") << row.why;
      EXPECT_EQ(outcome.errors, "kestrel: standard input" + std::string(row.want)) << row.why;
    }
  }
}

TEST(KestrelCheck, PutsAFaultOfTheOlderDictionaryBeforeTheModels) {
  const std::string document = Replaced(Legacy("<TreeModel/>"), "'ORDINAL'", "''");
  const ProgramOutcome outcome = RunKestrel({"check", "-"}, document);
  EXPECT_EQ(outcome.exit_code, 3);
  EXPECT_EQ(outcome.errors.find("kestrel: standard input:4:68: Measurement-level can't be null!! (code 7)"),
            0u)
      << outcome.errors;
}

TEST(KestrelCheck, AsksForAModelThatIsNamedInTheOlderFormatToo) {
  const TempFolder folder;
  folder.Write("names.txt", "RegressionModel\n");
  RunOptions options;
  options.input = Legacy("<TreeModel/>");
  for (const char* command : {"check", "describe"}) {
    const ProgramOutcome outcome = RunKestrel(folder, {command, "-", "--models", "T/names.txt"}, options);
    EXPECT_EQ(outcome.exit_code, 3) << command;
    EXPECT_EQ(outcome.output, "") << command;
    EXPECT_NE(outcome.errors.find("Unsupported Model found! (code 5)"), std::string::npos) << outcome.errors;
  }
}

TEST(KestrelScore, RefusesTheOlderFormat) {
  const TempFolder folder;
  folder.Write("tree.xml", Legacy("<TreeModel/>"));
  folder.Write("none.xml", Legacy());
  folder.Write("alone.xml", "<Tree/>");
  struct Row {
    std::vector<std::string> arguments;
    const char* want;
  };
  const Row rows[] = {
      {{"score", "T/tree.xml"},
       "kestrel: T/tree.xml:1:10: <vexa-ml>: models of the older document format are not supported! (code "
       "5)\n"
       "  hint: no library that is installed reads models of the older format (vexa-ml); export the model as "
       "PMML\n"},
      {{"score", "T/none.xml"},
       "kestrel: T/none.xml:1:10: Unsupported Model found! (code 5)\n"
       "  hint: accepted is a PMML element with a model such as RegressionModel directly in it; with "
       "--models, one that the list names\n"},
      {{"score", "T/alone.xml"},
       "kestrel: T/alone.xml:1:8: <Tree>: models of the older document format are not supported! (code 5)\n"
       "  hint: export the model as PMML; of a vexa-ml document, kestrel describe shows the dictionary\n"},
      {{"derive", "T/none.xml"},
       "kestrel: T/none.xml:1:10: Unsupported Model found! (code 5)\n"
       "  hint: accepted is PMML as the root element\n"},
  };
  RunOptions options;
  options.input = "age\n1\n";
  for (const Row& row : rows) {
    const ProgramOutcome outcome = RunKestrel(folder, row.arguments, options);
    EXPECT_EQ(outcome.exit_code, 3) << row.want;
    EXPECT_EQ(outcome.output, "") << row.want;
    EXPECT_EQ(outcome.errors, row.want);
  }
}

}  // namespace
}  // namespace kestrel_tests
