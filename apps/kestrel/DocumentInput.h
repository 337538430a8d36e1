// A document that may be needed twice.

#ifndef KESTREL_APPS_KESTREL_DOCUMENTINPUT_H
#define KESTREL_APPS_KESTREL_DOCUMENTINPUT_H

#include <istream>
#include <memory>
#include <string>

namespace kestrel_program {

/// Gives a document's bytes from the start as often as they are asked for. The standard input comes only
/// once, so that what was read of it is kept in memory; a file is opened again.
class DocumentInput {
 public:
  /// A UTF-8 path, or "-" for the standard input. Nothing is opened yet.
  explicit DocumentInput(const std::string& path);
  ~DocumentInput();
  DocumentInput(const DocumentInput&) = delete;
  DocumentInput& operator=(const DocumentInput&) = delete;

  /// What messages call it: the path, or "standard input".
  const std::string& GetName() const { return name_; }

  /// The document from its start; of the standard input, from the second time on, as far as it was read at
  /// first. Valid until the next call. Errors: ProgramError kInputOutput when a file cannot be opened.
  std::istream& Open();

  /// Whether the text stands anywhere in the document. The text is ASCII, and so must the document's encoding
  /// be as far as it goes. Ends what Open gave. Errors: as of Open.
  bool Holds(const std::string& text);

 private:
  class KeepingBuffer;

  std::string path_;
  std::string name_;
  std::unique_ptr<KeepingBuffer> kept_;  ///< of the standard input
  std::unique_ptr<std::istream> stream_;
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_DOCUMENTINPUT_H
