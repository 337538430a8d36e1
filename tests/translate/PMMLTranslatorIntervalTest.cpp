// Intervals of continuous fields: which values they make missing.

#include <gtest/gtest.h>

#include <limits>
#include <memory>
#include <string>

#include "kestrel/dictionary/MissingValueSet.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "tests/support/DictionaryText.h"

namespace {

using namespace MCKestrel_800;
using kestrel_test::ReadField;
using kestrel_test::ReadTree;

constexpr double kInfinity = std::numeric_limits<double>::infinity();

std::unique_ptr<DictVar> ContinuousField(const std::string& children, const char* dataType = "double") {
  return ReadField(std::string("<DataField name='x' optype='continuous' dataType='") + dataType + "'>" +
                   children + "</DataField>");
}

bool IsMissing(const DictVar& variable, double number) {
  const NumericValue value(number);
  return variable.IsMissingValue(&value);
}

struct ClosureRow {
  const char* closure;  ///< the attribute's text; null leaves it out
  bool leftInside;
  bool rightInside;
};

constexpr ClosureRow kClosures[] = {
    {"closedClosed", true, true}, {"closedOpen", true, false},    {"openClosed", false, true},
    {"openOpen", false, false},   {"ClosedClosed", false, false}, {"", false, false},
    {nullptr, false, false},
};

std::string Interval(const char* closure, const char* left, const char* right) {
  std::string text = "<Interval";
  if (closure != nullptr) text += std::string(" closure='") + closure + "'";
  if (left != nullptr) text += std::string(" leftMargin='") + left + "'";
  if (right != nullptr) text += std::string(" rightMargin='") + right + "'";
  return text + "/>";
}

TEST(PMMLTranslatorIntervals, MakeWhatLiesOutsideMissing) {
  for (const ClosureRow& row : kClosures) {
    const std::string why = row.closure != nullptr ? row.closure : "no closure";
    const auto both = ContinuousField(Interval(row.closure, "-2.5", "10"));
    EXPECT_EQ(IsMissing(*both, -2.5), !row.leftInside) << why;
    EXPECT_EQ(IsMissing(*both, 10.0), !row.rightInside) << why;
    EXPECT_FALSE(IsMissing(*both, -2.4999)) << why;
    EXPECT_FALSE(IsMissing(*both, 9.9999)) << why;
    EXPECT_TRUE(IsMissing(*both, -2.5001)) << why;
    EXPECT_TRUE(IsMissing(*both, 10.0001)) << why;
    EXPECT_TRUE(IsMissing(*both, -1e300)) << why;
    EXPECT_TRUE(IsMissing(*both, 1e300)) << why;
    EXPECT_EQ(both->GetMissingValues()->Size(), 2u) << why;

    const auto left = ContinuousField(Interval(row.closure, "0", nullptr));
    EXPECT_EQ(IsMissing(*left, 0.0), !row.leftInside) << why;
    EXPECT_TRUE(IsMissing(*left, -0.001)) << why;
    EXPECT_FALSE(IsMissing(*left, 1e300)) << why;
    EXPECT_EQ(left->GetMissingValues()->Size(), 1u) << why;

    const auto right = ContinuousField(Interval(row.closure, "", "0"));
    EXPECT_EQ(IsMissing(*right, 0.0), !row.rightInside) << why;
    EXPECT_TRUE(IsMissing(*right, 0.001)) << why;
    EXPECT_FALSE(IsMissing(*right, -1e300)) << why;
    EXPECT_EQ(right->GetMissingValues()->Size(), 1u) << why;

    const auto none = ContinuousField(Interval(row.closure, nullptr, nullptr));
    EXPECT_FALSE(IsMissing(*none, 0.0)) << why;
    EXPECT_FALSE(IsMissing(*none, 1e308)) << why;
    EXPECT_EQ(none->GetMissingValues()->Size(), 0u) << why;
  }
}

TEST(PMMLTranslatorIntervals, AreAskedBesideSingleValues) {
  const auto variable = ContinuousField("<Value value='5' property='missing'/>" +
                                        Interval("closedClosed", "0", "10") + "<Value value='12'/>");
  EXPECT_TRUE(IsMissing(*variable, 5.0));
  EXPECT_FALSE(IsMissing(*variable, 6.0));
  EXPECT_TRUE(IsMissing(*variable, 11.0));
  EXPECT_FALSE(IsMissing(*variable, 12.0)) << "a valid value outside the interval stands";
}

TEST(PMMLTranslatorIntervals, ThatAreEmptyMakeEverythingMissing) {
  const auto variable = ContinuousField(Interval("closedClosed", "10", "-10"));
  EXPECT_TRUE(IsMissing(*variable, 0.0));
  EXPECT_TRUE(IsMissing(*variable, 100.0));
}

TEST(PMMLTranslatorIntervals, LeaveInfinityAlone) {
  const auto valid = ContinuousField(Interval("closedClosed", "0", "10"));
  const auto invalid = ContinuousField("<Extension name='invalidRangeLower' value='99'/>");
  EXPECT_FALSE(IsMissing(*valid, kInfinity)) << "an infinity lies in no range";
  EXPECT_FALSE(IsMissing(*invalid, kInfinity)) << "nor equals the end of one";
  EXPECT_FALSE(IsMissing(*valid, -kInfinity));
  EXPECT_TRUE(IsMissing(*valid, std::numeric_limits<double>::max())) << "the largest number does";
}

TEST(PMMLTranslatorIntervals, AreOfNumbersAlone) {
  const auto variable = ContinuousField(Interval("closedClosed", "0", "10"), "date");
  const DateTimeValue outside(100.0, kDate);
  EXPECT_FALSE(variable->IsMissingValue(&outside)) << "the ranges hold numbers, and a date is none";
}

TEST(PMMLTranslatorIntervals, CanBeReadOnTheirOwn) {
  const auto tree = ReadTree(Interval("closedOpen", "1", "2"));
  MissingValueSet set;
  DictVar variable("x", ScoreDictVar::kNUMERIC_VAR);
  PMMLTranslator::handleInterval(&variable, tree->GetRoot(), &set, 0);
  ASSERT_EQ(set.Size(), 2u);
  const auto ranges = set.GetMissingValues();
  EXPECT_EQ(ranges[0]->GetMin()->GetDouble(), -kInfinity);
  EXPECT_EQ(ranges[0]->GetMax()->GetDouble(), 1.0);
  EXPECT_FALSE(ranges[0]->GetHighEnd());
  EXPECT_EQ(ranges[1]->GetMin()->GetDouble(), 2.0);
  EXPECT_EQ(ranges[1]->GetMax()->GetDouble(), kInfinity);
  EXPECT_TRUE(ranges[1]->GetLowEnd());

  PMMLTranslator::handleInterval(&variable, nullptr, &set, 0);
  PMMLTranslator::handleInterval(&variable, tree->GetRoot(), nullptr, 0);
  EXPECT_EQ(set.Size(), 2u);
}

struct BoundsRow {
  const char* why;
  const char* lower;
  const char* upper;
  double missing[3];
  double present[3];
};

constexpr BoundsRow kBounds[] = {
    {"a lower bound alone", "99", nullptr, {99, 150, 1e300}, {98.99, 0, -1e300}},
    {"an upper bound alone", nullptr, "-1", {-1, -2, -1e300}, {-0.99, 0, 1e300}},
    {"both bounds", "7", "9", {7, 8, 9}, {6.99, 9.01, 0}},
    {"both bounds the same", "7", "7", {7, 7, 7}, {6.99, 7.01, 0}},
    {"both bounds in the wrong order hold their ends alone", "9", "7", {9, 7, 9}, {8, 6, 10}},
};

TEST(PMMLTranslatorIntervals, OfProducersMakeWhatLiesInsideMissing) {
  for (const BoundsRow& row : kBounds) {
    std::string extensions;
    if (row.upper != nullptr) {
      extensions += std::string("<Extension name='invalidRangeUpper' value='") + row.upper + "'/>";
    }
    if (row.lower != nullptr) {
      extensions += std::string("<Extension name='invalidRangeLower' value='") + row.lower + "'/>";
    }
    const auto continuous = ContinuousField(extensions);
    const auto ordinal =
        ReadField("<DataField name='x' optype='ordinal' dataType='double'>" + extensions + "</DataField>");
    for (const DictVar* variable : {continuous.get(), ordinal.get()}) {
      for (const double number : row.missing)
        EXPECT_TRUE(IsMissing(*variable, number)) << row.why << ' ' << number;
      for (const double number : row.present)
        EXPECT_FALSE(IsMissing(*variable, number)) << row.why << ' ' << number;
    }
  }
}

TEST(PMMLTranslatorIntervals, OfProducersAreAddedByTheOperationItself) {
  MissingValueSet set;
  EXPECT_FALSE(PMMLTranslator::HandleVEXAMissingInterval(&set, 0, 1.0, 2.0));
  EXPECT_EQ(set.Size(), 0u);
  for (const int flags : {1, 10, 11}) {
    MissingValueSet one;
    EXPECT_TRUE(PMMLTranslator::HandleVEXAMissingInterval(&one, flags, 1.0, 2.0));
    EXPECT_TRUE(PMMLTranslator::HandleVEXAMissingInterval(&one, flags, 1.0, 2.0))
        << "held already, and not leaked";
    ASSERT_EQ(one.Size(), 1u) << flags;
    EXPECT_EQ(one.GetMissingValues()[0]->GetMin()->GetDouble(), 1.0);
    EXPECT_EQ(one.GetMissingValues()[0]->GetMax()->GetDouble(), 2.0);
    EXPECT_TRUE(one.GetMissingValues()[0]->GetLowEnd());
    EXPECT_TRUE(one.GetMissingValues()[0]->GetHighEnd());
  }
  EXPECT_FALSE(PMMLTranslator::HandleVEXAMissingInterval(nullptr, 1, 1.0, 2.0));
}

TEST(PMMLTranslatorIntervals, InsideXDataFieldAreMissingThemselves) {
  for (const ClosureRow& row : kClosures) {
    const std::string why = row.closure != nullptr ? row.closure : "no closure";
    const auto both = ContinuousField("<X-DataField>" + Interval(row.closure, "20", "30") + "</X-DataField>");
    EXPECT_EQ(IsMissing(*both, 20.0), row.leftInside) << why;
    EXPECT_EQ(IsMissing(*both, 30.0), row.rightInside) << why;
    EXPECT_TRUE(IsMissing(*both, 25.0)) << why;
    EXPECT_FALSE(IsMissing(*both, 19.99)) << why;
    EXPECT_FALSE(IsMissing(*both, 30.01)) << why;

    const auto left = ContinuousField("<X-DataField>" + Interval(row.closure, "20", "") + "</X-DataField>");
    EXPECT_EQ(IsMissing(*left, 20.0), row.leftInside) << why;
    EXPECT_TRUE(IsMissing(*left, 1e300)) << why;
    EXPECT_FALSE(IsMissing(*left, 19.0)) << why;

    const auto right =
        ContinuousField("<X-DataField>" + Interval(row.closure, nullptr, "20") + "</X-DataField>");
    EXPECT_EQ(IsMissing(*right, 20.0), row.rightInside) << why;
    EXPECT_TRUE(IsMissing(*right, -1e300)) << why;
    EXPECT_FALSE(IsMissing(*right, 21.0)) << why;
  }
}

TEST(PMMLTranslatorIntervals, InsideXDataFieldAreItsFirstChildAlone) {
  const auto first = ContinuousField("<X-DataField> text " + Interval("closedClosed", "1", "2") +
                                     Interval("closedClosed", "3", "4") + "</X-DataField>");
  EXPECT_TRUE(IsMissing(*first, 1.5));
  EXPECT_FALSE(IsMissing(*first, 3.5));
  const auto none = ContinuousField("<X-DataField/>");
  EXPECT_EQ(none->GetMissingValues()->Size(), 0u);
  const auto several =
      ContinuousField("<X-DataField>" + Interval("closedClosed", "1", "2") + "</X-DataField>" +
                      "<X-DataField>" + Interval("closedClosed", "3", "4") + "</X-DataField>");
  EXPECT_TRUE(IsMissing(*several, 1.5));
  EXPECT_TRUE(IsMissing(*several, 3.5));
}

TEST(PMMLTranslatorIntervals, OfEveryElementCanBeReadOnTheirOwn) {
  const auto tree = ReadTree("<ScaleInterval leftMargin='1' closure='openClosed'/>");
  MissingValueSet set;
  PMMLTranslator::handleTreeInterval(tree->GetRoot(), &set);
  ASSERT_EQ(set.Size(), 1u);
  const ScoreValueRange* range = set.GetMissingValues()[0];
  EXPECT_EQ(range->GetMin()->GetDouble(), 1.0);
  EXPECT_EQ(range->GetMax()->GetDouble(), kInfinity);
  EXPECT_FALSE(range->GetLowEnd());
  EXPECT_TRUE(range->GetHighEnd());
  PMMLTranslator::handleTreeInterval(nullptr, &set);
  PMMLTranslator::handleTreeInterval(tree->GetRoot(), nullptr);
  EXPECT_EQ(set.Size(), 1u);
}

}  // namespace
