#include "kestrel/translate/ScoreResultField.h"

namespace MCKestrel_800 {

ScoreResultField::~ScoreResultField() = default;

}  // namespace MCKestrel_800
