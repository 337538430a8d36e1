// Predicates of a model, compiled: what the reader built as objects becomes flat entries without pointers.

#ifndef KESTREL_PLUGINS_SUPPORT_CONDITIONTABLE_H
#define KESTREL_PLUGINS_SUPPORT_CONDITIONTABLE_H

#include <cstddef>
#include <vector>

#include "kestrel/predicates/CodeMap.h"
#include "kestrel/predicates/ScorePredicate.h"
#include "plugins/support/Condition.h"

namespace MCKestrel_800 {

class DiscreteSplit;
class PredicateInputs;
class ScaleSplit;

/// Decides exactly what the predicate objects decide on the same vector, without calling them. All predicates
/// that the core's reader makes can be compiled, so the objects need not be kept.
///
/// Compile is called while a model is built; Evaluate only reads and may run on several threads.
class ConditionTable {
 public:
  /// predicate  may be null, which is what the reader gives for a compound of nothing; it is never decided.
  /// inputs     gives each variable its slot; throws for a variable that the model does not read.
  /// Errors: code 5 for a predicate with a split that the reader does not build.
  Condition Compile(const ScorePredicate* predicate, PredicateInputs& inputs);

  /// Gives back the room that building needed.
  void Seal();

  /// `values` are a CaseVector's.
  ScorePredicate::PredicateResult Evaluate(const Condition& condition, const double* values) const;

  /// The bytes that the table holds beside the conditions that Compile returned.
  std::size_t GetMemorySize() const;

 private:
  struct CodeRun {
    std::int32_t first;
    std::int32_t last;
  };

  Condition CompileNumber(const ScaleSplit& split, PredicateInputs& inputs);
  Condition CompileCategory(const DiscreteSplit& split, PredicateInputs& inputs);
  void AddPart(const ScorePredicate* predicate, PredicateInputs& inputs);
  ScorePredicate::PredicateResult EvaluateCategory(const Condition& condition, double code) const;
  ScorePredicate::PredicateResult EvaluateCompound(std::size_t part, const double* values) const;

  std::vector<Condition> parts_;  ///< compounds, each followed by its children
  std::vector<CodeRun> runs_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_CONDITIONTABLE_H
