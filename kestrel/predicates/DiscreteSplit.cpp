#include "kestrel/predicates/DiscreteSplit.h"

#include <ostream>
#include <string>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/ScoreValue.h"

namespace MCKestrel_800 {

DiscreteSplit::DiscreteSplit() = default;

DiscreteSplit::DiscreteSplit(const ScoreDictVar* variable) : ScoreSplitVar(variable) {}

DiscreteSplit::DiscreteSplit(const DiscreteSplit& other)
    : ScoreSplitVar(other),
      start_index_(other.start_index_),
      end_index_(other.end_index_),
      codes_(other.codes_) {
  values_.reserve(other.values_.size());
  for (const auto& [value, child] : other.values_)
    values_.emplace_back(value->Clone(), child);
}

DiscreteSplit& DiscreteSplit::operator=(const DiscreteSplit& other) {
  if (this == &other) return *this;
  DiscreteSplit copy(other);
  ScoreSplitVar::operator=(copy);
  values_.swap(copy.values_);
  start_index_ = copy.start_index_;
  end_index_ = copy.end_index_;
  std::swap(codes_, copy.codes_);
  return *this;
}

DiscreteSplit::~DiscreteSplit() = default;

DiscreteSplit* DiscreteSplit::Clone() const {
  return new DiscreteSplit(*this);
}

ScoreSplitVar::SplitVarType DiscreteSplit::GetSplitVarType() const {
  return kDiscrete;
}

int DiscreteSplit::GetSplitChildIndex(double x) const {
  if (x < 0 && GetSplitMLevel() == ScoreDictVar::kNominal) return GetMissvalMap();
  return codes_.Find(x);
}

int DiscreteSplit::GetSplitChildIndex(const ScoreValue* value) const {
  if (value == nullptr) return GetMissvalMap();
  const ScoreDictVar* variable = GetSplitVar();
  if (variable != nullptr && variable->GetVarType() == ScoreDictVar::STRING_VAR) {
    const bool exact = variable->GetNoSpaceTrim(), emptyStringOK = variable->GetEmptyStringOK();
    for (const auto& [held, child] : values_) {
      if (held->Equal(value, exact, emptyStringOK)) return child;
    }
    return -1;
  }
  for (const auto& [held, child] : values_) {
    if (*held == *value) return child;
  }
  return -1;
}

void DiscreteSplit::Display(std::ostream& out) const {
  // Numbers go through to_string: a stream may carry a locale that groups digits.
  out << "SplitVarName = " << GetSplitName()
      << (GetSplitMLevel() == ScoreDictVar::kNominal ? "; Var type: Categorical\n" : "; Var type: Ordinal\n")
      << "Missing Value index: " << std::to_string(GetMissvalMap()) << "\n";
  if (start_index_ >= 0 && end_index_ >= 0) {
    out << "Split value index starts from  " << std::to_string(start_index_) << " to "
        << std::to_string(end_index_) << "\n";
  }
  for (const auto& [value, child] : values_)
    out << "Value = " << value->GetString() << "; Index = " << std::to_string(child) << "\n";
  out << "\n";
}

void DiscreteSplit::PutSplit(ScoreValue* value, int child) {
  if (value != nullptr) values_.emplace_back(std::unique_ptr<ScoreValue>(value), child);
}

void DiscreteSplit::PutSplit(double code, int child) {
  codes_.Insert(code, child);
}

void DiscreteSplit::PutCodes(int first, int last, int child) {
  codes_.InsertRun(first, last, child);
}

std::vector<ScoreValue*> DiscreteSplit::GetSplitValues() const {
  std::vector<ScoreValue*> values;
  values.reserve(values_.size());
  for (const auto& pair : values_)
    values.push_back(pair.first.get());
  return values;
}

std::vector<ScoreValue*> DiscreteSplit::GetSplitValuesForIndex(int child) const {
  std::vector<ScoreValue*> values;
  for (const auto& pair : values_) {
    if (pair.second == child) values.push_back(pair.first.get());
  }
  return values;
}

std::vector<ScoreValue*> DiscreteSplit::GetSplitValuesFirst() const {
  if (values_.empty()) return {};
  return {values_.front().first.get()};
}

void DiscreteSplit::GetStartAndEndIndex(int& start, int& end) const {
  start = start_index_;
  end = end_index_;
}

void DiscreteSplit::SetStartAndEndIndex(int start, int end) {
  start_index_ = start;
  end_index_ = end;
}

}  // namespace MCKestrel_800
