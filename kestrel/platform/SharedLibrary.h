// Opening a library while the program runs, and finding what it offers.

#ifndef KESTREL_PLATFORM_SHAREDLIBRARY_H
#define KESTREL_PLATFORM_SHAREDLIBRARY_H

#include <string>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// Holds one library by its file name. A loaded library stays in the process when the holder goes, because
/// objects whose code is in it live on; a further holder of the same name then gets it from the system at
/// next to no cost.
///
/// Threads: a holder belongs to one thread; holders on several threads may load the same library at once.
class KESTREL_API SharedLibrary {
 public:
  /// The name is in the system's narrow text, with its suffix. A name without a folder is looked for where
  /// the system keeps libraries, and beside the core library and in the folder of its plug-ins. Nothing is
  /// loaded yet.
  explicit SharedLibrary(const std::string& fileName);
  ~SharedLibrary();
  SharedLibrary(const SharedLibrary&) = delete;
  SharedLibrary& operator=(const SharedLibrary&) = delete;

  /// Loads the library, unless this holder has. False, with the error text set, when the system refuses: the
  /// file is absent, is no library, or needs something that is absent.
  bool Load();

  /// The address of an exported C name, or null, with the error text set, when the library has no such name
  /// or is not loaded.
  void* FindSymbol(const char* name);

  bool IsLoaded() const { return handle_ != nullptr; }
  const std::string& GetFileName() const { return file_name_; }

  /// What the system said about the last failure; empty until there is one.
  const std::string& GetLastErrorText() const { return last_error_; }

  /// Where the libraries of model kinds are installed, in words for the user.
  static const char* GetUsualPlace();

  /// What this system's library names end in: ".dll" or ".so".
  static const char* GetSuffix();

  /// The name with the suffix behind it. A name that has it already, in whatever case, stays as it is; one
  /// that is nothing but the suffix gets another.
  static std::string WithSuffix(const std::string& name);

 private:
  void* handle_ = nullptr;
  std::string file_name_;
  std::string last_error_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLATFORM_SHAREDLIBRARY_H
