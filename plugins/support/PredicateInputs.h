// The fields that a model's predicates read, as slots of its CaseVector.

#ifndef KESTREL_PLUGINS_SUPPORT_PREDICATEINPUTS_H
#define KESTREL_PLUGINS_SUPPORT_PREDICATEINPUTS_H

namespace MCKestrel_800 {

class CaseVector;
class MiningSchema;
class ScoreDictVar;
class ScoreDictionary;
struct ModelDictionaries;

/// Gives each variable that a predicate names a slot, once, and keeps it as the variable's encoded value
/// index: predicate objects that are evaluated on the CaseVector's values find their input where it is. A
/// value that is no category of a nominal field counts as missing here, as it does for predicates on records.
class PredicateInputs {
 public:
  /// All three must outlive this object; the dictionaries are those that the schema was read with. Forgets
  /// the indexes that their variables bring along: they may be copies of another model's.
  PredicateInputs(const MiningSchema& schema, const ModelDictionaries& dictionaries, CaseVector& inputs);

  /// Errors: code 8 for a variable that the schema does not give as an input.
  int SlotOf(const ScoreDictVar& variable);

  /// Where predicates look their fields up: the data fields, and the derived ones, null when there are none.
  const ScoreDictionary* GetData() const;
  const ScoreDictionary* GetDerived() const;

 private:
  const MiningSchema& schema_;
  const ModelDictionaries& dictionaries_;
  CaseVector& inputs_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_PREDICATEINPUTS_H
