#include "plugins/support/PredicateInputs.h"

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/ReaderFault.h"
#include "plugins/support/CaseVector.h"
#include "plugins/support/MiningSchema.h"
#include "plugins/support/ModelDictionaries.h"

namespace MCKestrel_800 {
namespace {

void ForgetIndexes(const ScoreDictionary& dictionary) {
  for (ScoreDictVar* variable : dictionary.GetScoreDictVars())
    variable->SetEncodedValueIndex(-1);
}

}  // namespace

PredicateInputs::PredicateInputs(const MiningSchema& schema, const ModelDictionaries& dictionaries,
                                 CaseVector& inputs)
    : schema_(schema), dictionaries_(dictionaries), inputs_(inputs) {
  ForgetIndexes(*dictionaries.data);
  if (dictionaries.derived != nullptr) ForgetIndexes(*dictionaries.derived);
}

const ScoreDictionary* PredicateInputs::GetData() const {
  return dictionaries_.data.get();
}

const ScoreDictionary* PredicateInputs::GetDerived() const {
  return dictionaries_.derived.get();
}

int PredicateInputs::SlotOf(const ScoreDictVar& variable) {
  if (variable.GetEncodedValueIndex() >= 0) return variable.GetEncodedValueIndex();
  const MiningField* field = schema_.FindInput(variable.GetName());
  if (field == nullptr) {
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
  ScoreDictVar* own = dictionaries_.data->GetVar(variable.GetName());
  if (own == nullptr) own = dictionaries_.derived->GetVar(variable.GetName());
  own->SetEncodedValueIndex(slot);
  return slot;
}

}  // namespace MCKestrel_800
