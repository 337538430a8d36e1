#include "plugins/support/DerivedInputs.h"

#include <algorithm>
#include <string>
#include <tuple>
#include <utility>

#include "kestrel/dictionary/ScoreCaseRecord.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/TransformationDictionary.h"
#include "plugins/support/MiningSchema.h"

namespace MCKestrel_800 {

DerivedInputs::DerivedInputs(const MiningSchema& schema, const ScoreDictionary& data,
                             TransformationDictionary& derived, const std::vector<const MiningField*>& fields)
    : data_(data), derived_(derived) {
  // Tells the derived fields their positions among the computed values.
  derived_.SetUpDerivedCaseRecord();
  DerivedNeeds needs(data, derived);
  PlaceFields(fields, needs);
  AddSources(schema, needs);
  AddTreatedFields(schema, needs);
  ChooseWanted(fields);
}

// By the name: a host's data dictionary may hold variables that once were derived.
bool DerivedInputs::IsDerived(const MiningField& field) const {
  return data_.GetVar(field.name) == nullptr;
}

void DerivedInputs::PlaceFields(const std::vector<const MiningField*>& fields, DerivedNeeds& needs) {
  std::vector<int> numbers;
  numbers.reserve(fields.size());
  for (const MiningField* field : fields) {
    numbers.push_back(IsDerived(*field) ? needs.AddDerived(field->name) : needs.AddData(*field->variable));
  }
  data_fields_ = needs.GetDataFields();
  case_positions_.assign(data_fields_.size(), -1);
  values_.assign(data_fields_.size(), nullptr);
  const std::vector<int> first_data = needs.FindFirstData();
  for (std::size_t i = 0; i < fields.size(); ++i) {
    const ScoreDictVar& variable = *fields[i]->variable;
    if (!IsDerived(*fields[i])) {
      positions_.push_back(numbers[i]);
      data_of_fields_.push_back(numbers[i]);
      continue;
    }
    positions_.push_back(static_cast<int>(values_.size()));
    const int first = first_data[static_cast<std::size_t>(numbers[i])];
    data_of_fields_.push_back(first == DerivedNeeds::kNone ? static_cast<int>(data_fields_.size()) : first);
    outputs_.push_back({values_.size(), static_cast<std::size_t>(variable.GetValueIndex())});
    values_.push_back(nullptr);
  }
}

void DerivedInputs::AddSources(const MiningSchema& schema, const DerivedNeeds& needs) {
  std::vector<bool> is_read(data_fields_.size(), false);
  for (const DerivedNeeds::Derived& field : needs.GetDerived()) {
    for (const int position : field.reads_data)
      is_read[static_cast<std::size_t>(position)] = true;
  }
  for (std::size_t position = 0; position < data_fields_.size(); ++position) {
    if (!is_read[position]) continue;
    const std::string& name = data_fields_[position]->GetName();
    const MiningField* const field = schema.Find(name);
    sources_.push_back({position, treated_.AddName(name),
                        field == nullptr ? nullptr : std::make_unique<FieldTreatment>(*field)});
  }
}

void DerivedInputs::AddTreatedFields(const MiningSchema& schema, const DerivedNeeds& needs) {
  const std::vector<DerivedNeeds::Derived>& derived = needs.GetDerived();
  const std::vector<int> first_data = needs.FindFirstData();
  // By derived field: how many treated ones stand one behind the other before those that read it.
  std::vector<int> levels(derived.size(), 0);
  for (std::size_t number = 0; number < derived.size(); ++number) {
    const DerivedNeeds::Derived& field = derived[number];
    for (const int read : field.reads)
      levels[number] = std::max(levels[number], levels[static_cast<std::size_t>(read)]);
    const MiningField* const mining_field = schema.Find(field.name);
    if (mining_field == nullptr || !field.is_read) continue;
    const int first = first_data[number];
    treated_fields_.push_back({levels[number]++, static_cast<std::size_t>(field.variable->GetValueIndex()),
                               treated_.AddName(field.name),
                               first == DerivedNeeds::kNone ? static_cast<int>(data_fields_.size()) : first,
                               std::make_unique<FieldTreatment>(*mining_field)});
  }
  std::sort(treated_fields_.begin(), treated_fields_.end(), [](const TreatedField& a, const TreatedField& b) {
    return std::tie(a.level, a.shown) < std::tie(b.level, b.shown);
  });
}

void DerivedInputs::ChooseWanted(const std::vector<const MiningField*>& fields) {
  std::vector<std::string> names;
  for (const MiningField* field : fields) {
    if (IsDerived(*field)) names.push_back(field->name);
  }
  for (const TreatedField& field : treated_fields_)
    names.push_back(field.treatment->GetField().name);
  derived_.SetWantedVars(names);
}

bool DerivedInputs::Compute(const ScoreCaseRecord& record) {
  TakeCase(record);
  if (!TreatSources() || !TreatDerived()) return false;
  const std::vector<ScoreValue*>& computed =
      derived_.GetValuesForDerivedVars(&treated_, &data_)->GetAllValues();
  for (const Output& output : outputs_)
    values_[output.value] = computed[output.value_index];
  return true;
}

void DerivedInputs::TakeCase(const ScoreCaseRecord& record) {
  const unsigned long long stamp = record.GetLayoutStamp();
  if (stamp == 0) {
    // Such a record promises nothing about its values as a whole.
    layout_stamp_ = 0;
    for (std::size_t i = 0; i < data_fields_.size(); ++i)
      values_[i] = record.Get(record.GetIndex(data_fields_[i]->GetName()));
    return;
  }
  const std::vector<ScoreValue*>& values = record.GetAllValues();
  if (stamp != layout_stamp_ || values.size() < positions_end_) {
    LookUpPositions(record);
    layout_stamp_ = stamp;
  }
  for (std::size_t i = 0; i < data_fields_.size(); ++i) {
    const int position = case_positions_[i];
    values_[i] = position < 0 ? nullptr : values[static_cast<std::size_t>(position)];
  }
}

void DerivedInputs::LookUpPositions(const ScoreCaseRecord& record) {
  const int size = static_cast<int>(record.GetAllValues().size());
  int end = 0;
  for (std::size_t i = 0; i < data_fields_.size(); ++i) {
    const int position = record.GetIndex(data_fields_[i]->GetName());
    case_positions_[i] = position < size ? position : -1;
    end = std::max(end, case_positions_[i] + 1);
  }
  positions_end_ = static_cast<std::size_t>(end);
}

bool DerivedInputs::TreatSources() {
  for (const Source& source : sources_) {
    const ScoreValue* value = values_[source.value];
    if (source.treatment != nullptr && !source.treatment->Treat(value, value)) {
      refused_ = static_cast<int>(source.value);
      return false;
    }
    treated_.Show(source.shown, value);
  }
  return true;
}

// What a treated field becomes, those that read it must see: each level is computed with those before it in
// place. Models with more than one level, or even one, are rare.
bool DerivedInputs::TreatDerived() {
  for (const TreatedField& field : treated_fields_)
    treated_.Show(field.shown, nullptr);
  for (auto field = treated_fields_.begin(); field != treated_fields_.end();) {
    const std::vector<ScoreValue*>& computed =
        derived_.GetValuesForDerivedVars(&treated_, &data_)->GetAllValues();
    for (const int level = field->level; field != treated_fields_.end() && field->level == level; ++field) {
      const ScoreValue* value = nullptr;
      if (!field->treatment->Treat(computed[field->value_index], value)) {
        refused_ = field->data_field;
        return false;
      }
      treated_.Show(field->shown, value);
    }
  }
  return true;
}

}  // namespace MCKestrel_800
