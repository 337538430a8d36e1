// The library that is built, so that another can be linked to it, and then not found.

#include "kestrel/platform/Export.h"

extern "C" KESTREL_PLUGIN_API int GiveNumberOfAbsent();

int GiveNumberOfAbsent() {
  return 1;
}
