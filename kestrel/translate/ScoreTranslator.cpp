#include "kestrel/translate/ScoreTranslator.h"

namespace MCKestrel_800 {

ScoreTranslator::~ScoreTranslator() = default;

}  // namespace MCKestrel_800
