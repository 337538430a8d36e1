// Which data fields derived fields need.

#ifndef KESTREL_APPS_KESTREL_DERIVEDINPUTS_H
#define KESTREL_APPS_KESTREL_DERIVEDINPUTS_H

#include <string>
#include <vector>

namespace MCKestrel_800 {
class ScoreDictVar;
class ScoreDictionary;
class TransformationDictionary;
}  // namespace MCKestrel_800

namespace kestrel_program {

/// The data fields that the named derived fields read, themselves or through other derived fields, in the
/// order of the data dictionary, to which they belong.
std::vector<const MCKestrel_800::ScoreDictVar*> FindDerivedInputs(
    const std::vector<std::string>& names, const MCKestrel_800::TransformationDictionary& derived,
    const MCKestrel_800::ScoreDictionary& dictionary);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_DERIVEDINPUTS_H
