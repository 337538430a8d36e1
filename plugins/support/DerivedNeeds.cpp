#include "plugins/support/DerivedNeeds.h"

#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/TransformationDictionary.h"

namespace MCKestrel_800 {

DerivedNeeds::DerivedNeeds(const ScoreDictionary& data, const TransformationDictionary& derived)
    : data_(data) {
  for (const std::string& name : derived.GetDerivedVarNames()) {
    const auto* const variable = dynamic_cast<const TransformVar*>(derived.GetVar(name));
    const int number = static_cast<int>(derived_fields_.size());
    if (variable == nullptr || !derived_numbers_.emplace(name, number).second) continue;
    derived_fields_.emplace_back();
    derived_fields_.back().name = name;
    derived_fields_.back().variable = variable;
  }
}

int DerivedNeeds::AddData(const ScoreDictVar& variable) {
  const int position = static_cast<int>(data_fields_.size());
  const auto [found, is_new] = data_positions_.emplace(variable.GetName(), position);
  if (is_new) data_fields_.push_back(&variable);
  return found->second;
}

int DerivedNeeds::AddDerived(const std::string& name) {
  const int wanted = derived_numbers_.at(name);
  std::vector<int> waiting = {wanted};
  while (!waiting.empty()) {
    const int number = waiting.back();
    waiting.pop_back();
    if (derived_fields_[number].is_needed) continue;
    derived_fields_[number].is_needed = true;
    NoteReads(number, waiting);
  }
  return wanted;
}

void DerivedNeeds::NoteReads(int number, std::vector<int>& waiting) {
  Derived& field = derived_fields_[number];
  for (const std::string& name : field.variable->GetSourceNames()) {
    // As everywhere, a name is first that of a data field.
    if (const ScoreDictVar* const data = data_.GetVar(name)) {
      field.reads_data.push_back(AddData(*data));
    } else if (const auto found = derived_numbers_.find(name); found != derived_numbers_.end()) {
      field.reads.push_back(found->second);
    }
  }
  for (const int read : field.reads)
    derived_fields_[read].is_read = true;
  waiting.insert(waiting.end(), field.reads.rbegin(), field.reads.rend());
}

std::vector<int> DerivedNeeds::FindFirstData() const {
  std::vector<int> first(derived_fields_.size(), kNone);
  for (std::size_t number = 0; number < derived_fields_.size(); ++number) {
    const Derived& field = derived_fields_[number];
    if (!field.reads_data.empty()) first[number] = field.reads_data.front();
    for (const int read : field.reads) {
      if (first[number] == kNone) first[number] = first[read];
    }
  }
  return first;
}

}  // namespace MCKestrel_800
