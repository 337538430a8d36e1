#include "kestrel/transform/DerivationPlan.h"

#include <algorithm>
#include <atomic>
#include <utility>

#include "kestrel/dictionary/ScoreCaseRecord.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/transform/ApplyProgram.h"
#include "kestrel/transform/FieldEvaluation.h"
#include "kestrel/transform/FunctionTree.h"
#include "kestrel/transform/StepOrder.h"
#include "kestrel/transform/TransformVar.h"
#include "kestrel/transform/TransformationDictionary.h"

namespace MCKestrel_800 {
namespace {

// Of any field in the process; a number that is never given twice.
std::atomic<unsigned long long> last_change{0};

// A table by codes is made unless the source's texts are so many more than the field's rows.
constexpr std::size_t kCodesPerRow = 8;

constexpr std::uint32_t kNoRow = static_cast<std::uint32_t>(-1);

// Behind the one for texts without a code.
std::size_t PlaceOfCode(int code) {
  static_assert(TextCodes::kUnknown == -1);
  return static_cast<std::size_t>(code) + 1;
}

FunctionValueKind KindOf(FieldEvaluation::Storage storage) {
  switch (storage) {
    case FieldEvaluation::Storage::kNumber:
      return FunctionValueKind::kNumber;
    case FieldEvaluation::Storage::kText:
      return FunctionValueKind::kText;
    default:
      return FunctionValueKind::kDateTime;
  }
}

unsigned long long StampOf(const ScoreDictionary* dictionary) {
  return dictionary == nullptr ? 0 : dictionary->GetLayoutStamp();
}

// A dictionary that promises nothing is looked at anew for each case.
bool IsSame(const ScoreDictionary* dictionary, const ScoreDictionary* other, unsigned long long stamp) {
  return dictionary == other && (dictionary == nullptr || (stamp != 0 && StampOf(dictionary) == stamp));
}

}  // namespace

DerivationPlan::DerivationPlan(const std::vector<const TransformVar*>& fields,
                               const ScoreDictionary* dictionary,
                               const TransformationDictionary* transformations)
    : dictionary_(dictionary),
      transformations_(transformations),
      dictionary_stamp_(StampOf(dictionary)),
      transformations_stamp_(StampOf(transformations)),
      noted_change_(last_change.load(std::memory_order_relaxed)) {
  for (const TransformVar* field : fields)
    AddStep(*field);
  // Reading a field may add the fields that it reads behind those that are there.
  for (std::size_t step = 0; step < steps_.size(); ++step)
    AddReads(static_cast<int>(step));
  Order();
  Prepare();
}

DerivationPlan::~DerivationPlan() = default;

void DerivationPlan::NoteChange(unsigned long long stamp) {
  last_change.store(stamp, std::memory_order_relaxed);
}

bool DerivationPlan::IsFor(const ScoreDictionary* dictionary,
                           const TransformationDictionary* transformations) {
  if (!IsSame(dictionary, dictionary_, dictionary_stamp_)) return false;
  if (!IsSame(transformations, transformations_, transformations_stamp_)) return false;
  const unsigned long long change = last_change.load(std::memory_order_relaxed);
  if (change == noted_change_) return true;
  noted_change_ = change;
  return std::all_of(steps_.begin(), steps_.end(),
                     [](const Step& step) { return step.field->definition_stamp_ == step.definition_stamp; });
}

int DerivationPlan::AddStep(const TransformVar& field) {
  const auto [place, is_new] = step_numbers_.emplace(&field, static_cast<int>(steps_.size()));
  if (is_new) {
    steps_.emplace_back();
    steps_.back().field = &field;
    steps_.back().definition_stamp = field.definition_stamp_;
  }
  return place->second;
}

// known  the variable that a function tree knows by that name; used when no dictionary has the name.
int DerivationPlan::AddSource(const std::string& name, const ScoreDictVar* known) {
  const auto [place, is_new] = source_numbers_.emplace(name, static_cast<int>(sources_.size()));
  if (!is_new) return place->second;
  const ScoreDictVar* variable = dictionary_ == nullptr ? nullptr : dictionary_->GetVar(name);
  if (variable == nullptr && transformations_ != nullptr) variable = transformations_->GetVar(name);
  if (variable == nullptr) variable = known;
  Source source;
  source.name = name;
  source.field = std::make_unique<SourceField>(variable);
  if (const auto* derived = dynamic_cast<const TransformVar*>(variable)) source.step = AddStep(*derived);
  sources_.push_back(std::move(source));
  return place->second;
}

void DerivationPlan::AddReads(int number) {
  const TransformVar& field = *steps_[number].field;
  std::vector<int> reads;
  if (field.GetTransExpression() == TransExpression::kApply) {
    if (field.GetRoot() != nullptr) reads = AddTreeReads(*field.GetRoot());
  } else if (!field.GetFieldName().empty()) {
    reads.push_back(AddSource(field.GetFieldName(), nullptr));
    steps_[number].task.source = sources_[reads.front()].field.get();
  }
  steps_[number].reads = std::move(reads);
}

std::vector<int> DerivationPlan::AddTreeReads(const FunctionTree& root) {
  std::vector<int> reads;
  for (const FunctionTree* reference : ApplyProgram::FindReferences(root)) {
    const ApplyNodeStats& stats = reference->GetNodeStats();
    reads.push_back(AddSource(stats.GetParameterName(), stats.GetVariable()));
  }
  std::sort(reads.begin(), reads.end());
  reads.erase(std::unique(reads.begin(), reads.end()), reads.end());
  return reads;
}

void DerivationPlan::Order() {
  std::vector<std::vector<int>> needs(steps_.size());
  for (std::size_t step = 0; step < steps_.size(); ++step) {
    for (const int source : steps_[step].reads) {
      if (sources_[source].step != kNone) needs[step].push_back(sources_[source].step);
    }
  }
  const StepOrder order = OrderSteps(needs);
  std::vector<Step> ordered;
  ordered.reserve(steps_.size());
  std::vector<int> new_number(steps_.size());
  for (const int step : order.steps) {
    new_number[step] = static_cast<int>(ordered.size());
    ordered.push_back(std::move(steps_[step]));
    ordered.back().is_circular = order.is_circular[step];
  }
  steps_ = std::move(ordered);
  for (auto& [field, number] : step_numbers_)
    number = new_number[number];
  for (std::size_t source = 0; source < sources_.size(); ++source) {
    int& step = sources_[source].step;
    if (step == kNone) continue;
    step = new_number[step];
    steps_[step].task.as_source = &sources_[source];
  }
}

void DerivationPlan::Prepare() {
  const auto find = [this](const std::string& name) -> const SourceField& {
    return *sources_[source_numbers_.at(name)].field;
  };
  GiveCodes();
  for (Step& step : steps_) {
    step.task.evaluation = &step.field->Evaluation();
    if (step.task.source == nullptr) step.task.source = &nothing_;
    PrepareStep(step, find);
  }
}

// The commonest expressions are called without asking again what they are.
void DerivationPlan::PrepareStep(Step& step, const ApplyProgram::FindSource& find) {
  const FieldEvaluation::Storage storage = step.task.evaluation->GetStorage();
  const TransExpression kind = step.field->GetTransExpression();
  step.task.run = RunOther;
  if (step.is_circular) {
    step.task.run = RunCircular;
  } else if (kind == TransExpression::kNormContinuous && storage == FieldEvaluation::Storage::kNumber) {
    step.task.run = RunNorm;
  } else if (kind == TransExpression::kDiscretize) {
    step.task.run = RunBin;
  } else if (kind == TransExpression::kMapValues || kind == TransExpression::kNormDiscrete) {
    UseCodes(step);
  } else if (kind == TransExpression::kApply && step.field->GetRoot() != nullptr) {
    const FunctionValueKind wanted = KindOf(storage);
    step.program = std::make_unique<ApplyProgram>(*step.field->GetRoot(), wanted, find, program_numbers_);
    step.task.program = step.program.get();
    step.task.run = wanted == FunctionValueKind::kText     ? RunTextTree
                    : wanted == FunctionValueKind::kNumber ? RunNumberTree
                                                           : RunDateTree;
  }
}

// Fields that list texts of one source share one look-up of its text.
void DerivationPlan::GiveCodes() {
  for (const Step& step : steps_) {
    if (step.field->GetAllEncodedValues().empty() || step.reads.size() != 1) continue;
    std::unique_ptr<TextCodes>& codes = sources_[step.reads.front()].codes;
    if (codes == nullptr) codes = std::make_unique<TextCodes>(false);
    for (const StringValue* text : step.field->Evaluation().GetEncodings().GetTexts())
      codes->Add(text->GetText(), static_cast<int>(codes->GetSize()));
  }
  for (Source& source : sources_)
    source.field->SetCodes(source.codes.get());
}

void DerivationPlan::UseCodes(Step& step) {
  // A table without rows has none.
  if (step.reads.size() != 1 || sources_[step.reads.front()].codes == nullptr) return;
  const TextCodes& codes = *sources_[step.reads.front()].codes;
  const EncodingTable& encodings = step.task.evaluation->GetEncodings();
  const std::vector<const StringValue*> texts = encodings.GetTexts();
  if (texts.empty() || !encodings.ListsTexts() || codes.GetSize() > kCodesPerRow * texts.size()) return;
  step.row_of_code.assign(codes.GetSize() + 1, kNoRow);
  for (const StringValue* text : texts) {
    std::uint32_t& row = step.row_of_code[PlaceOfCode(codes.Find(text->GetText()))];
    if (row == kNoRow) row = static_cast<std::uint32_t>(encodings.FindText(*text));
  }
  step.task.row_of_code = step.row_of_code.data();
  step.task.run = RunTextEncoding;
}

void DerivationPlan::Choose(const std::vector<Output>& outputs) {
  FillWork(outputs, chosen_);
}

void DerivationPlan::ComputeOnly(const TransformVar& field, const ScoreCaseRecord* record) {
  only_output_.assign(1, {&field, nullptr});
  FillWork(only_output_, only_);
  Run(only_, record);
}

// Every step stands behind those that it needs, so one walk from the end finds them all. Hosts ask for single
// fields case by case, so all room is kept.
void DerivationPlan::FillWork(const std::vector<Output>& outputs, Work& work) {
  is_needed_.assign(steps_.size(), false);
  is_read_.assign(sources_.size(), false);
  places_.assign(steps_.size(), nullptr);
  work.tasks.clear();
  work.sources.clear();
  for (const Output& output : outputs) {
    const auto found = step_numbers_.find(output.field);
    if (found == step_numbers_.end()) continue;
    is_needed_[static_cast<std::size_t>(found->second)] = true;
    places_[static_cast<std::size_t>(found->second)] = output.to;
  }
  for (std::size_t number = steps_.size(); number-- > 0;) {
    if (!is_needed_[number]) continue;
    const Step& step = steps_[number];
    Task task = step.task;
    task.to = places_[number] != nullptr ? places_[number] : &task.evaluation->GetOwnResult();
    const Source* const as_source = task.as_source;
    if (as_source != nullptr && is_read_[static_cast<std::size_t>(as_source - sources_.data())]) {
      work.tasks.push_back(task);
      work.tasks.back().run = ShowResult;
    }
    work.tasks.push_back(task);
    if (step.is_circular) continue;
    for (const int source : step.reads) {
      is_read_[source] = true;
      if (sources_[source].step != kNone) is_needed_[sources_[source].step] = true;
    }
  }
  std::reverse(work.tasks.begin(), work.tasks.end());
  for (std::size_t source = 0; source < sources_.size(); ++source) {
    if (is_read_[source]) work.sources.push_back(&sources_[source]);
  }
}

void DerivationPlan::Run(const Work& work, const ScoreCaseRecord* record) {
  if (record != nullptr) {
    TakeCase(work, *record);
  } else {
    for (Source* source : work.sources) {
      source->field->Set(nullptr);
      source->is_in_case = false;
    }
  }
  for (const Task& task : work.tasks)
    task.run(task);
}

void DerivationPlan::TakeCase(const Work& work, const ScoreCaseRecord& record) {
  const unsigned long long stamp = record.GetLayoutStamp();
  if (stamp == 0) {
    for (Source* source : work.sources) {
      const ScoreValue* const value = record.Get(source->name);
      source->is_in_case = value != nullptr;
      source->field->Set(value);
    }
    record_stamp_ = 0;
    return;
  }
  const std::vector<ScoreValue*>& values = record.GetAllValues();
  if (stamp != record_stamp_ || values.size() < positions_end_) LookUpPositions(record);
  const ScoreValue* const* const value_of = values.data();
  for (Source* source : work.sources) {
    const ScoreValue* const value = source->position == kNone ? nullptr : value_of[source->position];
    source->is_in_case = value != nullptr;
    source->field->Set(value);
  }
}

void DerivationPlan::LookUpPositions(const ScoreCaseRecord& record) {
  const int size = static_cast<int>(record.Size());
  positions_end_ = 0;
  for (Source& source : sources_) {
    const int position = record.GetIndex(source.name);
    source.position = position < size ? position : kNone;
    if (source.position != kNone) {
      positions_end_ = std::max(positions_end_, static_cast<std::size_t>(source.position) + 1);
    }
  }
  record_stamp_ = record.GetLayoutStamp();
}

// A value in the case goes before it.
void DerivationPlan::ShowResult(const Task& task) {
  if (!task.as_source->is_in_case) task.as_source->field->Set(task.to);
}

void DerivationPlan::RunCircular(const Task& task) {
  task.evaluation->GiveMissing(*task.to);
}

void DerivationPlan::RunNumberTree(const Task& task) {
  task.program->Run();
  static_cast<NumericValue&>(*task.to).SetDoubleValue(NumberOrMissing(task.program->GetNumber()));
}

void DerivationPlan::RunDateTree(const Task& task) {
  task.program->Run();
  task.evaluation->GiveNumber(task.program->GetNumber(), *task.to);
}

void DerivationPlan::RunTextTree(const Task& task) {
  task.program->Run();
  task.evaluation->GiveText(task.program->GetText(), *task.to);
}

void DerivationPlan::RunTextEncoding(const Task& task) {
  const int code = task.source->GetTextCode();
  if (code == SourceField::kNotLookedUp) {
    RunNextTextEncoding(task);
  } else {
    task.evaluation->GiveRow(task.row_of_code[PlaceOfCode(code)], *task.source, *task.to);
  }
}

// For a value that no step has looked up, or that is no text.
void DerivationPlan::RunNextTextEncoding(const Task& task) {
  const SourceField& source = *task.source;
  if (source.GetKind() == SourceField::Kind::kText) {
    source.LookUpTextCode();
    task.evaluation->GiveRow(task.row_of_code[PlaceOfCode(source.GetTextCode())], source, *task.to);
  } else {
    task.evaluation->Compute(source, *task.to);
  }
}

void DerivationPlan::RunNorm(const Task& task) {
  task.evaluation->ComputeNorm(*task.source, *task.to);
}

void DerivationPlan::RunBin(const Task& task) {
  task.evaluation->ComputeBin(*task.source, *task.to);
}

void DerivationPlan::RunOther(const Task& task) {
  task.evaluation->Compute(*task.source, *task.to);
}

}  // namespace MCKestrel_800
