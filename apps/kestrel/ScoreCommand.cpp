#include "apps/kestrel/ScoreCommand.h"

#include <cstdio>
#include <filesystem>
#include <memory>
#include <optional>

#include "apps/kestrel/CaseReader.h"
#include "apps/kestrel/ExplanationColumn.h"
#include "apps/kestrel/InputFile.h"
#include "apps/kestrel/KeptColumns.h"
#include "apps/kestrel/LoadedModel.h"
#include "apps/kestrel/OutputFile.h"
#include "apps/kestrel/PredictionColumns.h"
#include "apps/kestrel/ProgramError.h"
#include "apps/kestrel/Progress.h"
#include "apps/kestrel/ShownText.h"
#include "apps/kestrel/TableReader.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/MCStatus.h"
#include "kestrel/foundation/NumberText.h"
#include "kestrel/model/ScoreModel.h"

namespace kestrel_program {
namespace {

using namespace MCKestrel_800;
using MCScore::MCStatus;

/// The codes that say more than that it did not work.
constexpr long kFirstStatus = 90001;
constexpr long kInvalidValueStatus = 90025;
constexpr long kNoPredictionStatus = 90027;

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

std::string StatusText(const MCStatus& status) {
  const char* name = MCScore::StatusName(static_cast<std::size_t>(status.GetErrorCode() - kFirstStatus));
  return "(status " + std::to_string(status.GetErrorCode()) +
         (name == nullptr || *name == 0 ? std::string() : std::string(", ") + name) + ")";
}

/// ", accepted is one of: a, b" for a field that lists its categories.
std::string AcceptedCategories(const ScoreDictVar& variable) {
  const ScoreValueLabelSet* labels = variable.GetValueLabels();
  if (variable.GetMLevel() == ScoreDictVar::kContinuous || labels == nullptr || labels->Size() == 0)
    return {};
  constexpr std::size_t kMost = 20;
  std::string list = ", accepted is one of: ";
  for (std::size_t i = 0; i < labels->Size() && i < kMost; ++i) {
    const ScoreValue* value = labels->GetAllValueLabels()[i]->GetValue();
    list += (i == 0 ? "" : ", ") + (value == nullptr ? std::string() : ShownText(TextOf(*value)));
  }
  return labels->Size() > kMost ? list + ", ..." : list;
}

/// One run of the command.
class ScoreRun {
 public:
  explicit ScoreRun(const ScoreOptions& options)
      : options_(options),
        model_(LoadModel(options.model, options.names_file)),
        predictors_(model_->GetPredictors()),
        input_(options.data),
        table_(input_, options.delimiter),
        cases_(table_, predictors_, options.missing),
        predictions_(*model_),
        added_(predictions_.GetNames()) {
    if (!options.explains) return;
    explanation_.emplace(predictions_.GetResult());
    added_.push_back(ExplanationColumn::kName);
  }

  ExitCode Run() {
    ChooseColumns();
    OutputFile output(options_.output);
    BeginOutput(output);
    table_.ReadRows(ColumnsToRead(), [this, &output](const TableRow& row) {
      ScoreRow(row);
      output.FlushIfFull();
      progress_.CountCase();
      return true;
    });
    output.Finish();
    return Report();
  }

 private:
  void ChooseColumns() {
    if (options_.keep_all) {
      for (std::size_t column = 0; column < table_.GetHeader().size(); ++column)
        kept_.push_back(column);
    } else {
      kept_ = FindKeptColumns(table_, options_.keep);
    }
    for (const std::size_t column : kept_)
      kept_as_number_.push_back(options_.format == TableWriter::Format::kJsonLines &&
                                cases_.IsNumber(column));
  }

  void BeginOutput(OutputFile& output) {
    std::vector<std::string> kept_names;
    for (const std::size_t column : kept_)
      kept_names.push_back(table_.GetHeader()[column]);
    const std::vector<std::string> names = NameOutputColumns(kept_names, added_);
    for (std::size_t i = 0; i < added_.size(); ++i) {
      const std::string& wanted = added_[i];
      const std::string& given = names[kept_names.size() + i];
      if (given != wanted) {
        Say("the table has a column " + ShownText(wanted) + "; the model's is called " + ShownText(given));
      }
    }
    writer_ = TableWriter::Make(options_.format, names, output.GetBuffer());
    writer_->BeginTable();
  }

  std::vector<std::size_t> ColumnsToRead() const {
    std::vector<std::size_t> columns = cases_.GetColumns();
    columns.insert(columns.end(), kept_.begin(), kept_.end());
    return columns;
  }

  void ScoreRow(const TableRow& row) {
    std::optional<MCStatus> status;
    if (explanation_.has_value()) explanation_->BeginCase();
    if (cases_.Read(row, fault_)) status = model_->Score(&cases_.GetRecord(), predictions_.GetResult());
    const bool is_scored = status.has_value() && !status->IsError();
    if (!is_scored) {
      if (status.has_value()) DescribeStatus(*status, row);
      HandleFault(row);
    }
    WriteKept(row);
    if (is_scored) {
      predictions_.Write(*writer_);
    } else {
      predictions_.WriteMissing(*writer_);
    }
    if (explanation_.has_value()) WriteExplanation(is_scored);
    writer_->EndRow();
  }

  void WriteKept(const TableRow& row) {
    for (std::size_t i = 0; i < kept_.size(); ++i) {
      const std::string_view cell = row.GetCell(kept_[i]);
      double number = 0.0;
      if (cell.empty()) {
        writer_->AddMissing();
      } else if (kept_as_number_[i] && ParseDouble(cell.data(), cell.data() + cell.size(), number)) {
        writer_->AddNumber(number);
      } else {
        writer_->AddText(cell);
      }
    }
  }

  /// A model that has nothing to tell would leave the user to wonder about an empty column.
  void WriteExplanation(bool is_scored) {
    if (is_scored && !any_is_scored_ && !explanation_->HasPath()) {
      Say("the first scored case has no explanation: no node of a tree and no rule led to it (the model is "
          "a " +
          ShownText(model_->GetModelKind()) + ")");
    }
    any_is_scored_ = any_is_scored_ || is_scored;
    explanation_->Write(*writer_);
  }

  /// Puts into words why the model did not score the row.
  void DescribeStatus(const MCStatus& status, const TableRow& row) {
    fault_.column = CaseReader::Fault::kWholeRow;
    const auto position = static_cast<std::size_t>(status.GetDiscreteDatum(0));
    if (status.GetErrorCode() == kInvalidValueStatus && position < predictors_.size()) {
      fault_.column = cases_.GetColumns()[position];
      const std::string_view cell = row.GetCell(fault_.column);
      fault_.text = (cell.empty() ? std::string("the model refuses a missing value")
                                  : "the model refuses \"" + ShownText(cell) + "\"") +
                    AcceptedCategories(*predictors_[position]) + " " + StatusText(status);
    } else if (status.GetErrorCode() == kNoPredictionStatus) {
      fault_.text = "the case has no prediction" + MissingInputs() + " " + StatusText(status);
    } else {
      fault_.text = "the case cannot be scored " + StatusText(status);
    }
  }

  std::string MissingInputs() const {
    constexpr std::size_t kMost = 10;
    std::string list;
    std::size_t count = 0;
    for (const ScoreDictVar* variable : predictors_) {
      const int slot = cases_.GetRecord().GetIndex(variable->GetName());
      if (!variable->IsMissingValue(cases_.GetRecord().Get(slot)) || ++count > kMost) continue;
      list += (count == 1 ? "; missing are " : ", ") + ShownText(variable->GetName());
    }
    return count > kMost ? list + ", ..." : list;
  }

  void HandleFault(const TableRow& row) {
    const std::string text = table_.DescribePlace(row.GetLine(), fault_.column) + fault_.text;
    if (!options_.goes_on_after_faults) {
      throw ProgramError(kData, text + "\n  hint: --on-error null leaves such predictions empty and goes on");
    }
    progress_.CountFailure();
    if (progress_.GetFailures() <= kMostMessages) Say(text);
  }

  ExitCode Report() {
    if (options_.shows_statistics) Say(progress_.Summarize());
    if (progress_.GetFailures() == 0) return kDone;
    if (!options_.shows_statistics) {
      Say(std::to_string(progress_.GetFailures()) + " of " + std::to_string(progress_.GetCases()) +
          " cases have no prediction");
    }
    return kSomeCasesFailed;
  }

  void Say(const std::string& text) {
    progress_.Clear();
    std::fprintf(stderr, "kestrel: %s\n", text.c_str());
  }

  const ScoreOptions& options_;
  std::unique_ptr<ScoreModel> model_;
  std::vector<const ScoreDictVar*> predictors_;
  InputFile input_;
  TableReader table_;
  CaseReader cases_;
  PredictionColumns predictions_;
  std::optional<ExplanationColumn> explanation_;
  std::vector<std::string> added_;  ///< the names of the columns behind the kept ones
  bool any_is_scored_ = false;
  std::vector<std::size_t> kept_;
  std::vector<bool> kept_as_number_;
  std::unique_ptr<TableWriter> writer_;
  Progress progress_;
  CaseReader::Fault fault_;
};

}  // namespace

ExitCode Score(const ScoreOptions& options) {
  if (IsStandardStream(options.model) && IsStandardStream(options.data)) {
    throw ProgramError(
        kUsage, "the model and the table cannot both come from the standard input; name a file for one");
  }
  RefuseToOverwrite(options.output, options.model, "the model");
  RefuseToOverwrite(options.output, options.data, "the table");
  return ScoreRun(options).Run();
}

}  // namespace kestrel_program
