// The model library as hosts meet it: loaded by the factory through its name.

#include <gtest/gtest.h>

#include <cmath>
#include <fstream>
#include <memory>
#include <sstream>
#include <string>
#include <thread>
#include <vector>

#include "kestrel/foundation/NumberText.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/Results.h"
#include "tests/plugins/ModelText.h"
#include "tests/support/ExpectFault.h"
#include "tests/support/PlainTable.h"

namespace {

using namespace MCKestrel_800;
using kestrel_tests::PlainTable;
using kestrel_tests::ReadPlainTable;
using kestrel_tests::RecordOf;

std::unique_ptr<ScoreModel> Load(std::istream& in) {
  return std::unique_ptr<ScoreModel>(
      ModelFactory::MakeModelFromXML(in, {"TreeModel", "RegressionModel"}, ""));
}

/// Text cells for fields that are texts, numbers for the others; a field without variable is not put in.
CaseRecord RecordOfRow(const ScoreModel& model, const PlainTable& data, size_t row) {
  CaseRecord record(static_cast<int>(data.header.size()));
  for (const ScoreDictVar* variable : model.GetPredictors()) {
    for (size_t column = 0; column < data.header.size(); ++column) {
      if (data.header[column] != variable->GetName()) continue;
      record.Add(variable->GetName(), variable->ToMyValue(data.rows[row][column]));
    }
  }
  return record;
}

double ToNumber(const std::string& text) {
  double number = 0.0;
  EXPECT_TRUE(ParseDouble(text.data(), text.data() + text.size(), number)) << text;
  return number;
}

void ExpectNear(double actual, const std::string& expected) {
  EXPECT_NEAR(actual, ToNumber(expected), 1e-12 * std::fabs(ToNumber(expected)));
}

// Columns of the expected table: "prediction", "probability" and one "probability_CATEGORY" each.
void ExpectRow(const ScoreResult& result, const PlainTable& expected, size_t row) {
  const auto* classification = dynamic_cast<const ClsResult*>(&result);
  for (size_t column = 0; column < expected.header.size(); ++column) {
    const std::string& name = expected.header[column];
    const std::string& cell = expected.rows[row][column];
    SCOPED_TRACE(name + " of row " + std::to_string(row));
    if (classification == nullptr) {
      ExpectNear(result.GetPrediction()->GetDouble(), cell);
    } else if (name == "prediction") {
      EXPECT_EQ(result.GetPrediction()->GetString(), cell);
    } else if (name == "probability") {
      ExpectNear(classification->GetProbability(), cell);
    } else {
      const StringValue category(name.substr(std::string("probability_").size()));
      ExpectNear(classification->GetCategoryProbability(&category), cell);
    }
  }
}

// The expected tables were written by the programs that fitted the models.
TEST(RegressionLibrary, AgreesWithTheFittingProgramsToTwelveDigits) {
  for (const std::string name : {"breast-cancer", "diabetes", "housing", "iris", "titanic", "warpbreaks"}) {
    SCOPED_TRACE(name);
    const std::string folder = KESTREL_SOURCE_DIR "/examples/" + name;
    std::ifstream in(folder + "/model.xml", std::ios::binary);
    ASSERT_TRUE(in.good());
    const std::unique_ptr<ScoreModel> model = Load(in);
    const std::unique_ptr<ScoreResult> result(model->MakeResult());
    const PlainTable data = ReadPlainTable(folder + "/data.csv");
    const PlainTable expected = ReadPlainTable(folder + "/expected.csv");
    ASSERT_EQ(data.rows.size(), expected.rows.size());
    for (size_t row = 0; row < data.rows.size(); ++row) {
      const CaseRecord record = RecordOfRow(*model, data, row);
      ASSERT_TRUE(model->Score(&record, result.get()).IsOK()) << row;
      ExpectRow(*result, expected, row);
    }
  }
}

TEST(RegressionLibrary, FaultsPassThroughTheFactory) {
  std::istringstream in(kestrel_tests::DocumentOf(
      kestrel_tests::ModelOf("functionName='regression'", "y", "<RegressionTable/><RegressionTable/>")));
  kestrel_tests::ExpectFault([&] { Load(in); }, 1, "Only one RegressionTable is allowed for regression!");
}

TEST(RegressionLibrary, TwoModelsScoreOnTwoThreads) {
  const auto run = [](double slope, int* wrong) {
    std::istringstream in(kestrel_tests::DocumentOf(kestrel_tests::ModelOf(
        "functionName='regression'", "y",
        "<RegressionTable intercept='1'><NumericPredictor name='x' coefficient='" + std::to_string(slope) +
            "'/><CategoricalPredictor name='g' value='b' coefficient='0.5'/></RegressionTable>")));
    const std::unique_ptr<ScoreModel> model = Load(in);
    const std::unique_ptr<ScoreResult> result(model->MakeResult());
    CaseRecord record = RecordOf({{"x", 0.0}, {"g", "b"}});
    for (int i = 0; i < 20000; ++i) {
      record.SetValue(0, static_cast<double>(i));
      const bool is_right = model->Score(&record, result.get()).IsOK() &&
                            result->GetPrediction()->GetDouble() == 1.0 + slope * i + 0.5;
      if (!is_right) ++*wrong;
    }
  };
  int wrong[2] = {};
  std::thread first(run, 2.0, &wrong[0]);
  std::thread second(run, -3.0, &wrong[1]);
  first.join();
  second.join();
  EXPECT_EQ(wrong[0], 0);
  EXPECT_EQ(wrong[1], 0);
}

TEST(RegressionLibrary, RecordsOfAnyLayoutScoreTheSame) {
  std::istringstream in(kestrel_tests::DocumentOf(
      kestrel_tests::ModelOf("functionName='regression'", "y",
                             "<RegressionTable><NumericPredictor name='x' coefficient='1'/><NumericPredictor "
                             "name='z' coefficient='10'/>"
                             "</RegressionTable>")));
  const std::unique_ptr<ScoreModel> model = Load(in);
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  const CaseRecord first = RecordOf({{"x", 1.0}, {"z", 2.0}});
  const CaseRecord second = RecordOf({{"z", 2.0}, {"q", 5.0}, {"x", 1.0}});
  for (int i = 0; i < 3; ++i) {
    for (const CaseRecord* record : {&first, &second}) {
      ASSERT_TRUE(model->Score(record, result.get()).IsOK());
      EXPECT_EQ(result->GetPrediction()->GetDouble(), 21.0);
    }
  }
}

}  // namespace
