// What a loaded tree takes in memory for each node.

#include <gtest/gtest.h>

#include <cstddef>
#include <memory>
#include <string>

#include "tests/plugins/TreeText.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

constexpr int kNodes = 10001;

/// So many nodes as binary splits, as deep on all sides. `score` is what stands in each node beside its
/// predicate, as attributes and elements; `split` makes the predicates of two children.
class Balanced {
 public:
  using Split = std::pair<std::string, std::string> (*)(int node);

  Balanced(std::string attributes, std::string elements, Split split)
      : attributes_(std::move(attributes)), elements_(std::move(elements)), split_(split) {}

  std::string Grow(int nodes, const std::string& predicate = "<True/>") {
    const int number = number_++;
    const std::string inside = predicate + elements_;
    if (nodes < 3) return Node(attributes_, inside);
    const int first = (nodes - 1) / 2 | 1;
    const auto [first_test, second_test] = split_(number);
    return Node(attributes_, inside + Grow(first, first_test) + Grow(nodes - 1 - first, second_test));
  }

 private:
  std::string attributes_;
  std::string elements_;
  Split split_;
  int number_ = 0;
};

std::pair<std::string, std::string> NumberSplit(int node) {
  const std::string value = std::to_string(node);
  return {AtMost("x", value), Above("x", value)};
}

std::pair<std::string, std::string> CategorySplit(int node) {
  const std::string value(1, static_cast<char>('a' + node % 3));
  return {Is("g", value), Simple("g", "notEqual", value)};
}

std::pair<std::string, std::string> SurrogateSplit(int node) {
  std::string first, second;
  for (int i = 0; i < 6; ++i) {
    const std::string value = std::to_string(node + i);
    const std::string field = i % 2 == 0 ? "x" : "z";
    first += AtMost(field, value);
    second += Above(field, value);
  }
  return {Compound("surrogate", first), Compound("surrogate", second)};
}

struct MemoryRow {
  const char* why;
  const char* function;
  const char* attributes;  ///< of the model
  std::string node;        ///< the attributes of each
  std::string elements;    ///< in each
  Balanced::Split split;
  std::size_t most;  ///< bytes for each node
};

const MemoryRow kRows[] = {
    {"a regression", "regression", "", "score='1.5'", "", NumberSplit, 48},
    {"a regression with identifiers and weights", "regression", "missingValueStrategy='weightedConfidence'",
     "id='n' score='1.5' recordCount='3'", "", NumberSplit, 48},
    {"a classification", "classification", "", "score='red'", "", NumberSplit, 48},
    {"a classification with distributions", "classification", "", "", Counts("1", "2", "3"), NumberSplit, 48},
    {"a classification by categories with all there is", "classification",
     "missingValueStrategy='weightedConfidence'", "id='n' recordCount='3' score='red'", Counts("1", "2", "3"),
     CategorySplit, 48},
    {"five surrogates for each test", "regression", "", "score='1.5'", "", SurrogateSplit, 500},
};

TEST(TreeMemory, GrowsWithTheNodes) {
  for (const MemoryRow& row : kRows) {
    const bool is_regression = row.function == std::string("regression");
    const auto model = BuildTree(
        TreeDocument(TreeModelOf(row.function, row.attributes, TreeSchema(is_regression ? "y" : "m"),
                                 Balanced(row.node, row.elements, row.split).Grow(kNodes))));
    const Tree& tree = model->GetTree();
    ASSERT_EQ(tree.table.GetCount(), kNodes) << row.why;
    const std::size_t bytes = tree.GetMemorySize();
    EXPECT_LE(bytes, row.most * kNodes) << row.why;
    // It counts what is there: a condition at least.
    EXPECT_GE(bytes, 16u * kNodes) << row.why;
  }
}

// A condition on a long list is a few runs and not the list.
TEST(TreeMemory, DoesNotGrowWithTheListsOfFields) {
  std::string values;
  for (int i = 0; i < 5000; ++i)
    values += "<Value value='v" + std::to_string(i) + "'/>";
  const std::string field =
      "<DataField name='c' optype='categorical' dataType='string'>" + values + "</DataField>";
  std::string nodes;
  for (int i = 0; i < 1000; ++i)
    nodes += Node("score='1'", Simple("c", "notEqual", "v" + std::to_string(i)));
  const auto model =
      BuildTree("<PMML>" + kestrel_test::DictionaryOf(1, field) +
                TreeModelOf("regression", "", "<MiningSchema><MiningField name='c'/></MiningSchema>",
                            Node("score='0'", "<True/>" + nodes)) +
                "</PMML>");
  EXPECT_LE(model->GetTree().GetMemorySize(), 1001u * 48u);
}

}  // namespace
}  // namespace kestrel_tests
