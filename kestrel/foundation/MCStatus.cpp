#include "kestrel/foundation/MCStatus.h"

#include <iterator>

namespace MCScore {

namespace {

constexpr const char* kStatusNames[] = {
    "kE_PARSE",         "kE_NODICTVAR",  "kE_NOCHILD",      "kE_NULLCHILD",           "kE_ANCESTORCHILD",
    "kE_ZEROCHILD",     "kE_NULLARG",    "kE_NOTCHILD",     "kE_NODENOTCHILD",        "kE_SIBLING",
    "kE_NOTSIBLING",    "kE_ANCESTOR",   "kE_IO",           "kE_CONVERTVALUE",        "kE_OUTOFDOMAIN",
    "kE_NOPARAM",       "kE_SEMANTIC",   "kE_UNKNOWNMODEL", "kE_MISSINGVAR",          "kE_SPLITVARINVALID",
    "kE_MSGFMT",        "kE_DIFFTARGET", "kE_VALUECLASH",   "kE_UNSUP_VALUE",         "kE_INVALID_VALUE",
    "kE_UNKNOWN_ERROR", "kE_MISSINGVAR", "kE_UNSUP_METHOD", "kE_NO_FIRES_NO_DEFAULT", "",
};

}  // namespace

MCStatus::MCStatus(long code, bool isWarning)
    : code_(static_cast<int32_t>(code)), severity_(static_cast<int16_t>(isWarning ? 1 : -1)) {}

bool MCStatus::operator==(const MCStatus& other) const {
  if (code_ != other.code_ || severity_ != other.severity_) return false;
  for (unsigned int i = 0; i < 3; ++i) {
    if (discrete_[i] != other.discrete_[i] || scale_[i] != other.scale_[i]) return false;
  }
  return true;
}

const char* StatusName(size_t index) {
  return index < std::size(kStatusNames) ? kStatusNames[index] : nullptr;
}
size_t StatusNameCount() {
  return std::size(kStatusNames) - 1;
}

}  // namespace MCScore
