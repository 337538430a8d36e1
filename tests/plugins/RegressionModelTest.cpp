#include "plugins/regression/RegressionModel.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/model/Results.h"
#include "kestrel/model/ScoreVersionInfo.h"
#include "tests/plugins/ModelText.h"

namespace {

using namespace MCKestrel_800;
using kestrel_tests::BuildModel;
using kestrel_tests::Cell;
using kestrel_tests::DocumentOf;
using kestrel_tests::ModelOf;
using kestrel_tests::RecordOf;

using Cells = std::vector<std::pair<std::string, Cell>>;
constexpr double kSysmis = NumericValue::gSysmisValue;

std::unique_ptr<ScoreModel> Regression(const std::string& attributes, const std::string& table) {
  return BuildModel(DocumentOf(ModelOf("functionName=\"regression\" " + attributes, "y", table)));
}

/// The prediction for a case, or NaN when there is none.
double Predict(ScoreModel& model, const Cells& cells) {
  RegResult result;
  const CaseRecord record = RecordOf(cells);
  const MCScore::MCStatus status = model.Score(&record, &result);
  EXPECT_EQ(status.IsOK(), result.GetPrediction() != nullptr);
  return result.GetPrediction() == nullptr ? std::numeric_limits<double>::quiet_NaN()
                                           : result.GetPrediction()->GetDouble();
}

/// No prediction.
const double kNone = std::numeric_limits<double>::quiet_NaN();

struct EquationRow {
  const char* why;
  const char* table;
  Cells cells;
  double expected;  // NaN: no prediction
};

const EquationRow kEquationRows[] = {
    {"an intercept alone", "<RegressionTable intercept='2.5'/>", {}, 2.5},
    {"nothing at all", "<RegressionTable/>", {}, 0.0},
    {"the intercept is 0 when absent",
     "<RegressionTable><NumericPredictor name='x' coefficient='2'/></RegressionTable>",
     {{"x", 3.0}},
     6.0},
    {"two numbers",
     "<RegressionTable intercept='1'><NumericPredictor name='x' coefficient='2'/>"
     "<NumericPredictor name='z' coefficient='-0.5'/></RegressionTable>",
     {{"x", 3.0}, {"z", 8.0}},
     3.0},
    {"one number twice",
     "<RegressionTable intercept='1'><NumericPredictor name='x' coefficient='2'/>"
     "<NumericPredictor name='x' exponent='2' coefficient='3'/></RegressionTable>",
     {{"x", -2.0}},
     9.0},
    {"six numbers in a row",
     "<RegressionTable intercept='1'><NumericPredictor name='x' coefficient='1'/>"
     "<NumericPredictor name='z' coefficient='10'/><NumericPredictor name='n' coefficient='100'/>"
     "<NumericPredictor name='x' coefficient='1000'/><NumericPredictor name='z' coefficient='10000'/>"
     "<NumericPredictor name='n' coefficient='100000'/></RegressionTable>",
     {{"x", 1.0}, {"z", 2.0}, {"n", 3.0}},
     1 + 1 + 20 + 300 + 1000 + 20000 + 300000},
    {"cube of a negative base",
     "<RegressionTable><NumericPredictor name='x' exponent='3' coefficient='2'/>"
     "</RegressionTable>",
     {{"x", -2.0}},
     -16.0},
    {"a large exponent",
     "<RegressionTable><NumericPredictor name='x' exponent='2000' coefficient='1'/>"
     "</RegressionTable>",
     {{"x", -1.0}},
     1.0},
    {"exponent 0 is 1 for every base",
     "<RegressionTable><NumericPredictor name='x' exponent='0' coefficient='2'/>"
     "</RegressionTable>",
     {{"x", 0.0}},
     2.0},
    {"a negative exponent",
     "<RegressionTable><NumericPredictor name='x' exponent='-2' coefficient='2'/>"
     "</RegressionTable>",
     {{"x", 4.0}},
     0.125},
    {"zero to a negative power has no value",
     "<RegressionTable><NumericPredictor name='x' exponent='-2' "
     "coefficient='2'/></RegressionTable>",
     {{"x", 0.0}},
     kNone},
    {"a broken exponent",
     "<RegressionTable><NumericPredictor name='x' exponent='0.5' coefficient='2'/>"
     "</RegressionTable>",
     {{"x", 2.25}},
     3.0},
    {"a broken exponent of a negative base has no value",
     "<RegressionTable><NumericPredictor name='x' "
     "exponent='0.5' coefficient='2'/></RegressionTable>",
     {{"x", -1.0}},
     kNone},
    {"overflow has no value",
     "<RegressionTable><NumericPredictor name='x' exponent='3' coefficient='1'/>"
     "</RegressionTable>",
     {{"x", 1e200}},
     kNone},
    {"a number that is none has no value",
     "<RegressionTable><NumericPredictor name='x' coefficient='1'/>"
     "</RegressionTable>",
     {{"x", std::nan("")}},
     kNone},
    {"a category",
     "<RegressionTable intercept='1'><CategoricalPredictor name='g' value='a' coefficient='2'/>"
     "<CategoricalPredictor name='g' value='b' coefficient='4'/></RegressionTable>",
     {{"g", "b  "}},
     5.0},
    {"a category without coefficient",
     "<RegressionTable intercept='1'><CategoricalPredictor name='g' value='a' "
     "coefficient='2'/><CategoricalPredictor name='g' value='b' coefficient='4'/></RegressionTable>",
     {{"g", "c"}},
     1.0},
    {"a missing category adds nothing",
     "<RegressionTable intercept='1'><CategoricalPredictor name='g' value='a' "
     "coefficient='2'/></RegressionTable>",
     {{"g", {}}},
     1.0},
    {"a category given twice counts twice",
     "<RegressionTable intercept='1'><CategoricalPredictor name='g' "
     "value='a' coefficient='2'/><CategoricalPredictor name='g' value='a' "
     "coefficient='3'/></RegressionTable>",
     {{"g", "a"}},
     6.0},
    {"a coded category",
     "<RegressionTable><CategoricalPredictor name='n' value='3' coefficient='7'/>"
     "<CategoricalPredictor name='n' value='1' coefficient='5'/></RegressionTable>",
     {{"n", 3.0}},
     7.0},
    {"a code and a number of one field",
     "<RegressionTable><NumericPredictor name='n' coefficient='10'/>"
     "<CategoricalPredictor name='n' value='2' coefficient='5'/></RegressionTable>",
     {{"n", 2.0}},
     25.0},
    {"a value of a continuous field",
     "<RegressionTable intercept='1'><CategoricalPredictor name='x' value='0.5' "
     "coefficient='5'/></RegressionTable>",
     {{"x", 0.5}},
     6.0},
    {"a value that no case can have",
     "<RegressionTable intercept='1'><CategoricalPredictor name='x' value='1e999' "
     "coefficient='5'/></RegressionTable>",
     {{"x", 0.5}},
     1.0},
    {"a text without list",
     "<RegressionTable intercept='1'><CategoricalPredictor name='t' value='p' "
     "coefficient='5'/></RegressionTable>",
     {{"t", "p"}},
     6.0},
    {"another text without list",
     "<RegressionTable intercept='1'><CategoricalPredictor name='t' value='p' "
     "coefficient='5'/></RegressionTable>",
     {{"t", "q"}},
     1.0},
    {"fields by turns",
     "<RegressionTable><CategoricalPredictor name='g' value='a' coefficient='1'/>"
     "<CategoricalPredictor name='n' value='1' coefficient='2'/><CategoricalPredictor name='g' value='b' "
     "coefficient='4'/><CategoricalPredictor name='n' value='2' coefficient='8'/></RegressionTable>",
     {{"g", "b"}, {"n", 1.0}},
     6.0},
    {"a product",
     "<RegressionTable intercept='1'><PredictorTerm coefficient='2'><FieldRef field='x'/>"
     "<FieldRef field='z'/><FieldRef field='x'/></PredictorTerm></RegressionTable>",
     {{"x", 3.0}, {"z", 5.0}},
     91.0},
    {"a product of one",
     "<RegressionTable><PredictorTerm name='p' coefficient='2'><FieldRef field='n'/>"
     "</PredictorTerm></RegressionTable>",
     {{"n", 3.0}},
     6.0},
    {"a missing factor",
     "<RegressionTable><PredictorTerm coefficient='2'><FieldRef field='x'/></PredictorTerm>"
     "</RegressionTable>",
     {{"x", kSysmis}},
     kNone},
    {"a missing factor with a value for it",
     "<RegressionTable><PredictorTerm coefficient='2'><FieldRef field='x' "
     "mapMissingTo='4'/></PredictorTerm></RegressionTable>",
     {{"x", kSysmis}},
     8.0},
    {"a missing number",
     "<RegressionTable><NumericPredictor name='x' coefficient='2'/></RegressionTable>",
     {{"x", kSysmis}},
     kNone},
    {"with coefficient 0, too",
     "<RegressionTable><NumericPredictor name='x' coefficient='0'/></RegressionTable>",
     {{"x", {}}},
     kNone},
    {"with exponent 0, too",
     "<RegressionTable><NumericPredictor name='x' exponent='0' coefficient='1'/>"
     "</RegressionTable>",
     {{"x", {}}},
     kNone},
    {"what no term names may be missing",
     "<RegressionTable><NumericPredictor name='x' coefficient='2'/>"
     "</RegressionTable>",
     {{"x", 1.0}, {"z", kSysmis}, {"g", "no category"}},
     2.0},
    {"extensions everywhere",
     "<RegressionTable intercept='1'><Extension/><NumericPredictor name='x' "
     "coefficient='2'><Extension/></NumericPredictor><PredictorTerm coefficient='3'><Extension/>"
     "<FieldRef field='x'><Extension/></FieldRef></PredictorTerm></RegressionTable>",
     {{"x", 1.0}},
     6.0},
};

TEST(RegressionModel, SumsItsTerms) {
  for (const auto& row : kEquationRows) {
    SCOPED_TRACE(row.why);
    const auto model = Regression("", row.table);
    const double prediction = Predict(*model, row.cells);
    if (std::isnan(row.expected)) {
      EXPECT_TRUE(std::isnan(prediction)) << prediction;
    } else {
      EXPECT_EQ(prediction, row.expected);
    }
  }
}

TEST(RegressionModel, AddsInDocumentOrder) {
  const auto model =
      Regression("",
                 "<RegressionTable intercept='1e16'><NumericPredictor name='x' coefficient='1'/>"
                 "<CategoricalPredictor name='g' value='a' coefficient='1'/>"
                 "<NumericPredictor name='z' coefficient='-1e16'/></RegressionTable>");
  // Each 1 is lost against 1e16 when it is added there, and not when it is added elsewhere.
  EXPECT_EQ(Predict(*model, {{"x", 1.0}, {"z", 1.0}, {"g", "a"}}), ((1e16 + 1.0) + 1.0) - 1e16);
}

TEST(RegressionModel, ManyCategoriesTakeNoMoreThanTheirTerms) {
  std::string fields = "<DataField name=\"c\" optype=\"categorical\" dataType=\"string\">";
  std::string few, many;
  for (int i = 0; i < 3000; ++i) {
    fields += "<Value value=\"v" + std::to_string(i) + "\"/>";
    const std::string term = "<CategoricalPredictor name='c' value='v" + std::to_string(i) +
                             "' coefficient='" + std::to_string(i) + "'/>";
    // In turns with another field: each stands alone.
    many += term + "<NumericPredictor name='x' coefficient='0'/>";
    if (i % 1000 == 7) few += term;
  }
  fields += "</DataField><DataField name=\"x\" optype=\"continuous\" dataType=\"double\"/>";
  for (const std::string& terms : {few, many}) {
    const auto model =
        BuildModel("<PMML>" + kestrel_test::DictionaryOf(2, fields) +
                   "<RegressionModel functionName='regression'><MiningSchema><MiningField name='c'/>"
                   "<MiningField name='x'/></MiningSchema><RegressionTable intercept='0.5'>" +
                   terms + "</RegressionTable></RegressionModel></PMML>");
    EXPECT_EQ(Predict(*model, {{"c", "v1007"}, {"x", 1.0}}), 1007.5);
    EXPECT_EQ(Predict(*model, {{"c", {}}, {"x", 1.0}}), 0.5);
  }
}

// Computed with 40 digits.
TEST(RegressionModel, NormalizesRegressions) {
  const struct {
    const char* method;
    double expected;
  } kRows[] = {
      {"none", 0.75},
      {"softmax", 0.679178699175393},
      {"logit", 0.679178699175393},
      {"exp", 2.117000016612675},
      {"probit", 0.7733726476231318},
      {"cloglog", 0.8796077379201704},
      {"loglog", 0.6235249162568004},
      {"cauchit", 0.7048327646991335},
  };
  for (const auto& row : kRows) {
    const auto model =
        Regression(std::string("normalizationMethod='") + row.method + "'",
                   "<RegressionTable intercept='0.25'><NumericPredictor name='x' coefficient='0.5'/>"
                   "</RegressionTable>");
    EXPECT_NEAR(Predict(*model, {{"x", 1.0}}), row.expected, 1e-12 * row.expected) << row.method;
  }
  const auto growing =
      Regression("normalizationMethod='exp'",
                 "<RegressionTable><NumericPredictor name='x' coefficient='1'/></RegressionTable>");
  EXPECT_TRUE(std::isnan(Predict(*growing, {{"x", 800.0}}))) << "overflow has no value";
}

TEST(RegressionModel, MissingResultsFollowThePolicy) {
  const auto model =
      Regression("", "<RegressionTable><NumericPredictor name='x' coefficient='1'/></RegressionTable>");
  const CaseRecord record = RecordOf({{"x", kSysmis}});
  RegResult result;
  for (const ScoreModel::MVPolicy policy : {ScoreModel::kNullPrediction, ScoreModel::kDefaultPrediction}) {
    model->SetMissingValuePolicy(policy);
    const NumericValue before(1.0);
    result.SetPrediction(&before);
    const MCScore::MCStatus status = model->Score(&record, &result);
    EXPECT_EQ(status.GetErrorCode(), 90027);
    EXPECT_TRUE(status.IsError());
    EXPECT_EQ(result.GetPrediction(), nullptr);
  }
  const_cast<ScoreDictVar*>(model->GetTargetVar())->SetDefValue(new NumericValue(12.5));
  EXPECT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(result.GetPrediction()->GetDouble(), 12.5);
  model->SetMissingValuePolicy(ScoreModel::kNullPrediction);
  EXPECT_EQ(model->Score(&record, &result).GetErrorCode(), 90027);
  EXPECT_EQ(result.GetPrediction(), nullptr);
}

TEST(RegressionModel, RefusedValuesGiveAnErrorAndNoPrediction) {
  const auto model =
      Regression("",
                 "<RegressionTable><NumericPredictor name='x' coefficient='1'/>"
                 "<CategoricalPredictor name='g' value='a' coefficient='1'/></RegressionTable>");
  RegResult result;
  const NumericValue before(1.0);
  result.SetPrediction(&before);
  CaseRecord record = RecordOf({{"x", 1.0}, {"g", "z"}});
  MCScore::MCStatus status = model->Score(&record, &result);
  EXPECT_EQ(status.GetErrorCode(), 90025);
  EXPECT_TRUE(status.IsError());
  EXPECT_EQ(status.GetDiscreteDatum(0), 1);
  EXPECT_EQ(model->GetPredictors()[1]->GetName(), "g");
  EXPECT_EQ(result.GetPrediction(), nullptr);
  EXPECT_STREQ(MCScore::StatusName(90025 - 90001), "kE_INVALID_VALUE");
  EXPECT_STREQ(MCScore::StatusName(90007 - 90001), "kE_NULLARG");
  EXPECT_STREQ(MCScore::StatusName(90027 - 90001), "kE_MISSINGVAR");
  status = model->Score(nullptr, &result);
  EXPECT_EQ(status.GetErrorCode(), 90007);
  EXPECT_TRUE(status.IsError());
  EXPECT_EQ(model->Score(&record, nullptr).GetErrorCode(), 90007);
  record.SetValue("g", std::string("a"));
  EXPECT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(result.GetPrediction()->GetDouble(), 2.0);
}

TEST(RegressionModel, TellsWhatItIs) {
  const auto model = BuildModel(DocumentOf(
      "<RegressionModel functionName='regression' modelType='linearRegression' "
      "normalizationMethod='exp'><Extension/><MiningSchema><MiningField name='t' "
      "usageType='supplementary'/><MiningField name='z'/><MiningField name='g'/><MiningField "
      "name='x'/><MiningField name='y' usageType='predicted'/></MiningSchema><LocalTransformations/>"
      "<RegressionTable intercept='1.5'><NumericPredictor name='x' exponent='2' "
      "coefficient='0.1234567'/><NumericPredictor name='x' coefficient='3'/><CategoricalPredictor "
      "name='g' value='b' coefficient='-2'/><PredictorTerm coefficient='4'><FieldRef field='z'/>"
      "<FieldRef field='x'/></PredictorTerm></RegressionTable></RegressionModel>"));
  EXPECT_EQ(model->GetModelKind(), "RegressionModel");
  EXPECT_FALSE(model->SuppressCategoryProbabilities());
  ASSERT_EQ(model->GetPredictors().size(), 3u);
  EXPECT_EQ(model->GetPredictors()[0]->GetName(), "x");
  EXPECT_EQ(model->GetPredictors()[1]->GetName(), "g");
  EXPECT_EQ(model->GetPredictors()[2], model->GetDictionary()->GetVar("z"));
  EXPECT_EQ(model->GetTargetVar()->GetName(), "y");
  EXPECT_EQ(model->GetVarRole("y"), ScoreModel::kTarget);
  EXPECT_EQ(model->GetVarRole("z"), ScoreModel::kPredictor);
  EXPECT_EQ(model->GetVarRole("t"), ScoreModel::kSupplementary);
  EXPECT_EQ(model->GetVarRole("k"), -1);
  EXPECT_EQ(model->GetMissingValuePolicy(), ScoreModel::kDefaultPrediction);
  EXPECT_EQ(model->GetVersionInfo()->GetVersionInfo(), "4.4");
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  EXPECT_NE(dynamic_cast<RegResult*>(result.get()), nullptr);
  std::ostringstream out;
  model->Display(out);
  EXPECT_EQ(out.str(),
            "Start RegressionModel Display:\n"
            "Function = regression; Normalization = exp; Target = y\n"
            "Table; Intercept = 1.5\n"
            "\tNumericPredictor x; Exponent = 2; Coefficient = 0.123457\n"
            "\tNumericPredictor x; Coefficient = 3\n"
            "\tCategoricalPredictor g = b; Coefficient = -2\n"
            "\tPredictorTerm z * x; Coefficient = 4\n"
            "End of RegressionModel Display.\n\n");
}

TEST(RegressionModel, TargetFieldNameServesWhereTheSchemaNamesNone) {
  const std::string table = "<RegressionTable intercept='1'/>";
  auto model = BuildModel(DocumentOf(ModelOf("functionName='regression' targetFieldName='y'", "", table)));
  EXPECT_EQ(model->GetTargetVar()->GetName(), "y");
  EXPECT_EQ(model->GetVarRole("y"), ScoreModel::kTarget);
  model = BuildModel(DocumentOf(ModelOf("functionName='regression' targetFieldName='x'", "y", table)));
  EXPECT_EQ(model->GetTargetVar()->GetName(), "y") << "the schema goes first";
  model = BuildModel(DocumentOf(ModelOf("functionName='regression'", "", table)));
  EXPECT_EQ(model->GetTargetVar(), nullptr);
  EXPECT_EQ(Predict(*model, {}), 1.0) << "no target is needed for a number";
  model = BuildModel(
      DocumentOf("<RegressionModel functionName='regression' targetFieldName='x'><MiningSchema>"
                 "<MiningField name='x' usageType='target'/><MiningField name='y' usageType='target'/>"
                 "</MiningSchema>" +
                 table + "</RegressionModel>"));
  EXPECT_EQ(model->GetTargetVar()->GetName(), "x") << "chosen among several";
}

TEST(RegressionModel, BuildsFromAnElementAndADictionary) {
  const auto tree = kestrel_test::ReadTree(
      ModelOf("functionName='regression'", "y",
              "<RegressionTable><NumericPredictor name='n' coefficient='2'/></RegressionTable>"));
  const auto dictionary =
      kestrel_test::ReadDictionary(kestrel_test::DictionaryOf(9, kestrel_tests::TestFields()));
  RegressionTranslator translator;
  const std::unique_ptr<ScoreModel> model(
      translator.ParseFromTree(tree->GetRoot(), dictionary.get(), dictionary.get(), std::string()));
  EXPECT_NE(model->GetDictionary(), dictionary.get());
  EXPECT_NE(model->GetResultDictionary(), nullptr);
  EXPECT_EQ(Predict(*model, {{"n", 3.0}}), 6.0);
}

}  // namespace
