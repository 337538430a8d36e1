#include "kestrel/transform/BuiltinFunctions.h"

#include <algorithm>
#include <iterator>

namespace MCKestrel_800 {

namespace {

using Family = FunctionFamily;
using Kind = FunctionValueKind;
using Check = FunctionArgumentCheck;
using Nesting = FunctionNesting;
using Missing = FunctionMissingRule;

/// How many arguments and arrays a function takes, and what a reader says to another number.
struct Arity {
  int min_arguments;
  int max_arguments;
  int arrays;
  const char* text;
};
constexpr Arity kAny = {0, BuiltinFunction::kAnyNumber, 0, ""};
constexpr Arity kOne = {1, 1, 0, "Only one parameter is allowed!"};
constexpr Arity kOneRequired = {1, 1, 0, "Only one parameter is required!"};
constexpr Arity kOneAndArray = {1, 1, 1, "Only one parameter is allowed!"};
constexpr Arity kTwo = {2, 2, 0, "Two parameters are required!"};
constexpr Arity kTwoOrThree = {2, 3, 0, "Three parameters are required!"};
constexpr Arity kThree = {3, 3, 0, "Three parameters are required!"};
constexpr Arity kSix = {6, 6, 0, "Six parameters are required!"};
constexpr Arity kTwoAndTwoArrays = {2, 2, 2, "PMML error for IMPUTECATFIELDMISSINGAGAINSTCONTARGET"};

// A row in full, and short forms for what many functions have in common.
constexpr BuiltinFunction Row(const char* name, TransformFunction code, Family family, Kind argument,
                              Kind result, const Arity& arity, Check check, Nesting nesting, Missing missing,
                              const char* meaning) {
  return {
      name,       code,  family,  argument, result, arity.min_arguments, arity.max_arguments, arity.arrays,
      arity.text, check, nesting, missing,  meaning};
}

/// Numbers to a number, missing when one of them is.
constexpr BuiltinFunction Numeric(const char* name, TransformFunction code, Family family, const Arity& arity,
                                  const char* meaning) {
  return Row(name, code, family, Kind::kNumber, Kind::kNumber, arity, Check::kNone, Nesting::kNumeric,
             Missing::kPropagates, meaning);
}

/// What sums numbers up, as many as there are.
constexpr BuiltinFunction Summary(const char* name, TransformFunction code, const char* meaning) {
  return Row(name, code, Family::kList, Kind::kNumber, Kind::kNumber, kAny, Check::kKind, Nesting::kNumeric,
             Missing::kSkipped, meaning);
}

/// Numbers to 1 or 0.
constexpr BuiltinFunction Logical(const char* name, TransformFunction code, const Arity& arity,
                                  const char* meaning) {
  return Row(name, code, Family::kList, Kind::kNumber, Kind::kNumber, arity, Check::kNone, Nesting::kOther,
             Missing::kANumber, meaning);
}

/// A text to a text.
constexpr BuiltinFunction Text(const char* name, TransformFunction code, const char* meaning) {
  return Row(name, code, Family::kText, Kind::kText, Kind::kText, kOne, Check::kNone, Nesting::kString,
             Missing::kEmptyText, meaning);
}

/// A row with one argument of another kind.
constexpr BuiltinFunction With(int odd_index, Kind odd_argument, BuiltinFunction row) {
  row.odd_index = odd_index;
  row.odd_argument = odd_argument;
  return row;
}

/// A part of a date/time.
constexpr BuiltinFunction DateTime(const char* name, TransformFunction code, const char* meaning) {
  return Row(name, code, Family::kDateTime, Kind::kDateTime, Kind::kNumber, kOneRequired, Check::kNone,
             Nesting::kOther, Missing::kPropagates, meaning);
}

/// A date/time less a number of seconds.
constexpr BuiltinFunction Duration(const char* name, TransformFunction code, const char* meaning) {
  return With(1, Kind::kNumber,
              Row(name, code, Family::kDateTime, Kind::kDateTime, Kind::kNumber, kTwo, Check::kNone,
                  Nesting::kOther, Missing::kPropagates, meaning));
}

/// Values of any kind to 1 or 0.
constexpr BuiltinFunction Test(const char* name, TransformFunction code, Family family, const Arity& arity,
                               const char* meaning) {
  return Row(name, code, family, Kind::kAny, Kind::kNumber, arity, Check::kNone, Nesting::kOther,
             Missing::kAsMeant, meaning);
}

/// A field to 1 or 0.
constexpr BuiltinFunction FieldTest(const char* name, TransformFunction code, Nesting nesting,
                                    const char* meaning) {
  return Row(name, code, Family::kSpecial, Kind::kAny, Kind::kNumber, kOne, Check::kField, nesting,
             Missing::kAsMeant, meaning);
}

constexpr BuiltinFunction NumberOfField(const char* name, TransformFunction code, const char* meaning) {
  return Row(name, code, Family::kSpecial, Kind::kNumberOrText, Kind::kNumber, kOne, Check::kField,
             Nesting::kOther, Missing::kPropagates, meaning);
}

constexpr BuiltinFunction kFunctions[] = {
    Numeric("+", kPlusFunction, Family::kScalar, kTwo, "x + y"),
    Numeric("-", kMinusFunction, Family::kList, kTwo, "x - y"),
    Numeric("*", kMultiplyFunction, Family::kList, kTwo, "x times y"),
    Numeric("/", kDivideFunction, Family::kList, kTwo, "x / y; missing when y is 0"),
    Numeric("pow", kPowFunction, Family::kScalar, kTwo,
            "x to the whole part of y; missing for 0 to a negative power"),
    Numeric("abs", kAbsFunction, Family::kScalar, kOne, "the size of x without its sign"),
    Numeric("exp", kExpFunction, Family::kScalar, kOne,
            "e to the power x; missing above 709, 0 from -708 down"),
    Numeric("log10", kLog10Function, Family::kScalar, kOne, "the logarithm to base 10; missing unless x > 0"),
    Numeric("lg10", kLog10Function, Family::kScalar, kOne, "the logarithm to base 10; missing unless x > 0"),
    Numeric("ln", kLnFunction, Family::kScalar, kOne, "the natural logarithm; missing unless x > 0"),
    Numeric("mod", kModFunction, Family::kScalar, kTwo,
            "what the division of x by y leaves, with the sign of x; missing when y is 0 or the quotient is "
            "beyond 32-bit integers"),
    Numeric("round", kRoundFunction, Family::kScalar, kOne,
            "the nearest integer, halves away from 0; missing beyond 32-bit integers"),
    Numeric("sqrt", kSqrtFunction, Family::kScalar, kOne, "the square root; missing below 0"),
    Numeric("trunc", kTruncFunction, Family::kScalar, kOne,
            "x cut toward 0 to an integer; missing beyond 32-bit integers"),
    Numeric("cdf.normal", kCdfNormalFunction, Family::kList, kThree,
            "the normal distribution function of x with mean y and standard deviation z"),
    Numeric("cdfnorm", kCdfNormFunction, Family::kScalar, kOne, "the standard normal distribution function"),
    Numeric("idf.normal", kIdfNormalFunction, Family::kList, kThree,
            "the x at which cdf.normal with mean y and standard deviation z is the given probability"),
    Numeric("pdf.normal", kPdfNormalFunction, Family::kList, kThree,
            "the normal density at x with mean y and standard deviation z"),
    Summary("max", kMaxFunction, "the largest argument"),
    Summary("mean", kMeanFunction, "the mean"),
    Summary("avg", kMeanFunction, "the mean"),
    Summary("min", kMinFunction, "the smallest argument"),
    Summary("sd", kSdFunction,
            "the standard deviation of a sample (divisor n - 1); missing below two arguments"),
    Summary("sum", kSumFunction, "the sum"),
    Summary("variance", kVarianceFunction, "the square of sd"),
    Row("concat", kConcatFunction, Family::kText, Kind::kText, Kind::kText, kAny, Check::kKind,
        Nesting::kString, Missing::kEmptyText, "the texts one after the other"),
    Row("length", kLengthFunction, Family::kSpecial, Kind::kText, Kind::kNumber, kOne, Check::kKind,
        Nesting::kLength, Missing::kEmptyText,
        "the declared length of the text, its own where none is declared"),
    Text("lower", kLowerFunction, "ASCII letters made small"),
    Text("ltrim", kLtrimFunction, "without the blanks and tabs at the start"),
    Text("rtrim", kRtrimFunction, "without the blanks and tabs at the end"),
    Text("trimend", kRtrimFunction, "without the blanks and tabs at the end"),
    With(1, Kind::kNumber,
         Row("substr", kSubstrFunction, Family::kText, Kind::kText, Kind::kText, kTwo, Check::kNone,
             Nesting::kOther, Missing::kAsMeant,
             "x from the position y, counted from 1, to its end; empty unless 1 <= y < its size, and when "
             "y is missing")),
    Text("uppercase", kUppercaseFunction, "ASCII letters made large"),
    FieldTest("sysmis", kSysmisFunction, Nesting::kNumeric, "1 when the field is system-missing, else 0"),
    NumberOfField("value", kValueFunction, "the number of the field, or the one that its text reads as"),
    Duration("date_years_difference", kDateYearsDifferenceFunction,
             "x minus y, both in seconds, in years of 365.25 days, not rounded"),
    Duration("date_months_difference", kDateMonthsDifferenceFunction,
             "x minus y, both in seconds, in months of 30.4375 days, not rounded"),
    Duration("date_days_difference", kDateDaysDifferenceFunction,
             "x minus y, both in seconds, in days, not rounded"),
    DateTime("year-from-date", kYearFromDateFunction, "the year of x"),
    DateTime("month-from-date", kMonthFromDateFunction, "the month of x"),
    DateTime("day-from-date", kDayFromDateFunction, "the day of x"),
    Duration("time_hours_difference", kTimeHoursDifferenceFunction,
             "x minus y, both in seconds, in hours, not rounded"),
    Duration("time_minutes_difference", kTimeMinutesDifferenceFunction,
             "x minus y, both in seconds, in minutes, not rounded"),
    Duration("time_seconds_difference", kTimeSecondsDifferenceFunction,
             "x minus y, both in seconds, not rounded"),
    DateTime("hour-from-time", kHourFromTimeFunction, "the hour of x"),
    DateTime("minute-from-time", kMinuteFromTimeFunction, "the minute of x"),
    DateTime("second-from-time", kSecondFromTimeFunction, "the second of x"),
    NumberOfField("recast_to_ordinal", kRecastToOrdinalFunction, "the same as value"),
    NumberOfField("recast_to_scale", kRecastToScaleFunction, "the same as value"),
    With(1, Kind::kText,
         Row("outlierHandle", kOutlierHandleFunction, Family::kSpecial, Kind::kNumber, Kind::kNumber, kSix,
             Check::kNone, Nesting::kOther, Missing::kPropagates,
             "of (x, method, c, a, b, n): x when it is within a * b / sqrt(n) of c; outside it the nearer "
             "bound when the method is asExtremeValues, missing for asIs and asMissingValues")),
    FieldTest("isMissing", kIsMissingFunction, Nesting::kOther,
              "1 when the value of the field is missing by the rules of the field, else 0"),
    FieldTest("isNotMissing", kIsNotMissingFunction, Nesting::kOther,
              "0 when the value of the field is missing by the rules of the field, else 1"),
    Test("equal", kEqualFunction, Family::kComparison, kTwo,
         "1 when both values are of one kind and equal, else 0; two missing numbers are equal; an if is of "
         "the kind that it chose"),
    Test("notEqual", kNotEqualFunction, Family::kComparison, kTwo,
         "0 when both values are of one kind and equal, else 1; an if is of the kind that it chose"),
    Logical("lessThan", kLessThanFunction, kTwo, "1 when x < y, else 0"),
    Logical("lessOrEqual", kLessOrEqualFunction, kTwo, "1 when x <= y, else 0"),
    Logical("greaterThan", kGreaterThanFunction, kTwo, "1 when x > y, else 0"),
    Logical("greaterOrEqual", kGreaterOrEqualFunction, kTwo, "1 when x >= y, else 0"),
    Test("isIn", kIsInFunction, Family::kValueList, kOneAndArray,
         "1 when the value equals one of the array, else 0"),
    Test("isNotIn", kIsNotInFunction, Family::kValueList, kOneAndArray,
         "0 when the value equals one of the array, else 1"),
    Logical("and", kAndFunction, kAny, "1 when no argument is 0, else 0; 0 without arguments"),
    Logical("or", kOrFunction, kAny, "1 when an argument is other than 0, else 0"),
    Logical("not", kNotFunction, kOne, "1 when x is 0, else 0"),
    With(0, Kind::kNumber,
         Row("if", kIfFunction, Family::kSpecial, Kind::kAny, Kind::kArgument, kTwoOrThree, Check::kNone,
             Nesting::kNumeric, Missing::kAsMeant, "y when x is 1, else z; missing when there is no z")),
    Row("threshold", kThresholdFunction, Family::kScalar, Kind::kNumber, Kind::kNumber, kTwo, Check::kNone,
        Nesting::kOther, Missing::kANumber, "1 when x > y, else 0"),
    Row("floor", kFloorFunction, Family::kScalar, Kind::kNumber, Kind::kNumber, kOne, Check::kNone,
        Nesting::kOther, Missing::kPropagates, "the largest integer that is not above x"),
    Row("ceil", kCeilFunction, Family::kScalar, Kind::kNumber, Kind::kNumber, kOne, Check::kNone,
        Nesting::kOther, Missing::kPropagates, "the smallest integer that is not below x"),
    With(1, Kind::kNumber,
         Row("imputeCatFieldMissingAgainstConTarget", kImputeFunction, Family::kSpecial, Kind::kAny,
             Kind::kFirstArgument, kTwoAndTwoArrays, Check::kNone, Nesting::kNumeric, Missing::kAsMeant,
             "of (category, number, means, variances): the category when it is not missing, else the one "
             "whose mean is nearest to the number, measured in its standard deviation; missing when the "
             "number is")),
    Summary("median", kMedianFunction,
            "the middle one of the sorted arguments, or the mean of the two in the middle"),
    Summary("product", kProductFunction, "the product"),
    Text("lowercase", kLowercaseFunction, "the same as lower"),
};

constexpr bool IsInOrder() {
  for (std::size_t i = 1; i < std::size(kFunctions); ++i) {
    if (kFunctions[i - 1].code > kFunctions[i].code) return false;
  }
  return true;
}
static_assert(IsInOrder(), "a row is found by its code");

}  // namespace

const BuiltinFunction* GetBuiltinFunctions(std::size_t& count) {
  count = std::size(kFunctions);
  return kFunctions;
}

const BuiltinFunction* FindBuiltinFunction(std::string_view name) {
  const auto* row = std::find_if(std::begin(kFunctions), std::end(kFunctions),
                                 [name](const BuiltinFunction& function) { return name == function.name; });
  return row == std::end(kFunctions) ? nullptr : row;
}

const BuiltinFunction* FindBuiltinFunction(TransformFunction code) {
  const auto* row = std::lower_bound(
      std::begin(kFunctions), std::end(kFunctions), code,
      [](const BuiltinFunction& function, TransformFunction wanted) { return function.code < wanted; });
  return row == std::end(kFunctions) || row->code != code ? nullptr : row;
}

}  // namespace MCKestrel_800
