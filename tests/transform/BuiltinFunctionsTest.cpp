#include "kestrel/transform/BuiltinFunctions.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <set>
#include <string>
#include <vector>

#include "tests/transform/FunctionRows.h"

namespace MCKestrel_800 {
namespace {

std::vector<BuiltinFunction> AllFunctions() {
  std::size_t count = 0;
  const BuiltinFunction* rows = GetBuiltinFunctions(count);
  return {rows, rows + count};
}

std::set<int> CodesWhere(bool (*test)(const BuiltinFunction&)) {
  std::set<int> codes;
  for (const BuiltinFunction& row : AllFunctions()) {
    if (test(row)) codes.insert(row.code);
  }
  return codes;
}

/// All from a number to a number, and some more.
std::set<int> Codes(std::initializer_list<std::pair<int, int>> ranges, std::initializer_list<int> others) {
  std::set<int> codes = others;
  for (const auto& [first, last] : ranges) {
    for (int code = first; code <= last; ++code)
      codes.insert(code);
  }
  return codes;
}

// What documents and hosts rely on; a new function is a new line here.
const std::map<std::string, int> kCodesOfNames = {
    {"+", 0},
    {"-", 1},
    {"*", 2},
    {"/", 3},
    {"pow", 4},
    {"abs", 5},
    {"exp", 6},
    {"log10", 7},
    {"lg10", 7},
    {"ln", 8},
    {"mod", 9},
    {"round", 10},
    {"sqrt", 11},
    {"trunc", 12},
    {"cdf.normal", 13},
    {"cdfnorm", 14},
    {"idf.normal", 15},
    {"pdf.normal", 16},
    {"max", 17},
    {"mean", 18},
    {"avg", 18},
    {"min", 19},
    {"sd", 20},
    {"sum", 21},
    {"variance", 22},
    {"concat", 23},
    {"length", 24},
    {"lower", 25},
    {"ltrim", 26},
    {"rtrim", 27},
    {"trimend", 27},
    {"substr", 28},
    {"uppercase", 29},
    {"sysmis", 30},
    {"value", 31},
    {"date_years_difference", 32},
    {"date_months_difference", 33},
    {"date_days_difference", 34},
    {"year-from-date", 35},
    {"month-from-date", 36},
    {"day-from-date", 37},
    {"time_hours_difference", 38},
    {"time_minutes_difference", 39},
    {"time_seconds_difference", 40},
    {"hour-from-time", 41},
    {"minute-from-time", 42},
    {"second-from-time", 43},
    {"recast_to_ordinal", 44},
    {"recast_to_scale", 45},
    {"outlierHandle", 46},
    {"isMissing", 47},
    {"isNotMissing", 48},
    {"equal", 49},
    {"notEqual", 50},
    {"lessThan", 51},
    {"lessOrEqual", 52},
    {"greaterThan", 53},
    {"greaterOrEqual", 54},
    {"isIn", 55},
    {"isNotIn", 56},
    {"and", 57},
    {"or", 58},
    {"not", 59},
    {"if", 60},
    {"threshold", 61},
    {"floor", 62},
    {"ceil", 63},
    {"imputeCatFieldMissingAgainstConTarget", 64},
    {"median", 66},
    {"product", 67},
    {"lowercase", 68},
};

TEST(BuiltinFunctions, NamesHaveTheirCodes) {
  std::map<std::string, int> found;
  for (const BuiltinFunction& row : AllFunctions())
    EXPECT_TRUE(found.emplace(row.name, row.code).second) << row.name << " is there twice";
  EXPECT_EQ(found, kCodesOfNames);
}

TEST(BuiltinFunctions, AreFoundByTheirExactName) {
  for (const auto& [name, code] : kCodesOfNames) {
    const BuiltinFunction* row = FindBuiltinFunction(name);
    ASSERT_NE(row, nullptr) << name;
    EXPECT_EQ(row->name, name);
    EXPECT_EQ(row->code, code);
  }
  for (const char* name : {"", "ABS", "Abs", "lessthan", "abs ", " abs", "ab", "abss", "plus", "imputeCat"})
    EXPECT_EQ(FindBuiltinFunction(name), nullptr) << name;
}

TEST(BuiltinFunctions, AreFoundByTheirCode) {
  for (int code = -2; code <= 70; ++code) {
    const BuiltinFunction* row = FindBuiltinFunction(static_cast<TransformFunction>(code));
    const bool exists = code >= 0 && code <= 68 && code != kNoFunction;
    ASSERT_EQ(row != nullptr, exists) << code;
    if (exists) {
      EXPECT_EQ(row->code, code);
    }
  }
  EXPECT_STREQ(FindBuiltinFunction(kLog10Function)->name, "log10");
  EXPECT_STREQ(FindBuiltinFunction(kMeanFunction)->name, "mean");
  EXPECT_STREQ(FindBuiltinFunction(kRtrimFunction)->name, "rtrim");
}

TEST(BuiltinFunctions, NamesOfOneCodeDifferInNothingElse) {
  for (const BuiltinFunction& row : AllFunctions()) {
    const BuiltinFunction& first = *FindBuiltinFunction(row.code);
    EXPECT_EQ(row.family, first.family) << row.name;
    EXPECT_EQ(row.argument, first.argument) << row.name;
    EXPECT_EQ(row.result, first.result) << row.name;
    EXPECT_EQ(row.min_arguments, first.min_arguments) << row.name;
    EXPECT_EQ(row.max_arguments, first.max_arguments) << row.name;
    EXPECT_EQ(row.arrays, first.arrays) << row.name;
    EXPECT_STREQ(row.arity_text, first.arity_text) << row.name;
    EXPECT_EQ(row.check, first.check) << row.name;
    EXPECT_EQ(row.nesting, first.nesting) << row.name;
    EXPECT_EQ(row.missing, first.missing) << row.name;
    EXPECT_STREQ(row.meaning, first.meaning) << row.name;
  }
}

TEST(BuiltinFunctions, EveryFunctionHasRowsThatSayWhatItGives) {
  std::set<int> codes_with_rows;
  for (const kestrel_tests::FunctionRow& row : kestrel_tests::AllFunctionRows()) {
    const BuiltinFunction* function = FindBuiltinFunction(row.name);
    ASSERT_NE(function, nullptr) << row.name;
    codes_with_rows.insert(function->code);
  }
  for (const BuiltinFunction& row : AllFunctions())
    EXPECT_EQ(codes_with_rows.count(row.code), 1u) << row.name;
}

TEST(BuiltinFunctions, TakeTheirNumberOfArguments) {
  struct Row {
    std::set<int> codes;
    int min, max, arrays;
    const char* text;
  };
  constexpr int kAny = BuiltinFunction::kAnyNumber;
  const Row kRows[] = {
      {Codes({{0, 4}, {49, 54}}, {9, 28, 61}), 2, 2, 0, "Two parameters are required!"},
      {Codes({{32, 34}, {38, 40}}, {}), 2, 2, 0, "Two parameters are required!"},
      {Codes({{5, 8}, {10, 12}, {24, 27}, {29, 31}}, {14, 44, 45, 47, 48, 59, 62, 63, 68}), 1, 1, 0,
       "Only one parameter is allowed!"},
      {Codes({{35, 37}, {41, 43}}, {}), 1, 1, 0, "Only one parameter is required!"},
      {{55, 56}, 1, 1, 1, "Only one parameter is allowed!"},
      {{13, 15, 16}, 3, 3, 0, "Three parameters are required!"},
      {{60}, 2, 3, 0, "Three parameters are required!"},
      {{46}, 6, 6, 0, "Six parameters are required!"},
      {{64}, 2, 2, 2, "PMML error for IMPUTECATFIELDMISSINGAGAINSTCONTARGET"},
      {Codes({{17, 23}}, {57, 58, 66, 67}), 0, kAny, 0, ""},
  };
  std::set<int> seen;
  for (const Row& row : kRows) {
    for (const int code : row.codes) {
      const BuiltinFunction& function = *FindBuiltinFunction(static_cast<TransformFunction>(code));
      EXPECT_EQ(function.min_arguments, row.min) << function.name;
      EXPECT_EQ(function.max_arguments, row.max) << function.name;
      EXPECT_EQ(function.arrays, row.arrays) << function.name;
      EXPECT_STREQ(function.arity_text, row.text) << function.name;
      for (int count = 0; count < 9; ++count) {
        EXPECT_EQ(function.TakesCount(static_cast<std::size_t>(count)),
                  count >= row.min && (row.max == kAny || count <= row.max))
            << function.name << " with " << count;
      }
      seen.insert(code);
    }
  }
  EXPECT_EQ(seen, CodesWhere([](const BuiltinFunction&) { return true; }));
}

TEST(BuiltinFunctions, FamiliesAreThoseOfTheEvaluation) {
  EXPECT_EQ(CodesWhere([](const BuiltinFunction& row) { return row.family == FunctionFamily::kList; }),
            Codes({{1, 3}, {15, 22}, {51, 54}, {57, 59}}, {13, 66, 67}));
  EXPECT_EQ(CodesWhere([](const BuiltinFunction& row) { return row.family == FunctionFamily::kText; }),
            Codes({{25, 29}}, {23, 68}));
  EXPECT_EQ(CodesWhere([](const BuiltinFunction& row) { return row.family == FunctionFamily::kDateTime; }),
            Codes({{32, 43}}, {}));
  EXPECT_EQ(CodesWhere([](const BuiltinFunction& row) { return row.family == FunctionFamily::kComparison; }),
            Codes({}, {49, 50}));
  EXPECT_EQ(CodesWhere([](const BuiltinFunction& row) { return row.family == FunctionFamily::kValueList; }),
            Codes({}, {55, 56}));
  EXPECT_EQ(CodesWhere([](const BuiltinFunction& row) { return row.family == FunctionFamily::kSpecial; }),
            Codes({{44, 48}}, {24, 30, 31, 60, 64}));
}

TEST(BuiltinFunctions, ChecksAndNestingAreThoseOfTheReader) {
  EXPECT_EQ(CodesWhere([](const BuiltinFunction& row) { return row.nesting == FunctionNesting::kNumeric; }),
            Codes({{0, 22}}, {30, 60, 64, 66, 67}));
  EXPECT_EQ(CodesWhere([](const BuiltinFunction& row) { return row.nesting == FunctionNesting::kString; }),
            Codes({{25, 27}}, {23, 29, 68}));
  EXPECT_EQ(CodesWhere([](const BuiltinFunction& row) { return row.nesting == FunctionNesting::kLength; }),
            Codes({}, {24}));
  EXPECT_EQ(CodesWhere([](const BuiltinFunction& row) { return row.check == FunctionArgumentCheck::kKind; }),
            Codes({{17, 24}}, {66, 67}));
  EXPECT_EQ(CodesWhere([](const BuiltinFunction& row) { return row.check == FunctionArgumentCheck::kField; }),
            Codes({}, {30, 31, 44, 45, 47, 48}));
}

TEST(BuiltinFunctions, SomeTakeOneArgumentOfAnotherKind) {
  struct Row {
    std::set<int> codes;
    int index;
    FunctionValueKind kind, others;
  };
  const Row kRows[] = {
      {{28}, 1, FunctionValueKind::kNumber, FunctionValueKind::kText},
      {Codes({{32, 34}, {38, 40}}, {}), 1, FunctionValueKind::kNumber, FunctionValueKind::kDateTime},
      {{46}, 1, FunctionValueKind::kText, FunctionValueKind::kNumber},
      {{60}, 0, FunctionValueKind::kNumber, FunctionValueKind::kAny},
      {{64}, 1, FunctionValueKind::kNumber, FunctionValueKind::kAny},
  };
  std::set<int> seen;
  for (const Row& row : kRows) {
    for (const int code : row.codes) {
      const BuiltinFunction& function = *FindBuiltinFunction(static_cast<TransformFunction>(code));
      for (int i = 0; i < function.max_arguments; ++i)
        EXPECT_EQ(function.KindOfArgument(i), i == row.index ? row.kind : row.others) << function.name << i;
      seen.insert(code);
    }
  }
  EXPECT_EQ(CodesWhere([](const BuiltinFunction& row) { return row.odd_index >= 0; }), seen);
}

}  // namespace
}  // namespace MCKestrel_800
