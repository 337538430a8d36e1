// The fields that a model's predicates read, as slots of its CaseVector.

#ifndef KESTREL_PLUGINS_SUPPORT_PREDICATEINPUTS_H
#define KESTREL_PLUGINS_SUPPORT_PREDICATEINPUTS_H

namespace MCKestrel_800 {

class CaseVector;
class MiningSchema;
class ScoreDictVar;
class ScoreDictionary;

/// Gives each variable that a predicate names a slot, once, and keeps it as the variable's encoded value
/// index: predicate objects that are evaluated on the CaseVector's values find their input where it is. A
/// value that is no category of a nominal field counts as missing here, as it does for predicates on records.
class PredicateInputs {
 public:
  /// All three must outlive this object; `dictionary` is the one that the schema was read with. Forgets the
  /// indexes that its variables bring along: it may be a copy of another model's.
  PredicateInputs(const MiningSchema& schema, ScoreDictionary& dictionary, CaseVector& inputs);

  /// Errors: code 8 for a variable that is no active field of the schema.
  int SlotOf(const ScoreDictVar& variable);

 private:
  const MiningSchema& schema_;
  ScoreDictionary& dictionary_;
  CaseVector& inputs_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_PREDICATEINPUTS_H
