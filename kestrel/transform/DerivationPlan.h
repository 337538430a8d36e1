// The order in which derived fields are computed, with everything looked up that does not depend on the case.

#ifndef KESTREL_TRANSFORM_DERIVATIONPLAN_H
#define KESTREL_TRANSFORM_DERIVATIONPLAN_H

#include <cstddef>
#include <cstdint>
#include <deque>
#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

#include "kestrel/transform/ApplyProgram.h"
#include "kestrel/transform/SourceField.h"

namespace MCKestrel_800 {

class FieldEvaluation;
class FunctionTree;
class ScoreCaseRecord;
class ScoreDictionary;
class TransformVar;
class TransformationDictionary;

/// A list of derived fields, each behind those that it reads. A case is computed by one walk over the list:
/// neither chains nor cycles of fields cost stack, and a field that many others read is computed once. The
/// results are those of the fields' own evaluations.
///
/// A field is read by its name: from the case; where the case has no value and the name is that of a derived
/// field, that field's result. Names are looked up in the data dictionary first.
class DerivationPlan {
 public:
  /// Plans the fields and all derived fields that they depend on. Dictionaries may be null. All must outlive
  /// the plan, or make it stale.
  DerivationPlan(const std::vector<const TransformVar*>& fields, const ScoreDictionary* dictionary,
                 const TransformationDictionary* transformations);
  DerivationPlan(const DerivationPlan&) = delete;
  DerivationPlan& operator=(const DerivationPlan&) = delete;
  ~DerivationPlan();

  /// Whether the plan still stands for these dictionaries and the fields as they are.
  bool IsFor(const ScoreDictionary* dictionary, const TransformationDictionary* transformations);

  /// A field that is computed for each case, and where its value goes: a value of the type that the field
  /// computes.
  struct Output {
    const TransformVar* field;
    ScoreValue* to;
  };

  /// Chooses what Compute computes: these fields and what they depend on. At first nothing is chosen.
  void Choose(const std::vector<Output>& outputs);
  /// Computes the chosen fields for a case; null is a case without values.
  void Compute(const ScoreCaseRecord* record) { Run(chosen_, record); }
  /// Computes one field and what it depends on, each into its own result.
  void ComputeOnly(const TransformVar& field, const ScoreCaseRecord* record);

  /// To be told of each change of a field's definition, with the field's new stamp.
  static void NoteChange(unsigned long long stamp);

 private:
  static constexpr int kNone = -1;

  struct Source {
    std::string name;
    std::unique_ptr<SourceField> field;
    std::unique_ptr<TextCodes> codes;  ///< of the texts that fields list which read it
    int step = kNone;                  ///< the derived field of that name
    int position = kNone;              ///< in the record
    bool is_in_case = false;           ///< whether the case has a value of that name
  };

  /// What is to be done for a case. All that it needs stands together: there are more fields than the nearest
  /// memory holds.
  struct Task {
    void (*run)(const Task& task) = nullptr;
    ScoreValue* to = nullptr;
    FieldEvaluation* evaluation = nullptr;
    const SourceField* source = nullptr;  ///< what it reads, unless it is a function tree
    ApplyProgram* program = nullptr;
    const std::uint32_t* row_of_code = nullptr;
    Source* as_source = nullptr;  ///< the result as what others read; null when none does
  };

  struct Step {
    const TransformVar* field = nullptr;
    unsigned long long definition_stamp = 0;
    bool is_circular = false;
    Task task;  ///< its place for the result is chosen later
    std::unique_ptr<ApplyProgram> program;
    std::vector<std::uint32_t> row_of_code;  ///< by the code of the source's text, and 1 more
    std::vector<int> reads;                  ///< all sources
  };

  /// What to do, in order, with the sources that it reads. The task of a field that others read is followed
  /// by one that shows them its result.
  struct Work {
    std::vector<Task> tasks;
    std::vector<Source*> sources;
  };

  int AddStep(const TransformVar& field);
  int AddSource(const std::string& name, const ScoreDictVar* known);
  void AddReads(int step);
  std::vector<int> AddTreeReads(const FunctionTree& root);
  void Order();
  void Prepare();
  void PrepareStep(Step& step, const ApplyProgram::FindSource& find);
  void GiveCodes();
  void UseCodes(Step& step);
  void FillWork(const std::vector<Output>& outputs, Work& work);
  void Run(const Work& work, const ScoreCaseRecord* record);
  void TakeCase(const Work& work, const ScoreCaseRecord& record);
  void LookUpPositions(const ScoreCaseRecord& record);

  static void ShowResult(const Task& task);
  static void RunCircular(const Task& task);
  static void RunNumberTree(const Task& task);
  static void RunDateTree(const Task& task);
  static void RunTextTree(const Task& task);
  static void RunTextEncoding(const Task& task);
  static void RunNextTextEncoding(const Task& task);
  static void RunNorm(const Task& task);
  static void RunBin(const Task& task);
  static void RunOther(const Task& task);

  const ScoreDictionary* dictionary_;
  const TransformationDictionary* transformations_;
  unsigned long long dictionary_stamp_;
  unsigned long long transformations_stamp_;
  std::vector<Source> sources_;
  std::deque<double> program_numbers_;  ///< of the steps' programs
  std::vector<Step> steps_;
  Work chosen_;
  Work only_;
  std::vector<Output> only_output_;
  // Room for FillWork: by step and by source.
  std::vector<bool> is_needed_;
  std::vector<bool> is_read_;
  std::vector<ScoreValue*> places_;
  SourceField nothing_{nullptr};  ///< what a field reads that names none
  std::unordered_map<std::string, int> source_numbers_;
  std::unordered_map<const TransformVar*, int> step_numbers_;
  unsigned long long noted_change_;
  unsigned long long record_stamp_ = 0;
  std::size_t positions_end_ = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_DERIVATIONPLAN_H
