#include "apps/kestrel/TableRun.h"

#include <cstdint>
#include <filesystem>

#include "apps/kestrel/AddedColumns.h"
#include "apps/kestrel/KeptColumns.h"
#include "apps/kestrel/OutputFile.h"
#include "apps/kestrel/ProgramError.h"
#include "apps/kestrel/ShownText.h"
#include "kestrel/foundation/NumberText.h"

namespace kestrel_program {
namespace {

/// Messages about single cases beyond this many are not printed, only counted.
constexpr std::uint64_t kMostMessages = 10;

/// Writing over what is read is never meant, and would lose the user's data.
void RefuseToOverwrite(const std::string& output, const std::string& input, const char* what) {
  if (IsStandardStream(output) || IsStandardStream(input)) return;
  namespace fs = std::filesystem;
  std::error_code failure;
  const fs::path out = fs::u8path(output);
  if (!fs::is_regular_file(out, failure) || !fs::equivalent(out, fs::u8path(input), failure) || failure)
    return;
  throw ProgramError(kUsage, "-o " + output + ": this is " + what + " itself; name another file");
}

}  // namespace

AddedColumns::~AddedColumns() = default;

void RefuseClashes(const TableOptions& options, const char* what) {
  if (IsStandardStream(options.document) && IsStandardStream(options.data)) {
    throw ProgramError(
        kUsage, what + std::string(" and the table cannot both come from the standard input; name a file for "
                                   "one"));
  }
  RefuseToOverwrite(options.output, options.document, what);
  RefuseToOverwrite(options.output, options.data, "the table");
}

TableRun::TableRun(const TableOptions& options, AddedColumns& added)
    : options_(options),
      added_(added),
      input_(options.data),
      table_(input_, options.delimiter),
      cases_(table_, added.GetInputs(), added.GetOptionalInput(), options.missing, added.GetWords().reader) {}

TableRun::~TableRun() = default;

ExitCode TableRun::Run() {
  ChooseColumns();
  OutputFile output(options_.output);
  BeginOutput(output);
  table_.ReadRows(ColumnsToRead(), [this, &output](const TableRow& row) {
    HandleRow(row);
    output.FlushIfFull();
    progress_.CountCase();
    return true;
  });
  output.Finish();
  return Report();
}

void TableRun::ChooseColumns() {
  if (options_.keep_all) {
    for (std::size_t column = 0; column < table_.GetHeader().size(); ++column)
      kept_.push_back(column);
  } else {
    kept_ = FindKeptColumns(table_, options_.keep);
  }
  for (const std::size_t column : kept_)
    kept_as_number_.push_back(options_.format == TableWriter::Format::kJsonLines && cases_.IsNumber(column));
}

void TableRun::BeginOutput(OutputFile& output) {
  std::vector<std::string> kept_names;
  for (const std::size_t column : kept_)
    kept_names.push_back(table_.GetHeader()[column]);
  const std::vector<std::string>& added = added_.GetNames();
  const std::vector<std::string> names = NameOutputColumns(kept_names, added);
  for (std::size_t i = 0; i < added.size(); ++i) {
    const std::string& given = names[kept_names.size() + i];
    if (given != added[i]) {
      progress_.Say("the table has a column " + ShownText(added[i]) + "; " + added_.GetWords().of_source +
                    " is called " + ShownText(given));
    }
  }
  writer_ = TableWriter::Make(options_.format, names, output.GetBuffer());
  writer_->BeginTable();
}

std::vector<std::size_t> TableRun::ColumnsToRead() const {
  std::vector<std::size_t> columns = cases_.GetColumns();
  columns.insert(columns.end(), kept_.begin(), kept_.end());
  return columns;
}

void TableRun::HandleRow(const TableRow& row) {
  added_.BeginCase();
  const bool is_computed = cases_.Read(row, fault_) && added_.Compute(cases_, row, fault_);
  if (!is_computed) HandleFault(row);
  WriteKept(row);
  added_.Write(is_computed, *writer_, progress_);
  writer_->EndRow();
}

void TableRun::WriteKept(const TableRow& row) {
  for (std::size_t i = 0; i < kept_.size(); ++i) {
    const std::string_view cell = row.GetCell(kept_[i]);
    double number = 0.0;
    if (cell.empty()) {
      writer_->AddMissing();
    } else if (kept_as_number_[i] &&
               MCKestrel_800::ParseDouble(cell.data(), cell.data() + cell.size(), number)) {
      writer_->AddNumber(number);
    } else {
      writer_->AddText(cell);
    }
  }
}

void TableRun::HandleFault(const TableRow& row) {
  const std::string text = table_.DescribePlace(row.GetLine(), fault_.column) + fault_.text;
  if (!options_.goes_on_after_faults) {
    throw ProgramError(kData, text + "\n  hint: --on-error null leaves such " + added_.GetWords().left_out +
                                  " empty and goes on");
  }
  progress_.CountFailure();
  if (progress_.GetFailures() <= kMostMessages) progress_.Say(text);
}

ExitCode TableRun::Report() {
  if (options_.shows_statistics) progress_.Say(progress_.Summarize());
  if (progress_.GetFailures() == 0) return kDone;
  if (!options_.shows_statistics) {
    progress_.Say(std::to_string(progress_.GetFailures()) + " of " + std::to_string(progress_.GetCases()) +
                  " cases " + added_.GetWords().they_lack);
  }
  return kSomeCasesFailed;
}

}  // namespace kestrel_program
