// Bytes as a table: rows that are the same whichever columns are asked for, or the program's own fault.

#include <cstdint>
#include <filesystem>
#include <fstream>
#include <random>
#include <set>
#include <string>
#include <system_error>
#include <vector>

#include "apps/kestrel/InputFile.h"
#include "apps/kestrel/ProgramError.h"
#include "apps/kestrel/TableReader.h"
#include "fuzz/Check.h"

namespace {

using namespace kestrel_program;
using kestrel_fuzz::Check;

/// The one file that every case is written to, because the reader takes files alone.
class CaseFile {
 public:
  CaseFile() {
    // Several processes fuzz at once.
    const std::string name = "kestrel_fuzz_" + std::to_string(std::random_device()()) + ".csv";
    path_ = std::filesystem::temp_directory_path() / name;
  }
  ~CaseFile() {
    std::error_code ignored;
    std::filesystem::remove(path_, ignored);
  }
  CaseFile(const CaseFile&) = delete;
  CaseFile& operator=(const CaseFile&) = delete;

  std::string Write(const uint8_t* data, size_t size) const {
    std::ofstream out(path_, std::ios::binary);
    out.write(reinterpret_cast<const char*>(data), static_cast<std::streamsize>(size));
    out.close();
    Check(out.good(), "the case's file can be written");
    return path_.u8string();
  }

 private:
  std::filesystem::path path_;
};

struct Row {
  std::uint64_t line = 0;
  std::size_t count = 0;
  std::vector<std::string> cells;  ///< by column of the header; empty for those not asked for
};

struct Table {
  std::vector<std::string> header;
  std::vector<Row> rows;
  std::string fault;
};

/// Reads every `step`th column of the whole table.
Table Read(const std::string& path, char delimiter, std::size_t step) {
  Table table;
  try {
    InputFile input(path);
    TableReader reader(input, delimiter);
    table.header = reader.GetHeader();
    Check(!table.header.empty(), "a header has columns");
    std::vector<std::size_t> columns;
    for (std::size_t column = 0; column < table.header.size(); column += step)
      columns.push_back(column);
    std::uint64_t line = reader.GetHeaderLine();
    reader.ReadRows(columns, [&](const TableRow& row) {
      Check(row.GetLine() > line, "rows come in the order of their lines");
      line = row.GetLine();
      Check(row.GetCellCount() > 0, "a row has cells");
      Check(row.HasAllCells() == (row.GetCellCount() == table.header.size()), "counts agree");
      Check(row.HasAllCells() || !row.DescribeCellCount().empty(), "a wrong count is described");
      Row copy{line, row.GetCellCount(), std::vector<std::string>(table.header.size())};
      for (const std::size_t column : columns)
        copy.cells[column] = std::string(row.GetCell(column));
      table.rows.push_back(copy);
      return true;
    });
  } catch (const ProgramError& fault) {
    Check(fault.GetCode() == kData, "a table's fault is one of its data");
    Check(!fault.GetText().empty(), "a fault has a text");
    table.fault = fault.GetText();
  }
  return table;
}

void CheckHeader(const std::vector<std::string>& header) {
  std::set<std::string> names;
  for (const std::string& name : header)
    Check(name.empty() || names.insert(name).second, "names differ");
}

void CheckSame(const Table& all, const Table& some, std::size_t step) {
  Check(all.header == some.header, "the header is the same");
  Check(all.fault == some.fault, "the fault is the same whichever columns are asked for");
  Check(all.rows.size() == some.rows.size(), "the number of rows is the same");
  for (std::size_t i = 0; i < all.rows.size(); ++i) {
    Check(all.rows[i].line == some.rows[i].line && all.rows[i].count == some.rows[i].count,
          "rows have the same line and count");
    for (std::size_t column = 0; column < all.header.size(); column += step)
      Check(all.rows[i].cells[column] == some.rows[i].cells[column], "cells are the same");
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  static const CaseFile file;
  const std::string path = file.Write(data, size);
  for (const char delimiter : {'\0', ','}) {
    const Table all = Read(path, delimiter, 1);
    CheckHeader(all.header);
    CheckSame(all, Read(path, delimiter, 2), 2);
  }
  return 0;
}
