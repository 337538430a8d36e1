// What the program tells people to write instead of what a document holds.

#include <gtest/gtest.h>

#include <string>

#include "apps/kestrel/DocumentHints.h"

namespace kestrel_tests {
namespace {

struct HintRow {
  int code;
  const char* message;
  const char* hint;  ///< a part of it
};

constexpr HintRow kRows[] = {
    {1, "<Node> has more than one predicate!", "CompoundPredicate"},
    {4, "<Node> has no predicate!", "True"},
    {4, "<SimpleRule> has no predicate!", "True"},
    {4, "<Node> without children has no score!", "ScoreDistribution"},
    {4, "defaultChild is required for missingValueStrategy defaultChild!", "another strategy"},
    {4, "Value list is required!", "Value elements"},
    {6, "invalid missingValueStrategy -- skip", "weightedConfidence or aggregateNodes"},
    {6, "invalid missingValuePenalty -- 2", "from 0 to 1"},
    {6, "invalid noTrueChildStrategy -- skip", "returnLastPrediction"},
    {6, "invalid splitCharacteristic -- 2", "multiSplit"},
    {6, "invalid defaultChild -- 9", "id of a Node"},
    {6, "invalid criterion -- last", "firstHit, weightedMax or weightedSum"},
    {6, "invalid recordCount -- -1", "not negative"},
    {6, "ScoreDistribution: invalid recordCount -- -1", "not negative"},
    {6, "ScoreDistribution: invalid probability -- 2", "from 0 to 1"},
    {6, "invalid normalizationMethod -- x", "cauchit"},
    {8, "age: Invalid Split Variable!", "DataField"},
};

TEST(DocumentHints, SayWhatWouldBeAccepted) {
  for (const HintRow& row : kRows) {
    const std::string hint = kestrel_program::HintForFault(row.code, row.message);
    EXPECT_NE(hint.find(row.hint), std::string::npos) << row.message << "\n" << hint;
  }
}

TEST(DocumentHints, AreThereForEveryCodeThatIsRaised) {
  for (const int code : {1, 2, 3, 4, 5, 6, 7, 8, 9, 11, 12})
    EXPECT_NE(kestrel_program::HintForFault(code, "a message that no row knows"), nullptr) << code;
  EXPECT_EQ(kestrel_program::HintForFault(10, "a message that no row knows"), nullptr) << "never raised";
}

}  // namespace
}  // namespace kestrel_tests
