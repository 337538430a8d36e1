// A library for the tests to open.

#include "kestrel/platform/Export.h"

extern "C" KESTREL_PLUGIN_API int GiveNumber();
extern "C" KESTREL_PLUGIN_API int CountCalls();

int GiveNumber() {
  return 800;
}

int CountCalls() {
  static int calls = 0;
  return ++calls;
}
