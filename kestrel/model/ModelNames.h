// Reading the file that lists the model elements to look for.

#ifndef KESTREL_MODEL_MODELNAMES_H
#define KESTREL_MODEL_MODELNAMES_H

#include <string>
#include <vector>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// Fills `names` with the tags that a names file lists, in its order, repeated ones included; what it held
/// before goes. Tags are separated by blanks, commas, tabs and line ends of every system. A tag may be of any
/// length and a line too: lines longer than 32767 characters, which other programs cut, are read on. A UTF-8
/// mark at the start is skipped, because editors put one there that no tag begins with.
///
/// `path` is UTF-8; when it is empty the file is "modeldll.txt" in the current folder. A file that cannot be
/// opened or read throws code 2 "Could not open model names file".
KESTREL_API void ReadModelNames(const std::string& path, std::vector<std::string>& names);

}  // namespace MCKestrel_800

#endif  // KESTREL_MODEL_MODELNAMES_H
