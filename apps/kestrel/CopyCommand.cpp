#include "apps/kestrel/CopyCommand.h"

#include <memory>
#include <numeric>
#include <vector>

#include "apps/kestrel/InputFile.h"
#include "apps/kestrel/KeptColumns.h"
#include "apps/kestrel/OutputFile.h"
#include "apps/kestrel/ProgramError.h"
#include "apps/kestrel/TableReader.h"

namespace kestrel_program {

ExitCode CopyTable(const CopyOptions& options) {
  InputFile input(options.data);
  TableReader table(input, options.delimiter);
  const std::size_t width = table.GetHeader().size();
  OutputFile output(options.output);
  const std::unique_ptr<TableWriter> writer =
      TableWriter::Make(options.format, NameOutputColumns(table.GetHeader(), {}), output.GetBuffer());
  writer->BeginTable();
  std::vector<std::size_t> columns(width);
  std::iota(columns.begin(), columns.end(), std::size_t{0});
  table.ReadRows(columns, [&](const TableRow& row) {
    if (!row.HasAllCells())
      throw ProgramError(kData, table.DescribePlace(row.GetLine()) + row.DescribeCellCount());
    for (std::size_t column = 0; column < width; ++column) {
      const std::string_view cell = row.GetCell(column);
      if (cell.empty()) {
        writer->AddMissing();
      } else {
        writer->AddText(cell);
      }
    }
    writer->EndRow();
    output.FlushIfFull();
    return true;
  });
  output.Finish();
  return kDone;
}

}  // namespace kestrel_program
