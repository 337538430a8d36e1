#include "kestrel/translate/PMMLModelTags.h"

#include <gtest/gtest.h>

#include <fstream>
#include <map>
#include <set>
#include <string>
#include <type_traits>
#include <vector>

namespace {

using MCKestrel_800::GetPMMLTagTable;
using MCKestrel_800::PMMLModelTags;
using MCKestrel_800::PMMLTagRow;
using MCKestrel_800::PMMLTagText;

std::vector<PMMLTagRow> Rows() {
  size_t count = 0;
  const PMMLTagRow* const first = GetPMMLTagTable(count);
  return std::vector<PMMLTagRow>(first, first + count);
}

// The prefix that tells a constant's kind.
std::string KindOf(const std::string& constant) {
  for (const char* kind :
       {"XML_ELE_", "XML_ELM_", "XML_ATT_", "XML_VAL_", "XML_EXT_", "XML_MSTAT_", "XML_VEXA_TRANFUNC_"}) {
    if (constant.compare(0, std::string(kind).size(), kind) == 0) return kind;
  }
  return "none";
}

TEST(PMMLModelTags, HoldsSoManyOfEachKind) {
  std::map<std::string, int> counts;
  for (const PMMLTagRow& row : Rows())
    ++counts[KindOf(row.constant)];
  const std::map<std::string, int> expected = {{"XML_ELE_", 173},         {"XML_ELM_", 3},  {"XML_ATT_", 279},
                                               {"XML_VAL_", 181},         {"XML_EXT_", 21}, {"XML_MSTAT_", 2},
                                               {"XML_VEXA_TRANFUNC_", 72}};
  EXPECT_EQ(counts, expected);
  EXPECT_EQ(Rows().size(), 731u);
}

TEST(PMMLModelTags, IsSortedWithinKindsAndHasNoDuplicates) {
  std::set<std::string> seen;
  std::string previous;
  for (const PMMLTagRow& row : Rows()) {
    EXPECT_TRUE(seen.insert(row.constant).second) << row.constant;
    if (KindOf(previous) == KindOf(row.constant)) {
      EXPECT_LT(previous, row.constant);
    }
    previous = row.constant;
  }
}

TEST(PMMLModelTags, HoldsTheAgreedNames) {
  std::ifstream in(KESTREL_SOURCE_DIR "/tests/data/pmml_names.tsv");
  ASSERT_TRUE(in.is_open());
  std::map<std::string, std::string> agreed;
  for (std::string line; std::getline(in, line);) {
    const size_t tab = line.find('\t');
    ASSERT_NE(tab, std::string::npos) << line;
    agreed[line.substr(0, tab)] = line.substr(tab + 1);
  }
  EXPECT_EQ(agreed.size(), 731u);
  for (const PMMLTagRow& row : Rows())
    EXPECT_EQ(agreed[row.constant], row.text) << row.constant;
}

TEST(PMMLModelTags, WideTextsAreTheSame) {
  std::map<std::string, std::u16string> wide = {
#define KESTREL_TAG(name, text) {#name, PMMLTagText::name},
#include "kestrel/translate/PMMLModelTags.inc"
#undef KESTREL_TAG
  };
  for (const PMMLTagRow& row : Rows()) {
    const std::string narrow(row.text);
    EXPECT_EQ(wide[row.constant], std::u16string(narrow.begin(), narrow.end())) << row.constant;
  }
}

TEST(PMMLModelTags, ConstantsAreArrays) {
  static_assert(std::is_same<decltype(PMMLModelTags::XML_ELE_PMML), const char[5]>::value,
                "usable without a call");
  EXPECT_STREQ(PMMLModelTags::XML_ELE_PMML, "PMML");
  EXPECT_STREQ(PMMLModelTags::XML_VAL_EXTENSION_EXTENDER, "kestrel.example");
  EXPECT_STREQ(PMMLModelTags::XML_VEXA_TRANFUNC_ADDITION, "+");
  PMMLModelTags tags, other;
  EXPECT_EQ(&(tags = other), &tags);
}

}  // namespace
