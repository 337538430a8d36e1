#include "bench/support/TreeDocuments.h"

#include <cstdio>
#include <random>
#include <utility>

namespace kestrel_bench {

namespace {

std::string Number(double number) {
  char text[32];
  std::snprintf(text, sizeof text, "%.17g", number);
  return text;
}

/// Writes nodes depth first, as documents have them.
class TreeWriter {
 public:
  TreeWriter(const PlainTree& tree, const TreeShape& shape) : tree_(tree), shape_(shape) {}

  std::string Write() {
    Node(0, "<True/>", 4);
    return std::move(out_);
  }

 private:
  void Node(std::size_t node, const std::string& predicate, std::size_t indent) {
    const std::string margin(indent, ' ');
    const bool is_leaf = tree_.IsLeaf(node);
    const auto child = static_cast<std::size_t>(tree_.nodes[node].child);
    out_ += margin + "<Node id=\"" + std::to_string(node) + "\" recordCount=\"100\"";
    const double score = is_leaf ? tree_.nodes[node].threshold : 0.5;
    if (shape_.categories > 0) {
      out_ += " score=\"class" + std::to_string(CategoryOf(score, shape_.categories)) + "\"";
    } else if (is_leaf) {
      out_ += " score=\"" + Number(score) + "\"";
    }
    if (shape_.default_child && !is_leaf) out_ += " defaultChild=\"" + std::to_string(child) + "\"";
    out_ += ">\n" + margin + "  " + predicate + "\n";
    if (shape_.categories > 0) Distribution(CategoryOf(score, shape_.categories), margin);
    if (!is_leaf) {
      const PlainTree::Node& split = tree_.nodes[node];
      Node(child, Predicate(split, "lessOrEqual"), indent + 2);
      Node(child + 1, Predicate(split, "greaterThan"), indent + 2);
    }
    out_ += margin + "</Node>\n";
  }

  void Distribution(int winner, const std::string& margin) {
    for (int category = 0; category < shape_.categories; ++category) {
      out_ += margin + "  <ScoreDistribution value=\"class" + std::to_string(category) + "\" recordCount=\"" +
              (category == winner ? "70" : "15") + "\"/>\n";
    }
  }

  static std::string Predicate(const PlainTree::Node& split, const char* operation) {
    return "<SimplePredicate field=\"x" + std::to_string(split.feature) + "\" operator=\"" + operation +
           "\" value=\"" + Number(split.threshold) + "\"/>";
  }

  const PlainTree& tree_;
  const TreeShape& shape_;
  std::string out_;
};

std::string Field(const std::string& name) {
  return "    <DataField name=\"" + name + "\" optype=\"continuous\" dataType=\"double\"/>\n";
}

}  // namespace

int CategoryOf(double score, int categories) {
  return static_cast<int>(score * 1e6) % categories;
}

double PlainTree::Score(const double* x) const {
  const Node* const all = nodes.data();
  std::int32_t node = 0;
  for (int level = 0; level < depth; ++level)
    node = all[node].child +
           static_cast<std::int32_t>(x[all[node].feature] > all[node].threshold && all[node].child != node);
  return all[node].threshold;
}

PlainTree RandomTree(int inputs, int depth, unsigned seed) {
  struct Cell {
    std::vector<double> low, high;
  };
  std::mt19937 random(seed);
  const auto uniform = [&random] { return static_cast<double>(random()) / 4294967296.0; };
  PlainTree tree;
  tree.depth = depth;
  tree.nodes.push_back({});
  std::vector<Cell> cells = {{std::vector<double>(inputs, 0.0), std::vector<double>(inputs, 1.0)}};
  std::size_t level_begin = 0;
  for (int level = 0; level <= depth; ++level) {
    const std::size_t level_end = tree.nodes.size();
    std::vector<Cell> next_cells;
    for (std::size_t node = level_begin; node < level_end; ++node) {
      Cell& cell = cells[node - level_begin];
      if (level == depth || (level > 3 && uniform() < 0.04)) {
        tree.nodes[node] = {uniform(), static_cast<std::int32_t>(node), 0};
        continue;
      }
      const auto feature = static_cast<std::int32_t>(random() % static_cast<unsigned>(inputs));
      const double width = cell.high[feature] - cell.low[feature];
      const double threshold = cell.low[feature] + width * (0.35 + 0.3 * uniform());
      tree.nodes[node] = {threshold, static_cast<std::int32_t>(tree.nodes.size()), feature};
      tree.nodes.resize(tree.nodes.size() + 2);
      next_cells.push_back(cell);
      next_cells.back().high[feature] = threshold;
      next_cells.push_back(cell);
      next_cells.back().low[feature] = threshold;
    }
    level_begin = level_end;
    cells = std::move(next_cells);
  }
  return tree;
}

std::string TreeDocument(const PlainTree& tree, int inputs, const TreeShape& shape) {
  std::string text =
      "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<PMML xmlns=\"http://www.dmg.org/PMML-4_4\" "
      "version=\"4.4\">\n  <Header description=\"benchmark\"/>\n  <DataDictionary numberOfFields=\"" +
      std::to_string(inputs + 1) + "\">\n";
  std::string schema;
  for (int i = 0; i < inputs; ++i) {
    text += Field("x" + std::to_string(i));
    schema += "      <MiningField name=\"x" + std::to_string(i) + "\"/>\n";
  }
  if (shape.categories == 0) {
    text += Field("y");
  } else {
    text += "    <DataField name=\"y\" optype=\"categorical\" dataType=\"string\">\n";
    for (int category = 0; category < shape.categories; ++category)
      text += "      <Value value=\"class" + std::to_string(category) + "\"/>\n";
    text += "    </DataField>\n";
  }
  text += std::string("  </DataDictionary>\n  <TreeModel functionName=\"") +
          (shape.categories == 0 ? "regression" : "classification") +
          "\" splitCharacteristic=\"binarySplit\"" +
          (shape.default_child ? " missingValueStrategy=\"defaultChild\"" : "") + ">\n    <MiningSchema>\n" +
          schema + "      <MiningField name=\"y\" usageType=\"target\"/>\n    </MiningSchema>\n";
  return text + TreeWriter(tree, shape).Write() + "  </TreeModel>\n</PMML>\n";
}

}  // namespace kestrel_bench
