// Shows that scoring by rules allocates nothing after the first case; linked with the counting operators.

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "tests/plugins/RuleSetText.h"
#include "tests/support/AllocationCount.h"

namespace {

using namespace MCKestrel_800;
using namespace kestrel_tests;

// Rules of every kind, that fire or not, with long names, with and without the path.
TEST(RuleSetAllocation, NoneAfterTheFirstCase) {
  const std::string long_id = "an identifier that is too long to be kept in place ";
  const auto rules = [&long_id](const std::string& first, const std::string& second) {
    return "<SimpleRule id='" + long_id + "1' score='" + first + "'>" + kXAbove1 + "</SimpleRule>" +
           "<CompoundRule><CompoundPredicate booleanOperator='surrogate'>" + kXAbove1 + kGIsA +
           "</CompoundPredicate>" + Rule("score='" + first + "' weight='2'") + "<SimpleRule id='" + long_id +
           "2' score='" + second +
           "'><SimpleSetPredicate field='n' booleanOperator='isNotIn'><Array type='int'>1 2</Array>"
           "</SimpleSetPredicate></SimpleRule></CompoundRule>";
  };
  const double missing = NumericValue::gSysmisValue;
  const CaseRecord records[] = {
      RecordOf({{"x", 2.0}, {"n", 3.0}, {"g", "a"}}),
      RecordOf({{"g", "a"}, {"x", missing}, {"n", {}}}),
      RecordOf({{"x", 0.0}, {"n", 1.0}, {"g", {}}}),
      RecordOf({{"x", 2.0}, {"n", 3.0}, {"g", "a category that there is not, in many letters"}}),
  };
  for (const char* criterion : {"firstHit", "weightedMax", "weightedSum"}) {
    const std::string attributes = "defaultScore='blue' defaultConfidence='0.5'";
    const std::unique_ptr<ScoreModel> models[] = {
        BuildRuleSet(
            RuleSetDocument(criterion, "m", attributes,
                            "<ScoreDistribution value='red' recordCount='3'/>" + rules("red", "green"))),
        BuildRuleSet(RuleSetDocument(criterion, "t", "", rules(long_id + "yes", long_id + "no"))),
        BuildRegression(criterion, "", rules("1", "2")),
    };
    for (const std::unique_ptr<ScoreModel>& model : models) {
      const std::unique_ptr<ScoreResult> result(model->MakeResult());
      for (const bool wants_path : {false, true}) {
        ResultEntities::Of(result.get())->SetPathWanted(wants_path);
        // Whatever the first case is, the result has no room yet for those with more categories.
        for (const CaseRecord& record : records)
          model->Score(&record, result.get());
        const size_t before = CountAllocations();
        int scored = 0;
        for (int i = 0; i < 100; ++i) {
          for (const CaseRecord& record : records)
            scored += model->Score(&record, result.get()).IsOK() ? 1 : 0;
        }
        EXPECT_EQ(CountAllocations(), before) << criterion;
        EXPECT_EQ(scored, model == models[0] ? 300 : 200) << criterion;
      }
    }
  }
}

}  // namespace
