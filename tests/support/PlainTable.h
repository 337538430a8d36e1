// Reads the small comma separated tables that tests compare with: a header line, no quotes.

#ifndef KESTREL_TESTS_SUPPORT_PLAINTABLE_H
#define KESTREL_TESTS_SUPPORT_PLAINTABLE_H

#include <fstream>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

namespace kestrel_tests {

struct PlainTable {
  std::vector<std::string> header;
  std::vector<std::vector<std::string>> rows;
};

inline std::vector<std::string> SplitAtCommas(const std::string& line) {
  std::vector<std::string> cells(1);
  for (const char c : line) {
    if (c == ',') {
      cells.emplace_back();
    } else if (c != '\r') {
      cells.back() += c;
    }
  }
  return cells;
}

inline PlainTable ParsePlainTable(std::istream& in) {
  PlainTable table;
  std::string line;
  while (std::getline(in, line)) {
    std::vector<std::string> cells = SplitAtCommas(line);
    if (table.header.empty()) {
      table.header = cells;
    } else if (cells.size() != table.header.size()) {
      throw std::runtime_error("a row has another number of cells than the header: " + line);
    } else {
      table.rows.push_back(cells);
    }
  }
  return table;
}

inline PlainTable ReadPlainTable(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  if (!in) throw std::runtime_error("cannot open " + path);
  return ParsePlainTable(in);
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_PLAINTABLE_H
