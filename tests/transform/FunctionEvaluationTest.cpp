#include "kestrel/transform/FunctionEvaluation.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <optional>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "tests/support/AllocationCount.h"
#include "tests/transform/FunctionRows.h"

namespace MCKestrel_800 {
namespace {

using kestrel_tests::AllFunctionRows;
using kestrel_tests::FunctionRow;
using kestrel_tests::IsAsWanted;
using kestrel_tests::RowValue;

constexpr double kSysmis = NumericValue::gSysmisValue;

StringValue TextOf(const RowValue& value) {
  StringValue text(value.text);
  text.SetLength(value.length);
  return text;
}

std::vector<double> NumbersOf(const std::vector<RowValue>& values) {
  std::vector<double> numbers;
  for (const RowValue& value : values)
    numbers.push_back(value.number);
  return numbers;
}

RowValue TextResult(const std::string& text, int32_t length) {
  RowValue result(text.c_str());
  result.length = length;
  return result;
}

RowValue ComputeText(const FunctionRow& row, TransformFunction function) {
  // What was in them before does not matter.
  std::string text = "left over";
  int32_t length = 99;
  if (function == kConcatFunction) {
    text.clear();
    length = 0;
    for (const RowValue& argument : row.arguments)
      AppendText(TextOf(argument), text, length);
  } else if (function == kSubstrFunction) {
    ApplySubstring(TextOf(row.arguments[0]), row.arguments[1].number, text, length);
  } else {
    ApplyTextFunction(TextOf(row.arguments[0]), function, text, length);
  }
  return TextResult(text, length);
}

double ComputeList(const std::vector<double>& numbers, TransformFunction function) {
  std::vector<double> scratch = {1e300, -5.0};
  const double result = ApplyAccumulateFunction(numbers.data(), numbers.size(), function, scratch);
  EXPECT_EQ(result, ApplyAccumulateFunction(numbers.data(), numbers.size(), function));
  return result;
}

std::optional<RowValue> ComputeValues(const FunctionRow& row, const BuiltinFunction& function) {
  if (function.family == FunctionFamily::kComparison) {
    if (row.arguments.size() != 2) return std::nullopt;
    const bool equal = AreEqualValues(*row.arguments[0].ToValue(), *row.arguments[1].ToValue());
    return equal == (function.code == kEqualFunction) ? 1.0 : 0.0;
  }
  if (row.arguments.size() != 1) return std::nullopt;
  std::vector<std::unique_ptr<ScoreValue>> owned;
  std::vector<const ScoreValue*> listed = {nullptr};
  for (const RowValue& value : row.arrays[0]) {
    owned.push_back(value.ToValue());
    listed.push_back(owned.back().get());
  }
  return IsAmong(*row.arguments[0].ToValue(), listed) == (function.code == kIsInFunction) ? 1.0 : 0.0;
}

int MethodOf(const std::string& text) {
  return text == "asExtremeValues"   ? ScoreDictVar::kAsExtremeValues
         : text == "asMissingValues" ? ScoreDictVar::kAsMissingValues
                                     : ScoreDictVar::kAsIs;
}

std::optional<RowValue> ComputeSpecial(const FunctionRow& row, TransformFunction function) {
  const std::vector<RowValue>& a = row.arguments;
  switch (function) {
    case kLengthFunction:
      return static_cast<double>(LengthOf(TextOf(a[0])));
    case kOutlierHandleFunction:
      return HandleOutlier(a[0].number, MethodOf(a[1].text), a[2].number, a[3].number, a[4].number,
                           a[5].number);
    case kIfFunction:
      if (IsTrueCondition(a[0].number)) return a[1];
      return a.size() > 2 ? a[2] : RowValue();
    case kImputeFunction: {
      if (a[0].number != kSysmis || a[1].number == kSysmis) return std::nullopt;
      const std::vector<double> means = NumbersOf(row.arrays[0]), variances = NumbersOf(row.arrays[1]);
      return 1.0 +
             static_cast<double>(NearestMean(a[1].number, means.data(), variances.data(), means.size()));
    }
    default:
      return std::nullopt;  // what needs a field
  }
}

std::optional<RowValue> Compute(const FunctionRow& row, const BuiltinFunction& function) {
  const std::vector<double> numbers = NumbersOf(row.arguments);
  switch (function.family) {
    case FunctionFamily::kScalar:
      return ApplyTransFunction(numbers[0], numbers.size() > 1 ? numbers[1] : kSysmis, function.code);
    case FunctionFamily::kList:
      return ComputeList(numbers, function.code);
    case FunctionFamily::kText:
      return ComputeText(row, function.code);
    case FunctionFamily::kDateTime:
      return ApplyDateTimeFunction(numbers[0], numbers.size() > 1 ? numbers[1] : 0.0, function.code);
    case FunctionFamily::kComparison:
    case FunctionFamily::kValueList:
      return ComputeValues(row, function);
    case FunctionFamily::kSpecial:
      return ComputeSpecial(row, function.code);
  }
  return std::nullopt;
}

TEST(FunctionEvaluation, GivesWhatTheRowsSay) {
  for (const FunctionRow& row : AllFunctionRows()) {
    const BuiltinFunction* function = FindBuiltinFunction(row.name);
    ASSERT_NE(function, nullptr) << row.name;
    const std::optional<RowValue> result = Compute(row, *function);
    if (!result) continue;
    EXPECT_TRUE(IsAsWanted(*result, row.want, row.tolerance)) << row << " is " << *result;
  }
}

TEST(FunctionEvaluation, NoCodeOfAnotherFamilyIsComputed) {
  const double numbers[] = {4.0, 2.0};
  std::size_t count = 0;
  const BuiltinFunction* functions = GetBuiltinFunctions(count);
  for (std::size_t i = 0; i < count; ++i) {
    const BuiltinFunction& function = functions[i];
    if (function.family != FunctionFamily::kScalar) {
      EXPECT_EQ(ApplyTransFunction(4.0, 2.0, function.code), 0.0) << function.name;
    }
    if (function.family != FunctionFamily::kList) {
      EXPECT_EQ(ApplyAccumulateFunction(numbers, 2, function.code), kSysmis) << function.name;
    }
    if (function.family != FunctionFamily::kDateTime) {
      EXPECT_EQ(ApplyDateTimeFunction(4.0, 2.0, function.code), kSysmis) << function.name;
    }
    if (function.family != FunctionFamily::kText) {
      std::string text = "left over";
      int32_t length = 9;
      ApplyTextFunction(StringValue("abc"), function.code, text, length);
      EXPECT_EQ(text, "") << function.name;
      EXPECT_EQ(length, 0) << function.name;
    }
  }
  EXPECT_EQ(ApplyTransFunction(4.0, 2.0, kNoFunction), 0.0);
  EXPECT_EQ(ApplyTransFunction(4.0, 2.0, static_cast<TransformFunction>(-1)), 0.0);
}

const double kNastyNumbers[] = {
    kSysmis,
    0.0,
    -0.0,
    1.0,
    -1.0,
    0.5,
    2147483647.0,
    -2147483648.0,
    9.3e18,
    1e308,
    -1e308,
    5e-324,
    std::numeric_limits<double>::max(),
    NumericValue::gInfinity,
    -NumericValue::gInfinity,
    std::numeric_limits<double>::quiet_NaN(),
};

TEST(FunctionEvaluation, NumbersOfAnySortGiveANumber) {
  std::size_t row_count = 0;
  const BuiltinFunction* functions = GetBuiltinFunctions(row_count);
  for (std::size_t i = 0; i < row_count; ++i) {
    const BuiltinFunction& function = functions[i];
    for (const double x : kNastyNumbers) {
      for (const double y : kNastyNumbers) {
        EXPECT_TRUE(std::isfinite(ApplyTransFunction(x, y, function.code))) << function.name << x << ' ' << y;
        EXPECT_TRUE(std::isfinite(ApplyDateTimeFunction(x, y, function.code)))
            << function.name << x << ' ' << y;
        for (const double z : kNastyNumbers) {
          const double three[] = {x, y, z};
          for (std::size_t count = 0; count <= 3; ++count) {
            EXPECT_TRUE(std::isfinite(ApplyAccumulateFunction(three, count, function.code)))
                << function.name << count << ": " << x << ' ' << y << ' ' << z;
          }
        }
      }
    }
  }
}

TEST(FunctionEvaluation, MissingNumbersGoByTheRuleOfTheTable) {
  std::size_t row_count = 0;
  const BuiltinFunction* functions = GetBuiltinFunctions(row_count);
  for (std::size_t i = 0; i < row_count; ++i) {
    const BuiltinFunction& function = functions[i];
    const auto apply = [&function](const std::vector<double>& numbers) {
      switch (function.family) {
        case FunctionFamily::kScalar:
          return ApplyTransFunction(numbers[0], numbers.size() > 1 ? numbers[1] : kSysmis, function.code);
        case FunctionFamily::kDateTime:
          return ApplyDateTimeFunction(numbers[0], numbers.size() > 1 ? numbers[1] : 0.0, function.code);
        default:
          return ApplyAccumulateFunction(numbers.data(), numbers.size(), function.code);
      }
    };
    const bool is_numeric = function.family == FunctionFamily::kScalar ||
                            function.family == FunctionFamily::kDateTime ||
                            function.family == FunctionFamily::kList;
    if (!is_numeric) continue;
    const std::size_t count = function.max_arguments == BuiltinFunction::kAnyNumber
                                  ? 3
                                  : static_cast<std::size_t>(function.max_arguments);
    const std::vector<double> complete = {0.25, 0.5, 2.0};
    for (std::size_t missing = 0; missing < count; ++missing) {
      std::vector<double> numbers(complete.begin(), complete.begin() + static_cast<std::ptrdiff_t>(count));
      numbers[missing] = kSysmis;
      const double result = apply(numbers);
      if (function.missing == FunctionMissingRule::kPropagates) {
        EXPECT_EQ(result, kSysmis) << function.name << " without argument " << missing;
      } else if (function.missing == FunctionMissingRule::kSkipped) {
        numbers.erase(numbers.begin() + static_cast<std::ptrdiff_t>(missing));
        EXPECT_EQ(result, apply(numbers)) << function.name << " without argument " << missing;
        EXPECT_NE(result, kSysmis) << function.name;
      } else {
        ASSERT_EQ(function.missing, FunctionMissingRule::kANumber) << function.name;
        numbers[missing] = -1e308;
        EXPECT_EQ(result, apply(numbers)) << function.name << " without argument " << missing;
      }
    }
  }
}

TEST(FunctionEvaluation, DateTimeFunctionsOfOneArgumentAreMissingWithoutTheOther) {
  for (const TransformFunction function :
       {kYearFromDateFunction, kMonthFromDateFunction, kDayFromDateFunction, kHourFromTimeFunction,
        kMinuteFromTimeFunction, kSecondFromTimeFunction}) {
    EXPECT_NE(ApplyDateTimeFunction(0.0, 0.0, function), kSysmis);
    EXPECT_EQ(ApplyDateTimeFunction(0.0, kSysmis, function), kSysmis);
  }
}

TEST(FunctionEvaluation, NumbersAndShortTextsNeedNoMemory) {
  const double numbers[] = {3.0, 1.0, 2.0};
  std::vector<double> scratch;
  std::string text;
  int32_t length = 0;
  const StringValue value("  A text that is longer than what a string holds by itself  ");
  const auto run = [&] {
    double sum = 0.0;
    for (int code = 0; code <= 68; ++code) {
      const auto function = static_cast<TransformFunction>(code);
      sum += ApplyTransFunction(2.0, 3.0, function) * 1e-300;
      sum += ApplyAccumulateFunction(numbers, 3, function, scratch) * 1e-300;
      sum += ApplyDateTimeFunction(86400.0, 0.0, function) * 1e-300;
      ApplyTextFunction(value, function, text, length);
      sum += length;
    }
    ApplySubstring(value, 2.0, text, length);
    text.clear();
    AppendText(value, text, length);
    return sum;
  };
  const double first = run();
  const size_t before = kestrel_tests::CountAllocations();
  EXPECT_EQ(run(), first);
  EXPECT_EQ(kestrel_tests::CountAllocations(), before);
}

TEST(FunctionEvaluation, NearestMeanTakesDistancesThatAreNumbers) {
  const double kNaN = std::numeric_limits<double>::quiet_NaN();
  struct Row {
    double t;
    std::vector<double> means, variances;
    std::size_t nearest;
    const char* why;
  };
  const Row kRows[] = {
      {5.0, {4.0, 7.0}, {1.0, 1.0}, 0, "the nearest"},
      {5.0, {4.0, 7.0}, {0.01, 100.0}, 1, "in standard deviations"},
      {5.0, {4.0, 6.0}, {1.0, 1.0}, 0, "the first of two"},
      {5.0, {9.0}, {1.0}, 0, "the only one"},
      {5.0, {5.0, 9.0}, {0.0, 1.0}, 1, "no spread and no distance is no number"},
      {5.0, {4.0, 9.0}, {-1.0, 1.0}, 1, "a negative variance is none"},
      {5.0, {4.0, 9.0}, {0.0, 1.0}, 1, "without spread everything else is infinitely far"},
      {5.0, {kNaN, kNaN}, {1.0, 1.0}, 0, "none is a number"},
  };
  for (const Row& row : kRows) {
    EXPECT_EQ(NearestMean(row.t, row.means.data(), row.variances.data(), row.means.size()), row.nearest)
        << row.why;
  }
}

}  // namespace
}  // namespace MCKestrel_800
