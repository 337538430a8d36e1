// What describe shows of derived fields' expressions.

#include "apps/kestrel/ExpressionText.h"

#include <gtest/gtest.h>

#include <map>
#include <memory>
#include <sstream>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/transform/BuiltinFunctions.h"
#include "kestrel/transform/FunctionTreeImp.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/TransformationDictionary.h"

namespace kestrel_tests {
namespace {

using kestrel_program::ExpressionText;
using namespace MCKestrel_800;

/// The text of the derived field of a document. Data fields are the numbers x, y and z, the text t, the
/// ordinal o and the date/time d.
/// field  what stands in the DerivedField element
/// type   "double" for a number, "string" for a text, or a type of dates and times
std::string TextOf(const std::string& field, const std::string& type = "double",
                   const ExpressionText& text = ExpressionText()) {
  std::string document =
      "<PMML version=\"4.4\"><DataDictionary numberOfFields=\"6\">"
      "<DataField name=\"x\" optype=\"continuous\" dataType=\"double\"/>"
      "<DataField name=\"y\" optype=\"continuous\" dataType=\"double\"/>"
      "<DataField name=\"z\" optype=\"continuous\" dataType=\"double\"/>"
      "<DataField name=\"t\" optype=\"categorical\" dataType=\"string\"/>"
      "<DataField name=\"o\" optype=\"ordinal\" dataType=\"string\"><Value value=\"lo\"/><Value "
      "value=\"hi\"/>"
      "</DataField><DataField name=\"d\" optype=\"continuous\" dataType=\"dateTime\"/></DataDictionary>"
      "<TransformationDictionary><DerivedField name=\"f\" optype=\"";
  document += type == "string" ? "categorical" : "continuous";
  document += "\" dataType=\"" + type + "\">" + field + "</DerivedField></TransformationDictionary></PMML>";
  std::istringstream in(document);
  ScoreDictionary* dictionary = nullptr;
  const std::unique_ptr<TransformationDictionary> derived(
      ModelFactory::GetTransformationDictionaryFromXML(in, dictionary, std::string()));
  const std::unique_ptr<ScoreDictionary> owned(dictionary);
  return text.Of(dynamic_cast<const TransformVar&>(*derived->GetVar("f")));
}

struct ExpressionRow {
  const char* why;
  const char* type;
  std::string field;
  const char* want;
};

void CheckRows(const std::vector<ExpressionRow>& rows) {
  for (const ExpressionRow& row : rows)
    EXPECT_EQ(TextOf(row.field, row.type), row.want) << row.why;
}

std::string Interval(const char* attributes, const char* bin_attributes) {
  return "<DiscretizeBin " + std::string(bin_attributes) + "><Interval " + attributes + "/></DiscretizeBin>";
}

std::string MapRows(const std::string& attributes, const std::string& rows) {
  return "<MapValues outputColumn=\"b\" " + attributes +
         "><FieldColumnPair field=\"t\" column=\"a\"/><InlineTable>" + rows + "</InlineTable></MapValues>";
}

TEST(ExpressionText, WritesConstantsAndFields) {
  CheckRows({
      {"a text", "string", "<Constant>a \"b\\</Constant>", "\"a \\\"b\\\\\""},
      {"a number", "double", "<Constant>1.50</Constant>", "1.5"},
      {"no number", "double", "<Constant>many</Constant>", "missing"},
      {"a date", "date", "<Constant>2020-02-29</Constant>", "2020-02-29"},
      {"a field", "double", "<FieldRef field=\"x\"/>", "x"},
      {"with a replacement", "double", "<FieldRef field=\"x\" mapMissingTo=\"-1\"/>", "x{missing -> -1}"},
      {"of a text", "string", "<FieldRef field=\"t\" mapMissingTo=\"none\"/>", "t{missing -> \"none\"}"},
      {"with two", "double",
       "<FieldRef field=\"x\" mapMissingTo=\"1\"/><Extension name=\"mapSysmisTo\" value=\"2\"/>",
       "x{missing -> 1, no value -> 2}"},
  });
}

TEST(ExpressionText, WritesLines) {
  const std::string points = "<LinearNorm orig=\"160\" norm=\"1\"/><LinearNorm orig=\"190\" norm=\"2.5\"/>";
  CheckRows({
      {"points", "double", "<NormContinuous field=\"x\">" + points + "</NormContinuous>",
       "normContinuous(x): 160 -> 1, 190 -> 2.5"},
      {"all there is", "double",
       "<NormContinuous field=\"x\" mapMissingTo=\"0\" outliers=\"asExtremeValues\">" + points +
           "</NormContinuous>",
       "normContinuous(x): 160 -> 1, 190 -> 2.5, outliers asExtremeValues, missing -> 0"},
      {"outliers", "double",
       "<NormContinuous field=\"x\" outliers=\"asMissingValues\">" + points + "</NormContinuous>",
       "normContinuous(x): 160 -> 1, 190 -> 2.5, outliers asMissingValues"},
  });
}

TEST(ExpressionText, WritesTables) {
  const std::string row = "<row><a>red</a><b>1</b></row>";
  CheckRows({
      {"an indicator", "double", "<NormDiscrete field=\"t\" value=\"red\"/>",
       "normDiscrete(t): \"red\" -> 1, else 0"},
      {"with a replacement", "double", "<NormDiscrete field=\"t\" value=\"red\" mapMissingTo=\"0.5\"/>",
       "normDiscrete(t): \"red\" -> 1, else 0, missing -> 0.5"},
      {"a table", "double", MapRows("", row + "<row><a>green</a><b>2</b></row>"),
       "mapValues(t): \"red\" -> 1, \"green\" -> 2, else missing"},
      {"texts", "string", MapRows("defaultValue=\"x\" mapMissingTo=\"y\"", row),
       "mapValues(t): \"red\" -> \"1\", else \"x\", missing -> \"y\""},
      {"without rows", "double", MapRows("defaultValue=\"3\"", ""), "mapValues(t): else 3"},
      {"copies", "string", MapRows("", row + "<Extension/>") + "<Extension name=\"recodeElseCopy\"/>",
       "mapValues(t): \"red\" -> \"1\", else t"},
      {"copies of missing values", "string", MapRows("", row) + "<Extension name=\"recodeMissingCopy\"/>",
       "mapValues(t): \"red\" -> \"1\", else missing, missing -> t"},
  });
}

TEST(ExpressionText, WritesIntervals) {
  const std::string copy =
      "<Discretize field=\"x\" defaultValue=\"7\">" +
      Interval("closure=\"closedClosed\" leftMargin=\"1\" rightMargin=\"1\"", "binValue=\"5\"") +
      Interval("closure=\"openOpen\" leftMargin=\"1\" rightMargin=\"2.5\"", "") + "</Discretize>";
  CheckRows({
      {"open, half open and unbounded ones", "string",
       "<Discretize field=\"x\" mapMissingTo=\"?\">" +
           Interval("closure=\"closedOpen\" rightMargin=\"18\"", "binValue=\"young\"") +
           Interval("closure=\"closedOpen\" leftMargin=\"18\" rightMargin=\"65\"", "binValue=\"adult\"") +
           Interval("closure=\"closedClosed\" leftMargin=\"65\"", "binValue=\"senior\"") + "</Discretize>",
       "discretize(x): (-inf, 18) -> \"young\", [18, 65) -> \"adult\", [65, inf) -> \"senior\", else "
       "missing, missing -> \"?\""},
      {"single numbers and copies", "double", copy, "discretize(x): 1 -> 5, (1, 2.5) -> x, else 7"},
  });
}

const std::string kX = "<FieldRef field=\"x\"/>";
const std::string kY = "<FieldRef field=\"y\"/>";
const std::string kZ = "<FieldRef field=\"z\"/>";

std::string Apply(const std::string& function, const std::string& arguments,
                  const std::string& attributes = "") {
  // "<" is a function's name here as little as it is in documents.
  return "<Apply function=\"" + function + "\" " + attributes + ">" + arguments + "</Apply>";
}

TEST(ExpressionText, WritesOperatorsWithTheParenthesesThatTheyNeed) {
  const std::string sum = Apply("+", kX + kY);
  const std::string product = Apply("*", kX + kY);
  const std::string less = Apply("lessThan", kX + kY);
  const std::pair<std::string, const char*> rows[] = {
      {Apply("/", kX + Apply("*", kY + kY)), "x / (y * y)"},
      {Apply("/", Apply("*", kX + kX) + kY), "x * x / y"},
      {Apply("+", product + kZ), "x * y + z"},
      {Apply("+", kZ + product), "z + x * y"},
      {Apply("*", sum + kZ), "(x + y) * z"},
      {Apply("*", kZ + sum), "z * (x + y)"},
      {Apply("-", sum + kZ), "x + y - z"},
      {Apply("-", kZ + sum), "z - (x + y)"},
      {Apply("+", kZ + sum), "z + (x + y)"},
      {Apply("greaterOrEqual", sum + product), "x + y >= x * y"},
      {Apply("*", less + kZ), "(x < y) * z"},
      {Apply("equal", less + less), "(x < y) == (x < y)"},
      {Apply("notEqual", kX + less), "x != (x < y)"},
      {Apply("lessOrEqual", kX + "<Constant>-1</Constant>"), "x <= -1"},
      {Apply("sqrt", sum), "sqrt(x + y)"},
      {Apply("*", Apply("sqrt", sum) + Apply("ln", kZ)), "sqrt(x + y) * ln(z)"},
      {Apply("+", kX + kY, "mapMissingTo=\"0\""), "(x + y){missing -> 0}"},
      {Apply("*", Apply("+", kX + kY, "mapMissingTo=\"0\"") + kZ), "(x + y){missing -> 0} * z"},
      {Apply("sqrt", "<FieldRef field=\"x\" mapMissingTo=\"4\"/>", "mapMissingTo=\"0\""),
       "sqrt(x{missing -> 4}){missing -> 0}"},
  };
  for (const auto& [field, want] : rows)
    EXPECT_EQ(TextOf(field), want);
}

TEST(ExpressionText, WritesCallsWithListsAndConstants) {
  CheckRows({
      {"texts", "string", Apply("concat", "<FieldRef field=\"t\"/><Constant>, </Constant>"),
       "concat(t, \", \")"},
      {"an array", "double",
       Apply("isIn", "<FieldRef field=\"t\"/><Array n=\"2\" type=\"string\">a \"b c\"</Array>"),
       "isIn(t, [\"a\", \"b c\"])"},
      {"two arrays", "string",
       Apply("imputeCatFieldMissingAgainstConTarget",
             "<FieldRef field=\"o\"/>" + kX +
                 "<Array n=\"2\" type=\"real\">1 2.5</Array><Array n=\"2\" type=\"real\">3 4</Array>"),
       "imputeCatFieldMissingAgainstConTarget(o, x, [1, 2.5], [3, 4])"},
      {"dates", "double",
       Apply("date_days_difference",
             "<FieldRef field=\"d\"/><Constant dataType=\"dateTime\">2020-01-01T00:00:00</Constant>"),
       "date_days_difference(d, 2020-01-01T00:00:00)"},
      {"choices", "double",
       Apply("if",
             Apply("isMissing", kX) + "<Constant dataType=\"double\">-1</Constant>" + Apply("+", kX + kY)),
       "if(isMissing(x), -1, x + y)"},
      {"nothing", "double", Apply("sum", ""), "sum()"},
      {"a constant that is none", "double", Apply("abs", "<Constant dataType=\"double\">a</Constant>"),
       "abs(missing)"},
  });
}

TEST(ExpressionText, WritesEveryFunctionByItsName) {
  const std::map<std::string, std::string> signs = {{"+", "+"},           {"-", "-"},
                                                    {"*", "*"},           {"/", "/"},
                                                    {"equal", "=="},      {"notEqual", "!="},
                                                    {"lessThan", "<"},    {"lessOrEqual", "<="},
                                                    {"greaterThan", ">"}, {"greaterOrEqual", ">="}};
  std::size_t count = 0;
  const BuiltinFunction* functions = GetBuiltinFunctions(count);
  std::size_t written_between = 0;
  for (std::size_t i = 0; i < count; ++i) {
    const BuiltinFunction& function = functions[i];
    ApplyNodeStats stats;
    stats.SetParameterName(function.name);
    stats.SetTransFunction(function.code);
    for (int array = 0; array < function.arrays; ++array)
      stats.AddArray({new NumericValue(array + 0.5)});
    auto root = std::make_unique<FunctionTreeImp>(stats);
    const int arguments = function.max_arguments == BuiltinFunction::kAnyNumber ? 7 : function.max_arguments;
    std::string list;
    for (int argument = 0; argument < arguments; ++argument) {
      ApplyNodeStats leaf;
      leaf.SetParameterName(std::string(1, static_cast<char>('a' + argument)));
      root->Add(new FunctionTreeImp(leaf));
      list += (argument == 0 ? "" : ", ") + leaf.GetParameterName();
    }
    for (int array = 0; array < function.arrays; ++array)
      list += ", [" + std::to_string(array) + ".5]";
    TransformVar field("f", ScoreDictVar::kNUMERIC_VAR);
    field.AddFieldNameAndTransExpression("", TransExpression::kApply);
    field.SetRoot(root.release());
    const auto sign = signs.find(function.name);
    if (sign != signs.end()) ++written_between;
    const std::string want =
        sign != signs.end() ? "a " + sign->second + " b" : function.name + ("(" + list) + ")";
    EXPECT_EQ(ExpressionText().Of(field), want);
  }
  EXPECT_EQ(written_between, signs.size());
}

TEST(ExpressionText, ShortensWhatIsLong) {
  const ExpressionText text = ExpressionText::Short(3);
  std::string rows;
  std::string points;
  std::string bins;
  std::string arguments;
  std::string constants;
  for (int i = 1; i <= 5; ++i) {
    const std::string number = std::to_string(i);
    rows += "<row><a>" + number + "</a><b>" + number + "</b></row>";
    points += "<LinearNorm orig=\"" + number + "\" norm=\"0\"/>";
    bins += Interval(
        ("closure=\"openClosed\" leftMargin=\"" + number + "\" rightMargin=\"" + std::to_string(i + 1) + "\"")
            .c_str(),
        ("binValue=\"" + number + "\"").c_str());
    arguments += kX;
    constants += "<Constant dataType=\"double\">" + number + "</Constant>";
  }
  const std::pair<std::string, const char*> cases[] = {
      {MapRows("", rows),
       "mapValues(t): \"1\" -> 1, \"2\" -> 2, \"3\" -> 3, ... 2 more rows (see --json), else missing"},
      {"<NormContinuous field=\"x\">" + points + "</NormContinuous>",
       "normContinuous(x): 1 -> 0, 2 -> 0, 3 -> 0, ... 2 more rows (see --json)"},
      {"<Discretize field=\"x\">" + bins + "</Discretize>",
       "discretize(x): (1, 2] -> 1, (2, 3] -> 2, (3, 4] -> 3, ... 2 more rows (see --json), else missing"},
      {Apply("sum", arguments), "sum(x, x, x, ... 2 more arguments (see --json))"},
      {Apply("isIn", kX + constants), "isIn(x, [1, 2, 3, ... 2 more values (see --json)])"},
  };
  for (const auto& [field, want] : cases) {
    EXPECT_EQ(TextOf(field, "double", text), want);
    EXPECT_EQ(TextOf(field).find("more"), std::string::npos);
  }
  const std::string long_text = "<Constant>" + std::string(100, 'a') + "</Constant>";
  EXPECT_EQ(TextOf(long_text, "string", text), "\"" + std::string(60, 'a') + "...\"");
  EXPECT_EQ(TextOf(long_text, "string"), "\"" + std::string(100, 'a') + "\"");
}

TEST(ExpressionText, CutsDeepExpressionsAtACharacter) {
  std::string field = "<FieldRef field=\"t\"/>";
  for (int i = 0; i < 300; ++i)
    field = Apply("concat", field + "<Constant>\xC3\xA4</Constant>");
  const std::string cut = TextOf(field, "string", ExpressionText::Short(10));
  const std::string all = TextOf(field, "string");
  const std::string mark = "... (see --json)";
  ASSERT_GT(cut.size(), mark.size());
  const std::string shown = cut.substr(0, cut.size() - mark.size());
  EXPECT_EQ(cut.substr(shown.size()), mark);
  EXPECT_EQ(all.compare(0, shown.size(), shown), 0);
  EXPECT_LE(shown.size(), 600u);
  // The next byte begins a character.
  EXPECT_NE(static_cast<unsigned char>(all[shown.size()]) & 0xC0u, 0x80u);
}

}  // namespace
}  // namespace kestrel_tests
