// The column that tells which parts of a model led to an answer.

#include "apps/kestrel/ExplanationColumn.h"

#include <gtest/gtest.h>

#include <memory>

#include "apps/kestrel/TableWriter.h"
#include "kestrel/model/Results.h"

namespace kestrel_tests {
namespace {

using kestrel_program::ExplanationColumn;
using kestrel_program::TableWriter;
using MCKestrel_800::RegResult;
using MCKestrel_800::ResultEntities;
using MCKestrel_800::ScoreResult;
using MCKestrel_800::ScoreValue;

/// A result of a model library's own class, with no place for entities.
class ForeignResult : public ScoreResult {
 public:
  void SetPrediction(const ScoreValue*) override {}
  const ScoreValue* GetPrediction() const override { return nullptr; }
  void Reset() override {}
  void SetProbability(double) override {}
  double GetProbability() const override { return 0.0; }
  int GetResultKind() const override { return 2; }
};

/// The cell in JSON, which tells a list from a text and from nothing.
std::string Written(ExplanationColumn& column) {
  std::string out;
  const auto writer = TableWriter::Make(TableWriter::Format::kJsonLines, {"e"}, out);
  column.Write(*writer);
  return out;
}

TEST(ExplanationColumn, HasThePathRecorded) {
  RegResult result;
  ExplanationColumn column(&result);
  EXPECT_TRUE(result.GetEntities().IsPathWanted());
}

TEST(ExplanationColumn, WritesThePath) {
  RegResult result;
  ExplanationColumn column(&result);
  column.BeginCase();
  EXPECT_FALSE(column.HasPath());
  EXPECT_EQ(Written(column), "{\"e\":null");
  result.GetEntities().AddToPath("n1");
  EXPECT_TRUE(column.HasPath());
  EXPECT_EQ(Written(column), "{\"e\":[\"n1\"]");
  result.GetEntities().AddToPath("n2");
  EXPECT_EQ(Written(column), "{\"e\":[\"n1\",\"n2\"]");
}

TEST(ExplanationColumn, ForgetsTheCaseBefore) {
  RegResult result;
  ExplanationColumn column(&result);
  result.GetEntities().AddToPath("n1");
  column.BeginCase();
  EXPECT_FALSE(column.HasPath());
  EXPECT_EQ(Written(column), "{\"e\":null");
}

TEST(ExplanationColumn, IsEmptyForAResultWithoutEntities) {
  ForeignResult result;
  ExplanationColumn column(&result);
  column.BeginCase();
  EXPECT_FALSE(column.HasPath());
  EXPECT_EQ(Written(column), "{\"e\":null");
}

}  // namespace
}  // namespace kestrel_tests
