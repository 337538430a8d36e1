// The library of one kind of model: its name, and what is asked of it.

#ifndef KESTREL_MODEL_MODELLIBRARY_H
#define KESTREL_MODEL_MODELLIBRARY_H

#include <memory>
#include <string>
#include <vector>

#include "kestrel/platform/Export.h"
#include "kestrel/platform/SharedLibrary.h"

namespace MCKestrel_800 {

class ScoreTranslator;

/// Finds the library of a model element by the element's tag and gets a translator from it. Stays on one
/// thread; the library itself stays loaded when this object goes.
class KESTREL_API ModelLibrary {
 public:
  /// Nothing is loaded yet.
  explicit ModelLibrary(const std::string& tag);
  ~ModelLibrary();

  /// The library's file name: the tag, "800r" and the system's suffix. Empty for a tag that would make more
  /// of it than a name, one that is empty or has a folder's or a drive's mark in it.
  static std::string FileNameFor(const std::string& tag);

  /// Loads the library and calls its entry point "GiveMyTranslator". Offers the translator the names through
  /// the entry point "PassModelNames" where the library has one; it may keep the pointer as long as it lives.
  /// A library that has the entry point "GiveMyVersion" must give KESTREL_PLUGIN_VERSION there; one without
  /// it is taken as it is.
  /// Null, with the error text set, when there is no such library, it cannot be loaded, is built for another
  /// version, or gives no translator. What the entry points throw passes through.
  std::unique_ptr<ScoreTranslator> MakeTranslator(std::vector<std::string>& names);

  /// Why MakeTranslator gave null, in the system's words where it was the system; else empty.
  const std::string& GetLastErrorText() const { return last_error_; }

 private:
  SharedLibrary library_;
  std::string last_error_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_MODEL_MODELLIBRARY_H
