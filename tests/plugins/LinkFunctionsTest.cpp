#include "plugins/regression/LinkFunctions.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
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

TEST(LinkFunctions, ExpHasNoUpperLimit) {
  constexpr Normalization kExp = Normalization::kExp;
  EXPECT_TRUE(IsCumulative(kExp));
  EXPECT_EQ(LinkBelow(kExp, -1e300), 0.0);
  EXPECT_EQ(LinkAbove(kExp, -1e300), 1.0);
  EXPECT_TRUE(std::isinf(LinkBelow(kExp, 1e300)));
  EXPECT_TRUE(std::isinf(LinkAbove(kExp, 1e300)));
  EXPECT_EQ(LinkBetween(kExp, -1e300, 0.0), 1.0);
  EXPECT_EQ(LinkBetween(kExp, 0.0, -1e300), -1.0);
  EXPECT_EQ(LinkBetween(kExp, 1e300, 1e300), 0.0);
  EXPECT_TRUE(std::isinf(LinkBetween(kExp, 0.0, 1e300)));
}

// The reference values come from make_links.py beside the table.
TEST(LinkFunctions, SharesAgreeWithReferenceValuesToTwelveDigits) {
  const kestrel_tests::PlainTable table =
      kestrel_tests::ReadPlainTable(KESTREL_SOURCE_DIR "/tests/data/regression/shares.csv");
  ASSERT_GT(table.rows.size(), 200u);
  for (const std::vector<std::string>& row : table.rows) {
    Normalization method;
    ASSERT_TRUE(FindNormalization(row[0], method)) << row[0];
    const double values[] = {ToNumber(row[1]), ToNumber(row[2]), ToNumber(row[3])};
    double shares[3];
    LinkShares(method, values, 3, shares);
    for (int j = 0; j < 3; ++j) {
      const double expected = ToNumber(row[4 + j]);
      // The table has 0 for what is below 1e-100.
      EXPECT_NEAR(shares[j], expected, std::max(1e-12 * expected, 1.01e-100))
          << row[0] << " " << row[1] << " " << row[2] << " " << row[3];
    }
  }
}

TEST(LinkFunctions, SharesOfExtremeArguments) {
  constexpr double kLow = -std::numeric_limits<double>::max();
  for (const Normalization method : {Normalization::kLogit, Normalization::kProbit, Normalization::kCloglog,
                                     Normalization::kLoglog, Normalization::kExp}) {
    SCOPED_TRACE(NormalizationText(method));
    const double values[] = {kLow, -1e300, -1e300, 0.5 * kLow};
    double shares[4];
    LinkShares(method, values, 4, shares);
    EXPECT_EQ(shares[0], 0.0);
    EXPECT_EQ(shares[1], 0.5);
    EXPECT_EQ(shares[2], 0.5);
    EXPECT_EQ(shares[3], 0.0);
    LinkShares(method, values, 1, shares);
    EXPECT_EQ(shares[0], 1.0);
  }
  // Its F falls like 1 / y.
  const double values[] = {kLow, 0.25 * kLow};
  double shares[2];
  LinkShares(Normalization::kCauchit, values, 2, shares);
  EXPECT_DOUBLE_EQ(shares[0], 0.2);
  EXPECT_DOUBLE_EQ(shares[1], 0.8);
}

TEST(LinkFunctions, OtherMethodsHaveNone) {
  for (const Normalization method : {Normalization::kSoftmax, Normalization::kSimplemax}) {
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
