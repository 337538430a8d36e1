#include "kestrel/foundation/Locale.h"

#include <atomic>

#include "kestrel/foundation/TextConverter.h"
#include "kestrel/platform/Environment.h"

namespace MCXML_800 {

namespace {

// Inside a function, so that it is there for whichever part of the library starts first.
std::atomic<int>& Utf8Mode() {
  static std::atomic<int> mode{MCKestrel_800::NarrowTextIsUtf8ByDefault() ? 1 : 0};
  return mode;
}

bool TakeLocaleFromEnvironment() {
  MCKestrel_800::SetLocaleFromEnvironment();
  if (MCKestrel_800::CharacterLocaleName() != "C") return true;
  MCKestrel_800::SetLocaleByName("en_US");
  return MCKestrel_800::SetEnvironmentVariableText("LC_ALL", "en_US");
}

/// What happens when the library is loaded. The converter comes second, since its code page is the locale's.
const bool kStarted = [] {
  EnableLocale();
  RenewDefaultConverter(qUTF8mode() != 0);
  return true;
}();

}  // namespace

void EnableLocale() {
  [[maybe_unused]] static const bool done = TakeLocaleFromEnvironment();
}

void SetUTF8mode(int on) {
  Utf8Mode().store(on != 0 ? 1 : 0, std::memory_order_relaxed);
  RenewDefaultConverter(on != 0);
}

int qUTF8mode() {
  return Utf8Mode().load(std::memory_order_relaxed);
}

int VEXAMBDefaultConverterID() {
  return DefaultConverterCount();
}

}  // namespace MCXML_800
