#include "plugins/tree/NodeReader.h"

#include <xercesc/dom/DOMElement.hpp>

#include <algorithm>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/PMMLTranslator.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"
#include "plugins/support/Attributes.h"
#include "plugins/support/PredicateReader.h"

namespace MCKestrel_800 {
namespace {

using xercesc::DOMElement;
using Tags = PMMLTagText;

constexpr double kNoNumber = NumericValue::gSysmisValue;

double ReadRecordCount(const DOMElement* element) {
  const double count = ReadNumberOr(element, Tags::XML_ATT_RECORDCOUNT, kNoNumber);
  if (count < 0.0 && count != kNoNumber) {
    FailOnAttribute(element, Tags::XML_ATT_RECORDCOUNT, AttributeText(element, Tags::XML_ATT_RECORDCOUNT));
  }
  return count;
}

bool IsEmbeddedModel(const DOMElement* element) {
  return ElementIs(element, Tags::XML_ELE_REGRESSION) || ElementIs(element, Tags::XML_ELE_DECISIONTREE);
}

void CheckChildren(const DOMElement* element) {
  for (DOMElement* child : ChildElements(element)) {
    if (ElementIs(child, Tags::XML_ELE_NODE) || ElementIs(child, Tags::XML_ELE_SCOREDISTRIBUTION)) continue;
    if (IsEmbeddedModel(child)) {
      FailAt(child, KestrelException::kUnsupported,
             Narrow(child->getTagName()) + " in <Node>: Not supported!");
    }
    if (!IsPredicate(child) && !IsExtension(child) && !ElementIs(child, Tags::XML_ELE_PARTITION)) {
      FailAt(child, KestrelException::kStructure, Narrow(child->getTagName()) + ": Invalid element!");
    }
  }
}

[[noreturn]] void NodeLacks(const DOMElement* element, const char* what, const TreeOptions& options) {
  FailAt(element, KestrelException::kMissingElement,
         std::string(what) + " is required for missingValueStrategy " + options.GetStrategyText() + "!");
}

}  // namespace

void NodeReader::Read(DOMElement* root) {
  struct OpenElement {
    DOMElement* element;
    int node;
  };
  std::vector<OpenElement> open;
  DOMElement* element = root;
  while (element != nullptr) {
    open.push_back({element, OpenNode(element)});
    element = FirstChild(element, Tags::XML_ELE_NODE);
    while (element == nullptr && !open.empty()) {
      const OpenElement done = open.back();
      open.pop_back();
      CloseNode(done.element, done.node);
      if (!open.empty()) element = NextSibling(done.element, Tags::XML_ELE_NODE);
    }
  }
  tree_.conditions.Seal();
  tree_.scores.Seal();
}

int NodeReader::OpenNode(DOMElement* element) {
  CheckChildren(element);
  const Condition condition = ReadCondition(FindPredicate(element), inputs_, tree_.conditions);
  NodeScores::Node node;
  const std::string id = AttributeText(element, Tags::XML_VAL_NAME_ID);
  node.id = id;
  node.record_count = ReadRecordCount(element);
  shares_.clear();
  if (tree_.options.is_classification) {
    ReadDistribution(element, node);
    const XMLCh* score = FindAttribute(element, Tags::XML_ATT_SCORE);
    if (score != nullptr) node.winner = tree_.categories.Find(element, Narrow(score));
  } else {
    node.number = ReadNumberOr(element, Tags::XML_ATT_SCORE, kNoNumber);
  }
  tree_.scores.Add(node, shares_);
  return tree_.table.Open(condition);
}

// The winner is the category with the most records, the first among equals.
void NodeReader::ReadDistribution(DOMElement* element, NodeScores::Node& node) {
  PMMLTranslator::SetLeafNodeStats(element, stats_);
  if (stats_.empty()) return;
  double total = 0.0;
  bool has_probabilities = true;
  for (const LeafNodeStats& entry : stats_) {
    total += entry.record_count;
    has_probabilities &= entry.probability != kNoNumber;
  }
  double most = -1.0;
  const int number = tree_.table.GetCount();
  auto next = stats_.begin();
  for (const DOMElement* child : ChildElements(element, Tags::XML_ELE_SCOREDISTRIBUTION)) {
    const LeafNodeStats& entry = *next++;
    const double share = total > 0.0 ? entry.record_count / total : 0.0;
    const double probability = has_probabilities ? entry.probability : share;
    const double confidence = entry.confidence != kNoNumber ? entry.confidence : probability;
    const int category = tree_.categories.Find(child, entry.value);
    const auto place = static_cast<std::size_t>(category);
    if (last_nodes_.size() <= place) last_nodes_.resize(place + 1, -1);
    if (last_nodes_[place] == number) {
      FailAt(child, KestrelException::kStructure, "\"" + entry.value + "\": Duplicated Category Value!");
    }
    last_nodes_[place] = number;
    shares_.push_back({category, entry.record_count, probability, confidence});
    if (entry.record_count > most) {
      most = entry.record_count;
      node.winner = category;
    }
  }
  if (node.record_count == kNoNumber) node.record_count = total;
  std::sort(shares_.begin(), shares_.end(),
            [](const CategoryShare& a, const CategoryShare& b) { return a.category < b.category; });
}

void NodeReader::CloseNode(DOMElement* element, int node) {
  tree_.table.Close(node);
  const TreeOptions& options = tree_.options;
  if (Tree::NeedsRecordCounts(options) && tree_.scores.GetRecordCount(node) == kNoNumber && node != 0) {
    NodeLacks(element, "recordCount", options);
  }
  if (tree_.table.IsLeaf(node)) {
    CheckLeaf(element, node);
  } else if (options.strategy == MissingValueStrategy::kDefaultChild) {
    FindDefaultChild(element, node);
  }
}

void NodeReader::CheckLeaf(const DOMElement* element, int node) const {
  if (!tree_.scores.HasScore(node)) {
    FailAt(element, KestrelException::kMissingElement, "<Node> without children has no score!");
  }
  const TreeOptions& options = tree_.options;
  if (options.strategy == MissingValueStrategy::kAggregateNodes && options.is_classification &&
      !tree_.scores.HasDistribution(node)) {
    NodeLacks(element, "ScoreDistribution", options);
  }
}

void NodeReader::FindDefaultChild(const DOMElement* element, int node) {
  const std::string wanted = AttributeText(element, Tags::XML_ATT_DEFAULTCHILD);
  if (wanted.empty()) NodeLacks(element, "defaultChild", tree_.options);
  const TreeTable& table = tree_.table;
  for (int child = table.FirstChild(node); child != table.NodeAfter(node); child = table.NodeAfter(child)) {
    if (tree_.scores.GetId(child) != wanted) continue;
    tree_.scores.SetDefaultChild(node, child);
    return;
  }
  FailAt(element, KestrelException::kInvalidDocument, "invalid defaultChild -- " + wanted);
}

}  // namespace MCKestrel_800
