#include <CentroidTranslator.h>

#include "kestrel/platform/Export.h"

/// The one function that the factory looks for in the library. A new translator, which the factory deletes.
extern "C" KESTREL_PLUGIN_API MCKestrel_800::ScoreTranslator* GiveMyTranslator() {
  return new centroid::CentroidTranslator;
}
