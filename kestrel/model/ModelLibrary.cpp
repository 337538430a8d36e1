#include "kestrel/model/ModelLibrary.h"

#include "kestrel/translate/ScoreTranslator.h"

namespace MCKestrel_800 {
namespace {

using GiveVersion = const char* (*)();
using GiveTranslator = ScoreTranslator* (*)();
using TakeModelNames = void (*)(ScoreTranslator* translator, std::vector<std::string>* names);

/// The marks of folders and drives on every system, and what would end a name early. An element's tag holds
/// none of them but the colon, yet a library's name must not depend on who chose the tag.
constexpr char kNotInFileNames[] = {'/', '\\', ':', '\0'};

/// Why a library cannot be used that tells what it was built for; empty for one that does not tell.
std::string VersionFault(SharedLibrary& library) {
  const auto give = reinterpret_cast<GiveVersion>(library.FindSymbol("GiveMyVersion"));
  if (give == nullptr) return std::string();
  const char* const version = give();
  if (version == nullptr) return library.GetFileName() + ": GiveMyVersion gave no version.";
  if (std::string(version) == KESTREL_PLUGIN_VERSION) return std::string();
  return library.GetFileName() + ": built for Kestrel " + version + ", this is " KESTREL_PLUGIN_VERSION ".";
}

/// Some systems' words do not tell what they are about.
std::string NamedText(const std::string& name, const std::string& text) {
  return text.find(name) != std::string::npos ? text : name + ": " + text;
}

}  // namespace

ModelLibrary::ModelLibrary(const std::string& tag) : library_(FileNameFor(tag)) {}

ModelLibrary::~ModelLibrary() = default;

std::string ModelLibrary::FileNameFor(const std::string& tag) {
  const bool usable = !tag.empty() && tag[0] != '.' &&
                      tag.find_first_of(kNotInFileNames, 0, sizeof kNotInFileNames) == std::string::npos;
  return usable ? SharedLibrary::WithSuffix(tag + "800" + "r") : std::string();
}

std::unique_ptr<ScoreTranslator> ModelLibrary::MakeTranslator(std::vector<std::string>& names) {
  last_error_.clear();
  // The system takes an empty name for the program itself.
  if (library_.GetFileName().empty()) {
    last_error_ = "The element's tag cannot be part of a library's name.";
    return nullptr;
  }
  if (!library_.Load()) {
    last_error_ = NamedText(library_.GetFileName(), library_.GetLastErrorText());
    return nullptr;
  }
  // Before anything of the library is called that has to do with objects.
  last_error_ = VersionFault(library_);
  if (!last_error_.empty()) return nullptr;
  const char entry[] = "GiveMyTranslator";
  const auto give = reinterpret_cast<GiveTranslator>(library_.FindSymbol(entry));
  if (give == nullptr) {
    last_error_ = NamedText(library_.GetFileName(), NamedText(entry, library_.GetLastErrorText()));
    return nullptr;
  }
  std::unique_ptr<ScoreTranslator> translator(give());
  if (translator == nullptr) {
    last_error_ = library_.GetFileName() + ": GiveMyTranslator gave no translator.";
    return nullptr;
  }
  const auto take_names = reinterpret_cast<TakeModelNames>(library_.FindSymbol("PassModelNames"));
  if (take_names != nullptr) take_names(translator.get(), &names);
  return translator;
}

}  // namespace MCKestrel_800
