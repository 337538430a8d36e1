#include "apps/kestrel/ScoreCommand.h"

#include <algorithm>
#include <memory>
#include <optional>
#include <vector>

#include "apps/kestrel/AddedColumns.h"
#include "apps/kestrel/ExplanationColumn.h"
#include "apps/kestrel/KeptColumns.h"
#include "apps/kestrel/LoadedModel.h"
#include "apps/kestrel/OutputColumns.h"
#include "apps/kestrel/PredictionColumns.h"
#include "apps/kestrel/ShownText.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/MCStatus.h"
#include "kestrel/model/ScoreModel.h"
#include "kestrel/model/ScoreResult.h"

namespace kestrel_program {
namespace {

using namespace MCKestrel_800;
using MCScore::MCStatus;

/// The codes that say more than that it did not work.
constexpr long kFirstStatus = 90001;
constexpr long kInvalidValueStatus = 90025;
constexpr long kNoPredictionStatus = 90027;

constexpr ColumnWords kWords = {"the model reads", "the model's", "predictions", "have no prediction"};

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

/// The output fields that the document declares, or else predictions; where they are wanted, both, and
/// explanations.
class ScoredColumns : public AddedColumns {
 public:
  ScoredColumns(std::unique_ptr<ScoreModel> model, bool shows_all, bool explains)
      : model_(std::move(model)),
        predictors_(model_->GetPredictors()),
        result_(model_->MakeResult()),
        outputs_(*model_, result_.get()) {
    std::vector<std::string> names = outputs_.GetNames();
    if (names.empty() || shows_all) {
      predictions_.emplace(*model_, result_.get());
      names.insert(names.end(), predictions_->GetNames().begin(), predictions_->GetNames().end());
    }
    if (explains) {
      explanation_.emplace(result_.get());
      names.push_back(ExplanationColumn::kName);
    }
    // A document may call its output fields as we call our columns.
    names_ = NameOutputColumns({}, names);
  }

  const ColumnWords& GetWords() const override { return kWords; }
  const std::vector<const ScoreDictVar*>& GetInputs() const override { return predictors_; }
  const ScoreDictVar* GetOptionalInput() const override {
    const ScoreDictVar* target = model_->GetTargetVar();
    const bool is_input = std::find(predictors_.begin(), predictors_.end(), target) != predictors_.end();
    return !is_input && ComparesWithTrueValue(*model_) ? target : nullptr;
  }
  const std::vector<std::string>& GetNames() const override { return names_; }

  void BeginCase() override {
    outputs_.BeginCase();
    if (explanation_.has_value()) explanation_->BeginCase();
  }

  bool Compute(const CaseReader& cases, const TableRow& row, CaseReader::Fault& fault) override {
    const MCStatus status = model_->Score(&cases.GetRecord(), result_.get());
    if (!status.IsError()) return true;
    DescribeStatus(status, cases, row, fault);
    return false;
  }

  void Write(bool is_computed, TableWriter& writer, Progress& progress) override {
    // A case without prediction has output fields all the same: they may tell why.
    outputs_.Write(writer);
    if (predictions_.has_value()) {
      if (is_computed) {
        predictions_->Write(writer);
      } else {
        predictions_->WriteMissing(writer);
      }
    }
    if (explanation_.has_value()) WriteExplanation(is_computed, writer, progress);
  }

 private:
  /// A model that has nothing to tell would leave the user to wonder about an empty column.
  void WriteExplanation(bool is_scored, TableWriter& writer, Progress& progress) {
    if (is_scored && !any_is_scored_ && !explanation_->HasPath()) {
      progress.Say(
          "the first scored case has no explanation: no node of a tree and no rule led to it (the model is "
          "a " +
          ShownText(model_->GetModelKind()) + ")");
    }
    any_is_scored_ = any_is_scored_ || is_scored;
    explanation_->Write(writer);
  }

  /// Puts into words why the model did not score the row.
  void DescribeStatus(const MCStatus& status, const CaseReader& cases, const TableRow& row,
                      CaseReader::Fault& fault) const {
    fault.column = CaseReader::Fault::kWholeRow;
    const auto position = static_cast<std::size_t>(status.GetDiscreteDatum(0));
    if (status.GetErrorCode() == kInvalidValueStatus && position < predictors_.size()) {
      fault.column = cases.GetColumns()[position];
      const std::string_view cell = row.GetCell(fault.column);
      fault.text = (cell.empty() ? std::string("the model refuses a missing value")
                                 : "the model refuses \"" + ShownText(cell) + "\"") +
                   AcceptedCategories(*predictors_[position]) + " " + StatusText(status);
    } else if (status.GetErrorCode() == kNoPredictionStatus) {
      fault.text = "the case has no prediction" + MissingInputs(cases) + " " + StatusText(status);
    } else {
      fault.text = "the case cannot be scored " + StatusText(status);
    }
  }

  std::string MissingInputs(const CaseReader& cases) const {
    constexpr std::size_t kMost = 10;
    std::string list;
    std::size_t count = 0;
    for (const ScoreDictVar* variable : predictors_) {
      const int slot = cases.GetRecord().GetIndex(variable->GetName());
      if (!variable->IsMissingValue(cases.GetRecord().Get(slot)) || ++count > kMost) continue;
      list += (count == 1 ? "; missing are " : ", ") + ShownText(variable->GetName());
    }
    return count > kMost ? list + ", ..." : list;
  }

  std::unique_ptr<ScoreModel> model_;
  std::vector<const ScoreDictVar*> predictors_;
  std::unique_ptr<ScoreResult> result_;
  OutputColumns outputs_;
  std::optional<PredictionColumns> predictions_;
  std::optional<ExplanationColumn> explanation_;
  std::vector<std::string> names_;
  bool any_is_scored_ = false;
};

}  // namespace

ExitCode Score(const ScoreOptions& options) {
  RefuseClashes(options.table, "the model");
  ScoredColumns columns(LoadModel(options.table.document, options.names_file), options.shows_all,
                        options.explains);
  return TableRun(options.table, columns).Run();
}

}  // namespace kestrel_program
