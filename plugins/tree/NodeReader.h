// Reads the `Node` elements of a tree.

#ifndef KESTREL_PLUGINS_TREE_NODEREADER_H
#define KESTREL_PLUGINS_TREE_NODEREADER_H

#include <xercesc/util/XercesDefs.hpp>

#include <string>
#include <vector>

#include "kestrel/translate/LeafNodeStats.h"
#include "plugins/support/PredicateInputs.h"
#include "plugins/tree/Tree.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

/// Adds nodes to a tree. Walks the elements without recursion, so that depth costs no stack; predicates are
/// compiled one by one and dropped.
///
/// Errors, at the element, beside those of PMMLTranslator's predicate readers and SetLeafNodeStats:
///   code 1  a second predicate in a node, an element that does not belong there, or a category twice in a
///           distribution;
///   code 3  a `recordCount` or a regression's `score` that is no number;
///   code 4  a node without predicate; a leaf that predicts nothing; what the strategy for missing values
///           needs of a node that lacks it: `defaultChild`, `recordCount`, `ScoreDistribution`;
///   code 5  an embedded model;
///   code 6  a negative or infinite `recordCount` or an infinite `score`, a `defaultChild` that is no child's
///           `id`;
///   code 7  a score or distribution value that is no category of the target;
///   code 8  a predicate's field that is neither an active field of the mining schema nor a derived field.
class NodeReader {
 public:
  /// Both must outlive the reader.
  NodeReader(PredicateInputs& inputs, Tree& tree) : inputs_(inputs), tree_(tree) {}

  /// Reads the root's `Node` element and all below it.
  void Read(xercesc::DOMElement* root);

 private:
  int OpenNode(xercesc::DOMElement* element);
  void CloseNode(xercesc::DOMElement* element, int node);
  void ReadDistribution(xercesc::DOMElement* element, NodeScores::Node& node);
  void CheckLeaf(const xercesc::DOMElement* element, int node) const;
  void FindDefaultChild(const xercesc::DOMElement* element, int node);

  PredicateInputs& inputs_;
  Tree& tree_;
  // Kept from node to node.
  std::vector<LeafNodeStats> stats_;
  std::vector<CategoryShare> shares_;
  std::vector<int> last_nodes_;  ///< by category: the last node whose distribution names it
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_TREE_NODEREADER_H
