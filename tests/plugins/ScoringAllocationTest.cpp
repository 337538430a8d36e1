// Shows that scoring allocates nothing after the first case. A program of its own, because it counts every
// allocation of the process.

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "kestrel/model/Results.h"
#include "tests/plugins/DerivedModelText.h"
#include "tests/plugins/OutputText.h"
#include "tests/support/AllocationCount.h"

namespace {

using namespace MCKestrel_800;
using namespace kestrel_tests;

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

// Derived numbers and categories, present, missing and refused, through fields that the schema treats.
TEST(ScoringAllocation, NoneForDerivedFields) {
  const DerivedDocument document{
      Derived("d", "continuous double", Apply("*", FieldRef("x") + Constant("2"))) +
          Derived("bin", "categorical string", Bins("d", "3", "5")),
      Derived("e", "continuous double", NormDiscrete("g", "b")) +
          Derived("f", "continuous double", NormContinuous("d", LinearNorm("0", "0") + LinearNorm("9", "1"))),
      "<MiningField name='x' missingValueReplacement='2'/><MiningField name='z' outliers='asExtremeValues' "
      "highValue='9'/><MiningField name='g' invalidValueTreatment='asMissing'/><MiningField name='n'/>"
      "<MiningField name='d' outliers='asExtremeValues' highValue='8'/>"};
  const std::string both = "<CompoundPredicate booleanOperator='surrogate'>" +
                           Compare("f", "greaterThan", "0.5") + Compare("bin", "equal", "mid") +
                           "</CompoundPredicate>";
  const std::string documents[] = {
      document.Regression(Number("d") + Number("f") + Category("bin", "mid") + Number("e") + Number("z")),
      document.Tree(both),
      document.Rules(both),
  };
  const std::string text = "a text that is too long to be kept in place";
  for (const std::string& wanted : documents) {
    const std::unique_ptr<ScoreModel> model = BuildAny(wanted);
    const std::unique_ptr<ScoreResult> result(model->MakeResult());
    const CaseRecord records[] = {
        RecordOf({{"x", 1.0}, {"z", 2.0}, {"n", 3.0}, {"g", "a"}}),
        RecordOf({{"t", text}, {"x", 20.0}, {"z", 70.0}, {"n", 2.0}, {"g", "b  "}}),
        RecordOf({{"x", {}}, {"z", NumericValue::gSysmisValue}, {"n", {}}, {"g", {}}}),
        RecordOf({{"x", text}, {"z", 2.0}, {"n", 3.0}, {"g", text}}),
    };
    for (const CaseRecord& record : records)
      model->Score(&record, result.get());
    const size_t before = CountAllocations();
    int scored = 0;
    for (int i = 0; i < 100; ++i) {
      for (const CaseRecord& record : records)
        scored += model->Score(&record, result.get()).IsOK() ? 1 : 0;
    }
    EXPECT_EQ(CountAllocations(), before);
    EXPECT_GE(scored, 200);
    EXPECT_LE(scored, 300);
  }
}

// All features, of cases that are scored, missing and refused, with records of two layouts.
TEST(ScoringAllocation, NoneForOutputFields) {
  const std::string text = "a text that is too long to be kept in place";
  std::string fields = Field("name='yes' feature='probability' value='yes'") +
                       Field("name='text of a number' dataType='string' feature='entityAffinity'");
  for (const char* feature :
       {"predictedValue", "predictedDisplayValue", "probability", "residual", "standardError", "clusterId",
        "clusterAffinity", "entityId", "entityAffinity", "warning", "ruleValue", "standardDeviation"}) {
    fields += Field(std::string("name='") + feature + "' feature='" + feature + "'");
  }
  const std::string targets = "<Targets><Target field='k'><TargetValue value='yes' displayValue='" + text +
                              "' priorProbability='0.5'/><TargetValue value='no'/></Target></Targets>";
  for (const Kind kind : {Kind::kLogistic, Kind::kTree, Kind::kRules}) {
    const auto model = Build(kind, Output(fields), targets);
    const std::unique_ptr<ScoreResult> result(model->MakeResult());
    const CaseRecord records[] = {RecordOf({{"x", 2.0}, {"k", "yes"}}), RecordOf({{"k", "no"}, {"x", 0.5}}),
                                  RecordOf({{"x", NumericValue::gSysmisValue}, {"k", "yes"}}),
                                  RecordOf({{"x", text}, {"k", "no"}})};
    for (const CaseRecord& record : records)
      model->Score(&record, result.get());
    const size_t before = CountAllocations();
    for (int i = 0; i < 100; ++i) {
      for (const CaseRecord& record : records)
        model->Score(&record, result.get());
    }
    EXPECT_EQ(CountAllocations(), before) << model->GetModelKind();
  }
}

}  // namespace
