// Every fault that the reader of data dictionaries reports, with its code and its whole text.

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/MissingValueSet.h"
#include "kestrel/foundation/KestrelException.h"
#include "tests/support/DictionaryText.h"

namespace {

using kestrel_test::DictionaryOf;
using kestrel_test::DictionaryTranslator;
using kestrel_test::ReadDictionary;
using kestrel_test::ReadTree;
using MCKestrel_800::DictVar;
using MCKestrel_800::KestrelException;
using MCKestrel_800::PMMLTranslator;
using MCKestrel_800::ScoreDictVar;

struct Fault {
  int code = 0;
  std::string text;
  unsigned line = 0;
};

template <class Action>
Fault FaultOf(Action action) {
  try {
    action();
  } catch (const KestrelException& fault) {
    return {fault.GetErrorCode(), fault.GetErrorMessage(), fault.GetLine()};
  }
  return {0, "no fault", 0};
}

struct DocumentRow {
  const char* why;
  std::string document;
  int code;
  const char* text;
};

const DocumentRow kDocuments[] = {
    {"an element that is no field", DictionaryOf(1, "<Field name='x'/>"), 1,
     "<DataField> or <Extension> is required here!!"},
    {"a taxonomy is no field either",
     DictionaryOf(1, "<DataField name='x' optype='continuous' dataType='double'/><Taxonomy name='t'/>"), 1,
     "<DataField> or <Extension> is required here!!"},
    {"no children", DictionaryOf(0, ""), 1, "<DataDictionary is EMPTY!!"},
    {"only extensions", DictionaryOf(0, "<Extension name='a'/><Extension name='b'/>"), 1,
     "<DataDictionary is EMPTY!!"},
    {"no numberOfFields",
     "<DataDictionary><DataField name='x' optype='continuous' dataType='double'/></DataDictionary>", 12,
     "Attribute \"numberOfFields\": Null string is an invalid integer string!"},
    {"an empty numberOfFields",
     "<DataDictionary numberOfFields=''><DataField name='x' optype='continuous' "
     "dataType='double'/></DataDictionary>",
     12, "Attribute \"numberOfFields\": Null string is an invalid integer string!"},
    {"too few fields",
     DictionaryOf(3,
                  "<DataField name='x' optype='continuous' dataType='double'/>"
                  "<DataField name='y' optype='continuous' dataType='double'/>"),
     12, "Number of Variables in the Dictionary does not match with numberOfFields!"},
    {"too many fields",
     DictionaryOf(1,
                  "<DataField name='x' optype='continuous' dataType='double'/>"
                  "<DataField name='y' optype='continuous' dataType='double'/>"),
     12, "Number of Variables in the Dictionary does not match with numberOfFields!"},
    {"a negative number of fields",
     DictionaryOf(-1, "<DataField name='x' optype='continuous' dataType='double'/>"), 12,
     "Number of Variables in the Dictionary does not match with numberOfFields!"},
    {"a number of fields that no integer holds",
     "<DataDictionary numberOfFields='99999999999999999999'><DataField name='x' optype='continuous' "
     "dataType='double'/>"
     "</DataDictionary>",
     12, "Number of Variables in the Dictionary does not match with numberOfFields!"},
    {"a numberOfFields that is no integer",
     "<DataDictionary numberOfFields='one'><DataField name='x' optype='continuous' "
     "dataType='double'/></DataDictionary>",
     3, "oneInvalid integer string -- "},
    {"an extension does not count as a field",
     DictionaryOf(2, "<Extension/><DataField name='x' optype='continuous' dataType='double'/>"), 12,
     "Number of Variables in the Dictionary does not match with numberOfFields!"},
    {"a field without a name", DictionaryOf(1, "<DataField optype='continuous' dataType='double'/>"), 4,
     "Attribute name is missing from Node \"DataField\""},
    {"a field with an empty name",
     DictionaryOf(1, "<DataField name='' optype='continuous' dataType='double'/>"), 1,
     "<DataField>'s name can't be null string !!"},
    {"a name given twice",
     DictionaryOf(2,
                  "<DataField name='x' optype='continuous' dataType='double'/>"
                  "<DataField name='x' optype='categorical' dataType='string'/>"),
     8, "x: Invalid Variable Name -- alreay in the dictionary"},
    {"a name given twice is found before the field's other faults",
     DictionaryOf(2,
                  "<DataField name='x' optype='continuous' dataType='double'/>"
                  "<DataField name='x'/>"),
     8, "x: Invalid Variable Name -- alreay in the dictionary"},
    {"a field's fault is found before a wrong number of fields",
     DictionaryOf(7, "<DataField name='x' optype='nominal'/>"), 11, "nominal: Invalid Variable Type"},
};

TEST(PMMLTranslatorFaults, OfTheDictionaryHaveTheirCodeAndText) {
  for (const DocumentRow& row : kDocuments) {
    const Fault fault = FaultOf([&] { ReadDictionary(row.document); });
    EXPECT_EQ(fault.code, row.code) << row.why;
    EXPECT_EQ(fault.text, row.text) << row.why;
  }
}

struct FieldRow {
  const char* why;
  const char* attributes;  ///< of the field "x"
  const char* children;
  int code;
  const char* text;
};

constexpr FieldRow kFields[] = {
    // Attributes
    {"no optype", "dataType='double'", "", 11, "opType can't be null!!"},
    {"an empty optype", "optype='' dataType='double'", "", 11, "opType can't be null!!"},
    {"a capital letter", "optype='Continuous' dataType='double'", "", 11,
     "Continuous: Invalid Variable Type"},
    {"a continuous text", "optype='continuous' dataType='string'", "", 11,
     "string variable can't be continuous!!"},
    {"a continuous text by its storage", "optype='continuous' dataType='double' x-storageType='string'", "",
     11, "string variable can't be continuous!!"},
    {"a continuous text by an extension", "optype='continuous' dataType='double'",
     "<Extension name='x-storageType' value='string'/>", 11, "string variable can't be continuous!!"},
    // Extensions
    {"a continuous flag", "optype='continuous' dataType='double'",
     "<Extension name='x-measure' value='flag'/>", 11, "flag type only valid for categorical variables!"},
    {"a continuous flag, the other name", "optype='continuous' dataType='double'",
     "<Extension name='measure' value='flag'/>", 11, "flag type only valid for categorical variables!"},
    {"a continuous flag far below the field", "optype='continuous' dataType='double'",
     "<Value value='1'><Other><Extension name='measure' value='flag'/></Other></Value>", 11,
     "flag type only valid for categorical variables!"},
    {"a flag with three categories", "optype='categorical' dataType='string'",
     "<Extension name='x-measure' value='flag'/><Value value='a'/><Value value='b'/><Value value='c'/>", 12,
     "Flag variable has to have two categories!"},
    {"a flag with one category", "optype='ordinal' dataType='integer'",
     "<Extension name='x-measure' value='flag'/><Value value='1'/>", 12,
     "Flag variable has to have two categories!"},
    {"a flag without categories", "optype='ordinal' dataType='integer'",
     "<Extension name='x-measure' value='flag'/>", 12, "Flag variable has to have two categories!"},
    {"a missing value is no category of a flag", "optype='ordinal' dataType='integer'",
     "<Extension name='x-measure' value='flag'/><Value value='1'/><Value value='2' property='missing'/>", 12,
     "Flag variable has to have two categories!"},
    {"a format that is no integer", "optype='continuous' dataType='double'",
     "<Extension name='format' value='F8.2'/>", 3, "F8.2Invalid integer string -- "},
    {"a format without a value", "optype='categorical' dataType='double'", "<Extension name='format'/>", 3,
     "Invalid integer string -- "},
    {"a width that is no integer", "optype='continuous' dataType='double'",
     "<Extension name='width' value='8.5'/>", 3, "8.5Invalid integer string -- "},
    {"a string length that is no integer", "optype='categorical' dataType='string'",
     "<Extension name='stringLength' value=' 8'/>", 3, " 8Invalid integer string -- "},
    {"decimals that are no integer", "optype='categorical' dataType='double'",
     "<Extension name='decimals' value='-'/>", 3, "-Invalid integer string -- "},
    {"a lower bound that is no number", "optype='continuous' dataType='double'",
     "<Extension name='invalidRangeLower' value='1,5'/>", 3, "1,5Invalid double string -- "},
    {"an upper bound that is no number", "optype='ordinal' dataType='double'",
     "<Extension name='invalidRangeUpper' value='inf'/>", 3, "infInvalid double string -- "},
    {"two lower bounds", "optype='continuous' dataType='double'",
     "<Extension name='invalidRangeLower' value='1'/><Extension name='invalidRangeLower' value='2'/>", 5,
     "Only one \"invalidRangeLower\" or \"invalidRangeUpper\" is allowed!"},
    {"two upper bounds", "optype='categorical' dataType='double'",
     "<Extension name='invalidRangeUpper' value='1'/><Extension name='invalidRangeUpper' value='2'/>", 5,
     "Only one \"invalidRangeLower\" or \"invalidRangeUpper\" is allowed!"},
    {"two lower bounds and an upper one", "optype='continuous' dataType='double'",
     "<Extension name='invalidRangeLower' value='1'/><Extension name='invalidRangeUpper' value='5'/>"
     "<Extension name='invalidRangeLower' value='2'/>",
     5, "Only one \"invalidRangeLower\" or \"invalidRangeUpper\" is allowed!"},
    {"ten lower bounds are not one upper bound", "optype='continuous' dataType='double'",
     "<Extension name='invalidRangeLower' value='1'/><Extension name='invalidRangeLower' value='1'/>"
     "<Extension name='invalidRangeLower' value='1'/><Extension name='invalidRangeLower' value='1'/>"
     "<Extension name='invalidRangeLower' value='1'/><Extension name='invalidRangeLower' value='1'/>"
     "<Extension name='invalidRangeLower' value='1'/><Extension name='invalidRangeLower' value='1'/>"
     "<Extension name='invalidRangeLower' value='1'/><Extension name='invalidRangeLower' value='1'/>",
     5, "Only one \"invalidRangeLower\" or \"invalidRangeUpper\" is allowed!"},
    // Categorical values
    {"another element", "optype='categorical' dataType='string'", "<Interval leftMargin='1'/>", 1,
     "Interval: Invalid element!"},
    {"X-DataField belongs to continuous fields", "optype='ordinal' dataType='integer'", "<X-DataField/>", 1,
     "X-DataField: Invalid element!"},
    {"a category without a value", "optype='categorical' dataType='string'", "<Value displayValue='a'/>", 4,
     "Attribute value is missing from Node \"Value\""},
    {"an unknown property", "optype='categorical' dataType='string'", "<Value value='a' property='Valid'/>",
     6, "InValid property value!"},
    {"a category that is no number", "optype='categorical' dataType='integer'", "<Value value='one'/>", 7,
     "one: invalid value!"},
    {"an empty category of a number", "optype='ordinal' dataType='double'", "<Value value=''/>", 7,
     ": invalid value!"},
    {"a missing category that is no number", "optype='ordinal' dataType='double'",
     "<Value value='none' property='missing'/>", 3, "none: Invalid Numeric Categorical Value!"},
    {"an invalid category that is no number", "optype='categorical' dataType='float'",
     "<Value value='1x' property='invalid'/>", 3, "1x: Invalid Numeric Categorical Value!"},
    {"a date category that is no number", "optype='ordinal' dataType='date'", "<Value value='today'/>", 3,
     "todayInvalid double string -- "},
    {"a missing date that is no number", "optype='ordinal' dataType='dateTime'",
     "<Value value='never' property='missing'/>", 3, "neverInvalid double string -- "},
    {"valid and missing text", "optype='categorical' dataType='string'",
     "<Value value='a'/><Value value='b'/><Value value='a' property='missing'/>", 1,
     "\"a\": defined as both Valid and Invalid value!"},
    {"missing first", "optype='ordinal' dataType='string'",
     "<Value value='a' property='invalid'/><Value value='a'/>", 1,
     "\"a\": defined as both Valid and Invalid value!"},
    {"trailing blanks do not count", "optype='categorical' dataType='string'",
     "<Value value='a '/><Value value='a' property='missing'/>", 1,
     "\"a\": defined as both Valid and Invalid value!"},
    {"valid and missing number", "optype='ordinal' dataType='double'",
     "<Value value='1.5'/><Value value='1.50' property='missing'/>", 1,
     "\"1.5\": defined as both Valid and Invalid value!"},
    {"numbers within the tolerance", "optype='ordinal' dataType='double'",
     "<Value value='1'/><Value value='1.00000000000000001' property='missing'/>", 1,
     "\"1\": defined as both Valid and Invalid value!"},
    {"an invalid range of one number", "optype='ordinal' dataType='integer'",
     "<Value value='7'/><Extension name='invalidRangeLower' value='7'/><Extension name='invalidRangeUpper' "
     "value='7'/>",
     1, "\"7\": defined as both Valid and Invalid value!"},
    {"valid and missing comes before listed twice", "optype='categorical' dataType='string'",
     "<Value value='b'/><Value value='b'/><Value value='a'/><Value value='a' property='missing'/>", 1,
     "\"a\": defined as both Valid and Invalid value!"},
    {"valid and missing comes before the flag's categories", "optype='categorical' dataType='string'",
     "<Extension name='measure' value='flag'/><Value value='a'/><Value value='a' property='missing'/>", 1,
     "\"a\": defined as both Valid and Invalid value!"},
    {"the system-missing value as a category", "optype='categorical' dataType='double'",
     "<Value value='-1.7976931348623157e+308'/>", 12,
     "x: category value is defined as both valid and invalid/missing"},
    {"the system-missing value as a date", "optype='ordinal' dataType='date'",
     "<Value value='-1.7976931348623157e+308'/>", 12,
     "x: category value is defined as both valid and invalid/missing"},
    {"the flag's categories come before a missing category", "optype='categorical' dataType='double'",
     "<Extension name='measure' value='flag'/><Value value='-1.7976931348623157e+308'/>", 12,
     "Flag variable has to have two categories!"},
    {"a missing category comes before listed twice", "optype='categorical' dataType='double'",
     "<Value value='1'/><Value value='1'/><Value value='-1.7976931348623157e+308'/>", 12,
     "x: category value is defined as both valid and invalid/missing"},
    {"a category listed twice", "optype='categorical' dataType='string'",
     "<Value value='a'/><Value value='b'/><Value value='a'/>", 1, "\"a\": Duplicated Category Value!"},
    {"a category listed twice but for trailing blanks", "optype='categorical' dataType='string'",
     "<Value value='a'/><Value value='a  '/>", 1, "\"a  \": Duplicated Category Value!"},
    {"an empty category listed twice", "optype='categorical' dataType='string'",
     "<Value value=''/><Value value=''/>", 1, "\"\": Duplicated Category Value!"},
    {"a number listed twice", "optype='ordinal' dataType='integer'",
     "<Value value='10'/><Value value='1e1'/>", 1, "\"10\": Duplicated Category Value!"},
    {"zero has no sign", "optype='ordinal' dataType='integer'", "<Value value='0'/><Value value='-0'/>", 1,
     "\"-0\": Duplicated Category Value!"},
    {"exact text listed twice", "optype='categorical' dataType='string'",
     "<Extension name='noSpaceTrim' value='true'/><Value value='a '/><Value value='a'/><Value value='a '/>",
     1, "\"a \": Duplicated Category Value!"},
    // Continuous values
    {"another element of a number", "optype='continuous' dataType='double'", "<Values/>", 1,
     "Values: Invalid element!"},
    {"a value without its attribute", "optype='continuous' dataType='double'", "<Value property='missing'/>",
     4, "Attribute value is missing from Node \"Value\""},
    {"an unknown property of a number", "optype='continuous' dataType='double'",
     "<Value value='1' property='outlier'/>", 6, "InValid property value!"},
    {"a valid value that is no number", "optype='continuous' dataType='double'",
     "<Value value='one' property='valid'/>", 7, "one: invalid value!"},
    {"a value without property that is no number", "optype='continuous' dataType='double'",
     "<Value value='1.'/>", 7, "1.: invalid value!"},
    {"a valid date that is no number", "optype='continuous' dataType='date'", "<Value value='2001-02-03'/>",
     7, "2001-02-03: invalid value!"},
    {"a missing value that is no number", "optype='continuous' dataType='double'",
     "<Value value='none' property='missing'/>", 3, "noneInvalid double string -- "},
    {"an invalid value that is no number", "optype='continuous' dataType='integer'",
     "<Value value='' property='invalid'/>", 3, "Invalid double string -- "},
    {"two intervals", "optype='continuous' dataType='double'",
     "<Interval leftMargin='1'/><Interval leftMargin='9'/>", 5, "Only One InterVal Element allowed here!"},
    {"a left margin that is no number", "optype='continuous' dataType='double'", "<Interval leftMargin='a'/>",
     3, "aInvalid double string -- "},
    {"a right margin that is no number", "optype='continuous' dataType='double'",
     "<Interval rightMargin='1 0'/>", 3, "1 0Invalid double string -- "},
    {"a margin of a producer's interval", "optype='continuous' dataType='double'",
     "<X-DataField><Interval leftMargin='+'/></X-DataField>", 3, "+Invalid double string -- "},
    {"valid and missing", "optype='continuous' dataType='double'",
     "<Value value='9'/><Value value='9' property='missing'/>", 1,
     "\"9\": defined as both valid and invalid/missing value!"},
    {"valid and missing date", "optype='continuous' dataType='date'",
     "<Value value='86400'/><Value value='86400' property='missing'/>", 1,
     "\"1970-01-02\": defined as both valid and invalid/missing value!"},
    {"the system-missing value as a valid one", "optype='continuous' dataType='double'",
     "<Value value='-1.7976931348623157e+308'/>", 12,
     "x: value is defined as both valid and invalid/missing"},
    {"a value listed twice", "optype='continuous' dataType='double'",
     "<Value value='9'/><Value value='9.0'/>", 1, "\"9\": Duplicated Value!"},
    {"a date listed twice", "optype='continuous' dataType='dateDaysSince[1970]'",
     "<Value value='1'/><Value value='1'/>", 1, "\"1970-01-02\": Duplicated Value!"},
};

TEST(PMMLTranslatorFaults, OfAFieldHaveTheirCodeAndText) {
  for (const FieldRow& row : kFields) {
    const std::string document = DictionaryOf(
        1, std::string("\n<DataField name='x' ") + row.attributes + ">\n" + row.children + "</DataField>");
    const Fault fault = FaultOf([&] { ReadDictionary(document); });
    EXPECT_EQ(fault.code, row.code) << row.why;
    EXPECT_EQ(fault.text, row.text) << row.why;
    EXPECT_GE(fault.line, 2u) << row.why << ": a fault of a field has its place";
  }
}

TEST(PMMLTranslatorFaults, PointAtTheElement) {
  const std::string document = DictionaryOf(1,
                                            "\n<DataField name='x' optype='ordinal' dataType='integer'>\n"
                                            "<Value value='1'/>\n"
                                            "<Value value='two'/>\n"
                                            "</DataField>");
  EXPECT_EQ(FaultOf([&] { ReadDictionary(document); }).line, 4u);
}

TEST(PMMLTranslatorFaults, ANullDictionaryIsRequired) {
  DictionaryTranslator translator;
  const Fault fault = FaultOf([&] { translator.ParseDictionary(nullptr, false); });
  EXPECT_EQ(fault.code, 1);
  EXPECT_EQ(fault.text, "<DataDictionary is required !!");
}

TEST(PMMLTranslatorFaults, ACategoricalFieldOfAContinuousVariableIsRefused) {
  const auto tree = ReadTree("<DataField name='x'><Value value='1'/></DataField>");
  DictVar variable("x", ScoreDictVar::kNUMERIC_VAR);
  const Fault fault = FaultOf([&] { PMMLTranslator::ParseCategoricalValues(tree->GetRoot(), &variable); });
  EXPECT_EQ(fault.code, 1);
  EXPECT_EQ(fault.text, "Invalid Variable Type!");
}

TEST(PMMLTranslatorFaults, ABoundGivenTwiceIsRefusedByTheOperationItself) {
  for (const int flags : {2, 3, 12, 20, 21, 22, 100, -1}) {
    MCKestrel_800::MissingValueSet set;
    const Fault fault = FaultOf([&] { PMMLTranslator::HandleVEXAMissingInterval(&set, flags, 1.0, 2.0); });
    EXPECT_EQ(fault.code, 5) << flags;
    EXPECT_EQ(fault.text, "Only one \"invalidRangeLower\" or \"invalidRangeUpper\" is allowed!") << flags;
    EXPECT_EQ(set.Size(), 0u) << flags;
  }
}

}  // namespace
