// The example of a model kind of one's own, as hosts meet it: loaded by the factory through its name.

#include <gtest/gtest.h>

#include <cmath>
#include <fstream>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/Results.h"
#include "tests/plugins/ModelText.h"
#include "tests/support/AllocationCount.h"
#include "tests/support/ExpectFault.h"
#include "tests/support/PlainTable.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

std::unique_ptr<ScoreModel> Load(std::istream& in) {
  return std::unique_ptr<ScoreModel>(ModelFactory::MakeModelFromXML(in, {"CentroidModel"}, ""));
}

std::unique_ptr<ScoreModel> Load(const std::string& document) {
  std::istringstream in(document);
  return Load(in);
}

std::string Coordinate(const char* field, const char* value) {
  return std::string("<Coordinate field='") + field + "' value='" + value + "'/>";
}

std::string Centroid(const char* category, const std::string& coordinates) {
  return std::string("<Centroid category='") + category + "'>" + coordinates + "</Centroid>";
}

/// red at (0, 0), green at (2, 0).
std::string RedAndGreen() {
  return Centroid("red", Coordinate("x", "0") + Coordinate("z", "0")) +
         Centroid("green", Coordinate("z", "0") + Coordinate("x", "2"));
}

/// A model of the target m with all inputs active.
std::string ColourModel(const std::string& inside) {
  return "<CentroidModel functionName='classification'><MiningSchema>" + std::string(TestInputs()) +
         "<MiningField name='m' usageType='target'/></MiningSchema>" + inside + "</CentroidModel>";
}

std::string ColourDocument(const std::string& inside) {
  return DocumentOf(ColourModel(inside));
}

TEST(CentroidModel, AgreesWithTheFittingProgram) {
  const std::string folder = KESTREL_SOURCE_DIR "/plugins/example/";
  std::ifstream in(folder + "model.xml", std::ios::binary);
  const std::unique_ptr<ScoreModel> model = Load(in);
  const PlainTable data = ReadPlainTable(folder + "data.csv");
  const PlainTable expected = ReadPlainTable(folder + "expected.csv");
  ASSERT_EQ(data.rows.size(), 150u);
  ASSERT_EQ(expected.rows.size(), data.rows.size());
  ClsResult result;
  for (size_t row = 0; row < data.rows.size(); ++row) {
    SCOPED_TRACE("case " + std::to_string(row + 1));
    const CaseRecord record = RecordOf(
        {{data.header[0], std::stod(data.rows[row][0])}, {data.header[1], std::stod(data.rows[row][1])}});
    ASSERT_TRUE(model->Score(&record, &result).IsOK());
    EXPECT_EQ(result.GetPrediction()->GetString(), expected.rows[row][0]);
    ASSERT_EQ(result.GetCategoryCount() + 2, expected.header.size());
    for (size_t i = 1; i < expected.header.size(); ++i) {
      const double want = std::stod(expected.rows[row][i]);
      const double got = i == 1 ? result.GetProbability() : result.GetProbability(i - 2);
      EXPECT_NEAR(got, want, 1e-12 * want);
      const std::string column = i == 1 ? "" : "_" + result.GetCategory(i - 2)->GetString();
      EXPECT_EQ("probability" + column, expected.header[i]);
    }
  }
}

struct CaseRow {
  const char* why;
  double x;
  double z;
  const char* prediction;
  double probability;  ///< of the prediction
  double other;        ///< of the other category
};

const CaseRow kCaseRows[] = {
    {"nearer to the first", 0.5, 0.0, "red", 1.0 / (1.0 + std::exp(-1.0)), 1.0 / (1.0 + std::exp(1.0))},
    {"nearer to the second", 1.5, 0.0, "green", 1.0 / (1.0 + std::exp(-1.0)), 1.0 / (1.0 + std::exp(1.0))},
    {"a field in which they agree", 1.5, 7.0, "green", 1.0 / (1.0 + std::exp(-1.0)),
     1.0 / (1.0 + std::exp(1.0))},
    {"of equally near ones the first", 1.0, 5.0, "red", 0.5, 0.5},
    {"far from both, where both densities are 0", 1e10, 0.0, "green", 1.0, 0.0},
    {"far on the other side", -1e100, 0.0, "red", 0.5, 0.5},
};

TEST(CentroidModel, PredictsTheNearestCategory) {
  const std::unique_ptr<ScoreModel> model = Load(ColourDocument(RedAndGreen()));
  ClsResult result;
  for (const CaseRow& row : kCaseRows) {
    const CaseRecord record = RecordOf({{"z", row.z}, {"x", row.x}});
    ASSERT_TRUE(model->Score(&record, &result).IsOK()) << row.why;
    EXPECT_EQ(result.GetPrediction()->GetString(), row.prediction) << row.why;
    EXPECT_NEAR(result.GetProbability(), row.probability, 1e-15) << row.why;
    const StringValue other(row.prediction == std::string("red") ? "green" : "red");
    EXPECT_NEAR(result.GetCategoryProbability(&other), row.other, 1e-15) << row.why;
    const StringValue blue("blue");
    EXPECT_EQ(result.GetCategoryProbability(&blue), 0.0) << "a category without centroid";
  }
}

TEST(CentroidModel, GivesAPlainResultNoCategories) {
  const std::unique_ptr<ScoreModel> model = Load(ColourDocument(RedAndGreen()));
  RegResult result;
  const CaseRecord record = RecordOf({{"x", 1.0}, {"z", 0.0}});
  ASSERT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(result.GetPrediction()->GetString(), "red");
  EXPECT_EQ(result.GetProbability(), 0.5);
}

TEST(CentroidModel, HasNoPredictionWithoutData) {
  const std::pair<const char*, CaseRecord> rows[] = {
      {"a missing number", RecordOf({{"x", NumericValue::gSysmisValue}, {"z", 0.0}})},
      {"an absent field", RecordOf({{"x", 1.0}})},
      {"distances that are no finite numbers", RecordOf({{"x", 1e200}, {"z", 0.0}})},
      {"an infinite number", RecordOf({{"x", HUGE_VAL}, {"z", 0.0}})},
  };
  const std::unique_ptr<ScoreModel> model = Load(ColourDocument(RedAndGreen()));
  ClsResult result;
  for (const auto& [why, record] : rows) {
    const MCScore::MCStatus status = model->Score(&record, &result);
    EXPECT_TRUE(status.IsError()) << why;
    EXPECT_EQ(status.GetErrorCode(), 90027) << why;
    EXPECT_EQ(result.GetPrediction(), nullptr) << why;
    EXPECT_EQ(result.GetCategoryCount(), 0u) << why;
  }
}

std::string Outputs(ScoreResult& result) {
  std::string all;
  for (const char* name : {"label", "chance", "warning"}) {
    const ScoreValue* value = OutputFieldsOf(&result)->GetResultValue(name);
    all += value == nullptr ? "nothing; " : value->IsSystemMissingValue() ? "-; " : value->GetString() + "; ";
  }
  return all;
}

// What every model kind gets without a line of its own.
TEST(CentroidModel, HasReplacementsTargetsAndOutputFields) {
  const std::unique_ptr<ScoreModel> model = Load(DocumentOf(
      "<CentroidModel functionName='classification'><MiningSchema>"
      "<MiningField name='x' missingValueReplacement='1.5'/><MiningField name='z'/>"
      "<MiningField name='m' usageType='target'/></MiningSchema>"
      "<Output><OutputField name='label' feature='predictedDisplayValue'/>"
      "<OutputField name='chance' feature='probability' value='red' dataType='string'/>"
      "<OutputField name='warning' feature='warning'/></Output>"
      "<Targets><Target field='m'><TargetValue value='red' displayValue='Red!' priorProbability='0.75'/>"
      "<TargetValue value='green' displayValue='Green!' priorProbability='0.25'/></Target></Targets>" +
      RedAndGreen() + "</CentroidModel>"));
  const std::unique_ptr<ScoreResult> result(model->MakeResult());

  const CaseRecord replaced = RecordOf({{"z", 0.0}});
  EXPECT_TRUE(model->Score(&replaced, result.get()).IsOK());
  EXPECT_EQ(Outputs(*result), "Green!; 0.2689414213699951; ; ");

  const CaseRecord missing = RecordOf({{"x", 0.0}});
  EXPECT_TRUE(model->Score(&missing, result.get()).IsOK());
  EXPECT_EQ(Outputs(*result), "Red!; 0.75; data are missing, the target's default is predicted; ");

  model->SetMissingValuePolicy(ScoreModel::kNullPrediction);
  EXPECT_EQ(model->Score(&missing, result.get()).GetErrorCode(), 90027);
  EXPECT_EQ(Outputs(*result), "; ; data are missing, nothing is predicted; ");

  const CaseRecord invalid = RecordOf({{"x", 0.0}, {"z", "high"}});
  EXPECT_EQ(model->Score(&invalid, result.get()).GetErrorCode(), 90025);
  EXPECT_EQ(Outputs(*result), "; ; invalid value of z; ");
}

TEST(CentroidModel, TakesDerivedFields) {
  const std::unique_ptr<ScoreModel> model = Load(ColourDocument(
      "<LocalTransformations><DerivedField name='twice' optype='continuous' dataType='double'>"
      "<Apply function='*'><FieldRef field='x'/><Constant dataType='double'>2</Constant></Apply>"
      "</DerivedField></LocalTransformations>" +
      Centroid("red", Coordinate("twice", "0")) + Centroid("blue", Coordinate("twice", "10"))));
  ASSERT_EQ(model->GetPredictors().size(), 1u);
  EXPECT_EQ(model->GetPredictors()[0]->GetName(), "x");
  ClsResult result;
  const CaseRecord record = RecordOf({{"x", 3.0}});
  ASSERT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(result.GetPrediction()->GetString(), "blue");
}

TEST(CentroidModel, PredictsTextsWithoutATarget) {
  const std::unique_ptr<ScoreModel> model =
      Load(DocumentOf("<CentroidModel functionName='classification'><MiningSchema><MiningField name='x'/>"
                      "</MiningSchema>" +
                      Centroid("any", Coordinate("x", "0")) + "</CentroidModel>"));
  ClsResult result;
  const CaseRecord record = RecordOf({{"x", 3.0}});
  ASSERT_TRUE(model->Score(&record, &result).IsOK());
  EXPECT_EQ(result.GetPrediction()->GetString(), "any");
  EXPECT_EQ(result.GetProbability(), 1.0);
}

TEST(CentroidModel, TellsWhatItIs) {
  const std::unique_ptr<ScoreModel> model = Load(ColourDocument(RedAndGreen()));
  EXPECT_EQ(model->GetModelKind(), "CentroidModel");
  std::ostringstream out;
  model->Display(out);
  EXPECT_EQ(out.str(), "Centroid red\n\tx = 0\n\tz = 0\nCentroid green\n\tx = 2\n\tz = 0\n");
}

TEST(CentroidModel, AllocationsOfThePlugInAreCounted) {
  const std::unique_ptr<ScoreModel> model = Load(ColourDocument(RedAndGreen()));
  const size_t before = CountAllocations();
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  EXPECT_GT(CountAllocations(), before) << result.get();
}

TEST(CentroidModel, AllocatesNothingAfterTheFirstCase) {
  const std::unique_ptr<ScoreModel> model = Load(ColourDocument(RedAndGreen()));
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  const CaseRecord complete = RecordOf({{"x", 0.5}, {"z", 0.0}});
  const CaseRecord missing = RecordOf({{"z", 0.0}, {"x", NumericValue::gSysmisValue}});
  model->Score(&complete, result.get());
  model->Score(&missing, result.get());
  model->Score(&complete, result.get());
  const size_t before = CountAllocations();
  int scored = 0;
  for (int i = 0; i < 100; ++i)
    scored += model->Score(&complete, result.get()).IsOK() ? 1 : 0;
  EXPECT_EQ(CountAllocations(), before);
  EXPECT_EQ(scored, 100);
}

struct FaultRow {
  const char* why;
  std::string inside;
  int code;
  const char* text;
};

TEST(CentroidModel, RefusesWhatIsWrong) {
  const std::string good = Coordinate("x", "1");
  const FaultRow rows[] = {
      {"no centroid", "", 4, "Node is missing --- Centroid ---"},
      {"no coordinate", Centroid("red", ""), 4, "Node is missing --- Coordinate ---"},
      {"no category", "<Centroid>" + good + "</Centroid>", 4,
       "Attribute category is missing from Node \"Centroid\""},
      {"a category that the target does not list", Centroid("pink", good), 7, "m: invalid value!"},
      {"a category twice", Centroid("red", good) + Centroid("red", good), 1,
       "\"red\": Duplicated Category Value!"},
      {"a field that there is not", Centroid("red", Coordinate("q", "1")), 8,
       "Variable q not among the active fields of the MiningSchema!"},
      {"the target", Centroid("red", Coordinate("m", "1")), 8,
       "Variable m not among the active fields of the MiningSchema!"},
      {"no field", Centroid("red", "<Coordinate value='1'/>"), 8,
       "Variable  not among the active fields of the MiningSchema!"},
      {"a text field", Centroid("red", Coordinate("g", "1")), 11, "g: Invalid Variable Type"},
      {"a field twice", Centroid("red", good + good), 1, "x: Duplicated Coordinate!"},
      {"no number", Centroid("red", Coordinate("x", "one")), 3, "oneInvalid double string -- "},
      {"no value", Centroid("red", "<Coordinate field='x'/>"), 3, "Invalid double string -- "},
      {"a number that is not finite", Centroid("red", Coordinate("x", "1e999")), 6, "invalid value -- 1e999"},
      {"a field more", Centroid("red", good) + Centroid("blue", good + Coordinate("z", "1")), 1,
       "Centroids have different fields!"},
      {"a field less", Centroid("red", good + Coordinate("z", "1")) + Centroid("blue", good), 1,
       "Centroids have different fields!"},
      {"another field", Centroid("red", good) + Centroid("blue", Coordinate("z", "1")), 1,
       "Centroids have different fields!"},
  };
  for (const FaultRow& row : rows)
    ExpectFault([&] { Load(ColourDocument(row.inside)); }, row.code, row.text, row.why);
  ExpectFault(
      [] {
        Load(
            DocumentOf("<CentroidModel functionName='regression'><MiningSchema><MiningField name='x'/>"
                       "</MiningSchema></CentroidModel>"));
      },
      5, "functionName -- regression: Not supported!");
}

TEST(CentroidModel, TellsWhereTheFaultStands) {
  try {
    Load(ColourDocument("\n<Centroid category='red'>\n <Coordinate field='q' value='1'/></Centroid>"));
    FAIL() << "nothing was thrown";
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetLine(), 3u);
    EXPECT_EQ(fault.GetColumn(), 35u);
  }
}

}  // namespace
}  // namespace kestrel_tests
