// Tests of the dictionary of derived fields as a container.

#include "kestrel/transform/TransformationDictionary.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/DictVar.h"

namespace {

using namespace MCKestrel_800;

using Names = std::vector<std::string>;

TEST(TransformationDictionary, KeepsDerivedNamesInTheOrderInWhichTheyCame) {
  TransformationDictionary dictionary;
  EXPECT_EQ(dictionary.GetDerivedVarNames(), Names());
  for (const char* name : {"b", "a", "b", ""})
    dictionary.AddDerievedVarName(name);
  EXPECT_EQ(dictionary.GetDerivedVarNames(), (Names{"b", "a", "b", ""}));
}

TEST(TransformationDictionary, KeepsVariablesAndDerivedNamesApart) {
  TransformationDictionary dictionary;
  dictionary.AddVar("x", new DictVar("x", ScoreDictVar::kNUMERIC_VAR));
  EXPECT_EQ(dictionary.GetDerivedVarNames(), Names());
  EXPECT_EQ(dictionary.Size(), 1u);
  dictionary.AddDerievedVarName("y");
  EXPECT_EQ(dictionary.GetVar("y"), nullptr);
  EXPECT_EQ(dictionary.GetVarNames(), Names{"x"});
}

TEST(TransformationDictionary, CopiesDeeply) {
  TransformationDictionary dictionary;
  dictionary.AddVar("x", new DictVar("x", ScoreDictVar::kNUMERIC_VAR));
  dictionary.AddDerievedVarName("x");
  const TransformationDictionary copy(dictionary);
  TransformationDictionary assigned;
  assigned.AddDerievedVarName("gone");
  assigned = dictionary;
  const std::unique_ptr<ScoreDictionary> clone(static_cast<const ScoreDictionary&>(dictionary).Clone());
  dictionary.GetVar("x")->SetLabel("changed");
  dictionary.AddDerievedVarName("y");
  const auto* clone_as_made = dynamic_cast<const TransformationDictionary*>(clone.get());
  ASSERT_NE(clone_as_made, nullptr) << "a clone through the interface is of the same class";
  for (const TransformationDictionary* made :
       {&copy, static_cast<const TransformationDictionary*>(&assigned), clone_as_made}) {
    EXPECT_EQ(made->GetDerivedVarNames(), Names{"x"});
    ASSERT_NE(made->GetVar("x"), nullptr);
    EXPECT_EQ(made->GetVar("x")->GetLabel(), "");
  }
}

}  // namespace
