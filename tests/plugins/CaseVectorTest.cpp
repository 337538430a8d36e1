#include "plugins/support/CaseVector.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "plugins/support/MiningSchema.h"
#include "tests/plugins/ModelText.h"

namespace {

using namespace MCKestrel_800;
using kestrel_tests::Cell;
using kestrel_tests::RecordOf;

constexpr double kSysmis = NumericValue::gSysmisValue;
constexpr double kMissing = CaseVector::kMissingCategory;
constexpr double kOther = CaseVector::kOtherCategory;
constexpr unsigned kOk = CaseVector::kComplete;
constexpr unsigned kNoNumber = CaseVector::kMissingNumber;
constexpr unsigned kRefused = CaseVector::kInvalidInput;

/// A vector over the fields of TestFields plus u (9 is missing, valid from 0 to 100) and d (days since 1970).
class Inputs {
 public:
  explicit Inputs(const std::string& fields)
      : dictionary_(kestrel_test::ReadDictionary(kestrel_test::DictionaryOf(
            11, std::string(kestrel_tests::TestFields()) +
                    "<DataField name=\"u\" optype=\"continuous\" dataType=\"double\"><Value value=\"9\" "
                    "property=\"missing\"/><Interval closure=\"closedClosed\" leftMargin=\"0\" "
                    "rightMargin=\"100\"/>"
                    "</DataField><DataField name=\"d\" optype=\"continuous\" "
                    "dataType=\"dateDaysSince[1970]\"/>"))),
        schema_(MiningSchema::Read(
            kestrel_test::ReadTree("<MiningSchema>" + fields + "</MiningSchema>")->GetRoot(),
            dictionary_.get())) {}

  const MiningField& Field(const std::string& name) const { return *schema_.Find(name); }

  /// The same fields with one more, "copy", which is derived and a copy of the field of that name.
  const MiningField& AddCopyOf(const std::string& name) {
    const ScoreDictVar& variable = *dictionary_->GetVar(name);
    auto copy = std::make_unique<TransformVar>("copy", variable.GetVarType());
    copy->SetMLevel(variable.GetMLevel());
    copy->AddFieldNameAndTransExpression(name, TransExpression::kFieldRef);
    derived_.AddVar("copy", copy.release());
    derived_.AddDerievedVarName("copy");
    schema_.AddDerivedFields(derived_);
    return *schema_.FindInput("copy");
  }
  void SealWithCopy() { vector.Seal(schema_, *dictionary_, &derived_); }
  const ScoreValueLabelSet* LabelsOf(const std::string& name) const {
    return dictionary_->GetVar(name)->GetValueLabels();
  }

  CaseVector vector;

 private:
  std::unique_ptr<ScoreDictionary> dictionary_;
  TransformationDictionary derived_;
  MiningSchema schema_;
};

enum Form { kNumber, kCategory };

struct TreatmentRow {
  const char* why;
  std::string name;
  std::string attributes;
  Form form;
  Cell cell;
  unsigned outcome;
  double value;
};

const TreatmentRow kTreatmentRows[] = {
    // Numbers
    {"a number", "x", "", kNumber, 1.5, kOk, 1.5},
    {"an empty slot", "x", "", kNumber, {}, kNoNumber, kSysmis},
    {"a system-missing number", "x", "", kNumber, kSysmis, kNoNumber, kSysmis},
    {"replaced", "x", "missingValueReplacement='4'", kNumber, kSysmis, kOk, 4.0},
    {"replaced where empty", "x", "missingValueReplacement='4'", kNumber, {}, kOk, 4.0},
    {"present, so not replaced", "x", "missingValueReplacement='4'", kNumber, 0.0, kOk, 0.0},
    {"refused when missing", "x", "missingValueTreatment='returnInvalid'", kNumber, kSysmis, kRefused, 0},
    {"refused in spite of a replacement",
     "x",
     "missingValueTreatment='returnInvalid' missingValueReplacement='4'",
     kNumber,
     {},
     kRefused,
     0},
    {"a text is invalid", "x", "", kNumber, "1.5", kRefused, 0},
    {"an invalid text as missing", "x", "invalidValueTreatment='asMissing'", kNumber, "1.5", kNoNumber,
     kSysmis},
    {"an invalid text as missing, replaced", "x",
     "invalidValueTreatment='asMissing' missingValueReplacement='4'", kNumber, "q", kOk, 4.0},
    {"an invalid text as a value", "x", "invalidValueTreatment='asValue' invalidValueReplacement='6'",
     kNumber, "q", kOk, 6.0},
    {"a missing number is not an invalid one", "x",
     "invalidValueTreatment='asValue' invalidValueReplacement='6'", kNumber, kSysmis, kNoNumber, kSysmis},
    {"an invalid text as it is", "x", "invalidValueTreatment='asIs'", kNumber, "1.5", kOk, 1.5},
    {"no number in it", "x", "invalidValueTreatment='asIs'", kNumber, "1.5x", kNoNumber, kSysmis},
    {"no number in it, replaced", "x", "invalidValueTreatment='asIs' missingValueReplacement='4'", kNumber,
     "", kOk, 4.0},
    // User-missing numbers and intervals
    {"user-missing", "u", "", kNumber, 9.0, kNoNumber, kSysmis},
    {"user-missing, replaced", "u", "missingValueReplacement='4'", kNumber, 9.0, kOk, 4.0},
    {"outside the interval is missing", "u", "missingValueReplacement='4'", kNumber, 100.5, kOk, 4.0},
    {"on the margin", "u", "", kNumber, 100.0, kOk, 100.0},
    // Outliers
    {"an outlier as it is", "x", "outliers='asIs' lowValue='0' highValue='10'", kNumber, 11.0, kOk, 11.0},
    {"above, as extreme", "x", "outliers='asExtremeValues' lowValue='0' highValue='10'", kNumber, 11.0, kOk,
     10.0},
    {"below, as extreme", "x", "outliers='asExtremeValues' lowValue='0' highValue='10'", kNumber, -1.0, kOk,
     0.0},
    {"on the margin", "x", "outliers='asExtremeValues' lowValue='0' highValue='10'", kNumber, 10.0, kOk,
     10.0},
    {"inside", "x", "outliers='asExtremeValues' lowValue='0' highValue='10'", kNumber, 5.0, kOk, 5.0},
    {"one margin alone", "x", "outliers='asExtremeValues' highValue='10'", kNumber, -1e9, kOk, -1e9},
    {"above, as missing", "x", "outliers='asMissingValues' lowValue='0' highValue='10'", kNumber, 11.0,
     kNoNumber, kSysmis},
    {"above, as missing, replaced", "x",
     "outliers='asMissingValues' lowValue='0' highValue='10' missingValueReplacement='50'", kNumber, 11.0,
     kOk, 50},
    {"above, as missing, refused", "x",
     "outliers='asMissingValues' highValue='10' missingValueTreatment='returnInvalid'", kNumber, 11.0,
     kRefused, 0},
    {"a missing number is no outlier", "x", "outliers='asExtremeValues' lowValue='0' highValue='10'", kNumber,
     kSysmis, kNoNumber, kSysmis},
    {"a replacement is no outlier",
     "x",
     "outliers='asExtremeValues' lowValue='0' highValue='10' missingValueReplacement='50'",
     kNumber,
     {},
     kOk,
     50},
    {"a value used as it is is no outlier", "x",
     "outliers='asExtremeValues' lowValue='0' highValue='10' invalidValueTreatment='asIs'", kNumber, "50",
     kOk, 50},
    {"categories have no outliers", "n", "outliers='asExtremeValues' lowValue='0' highValue='2'", kNumber,
     3.0, kOk, 3.0},
    // Coded categories as numbers
    {"a listed number", "n", "", kNumber, 2.0, kOk, 2.0},
    {"a number that is not listed", "n", "", kNumber, 4.0, kRefused, 0},
    {"a number that is not listed, as it is", "n", "invalidValueTreatment='asIs'", kNumber, 4.0, kOk, 4.0},
    {"any number when the field is continuous here", "n", "optype='continuous'", kNumber, 4.0, kOk, 4.0},
    // Coded categories
    {"a coded category", "n", "", kCategory, 2.0, kOk, 1.0},
    {"within the tolerance", "n", "", kCategory, 2.0000000000000004, kOk, 1.0},
    {"a missing code", "n", "", kCategory, kSysmis, kOk, kMissing},
    {"a missing code, replaced", "n", "missingValueReplacement='3'", kCategory, {}, kOk, 2.0},
    {"an unknown code", "n", "", kCategory, 4.0, kRefused, 0},
    {"an unknown code as it is", "n", "invalidValueTreatment='asIs'", kCategory, 4.0, kOk, kOther},
    {"an outlier's margin as category", "x", "outliers='asExtremeValues' highValue='2'", kCategory, 7.0, kOk,
     0.0},
    // Texts
    {"a category", "g", "", kCategory, "b", kOk, 1.0},
    {"with trailing blanks", "g", "", kCategory, "c  ", kOk, 2.0},
    {"an empty slot", "g", "", kCategory, {}, kOk, kMissing},
    {"the text that SetMissingValue leaves", "g", "", kCategory, "", kOk, kMissing},
    {"replaced", "g", "missingValueReplacement='c'", kCategory, "", kOk, 2.0},
    {"replaced by another value", "g", "missingValueReplacement='q'", kCategory, {}, kOk, kOther},
    {"refused when missing", "g", "missingValueTreatment='returnInvalid'", kCategory, {}, kRefused, 0},
    {"an unknown category", "g", "", kCategory, "q", kRefused, 0},
    {"case counts", "g", "", kCategory, "B", kRefused, 0},
    {"an unknown category as missing", "g", "invalidValueTreatment='asMissing'", kCategory, "q", kOk,
     kMissing},
    {"an unknown category as missing, replaced", "g",
     "invalidValueTreatment='asMissing' missingValueReplacement='a'", kCategory, "q", kOk, 0.0},
    {"an unknown category as it is", "g", "invalidValueTreatment='asIs'", kCategory, "q", kOk, kOther},
    {"an unknown category as a value", "g", "invalidValueTreatment='asValue' invalidValueReplacement='b'",
     kCategory, "q", kOk, 1.0},
    {"a number in place of a text", "g", "", kCategory, 1.0, kRefused, 0},
    {"a field without list takes every text", "t", "", kCategory, "q", kOk, kOther},
    {"the empty one, too", "t", "missingValueReplacement='a'", kCategory, "", kOk, kOther},
    {"but not an empty slot", "t", "", kCategory, {}, kOk, kMissing},
};

TEST(CaseVector, TreatsValuesAsTheSchemaSays) {
  for (const auto& row : kTreatmentRows) {
    SCOPED_TRACE(std::string(row.name) + ": " + row.why);
    std::string attributes = row.attributes;
    for (char& c : attributes)
      c = c == '\'' ? '"' : c;
    Inputs inputs("<MiningField name=\"" + row.name + "\" " + attributes + "/>");
    const MiningField& field = inputs.Field(row.name);
    CaseVector& vector = inputs.vector;
    const int slot = row.form == kNumber ? vector.AddNumber(field) : vector.AddCategory(field);
    if (row.name == "x" && row.form == kCategory) vector.AddCategoryValue(slot, NumericValue(2.0));
    vector.Seal();
    ASSERT_EQ(vector.Fill(RecordOf({{row.name, row.cell}})), row.outcome);
    if (row.outcome == kRefused) {
      EXPECT_EQ(vector.GetInvalidField(), 0);
    } else {
      EXPECT_EQ(vector.GetValues()[slot], row.value);
    }
  }
}

// A derived field that copies a field is what the field itself is.
TEST(CaseVector, DerivedFieldsSeeTheTreatedValue) {
  for (const auto& row : kTreatmentRows) {
    SCOPED_TRACE(std::string(row.name) + ": " + row.why);
    // A derived field calls the empty text missing, a text without list does not; and it gives the values
    // that a field calls missing as they are.
    if ((row.name == "t" && row.cell == Cell("")) || (row.name == "u" && row.attributes.empty())) continue;
    std::string attributes = row.attributes;
    std::replace(attributes.begin(), attributes.end(), '\'', '"');
    Inputs inputs("<MiningField name=\"" + row.name + "\" " + attributes + "/>");
    const MiningField& field = inputs.AddCopyOf(row.name);
    CaseVector& vector = inputs.vector;
    const int slot = row.form == kNumber ? vector.AddNumber(field) : vector.AddCategory(field);
    if (row.name == "x" && row.form == kCategory) vector.AddCategoryValue(slot, NumericValue(2.0));
    if (row.form == kCategory && inputs.LabelsOf(row.name) != nullptr) {
      for (const ScoreValueLabel* label : inputs.LabelsOf(row.name)->GetAllValueLabels())
        vector.AddCategoryValue(slot, *label->GetValue());
    }
    inputs.SealWithCopy();
    ASSERT_EQ(vector.Fill(RecordOf({{row.name, row.cell}})), row.outcome);
    if (row.outcome == kRefused) {
      EXPECT_EQ(vector.GetInvalidField(), 0);
    } else {
      EXPECT_EQ(vector.GetValues()[slot], row.value);
    }
  }
}

TEST(CaseVector, AnInputAskedForTwiceIsOneSlot) {
  Inputs inputs("<MiningField name=\"x\"/><MiningField name=\"n\"/>");
  CaseVector& vector = inputs.vector;
  EXPECT_EQ(vector.AddNumber(inputs.Field("x")), 0);
  EXPECT_EQ(vector.AddNumber(inputs.Field("n")), 1);
  EXPECT_EQ(vector.AddCategory(inputs.Field("n")), 2);
  EXPECT_EQ(vector.AddNumber(inputs.Field("x")), 0);
  EXPECT_EQ(vector.AddCategory(inputs.Field("n")), 2);
  EXPECT_EQ(vector.AddNumber(inputs.Field("x"), 5.0), 3);
  EXPECT_EQ(vector.AddNumber(inputs.Field("x"), 5.0), 3);
  vector.Seal();
  EXPECT_EQ(vector.GetSlotCount(), 4);
  ASSERT_EQ(vector.GetPredictors().size(), 2u);
  EXPECT_EQ(vector.GetPredictors()[0]->GetName(), "x");
  EXPECT_EQ(vector.Fill(RecordOf({{"n", 2.0}, {"x", kSysmis}})), kNoNumber);
  EXPECT_EQ(vector.GetValues()[3], 5.0);
  EXPECT_EQ(vector.GetValues()[2], 1.0);
  EXPECT_EQ(vector.GetValues()[1], 2.0);
  EXPECT_EQ(vector.GetValues()[0], kSysmis);
}

TEST(CaseVector, RecordsOfAnyLayoutWork) {
  Inputs inputs(
      "<MiningField name=\"x\"/><MiningField name=\"g\"/><MiningField name=\"z\" "
      "missingValueReplacement=\"8\"/>");
  CaseVector& vector = inputs.vector;
  const int x = vector.AddNumber(inputs.Field("x"));
  const int g = vector.AddCategory(inputs.Field("g"));
  const int z = vector.AddNumber(inputs.Field("z"));
  vector.Seal();
  CaseRecord first = RecordOf({{"x", 1.0}, {"g", "a"}, {"z", 3.0}});
  CaseRecord second = RecordOf({{"other", 5.0}, {"z", 6.0}, {"g", "b"}, {"x", 7.0}});
  CaseRecord third = RecordOf({{"x", 9.0}});
  for (int round = 0; round < 3; ++round) {
    EXPECT_EQ(vector.Fill(first), kOk);
    EXPECT_EQ(vector.GetValues()[x], 1.0);
    EXPECT_EQ(vector.GetValues()[g], 0.0);
    EXPECT_EQ(vector.GetValues()[z], 3.0);
    EXPECT_EQ(vector.Fill(second), kOk);
    EXPECT_EQ(vector.GetValues()[x], 7.0);
    EXPECT_EQ(vector.GetValues()[g], 1.0);
    EXPECT_EQ(vector.GetValues()[z], 6.0);
    EXPECT_EQ(vector.Fill(third), kOk);
    EXPECT_EQ(vector.GetValues()[x], 9.0);
    EXPECT_EQ(vector.GetValues()[g], kMissing);
    EXPECT_EQ(vector.GetValues()[z], 8.0);
  }
  third.Add("z", new NumericValue(10.0));
  EXPECT_EQ(vector.Fill(third), kOk);
  EXPECT_EQ(vector.GetValues()[z], 10.0);
  EXPECT_EQ(vector.Fill(CaseRecord(0)), kNoNumber);
}

/// A record that promises nothing about its layout.
class StamplessRecord : public CaseRecord {
 public:
  using CaseRecord::CaseRecord;
  explicit StamplessRecord(const CaseRecord& other) : CaseRecord(other) {}
  unsigned long long GetLayoutStamp() const override { return 0; }
};

TEST(CaseVector, RecordsWithoutStampAreLookedUpEachTime) {
  Inputs inputs("<MiningField name=\"x\"/><MiningField name=\"g\"/>");
  const int x = inputs.vector.AddNumber(inputs.Field("x"));
  const int g = inputs.vector.AddCategory(inputs.Field("g"));
  inputs.vector.Seal();
  for (int round = 0; round < 2; ++round) {
    EXPECT_EQ(inputs.vector.Fill(StamplessRecord(RecordOf({{"x", 1.0}, {"g", "a"}}))), kOk);
    EXPECT_EQ(inputs.vector.GetValues()[x], 1.0);
    EXPECT_EQ(inputs.vector.Fill(StamplessRecord(RecordOf({{"g", "c"}, {"x", 2.0}}))), kOk);
    EXPECT_EQ(inputs.vector.GetValues()[x], 2.0);
    EXPECT_EQ(inputs.vector.GetValues()[g], 2.0);
  }
}

TEST(CaseVector, DatesCountInTheirFieldsUnit) {
  Inputs inputs(
      "<MiningField name=\"d\" outliers=\"asExtremeValues\" highValue=\"100\" "
      "missingValueReplacement=\"3\"/>");
  const int d = inputs.vector.AddNumber(inputs.Field("d"));
  inputs.vector.Seal();
  CaseRecord record;
  record.Add("d", new DateTimeValue(10.0, kDateDaysSince1970));
  EXPECT_EQ(inputs.vector.Fill(record), kOk);
  EXPECT_EQ(inputs.vector.GetValues()[d], 10.0);
  record.SetValue("d", 101.0, kDateDaysSince1970);
  EXPECT_EQ(inputs.vector.Fill(record), kOk);
  EXPECT_EQ(inputs.vector.GetValues()[d], 100.0);
  record.SetMissingValue("d");
  EXPECT_EQ(inputs.vector.Fill(record), kOk);
  EXPECT_EQ(inputs.vector.GetValues()[d], 3.0);
}

TEST(CaseVector, TheFirstRefusedFieldIsTold) {
  Inputs inputs("<MiningField name=\"x\"/><MiningField name=\"g\"/><MiningField name=\"n\"/>");
  inputs.vector.AddNumber(inputs.Field("n"));
  inputs.vector.AddCategory(inputs.Field("g"));
  inputs.vector.AddNumber(inputs.Field("x"));
  inputs.vector.Seal();
  EXPECT_EQ(inputs.vector.Fill(RecordOf({{"x", "?"}, {"n", 1.0}, {"g", "?"}})), kRefused);
  EXPECT_EQ(inputs.vector.GetInvalidField(), 1);
  EXPECT_EQ(inputs.vector.Fill(RecordOf({{"x", "?"}, {"n", kSysmis}, {"g", "a"}})), kRefused | kNoNumber);
  EXPECT_EQ(inputs.vector.GetInvalidField(), 2);
}

}  // namespace
