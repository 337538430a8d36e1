#include "kestrel/transform/DerivationPlan.h"

#include <algorithm>

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
      transformations_stamp_(StampOf(transformations)) {
  for (const TransformVar* field : fields)
    AddStep(*field);
  // Reading a field may add the fields that it reads behind those that are there.
  for (std::size_t step = 0; step < steps_.size(); ++step)
    AddReads(static_cast<int>(step));
  Order();
  Prepare();
}

DerivationPlan::~DerivationPlan() = default;

bool DerivationPlan::IsFor(const ScoreDictionary* dictionary,
                           const TransformationDictionary* transformations) const {
  if (!IsSame(dictionary, dictionary_, dictionary_stamp_)) return false;
  if (!IsSame(transformations, transformations_, transformations_stamp_)) return false;
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
    steps_[number].source = reads.front();
  }
  steps_[number].reads = std::move(reads);
}

std::vector<int> DerivationPlan::AddTreeReads(const FunctionTree& root) {
  std::vector<int> reads;
  std::vector<const FunctionTree*> waiting = {&root};
  while (!waiting.empty()) {
    const FunctionTree& node = *waiting.back();
    waiting.pop_back();
    for (const FunctionTree* child : node.Children())
      waiting.push_back(child);
    if (ApplyProgram::IsReference(node)) {
      const ApplyNodeStats& stats = node.GetNodeStats();
      reads.push_back(AddSource(stats.GetParameterName(), stats.GetVariable()));
    }
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
    steps_[step].as_source = static_cast<int>(source);
  }
}

void DerivationPlan::Prepare() {
  const auto find = [this](const std::string& name) -> const SourceField& {
    return *sources_[source_numbers_.at(name)].field;
  };
  for (Step& step : steps_) {
    step.evaluation = &step.field->Evaluation();
    if (step.is_circular || step.field->GetTransExpression() != TransExpression::kApply) continue;
    if (step.field->GetRoot() == nullptr) continue;
    step.program = std::make_unique<ApplyProgram>(
        *step.field->GetRoot(), step.evaluation->GetStorage() == FieldEvaluation::Storage::kText, find);
  }
}

void DerivationPlan::Choose(const std::vector<const TransformVar*>& fields) {
  chosen_ = Work();
  AddNeeds(fields, chosen_);
}

// Every step stands behind those that it needs, so one walk from the end finds them all.
void DerivationPlan::AddNeeds(const std::vector<const TransformVar*>& fields, Work& work) const {
  std::vector<bool> is_needed(steps_.size(), false);
  std::vector<bool> is_read(sources_.size(), false);
  for (const TransformVar* field : fields) {
    const auto found = step_numbers_.find(field);
    if (found != step_numbers_.end()) is_needed[found->second] = true;
  }
  for (std::size_t step = steps_.size(); step-- > 0;) {
    if (!is_needed[step]) continue;
    work.steps.push_back(static_cast<int>(step));
    if (steps_[step].is_circular) continue;
    for (const int source : steps_[step].reads) {
      is_read[source] = true;
      if (sources_[source].step != kNone) is_needed[sources_[source].step] = true;
    }
  }
  std::reverse(work.steps.begin(), work.steps.end());
  for (std::size_t source = 0; source < sources_.size(); ++source) {
    if (is_read[source]) work.sources.push_back(static_cast<int>(source));
  }
}

void DerivationPlan::Compute(const ScoreCaseRecord* record) {
  Run(chosen_, record);
}

void DerivationPlan::ComputeOnly(const TransformVar& field, const ScoreCaseRecord* record) {
  Work work;
  AddNeeds({&field}, work);
  Run(work, record);
}

void DerivationPlan::Run(const Work& work, const ScoreCaseRecord* record) {
  if (record != nullptr) {
    TakeCase(work, *record);
  } else {
    for (const int source : work.sources) {
      sources_[source].field->Set(nullptr);
      sources_[source].is_in_case = false;
    }
  }
  for (const int step : work.steps)
    RunStep(steps_[step]);
}

void DerivationPlan::TakeCase(const Work& work, const ScoreCaseRecord& record) {
  const unsigned long long stamp = record.GetLayoutStamp();
  if (stamp == 0) {
    for (const int number : work.sources) {
      Source& source = sources_[number];
      const ScoreValue* const value = record.Get(source.name);
      source.is_in_case = value != nullptr;
      source.field->Set(value);
    }
    record_stamp_ = 0;
    return;
  }
  const std::vector<ScoreValue*>& values = record.GetAllValues();
  if (stamp != record_stamp_ || values.size() < positions_end_) LookUpPositions(record);
  const ScoreValue* const* const value_of = values.data();
  for (const int number : work.sources) {
    Source& source = sources_[number];
    const ScoreValue* const value = source.position == kNone ? nullptr : value_of[source.position];
    source.is_in_case = value != nullptr;
    source.field->Set(value);
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

void DerivationPlan::RunStep(Step& step) {
  if (step.is_circular) {
    step.evaluation->SetMissing();
  } else if (step.program != nullptr) {
    step.program->Run();
    if (step.evaluation->GetStorage() == FieldEvaluation::Storage::kText) {
      step.evaluation->TakeText(step.program->GetText());
    } else {
      step.evaluation->TakeNumber(step.program->GetNumber());
    }
  } else {
    step.evaluation->Compute(step.source == kNone ? nothing_ : *sources_[step.source].field);
  }
  if (step.as_source == kNone) return;
  Source& source = sources_[step.as_source];
  if (!source.is_in_case) source.field->Set(&step.evaluation->GetResult());
}

}  // namespace MCKestrel_800
