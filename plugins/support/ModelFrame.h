// What stands around a model in its document.

#ifndef KESTREL_PLUGINS_SUPPORT_MODELFRAME_H
#define KESTREL_PLUGINS_SUPPORT_MODELFRAME_H

#include <string>

#include "plugins/support/MiningSchema.h"
#include "plugins/support/OutputFields.h"

namespace MCKestrel_800 {

class ScoreDictVar;

/// What the attributes of a model element, its mining schema, targets and output fields say, whatever its
/// kind.
struct ModelFrame {
  bool is_classification = false;
  MiningSchema schema;
  /// The name of the field that is predicted; empty when the document names none.
  std::string target;
  /// The variable of that name; null when there is none.
  const ScoreDictVar* target_variable = nullptr;
  OutputFields outputs;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_MODELFRAME_H
