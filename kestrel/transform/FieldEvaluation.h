// What a derived field computes with: its definition prepared, and the value of the case at hand.

#ifndef KESTREL_TRANSFORM_FIELDEVALUATION_H
#define KESTREL_TRANSFORM_FIELDEVALUATION_H

#include <string>

#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/transform/BinTable.h"
#include "kestrel/transform/EncodingTable.h"
#include "kestrel/transform/NormCurve.h"
#include "kestrel/transform/TransformVar.h"

namespace MCKestrel_800 {

class SourceField;

/// Bound to one field, which must not change. The result is of the field's storage type: a number, a
/// date/time (computed with as the number of its seconds) or, for every other type, a text.
class FieldEvaluation {
 public:
  enum class Storage { kNumber, kDateTime, kText };

  explicit FieldEvaluation(const TransformVar& field);
  FieldEvaluation(const FieldEvaluation&) = delete;
  FieldEvaluation& operator=(const FieldEvaluation&) = delete;

  Storage GetStorage() const { return storage_; }
  const ScoreValue& GetResult() const { return *result_; }
  const NumericValue& GetNumber() const { return number_; }
  const StringValue& GetText() const { return text_; }
  const DateTimeValue& GetDateTime() const { return date_; }

  /// The missing value of the storage type.
  void SetMissing();
  /// A result that was computed elsewhere; what is no finite number is missing.
  void TakeNumber(double number);
  void TakeText(const StringValue& text);

  /// Computes every kind of expression but Apply, which takes its result from outside.
  void Compute(const SourceField& source);

  /// The encoded or binned value of the source's value, which may be absent: one of the field's own values or
  /// a result of this object.
  const ScoreValue* Encode(const SourceField& source);
  const ScoreValue* Bin(const SourceField& source);
  const ScoreValue* Recode(const SourceField& source, bool is_string);
  double Norm(double x) const { return curve_.Compute(x); }

 private:
  /// A value of the definition as both kinds of fields use it.
  struct Replacement {
    explicit Replacement(const ScoreValue* value);
    bool is_set;
    double number = NumericValue::gSysmisValue;
    StringValue text;
    bool HasNumber() const { return is_set && !NumericValue::IsSystemMissingValue(number); }
  };

  void ComputeConstant();
  void ComputeFieldRef(const SourceField& source);
  void ComputeNorm(const SourceField& source);
  void Take(const ScoreValue* value);
  void CutText();
  const ScoreValue* RecodeText(const SourceField& source);
  const ScoreValue* RecodeNumber(const SourceField& source);
  const ScoreValue* RecodeAbsent(bool uses_text);
  const ScoreValue* RecodedNumber(double number);
  bool IsText() const { return storage_ == Storage::kText; }

  const TransformVar& field_;
  Storage storage_;
  NumericValue number_;
  DateTimeValue date_;
  StringValue text_;
  ScoreValue* result_;
  bool is_constant_done_ = false;

  Replacement missing_;
  Replacement default_;
  Replacement sysmis_;
  NormCurve curve_;
  BinTable bins_;
  EncodingTable encodings_;
  NumericValue recoded_number_;
  DateTimeValue recoded_date_;
  StringValue recoded_text_;
  std::string cut_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_FIELDEVALUATION_H
