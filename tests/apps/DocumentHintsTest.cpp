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
    {1, "Invalid EXPRESSION", "NormContinuous"},
    {1, "Only one EXPRESSION is allowed", "one expression"},
    {1, "d: Redefinition!", "name of its own"},
    {1, "x: must predefined as continuous type", "optype"},
    {1, "x: not predefined!", "stands before"},
    {1, "At least two <LinearNorm>s are required!!", "two points"},
    {1, "Element <FieldColumnPair> should defined before!", "before the InlineTable"},
    {1, "No Element Found from MapValues!!!", "and then an InlineTable"},
    {1, "Child element a is not found in <Row>!", "outputColumn"},
    {1, "In valid closure value in <InterVal>.", "openOpen"},
    {1, "At least one margin must be defined.", "leftMargin"},
    {1, "Only disjoint value range is allowed", "overlap"},
    {1, "Element Interval is required", "DiscretizeBin"},
    {1, "ONLY one <Interval> is allowed.", "DiscretizeBin"},
    {4, "Constant value is required!", "between the tags"},
    {5, "Sqrt: not Supported function name", "case count"},
    {5, "d: not Supported outlier handle method", "asExtremeValues"},
    {5, "x: not predefined!", "stands before"},
    {5, "defaultValue value is defined already!!", "remove one"},
    {6, "Two parameters are required!", "how many arguments"},
    {6, "PMML error for IMPUTECATFIELDMISSINGAGAINSTCONTARGET", "variances"},
    {6, "Only <FieldRef> is allowed for function value!", "FieldRef"},
    {6, "Numeric function is required!", "outer one"},
    {6, "apply functions don't match!", "outer one"},
    {6, "Variable type doesn't match!", "take numbers"},
    {8, "x: not predefined", "stands before"},
    {8, "d: has to have the same type as x", "mapMissingTo"},
    {1, "field: should be variable", "variable elements"},
    {1, "value: should be category", "category elements"},
    {4, "category is required in range element node!!", "two category elements"},
    {5, "<Tree>: models of the older document format are not supported!", "as PMML"},
    {6, "category values are required!!!", "not empty"},
    {6, "Missing Value and Valid value intersect", "not both"},
    {6, "Dicitonary is empty!!", "variable elements"},
    {7, "Varname or storage type can't be null!!", "storage-type"},
    {7, "Measurement-level can't be null!!", "ORDINAL"},
    {7, "category value is null!!", "not empty"},
    {7, "category value is required!!", "not empty"},
    {8, "x is duplicated!!!", "every variable"},
    {11, "Invalid measurement-level attribute!!", "upper case"},
    {11, "VEXATranslator::parseDictionary():Continuous variable should be numeric!!", "NOMINAL"},
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
