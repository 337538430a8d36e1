// Compiled into each model library by kestrel_add_plugin: what the library was built for.

#include "kestrel/platform/Export.h"

/// The version of the headers that the library was compiled with.
extern "C" KESTREL_PLUGIN_API const char* GiveMyVersion();

extern "C" const char* GiveMyVersion() {
  return KESTREL_PLUGIN_VERSION;
}
