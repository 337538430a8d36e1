// Reads a predicate from text, the way a plug-in does, and asks it about cases on both roads.

#ifndef KESTREL_TESTS_SUPPORT_PREDICATETEXT_H
#define KESTREL_TESTS_SUPPORT_PREDICATETEXT_H

#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/DictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/predicates/ScorePredicate.h"
#include "tests/support/DictionaryText.h"

namespace kestrel_test {

/// A predicate element read with the reader of its tag.
inline std::unique_ptr<MCKestrel_800::ScorePredicate> ReadPredicateElement(
    xercesc::DOMElement* element, const MCKestrel_800::ScoreDictionary& dictionary,
    bool ordinalAsScale = false, const MCKestrel_800::ScoreDictionary* derived = nullptr) {
  using MCKestrel_800::PMMLTranslator;
  MCKestrel_800::ScorePredicate* predicate = nullptr;
  if (MCKestrel_800::ElementIs(element, u"SimpleSetPredicate")) {
    predicate = PMMLTranslator::ParseSetPredicate(element, &dictionary, derived);
  } else if (MCKestrel_800::ElementIs(element, u"CompoundPredicate")) {
    predicate = PMMLTranslator::ParseCompoundPredicate(element, &dictionary, derived, ordinalAsScale);
  } else {
    predicate = PMMLTranslator::ParsePredicate(element, &dictionary, derived, ordinalAsScale);
  }
  return std::unique_ptr<MCKestrel_800::ScorePredicate>(predicate);
}

/// The predicate of a document whose root it is.
inline std::unique_ptr<MCKestrel_800::ScorePredicate> ReadPredicate(
    const std::string& xml, const MCKestrel_800::ScoreDictionary& dictionary, bool ordinalAsScale = false,
    const MCKestrel_800::ScoreDictionary* derived = nullptr) {
  const auto tree = ReadTree(xml);
  return ReadPredicateElement(tree->GetRoot(), dictionary, ordinalAsScale, derived);
}

/// A dictionary whose variables know their places in a flat vector.
inline std::unique_ptr<MCKestrel_800::ScoreDictionary> ReadIndexedDictionary(const std::string& xml) {
  auto dictionary = ReadDictionary(xml);
  int index = 0;
  for (MCKestrel_800::ScoreDictVar* variable : dictionary->GetScoreDictVars())
    variable->SetEncodedValueIndex(index++);
  return dictionary;
}

/// Replaces a variable's encoder, by none if it is null.
inline void ReplaceEncoder(MCKestrel_800::ScoreDictVar& variable, MCKestrel_800::ScoreEncoder* encoder) {
  delete variable.GetEncoder();
  variable.SetEncoder(encoder);
}

/// A value of the variable's kind: of a date/time the number in its unit. "-" is no value; "_" is a blank.
inline std::unique_ptr<MCKestrel_800::ScoreValue> ValueFor(const MCKestrel_800::ScoreDictVar& variable,
                                                           std::string text) {
  using namespace MCKestrel_800;
  if (text == "-") return nullptr;
  for (char& c : text)
    if (c == '_') c = ' ';
  switch (variable.GetVarType()) {
    case ScoreDictVar::STRING_VAR:
      return std::make_unique<StringValue>(text);
    case ScoreDictVar::kDATETIME_VAR:
      return std::make_unique<DateTimeValue>(NumericValue(text).GetDouble(), variable.GetDateTimeType());
    default:
      return std::make_unique<NumericValue>(text);
  }
}

/// What a flat vector holds for a value, written by the rules of ScorePredicate: as a category's code the
/// encoder's, or the position in the list. With `asNumber` an ordinal variable has its number there; a
/// missing one stays -2, since the variable is ordinal.
inline double VectorEntry(const MCKestrel_800::ScoreDictVar& variable, const MCKestrel_800::ScoreValue* value,
                          bool asNumber) {
  using namespace MCKestrel_800;
  const ScoreDictVar::MeasureLevel level = variable.GetMLevel();
  if (variable.IsMissingValue(value)) {
    return level == ScoreDictVar::kContinuous ? NumericValue::gSysmisValue : -2.0;
  }
  if (asNumber || level == ScoreDictVar::kContinuous) {
    const auto* date = dynamic_cast<const DateTimeValue*>(value);
    return date != nullptr ? date->GetDoubleValue(variable.GetDateTimeType()) : value->GetDouble();
  }
  int code = -1;
  if (variable.GetEncoder() != nullptr) {
    code = variable.GetEncoder()->EncodeConst(value);
  } else if (variable.IsValidValue(value)) {
    const auto& labels = variable.GetValueLabels()->GetAllValueLabels();
    for (size_t i = 0; i < labels.size() && code < 0; ++i) {
      const ScoreValue& label = *labels[i]->GetValue();
      const bool same = variable.GetVarType() == ScoreDictVar::STRING_VAR
                            ? label.Equal(value, variable.GetNoSpaceTrim(), variable.GetEmptyStringOK())
                            : label == *value;
      if (same) code = static_cast<int>(i);
    }
  }
  return code < 0 && level == ScoreDictVar::kNominal ? -2.0 : code;
}

/// 'T', 'F', 'U' or 'S' for the four results.
inline char ResultLetter(MCKestrel_800::ScorePredicate::PredicateResult result) {
  return "TFUS"[result];
}

/// The results of a predicate for one value of one field, every other field being missing: first on a record,
/// then on a flat vector.
struct BothRoads {
  char record;
  char vector;
};
inline BothRoads Ask(const MCKestrel_800::ScorePredicate& predicate,
                     const MCKestrel_800::ScoreDictionary& dictionary, const std::string& field,
                     const std::string& text, bool ordinalAsScale = false) {
  using namespace MCKestrel_800;
  CaseRecord record;
  std::vector<double> values;
  for (const ScoreDictVar* variable : dictionary.GetScoreDictVars()) {
    const auto value = ValueFor(*variable, variable->GetName() == field ? text : "-");
    const bool asNumber = ordinalAsScale && variable->GetVarType() != ScoreDictVar::STRING_VAR &&
                          variable->GetMLevel() == ScoreDictVar::kOrdinal;
    values.push_back(VectorEntry(*variable, value.get(), asNumber));
    if (value != nullptr) record.Add(variable->GetName(), value->Clone());
  }
  return {ResultLetter(predicate.Evaluate(&record, nullptr)), ResultLetter(predicate.Evaluate(values))};
}

/// The text that a row of probes should be, "value:result ...", with the results that came out; a result on
/// which the two roads differ is shown as both.
inline std::string Answers(const MCKestrel_800::ScorePredicate& predicate,
                           const MCKestrel_800::ScoreDictionary& dictionary, const std::string& field,
                           const std::string& probes, bool ordinalAsScale = false) {
  std::istringstream words(probes);
  std::string answers;
  for (std::string word; words >> word;) {
    const std::string value = word.substr(0, word.rfind(':'));
    const BothRoads results = Ask(predicate, dictionary, field, value, ordinalAsScale);
    answers += (answers.empty() ? "" : " ") + value + ":" + results.record;
    if (results.vector != results.record) answers += std::string("/") + results.vector;
  }
  return answers;
}

}  // namespace kestrel_test

#endif  // KESTREL_TESTS_SUPPORT_PREDICATETEXT_H
