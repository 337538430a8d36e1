// Opening a file whose name is UTF-8.

#ifndef KESTREL_MODEL_INPUTFILE_H
#define KESTREL_MODEL_INPUTFILE_H

#include <fstream>
#include <string>

namespace MCKestrel_800 {

/// Opens the file for reading, byte by byte as it is. `is_open` of the result tells whether that worked; a
/// name that is no text of the system, or that ends early, opens nothing.
std::ifstream OpenInputFile(const std::string& utf8Name);

}  // namespace MCKestrel_800

#endif  // KESTREL_MODEL_INPUTFILE_H
