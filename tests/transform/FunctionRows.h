// What the built-in functions give: the rows that every road to a function is held against.

#ifndef KESTREL_TESTS_TRANSFORM_FUNCTIONROWS_H
#define KESTREL_TESTS_TRANSFORM_FUNCTIONROWS_H

#include <cstdint>
#include <memory>
#include <ostream>
#include <string>
#include <vector>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/transform/BuiltinFunctions.h"

namespace kestrel_tests {

/// An argument or a result.
struct RowValue {
  MCKestrel_800::ScoreValue::ValueType kind = MCKestrel_800::ScoreValue::kNumeric;
  double number = MCKestrel_800::NumericValue::gSysmisValue;
  std::string text;
  int32_t length = 0;

  RowValue() = default;
  RowValue(double x) : number(x) {}
  RowValue(const char* characters);

  /// The value as an object; a text with its length.
  std::unique_ptr<MCKestrel_800::ScoreValue> ToValue() const;
};

/// A text with another length than its own.
RowValue Wide(const char* characters, int32_t length);
/// A date/time of so many seconds.
RowValue Seconds(double seconds);
std::ostream& operator<<(std::ostream& os, const RowValue& value);

/// Sets result beside what is wanted: kind, text and length exactly, numbers within `tolerance` of
/// themselves.
bool IsAsWanted(const RowValue& result, const RowValue& want, double tolerance);

struct FunctionRow {
  const char* name;
  std::vector<RowValue> arguments;
  RowValue want;
  const char* why;
  double tolerance = 0.0;  ///< relative; 0 where the result is exact
  std::vector<std::vector<RowValue>> arrays = {};
};
std::ostream& operator<<(std::ostream& os, const FunctionRow& row);

/// All rows. Those of one name of a function are those of all its names.
std::vector<FunctionRow> AllFunctionRows();
/// By family.
const std::vector<FunctionRow>& ScalarRows();
const std::vector<FunctionRow>& ArithmeticRows();
const std::vector<FunctionRow>& SummaryRows();
const std::vector<FunctionRow>& NormalRows();
const std::vector<FunctionRow>& LogicalRows();
const std::vector<FunctionRow>& TextRows();
const std::vector<FunctionRow>& DateTimeRows();
const std::vector<FunctionRow>& ValueRows();
const std::vector<FunctionRow>& SpecialRows();

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_TRANSFORM_FUNCTIONROWS_H
