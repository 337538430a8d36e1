// How a tree treats cases that do not fit it.

#ifndef KESTREL_PLUGINS_TREE_TREEOPTIONS_H
#define KESTREL_PLUGINS_TREE_TREEOPTIONS_H

#include <xercesc/util/XercesDefs.hpp>

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

/// What happens when a child's predicate cannot be decided.
enum class MissingValueStrategy {
  kNone,                ///< it counts as false
  kLastPrediction,      ///< the node whose children are asked predicts
  kNullPrediction,      ///< there is no prediction
  kDefaultChild,        ///< the node names the child to go on with
  kWeightedConfidence,  ///< all children that are not false predict, weighted by their record counts
  kAggregateNodes       ///< the record counts of all leaves that can be reached are added up
};

/// The attributes of a `TreeModel` element that belong to no model kind but this one.
struct TreeOptions {
  bool is_classification = false;
  MissingValueStrategy strategy = MissingValueStrategy::kNone;
  /// Multiplied to the confidence for each step by a default child or a surrogate; from 0 to 1.
  double penalty = 1.0;
  /// Whether a node none of whose children is true predicts itself; else there is no prediction.
  bool returns_last_prediction = false;

  /// Reads the attributes, but for the function, which stays as it is. `splitCharacteristic` is only checked:
  /// it says nothing that the nodes do not say. Errors, at the element: code 3 for a penalty that is no
  /// number, code 6 for a word that is not in the vocabulary and a penalty outside 0 to 1.
  void Read(const xercesc::DOMElement* element);

  /// The document's word for the strategy.
  const char* GetStrategyText() const;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_TREE_TREEOPTIONS_H
