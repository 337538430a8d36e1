// The elements of an `Array`, one after the other, as its text writes them.

#ifndef KESTREL_TRANSLATE_ARRAYTEXT_H
#define KESTREL_TRANSLATE_ARRAYTEXT_H

#include <xercesc/util/XercesDefs.hpp>

#include <cstddef>
#include <string>

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

/// Walks the text of an array from left to right.
///   A blank ends an element. A line feed is skipped and ends nothing, since long lines are broken anywhere.
///   Double quotes hold an element of any characters, also of none; it is taken as it stands, with the
///   backslash before a quote that belongs to it.
///   A backslash and a quote outside of quotes are skipped.
class ArrayText {
 public:
  explicit ArrayText(const xercesc::DOMElement* array);

  /// Replaces `element` by the next one; false, when there is none.
  bool Next(std::u16string& element);

 private:
  void ReadQuoted(std::u16string& element);

  std::u16string text_;
  std::size_t at_ = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_ARRAYTEXT_H
