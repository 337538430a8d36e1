// Reads the random documents with derived fields, their cases and the answers that an evaluator of its own
// gave. tests/data/derived/make_documents.py says how the file is made and what its cells mean.

#ifndef KESTREL_TESTS_TRANSFORM_RANDOMDOCUMENTS_H
#define KESTREL_TESTS_TRANSFORM_RANDOMDOCUMENTS_H

#include <fstream>
#include <stdexcept>
#include <string>
#include <vector>

namespace kestrel_tests {

struct RandomDocument {
  std::string title;                              ///< for messages
  std::string text;                               ///< the document itself
  std::vector<std::string> given;                 ///< the fields that cases have values for
  std::vector<std::string> derived;               ///< the derived fields in their order
  std::vector<std::vector<std::string>> cases;    ///< for each case a cell for each of `given`
  std::vector<std::vector<std::string>> answers;  ///< and one for each of `derived`
};

inline void SplitAtBar(const std::string& line, std::vector<std::string>& before,
                       std::vector<std::string>& behind) {
  std::vector<std::string>* cells = &before;
  for (size_t at = 0; at <= line.size();) {
    const size_t end = std::min(line.find('\t', at), line.size());
    const std::string cell = line.substr(at, end - at);
    if (cell == "|") {
      cells = &behind;
    } else {
      cells->push_back(cell);
    }
    at = end + 1;
  }
}

inline std::vector<RandomDocument> ReadRandomDocuments(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  if (!in) throw std::runtime_error("cannot open " + path);
  std::vector<RandomDocument> documents;
  std::string line;
  while (std::getline(in, line)) {
    RandomDocument document;
    document.title = line;
    while (std::getline(in, line) && line != "table")
      document.text += line + "\n";
    std::getline(in, line);
    SplitAtBar(line, document.given, document.derived);
    while (std::getline(in, line) && !line.empty()) {
      document.cases.emplace_back();
      document.answers.emplace_back();
      SplitAtBar(line, document.cases.back(), document.answers.back());
      if (document.cases.back().size() != document.given.size() ||
          document.answers.back().size() != document.derived.size()) {
        throw std::runtime_error(document.title + " has a row of another length: " + line);
      }
    }
    documents.push_back(document);
  }
  return documents;
}

/// The text that a cell holds behind its quote.
inline std::string UnescapedText(const std::string& cell) {
  std::string text;
  for (size_t at = 1; at < cell.size(); ++at) {
    if (cell[at] != '\\') {
      text += cell[at];
    } else if (cell.at(++at) == 'x') {
      text += static_cast<char>(std::stoi(cell.substr(at + 1, 2), nullptr, 16));
      at += 2;
    } else {
      text += cell[at] == 't' ? '\t' : cell[at] == 'n' ? '\n' : cell[at];
    }
  }
  return text;
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_TRANSFORM_RANDOMDOCUMENTS_H
