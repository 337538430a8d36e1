// The flat table of a tree against predicate objects: random trees are read as models and walked a second
// time, from the same text, by asking each node's predicate object in turn.

#include "plugins/tree/TreeTable.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <memory>
#include <random>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "plugins/support/PredicateReader.h"
#include "tests/plugins/TreePredicates.h"
#include "tests/plugins/TreeText.h"

namespace kestrel_tests {
namespace {

using namespace MCKestrel_800;

constexpr double kSysmis = NumericValue::gSysmisValue;
constexpr double kInfinity = std::numeric_limits<double>::infinity();

/// Number fields x0 ... with their thresholds, nominal fields c0 ... and ordinal fields o0 ...
constexpr int kNumbers = 3;
constexpr double kThresholds[] = {-2.5, 0.0, 0.1, 1.0, 1e6};
constexpr int kSizes[] = {2, 5, 64, 70};

std::string CategoryField(const std::string& name, const std::string& optype, int size) {
  std::string field = "<DataField name='" + name + "' optype='" + optype + "' dataType='string'>";
  for (int i = 0; i < size; ++i)
    field += "<Value value='v" + std::to_string(i) + "'/>";
  return field + "</DataField>";
}

/// Grows trees of every shape that the table treats in its own way, and of shapes that only look like these.
class RandomTree {
 public:
  explicit RandomTree(unsigned seed) : random_(seed) {}

  std::string Document(const std::string& attributes) {
    const std::string number = "' optype='continuous' dataType='double'/>";
    std::string fields, names;
    for (int i = 0; i < kNumbers; ++i)
      fields += "<DataField name='x" + std::to_string(i) + number;
    for (const int size : kSizes) {
      fields += CategoryField("c" + std::to_string(size), "categorical", size);
      fields += CategoryField("o" + std::to_string(size), "ordinal", size);
    }
    for (int i = 0; i < kNumbers; ++i)
      names += "<MiningField name='x" + std::to_string(i) + "'/>";
    for (const int size : kSizes) {
      names += "<MiningField name='c" + std::to_string(size) + "'/>";
      names += "<MiningField name='o" + std::to_string(size) + "'/>";
    }
    return "<PMML>" + kestrel_test::DictionaryOf(kNumbers + 2 * static_cast<int>(std::size(kSizes)), fields) +
           TreeModelOf("regression", attributes, "<MiningSchema>" + names + "</MiningSchema>",
                       Grow(Below(6) == 0 ? Atom() : "<True/>", 5)) +
           "</PMML>";
  }

  unsigned Below(unsigned end) { return static_cast<unsigned>(random_() % end); }

 private:
  std::string Grow(const std::string& predicate, int depth) {
    const std::string id = "n" + std::to_string(nodes_++);
    // Every third inner node has no score of its own.
    if (depth == 0 || Below(5) == 0) return Node("id='" + id + "' score='1'", predicate);
    const std::vector<std::string> tests = Split();
    const unsigned default_child = Below(static_cast<unsigned>(tests.size()));
    std::string children, default_id;
    for (size_t i = 0; i < tests.size(); ++i) {
      if (i == default_child) default_id = "n" + std::to_string(nodes_);
      children += Grow(tests[i], depth - 1);
    }
    return Node("id='" + id + "' defaultChild='" + default_id + (Below(3) == 0 ? "'" : "' score='2'"),
                predicate + children);
  }

  std::vector<std::string> Split() {
    switch (Below(6)) {
      case 0: {  // a binary split of a number
        const std::string x = NumberField(), value = Threshold();
        const bool is_strict = Below(2) == 0;
        return Shuffled({Simple(x, is_strict ? "lessThan" : "lessOrEqual", value),
                         Simple(x, is_strict ? "greaterOrEqual" : "greaterThan", value)});
      }
      case 1:  // of another number, or with a gap or an overlap
        return Shuffled({AtMost(NumberField(), Threshold()), Above(NumberField(), Threshold())});
      case 2: {  // a set and its complement, or a part of it
        const std::string field = CategoryName(), members = Members(field);
        return Shuffled(
            {Set(field, "isIn", members), Set(field, "isNotIn", Below(3) == 0 ? Members(field) : members)});
      }
      case 3: {
        const std::string field = CategoryName(), value = Member(field);
        return Shuffled({Is(field, value), Simple(field, "notEqual", value)});
      }
      default: {
        std::vector<std::string> tests;
        for (unsigned count = 1 + Below(4); count > 0; --count)
          tests.push_back(Below(4) == 0 ? AnyCompound(2) : Atom());
        if (Below(2) == 0) tests.push_back("<True/>");
        return tests;
      }
    }
  }

  std::vector<std::string> Shuffled(std::vector<std::string> two) {
    if (Below(4) == 0) two[1] = "<True/>";
    if (Below(2) == 0 && two[1] != "<True/>") two[0].swap(two[1]);
    return two;
  }

  std::string AnyCompound(int depth) {
    constexpr const char* kOperators[] = {"or", "and", "xor", "surrogate"};
    std::string parts;
    for (unsigned count = 2 + Below(2); count > 0; --count)
      parts += depth > 1 && Below(3) == 0 ? AnyCompound(depth - 1) : Atom();
    return Compound(kOperators[Below(4)], parts);
  }

  std::string Atom() {
    constexpr const char* kOperators[] = {"equal",       "notEqual",       "lessThan",  "lessOrEqual",
                                          "greaterThan", "greaterOrEqual", "isMissing", "isNotMissing"};
    const std::string operator_text = kOperators[Below(8)];
    const bool is_question = operator_text.compare(0, 2, "is") == 0;
    if (Below(2) == 0) {
      return is_question ? Ask(NumberField(), operator_text)
                         : Simple(NumberField(), operator_text, Threshold());
    }
    const std::string field = CategoryName();
    if (is_question) return Ask(field, operator_text);
    return Set(field, Below(2) == 0 ? "isIn" : "isNotIn", Members(field));
  }

  static std::string Ask(const std::string& field, const std::string& operator_text) {
    return "<SimplePredicate field='" + field + "' operator='" + operator_text + "'/>";
  }
  static std::string Set(const std::string& field, const std::string& boolean_operator,
                         const std::string& members) {
    return "<SimpleSetPredicate field='" + field + "' booleanOperator='" + boolean_operator +
           "'><Array type='string'>" + members + "</Array></SimpleSetPredicate>";
  }

  std::string NumberField() { return "x" + std::to_string(Below(kNumbers)); }
  std::string Threshold() { return NumberText(kThresholds[Below(std::size(kThresholds))]); }
  std::string CategoryName() {
    return (Below(2) == 0 ? "c" : "o") + std::to_string(kSizes[Below(std::size(kSizes))]);
  }
  std::string Member(const std::string& field) {
    return "v" + std::to_string(Below(static_cast<unsigned>(std::stoi(field.substr(1)))));
  }
  std::string Members(const std::string& field) {
    std::string members = Member(field);
    for (int count = std::stoi(field.substr(1)) / 2; count > 0; --count)
      members += " " + Member(field);
    return members;
  }

  std::mt19937_64 random_;
  int nodes_ = 0;
};

/// A tree of predicate objects.
struct PlainNode {
  std::string id;
  std::unique_ptr<ScorePredicate> predicate;
  bool has_score;
  std::string default_child;
  std::vector<PlainNode> children;
};

std::string AttributeOf(const xercesc::DOMElement* element, const char16_t* name) {
  return Narrow(FindAttribute(element, name));
}

PlainNode ReadPlainNode(xercesc::DOMElement* element, const ScoreDictionary& dictionary) {
  PlainNode node;
  node.id = AttributeOf(element, u"id");
  node.has_score = FindAttribute(element, u"score") != nullptr;
  node.default_child = AttributeOf(element, u"defaultChild");
  for (xercesc::DOMElement* child : ChildElements(element)) {
    if (IsPredicate(child)) {
      node.predicate = ReadAnyPredicate(child, dictionary);
    } else {
      node.children.push_back(ReadPlainNode(child, dictionary));
    }
  }
  return node;
}

/// The rules for one node after the other, as the documentation has them.
class PlainTree {
 public:
  PlainTree(const std::string& document, const TreeModel& model) {
    const auto parsed = kestrel_test::ReadTree(document);
    dictionary_ = kestrel_test::ReadDictionary(document);
    int slot = 0;
    for (const ScoreDictVar* variable : model.GetPredictors())
      dictionary_->GetVar(variable->GetName())->SetEncodedValueIndex(slot++);
    root_ = ReadPlainNode(FirstChild(FirstChild(parsed->GetRoot(), u"TreeModel"), u"Node"), *dictionary_);
  }

  /// The id of the node that predicts, or "90027".
  std::string Walk(const std::vector<double>& values, const std::string& strategy, bool returns_last) const {
    if (!IsTrue(root_.predicate->Evaluate(values))) return "90027";
    const PlainNode* node = &root_;
    for (;;) {
      if (node->children.empty()) return node->id;
      const PlainNode* next = nullptr;
      for (const PlainNode& child : node->children) {
        const auto result = child.predicate->Evaluate(values);
        if (result == ScorePredicate::PredUnknown) {
          if (strategy == "none") continue;
          if (strategy == "nullPrediction") return "90027";
          if (strategy == "lastPrediction") return Predict(*node);
          for (const PlainNode& other : node->children) {
            if (other.id == node->default_child) next = &other;
          }
          break;
        }
        if (!IsTrue(result)) continue;
        next = &child;
        break;
      }
      if (next == nullptr) return returns_last ? Predict(*node) : "90027";
      node = next;
    }
  }

 private:
  static bool IsTrue(ScorePredicate::PredicateResult result) {
    return result == ScorePredicate::PredTrue || result == ScorePredicate::PredSurrogateTrue;
  }
  static std::string Predict(const PlainNode& node) { return node.has_score ? node.id : "90027"; }

  std::unique_ptr<ScoreDictionary> dictionary_;
  PlainNode root_;
};

double RandomNumber(RandomTree& random) {
  const unsigned kind = random.Below(12);
  if (kind == 0) return kSysmis;
  if (kind == 1) {
    constexpr double kOdd[] = {kInfinity, -kInfinity, std::numeric_limits<double>::max(),
                               std::numeric_limits<double>::quiet_NaN()};
    return kOdd[random.Below(4)];
  }
  double value = kThresholds[random.Below(std::size(kThresholds))];
  if (kind < 5) return value;
  if (kind < 8) return value + (random.Below(2) == 0 ? 0.5 : -0.5);
  // Up to where the tolerance ends, and beyond.
  const double end = random.Below(2) == 0 ? kInfinity : -kInfinity;
  for (unsigned steps = random.Below(256); steps > 0; --steps)
    value = std::nextafter(value, end);
  return value;
}

std::vector<double> RandomCase(RandomTree& random, const TreeModel& model) {
  std::vector<double> values;
  for (const ScoreDictVar* variable : model.GetPredictors()) {
    if (variable->GetMLevel() == ScoreDictVar::kContinuous) {
      values.push_back(RandomNumber(random));
      continue;
    }
    const auto size = static_cast<unsigned>(std::stoi(variable->GetName().substr(1)));
    const unsigned kind = random.Below(12);
    values.push_back(kind == 0 ? -2.0 : kind == 1 ? -1.0 : random.Below(size));
  }
  return values;
}

TEST(TreeTable, EndsWherePredicateObjectsEnd) {
  int predicted = 0, scored = 0;
  int short_ways[4] = {};
  for (unsigned seed = 0; seed < 200; ++seed) {
    constexpr const char* kStrategies[] = {"none", "lastPrediction", "nullPrediction", "defaultChild"};
    const std::string strategy = kStrategies[seed % 4];
    const bool returns_last = seed / 4 % 2 == 1;
    RandomTree random(seed);
    const std::string document =
        random.Document("missingValueStrategy='" + strategy + "' noTrueChildStrategy='" +
                        (returns_last ? "returnLastPrediction'" : "returnNullPrediction'"));
    const auto model = BuildTree(document);
    const PlainTree plain(document, *model);
    const TreeTable& table = model->GetTree().table;
    for (int node = 0; node < table.GetCount(); ++node)
      ++short_ways[table.GetCondition(node).decides];
    RegResult result, result_with_path;
    result.GetEntities().SetDecidingIdWanted(true);
    result_with_path.GetEntities().SetPathWanted(true);
    for (int i = 0; i < 100; ++i, ++scored) {
      const std::vector<double> values = RandomCase(random, *model);
      const std::string wanted = plain.Walk(values, strategy, returns_last);
      for (RegResult* found : {&result, &result_with_path}) {
        const MCScore::MCStatus status = model->ScoreVector(values.data(), found);
        const std::string id =
            status.IsOK() ? found->GetEntities().GetDecidingId() : std::to_string(status.GetErrorCode());
        ASSERT_EQ(id, wanted) << "tree " << seed << ", case " << i << "\n" << document;
      }
      predicted += wanted != "90027" ? 1 : 0;
    }
  }
  // Both ends are common, or the trees are worth nothing.
  EXPECT_GT(predicted, scored / 3);
  EXPECT_LT(predicted, scored * 9 / 10);
  for (const int count : short_ways)
    EXPECT_GT(count, 100);
}

}  // namespace
}  // namespace kestrel_tests
