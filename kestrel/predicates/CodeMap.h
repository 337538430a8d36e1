// Codes with what they map to, kept as runs of neighbours.

#ifndef KESTREL_PREDICATES_CODEMAP_H
#define KESTREL_PREDICATES_CODEMAP_H

#include <cstddef>
#include <vector>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// An ordered map from numbers (mostly category codes) to child indexes. Whole codes that follow each other
/// and go to the same child are one run, so that the complement of a few categories of a large list takes a
/// few entries: a document's size bounds what its predicates keep.
class KESTREL_API CodeMap {
 public:
  /// The whole numbers from `first` to `last`, or, when the two are the same, that one number of any kind.
  struct Run {
    double first;
    double last;
    int child;
  };

  /// Maps a number; one that is mapped already keeps its child.
  void Insert(double code, int child);
  /// Maps the whole numbers from `first` to `last`; those that are mapped already keep their child. Takes
  /// time that grows with the runs in the way, not with the codes.
  void InsertRun(int first, int last, int child);

  /// The child of a number that is equal to a key, or -1.
  int Find(double code) const;

  /// Ascending and disjoint.
  const std::vector<Run>& GetRuns() const { return runs_; }

 private:
  std::vector<Run> runs_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PREDICATES_CODEMAP_H
