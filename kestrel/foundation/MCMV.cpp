#include "kestrel/foundation/MCMV.h"

namespace MCCommon_800 {

// Defined here too, so that hosts and plug-ins can take its address.
constexpr double MCMV::gMissingValue;

}  // namespace MCCommon_800
