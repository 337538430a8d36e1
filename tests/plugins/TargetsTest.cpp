// What a document's targets do to predictions, in models of all kinds.

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "kestrel/model/Results.h"
#include "tests/plugins/OutputText.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

const std::string kPriors =
    "<Targets><Target field='k' optype='categorical'>"
    "<TargetValue value='yes' displayValue='Yes, please' priorProbability='0.2'/>"
    "<TargetValue value='no' displayValue='No' priorProbability='0.8'/></Target></Targets>";
const std::string kDefault =
    "<Targets><Target field='y'><TargetValue defaultValue='12.5'/></Target></Targets>";

const std::string kFields = Field("name='v'") + Field("name='d' feature='predictedDisplayValue'") +
                            Field("name='p' feature='probability'") +
                            Field("name='yes' feature='probability' value='yes'") +
                            Field("name='id' feature='entityId'") + Field("name='w' feature='warning'");

class CategoricalTargets : public testing::TestWithParam<Kind> {};
INSTANTIATE_TEST_SUITE_P(AllKinds, CategoricalTargets,
                         testing::Values(Kind::kLogistic, Kind::kTree, Kind::kRules));

std::string Outputs(ScoreResult* result) {
  std::string all;
  for (const char* name : {"v", "d", "p", "yes", "id", "w"})
    all += Show(OutputFieldsOf(result)->GetResultValue(name)) + "; ";
  return all;
}

TEST_P(CategoricalTargets, PriorsArePredictedWhenDataAreMissing) {
  const auto model = Build(GetParam(), Output(kFields), kPriors);
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  const CaseRecord record = RecordOf(kNone);
  EXPECT_TRUE(model->Score(&record, result.get()).IsOK());
  ASSERT_NE(result->GetPrediction(), nullptr);
  EXPECT_EQ(result->GetPrediction()->GetString(), "no");
  EXPECT_EQ(result->GetProbability(), 0.8);
  const auto& classification = static_cast<const ClsResult&>(*result);
  ASSERT_EQ(classification.GetCategoryCount(), 2u);
  EXPECT_EQ(classification.GetCategory(0)->GetString(), "yes");
  EXPECT_EQ(classification.GetProbability(0), 0.2);
  EXPECT_EQ(classification.GetProbability(1), 0.8);
  EXPECT_EQ(Outputs(result.get()),
            "text no; text No; number 0.8; number 0.2; missing text; "
            "text data are missing, the target's default is predicted; ");
}

TEST_P(CategoricalTargets, PriorsAreNotAskedByTheOtherPolicy) {
  const auto model = Build(GetParam(), Output(kFields), kPriors);
  model->SetMissingValuePolicy(ScoreModel::kNullPrediction);
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  const CaseRecord record = RecordOf(kNone);
  EXPECT_EQ(model->Score(&record, result.get()).GetErrorCode(), 90027);
  EXPECT_EQ(result->GetPrediction(), nullptr);
  EXPECT_EQ(Outputs(result.get()),
            "missing text; missing text; missing number; missing number; missing text; "
            "text data are missing, nothing is predicted; ");
}

TEST_P(CategoricalTargets, DisplayValuesGoWithThePrediction) {
  const auto model = Build(GetParam(), Output(Field("name='d' feature='predictedDisplayValue'")), kPriors);
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  const CaseRecord record = RecordOf(kHigh);
  ASSERT_TRUE(model->Score(&record, result.get()).IsOK());
  EXPECT_EQ(result->GetPrediction()->GetString(), "yes");
  EXPECT_EQ(Show(OutputFieldsOf(result.get())->GetResultValue("d")), "text Yes, please");
}

TEST_P(CategoricalTargets, WithoutPriorsLeaveACaseUnpredicted) {
  const std::string no_priors =
      "<Targets><Target field='k'><TargetValue value='yes'/><TargetValue value='no'/></Target></Targets>";
  const auto model = Build(GetParam(), "", no_priors);
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  const CaseRecord record = RecordOf(kNone);
  // There is a set of priors, and it is empty.
  EXPECT_TRUE(model->Score(&record, result.get()).IsOK());
  EXPECT_EQ(result->GetPrediction(), nullptr);
}

TEST_P(CategoricalTargets, WithoutAnyGiveAnErrorStatus) {
  const auto model = Build(GetParam(), "", "<Targets><Target field='k'/></Targets>");
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  const CaseRecord record = RecordOf(kNone);
  EXPECT_EQ(model->Score(&record, result.get()).GetErrorCode(), 90027);
  EXPECT_EQ(result->GetPrediction(), nullptr);
}

TEST(Targets, OfARegressionGiveItsDefaultWhenDataAreMissing) {
  const auto model =
      Build(Kind::kRegression, Output(Field("name='v'") + Field("name='w' feature='warning'")), kDefault);
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  const CaseRecord missing = RecordOf(kNone);
  EXPECT_TRUE(model->Score(&missing, result.get()).IsOK());
  ASSERT_NE(result->GetPrediction(), nullptr);
  EXPECT_EQ(result->GetPrediction()->GetDouble(), 12.5);
  EXPECT_EQ(Show(OutputFieldsOf(result.get())->GetResultValue("v")), "number 12.5");
  EXPECT_EQ(Show(OutputFieldsOf(result.get())->GetResultValue("w")),
            "text data are missing, the target's default is predicted");
  const CaseRecord high = RecordOf(kHigh);
  EXPECT_TRUE(model->Score(&high, result.get()).IsOK());
  EXPECT_EQ(result->GetPrediction()->GetDouble(), 5.0);
  EXPECT_EQ(Show(OutputFieldsOf(result.get())->GetResultValue("w")), "missing text");
}

TEST(Targets, OfTreeAndRulesThatPredictNumbersGiveTheirDefault) {
  const std::string tree = DocumentOf(
      "<TreeModel functionName='regression' missingValueStrategy='nullPrediction'><MiningSchema>"
      "<MiningField name='x'/><MiningField name='y' usageType='target'/></MiningSchema>" +
      kDefault + "<Node><True/><Node score='1'>" + kXAbove1 +
      "</Node><Node score='2'><SimplePredicate field='x' operator='lessOrEqual' value='1'/></Node></Node>"
      "</TreeModel>");
  const std::string rules = DocumentOf(RuleSetModelOf(
      "functionName='regression'", "y",
      kDefault + RuleSetOf("firstHit", "", "<SimpleRule score='1'>" + kXAbove1 + "</SimpleRule>")));
  const std::unique_ptr<ScoreModel> models[] = {BuildTree(tree), BuildRuleSet(rules)};
  for (const auto& model : models) {
    SCOPED_TRACE(model->GetModelKind());
    const std::unique_ptr<ScoreResult> result(model->MakeResult());
    const CaseRecord missing = RecordOf(kNone);
    EXPECT_TRUE(model->Score(&missing, result.get()).IsOK());
    ASSERT_NE(result->GetPrediction(), nullptr);
    EXPECT_EQ(result->GetPrediction()->GetDouble(), 12.5);
  }
}

// The categories of the target are those that its TargetValues list, in their order.
TEST_P(CategoricalTargets, AreTheModelsCategories) {
  const std::string turned =
      "<Targets><Target field='k'><TargetValue value='no'/><TargetValue value='yes'/></Target></Targets>";
  const auto model = Build(GetParam(), "", turned);
  const auto& labels = model->GetTargetVar()->GetValueLabels()->GetAllValueLabels();
  ASSERT_EQ(labels.size(), 2u);
  EXPECT_EQ(labels[0]->GetValue()->GetString(), "no");
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  const CaseRecord record = RecordOf(kHigh);
  ASSERT_TRUE(model->Score(&record, result.get()).IsOK());
  EXPECT_EQ(result->GetPrediction()->GetString(), "yes");
  const std::string short_list = "<Targets><Target field='k'><TargetValue value='no'/></Target></Targets>";
  ExpectFault([&] { Build(GetParam(), "", short_list); }, KestrelException::kInvalidValue,
              "k: invalid value!");
}

}  // namespace
}  // namespace kestrel_tests
