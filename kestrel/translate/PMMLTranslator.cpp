#include "kestrel/translate/PMMLTranslator.h"

namespace MCKestrel_800 {

PMMLTranslator::PMMLTranslator() = default;

// Defined here so that the class's tables of virtual operations live in the core and not in every plug-in.
PMMLTranslator::~PMMLTranslator() = default;

}  // namespace MCKestrel_800
