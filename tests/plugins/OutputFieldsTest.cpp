// The output fields of a document, filled by the models of all kinds.

#include "plugins/support/OutputFields.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/model/Results.h"
#include "kestrel/translate/ResultVar.h"
#include "tests/plugins/OutputText.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

struct FeatureRow {
  const char* why;
  Kind kind;
  std::string attributes;
  Cells cells;
  const char* want;
};

const FeatureRow kFeatureRows[] = {
    {"a number is predicted", Kind::kRegression, "feature='predictedValue'", kHigh, "number 5"},
    {"a field without feature tells the prediction", Kind::kRegression, "", kHigh, "number 5"},
    {"a predicted text makes a field without data type a text", Kind::kTree, "feature='predictedValue'",
     kHigh, "text yes"},
    {"a text field tells a number in its shortest form",
     Kind::kRegression,
     "feature='predictedValue' dataType='string'",
     {{"x", 0.05}},
     "text 1.1"},
    {"a number field has no place for a text", Kind::kTree, "feature='predictedValue' dataType='double'",
     kHigh, "missing number"},
    {"no prediction leaves a number missing", Kind::kRegression, "feature='predictedValue'", kNone,
     "missing number"},
    {"no prediction leaves a text missing", Kind::kTree, "feature='predictedValue'", kNone, "missing text"},
    {"a category without label is displayed as itself", Kind::kTree, "feature='predictedDisplayValue'", kHigh,
     "text yes"},
    {"a number is displayed as itself", Kind::kRegression, "feature='predictedDisplayValue'", kHigh,
     "text 5"},
    {"the probability of the prediction", Kind::kTree, "feature='probability'", kHigh, "number 0.7"},
    {"the probability of a category", Kind::kTree, "feature='probability' value='yes'", kHigh, "number 0.75"},
    {"the probability of a category that is not predicted", Kind::kTree, "feature='probability' value='no'",
     kHigh, "number 0.25"},
    {"a category that the node does not have", Kind::kTree, "feature='probability' value='yes'", kLow,
     "number 0"},
    {"no prediction has no probability", Kind::kTree, "feature='probability'", kNone, "missing number"},
    {"nor have its categories", Kind::kTree, "feature='probability' value='yes'", kNone, "missing number"},
    {"a probability as a text", Kind::kTree, "feature='probability' dataType='string'", kHigh, "text 0.7"},
    {"a regression has no probability", Kind::kRegression, "feature='probability'", kHigh, "missing number"},
    {"a rule without distribution gives the predicted category its confidence", Kind::kRules,
     "feature='probability' value='yes'", kHigh, "number 0.9"},
    {"and nothing to the others", Kind::kRules, "feature='probability' value='no'", kHigh, "number 0"},
    {"a regression's residual",
     Kind::kRegression,
     "feature='residual'",
     {{"x", 2.0}, {"y", 4.5}},
     "number -0.5"},
    {"no true value",
     Kind::kRegression,
     "feature='residual'",
     {{"x", 2.0}, {"y", kSysmis}},
     "missing number"},
    {"no field of the target", Kind::kRegression, "feature='residual'", kHigh, "missing number"},
    {"a true value of another kind",
     Kind::kRegression,
     "feature='residual'",
     {{"x", 2.0}, {"y", "4.5"}},
     "missing number"},
    {"no prediction to compare",
     Kind::kRegression,
     "feature='residual'",
     {{"x", kSysmis}, {"y", 4.5}},
     "missing number"},
    {"a classification's residual of the true category",
     Kind::kTree,
     "feature='residual' value='yes'",
     {{"x", 2.0}, {"k", "yes"}},
     "number 0.25"},
    {"of another category",
     Kind::kTree,
     "feature='residual' value='no'",
     {{"x", 2.0}, {"k", "yes"}},
     "number -0.25"},
    {"of the predicted category",
     Kind::kLogistic,
     "feature='residual'",
     {{"x", 0.0}, {"k", "no"}},
     "number -0.5"},
    {"a true value that is no category",
     Kind::kTree,
     "feature='residual' value='yes'",
     {{"x", 2.0}, {"k", "maybe"}},
     "missing number"},
    {"an empty true value",
     Kind::kTree,
     "feature='residual' value='yes'",
     {{"x", 2.0}, {"k", ""}},
     "missing number"},
    {"no model here knows its standard error", Kind::kRegression, "feature='standardError'", kHigh,
     "missing number"},
    {"nor has a classification one", Kind::kTree, "feature='standardError'", kHigh, "missing number"},
    {"nor a standard deviation", Kind::kRegression, "feature='standardDeviation'", kHigh, "missing number"},
    {"a node's identifier", Kind::kTree, "feature='entityId'", kHigh, "text high"},
    {"a node without one is told by its number", Kind::kTree, "feature='entityId'", kLow, "text #3"},
    {"as a number when the field is one", Kind::kTree, "feature='entityId' dataType='integer'", kLow,
     "number 3"},
    {"an identifier that is no number", Kind::kTree, "feature='entityId' dataType='integer'", kHigh,
     "missing number"},
    {"a rule's identifier", Kind::kRules, "feature='entityId'", kHigh, "text r1"},
    {"the older name of the same", Kind::kRules, "feature='clusterId'", kHigh, "text r1"},
    {"no rule decides", Kind::kRules, "feature='entityId'", kLow, "missing text"},
    {"an equation has no identifier", Kind::kRegression, "feature='entityId'", kHigh, "missing text"},
    {"a node's confidence", Kind::kTree, "feature='entityAffinity'", kHigh, "number 0.7"},
    {"a rule's confidence", Kind::kRules, "feature='clusterAffinity'", kHigh, "number 0.9"},
    {"the newer name", Kind::kRules, "feature='affinity'", kHigh, "number 0.9"},
    {"no rule has no confidence", Kind::kRules, "feature='entityAffinity'", kLow, "missing number"},
    {"an equation has none", Kind::kLogistic, "feature='entityAffinity'", kHigh, "missing number"},
    {"what the rule predicts", Kind::kRules, "feature='ruleValue'", kHigh, "text yes"},
    {"by its name", Kind::kRules, "feature='ruleValue' ruleFeature='consequent'", kHigh, "text yes"},
    {"the rule's identifier", Kind::kRules, "feature='ruleValue' ruleFeature='ruleId'", kHigh, "text r1"},
    {"the rule itself", Kind::kRules, "feature='ruleValue' ruleFeature='rule'", kHigh, "text r1"},
    {"the rule's confidence", Kind::kRules, "feature='ruleValue' ruleFeature='confidence'", kHigh,
     "number 0.9"},
    {"the newer way to ask for the identifier", Kind::kRules, "feature='ruleId'", kHigh, "text r1"},
    {"for what it predicts", Kind::kRules, "feature='consequent'", kHigh, "text yes"},
    {"for its confidence", Kind::kRules, "feature='confidence'", kHigh, "number 0.9"},
    {"for what there is not", Kind::kRules, "feature='antecedent'", kHigh, "missing number"},
    {"what these rules do not have", Kind::kRules, "feature='ruleValue' ruleFeature='lift'", kHigh,
     "missing number"},
    {"no rule fires", Kind::kRules, "feature='ruleValue'", kLow, "missing text"},
    {"a node is no rule", Kind::kTree, "feature='ruleValue'", kHigh, "missing text"},
    {"nothing to warn of", Kind::kTree, "feature='warning'", kHigh, "missing text"},
    {"no data", Kind::kTree, "feature='warning'", kNone, "text data are missing, nothing is predicted"},
    {"its status code", Kind::kTree, "feature='warning' dataType='integer'", kNone, "number 90027"},
    {"no warning has no code", Kind::kTree, "feature='warning' dataType='integer'", kHigh, "missing number"},
    {"an invalid value", Kind::kTree, "feature='warning'", {{"x", "high"}}, "text invalid value of x"},
    {"the code of an invalid value",
     Kind::kTree,
     "feature='warning' dataType='double'",
     {{"x", "high"}},
     "number 90025"},
    {"nothing else is told of an invalid value",
     Kind::kTree,
     "feature='entityId'",
     {{"x", "high"}},
     "missing text"},
};

TEST(OutputFields, TellWhatTheirFeatureSays) {
  for (const FeatureRow& row : kFeatureRows) {
    SCOPED_TRACE(row.why);
    const auto model = Build(row.kind, Output(Field("name='f' " + row.attributes)));
    const std::unique_ptr<ScoreResult> result(model->MakeResult());
    const CaseRecord record = RecordOf(row.cells);
    model->Score(&record, result.get());
    EXPECT_EQ(Show(OutputFieldsOf(result.get())->GetResultValue("f")), row.want);
    const auto* variable = dynamic_cast<const ResultVar*>(model->GetResultDictionary()->GetVar("f"));
    ASSERT_NE(variable, nullptr);
    EXPECT_EQ(variable->IsString(), std::string(row.want).find("text") != std::string::npos);
  }
}

TEST(OutputFields, OfTheOlderElementAreTheSame) {
  const auto model = Build(Kind::kTree, Output("<Extension/><ResultField name='a' feature='entityId'/>"
                                               "<ResultField name='b' feature='categorical'/>" +
                                               Field("name='c' feature='probability' value='no'")));
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  const CaseRecord record = RecordOf(kHigh);
  ASSERT_TRUE(model->Score(&record, result.get()).IsOK());
  const ResultField& outputs = *OutputFieldsOf(result.get());
  EXPECT_EQ(Show(outputs.GetResultValue("a")), "text high");
  EXPECT_EQ(Show(outputs.GetResultValue("b")), "text yes");
  EXPECT_EQ(Show(outputs.GetResultValue("c")), "number 0.25");
  EXPECT_EQ(model->GetResultDictionary()->GetVarNames(), (std::vector<std::string>{"a", "b", "c"}));
}

TEST(OutputFields, StartCleanWithEachCase) {
  const std::string fields = Field("name='v'") + Field("name='p' feature='probability' value='yes'") +
                             Field("name='id' feature='entityId'") + Field("name='w' feature='warning'");
  const auto model = Build(Kind::kTree, Output(fields));
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  const ResultField& outputs = *OutputFieldsOf(result.get());
  const auto score = [&](const Cells& cells) {
    const CaseRecord record = RecordOf(cells);
    model->Score(&record, result.get());
    std::string all;
    for (const char* name : {"v", "p", "id", "w"})
      all += Show(outputs.GetResultValue(name)) + "; ";
    return all;
  };
  const std::string high = "text yes; number 0.75; text high; missing text; ";
  const std::string none =
      "missing text; missing number; missing text; text data are missing, nothing is predicted; ";
  const std::string invalid = "missing text; missing number; missing text; text invalid value of x; ";
  EXPECT_EQ(score(kHigh), high);
  EXPECT_EQ(score(kNone), none);
  EXPECT_EQ(score(kHigh), high);
  EXPECT_EQ(score({{"x", "high"}}), invalid);
  EXPECT_EQ(score(kHigh), high);
  result->Reset();
  EXPECT_EQ(Show(outputs.GetResultValue("v")), "missing text");
  EXPECT_EQ(Show(outputs.GetResultValue("p")), "missing number");
}

TEST(OutputFields, FindTheTrueValueInRecordsOfOtherLayouts) {
  const auto model = Build(Kind::kRegression, Output(Field("name='r' feature='residual'")));
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  const ResultField& outputs = *OutputFieldsOf(result.get());
  const Cells layouts[] = {{{"x", 2.0}, {"y", 6.0}}, {{"y", 6.0}, {"x", 2.0}}, {{"x", 2.0}, {"y", 6.0}}};
  for (const Cells& cells : layouts) {
    const CaseRecord record = RecordOf(cells);
    ASSERT_TRUE(model->Score(&record, result.get()).IsOK());
    EXPECT_EQ(Show(outputs.GetResultValue("r")), "number 1");
  }
  const CaseRecord without = RecordOf(kHigh);
  ASSERT_TRUE(model->Score(&without, result.get()).IsOK());
  EXPECT_EQ(Show(outputs.GetResultValue("r")), "missing number");
}

TEST(OutputFields, AreTheModelsThatScoredLast) {
  const auto first = Build(Kind::kTree, Output(Field("name='a'") + Field("name='b' feature='probability'")));
  const auto second = Build(Kind::kRules, Output(Field("name='b' feature='entityId'")));
  const auto plain = Build(Kind::kTree, "");
  const std::unique_ptr<ScoreResult> result(first->MakeResult());
  const ResultField& outputs = *OutputFieldsOf(result.get());
  const CaseRecord record = RecordOf(kHigh);
  for (int round = 0; round < 2; ++round) {
    ASSERT_TRUE(first->Score(&record, result.get()).IsOK());
    EXPECT_EQ(outputs.GetResultFields(), (std::vector<std::string>{"a", "b"}));
    EXPECT_EQ(Show(outputs.GetResultValue("b")), "number 0.7");
    ASSERT_TRUE(second->Score(&record, result.get()).IsOK());
    EXPECT_EQ(outputs.GetResultFields(), (std::vector<std::string>{"b"}));
    EXPECT_EQ(Show(outputs.GetResultValue("b")), "text r1");
  }
  // A model without output fields leaves those that are there without values.
  ASSERT_TRUE(plain->Score(&record, result.get()).IsOK());
  EXPECT_EQ(Show(outputs.GetResultValue("b")), "missing text");
}

TEST(OutputFields, AreAbsentWithoutAnOutputElement) {
  for (const std::string& output : {std::string(), Output(""), Output("<Extension/>")}) {
    const auto model = Build(Kind::kTree, output);
    EXPECT_EQ(model->GetResultDictionary(), nullptr);
    const std::unique_ptr<ScoreResult> result(model->MakeResult());
    const CaseRecord record = RecordOf(kHigh);
    ASSERT_TRUE(model->Score(&record, result.get()).IsOK());
    EXPECT_EQ(OutputFieldsOf(result.get())->GetResultSize(), 0u);
  }
}

struct FaultRow {
  std::string field;
  int code;
  const char* message;
};

const FaultRow kFaultRows[] = {
    {Field("name='f' targetField='y'"), KestrelException::kUnsupported,
     "f: targetField -- y: Not supported!"},
    {Field("name='f' rank='2'"), KestrelException::kUnsupported, "f: rank -- 2: Not supported!"},
    {Field("name='f' feature='probability' value='maybe'"), KestrelException::kInvalidValue,
     "f: invalid value!"},
    {Field("name='f' feature='residual' value='maybe'"), KestrelException::kInvalidValue,
     "f: invalid value!"},
    {Field("name='f' feature='ruleValue' ruleFeature='colour'"), KestrelException::kInvalidDocument,
     "invalid ruleFeature -- colour"},
    {Field("name='f' feature='nothing'"), KestrelException::kInvalidType, "f: Invalid feature Type"},
    {Field("name='f'") + Field("name='f'"), KestrelException::kUnknownVariable,
     "f: Invalid Variable Name -- alreay in the dictionary"},
};

TEST(OutputFields, ThatCannotBeToldAreRefused) {
  for (const FaultRow& row : kFaultRows) {
    ExpectFault([&] { Build(Kind::kTree, Output(row.field)); }, row.code, row.message, row.field);
  }
}

TEST(OutputFields, MayNameTheirOwnTargetAndTheFirstRank) {
  EXPECT_NE(Build(Kind::kTree, Output(Field("name='f' targetField='k' rank='1'"))), nullptr);
}

}  // namespace
}  // namespace kestrel_tests
