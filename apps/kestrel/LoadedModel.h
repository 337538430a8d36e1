// A model read from its document, with the words for what can go wrong on the way.

#ifndef KESTREL_APPS_KESTREL_LOADEDMODEL_H
#define KESTREL_APPS_KESTREL_LOADEDMODEL_H

#include <memory>
#include <string>
#include <vector>

namespace MCKestrel_800 {
class ScoreModel;
}  // namespace MCKestrel_800

namespace kestrel_program {

/// The tags of the model elements that PMML knows, those that may hold others first, because the first one
/// that a document has decides which model it is.
const std::vector<std::string>& StandardModelElements();

/// Reads the model of a document.
/// path        UTF-8, or "-" for the standard input
/// names_file  a file with the tags to look for; empty for the standard's
/// Errors: ProgramError kDocument with place, code, text and a hint what to do; kInputOutput for files that
/// cannot be read.
std::unique_ptr<MCKestrel_800::ScoreModel> LoadModel(const std::string& path, const std::string& names_file);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_LOADEDMODEL_H
