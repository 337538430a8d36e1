// Texts from a user's files inside messages.

#ifndef KESTREL_APPS_KESTREL_SHOWNTEXT_H
#define KESTREL_APPS_KESTREL_SHOWNTEXT_H

#include <string>
#include <string_view>

namespace kestrel_program {

/// The text as a message may hold it: cut to about 60 bytes (at a character, with "..." behind it), control
/// characters as question marks, so that a message stays one line and cannot steer a terminal.
inline std::string ShownText(std::string_view text) {
  constexpr std::size_t kLongest = 60;
  std::size_t length = text.size();
  if (length > kLongest) {
    length = kLongest;
    while (length > 0 && (static_cast<unsigned char>(text[length]) & 0xC0u) == 0x80u)
      --length;
  }
  std::string shown(text.substr(0, length));
  for (char& c : shown) {
    if (static_cast<unsigned char>(c) < 0x20 || c == 0x7F) c = '?';
  }
  return length < text.size() ? shown + "..." : shown;
}

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_SHOWNTEXT_H
