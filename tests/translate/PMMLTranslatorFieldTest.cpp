// What the reader of data dictionaries makes of good fields.

#include <gtest/gtest.h>

#include <fstream>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/ScoreEncoder.h"
#include "kestrel/dictionary/ScoreMissingValueSet.h"
#include "kestrel/dictionary/ScoreValueLabel.h"
#include "kestrel/dictionary/ScoreValueLabelSet.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "tests/support/DictionaryText.h"

namespace {

using namespace MCKestrel_800;
using kestrel_test::DictionaryOf;
using kestrel_test::ReadDictionary;
using kestrel_test::ReadField;

std::string DisplayOf(const ScoreDictVar& variable) {
  std::ostringstream out;
  variable.Display(out);
  return out.str();
}

std::unique_ptr<DictVar> FieldOf(const std::string& attributes, const std::string& children) {
  return ReadField("<DataField name='x' " + attributes + ">" + children + "</DataField>");
}

struct TypeRow {
  const char* why;
  const char* attributes;
  const char* children;
  ScoreDictVar::VariableType type;
  ScoreDictVar::NumericDataType numericType;
  int dateTimeType;
};

constexpr TypeRow kTypes[] = {
    {"text", "optype='categorical' dataType='string'", "", ScoreDictVar::STRING_VAR,
     ScoreDictVar::kUnspecified, 0},
    {"integer", "optype='continuous' dataType='integer'", "", ScoreDictVar::kNUMERIC_VAR,
     ScoreDictVar::kInteger, 0},
    {"double", "optype='continuous' dataType='double'", "", ScoreDictVar::kNUMERIC_VAR, ScoreDictVar::kDouble,
     0},
    {"float is a plain number", "optype='continuous' dataType='float'", "", ScoreDictVar::kNUMERIC_VAR,
     ScoreDictVar::kUnspecified, 0},
    {"boolean is a plain number", "optype='categorical' dataType='boolean'", "", ScoreDictVar::kNUMERIC_VAR,
     ScoreDictVar::kUnspecified, 0},
    {"no dataType", "optype='continuous'", "", ScoreDictVar::kNUMERIC_VAR, ScoreDictVar::kUnspecified, 0},
    {"capital letters count", "optype='continuous' dataType='Double'", "", ScoreDictVar::kNUMERIC_VAR,
     ScoreDictVar::kUnspecified, 0},
    {"date", "optype='continuous' dataType='date'", "", ScoreDictVar::kDATETIME_VAR,
     ScoreDictVar::kUnspecified, 1},
    {"time", "optype='continuous' dataType='time'", "", ScoreDictVar::kDATETIME_VAR,
     ScoreDictVar::kUnspecified, 2},
    {"date and time", "optype='ordinal' dataType='dateTime'", "", ScoreDictVar::kDATETIME_VAR,
     ScoreDictVar::kUnspecified, 3},
    {"days of year 0", "optype='continuous' dataType='dateDaysSince[0]'", "", ScoreDictVar::kDATETIME_VAR,
     ScoreDictVar::kUnspecified, 4},
    {"days of 1960", "optype='continuous' dataType='dateDaysSince[1960]'", "", ScoreDictVar::kDATETIME_VAR,
     ScoreDictVar::kUnspecified, 5},
    {"days of 1970", "optype='continuous' dataType='dateDaysSince[1970]'", "", ScoreDictVar::kDATETIME_VAR,
     ScoreDictVar::kUnspecified, 6},
    {"days of 1980", "optype='continuous' dataType='dateDaysSince[1980]'", "", ScoreDictVar::kDATETIME_VAR,
     ScoreDictVar::kUnspecified, 7},
    {"seconds of a day", "optype='continuous' dataType='timeSeconds'", "", ScoreDictVar::kDATETIME_VAR,
     ScoreDictVar::kUnspecified, 8},
    {"seconds of year 0", "optype='continuous' dataType='dateTimeSecondsSince[0]'", "",
     ScoreDictVar::kDATETIME_VAR, ScoreDictVar::kUnspecified, 9},
    {"seconds of 1960", "optype='continuous' dataType='dateTimeSecondsSince[1960]'", "",
     ScoreDictVar::kDATETIME_VAR, ScoreDictVar::kUnspecified, 10},
    {"seconds of 1970", "optype='continuous' dataType='dateTimeSecondsSince[1970]'", "",
     ScoreDictVar::kDATETIME_VAR, ScoreDictVar::kUnspecified, 11},
    {"seconds of 1980", "optype='continuous' dataType='dateTimeSecondsSince[1980]'", "",
     ScoreDictVar::kDATETIME_VAR, ScoreDictVar::kUnspecified, 12},
    {"days of another year are a plain number", "optype='continuous' dataType='dateDaysSince[1990]'", "",
     ScoreDictVar::kNUMERIC_VAR, ScoreDictVar::kUnspecified, 0},
    // Storage
    {"a stored text", "optype='categorical' dataType='integer' x-storageType='string'", "",
     ScoreDictVar::STRING_VAR, ScoreDictVar::kUnspecified, 0},
    {"a text by an extension", "optype='categorical' dataType='integer'",
     "<Extension name='x-storageType' value='string'/>", ScoreDictVar::STRING_VAR, ScoreDictVar::kUnspecified,
     0},
    {"an extension below a value", "optype='categorical' dataType='integer'",
     "<Value value='a'><Extension name='x-storageType' value='string'/></Value>", ScoreDictVar::STRING_VAR,
     ScoreDictVar::kUnspecified, 0},
    {"the attribute wins", "optype='categorical' dataType='integer' x-storageType='numeric'",
     "<Extension name='x-storageType' value='string'/>", ScoreDictVar::kNUMERIC_VAR, ScoreDictVar::kInteger,
     0},
    {"an empty attribute says nothing", "optype='categorical' dataType='integer' x-storageType=''",
     "<Extension name='x-storageType' value='string'/>", ScoreDictVar::STRING_VAR, ScoreDictVar::kUnspecified,
     0},
    {"the first extension wins", "optype='categorical' dataType='integer'",
     "<Extension name='x-storageType' value='string'/><Extension name='x-storageType' value='numeric'/>",
     ScoreDictVar::STRING_VAR, ScoreDictVar::kUnspecified, 0},
    {"a stored number leaves the dataType to decide",
     "optype='categorical' dataType='string' x-storageType='numeric'", "", ScoreDictVar::STRING_VAR,
     ScoreDictVar::kUnspecified, 0},
};

TEST(PMMLTranslatorFields, TakeTheirTypeFromStorageAndDataType) {
  for (const TypeRow& row : kTypes) {
    const auto variable = FieldOf(row.attributes, row.children);
    ASSERT_NE(variable, nullptr) << row.why;
    EXPECT_EQ(variable->GetVarType(), row.type) << row.why;
    EXPECT_EQ(variable->GetNumericDataType(), row.numericType) << row.why;
    EXPECT_EQ(static_cast<int>(variable->GetDateTimeType()), row.dateTimeType) << row.why;
  }
}

TEST(PMMLTranslatorFields, TakeTheirLevelFromOptype) {
  EXPECT_EQ(FieldOf("optype='continuous'", "")->GetMLevel(), ScoreDictVar::kContinuous);
  EXPECT_EQ(FieldOf("optype='ordinal'", "")->GetMLevel(), ScoreDictVar::kOrdinal);
  EXPECT_EQ(FieldOf("optype='categorical'", "")->GetMLevel(), ScoreDictVar::kNominal);
}

TEST(PMMLTranslatorFields, DateTimeTypesOfOtherTextsAreNone) {
  EXPECT_EQ(static_cast<int>(PMMLTranslator::ParseDateTimeType(nullptr)), 0);
  EXPECT_EQ(static_cast<int>(PMMLTranslator::ParseDateTimeType(ToXMLCh(u""))), 0);
  EXPECT_EQ(static_cast<int>(PMMLTranslator::ParseDateTimeType(ToXMLCh(u"Date"))), 0);
  EXPECT_EQ(static_cast<int>(PMMLTranslator::ParseDateTimeType(ToXMLCh(u"double"))), 0);
  EXPECT_EQ(static_cast<int>(PMMLTranslator::ParseDateTimeType(ToXMLCh(u"date"))), 1);
}

struct PropertyRow {
  const char* why;
  const char* attributes;
  const char* children;
  /// The variable's properties in one line: see PropertiesOf.
  const char* want;
};

std::string PropertiesOf(const DictVar& v) {
  std::ostringstream out;
  out << "label=" << v.GetLabel() << " width=" << v.GetWidth() << " decimals=" << v.GetDecimal()
      << " trim=" << !v.GetNoSpaceTrim() << " empty=" << v.GetEmptyStringOK()
      << " measure=" << v.GetXMeasure() << " flag=" << v.IsFlagVariable()
      << " true=" << v.GetFalgTypeTrueValue() << " used=" << v.IsUsageTypeEnable();
  return out.str();
}

constexpr PropertyRow kProperties[] = {
    {"a plain number", "optype='continuous' dataType='double'", "",
     "label= width=-1 decimals=0 trim=1 empty=0 measure= flag=0 true= used=1"},
    {"a plain text accepts the empty text", "optype='categorical' dataType='string'", "",
     "label= width=-1 decimals=0 trim=1 empty=1 measure= flag=0 true= used=1"},
    {"a label", "optype='continuous' displayName='Heat &lt;in&gt; °C'", "",
     "label=Heat <in> °C width=-1 decimals=0 trim=1 empty=0 measure= flag=0 true= used=1"},
    {"an empty label", "optype='continuous' displayName=''", "",
     "label= width=-1 decimals=0 trim=1 empty=0 measure= flag=0 true= used=1"},
    {"a display format", "optype='continuous'",
     "<Extension name='format' value='5'/><Extension name='width' value='8'/><Extension name='decimals' "
     "value='2'/>",
     "label= width=8 decimals=2 trim=1 empty=0 measure= flag=0 true= used=1"},
    {"a display format of a category", "optype='ordinal' dataType='integer'",
     "<Extension name='format' value='5'/><Extension name='width' value='9'/><Extension name='decimals' "
     "value='3'/>",
     "label= width=9 decimals=3 trim=1 empty=0 measure= flag=0 true= used=1"},
    {"a text's length", "optype='categorical' dataType='string'",
     "<Extension name='stringLength' value='12'/>",
     "label= width=12 decimals=0 trim=1 empty=1 measure= flag=0 true= used=1"},
    {"the last width counts", "optype='continuous'",
     "<Extension name='width' value='8'/><Extension name='stringLength' value='12'/>",
     "label= width=12 decimals=0 trim=1 empty=0 measure= flag=0 true= used=1"},
    {"a format counts as the field's own child only", "optype='continuous'",
     "<Extension name='other'><Extension name='width' value='8'/></Extension>",
     "label= width=-1 decimals=0 trim=1 empty=0 measure= flag=0 true= used=1"},
    {"no trimming", "optype='categorical' dataType='string'", "<Extension name='noSpaceTrim' value='true'/>",
     "label= width=-1 decimals=0 trim=0 empty=1 measure= flag=0 true= used=1"},
    {"another value leaves trimming on", "optype='categorical' dataType='string'",
     "<Extension name='noSpaceTrim' value='false'/>",
     "label= width=-1 decimals=0 trim=1 empty=1 measure= flag=0 true= used=1"},
    {"a number is not trimmed either way", "optype='categorical' dataType='double'",
     "<Extension name='noSpaceTrim' value='true'/>",
     "label= width=-1 decimals=0 trim=1 empty=0 measure= flag=0 true= used=1"},
    {"the empty text confirmed", "optype='categorical' dataType='string'",
     "<Extension name='emptyStringOk' value='true'/>",
     "label= width=-1 decimals=0 trim=1 empty=1 measure= flag=0 true= used=1"},
    {"the empty text cannot be refused", "optype='categorical' dataType='string'",
     "<Extension name='emptyStringOk' value='false'/>",
     "label= width=-1 decimals=0 trim=1 empty=1 measure= flag=0 true= used=1"},
    {"x-measure", "optype='continuous'", "<Extension name='x-measure' value='range'/>",
     "label= width=-1 decimals=0 trim=1 empty=0 measure=range flag=0 true= used=1"},
    {"measure", "optype='ordinal'", "<Extension name='measure' value='set'/>",
     "label= width=-1 decimals=0 trim=1 empty=0 measure=set flag=0 true= used=1"},
    {"a flag", "optype='categorical' dataType='string'",
     "<Extension name='x-measure' value='flag'/><Extension name='flagTypeTrueValue' value='yes'/>"
     "<Value value='no'/><Value value='yes'/>",
     "label= width=-1 decimals=0 trim=1 empty=1 measure=flag flag=1 true=yes used=1"},
    {"a flag's true value means nothing to a number", "optype='continuous' dataType='double'",
     "<Extension name='flagTypeTrueValue' value='yes'/>",
     "label= width=-1 decimals=0 trim=1 empty=0 measure= flag=0 true= used=1"},
    {"a field that is not to be used", "optype='continuous'",
     "<Extension name='any'><UsageType value='disable'/></Extension>",
     "label= width=-1 decimals=0 trim=1 empty=0 measure= flag=0 true= used=0"},
    {"another usage", "optype='continuous'", "<Extension name='any'><UsageType value='enable'/></Extension>",
     "label= width=-1 decimals=0 trim=1 empty=0 measure= flag=0 true= used=1"},
    {"a usage among other children", "optype='continuous'",
     "<Extension>text<Other value='disable'/><UsageType/><UsageType value='disable'/></Extension>",
     "label= width=-1 decimals=0 trim=1 empty=0 measure= flag=0 true= used=0"},
    {"a usage deeper in an extension belongs to something else", "optype='continuous'",
     "<Extension><Other><UsageType value='disable'/></Other></Extension>",
     "label= width=-1 decimals=0 trim=1 empty=0 measure= flag=0 true= used=1"},
    {"unknown extensions", "optype='continuous'", "<Extension/><Extension name='x'/><Extension value='y'/>",
     "label= width=-1 decimals=0 trim=1 empty=0 measure= flag=0 true= used=1"},
};

TEST(PMMLTranslatorFields, TakeTheirPropertiesFromAttributesAndExtensions) {
  for (const PropertyRow& row : kProperties) {
    EXPECT_EQ(PropertiesOf(*FieldOf(row.attributes, row.children)), row.want) << row.why;
  }
}

/// The labels as "value=label" and the missing values as "[low,high]", joined by blanks, then the number of
/// categories.
std::string ValuesOf(const DictVar& variable) {
  std::ostringstream out;
  if (variable.GetValueLabels() != nullptr) {
    for (const ScoreValueLabel* label : variable.GetValueLabels()->GetAllValueLabels()) {
      out << label->GetValue()->GetString() << '=' << label->GetLabel() << ' ';
    }
  }
  if (variable.GetMissingValues() != nullptr) {
    for (const ScoreValueRange* range : variable.GetMissingValues()->GetMissingValues()) {
      out << (range->GetLowEnd() ? '[' : '(') << range->GetMin()->GetString() << ','
          << range->GetMax()->GetString() << (range->GetHighEnd() ? ']' : ')') << ' ';
    }
  }
  out << variable.GetNumberOfCats();
  return out.str();
}

constexpr PropertyRow kValues[] = {
    {"no values", "optype='categorical' dataType='string'", "", "0"},
    {"valid in every way", "optype='categorical' dataType='string'",
     "<Value value='b' displayValue='Bee'/><Value value='a' property='valid'/><Value value='c' property=''/>",
     "b=Bee a= c= 3"},
    {"missing and invalid", "optype='categorical' dataType='string'",
     "<Value value='a'/><Value value='?' property='missing'/><Value value='!' property='invalid' "
     "displayValue='x'/>",
     "a= [?,?] [!,!] 1"},
    {"the same missing value twice counts once", "optype='ordinal' dataType='integer'",
     "<Value value='9' property='missing'/><Value value='9.0' property='invalid'/>", "[9,9] 0"},
    {"numbers", "optype='ordinal' dataType='double'",
     "<Value value=' 2.5'/><Value value='-1e2'/><Value value='0' property='missing'/>", "2.5= -100= [0,0] 2"},
    {"the empty text is a category", "optype='categorical' dataType='string'",
     "<Value value=''/><Value value='a'/>", "= a= 2"},
    {"trailing blanks make two categories where they count", "optype='categorical' dataType='string'",
     "<Extension name='noSpaceTrim' value='true'/><Value value='a'/><Value value='a '/>", "a= a = 2"},
    {"leading blanks always do", "optype='categorical' dataType='string'",
     "<Value value='a'/><Value value=' a'/>", "a=  a= 2"},
    {"case counts", "optype='categorical' dataType='string'", "<Value value='a'/><Value value='A'/>",
     "a= A= 2"},
    {"a label inside a missing interval stands", "optype='ordinal' dataType='integer'",
     "<Value value='8'/><Extension name='invalidRangeLower' value='7'/>"
     "<Extension name='invalidRangeUpper' value='9'/>",
     "8= [7,9] 1"},
    {"dates are numbers in values", "optype='ordinal' dataType='dateDaysSince[1970]'",
     "<Value value='1' displayValue='first'/><Value value='2' property='missing'/>",
     "1970-01-02=first [1970-01-03,1970-01-03] 1"},
    {"text between elements", "optype='categorical' dataType='string'",
     "blah<Value value='a'/><!-- note --><?pi?><Value value='b'/>", "a= b= 2"},
    {"a value's own extension", "optype='categorical' dataType='string'",
     "<Value value='a'><Extension name='width' value='many'/></Value>", "a= 1"},
    {"continuous values", "optype='continuous' dataType='double'",
     "<Value value='1' displayValue='poor'/><Value value='2' property='valid'/><Value value='-1' "
     "property='missing'/>"
     "<Value value='-2' property='invalid'/>",
     "1=poor 2= [-1,-1] [-2,-2] 1"},
    {"continuous dates", "optype='continuous' dataType='date'",
     "<Value value='86400' displayValue='second day'/><Value value='0' property='missing'/>",
     "1970-01-02=second day [1970-01-01,1970-01-01] 1"},
};

TEST(PMMLTranslatorFields, HoldTheirValues) {
  for (const PropertyRow& row : kValues) {
    EXPECT_EQ(ValuesOf(*FieldOf(row.attributes, row.children)), row.want) << row.why;
  }
}

TEST(PMMLTranslatorFields, TellMissingFromValid) {
  const auto variable = FieldOf("optype='ordinal' dataType='integer'",
                                "<Value value='1'/><Value value='8'/><Value value='0' property='missing'/>"
                                "<Extension name='invalidRangeLower' value='7'/>"
                                "<Extension name='invalidRangeUpper' value='9'/>");
  const NumericValue one(1), eight(8), seven(7), zero(0), three(3);
  EXPECT_TRUE(variable->IsValidValue(&one));
  EXPECT_TRUE(variable->IsValidValue(&eight)) << "a label inside a missing interval wins";
  EXPECT_TRUE(variable->IsMissingValue(&seven));
  EXPECT_TRUE(variable->IsMissingValue(&zero));
  EXPECT_FALSE(variable->IsMissingValue(&three));
  EXPECT_FALSE(variable->IsValidValue(&three));
}

TEST(PMMLTranslatorFields, WithoutValuesAcceptWhateverFits) {
  const auto text = FieldOf("optype='categorical' dataType='string'", "");
  const StringValue any("anything");
  EXPECT_TRUE(text->IsValidValue(&any));
  EXPECT_TRUE(text->IsEmptyCateValues());
  const auto number = FieldOf("optype='continuous' dataType='double'", "");
  const NumericValue two(2);
  EXPECT_TRUE(number->IsValidValue(&two));
  EXPECT_FALSE(number->IsValidValue(&any));
  EXPECT_FALSE(number->IsEmptyCateValues());
  EXPECT_FALSE(FieldOf("optype='ordinal' dataType='double'", "<Value value='1'/>")->IsEmptyCateValues());
}

TEST(PMMLTranslatorFields, DatesAreMissingByTheirDate) {
  const auto variable =
      FieldOf("optype='continuous' dataType='dateDaysSince[1960]'", "<Value value='0' property='missing'/>");
  const DateTimeValue epoch(0.0, kDateDaysSince1960);
  const DateTimeValue later(1.0, kDateDaysSince1960);
  EXPECT_TRUE(variable->IsMissingValue(&epoch));
  EXPECT_FALSE(variable->IsMissingValue(&later));
}

TEST(PMMLTranslatorFields, CodesFollowTheOrderOfTheValues) {
  const auto text =
      FieldOf("optype='categorical' dataType='string'",
              "<Value value='b'/><Value value='z' property='missing'/><Value value='a'/><Value value='c'/>");
  ASSERT_NE(text->GetEncoder(), nullptr);
  EXPECT_EQ(text->GetEncoder()->GetEncoderType(), ScoreEncoder::kCatString);
  EXPECT_EQ(text->GetEncoder()->GetNumberOfCategories(), 3);
  EXPECT_EQ(text->GetEncoder()->EncodeConst(std::string("b")), 0);
  EXPECT_EQ(text->GetEncoder()->EncodeConst(std::string("a")), 1);
  EXPECT_EQ(text->GetEncoder()->EncodeConst(std::string("c ")), 2) << "trailing blanks do not count";
  EXPECT_EQ(text->GetEncoder()->EncodeConst(std::string("z")), -1);

  const auto number = FieldOf("optype='ordinal' dataType='double'", "<Value value='3.5'/><Value value='1'/>");
  ASSERT_NE(number->GetEncoder(), nullptr);
  EXPECT_EQ(number->GetEncoder()->GetEncoderType(), ScoreEncoder::kCatNumeric);
  EXPECT_EQ(number->GetEncoder()->DecodeNum(0), 3.5);
  EXPECT_EQ(number->GetEncoder()->DecodeNum(1), 1.0);

  EXPECT_EQ(FieldOf("optype='continuous' dataType='double'", "<Value value='1'/>")->GetEncoder(), nullptr);
}

TEST(PMMLTranslatorFields, WithExactTextHaveExactCodes) {
  const auto exact =
      FieldOf("optype='categorical' dataType='string'",
              "<Extension name='noSpaceTrim' value='true'/><Value value='a'/><Value value='a '/>");
  EXPECT_EQ(exact->GetEncoder()->EncodeConst(std::string("a")), 0);
  EXPECT_EQ(exact->GetEncoder()->EncodeConst(std::string("a ")), 1);
  EXPECT_EQ(exact->GetEncoder()->EncodeConst(std::string("a  ")), -1);
}

TEST(PMMLTranslatorFields, SetupCatEncoderServesCategoriesAlone) {
  EXPECT_FALSE(PMMLTranslator::SetupCatEncoder(nullptr));
  DictVar continuous("x", ScoreDictVar::kNUMERIC_VAR);
  EXPECT_FALSE(PMMLTranslator::SetupCatEncoder(&continuous));
  EXPECT_EQ(continuous.GetEncoder(), nullptr);

  DictVar nominal("x", ScoreDictVar::STRING_VAR);
  nominal.SetMLevel(ScoreDictVar::kNominal);
  EXPECT_TRUE(PMMLTranslator::SetupCatEncoder(&nominal)) << "without labels there is an encoder all the same";
  ASSERT_NE(nominal.GetEncoder(), nullptr);
  EXPECT_EQ(nominal.GetEncoder()->GetNumberOfCategories(), 0);

  const ScoreEncoder* encoder = nominal.GetEncoder();
  ASSERT_TRUE(nominal.AddScoreValueLabel(new StringValue("later"), "Later"));
  EXPECT_TRUE(PMMLTranslator::SetupCatEncoder(&nominal));
  EXPECT_EQ(nominal.GetEncoder(), encoder) << "an encoder that is there is kept";
  EXPECT_EQ(encoder->EncodeConst(std::string("later")), 0);
}

// No document makes such a variable; a plug-in may.
TEST(PMMLTranslatorFields, OfAnUnknownTypeHoldNoValues) {
  const auto tree = kestrel_test::ReadTree(
      "<DataField><Value value='1'/><Value value='2' property='missing'/></DataField>");
  for (const ScoreDictVar::MeasureLevel level : {ScoreDictVar::kNominal, ScoreDictVar::kContinuous}) {
    DictVar variable("x", static_cast<ScoreDictVar::VariableType>(2));
    variable.SetMLevel(level);
    if (level == ScoreDictVar::kNominal) {
      PMMLTranslator::ParseCategoricalValues(tree->GetRoot(), &variable);
    } else {
      PMMLTranslator::ParseContinuousValues(tree->GetRoot(), &variable);
    }
    EXPECT_EQ(variable.GetValueLabels()->Size(), 0u);
    EXPECT_EQ(variable.GetMissingValues()->Size(), 0u);
  }
}

TEST(PMMLTranslatorFields, KeepTheOrderOfTheDocument) {
  const auto dictionary = ReadDictionary(
      DictionaryOf(3,
                   "<Extension name='first'/><DataField name='b' optype='continuous'/><Extension/>"
                   "<DataField name='a' optype='continuous'/><DataField name='B' optype='continuous'/>"));
  EXPECT_EQ(dictionary->Size(), 3u);
  EXPECT_EQ(dictionary->GetVarNames(), (std::vector<std::string>{"b", "a", "B"}));
  EXPECT_EQ(dictionary->GetVar("A"), nullptr);
}

TEST(PMMLTranslatorFields, KeepNamesAndTextsInUtf8) {
  const auto dictionary =
      ReadDictionary(DictionaryOf(1,
                                  "<DataField name='Größe 東京 𝄞' optype='categorical' dataType='string'>"
                                  "<Value value='weiß' displayValue='белый'/></DataField>"));
  const ScoreDictVar* variable = dictionary->GetVar("Größe 東京 𝄞");
  ASSERT_NE(variable, nullptr);
  const StringValue white("weiß");
  EXPECT_EQ(variable->GetLabelOfValue(&white), "белый");
  EXPECT_EQ(variable->GetEncoder()->EncodeConst(std::string("weiß")), 0);
}

TEST(PMMLTranslatorFields, DisplayAsTheyWereDeclared) {
  const auto variable =
      FieldOf("displayName='Fuel' optype='categorical' dataType='string'",
              "<Extension name='x-measure' value='set'/><Value value='gas' displayValue='Gas'/>"
              "<Value value='oil'/><Value value='?' property='missing'/>");
  EXPECT_EQ(DisplayOf(*variable),
            "Start ScoreDictVar Display:\n"
            "Var Name = x; Var Lable = Fuel; Var Type = STRING_VAR; Var level =  Nominal; \n"
            "Start ScoreValueLabelSet Display:\n"
            "Value: gas;  Label: Gas\n"
            "Value: oil;  Label: \n"
            "End of ScoreValueLabelSet Display.\n\n"
            " Begin MissingValueSet Display:\n"
            "  Start Range Display   \n"
            "MinValue: ?;  MaxValue: ?; High End included; lower End included\n End of Range Display\n\n"
            "End MissingValueSet Display.\n"
            "x-Measure: set\n"
            "End of ScoreDictVar Display.\n\n");
}

std::string DocumentText(const std::string& name) {
  std::ifstream in(std::string(KESTREL_SOURCE_DIR) + "/tests/data/documents/" + name, std::ios::binary);
  std::ostringstream text;
  text << in.rdbuf();
  return text.str();
}

TEST(PMMLTranslatorFields, OfWholeDocumentsAreRead) {
  EXPECT_EQ(ReadDictionary(DocumentText("heating_small.xml"))->Size(), 3u);
  EXPECT_EQ(ReadDictionary(DocumentText("heating_wide.xml"))->Size(), 81u);

  const auto fields = ReadDictionary(DocumentText("heating_fields.xml"));
  EXPECT_EQ(fields->Size(), 22u);
  EXPECT_EQ(fields->GetVar("town")->GetLabel(), "Städte & Dörfer");
  EXPECT_EQ(ValuesOf(static_cast<const DictVar&>(*fields->GetVar("class"))), "3= 1= 2= [9,9] 3");
  EXPECT_EQ(ValuesOf(static_cast<const DictVar&>(*fields->GetVar("outside"))),
            "(Undefined,-60] [60,inf) [-99,-99] [99,99] 1")
      << "minus infinity is written like every number below the system-missing value";

  const auto extensions = ReadDictionary(DocumentText("heating_extensions.xml"));
  EXPECT_EQ(extensions->Size(), 9u);
  EXPECT_EQ(ValuesOf(static_cast<const DictVar&>(*extensions->GetVar("code"))), "007= 7= 2");
  EXPECT_FALSE(extensions->GetVar("meter")->IsUsageTypeEnable());
}

}  // namespace
