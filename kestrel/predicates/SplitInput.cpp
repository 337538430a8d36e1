#include "kestrel/predicates/SplitInput.h"

#include "kestrel/dictionary/ScoreCaseRecord.h"

namespace MCKestrel_800 {

namespace {

const ScoreValue* FindValue(const ScoreDictVar& variable, const ScoreCaseRecord& record) {
  const std::string& name = variable.GetName();
  const int index = variable.GetValueIndex();
  // The index may come from a record of another layout; there it belongs to another variable.
  if (index >= 0 && record.HasMap() && record.GetIndex(name) == index) {
    const ScoreValue* value = record.Get(index);
    if (value != nullptr) return value;
  }
  return record.Get(name);
}

bool IsMissing(const ScoreDictVar& variable, const RecordInput& input) {
  if (input.value == nullptr) return true;
  if (variable.GetMLevel() != ScoreDictVar::kNominal) return variable.IsMissingValue(input.value);
  if (input.encoder == nullptr) return !variable.IsValidValue(input.value);
  return input.code == -1.0 || variable.IsMissingValue(input.value);
}

}  // namespace

const ScoreValue* GetScoreValue(const ScoreDictVar& variable, const ScoreCaseRecord* record,
                                const ScoreCaseRecord* derivedRecord) {
  const bool isDerived = derivedRecord != nullptr && variable.IsDerivedVariable();
  const ScoreCaseRecord* searched = isDerived ? derivedRecord : record;
  return searched == nullptr ? nullptr : FindValue(variable, *searched);
}

RecordInput FindInput(const ScoreDictVar& variable, const ScoreCaseRecord* record,
                      const ScoreCaseRecord* derivedRecord) {
  RecordInput input{GetScoreValue(variable, record, derivedRecord), variable.GetEncoder(),
                    NumericValue::gSysmisValue, false};
  if (input.value != nullptr && input.encoder != nullptr)
    input.code = input.encoder->EncodeConst(input.value);
  input.missing = IsMissing(variable, input);
  return input;
}

}  // namespace MCKestrel_800
