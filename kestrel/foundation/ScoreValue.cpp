#include "kestrel/foundation/ScoreValue.h"

namespace MCKestrel_800 {

ScoreValue::~ScoreValue() = default;

}  // namespace MCKestrel_800
