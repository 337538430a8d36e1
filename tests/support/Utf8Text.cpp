// Part of most test programs: narrow text is UTF-8 there, which it is not by itself on every system.

#include "kestrel/foundation/Locale.h"

namespace {

[[maybe_unused]] const bool is_set = [] {
  MCXML_800::SetUTF8mode(1);
  return true;
}();

}  // namespace
