#include "kestrel/model/ModelFinder.h"

#include <algorithm>
#include <cstddef>
#include <iterator>
#include <unordered_map>
#include <xercesc/dom/DOMElement.hpp>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/ReaderFault.h"
#include "kestrel/translate/XmlText.h"

namespace MCKestrel_800 {
namespace {

using xercesc::DOMElement;

constexpr char kUnsupported[] = "Unsupported Model found!";

/// How the model of a document with a certain root is found.
struct RootRule {
  const char* root;
  const char*
      sign;  ///< an element anywhere in the document that settles the model; null when none is looked for
  const char* tag;  ///< the model that the root or the sign stands for; null when the names are searched for
};

constexpr RootRule kRoots[] = {
    {"PMML", nullptr, nullptr},
    {"vexa-ml", "regression-model", "GeneralRegressionModel"},
    {"Tree", nullptr, "TreeModel"},
    {"AssocLattice", nullptr, nullptr},
    {"SequentialAssociationLattice", nullptr, nullptr},
};

struct TagPair {
  const char* tag;
  const char* stands_for;
};

/// Tags of elements whose libraries bear another model's name.
constexpr TagPair kLibraryTags[] = {{"AssociationModelLattice", "AssociationModel"}};

/// Tags that hosts with a tree of their own may still use.
constexpr TagPair kOlderTags[] = {{"DecisionTree", "TreeModel"}, {"Regression", "RegressionModel"}};

template <size_t count>
std::string Translated(const std::string& tag, const TagPair (&pairs)[count]) {
  for (const TagPair& pair : pairs) {
    if (tag == pair.tag) return pair.stands_for;
  }
  return tag;
}

/// The element after `element` in document order within `root`; null after the last one. Goes from element to
/// element, so that it needs neither a stack as deep as the document nor one of the parser's live lists, of
/// which each keeps looking through the whole tree.
const DOMElement* NextElement(const DOMElement* element, const DOMElement* root) {
  if (const DOMElement* child = element->getFirstElementChild()) return child;
  while (element != root) {
    if (const DOMElement* sibling = element->getNextElementSibling()) return sibling;
    element = static_cast<const DOMElement*>(element->getParentNode());
  }
  return nullptr;
}

/// Positions of tags on a list of names. A tag is looked up by its address after the first time: the tree
/// holds each distinct name once, and a document has few of them for very many elements.
class TagRanks {
 public:
  explicit TagRanks(const std::vector<std::string>& names) : none_(names.size()) {
    // The first of repeated names counts: emplace leaves what is there.
    for (size_t i = 0; i < names.size(); ++i)
      by_name_.emplace(names[i], i);
  }

  /// The number of names for a tag that is not on the list.
  size_t Of(const XMLCh* tag) {
    const auto known = by_address_.find(tag);
    if (known != by_address_.end()) return known->second;
    const auto found = by_name_.find(Narrow(tag));
    const size_t rank = found == by_name_.end() ? none_ : found->second;
    by_address_.emplace(tag, rank);
    return rank;
  }

 private:
  size_t none_;
  std::unordered_map<std::string, size_t> by_name_;
  std::unordered_map<const XMLCh*, size_t> by_address_;
};

/// The element whose tag is nearest to the front of the list, the first of several; null when there is none.
const DOMElement* FindFirstOf(const DOMElement* root, const std::vector<std::string>& names) {
  TagRanks ranks(names);
  const DOMElement* best = nullptr;
  size_t best_rank = names.size();
  for (const DOMElement* element = root; element != nullptr && best_rank > 0;
       element = NextElement(element, root)) {
    const size_t rank = ranks.Of(element->getTagName());
    if (rank < best_rank) {
      best_rank = rank;
      best = element;
    }
  }
  return best;
}

}  // namespace

FoundModel FindModel(const DOMElement* root, const std::vector<std::string>& names) {
  const std::string root_tag = Narrow(root->getTagName());
  const auto* rule = std::find_if(std::begin(kRoots), std::end(kRoots),
                                  [&root_tag](const RootRule& row) { return root_tag == row.root; });
  if (rule == std::end(kRoots)) FailAt(root, KestrelException::kUnsupported, kUnsupported);
  if (rule->sign != nullptr) {
    if (const DOMElement* sign = FindFirstOf(root, {rule->sign})) return {rule->tag, sign};
  } else if (rule->tag != nullptr) {
    return {rule->tag, root};
  }
  const DOMElement* element = FindFirstOf(root, names);
  if (element == nullptr) FailAt(root, KestrelException::kUnsupported, kUnsupported);
  return {Translated(Narrow(element->getTagName()), kLibraryTags), element};
}

FoundModel ModelOfElement(const DOMElement* element, const std::vector<std::string>& names) {
  if (element == nullptr) Fail(KestrelException::kUnsupported, "Empty Node!!");
  const std::string tag = Translated(Narrow(element->getTagName()), kOlderTags);
  if (std::find(names.begin(), names.end(), tag) == names.end()) {
    FailAt(element, KestrelException::kUnsupported, kUnsupported);
  }
  return {Translated(tag, kLibraryTags), element};
}

}  // namespace MCKestrel_800
