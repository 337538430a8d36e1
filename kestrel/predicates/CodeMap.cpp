#include "kestrel/predicates/CodeMap.h"

#include <algorithm>
#include <cmath>
#include <iterator>
#include <limits>

namespace MCKestrel_800 {

namespace {

/// Whether a number is a whole one that `int` holds: runs are made of these alone.
bool IsCode(double number) {
  constexpr double kLowest = std::numeric_limits<int>::min(), kHighest = std::numeric_limits<int>::max();
  return number >= kLowest && number <= kHighest && number == static_cast<double>(static_cast<int>(number));
}

}  // namespace

void CodeMap::Insert(double code, int child) {
  if (IsCode(code)) {
    InsertRun(static_cast<int>(code), static_cast<int>(code), child);
    return;
  }
  if (std::isnan(code)) return;
  const auto below = RunBelow(code);
  if (below != runs_.end() && code <= below->second.last) {
    if (code == below->first) return;
    // A fraction between two codes of a run: the run has to make room.
    runs_.emplace(std::ceil(code), below->second);
    below->second.last = std::floor(code);
  }
  runs_.emplace(code, End{code, child});
}

void CodeMap::InsertRun(int first, int last, int child) {
  double next = first;
  while (next <= last) {
    const auto below = RunBelow(next);
    if (below != runs_.end() && next <= below->second.last) {
      next = below->second.last + 1;
      continue;
    }
    const bool isTop = below == runs_.begin();
    const double end = isTop ? last : std::min<double>(last, std::ceil(std::prev(below)->first) - 1);
    Fill(below, next, end, child);
    next = end + 1;
  }
}

CodeMap::Runs::iterator CodeMap::RunBelow(double code) {
  // Codes mostly come in ascending order.
  const bool isAboveAll = !runs_.empty() && runs_.begin()->first <= code;
  return isAboveAll ? runs_.begin() : runs_.lower_bound(code);
}

void CodeMap::Fill(Runs::iterator below, double first, double last, int child) {
  const auto joins = [child](Runs::iterator run) { return run->second.child == child && IsCode(run->first); };
  if (below != runs_.begin()) {
    const auto above = std::prev(below);
    if (above->first == last + 1 && joins(above)) {
      last = above->second.last;
      runs_.erase(above);
    }
  }
  if (below != runs_.end() && below->second.last == first - 1 && joins(below)) {
    below->second.last = last;
  } else {
    runs_.emplace_hint(below, first, End{last, child});
  }
}

int CodeMap::Find(double code) const {
  const auto run = runs_.lower_bound(code);
  if (run == runs_.end() || !(code <= run->second.last)) return -1;
  return code == run->first || IsCode(code) ? run->second.child : -1;
}

std::vector<CodeMap::Run> CodeMap::GetRuns() const {
  std::vector<Run> runs;
  runs.reserve(runs_.size());
  for (auto run = runs_.rbegin(); run != runs_.rend(); ++run)
    runs.push_back({run->first, run->second.last, run->second.child});
  return runs;
}

}  // namespace MCKestrel_800
