// Tests of the process's environment and C locale.

#include "kestrel/platform/Environment.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>

namespace {

using namespace MCKestrel_800;

TEST(Environment, TakesVariablesOverWhatTheyWere) {
  const std::string name = "KESTREL_TEST_VARIABLE";
  ASSERT_EQ(std::getenv(name.c_str()), nullptr);
  EXPECT_TRUE(SetEnvironmentVariableText(name, "one"));
  EXPECT_STREQ(std::getenv(name.c_str()), "one");
  EXPECT_TRUE(SetEnvironmentVariableText(name, "two = 2"));
  EXPECT_STREQ(std::getenv(name.c_str()), "two = 2");
  EXPECT_FALSE(SetEnvironmentVariableText("", "x")) << "a variable has a name";
}

/// Leaves the process in the C locale.
class EnvironmentLocale : public testing::Test {
 protected:
  ~EnvironmentLocale() override { SetLocaleByName("C"); }
};

TEST_F(EnvironmentLocale, IsSetByName) {
  ASSERT_TRUE(SetLocaleByName("C"));
  EXPECT_EQ(CharacterLocaleName(), "C");
  EXPECT_FALSE(SetLocaleByName("no such locale"));
  EXPECT_EQ(CharacterLocaleName(), "C") << "one that is not known changes nothing";
}

TEST_F(EnvironmentLocale, IsTakenFromTheEnvironment) {
  if (!NarrowTextIsUtf8ByDefault()) GTEST_SKIP() << "the system has locales that no variable names";
  ASSERT_TRUE(SetEnvironmentVariableText("LC_ALL", "C"));
  EXPECT_TRUE(SetLocaleFromEnvironment());
  EXPECT_EQ(CharacterLocaleName(), "C");
  ASSERT_TRUE(SetEnvironmentVariableText("LC_ALL", "no such locale"));
  EXPECT_FALSE(SetLocaleFromEnvironment());
  EXPECT_EQ(CharacterLocaleName(), "C");
  ASSERT_TRUE(SetEnvironmentVariableText("LC_ALL", "C"));
}

TEST(Environment, NamesTheCodePage) {
  EXPECT_NE(CodePageName(), "");
  EXPECT_EQ(NarrowTextIsUtf8ByDefault(), CodePageNumber() == 0)
      << "where code pages have no numbers, text is UTF-8";
}

}  // namespace
