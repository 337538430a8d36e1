// The ScoreDistribution children of a node.

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/translate/LeafNodeStats.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "tests/support/DictionaryText.h"

namespace {

using kestrel_test::ReadTree;
using namespace MCKestrel_800;

constexpr double kAbsent = NumericValue::gSysmisValue;

void Read(const std::string& children, std::vector<LeafNodeStats>& stats) {
  const auto tree = ReadTree("<Node>\n" + children + "</Node>");
  PMMLTranslator::SetLeafNodeStats(tree->GetRoot(), stats);
}

TEST(LeafNodeStats, AreReadInTheirOrder) {
  std::vector<LeafNodeStats> stats;
  Read(
      "<Extension/><ScoreDistribution value='yes' recordCount='7.5' confidence='1' probability='0.75'/>"
      "<True/><ScoreDistribution value='' recordCount='0' probability='0'/>"
      "<ScoreDistribution value='M\xC3\xA4rz' recordCount=' 2.5e0' confidence='0.25'/>"
      "<Node><ScoreDistribution value='inner' recordCount='1'/></Node>",
      stats);
  ASSERT_EQ(stats.size(), 3u);
  EXPECT_EQ(stats[0].value, "yes");
  EXPECT_EQ(stats[0].record_count, 7.5);
  EXPECT_EQ(stats[0].confidence, 1.0);
  EXPECT_EQ(stats[0].probability, 0.75);
  EXPECT_EQ(stats[1].value, "");
  EXPECT_EQ(stats[1].record_count, 0.0);
  EXPECT_EQ(stats[1].confidence, kAbsent);
  EXPECT_EQ(stats[1].probability, 0.0);
  EXPECT_EQ(stats[2].value, "M\xC3\xA4rz");
  EXPECT_EQ(stats[2].record_count, 2.5);
  EXPECT_EQ(stats[2].confidence, 0.25);
  EXPECT_EQ(stats[2].probability, kAbsent);
}

TEST(LeafNodeStats, ReplaceWhatWasThereInItsMemory) {
  std::vector<LeafNodeStats> stats;
  const std::string text(200, 'x');
  Read("<ScoreDistribution value='" + text + "' recordCount='1' confidence='0.5' probability='0.5'/>" +
           "<ScoreDistribution value='b' recordCount='2'/>",
       stats);
  const LeafNodeStats* const first = stats.data();
  const char* const letters = stats[0].value.data();
  Read("<ScoreDistribution value='c' recordCount='3'/>", stats);
  ASSERT_EQ(stats.size(), 1u);
  EXPECT_EQ(stats[0].value, "c");
  EXPECT_EQ(stats[0].record_count, 3.0);
  EXPECT_EQ(stats[0].confidence, kAbsent) << "nothing of the one before is left";
  EXPECT_EQ(stats[0].probability, kAbsent);
  EXPECT_EQ(stats.data(), first);
  EXPECT_EQ(stats[0].value.data(), letters);
  Read("", stats);
  EXPECT_TRUE(stats.empty());
  PMMLTranslator::SetLeafNodeStats(nullptr, stats);
  EXPECT_TRUE(stats.empty());
}

struct FaultRow {
  const char* why;
  const char* attributes;
  int code;
  const char* text;
};

constexpr FaultRow kFaults[] = {
    {"no value", "recordCount='1'", 4, "Attribute value is missing from Node \"ScoreDistribution\""},
    {"no count", "value='a'", 4, "Attribute recordCount is missing from Node \"ScoreDistribution\""},
    {"a count that is no number", "value='a' recordCount='many'", 3, "manyInvalid double string -- "},
    {"an empty count", "value='a' recordCount=''", 3, "Invalid double string -- "},
    {"a count that is not a number", "value='a' recordCount='NaN'", 3, "NaNInvalid double string -- "},
    {"a negative count", "value='a' recordCount='-1'", 6, "ScoreDistribution: invalid recordCount -- -1"},
    {"an infinite count", "value='a' recordCount='1e999'", 6,
     "ScoreDistribution: invalid recordCount -- 1e999"},
    {"the missing number as a count", "value='a' recordCount='-1.7976931348623157e308'", 6,
     "ScoreDistribution: invalid recordCount -- -1.7976931348623157e308"},
    {"a confidence that is no number", "value='a' recordCount='1' confidence='high'", 3,
     "highInvalid double string -- "},
    {"a negative confidence", "value='a' recordCount='1' confidence='-0.5'", 6,
     "ScoreDistribution: invalid confidence -- -0.5"},
    {"a confidence above 1", "value='a' recordCount='1' confidence='1.5'", 6,
     "ScoreDistribution: invalid confidence -- 1.5"},
    {"a probability that is no number", "value='a' recordCount='1' probability='50%'", 3,
     "50%Invalid double string -- "},
    {"a negative probability", "value='a' recordCount='1' probability='-1e-9'", 6,
     "ScoreDistribution: invalid probability -- -1e-9"},
    {"a probability above 1", "value='a' recordCount='1' probability='50'", 6,
     "ScoreDistribution: invalid probability -- 50"},
    {"an infinite probability", "value='a' recordCount='1' probability='1e999'", 6,
     "ScoreDistribution: invalid probability -- 1e999"},
};

TEST(LeafNodeStats, AreRefusedAtTheirPlace) {
  for (const FaultRow& row : kFaults) {
    std::vector<LeafNodeStats> stats;
    try {
      Read(std::string("<ScoreDistribution value='b' recordCount='1'/>\n<ScoreDistribution ") +
               row.attributes + "/>",
           stats);
      ADD_FAILURE() << row.why << ": nothing was thrown";
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetErrorCode(), row.code) << row.why;
      EXPECT_EQ(fault.GetErrorMessage(), row.text) << row.why;
      EXPECT_EQ(fault.GetLine(), 3u) << row.why;
    }
  }
}

}  // namespace
