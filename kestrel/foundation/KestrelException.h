// The one exception of the library: a document, or a file that it needs, cannot be read.

#ifndef KESTREL_FOUNDATION_KESTRELEXCEPTION_H
#define KESTREL_FOUNDATION_KESTRELEXCEPTION_H

#include <string>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// A code, the text that is shown to the user and, when the fault lies at a known place of the document, that
/// place. It derives from no standard exception; callers catch it by its own type.
class KESTREL_API KestrelException {
 public:
  /// What kind of failure it is. docs/errors.md lists the texts of each.
  enum ExceptionCode : int {
    kNone = 0,             ///< of a default-constructed exception
    kStructure = 1,        ///< an element or attribute where it is not allowed, or a required one absent
    kFile = 2,             ///< a file could not be opened or read
    kConversion = 3,       ///< a text could not be converted into the required value
    kMissingElement = 4,   ///< a required list, child or document is missing
    kUnsupported = 5,      ///< a construct or model that the library does not support
    kInvalidDocument = 6,  ///< not well-formed, or an attribute outside its allowed set
    kInvalidValue = 7,     ///< a value that is not valid for its variable
    kUnknownVariable = 8,  ///< a name that is unknown to, or already in, the dictionary
    kInvalidOperator = 9,  ///< an operator that is not valid where it stands
    kReserved = 10,        ///< never raised by this library
    kInvalidType = 11,     ///< a variable type or operator that does not fit its use
    kInconsistentDictionary = 12,  ///< a data dictionary that contradicts itself
  };

  KestrelException();
  KestrelException(ExceptionCode code, const std::string& message);
  KestrelException(const KestrelException& other);
  KestrelException& operator=(const KestrelException& other);
  virtual ~KestrelException();

  int GetErrorCode() const { return code_; }
  /// Valid as long as the exception lives.
  const std::string& GetErrorMessage() const { return message_; }

  /// Where in the document the fault lies, both counted from 1. 0 means that the place is not known.
  void SetPlace(unsigned line, unsigned column);
  unsigned GetLine() const { return line_; }
  unsigned GetColumn() const { return column_; }

 private:
  ExceptionCode code_ = kNone;
  std::string message_;
  unsigned line_ = 0;
  unsigned column_ = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_FOUNDATION_KESTRELEXCEPTION_H
