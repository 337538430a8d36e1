// The categories that a classification can predict, numbered.

#ifndef KESTREL_PLUGINS_SUPPORT_TARGETCATEGORIES_H
#define KESTREL_PLUGINS_SUPPORT_TARGETCATEGORIES_H

#include <xercesc/util/XercesDefs.hpp>

#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/foundation/ScoreValue.h"
#include "plugins/support/ValueRules.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

/// The target's listed values in their order; a target without a list has the categories that the model
/// names, in the order in which it names them first. Categories are of the target's type, or texts when the
/// model has no target.
class TargetCategories {
 public:
  /// target  may be null; must outlive this object.
  explicit TargetCategories(const ScoreDictVar* target);

  /// The number of the category that a text of the document names, from 0. Errors: code 7, at the element,
  /// for a text that is not of the target's type or not among its listed values.
  int Find(const xercesc::DOMElement* element, const std::string& text);

  int GetCount() const { return static_cast<int>(values_.size()); }
  const ScoreValue& Get(int number) const { return *values_[static_cast<std::size_t>(number)]; }

 private:
  int Add(const xercesc::DOMElement* element, const std::string& text);

  const DictVar text_;  ///< stands in for the target that a model does not have
  const ScoreDictVar& target_;
  ValueRules rules_;
  std::vector<std::unique_ptr<ScoreValue>> values_;
  std::unordered_map<std::string, int> numbers_;  ///< by the document's spelling
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_TARGETCATEGORIES_H
