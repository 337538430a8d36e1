// What is refused in derived fields: the code, the text and the place of each fault.

#include <gtest/gtest.h>

#include <string>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/transform/BuiltinFunctions.h"
#include "tests/support/DerivedText.h"

namespace {

using kestrel_test::DerivedDocument;
using kestrel_test::ReadDerivedDocument;
using namespace MCKestrel_800;

struct FaultRow {
  const char* why;
  /// The derived fields. The element at fault stands behind an "@", which becomes a line end.
  const char* fields;
  int code;
  const char* text;
};

constexpr char kSecondLine[] = "\n";

void ExpectRow(const FaultRow& row) {
  std::string fields = row.fields;
  const size_t mark = fields.find('@');
  ASSERT_NE(mark, std::string::npos) << row.why;
  fields.replace(mark, 1, kSecondLine);
  try {
    ReadDerivedDocument(DerivedDocument(fields));
    ADD_FAILURE() << row.why << ": nothing was thrown";
  } catch (const KestrelException& fault) {
    EXPECT_EQ(fault.GetErrorCode(), row.code) << row.why;
    EXPECT_EQ(fault.GetErrorMessage(), row.text) << row.why;
    EXPECT_EQ(fault.GetLine(), 2u) << row.why;
  }
}

// Short forms of what many rows share.
#define NUMBER "optype='continuous' dataType='double'"
#define TEXT "optype='categorical' dataType='string'"
#define FIELD(content) "<DerivedField name='d' " NUMBER ">" content "</DerivedField>"
#define TEXT_FIELD(content) "<DerivedField name='d' " TEXT ">" content "</DerivedField>"
#define POINTS "<LinearNorm orig='0' norm='0'/><LinearNorm orig='1' norm='1'/>"
#define PAIR "<FieldColumnPair field='color' column='in'/>"
#define TABLE "<InlineTable><row><in>red</in><out>1</out></row></InlineTable>"
#define BIN "<DiscretizeBin binValue='1'><Interval closure='openOpen' rightMargin='0'/></DiscretizeBin>"
#define X "<FieldRef field='x'/>"
#define ONE "<Constant dataType='double'>1</Constant>"
#define WORD "<Constant dataType='string'>w</Constant>"

constexpr FaultRow kFieldFaults[] = {
    {"no name", "@<DerivedField " NUMBER ">" X "</DerivedField>", 4,
     "Attribute name is missing from Node \"DerivedField\""},
    {"empty name", "@<DerivedField name='' " NUMBER ">" X "</DerivedField>", 1,
     "Variable name can't be empty string!"},
    {"no optype", "@<DerivedField name='d' dataType='double'>" X "</DerivedField>", 11,
     "opType is required!!"},
    {"empty optype", "@<DerivedField name='d' optype='' dataType='double'>" X "</DerivedField>", 11,
     "opType is required!!"},
    {"optype in capitals",
     "@<DerivedField name='d' optype='Continuous' dataType='double'>" X "</DerivedField>", 11,
     "d: Invalid Variable Type"},
    {"continuous text", "@<DerivedField name='d' optype='continuous' dataType='string'>" X "</DerivedField>",
     11, "d: Invalid Variable dataType -- string variable can't be continuous!!"},
    {"two expressions", FIELD(X "@" ONE), 1, "Only one EXPRESSION is allowed"},
    {"two expressions of which one is bad", FIELD("<FieldRef field='none'/>@" ONE), 1,
     "Only one EXPRESSION is allowed"},
    {"no expression", "@<DerivedField name='d' " NUMBER "/>", 1, "Invalid EXPRESSION"},
    {"an extension alone", "@" FIELD("<Extension name='a'/>"), 1, "Invalid EXPRESSION"},
    {"an element that is no expression", FIELD(X "@<Interval/>"), 1, "Invalid EXPRESSION"},
    {"an unknown expression", FIELD("@<TextIndex/>"), 1, "Invalid EXPRESSION"},
    {"an aggregate", FIELD("@<Aggregate field='x' function='sum'/>"), 5, "d: Not supported!"},
    {"a derived field twice", FIELD(X) "@" FIELD(X), 1, "d: Redefinition!"},
    {"a data field's name", "@<DerivedField name='x' " NUMBER ">" ONE "</DerivedField>", 1,
     "x: Redefinition!"},
    {"a width that is none", TEXT_FIELD(WORD "@<Extension name='width' value='wide'/>"), 3,
     "wideInvalid integer string -- "},
    {"a property that is none", TEXT_FIELD(WORD "@<Value value='a' property='odd'/>"), 6,
     "InValid property value!"},
    {"a value without a value", TEXT_FIELD(WORD "@<Value property='valid'/>"), 4,
     "Attribute value is missing from Node \"Value\""},
    {"a value of another type", FIELD(ONE "@<Value value='a'/>"), 3, "aInvalid double string -- "},
    {"a value that is valid and missing",
     "@" TEXT_FIELD(WORD "<Value value='a'/><Value value='a' property='missing'/>"), 1,
     "d: category value is defined as both valid and invalid/missing!!!"},
    {"a value that is valid and listed among the missing ones",
     "@" TEXT_FIELD(WORD "<Extension name='MissingValues'><Value value='a'/></Extension><Value value='a'/>"),
     1, "d: category value is defined as both valid and invalid/missing!!!"},
    {"an interval of missing values", FIELD(ONE "<Extension name='MissingValues'>@<Interval/></Extension>"),
     1, "InterVal is not allowed!!"},
    {"something else among missing values", FIELD(ONE "<Extension name='MissingValues'>@<Foo/></Extension>"),
     1, "Foo: Invalid element!"},
    {"two lower bounds of the invalid range",
     FIELD(ONE "@<Extension name='MissingValues'><Extension name='invalidRangeLower' value='1'/>"
               "<Extension name='invalidRangeLower' value='2'/></Extension>"),
     5, "Only one \"invalidRangeLower\" or \"invalidRangeUpper\" is allowed!"},
    {"a bound that is no number",
     FIELD(ONE
           "<Extension name='MissingValues'>@<Extension name='invalidRangeUpper' value='a'/></Extension>"),
     3, "aInvalid double string -- "},
};

TEST(DerivedFieldFaults, OfFields) {
  for (const FaultRow& row : kFieldFaults)
    ExpectRow(row);
}

constexpr FaultRow kExpressionFaults[] = {
    // NormContinuous
    {"a norm of nothing", FIELD("@<NormContinuous>" POINTS "</NormContinuous>"), 4,
     "Attribute field is missing from Node \"NormContinuous\""},
    {"a norm of no field", FIELD("@<NormContinuous field='none'>" POINTS "</NormContinuous>"), 1,
     "none: must predefined as continuous type"},
    {"a norm of categories", FIELD("@<NormContinuous field='code'>" POINTS "</NormContinuous>"), 1,
     "code: must predefined as continuous type"},
    {"one point", FIELD("@<NormContinuous field='x'><LinearNorm orig='0' norm='0'/></NormContinuous>"), 1,
     "At least two <LinearNorm>s are required!!"},
    {"no point", FIELD("@<NormContinuous field='x'/>"), 1, "At least two <LinearNorm>s are required!!"},
    {"a point without its value", FIELD("<NormContinuous field='x'>@<LinearNorm orig='0'/></NormContinuous>"),
     4, "Attribute norm is missing from Node \"LinearNorm\""},
    {"a point that is no number",
     FIELD("<NormContinuous field='x'>@<LinearNorm orig='a' norm='0'/></NormContinuous>"), 3,
     "aInvalid double string -- "},
    {"a replacement that is no number",
     FIELD("@<NormContinuous field='x' mapMissingTo='no'>" POINTS "</NormContinuous>"), 3,
     "noInvalid double string -- "},
    {"a misspelt point", FIELD("<NormContinuous field='x'>" POINTS "@<LinearNrom/></NormContinuous>"), 1,
     "LinearNrom: Invalid element!"},
    // NormDiscrete
    {"an indicator of no field", FIELD("@<NormDiscrete field='none' value='1'/>"), 1,
     "none: must predefined as categorical or ordinal type"},
    {"an indicator of a number", FIELD("@<NormDiscrete field='x' value='1'/>"), 1,
     "x: must predefined as categorical or ordinal type"},
    {"an indicator of no value", FIELD("@<NormDiscrete field='color'/>"), 4,
     "Attribute value is missing from Node \"NormDiscrete\""},
    {"an indicator of another type", FIELD("@<NormDiscrete field='code' value='a'/>"), 3,
     "aInvalid double string -- "},
    {"an element in an indicator", FIELD("<NormDiscrete field='color' value='red'>@<Foo/></NormDiscrete>"), 1,
     "Foo: Invalid element!"},
    // FieldRef
    {"a reference to nothing", FIELD("@<FieldRef/>"), 4, "Attribute field is missing from Node \"FieldRef\""},
    {"a reference to no field", FIELD("@<FieldRef field='none'/>"), 8, "none: not predefined"},
    {"a reference to itself", FIELD("@<FieldRef field='d'/>"), 8, "d: not predefined"},
    {"a reference to a later field",
     FIELD("@<FieldRef field='e'/>") "<DerivedField name='e' " NUMBER ">" X "</DerivedField>", 8,
     "e: not predefined"},
    {"a replacement of another type", FIELD("@<FieldRef field='x' mapMissingTo='a'/>"), 8,
     "d: has to have the same type as x"},
    {"a replacement that is no date", FIELD("@<FieldRef field='born' mapMissingTo='2020-13-01'/>"), 8,
     "d: has to have the same type as born"},
    // Constant
    {"an empty constant", FIELD("@<Constant/>"), 4, "Constant value is required!"},
    {"a constant of no text", TEXT_FIELD("@<Constant dataType='string'></Constant>"), 4,
     "Constant value is required!"},
    // MapValues
    {"no output column", FIELD("@<MapValues>" PAIR TABLE "</MapValues>"), 4,
     "Attribute outputColumn is missing from Node \"MapValues\""},
    {"a default that is no number",
     FIELD("@<MapValues outputColumn='out' defaultValue='a'>" PAIR TABLE "</MapValues>"), 3,
     "aInvalid double string -- "},
    {"a pair without its field",
     FIELD("<MapValues outputColumn='out'>@<FieldColumnPair column='in'/></MapValues>"), 4,
     "Attribute field is missing from Node \"FieldColumnPair\""},
    {"a pair without its column",
     FIELD("<MapValues outputColumn='out'>@<FieldColumnPair field='color'/></MapValues>"), 4,
     "Attribute column is missing from Node \"FieldColumnPair\""},
    {"a pair of no field",
     FIELD("<MapValues outputColumn='out'>@<FieldColumnPair field='none' column='in'/></MapValues>"), 5,
     "none: not predefined!"},
    {"two pairs",
     FIELD("<MapValues outputColumn='out'>" PAIR "@<FieldColumnPair field='x' column='b'/>" TABLE
           "</MapValues>"),
     5, "Multi-dimensional case not supported!!"},
    {"a table before its pair", FIELD("<MapValues outputColumn='out'>@" TABLE PAIR "</MapValues>"), 1,
     "Element <FieldColumnPair> should defined before!"},
    {"two tables", FIELD("<MapValues outputColumn='out'>" PAIR TABLE "@" TABLE "</MapValues>"), 1,
     "Only one <InlineTable> is allowed!!"},
    {"a table elsewhere", FIELD("<MapValues outputColumn='out'>" PAIR "@<TableLocator/></MapValues>"), 1,
     "Invalid element!"},
    {"another element", FIELD("<MapValues outputColumn='out'>" PAIR "@<Foo/></MapValues>"), 1,
     "Invalid element!"},
    {"no table", FIELD("@<MapValues outputColumn='out'>" PAIR "</MapValues>"), 1,
     "No Element Found from MapValues!!!"},
    {"no pair", FIELD("@<MapValues outputColumn='out'/>"), 1, "No Element Found from MapValues!!!"},
    {"a row without its input",
     FIELD("<MapValues outputColumn='out'>" PAIR
           "<InlineTable>@<row><out>1</out></row></InlineTable></MapValues>"),
     1, "Child element in is not found in <Row>!"},
    {"a row without its output",
     FIELD("<MapValues outputColumn='out'>" PAIR
           "<InlineTable>@<row><in>a</in></row></InlineTable></MapValues>"),
     1, "Child element out is not found in <Row>!"},
    {"a column in other letters",
     FIELD("<MapValues outputColumn='out'>" PAIR
           "<InlineTable>@<row><IN>a</IN><out>1</out></row></InlineTable></MapValues>"),
     1, "Child element in is not found in <Row>!"},
    {"an output of another type",
     FIELD("<MapValues outputColumn='out'>" PAIR
           "<InlineTable><row><in>a</in>@<out>b</out></row></InlineTable></MapValues>"),
     3, "bInvalid double string -- "},
    {"an input of another type",
     FIELD("<MapValues outputColumn='out'><FieldColumnPair field='x' column='in'/>"
           "<InlineTable><row>@<in></in><out>1</out></row></InlineTable></MapValues>"),
     3, "Invalid double string -- "},
    {"something between rows",
     FIELD("<MapValues outputColumn='out'>" PAIR "<InlineTable>@<line/></InlineTable></MapValues>"), 1,
     "line: Invalid element!"},
    // Discretize
    {"bins of nothing", FIELD("@<Discretize>" BIN "</Discretize>"), 4,
     "Attribute field is missing from Node \"Discretize\""},
    {"bins of no field", FIELD("@<Discretize field='none'>" BIN "</Discretize>"), 1, "none: not predefined!"},
    {"no bin", FIELD("@<Discretize field='x'/>"), 1, "<DiscretizeBin> is required"},
    {"something among bins", FIELD("<Discretize field='x'>@<Foo/></Discretize>"), 1,
     "Only <Extension> and <DisCretizeBin> are allowed!"},
    {"a bin without its interval", FIELD("<Discretize field='x'>@<DiscretizeBin binValue='1'/></Discretize>"),
     1, "Element Interval is required"},
    {"a bin of two intervals",
     FIELD("<Discretize field='x'><DiscretizeBin binValue='1'><Interval closure='openOpen' rightMargin='0'/>"
           "@<Interval closure='openOpen' leftMargin='1'/></DiscretizeBin></Discretize>"),
     1, "ONLY one <Interval> is allowed."},
    {"something in a bin",
     FIELD("<Discretize field='x'><DiscretizeBin binValue='1'>@<Foo/></DiscretizeBin>"
           "</Discretize>"),
     1, "Only <Extension> and <Interval> are allowed!"},
    {"a bin value of another type",
     FIELD("<Discretize field='x'>@<DiscretizeBin binValue='a'><Interval closure='openOpen' rightMargin='0'/>"
           "</DiscretizeBin></Discretize>"),
     3, "aInvalid double string -- "},
    {"an interval without its closure",
     FIELD("<Discretize field='x'><DiscretizeBin binValue='1'>@<Interval rightMargin='0'/></DiscretizeBin>"
           "</Discretize>"),
     1, "In valid closure value in <InterVal>."},
    {"a closure that is none",
     FIELD("<Discretize field='x'><DiscretizeBin binValue='1'>@<Interval closure='open' rightMargin='0'/>"
           "</DiscretizeBin></Discretize>"),
     1, "In valid closure value in <InterVal>."},
    {"an interval of everything",
     FIELD("<Discretize field='x'><DiscretizeBin binValue='1'>@<Interval closure='openOpen'/>"
           "</DiscretizeBin></Discretize>"),
     1, "At least one margin must be defined."},
    {"a margin that is no number",
     FIELD("<Discretize field='x'><DiscretizeBin binValue='1'>@<Interval closure='openOpen' leftMargin='a'/>"
           "</DiscretizeBin></Discretize>"),
     3, "aInvalid double string -- "},
};

TEST(DerivedFieldFaults, OfExpressions) {
  for (const FaultRow& row : kExpressionFaults)
    ExpectRow(row);
}

#define MAP(attributes, extensions) \
  "<MapValues outputColumn='out' " attributes ">" extensions PAIR TABLE "</MapValues>"
#define EXT(name) "<Extension name='" name "' value='1'/>"

constexpr FaultRow kExtensionFaults[] = {
    {"copied against a default", FIELD(MAP("defaultValue='1'", "@" EXT("recodeElseCopy"))), 5,
     "defaultValue value is defined already!!"},
    {"the same beside the expression", FIELD("@" EXT("recodeElseCopy") MAP("defaultValue='1'", "")), 5,
     "defaultValue value is defined already!!"},
    {"missing copied against a replacement", FIELD(MAP("mapMissingTo='1'", "@" EXT("recodeMissingCopy"))), 5,
     "mapMissingTo value is defined already!!"},
    {"two replacements of the missing number", FIELD(MAP("", EXT("mapSysmisTo") "@" EXT("mapSysmisTo"))), 5,
     "mapSysmisTo value is defined already!!"},
    {"no replacement of the missing number", FIELD(MAP("", "@<Extension name='mapSysmisTo'/>")), 4,
     "Attribute value is missing from Node \"Extension\""},
    {"a replacement of another type", FIELD(MAP("", "@<Extension name='mapSysmisTo' value='a'/>")), 3,
     "aInvalid double string -- "},
    {"a missing number for a text", TEXT_FIELD(MAP("", "@" EXT("recodeMissingSysmis"))), 5,
     "Only numeric derived variable is allowed!!"},
    {"made missing against a replacement", FIELD(MAP("mapMissingTo='1'", "@" EXT("recodeMissingSysmis"))), 5,
     "mapMissing replacement value is defined already!!"},
    {"made missing against a copy", FIELD(MAP("", EXT("recodeMissingCopy") "@" EXT("recodeMissingSysmis"))),
     5, "mapMissing replacement value is defined already!!"},
    {"made missing against another", FIELD(MAP("", EXT("mapSysmisTo") "@" EXT("recodeMissingSysmis"))), 5,
     "mapMissing replacement value is defined already!!"},
    {"a text made missing", TEXT_FIELD(MAP("", "@" EXT("recodeTargetSysmis"))), 5,
     "Only numeric type derived variable is allowed!"},
    {"a value made missing that is no number",
     FIELD(MAP("", "@<Extension name='recodeTargetSysmis' value='a'/>")), 3, "aInvalid double string -- "},
    {"an interval made missing that is none",
     FIELD("<Discretize field='x'>@" EXT("recodeTargetSysmis") BIN "</Discretize>"), 1,
     "Element Interval is required"},
    {"an interval of texts made missing",
     TEXT_FIELD("<Discretize field='x'>@" EXT("recodeTargetSysmis") BIN "</Discretize>"), 5,
     "Only numeric type derived variable is allowed!"},
    {"an interval copied that a bin has",
     FIELD("<Discretize field='x'>" BIN "<Extension name='recodeIntervalCopy'>"
           "@<Interval closure='closedClosed' leftMargin='-1' rightMargin='1'/></Extension></Discretize>"),
     1, "Only disjoint value range is allowed"},
};

TEST(DerivedFieldFaults, OfExtensions) {
  for (const FaultRow& row : kExtensionFaults)
    ExpectRow(row);
}

#define APPLY(name, arguments) "<Apply function='" name "'>" arguments "</Apply>"
#define COLOR "<FieldRef field='color'/>"
#define MEANS(numbers) "<Array type='real'>" numbers "</Array>"

constexpr FaultRow kApplyFaults[] = {
    {"no function", FIELD("@<Apply>" X "</Apply>"), 4, "Attribute function is missing from Node \"Apply\""},
    {"an unknown function", FIELD("@" APPLY("Sqrt", X)), 5, "Sqrt: not Supported function name"},
    {"no function is none", FIELD("@" APPLY("", X)), 5, ": not Supported function name"},
    {"a field that is none", FIELD("<Apply function='sqrt'>@<FieldRef field='none'/></Apply>"), 8,
     "none: not predefined"},
    {"a replacement of another type",
     FIELD("<Apply function='sqrt'>@<FieldRef field='x' mapMissingTo='a'/></Apply>"), 8,
     "d: has to have the same type as x"},
    {"a result's replacement of another type",
     FIELD("@<Apply function='sqrt' mapMissingTo='a'>" X "</Apply>"), 3, "aInvalid double string -- "},
    {"an empty constant", FIELD("<Apply function='sqrt'>@<Constant/></Apply>"), 4,
     "Constant value is required!"},
    {"an expression that is no argument", FIELD("<Apply function='sqrt'>@<NormContinuous/></Apply>"), 1,
     "NormContinuous: Invalid element!"},
    {"an array where none is taken", FIELD("<Apply function='sqrt'>" X "@<Array>1</Array></Apply>"), 1,
     "Array: Invalid element!"},
    {"two for one", FIELD("@" APPLY("sqrt", X X)), 6, "Only one parameter is allowed!"},
    {"none for one", FIELD("@<Apply function='sqrt'/>"), 6, "Only one parameter is allowed!"},
    {"one for two", FIELD("@" APPLY("+", X)), 6, "Two parameters are required!"},
    {"three for two", FIELD("@" APPLY("/", X X X)), 6, "Two parameters are required!"},
    {"two for three", FIELD("@" APPLY("cdf.normal", X X)), 6, "Three parameters are required!"},
    {"two dates for one", FIELD("@" APPLY("year-from-date", X X)), 6, "Only one parameter is required!"},
    {"one date for two", FIELD("@" APPLY("date_days_difference", X)), 6, "Two parameters are required!"},
    {"five for six", FIELD("@" APPLY("outlierHandle", X "<Constant>asIs</Constant>" X X X)), 6,
     "Six parameters are required!"},
    {"a fault inside", FIELD(APPLY("+", X "@" APPLY("sqrt", X X))), 6, "Only one parameter is allowed!"},
    {"a function where a field is wanted", FIELD("@" APPLY("sysmis", APPLY("sqrt", X))), 6,
     "Only <FieldRef> is allowed for function value!"},
    {"a constant where a field is wanted", FIELD("@" APPLY("isMissing", ONE)), 6,
     "Only <FieldRef> is allowed for function value!"},
    {"the number of a date", FIELD("@" APPLY("value", "<FieldRef field='born'/>")), 6,
     "Variable type doesn't match!"},
    {"a recast date", FIELD("@" APPLY("recast_to_scale", "<FieldRef field='day'/>")), 6,
     "Variable type doesn't match!"},
    {"the mean of texts", FIELD("@" APPLY("mean", X COLOR)), 6, "Variable type doesn't match!"},
    {"the mean of a word", FIELD("@" APPLY("mean", X WORD)), 6, "Variable type doesn't match!"},
    {"the mean of a text function", FIELD("@" APPLY("mean", APPLY("concat", COLOR))), 6,
     "Numeric function is required!"},
    {"numbers joined", TEXT_FIELD("@" APPLY("concat", COLOR X)), 6, "Variable type doesn't match!"},
    {"a number's function joined", TEXT_FIELD("@" APPLY("concat", APPLY("sqrt", X))), 6,
     "string function is required!"},
    {"a number's function measured", FIELD("@" APPLY("length", APPLY("sqrt", X))), 6,
     "apply functions don't match!"},
    {"a method that is none",
     FIELD("@" APPLY("outlierHandle", X "<Constant dataType='string'>asis</Constant>" X X X X)), 5,
     "d: not Supported outlier handle method"},
    {"a method that is a field", FIELD("@" APPLY("outlierHandle", X X X X X X)), 5,
     "d: not Supported outlier handle method"},
    {"a set without its array", FIELD("@" APPLY("isIn", X)), 6, "Only one parameter is allowed!"},
    {"two arrays for one", FIELD("@" APPLY("isIn", X MEANS("1") MEANS("2"))), 6,
     "Only one parameter is allowed!"},
    {"a set of fields", FIELD("@" APPLY("isIn", X X)), 6, "Only one parameter is allowed!"},
    {"a set of another type", FIELD("<Apply function='isIn'>" X "@<Array type='string'>a</Array></Apply>"), 3,
     "aInvalid double string -- "},
    {"an empty array", FIELD("<Apply function='isIn'>" X "@<Array type='real'/></Apply>"), 4,
     "No Elements found in array!"},
    {"an imputation without arrays", TEXT_FIELD("@" APPLY("imputeCatFieldMissingAgainstConTarget", COLOR X)),
     6, "PMML error for IMPUTECATFIELDMISSINGAGAINSTCONTARGET"},
    {"an imputation with one array",
     TEXT_FIELD("@" APPLY("imputeCatFieldMissingAgainstConTarget", COLOR X MEANS("1 2 3"))), 6,
     "PMML error for IMPUTECATFIELDMISSINGAGAINSTCONTARGET"},
    {"an imputation the wrong way round",
     TEXT_FIELD("@" APPLY("imputeCatFieldMissingAgainstConTarget", X COLOR MEANS("1 2 3") MEANS("1 2 3"))), 6,
     "PMML error for IMPUTECATFIELDMISSINGAGAINSTCONTARGET"},
    {"an imputation with fewer variances",
     TEXT_FIELD("@" APPLY("imputeCatFieldMissingAgainstConTarget", COLOR X MEANS("1 2 3") MEANS("1 2"))), 6,
     "PMML error for IMPUTECATFIELDMISSINGAGAINSTCONTARGET"},
    {"an imputation with more means than categories",
     TEXT_FIELD(
         "@" APPLY("imputeCatFieldMissingAgainstConTarget", COLOR X MEANS("1 2 3 4") MEANS("1 2 3 4"))),
     6, "PMML error for IMPUTECATFIELDMISSINGAGAINSTCONTARGET"},
};

TEST(DerivedFieldFaults, OfApply) {
  for (const FaultRow& row : kApplyFaults)
    ExpectRow(row);
}

// The argument counts of all functions come from one table, and each is asked here.
TEST(DerivedFieldFaults, EveryFunctionRefusesOneArgumentTooMany) {
  std::size_t count = 0;
  const BuiltinFunction* const rows = GetBuiltinFunctions(count);
  for (std::size_t i = 0; i < count; ++i) {
    if (rows[i].max_arguments == BuiltinFunction::kAnyNumber) continue;
    std::string arguments;
    for (int k = 0; k <= rows[i].max_arguments; ++k)
      arguments += k == 1 && rows[i].code == kOutlierHandleFunction
                       ? "<Constant dataType='string'>asIs</Constant>"
                       : X;
    const std::string fields = "\n<DerivedField name='d' " NUMBER "><Apply function='" +
                               std::string(rows[i].name) + "'>" + arguments + "</Apply></DerivedField>";
    try {
      ReadDerivedDocument(DerivedDocument(fields));
      ADD_FAILURE() << rows[i].name;
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetErrorCode(), 6) << rows[i].name;
      EXPECT_EQ(fault.GetErrorMessage(), rows[i].arity_text) << rows[i].name;
    }
  }
}

}  // namespace
