// Converting between parser text and one named encoding, by a transcoder of the parser library.

#ifndef KESTREL_FOUNDATION_PLIANTTRANSCODER_H
#define KESTREL_FOUNDATION_PLIANTTRANSCODER_H

#include <xercesc/util/XercesDefs.hpp>

#include <cstddef>
#include <memory>
#include <string>

#include "kestrel/platform/Export.h"

XERCES_CPP_NAMESPACE_BEGIN
class XMLTranscoder;
XERCES_CPP_NAMESPACE_END

namespace MCXML_800 {

/// Holds the parser library's transcoder for one encoding.
///
/// The parser library must be initialised before, and must stay so for as long as the object lives: the class
/// does not do it, since whoever reads documents has done it. Without it, and for an encoding that is
/// unknown, null, or has shift states (such as "ISO-2022-JP", whose texts cannot be taken one by one),
/// IsValid is false and every conversion refuses.
///
/// What cannot be converted is replaced: by the encoding's own substitute on the way out, by U+FFFD on the
/// way in. Texts may be of any length; each call starts anew, whatever the one before ended in.
///
/// Threads: one at a time.
class KESTREL_API PliantTranscoder {
 public:
  explicit PliantTranscoder(const char* encoding);
  explicit PliantTranscoder(const std::string& encoding) : PliantTranscoder(encoding.c_str()) {}
  ~PliantTranscoder();
  PliantTranscoder(const PliantTranscoder&) = delete;
  PliantTranscoder& operator=(const PliantTranscoder&) = delete;

  bool IsValid() const { return transcoder_ != nullptr; }

  /// Converts parser text into the encoding. `out` is replaced; a null text counts as empty. False, with an
  /// empty `out`, when the object is not valid. The form with a length takes texts with U+0000 inside.
  bool transcodeTo(const XMLCh* text, std::string& out) const;
  bool transcodeTo(const XMLCh* text, size_t length, std::string& out) const;

  /// Converts narrow text in the encoding into terminated parser text, which the caller frees with
  /// xercesc::XMLString::release. Null when `text` is null or the object is not valid. The form with a length
  /// takes texts with zero bytes inside, which is all texts of a wide encoding such as "UTF-16LE".
  XMLCh* ChangeChar2XML(const char* text) const;
  XMLCh* ChangeChar2XML(const char* text, size_t length) const;

 private:
  bool DecodeWithTranscoder(const char* text, size_t length, std::u16string& out) const;
  std::u16string Decode(const char* text, size_t length) const;

  std::unique_ptr<xercesc::XMLTranscoder> transcoder_;
  std::string encoding_;
  size_t unit_bytes_ = 1;
};

}  // namespace MCXML_800

#endif  // KESTREL_FOUNDATION_PLIANTTRANSCODER_H
