// Writes the program's answer row by row: comma separated values, or one JSON object a line.

#ifndef KESTREL_APPS_KESTREL_TABLEWRITER_H
#define KESTREL_APPS_KESTREL_TABLEWRITER_H

#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace kestrel_program {

/// Appends rows to a text that the caller owns and empties between rows as it likes. A row is given one cell
/// for each column in turn, and ended. Nothing is allocated for a cell, unless a text needs escapes in JSON.
class TableWriter {
 public:
  enum class Format { kCsv, kJsonLines };

  /// The columns' names must be different; there is at least one.
  static std::unique_ptr<TableWriter> Make(Format format, const std::vector<std::string>& columns,
                                           std::string& out);

  virtual ~TableWriter();
  /// Writes what stands before the first row.
  virtual void BeginTable() = 0;
  virtual void AddText(std::string_view text) = 0;
  /// The shortest text that reads back to the same number.
  virtual void AddNumber(double number) = 0;
  virtual void AddMissing() = 0;
  virtual void EndRow() = 0;
};

/// Appends the shortest text that reads back to the same number.
void AppendNumber(double number, std::string& out);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_TABLEWRITER_H
