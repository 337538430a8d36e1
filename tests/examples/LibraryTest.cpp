// Scores every example through the library and compares with the answers of the program that trained the
// model.

#include <gtest/gtest.h>

#include <map>
#include <memory>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/model/Results.h"
#include "tests/examples/LoadedExample.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

class EveryExample : public LoadedExample {
 protected:
  void SetUp() override { Load("expected.csv"); }
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
    ASSERT_TRUE(model_->Score(MakeRecord(data_.rows[row], /*has_target=*/false).get(), result.get()).IsOK());
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
