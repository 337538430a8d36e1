// Finds the elements of a list that may hold a given value, without walking the list.

#ifndef KESTREL_DICTIONARY_VALUEINDEX_H
#define KESTREL_DICTIONARY_VALUEINDEX_H

#include <cstddef>
#include <cstdint>
#include <vector>

#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// Where a value is filed and where values equal to it may be filed.
///
/// Numbers are equal within a relative tolerance, so equal numbers need not share a place: a number is filed
/// by its leading digits, and what equals it lies there or, near the edge, in one neighbouring place. Texts
/// are filed without their trailing blanks, which never count.
struct ValueKey {
  enum Kind : std::uint8_t {
    kForeign,  ///< null or a class of its own: it decides itself what it equals, so it has to be asked
    kNever,    ///< an infinity or NaN: equal to no value of the kinds below, itself included
    kNumber,
    kText,
    kDateTime
  };

  Kind kind = kForeign;
  /// Where it is filed.
  std::uint32_t own = 0;
  /// The other place where an equal value may be; the same as `own` when there is none.
  std::uint32_t neighbour = 0;

  bool IsFiled() const { return kind >= kNumber; }
};

/// The key of a value; null is allowed.
KESTREL_API ValueKey MakeValueKey(const ScoreValue* value);
/// The place of a pair of values, such as the two ends of an interval.
KESTREL_API std::uint32_t JoinPlaces(std::uint32_t first, std::uint32_t second);

/// Keeps, for each position of a list, the place where its element is filed. The positions of one place are
/// visited in ascending order, so that the first match is the one that a walk would find.
///
/// Several elements may share a place by chance: a visitor has to compare. About 12 bytes per element.
/// Places come from a keyed hash with a key of this process: a document cannot be made to crowd one of them.
class KESTREL_API ValueIndex {
 public:
  /// No position.
  static constexpr std::size_t kNone = static_cast<std::size_t>(-1);
  /// Up to this many elements a walk costs no more than a look-up; a list keeps no index for them.
  static constexpr std::size_t kSmall = 16;

  void Clear();
  /// The number of positions known; 0 when no index is kept.
  std::size_t Size() const { return places_.size(); }

  /// Files the next position under a place.
  void Append(std::uint32_t place);
  /// Notes the next position as one that `FirstOf` never visits.
  void AppendUnfiled();
  /// Notes the next position as one that every `FirstOf` visits.
  void AppendForeign();
  /// Forgets a position; those after it move down by one. As expensive as erasing from a vector.
  void Erase(std::size_t position);

  /// The first position before `limit` filed under `place` for which `matches(position)` holds; else `limit`.
  template <class Matches>
  std::size_t FirstIn(std::uint32_t place, std::size_t limit, const Matches& matches) const {
    if (tails_.empty()) return limit;
    const std::uint32_t tail = tails_[place & (tails_.size() - 1)];
    if (tail == kUnlinked) return limit;
    std::uint32_t position = tail;
    do {
      position = next_[position];
      if (position >= limit) return limit;
      if (places_[position] == place && matches(position)) return position;
    } while (position != tail);
    return limit;
  }
  /// The first foreign position before `limit` for which `matches(position)` holds; else `limit`.
  template <class Matches>
  std::size_t FirstForeign(std::size_t limit, const Matches& matches) const {
    for (const std::uint32_t position : foreign_) {
      if (position >= limit) break;
      if (matches(position)) return position;
    }
    return limit;
  }
  /// The first position for which `matches(position)` holds, among those where a value of this key may have
  /// an equal; kNone when there is none. The key must not be foreign.
  template <class Matches>
  std::size_t FirstOf(const ValueKey& key, const Matches& matches) const {
    std::size_t first = kNone;
    if (key.IsFiled()) {
      first = FirstIn(key.own, first, matches);
      if (key.neighbour != key.own) first = FirstIn(key.neighbour, first, matches);
    }
    return FirstForeign(first, matches);
  }

 private:
  static constexpr std::uint32_t kUnlinked = 0xFFFFFFFFu;

  void Link(std::uint32_t position);
  void LinkAll();

  std::vector<std::uint32_t> places_;  // by position
  // By position: the next one in the same chain, in a ring; kUnlinked if in none.
  std::vector<std::uint32_t> next_;
  std::vector<std::uint32_t> tails_;    // by the place's low bits: the last position of the chain
  std::vector<std::uint32_t> foreign_;  // ascending
  std::size_t linked_ = 0;
};

/// Takes a position out of an ascending list and moves those after it down by one.
void ErasePosition(std::vector<std::uint32_t>& positions, std::size_t position);

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_VALUEINDEX_H
