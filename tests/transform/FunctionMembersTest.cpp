// The built-in functions as members of the dictionary that hosts call.

#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ValueLbl.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "tests/transform/FunctionRows.h"

namespace MCKestrel_800 {
namespace {

using kestrel_tests::FunctionRow;
using kestrel_tests::IsAsWanted;
using kestrel_tests::RowValue;

using Dictionary = TransformationDictionary;

struct NumberMember {
  const char* name;
  double (*member)(const std::vector<double>&);
};
constexpr NumberMember kNumberMembers[] = {
    {"-", Dictionary::Minus},
    {"*", Dictionary::Multiply},
    {"/", Dictionary::Divided},
    {"sum", Dictionary::Sum},
    {"mean", Dictionary::Mean},
    {"min", Dictionary::Min},
    {"max", Dictionary::Max},
    {"product", Dictionary::ProductOperator},
    {"median", Dictionary::MedianOperator},
    {"sd", Dictionary::Sd},
    {"variance", Dictionary::Variance},
    {"cdf.normal", Dictionary::CdfNormal},
    {"idf.normal", Dictionary::IdfNormal},
    {"pdf.normal", Dictionary::PdfNormal},
    {"lessThan", Dictionary::lessThan},
    {"lessOrEqual", Dictionary::lessOrEqual},
    {"greaterThan", Dictionary::greaterThan},
    {"greaterOrEqual", Dictionary::greaterOrEqual},
    {"and", Dictionary::AndOperator},
    {"or", Dictionary::OrOperator},
    {"not", Dictionary::NotOperator},
};

TEST(FunctionMembers, OfNumbersGiveWhatTheRowsSay) {
  for (const auto* rows : {&kestrel_tests::ArithmeticRows(), &kestrel_tests::SummaryRows(),
                           &kestrel_tests::NormalRows(), &kestrel_tests::LogicalRows()}) {
    for (const FunctionRow& row : *rows) {
      const auto* const member =
          std::find_if(std::begin(kNumberMembers), std::end(kNumberMembers),
                       [&row](const NumberMember& m) { return m.name == std::string(row.name); });
      ASSERT_NE(member, std::end(kNumberMembers)) << row.name;
      std::vector<double> numbers;
      for (const RowValue& argument : row.arguments)
        numbers.push_back(argument.number);
      const double result = member->member(numbers);
      EXPECT_TRUE(IsAsWanted(result, row.want, row.tolerance)) << row << " is " << result;
    }
  }
}

RowValue CallText(const FunctionRow& row) {
  const std::string name = row.name;
  int length = 99;
  std::string text;
  if (name == "concat") {
    std::vector<std::string> texts;
    std::vector<int> widths;
    for (const RowValue& argument : row.arguments) {
      texts.push_back(argument.text);
      // The caller says the widths.
      widths.push_back(argument.length == 0 ? static_cast<int>(argument.text.size()) : argument.length);
    }
    text = Dictionary::Concat(texts, widths, length);
  } else {
    StringValue value(row.arguments[0].text);
    value.SetLength(row.arguments[0].length);
    text = name == "substr"      ? Dictionary::Substring(value, row.arguments[1].number, length)
           : name == "uppercase" ? Dictionary::ToUpperCase(value, length)
           : name == "ltrim"     ? Dictionary::Ltrim(value, length)
           : name == "rtrim"     ? Dictionary::Rtrim(value, length)
                                 : Dictionary::ToLowerCase(value, length);
  }
  return kestrel_tests::Wide(text.c_str(), length);
}

TEST(FunctionMembers, OfTextsGiveWhatTheRowsSay) {
  for (const FunctionRow& row : kestrel_tests::TextRows()) {
    const RowValue result = CallText(row);
    EXPECT_TRUE(IsAsWanted(result, row.want, 0.0)) << row << " is " << result;
  }
}

std::vector<ScoreValue*> ValuesOf(const std::vector<RowValue>& values) {
  std::vector<ScoreValue*> list;
  for (const RowValue& value : values)
    list.push_back(value.ToValue().release());
  return list;
}

void DeleteAll(std::vector<ScoreValue*>& values) {
  for (ScoreValue* value : values)
    delete value;
}

TEST(FunctionMembers, OfValuesGiveWhatTheRowsSayAndDeleteThem) {
  for (const FunctionRow& row : kestrel_tests::ValueRows()) {
    const BuiltinFunction& function = *FindBuiltinFunction(row.name);
    double result = 0.0;
    bool is_left = false;
    std::vector<ScoreValue*> values =
        ValuesOf(function.family == FunctionFamily::kValueList ? row.arrays[0] : row.arguments);
    if (function.family == FunctionFamily::kValueList) {
      ScoreValue* argument = row.arguments.empty() ? nullptr : row.arguments[0].ToValue().release();
      result = function.code == kIsInFunction ? Dictionary::isIn(values, argument)
                                              : Dictionary::isNotIn(values, argument);
    } else {
      is_left = values.size() == 2 && values[0]->GetType() != values[1]->GetType();
      result = function.code == kEqualFunction ? Dictionary::equal(values) : Dictionary::notEqual(values);
    }
    EXPECT_EQ(result, row.want.number) << row;
    EXPECT_EQ(values.size(), is_left ? 2u : 0u) << row;
    DeleteAll(values);
  }
}

TEST(FunctionMembers, NullAmongValuesEqualsNothing) {
  std::vector<ScoreValue*> values = {nullptr, nullptr};
  EXPECT_EQ(Dictionary::equal(values), 0.0);
  EXPECT_TRUE(values.empty());
  values = {new NumericValue(1.0), nullptr};
  EXPECT_EQ(Dictionary::notEqual(values), 1.0);
  EXPECT_TRUE(values.empty());
  values = {nullptr, new NumericValue(1.0)};
  EXPECT_EQ(Dictionary::isIn(values, new NumericValue(1.0)), 1.0);
  EXPECT_TRUE(values.empty());
}

TEST(FunctionMembers, OutlierHandleTakesTheMethodAsItsCode) {
  EXPECT_EQ(Dictionary::OutlierHandle(9.0, ScoreDictVar::kAsExtremeValues, 4.0, 2.0, 3.0, 9.0), 6.0);
  EXPECT_EQ(Dictionary::OutlierHandle(1.0, ScoreDictVar::kAsExtremeValues, 4.0, 2.0, 3.0, 9.0), 2.0);
  for (const int method : {0, 1, 3, -1}) {
    EXPECT_EQ(Dictionary::OutlierHandle(9.0, method, 4.0, 2.0, 3.0, 9.0), NumericValue::gSysmisValue);
    EXPECT_EQ(Dictionary::OutlierHandle(5.0, method, 4.0, 2.0, 3.0, 9.0), 5.0);
  }
}

class Imputation : public testing::Test {
 protected:
  const ScoreValue* Impute(double t, const std::vector<double>& means, const std::vector<double>& variances) {
    return Dictionary::ImputeCatFieldMissingAgainstConTargetHandle(t, {&red_, &green_}, means, variances);
  }

  ValueLbl red_{new StringValue("red"), ""};
  ValueLbl green_{new StringValue("green"), ""};
};

TEST_F(Imputation, GivesTheValueOfTheNearestCategory) {
  EXPECT_EQ(Impute(11.0, {10.0, 20.0}, {1.0, 1.0}), red_.GetValue());
  EXPECT_EQ(Impute(16.0, {10.0, 20.0}, {1.0, 1.0}), green_.GetValue());
  EXPECT_EQ(Impute(15.0, {10.0, 20.0}, {1.0, 1.0}), red_.GetValue());
  EXPECT_EQ(Impute(11.0, {10.0, 20.0}, {0.01, 100.0}), green_.GetValue());
  // More variances than means, and fewer categories than means as long as the nearest has one.
  EXPECT_EQ(Impute(11.0, {10.0, 20.0}, {1.0, 1.0, 1.0}), red_.GetValue());
  EXPECT_EQ(Impute(11.0, {10.0, 20.0, 30.0}, {1.0, 1.0, 1.0}), red_.GetValue());
}

TEST_F(Imputation, ThrowsWhenTheNearestHasNoCategory) {
  struct Row {
    std::vector<double> means, variances;
    const char* why;
  };
  const Row kRows[] = {
      {{}, {}, "no means"},
      {{}, {1.0}, "no means, but a variance"},
      {{10.0, 20.0}, {1.0}, "too few variances"},
      {{30.0, 20.0, 11.0}, {1.0, 1.0, 1.0}, "the third of two categories"},
  };
  for (const Row& row : kRows) {
    try {
      Impute(11.0, row.means, row.variances);
      ADD_FAILURE() << row.why;
    } catch (const std::out_of_range& e) {
      EXPECT_STREQ(e.what(), "invalid vector<T> subscript") << row.why;
    }
  }
}

}  // namespace
}  // namespace MCKestrel_800
