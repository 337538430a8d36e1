#include "plugins/support/TreatedRecord.h"

#include <ostream>

namespace MCKestrel_800 {

TreatedRecord::TreatedRecord() = default;
TreatedRecord::~TreatedRecord() = default;

std::size_t TreatedRecord::AddName(const std::string& name) {
  names_.Add(name, nullptr);
  values_.resize(names_.Size(), nullptr);
  return static_cast<std::size_t>(names_.GetIndex(name));
}

void TreatedRecord::Add(const std::string&, ScoreValue*) {}

bool TreatedRecord::SetValue(int, const std::string&) {
  return false;
}

bool TreatedRecord::SetValue(const std::string&, const std::string&) {
  return false;
}

bool TreatedRecord::SetValue(int, double, DateTimeType) {
  return false;
}

bool TreatedRecord::SetValue(const std::string&, double, DateTimeType) {
  return false;
}

bool TreatedRecord::SetValue(int, double) {
  return false;
}

bool TreatedRecord::SetValue(const std::string&, double) {
  return false;
}

bool TreatedRecord::SetMissingValue(int) {
  return false;
}

bool TreatedRecord::SetMissingValue(const std::string&) {
  return false;
}

void TreatedRecord::Remove(const std::string&) {}

const ScoreValue* TreatedRecord::Get(int index) const {
  // A negative index becomes a number beyond every size.
  const auto position = static_cast<std::size_t>(index);
  return position < values_.size() ? values_[position] : nullptr;
}

const ScoreValue* TreatedRecord::Get(const std::string& name) const {
  return Get(GetIndex(name));
}

void TreatedRecord::SetUpNameIndexMap(const std::vector<std::string>&) {}

void TreatedRecord::SetUpNameIndexMap(const std::vector<ScoreDictVar*>&) {}

bool TreatedRecord::HasMap() const {
  return true;
}

int TreatedRecord::GetIndex(const std::string& name) const {
  return names_.GetIndex(name);
}

std::size_t TreatedRecord::Size() const {
  return values_.size();
}

std::vector<std::string> TreatedRecord::GetVarNames() const {
  return names_.GetVarNames();
}

void TreatedRecord::Display(std::ostream& os) const {
  os << "Start ScoreCaseRecord Display:\n";
  for (const std::string& name : names_.GetVarNames()) {
    os << "Var Name: " << name;
    const ScoreValue* const value = Get(name);
    if (value != nullptr) os << "; Var Value: " << value->GetString();
    os << "\n";
  }
  os << "End of ScoreCaseRecord Display.\n\n";
}

}  // namespace MCKestrel_800
