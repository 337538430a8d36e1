// Writes the program's answer row by row: comma separated values, or one JSON object a line.

#ifndef KESTREL_APPS_KESTREL_TABLEWRITER_H
#define KESTREL_APPS_KESTREL_TABLEWRITER_H

#include <array>
#include <cstdint>
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
  /// One cell for several texts: with " > " between them where a cell can only be a text.
  virtual void AddList(const std::vector<std::string_view>& texts) = 0;
  virtual void EndRow() = 0;
};

/// Appends the shortest text that reads back to the same number.
void AppendNumber(double number, std::string& out);

/// The same texts, the latest of them remembered: a probability is that of a category as well, and where all
/// inputs are categories the answers are few. Finding digits costs ten times as much as finding them here.
class NumberTexts {
 public:
  /// Valid until the next call.
  std::string_view Get(double number);

 private:
  struct Entry {
    std::uint64_t bits = 0;
    std::size_t length = 0;  ///< 0: nothing is remembered here
    char text[32];
  };
  static constexpr unsigned kIndexBits = 7;

  std::array<Entry, std::size_t{1} << kIndexBits> entries_{};
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_TABLEWRITER_H
