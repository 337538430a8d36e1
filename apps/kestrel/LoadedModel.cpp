#include "apps/kestrel/LoadedModel.h"

#include <exception>
#include <fstream>
#include <iostream>
#include <new>

#include "apps/kestrel/DocumentHints.h"
#include "apps/kestrel/DocumentInput.h"
#include "apps/kestrel/InputFile.h"
#include "apps/kestrel/ProgramError.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/ModelNames.h"

namespace kestrel_program {
namespace {

using namespace MCKestrel_800;

/// Some messages begin with a line end, which belongs to their text but not onto a terminal.
std::string WithoutLeadingLineEnds(const std::string& text) {
  const std::size_t first = text.find_first_not_of("\r\n");
  return first == std::string::npos ? std::string() : text.substr(first);
}

/// own_hint  takes the place of the general one.
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
    text += "\n  the system says: " + reason +
            "\n  hint: install the library for this kind of model beside the others, in lib/kestrel/plugins";
  } else if (const char* hint =
                 own_hint != nullptr ? own_hint : HintForFault(code, fault.GetErrorMessage())) {
    text += std::string("\n  hint: ") + hint;
  }
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

std::unique_ptr<ScoreModel> MakeModel(std::istream& document, const std::vector<std::string>& elements) {
  return std::unique_ptr<ScoreModel>(ModelFactory::MakeModelFromXML(document, elements, std::string()));
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

std::unique_ptr<ScoreModel> RequireModel(std::unique_ptr<ScoreModel> model, const std::string& name) {
  if (model == nullptr) throw ProgramError(kDocument, name + ": the model's library made no model of it");
  return model;
}

std::unique_ptr<ScoreModel> ReadModel(std::istream& document, const std::string& name,
                                      const std::vector<std::string>& elements) {
  return RequireModel(Guard(name, [&] { return MakeModel(document, elements); }), name);
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
  if (IsStandardStream(path)) return ReadModel(std::cin, "standard input", elements);
  std::ifstream document = OpenForReading(path);
  return ReadModel(document, path, elements);
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
  return Guard(name, [&] {
    LoadedDocument loaded;
    try {
      loaded.model = RequireModel(MakeModel(document.Open(), elements), name);
    } catch (const KestrelException& fault) {
      if (!names_file.empty() || !IsWithoutModel(fault)) throw;
      loaded.fields = MakeFields(document.Open());
      if (!HasFields(loaded.fields)) throw;
    }
    return loaded;
  });
}

}  // namespace kestrel_program
