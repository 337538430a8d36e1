// Scores the examples with output fields through the library and compares every field with the training
// program's answer.

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <fstream>
#include <memory>
#include <string>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/Results.h"
#include "kestrel/model/ScoreModel.h"
#include "tests/examples/ExampleFolders.h"
#include "tests/support/PlainTable.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

class EveryExampleWithOutputs : public testing::TestWithParam<std::string> {
 protected:
  void SetUp() override {
    std::ifstream document(ExamplePath(GetParam(), "model.xml"), std::ios::binary);
    ASSERT_TRUE(document.is_open());
    model_.reset(ModelFactory::MakeModelFromXML(document, ExampleKinds(), std::string()));
    ASSERT_NE(model_, nullptr);
    data_ = ReadPlainTable(ExamplePath(GetParam(), "data.csv"));
    expected_ = ReadPlainTable(ExamplePath(GetParam(), "outputs.csv"));
    ASSERT_FALSE(expected_.rows.empty());
    ASSERT_EQ(data_.rows.size(), expected_.rows.size());
  }

  /// Of all columns, the target's too; an empty cell is a missing value.
  std::unique_ptr<CaseRecord> MakeRecord(const std::vector<std::string>& cells) const {
    auto record = std::make_unique<CaseRecord>(static_cast<int>(cells.size()));
    for (size_t i = 0; i < cells.size(); ++i) {
      const ScoreDictVar* var = model_->GetDictionary()->GetVar(data_.header[i]);
      EXPECT_NE(var, nullptr) << data_.header[i];
      if (var == nullptr) continue;
      record->Add(data_.header[i], var->ToMyValue(cells[i]));
      if (cells[i].empty()) record->SetMissingValue(data_.header[i]);
    }
    return record;
  }

  std::unique_ptr<ScoreModel> model_;
  PlainTable data_;
  PlainTable expected_;
};

void ExpectCell(const std::string& expected, const ScoreValue* value) {
  ASSERT_NE(value, nullptr);
  if (value->GetType() == ScoreValue::kString) {
    EXPECT_EQ(value->GetString(), expected);
  } else if (expected.empty()) {
    EXPECT_TRUE(value->IsSystemMissingValue());
  } else {
    // A residual is a difference of numbers of that size.
    const double number = std::stod(expected);
    EXPECT_NEAR(value->GetDouble(), number, kTolerance * std::max(100.0, std::abs(number)));
  }
}

TEST_P(EveryExampleWithOutputs, AgreesWithItsTrainingProgram) {
  EXPECT_EQ(model_->GetResultDictionary()->GetVarNames(), expected_.header);
  const std::unique_ptr<ScoreResult> result(model_->MakeResult());
  for (size_t row = 0; row < data_.rows.size(); ++row) {
    model_->Score(MakeRecord(data_.rows[row]).get(), result.get());
    for (size_t i = 0; i < expected_.header.size(); ++i) {
      SCOPED_TRACE("case " + std::to_string(row + 1) + ", field " + expected_.header[i]);
      ExpectCell(expected_.rows[row][i], OutputFieldsOf(result.get())->GetResultValue(expected_.header[i]));
    }
  }
}

INSTANTIATE_TEST_SUITE_P(Examples, EveryExampleWithOutputs, testing::ValuesIn(OutputExampleFolders()),
                         [](const auto& example) { return TestNameOf(example.param); });

}  // namespace
}  // namespace kestrel_tests
