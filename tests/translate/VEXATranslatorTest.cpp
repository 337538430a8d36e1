// Tests of the dictionaries of documents in the older format.

#include "kestrel/translate/VEXATranslator.h"

#include <gtest/gtest.h>

#include <limits>
#include <memory>
#include <sstream>
#include <string>
#include <vector>
#include <xercesc/dom/DOMElement.hpp>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/ScoreEncoder.h"
#include "kestrel/dictionary/ScoreValueLabel.h"
#include "kestrel/dictionary/ScoreValueLabelSet.h"
#include "kestrel/dictionary/ScoreVarStats.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/translate/DocumentReader.h"
#include "kestrel/translate/LegacyDictionary.h"
#include "tests/support/ExpectFault.h"

namespace {

using namespace MCKestrel_800;
using kestrel_tests::ExpectFault;

std::unique_ptr<ScoreDictionary> Read(const std::string& document) {
  std::istringstream in(document);
  return ReadLegacyDictionary(in);
}

/// A document around the inside of its dictionary, which begins on line 2.
std::string DocumentOf(const std::string& variables) {
  return "<vexa-ml><dictionary>\n" + variables + "</dictionary></vexa-ml>";
}

std::unique_ptr<ScoreDictionary> ReadVariables(const std::string& variables) {
  return Read(DocumentOf(variables));
}

std::string Number(const std::string& inside, const std::string& level = "NOMINAL") {
  return "<variable name='x' storage-type='NUMERIC' measurement-level='" + level + "'>" + inside +
         "</variable>";
}

std::string Text(const std::string& inside) {
  return "<variable name='x' storage-type='STRING' measurement-level='NOMINAL'>" + inside + "</variable>";
}

/// The one variable of a dictionary, as a copy that outlives the dictionary.
std::unique_ptr<ScoreDictVar> ReadOne(const std::string& variable) {
  const auto dictionary = ReadVariables(variable);
  return std::unique_ptr<ScoreDictVar>(dictionary->GetVar("x")->Clone());
}

TEST(VEXATranslator, ReadsADictionary) {
  const auto dictionary = ReadVariables(
      "<variable name='age' storage-type='NUMERIC' measurement-level='CONTINUOUS' label='age in years'>"
      " <var-stats minimum='18' maximum='99.5' mean='40' standard-deviation='1.5e1'>"
      "  <format-spec decimals='2' width='8'/></var-stats>"
      " <missing-values><category value='-1'/><range><category value='900'/><category value='999'/></range>"
      " </missing-values></variable> between "
      "<variable name='town' storage-type='STRING' measurement-level='NOMINAL'>"
      " <categories><category value='r' display-value='Rome'/><category value='b'/></categories>"
      " <missing-values><category value='n/a'/></missing-values></variable>"
      "<variable name='rank' storage-type='INTEGER' measurement-level='ORDINAL' label=''>"
      " <categories><category value='3'/><category value='1'/><category value='2'/></categories></variable>");
  EXPECT_EQ(dictionary->GetVarNames(), (std::vector<std::string>{"age", "town", "rank"}));

  const ScoreDictVar& age = *dictionary->GetVar("age");
  EXPECT_EQ(age.GetLabel(), "age in years");
  EXPECT_EQ(age.GetVarType(), ScoreDictVar::kNUMERIC_VAR);
  EXPECT_EQ(age.GetMLevel(), ScoreDictVar::kContinuous);
  EXPECT_EQ(age.GetDecimal(), 2);
  EXPECT_EQ(age.GetWidth(), 8);
  ASSERT_NE(age.GetVarStats(), nullptr);
  EXPECT_EQ(age.GetVarStats()->GetMin(), 18.0);
  EXPECT_EQ(age.GetVarStats()->GetMax(), 99.5);
  EXPECT_EQ(age.GetVarStats()->GetMean(), 40.0);
  EXPECT_EQ(age.GetVarStats()->GetStddev(), 15.0);
  EXPECT_EQ(age.GetEncoder(), nullptr) << "a continuous variable has no codes";
  const std::pair<double, bool> ages[] = {{-1.0, true},  {0.0, false},  {899.0, false},
                                          {900.0, true}, {999.0, true}, {1000.0, false}};
  for (const auto& [number, missing] : ages) {
    const NumericValue value(number);
    EXPECT_EQ(age.IsMissingValue(&value), missing) << number;
  }

  const ScoreDictVar& town = *dictionary->GetVar("town");
  EXPECT_EQ(town.GetLabel(), "");
  EXPECT_EQ(town.GetVarType(), ScoreDictVar::STRING_VAR);
  EXPECT_EQ(town.GetMLevel(), ScoreDictVar::kNominal);
  EXPECT_EQ(town.GetVarStats(), nullptr);
  EXPECT_EQ(town.GetNumberOfCats(), 2);
  const StringValue rome("r"), absent("n/a"), other("x");
  EXPECT_EQ(town.GetLabelOfValue(&rome), "Rome");
  EXPECT_TRUE(town.IsValidValue(&rome));
  EXPECT_FALSE(town.IsValidValue(&other));
  EXPECT_TRUE(town.IsMissingValue(&absent));
  ASSERT_NE(town.GetEncoder(), nullptr);
  EXPECT_EQ(town.GetEncoder()->EncodeConst("b"), 1);

  const ScoreDictVar& rank = *dictionary->GetVar("rank");
  EXPECT_EQ(rank.GetVarType(), ScoreDictVar::kNUMERIC_VAR) << "every type but STRING";
  EXPECT_EQ(rank.GetMLevel(), ScoreDictVar::kOrdinal);
  ASSERT_NE(rank.GetEncoder(), nullptr);
  for (int code = 0; code < 3; ++code)
    EXPECT_EQ(rank.GetEncoder()->DecodeNum(code), (code + 2) % 3 + 1.0) << "the document's order";
}

struct FaultRow {
  const char* why;
  std::string variables;
  int code;
  const char* text;
  unsigned line;
};

std::vector<FaultRow> FaultRows() {
  const char* const kDouble = "oneInvalid double string -- ";
  const char* const kNull = "Varname or storage type can't be null!!";
  const char* const kNullCategory = "category value is null!!";
  const char* const kNullBound = "category value is required!!";
  const char* const kNoBound = "category is required in range element node!!";
  const char* const kNoCategory = "category values are required!!!";
  const char* const kIntersect = "Missing Value and Valid value intersect";
  const std::string two = "<categories><category value='1'/><category value='2'/></categories>";
  const auto missing = [](const std::string& inside) {
    return "<missing-values>" + inside + "</missing-values>";
  };
  const auto range = [&missing](const std::string& inside) {
    return missing("<range>" + inside + "</range>");
  };
  return {
      {"no variable", "", 6, "Dicitonary is empty!!", 1},
      {"text alone", "x", 6, "Dicitonary is empty!!", 1},
      {"another element", "\n<Variable/>", 1, "Variable: should be variable", 3},
      {"another element behind a variable", Number("") + "\n<note/>", 1, "note: should be variable", 3},
      {"no name", "<variable storage-type=''/>", 4, "Attribute name is missing from Node \"variable\"", 2},
      {"no storage type", "<variable name=''/>", 4,
       "Attribute storage-type is missing from Node \"variable\"", 2},
      {"an empty name", "<variable name='' storage-type='STRING'/>", 7, kNull, 2},
      {"an empty storage type", "<variable name='x' storage-type=''/>", 7, kNull, 2},
      {"a name twice, before anything else is looked at",
       Number("") + "\n<variable name='x' storage-type='STRING'/>", 8, "x is duplicated!!!", 3},
      {"no level", "<variable name='x' storage-type='STRING'/>", 7, "Measurement-level can't be null!!", 2},
      {"an empty level", Number("", ""), 7, "Measurement-level can't be null!!", 2},
      {"a level in lower case", Number("", "continuous"), 11, "Invalid measurement-level attribute!!", 2},
      {"PMML's word", Number("", "CATEGORICAL"), 11, "Invalid measurement-level attribute!!", 2},
      {"a continuous text", "<variable name='x' storage-type='STRING' measurement-level='CONTINUOUS'/>", 11,
       "VEXATranslator::parseDictionary():Continuous variable should be numeric!!", 2},
      {"decimals", Number("<var-stats>\n<format-spec decimals='1.5'/></var-stats>"), 3,
       "1.5Invalid integer string -- ", 3},
      {"a width", Number("<var-stats>\n<format-spec width='one'/></var-stats>"), 3,
       "oneInvalid integer string -- ", 3},
      {"a minimum", Number("\n<var-stats minimum='one'/>"), 3, kDouble, 3},
      {"a maximum", Number("\n<var-stats maximum='one'/>"), 3, kDouble, 3},
      {"a mean", Number("\n<var-stats mean='one'/>"), 3, kDouble, 3},
      {"a deviation", Number("\n<var-stats standard-deviation='one'/>"), 3, kDouble, 3},
      {"a missing value that is absent", Number(missing("\n<category/>")), 7, kNullCategory, 3},
      {"a missing value that is empty", Text(missing("\n<category value=''/>")), 7, kNullCategory, 3},
      {"a missing value that is no number", Number(missing("\n<category value='one'/>")), 3, kDouble, 3},
      {"a range without bounds", Number(missing("\n<range/>")), 4, kNoBound, 3},
      {"a range with one bound", Number(range("<category value=''/><value/>")), 4, kNoBound, 2},
      {"a lower bound that is absent", Number(range("\n<category/>\n<category value='1'/>")), 7, kNullBound,
       3},
      {"an upper bound that is absent", Number(range("\n<category value='1'/>\n<category/>")), 7, kNullBound,
       4},
      {"a bound that is empty", Number(range("<category value=''/><category value='1'/>")), 7, kNullBound, 2},
      {"a lower bound that is no number", Number(range("\n<category value='one'/>\n<category value='1'/>")),
       3, kDouble, 3},
      {"an upper bound that is no number", Number(range("\n<category value='1'/>\n<category value='one'/>")),
       3, kDouble, 4},
      {"another element among the categories",
       Number("<categories><category value='1'/>\n<value value='2'/></categories>"), 1,
       "value: should be category", 3},
      {"a category that is no number", Number("<categories>\n<category value='one'/></categories>"), 3,
       kDouble, 3},
      {"a category twice", Number("<categories><category value='1'/>\n<category value='1.0'/></categories>"),
       1, "\"1\": Duplicated Category Value!", 3},
      {"a text twice but for trailing blanks",
       Text("<categories><category value='a'/>\n<category value='a '/></categories>"), 1,
       "\"a \": Duplicated Category Value!", 3},
      {"a category twice in two lists", Number(two + "\n" + two), 1, "\"1\": Duplicated Category Value!", 3},
      {"no categories", Number("\n<categories> </categories>"), 6, kNoCategory, 3},
      {"no categories, continuous", Number("\n<categories/>", "CONTINUOUS"), 6, kNoCategory, 3},
      {"a second list without categories", Number(two + "\n<categories/>"), 6, kNoCategory, 3},
      {"a category without a value", Number("<categories>\n<category/></categories>"), 6, kNoCategory, 3},
      {"an empty category among others",
       Text("<categories><category value='a'/>\n<category value=''/></categories>"), 6, kNoCategory, 3},
      {"faults of children come before that", Number("<categories/>\n" + missing("<category/>")), 7,
       kNullCategory, 3},
      {"missing and then valid", Number(missing("\n<category value='7'/><category value='2.0'/>") + two), 6,
       kIntersect, 3},
      {"valid and then missing", Number(two + missing("\n<category value='1'/>")), 6, kIntersect, 3},
      {"the same of texts",
       Text(missing("\n<category value='a '/>") + "<categories><category value='a'/></categories>"), 6,
       kIntersect, 3},
      {"a range of one number",
       Number(two + missing("\n<range><category value='1'/><category value='1'/></range>")), 6, kIntersect,
       3},
      {"the system-missing number as a category",
       Number("<categories>\n<category value='-1.7976931348623157e308'/></categories>"), 6, kIntersect, 3},
      {"the system-missing number as a labelled value",
       Number("<categories>\n<category value='-1.7976931348623157e308'/></categories>", "CONTINUOUS"), 6,
       kIntersect, 3},
  };
}

TEST(VEXATranslator, RefusesWhatIsWrongAndSaysWhere) {
  for (const FaultRow& row : FaultRows()) {
    ExpectFault([&row] { ReadVariables(row.variables); }, row.code, row.text, row.why);
    try {
      ReadVariables(row.variables);
    } catch (const KestrelException& fault) {
      EXPECT_EQ(fault.GetLine(), row.line) << row.why;
      EXPECT_GT(fault.GetColumn(), 0u) << row.why;
    }
  }
}

TEST(VEXATranslator, AsksForADictionary) {
  ExpectFault([] { VEXATranslator().ParseDictionary(nullptr); }, 1, "<DataDictionary is required !!");
  ExpectFault([] { Read("<vexa-ml><a><dictionary/></a></vexa-ml>"); }, 1, "<DataDictionary is required !!",
              "not directly below the root");
  ExpectFault([] { Read("<PMML><dictionary/></PMML>"); }, 5, "Unsupported Model found!", "another root");
  ExpectFault([] { Read("<vexa-ml><dictionary></vexa-ml>"); }, 6, "Invalid XML file!!");
}

TEST(VEXATranslator, TakesWhatIsAbsentOrUnknown) {
  struct Row {
    const char* why;
    std::string variable;
  };
  const Row rows[] = {
      {"nothing", Number("")},
      {"other children", Number("<note/>text<statistics minimum='one'/>")},
      {"other attributes",
       "<variable name='x' storage-type='NUMERIC' measurement-level='NOMINAL' role='one'/>"},
      {"empty attributes",
       Number("<var-stats minimum='' maximum='' mean='' standard-deviation=''><format-spec decimals='' "
              "width=''/></var-stats>")},
      {"no missing values", Number("<missing-values/>")},
      {"other elements among the missing values",
       Number("<missing-values><note value='1'/></missing-values>")},
  };
  for (const Row& row : rows) {
    const auto variable = ReadOne(row.variable);
    EXPECT_EQ(variable->GetVarStats(), nullptr) << row.why;
    EXPECT_EQ(variable->GetDecimal(), 0) << row.why;
    EXPECT_EQ(variable->GetWidth(), -1) << row.why;
    EXPECT_EQ(variable->GetNumberOfCats(), 0) << row.why;
    EXPECT_TRUE(variable->IsEmptyCateValues()) << row.why;
    EXPECT_NE(variable->GetEncoder(), nullptr) << row.why;
    const NumericValue one(1.0);
    EXPECT_FALSE(variable->IsMissingValue(&one)) << row.why;
  }
}

TEST(VEXATranslator, KeepsTheStatisticsThatAreGiven) {
  const auto variable = ReadOne(Number("<var-stats mean='2.5'/><var-stats minimum='-1'/>", "CONTINUOUS"));
  ASSERT_NE(variable->GetVarStats(), nullptr);
  EXPECT_EQ(variable->GetVarStats()->GetMin(), -1.0);
  EXPECT_EQ(variable->GetVarStats()->GetMean(), 2.5);
  EXPECT_EQ(variable->GetVarStats()->GetMax(), std::numeric_limits<double>::max());
  EXPECT_EQ(variable->GetVarStats()->GetStddev(), 1.0);
}

TEST(VEXATranslator, ClosesRangesAtBothEnds) {
  const auto variable = ReadOne(
      Number("<missing-values><range><note/><category value='1'/><category value='2'/><category value='9'/>"
             "</range><range><category value='5'/><category value='4'/></range>"
             "<range><category value='7'/><category value='1e999'/></range></missing-values>",
             "CONTINUOUS"));
  const std::pair<double, bool> rows[] = {{0.9, false}, {1.0, true},  {1.5, true}, {2.0, true}, {2.1, false},
                                          {4.5, false}, {6.9, false}, {7.0, true}, {1e30, true}};
  for (const auto& [number, missing] : rows) {
    const NumericValue value(number);
    EXPECT_EQ(variable->IsMissingValue(&value), missing) << number;
  }
}

TEST(VEXATranslator, LetsACategoryStandInAMissingRange) {
  const auto variable = ReadOne(
      Number("<missing-values><range><category value='1'/><category value='3'/></range></missing-values>"
             "<categories><category value='2'/></categories>"));
  const NumericValue inside(1.5), category(2.0);
  EXPECT_TRUE(variable->IsMissingValue(&inside));
  EXPECT_FALSE(variable->IsMissingValue(&category));
}

TEST(VEXATranslator, TakesAMissingValueTwice) {
  const auto variable = ReadOne(
      Text("<missing-values><category value='a'/><category value='a '/><range><category value='b'/><category "
           "value='b'/></range><range><category value='c'/><category value='e'/></range></missing-values>"));
  EXPECT_EQ(variable->GetMissingValues()->Size(), 3u);
  const std::pair<const char*, bool> rows[] = {{"a", true}, {"b", true}, {"c", false}, {"d", false}};
  for (const auto& [text, missing] : rows) {
    const StringValue value(text);
    EXPECT_EQ(variable->IsMissingValue(&value), missing) << text << ": only a range of one text holds texts";
  }
}

TEST(VEXATranslator, LabelsTheNumbersOfAContinuousVariable) {
  const auto variable =
      ReadOne(Number("<categories><category value='0' display-value='none'/></categories>", "CONTINUOUS"));
  const NumericValue zero(0.0), one(1.0);
  EXPECT_EQ(variable->GetLabelOfValue(&zero), "none");
  EXPECT_TRUE(variable->IsValidValue(&one));
  EXPECT_EQ(variable->GetEncoder(), nullptr);
}

TEST(VEXATranslator, SetsEncodersUpForCategoriesAlone) {
  VEXATranslator translator;
  EXPECT_FALSE(translator.SetupCatEncoder(nullptr));
  DictVar variable("x", ScoreDictVar::kNUMERIC_VAR);
  EXPECT_FALSE(translator.SetupCatEncoder(&variable));
  EXPECT_EQ(variable.GetEncoder(), nullptr);
  variable.SetMLevel(ScoreDictVar::kOrdinal);
  variable.AddScoreValueLabel(new NumericValue(8.0), "eight");
  EXPECT_TRUE(translator.SetupCatEncoder(&variable));
  ASSERT_NE(variable.GetEncoder(), nullptr);
  EXPECT_EQ(variable.GetEncoder()->DecodeNum(0), 8.0);
  const ScoreEncoder* const encoder = variable.GetEncoder();
  EXPECT_TRUE(translator.SetupCatEncoder(&variable));
  EXPECT_EQ(variable.GetEncoder(), encoder) << "one that is there stays";
  EXPECT_EQ(encoder->GetNumberOfCategories(), 1);
}

TEST(VEXATranslator, CopiesReadOnTheirOwn) {
  std::istringstream in(DocumentOf(Text("")));
  const auto document = ReadDocument(in);
  auto original = std::make_unique<VEXATranslator>();
  original->CreateTranscoder("CP1252");
  VEXATranslator copy(*original);
  EXPECT_NE(copy.GetTranscoder(), nullptr);
  original.reset();
  xercesc::DOMElement* const element = document->GetRoot()->getFirstElementChild();
  const std::unique_ptr<ScoreDictionary> dictionary(copy.ParseDictionary(element));
  EXPECT_EQ(dictionary->Size(), 1u);
  const std::unique_ptr<ScoreDictionary> again(copy.ParseDictionary(element));
  EXPECT_EQ(again->Size(), 1u) << "a reader keeps nothing";
  EXPECT_EQ(copy.ParseFromTree(document->GetRoot(), ""), nullptr) << "it makes no models";
}

TEST(VEXATranslator, KeepsTheOrderOfManyVariables) {
  constexpr int kCount = 20000;
  std::string variables;
  for (int i = kCount; i > 0; --i) {
    variables += "<variable name='v" + std::to_string(i) +
                 "' storage-type='STRING' measurement-level='ORDINAL'><categories><category value='a" +
                 std::to_string(i) + "'/></categories></variable>\n";
  }
  const auto dictionary = ReadVariables(variables);
  const std::vector<std::string> names = dictionary->GetVarNames();
  ASSERT_EQ(names.size(), static_cast<std::size_t>(kCount));
  for (int i = 0; i < kCount; ++i) {
    const std::string number = std::to_string(kCount - i);
    ASSERT_EQ(names[static_cast<std::size_t>(i)], "v" + number);
    ASSERT_EQ(dictionary->GetVar("v" + number)->GetEncoder()->EncodeConst("a" + number), 0);
  }
}

// Comparing each with each would take ten thousand million steps for each of the lists.
TEST(VEXATranslator, ReadsLongListsInOneWalk) {
  constexpr int kCount = 100000;
  std::string categories, missing, ranges;
  for (int i = 0; i < kCount; ++i) {
    const std::string number = std::to_string(i);
    categories += "<category value='" + number + "'/>";
    missing += "<category value='-" + number + ".5'/>";
    ranges += "<range><category value='" + number + ".25'/><category value='" + number + ".75'/></range>";
  }
  categories = "<categories>" + categories + "</categories>";
  const auto dictionary =
      ReadVariables(Text("<missing-values>" + missing + "</missing-values>" + categories));
  const ScoreDictVar& variable = *dictionary->GetVar("x");
  EXPECT_EQ(variable.GetNumberOfCats(), kCount);
  EXPECT_EQ(variable.GetMissingValues()->Size(), static_cast<std::size_t>(kCount));
  EXPECT_EQ(variable.GetEncoder()->EncodeConst(std::to_string(kCount - 1)), kCount - 1);
  const std::string twice = "<category value='99999'/></missing-values>";
  ExpectFault([&] { ReadVariables(Number(categories + "<missing-values>" + missing + ranges + twice)); }, 6,
              "Missing Value and Valid value intersect");
}

}  // namespace
