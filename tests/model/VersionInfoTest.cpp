// Tests of a model's version text.

#include "kestrel/model/VersionInfo.h"

#include <gtest/gtest.h>

#include <memory>

namespace {

using namespace MCKestrel_800;

TEST(VersionInfo, ReportsTheStandardVersionUnlessGivenAnother) {
  EXPECT_EQ(VersionInfo().GetVersionInfo(), "2.1");
  EXPECT_EQ(VersionInfo("4.4").GetVersionInfo(), "4.4");
  EXPECT_EQ(VersionInfo("").GetVersionInfo(), "");
  VersionInfo version;
  version.SetVersionInfo("3.0");
  EXPECT_EQ(version.GetVersionInfo(), "3.0");
}

TEST(VersionInfo, ComparesTextsExactly) {
  const VersionInfo version("2.1");
  const ScoreVersionInfo& general = version;
  EXPECT_TRUE(general == VersionInfo());
  EXPECT_FALSE(general == VersionInfo("2.10"));
  EXPECT_FALSE(general == VersionInfo("2.1 "));
  EXPECT_FALSE(general == VersionInfo(""));
  const ScoreVersionInfo* same = &general;
  const ScoreVersionInfo* none = nullptr;
  EXPECT_TRUE(version == same);
  EXPECT_FALSE(version == none);
}

TEST(VersionInfo, CopiesItsText) {
  VersionInfo first("3.2");
  VersionInfo copy(first);
  VersionInfo assigned;
  assigned = first;
  const std::unique_ptr<ScoreVersionInfo> clone(first.Clone());
  first.SetVersionInfo("changed");
  EXPECT_EQ(copy.GetVersionInfo(), "3.2");
  EXPECT_EQ(assigned.GetVersionInfo(), "3.2");
  EXPECT_EQ(clone->GetVersionInfo(), "3.2");
}

}  // namespace
