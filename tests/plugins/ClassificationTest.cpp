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
#include "tests/support/FileText.h"
#include "tests/support/PlainTable.h"

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
    {"exp of two",
     "exp",
     "k",
     Table("yes", "-1.25"),
     {{"yes", 0.2865047968601901}, {"no", 0.7134952031398099}},
     "no"},
    {"exp, a reference before it",
     "exp",
     "k",
     Reference("yes") + Table("no", "-1.25"),
     {{"yes", 0.7134952031398099}, {"no", 0.2865047968601901}},
     "yes"},
    {"exp keeps small probabilities",
     "exp",
     "k",
     Table("no", "-40"),
     {{"no", 4.248354255291589e-18}, {"yes", 1.0}},
     "yes"},
    {"and small rests of exp",
     "exp",
     "k",
     Table("no", "-9.313225746154785e-10"),
     {{"no", 0.9999999990686774}, {"yes", 9.313225741817976e-10}},
     "no"},
    {"exp of certainty", "exp", "k", Table("no", "0"), {{"no", 1.0}, {"yes", 0.0}}, "no"},
    {"exp of certainty, but for rounding",
     "exp",
     "k",
     Table("no", "4.440892098500626e-16"),
     {{"no", 1.0}, {"yes", 0.0}},
     "no"},
    {"ordinal exp",
     "exp",
     "o",
     Table("low", "-1.25") + Table("mid", "-0.5"),
     {{"low", 0.2865047968601901}, {"mid", 0.32002586285244333}, {"high", 0.3934693402873666}},
     "high"},
    {"ordinal logit of one threshold twice",
     "logit",
     "o",
     Table("low", "-0.5") + Table("mid", "-0.5"),
     {{"low", 0.37754066879814546}, {"mid", 0.0}, {"high", 0.6224593312018546}},
     "high"},
    {"logit, one against the rest",
     "logit",
     "m",
     Table("red", "0.5") + Table("green", "-2") + Table("blue", "1.25"),
     {{"red", 0.4097925322174858}, {"green", 0.07847656033824675}, {"blue", 0.5117309074442674}},
     "blue"},
    {"probit, one against the rest",
     "probit",
     "m",
     Table("red", "0.5") + Table("green", "-2") + Table("blue", "1.25"),
     {{"red", 0.42986351099744896}, {"green", 0.014143141735967849}, {"blue", 0.5559933472665832}},
     "blue"},
    {"cloglog, one against the rest",
     "cloglog",
     "m",
     Table("red", "0.5") + Table("green", "-2") + Table("blue", "1.25"),
     {{"red", 0.4242610598190795}, {"green", 0.06648680798464038}, {"blue", 0.5092521321962801}},
     "blue"},
    {"loglog, one against the rest",
     "loglog",
     "m",
     Table("red", "0.5") + Table("green", "-2") + Table("blue", "1.25"),
     {{"red", 0.4204689692772638}, {"green", 0.0004765632827050424}, {"blue", 0.5790544674400312}},
     "blue"},
    {"cauchit, one against the rest",
     "cauchit",
     "m",
     Table("red", "0.5") + Table("green", "-2") + Table("blue", "1.25"),
     {{"red", 0.40976176983904977}, {"green", 0.0933842714970211}, {"blue", 0.4968539586639292}},
     "blue"},
    {"exp, one against the rest",
     "exp",
     "m",
     Table("red", "0.5") + Table("green", "-2") + Table("blue", "1.25"),
     {{"red", 0.31258937953733923}, {"green", 0.02565889878916787}, {"blue", 0.6617517216734928}},
     "blue"},
    {"logit, one against the rest, a table less",
     "logit",
     "m",
     Table("red", "-0.5") + Table("green", "-2"),
     {{"red", 0.37754066879814546}, {"green", 0.11920292202211756}, {"blue", 0.503256409179737}},
     "blue"},
    {"logit with a reference category",
     "logit",
     "m",
     Reference("blue") + Table("red", "-0.5") + Table("green", "-2"),
     {{"blue", 0.503256409179737}, {"red", 0.37754066879814546}, {"green", 0.11920292202211756}},
     "blue"},
    {"probit with a reference category",
     "probit",
     "m",
     Table("red", "-0.5") + Reference("blue") + Table("green", "-2"),
     {{"red", 0.3085375387259869}, {"blue", 0.6687123293258339}, {"green", 0.02275013194817921}},
     "blue"},
    {"cloglog with a reference category",
     "cloglog",
     "m",
     Table("red", "-0.5") + Table("green", "-2") + Reference("blue"),
     {{"red", 0.45476078810739495}, {"green", 0.12657698150688335}, {"blue", 0.4186622303857217}},
     "red"},
    {"loglog with a reference category",
     "loglog",
     "m",
     Reference("blue") + Table("red", "-0.5") + Table("green", "-2"),
     {{"blue", 0.807086375462704}, {"red", 0.19229564554796494}, {"green", 0.0006179789893310935}},
     "blue"},
    {"cauchit with a reference category",
     "cauchit",
     "m",
     Table("red", "-0.5") + Reference("blue") + Table("green", "-2"),
     {{"red", 0.35241638234956674}, {"blue", 0.5}, {"green", 0.14758361765043326}},
     "blue"},
    {"exp, one against the rest, a table less",
     "exp",
     "m",
     Table("red", "-1.25") + Table("green", "-2"),
     {{"red", 0.2865047968601901}, {"green", 0.1353352832366127}, {"blue", 0.5781599199031973}},
     "blue"},
    {"one against the rest with two constants",
     "logit",
     "m",
     Reference("red") + Table("green", "-1.25") + Reference("blue"),
     {{"red", 0.4089310077942476}, {"green", 0.1821379844115048}, {"blue", 0.4089310077942476}},
     "red"},
    {"one against the rest keeps small rests",
     "logit",
     "m",
     Reference("blue") + Table("red", "30") + Table("green", "-32"),
     {{"blue", 8.091206413929898e-14}, {"red", 0.9999999999999064}, {"green", 1.2664165549094015e-14}},
     "red"},
    {"one against the rest, all far off",
     "cloglog",
     "m",
     Table("red", "-800") + Table("green", "-801") + Table("blue", "-900"),
     {{"red", 0.7310585786300049}, {"green", 0.2689414213699951}, {"blue", 2.7195934554254203e-44}},
     "red"},
    {"one against the rest without target",
     "logit",
     "",
     Table("p", "0.5") + Table("q", "-2") + Table("r", "1.25"),
     {{"p", 0.4097925322174858}, {"q", 0.07847656033824675}, {"r", 0.5117309074442674}},
     "r"},
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

TEST(Classification, EquationsThatMakeNoProbabilitiesGiveNoPrediction) {
  const struct {
    const char* why;
    const char* method;
    const char* target;
    std::string tables;
    bool has_prediction;
  } kRows[] = {
      {"exp above 1", "exp", "k", Table("yes", "0.25"), false},
      {"exp above everything", "exp", "k", Table("yes", "1e300"), false},
      {"exp just above 1", "exp", "k", Table("yes", "1e-11"), false},
      {"exp of the rest above 1", "exp", "m", Table("red", "0.25") + Table("green", "-9"), false},
      {"exp, sum above 1", "exp", "m", Table("red", "-0.5") + Table("green", "-0.5"), false},
      {"logit, sum above 1", "logit", "m", Table("red", "1") + Reference("blue") + Table("green", "1"),
       false},
      {"logit, sum above 1 by rounding alone", "logit", "m", Table("red", "1.25") + Table("green", "-1.25"),
       true},
      {"crossing thresholds", "logit", "o", Table("low", "1") + Table("mid", "0.5"), false},
      {"crossing by rounding alone", "logit", "o", Table("low", "0.5000000000000002") + Table("mid", "0.5"),
       true},
      {"crossing thresholds of probit", "probit", "o", Table("low", "1") + Table("mid", "0.5"), false},
      {"crossing thresholds of exp", "exp", "o", Table("low", "-1") + Table("mid", "-2"), false},
      {"ordinal exp above 1", "exp", "o", Table("low", "-1") + Table("mid", "0.5"), false},
      {"ordinal exp above everything", "exp", "o", Table("low", "1e300") + Table("mid", "1e300"), false},
      {"none is not bounded", "none", "k", Table("yes", "1.5"), true},
      {"nor of three", "none", "m", Table("red", "0.75") + Table("green", "0.75"), true},
      {"nor ordinal", "none", "o", Table("low", "0.75") + Table("mid", "0.5"), true},
      {"nor are shares", "simplemax", "k", Table("yes", "3") + Table("no", "-1"), true},
      {"a share that is no number", "simplemax", "m",
       Table("red", "1e308") + Table("green", "-1e308") + Table("blue", "0.0001"), false},
  };
  for (const auto& row : kRows) {
    SCOPED_TRACE(row.why);
    const auto model = Classification(row.method, row.target, row.tables);
    const CaseRecord record = RecordOf({{"x", 1.0}});
    ClsResult result;
    const MCScore::MCStatus status = model->Score(&record, &result);
    EXPECT_EQ(status.GetErrorCode(), row.has_prediction ? 0 : 90027);
    EXPECT_EQ(result.GetPrediction() != nullptr, row.has_prediction);
    EXPECT_EQ(result.GetCategoryCount() != 0, row.has_prediction);
  }
}

// Document and table were made by make_one_against_rest.py beside them.
TEST(Classification, OneAgainstTheRestAgreesWithItsTrainingProgram) {
  const std::string folder = KESTREL_SOURCE_DIR "/tests/data/regression/";
  const auto model = BuildModel(kestrel_tests::FileText(folder + "one_against_rest.xml"));
  const kestrel_tests::PlainTable flowers = kestrel_tests::ReadPlainTable(folder + "one_against_rest.csv");
  ASSERT_GT(flowers.rows.size(), 20u);
  const size_t inputs = flowers.header.size() - 3;
  CaseRecord record;
  for (size_t i = 0; i < inputs; ++i)
    record.Add(flowers.header[i], new NumericValue(0.0));
  ClsResult result;
  for (const std::vector<std::string>& flower : flowers.rows) {
    for (size_t i = 0; i < inputs; ++i)
      record.SetValue(flowers.header[i], std::stod(flower[i]));
    ASSERT_TRUE(model->Score(&record, &result).IsOK());
    ASSERT_EQ(result.GetCategoryCount(), 3u);
    for (size_t j = 0; j < 3; ++j) {
      const double expected = std::stod(flower[inputs + j]);
      EXPECT_EQ(result.GetCategory(j)->GetString(), flowers.header[inputs + j]);
      EXPECT_NEAR(result.GetProbability(j), expected, 1e-12 * expected);
    }
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
