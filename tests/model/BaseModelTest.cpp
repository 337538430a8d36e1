// Tests of what all models have in common.

#include "kestrel/model/BaseModel.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/ValueProbability.h"
#include "kestrel/dictionary/ValueProbabilitySet.h"
#include "kestrel/model/Results.h"
#include "kestrel/model/VersionInfo.h"
#include "kestrel/transform/TransformationDictionary.h"

namespace {

using namespace MCKestrel_800;
using MCScore::MCStatus;

/// The common part alone.
class PlainModel : public BaseModel {
 public:
  MCStatus Score(const ScoreCaseRecord*, ScoreResult* result) override { return HandleMissingValue(result); }
  std::vector<const ScoreDictVar*> GetPredictors() const override { return {}; }
  ScoreResult* MakeResult() const override { return new ClsResult; }
  std::string GetModelKind() const override { return "PlainModel"; }
  bool SuppressCategoryProbabilities() const override { return suppress; }
  void Display(std::ostream&) const override {}

  using BaseModel::GetTargetName;
  using BaseModel::GetVarRoles;
  using BaseModel::HandleMissingValue;

  bool suppress = false;
};

/// A classification result that says to be of any kind.
class ResultOfKind : public ClsResult {
 public:
  explicit ResultOfKind(int kind) : kind_(kind) {}
  int GetResultKind() const override { return kind_; }

 private:
  int kind_;
};

using Prior = std::pair<std::string, double>;

/// A model with a target "t" and a predictor "x"; the target is categorical when a distribution is given.
class BaseModelTest : public testing::Test {
 protected:
  BaseModelTest() {
    auto* dictionary = new BaseDictionary;
    model_.SetScoreDictionary(dictionary);
    dictionary->AddVar("x", new DictVar("x", ScoreDictVar::kNUMERIC_VAR));
    target_ = new DictVar("t", ScoreDictVar::STRING_VAR);
    dictionary->AddVar("t", target_);
    auto* transformations = new TransformationDictionary;
    model_.SetTransformationScoreDictionary(transformations);
    transformations->AddVar("derived", new DictVar("derived", ScoreDictVar::kNUMERIC_VAR));
  }

  void UseDistribution(const std::vector<Prior>& priors) {
    target_->SetMLevel(ScoreDictVar::kNominal);
    auto* set = new ValueProbabilitySet;
    for (const Prior& prior : priors)
      set->Add(new ValueProbability(new StringValue(prior.first), prior.second));
    target_->SetValueProbabilities(set);
    model_.SetVarRole("t", ScoreModel::kTarget);
  }

  void ExpectNoPredictionStatus(const MCStatus& status) {
    EXPECT_EQ(status.GetErrorCode(), 90027);
    EXPECT_TRUE(status.IsError());
    EXPECT_TRUE(status == MCStatus(90027, false)) << "the data slots are zero";
  }

  PlainModel model_;
  DictVar* target_ = nullptr;
};

TEST(BaseModel, StartsEmpty) {
  const PlainModel model;
  EXPECT_EQ(model.GetDictionary(), nullptr);
  EXPECT_EQ(model.GetTransformationDictionary(), nullptr);
  EXPECT_EQ(model.GetResultDictionary(), nullptr);
  EXPECT_EQ(model.GetVersionInfo(), nullptr);
  EXPECT_EQ(model.GetTargetVar(), nullptr);
  EXPECT_EQ(model.GetTargetName(), "");
  EXPECT_EQ(model.GetMissingValuePolicy(), ScoreModel::kDefaultPrediction);
  EXPECT_EQ(model.GetMissingValuePolicy(), 1);
  EXPECT_EQ(model.GetVarRole("x"), -1);
  EXPECT_TRUE(model.GetVarRoles().empty());
}

TEST(BaseModel, HasRolesAndPoliciesOfTheStatedNumbers) {
  const int roles[] = {ScoreModel::kUnused,         ScoreModel::kTarget, ScoreModel::kPredictor,
                       ScoreModel::kSupplementary,  ScoreModel::kOrder,  ScoreModel::kFrequencyWeight,
                       ScoreModel::kAnalysisWeight, ScoreModel::kGroup};
  for (int i = 0; i < 8; ++i)
    EXPECT_EQ(roles[i], i);
  EXPECT_EQ(ScoreModel::kNullPrediction, 0);
  EXPECT_EQ(ScoreModel::kDefaultPrediction, 1);
}

TEST(BaseModel, KnowsNoVariableWithoutDictionaries) {
  PlainModel model;
  EXPECT_FALSE(model.SetVarRole("x", ScoreModel::kPredictor));
  EXPECT_FALSE(model.SetVarRole("x", ScoreModel::kTarget));
  EXPECT_EQ(model.GetTargetName(), "");
}

TEST(BaseModel, HoldsWhatItIsGiven) {
  PlainModel model;
  auto* dictionary = new BaseDictionary;
  auto* transformations = new TransformationDictionary;
  auto* results = new BaseDictionary;
  auto* version = new VersionInfo("4.4");
  model.SetScoreDictionary(dictionary);
  model.SetTransformationScoreDictionary(transformations);
  model.SetResultScoreDictionary(results);
  model.SetVersionInfo(version);
  model.SetMissingValuePolicy(ScoreModel::kNullPrediction);
  EXPECT_EQ(model.GetDictionary(), dictionary);
  EXPECT_EQ(model.GetTransformationDictionary(), transformations);
  EXPECT_EQ(model.GetResultDictionary(), results);
  EXPECT_EQ(model.GetVersionInfo(), version);
  EXPECT_EQ(model.GetMissingValuePolicy(), ScoreModel::kNullPrediction);
}

TEST(BaseModel, LeavesTheObjectThatASetterReplacesToTheCaller) {
  BaseDictionary first;
  TransformationDictionary first_transformations;
  BaseDictionary first_results;
  VersionInfo first_version;
  PlainModel model;
  model.SetScoreDictionary(&first);
  model.SetTransformationScoreDictionary(&first_transformations);
  model.SetResultScoreDictionary(&first_results);
  model.SetVersionInfo(&first_version);
  model.SetScoreDictionary(new BaseDictionary);
  model.SetTransformationScoreDictionary(new TransformationDictionary);
  model.SetResultScoreDictionary(nullptr);
  model.SetVersionInfo(new VersionInfo);
  EXPECT_EQ(first.Size(), 0u);
  EXPECT_EQ(first_version.GetVersionInfo(), "2.1");
}

/// Notes in a list that it is being destroyed.
template <typename Base>
class Noted : public Base {
 public:
  Noted(std::vector<std::string>& log, const char* name) : log_(log), name_(name) {}
  ~Noted() override { log_.push_back(name_); }

 private:
  std::vector<std::string>& log_;
  const char* name_;
};

TEST(BaseModel, DestroysWhatItOwnsInAFixedOrder) {
  std::vector<std::string> log;
  {
    PlainModel model;
    model.SetResultScoreDictionary(new Noted<BaseDictionary>(log, "results"));
    model.SetTransformationScoreDictionary(new Noted<TransformationDictionary>(log, "transformations"));
    model.SetScoreDictionary(new Noted<BaseDictionary>(log, "dictionary"));
    model.SetVersionInfo(new Noted<VersionInfo>(log, "version"));
  }
  EXPECT_EQ(log, (std::vector<std::string>{"version", "dictionary", "transformations", "results"}));
}

TEST_F(BaseModelTest, GivesRolesToKnownVariables) {
  EXPECT_TRUE(model_.SetVarRole("x", ScoreModel::kPredictor));
  EXPECT_TRUE(model_.SetVarRole("derived", ScoreModel::kPredictor)) << "a derived field";
  EXPECT_TRUE(model_.SetVarRole(target_, ScoreModel::kTarget));
  EXPECT_EQ(model_.GetVarRole("x"), ScoreModel::kPredictor);
  EXPECT_EQ(model_.GetVarRole("derived"), ScoreModel::kPredictor);
  EXPECT_EQ(model_.GetVarRole(target_), ScoreModel::kTarget);
  EXPECT_EQ(model_.GetTargetVar(), target_);
  EXPECT_TRUE(model_.SetVarRole("x", ScoreModel::kSupplementary)) << "a second role";
  EXPECT_EQ(model_.GetVarRole("x"), ScoreModel::kSupplementary) << "takes the place of the first";
  EXPECT_EQ(model_.GetVarRoles().size(), 3u);
}

TEST_F(BaseModelTest, RefusesUnknownVariables) {
  const DictVar stranger("stranger", ScoreDictVar::kNUMERIC_VAR);
  const ScoreDictVar* none = nullptr;
  model_.SetVarRole("t", ScoreModel::kTarget);
  EXPECT_FALSE(model_.SetVarRole("", ScoreModel::kTarget));
  EXPECT_FALSE(model_.SetVarRole("X", ScoreModel::kTarget)) << "case counts";
  EXPECT_FALSE(model_.SetVarRole("stranger", ScoreModel::kTarget));
  EXPECT_FALSE(model_.SetVarRole(&stranger, ScoreModel::kTarget));
  EXPECT_FALSE(model_.SetVarRole(none, ScoreModel::kTarget));
  EXPECT_EQ(model_.GetVarRoles().size(), 1u);
  EXPECT_EQ(model_.GetTargetName(), "t");
}

TEST_F(BaseModelTest, HasNoRoleForOtherVariables) {
  const ScoreDictVar* none = nullptr;
  EXPECT_EQ(model_.GetVarRole(""), -1);
  EXPECT_EQ(model_.GetVarRole("x"), -1);
  EXPECT_EQ(model_.GetVarRole("stranger"), -1);
  EXPECT_EQ(model_.GetVarRole(none), -1);
}

TEST_F(BaseModelTest, TakesTheLastTarget) {
  model_.SetVarRole("t", ScoreModel::kTarget);
  model_.SetVarRole("x", ScoreModel::kTarget);
  EXPECT_EQ(model_.GetTargetVar()->GetName(), "x");
  EXPECT_EQ(model_.GetVarRole("t"), ScoreModel::kTarget);
  model_.SetVarRole("x", ScoreModel::kPredictor);
  EXPECT_EQ(model_.GetTargetVar()->GetName(), "x") << "another role does not take the target away";
}

TEST_F(BaseModelTest, LooksForTheTargetInTheDataDictionaryAlone) {
  EXPECT_TRUE(model_.SetVarRole("derived", ScoreModel::kTarget));
  EXPECT_EQ(model_.GetTargetName(), "derived");
  EXPECT_EQ(model_.GetTargetVar(), nullptr);
}

TEST_F(BaseModelTest, PredictsTheMostProbableCategory) {
  struct Row {
    std::vector<Prior> priors;
    const char* prediction;
    double probability;
    const char* why;
  };
  const Row rows[] = {
      {{{"a", 0.2}, {"b", 0.5}, {"c", 0.3}}, "b", 0.5, "the highest"},
      {{{"a", 0.4}, {"b", 0.4}, {"c", 0.2}}, "a", 0.4, "the first of equal ones"},
      {{{"z", 0.4}, {"b", 0.4}}, "z", 0.4, "by stored order, not by name"},
      {{{"a", 0.0}, {"b", 0.0}, {"c", 1e-300}}, "c", 1e-300, "however small"},
      {{{"a", 1.0}}, "a", 1.0, "the only one"},
  };
  for (const Row& row : rows) {
    PlainModel model;
    auto* dictionary = new BaseDictionary;
    model.SetScoreDictionary(dictionary);
    auto* target = new DictVar("t", ScoreDictVar::STRING_VAR);
    dictionary->AddVar("t", target);
    target->SetMLevel(ScoreDictVar::kOrdinal);
    auto* set = new ValueProbabilitySet;
    for (const Prior& prior : row.priors)
      set->Add(new ValueProbability(new StringValue(prior.first), prior.second));
    target->SetValueProbabilities(set);
    model.SetVarRole("t", ScoreModel::kTarget);
    ClsResult result;
    EXPECT_TRUE(model.HandleMissingValue(&result).IsOK()) << row.why;
    ASSERT_NE(result.GetPrediction(), nullptr) << row.why;
    EXPECT_EQ(result.GetPrediction()->GetString(), row.prediction) << row.why;
    EXPECT_EQ(result.GetProbability(), row.probability) << row.why;
    ASSERT_EQ(result.GetCategoryCount(), row.priors.size()) << row.why;
    for (size_t i = 0; i < row.priors.size(); ++i) {
      EXPECT_EQ(result.GetCategory(i)->GetString(), row.priors[i].first) << row.why;
      EXPECT_EQ(result.GetProbability(i), row.priors[i].second) << row.why;
    }
  }
}

TEST_F(BaseModelTest, LeavesThePredictionWhenNoCategoryIsPossible) {
  for (const std::vector<Prior>& priors :
       {std::vector<Prior>{}, std::vector<Prior>{{"a", 0.0}, {"b", 0.0}}}) {
    delete target_->GetValueProbabilities();
    UseDistribution(priors);
    ClsResult result;
    const StringValue before("before");
    result.SetPrediction(&before);
    result.SetProbability(0.25);
    EXPECT_TRUE(model_.HandleMissingValue(&result) == MCStatus());
    ASSERT_NE(result.GetPrediction(), nullptr);
    EXPECT_EQ(result.GetPrediction()->GetString(), "before");
    EXPECT_EQ(result.GetProbability(), 0.25);
    EXPECT_EQ(result.GetCategoryCount(), priors.size()) << "the probabilities are recorded all the same";
  }
}

TEST_F(BaseModelTest, ClearsThePredictionWhenTheDistributionIsMissing) {
  for (const ScoreDictVar::MeasureLevel level : {ScoreDictVar::kOrdinal, ScoreDictVar::kNominal}) {
    target_->SetMLevel(level);
    model_.SetVarRole("t", ScoreModel::kTarget);
    ClsResult result;
    const StringValue before("before");
    result.SetPrediction(&before);
    ExpectNoPredictionStatus(model_.HandleMissingValue(&result));
    EXPECT_EQ(result.GetPrediction(), nullptr);
  }
}

TEST_F(BaseModelTest, RecordsProbabilitiesInResultsOfSomeKinds) {
  UseDistribution({{"a", 0.25}, {"b", 0.75}});
  const int recording[] = {0, 2, 3, 4, 6, 10, 15, 18, 20, 21, 24, 26};
  for (int kind = -2; kind <= 40; ++kind) {
    bool expected = false;
    for (const int one : recording)
      expected = expected || one == kind;
    ResultOfKind result(kind);
    EXPECT_TRUE(model_.HandleMissingValue(&result).IsOK());
    EXPECT_EQ(result.GetCategoryCount(), expected ? 2u : 0u) << "kind " << kind;
    EXPECT_EQ(result.GetPrediction()->GetString(), "b") << "kind " << kind;
    EXPECT_EQ(result.GetProbability(), 0.75) << "kind " << kind;
  }
}

TEST_F(BaseModelTest, RecordsNoProbabilitiesWhenTheModelSuppressesThem) {
  UseDistribution({{"a", 0.25}, {"b", 0.75}});
  model_.suppress = true;
  ClsResult result;
  EXPECT_TRUE(model_.HandleMissingValue(&result).IsOK());
  EXPECT_EQ(result.GetCategoryCount(), 0u);
  EXPECT_EQ(result.GetPrediction()->GetString(), "b");
  EXPECT_EQ(result.GetProbability(), 0.75);
}

TEST_F(BaseModelTest, PredictsACategoryInARegressionResultToo) {
  UseDistribution({{"a", 0.25}, {"b", 0.75}});
  RegResult result;
  EXPECT_TRUE(model_.HandleMissingValue(&result).IsOK());
  EXPECT_EQ(result.GetPrediction()->GetString(), "b");
}

TEST_F(BaseModelTest, PredictsTheDefaultOfAContinuousTarget) {
  model_.SetVarRole("x", ScoreModel::kTarget);
  auto* x = const_cast<ScoreDictVar*>(model_.GetTargetVar());
  RegResult result;
  const NumericValue before(1.0);
  result.SetPrediction(&before);
  ExpectNoPredictionStatus(model_.HandleMissingValue(&result));
  EXPECT_EQ(result.GetPrediction()->GetDouble(), 1.0) << "without a default the prediction stays";
  x->SetDefValue(new NumericValue(7.5));
  EXPECT_TRUE(model_.HandleMissingValue(&result) == MCStatus());
  EXPECT_EQ(result.GetPrediction()->GetDouble(), 7.5);
  EXPECT_EQ(result.GetProbability(), 0.0) << "a default has no probability";
}

TEST_F(BaseModelTest, CannotPredictWithoutATarget) {
  ClsResult result;
  ExpectNoPredictionStatus(model_.HandleMissingValue(&result));
  ExpectNoPredictionStatus(PlainModel().HandleMissingValue(&result));
  model_.SetVarRole("derived", ScoreModel::kTarget);
  ExpectNoPredictionStatus(model_.HandleMissingValue(&result));
}

TEST_F(BaseModelTest, HasNothingToDoWithoutAResult) {
  EXPECT_TRUE(model_.HandleMissingValue(nullptr) == MCStatus());
  UseDistribution({});
  EXPECT_TRUE(model_.HandleMissingValue(nullptr) == MCStatus());
}

}  // namespace
