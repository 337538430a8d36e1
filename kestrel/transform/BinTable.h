// The bins of a Discretize field, laid out so that the first that holds a number is found without a walk.

#ifndef KESTREL_TRANSFORM_BINTABLE_H
#define KESTREL_TRANSFORM_BINTABLE_H

#include <cstddef>
#include <cstdint>
#include <vector>

#include "kestrel/transform/NumberSearch.h"
#include "kestrel/transform/TransformVar.h"

namespace MCKestrel_800 {

class Range;

/// Answers as asking the bins' ranges in their order does. Bins that do not overlap (but for the tolerance of
/// their ends) are searched by halving; others are asked one by one. The bins must outlive the table and not
/// change.
class BinTable {
 public:
  static constexpr std::size_t kNone = static_cast<std::size_t>(-1);

  explicit BinTable(const std::vector<TransformVar::Bin>& bins);

  /// The first bin that holds the number; kNone when there is none.
  std::size_t Find(double number) const;
  /// The same where the number is in a bin but not near its ends; kNone elsewhere. Of the system-missing
  /// value, kNone.
  std::size_t FindInside(double number) const {
    const Core& core = cores_[highs_.FirstNotBelow(number)];
    return core.low < number && number < core.high ? core.bin : kNone;
  }

 private:
  /// Between which numbers a bin alone may hold one: neither an end's tolerance nor a neighbour's reaches
  /// there.
  struct Core {
    double low;
    double high;
    std::size_t bin;
  };
  /// A bin with the numbers between which it may hold one, tolerances included.
  struct Reach {
    double low;
    double high;
    const Range* range;
    std::size_t bin;
  };

  void ReadReaches();
  void MakeCores();
  std::size_t Walk(double number) const;

  // First what every case needs.
  std::vector<Core> cores_;     ///< of the reaches, and behind them one that holds nothing
  NumberSearch highs_;          ///< of the reaches
  std::vector<Reach> reaches_;  ///< ascending at both ends; empty when the bins are no such list
  const std::vector<TransformVar::Bin>& bins_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_BINTABLE_H
