// A tree as a document gives it, compiled.

#ifndef KESTREL_PLUGINS_TREE_TREE_H
#define KESTREL_PLUGINS_TREE_TREE_H

#include <cstddef>

#include "plugins/support/CaseVector.h"
#include "plugins/support/ConditionTable.h"
#include "plugins/support/TargetCategories.h"
#include "plugins/tree/NodeScores.h"
#include "plugins/tree/TreeOptions.h"
#include "plugins/tree/TreeTable.h"

namespace MCKestrel_800 {

/// Everything that is known of the tree after loading; nothing of it changes while cases are scored, but for
/// the inputs' values.
struct Tree {
  Tree(const TreeOptions& the_options, const ScoreDictVar* target)
      : options(the_options),
        categories(target),
        scores({the_options.is_classification, NeedsRecordCounts(the_options),
                the_options.strategy == MissingValueStrategy::kDefaultChild}) {}

  /// The record counts of nodes, as opposed to those of their distributions, are weights.
  static bool NeedsRecordCounts(const TreeOptions& options) {
    return options.strategy == MissingValueStrategy::kWeightedConfidence ||
           (options.strategy == MissingValueStrategy::kAggregateNodes && !options.is_classification);
  }

  /// What nodes take in memory, all but distributions and identifiers.
  std::size_t GetMemorySize() const {
    return table.GetMemorySize() + conditions.GetMemorySize() + scores.GetMemorySize();
  }

  TreeOptions options;
  CaseVector inputs;
  TargetCategories categories;
  TreeTable table;
  ConditionTable conditions;
  NodeScores scores;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_TREE_TREE_H
