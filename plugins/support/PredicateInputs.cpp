#include "plugins/support/PredicateInputs.h"

#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/ReaderFault.h"
#include "plugins/support/CaseVector.h"
#include "plugins/support/MiningSchema.h"

namespace MCKestrel_800 {

PredicateInputs::PredicateInputs(const MiningSchema& schema, ScoreDictionary& dictionary, CaseVector& inputs)
    : schema_(schema), dictionary_(dictionary), inputs_(inputs) {
  for (ScoreDictVar* variable : dictionary.GetScoreDictVars())
    variable->SetEncodedValueIndex(-1);
}

int PredicateInputs::SlotOf(const ScoreDictVar& variable) {
  if (variable.GetEncodedValueIndex() >= 0) return variable.GetEncodedValueIndex();
  const MiningField* field = schema_.Find(variable.GetName());
  if (field == nullptr || field->role != ScoreModel::kPredictor) {
    Fail(KestrelException::kUnknownVariable,
         "Variable " + variable.GetName() + " not among the active fields of the MiningSchema!");
  }
  int slot = 0;
  switch (variable.GetMLevel()) {
    case ScoreDictVar::kContinuous:
      slot = inputs_.AddNumber(*field);
      break;
    case ScoreDictVar::kOrdinal:
      slot = inputs_.AddCategory(*field);
      break;
    default:
      slot = inputs_.AddCategory(*field, CaseVector::kMissingCategory);
  }
  dictionary_.GetVar(variable.GetName())->SetEncodedValueIndex(slot);
  return slot;
}

}  // namespace MCKestrel_800
