// The one function that the model factory looks for in this library.

#include "kestrel/platform/Export.h"
#include "plugins/rule_set/RuleSetTranslator.h"

/// A new translator; the factory deletes it.
extern "C" KESTREL_PLUGIN_API MCKestrel_800::ScoreTranslator* GiveMyTranslator();

extern "C" MCKestrel_800::ScoreTranslator* GiveMyTranslator() {
  return new MCKestrel_800::RuleSetTranslator;
}
