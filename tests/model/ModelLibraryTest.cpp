// Tests of naming a model's library.

#include "kestrel/model/ModelLibrary.h"

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "kestrel/translate/ScoreTranslator.h"

namespace {

using namespace MCKestrel_800;

const std::string kEnd = std::string("800r") + SharedLibrary::GetSuffix();

TEST(ModelLibrary, FormsItsNameFromTheTag) {
  struct Row {
    std::string tag;
    std::string expected;
    const char* why;
  };
  const Row rows[] = {
      {"TreeModel", "TreeModel" + kEnd, "the rule"},
      {"Tree.Model-2_x", "Tree.Model-2_x" + kEnd, "what else a tag may hold"},
      {"Mod\xC3\xA8le", "Mod\xC3\xA8le" + kEnd, "letters beyond ASCII"},
      {"TreeModel.dll", "TreeModel.dll" + kEnd, "a suffix inside the name is part of it"},
      {"TreeModel.so", "TreeModel.so" + kEnd, "a suffix inside the name is part of it"},
      {"", "", "no tag"},
      {"a/b", "", "a folder"},
      {"/TreeModel", "", "the top folder"},
      {"../TreeModel", "", "the folder above"},
      {"..", "", "the folder above"},
      {".TreeModel", "", "a hidden file"},
      {"a\\b", "", "a folder on Windows"},
      {"c:TreeModel", "", "a drive on Windows"},
      {"p:TreeModel", "", "a prefix, which would be a drive on Windows"},
      {std::string("Tree\0Model", 10), "", "a name that ends early"},
  };
  for (const Row& row : rows)
    EXPECT_EQ(ModelLibrary::FileNameFor(row.tag), row.expected) << row.why;
}

TEST(ModelLibrary, LoadsNothingForATagThatIsNoName) {
  std::vector<std::string> names;
  for (const char* tag : {"", "../TreeModel", "p:TreeModel", "./TreeModel"}) {
    ModelLibrary library(tag);
    EXPECT_EQ(library.MakeTranslator(names), nullptr) << tag;
    EXPECT_NE(library.GetLastErrorText(), "") << tag;
  }
}

TEST(ModelLibrary, GivesATranslator) {
  const std::pair<const char*, const char*> rows[] = {
      {"TreeModel", "without the entry points that may be absent"},
      {"VersionedModel", "built for this version"},
  };
  std::vector<std::string> names;
  for (const auto& [tag, why] : rows) {
    ModelLibrary library(tag);
    EXPECT_NE(library.MakeTranslator(names), nullptr) << library.GetLastErrorText() << why;
    EXPECT_EQ(library.GetLastErrorText(), "") << why;
  }
}

TEST(ModelLibrary, TellsWhatWentWrong) {
  struct Row {
    const char* tag;
    const char* text;  ///< all behind the name when it begins with a colon, else a part
    const char* why;
  };
  const Row rows[] = {
      {"NoSuchModel", "", "absent"},
      {"NotALibrary", "", "a text file"},
      {"Fault_NEEDS_ABSENT", "", "needs a library that is absent"},
      {"Fault_NO_ENTRY", "GiveMyTranslator", "no entry point"},
      {"Fault_NULL_TRANSLATOR", ": GiveMyTranslator gave no translator.", "no translator"},
      {"Fault_OTHER_VERSION", ": built for Kestrel 7.2, this is " KESTREL_PLUGIN_VERSION ".",
       "built for another version"},
      {"Fault_NULL_VERSION", ": GiveMyVersion gave no version.", "does not know its version"},
  };
  std::vector<std::string> names;
  for (const Row& row : rows) {
    ModelLibrary library(row.tag);
    EXPECT_EQ(library.MakeTranslator(names), nullptr) << row.why;
    const std::string text = library.GetLastErrorText();
    EXPECT_NE(text, "") << row.why;
    if (row.text[0] == ':') {
      EXPECT_EQ(text, ModelLibrary::FileNameFor(row.tag) + row.text) << row.why;
    }
    EXPECT_NE(text.find(row.text), std::string::npos) << row.why << ": " << text;
  }
}

TEST(ModelLibrary, SaysWhyAgainWhenAskedAgain) {
  std::vector<std::string> names;
  ModelLibrary library("Fault_OTHER_VERSION");
  for (int i = 0; i < 2; ++i) {
    EXPECT_EQ(library.MakeTranslator(names), nullptr);
    EXPECT_NE(library.GetLastErrorText().find("built for Kestrel 7.2"), std::string::npos);
  }
}

}  // namespace
