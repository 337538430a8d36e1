// A library that cannot be opened, because the library that it needs is not where the system looks.

#include "kestrel/platform/Export.h"

extern "C" KESTREL_PLUGIN_API int GiveNumber();
extern "C" int GiveNumberOfAbsent();

int GiveNumber() {
  return GiveNumberOfAbsent();
}
