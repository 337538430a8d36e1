// What a node of a tree, or a rule, knows of one category of the target.

#ifndef KESTREL_TRANSLATE_LEAFNODESTATS_H
#define KESTREL_TRANSLATE_LEAFNODESTATS_H

#include <string>

#include "kestrel/foundation/NumericValue.h"

namespace MCKestrel_800 {

/// One `ScoreDistribution` element. Numbers are finite and not negative; a number that the document does not
/// give is the system-missing value. `recordCount` is always given.
struct LeafNodeStats {
  std::string value;  ///< the category, as the document spells it
  double record_count = NumericValue::gSysmisValue;
  double confidence = NumericValue::gSysmisValue;
  double probability = NumericValue::gSysmisValue;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_LEAFNODESTATS_H
