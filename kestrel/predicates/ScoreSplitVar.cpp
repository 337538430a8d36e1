#include "kestrel/predicates/ScoreSplitVar.h"

#include "kestrel/dictionary/ScoreDictVar.h"

namespace MCKestrel_800 {

ScoreSplitVar::~ScoreSplitVar() = default;

void ScoreSplitVar::SetSplitVar(const ScoreDictVar* variable) {
  variable_ = variable;
}

void ScoreSplitVar::SetMissvalMap(int child) {
  missval_map_ = child;
}

std::string ScoreSplitVar::GetSplitName() const {
  return variable_ == nullptr ? std::string() : variable_->GetName();
}

std::string ScoreSplitVar::GetSplitLabel() const {
  return variable_ == nullptr ? std::string() : variable_->GetLabel();
}

int ScoreSplitVar::GetSplitType() const {
  return variable_ == nullptr ? -1 : variable_->GetVarType();
}

int ScoreSplitVar::GetSplitMLevel() const {
  return variable_ == nullptr ? -1 : variable_->GetMLevel();
}

int ScoreSplitVar::GetMissvalMap() const {
  return missval_map_;
}

}  // namespace MCKestrel_800
