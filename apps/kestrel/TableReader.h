// Tables in text files: a header line with the columns' names, then a line per case.

#ifndef KESTREL_APPS_KESTREL_TABLEREADER_H
#define KESTREL_APPS_KESTREL_TABLEREADER_H

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace kestrel_program {

class InputFile;

/// One line of the table. Its texts are valid until the function that it was handed to returns.
class TableRow {
 public:
  /// The number of cells that the line has, which need not be the header's.
  std::size_t GetCellCount() const { return count_; }
  bool HasAllCells() const { return count_ == spans_.size(); }

  /// The cell of a column; empty for a column that was not asked for or that the line does not have.
  std::string_view GetCell(std::size_t column) const {
    const Span span = spans_[column];
    return std::string_view(text_.data() + span.begin, span.length);
  }

  /// What is wrong when it is not: "the row has 2 cells where the header has 3".
  std::string DescribeCellCount() const;

  /// The line of the file that the row begins on, from 1. A cell may hold line ends, so a row may be several
  /// lines long.
  std::uint64_t GetLine() const { return line_; }

 private:
  friend class TableReader;
  struct Span {
    std::size_t begin = 0;
    std::size_t length = 0;
  };

  std::string text_;
  std::vector<Span> spans_;  ///< by column of the header
  std::size_t count_ = 0;
  std::uint64_t line_ = 0;
};

/// Reads a table in constant memory.
///
/// What a table is: cells are separated by commas, tabs, semicolons or vertical bars, lines end with LF, CR
/// LF or CR, the last one need not end. A cell in quotation marks may hold separators, line ends and
/// quotation marks written twice. Blanks around a cell, outside of its quotation marks, do not count. Lines
/// without any cell are skipped. A UTF-8 mark at the start is skipped.
///
/// Errors: ProgramError kData with name and line (and the column when it is known) for what is no such table,
/// and for a cell of more than 16 MB, which is what a missing quotation mark looks like.
class TableReader {
 public:
  /// Returns false to read no further.
  using RowFunction = std::function<bool(const TableRow&)>;

  /// The input is not owned.
  /// delimiter  0: the one of the four that occurs most often in the header; the comma when none does.
  TableReader(InputFile& input, char delimiter);
  ~TableReader();
  TableReader(const TableReader&) = delete;
  TableReader& operator=(const TableReader&) = delete;

  /// Reads the header at the first call. At least one column; names other than the empty one are all
  /// different.
  const std::vector<std::string>& GetHeader();
  /// The line of the file that the header begins on; to be called after GetHeader.
  std::uint64_t GetHeaderLine() const { return header_line_; }

  /// Calls the function for each row. `columns` are the positions in the header whose cells it wants.
  /// What the function throws passes through. To be called once, after GetHeader.
  void ReadRows(const std::vector<std::size_t>& columns, const RowFunction& function);

  /// What errors call a place: "FILE:LINE: column NAME: ".
  std::string DescribePlace(std::uint64_t line, std::size_t column) const;
  /// "FILE:LINE: ".
  std::string DescribePlace(std::uint64_t line) const;

 private:
  struct Parser;

  void ReadHead();
  void FeedHeader();
  void TakeHeader();
  void Feed(const char* bytes, std::size_t size);
  void FinishFeeding();
  [[noreturn]] void FailToParse();
  void AddCell(const char* text, std::size_t size);
  void EndRow(int terminator);
  void StoreHeaderCell(std::string_view cell);

  InputFile& input_;
  char delimiter_;
  std::unique_ptr<Parser> parser_;
  std::string head_;           ///< what was read before the rows
  std::size_t head_used_ = 0;  ///< first as far as the header may reach, then as far as it does
  bool input_ended_ = false;
  std::vector<std::string> header_;
  bool header_done_ = false;
  std::uint64_t header_line_ = 0;

  TableRow row_;
  std::vector<char> wanted_;  ///< by column
  const RowFunction* function_ = nullptr;
  bool stopped_ = false;
  std::uint64_t line_ = 1;  ///< the line that the next byte outside of quotation marks is on
  bool after_cr_ = false;   ///< a line feed that comes now belongs to the line end before it
  bool may_hold_line_ends_ = true;
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_TABLEREADER_H
