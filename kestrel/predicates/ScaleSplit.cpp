#include "kestrel/predicates/ScaleSplit.h"

#include <ostream>
#include <string>

#include "kestrel/dictionary/ScoreDictVar.h"

namespace MCKestrel_800 {

ScaleSplit::ScaleSplit() = default;

ScaleSplit::ScaleSplit(const ScoreDictVar* variable) : ScoreSplitVar(variable) {}

ScaleSplit::ScaleSplit(const ScaleSplit& other) : ScoreSplitVar(other) {
  ranges_.reserve(other.ranges_.size());
  for (const auto& [range, child] : other.ranges_)
    ranges_.emplace_back(range->Clone(), child);
}

ScaleSplit& ScaleSplit::operator=(const ScaleSplit& other) {
  if (this == &other) return *this;
  ScaleSplit copy(other);
  ScoreSplitVar::operator=(copy);
  ranges_.swap(copy.ranges_);
  return *this;
}

ScaleSplit::~ScaleSplit() = default;

ScaleSplit* ScaleSplit::Clone() const {
  return new ScaleSplit(*this);
}

ScoreSplitVar::SplitVarType ScaleSplit::GetSplitVarType() const {
  return kScale;
}

int ScaleSplit::GetSplitChildIndex(const ScoreValue* value) const {
  const ScoreDictVar* variable = GetSplitVar();
  if (value == nullptr || (variable != nullptr && variable->IsMissingValue(value))) return GetMissvalMap();
  for (const auto& [range, child] : ranges_) {
    if (range->IsInRange(value)) return child;
  }
  return -1;
}

void ScaleSplit::Display(std::ostream& out) const {
  // Numbers go through to_string: a stream may carry a locale that groups digits.
  out << "SplitVarName = " << GetSplitName() << "\nMissing Value index: " << std::to_string(GetMissvalMap())
      << "\n";
  for (const auto& [range, child] : ranges_) {
    out << "Index = " << std::to_string(child) << "\n";
    range->Display(out);
  }
  out << "\n";
}

void ScaleSplit::PutSplit(ScoreValueRange* range, int child) {
  if (range != nullptr) ranges_.emplace_back(std::unique_ptr<ScoreValueRange>(range), child);
}

const ScoreValueRange* ScaleSplit::GetSplitValueRangeFirst() const {
  return ranges_.empty() ? nullptr : ranges_.front().first.get();
}

const ScoreValueRange* ScaleSplit::GetSplitValueRangeForIndex(int child) const {
  for (const auto& pair : ranges_) {
    if (pair.second == child) return pair.first.get();
  }
  return nullptr;
}

}  // namespace MCKestrel_800
