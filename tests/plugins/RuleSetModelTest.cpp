#include "plugins/rule_set/RuleSetModel.h"

#include <gtest/gtest.h>

#include <memory>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/dictionary/ValueProbability.h"
#include "kestrel/dictionary/ValueProbabilitySet.h"
#include "kestrel/model/ScoreVersionInfo.h"
#include "tests/plugins/RuleSetText.h"

namespace {

using namespace MCKestrel_800;
using namespace kestrel_tests;

using Cells = std::vector<std::pair<std::string, Cell>>;
constexpr double kSysmis = NumericValue::gSysmisValue;

TEST(RuleSetModel, CasesThatNoRuleFitsFollowThePolicy) {
  const auto model = BuildRegression("firstHit", "defaultConfidence='0.5'", RuleAbove("1", "score='1'"));
  for (const Cell& cell : {Cell(kSysmis), Cell(0.0), Cell()}) {
    const CaseRecord record = RecordOf({{"x", cell}});
    Telling<RegResult> result;
    for (const ScoreModel::MVPolicy policy : {ScoreModel::kNullPrediction, ScoreModel::kDefaultPrediction}) {
      model->SetMissingValuePolicy(policy);
      const NumericValue before(1.0);
      result.SetPrediction(&before);
      const MCScore::MCStatus status = model->Score(&record, &result);
      EXPECT_EQ(status.GetErrorCode(), 90027);
      EXPECT_TRUE(status.IsError());
      EXPECT_EQ(ShowResult(result), "- 0 -");
    }
  }
  const_cast<ScoreDictVar*>(model->GetTargetVar())->SetDefValue(new NumericValue(12.5));
  Telling<RegResult> result;
  const CaseRecord record = RecordOf({{"x", 0.0}});
  EXPECT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(ShowResult(result), "12.5 0 -");
  model->SetMissingValuePolicy(ScoreModel::kNullPrediction);
  EXPECT_EQ(model->Score(&record, &result).GetErrorCode(), 90027);
  EXPECT_EQ(ShowResult(result), "- 0 -");
}

TEST(RuleSetModel, PredictsTheMostProbableCategoryWhereThereIsOne) {
  const auto model = BuildRuleSet(RuleSetDocument("weightedSum", "k", "", RuleAbove("1", "score='yes'")));
  auto probabilities = std::make_unique<ValueProbabilitySet>();
  probabilities->Add(new ValueProbability(new StringValue("yes"), 0.25));
  probabilities->Add(new ValueProbability(new StringValue("no"), 0.75));
  const_cast<ScoreDictVar*>(model->GetTargetVar())->SetValueProbabilities(probabilities.release());
  Telling<ClsResult> result;
  const CaseRecord record(0);
  EXPECT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(ShowResult(result), "no 0.75 -");
  EXPECT_EQ(ShowCategories(result), " yes=0.25 no=0.75");
}

TEST(RuleSetModel, RefusedValuesGiveAnErrorAndNoPrediction) {
  const auto model = BuildRuleSet(RuleSetDocument(
      "firstHit", "k", "defaultScore='no'", RuleAbove("1", "id='r1' score='yes'") + If(kGIsA, "score='no'")));
  Telling<ClsResult> result;
  CaseRecord record = RecordOf({{"x", 2.0}, {"g", "z"}});
  EXPECT_EQ(model->Score(nullptr, &result).GetErrorCode(), 90007);
  EXPECT_EQ(model->Score(&record, nullptr).GetErrorCode(), 90007);
  EXPECT_TRUE(model->Score(nullptr, nullptr).IsError());
  const MCScore::MCStatus status = model->Score(&record, &result);
  EXPECT_EQ(status.GetErrorCode(), 90025);
  EXPECT_TRUE(status.IsError());
  EXPECT_EQ(status.GetDiscreteDatum(0), 1);
  EXPECT_EQ(model->GetPredictors()[1]->GetName(), "g");
  EXPECT_EQ(ShowResult(result), "- 0 -");
  EXPECT_EQ(result.GetCategoryCount(), 0u);
  record.SetValue("g", std::string("b"));
  EXPECT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(ShowResult(result), "yes 1 r1");
}

TEST(RuleSetModel, TreatsValuesAsTheMiningSchemaSays) {
  const auto model = BuildRuleSet(DocumentOf(
      "<RuleSetModel functionName='classification'><MiningSchema><MiningField name='x' "
      "missingValueReplacement='4'/><MiningField name='g' invalidValueTreatment='asMissing'/><MiningField "
      "name='n' invalidValueTreatment='asIs'/></MiningSchema>" +
      RuleSetOf("firstHit", "defaultScore='none'",
                RuleAbove("3", "score='replaced'") +
                    If("<SimplePredicate field='g' operator='isMissing'/>", "score='g is missing'") +
                    If("<SimplePredicate field='n' operator='isMissing'/>", "score='n is missing'") +
                    If("<SimplePredicate field='n' operator='notEqual' value='1'/>", "score='n is not 1'")) +
      "</RuleSetModel>"));
  const struct {
    const char* why;
    Cells cells;
    const char* prediction;
  } kRows[] = {
      {"a replacement is a value like any other", {{"g", "a"}, {"n", 1.0}}, "replaced"},
      {"a listed value", {{"x", 1.0}, {"g", "a"}, {"n", 2.0}}, "n is not 1"},
      {"an invalid one as missing", {{"x", 1.0}, {"g", "z"}, {"n", 1.0}}, "g is missing"},
      {"one that is no category counts as missing", {{"x", 1.0}, {"g", "a"}, {"n", 9.0}}, "n is missing"},
      {"nothing fits", {{"x", 1.0}, {"g", "a"}, {"n", 1.0}}, "none"},
  };
  for (const auto& row : kRows) {
    Telling<ClsResult> result;
    const CaseRecord record = RecordOf(row.cells);
    ASSERT_TRUE(model->Score(&record, &result).IsOK()) << row.why;
    EXPECT_EQ(result.GetPrediction()->GetString(), row.prediction) << row.why;
  }
}

TEST(RuleSetModel, FillsResultsOfTheOtherKind) {
  const auto classification =
      BuildRuleSet(RuleSetDocument("weightedSum", "k", "", Rule("id='r1' score='yes' confidence='0.5'")));
  Telling<RegResult> number;
  const CaseRecord record(0);
  EXPECT_TRUE(classification->Score(&record, &number).IsOK());
  EXPECT_EQ(ShowResult(number), "yes 0.5 r1");
  Telling<ClsResult> categories;
  EXPECT_TRUE(
      BuildRegression("weightedSum", "", Rule("id='r1' score='2'"))->Score(&record, &categories).IsOK());
  EXPECT_EQ(ShowResult(categories), "2 1 r1");
  EXPECT_EQ(categories.GetCategoryCount(), 0u);
}

TEST(RuleSetModel, TellsWhatItIs) {
  const auto model = BuildRuleSet(DocumentOf(
      "<RuleSetModel functionName='classification' modelName='m' algorithmName='a'><Extension/><MiningSchema>"
      "<MiningField name='t' usageType='supplementary'/><MiningField name='z'/><MiningField name='g'/>"
      "<MiningField name='x'/><MiningField name='m' usageType='predicted'/></MiningSchema>"
      "<LocalTransformations/>" +
      RuleSetOf("weightedMax", "defaultScore='blue' defaultConfidence='0.1234567'",
                RuleAbove("1", "id='first' score='red' weight='0.25' confidence='0.75'") + "<CompoundRule>" +
                    kGIsA + RuleAbove("2", "score='green'") + "<CompoundRule><True/></CompoundRule>" +
                    "</CompoundRule>") +
      "</RuleSetModel>"));
  EXPECT_EQ(model->GetModelKind(), "RuleSetModel");
  EXPECT_FALSE(model->SuppressCategoryProbabilities());
  ASSERT_EQ(model->GetPredictors().size(), 2u);
  EXPECT_EQ(model->GetPredictors()[0]->GetName(), "x");
  EXPECT_EQ(model->GetPredictors()[1], model->GetDictionary()->GetVar("g"));
  EXPECT_EQ(model->GetTargetVar()->GetName(), "m");
  EXPECT_EQ(model->GetVarRole("m"), ScoreModel::kTarget);
  EXPECT_EQ(model->GetVarRole("z"), ScoreModel::kPredictor);
  EXPECT_EQ(model->GetVarRole("t"), ScoreModel::kSupplementary);
  EXPECT_EQ(model->GetVarRole("k"), -1);
  EXPECT_EQ(model->GetMissingValuePolicy(), ScoreModel::kDefaultPrediction);
  EXPECT_EQ(model->GetVersionInfo()->GetVersionInfo(), "4.4");
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  EXPECT_NE(dynamic_cast<ClsResult*>(result.get()), nullptr);
  std::ostringstream out;
  model->Display(out);
  EXPECT_EQ(out.str(),
            "Start RuleSetModel Display:\n"
            "Function = classification; Criterion = weightedMax; Target = m\n"
            "Default score = blue; Confidence = 0.123457\n"
            "\tSimpleRule first; Score = red; Weight = 0.25; Confidence = 0.75\n"
            "\tCompoundRule; Rules inside = 2\n"
            "\tSimpleRule #2; Score = green; Weight = 1; Confidence = 1\n"
            "\tCompoundRule; Rules inside = 0\n"
            "End of RuleSetModel Display.\n\n");
  const auto regression = BuildRegression("firstHit", "defaultScore='2'", "");
  const std::unique_ptr<ScoreResult> number(regression->MakeResult());
  EXPECT_NE(dynamic_cast<RegResult*>(number.get()), nullptr);
  std::ostringstream shown;
  regression->Display(shown);
  EXPECT_EQ(shown.str(),
            "Start RuleSetModel Display:\n"
            "Function = regression; Criterion = firstHit; Target = y\n"
            "Default score = 2\n"
            "End of RuleSetModel Display.\n\n");
}

TEST(RuleSetModel, BuildsFromAnElementAndADictionary) {
  const auto tree = kestrel_test::ReadTree(RuleSetModelOf(
      "functionName='classification'", "k",
      RuleSetOf("firstHit", "defaultScore='no'",
                If("<SimplePredicate field='n' operator='equal' value='2'/>", "score='yes'"))));
  const auto dictionary =
      kestrel_test::ReadDictionary(kestrel_test::DictionaryOf(9, kestrel_tests::TestFields()));
  // A dictionary that served another model first knows that model's places.
  dictionary->GetVar("n")->SetEncodedValueIndex(3);
  RuleSetTranslator translator;
  const std::unique_ptr<ScoreModel> model(
      translator.ParseFromTree(tree->GetRoot(), dictionary.get(), dictionary.get(), std::string()));
  EXPECT_NE(model->GetDictionary(), dictionary.get());
  EXPECT_NE(model->GetResultDictionary(), nullptr);
  EXPECT_NE(model->GetResultDictionary(), dictionary.get());
  EXPECT_EQ(dictionary->GetVar("n")->GetEncodedValueIndex(), 3) << "the host's own is left alone";
  Telling<ClsResult> result;
  for (const double n : {1.0, 2.0}) {
    const CaseRecord record = RecordOf({{"n", n}});
    ASSERT_TRUE(model->Score(&record, &result).IsOK());
    EXPECT_EQ(result.GetPrediction()->GetString(), n == 2.0 ? "yes" : "no");
  }
}

// Compounds as deep as a document may be; the innermost rule is reached, and left out, without recursion.
TEST(RuleSetModel, NestsAsDeepAsADocument) {
  constexpr int kDepth = 505;
  std::string rules = Rule("id='inmost' score='yes'");
  for (int i = 0; i < kDepth; ++i) {
    const std::string limit = std::to_string(i);
    rules = "<CompoundRule><SimplePredicate field='x' operator='greaterThan' value='" + limit + "'/>" +
            rules + "</CompoundRule>";
  }
  const auto model = BuildRuleSet(RuleSetDocument("firstHit", "k", "defaultScore='no'", rules));
  Telling<ClsResult> result;
  for (const double x : {0.0, 1.0, 504.0, 505.0}) {
    const CaseRecord record = RecordOf({{"x", x}});
    ASSERT_TRUE(model->Score(&record, &result).IsOK());
    EXPECT_EQ(ShowResult(result), x > 504.0 ? "yes 1 inmost" : "no 0 -") << x;
  }
  std::ostringstream out;
  model->Display(out);
  EXPECT_LT(out.str().size(), 50u * kDepth);
}

}  // namespace
