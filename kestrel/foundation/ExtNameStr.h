// The name of a file in every encoding that somebody wants it in.

#ifndef KESTREL_FOUNDATION_EXTNAMESTR_H
#define KESTREL_FOUNDATION_EXTNAMESTR_H

#include <fstream>
#include <ios>
#include <string>

#include "kestrel/foundation/MultibyteConversions.h"
#include "kestrel/platform/Export.h"

namespace MCXML_800 {

/// Holds one file or path name. Callers give names in UTF-8; the name is kept as it was given, and each other
/// form is made when it is asked for. On Linux names are bytes to the system: one that is no UTF-8 reaches it
/// unchanged.
///
/// The forms:
/// - U8: UTF-8.
/// - CP: the current code page; on Linux that of the C locale.
/// - System: what the system's own functions take: UTF-8 on Linux whatever the locale, the code page on
/// Windows.
/// - U16: UTF-16.
/// - Generic: what the library's narrow text is, by the UTF-8 mode of the moment.
/// The forms in Z are terminated and belong to the object: a pointer is good until the same form is asked for
/// again or the object changes or goes.
///
/// Threads: one at a time, since the object keeps what it has made.
class KESTREL_API ExtNameStr {
 public:
  ExtNameStr();
  /// Null counts as empty.
  ExtNameStr(const char* utf8Name);
  ExtNameStr(const std::string& utf8Name);
  ExtNameStr(const ExtNameStr&);
  ExtNameStr(ExtNameStr&&) noexcept;
  ExtNameStr& operator=(const ExtNameStr&);
  ExtNameStr& operator=(ExtNameStr&&) noexcept;
  ~ExtNameStr();

  /// Names that come in another form.
  static ExtNameStr FromCP(const std::string& name);
  static ExtNameStr FromSystem(const std::string& name);
  static ExtNameStr FromU16(const std::u16string& name);
  static ExtNameStr FromU16(const VEXAMBU16String& name);
  static ExtNameStr FromGeneric(const std::string& name);

  std::string GetU8() const;
  std::string GetCP() const;
  std::string GetSystem() const;
  VEXAMBU16String GetU16() const;

  const char* GetU8Z() const;
  const char* GetCPZ() const;
  const char* GetSystemZ() const;
  const unsigned short* GetU16Z() const;
  const char* GetGenericZ() const;

  bool Empty() const { return name_.empty(); }

  /// The VEXAMBStatus of the last conversion of this name, from the form it came in or into another: 0, or
  /// kVEXAMBSubstituted when the form lacks one of its characters, so that it names another file.
  int ErrorCode() const { return error_; }

  /// Opens the file. False, with `in` not open, when it cannot be opened, when the system has no such name,
  /// and for a name with a zero byte inside, which the system would take for a shorter one.
  bool Open(std::ifstream& in, std::ios::openmode mode = std::ios::in | std::ios::binary) const;

 private:
  std::string name_;  // UTF-8
  mutable std::string cp_, system_, generic_;
  mutable VEXAMBU16String u16_;
  mutable int error_ = kVEXAMBOk;
};

}  // namespace MCXML_800

#endif  // KESTREL_FOUNDATION_EXTNAMESTR_H
