// Values that an "if" chooses, where they decide what a function or a field makes of them.

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "tests/transform/DerivedFields.h"

namespace {

using namespace MCKestrel_800;
using namespace kestrel_test;

constexpr auto kDateVar = ScoreDictVar::kDATETIME_VAR;
constexpr double kDay = 86400.0;

FunctionTree* Constant(double number) {
  return ConstantLeaf(Number(number));
}
FunctionTree* Constant(const char* text) {
  return ConstantLeaf(Text(text));
}

/// By the field x.
FunctionTree* Choice(FunctionTree* second, FunctionTree* third = nullptr) {
  std::vector<FunctionTree*> arguments = {FieldLeaf("x"), second};
  if (third != nullptr) arguments.push_back(third);
  return Call(kIfFunction, arguments);
}

FunctionTree* T() {
  return FieldLeaf("t");
}
FunctionTree* D() {
  return FieldLeaf("d");
}
/// A missing number.
FunctionTree* Y() {
  return FieldLeaf("y");
}

/// The field d, a missing one replaced.
FunctionTree* Imputation(double replacement) {
  FunctionTree* const tree = Call(kImputeFunction, {D(), Y()});
  ApplyNodeStats stats(tree->GetNodeStats());
  stats.AddArray({Number(1)});
  stats.AddArray({Number(1)});
  tree->SetNodeStats(stats);
  return WithReplacement(tree, replacement);
}

/// x is 1 or 0, t is "abc", d one day after 1970 began, y missing.
class Choices : public testing::Test {
 protected:
  Choices() {
    data_.record.SetValue("t", "abc");
    data_.record.SetValue("d", 1.0, kDateDaysSince1970);
    data_.dictionary.GetVar("d")->AddScoreValueLabel(new DateTimeValue(kDay, kDateVal), "day");
  }

  void Set(double x) { data_.record.SetValue("x", x); }
  double Get(const std::string& name) {
    return dictionary_.GetValuesForDerivedVars(&data_.record, &data_.dictionary)->Get(name)->GetDouble();
  }

  Data data_;
  TransformationDictionary dictionary_;
};

struct EqualRow {
  const char* why;
  FunctionTree* left;
  FunctionTree* right;
  double when_true;   ///< what "equal" gives when the condition is true
  double when_false;  ///< and when it is not
};

TEST_F(Choices, AreComparedAsTheKindThatTheyAre) {
  const EqualRow rows[] = {
      {"date or its seconds, with a date", Choice(D(), Constant(kDay)), D(), 1, 0},
      {"date or its seconds, with the seconds", Choice(D(), Constant(kDay)), Constant(kDay), 0, 1},
      {"the same, turned round", Constant(kDay), Choice(D(), Constant(kDay)), 0, 1},
      {"text or number, with a number", Choice(T(), Constant(5)), Constant(5), 0, 1},
      {"text or number, with a text", Choice(T(), Constant(5)), Constant("abc  "), 1, 0},
      {"text or number, with another text", Choice(T(), Constant(5)), Constant("ab"), 0, 0},
      {"number or text, with a text", Choice(Constant(5), T()), T(), 0, 1},
      {"both the same", Choice(T(), Constant(5)), Choice(T(), Constant(5)), 1, 1},
      {"both text or number", Choice(T(), Constant(5)), Choice(T(), Constant(6)), 1, 0},
      {"both, crosswise", Choice(T(), Constant(5)), Choice(Constant(5), T()), 0, 0},
      {"a choice within", Choice(Choice(T(), D()), Choice(D(), Constant(5))), Constant(5), 0, 1},
      {"texts alone", Choice(T(), Constant("d")), Constant("d"), 0, 1},
      {"numbers alone", Choice(Constant(4), Constant(5)), Constant(5), 0, 1},
      {"nothing, of the kind of the second argument", Choice(T()), Constant(""), 0, 1},
      {"nothing, where only one of a choice is a text", Choice(Choice(T(), Constant(5))), Constant(""), 0, 1},
      {"a missing number", Choice(T(), Y()), Y(), 0, 1},
      {"a missing number, replaced", WithReplacement(Choice(T(), Y()), 7), Constant(7), 0, 1},
      {"a missing number, replaced further out", WithReplacement(Choice(T(), Choice(T(), Y())), 7),
       Constant(7), 0, 1},
      {"a number that is there, not replaced", WithReplacement(Choice(T(), Constant(5)), 7), Constant(7), 0,
       0},
  };
  for (const EqualRow& row : rows) {
    const std::string equal = row.why, not_equal = "not " + equal;
    AddDerived(dictionary_, NewApply(equal, Call(kEqualFunction, {row.left, row.right})));
    AddDerived(dictionary_,
               NewApply(not_equal, Call(kNotEqualFunction, {row.left->Clone(), row.right->Clone()})));
  }
  dictionary_.SetUpDerivedCaseRecord();
  for (const bool is_true : {true, false, true}) {
    Set(is_true ? 1 : 0);
    for (const EqualRow& row : rows) {
      const double wanted = is_true ? row.when_true : row.when_false;
      EXPECT_EQ(Get(row.why), wanted) << row.why << ", " << is_true;
      EXPECT_EQ(Get(std::string("not ") + row.why), 1 - wanted) << row.why << ", " << is_true;
    }
  }
}

TEST_F(Choices, OfAMissingDateAreReplacedByNoNumber) {
  data_.record.SetMissingValue("d");
  AddDerived(dictionary_, NewApply("equal", Call(kEqualFunction, {WithReplacement(Choice(D()), 7), D()})));
  AddDerived(dictionary_, NewApply("imputed", Call(kEqualFunction, {Imputation(7), D()})));
  AddDerived(dictionary_, NewApply("year", Call(kYearFromDateFunction, {Imputation(7)})));
  AddDerived(dictionary_, NewApply("number", WithReplacement(Choice(D()), 7)));
  dictionary_.SetUpDerivedCaseRecord();
  for (const double x : {1.0, 0.0}) {
    Set(x);
    EXPECT_EQ(Get("equal"), 1) << x;
    EXPECT_EQ(Get("imputed"), 1) << x;
    EXPECT_EQ(Get("year"), kSysmis) << x;
    EXPECT_EQ(Get("number"), 7) << "asked for a number, it is one";
  }
}

struct ListRow {
  const char* why;
  FunctionTree* argument;
  double when_true;
  double when_false;
};

TEST_F(Choices, AreLookedForAsTheKindThatTheyAre) {
  const ListRow rows[] = {
      {"date or number", Choice(D(), Constant(5)), 1, 1},
      {"number or date", Choice(Constant(2 * kDay), D()), 0, 1},
      {"text or number", Choice(T(), Constant(5)), 1, 1},
      {"number or text", Choice(Constant(6), T()), 0, 1},
      {"others", Choice(Constant("abcd"), Constant(5.5)), 0, 0},
      {"a date's seconds", Choice(D(), Constant(kDay)), 1, 0},
      {"a missing number, replaced", WithReplacement(Choice(T(), Y()), 5), 1, 1},
      {"a missing number", Choice(T(), Y()), 1, 0},
      {"nothing", Choice(T()), 1, 0},
      {"numbers alone", Choice(Constant(5), Constant(6)), 1, 0},
  };
  for (const ListRow& row : rows) {
    for (const TransformFunction function : {kIsInFunction, kIsNotInFunction}) {
      FunctionTree* const argument = function == kIsInFunction ? row.argument : row.argument->Clone();
      FunctionTree* const tree = Call(function, {argument});
      ApplyNodeStats stats(tree->GetNodeStats());
      stats.AddArray({Text("xyz"), Number(5), Text("abc"), new DateTimeValue(kDay, kDateVal), Number(-3)});
      tree->SetNodeStats(stats);
      AddDerived(dictionary_,
                 NewApply((function == kIsInFunction ? "" : "not ") + std::string(row.why), tree));
    }
  }
  dictionary_.SetUpDerivedCaseRecord();
  for (const bool is_true : {true, false, true}) {
    Set(is_true ? 1 : 0);
    for (const ListRow& row : rows) {
      const double wanted = is_true ? row.when_true : row.when_false;
      EXPECT_EQ(Get(row.why), wanted) << row.why << ", " << is_true;
      EXPECT_EQ(Get(std::string("not ") + row.why), 1 - wanted) << row.why << ", " << is_true;
    }
  }
}

TEST_F(Choices, ThatAreNestedTooDeepHaveNoValue) {
  for (const int depth : {500, 100000}) {
    FunctionTree* tree = T();
    for (int i = 0; i < depth; ++i)
      tree = Choice(tree, Constant(5));
    AddDerived(dictionary_, NewApply(std::to_string(depth), Call(kEqualFunction, {tree, Constant(5)})));
  }
  dictionary_.SetUpDerivedCaseRecord();
  Set(0);
  EXPECT_EQ(Get("500"), 1);
  EXPECT_EQ(Get("100000"), kSysmis);
  Set(1);
  EXPECT_EQ(Get("500"), 0);
}

struct DateRow {
  const char* why;
  FunctionTree* tree;
  double when_true;  ///< seconds
  double when_false;
};

TEST_F(Choices, GiveADateFieldDatesAlone) {
  const DateRow rows[] = {
      {"a number", Call(kPlusFunction, {Constant(1), Constant(2)}), kSysmis, kSysmis},
      {"a number of one argument", Call(kAbsFunction, {Constant(1)}), kSysmis, kSysmis},
      {"the number of a date", Call(kPlusFunction, {D(), Constant(2)}), kSysmis, kSysmis},
      {"a number in place of a missing one", WithReplacement(Call(kAbsFunction, {Y()}), 7), kSysmis, kSysmis},
      {"a text", Call(kLowerFunction, {T()}), kSysmis, kSysmis},
      {"date or number", Choice(D(), Constant(5)), kDay, kSysmis},
      {"number or date", Choice(Constant(5), D()), kSysmis, kDay},
      {"text or date", Choice(T(), D()), kSysmis, kDay},
      {"date or nothing", Choice(D()), kDay, kSysmis},
      {"date or nothing, replaced by a number", WithReplacement(Choice(D()), 7), kDay, kSysmis},
      {"a choice within", Choice(Choice(D(), Constant(5)), Choice(D(), Constant(5))), kDay, kSysmis},
      {"an imputation", Imputation(7), kDay, kDay},
      {"a field", D(), kDay, kDay},
      {"a field of another kind", FieldLeaf("x"), kSysmis, kSysmis},
      {"a constant", ConstantLeaf(new DateTimeValue(2 * kDay, kDateVal)), 2 * kDay, 2 * kDay},
  };
  for (const DateRow& row : rows)
    AddDerived(dictionary_, NewApply(row.why, row.tree, kDateVar));
  dictionary_.SetUpDerivedCaseRecord();
  for (const bool is_true : {true, false, true}) {
    Set(is_true ? 1 : 0);
    for (const DateRow& row : rows)
      EXPECT_EQ(Get(row.why), is_true ? row.when_true : row.when_false) << row.why << ", " << is_true;
  }
}

}  // namespace
