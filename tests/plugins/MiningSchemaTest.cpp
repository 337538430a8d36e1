#include "plugins/support/MiningSchema.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "tests/plugins/ModelText.h"
#include "tests/support/ExpectFault.h"

namespace {

using namespace MCKestrel_800;
using kestrel_tests::ExpectFault;

std::unique_ptr<ScoreDictionary> TestDictionary() {
  return kestrel_test::ReadDictionary(kestrel_test::DictionaryOf(9, kestrel_tests::TestFields()));
}

MiningSchema ReadSchema(const std::string& fields, ScoreDictionary& dictionary) {
  const auto tree = kestrel_test::ReadTree("<MiningSchema>" + fields + "</MiningSchema>");
  return MiningSchema::Read(tree->GetRoot(), &dictionary);
}

TEST(MiningSchema, ReadsEveryAttribute) {
  const auto dictionary = TestDictionary();
  const MiningSchema schema = ReadSchema(
      "<Extension name=\"a\"><MiningField name=\"nothing\"/></Extension>"
      "<MiningField name=\"x\" importance=\"0.5\" outliers=\"asExtremeValues\" lowValue=\"-1\" "
      "highValue=\"1e3\""
      " missingValueReplacement=\"2.5\" missingValueTreatment=\"asMean\" invalidValueTreatment=\"asValue\""
      " invalidValueReplacement=\"7\"><Extension/></MiningField>"
      "<MiningField name=\"g\" usageType=\"supplementary\" missingValueReplacement=\"b\"/>",
      *dictionary);
  ASSERT_EQ(schema.GetFields().size(), 2u);
  const MiningField* x = schema.Find("x");
  ASSERT_NE(x, nullptr);
  EXPECT_EQ(x->variable, dictionary->GetVar("x"));
  EXPECT_EQ(x->role, ScoreModel::kPredictor);
  EXPECT_EQ(x->outliers, ScoreDictVar::kAsExtremeValues);
  EXPECT_EQ(x->low_value, -1.0);
  EXPECT_EQ(x->high_value, 1000.0);
  EXPECT_EQ(x->missing_replacement->GetDouble(), 2.5);
  EXPECT_FALSE(x->missing_is_invalid);
  EXPECT_EQ(x->invalid, MiningField::InvalidTreatment::kAsValue);
  EXPECT_EQ(x->invalid_replacement->GetDouble(), 7.0);
  EXPECT_EQ(schema.Find("g")->role, ScoreModel::kSupplementary);
  EXPECT_EQ(schema.Find("g")->missing_replacement->GetString(), "b");
  EXPECT_EQ(schema.Find("z"), nullptr);
}

TEST(MiningSchema, DefaultsAreThoseOfTheStandard) {
  const auto dictionary = TestDictionary();
  const MiningSchema schema = ReadSchema("<MiningField name=\"x\"/>", *dictionary);
  const MiningField& x = schema.GetFields().front();
  EXPECT_EQ(x.role, ScoreModel::kPredictor);
  EXPECT_EQ(x.outliers, ScoreDictVar::kAsIs);
  EXPECT_EQ(x.missing_replacement, nullptr);
  EXPECT_FALSE(x.missing_is_invalid);
  EXPECT_EQ(x.invalid, MiningField::InvalidTreatment::kReturnInvalid);
  EXPECT_EQ(x.invalid_replacement, nullptr);
}

TEST(MiningSchema, UsageTypesBecomeRoles) {
  constexpr struct {
    const char* usage;
    ScoreModel::VarRole role;
  } kRows[] = {
      {"active", ScoreModel::kPredictor},
      {"predicted", ScoreModel::kTarget},
      {"target", ScoreModel::kTarget},
      {"supplementary", ScoreModel::kSupplementary},
      {"order", ScoreModel::kOrder},
      {"group", ScoreModel::kGroup},
      {"frequencyWeight", ScoreModel::kFrequencyWeight},
      {"analysisWeight", ScoreModel::kAnalysisWeight},
  };
  for (const auto& row : kRows) {
    const auto dictionary = TestDictionary();
    const MiningSchema schema =
        ReadSchema(std::string("<MiningField name=\"x\" usageType=\"") + row.usage + "\"/>", *dictionary);
    EXPECT_EQ(schema.GetFields().front().role, row.role) << row.usage;
  }
}

TEST(MiningSchema, MissingTreatmentMattersOnlyAsReturnInvalid) {
  for (const std::string treatment : {"asIs", "asMean", "asMode", "asMedian", "asValue", "returnInvalid"}) {
    const auto dictionary = TestDictionary();
    const MiningSchema schema =
        ReadSchema("<MiningField name=\"x\" missingValueTreatment=\"" + treatment + "\"/>", *dictionary);
    EXPECT_EQ(schema.GetFields().front().missing_is_invalid, treatment == "returnInvalid") << treatment;
  }
}

TEST(MiningSchema, OptypeReplacesTheLevelInThisDictionary) {
  const auto dictionary = TestDictionary();
  ReadSchema(
      "<MiningField name=\"n\" optype=\"continuous\"/><MiningField name=\"x\" optype=\"categorical\"/>"
      "<MiningField name=\"g\" optype=\"ordinal\"/>",
      *dictionary);
  EXPECT_EQ(dictionary->GetVar("n")->GetMLevel(), ScoreDictVar::kContinuous);
  EXPECT_EQ(dictionary->GetVar("x")->GetMLevel(), ScoreDictVar::kNominal);
  EXPECT_NE(dictionary->GetVar("x")->GetEncoder(), nullptr);
  EXPECT_EQ(dictionary->GetVar("g")->GetMLevel(), ScoreDictVar::kOrdinal);
}

struct RefusalRow {
  const char* why;
  const char* fields;
  int code;
  const char* message;
};

const RefusalRow kRefusalRows[] = {
    {"no field", "", 1, "<MiningSchema> is EMPTY!!"},
    {"extensions are no fields", "<Extension/>", 1, "<MiningSchema> is EMPTY!!"},
    {"another element", "<DataField name=\"x\"/>", 1, "<MiningField> or <Extension> is required here!!"},
    {"no name", "<MiningField/>", 4, "Attribute name is missing from Node \"MiningField\""},
    {"empty name", "<MiningField name=\"\"/>", 1, "<MiningField>'s name can't be null string !!"},
    {"unknown field", "<MiningField name=\"X\"/>", 8, "Variable X not in the dictionary!"},
    {"given twice", "<MiningField name=\"x\"/><MiningField name=\"x\"/>", 1, "x: Duplicated MiningField!"},
    {"usage", "<MiningField name=\"x\" usageType=\"Active\"/>", 6, "x: invalid usageType -- Active"},
    {"empty usage", "<MiningField name=\"x\" usageType=\"\"/>", 6, "x: invalid usageType -- "},
    {"optype", "<MiningField name=\"x\" optype=\"scale\"/>", 6, "x: invalid optype -- scale"},
    {"outliers", "<MiningField name=\"x\" outliers=\"asMissing\"/>", 6, "x: invalid outliers -- asMissing"},
    {"missing treatment", "<MiningField name=\"x\" missingValueTreatment=\"asMax\"/>", 6,
     "x: invalid missingValueTreatment -- asMax"},
    {"invalid treatment", "<MiningField name=\"x\" invalidValueTreatment=\"ignore\"/>", 6,
     "x: invalid invalidValueTreatment -- ignore"},
    {"low value", "<MiningField name=\"x\" lowValue=\"1,5\"/>", 3, "x: invalid lowValue -- 1,5"},
    {"high value", "<MiningField name=\"x\" highValue=\"much\"/>", 3, "x: invalid highValue -- much"},
    {"margins the wrong way", "<MiningField name=\"x\" lowValue=\"2\" highValue=\"1\"/>", 6,
     "x: lowValue is above highValue"},
    {"replacement of the wrong type", "<MiningField name=\"x\" missingValueReplacement=\"none\"/>", 7,
     "x: invalid missingValueReplacement -- none"},
    {"empty replacement of a number", "<MiningField name=\"n\" missingValueReplacement=\"\"/>", 7,
     "n: invalid missingValueReplacement -- "},
    {"invalid replacement", "<MiningField name=\"x\" invalidValueReplacement=\"none\"/>", 7,
     "x: invalid invalidValueReplacement -- none"},
    {"asValue without value", "<MiningField name=\"x\" invalidValueTreatment=\"asValue\"/>", 6,
     "x: invalidValueReplacement is required"},
    {"continuous text", "<MiningField name=\"g\" optype=\"continuous\"/>", 11,
     "g: string variable can't be continuous!!"},
};

TEST(MiningSchema, Refusals) {
  for (const auto& row : kRefusalRows) {
    const auto dictionary = TestDictionary();
    ExpectFault([&] { ReadSchema(row.fields, *dictionary); }, row.code, row.message, row.why);
  }
}

TEST(MiningSchema, FaultsHaveAPlace) {
  const auto dictionary = TestDictionary();
  try {
    ReadSchema("\n<MiningField name=\"x\"/>\n<MiningField name=\"w\"/>", *dictionary);
    ADD_FAILURE();
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetLine(), 3u);
  }
}

}  // namespace
