// Shows that scoring allocates nothing after the first case. A program of its own, because it counts every
// allocation of the process.

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "kestrel/model/Results.h"
#include "tests/model/AllocationCount.h"
#include "tests/plugins/ModelText.h"

namespace {

using namespace MCKestrel_800;
using kestrel_tests::BuildModel;
using kestrel_tests::CountAllocations;
using kestrel_tests::DocumentOf;
using kestrel_tests::ModelOf;
using kestrel_tests::RecordOf;

TEST(ScoringAllocation, IsCountedHere) {
  const size_t before = CountAllocations();
  const std::vector<int> some(100);
  EXPECT_GT(CountAllocations(), before) << some.size();
}

// Numbers and categories, present, missing, refused and in two layouts.
TEST(ScoringAllocation, NoneAfterTheFirstCase) {
  const std::string terms =
      "<NumericPredictor name='x' coefficient='1'/><NumericPredictor name='n' exponent='2' "
      "coefficient='0.5'/>"
      "<CategoricalPredictor name='g' value='a' coefficient='1'/><CategoricalPredictor name='t' value='a "
      "text that is "
      "too long to be kept in place' coefficient='1'/><CategoricalPredictor name='n' value='2' "
      "coefficient='1'/>"
      "<PredictorTerm coefficient='2'><FieldRef field='x'/><FieldRef field='z' "
      "mapMissingTo='1'/></PredictorTerm>";
  const auto table = [&terms](const std::string& category) {
    return "<RegressionTable targetCategory='" + category + "'>" + terms + "</RegressionTable>";
  };
  const std::string documents[] = {
      DocumentOf(ModelOf("functionName='regression'", "y", table(""))),
      DocumentOf(ModelOf("functionName='classification' normalizationMethod='softmax'", "m",
                         table("red") + table("green") + table("blue"))),
      DocumentOf(ModelOf("functionName='classification' normalizationMethod='probit'", "o",
                         table("low") + table("mid"))),
      DocumentOf(ModelOf("functionName='classification' normalizationMethod='cloglog'", "m",
                         table("red") + table("green") + table("blue"))),
      DocumentOf(ModelOf("functionName='classification' normalizationMethod='exp'", "m",
                         table("red") + table("green") + table("blue"))),
  };
  const double missing = NumericValue::gSysmisValue;
  const std::string text = "a text that is too long to be kept in place";
  for (const std::string& document : documents) {
    const std::unique_ptr<ScoreModel> model = BuildModel(document);
    const std::unique_ptr<ScoreResult> result(model->MakeResult());
    const CaseRecord records[] = {
        RecordOf({{"x", 1.0}, {"z", 2.0}, {"n", 3.0}, {"g", "a"}, {"t", text}}),
        RecordOf({{"t", text}, {"x", 1.0}, {"z", missing}, {"n", 2.0}, {"g", "c  "}}),
        RecordOf({{"x", missing}, {"z", 2.0}, {"n", {}}, {"g", {}}, {"t", "other"}}),
        RecordOf({{"x", 1.0}, {"z", 2.0}, {"n", 3.0}, {"g", text}, {"t", text}}),
    };
    ASSERT_TRUE(model->Score(&records[0], result.get()).IsOK());
    const size_t before = CountAllocations();
    int scored = 0;
    for (int i = 0; i < 100; ++i) {
      for (const CaseRecord& record : records)
        scored += model->Score(&record, result.get()).IsOK() ? 1 : 0;
    }
    EXPECT_EQ(CountAllocations(), before);
    EXPECT_EQ(scored, 200);
  }
}

}  // namespace
