#include "apps/kestrel/LoadedModel.h"

#include <exception>
#include <istream>
#include <new>

#include "apps/kestrel/DocumentHints.h"
#include "apps/kestrel/DocumentInput.h"
#include "apps/kestrel/ProgramError.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/ModelNames.h"
#include "kestrel/platform/SharedLibrary.h"
#include "kestrel/translate/LegacyDictionary.h"

namespace kestrel_program {
namespace {

using namespace MCKestrel_800;

/// Some messages begin with a line end, which belongs to their text but not onto a terminal.
std::string WithoutLeadingLineEnds(const std::string& text) {
  const std::size_t first = text.find_first_not_of("\r\n");
  return first == std::string::npos ? std::string() : text.substr(first);
}

/// own_hint  takes the place of the general ones.
ProgramError Describe(const std::string& name, const KestrelException& fault,
                      const char* own_hint = nullptr) {
  std::string text = name;
  if (fault.GetLine() != 0) {
    text += ":" + std::to_string(fault.GetLine()) + ":" + std::to_string(fault.GetColumn());
  }
  const int code = fault.GetErrorCode();
  text += ": " + WithoutLeadingLineEnds(fault.GetErrorMessage()) + " (code " + std::to_string(code) + ")";
  const std::string reason = ModelFactory::GetLastLoadError();
  if (code == KestrelException::kUnsupported && !reason.empty()) {
    text += "\n  the system says: " + reason;
    if (own_hint == nullptr) {
      static const std::string kInstall =
          std::string("install the library for this kind of model beside the others, in ") +
          MCKestrel_800::SharedLibrary::GetUsualPlace();
      own_hint = reason.find("built for Kestrel") != std::string::npos
                     ? "build the library for this kind of model again, with this version's headers"
                     : kInstall.c_str();
    }
  } else if (own_hint == nullptr) {
    own_hint = HintForFault(code, fault.GetErrorMessage());
  }
  if (own_hint != nullptr) text += std::string("\n  hint: ") + own_hint;
  return ProgramError(code == KestrelException::kFile ? kInputOutput : kDocument, text);
}

std::vector<std::string> ModelElements(const std::string& names_file) {
  if (names_file.empty()) return StandardModelElements();
  std::vector<std::string> names;
  try {
    ReadModelNames(names_file, names);
  } catch (const KestrelException& fault) {
    throw ProgramError(kInputOutput, names_file + ": " + fault.GetErrorMessage());
  }
  return names;
}

LoadedFields MakeFields(std::istream& document) {
  ScoreDictionary* dictionary = nullptr;
  LoadedFields fields;
  fields.derived.reset(ModelFactory::GetTransformationDictionaryFromXML(document, dictionary, std::string()));
  fields.dictionary.reset(dictionary);
  return fields;
}

bool HasFields(const LoadedFields& fields) {
  return !fields.derived->GetDerivedVarNames().empty();
}

/// Whether the document was looked through and has none of the models that were looked for.
bool IsWithoutModel(const KestrelException& fault) {
  return fault.GetErrorCode() == KestrelException::kUnsupported &&
         std::string(fault.GetErrorMessage()).find("Unsupported Model found!") != std::string::npos;
}

/// Makes the document's model. What the older format's models lack is another export, not an installation.
std::unique_ptr<ScoreModel> MakeModel(DocumentInput& document, const std::vector<std::string>& elements) {
  std::unique_ptr<ScoreModel> model;
  try {
    model.reset(ModelFactory::MakeModelFromXML(document.Open(), elements, std::string()));
  } catch (const KestrelException& fault) {
    const bool lacks_support = fault.GetErrorCode() == KestrelException::kUnsupported;
    if (!lacks_support || IsWithoutModel(fault) || !document.Holds("<vexa-ml")) throw;
    throw Describe(
        document.GetName(), fault,
        "no library that is installed reads models of the older format (vexa-ml); export the model "
        "as PMML");
  }
  if (model == nullptr)
    throw ProgramError(kDocument, document.GetName() + ": the model's library made no model of it");
  return model;
}

/// The dictionary of a document in the older format; null for another document and for one without it.
std::unique_ptr<ScoreDictionary> MakeLegacyDictionary(std::istream& document) {
  try {
    return ReadLegacyDictionary(document);
  } catch (const KestrelException& fault) {
    const bool is_without_dictionary = fault.GetErrorCode() == KestrelException::kStructure &&
                                       fault.GetErrorMessage() == "<DataDictionary is required !!";
    if (IsWithoutModel(fault) || is_without_dictionary) return nullptr;
    throw;
  }
}

/// Calls a reader of the document and puts into words what it throws: a model's library may throw anything.
template <class Reader>
auto Guard(const std::string& name, const Reader& reader) {
  try {
    return reader();
  } catch (const ProgramError&) {
    throw;
  } catch (const KestrelException& fault) {
    throw Describe(name, fault);
  } catch (const std::bad_alloc&) {
    throw;
  } catch (const std::exception& fault) {
    throw ProgramError(kDocument, name + ": the model's library failed: " + fault.what());
  } catch (...) {
    throw ProgramError(kDocument, name + ": the model's library failed without saying why");
  }
}

constexpr char kAcceptedFields[] =
    "accepted are DerivedField elements in a TransformationDictionary directly below PMML";

}  // namespace

const std::vector<std::string>& StandardModelElements() {
  static const std::vector<std::string> elements = {
      "AnomalyDetectionModel",
      "MiningModel",
      "AssociationModel",
      "AssociationModelLattice",
      "BaselineModel",
      "BayesianNetworkModel",
      "BayesNetModel",
      "ClusteringModel",
      "GaussianProcessModel",
      "GeneralRegressionModel",
      "NaiveBayesModel",
      "NearestNeighborModel",
      "NeuralNetwork",
      "RegressionModel",
      "RuleSetModel",
      "Scorecard",
      "SequenceModel",
      "SupportVectorMachineModel",
      "TextModel",
      "TimeSeriesModel",
      "TreeModel",
  };
  return elements;
}

std::unique_ptr<ScoreModel> LoadModel(const std::string& path, const std::string& names_file) {
  const std::vector<std::string> elements = ModelElements(names_file);
  DocumentInput document(path);
  return Guard(document.GetName(), [&] { return MakeModel(document, elements); });
}

LoadedFields LoadFields(const std::string& path) {
  DocumentInput document(path);
  const std::string& name = document.GetName();
  LoadedFields fields = Guard(name, [&] {
    try {
      return MakeFields(document.Open());
    } catch (const KestrelException& fault) {
      // The general hint tells of models.
      if (IsWithoutModel(fault)) throw Describe(name, fault, "accepted is PMML as the root element");
      throw;
    }
  });
  if (HasFields(fields)) return fields;
  const char* text = document.Holds("DerivedField")
                         ? ": the derived fields are those of a model alone (LocalTransformations), which "
                           "kestrel score computes for the model\n  hint: "
                         : ": the document has no derived fields\n  hint: ";
  throw ProgramError(kDocument, name + text + kAcceptedFields);
}

LoadedDocument LoadDocument(const std::string& path, const std::string& names_file) {
  const std::vector<std::string> elements = ModelElements(names_file);
  DocumentInput document(path);
  const std::string& name = document.GetName();
  LoadedDocument loaded;
  bool is_without_model = false;
  try {
    loaded.model = Guard(name, [&] {
      try {
        return MakeModel(document, elements);
      } catch (const KestrelException& fault) {
        is_without_model = IsWithoutModel(fault);
        throw;
      }
    });
  } catch (const ProgramError& fault) {
    // Who names the models that there may be wants one of these.
    if (fault.GetCode() != kDocument || (is_without_model && !names_file.empty())) throw;
    loaded.legacy = Guard(name, [&] { return MakeLegacyDictionary(document.Open()); });
    if (loaded.legacy != nullptr) {
      if (!is_without_model) loaded.refusal = fault.GetText();
      return loaded;
    }
    if (!is_without_model) throw;
    loaded.fields = Guard(name, [&] { return MakeFields(document.Open()); });
    if (!HasFields(loaded.fields)) throw;
  }
  return loaded;
}

}  // namespace kestrel_program
