#include "plugins/regression/LinkFunctions.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>

#include "kestrel/foundation/NumberText.h"
#include "tests/support/PlainTable.h"

namespace {

using namespace MCKestrel_800;

double ToNumber(const std::string& text) {
  double number = 0.0;
  EXPECT_TRUE(ParseDouble(text.data(), text.data() + text.size(), number)) << text;
  return number;
}

// The reference values were computed with 60 digits (400 for differences) by make_links.py beside the table.
TEST(LinkFunctions, AgreeWithReferenceValuesToTwelveDigits) {
  const kestrel_tests::PlainTable table =
      kestrel_tests::ReadPlainTable(KESTREL_SOURCE_DIR "/tests/data/regression/links.csv");
  ASSERT_GT(table.rows.size(), 1000u);
  for (const std::vector<std::string>& row : table.rows) {
    Normalization method;
    ASSERT_TRUE(FindNormalization(row[0], method)) << row[0];
    const double low = ToNumber(row[2]);
    const double high = ToNumber(row[3]);
    const double expected = ToNumber(row[4]);
    const double actual = row[1] == "below"   ? LinkBelow(method, low)
                          : row[1] == "above" ? LinkAbove(method, low)
                                              : LinkBetween(method, low, high);
    EXPECT_NEAR(actual, expected, 1e-12 * std::fabs(expected))
        << row[0] << " " << row[1] << " " << row[2] << " " << row[3];
  }
}

TEST(LinkFunctions, ExtremeArgumentsGiveTheLimits) {
  for (const Normalization method : {Normalization::kLogit, Normalization::kProbit, Normalization::kCloglog,
                                     Normalization::kLoglog, Normalization::kCauchit}) {
    SCOPED_TRACE(NormalizationText(method));
    EXPECT_EQ(LinkBelow(method, 1e300), 1.0);
    EXPECT_NEAR(LinkBelow(method, -1e300), 0.0, 1e-300);
    EXPECT_EQ(LinkAbove(method, -1e300), 1.0);
    EXPECT_NEAR(LinkAbove(method, 1e300), 0.0, 1e-300);
    EXPECT_EQ(LinkBetween(method, -1e300, 1e300), 1.0);
    EXPECT_EQ(LinkBetween(method, 0.5, 0.5), 0.0);
    EXPECT_EQ(LinkBetween(method, 1e300, 1e300), 0.0);
    EXPECT_EQ(LinkBetween(method, -1e300, -1e300), 0.0);
    EXPECT_DOUBLE_EQ(LinkBetween(method, 1.0, 0.25), -LinkBetween(method, 0.25, 1.0));
  }
}

TEST(LinkFunctions, OtherMethodsHaveNone) {
  for (const Normalization method :
       {Normalization::kSoftmax, Normalization::kSimplemax, Normalization::kExp}) {
    EXPECT_FALSE(IsCumulative(method));
    EXPECT_TRUE(std::isnan(LinkBelow(method, 1.0)));
    EXPECT_TRUE(std::isnan(LinkAbove(method, 1.0)));
    EXPECT_TRUE(std::isnan(LinkBetween(method, 0.0, 1.0)));
  }
}

TEST(Normalization, NamesAreExact) {
  Normalization method = Normalization::kExp;
  for (const char* text :
       {"none", "simplemax", "softmax", "logit", "probit", "cloglog", "exp", "loglog", "cauchit"}) {
    ASSERT_TRUE(FindNormalization(text, method)) << text;
    EXPECT_STREQ(NormalizationText(method), text);
  }
  method = Normalization::kExp;
  for (const char* text : {"", "None", "logit ", "identity"}) {
    EXPECT_FALSE(FindNormalization(text, method)) << text;
    EXPECT_EQ(method, Normalization::kExp);
  }
}

}  // namespace
