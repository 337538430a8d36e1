// Codes with what they map to, kept as runs of neighbours.

#ifndef KESTREL_PREDICATES_CODEMAP_H
#define KESTREL_PREDICATES_CODEMAP_H

#include <functional>
#include <map>
#include <vector>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// An ordered map from numbers (mostly category codes) to child indexes. Whole codes that follow each other
/// and go to the same child are one run, so that the complement of a few categories of a large list takes a
/// few entries: a document's size bounds what its predicates keep.
///
/// Threads: a finished map may be asked from several threads.
class KESTREL_API CodeMap {
 public:
  /// The whole numbers from `first` to `last`, or, when the two are the same, that one number of any kind.
  struct Run {
    double first;
    double last;
    int child;
  };

  /// Maps a number; one that is mapped already keeps its child. NaN, which equals no number, is ignored.
  void Insert(double code, int child);
  /// Maps the whole numbers from `first` to `last`; those that are mapped already keep their child. Takes
  /// time that grows with the runs in the way, not with the codes.
  void InsertRun(int first, int last, int child);

  /// The child of a number that is equal to a key, or -1.
  int Find(double code) const;

  /// Ascending and disjoint; made anew by each call.
  std::vector<Run> GetRuns() const;

 private:
  struct End {
    double last;
    int child;
  };
  // By their first codes, the highest run first, so that lower_bound finds the one run that may hold a code
  // without a step back. A tree and not a sorted list: codes come in any order, and a list would move all
  // that follow for each of them.
  using Runs = std::map<double, End, std::greater<double>>;

  /// The run that starts last among those that start at or below a code.
  Runs::iterator RunBelow(double code);
  /// Maps codes of which none is mapped and joins them with the runs that they touch; `below` is the run
  /// below them.
  void Fill(Runs::iterator below, double first, double last, int child);

  Runs runs_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PREDICATES_CODEMAP_H
