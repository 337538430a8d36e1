// A field that derived fields read, with its value in the case at hand as each of them wants to see it.

#ifndef KESTREL_TRANSFORM_SOURCEFIELD_H
#define KESTREL_TRANSFORM_SOURCEFIELD_H

#include <cstdint>
#include <limits>
#include <string>
#include <typeinfo>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/TextCodes.h"
#include "kestrel/dictionary/ValueIndex.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"

namespace MCKestrel_800 {

/// The number that all of a text but blanks around it reads as; the system-missing value when it is none, or
/// too large.
double NumberIn(const std::string& text);
/// The number of a value: the seconds of a date/time, of a text the number that it reads as.
double NumberOf(const ScoreValue& value);

/// A number as arithmetic takes it: NaN where it is missing, which goes from operands to results by itself.
/// Minus infinity is missing, as it is wherever numbers are computed with.
constexpr double kMissingOperand = std::numeric_limits<double>::quiet_NaN();
inline double AsOperand(double number) {
  return number > NumericValue::gSysmisValue ? number : kMissingOperand;
}

/// Looks at a value once for all derived fields that read it. The value and the variable must live as long as
/// they are used here. The addresses of the views stay the same from case to case: what is computed from them
/// is bound to them once.
class SourceField {
 public:
  enum class Kind : std::uint8_t { kNone, kNumber, kText, kDateTime, kOther };
  static constexpr int kNotLookedUp = TextCodes::kUnknown - 1;

  /// variable  whose rules say what is missing; null when nobody knows the field: then the system-missing
  ///           value alone is.
  explicit SourceField(const ScoreDictVar* variable);
  SourceField(const SourceField&) = delete;
  SourceField& operator=(const SourceField&) = delete;

  /// Takes the value of a case; null when there is none. Most values are of the class of the one before.
  void Set(const ScoreValue* value) {
    value_ = value;
    has_key_ = false;
    code_ = kNotLookedUp;
    if (value == nullptr || &typeid(*value) != plain_type_) {
      SetNew(value);
    } else if (kind_ == Kind::kNumber) {
      number_ = static_cast<const NumericValue*>(value)->NumericValue::GetDouble();
      operand_ = AsOperand(number_);
      is_missing_ = number_ == missing_number_;
    } else {
      text_ = static_cast<const StringValue*>(value);
      is_missing_ = false;
    }
    if (!takes_every_value_) AskForMissing();
  }

  const ScoreDictVar* GetVariable() const { return variable_; }
  bool HasValue() const { return value_ != nullptr; }
  const ScoreValue* GetValue() const { return value_; }
  Kind GetKind() const { return kind_; }
  /// Whether the value is absent or the variable says that it is missing.
  bool IsMissing() const { return is_missing_; }

  /// Whether the value is a number that is not missing.
  bool IsNumber() const { return kind_ == Kind::kNumber && !is_missing_; }

  /// The number, or the seconds of a date/time; the system-missing value for everything else.
  const double& GetNumber() const { return number_; }
  /// The number as an operand.
  const double& GetOperand() const { return operand_; }
  /// The seconds of a date/time; the system-missing value for everything else.
  const double& GetSeconds() const { return seconds_; }
  /// The text; the empty one for everything else. Never null.
  const StringValue* const& GetText() const { return text_; }
  /// Where values equal to this one are filed; computed when it is first asked for.
  const ValueKey& GetKey() const;

  /// Gives texts codes, so that a text is looked up once for all fields that list texts. `codes` must outlive
  /// this object.
  void SetCodes(const TextCodes* codes) { codes_ = codes; }
  /// Looks up the code of the text at hand; TextCodes::kUnknown when it has none. The value must be a text
  /// and there must be codes.
  void LookUpTextCode() const { code_ = codes_->Find(text_->GetText()); }
  /// What was looked up; kNotLookedUp when the value at hand is no text, or that is still to be done.
  int GetTextCode() const { return code_; }

 private:
  void SetNew(const ScoreValue* value);
  void SetOther(const ScoreValue& value);
  void AskForMissing();

  const ScoreDictVar* variable_;
  /// Whether the variable calls no value missing but the one number, which is NaN when it calls none missing.
  bool takes_every_value_;
  double missing_number_;
  /// The class of the value at hand when it is a number or a text of the library's own.
  const std::type_info* plain_type_ = nullptr;
  mutable bool has_key_ = false;
  bool is_missing_ = true;
  Kind kind_ = Kind::kNone;
  const ScoreValue* value_ = nullptr;
  double number_ = NumericValue::gSysmisValue;
  double operand_ = kMissingOperand;
  double seconds_ = NumericValue::gSysmisValue;
  const StringValue* text_;
  mutable ValueKey key_;
  const TextCodes* codes_ = nullptr;
  mutable int code_ = kNotLookedUp;
  StringValue copied_text_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_SOURCEFIELD_H
