// `kestrel describe` and `kestrel check` with documents that declare output fields.

#include <gtest/gtest.h>

#include <nlohmann/json.hpp>

#include "tests/apps/KestrelProgram.h"
#include "tests/support/FileText.h"

namespace kestrel_tests {
namespace {

const char kEveryFeature[] =
    "<Output><OutputField name='size it has' displayName='the size' dataType='string' optype='categorical'/>"
    "<OutputField name='b' feature='predictedDisplayValue'/>"
    "<OutputField name='c' feature='probability' value='large'/>"
    "<OutputField name='d' feature='residual' value='1' dataType='string'/>"
    "<OutputField name='e' feature='standardError'/><OutputField name='f' feature='clusterId'/>"
    "<OutputField name='g' feature='clusterAffinity'/><OutputField name='h' feature='entityId'/>"
    "<OutputField name='i' feature='entityAffinity'/><OutputField name='j' feature='warning'/>"
    "<OutputField name='k' feature='ruleValue' dataType='double'/>"
    "<OutputField name='l' feature='standardDeviation' displayName='spread'/>"
    "<OutputField name='m' feature=''/></Output>";

/// A document of the test data with output fields.
std::string DocumentWith(const char* name, const char* output) {
  return Replaced(FileText(DataPath(name)), "</MiningSchema>", std::string("</MiningSchema>") + output);
}

/// Of tree.xml, whose categories a residual may be about.
std::string EveryFeature() {
  return Replaced(DocumentWith("tree.xml", kEveryFeature), "value='1'", "value='small'");
}

TEST(KestrelDescribeOutputs, ShowsATable) {
  const ProgramOutcome outcome = RunKestrel({"describe", "-"}, EveryFeature());
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  const std::size_t begin = outcome.output.find("output fields");
  ASSERT_NE(begin, std::string::npos) << outcome.output;
  EXPECT_EQ(outcome.output.substr(begin),
            "output fields: 13\n"
            "  name         type    feature                value  label\n"
            "  size it has  text    predictedValue         -      the size\n"
            "  b            text    predictedDisplayValue  -      -\n"
            "  c            number  probability            large  -\n"
            "  d            text    residual               small  -\n"
            "  e            number  standardError          -      -\n"
            "  f            text    clusterId              -      -\n"
            "  g            number  clusterAffinity        -      -\n"
            "  h            text    entityId               -      -\n"
            "  i            number  entityAffinity         -      -\n"
            "  j            text    warning                -      -\n"
            "  k            number  ruleValue              -      -\n"
            "  l            number  standardDeviation      -      spread\n"
            "  m            number  -                      -      -\n");
}

TEST(KestrelDescribeOutputs, WritesJson) {
  const ProgramOutcome outcome = RunKestrel({"describe", "-", "--json"}, EveryFeature());
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  const nlohmann::json model = nlohmann::json::parse(outcome.output);
  ASSERT_EQ(model["outputs"].size(), 13u);
  EXPECT_EQ(model["outputs"][0], nlohmann::json::parse(R"({"name": "size it has", "label": "the size",
    "type": "text", "feature": "predictedValue"})"));
  EXPECT_EQ(model["outputs"][2], nlohmann::json::parse(R"({"name": "c", "type": "number",
    "feature": "probability", "value": "large"})"));
  EXPECT_EQ(model["outputs"][12],
            nlohmann::json::parse(R"({"name": "m", "type": "number", "feature": null})"));
}

TEST(KestrelDescribeOutputs, StandBehindTheDerivedFields) {
  const char output[] =
      "<Output><OutputField name='y1'/></Output><LocalTransformations><DerivedField name='twice' "
      "optype='continuous' dataType='double'><Apply function='+'><FieldRef field='x'/><FieldRef field='x'/>"
      "</Apply></DerivedField></LocalTransformations>";
  const ProgramOutcome outcome = RunKestrel({"describe", "-"}, DocumentWith("line.xml", output));
  EXPECT_EQ(outcome.exit_code, 0) << outcome.errors;
  const std::size_t begin = outcome.output.find("derived fields");
  ASSERT_NE(begin, std::string::npos) << outcome.output;
  EXPECT_EQ(outcome.output.substr(begin),
            "derived fields: 1\n"
            "  name   type    level       expression\n"
            "  twice  number  continuous  x + x\n"
            "output fields: 1\n"
            "  name  type    feature         value  label\n"
            "  y1    number  predictedValue  -      -\n");
}

TEST(KestrelDescribeOutputs, AreNotThereWhenNoneAreDeclared) {
  EXPECT_EQ(RunKestrel({"describe", "D/line.xml"}).output.find("output"), std::string::npos);
  for (const char* document : {"D/line.xml", "D/derived.xml"}) {
    const nlohmann::json model = nlohmann::json::parse(RunKestrel({"describe", document, "--json"}).output);
    EXPECT_EQ(model["outputs"], nlohmann::json::array()) << document;
  }
}

TEST(KestrelCheckOutputs, SaysWhatIsWrongWithThem) {
  const std::tuple<const char*, int, const char*> rows[] = {
      {"<Output><OutputField name='z'/></Output>", 0, ""},
      {"<Output><OutputField name='z'/><OutputField name='z'/></Output>", 3,
       "z: Invalid Variable Name -- alreay in the dictionary"},
      {"<Output><OutputField name='z' feature='guess'/></Output>", 3, "z: Invalid feature Type"},
      {"<Output><OutputField name='z' rank='2'/></Output>", 3, "z: rank -- 2: Not supported!"},
  };
  for (const auto& [output, exit_code, want] : rows) {
    const ProgramOutcome outcome = RunKestrel({"check", "-"}, DocumentWith("line.xml", output));
    EXPECT_EQ(outcome.exit_code, exit_code) << output;
    EXPECT_NE(outcome.errors.find(want), std::string::npos) << outcome.errors;
  }
}

}  // namespace
}  // namespace kestrel_tests
