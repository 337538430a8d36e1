#include "apps/kestrel/CaseReader.h"

#include <cmath>
#include <unordered_map>

#include "apps/kestrel/NameChoice.h"
#include "apps/kestrel/ProgramError.h"
#include "apps/kestrel/ShownText.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumberText.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"

namespace kestrel_program {
namespace {

using namespace MCKestrel_800;

/// Blanks around a number count in quotation marks as little as outside.
std::string_view WithoutBlanks(std::string_view text) {
  const std::size_t first = text.find_first_not_of(" \t");
  if (first == std::string_view::npos) return std::string_view();
  return text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

/// A finite number that fills the whole cell.
bool ReadNumber(std::string_view cell, double& number) {
  const char* first = cell.data();
  const char* last = first + cell.size();
  if (!ParseDouble(first, last, number)) {
    const std::string_view inner = WithoutBlanks(cell);
    if (inner.size() == cell.size() || !ParseDouble(inner.data(), inner.data() + inner.size(), number))
      return false;
  }
  return std::isfinite(number);
}

/// What may be the matter when inputs have no column.
std::string HintForAbsent(const std::vector<std::string>& absent, const std::vector<std::string>& header,
                          const char* reader) {
  // So many names are compared that a table of hundreds of thousands of columns takes no time to speak of.
  constexpr std::size_t kMost = 30;
  for (std::size_t i = 0; i < absent.size() && i < kMost; ++i) {
    const std::string* found = FindInAnyCase(header, absent[i]);
    if (found == nullptr) continue;
    return "\n  hint: upper and lower case count; the table has " + ShownText(*found) + " where " + reader +
           " " + ShownText(absent[i]);
  }
  return header.size() == 1 ? "\n  hint: --delimiter tells what separates the cells" : "";
}

}  // namespace

CaseReader::CaseReader(TableReader& table, const std::vector<const ScoreDictVar*>& inputs,
                       const ScoreDictVar* optional, const std::vector<std::string>& missing_texts,
                       const char* reader)
    : is_number_(table.GetHeader().size(), false),
      missing_texts_(missing_texts),
      record_(static_cast<int>(inputs.size())) {
  std::unordered_map<std::string, std::size_t> positions;
  for (std::size_t column = 0; column < table.GetHeader().size(); ++column)
    positions.emplace(table.GetHeader()[column], column);
  std::vector<std::string> absent;
  for (const ScoreDictVar* variable : inputs) {
    const auto found = positions.find(variable->GetName());
    if (found == positions.end()) {
      absent.push_back(variable->GetName());
      continue;
    }
    AddInput(*variable, found->second);
  }
  const auto found = optional == nullptr ? positions.end() : positions.find(optional->GetName());
  if (found != positions.end()) AddInput(*optional, found->second);
  if (absent.empty()) return;
  throw ProgramError(kData, table.DescribePlace(table.GetHeaderLine()) + reader + " " + ListNames(absent) +
                                ", for which there is no column; the columns are " +
                                ListNames(table.GetHeader()) +
                                HintForAbsent(absent, table.GetHeader(), reader));
}

CaseReader::~CaseReader() = default;

void CaseReader::AddInput(const ScoreDictVar& variable, std::size_t column) {
  inputs_.push_back(MakeInput(variable, column));
  columns_.push_back(column);
  const Kind kind = inputs_.back().kind;
  is_number_[column] = kind == Kind::kNumber || kind == Kind::kDateTimeNumber;
  AddSlot(inputs_.back());
}

CaseReader::Input CaseReader::MakeInput(const ScoreDictVar& variable, std::size_t column) {
  Kind kind = Kind::kNumber;
  DateTimeType type = kNoDateTime;
  if (variable.GetVarType() == ScoreDictVar::STRING_VAR) {
    kind = Kind::kText;
  } else if (variable.GetVarType() == ScoreDictVar::kDATETIME_VAR) {
    type = variable.GetDateTimeType() == kNoDateTime ? kDateTime : variable.GetDateTimeType();
    const bool is_text = type == kDate || type == kTime || type == kDateTime;
    kind = is_text ? Kind::kDateTimeText : Kind::kDateTimeNumber;
  }
  return {variable.GetName(), kind, type, column, nullptr};
}

void CaseReader::AddSlot(const Input& input) {
  switch (input.kind) {
    case Kind::kNumber:
      return record_.Add(input.name, new NumericValue);
    case Kind::kText:
      return record_.Add(input.name, new StringValue);
    default:
      return record_.Add(input.name, new DateTimeValue(NumericValue::gSysmisValue, input.date_time_type));
  }
}

std::string CaseReader::WhatIsAccepted(const Input& input) {
  switch (input.date_time_type) {
    case kNoDateTime:
      return "a number such as -1.5 or 2e3, with a decimal point";
    case kDate:
      return "a date such as 2024-02-29";
    case kTime:
      return "a time such as 13:05:59";
    case kDateTime:
      return "a date with a time such as 2024-02-29T13:05:59";
    case kDateDaysSince0:
    case kDateDaysSince1960:
    case kDateDaysSince1970:
    case kDateDaysSince1980:
      return "a number of days such as 19782";
    default:
      return "a number of seconds such as 47159";
  }
}

bool CaseReader::IsMissing(std::string_view cell) const {
  if (cell.empty()) return true;
  for (const std::string& text : missing_texts_) {
    if (cell == text) return true;
  }
  return false;
}

// The empty text may be a value of a text field, so a text that is not there is an empty slot.
void CaseReader::SetMissing(Input& input, int slot) {
  if (input.kind != Kind::kText) {
    record_.SetMissingValue(slot);
  } else if (input.parked == nullptr) {
    input.parked.reset(static_cast<StringValue*>(record_.GetAllValues()[static_cast<std::size_t>(slot)]));
    record_.Add(input.name, nullptr);
  }
}

void CaseReader::SetText(Input& input, int slot, std::string_view cell) {
  if (input.parked != nullptr) record_.Add(input.name, input.parked.release());
  scratch_.assign(cell);
  record_.SetValue(slot, scratch_);
}

bool CaseReader::SetNumber(const Input& input, int slot, std::string_view cell) {
  double number = 0.0;
  if (!ReadNumber(cell, number)) return false;
  return input.kind == Kind::kNumber ? record_.SetValue(slot, number)
                                     : record_.SetValue(slot, number, input.date_time_type);
}

bool CaseReader::SetDateTime(const Input& input, int slot, std::string_view cell) {
  scratch_.assign(WithoutBlanks(cell));
  if (scratch_.empty() || !DateTimeValue::IsValidDateTime(scratch_, input.date_time_type)) return false;
  DateTimeValue value;
  value.FromString(scratch_, input.date_time_type);
  return record_.SetValue(slot, value.GetDoubleValue(input.date_time_type), input.date_time_type);
}

bool CaseReader::Read(const TableRow& row, Fault& fault) {
  if (!row.HasAllCells()) {
    fault.column = Fault::kWholeRow;
    fault.text = row.DescribeCellCount();
    return false;
  }
  int slot = 0;
  for (Input& input : inputs_) {
    const std::string_view cell = row.GetCell(input.column);
    bool is_read = true;
    if (IsMissing(cell)) {
      SetMissing(input, slot);
    } else if (input.kind == Kind::kText) {
      SetText(input, slot, cell);
    } else if (input.kind == Kind::kDateTimeText) {
      is_read = SetDateTime(input, slot, cell);
    } else {
      is_read = SetNumber(input, slot, cell);
    }
    if (!is_read) {
      fault.column = input.column;
      fault.text = "\"" + ShownText(cell) + "\" cannot be read; accepted is " + WhatIsAccepted(input) +
                   ", or an empty cell or a text of --missing for a missing value";
      return false;
    }
    ++slot;
  }
  return true;
}

}  // namespace kestrel_program
