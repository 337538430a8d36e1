// What derived fields may hold: attributes, extensions and the borders of what is accepted.

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/predicates/ScoreValueRange.h"
#include "kestrel/transform/FunctionTree.h"
#include "kestrel/transform/ValueMatcher.h"
#include "tests/support/DerivedText.h"
#include "tests/support/ExpectFault.h"

namespace {

using kestrel_test::DerivedDocument;
using kestrel_test::DerivedField;
using kestrel_test::DerivedFields;
using kestrel_test::kCategory;
using kestrel_test::kNumber;
using kestrel_test::ReadDerivedDocument;
using kestrel_test::ReadDerivedField;
using kestrel_test::ReadTree;
using namespace MCKestrel_800;

std::string TextOf(const ScoreValue* value) {
  return value != nullptr ? value->GetString() : "none";
}

std::string RangeText(const ScoreValueRange& range) {
  return (range.GetLowEnd() ? "[" : "(") + TextOf(range.GetMin()) + ", " + TextOf(range.GetMax()) +
         (range.GetHighEnd() ? "]" : ")");
}

struct TypeRow {
  const char* type;
  ScoreDictVar::VariableType variable;
  ScoreDictVar::NumericDataType number;
  DateTimeType date;
};

TEST(DerivedFieldRules, TypesAreThoseOfDataFields) {
  const TypeRow rows[] = {
      {"integer", ScoreDictVar::kNUMERIC_VAR, ScoreDictVar::kInteger, kNoDateTime},
      {"double", ScoreDictVar::kNUMERIC_VAR, ScoreDictVar::kDouble, kNoDateTime},
      {"boolean", ScoreDictVar::kNUMERIC_VAR, ScoreDictVar::kUnspecified, kNoDateTime},
      {"", ScoreDictVar::kNUMERIC_VAR, ScoreDictVar::kUnspecified, kNoDateTime},
      {"string", ScoreDictVar::STRING_VAR, ScoreDictVar::kUnspecified, kNoDateTime},
      {"date", ScoreDictVar::kDATETIME_VAR, ScoreDictVar::kUnspecified, kDate},
      {"dateTimeSecondsSince[1960]", ScoreDictVar::kDATETIME_VAR, ScoreDictVar::kUnspecified,
       kDateTimeSecondsSince1960},
  };
  for (const TypeRow& row : rows) {
    const std::string type = "optype='categorical' dataType='" + std::string(row.type) + "'";
    const DerivedFields fields = ReadDerivedField(type, "<FieldRef field='color'/>");
    const TransformVar& d = *fields.Get("d");
    EXPECT_EQ(d.GetVarType(), row.variable) << row.type;
    EXPECT_EQ(d.GetNumericDataType(), row.number) << row.type;
    if (row.variable == ScoreDictVar::kDATETIME_VAR) {
      EXPECT_EQ(d.GetDateTimeType(), row.date) << row.type;
    }
  }
}

TEST(DerivedFieldRules, LevelsAndAttributesReachTheField) {
  const DerivedFields fields = ReadDerivedDocument(
      DerivedDocument("<DerivedField name='a' displayName='A b' optype='ordinal' dataType='string' width='3'>"
                      "<Constant>w</Constant></DerivedField>"
                      "<DerivedField name='b' optype='categorical' dataType='string'>"
                      "<Extension name='stringLength' value='5'/><Constant>w</Constant>"
                      "<Extension name='u'><UsageType value='disable'/></Extension></DerivedField>"
                      "<DerivedField name='c' optype='continuous'><Constant>1</Constant>"
                      "<Extension name='width' value='5'/></DerivedField>"));
  EXPECT_EQ(fields.Get("a")->GetMLevel(), ScoreDictVar::kOrdinal);
  EXPECT_EQ(fields.Get("a")->GetLabel(), "A b");
  EXPECT_EQ(fields.Get("a")->GetWidth(), 3);
  EXPECT_TRUE(fields.Get("a")->IsUsageTypeEnable());
  EXPECT_EQ(fields.Get("b")->GetMLevel(), ScoreDictVar::kNominal);
  EXPECT_EQ(fields.Get("b")->GetWidth(), 5);
  EXPECT_FALSE(fields.Get("b")->IsUsageTypeEnable());
  EXPECT_EQ(fields.Get("c")->GetMLevel(), ScoreDictVar::kContinuous);
  EXPECT_EQ(fields.Get("c")->GetWidth(), -1) << "of a text alone";
}

TEST(DerivedFieldRules, ValuesBecomeLabelsAndMissingValues) {
  const char* const lists[] = {
      "<Value value='b' displayValue='Bee'/><Value value='a' property='valid'/><Value value='b'/>"
      "<Value value='z' property='missing'/><Value value='q' property='invalid'/>",
      "<Extension name='DerivedFields'><Value value='b' displayValue='Bee'/><Value value='a'/></Extension>"
      "<Extension name='MissingValues'><Value value='z'/><Value value='q'/><Extension "
      "name='other'/></Extension>",
  };
  for (const char* list : lists) {
    const DerivedFields fields = ReadDerivedField(kCategory, std::string("<FieldRef field='free'/>") + list);
    const TransformVar& d = *fields.Get("d");
    ASSERT_NE(d.GetValueLabels(), nullptr) << list;
    ASSERT_EQ(d.GetValueLabels()->Size(), 2u) << list;
    EXPECT_EQ(TextOf(d.GetValueLabels()->GetAllValueLabels()[0]->GetValue()), "b");
    const StringValue b("b"), z("z"), q("q"), other("c");
    EXPECT_EQ(d.GetLabelOfValue(&b), "Bee");
    EXPECT_TRUE(d.IsMissingValue(&z) && d.IsMissingValue(&q)) << list;
    EXPECT_TRUE(d.IsValidValue(&b)) << list;
    EXPECT_FALSE(d.IsValidValue(&other)) << list;
    ASSERT_NE(d.GetEncoder(), nullptr);
    EXPECT_EQ(d.GetEncoder()->EncodeConst(&b), 0);
  }
}

TEST(DerivedFieldRules, TheInvalidRangeIsMissing) {
  const DerivedFields fields = ReadDerivedField(
      kNumber,
      "<Extension name='MissingValues'><Value value='7'/><Extension name='invalidRangeLower' value='90'/>"
      "<Extension name='invalidRangeUpper' value='99'/></Extension><FieldRef field='x'/>");
  for (const auto& [number, is_missing] :
       std::vector<std::pair<double, bool>>{{7, true}, {8, false}, {90, true}, {99, true}, {100, false}}) {
    const NumericValue value(number);
    EXPECT_EQ(fields.Get("d")->IsMissingValue(&value), is_missing) << number;
  }
}

struct SegmentRow {
  const char* why;
  const char* points;
  std::vector<double> slopes;
  std::vector<double> intercepts;
};

TEST(DerivedFieldRules, SegmentsLeadFromPointToPoint) {
  const SegmentRow rows[] = {
      {"two points", "<LinearNorm orig='0' norm='1'/><LinearNorm orig='2' norm='5'/>", {2}, {1}},
      {"a jump", "<LinearNorm orig='1' norm='0'/><LinearNorm orig='1' norm='9'/>", {1}, {0}},
      {"backwards", "<LinearNorm orig='2' norm='5'/><LinearNorm orig='0' norm='1'/>", {2}, {1}},
      {"with an extension",
       "<LinearNorm orig='0' norm='0'/><Extension/><LinearNorm orig='4' norm='-2'/>"
       "<LinearNorm orig='8' norm='-2'/>",
       {-0.5, 0},
       {0, -2}},
  };
  for (const SegmentRow& row : rows) {
    const DerivedFields fields = ReadDerivedField(
        kNumber, "<NormContinuous field='x'>" + std::string(row.points) + "</NormContinuous>");
    EXPECT_EQ(fields.Get("d")->GetSlopes(), row.slopes) << row.why;
    EXPECT_EQ(fields.Get("d")->GetIntercepts(), row.intercepts) << row.why;
    EXPECT_EQ(fields.Get("d")->GetOutlierTreatment(), ScoreDictVar::kAsIs) << row.why;
    EXPECT_EQ(fields.Get("d")->GetRecodeMissValueRep(), nullptr) << row.why;
  }
}

struct BinsRow {
  const char* why;
  const char* first;
  const char* second;
  bool is_accepted;
};

std::string Bin(const std::string& interval) {
  return "<DiscretizeBin binValue='1'><Interval " + interval + "/></DiscretizeBin>";
}

TEST(DerivedFieldRules, BinsMeetButDoNotOverlap) {
  const BinsRow rows[] = {
      {"one in the other", "closure='closedClosed' leftMargin='0' rightMargin='10'",
       "closure='closedClosed' leftMargin='5' rightMargin='20'", false},
      {"the other way round", "closure='closedClosed' leftMargin='5' rightMargin='20'",
       "closure='closedClosed' leftMargin='0' rightMargin='10'", false},
      {"around it", "closure='openOpen' leftMargin='5' rightMargin='6'",
       "closure='openOpen' leftMargin='0' rightMargin='10'", false},
      {"twice the same", "closure='openOpen' leftMargin='5' rightMargin='6'",
       "closure='openOpen' leftMargin='5' rightMargin='6'", false},
      {"both have the margin", "closure='closedClosed' leftMargin='0' rightMargin='10'",
       "closure='closedOpen' leftMargin='10' rightMargin='20'", false},
      {"one has the margin", "closure='closedOpen' leftMargin='0' rightMargin='10'",
       "closure='closedOpen' leftMargin='10' rightMargin='20'", true},
      {"none has the margin", "closure='openOpen' leftMargin='0' rightMargin='10'",
       "closure='openOpen' leftMargin='10' rightMargin='20'", true},
      {"the margin as another writes it",
       "closure='closedClosed' leftMargin='0' rightMargin='0.30000000000000004'",
       "closure='openOpen' leftMargin='0.3' rightMargin='20'", true},
      {"two halves", "closure='openOpen' rightMargin='0'", "closure='closedOpen' leftMargin='0'", true},
      {"two that go down for ever", "closure='openOpen' rightMargin='0'",
       "closure='openOpen' rightMargin='-5'", false},
      {"two that go up for ever", "closure='openOpen' leftMargin='0'", "closure='openOpen' leftMargin='5'",
       false},
      {"a single number in the gap", "closure='openOpen' leftMargin='0' rightMargin='10'",
       "closure='closedClosed' leftMargin='10' rightMargin='10'", true},
      {"a single number that the bin has", "closure='openClosed' leftMargin='0' rightMargin='10'",
       "closure='openOpen' leftMargin='10' rightMargin='10'", false},
      {"a single number before the bin", "closure='openOpen' leftMargin='0' rightMargin='10'",
       "closure='closedClosed' leftMargin='0' rightMargin='0'", true},
      {"a bin of nothing", "closure='closedClosed' leftMargin='0' rightMargin='10'",
       "closure='closedClosed' leftMargin='6' rightMargin='5'", true},
  };
  for (const BinsRow& row : rows) {
    const std::string content = "<Discretize field='x'>" + Bin(row.first) + Bin(row.second) + "</Discretize>";
    if (row.is_accepted) {
      EXPECT_EQ(ReadDerivedField(kNumber, content).Get("d")->GetBins().size(), 2u) << row.why;
    } else {
      kestrel_tests::ExpectFault([&] { ReadDerivedField(kNumber, content); }, 1,
                                 "Only disjoint value range is allowed", row.why);
    }
  }
}

TEST(DerivedFieldRules, BinsKeepTheOrderAndTheClosureOfTheDocument) {
  const DerivedFields fields = ReadDerivedField(
      kNumber,
      "<Discretize field='x'>"
      "<DiscretizeBin binValue='3'><Interval closure='closedOpen' leftMargin='10'/></DiscretizeBin>"
      "<DiscretizeBin><Interval closure='openClosed' leftMargin='0' rightMargin='5'/></DiscretizeBin>"
      "<Extension name='recodeTargetSysmis'><Interval closure='closedClosed' leftMargin='-5' "
      "rightMargin='-1'/>"
      "</Extension>"
      "<Extension name='recodeIntervalCopy'><Interval closure='openOpen' leftMargin='6' rightMargin='7'/>"
      "</Extension></Discretize>");
  const TransformVar& d = *fields.Get("d");
  ASSERT_EQ(d.GetBins().size(), 4u);
  EXPECT_EQ(TextOf(d.GetBins()[0].value.get()), "3");
  EXPECT_TRUE(d.GetBins()[0].range->IsInRange(10) && d.GetBins()[0].range->IsInRange(1e300));
  EXPECT_EQ(d.GetBins()[1].value, nullptr) << "copies";
  EXPECT_EQ(RangeText(*d.GetBins()[1].range), "(0, 5]");
  EXPECT_TRUE(d.GetBins()[2].value->IsSystemMissingValue());
  EXPECT_EQ(RangeText(*d.GetBins()[2].range), "[-5, -1]");
  EXPECT_EQ(d.GetBins()[3].value, nullptr) << "copies";
  ASSERT_NE(d.GetRecodeIntervalCopy(), nullptr);
  EXPECT_EQ(RangeText(*d.GetRecodeIntervalCopy()), "(6, 7)");
}

TEST(DerivedFieldRules, RowsKeepTheOrderOfTheDocument) {
  const DerivedFields fields =
      ReadDerivedField(kNumber,
                       "<MapValues outputColumn='o'><Extension name='recodeTargetSysmis' value='9'/>"
                       "<FieldColumnPair field='y' column='i'/><InlineTable><Extension/>"
                       "<row><i>1</i><o>10</o><other>x</other></row><row><i>1</i><o>20</o></row>"
                       "<row><i><![CDATA[2]]></i><o>3<!-- more -->0</o></row></InlineTable>"
                       "<Extension name='recodeTargetSysmis' value='8'/></MapValues>");
  std::string rows;
  for (const TransformVar::Encoding& row : fields.Get("d")->GetAllEncodedValues())
    rows += TextOf(static_cast<const ValueMatcher&>(*row.matcher).GetValue()) + ":" +
            TextOf(row.value.get()) + " ";
  EXPECT_EQ(rows, "9:Undefined 1:10 1:20 2:30 8:Undefined ");
}

TEST(DerivedFieldRules, ATableWithoutRowsMapsNothing) {
  const DerivedFields fields =
      ReadDerivedField(kNumber,
                       "<MapValues outputColumn='o'><FieldColumnPair field='y' column='i'/><InlineTable/>"
                       "</MapValues>");
  EXPECT_TRUE(fields.Get("d")->GetAllEncodedValues().empty());
}

TEST(DerivedFieldRules, DatesAreNumbersInTheirUnitOrTexts) {
  const DerivedFields fields = ReadDerivedDocument(DerivedDocument(
      "<DerivedField name='a' optype='continuous' dataType='date'>"
      "<MapValues outputColumn='o' defaultValue='1970-01-03' mapMissingTo='86400'>"
      "<FieldColumnPair field='day' "
      "column='i'/><InlineTable><row><i>2</i><o>1970-01-02</o></row></InlineTable>"
      "</MapValues></DerivedField>"
      "<DerivedField name='b' optype='continuous' dataType='dateDaysSince[1960]'>"
      "<Discretize field='clock' defaultValue='3653'><DiscretizeBin binValue='3654'>"
      "<Interval closure='openOpen' leftMargin='0'/></DiscretizeBin></Discretize></DerivedField>"));
  const TransformVar& a = *fields.Get("a");
  EXPECT_EQ(a.GetRecodeDefaultValue()->GetDouble(), 2 * 86400.0);
  EXPECT_EQ(a.GetRecodeMissValueRep()->GetDouble(), 86400.0);
  const TransformVar::Encoding& row = a.GetAllEncodedValues().front();
  EXPECT_EQ(row.value->GetDouble(), 86400.0);
  EXPECT_EQ(row.value->GetType(), ScoreValue::kDateTime);
  EXPECT_TRUE(row.matcher->Matches(DateTimeValue(2.0, kDateDaysSince1970)));
  EXPECT_FALSE(row.matcher->Matches(DateTimeValue(3.0, kDateDaysSince1970)));
  const TransformVar& b = *fields.Get("b");
  EXPECT_EQ(b.GetRecodeDefaultValue()->GetDouble(), 0.0) << "3653 days after 1960 began 1970";
  EXPECT_EQ(b.GetBins().front().value->GetDouble(), 86400.0);
}

TEST(DerivedFieldRules, RecodeExtensionsCountInsideAndBeside) {
  const std::string map_end =
      "<FieldColumnPair field='y' "
      "column='i'/><InlineTable><row><i>1</i><o>2</o></row></InlineTable></MapValues>";
  for (const bool is_inside : {true, false}) {
    const std::string extensions =
        "<Extension name='recodeElseCopy'/><Extension name='recodeMissingCopy'/>"
        "<Extension name='mapSysmisTo' value='4'/><Extension name='whatever' value='5'/>";
    const DerivedFields fields =
        ReadDerivedField(kNumber, (is_inside ? "" : extensions) + "<MapValues outputColumn='o'>" +
                                      (is_inside ? extensions : "") + map_end);
    EXPECT_TRUE(fields.Get("d")->IsRecodeElseCopy()) << is_inside;
    EXPECT_TRUE(fields.Get("d")->IsRecodeMissingCopy()) << is_inside;
    EXPECT_EQ(TextOf(fields.Get("d")->GetRecodeSysmisValueRep()), "4") << is_inside;
  }
  const DerivedFields fields = ReadDerivedField(
      kNumber, "<Extension name='recodeMissingSysmis'/><MapValues outputColumn='o'>" + map_end);
  ASSERT_NE(fields.Get("d")->GetRecodeMissValueRep(), nullptr);
  EXPECT_TRUE(fields.Get("d")->GetRecodeMissValueRep()->IsSystemMissingValue());
}

TEST(DerivedFieldRules, DerivedFieldsReferToThoseBefore) {
  const DerivedFields fields = ReadDerivedDocument(DerivedDocument(
      "<DerivedField name='a' optype='continuous' dataType='double'><FieldRef field='x'/></DerivedField>"
      "<DerivedField name='b' optype='categorical' dataType='double'>"
      "<Discretize field='a'><DiscretizeBin binValue='1'><Interval closure='openOpen' leftMargin='0'/>"
      "</DiscretizeBin></Discretize></DerivedField>"
      "<DerivedField name='c' optype='continuous' dataType='double'><NormDiscrete field='b' value='1'/>"
      "</DerivedField>"
      "<DerivedField name='e' optype='continuous' dataType='double'><NormContinuous field='c'>"
      "<LinearNorm orig='0' norm='0'/><LinearNorm orig='1' norm='2'/></NormContinuous></DerivedField>"));
  EXPECT_EQ(fields.Get("e")->GetFieldName(), "c");
}

TEST(DerivedFieldRules, AGivenDictionaryGetsTheFieldsAndKeepsThemAfterAFault) {
  const auto data = kestrel_test::ReadDictionary(kestrel_test::kDerivedSources);
  const auto first = ReadTree("<TransformationDictionary>" + DerivedField(kNumber, "<FieldRef field='x'/>") +
                              "</TransformationDictionary>");
  const auto local = ReadTree(
      "<LocalTransformations><DerivedField name='e' optype='continuous'><FieldRef field='d'/>"
      "</DerivedField><DefineFunction name='f'/></LocalTransformations>");
  const auto broken = ReadTree(
      "<LocalTransformations><DerivedField name='f' optype='continuous'><FieldRef field='e'/>"
      "</DerivedField><DerivedField name='g' optype='continuous'><FieldRef field='none'/></DerivedField>"
      "</LocalTransformations>");
  TransformationDictionary derived;
  for (const auto* tree : {first.get(), local.get()}) {
    EXPECT_EQ(PMMLTranslator::HandleTransformationDictionary(tree->GetRoot(), data.get(), &derived),
              &derived);
  }
  kestrel_tests::ExpectFault(
      [&] { PMMLTranslator::HandleTransformationDictionary(broken->GetRoot(), data.get(), &derived); }, 8,
      "none: not predefined");
  EXPECT_EQ(derived.GetDerivedVarNames(), (std::vector<std::string>{"d", "e", "f"}));
  EXPECT_EQ(derived.Size(), 3u);
}

TEST(DerivedFieldRules, NoElementHasNoFields) {
  const std::unique_ptr<TransformationDictionary> derived(
      PMMLTranslator::HandleTransformationDictionary(nullptr, nullptr, nullptr));
  ASSERT_NE(derived, nullptr);
  EXPECT_EQ(derived->Size(), 0u);
  EXPECT_TRUE(derived->GetDerivedVarNames().empty());
}

}  // namespace
