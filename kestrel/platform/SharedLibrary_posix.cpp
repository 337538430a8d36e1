// Library loading on Linux and its relatives.

#include <dlfcn.h>

#include "kestrel/platform/SharedLibrary.h"

namespace MCKestrel_800 {
namespace {

std::string TakeSystemText(const char* otherwise) {
  const char* text = dlerror();
  return text != nullptr && *text != '\0' ? text : otherwise;
}

}  // namespace

const char* SharedLibrary::GetUsualPlace() {
  return "lib/kestrel/plugins";
}

const char* SharedLibrary::GetSuffix() {
  return ".so";
}

bool SharedLibrary::Load() {
  if (handle_ != nullptr) return true;
  // Everything is bound now: a library that lacks something is refused here, and does not stop the process at
  // the first call. A bare name is looked for along the run path of the library that this code is in, the
  // core.
  handle_ = dlopen(file_name_.c_str(), RTLD_NOW | RTLD_LOCAL);
  if (handle_ != nullptr) return true;
  last_error_ = TakeSystemText("The library could not be loaded.");
  return false;
}

void* SharedLibrary::FindSymbol(const char* name) {
  if (handle_ == nullptr) {
    last_error_ = "The library is not loaded.";
    return nullptr;
  }
  dlerror();
  void* symbol = dlsym(handle_, name);
  if (symbol == nullptr) last_error_ = TakeSystemText("The name has no address.");
  return symbol;
}

}  // namespace MCKestrel_800
