// Random trees against the answers of an evaluator of its own: tests/data/tree/score_tree.py, which was
// written from the standard's text and knows nothing of this library. make_trees.py beside it says how
// documents and tables are made and what the columns are.

#include <gtest/gtest.h>

#include <cmath>
#include <fstream>
#include <memory>
#include <string>

#include "kestrel/foundation/NumberText.h"
#include "kestrel/model/ModelFactory.h"
#include "tests/plugins/TreeText.h"
#include "tests/support/PlainTable.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

constexpr int kDocuments = 60;
constexpr double kTolerance = 1e-12;

std::string PathOf(int number, const char* suffix) {
  const std::string digits = std::to_string(100 + number).substr(1);
  return std::string(KESTREL_SOURCE_DIR) + "/tests/data/tree/random/" + digits + suffix;
}

/// Named by the file it is read from, as hosts do.
std::unique_ptr<ScoreModel> LoadFile(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  return std::unique_ptr<ScoreModel>(ModelFactory::MakeModelFromXML(in, {"TreeModel"}, std::string()));
}

size_t ColumnOf(const PlainTable& table, const std::string& name) {
  size_t column = 0;
  while (table.header.at(column) != name)
    ++column;
  return column;
}

/// The cells of the inputs, which stand before the prediction, as a host makes values of them.
CaseRecord RecordOfRow(const ScoreModel& model, const PlainTable& table, size_t row) {
  const size_t inputs = ColumnOf(table, "prediction");
  CaseRecord record(static_cast<int>(inputs));
  for (size_t column = 0; column < inputs; ++column) {
    const std::string& cell = table.rows[row][column];
    const ScoreDictVar* variable = model.GetDictionary()->GetVar(table.header[column]);
    record.Add(table.header[column], cell.empty() ? nullptr : variable->ToMyValue(cell));
  }
  return record;
}

double ToNumber(const std::string& text) {
  double number = 0.0;
  EXPECT_TRUE(ParseDouble(text.data(), text.data() + text.size(), number)) << text;
  return number;
}

void ExpectNear(double found, const std::string& wanted, const std::string& why) {
  EXPECT_NEAR(found, ToNumber(wanted), kTolerance * std::fmax(1.0, std::fabs(ToNumber(wanted)))) << why;
}

/// Compares a result with one row; `status` is OK.
void ExpectRow(ScoreResult& result, const PlainTable& table, size_t row, const std::string& where) {
  const ScoreValue& prediction = *result.GetPrediction();
  const auto* classification = dynamic_cast<const ClsResult*>(&result);
  size_t categories = 0;
  for (size_t column = ColumnOf(table, "prediction"); column < table.header.size(); ++column) {
    const std::string& name = table.header[column];
    const std::string& cell = table.rows[row][column];
    const std::string why = where + ", " + name;
    if (name == "prediction") {
      if (classification != nullptr) {
        EXPECT_EQ(prediction.GetString(), cell) << why;
      } else {
        ExpectNear(prediction.GetDouble(), cell, why);
      }
    } else if (name == "probability") {
      ExpectNear(result.GetProbability(), cell, why);
    } else if (name == "node") {
      if (cell != "?") {
        EXPECT_EQ(ResultEntities::Of(&result)->GetDecidingId(), cell) << why;
      }
    } else {
      ASSERT_LT(categories, classification->GetCategoryCount()) << why;
      EXPECT_EQ("probability_" + classification->GetCategory(categories)->GetString(), name) << where;
      if (!cell.empty()) ExpectNear(classification->GetProbability(categories), cell, why);
      ++categories;
    }
  }
  if (classification != nullptr) {
    EXPECT_EQ(classification->GetCategoryCount(), categories) << where;
  }
}

TEST(TreeRandom, ScoresAsTheEvaluatorDoes) {
  int predictions = 0, none = 0, several = 0;
  for (int number = 0; number < kDocuments; ++number) {
    const auto model = LoadFile(PathOf(number, ".xml"));
    ASSERT_NE(model, nullptr) << number;
    const PlainTable table = ReadPlainTable(PathOf(number, ".csv"));
    ASSERT_GE(table.rows.size(), 20u) << number;
    const auto result = MakeResultOf(*model);
    for (size_t row = 0; row < table.rows.size(); ++row) {
      const std::string where = std::to_string(number) + ".csv, row " + std::to_string(row + 1);
      const CaseRecord record = RecordOfRow(*model, table, row);
      const MCScore::MCStatus status = model->Score(&record, result.get());
      if (table.rows[row][ColumnOf(table, "prediction")].empty()) {
        EXPECT_EQ(status.GetErrorCode(), 90027) << where;
        EXPECT_EQ(result->GetPrediction(), nullptr) << where;
        ++none;
        continue;
      }
      ASSERT_TRUE(status.IsOK()) << where << ": " << status.GetErrorCode();
      ExpectRow(*result, table, row, where);
      ++predictions;
      several += table.rows[row].back().empty() ? 1 : 0;
    }
  }
  // Enough of each, or the comparison is worth little.
  EXPECT_GT(predictions, 1200);
  EXPECT_GT(none, 300);
  EXPECT_GT(several, 200);
}

}  // namespace
}  // namespace kestrel_tests
