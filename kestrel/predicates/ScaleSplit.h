// A split that maps intervals of numbers.

#ifndef KESTREL_PREDICATES_SCALESPLIT_H
#define KESTREL_PREDICATES_SCALESPLIT_H

#include <cstddef>
#include <iosfwd>
#include <memory>
#include <utility>
#include <vector>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/platform/Export.h"
#include "kestrel/predicates/ScoreSplitVar.h"
#include "kestrel/predicates/ScoreValueRange.h"

namespace MCKestrel_800 {

/// Ranges in the order in which they were put; where they overlap the first one wins. Copies are deep.
class KESTREL_API ScaleSplit : public ScoreSplitVar {
 public:
  ScaleSplit();
  explicit ScaleSplit(const ScoreDictVar* variable);
  ScaleSplit(const ScaleSplit& other);
  ScaleSplit& operator=(const ScaleSplit& other);
  ~ScaleSplit() override;

  ScaleSplit* Clone() const override;
  SplitVarType GetSplitVarType() const override;
  /// The system-missing number goes where missing values go; the variable's own missing values are not known
  /// here. Stands here so that a compiler can put it in the place of a predicate's virtual call, which takes
  /// a good part of the time of a comparison.
  int GetSplitChildIndex(double x) const override {
    if (NumericValue::IsSystemMissingValue(x)) return GetMissvalMap();
    for (const auto& [range, child] : ranges_) {
      if (range->IsInRange(x)) return child;
    }
    return -1;
  }
  /// Null and what the variable calls missing go where missing values go.
  int GetSplitChildIndex(const ScoreValue* value) const override;
  void Display(std::ostream& out) const override;

  /// Appends a range, which the split owns from then on. Null is refused: nothing happens.
  void PutSplit(ScoreValueRange* range, int child);

  /// The first range, or the first of a child; null when there is none. They belong to the split.
  const ScoreValueRange* GetSplitValueRangeFirst() const;
  const ScoreValueRange* GetSplitValueRangeForIndex(int child) const;

  /// All ranges, in the order in which they were put; `position` is below the count.
  std::size_t GetRangeCount() const { return ranges_.size(); }
  const ScoreValueRange& GetRange(std::size_t position) const { return *ranges_[position].first; }

 private:
  std::vector<std::pair<std::unique_ptr<ScoreValueRange>, int>> ranges_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PREDICATES_SCALESPLIT_H
