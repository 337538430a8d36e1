// Attributes and elements as readers of models meet them.

#ifndef KESTREL_PLUGINS_SUPPORT_ATTRIBUTES_H
#define KESTREL_PLUGINS_SUPPORT_ATTRIBUTES_H

#include <xercesc/util/XercesDefs.hpp>

#include <cstddef>
#include <string>

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

/// A finite number. Errors, at the element: code 3 for what is no number, as an absent or empty attribute is
/// none; code 6 for one that is infinite or the system-missing one.
double ReadNumber(const xercesc::DOMElement* element, const char16_t* attribute);
/// The same, but `absent` when the attribute is absent or empty.
double ReadNumberOr(const xercesc::DOMElement* element, const char16_t* attribute, double absent);

/// Throws code 6 at the element: "invalid `attribute` -- `text`".
[[noreturn]] void FailOnAttribute(const xercesc::DOMElement* element, const char16_t* attribute,
                                  const std::string& text);

/// Whether producers add the element for themselves: `Extension`, or a name that begins with "X-" or "x-".
bool IsExtension(const xercesc::DOMElement* element);

/// One word of a vocabulary with its meaning.
template <typename T>
struct Word {
  const char* text;
  T meaning;
};

/// The row of a vocabulary with that text; null when there is none.
template <typename T, std::size_t kSize>
const Word<T>* FindWord(const Word<T> (&vocabulary)[kSize], const std::string& text) {
  for (const Word<T>& word : vocabulary) {
    if (text == word.text) return &word;
  }
  return nullptr;
}

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_ATTRIBUTES_H
