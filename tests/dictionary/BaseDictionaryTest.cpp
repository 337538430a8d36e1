#include "kestrel/dictionary/BaseDictionary.h"

#include <gtest/gtest.h>

#include <memory>

#include "kestrel/dictionary/DictVar.h"
#include "tests/dictionary/TestValues.h"

namespace MCKestrel_800 {
namespace {

using Names = std::vector<std::string>;

DictVar* NewVar(const std::string& name) {
  return new DictVar(name, ScoreDictVar::kNUMERIC_VAR);
}

Names NamesOf(const std::vector<ScoreDictVar*>& vars) {
  Names names;
  for (const ScoreDictVar* var : vars)
    names.push_back(var->GetName());
  return names;
}

TEST(BaseDictionary, NamesKeepTheirOrderAndVariablesAreSorted) {
  BaseDictionary dictionary;
  EXPECT_TRUE(dictionary.AddVar("b", NewVar("b")));
  EXPECT_TRUE(dictionary.AddVar("a", NewVar("a")));
  EXPECT_EQ(dictionary.GetVarNames(), (Names{"b", "a"}));
  EXPECT_EQ(NamesOf(dictionary.GetScoreDictVars()), (Names{"a", "b"}));
  EXPECT_EQ(dictionary.Size(), 2u);
  const std::string display = DisplayOf(dictionary);
  EXPECT_LT(display.find("Var Name = a;"), display.find("Var Name = b;"));
}

TEST(BaseDictionary, SortsByBytes) {
  BaseDictionary dictionary;
  for (const char* name : {"\xC3\xA4", "a", "Z"})
    dictionary.AddVar(name, NewVar(name));
  EXPECT_EQ(NamesOf(dictionary.GetScoreDictVars()), (Names{"Z", "a", "\xC3\xA4"}));
}

TEST(BaseDictionary, LooksUpExactNames) {
  BaseDictionary dictionary;
  DictVar* var = NewVar("age");
  dictionary.AddVar("age", var);
  EXPECT_EQ(dictionary.GetVar("age"), var);
  EXPECT_EQ(dictionary.GetVar("Age"), nullptr);
  const BaseDictionary& constant = dictionary;
  EXPECT_EQ(constant.GetVar("age"), var);
  EXPECT_EQ(constant.GetVar("Age"), nullptr);
}

TEST(BaseDictionary, RefusesAnEmptyNameAndANullVariable) {
  BaseDictionary dictionary;
  const std::unique_ptr<DictVar> refused(NewVar("a"));
  EXPECT_FALSE(dictionary.AddVar("", refused.get()));
  EXPECT_FALSE(dictionary.AddVar("a", static_cast<ScoreDictVar*>(nullptr)));
  EXPECT_EQ(dictionary.Size(), 0u);
  EXPECT_TRUE(dictionary.GetVarNames().empty());
}

TEST(BaseDictionary, ATakenNameKeepsTheFirstVariableAndLeavesTheSecondToItsCaller) {
  BaseDictionary dictionary;
  DictVar* first = NewVar("a");
  const std::unique_ptr<DictVar> second(NewVar("a"));
  EXPECT_TRUE(dictionary.AddVar("a", first));
  EXPECT_TRUE(dictionary.AddVar("a", second.get()));
  EXPECT_TRUE(dictionary.AddVar("a", first));
  EXPECT_EQ(dictionary.Size(), 1u);
  EXPECT_EQ(dictionary.GetVarNames(), (Names{"a", "a", "a"}));
  EXPECT_EQ(dictionary.GetVar("a"), first);
}

TEST(BaseDictionary, RemovesTheVariableAndKeepsTheNameListed) {
  BaseDictionary dictionary;
  dictionary.AddVar("a", NewVar("a"));
  dictionary.AddVar("b", NewVar("b"));
  EXPECT_FALSE(dictionary.RemoveVar(""));
  EXPECT_FALSE(dictionary.RemoveVar("c"));
  EXPECT_FALSE(dictionary.RemoveVar("A"));
  EXPECT_TRUE(dictionary.RemoveVar(dictionary.GetVar("a")->GetName()));
  EXPECT_FALSE(dictionary.RemoveVar("a"));
  EXPECT_EQ(dictionary.Size(), 1u);
  EXPECT_EQ(dictionary.GetVar("a"), nullptr);
  EXPECT_EQ(NamesOf(dictionary.GetScoreDictVars()), (Names{"b"}));
  EXPECT_EQ(dictionary.GetVarNames(), (Names{"a", "b"}));
}

TEST(BaseDictionary, MergingReplacesTheNamesAndNeverReportsSuccess) {
  BaseDictionary dictionary;
  DictVar* kept = NewVar("shared");
  dictionary.AddVar("own", NewVar("own"));
  dictionary.AddVar("shared", kept);
  BaseDictionary other;
  other.AddVar("new", NewVar("new"));
  other.AddVar("shared", NewVar("shared"));
  other.AddVar("gone", NewVar("gone"));
  other.RemoveVar("gone");
  EXPECT_FALSE(dictionary.AddVar(static_cast<const ScoreDictionary*>(nullptr)));
  EXPECT_FALSE(dictionary.AddVar(&other));
  EXPECT_EQ(dictionary.Size(), 3u);
  EXPECT_EQ(dictionary.GetVarNames(), (Names{"new", "shared", "gone"}));
  EXPECT_EQ(NamesOf(dictionary.GetScoreDictVars()), (Names{"new", "own", "shared"}));
  EXPECT_EQ(dictionary.GetVar("shared"), kept);
  EXPECT_NE(dictionary.GetVar("new"), other.GetVar("new"));
  EXPECT_EQ(dictionary.GetVar("gone"), nullptr);
  EXPECT_FALSE(dictionary.AddVar(&dictionary));
  EXPECT_EQ(dictionary.Size(), 3u);
}

TEST(BaseDictionary, CopiesAreDeep) {
  BaseDictionary dictionary;
  dictionary.AddVar("b", NewVar("b"));
  dictionary.AddVar("a", NewVar("a"));
  dictionary.AddVar("gone", NewVar("gone"));
  dictionary.RemoveVar("gone");
  const std::unique_ptr<ScoreDictionary> clone(dictionary.Clone());
  const BaseDictionary copy(dictionary);
  BaseDictionary assigned;
  assigned.AddVar("old", NewVar("old"));
  assigned = dictionary;
  const BaseDictionary& same = assigned;
  assigned = same;
  dictionary.GetVar("a")->SetLabel("changed");
  for (const ScoreDictionary* other : std::vector<const ScoreDictionary*>{clone.get(), &copy, &assigned}) {
    EXPECT_EQ(other->GetVarNames(), (Names{"b", "a", "gone"}));
    EXPECT_EQ(NamesOf(other->GetScoreDictVars()), (Names{"a", "b"}));
    EXPECT_EQ(other->GetVar("a")->GetLabel(), "");
  }
}

TEST(BaseDictionary, DisplaysItsVariablesInOrderOfTheirNames) {
  BaseDictionary dictionary;
  EXPECT_EQ(
      DisplayOf(dictionary),
      "\n ############ Begin dictionary display ################ \nEnd Of ScoreDictionary display.\n\n");
  dictionary.AddVar("b", NewVar("b"));
  dictionary.AddVar("a", new DictVar("a", ScoreDictVar::STRING_VAR));
  EXPECT_EQ(DisplayOf(dictionary),
            "\n ############ Begin dictionary display ################ \n"
            "Start ScoreDictVar Display:\nVar Name = a; Var Lable = ; Var Type = STRING_VAR; "
            "Var level =  Continuous; \nEnd of ScoreDictVar Display.\n\n"
            "Start ScoreDictVar Display:\nVar Name = b; Var Lable = ; Var Type = kNUMERIC_VAR; "
            "Var level =  Continuous; \nEnd of ScoreDictVar Display.\n\n"
            "End Of ScoreDictionary display.\n\n");
}

}  // namespace
}  // namespace MCKestrel_800
