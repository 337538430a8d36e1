#include "apps/kestrel/TableReader.h"

#include <csv.h>

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <exception>
#include <unordered_set>

#include "apps/kestrel/InputFile.h"
#include "apps/kestrel/ProgramError.h"
#include "apps/kestrel/ShownText.h"

namespace kestrel_program {
namespace {

constexpr std::size_t kBlock = 256 * 1024;
constexpr std::size_t kLongestCell = 16 * 1024 * 1024;
constexpr std::size_t kLongestHeader = 16 * 1024 * 1024;
/// The parser's cell buffer grows by this much; the cost of growing stays small against that of filling.
constexpr std::size_t kCellGrowth = 64 * 1024;

void* GrowCell(void* memory, std::size_t size) {
  return size > kLongestCell + kCellGrowth ? nullptr : std::realloc(memory, size);
}

bool IsLineEnd(char c) {
  return c == '\n' || c == '\r';
}

/// The end of the first line that holds a cell, behind its line end; npos when the text does not reach so
/// far.
std::size_t FindHeaderEnd(const std::string& text) {
  bool quoted = false;
  bool blank = true;
  for (std::size_t at = 0; at < text.size(); ++at) {
    const char c = text[at];
    if (c == '"') {
      quoted = !quoted;
      blank = false;
    } else if (!quoted && IsLineEnd(c)) {
      if (!blank) return at + 1;
    } else if (c != ' ' && c != '\t') {
      blank = false;
    }
  }
  return std::string::npos;
}

/// The candidate that stands most often outside of quotation marks; of equally frequent ones the first.
char FindDelimiter(std::string_view header) {
  // In the order of trust: a tab is hardly ever part of a name.
  constexpr char kCandidates[] = {'\t', ',', ';', '|'};
  std::size_t counts[256] = {};
  bool quoted = false;
  for (const char c : header) {
    if (c == '"') {
      quoted = !quoted;
    } else if (!quoted) {
      ++counts[static_cast<unsigned char>(c)];
    }
  }
  char best = ',';
  std::size_t most = 0;
  for (const char candidate : kCandidates) {
    const std::size_t count = counts[static_cast<unsigned char>(candidate)];
    if (count > most) {
      most = count;
      best = candidate;
    }
  }
  return best;
}

}  // namespace

/// The C parser and what its callbacks need. Nothing may be thrown through it, so what a callback meets waits
/// here.
struct TableReader::Parser {
  Parser() {
    if (csv_init(&csv, CSV_STRICT | CSV_STRICT_FINI | CSV_REPALL_NL) != 0) throw std::bad_alloc();
    csv_set_realloc_func(&csv, GrowCell);
    csv_set_blk_size(&csv, kCellGrowth);
  }
  ~Parser() { csv_free(&csv); }
  Parser(const Parser&) = delete;
  Parser& operator=(const Parser&) = delete;

  static void OnCell(void* text, std::size_t size, void* reader) {
    auto* self = static_cast<TableReader*>(reader);
    if (self->stopped_) return;
    try {
      self->AddCell(static_cast<const char*>(text), size);
    } catch (...) {
      self->parser_->failure = std::current_exception();
      self->stopped_ = true;
    }
  }
  static void OnRow(int terminator, void* reader) {
    auto* self = static_cast<TableReader*>(reader);
    if (self->stopped_) return;
    try {
      self->EndRow(terminator);
    } catch (...) {
      self->parser_->failure = std::current_exception();
      self->stopped_ = true;
    }
  }

  csv_parser csv;
  std::exception_ptr failure;
};

std::string TableRow::DescribeCellCount() const {
  return "the row has " + std::to_string(count_) + (count_ == 1 ? " cell" : " cells") +
         " where the header has " + std::to_string(spans_.size());
}

TableReader::TableReader(InputFile& input, char delimiter)
    : input_(input), delimiter_(delimiter), parser_(std::make_unique<Parser>()) {}

TableReader::~TableReader() = default;

std::string TableReader::DescribePlace(std::uint64_t line) const {
  return input_.GetName() + ":" + std::to_string(line) + ": ";
}

std::string TableReader::DescribePlace(std::uint64_t line, std::size_t column) const {
  std::string place = DescribePlace(line);
  if (column >= header_.size()) return place;
  const std::string& name = header_[column];
  return place + "column " + (name.empty() ? std::to_string(column + 1) : ShownText(name)) + ": ";
}

void TableReader::ReadHead() {
  do {
    const std::size_t before = head_.size();
    head_.resize(before + kBlock);
    head_.resize(before + input_.Read(&head_[before], kBlock));
    input_ended_ = head_.size() < before + kBlock;
    if (before == 0) {
      if (head_.compare(0, 3, "\xEF\xBB\xBF") == 0) head_.erase(0, 3);
      if (head_.compare(0, 2, "\xFF\xFE") == 0 || head_.compare(0, 2, "\xFE\xFF") == 0) {
        throw ProgramError(kData, input_.GetName() + ": the table is written in UTF-16; UTF-8 is expected");
      }
    }
    head_used_ = FindHeaderEnd(head_);
  } while (head_used_ == std::string::npos && !input_ended_ && head_.size() < kLongestHeader);
  if (head_used_ != std::string::npos) return;
  if (!input_ended_) {
    throw ProgramError(kData, DescribePlace(1) +
                                  "the header line has no end within 16 MB; is this a text table, and " +
                                  "does every quotation mark have its closing one?");
  }
  head_used_ = head_.size();
}

const std::vector<std::string>& TableReader::GetHeader() {
  if (header_done_) return header_;
  ReadHead();
  if (delimiter_ == 0) delimiter_ = FindDelimiter(std::string_view(head_).substr(0, head_used_));
  csv_set_delim(&parser_->csv, static_cast<unsigned char>(delimiter_));
  FeedHeader();
  if (!header_done_) {
    throw ProgramError(
        kData, input_.GetName() + ": the table is empty; a line with the names of the columns is expected");
  }
  return header_;
}

// Line by line, because a line of tabs alone is blank or a header of columns without names, as the delimiter
// has it; what follows the header must wait for ReadRows.
void TableReader::FeedHeader() {
  std::size_t begin = 0;
  while (begin < head_.size() && !header_done_) {
    const std::size_t line_end = head_.find_first_of("\r\n", begin);
    const std::size_t end = line_end == std::string::npos ? head_.size() : line_end + 1;
    Feed(head_.data() + begin, end - begin);
    begin = end;
  }
  head_used_ = begin;
  if (!header_done_ && input_ended_) FinishFeeding();
}

void TableReader::TakeHeader() {
  header_done_ = true;
  header_line_ = row_.line_;
  std::unordered_set<std::string_view> seen;
  for (std::size_t column = 0; column < header_.size(); ++column) {
    if (header_[column].find('\0') != std::string::npos) {
      throw ProgramError(kData, DescribePlace(header_line_) +
                                    "this is no text table: there are zero bytes in its first line; is the "
                                    "file compressed, a spreadsheet, or written in UTF-16?");
    }
    if (!header_[column].empty() && !seen.insert(header_[column]).second) {
      throw ProgramError(kData, DescribePlace(header_line_) + "column " + ShownText(header_[column]) +
                                    " is there twice; every column needs a name of its own");
    }
  }
}

void TableReader::ReadRows(const std::vector<std::size_t>& columns, const RowFunction& function) {
  function_ = &function;
  row_.spans_.assign(header_.size(), TableRow::Span());
  wanted_.assign(header_.size(), 0);
  for (const std::size_t column : columns)
    wanted_[column] = 1;
  Feed(head_.data() + head_used_, head_.size() - head_used_);
  std::string block = std::move(head_);
  block.resize(kBlock);
  while (!input_ended_ && !stopped_) {
    const std::size_t got = input_.Read(&block[0], block.size());
    input_ended_ = got < block.size();
    Feed(block.data(), got);
  }
  if (!stopped_) FinishFeeding();
}

void TableReader::Feed(const char* bytes, std::size_t size) {
  if (size == 0) return;
  // Only a cell in quotation marks holds line ends, and most tables have none.
  may_hold_line_ends_ = parser_->csv.quoted != 0 || std::memchr(bytes, '"', size) != nullptr;
  const std::size_t parsed = csv_parse(&parser_->csv, bytes, size, &Parser::OnCell, &Parser::OnRow, this);
  if (parser_->failure) std::rethrow_exception(parser_->failure);
  if (parsed != size && !stopped_) FailToParse();
}

void TableReader::FinishFeeding() {
  may_hold_line_ends_ = true;
  const int outcome = csv_fini(&parser_->csv, &Parser::OnCell, &Parser::OnRow, this);
  if (parser_->failure) std::rethrow_exception(parser_->failure);
  if (outcome != 0 && !stopped_) {
    throw ProgramError(kData, DescribePlace(line_, row_.count_) +
                                  "the quotation mark that opens this cell has no closing one up to the end");
  }
}

void TableReader::FailToParse() {
  const std::string place = DescribePlace(line_, row_.count_);
  if (csv_error(&parser_->csv) == CSV_ENOMEM) {
    throw ProgramError(kData,
                       place + "this cell has more than 16 MB; is its closing quotation mark missing?");
  }
  throw ProgramError(
      kData, place + "a quotation mark stands inside this cell; the cell must be enclosed in quotation " +
                 "marks, and those inside it written twice");
}

void TableReader::StoreHeaderCell(std::string_view cell) {
  header_.emplace_back(cell);
}

void TableReader::AddCell(const char* text, std::size_t size) {
  after_cr_ = false;
  const std::size_t column = row_.count_++;
  if (column == 0) {
    row_.line_ = line_;
    row_.text_.clear();
  }
  if (!header_done_) {
    StoreHeaderCell(std::string_view(text, size));
  } else if (column < wanted_.size() && wanted_[column] != 0) {
    row_.spans_[column] = {row_.text_.size(), size};
    row_.text_.append(text, size);
  }
  if (may_hold_line_ends_ && size != 0) {
    line_ += static_cast<std::uint64_t>(std::count(text, text + size, '\n'));
  }
}

void TableReader::EndRow(int terminator) {
  const bool is_second_half = terminator == '\n' && after_cr_;
  after_cr_ = terminator == '\r';
  if (!is_second_half) ++line_;
  if (row_.count_ == 0) return;
  if (!header_done_) {
    TakeHeader();
  } else {
    for (std::size_t missing = row_.count_; missing < row_.spans_.size(); ++missing)
      row_.spans_[missing] = TableRow::Span();
    if (!(*function_)(row_)) stopped_ = true;
  }
  row_.count_ = 0;
}

}  // namespace kestrel_program
