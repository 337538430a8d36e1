#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/ValueProbability.h"
#include "kestrel/dictionary/ValueProbabilitySet.h"
#include "kestrel/model/Results.h"
#include "tests/plugins/ModelText.h"

namespace {

using namespace MCKestrel_800;
using kestrel_tests::BuildModel;
using kestrel_tests::DocumentOf;
using kestrel_tests::ModelOf;
using kestrel_tests::RecordOf;

constexpr double kSysmis = NumericValue::gSysmisValue;

/// A table whose value is `y` for x = 1.
std::string Table(const std::string& category, const std::string& y) {
  return "<RegressionTable targetCategory='" + category +
         "' intercept='1'><NumericPredictor name='x' coefficient='" + y +
         "'/><NumericPredictor name='x' coefficient='-1'/></RegressionTable>";
}

/// As producers write it for a reference category.
std::string Reference(const std::string& category) {
  return "<RegressionTable targetCategory='" + category + "' intercept='0'/>";
}

std::unique_ptr<ScoreModel> Classification(const std::string& method, const std::string& target,
                                           const std::string& tables) {
  return BuildModel(DocumentOf(
      ModelOf("functionName='classification' normalizationMethod='" + method + "'", target, tables)));
}

struct Share {
  const char* category;
  double probability;
};

/// Scores x = 1 and compares prediction and all categories in their order.
void ExpectShares(ScoreModel& model, const std::vector<Share>& shares, const std::string& prediction) {
  const std::unique_ptr<ScoreResult> made(model.MakeResult());
  auto* result = dynamic_cast<ClsResult*>(made.get());
  ASSERT_NE(result, nullptr);
  const CaseRecord record = RecordOf({{"x", 1.0}});
  for (int round = 0; round < 2; ++round) {
    ASSERT_TRUE(model.Score(&record, result).IsOK());
    ASSERT_EQ(result->GetCategoryCount(), shares.size());
    double best = -1e300;
    for (size_t j = 0; j < shares.size(); ++j) {
      EXPECT_EQ(result->GetCategory(j)->GetString(), shares[j].category);
      EXPECT_NEAR(result->GetProbability(j), shares[j].probability, 1e-12 * std::fabs(shares[j].probability))
          << shares[j].category;
      best = std::max(best, result->GetProbability(j));
    }
    EXPECT_EQ(result->GetPrediction()->GetString(), prediction);
    EXPECT_EQ(result->GetProbability(), best);
  }
}

struct SharesRow {
  const char* why;
  const char* method;
  const char* target;
  std::string tables;
  std::vector<Share> shares;
  const char* prediction;
};

const SharesRow kSharesRows[] = {
    {"softmax of three",
     "softmax",
     "m",
     Table("red", "0.5") + Table("green", "-2") + Table("blue", "1.25"),
     {{"red", 0.31258937953733923}, {"green", 0.02565889878916787}, {"blue", 0.6617517216734928}},
     "blue"},
    {"softmax in the tables' order",
     "softmax",
     "m",
     Table("green", "-2") + Table("blue", "1.25") + Table("red", "0.5"),
     {{"green", 0.02565889878916787}, {"blue", 0.6617517216734928}, {"red", 0.31258937953733923}},
     "blue"},
    {"softmax of large values",
     "softmax",
     "m",
     Table("red", "1000") + Table("green", "998") + Table("blue", "-1000"),
     {{"red", 0.8807970779778824}, {"green", 0.11920292202211756}, {"blue", 0.0}},
     "red"},
    {"softmax with a reference category",
     "softmax",
     "k",
     Table("no", "-1.25") + Reference("yes"),
     {{"no", 0.22270013882530884}, {"yes", 0.7772998611746912}},
     "yes"},
    {"softmax with the reference first",
     "softmax",
     "k",
     Reference("yes") + Table("no", "-1.25"),
     {{"yes", 0.7772998611746912}, {"no", 0.22270013882530884}},
     "yes"},
    {"softmax with a single table",
     "softmax",
     "k",
     Table("no", "-1.25"),
     {{"no", 0.22270013882530884}, {"yes", 0.7772998611746912}},
     "yes"},
    {"softmax of an ordinal target, in its order",
     "softmax",
     "o",
     Table("high", "1.25") + Table("low", "0.5") + Table("mid", "-2"),
     {{"low", 0.31258937953733923}, {"mid", 0.02565889878916787}, {"high", 0.6617517216734928}},
     "high"},
    {"simplemax",
     "simplemax",
     "m",
     Table("red", "1") + Table("green", "2") + Table("blue", "5"),
     {{"red", 0.125}, {"green", 0.25}, {"blue", 0.625}},
     "blue"},
    {"none, two tables",
     "none",
     "k",
     Table("yes", "0.3") + Table("no", "0.9"),
     {{"yes", 0.3}, {"no", 0.7}},
     "no"},
    {"none, one table", "none", "k", Table("no", "0.9"), {{"no", 0.9}, {"yes", 0.1}}, "no"},
    {"none is the default",
     "none",
     "k",
     Table("no", "0.9") + Reference("yes"),
     {{"no", 0.9}, {"yes", 0.1}},
     "no"},
    {"none, three tables",
     "none",
     "m",
     Table("red", "0.2") + Table("green", "0.5") + Table("blue", "9"),
     {{"red", 0.2}, {"green", 0.5}, {"blue", 0.3}},
     "green"},
    {"none, a table less",
     "none",
     "m",
     Table("blue", "0.2") + Table("red", "0.5"),
     {{"blue", 0.2}, {"red", 0.5}, {"green", 0.3}},
     "red"},
    {"logit, one table",
     "logit",
     "k",
     Table("no", "-1.25"),
     {{"no", 0.22270013882530884}, {"yes", 0.7772998611746912}},
     "yes"},
    {"logit, a reference after it",
     "logit",
     "k",
     Table("no", "-1.25") + Reference("yes"),
     {{"no", 0.22270013882530884}, {"yes", 0.7772998611746912}},
     "yes"},
    {"logit, a reference before it",
     "logit",
     "k",
     Reference("yes") + Table("no", "-1.25"),
     {{"yes", 0.7772998611746912}, {"no", 0.22270013882530884}},
     "yes"},
    {"logit, the second of two equations plays no part",
     "logit",
     "k",
     Table("no", "-1.25") + Table("yes", "7"),
     {{"no", 0.22270013882530884}, {"yes", 0.7772998611746912}},
     "yes"},
    {"logit of two constants",
     "logit",
     "k",
     Reference("no") + Reference("yes"),
     {{"no", 0.5}, {"yes", 0.5}},
     "no"},
    {"logit keeps small probabilities",
     "logit",
     "k",
     Table("no", "-40"),
     {{"no", 4.248354255291589e-18}, {"yes", 1.0}},
     "yes"},
    {"and small rests", "logit", "k", Table("no", "40"), {{"no", 1.0}, {"yes", 4.248354255291589e-18}}, "no"},
    {"probit",
     "probit",
     "k",
     Table("yes", "-1.25"),
     {{"yes", 0.10564977366685525}, {"no", 0.8943502263331448}},
     "no"},
    {"cloglog",
     "cloglog",
     "k",
     Table("yes", "-1.25"),
     {{"yes", 0.24911652336060514}, {"no", 0.7508834766393948}},
     "no"},
    {"loglog",
     "loglog",
     "k",
     Table("yes", "-1.25"),
     {{"yes", 0.030490413463062215}, {"no", 0.9695095865369378}},
     "no"},
    {"cauchit",
     "cauchit",
     "k",
     Table("yes", "-1.25"),
     {{"yes", 0.21477671252272273}, {"no", 0.7852232874772773}},
     "no"},
    {"ordinal logit",
     "logit",
     "o",
     Table("low", "-0.5") + Table("mid", "1.25") + Reference("high"),
     {{"low", 0.37754066879814546}, {"mid", 0.3997591923765457}, {"high", 0.22270013882530884}},
     "mid"},
    {"ordinal logit without the last table, in any order",
     "logit",
     "o",
     Table("mid", "1.25") + Table("low", "-0.5"),
     {{"low", 0.37754066879814546}, {"mid", 0.3997591923765457}, {"high", 0.22270013882530884}},
     "mid"},
    {"ordinal probit",
     "probit",
     "o",
     Table("low", "-0.5") + Table("mid", "1.25"),
     {{"low", 0.3085375387259869}, {"mid", 0.5858126876071579}, {"high", 0.10564977366685525}},
     "mid"},
    {"ordinal cloglog",
     "cloglog",
     "o",
     Table("low", "-0.5") + Table("mid", "1.25"),
     {{"low", 0.45476078810739495}, {"mid", 0.5147487984295428}, {"high", 0.030490413463062215}},
     "mid"},
    {"ordinal loglog",
     "loglog",
     "o",
     Table("low", "-0.5") + Table("mid", "1.25"),
     {{"low", 0.19229564554796494}, {"mid", 0.55858783109143}, {"high", 0.24911652336060514}},
     "mid"},
    {"ordinal cauchit",
     "cauchit",
     "o",
     Table("low", "-0.5") + Table("mid", "1.25"),
     {{"low", 0.35241638234956674}, {"mid", 0.43280690512771053}, {"high", 0.21477671252272273}},
     "mid"},
    {"ordinal none",
     "none",
     "o",
     Table("low", "0.25") + Table("mid", "0.75"),
     {{"low", 0.25}, {"mid", 0.5}, {"high", 0.25}},
     "mid"},
    {"the first of equal ones",
     "simplemax",
     "m",
     Table("green", "2") + Table("red", "1") + Table("blue", "2"),
     {{"green", 0.4}, {"red", 0.2}, {"blue", 0.4}},
     "green"},
    {"categories that are numbers",
     "softmax",
     "n",
     Table("2", "-1.25") + Reference("1") + Table("3", "-1e9"),
     {{"2", 0.22270013882530884}, {"1", 0.7772998611746912}, {"3", 0.0}},
     "1"},
    {"without a target the categories are texts",
     "softmax",
     "",
     Table("p", "-1.25") + Reference("q"),
     {{"p", 0.22270013882530884}, {"q", 0.7772998611746912}},
     "q"},
};

// All expected numbers were computed with 40 digits.
TEST(Classification, ProbabilitiesOfTheCategories) {
  for (const auto& row : kSharesRows) {
    SCOPED_TRACE(row.why);
    // One field is both input and target where the categories are numbers, which no equation reads.
    std::string schema_target = row.target;
    std::string document = DocumentOf(
        ModelOf(std::string("functionName='classification' normalizationMethod='") + row.method + "'",
                schema_target, row.tables));
    if (schema_target == "n") {
      const std::string input = "<MiningField name=\"n\"/>";
      document.erase(document.find(input), input.size());
    }
    const auto model = BuildModel(document);
    ExpectShares(*model, row.shares, row.prediction);
  }
}

TEST(Classification, PredictionsAreOfTheTargetsType) {
  const auto model =
      BuildModel("<PMML>" + kestrel_test::DictionaryOf(9, kestrel_tests::TestFields()) +
                 "<RegressionModel functionName='classification' "
                 "normalizationMethod='softmax'><MiningSchema><MiningField "
                 "name='x'/><MiningField name='n' usageType='target'/></MiningSchema>" +
                 Table("1", "0") + Table("2", "3") + Table("3", "1") + "</RegressionModel></PMML>");
  ClsResult result;
  const CaseRecord record = RecordOf({{"x", 1.0}});
  ASSERT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(result.GetPrediction()->GetType(), ScoreValue::kNumeric);
  EXPECT_EQ(result.GetPrediction()->GetDouble(), 2.0);
  const NumericValue one(1.0);
  EXPECT_GT(result.GetCategoryProbability(&one), 0.0);
}

TEST(Classification, AnotherKindOfResultGetsThePredictionAlone) {
  const auto model = Classification("logit", "k", Table("no", "-1.25"));
  RegResult result;
  const CaseRecord record = RecordOf({{"x", 1.0}});
  ASSERT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(result.GetPrediction()->GetString(), "yes");
  EXPECT_NEAR(result.GetProbability(), 0.7772998611746912, 1e-12);
}

TEST(Classification, MissingResultsFollowThePolicy) {
  const struct {
    const char* why;
    const char* method;
    std::string tables;
    double x;
  } kRows[] = {
      {"a missing number", "softmax", Table("yes", "1") + Table("no", "2"), kSysmis},
      {"an equation without value", "softmax", Table("yes", "1e308") + Table("no", "2"), 1e10},
      {"shares of nothing", "simplemax", Table("yes", "1") + Table("no", "-1"), 1.0},
  };
  for (const auto& row : kRows) {
    SCOPED_TRACE(row.why);
    const auto model = Classification(row.method, "k", row.tables);
    const CaseRecord record = RecordOf({{"x", row.x}});
    ClsResult result;
    EXPECT_EQ(model->Score(&record, &result).GetErrorCode(), 90027);
    EXPECT_EQ(result.GetPrediction(), nullptr);
    auto* probabilities = new ValueProbabilitySet;
    probabilities->Add(new ValueProbability(new StringValue("yes"), 0.25));
    probabilities->Add(new ValueProbability(new StringValue("no"), 0.75));
    const_cast<ScoreDictVar*>(model->GetTargetVar())->SetValueProbabilities(probabilities);
    EXPECT_TRUE(model->Score(&record, &result).IsOK());
    EXPECT_EQ(result.GetPrediction()->GetString(), "no");
    EXPECT_EQ(result.GetProbability(), 0.75);
    EXPECT_EQ(result.GetCategoryCount(), 2u);
    model->SetMissingValuePolicy(ScoreModel::kNullPrediction);
    const MCScore::MCStatus status = model->Score(&record, &result);
    EXPECT_EQ(status.GetErrorCode(), 90027);
    EXPECT_TRUE(status.IsError());
    EXPECT_EQ(result.GetPrediction(), nullptr);
    EXPECT_EQ(result.GetCategoryCount(), 0u);
  }
}

TEST(Classification, EquationsThatPlayNoPartReadNothing) {
  const auto model = Classification("logit", "k",
                                    Table("no", "-1.25") +
                                        "<RegressionTable targetCategory='yes'><NumericPredictor name='z' "
                                        "coefficient='1'/></RegressionTable>");
  ASSERT_EQ(model->GetPredictors().size(), 1u);
  ClsResult result;
  const CaseRecord record = RecordOf({{"x", 1.0}, {"z", kSysmis}});
  EXPECT_TRUE(model->Score(&record, &result).IsOK());
}

TEST(Classification, DisplayListsTheTables) {
  const auto model = Classification("logit", "k", Table("no", "-1.25") + Reference("yes"));
  std::ostringstream out;
  model->Display(out);
  EXPECT_EQ(out.str(),
            "Start RegressionModel Display:\n"
            "Function = classification; Normalization = logit; Target = k\n"
            "Table no; Intercept = 1\n"
            "\tNumericPredictor x; Coefficient = -1.25\n"
            "\tNumericPredictor x; Coefficient = -1\n"
            "Table yes; Intercept = 0\n"
            "End of RegressionModel Display.\n\n");
}

}  // namespace
