// What a derived field computes with: its definition prepared.

#ifndef KESTREL_TRANSFORM_FIELDEVALUATION_H
#define KESTREL_TRANSFORM_FIELDEVALUATION_H

#include <cstddef>
#include <string>
#include <vector>

#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/transform/BinTable.h"
#include "kestrel/transform/EncodingTable.h"
#include "kestrel/transform/FunctionEvaluation.h"
#include "kestrel/transform/NormCurve.h"
#include "kestrel/transform/SourceField.h"
#include "kestrel/transform/TransformVar.h"

namespace MCKestrel_800 {

/// Bound to one field, which must not change. Results are of the field's storage type: a number, a date/time
/// (computed with as the number of its seconds) or, for every other type, a text. They are written where the
/// caller says, into a value of just that type and of the library's own class.
class FieldEvaluation {
 public:
  enum class Storage { kNumber, kDateTime, kText };

  explicit FieldEvaluation(const TransformVar& field);
  FieldEvaluation(const FieldEvaluation&) = delete;
  FieldEvaluation& operator=(const FieldEvaluation&) = delete;

  Storage GetStorage() const { return storage_; }
  /// A value of the storage type for results that go nowhere else.
  ScoreValue& GetOwnResult() { return *result_; }

  /// The missing value of the storage type.
  void GiveMissing(ScoreValue& to);
  /// A result that was computed elsewhere; what is no finite number is missing, a text is cut to the width.
  void GiveNumber(double number, ScoreValue& to) {
    if (storage_ == Storage::kNumber) {
      static_cast<NumericValue&>(to).SetDoubleValue(NumberOrMissing(number));
    } else {
      GiveSeconds(number, to);
    }
  }
  void GiveText(const StringValue& text, ScoreValue& to);
  /// The result of an encoding row or a bin; a number that none has, as kNone is, when none applies to the
  /// source's value.
  void GiveRow(std::size_t row, const SourceField& source, ScoreValue& to) {
    if (row < given_numbers_) {
      static_cast<NumericValue&>(to).SetDoubleValue(row_numbers_[row]);
    } else {
      GiveOtherRow(row, source, to);
    }
  }

  /// Computes every kind of expression but Apply, whose results are computed elsewhere.
  void Compute(const SourceField& source, ScoreValue& to) { (this->*compute_)(source, to); }

  /// The same for the one kind, of which the field must be: a normalised number, a bin.
  void ComputeNorm(const SourceField& source, ScoreValue& to) {
    if (source.IsNumber() && curve_.IsPlainAt(source.GetNumber())) {
      static_cast<NumericValue&>(to).SetDoubleValue(curve_.ComputePlain(source.GetNumber()));
    } else {
      ComputeOtherNorm(source, to);
    }
  }
  void ComputeBin(const SourceField& source, ScoreValue& to) {
    const std::size_t row = bins_.FindInside(source.GetNumber());
    if (row < given_numbers_) {
      static_cast<NumericValue&>(to).SetDoubleValue(row_numbers_[row]);
    } else {
      ComputeOtherBin(row, source, to);
    }
  }

  const EncodingTable& GetEncodings() const { return encodings_; }

  /// The encoded or binned value of the source's value, which may be absent: one of the field's own values or
  /// a result of this object.
  const ScoreValue* Encode(const SourceField& source);
  const ScoreValue* Bin(const SourceField& source);
  const ScoreValue* Recode(const SourceField& source, bool is_string);
  double Norm(double x) const { return curve_.Compute(x); }

 private:
  using Computing = void (FieldEvaluation::*)(const SourceField&, ScoreValue&);

  /// A value of the definition as both kinds of fields use it.
  struct Replacement {
    explicit Replacement(const ScoreValue* value);
    bool is_set;
    double number = NumericValue::gSysmisValue;
    StringValue text;
    bool HasNumber() const { return is_set && !NumericValue::IsSystemMissingValue(number); }
  };

  void ComputeConstant(const SourceField& source, ScoreValue& to);
  void ComputeFieldRef(const SourceField& source, ScoreValue& to);
  void ComputeEncoding(const SourceField& source, ScoreValue& to);
  void ComputeNothing(const SourceField& source, ScoreValue& to);

  void ComputeOtherNorm(const SourceField& source, ScoreValue& to);
  void ComputeOtherBin(std::size_t row, const SourceField& source, ScoreValue& to);
  void GiveSeconds(double seconds, ScoreValue& to) const;
  void ReadConstant();
  void GiveOtherRow(std::size_t row, const SourceField& source, ScoreValue& to);
  void PrepareRow(const ScoreValue* value, bool copies_input);
  void Take(const ScoreValue* value, ScoreValue& to);
  void GiveString(const std::string& text, ScoreValue& to);
  const ScoreValue* RecodeText(const SourceField& source);
  const ScoreValue* RecodeNumber(const SourceField& source);
  const ScoreValue* RecodeAbsent(bool uses_text);
  const ScoreValue* RecodedNumber(double number);
  bool IsText() const { return storage_ == Storage::kText; }

  const TransformVar& field_;
  Storage storage_;
  Computing compute_;
  DateTimeValType date_kind_ = kDateTimeVal;
  NumericValue number_;
  DateTimeValue date_;
  StringValue text_;
  ScoreValue* result_;

  Replacement missing_;
  Replacement default_;
  Replacement sysmis_;
  NormCurve curve_;
  // By row or bin, as the storage type has it.
  std::vector<double> row_numbers_;
  /// How many rows give a number to a number: all or none.
  std::size_t given_numbers_ = 0;
  BinTable bins_;
  EncodingTable encodings_;
  std::vector<StringValue> row_texts_;
  std::vector<bool> row_copies_;  ///< whether it gives the input itself; empty when none does
  NumericValue recoded_number_;
  DateTimeValue recoded_date_;
  StringValue recoded_text_;
  std::string cut_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_FIELDEVALUATION_H
