// What the readers of data fields, derived fields, targets and output fields share.

#ifndef KESTREL_TRANSLATE_FIELDRULES_H
#define KESTREL_TRANSLATE_FIELDRULES_H

#include <xercesc/util/XercesDefs.hpp>

#include <cstddef>

#include "kestrel/dictionary/ScoreDictVar.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

class ValueLabelSet;

/// Sets `level` to the one that an `optype` text names; false, changing nothing, for every other text, the
/// empty one and null.
bool FindMeasureLevel(const XMLCh* text, ScoreDictVar::MeasureLevel& level);

/// Whether an equal value is among the labels. Where trailing blanks count, two texts that differ in them are
/// two categories.
bool IsListed(const ValueLabelSet& labels, const ScoreDictVar& variable, const ScoreValue& value);

/// Refuses a number of categories other than two where the variable is a flag (code 12).
void CheckFlagCategories(const xercesc::DOMElement* where, const ScoreDictVar& variable,
                         std::size_t categories);

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_FIELDRULES_H
