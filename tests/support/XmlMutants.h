// Breaks a well-formed document in every small way: what a reader must survive.

#ifndef KESTREL_TESTS_SUPPORT_XMLMUTANTS_H
#define KESTREL_TESTS_SUPPORT_XMLMUTANTS_H

#include <cctype>
#include <cstddef>
#include <string>
#include <vector>

namespace kestrel_test {

/// A document that is no longer what it was, and how it came about.
struct Mutant {
  std::string why;
  std::string document;
};

/// Where the elements and attributes of a document stand. Made for the documents of these tests: no CDATA, no
/// internal subset, no ">" inside attributes.
class XmlMap {
 public:
  struct Attribute {
    size_t start;  ///< of the blank before it
    size_t valueStart;
    size_t valueEnd;
    size_t end;
    std::string name;
  };
  struct Element {
    size_t start;
    size_t openEnd;
    size_t closeStart;  ///< of "</name>", or `openEnd` when the element has no end tag
    size_t end;
    std::string name;
  };

  explicit XmlMap(const std::string& text) {
    std::vector<size_t> open;
    for (size_t at = text.find('<'); at != std::string::npos; at = text.find('<', at)) {
      if (text.compare(at, 4, "<!--") == 0) {
        at = text.find("-->", at);
      } else if (text[at + 1] == '?') {
        at = text.find("?>", at);
      } else if (text[at + 1] == '/') {
        Element& element = elements_[open.back()];
        open.pop_back();
        element.closeStart = at;
        at = text.find('>', at) + 1;
        element.end = at;
      } else {
        const size_t end = text.find('>', at) + 1;
        elements_.push_back({at, end, end, end, NameAt(text, at + 1)});
        ReadAttributes(text, at, end);
        if (text[end - 2] != '/') open.push_back(elements_.size() - 1);
        at = end;
      }
    }
  }

  const std::vector<Element>& Elements() const { return elements_; }
  const std::vector<Attribute>& Attributes() const { return attributes_; }

 private:
  static std::string NameAt(const std::string& text, size_t start) {
    size_t end = start;
    while (std::isalnum(static_cast<unsigned char>(text[end])) || text[end] == '-' || text[end] == '_')
      ++end;
    return text.substr(start, end - start);
  }

  void ReadAttributes(const std::string& text, size_t start, size_t end) {
    for (size_t quote = text.find("=\"", start); quote < end; quote = text.find("=\"", start)) {
      const size_t blank = text.rfind(' ', quote);
      const size_t close = text.find('"', quote + 2);
      attributes_.push_back({blank, quote + 2, close, close + 1, text.substr(blank + 1, quote - blank - 1)});
      start = close + 1;
    }
  }

  std::vector<Element> elements_;
  std::vector<Attribute> attributes_;
};

/// The document cut off after every `step` bytes.
inline std::vector<Mutant> Truncated(const std::string& text, size_t step) {
  std::vector<Mutant> mutants;
  for (size_t length = 0; length < text.size(); length += step) {
    mutants.push_back({"cut off after " + std::to_string(length) + " bytes", text.substr(0, length)});
  }
  return mutants;
}

/// Each `step`-th attribute dropped, emptied and set to "x" in turn.
inline std::vector<Mutant> WithBrokenAttributes(const std::string& text, size_t step) {
  std::vector<Mutant> mutants;
  const XmlMap map(text);
  for (size_t i = 0; i < map.Attributes().size(); i += step) {
    const XmlMap::Attribute& attribute = map.Attributes()[i];
    const std::string where = attribute.name + " at byte " + std::to_string(attribute.start);
    std::string dropped = text;
    dropped.erase(attribute.start, attribute.end - attribute.start);
    mutants.push_back({where + " dropped", dropped});
    for (const char* value : {"", "x"}) {
      std::string changed = text;
      changed.replace(attribute.valueStart, attribute.valueEnd - attribute.valueStart, value);
      mutants.push_back({where + " set to \"" + value + "\"", changed});
    }
  }
  return mutants;
}

/// Each `step`-th element renamed, removed, doubled and robbed of its end tag in turn.
inline std::vector<Mutant> WithBrokenElements(const std::string& text, size_t step) {
  std::vector<Mutant> mutants;
  const XmlMap map(text);
  for (size_t i = 0; i < map.Elements().size(); i += step) {
    const XmlMap::Element& element = map.Elements()[i];
    const std::string where = element.name + " at byte " + std::to_string(element.start);
    const size_t length = element.end - element.start;
    std::string renamed = text;
    if (element.closeStart != element.openEnd || element.end != element.openEnd) {
      renamed.replace(element.closeStart + 2, element.name.size(), "Renamed");
    }
    renamed.replace(element.start + 1, element.name.size(), "Renamed");
    mutants.push_back({where + " renamed", renamed});
    std::string removed = text;
    removed.erase(element.start, length);
    mutants.push_back({where + " removed", removed});
    std::string doubled = text;
    doubled.insert(element.end, text.substr(element.start, length));
    mutants.push_back({where + " doubled", doubled});
    if (element.end != element.openEnd) {
      std::string unclosed = text;
      unclosed.erase(element.closeStart, element.end - element.closeStart);
      mutants.push_back({where + " not closed", unclosed});
    }
  }
  return mutants;
}

}  // namespace kestrel_test

#endif  // KESTREL_TESTS_SUPPORT_XMLMUTANTS_H
