#include "kestrel/model/ModelFactory.h"

#include <fstream>
#include <memory>
#include <mutex>
#include <utility>
#include <xercesc/dom/DOMElement.hpp>

#include "kestrel/foundation/ExtNameStr.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/model/ModelFinder.h"
#include "kestrel/model/ModelLibrary.h"
#include "kestrel/model/ModelNames.h"
#include "kestrel/platform/ThreadObject.h"
#include "kestrel/translate/BaseTranslator.h"
#include "kestrel/translate/DocumentReader.h"
#include "kestrel/translate/ReaderFault.h"

namespace MCKestrel_800 {

std::vector<std::string> ModelFactory::fModelNames;

namespace {

/// Guards fModelNames. Loading alone takes it, for as long as a copy of the list takes.
std::mutex& NamesMutex() {
  static std::mutex mutex;
  return mutex;
}

std::string& LoadError() {
  struct Own {
    std::string text;
  };
  return ThreadObject<Own>().text;
}

/// The names that one load works with. Its translator is offered this list, and another load may read a names
/// file meanwhile, so a copy it must be even where the list is the factory's own.
std::vector<std::string> CopyNames(const std::vector<std::string>& names) {
  if (&names != &ModelFactory::fModelNames) return names;
  const std::lock_guard<std::mutex> lock(NamesMutex());
  return names;
}

std::vector<std::string> ReadNamesFile(const std::string& fileName) {
  std::vector<std::string> names;
  ReadModelNames(fileName, names);
  const std::lock_guard<std::mutex> lock(NamesMutex());
  ModelFactory::fModelNames = names;
  return names;
}

std::unique_ptr<ScoreTranslator> MakeTranslator(const FoundModel& model, std::vector<std::string>& names) {
  ModelLibrary library(model.tag);
  std::unique_ptr<ScoreTranslator> translator = library.MakeTranslator(names);
  if (translator == nullptr) {
    LoadError() = library.GetLastErrorText();
    FailAt(model.element, KestrelException::kUnsupported,
           "Doesn't Support " + model.tag + "  Model: No Required dll or lib available!");
  }
  return translator;
}

/// Where the stream stands; -1 when it cannot be set back. Asked of its buffer, because a stream that a host
/// has set to throw throws something of its own when it is at its end or cannot be set.
std::istream::pos_type PositionOf(std::istream& in) {
  if (in.rdbuf() == nullptr || !in.good()) return std::istream::pos_type(-1);
  try {
    return in.rdbuf()->pubseekoff(0, std::ios_base::cur, std::ios_base::in);
  } catch (...) {
    return std::istream::pos_type(-1);
  }
}

bool SetBack(std::istream& in, std::istream::pos_type start) {
  if (start == std::istream::pos_type(-1)) return false;
  try {
    if (in.rdbuf()->pubseekpos(start, std::ios_base::in) != start) return false;
    in.clear();
    return true;
  } catch (...) {
    return false;
  }
}

/// Offers the whole stream to a translator that takes two arguments. Null when it is none or the stream
/// cannot be set back to `start`.
ScoreModel* ParseWithTwoArguments(ScoreTranslator& translator, std::istream& in, std::istream::pos_type start,
                                  const std::string& arg, const std::string& secondArg) {
  auto* base = dynamic_cast<BaseTranslator*>(&translator);
  return base != nullptr && SetBack(in, start) ? base->ParseFromTree(in, arg, secondArg) : nullptr;
}

// Every document is read into a tree, a "NearestNeighborModel" too. Scanning the stream for that one element
// before would read each document twice, and could not be done at all to a stream that cannot be set back; a
// translator gets the whole document through its root element as it is.
ScoreModel* MakeModel(std::istream& in, std::vector<std::string> names, const std::string& arg,
                      const std::string* secondArg) {
  LoadError().clear();
  const std::istream::pos_type start = secondArg != nullptr ? PositionOf(in) : std::istream::pos_type(-1);
  const std::unique_ptr<ParsedDocument> document = ReadDocument(in);
  const FoundModel found = FindModel(document->GetRoot(), names);
  const std::unique_ptr<ScoreTranslator> translator = MakeTranslator(found, names);
  if (secondArg != nullptr) {
    ScoreModel* model = ParseWithTwoArguments(*translator, in, start, arg, *secondArg);
    if (model != nullptr) return model;
  }
  return translator->ParseFromTree(document->GetRoot(), arg);
}

ScoreModel* MakeModelFromFile(const std::string& fileName, const std::string& namesFileName,
                              const std::string& arg, const std::string* secondArg) {
  LoadError().clear();
  std::vector<std::string> names = ReadNamesFile(namesFileName);
  std::ifstream in;
  if (!MCXML_800::ExtNameStr(fileName).Open(in)) Fail(KestrelException::kFile, "Could not open model file");
  return MakeModel(in, std::move(names), arg, secondArg);
}

}  // namespace

ScoreModel* ModelFactory::MakeModelFromXML(std::istream& in, const std::vector<std::string>& modelNames,
                                           const std::string& arg) {
  return MakeModel(in, CopyNames(modelNames), arg, nullptr);
}

ScoreModel* ModelFactory::MakeModelFromXML(std::istream& in, const std::vector<std::string>& modelNames,
                                           const std::string& arg, const std::string& secondArg) {
  return MakeModel(in, CopyNames(modelNames), arg, &secondArg);
}

ScoreModel* ModelFactory::MakeModelFromXML(const std::string& fileName, const std::string& namesFileName,
                                           const std::string& arg) {
  return MakeModelFromFile(fileName, namesFileName, arg, nullptr);
}

ScoreModel* ModelFactory::MakeModelFromXML(const std::string& fileName, const std::string& namesFileName,
                                           const std::string& arg, const std::string& secondArg) {
  return MakeModelFromFile(fileName, namesFileName, arg, &secondArg);
}

ScoreModel* ModelFactory::MakeModelFromXML(void* modelElement, const std::vector<std::string>& modelNames,
                                           ScoreDictionary* dictionary, const std::string& arg,
                                           ScoreDictionary* resultDictionary) {
  LoadError().clear();
  auto* element = static_cast<xercesc::DOMElement*>(modelElement);
  std::vector<std::string> names = CopyNames(modelNames);
  const std::unique_ptr<ScoreTranslator> translator = MakeTranslator(ModelOfElement(element, names), names);
  return translator->ParseFromTree(element, dictionary, resultDictionary, arg);
}

ScoreModel* ModelFactory::MakeModelFromXML(void* modelElement, const std::vector<std::string>& modelNames,
                                           void* otherElement, const std::string& arg) {
  LoadError().clear();
  auto* element = static_cast<xercesc::DOMElement*>(modelElement);
  std::vector<std::string> names = CopyNames(modelNames);
  const std::unique_ptr<ScoreTranslator> translator = MakeTranslator(ModelOfElement(element, names), names);
  return translator->ParseFromTree(element, static_cast<xercesc::DOMElement*>(otherElement), arg);
}

std::string ModelFactory::GetLastLoadError() {
  return LoadError();
}

}  // namespace MCKestrel_800
