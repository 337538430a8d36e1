#include "kestrel/dictionary/BaseDictionary.h"

#include <ostream>
#include <utility>

#include "kestrel/dictionary/LayoutStamp.h"

namespace MCKestrel_800 {

ScoreDictionary::~ScoreDictionary() = default;

BaseDictionary::BaseDictionary() : stamp_(NewLayoutStamp()) {}

BaseDictionary::BaseDictionary(const BaseDictionary& other)
    : ScoreDictionary(other), names_(other.names_), stamp_(NewLayoutStamp()) {
  for (const auto& [name, var] : other.vars_) {
    vars_.emplace_hint(vars_.end(), name, std::unique_ptr<ScoreDictVar>(var->Clone()));
  }
}

BaseDictionary& BaseDictionary::operator=(const BaseDictionary& other) {
  if (this == &other) return *this;
  BaseDictionary copy(other);
  vars_.swap(copy.vars_);
  names_.swap(copy.names_);
  stamp_ = copy.stamp_;
  return *this;
}

BaseDictionary::~BaseDictionary() = default;

BaseDictionary* BaseDictionary::Clone() const {
  return new BaseDictionary(*this);
}

bool BaseDictionary::AddVar(const ScoreDictionary* other) {
  if (other == nullptr) return false;
  std::vector<std::string> names = other->GetVarNames();
  stamp_ = NewLayoutStamp();
  for (const std::string& name : names) {
    // A name that was removed from the other dictionary is still listed there.
    const ScoreDictVar* var = other->GetVar(name);
    if (var == nullptr || vars_.count(name) != 0) continue;
    vars_.emplace(name, std::unique_ptr<ScoreDictVar>(var->Clone()));
  }
  names_ = std::move(names);
  return false;
}

bool BaseDictionary::AddVar(const std::string& name, ScoreDictVar* var) {
  if (name.empty() || var == nullptr) return false;
  names_.push_back(name);
  // A refused variable is not deleted: its caller may still hold it, and may have added the same object
  // before.
  if (vars_.count(name) == 0) vars_.emplace(name, std::unique_ptr<ScoreDictVar>(var));
  stamp_ = NewLayoutStamp();
  return true;
}

bool BaseDictionary::RemoveVar(const std::string& name) {
  if (name.empty()) return false;
  stamp_ = NewLayoutStamp();
  return vars_.erase(name) != 0;
}

ScoreDictVar* BaseDictionary::GetVar(const std::string& name) {
  const auto it = vars_.find(name);
  return it == vars_.end() ? nullptr : it->second.get();
}

const ScoreDictVar* BaseDictionary::GetVar(const std::string& name) const {
  const auto it = vars_.find(name);
  return it == vars_.end() ? nullptr : it->second.get();
}

std::size_t BaseDictionary::Size() const {
  return vars_.size();
}

std::vector<ScoreDictVar*> BaseDictionary::GetScoreDictVars() const {
  std::vector<ScoreDictVar*> vars;
  vars.reserve(vars_.size());
  for (const auto& [name, var] : vars_)
    vars.push_back(var.get());
  return vars;
}

std::vector<std::string> BaseDictionary::GetVarNames() const {
  return names_;
}

void BaseDictionary::Display(std::ostream& os) const {
  os << "\n ############ Begin dictionary display ################ \n";
  for (const auto& [name, var] : vars_)
    var->Display(os);
  os << "End Of ScoreDictionary display.\n\n";
}

unsigned long long BaseDictionary::GetLayoutStamp() const {
  return stamp_;
}

}  // namespace MCKestrel_800
