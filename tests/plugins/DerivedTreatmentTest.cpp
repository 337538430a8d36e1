// What derived fields see of a case: the values as the mining schema makes them.

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "tests/plugins/DerivedModelText.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

constexpr double kMissing = NumericValue::gSysmisValue;
const std::string kCurve = LinearNorm("0", "0") + LinearNorm("10", "1") + LinearNorm("20", "3");

struct TreatmentRow {
  const char* why;
  std::string treatment;   ///< attributes of the one mining field that the derived field reads
  std::string expression;  ///< of the derived field d, which is the prediction
  Cell cell;               ///< the field's value
  std::string want;
};

const TreatmentRow kNumberRows[] = {
    {"no treatment", "", FieldRef("x"), 3.0, "3"},
    {"a missing number", "", FieldRef("x"), kMissing, "90027"},
    {"no number", "", FieldRef("x"), {}, "90027"},
    {"replaced before it is read", "missingValueReplacement='4'", FieldRef("x"), kMissing, "4"},
    {"replaced where the case has none", "missingValueReplacement='4'", FieldRef("x"), {}, "4"},
    {"replaced before it is computed with", "missingValueReplacement='4'",
     Apply("*", FieldRef("x") + Constant("2")), kMissing, "8"},
    {"the schema's replacement goes before the expression's", "missingValueReplacement='4'",
     NormContinuous("x", kCurve, "mapMissingTo='7'"), kMissing, "0.4"},
    {"the expression's where the schema has none", "", NormContinuous("x", kCurve, "mapMissingTo='7'"),
     kMissing, "7"},
    {"and where the case has no value", "", NormContinuous("x", kCurve, "mapMissingTo='7'"), {}, "7"},
    {"an outlier as it is", "outliers='asIs' lowValue='0' highValue='10'", NormContinuous("x", kCurve), 20.0,
     "3"},
    {"cut off before the curve", "outliers='asExtremeValues' lowValue='0' highValue='10'",
     NormContinuous("x", kCurve), 20.0, "1"},
    {"cut off below", "outliers='asExtremeValues' lowValue='5' highValue='10'", NormContinuous("x", kCurve),
     -1.0, "0.5"},
    {"an outlier as missing", "outliers='asMissingValues' highValue='10'", NormContinuous("x", kCurve), 20.0,
     "90027"},
    {"an outlier as missing, mapped", "outliers='asMissingValues' highValue='10'",
     NormContinuous("x", kCurve, "mapMissingTo='7'"), 20.0, "7"},
    {"an outlier as missing, replaced",
     "outliers='asMissingValues' highValue='10' missingValueReplacement='5'", NormContinuous("x", kCurve),
     20.0, "0.5"},
    {"a missing value that is refused", "missingValueTreatment='returnInvalid'", FieldRef("x"), kMissing,
     "90025/0"},
    {"refused although the expression has a replacement",
     "missingValueTreatment='returnInvalid'",
     NormContinuous("x", kCurve, "mapMissingTo='7'"),
     {},
     "90025/0"},
    {"a text is invalid", "", FieldRef("x"), "1.5", "90025/0"},
    {"a text as it is: the number that it reads as", "invalidValueTreatment='asIs'", FieldRef("x"), "1.5",
     "1.5"},
    {"a text that reads as none", "invalidValueTreatment='asIs'", FieldRef("x"), "q", "90027"},
    {"a text as missing", "invalidValueTreatment='asMissing' missingValueReplacement='4'", FieldRef("x"), "q",
     "4"},
    {"a text as a value", "invalidValueTreatment='asValue' invalidValueReplacement='6'", FieldRef("x"), "q",
     "6"},
};

const TreatmentRow kTextRows[] = {
    {"a category", "", NormDiscrete("g", "b"), "b", "1"},
    {"another category", "", NormDiscrete("g", "b"), "a", "0"},
    {"replaced", "missingValueReplacement='b'", NormDiscrete("g", "b"), {}, "1"},
    {"the empty text is missing", "missingValueReplacement='b'", NormDiscrete("g", "b"), "", "1"},
    {"and stays it without replacement", "", NormDiscrete("g", "b", "mapMissingTo='5'"), "", "5"},
    {"an unknown category is refused", "", NormDiscrete("g", "b"), "q", "90025/0"},
    {"as it is", "invalidValueTreatment='asIs'", NormDiscrete("g", "b"), "q", "0"},
    {"as missing", "invalidValueTreatment='asMissing'", NormDiscrete("g", "b", "mapMissingTo='5'"), "q", "5"},
    {"as missing, replaced", "invalidValueTreatment='asMissing' missingValueReplacement='b'",
     NormDiscrete("g", "b"), "q", "1"},
    {"as a value", "invalidValueTreatment='asValue' invalidValueReplacement='b'", NormDiscrete("g", "b"), "q",
     "1"},
    {"missing and refused", "missingValueTreatment='returnInvalid'", NormDiscrete("g", "b"), "", "90025/0"},
    {"a table", "missingValueReplacement='c'", Map("g", "1", "2", "3"), {}, "3"},
};

void ExpectRow(const TreatmentRow& row, const std::string& source) {
  const std::string fields = "<MiningField name='" + source + "' " + row.treatment + "/>";
  const std::string field = Derived("d", "continuous double", row.expression);
  const Case cells = {{source, row.cell}};
  EXPECT_EQ(ScoreOf(DerivedDocument{field, "", fields}.Regression(Number("d")), cells), row.want)
      << row.why << ", a field of the document";
  EXPECT_EQ(ScoreOf(DerivedDocument{"", field, fields}.Regression(Number("d")), cells), row.want)
      << row.why << ", a field of the model";
  // The field's own slot and what the derived field sees do not disturb each other.
  const std::string also = Derived("e", "continuous double", FieldRef("d"));
  EXPECT_EQ(
      ScoreOf(DerivedDocument{field, also, fields}.Regression(Number("d", "2") + Number("e", "-1")), cells),
      row.want)
      << row.why << ", through another derived field";
}

TEST(DerivedTreatment, NumbersAreTreatedBeforeTheyAreRead) {
  for (const TreatmentRow& row : kNumberRows)
    ExpectRow(row, "x");
}

TEST(DerivedTreatment, TextsAreTreatedBeforeTheyAreRead) {
  for (const TreatmentRow& row : kTextRows)
    ExpectRow(row, "g");
}

TEST(DerivedTreatment, AFieldThatIsNotInTheSchemaIsReadAsItIs) {
  const DerivedDocument document{"", Derived("d", "continuous double", NormDiscrete("g", "b")),
                                 "<MiningField name='x'/>"};
  const auto model = BuildAny(document.Regression(Number("d") + Number("x")));
  EXPECT_EQ(ScoreOf(*model, {{"x", 2.0}, {"g", "b"}}), "3");
  EXPECT_EQ(ScoreOf(*model, {{"x", 2.0}, {"g", "q"}}), "2");
  ASSERT_EQ(model->GetPredictors().size(), 2u);
  EXPECT_EQ(model->GetPredictors()[0], model->GetDictionary()->GetVar("g"));
  EXPECT_EQ(model->GetPredictors()[1], model->GetDictionary()->GetVar("x"));
  EXPECT_EQ(model->GetVarRole("g"), -1);
}

TEST(DerivedTreatment, AFieldThatNoUsedFieldReadsRefusesNothing) {
  const DerivedDocument document{"", Derived("d", "continuous double", FieldRef("x")) +
                                         Derived("e", "continuous double", NormDiscrete("g", "b"))};
  const auto model = BuildAny(document.Regression(Number("d")));
  EXPECT_EQ(ScoreOf(*model, {{"x", 2.0}, {"g", "q"}}), "2");
  ASSERT_EQ(model->GetPredictors().size(), 1u);
}

TEST(DerivedTreatment, ASupplementaryFieldIsTreatedToo) {
  const DerivedDocument document{
      "", Derived("d", "continuous double", FieldRef("z")),
      "<MiningField name='x'/><MiningField name='z' usageType='supplementary' missingValueReplacement='4'/>"};
  EXPECT_EQ(ScoreOf(document.Regression(Number("d")), {{"x", 1.0}}), "4");
}

TEST(DerivedTreatment, TellsWhichInputWasRefused) {
  const DerivedDocument document{
      "", Derived("d", "continuous double", Apply("+", FieldRef("z") + FieldRef("n"))) +
              Derived("f", "continuous double", NormDiscrete("g", "b"))};
  const auto model = BuildAny(document.Regression(Number("x") + Number("d") + Number("f")));
  ASSERT_EQ(model->GetPredictors().size(), 4u);
  const char* const names[] = {"x", "z", "n", "g"};
  for (int i = 0; i < 4; ++i)
    EXPECT_EQ(model->GetPredictors()[static_cast<size_t>(i)]->GetName(), names[i]);
  const Case valid = {{"x", 1.0}, {"z", 2.0}, {"n", 3.0}, {"g", "b"}};
  EXPECT_EQ(ScoreOf(*model, valid), "7");
  for (std::size_t i = 0; i < valid.size(); ++i) {
    Case refused = valid;
    refused[i].second = i == 3 ? Cell("q") : Cell("text");
    EXPECT_EQ(ScoreOf(*model, refused), "90025/" + std::to_string(i));
  }
}

// A derived field in the schema: its value is treated, for the model and for the fields that read it.
TEST(DerivedTreatment, ADerivedMiningFieldIsTreated) {
  const std::string half = Derived("h", "continuous double", Apply("/", FieldRef("x") + Constant("2")));
  const std::string inverse = Derived("i", "continuous double", Apply("/", Constant("1") + FieldRef("h")));
  const std::string next = Derived("j", "continuous double", Apply("+", FieldRef("i") + FieldRef("h")));
  struct Row {
    const char* why;
    std::string h, i;  ///< treatment
    Cell x;
    std::string want_h, want_i, want_j;
  };
  const Row rows[] = {
      {"no treatment", "", "", 8.0, "4", "0.25", "4.25"},
      {"missing", "", "", kMissing, "90027", "90027", "90027"},
      {"replaced", "missingValueReplacement='2'", "", kMissing, "2", "0.5", "2.5"},
      {"cut off", "outliers='asExtremeValues' highValue='5'", "", 40.0, "5", "0.2", "5.2"},
      {"as missing", "outliers='asMissingValues' highValue='5'", "", 40.0, "90027", "90027", "90027"},
      {"refused", "missingValueTreatment='returnInvalid'", "", {}, "90025/0", "90025/0", "90025/0"},
      {"the second, too", "missingValueReplacement='2'", "outliers='asExtremeValues' highValue='0.25'",
       kMissing, "2", "0.25", "2.25"},
      {"the second alone", "", "missingValueReplacement='3'", kMissing, "90027", "3", "90027"},
      {"a division by zero is missing", "", "missingValueReplacement='3'", 0.0, "0", "3", "3"},
  };
  for (const Row& row : rows) {
    const DerivedDocument document{
        half + inverse, next,
        "<MiningField name='x'/><MiningField name='h' " + row.h + "/><MiningField name='i' " + row.i + "/>"};
    const Case cells = {{"x", row.x}};
    EXPECT_EQ(ScoreOf(document.Regression(Number("h")), cells), row.want_h) << row.why;
    EXPECT_EQ(ScoreOf(document.Regression(Number("i")), cells), row.want_i) << row.why;
    EXPECT_EQ(ScoreOf(document.Regression(Number("j")), cells), row.want_j) << row.why;
    // Nothing of one case may reach into the next.
    const auto model = BuildAny(document.Regression(Number("j")));
    const std::string other = ScoreOf(*model, {{"x", 2.0}});
    EXPECT_EQ(ScoreOf(*model, cells), row.want_j) << row.why;
    EXPECT_EQ(ScoreOf(*model, {{"x", 2.0}}), other) << row.why;
  }
}

TEST(DerivedTreatment, ADerivedMiningCategoryIsTreated) {
  const std::string bin = Derived("b", "categorical string", Bins("x", "1", "5"));
  const std::string flag = Derived("f", "continuous double", NormDiscrete("b", "mid", "mapMissingTo='7'"));
  struct Row {
    const char* why;
    std::string treatment;
    Cell x;
    std::string want;
  };
  const Row rows[] = {
      {"a bin", "", 3.0, "11"},
      {"another", "", 0.0, "0"},
      {"missing", "", kMissing, "0"},
      {"replaced for both", "missingValueReplacement='mid'", kMissing, "11"},
      {"refused", "missingValueTreatment='returnInvalid'", kMissing, "90025/0"},
  };
  for (const Row& row : rows) {
    const DerivedDocument document{bin, flag,
                                   "<MiningField name='x'/><MiningField name='b' " + row.treatment + "/>"};
    EXPECT_EQ(ScoreOf(document.Regression(Number("f") + Category("b", "mid", "10")), {{"x", row.x}}),
              row.want)
        << row.why;
  }
}

TEST(DerivedTreatment, TheCasesOwnValueUnderADerivedNamePlaysNoPart) {
  const DerivedDocument document{"", Derived("d", "continuous double", FieldRef("x")) +
                                         Derived("e", "continuous double", FieldRef("d"))};
  EXPECT_EQ(ScoreOf(document.Regression(Number("d") + Number("e")), {{"x", 1.0}, {"d", 50.0}, {"e", 60.0}}),
            "2");
}

TEST(DerivedTreatment, AnOptypeOfTheSchemaCountsForTheModelsOwnFields) {
  const DerivedDocument document{"",
                                 Derived("d", "continuous double", Apply("*", FieldRef("n") + Constant("2"))),
                                 "<MiningField name='n' optype='continuous'/>"};
  // As a category, 7 would be invalid.
  EXPECT_EQ(ScoreOf(document.Regression(Number("d")), {{"n", 7.0}}), "14");
}

/// A record that promises nothing about its layout.
class UnstampedRecord : public CaseRecord {
 public:
  explicit UnstampedRecord(const CaseRecord& other) : CaseRecord(other) {}
  unsigned long long GetLayoutStamp() const override { return 0; }
};

TEST(DerivedTreatment, RecordsOfAnyLayoutWork) {
  const DerivedDocument document{
      "", Derived("d", "continuous double", Apply("-", FieldRef("x") + FieldRef("z")))};
  const auto model = BuildAny(document.Regression(Number("d") + Number("x", "10")));
  const Case cells = {{"x", 5.0}, {"z", 3.0}};
  const Case turned = {{"t", "?"}, {"z", 3.0}, {"g", "?"}, {"x", 5.0}};
  EXPECT_EQ(ScoreOf(*model, cells), "52");
  EXPECT_EQ(ScoreOf(*model, turned), "52");
  EXPECT_EQ(ScoreOf(*model, UnstampedRecord(RecordOf(turned))), "52");
  EXPECT_EQ(ScoreOf(*model, UnstampedRecord(RecordOf(cells))), "52");
  EXPECT_EQ(ScoreOf(*model, {{"x", 5.0}}), "90027");
  EXPECT_EQ(ScoreOf(*model, cells), "52");
}

}  // namespace
}  // namespace kestrel_tests
