#include "apps/kestrel/DerivedColumns.h"

#include <utility>

#include "apps/kestrel/DerivedInputs.h"
#include "apps/kestrel/NameChoice.h"
#include "apps/kestrel/TableWriter.h"
#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/StringValue.h"

namespace kestrel_program {
namespace {

using namespace MCKestrel_800;

constexpr ColumnWords kWords = {"the derived fields read", "the derived field", "derived fields",
                                "have no derived fields"};
constexpr ChoiceWords kChoice = {"--fields", "the document has no derived field", "the derived field",
                                 "the derived fields are"};

/// What a date/time field's values are written as when it has no type of its own.
DateTimeType TypeOf(const ScoreDictVar& field) {
  return field.GetDateTimeType() == kNoDateTime ? kDateTime : field.GetDateTimeType();
}

}  // namespace

DerivedColumns::DerivedColumns(LoadedFields fields, const std::vector<std::string>& chosen)
    : fields_(std::move(fields)), names_(fields_.derived->GetDerivedVarNames()) {
  TransformationDictionary& derived = *fields_.derived;
  if (!chosen.empty()) {
    std::vector<std::string> names;
    for (const std::size_t position : ChooseNames(names_, chosen, kChoice))
      names.push_back(names_[position]);
    names_ = std::move(names);
    derived.SetWantedVars(names_);
  }
  inputs_ = FindDerivedInputs(names_, derived, *fields_.dictionary);
  for (const std::string& name : names_) {
    const ScoreDictVar& field = *derived.GetVar(name);
    columns_.push_back({field.GetValueIndex(), TypeOf(field)});
  }
}

DerivedColumns::~DerivedColumns() = default;

const ColumnWords& DerivedColumns::GetWords() const {
  return kWords;
}

bool DerivedColumns::Compute(const CaseReader& cases, const TableRow& /*row*/, CaseReader::Fault& /*fault*/) {
  values_ = fields_.derived->GetValuesForDerivedVars(&cases.GetRecord(), fields_.dictionary.get());
  return true;
}

void DerivedColumns::Write(bool is_computed, TableWriter& writer, Progress& /*progress*/) {
  for (const Column& column : columns_) {
    const ScoreValue* value = is_computed ? values_->Get(column.slot) : nullptr;
    if (value == nullptr || value->IsSystemMissingValue()) {
      writer.AddMissing();
    } else {
      WriteValue(*value, column.date_time_type, writer);
    }
  }
}

void DerivedColumns::WriteValue(const ScoreValue& value, DateTimeType type, TableWriter& writer) {
  if (value.GetType() == ScoreValue::kNumeric) return writer.AddNumber(value.GetDouble());
  if (const auto* text = dynamic_cast<const StringValue*>(&value)) {
    // The empty text is what a text field without a value holds.
    return text->GetText().empty() ? writer.AddMissing() : writer.AddText(text->GetText());
  }
  DateTimeValue moment;
  moment.SetValue(&value);
  if (type > kDateTime) return writer.AddNumber(moment.GetDoubleValue(type));
  moment.SetDateTimeType(DateTimeValue::GetValType(type));
  writer.AddText(moment.GetString());
}

}  // namespace kestrel_program
