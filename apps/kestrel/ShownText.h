// Texts from a user's files inside messages.

#ifndef KESTREL_APPS_KESTREL_SHOWNTEXT_H
#define KESTREL_APPS_KESTREL_SHOWNTEXT_H

#include <string>
#include <string_view>

namespace kestrel_program {

/// The text as a message may hold it: cut to 60 bytes (at a character, with "..." behind it), control
/// characters and bytes that are no UTF-8 as question marks, so that a message stays one line and cannot
/// steer a terminal.
std::string ShownText(std::string_view text);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_SHOWNTEXT_H
