// What one case holds for the variable of a simple or set predicate.

#ifndef KESTREL_PREDICATES_SPLITINPUT_H
#define KESTREL_PREDICATES_SPLITINPUT_H

#include <cstddef>
#include <vector>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/predicates/ScorePredicate.h"
#include "kestrel/predicates/ScoreSplitVar.h"

namespace MCKestrel_800 {

class ScoreCaseRecord;
class ScoreEncoder;
class ScoreValue;

/// The variable's value in the records; null when there is none. Only the derived record is searched for a
/// derived variable, if it is given, else only the input record.
const ScoreValue* GetScoreValue(const ScoreDictVar& variable, const ScoreCaseRecord* record,
                                const ScoreCaseRecord* derivedRecord);

/// The variable's part of a record.
struct RecordInput {
  const ScoreValue* value;
  /// Null where the variable has none.
  const ScoreEncoder* encoder;
  /// The value's category code, -1 for a value that is no category; the system-missing value without a value
  /// or encoder.
  double code;
  bool missing;
};
RecordInput FindInput(const ScoreDictVar& variable, const ScoreCaseRecord* record,
                      const ScoreCaseRecord* derivedRecord);

/// Whether a flat vector holds the variable's category codes.
inline bool IsEncoded(const ScoreDictVar& variable) {
  const ScoreDictVar::MeasureLevel level = variable.GetMLevel();
  return level == ScoreDictVar::kOrdinal || level == ScoreDictVar::kNominal;
}

/// The variable's number in a flat vector. A category that is not there is no category, and so differs from
/// one that is missing; a number that is not there is missing.
inline double FindNumber(const ScoreDictVar& variable, const std::vector<double>& values) {
  constexpr double kNoCategory = -1.0;
  // A negative index becomes a number beyond every size.
  const auto index = static_cast<std::size_t>(variable.GetEncodedValueIndex());
  if (index < values.size()) return values[index];
  return IsEncoded(variable) ? kNoCategory : NumericValue::gSysmisValue;
}

/// Whether a number is the missing marker of its variable. The level is asked for only where it matters: a
/// virtual call is a good part of an evaluation.
inline bool IsMissingMarker(const ScoreDictVar& variable, double x) {
  constexpr double kMissingCategory = -2.0, kMissingNumber = NumericValue::gSysmisValue;
  if (x == kMissingNumber) return !IsEncoded(variable);
  return x == kMissingCategory && IsEncoded(variable);
}

/// The variable that a predicate asks about; null when it has no split or the split has no variable.
inline const ScoreDictVar* VariableOf(const ScoreSplitVar* split) {
  return split == nullptr ? nullptr : split->GetSplitVar();
}

inline ScorePredicate::PredicateResult ResultOfChild(int child) {
  return child == -1 ? ScorePredicate::PredFalse : ScorePredicate::PredTrue;
}

}  // namespace MCKestrel_800

#endif  // KESTREL_PREDICATES_SPLITINPUT_H
