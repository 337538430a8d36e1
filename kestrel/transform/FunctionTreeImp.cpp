#include "kestrel/transform/FunctionTreeImp.h"

#include <algorithm>
#include <cstddef>
#include <iterator>
#include <memory>
#include <ostream>
#include <typeinfo>
#include <utility>

namespace MCKestrel_800 {

namespace {

/// The neighbour of a node under its parent, `step` places to the right; null when there is none.
FunctionTree* SiblingOf(const FunctionTree* node, int step) {
  FunctionTree* parent = node->GetParent();
  const int index = parent == nullptr ? -1 : parent->GetIndex(node);
  return index < 0 ? nullptr : parent->GetChildAt(index + step);
}

FunctionTree* FirstLeafOf(FunctionTree* node) {
  while (!node->IsLeaf())
    node = node->GetChildAt(0);
  return node;
}

FunctionTree* LastLeafOf(FunctionTree* node) {
  while (!node->IsLeaf())
    node = node->GetChildAt(node->GetChildCount() - 1);
  return node;
}

/// The sibling of the node, or else of the nearest ancestor that has one.
FunctionTree* SiblingOnTheWayUp(const FunctionTree* node, int step) {
  for (; node != nullptr; node = node->GetParent()) {
    if (FunctionTree* sibling = SiblingOf(node, step)) return sibling;
  }
  return nullptr;
}

/// Whether `node` is `ancestor` or below it.
bool IsBelow(const FunctionTree* node, const FunctionTree* ancestor) {
  while (node != nullptr && node != ancestor)
    node = node->GetParent();
  return node != nullptr;
}

struct FunctionSign {
  TransformFunction function;
  const char* sign;
};
// Those that a dump shows by name; the others by their code.
constexpr FunctionSign kSigns[] = {
    {kPlusFunction, "+"},  {kMinusFunction, "-"}, {kMultiplyFunction, "*"},
    {kAbsFunction, "abs"}, {kLnFunction, "ln"},   {kSqrtFunction, "sqrt"},
};

void DisplayNode(const FunctionTree& node, int level, std::ostream& os) {
  const ApplyNodeStats& stats = node.GetNodeStats();
  os << "Node ID = " << stats.GetNodeID() << "\nTransformation function: ";
  const auto* row = std::find_if(std::begin(kSigns), std::end(kSigns), [&](const FunctionSign& candidate) {
    return candidate.function == stats.GetTransFunction();
  });
  if (row != std::end(kSigns)) {
    os << row->sign;
  } else {
    os << "code =" << static_cast<int>(stats.GetTransFunction());
  }
  os << "  Parameter Name: " << stats.GetParameterName() << "  Level = " << level
     << "\nNumber of children = " << node.GetChildCount() << '\n';
}

}  // namespace

FunctionTreeImp::FunctionTreeImp(bool allows_children) : allows_children_(allows_children) {}

FunctionTreeImp::FunctionTreeImp(const ApplyNodeStats& stats, bool allows_children)
    : allows_children_(allows_children), stats_(stats) {}

FunctionTreeImp::~FunctionTreeImp() {
  FunctionTreeImp::RemoveFromParent();
  // Leaf by leaf, from the right: needs no stack by the depth, and no memory.
  FunctionTree* node = this;
  for (;;) {
    const int last = node->GetChildCount() - 1;
    if (last >= 0) {
      FunctionTree* child = node->GetChildAt(last);
      child->SetParent(node);
      node = child;
    } else if (node != this) {
      FunctionTree* parent = node->GetParent();
      parent->Remove(parent->GetChildCount() - 1);
      delete node;
      node = parent;
    } else {
      return;
    }
  }
}

void FunctionTreeImp::Display(std::ostream& os) const {
  os << "Start FunctionTree Display:\n";
  std::vector<std::pair<const FunctionTree*, int>> pending = {{this, GetLevel()}};
  while (!pending.empty()) {
    const auto [node, level] = pending.back();
    pending.pop_back();
    DisplayNode(*node, level, os);
    for (int i = node->GetChildCount(); i-- > 0;)
      pending.emplace_back(node->GetChildAt(i), level + 1);
  }
  os << "End FunctionTree Display. \n\n";
}

bool FunctionTreeImp::operator==(const FunctionTree& other) const {
  std::vector<std::pair<const FunctionTree*, const FunctionTree*>> pending = {{this, &other}};
  while (!pending.empty()) {
    const auto [mine, theirs] = pending.back();
    pending.pop_back();
    if (mine->GetChildCount() != theirs->GetChildCount() ||
        !(mine->GetNodeStats() == theirs->GetNodeStats())) {
      return false;
    }
    for (int i = mine->GetChildCount(); i-- > 0;)
      pending.emplace_back(mine->GetChildAt(i), theirs->GetChildAt(i));
  }
  return true;
}

void FunctionTreeImp::Add(FunctionTree* child) {
  Insert(child, GetChildCount());
}

void FunctionTreeImp::Insert(FunctionTree* child, int index) {
  if (!allows_children_ || child == nullptr || child == this) return;
  // A leaf is nobody's ancestor. Not to ask keeps it cheap to build a deep tree from its root.
  if (!child->IsLeaf() && IsNodeAncestor(child)) return;
  // The place is made before anything changes, since to make it may fail.
  children_.push_back(nullptr);
  child->RemoveFromParent();
  child->SetParent(this);
  const auto place = children_.begin() + std::clamp(index, 0, GetChildCount() - 1);
  std::move_backward(place, children_.end() - 1, children_.end());
  *place = child;
}

void FunctionTreeImp::Remove(FunctionTree* child) {
  Remove(GetIndex(child));
}

void FunctionTreeImp::Remove(int index) {
  if (index < 0 || index >= GetChildCount()) return;
  const auto place = children_.begin() + index;
  (*place)->SetParent(nullptr);
  children_.erase(place);
}

void FunctionTreeImp::RemoveAllChildren() {
  for (FunctionTree* child : children_)
    child->SetParent(nullptr);
  children_.clear();
}

void FunctionTreeImp::RemoveFromParent() {
  if (parent_ != nullptr) parent_->Remove(this);
}

FunctionTree* FunctionTreeImp::GetChildAt(int index) {
  const auto position = static_cast<std::size_t>(index);  // beyond the end for a negative one
  return position < children_.size() ? children_[position] : nullptr;
}

const FunctionTree* FunctionTreeImp::GetChildAt(int index) const {
  const auto position = static_cast<std::size_t>(index);  // beyond the end for a negative one
  return position < children_.size() ? children_[position] : nullptr;
}

int FunctionTreeImp::GetIndex(const FunctionTree* child) const {
  if (child == nullptr) return -1;
  // From the right, since children are mostly taken off and asked for there.
  const auto place = std::find(children_.rbegin(), children_.rend(), child);
  return static_cast<int>(children_.rend() - place) - 1;
}

FunctionTree* FunctionTreeImp::GetRoot() {
  FunctionTree* node = this;
  while (FunctionTree* parent = node->GetParent())
    node = parent;
  return node;
}

FunctionTree* FunctionTreeImp::Clone() const {
  auto copy = std::make_unique<FunctionTreeImp>(stats_, allows_children_);
  std::vector<std::pair<const FunctionTreeImp*, FunctionTreeImp*>> pending = {{this, copy.get()}};
  while (!pending.empty()) {
    const auto [from, to] = pending.back();
    pending.pop_back();
    to->children_.reserve(from->children_.size());
    for (const FunctionTree* child : from->children_) {
      // A node of another class knows how it is copied.
      const bool is_ours = typeid(*child) == typeid(FunctionTreeImp);
      FunctionTree* twin =
          is_ours ? new FunctionTreeImp(child->GetNodeStats(), child->GetAllowsChildren()) : child->Clone();
      // Not through Add: a node may have children that it takes no more of.
      to->children_.push_back(twin);
      twin->SetParent(to);
      if (is_ours) {
        pending.emplace_back(static_cast<const FunctionTreeImp*>(child), static_cast<FunctionTreeImp*>(twin));
      }
    }
  }
  return copy.release();
}

FunctionTree* FunctionTreeImp::GetFirstChild() const {
  return children_.empty() ? nullptr : children_.front();
}

FunctionTree* FunctionTreeImp::GetLastChild() const {
  return children_.empty() ? nullptr : children_.back();
}

FunctionTree* FunctionTreeImp::GetChildBefore(const FunctionTree* child) const {
  return IsNodeChild(child) ? SiblingOf(child, -1) : nullptr;
}

FunctionTree* FunctionTreeImp::GetChildAfter(const FunctionTree* child) const {
  return IsNodeChild(child) ? SiblingOf(child, 1) : nullptr;
}

FunctionTree* FunctionTreeImp::GetNextSibling() const {
  return SiblingOf(this, 1);
}

FunctionTree* FunctionTreeImp::GetPreviousSibling() const {
  return SiblingOf(this, -1);
}

int FunctionTreeImp::GetSiblingCount() const {
  return parent_ == nullptr ? 1 : parent_->GetChildCount();
}

bool FunctionTreeImp::IsNodeSibling(const FunctionTree* node) const {
  return node != nullptr && (node == this || (parent_ != nullptr && node->GetParent() == parent_));
}

FunctionTree* FunctionTreeImp::GetFirstLeaf() {
  return FirstLeafOf(this);
}

FunctionTree* FunctionTreeImp::GetLastLeaf() {
  return LastLeafOf(this);
}

FunctionTree* FunctionTreeImp::GetNextLeaf() const {
  FunctionTree* next = SiblingOnTheWayUp(this, 1);
  return next == nullptr ? nullptr : FirstLeafOf(next);
}

FunctionTree* FunctionTreeImp::GetPreviousLeaf() const {
  FunctionTree* previous = SiblingOnTheWayUp(this, -1);
  return previous == nullptr ? nullptr : LastLeafOf(previous);
}

FunctionTree* FunctionTreeImp::GetNextNode() const {
  return children_.empty() ? SiblingOnTheWayUp(this, 1) : children_.front();
}

FunctionTree* FunctionTreeImp::GetPreviousNode() const {
  FunctionTree* previous = GetPreviousSibling();
  return previous == nullptr ? parent_ : LastLeafOf(previous);
}

int FunctionTreeImp::GetLevel() const {
  int level = 0;
  for (const FunctionTree* node = parent_; node != nullptr; node = node->GetParent())
    ++level;
  return level;
}

bool FunctionTreeImp::IsNodeAncestor(const FunctionTree* node) const {
  return node != nullptr && IsBelow(this, node);
}

bool FunctionTreeImp::IsNodeDescendant(const FunctionTree* node) const {
  return IsBelow(node, this);
}

bool FunctionTreeImp::IsNodeChild(const FunctionTree* node) const {
  return GetIndex(node) >= 0;
}

}  // namespace MCKestrel_800
