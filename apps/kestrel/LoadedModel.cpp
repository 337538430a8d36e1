#include "apps/kestrel/LoadedModel.h"

#include <exception>
#include <fstream>
#include <iostream>
#include <new>

#include "apps/kestrel/DocumentHints.h"
#include "apps/kestrel/InputFile.h"
#include "apps/kestrel/ProgramError.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/ModelNames.h"
#include "kestrel/model/ScoreModel.h"

namespace kestrel_program {
namespace {

using namespace MCKestrel_800;

/// Some messages begin with a line end, which belongs to their text but not onto a terminal.
std::string WithoutLeadingLineEnds(const std::string& text) {
  const std::size_t first = text.find_first_not_of("\r\n");
  return first == std::string::npos ? std::string() : text.substr(first);
}

ProgramError Describe(const std::string& name, const KestrelException& fault) {
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
  } else if (const char* hint = HintForFault(code, fault.GetErrorMessage())) {
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

std::unique_ptr<ScoreModel> ReadModel(std::istream& document, const std::string& name,
                                      const std::vector<std::string>& elements) {
  try {
    return std::unique_ptr<ScoreModel>(ModelFactory::MakeModelFromXML(document, elements, std::string()));
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
  std::unique_ptr<ScoreModel> model;
  const std::string name = IsStandardStream(path) ? "standard input" : path;
  if (IsStandardStream(path)) {
    model = ReadModel(std::cin, name, elements);
  } else {
    std::ifstream document = OpenForReading(path);
    model = ReadModel(document, name, elements);
  }
  if (model == nullptr) throw ProgramError(kDocument, name + ": the model's library made no model of it");
  return model;
}

}  // namespace kestrel_program
