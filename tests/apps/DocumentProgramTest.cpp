// `kestrel check` and `kestrel describe`, and how documents that are not good are reported.

#include <gtest/gtest.h>

#include <nlohmann/json.hpp>
#include <set>

#include "apps/kestrel/LoadedModel.h"
#include "kestrel/platform/SharedLibrary.h"
#include "tests/apps/KestrelProgram.h"
#include "tests/support/FileText.h"
#include "tests/support/SystemFiles.h"

namespace kestrel_tests {
namespace {

TEST(KestrelCheck, SaysThatADocumentIsGood) {
  const std::pair<const char*, const char*> rows[] = {
      {"D/line.xml", "D/line.xml: good: RegressionModel with 1 input, target y\n"},
      {"D/inputs.xml", "D/inputs.xml: good: RegressionModel with 8 inputs, target y\n"},
      {"D/tree.xml", "D/tree.xml: good: TreeModel with 2 inputs, target size\n"},
      {"D/rules.xml", "D/rules.xml: good: RuleSetModel with 1 input, target y\n"},
  };
  for (const auto& [model, want] : rows) {
    const ProgramOutcome outcome = RunKestrel({"check", model});
    EXPECT_EQ(outcome.exit_code, 0);
    EXPECT_EQ(outcome.output, want);
    EXPECT_EQ(outcome.errors, "");
  }
  const ProgramOutcome outcome = RunKestrel({"check", "-"}, FileText(DataPath("line.xml")));
  EXPECT_EQ(outcome.output, "standard input: good: RegressionModel with 1 input, target y\n");
}

struct DocumentRow {
  const char* why;
  const char* from;  ///< what is changed in line.xml
  const char* to;
  const char* want;
};

const DocumentRow kDocuments[] = {
    {"not well-formed", "</RegressionTable>", "",
     ":16:5: Invalid XML file!! (code 6)\n"
     "  hint: up to here it is well-formed XML; what follows is not, needs something outside of the "
     "document, "
     "or is beyond the limits in docs/documents.md\n"},
    {"an unknown optype", "name=\"x\" optype=\"continuous\"", "name=\"x\" optype=\"gradual\"",
     ":5:61: gradual: Invalid Variable Type (code 11)\n"
     "  hint: accepted as optype is continuous, categorical or ordinal; where a number is needed, no text "
     "field\n"},
    {"a number of fields that is not right", "numberOfFields=\"2\"", "numberOfFields=\"3\"",
     ":4:38: Number of Variables in the Dictionary does not match with numberOfFields! (code 12)\n"
     "  hint: accepted is the number of DataField elements\n"},
    {"no model element", "RegressionModel", "Regress",
     ":2:57: Unsupported Model found! (code 5)\n"
     "  hint: accepted is a PMML element with a model such as RegressionModel directly in it; with --models, "
     "one that the list names\n"},
    {"a coefficient with a comma", "coefficient=\"2\"", "coefficient=\"2,5\"",
     ":14:53: 2,5Invalid double string --  (code 3)\n"
     "  hint: accepted is a number such as -1.5 or 2e3, with a decimal point\n"},
    {"a predictor that is no field", "NumericPredictor name=\"x\"", "NumericPredictor name=\"z\"",
     ":14:51: Variable z not among the active fields of the MiningSchema! (code 8)\n"
     "  hint: accepted is the name of a MiningField of this model with usageType=\"active\" or none\n"},
    {"another function", "functionName=\"regression\"", "functionName=\"clustering\"",
     ":8:46: functionName -- clustering: Not supported! (code 5)\n"
     "  hint: accepted is regression or classification\n"},
};

TEST(KestrelCheck, SaysWhatIsWrongAndWhere) {
  for (const DocumentRow& row : kDocuments) {
    const TempFolder folder;
    folder.Write("m.xml", Replaced(FileText(DataPath("line.xml")), row.from, row.to));
    const ProgramOutcome outcome = RunKestrel(folder, {"check", "T/m.xml"});
    EXPECT_EQ(outcome.exit_code, 3) << row.why;
    EXPECT_EQ(outcome.output, "") << row.why;
    EXPECT_EQ(outcome.errors, "kestrel: T/m.xml" + std::string(row.want)) << row.why;
  }
}

TEST(KestrelCheck, SaysSoOfTextsThatAreNoDocument) {
  for (const char* text : {"", "x,y\n1,2\n", "<PMML>"}) {
    const ProgramOutcome outcome = RunKestrel({"check", "-"}, text);
    EXPECT_EQ(outcome.exit_code, 3) << text;
    EXPECT_EQ(outcome.errors.compare(0, 24, "kestrel: standard input:"), 0) << outcome.errors;
    EXPECT_NE(outcome.errors.find("\n  hint: "), std::string::npos) << outcome.errors;
  }
}

TEST(KestrelCheck, EveryCommandReportsTheDocument) {
  const TempFolder folder;
  folder.Write("m.xml", "<PMML/>");
  for (const char* command : {"check", "describe", "score"}) {
    const ProgramOutcome outcome = RunKestrel(folder, {command, "T/m.xml"});
    EXPECT_EQ(outcome.exit_code, 3);
    EXPECT_EQ(outcome.errors.compare(0, 16, "kestrel: T/m.xml"), 0) << outcome.errors;
  }
}

TEST(KestrelCheck, SaysWhichFileCannotBeRead) {
  const TempFolder folder;
  const std::pair<std::vector<std::string>, const char*> rows[] = {
      {{"check", "T/absent.xml"}, "kestrel: T/absent.xml: cannot be opened: No such file or directory\n"},
      {{"score", "D/line.xml", "T/absent.csv"},
       "kestrel: T/absent.csv: cannot be opened: No such file or directory\n"},
      {{"check", "T/"}, "kestrel: T/: this is a folder; a file is expected\n"},
      {{"check", "D/line.xml", "--models", "T/absent.txt"},
       "kestrel: T/absent.txt: Could not open model names file\n"},
      {{"score", "D/line.xml", "-o", "T/absent/out.csv"},
       "kestrel: T/absent/out.csv: cannot be written: No such file or directory\n"},
  };
  for (const auto& [arguments, want] : rows) {
    RunOptions options;
    options.input = "x\n1\n";
    const ProgramOutcome outcome = RunKestrel(folder, arguments, options);
    EXPECT_EQ(outcome.exit_code, 5) << want;
    EXPECT_EQ(outcome.errors, want);
  }
}

TEST(KestrelModels, TakesTheNamesFromAFile) {
  const TempFolder folder;
  folder.Write("names.txt", "TreeModel\nRegressionModel\n");
  folder.Write("others.txt", "TreeModel NeuralNetwork\n");
  ProgramOutcome outcome = RunKestrel(folder, {"check", "D/line.xml", "--models", "T/names.txt"});
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  outcome = RunKestrel(folder, {"check", "D/line.xml", "--models", "T/others.txt"});
  EXPECT_EQ(outcome.exit_code, 3);
  EXPECT_NE(outcome.errors.find("Unsupported Model found! (code 5)"), std::string::npos) << outcome.errors;
}

TEST(KestrelModels, SaysWhyAModelLibraryCannotBeLoaded) {
  const std::set<std::string> left_out = {"RegressionModel", "RuleSetModel", "TreeModel",
                                          "AssociationModelLattice"};
  for (const std::string& element : kestrel_program::StandardModelElements()) {
    if (left_out.count(element) != 0) continue;
    const std::string document = Replaced(FileText(DataPath("line.xml")), "RegressionModel", element);
    const ProgramOutcome outcome = RunKestrel({"check", "-"}, document);
    EXPECT_EQ(outcome.exit_code, 3) << element;
    EXPECT_NE(outcome.errors.find(": Doesn't Support " + element +
                                  "  Model: No Required dll or lib available! (code 5)\n"
                                  "  the system says: " +
                                  element + "800r" + MCKestrel_800::SharedLibrary::GetSuffix() + ": "),
              std::string::npos)
        << outcome.errors;
    EXPECT_NE(
        outcome.errors.find("\n  hint: install the library for this kind of model beside the others, in " +
                            std::string(MCKestrel_800::SharedLibrary::GetUsualPlace()) + "\n"),
        std::string::npos)
        << outcome.errors;
  }
}

/// Libraries that fail, in front of the good ones.
ProgramOutcome CheckWithFaultyLibrary(const std::string& fault) {
  const TempFolder folder;
  folder.Write("names.txt", "Fault_" + fault);
  folder.Write("m.xml", "<PMML><Fault_" + fault + "/></PMML>");
  const char* present = std::getenv(kLibraryPath);
  RunOptions options;
  options.environment = {kLibraryPath + std::string("=") + KESTREL_BINARY_DIR + "/tests/plugins" +
                         (present == nullptr ? std::string() : kBetweenFolders + std::string(present))};
  return RunKestrel(folder, {"check", "T/m.xml", "--models", "T/names.txt"}, options);
}

TEST(KestrelModels, SurvivesLibrariesThatFail) {
  const std::pair<const char*, const char*> rows[] = {
      {"THROWS_STANDARD", "kestrel: T/m.xml: the model's library failed: from the plug-in\n"},
      {"THROWS_INT", "kestrel: T/m.xml: the model's library failed without saying why\n"},
      {"ENTRY_THROWS", "kestrel: T/m.xml: the model's library failed without saying why\n"},
      {"NULL_MODEL", "kestrel: T/m.xml: the model's library made no model of it\n"},
      {"THROWS_KESTREL",
       "kestrel: T/m.xml: Variable x not in the dictionary! (code 8)\n"
       "  hint: accepted is the name of a DataField; upper and lower case count\n"},
  };
  for (const auto& [fault, want] : rows) {
    const ProgramOutcome outcome = CheckWithFaultyLibrary(fault);
    EXPECT_EQ(outcome.exit_code, 3) << fault;
    EXPECT_EQ(outcome.errors, want);
  }
}

TEST(KestrelDescribe, ShowsATable) {
  const ProgramOutcome outcome = RunKestrel({"describe", "D/inputs.xml"});
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  EXPECT_EQ(outcome.errors, "");
  EXPECT_EQ(
      outcome.output,
      "kind:    RegressionModel\n"
      "version: 4.4\n"
      "target:\n"
      "  name  type    level       role    missing values  categories\n"
      "  y     number  continuous  target  -               -\n"
      "inputs: 9\n"
      "  name       type                 level       role                      missing values   categories\n"
      "  x          number               continuous  predictor                 [900, inf), -99  -\n"
      "  n          integer              continuous  predictor                 -                -\n"
      "  colour     text                 nominal     predictor                 n/a              red (dark "
      "red), "
      "green\n"
      "  free text  text                 nominal     predictor                 -                -\n"
      "  day        date                 continuous  predictor                 -                -\n"
      "  hour       time                 continuous  predictor                 -                -\n"
      "  moment     dateTime             continuous  predictor                 -                -\n"
      "  days       dateDaysSince[1970]  continuous  predictor                 -                -\n"
      "  comment    text                 nominal     supplementary (not read)  -                -\n");
}

TEST(KestrelDescribe, ShowsEveryKindOfModel) {
  const std::pair<const char*, const char*> rows[] = {
      {"D/tree.xml",
       "kind:    TreeModel\n"
       "version: 4.4\n"
       "target:\n"
       "  name  type  level    role    missing values  categories\n"
       "  size  text  nominal  target  -               small, large\n"
       "inputs: 2\n"
       "  name    type    level       role       missing values  categories\n"
       "  x       number  continuous  predictor  -               -\n"
       "  colour  text    nominal     predictor  -               red, gr\xC3\xBCn\n"},
      {"D/rules.xml",
       "kind:    RuleSetModel\n"
       "version: 4.4\n"
       "target:\n"
       "  name  type    level       role    missing values  categories\n"
       "  y     number  continuous  target  -               -\n"
       "inputs: 1\n"
       "  name  type    level       role       missing values  categories\n"
       "  x     number  continuous  predictor  -               -\n"},
  };
  for (const auto& [model, want] : rows) {
    const ProgramOutcome outcome = RunKestrel({"describe", model});
    EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
    EXPECT_EQ(outcome.output, want);
    EXPECT_EQ(outcome.errors, "");
  }
}

TEST(KestrelDescribe, WritesJson) {
  const ProgramOutcome outcome = RunKestrel({"describe", "--json", "D/inputs.xml"});
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  const nlohmann::json model = nlohmann::json::parse(outcome.output);
  EXPECT_EQ(model["kind"], "RegressionModel");
  EXPECT_EQ(model["version"], "4.4");
  EXPECT_EQ(model["target"]["name"], "y");
  EXPECT_EQ(model["target"]["role"], "target");
  ASSERT_EQ(model["inputs"].size(), 9u);
  EXPECT_EQ(model["inputs"][2], nlohmann::json::parse(R"({
    "name": "colour", "label": "colour of the cover", "type": "text", "level": "nominal", "role": "predictor",
    "read": true, "categories": [{"value": "red", "label": "dark red"}, {"value": "green"}], "missing": ["n/a"]})"));
  EXPECT_EQ(model["inputs"][7]["type"], "dateDaysSince[1970]");
  EXPECT_EQ(model["inputs"][8]["role"], "supplementary");
  EXPECT_EQ(model["inputs"][8]["read"], false);
}

TEST(KestrelDescribe, ShowsSoManyCategoriesAsCanBeRead) {
  std::string field = "name=\"x\" optype=\"categorical\" dataType=\"double\">";
  for (int i = 1; i <= 1000; ++i)
    field += "<Value value=\"" + std::to_string(i) + "\"/>";
  for (int i = 1; i <= 7; ++i)
    field += "<Value value=\"-" + std::to_string(i) + "\" property=\"missing\"/>";
  const std::string document =
      Replaced(FileText(DataPath("line.xml")), "name=\"x\" optype=\"continuous\" dataType=\"double\"/>",
               field + "</DataField>");
  const ProgramOutcome table = RunKestrel({"describe", "-"}, document);
  EXPECT_EQ(table.exit_code, 0) << table.errors;
  EXPECT_NE(table.output.find("  -1, -2, -3, -4, -5 and 2 more (see --json)  1, 2, 3, "), std::string::npos)
      << table.output;
  EXPECT_NE(table.output.find(", 19, 20 and 980 more (see --json)\n"), std::string::npos) << table.output;
  const nlohmann::json model =
      nlohmann::json::parse(RunKestrel({"describe", "-", "--json"}, document).output);
  EXPECT_EQ(model["inputs"][0]["categories"].size(), 1000u);
  EXPECT_EQ(model["inputs"][0]["missing"].size(), 7u);
}

TEST(KestrelDescribe, AlignsNamesThatAreNotAscii) {
  const ProgramOutcome outcome = RunKestrel(
      {"describe", "-"}, Replaced(FileText(DataPath("line.xml")), "name=\"x\"", "name=\"\xC3\xA4\xC3\xB6\""));
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  EXPECT_NE(outcome.output.find("  name  type    level       role       missing values  categories\n"
                                "  \xC3\xA4\xC3\xB6    number  continuous  predictor  -               -\n"),
            std::string::npos)
      << outcome.output;
}

}  // namespace
}  // namespace kestrel_tests
