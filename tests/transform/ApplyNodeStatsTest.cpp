#include "kestrel/transform/ApplyNodeStats.h"

#include <gtest/gtest.h>

#include <memory>
#include <vector>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"

namespace MCKestrel_800 {
namespace {

/// Counts the values that are there.
class CountedValue : public NumericValue {
 public:
  explicit CountedValue(int& count) : NumericValue(1.0), count_(count) { ++count_; }
  CountedValue(const CountedValue& other) : NumericValue(other), count_(other.count_) { ++count_; }
  CountedValue& operator=(const CountedValue&) = delete;
  ~CountedValue() override { --count_; }
  ScoreValue* Clone() const override { return new CountedValue(*this); }

 private:
  int& count_;
};

TEST(ApplyNodeStats, BeginsAsALeafWithoutAnything) {
  const ApplyNodeStats stats;
  EXPECT_EQ(stats.GetNodeID(), "");
  EXPECT_EQ(stats.GetParameterName(), "");
  EXPECT_EQ(stats.GetValue(), nullptr);
  EXPECT_EQ(stats.GetTransFunction(), 65);
  EXPECT_EQ(stats.GetVariable(), nullptr);
  EXPECT_EQ(stats.GetVarIndex(), -1);
  EXPECT_FALSE(stats.IsConstNode());
  EXPECT_EQ(stats.GetNumberOfArray(), 0);
  EXPECT_EQ(stats.GetInvalidValueTreatment(), 3);
  EXPECT_EQ(stats.GetRecodeMissValueTo(), nullptr);
  EXPECT_EQ(stats.GetFieldrefRecodeMissValueTo(), nullptr);
}

TEST(ApplyNodeStats, OwnsItsValues) {
  int count = 0;
  {
    ApplyNodeStats stats;
    for (int round = 0; round < 2; ++round) {
      stats.SetValue(new CountedValue(count));
      stats.SetRecodeMissValueTo(new CountedValue(count));
      stats.SetFieldrefRecodeMissValueTo(new CountedValue(count));
      EXPECT_EQ(count, 3);
    }
    stats.AddArray({new CountedValue(count), nullptr, new CountedValue(count)});
    EXPECT_EQ(count, 5);
    stats.ClearArray();
    EXPECT_EQ(count, 3);
    EXPECT_EQ(stats.GetNumberOfArray(), 0);
    // A value that is set again is the same value.
    stats.SetValue(const_cast<ScoreValue*>(stats.GetValue()));
    EXPECT_EQ(count, 3);
    stats.SetValue(nullptr);
    EXPECT_EQ(count, 2);
    const ApplyNodeStats copy(stats);
    EXPECT_EQ(count, 4);
    ApplyNodeStats assigned;
    assigned.SetValue(new CountedValue(count));
    assigned = copy;
    EXPECT_EQ(count, 6);
    assigned = *&assigned;
    EXPECT_EQ(count, 6);
  }
  EXPECT_EQ(count, 0);
}

TEST(ApplyNodeStats, GivesItsArrays) {
  ApplyNodeStats stats;
  stats.AddArray({new NumericValue(1.0), nullptr});
  stats.AddArray({});
  stats.AddArray({new StringValue("a")});
  ASSERT_EQ(stats.GetNumberOfArray(), 3);
  ASSERT_EQ(stats.GetArray(0).size(), 2u);
  EXPECT_EQ(stats.GetArray(0)[0]->GetDouble(), 1.0);
  EXPECT_EQ(stats.GetArray(0)[1], nullptr);
  EXPECT_TRUE(stats.GetArray(1).empty());
  EXPECT_EQ(stats.GetArray(2)[0]->GetString(), "a");
  EXPECT_TRUE(stats.GetArray(3).empty());
  EXPECT_TRUE(stats.GetArray(-1).empty());
}

ApplyNodeStats Complete(const ScoreDictVar& variable) {
  ApplyNodeStats stats;
  stats.SetNodeID("7");
  stats.SetParameterName("age");
  stats.SetValue(new NumericValue(1.0));
  stats.SetTransFunction(kIsInFunction);
  stats.SetVariable(&variable);
  stats.SetVarIndex(3);
  stats.SetConstNode(true);
  stats.AddArray({new StringValue("a"), nullptr});
  stats.SetInvalidValueTreatment(ApplyNodeStats::kAsMissing);
  stats.SetRecodeMissValueTo(new NumericValue(2.0));
  stats.SetFieldrefRecodeMissValueTo(new NumericValue(3.0));
  return stats;
}

TEST(ApplyNodeStats, CopiesAreDeepButForTheVariable) {
  const DictVar variable("age", ScoreDictVar::kNUMERIC_VAR);
  const ApplyNodeStats stats = Complete(variable);
  const ApplyNodeStats copy(stats);
  ApplyNodeStats assigned;
  assigned = stats;
  for (const ApplyNodeStats* other : {&copy, static_cast<const ApplyNodeStats*>(&assigned)}) {
    EXPECT_TRUE(*other == stats);
    EXPECT_EQ(other->GetNodeID(), "7");
    EXPECT_EQ(other->GetVarIndex(), 3);
    EXPECT_EQ(other->GetVariable(), &variable);
    EXPECT_NE(other->GetValue(), stats.GetValue());
    EXPECT_EQ(other->GetValue()->GetDouble(), 1.0);
    EXPECT_NE(other->GetArray(0)[0], stats.GetArray(0)[0]);
    EXPECT_EQ(other->GetArray(0)[0]->GetString(), "a");
    EXPECT_NE(other->GetRecodeMissValueTo(), stats.GetRecodeMissValueTo());
    EXPECT_EQ(other->GetRecodeMissValueTo()->GetDouble(), 2.0);
    EXPECT_NE(other->GetFieldrefRecodeMissValueTo(), stats.GetFieldrefRecodeMissValueTo());
    EXPECT_EQ(other->GetFieldrefRecodeMissValueTo()->GetDouble(), 3.0);
  }
}

TEST(ApplyNodeStats, EqualityLooksAtAllThatIsComputedWith) {
  const DictVar variable("age", ScoreDictVar::kNUMERIC_VAR);
  const ApplyNodeStats stats = Complete(variable);
  struct Row {
    void (*change)(ApplyNodeStats&);
    bool equal;
    const char* what;
  };
  const Row kRows[] = {
      {[](ApplyNodeStats& s) { s.SetNodeID("8"); }, true, "identifier"},
      {[](ApplyNodeStats& s) { s.SetVariable(nullptr); }, true, "variable"},
      {[](ApplyNodeStats& s) { s.SetVarIndex(9); }, true, "position"},
      {[](ApplyNodeStats& s) { s.SetParameterName("Age"); }, false, "name"},
      {[](ApplyNodeStats& s) { s.SetValue(new NumericValue(1.0)); }, true, "equal value"},
      {[](ApplyNodeStats& s) { s.SetValue(new NumericValue(2.0)); }, false, "value"},
      {[](ApplyNodeStats& s) { s.SetValue(new StringValue("1")); }, false, "kind of value"},
      {[](ApplyNodeStats& s) { s.SetValue(nullptr); }, false, "no value"},
      {[](ApplyNodeStats& s) { s.SetTransFunction(kIsNotInFunction); }, false, "function"},
      {[](ApplyNodeStats& s) { s.SetConstNode(false); }, false, "constant"},
      {[](ApplyNodeStats& s) { s.AddArray({}); }, false, "number of arrays"},
      {[](ApplyNodeStats& s) { s.ClearArray(); }, false, "no array"},
      {[](ApplyNodeStats& s) {
         s.ClearArray();
         s.AddArray({new StringValue("a ")});
       },
       false, "shorter array"},
      {[](ApplyNodeStats& s) {
         s.ClearArray();
         s.AddArray({new StringValue("a "), nullptr});
       },
       true, "equal array"},
      {[](ApplyNodeStats& s) { s.SetInvalidValueTreatment(ApplyNodeStats::kAsIs); }, false, "treatment"},
      {[](ApplyNodeStats& s) { s.SetRecodeMissValueTo(nullptr); }, false, "replacement"},
      {[](ApplyNodeStats& s) { s.SetFieldrefRecodeMissValueTo(nullptr); }, false, "field's replacement"},
  };
  for (const Row& row : kRows) {
    ApplyNodeStats other(stats);
    row.change(other);
    EXPECT_EQ(stats == other, row.equal) << row.what;
    EXPECT_EQ(other == stats, row.equal) << row.what;
  }
}

}  // namespace
}  // namespace MCKestrel_800
