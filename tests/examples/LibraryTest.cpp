// Scores every example through the library and compares with the answers of the program that trained the
// model.

#include <gtest/gtest.h>

#include <fstream>
#include <map>
#include <memory>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/Results.h"
#include "kestrel/model/ScoreModel.h"
#include "tests/examples/ExampleFolders.h"
#include "tests/support/PlainTable.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

class EveryExample : public testing::TestWithParam<std::string> {
 protected:
  void SetUp() override {
    std::ifstream document(ExamplePath(GetParam(), "model.xml"), std::ios::binary);
    ASSERT_TRUE(document.is_open());
    model_.reset(ModelFactory::MakeModelFromXML(document, ExampleKinds(), std::string()));
    ASSERT_NE(model_, nullptr);
    data_ = ReadPlainTable(ExamplePath(GetParam(), "data.csv"));
    expected_ = ReadPlainTable(ExamplePath(GetParam(), "expected.csv"));
    ASSERT_FALSE(expected_.rows.empty());
    ASSERT_EQ(data_.rows.size(), expected_.rows.size());
  }

  std::unique_ptr<CaseRecord> MakeRecord(const std::vector<std::string>& cells) const {
    auto record = std::make_unique<CaseRecord>(static_cast<int>(cells.size()));
    for (size_t i = 0; i < cells.size(); ++i) {
      const ScoreDictVar* var = model_->GetDictionary()->GetVar(data_.header[i]);
      EXPECT_NE(var, nullptr) << data_.header[i];
      if (var == nullptr || model_->GetVarRole(var) == ScoreModel::kTarget) continue;
      record->Add(data_.header[i], var->ToMyValue(cells[i]));
    }
    return record;
  }

  std::unique_ptr<ScoreModel> model_;
  PlainTable data_;
  PlainTable expected_;
};

TEST_P(EveryExample, AgreesWithItsTrainingProgram) {
  const std::unique_ptr<ScoreResult> result(model_->MakeResult());
  auto* classes = dynamic_cast<ScoreClsResult*>(result.get());
  const bool regression = expected_.header.size() == 1;
  ASSERT_EQ(classes == nullptr, regression);
  for (size_t row = 0; row < data_.rows.size(); ++row) {
    const std::vector<std::string>& expected = expected_.rows[row];
    SCOPED_TRACE("case " + std::to_string(row + 1));
    result->Reset();
    ASSERT_TRUE(model_->Score(MakeRecord(data_.rows[row]).get(), result.get()).IsOK());
    ASSERT_NE(result->GetPrediction(), nullptr);
    if (regression) {
      EXPECT_PRED2(AgreesWith, std::stod(expected[0]), result->GetPrediction()->GetDouble());
      continue;
    }
    EXPECT_EQ(result->GetPrediction()->GetString(), expected[0]);
    EXPECT_PRED2(AgreesWith, std::stod(expected[1]), result->GetProbability());
    ASSERT_EQ(classes->GetCategoryCount(), expected.size() - 2);
    for (size_t i = 2; i < expected.size(); ++i) {
      const StringValue category(expected_.header[i].substr(std::string("probability_").size()));
      EXPECT_PRED2(AgreesWith, std::stod(expected[i]), classes->GetCategoryProbability(&category));
    }
  }
}

INSTANTIATE_TEST_SUITE_P(Examples, EveryExample, testing::ValuesIn(ExampleFolders()),
                         [](const auto& example) { return TestNameOf(example.param); });

}  // namespace
}  // namespace kestrel_tests
