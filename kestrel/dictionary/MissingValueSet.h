// The one implementation of ScoreMissingValueSet, with look-ups that do not grow with the number of single
// values.

#ifndef KESTREL_DICTIONARY_MISSINGVALUESET_H
#define KESTREL_DICTIONARY_MISSINGVALUESET_H

#include <cstdint>
#include <vector>

#include "kestrel/dictionary/ScoreMissingValueSet.h"
#include "kestrel/dictionary/ValueIndex.h"

namespace MCKestrel_800 {

/// A missing-value set whose answers are those of a walk from the first range to the last. Once the set has
/// grown beyond a few ranges, duplicates and single values are found through an index; true intervals are
/// still walked.
///
/// A range must not be changed through a pointer that was kept after it was added.
/// The index changes in `Add` and `Remove` alone: a set that nobody changes may be read by several threads.
class KESTREL_API MissingValueSet : public ScoreMissingValueSet {
 public:
  MissingValueSet();
  MissingValueSet(const MissingValueSet& other);
  MissingValueSet& operator=(const MissingValueSet& other);
  ~MissingValueSet() override;

  MissingValueSet* Clone() const override;
  bool Add(ScoreValueRange* range) override;
  bool Remove(const ScoreValueRange* range) override;
  std::size_t Size() const override;
  bool Contains(const ScoreValueRange* range) const override;
  std::vector<const ScoreValueRange*> GetMissingValues() const override;
  void Display(std::ostream& os) const override;

  /// True when some range holds the value (`IsInRange`). Allocates nothing.
  bool HoldsValue(const ScoreValue* value) const;

 private:
  std::size_t FindEqual(const ScoreValueRange& range) const;
  std::size_t FindEqualByWalk(const ScoreValueRange& range) const;
  bool HoldsValueByWalk(const ScoreValue* value) const;
  void Append(ScoreValueRange* range);
  void AppendToIndex(const ScoreValueRange& range, std::uint32_t position);
  void CopyRanges(const MissingValueSet& other);
  void DeleteRanges();

  std::vector<ScoreValueRange*> ranges_;
  ValueIndex index_;
  // Positions of the ranges that are not indexed as single values, ascending; filled once index_ is.
  std::vector<std::uint32_t> intervals_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_MISSINGVALUESET_H
