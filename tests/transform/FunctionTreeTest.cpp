#include <gtest/gtest.h>

#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/transform/FunctionTreeImp.h"
#include "tests/support/SmallStack.h"

namespace MCKestrel_800 {
namespace {

using Tree = std::unique_ptr<FunctionTreeImp>;

FunctionTreeImp* Node(const std::string& id) {
  ApplyNodeStats stats;
  stats.SetNodeID(id);
  stats.SetParameterName(id);
  return new FunctionTreeImp(stats);
}

std::string IdOf(const FunctionTree* node) {
  return node == nullptr ? "-" : node->GetNodeStats().GetNodeID();
}

/// The names of nodes in pre-order, children in brackets: a(b,c(d)).
std::string TextOf(const FunctionTree& node) {
  std::string text = IdOf(&node);
  for (const FunctionTree* child : node.Children()) {
    EXPECT_EQ(child->GetParent(), &node) << IdOf(child);
    text += (child == node.Children().front() ? "(" : ",") + TextOf(*child);
  }
  return node.IsLeaf() ? text : text + ")";
}

/// a(b(d,e),c(f)) by its names.
struct Family {
  Family() : a(Node("a")) {
    a->Add(b = Node("b"));
    a->Add(c = Node("c"));
    b->Add(d = Node("d"));
    b->Add(e = Node("e"));
    c->Add(f = Node("f"));
  }

  Tree a;
  FunctionTreeImp *b, *c, *d, *e, *f;
};

TEST(FunctionTree, KnowsItsNeighbours) {
  const Family t;
  struct Row {
    FunctionTreeImp* node;
    const char *first_child, *last_child, *next, *previous, *next_leaf, *previous_leaf, *next_node,
        *previous_node, *first_leaf, *last_leaf;
    int level, children, siblings;
  };
  const Row kRows[] = {
      {t.a.get(), "b", "c", "-", "-", "-", "-", "b", "-", "d", "f", 0, 2, 1},
      {t.b, "d", "e", "c", "-", "f", "-", "d", "a", "d", "e", 1, 2, 2},
      {t.c, "f", "f", "-", "b", "-", "e", "f", "e", "f", "f", 1, 1, 2},
      {t.d, "-", "-", "e", "-", "e", "-", "e", "b", "d", "d", 2, 0, 2},
      {t.e, "-", "-", "-", "d", "f", "d", "c", "d", "e", "e", 2, 0, 2},
      {t.f, "-", "-", "-", "-", "-", "e", "-", "c", "f", "f", 2, 0, 1},
  };
  for (const Row& row : kRows) {
    const std::string id = IdOf(row.node);
    EXPECT_EQ(IdOf(row.node->GetFirstChild()), row.first_child) << id;
    EXPECT_EQ(IdOf(row.node->GetLastChild()), row.last_child) << id;
    EXPECT_EQ(IdOf(row.node->GetNextSibling()), row.next) << id;
    EXPECT_EQ(IdOf(row.node->GetPreviousSibling()), row.previous) << id;
    EXPECT_EQ(IdOf(row.node->GetNextLeaf()), row.next_leaf) << id;
    EXPECT_EQ(IdOf(row.node->GetPreviousLeaf()), row.previous_leaf) << id;
    EXPECT_EQ(IdOf(row.node->GetNextNode()), row.next_node) << id;
    EXPECT_EQ(IdOf(row.node->GetPreviousNode()), row.previous_node) << id;
    EXPECT_EQ(IdOf(row.node->GetFirstLeaf()), row.first_leaf) << id;
    EXPECT_EQ(IdOf(row.node->GetLastLeaf()), row.last_leaf) << id;
    EXPECT_EQ(row.node->GetLevel(), row.level) << id;
    EXPECT_EQ(row.node->GetChildCount(), row.children) << id;
    EXPECT_EQ(row.node->IsLeaf(), row.children == 0) << id;
    EXPECT_EQ(row.node->GetSiblingCount(), row.siblings) << id;
    EXPECT_EQ(row.node->IsRoot(), row.level == 0) << id;
    EXPECT_EQ(row.node->GetRoot(), t.a.get()) << id;
  }
}

TEST(FunctionTree, FindsChildren) {
  const Family t;
  const FunctionTreeImp& a = *t.a;
  EXPECT_EQ(a.GetChildAt(0), t.b);
  EXPECT_EQ(t.a->GetChildAt(1), t.c);
  for (const int index : {-1, 2, 1000}) {
    EXPECT_EQ(a.GetChildAt(index), nullptr);
    EXPECT_EQ(t.a->GetChildAt(index), nullptr);
  }
  EXPECT_EQ(a.GetIndex(t.c), 1);
  EXPECT_EQ(a.GetIndex(t.d), -1);
  EXPECT_EQ(a.GetIndex(nullptr), -1);
  EXPECT_EQ(a.GetChildAfter(t.b), t.c);
  EXPECT_EQ(a.GetChildBefore(t.c), t.b);
  EXPECT_EQ(a.GetChildAfter(t.c), nullptr);
  EXPECT_EQ(a.GetChildBefore(t.b), nullptr);
  EXPECT_EQ(a.GetChildAfter(t.d), nullptr);
  EXPECT_EQ(a.GetChildBefore(t.e), nullptr);
  EXPECT_EQ(a.GetChildAfter(nullptr), nullptr);
}

TEST(FunctionTree, KnowsItsRelations) {
  const Family t;
  EXPECT_TRUE(t.d->IsNodeAncestor(t.a.get()));
  EXPECT_TRUE(t.d->IsNodeAncestor(t.d));
  EXPECT_FALSE(t.d->IsNodeAncestor(t.c));
  EXPECT_FALSE(t.a->IsNodeAncestor(t.d));
  EXPECT_FALSE(t.a->IsNodeAncestor(nullptr));
  EXPECT_TRUE(t.a->IsNodeDescendant(t.d));
  EXPECT_TRUE(t.a->IsNodeDescendant(t.a.get()));
  EXPECT_FALSE(t.c->IsNodeDescendant(t.d));
  EXPECT_FALSE(t.c->IsNodeDescendant(nullptr));
  EXPECT_TRUE(t.a->IsNodeChild(t.b));
  EXPECT_FALSE(t.a->IsNodeChild(t.d));
  EXPECT_FALSE(t.a->IsNodeChild(nullptr));
  EXPECT_TRUE(t.d->IsNodeSibling(t.e));
  EXPECT_TRUE(t.d->IsNodeSibling(t.d));
  EXPECT_TRUE(t.a->IsNodeSibling(t.a.get()));
  EXPECT_FALSE(t.d->IsNodeSibling(t.f));
  EXPECT_FALSE(t.a->IsNodeSibling(Family().a.get()));
  EXPECT_FALSE(t.d->IsNodeSibling(nullptr));
}

TEST(FunctionTree, AddMovesAChildToTheEnd) {
  const Family t;
  t.a->Add(t.b);
  EXPECT_EQ(TextOf(*t.a), "a(c(f),b(d,e))");
  t.a->Add(t.b);
  EXPECT_EQ(TextOf(*t.a), "a(c(f),b(d,e))");
}

TEST(FunctionTree, AddTakesAChildOverFromItsFormerParent) {
  const Family t;
  t.c->Add(t.d);
  EXPECT_EQ(TextOf(*t.a), "a(b(e),c(f,d))");
  t.c->Insert(t.b, 0);
  EXPECT_EQ(TextOf(*t.a), "a(c(b(e),f,d))");
}

TEST(FunctionTree, InsertTakesAnyPosition) {
  struct Row {
    int index;
    const char* want;
  };
  const Row kRows[] = {{-5, "r(n,x,y)"}, {0, "r(n,x,y)"}, {1, "r(x,n,y)"}, {2, "r(x,y,n)"}, {99, "r(x,y,n)"}};
  for (const Row& row : kRows) {
    const Tree root(Node("r"));
    root->Add(Node("x"));
    root->Add(Node("y"));
    root->Insert(Node("n"), row.index);
    EXPECT_EQ(TextOf(*root), row.want) << row.index;
  }
}

TEST(FunctionTree, InsertMovesWithinItsChildren) {
  const Tree root(Node("r"));
  FunctionTreeImp* x = Node("x");
  root->Add(x);
  root->Add(Node("y"));
  root->Add(Node("z"));
  root->Insert(x, 1);
  EXPECT_EQ(TextOf(*root), "r(y,x,z)");
  root->Insert(x, 0);
  EXPECT_EQ(TextOf(*root), "r(x,y,z)");
  root->Insert(x, 2);
  EXPECT_EQ(TextOf(*root), "r(y,z,x)");
}

TEST(FunctionTree, InsertRefusesWhatWouldMakeACycle) {
  const Family t;
  t.d->Insert(t.a.get(), 0);
  t.d->Insert(t.b, 0);
  t.d->Insert(t.d, 0);
  t.a->Add(t.a.get());
  t.a->Add(nullptr);
  t.a->Insert(nullptr, 0);
  EXPECT_EQ(TextOf(*t.a), "a(b(d,e),c(f))");
  EXPECT_TRUE(t.a->IsRoot());
}

TEST(FunctionTree, InsertRefusesWhenItAllowsNoChildren) {
  FunctionTreeImp leaf(false);
  EXPECT_FALSE(leaf.GetAllowsChildren());
  const Tree child(Node("x"));
  leaf.Add(child.get());
  EXPECT_TRUE(leaf.IsLeaf());
  EXPECT_TRUE(child->IsRoot());
  const Family t;
  t.a->SetAllowsChildren(false);
  t.a->Insert(child.get(), 0);
  EXPECT_EQ(TextOf(*t.a), "a(b(d,e),c(f))");
  t.a->SetAllowsChildren(true);
  t.a->Insert(Node("y"), 0);
  EXPECT_EQ(TextOf(*t.a), "a(y,b(d,e),c(f))");
}

TEST(FunctionTree, RemovedNodesBelongToTheCaller) {
  const Family t;
  t.a->Remove(t.b);
  const Tree b(t.b);
  EXPECT_TRUE(b->IsRoot());
  EXPECT_EQ(TextOf(*b), "b(d,e)");
  EXPECT_EQ(TextOf(*t.a), "a(c(f))");
  b->Remove(1);
  const Tree e(t.e);
  EXPECT_TRUE(e->IsRoot());
  EXPECT_EQ(TextOf(*b), "b(d)");
  t.d->RemoveFromParent();
  const Tree d(t.d);
  EXPECT_TRUE(d->IsRoot());
  EXPECT_TRUE(b->IsLeaf());
  t.a->RemoveAllChildren();
  const Tree c(t.c);
  EXPECT_TRUE(c->IsRoot());
  EXPECT_TRUE(t.a->IsLeaf());
}

TEST(FunctionTree, RemoveLeavesWhatIsNotThere) {
  const Family t;
  t.a->Remove(t.d);
  t.a->Remove(nullptr);
  t.a->Remove(-1);
  t.a->Remove(2);
  t.a->RemoveFromParent();
  EXPECT_EQ(TextOf(*t.a), "a(b(d,e),c(f))");
}

TEST(FunctionTree, DeletedNodesLeaveTheirParent) {
  const Family t;
  delete t.b;
  EXPECT_EQ(TextOf(*t.a), "a(c(f))");
}

TEST(FunctionTree, CloneIsDeepAndHasNoParent) {
  const Family t;
  t.b->SetAllowsChildren(false);
  const std::unique_ptr<FunctionTree> whole(t.a->Clone());
  EXPECT_TRUE(*whole == *t.a);
  EXPECT_EQ(TextOf(*whole), "a(b(d,e),c(f))");
  EXPECT_FALSE(whole->GetChildAt(0)->GetAllowsChildren());
  const std::unique_ptr<FunctionTree> part(t.b->Clone());
  EXPECT_EQ(part->GetParent(), nullptr);
  EXPECT_EQ(TextOf(*part), "b(d,e)");
  ApplyNodeStats other;
  other.SetParameterName("other");
  part->GetChildAt(0)->SetNodeStats(other);
  EXPECT_FALSE(*part == *t.b);
  EXPECT_EQ(IdOf(t.d), "d");
}

/// A host's own kind of node.
class CountingNode : public FunctionTreeImp {
 public:
  explicit CountingNode(int& clones) : clones_(clones) {}
  FunctionTree* Clone() const override {
    ++clones_;
    return new CountingNode(clones_);
  }

 private:
  int& clones_;
};

TEST(FunctionTree, CloneAsksNodesOfOtherClasses) {
  int clones = 0;
  const Tree root(Node("r"));
  root->Add(new CountingNode(clones));
  const std::unique_ptr<FunctionTree> copy(root->Clone());
  EXPECT_EQ(clones, 1);
  EXPECT_NE(dynamic_cast<CountingNode*>(copy->GetChildAt(0)), nullptr);
  EXPECT_EQ(copy->GetChildAt(0)->GetParent(), copy.get());
}

TEST(FunctionTree, EqualTreesHaveEqualNodesInEqualOrder) {
  const Family t;
  EXPECT_TRUE(*t.a == *Family().a);
  const Family moved;
  moved.a->Add(moved.b);
  EXPECT_FALSE(*t.a == *moved.a);
  const Family shorter;
  delete shorter.f;
  EXPECT_FALSE(*t.a == *shorter.a);
  EXPECT_FALSE(*shorter.a == *t.a);
}

TEST(FunctionTree, DisplayShowsEveryNode) {
  ApplyNodeStats stats;
  stats.SetNodeID("1");
  stats.SetParameterName("total");
  stats.SetTransFunction(kPlusFunction);
  FunctionTreeImp root(stats);
  stats.SetNodeID("2");
  stats.SetParameterName("age");
  stats.SetTransFunction(kNoFunction);
  root.Add(new FunctionTreeImp(stats));
  std::ostringstream out;
  root.Display(out);
  EXPECT_EQ(out.str(),
            "Start FunctionTree Display:\n"
            "Node ID = 1\nTransformation function: +  Parameter Name: total  Level = 0\n"
            "Number of children = 1\n"
            "Node ID = 2\nTransformation function: code =65  Parameter Name: age  Level = 1\n"
            "Number of children = 0\n"
            "End FunctionTree Display. \n\n");
}

TEST(FunctionTree, DisplayNamesSixFunctions) {
  struct Row {
    TransformFunction function;
    const char* text;
  };
  const Row kRows[] = {{kPlusFunction, ": +  "},         {kMinusFunction, ": -  "},
                       {kMultiplyFunction, ": *  "},     {kAbsFunction, ": abs  "},
                       {kLnFunction, ": ln  "},          {kSqrtFunction, ": sqrt  "},
                       {kDivideFunction, ": code =3  "}, {kLowercaseFunction, ": code =68  "}};
  for (const Row& row : kRows) {
    ApplyNodeStats stats;
    stats.SetTransFunction(row.function);
    std::ostringstream out;
    FunctionTreeImp(stats).Display(out);
    EXPECT_NE(out.str().find(row.text), std::string::npos) << out.str();
  }
}

constexpr int kDepth = 100000;

TEST(FunctionTree, DeepTreesNeedNoDeepStack) {
  kestrel_test::RunOnStack(256 * 1024, [] {
    Tree root(Node("0"));
    FunctionTree* deepest = root.get();
    for (int i = 1; i < kDepth; ++i) {
      FunctionTree* next = Node("1");
      deepest->Add(next);
      deepest = next;
    }
    EXPECT_EQ(static_cast<FunctionTreeImp*>(deepest)->GetLevel(), kDepth - 1);
    EXPECT_EQ(deepest->GetRoot(), root.get());
    EXPECT_EQ(root->GetFirstLeaf(), deepest);
    EXPECT_EQ(root->GetLastLeaf(), deepest);
    const std::unique_ptr<FunctionTree> copy(root->Clone());
    EXPECT_TRUE(*copy == *root);
    std::ostringstream out;
    root->Display(out);
    EXPECT_NE(out.str().find("Level = 99999\nNumber of children = 0\n"), std::string::npos);
    deepest->Insert(root.get(), 0);
    EXPECT_TRUE(root->IsRoot());
    root.reset();
  });
}

TEST(FunctionTree, WideTreesCostWhatTheirSizeSays) {
  Tree root(Node("r"));
  for (int i = 0; i < kDepth; ++i)
    root->Add(Node("x"));
  const std::unique_ptr<FunctionTree> copy(root->Clone());
  EXPECT_TRUE(*copy == *root);
  root.reset();
  EXPECT_EQ(copy->GetChildCount(), kDepth);
}

}  // namespace
}  // namespace MCKestrel_800
