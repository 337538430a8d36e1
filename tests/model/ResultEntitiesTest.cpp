// Tests of the parts of a model that a result names.

#include "kestrel/model/ResultEntities.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "kestrel/model/Results.h"

namespace {

using namespace MCKestrel_800;

class DerivedClsResult : public ClsResult {};
class DerivedRegResult : public RegResult {};

/// A result of a model library's own class.
class ForeignResult : public ScoreResult {
 public:
  void SetPrediction(const ScoreValue*) override {}
  const ScoreValue* GetPrediction() const override { return nullptr; }
  void Reset() override {}
  void SetProbability(double) override {}
  double GetProbability() const override { return 0.0; }
  int GetResultKind() const override { return 0; }
};

std::vector<std::string> PathOf(const ResultEntities& entities) {
  std::vector<std::string> path;
  for (std::size_t i = 0; i < entities.GetPathLength(); ++i)
    path.push_back(entities.GetPathId(i));
  return path;
}

template <typename Result>
class EntitiesOfResult : public testing::Test {
 protected:
  Result result_;
  ResultEntities& entities_ = result_.GetEntities();
};

using ResultsWithEntities = testing::Types<ClsResult, RegResult, DerivedClsResult, DerivedRegResult>;
TYPED_TEST_SUITE(EntitiesOfResult, ResultsWithEntities);

TYPED_TEST(EntitiesOfResult, AreFoundFromTheInterface) {
  const TypeParam& unchanging = this->result_;
  EXPECT_EQ(ResultEntities::Of(&this->result_), &this->entities_);
  EXPECT_EQ(&unchanging.GetEntities(), &this->entities_);
}

TYPED_TEST(EntitiesOfResult, AreNoneAtFirst) {
  EXPECT_FALSE(this->entities_.IsPathWanted());
  EXPECT_FALSE(this->entities_.IsDecidingIdWanted());
  EXPECT_EQ(this->entities_.GetDecidingId(), "");
  EXPECT_EQ(this->entities_.GetPathLength(), 0u);
}

TYPED_TEST(EntitiesOfResult, AreToldOnRequest) {
  const struct {
    bool deciding_id_wanted, path_wanted, tells_deciding_id, tells_path;
    const char* why;
  } rows[] = {
      {false, false, false, false, "names cost time"},
      {true, false, true, false, "the deciding one alone"},
      {false, true, true, true, "the deciding one is told with the path"},
      {true, true, true, true, "both"},
  };
  for (const auto& row : rows) {
    this->entities_.SetDecidingIdWanted(row.deciding_id_wanted);
    this->entities_.SetPathWanted(row.path_wanted);
    this->result_.Reset();
    EXPECT_EQ(this->entities_.IsDecidingIdWanted(), row.tells_deciding_id) << row.why;
    EXPECT_EQ(this->entities_.IsPathWanted(), row.tells_path) << row.why;
  }
}

TYPED_TEST(EntitiesOfResult, AreForgottenByReset) {
  this->entities_.SetPathWanted(true);
  this->entities_.SetDecidingId("leaf");
  this->entities_.AddToPath("root");
  this->result_.Reset();
  EXPECT_EQ(this->entities_.GetDecidingId(), "");
  EXPECT_EQ(this->entities_.GetPathLength(), 0u);
  EXPECT_TRUE(this->entities_.IsPathWanted()) << "stays from case to case";
}

TEST(ResultEntities, AreNullForAResultThatHasNone) {
  ForeignResult foreign;
  EXPECT_EQ(ResultEntities::Of(&foreign), nullptr);
  EXPECT_EQ(ResultEntities::Of(nullptr), nullptr);
}

TEST(ResultEntities, HoldNoPathUnlessItIsWanted) {
  ResultEntities entities;
  entities.AddToPath("root");
  EXPECT_EQ(PathOf(entities), std::vector<std::string>{});
  entities.SetPathWanted(true);
  entities.AddToPath("root");
  EXPECT_EQ(PathOf(entities), std::vector<std::string>{"root"});
  entities.Reset();
  entities.SetPathWanted(false);
  entities.AddToPath("root");
  EXPECT_EQ(PathOf(entities), std::vector<std::string>{});
}

TEST(ResultEntities, AreCopied) {
  ResultEntities entities;
  entities.SetPathWanted(true);
  {
    std::string id = "n1";
    entities.SetDecidingId(id);
    entities.AddToPath(id);
    id = "n2";
    entities.AddToPath(id);
  }
  EXPECT_EQ(entities.GetDecidingId(), "n1");
  EXPECT_EQ(PathOf(entities), (std::vector<std::string>{"n1", "n2"}));
}

TEST(ResultEntities, HoldIdentifiersOfAnyCharacters) {
  using std::string_literals::operator""s;
  const std::vector<std::string> ids = {"",           " > ",   "a,b",           "\"quoted\"",
                                        "two\nlines", "a\0b"s, "W\xc3\xa4hler", std::string(1000, 'x')};
  ResultEntities entities;
  entities.SetPathWanted(true);
  for (const std::string& id : ids) {
    entities.SetDecidingId(id);
    EXPECT_EQ(entities.GetDecidingId(), id);
    entities.AddToPath(id);
  }
  EXPECT_EQ(PathOf(entities), ids);
}

TEST(ResultEntities, TakeTheirOwnIdentifiersAgain) {
  ResultEntities entities;
  entities.SetPathWanted(true);
  const std::vector<std::string> ids = {"n1", std::string(100, 'x')};
  for (const std::string& id : ids)
    entities.AddToPath(id);
  for (std::size_t i = 0; i < 50; ++i)
    entities.AddToPath(entities.GetPathId(i));
  entities.SetDecidingId(entities.GetPathId(51));
  EXPECT_EQ(entities.GetPathId(50), ids[0]);
  EXPECT_EQ(entities.GetPathId(51), ids[1]);
  EXPECT_EQ(entities.GetDecidingId(), ids[1]);
}

TEST(ResultEntities, ShowNothingOfALongerEarlierPath) {
  ResultEntities entities;
  entities.SetPathWanted(true);
  for (const char* id : {"a", "b", "c"})
    entities.AddToPath(id);
  entities.Reset();
  entities.AddToPath("d");
  EXPECT_EQ(PathOf(entities), std::vector<std::string>{"d"});
  entities.AddToPath("e");
  EXPECT_EQ(PathOf(entities), (std::vector<std::string>{"d", "e"}));
}

}  // namespace
