// What the program writes it reads back as it was, and no bytes at all bring its reader down.

#include <gtest/gtest.h>

#include <algorithm>
#include <numeric>
#include <random>

#include "apps/kestrel/InputFile.h"
#include "apps/kestrel/ProgramError.h"
#include "apps/kestrel/TableReader.h"
#include "apps/kestrel/TableWriter.h"
#include "tests/support/TempFolder.h"

namespace kestrel_tests {
namespace {

using namespace kestrel_program;
using Rows = std::vector<std::vector<std::string>>;

/// Texts of the characters that mean something in tables, and some that do not.
std::string RandomText(std::mt19937& random, std::size_t longest) {
  static const char kCharacters[] = {'a', 'b',  ',',  ';', '\t', '|',    '"',
                                     '"', '\n', '\r', ' ', '\0', '\xC3', '\xA4'};
  std::string text(random() % (longest + 1), ' ');
  for (char& c : text)
    c = kCharacters[random() % sizeof kCharacters];
  return text;
}

Rows ReadAll(const std::string& path, std::size_t width) {
  InputFile input(path);
  TableReader reader(input, ',');
  EXPECT_EQ(reader.GetHeader().size(), width);
  std::vector<std::size_t> columns(reader.GetHeader().size());
  std::iota(columns.begin(), columns.end(), std::size_t{0});
  Rows rows;
  reader.ReadRows(columns, [&](const TableRow& row) {
    EXPECT_TRUE(row.HasAllCells());
    rows.emplace_back();
    for (const std::size_t column : columns)
      rows.back().emplace_back(row.GetCell(column));
    return true;
  });
  return rows;
}

TEST(Tables, ReadBackAsTheyWereWritten) {
  std::mt19937 random(8);
  const TempFolder folder;
  for (const std::size_t width : {1u, 2u, 7u}) {
    std::vector<std::string> header;
    for (std::size_t column = 0; column < width; ++column) {
      header.push_back("c" + std::to_string(column) + RandomText(random, 5));
      // Zero bytes in a header are taken for a file that is no text.
      std::string& name = header.back();
      name.erase(std::remove(name.begin(), name.end(), '\0'), name.end());
    }
    Rows rows(500, std::vector<std::string>(width));
    std::string text;
    const auto writer = TableWriter::Make(TableWriter::Format::kCsv, header, text);
    writer->BeginTable();
    for (std::vector<std::string>& row : rows) {
      for (std::string& cell : row) {
        cell = RandomText(random, 8);
        writer->AddText(cell);
      }
      writer->EndRow();
    }
    EXPECT_EQ(ReadAll(folder.Write("t.csv", text), width), rows);
  }
}

TEST(Tables, OfAnyBytesAreReadOrRefused) {
  std::mt19937 random(8);
  const TempFolder folder;
  int read = 0;
  int refused = 0;
  for (int i = 0; i < 2000; ++i) {
    InputFile input(folder.Write("t.csv", RandomText(random, 60)));
    try {
      TableReader reader(input, 0);
      const std::size_t width = reader.GetHeader().size();
      ASSERT_GT(width, 0u);
      reader.ReadRows({0, width - 1}, [&](const TableRow& row) {
        EXPECT_GT(row.GetCellCount(), 0u);
        EXPECT_LE(row.GetCell(0).size() + row.GetCell(width - 1).size(), 120u);
        return true;
      });
      ++read;
    } catch (const ProgramError& fault) {
      EXPECT_EQ(fault.GetCode(), kData);
      ++refused;
    }
  }
  EXPECT_GT(read, 100);
  EXPECT_GT(refused, 100);
}

}  // namespace
}  // namespace kestrel_tests
