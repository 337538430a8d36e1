// The interface of a node of an Apply expression.

#ifndef KESTREL_TRANSFORM_FUNCTIONTREE_H
#define KESTREL_TRANSFORM_FUNCTIONTREE_H

#include <iosfwd>
#include <vector>

#include "kestrel/platform/Export.h"
#include "kestrel/transform/ApplyNodeStats.h"

namespace MCKestrel_800 {

/// A node with its children, which are the function's arguments in the order of the document. A node owns its
/// children; a node that is removed belongs to whoever removed it.
class KESTREL_API FunctionTree {
 public:
  virtual ~FunctionTree();
  virtual void Display(std::ostream& os) const = 0;
  /// Equal payloads and equal children in equal order.
  virtual bool operator==(const FunctionTree& other) const = 0;
  /// Appends a child. A child that is under this node already moves to the end. Refused as by Insert.
  virtual void Add(FunctionTree* child) = 0;
  /// Puts a child before the one at `index` (at the end for an index beyond it, at the front for a negative
  /// one) and takes it over from its former parent. Nothing happens when this node takes no children, when
  /// `child` is null, or when it is this node or one of its ancestors.
  virtual void Insert(FunctionTree* child, int index) = 0;
  /// Takes a child off, which belongs to the caller then. Nothing happens when it is no child.
  virtual void Remove(FunctionTree* child) = 0;
  virtual void Remove(int index) = 0;
  /// Takes all children off; they belong to the caller, who has looked at `Children()` before.
  virtual void RemoveAllChildren() = 0;
  /// Takes this node off its parent, if it has one; it belongs to the caller then.
  virtual void RemoveFromParent() = 0;
  /// Notes the parent, without telling it: Add and Insert use this.
  virtual void SetParent(FunctionTree* parent) = 0;
  virtual FunctionTree* GetParent() const = 0;
  /// A child, or null.
  virtual FunctionTree* GetChildAt(int index) = 0;
  virtual const FunctionTree* GetChildAt(int index) const = 0;
  virtual int GetChildCount() const = 0;
  /// The position of a child, or -1.
  virtual int GetIndex(const FunctionTree* child) const = 0;
  virtual bool GetAllowsChildren() const = 0;
  virtual bool IsLeaf() const = 0;
  /// The node at the top, this one if it has no parent.
  virtual FunctionTree* GetRoot() = 0;
  virtual const std::vector<FunctionTree*>& Children() const = 0;
  virtual const ApplyNodeStats& GetNodeStats() const = 0;
  virtual void SetNodeStats(const ApplyNodeStats& stats) = 0;
  /// A deep copy of the node and all below it, without a parent, that the caller owns.
  virtual FunctionTree* Clone() const = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_FUNCTIONTREE_H
