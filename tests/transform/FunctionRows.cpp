#include "tests/transform/FunctionRows.h"

#include <cmath>

#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/StringValue.h"

namespace kestrel_tests {

using namespace MCKestrel_800;

RowValue::RowValue(const char* characters)
    : kind(ScoreValue::kString), text(characters), length(static_cast<int32_t>(text.size())) {}

std::unique_ptr<ScoreValue> RowValue::ToValue() const {
  if (kind == ScoreValue::kNumeric) return std::make_unique<NumericValue>(number);
  if (kind == ScoreValue::kDateTime) return std::make_unique<DateTimeValue>(number, kDateTimeVal);
  auto value = std::make_unique<StringValue>(text);
  value->SetLength(length);
  return value;
}

RowValue Wide(const char* characters, int32_t length) {
  RowValue value(characters);
  value.length = length;
  return value;
}

RowValue Seconds(double seconds) {
  RowValue value(seconds);
  value.kind = ScoreValue::kDateTime;
  return value;
}

std::ostream& operator<<(std::ostream& os, const RowValue& value) {
  if (value.kind == ScoreValue::kString) return os << '"' << value.text << "\" of length " << value.length;
  if (NumericValue::IsSystemMissingValue(value.number)) return os << "missing";
  const auto precision = os.precision(17);
  os << value.number << (value.kind == ScoreValue::kDateTime ? " s" : "");
  os.precision(precision);
  return os;
}

bool IsAsWanted(const RowValue& result, const RowValue& want, double tolerance) {
  if (result.kind != want.kind) return false;
  if (want.kind == ScoreValue::kString) return result.text == want.text && result.length == want.length;
  if (result.number == want.number) return !std::signbit(result.number) || std::signbit(want.number);
  return std::fabs(result.number - want.number) <= tolerance * std::fabs(want.number);
}

std::ostream& operator<<(std::ostream& os, const FunctionRow& row) {
  os << row.why << ": " << row.name << '(';
  for (const RowValue& argument : row.arguments)
    os << (&argument == row.arguments.data() ? "" : ", ") << argument;
  return os << ')';
}

std::vector<FunctionRow> AllFunctionRows() {
  std::vector<FunctionRow> all;
  for (const auto& rows : {ScalarRows(), ArithmeticRows(), SummaryRows(), NormalRows(), LogicalRows(),
                           TextRows(), DateTimeRows(), ValueRows(), SpecialRows()}) {
    all.insert(all.end(), rows.begin(), rows.end());
  }
  return all;
}

}  // namespace kestrel_tests
