// What `kestrel describe` and `kestrel check` say of derived fields, and models that read them.

#include <gtest/gtest.h>

#include <nlohmann/json.hpp>

#include "tests/apps/KestrelProgram.h"
#include "tests/support/FileText.h"

namespace kestrel_tests {
namespace {

TEST(KestrelDescribe, ShowsDerivedFieldsWithoutAModel) {
  const char* want =
      "kind:    none, derived fields alone\n"
      "version: -\n"
      "target:\n"
      "  none\n"
      "inputs: 7\n"
      "  name     type                 level       role                   missing values  categories\n"
      "  x        number               continuous  data field             -99             -\n"
      "  colour   text                 nominal     data field             n/a             red, green\n"
      "  day      date                 continuous  data field             -               -\n"
      "  hour     time                 continuous  data field             -               -\n"
      "  moment   dateTime             continuous  data field             -               -\n"
      "  days     dateDaysSince[1970]  continuous  data field             -               -\n"
      "  comment  text                 nominal     data field (not read)  -               -\n"
      "derived fields: 7\n"
      "  name        type                 level       expression\n"
      "  twice       number               continuous  x * 2\n"
      "  size        text                 ordinal     discretize(twice): (-inf, 10) -> \"small\", [10, inf) "
      "-> "
      "\"large, or more\", else missing\n"
      "  tint        text                 nominal     colour{missing -> \"grey\"}\n"
      "  the day     date                 continuous  day\n"
      "  the hour    time                 continuous  hour\n"
      "  the moment  dateTime             continuous  moment\n"
      "  the days    dateDaysSince[1970]  continuous  days\n";
  for (const char* path : {"D/derived.xml", "-"}) {
    const ProgramOutcome outcome = RunKestrel({"describe", path}, FileText(DataPath("derived.xml")));
    EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
    EXPECT_EQ(outcome.errors, "");
    EXPECT_EQ(outcome.output, want) << path;
  }
}

TEST(KestrelDescribe, WritesDerivedFieldsAsJson) {
  const ProgramOutcome outcome = RunKestrel({"describe", "--json", "D/derived.xml"});
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  const nlohmann::json document = nlohmann::json::parse(outcome.output);
  EXPECT_TRUE(document["kind"].is_null());
  EXPECT_TRUE(document["target"].is_null());
  ASSERT_EQ(document["inputs"].size(), 7u);
  EXPECT_EQ(document["inputs"][0]["read"], true);
  EXPECT_EQ(document["inputs"][6]["read"], false);
  ASSERT_EQ(document["derived"].size(), 7u);
  EXPECT_EQ(document["derived"][1], nlohmann::json::parse(R"({
    "name": "size", "label": "how large it is", "type": "text", "level": "ordinal",
    "expression":
      "discretize(twice): (-inf, 10) -> \"small\", [10, inf) -> \"large, or more\", else missing",
    "categories": [{"value": "small"}, {"value": "large, or more"}], "missing": []})"));
}

TEST(KestrelDescribe, ShowsSoManyRowsOfATableAsCanBeRead) {
  std::string table =
      "<MapValues outputColumn=\"b\"><FieldColumnPair field=\"colour\" column=\"a\"/><InlineTable>";
  for (int i = 1; i <= 1000; ++i)
    table += "<row><a>" + std::to_string(i) + "</a><b>" + std::to_string(-i) + "</b></row>";
  const std::string document =
      Replaced(FileText(DataPath("derived.xml")), "<FieldRef field=\"colour\" mapMissingTo=\"grey\"/>",
               table + "</InlineTable></MapValues>");
  const ProgramOutcome shown = RunKestrel({"describe", "-"}, document);
  EXPECT_EQ(shown.exit_code, 0) << shown.errors;
  EXPECT_NE(shown.output.find(", \"10\" -> \"-10\", ... 990 more rows (see --json), else missing\n"),
            std::string::npos)
      << shown.output;
  const nlohmann::json all = nlohmann::json::parse(RunKestrel({"describe", "-", "--json"}, document).output);
  const std::string expression = all["derived"][2]["expression"];
  EXPECT_NE(expression.find(", \"1000\" -> \"-1000\", else missing"), std::string::npos);
}

/// line.xml with a derived field of the document, and one of the model that reads it and is read in the place
/// of x.
std::string ModelThatReadsDerivedFields() {
  const std::string field =
      "<DerivedField name=\"NAME\" optype=\"continuous\" dataType=\"double\"><Apply "
      "function=\"*\"><FieldRef field=\"SOURCE\"/><Constant>FACTOR</Constant></Apply>"
      "</DerivedField>";
  const auto field_of = [&field](const char* name, const char* source, const char* factor) {
    return Replaced(Replaced(Replaced(field, "NAME", name), "SOURCE", source), "FACTOR", factor);
  };
  std::string document = Replaced(FileText(DataPath("line.xml")), "</DataDictionary>",
                                  "</DataDictionary><TransformationDictionary>" + field_of("two", "x", "2") +
                                      "</TransformationDictionary>");
  document = Replaced(
      document, "</MiningSchema>",
      "</MiningSchema><LocalTransformations>" + field_of("six", "two", "3") + "</LocalTransformations>");
  return Replaced(document, "NumericPredictor name=\"x\"", "NumericPredictor name=\"six\"");
}

TEST(KestrelDescribe, ShowsTheDerivedFieldsOfAModel) {
  const ProgramOutcome outcome = RunKestrel({"describe", "-"}, ModelThatReadsDerivedFields());
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  EXPECT_EQ(outcome.output,
            "kind:    RegressionModel\n"
            "version: 4.4\n"
            "target:\n"
            "  name  type    level       role    missing values  categories\n"
            "  y     number  continuous  target  -               -\n"
            "inputs: 1\n"
            "  name  type    level       role       missing values  categories\n"
            "  x     number  continuous  predictor  -               -\n"
            "derived fields: 2\n"
            "  name  type    level       expression\n"
            "  two   number  continuous  x * 2\n"
            "  six   number  continuous  two * 3\n");
}

TEST(KestrelScore, ComputesTheDerivedFieldsOfAModel) {
  const TempFolder folder;
  folder.Write("m.xml", ModelThatReadsDerivedFields());
  RunOptions options;
  options.input = "x\n1\n-0.5\n";
  ProgramOutcome outcome = RunKestrel(folder, {"score", "T/m.xml"}, options);
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  EXPECT_EQ(outcome.output, "prediction\n13\n-5\n");
  outcome = RunKestrel(folder, {"derive", "T/m.xml"}, options);
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  EXPECT_EQ(outcome.output, "two\n2\n-1\n");
}

TEST(KestrelDescribe, HasNoDerivedFieldsWhereThereAreNone) {
  EXPECT_EQ(RunKestrel({"describe", "D/line.xml"}).output.find("derived"), std::string::npos);
  const nlohmann::json model = nlohmann::json::parse(RunKestrel({"describe", "D/line.xml", "--json"}).output);
  EXPECT_EQ(model["derived"], nlohmann::json::array());
}

TEST(KestrelCheck, SaysThatDerivedFieldsAreGood) {
  const ProgramOutcome outcome = RunKestrel({"check", "D/derived.xml"});
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  EXPECT_EQ(outcome.output, "D/derived.xml: good: 7 derived fields, no model\n");
}

TEST(KestrelCheck, SaysWhatIsWrongWithDerivedFields) {
  const std::string document =
      Replaced(FileText(DataPath("derived.xml")), "<FieldRef field=\"x\"/>", "<FieldRef field=\"z\"/>");
  for (const char* command : {"check", "describe"}) {
    const ProgramOutcome outcome = RunKestrel({command, "-"}, document);
    EXPECT_EQ(outcome.exit_code, 3) << command;
    EXPECT_EQ(outcome.output, "") << command;
    EXPECT_EQ(outcome.errors,
              "kestrel: standard input:22:30: z: not predefined (code 8)\n"
              "  hint: accepted is a data field, or a derived field that stands before\n");
  }
}

// Who says which models there may be wants one of these.
TEST(KestrelCheck, AsksForAModelThatIsNamed) {
  const TempFolder folder;
  folder.Write("names.txt", "RegressionModel\n");
  const ProgramOutcome outcome = RunKestrel(folder, {"check", "D/derived.xml", "--models", "T/names.txt"});
  EXPECT_EQ(outcome.exit_code, 3);
  EXPECT_NE(outcome.errors.find("Unsupported Model found! (code 5)"), std::string::npos) << outcome.errors;
  // Without derived fields, the fault is that there is no model.
  const ProgramOutcome none =
      RunKestrel({"check", "-"}, Replaced(FileText(DataPath("line.xml")), "RegressionModel", "Regress"));
  EXPECT_EQ(none.exit_code, 3);
  EXPECT_NE(none.errors.find("Unsupported Model found! (code 5)"), std::string::npos) << none.errors;
}

}  // namespace
}  // namespace kestrel_tests
