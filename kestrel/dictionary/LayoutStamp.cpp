#include "kestrel/dictionary/LayoutStamp.h"

#include <atomic>

namespace MCKestrel_800 {

unsigned long long NewLayoutStamp() {
  static std::atomic<unsigned long long> next{1};
  return next.fetch_add(1, std::memory_order_relaxed);
}

}  // namespace MCKestrel_800
