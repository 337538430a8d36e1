// The dictionary of a document in the older format, for hosts, which have no need of the XML parser's
// headers.

#ifndef KESTREL_TRANSLATE_LEGACYDICTIONARY_H
#define KESTREL_TRANSLATE_LEGACYDICTIONARY_H

#include <iosfwd>
#include <memory>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// Reads the dictionary of a whole document of the older format: the "dictionary" child of its root. Never
/// null or empty. Errors: those of ReadDocument and VEXATranslator::ParseDictionary; code 5 "Unsupported
/// Model found!" for a root that is not "vexa-ml".
KESTREL_API std::unique_ptr<ScoreDictionary> ReadLegacyDictionary(std::istream& in);

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_LEGACYDICTIONARY_H
