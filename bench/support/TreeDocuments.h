// Tree models of a wanted size with the same trees as plain arrays, to hold the library against.

#ifndef KESTREL_BENCH_SUPPORT_TREEDOCUMENTS_H
#define KESTREL_BENCH_SUPPORT_TREEDOCUMENTS_H

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace kestrel_bench {

/// Random binary splits on numbers from 0 to 1. Nodes lie level by level, two siblings side by side, as a
/// walk by hand would have them.
struct PlainTree {
  struct Node {
    double threshold;    ///< at most this: the first child; of a leaf the score
    std::int32_t child;  ///< the first child; a leaf is its own
    std::int32_t feature;
  };
  std::vector<Node> nodes;
  int depth = 0;  ///< comparisons on the longest way

  bool IsLeaf(std::size_t node) const { return nodes[node].child == static_cast<std::int32_t>(node); }
  /// Always `depth` steps without a branch: a leaf steps onto itself.
  double Score(const double* x) const;
};

/// A tree in which about one node in twenty-five is a leaf before the last level.
PlainTree RandomTree(int inputs, int depth, unsigned seed);

/// What a tree document has beside its splits.
struct TreeShape {
  int categories = 0;          ///< 0 for a regression; else each node has a distribution
  bool default_child = false;  ///< missingValueStrategy
};

/// The tree as a PMML document on fields x0, x1, ..., in the layout that training programs write.
std::string TreeDocument(const PlainTree& tree, int inputs, const TreeShape& shape);

/// The category that a leaf of such a document predicts, by its score.
int CategoryOf(double score, int categories);

}  // namespace kestrel_bench

#endif  // KESTREL_BENCH_SUPPORT_TREEDOCUMENTS_H
