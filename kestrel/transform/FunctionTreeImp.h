// The one implementation of FunctionTree.

#ifndef KESTREL_TRANSFORM_FUNCTIONTREEIMP_H
#define KESTREL_TRANSFORM_FUNCTIONTREEIMP_H

#include <iosfwd>
#include <vector>

#include "kestrel/platform/Export.h"
#include "kestrel/transform/FunctionTree.h"

namespace MCKestrel_800 {

/// A node that holds its children in a vector. `a + 1` is
///
///   ApplyNodeStats plus, field, one;
///   plus.SetTransFunction(kPlusFunction);
///   field.SetParameterName("a");
///   one.SetConstNode(true);
///   one.SetValue(new NumericValue(1.0));
///   auto* tree = new FunctionTreeImp(plus);
///   tree->Add(new FunctionTreeImp(field));
///   tree->Add(new FunctionTreeImp(one));
///
/// Neither destruction nor cloning, comparing or showing costs stack by the depth of the tree.
class KESTREL_API FunctionTreeImp : public FunctionTree {
 public:
  explicit FunctionTreeImp(bool allows_children = true);
  explicit FunctionTreeImp(const ApplyNodeStats& stats, bool allows_children = true);
  FunctionTreeImp(const FunctionTreeImp&) = delete;
  FunctionTreeImp& operator=(const FunctionTreeImp&) = delete;
  /// Deletes all below it. Takes itself off a parent that it still has.
  ~FunctionTreeImp() override;

  void Display(std::ostream& os) const override;
  bool operator==(const FunctionTree& other) const override;
  void Add(FunctionTree* child) override;
  void Insert(FunctionTree* child, int index) override;
  void Remove(FunctionTree* child) override;
  void Remove(int index) override;
  void RemoveAllChildren() override;
  void RemoveFromParent() override;
  void SetParent(FunctionTree* parent) override { parent_ = parent; }
  FunctionTree* GetParent() const override { return parent_; }
  FunctionTree* GetChildAt(int index) override;
  const FunctionTree* GetChildAt(int index) const override;
  int GetChildCount() const override { return static_cast<int>(children_.size()); }
  int GetIndex(const FunctionTree* child) const override;
  bool GetAllowsChildren() const override { return allows_children_; }
  bool IsLeaf() const override { return children_.empty(); }
  FunctionTree* GetRoot() override;
  const std::vector<FunctionTree*>& Children() const override { return children_; }
  const ApplyNodeStats& GetNodeStats() const override { return stats_; }
  void SetNodeStats(const ApplyNodeStats& stats) override { stats_ = stats; }
  FunctionTree* Clone() const override;

  /// Children that are there already stay.
  void SetAllowsChildren(bool allows_children) { allows_children_ = allows_children; }

  /// Neighbours; null where there is none, and for a child that is none of this node's.
  FunctionTree* GetFirstChild() const;
  FunctionTree* GetLastChild() const;
  FunctionTree* GetChildBefore(const FunctionTree* child) const;
  FunctionTree* GetChildAfter(const FunctionTree* child) const;
  FunctionTree* GetNextSibling() const;
  FunctionTree* GetPreviousSibling() const;
  /// This node included; 1 for a root.
  int GetSiblingCount() const;
  /// A node is its own sibling.
  bool IsNodeSibling(const FunctionTree* node) const;

  /// Leaves from left to right. A leaf is its own first and last leaf.
  FunctionTree* GetFirstLeaf();
  FunctionTree* GetLastLeaf();
  FunctionTree* GetNextLeaf() const;
  FunctionTree* GetPreviousLeaf() const;
  /// Nodes in pre-order, over the whole tree that this node is in.
  FunctionTree* GetNextNode() const;
  FunctionTree* GetPreviousNode() const;

  bool IsRoot() const { return parent_ == nullptr; }
  /// The number of steps up to the root.
  int GetLevel() const;
  /// A node is its own ancestor and its own descendant.
  bool IsNodeAncestor(const FunctionTree* node) const;
  bool IsNodeDescendant(const FunctionTree* node) const;
  bool IsNodeChild(const FunctionTree* node) const;

 private:
  FunctionTree* parent_ = nullptr;
  std::vector<FunctionTree*> children_;
  bool allows_children_;
  ApplyNodeStats stats_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_FUNCTIONTREEIMP_H
