// Values of a host's own classes count by what they say of themselves; nothing is read that they do not have.

#include "tests/plugins/ForeignValue.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/model/Results.h"
#include "plugins/support/ValueRules.h"
#include "tests/plugins/ModelText.h"

namespace {

using namespace MCKestrel_800;
using kestrel_tests::BuildModel;
using kestrel_tests::ForeignValue;

TEST(ForeignValues, TextsAreJudgedByTheirString) {
  DictVar listed("g", ScoreDictVar::STRING_VAR);
  listed.SetMLevel(ScoreDictVar::kNominal);
  listed.AddScoreValueLabel(new StringValue("a"), "A");
  listed.AddScoreValueLabel(new StringValue("b"), "B");
  ValueRules rules(listed);
  EXPECT_EQ(rules.AddCategory(ForeignValue("b")), 1);
  EXPECT_EQ(rules.AddCategory(ForeignValue("c")), ValueRules::kUnknown);
  rules.Seal();
  for (const char* text : {"a", "b", "b ", "c", "", "a text that is too long to be kept in place"}) {
    SCOPED_TRACE(text);
    const ForeignValue foreign(text);
    EXPECT_EQ(rules.Judge(&foreign) == ValueRules::kValid, listed.IsValidValue(&foreign));
    EXPECT_EQ(rules.FindCode(foreign), rules.FindCode(StringValue(text)));
  }

  const DictVar open("t", ScoreDictVar::STRING_VAR);
  ValueRules codes(open);
  EXPECT_EQ(codes.AddCategory(ForeignValue("p")), 0);
  EXPECT_EQ(codes.AddCategory(StringValue("q")), 1);
  codes.Seal();
  EXPECT_EQ(codes.FindCode(ForeignValue("q")), 1);
  EXPECT_EQ(codes.FindCode(ForeignValue("r")), ValueRules::kUnknown);
}

/// y = 1 if g is "a", 2 if it is "b"; 4 if t is "long"; x, which takes texts as numbers; and d in days.
std::unique_ptr<ScoreModel> MakeModel() {
  return BuildModel(
      "<PMML version='4.4'>" +
      kestrel_test::DictionaryOf(
          10, std::string(kestrel_tests::TestFields()) +
                  "<DataField name='d' optype='continuous' dataType='dateDaysSince[1970]'/>") +
      "<RegressionModel functionName='regression'><MiningSchema><MiningField name='g' "
      "missingValueReplacement='b'/><MiningField name='t'/><MiningField name='x' "
      "invalidValueTreatment='asIs'/><MiningField name='d'/><MiningField name='y' usageType='target'/>"
      "</MiningSchema><RegressionTable>"
      "<CategoricalPredictor name='g' value='a' coefficient='1'/>"
      "<CategoricalPredictor name='g' value='b' coefficient='2'/>"
      "<CategoricalPredictor name='t' value='long' coefficient='4'/>"
      "<NumericPredictor name='x' coefficient='1'/><NumericPredictor name='d' coefficient='1'/>"
      "</RegressionTable></RegressionModel></PMML>");
}

TEST(ForeignValues, ScoreAsTheLibrarysOwn) {
  constexpr double kMissing = NumericValue::gSysmisValue;
  const ForeignValue zero(ScoreValue::kNumeric, 0.0);
  const ForeignValue day(ScoreValue::kDateTime, 86400.0);
  const struct {
    const char* why;
    ForeignValue g, t, x, d;
    bool scores;
    double y;
  } kRows[] = {
      {"texts", ForeignValue("a"), ForeignValue("long"), zero, day, true, 6.0},
      {"an unknown category", ForeignValue("z"), ForeignValue("long"), zero, day, false, 0.0},
      {"another text", ForeignValue("b"), ForeignValue("short"), zero, day, true, 3.0},
      {"the empty text is missing", ForeignValue(""), ForeignValue(""), zero, day, true, 3.0},
      {"numbers", ForeignValue("a"), ForeignValue(""), ForeignValue(ScoreValue::kNumeric, 16.5), day, true,
       18.5},
      {"a text as a number", ForeignValue("a"), ForeignValue(""), ForeignValue("16.5"), day, true, 18.5},
      {"a text that is no number", ForeignValue("a"), ForeignValue(""), ForeignValue("16,5"), day, false,
       0.0},
      {"a missing number", ForeignValue("a"), ForeignValue(""), ForeignValue(ScoreValue::kNumeric, kMissing),
       day, false, 0.0},
      {"a date in its field's unit", ForeignValue("a"), ForeignValue(""), zero,
       ForeignValue(ScoreValue::kDateTime, 86400.0 * 2.5), true, 3.5},
  };
  const std::unique_ptr<ScoreModel> model = MakeModel();
  for (const auto& row : kRows) {
    SCOPED_TRACE(row.why);
    CaseRecord record(4);
    record.Add("g", row.g.Clone());
    record.Add("t", row.t.Clone());
    record.Add("x", row.x.Clone());
    record.Add("d", row.d.Clone());
    RegResult result;
    ASSERT_EQ(model->Score(&record, &result).IsOK(), row.scores);
    if (!row.scores) continue;
    EXPECT_EQ(result.GetPrediction()->GetDouble(), row.y);
  }
}

}  // namespace
