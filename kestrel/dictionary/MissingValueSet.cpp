#include "kestrel/dictionary/MissingValueSet.h"

#include <memory>
#include <ostream>
#include <typeinfo>

#include "kestrel/predicates/Range.h"

namespace MCKestrel_800 {

namespace {

/// The keys of a range's ends. Both foreign when the range is of another class, which compares in its own
/// way.
struct RangeKeys {
  ValueKey min;
  ValueKey max;

  explicit RangeKeys(const ScoreValueRange& range) {
    if (typeid(range) != typeid(Range)) return;
    min = MakeValueKey(range.GetMin());
    max = MakeValueKey(range.GetMax());
  }

  /// True when whatever the range holds lies near its minimum: its ends are the same. Ends that are merely
  /// equal within the tolerance do not count, since such a range may hold what equals either of them.
  bool HoldsItsMinimumAlone(const ScoreValueRange& range) const {
    if (!min.IsFiled() || min.kind != max.kind) return false;
    if (min.kind == ValueKey::kText) return *range.GetMin() == *range.GetMax();
    return range.GetMin()->GetDouble() == range.GetMax()->GetDouble();
  }

  bool AnyForeign() const { return min.kind == ValueKey::kForeign || max.kind == ValueKey::kForeign; }
  /// An end that equals nothing makes a range that equals nothing.
  bool AnyNever() const { return min.kind == ValueKey::kNever || max.kind == ValueKey::kNever; }
};

}  // namespace

ScoreMissingValueSet::~ScoreMissingValueSet() = default;

MissingValueSet::MissingValueSet() = default;

// Through the default constructor, so that the destructor runs when a range cannot be cloned.
MissingValueSet::MissingValueSet(const MissingValueSet& other) : MissingValueSet() {
  CopyRanges(other);
}

MissingValueSet& MissingValueSet::operator=(const MissingValueSet& other) {
  if (this == &other) return *this;
  DeleteRanges();
  CopyRanges(other);
  return *this;
}

MissingValueSet::~MissingValueSet() {
  DeleteRanges();
}

MissingValueSet* MissingValueSet::Clone() const {
  return new MissingValueSet(*this);
}

void MissingValueSet::CopyRanges(const MissingValueSet& other) {
  ranges_.reserve(other.ranges_.size());
  for (const ScoreValueRange* range : other.ranges_)
    Append(range->Clone());
}

void MissingValueSet::DeleteRanges() {
  for (ScoreValueRange* range : ranges_)
    delete range;
  ranges_.clear();
  index_.Clear();
  intervals_.clear();
}

bool MissingValueSet::Add(ScoreValueRange* range) {
  if (range == nullptr || FindEqual(*range) != ValueIndex::kNone) return false;
  Append(range);
  return true;
}

void MissingValueSet::Append(ScoreValueRange* range) {
  ranges_.push_back(range);
  if (ranges_.size() > ValueIndex::kSmall || index_.Size() != 0) {
    for (std::size_t position = index_.Size(); position < ranges_.size(); ++position) {
      AppendToIndex(*ranges_[position], static_cast<std::uint32_t>(position));
    }
  }
}

void MissingValueSet::AppendToIndex(const ScoreValueRange& range, std::uint32_t position) {
  const RangeKeys keys(range);
  // A range with an end of an unknown class has to be asked, for equality and for what it holds.
  if (keys.AnyForeign()) {
    index_.AppendForeign();
    intervals_.push_back(position);
    return;
  }
  if (keys.AnyNever()) {
    index_.AppendUnfiled();
    intervals_.push_back(position);
    return;
  }
  if (keys.HoldsItsMinimumAlone(range)) {
    index_.Append(keys.min.own);
    return;
  }
  index_.Append(JoinPlaces(keys.min.own, keys.max.own));
  intervals_.push_back(position);
}

std::size_t MissingValueSet::FindEqualByWalk(const ScoreValueRange& range) const {
  for (std::size_t position = 0; position < ranges_.size(); ++position) {
    if (*ranges_[position] == range) return position;
  }
  return ValueIndex::kNone;
}

std::size_t MissingValueSet::FindEqual(const ScoreValueRange& range) const {
  if (index_.Size() == 0) return FindEqualByWalk(range);
  const RangeKeys keys(range);
  if (keys.AnyForeign()) return FindEqualByWalk(range);
  const auto matches = [&](std::size_t position) { return *ranges_[position] == range; };
  std::size_t first = ValueIndex::kNone;
  if (!keys.AnyNever()) {
    // Equal ranges need not both count as single values: the ends of one may differ by less than the
    // tolerance.
    first = index_.FirstIn(keys.min.own, first, matches);
    if (keys.min.neighbour != keys.min.own) first = index_.FirstIn(keys.min.neighbour, first, matches);
    for (const std::uint32_t min : {keys.min.own, keys.min.neighbour}) {
      for (const std::uint32_t max : {keys.max.own, keys.max.neighbour}) {
        first = index_.FirstIn(JoinPlaces(min, max), first, matches);
      }
    }
  }
  return index_.FirstForeign(first, matches);
}

bool MissingValueSet::Remove(const ScoreValueRange* range) {
  if (range == nullptr) return false;
  const std::size_t position = FindEqual(*range);
  if (position == ValueIndex::kNone) return false;
  delete ranges_[position];
  ranges_.erase(ranges_.begin() + static_cast<std::ptrdiff_t>(position));
  if (index_.Size() != 0) {
    index_.Erase(position);
    ErasePosition(intervals_, position);
  }
  return true;
}

std::size_t MissingValueSet::Size() const {
  return ranges_.size();
}

bool MissingValueSet::Contains(const ScoreValueRange* range) const {
  return range != nullptr && FindEqual(*range) != ValueIndex::kNone;
}

std::vector<const ScoreValueRange*> MissingValueSet::GetMissingValues() const {
  return std::vector<const ScoreValueRange*>(ranges_.begin(), ranges_.end());
}

bool MissingValueSet::HoldsValueByWalk(const ScoreValue* value) const {
  for (const ScoreValueRange* range : ranges_) {
    if (range->IsInRange(value)) return true;
  }
  return false;
}

bool MissingValueSet::HoldsValue(const ScoreValue* value) const {
  if (index_.Size() == 0) return HoldsValueByWalk(value);
  const ValueKey key = MakeValueKey(value);
  if (key.kind == ValueKey::kForeign) return HoldsValueByWalk(value);
  const auto holds = [&](std::size_t position) { return ranges_[position]->IsInRange(value); };
  if (key.IsFiled()) {
    constexpr std::size_t kNone = ValueIndex::kNone;
    if (index_.FirstIn(key.own, kNone, holds) != kNone) return true;
    if (key.neighbour != key.own && index_.FirstIn(key.neighbour, kNone, holds) != kNone) return true;
  }
  for (const std::uint32_t position : intervals_) {
    if (holds(position)) return true;
  }
  return false;
}

void MissingValueSet::Display(std::ostream& os) const {
  os << " Begin MissingValueSet Display:\n";
  for (const ScoreValueRange* range : ranges_)
    range->Display(os);
  os << "End MissingValueSet Display.\n";
}

}  // namespace MCKestrel_800
