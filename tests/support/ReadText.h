// Documents and elements from text, as readers get them.

#ifndef KESTREL_TESTS_SUPPORT_READTEXT_H
#define KESTREL_TESTS_SUPPORT_READTEXT_H

#include <memory>
#include <sstream>
#include <string>

#include "kestrel/translate/DocumentReader.h"

namespace kestrel_tests {

inline std::unique_ptr<MCKestrel_800::ParsedDocument> ReadText(const std::string& text) {
  std::istringstream in(text);
  return MCKestrel_800::ReadDocument(in);
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_READTEXT_H
