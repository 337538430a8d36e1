// What a document holds, with the words for what can go wrong on the way.

#ifndef KESTREL_APPS_KESTREL_LOADEDMODEL_H
#define KESTREL_APPS_KESTREL_LOADEDMODEL_H

#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/model/ScoreModel.h"
#include "kestrel/transform/TransformationDictionary.h"

namespace kestrel_program {

/// The data dictionary of a document and the derived fields that stand directly below its root. There is at
/// least one of these. They refer to the dictionary's fields, so they go first.
struct LoadedFields {
  std::unique_ptr<MCKestrel_800::ScoreDictionary> dictionary;
  std::unique_ptr<MCKestrel_800::TransformationDictionary> derived;
};

/// What a document holds: its model, or else its dictionary in the older format, or else its derived fields.
/// The others are null.
struct LoadedDocument {
  std::unique_ptr<MCKestrel_800::ScoreModel> model;
  std::unique_ptr<MCKestrel_800::ScoreDictionary> legacy;
  std::string refusal;  ///< beside `legacy`: why there is no model of the one that is in the document
  LoadedFields fields;
};

/// The tags of the model elements that PMML knows, those that may hold others first, because the first one
/// that a document has decides which model it is.
const std::vector<std::string>& StandardModelElements();

/// Reads the model of a document.
/// path        UTF-8, or "-" for the standard input
/// names_file  a file with the tags to look for; empty for the standard's
/// Errors: ProgramError kDocument with place, code, text and a hint what to do; kInputOutput for files that
/// cannot be read.
std::unique_ptr<MCKestrel_800::ScoreModel> LoadModel(const std::string& path, const std::string& names_file);

/// Reads the derived fields of a document, whatever model it has; no model library is needed.
/// Errors as above, also for a document without derived fields.
LoadedFields LoadFields(const std::string& path);

/// Reads the model as LoadModel does. Where that fails, a document in the older format (root "vexa-ml") gives
/// its dictionary; a document without any of the standard's models is looked at for derived fields. Errors as
/// above, also for a dictionary of the older format that is not good; for a document with nothing of all
/// this, that there is no model. With a names file there must be one of its models.
LoadedDocument LoadDocument(const std::string& path, const std::string& names_file);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_LOADEDMODEL_H
