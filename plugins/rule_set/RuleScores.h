// The values that the rules of a set predict, each once, numbered.

#ifndef KESTREL_PLUGINS_RULE_SET_RULESCORES_H
#define KESTREL_PLUGINS_RULE_SET_RULESCORES_H

#include <xercesc/util/XercesDefs.hpp>

#include <cstddef>
#include <string>
#include <unordered_map>
#include <vector>

#include "kestrel/foundation/NumericValue.h"
#include "plugins/support/TargetCategories.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

/// Of a classification the target's categories, predicted or not; see TargetCategories. Of a regression the
/// numbers in the order in which they are first looked for; two are the same only when they compare equal
/// exactly, since a rule's prediction is the number that the document gives.
class RuleScores {
 public:
  /// target  may be null; must outlive this object.
  RuleScores(bool is_classification, const ScoreDictVar* target)
      : is_classification_(is_classification), categories_(target) {}

  /// The number of a classification's category, from 0; errors as TargetCategories says.
  int FindCategory(const xercesc::DOMElement* element, const std::string& text) {
    return categories_.Find(element, text);
  }

  /// The number of a regression's score, which is finite.
  int FindNumber(double score);

  int GetCount() const {
    return is_classification_ ? categories_.GetCount() : static_cast<int>(numbers_.size());
  }
  const ScoreValue& Get(int score) const {
    if (is_classification_) return categories_.Get(score);
    return numbers_[static_cast<std::size_t>(score)];
  }

 private:
  const bool is_classification_;
  TargetCategories categories_;
  std::vector<NumericValue> numbers_;
  std::unordered_map<double, int> positions_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_RULE_SET_RULESCORES_H
