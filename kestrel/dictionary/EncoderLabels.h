// The display labels that every encoder may carry.

#ifndef KESTREL_DICTIONARY_ENCODERLABELS_H
#define KESTREL_DICTIONARY_ENCODERLABELS_H

#include <algorithm>
#include <cstddef>
#include <string>
#include <vector>

namespace MCKestrel_800 {

/// Room that a caller asks for in advance is made up to this many categories; a wrong count must not exhaust
/// the memory.
inline std::size_t EncoderRoom(int n) {
  return n <= 0 ? 0 : std::min<std::size_t>(static_cast<std::size_t>(n), 65536);
}

/// Sets the label of a code below `categories` or below the number of labels; any other code is ignored, so
/// that a wild code cannot make the list grow without bound.
inline void SetEncoderLabel(std::vector<std::string>& labels, int categories, int code,
                            const std::string& label) {
  if (code < 0) return;
  const auto position = static_cast<std::size_t>(code);
  if (position >= labels.size()) {
    if (code >= categories) return;
    labels.resize(position + 1);
  }
  labels[position] = label;
}

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_ENCODERLABELS_H
