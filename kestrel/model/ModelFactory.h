// The way from a document to a model: reads the document, finds the model in it, loads the model's library
// and has the library's translator build the model.

#ifndef KESTREL_MODEL_MODELFACTORY_H
#define KESTREL_MODEL_MODELFACTORY_H

#include <iosfwd>
#include <string>
#include <vector>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

class ScoreDictionary;
class ScoreModel;
class TransformationDictionary;

/// Makes models from documents. All operations are static.
///
/// Errors: every failure is a KestrelException; what a translator throws passes through unchanged. When the
/// exception says that a model is not supported because its library could not be used, GetLastLoadError tells
/// what the system said about it.
///
/// Model libraries: the library of the element `TreeModel` is the file `TreeModel800r.so` (`.dll` on
/// Windows). It is looked for by that name alone, beside the core library, in the folder `kestrel/plugins`
/// beside the core (Linux) and where the system looks for libraries; LD_LIBRARY_PATH comes first on Linux. No
/// document can name another file.
///
/// Names: the element tags that a host wants recognised, most wanted first. A host passes them as a list,
/// `fModelNames` among others, or as a names file: tags between blanks, commas, tabs and line ends.
///
/// Ownership: the caller owns the model and deletes it. The model is what the translator returned, so it is
/// null when the translator returned null. The library that the model came from stays loaded for the rest of
/// the process, because the model's code is in it.
///
/// Threads: any number of threads may load at once. Each load has its own document, its own translator and
/// its own copy of the names; the one thing that loads share is `fModelNames`, and they read and write it
/// under a lock. A host that changes `fModelNames` itself does so while nothing is being loaded.
class KESTREL_API ModelFactory {
 public:
  /// The tags of the model elements that the factory knows, as the last names file that was read listed them.
  static std::vector<std::string> fModelNames;

  /// Reads the document from the stream's present position to its end. Of the tags in `modelNames` the first
  /// one that occurs in the document decides which model is made; tags count exactly as they stand, and no
  /// pattern is known. `arg` is handed to the translator; its meaning is the model library's.
  static ScoreModel* MakeModelFromXML(std::istream& in, const std::vector<std::string>& modelNames,
                                      const std::string& arg);

  /// The same with a second argument for translators that take two. Such a translator reads the document
  /// itself, from the stream set back to where it was; one that gives null there is asked as above, and so is
  /// every translator when the stream cannot be set back.
  static ScoreModel* MakeModelFromXML(std::istream& in, const std::vector<std::string>& modelNames,
                                      const std::string& arg, const std::string& secondArg);

  /// Reads the names file into `fModelNames`, then the document from the file. File names are UTF-8 on every
  /// system. An empty `namesFileName` stands for "modeldll.txt" in the current folder.
  static ScoreModel* MakeModelFromXML(const std::string& fileName, const std::string& namesFileName,
                                      const std::string& arg);
  static ScoreModel* MakeModelFromXML(const std::string& fileName, const std::string& namesFileName,
                                      const std::string& arg, const std::string& secondArg);

  /// Makes the model of one element in a tree that the host has parsed. `modelElement` is the host's
  /// `xercesc::DOMElement*` of the model element (no other pointer type will do, because it is cast back);
  /// the tree stays the host's. The element's tag must be on the names list; the older tags "DecisionTree"
  /// and "Regression" stand for "TreeModel" and "RegressionModel". The dictionaries go to the translator as
  /// they are: whether the model keeps them is the model library's contract, and the factory deletes neither.
  /// Null when the translator has no such operation. A null dictionary is passed as a ScoreDictionary*, since
  /// a bare `nullptr` fits both this operation and the next.
  static ScoreModel* MakeModelFromXML(void* modelElement, const std::vector<std::string>& modelNames,
                                      ScoreDictionary* dictionary, const std::string& arg = std::string(),
                                      ScoreDictionary* resultDictionary = nullptr);

  /// The same for translators that read a second element (`xercesc::DOMElement*`, may be null) beside the
  /// model's, such as the element that holds the dictionary.
  static ScoreModel* MakeModelFromXML(void* modelElement, const std::vector<std::string>& modelNames,
                                      void* otherElement, const std::string& arg = std::string());

  /// Reads the data dictionary and the derived fields of a document, and no model: what a host needs that
  /// computes derived fields alone. No model library is looked for.
  /// dictionaryOut  set to the data dictionary, which the caller deletes, after the derived fields, since
  ///                these refer to its fields; null after a failure.
  /// reserved       without meaning; pass an empty text.
  /// Returns the derived fields, which the caller deletes, set up for their first case. A document without a
  /// `TransformationDictionary` element has none: the dictionary is empty. The root must be "PMML".
  static TransformationDictionary* GetTransformationDictionaryFromXML(std::istream& in,
                                                                      ScoreDictionary*& dictionaryOut,
                                                                      const std::string& reserved);
  static TransformationDictionary* GetTransformationDictionaryFromXML(const std::string& fileName,
                                                                      ScoreDictionary*& dictionaryOut,
                                                                      const std::string& reserved);

  /// Why the last load on the calling thread could not use a model library, in the system's words; empty when
  /// it could, or did not get that far.
  static std::string GetLastLoadError();

  ModelFactory() = delete;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_MODEL_MODELFACTORY_H
