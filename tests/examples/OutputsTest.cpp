// Scores the examples with output fields through the library and compares every field with the training
// program's answer.

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <memory>
#include <string>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/model/Results.h"
#include "tests/examples/LoadedExample.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

class EveryExampleWithOutputs : public LoadedExample {
 protected:
  void SetUp() override { Load("outputs.csv"); }
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
    model_->Score(MakeRecord(data_.rows[row], /*has_target=*/true).get(), result.get());
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
