// A field that derived fields read, with its value in the case at hand as each of them wants to see it.

#ifndef KESTREL_TRANSFORM_SOURCEFIELD_H
#define KESTREL_TRANSFORM_SOURCEFIELD_H

#include <cstdint>
#include <string>

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

/// Looks at a value once for all derived fields that read it. The value and the variable must live as long as
/// they are used here. The addresses of the views stay the same from case to case: what is computed from them
/// is bound to them once.
class SourceField {
 public:
  enum class Kind : std::uint8_t { kNone, kNumber, kText, kDateTime, kOther };

  /// variable  whose rules say what is missing; null when nobody knows the field: then the system-missing
  ///           value alone is.
  explicit SourceField(const ScoreDictVar* variable);
  SourceField(const SourceField&) = delete;
  SourceField& operator=(const SourceField&) = delete;

  /// Takes the value of a case; null when there is none.
  void Set(const ScoreValue* value);

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
  /// The seconds of a date/time; the system-missing value for everything else.
  const double& GetSeconds() const { return seconds_; }
  /// The text; the empty one for everything else. Never null.
  const StringValue* const& GetText() const { return text_; }
  /// Where values equal to this one are filed; computed when it is first asked for.
  const ValueKey& GetKey() const;

  /// Gives texts codes, so that a text is looked up once for all fields that list texts. `codes` must outlive
  /// this object.
  void SetCodes(const TextCodes* codes) { codes_ = codes; }
  /// The code of the text at hand, which must be one; TextCodes::kUnknown when it has none. Looked up when it
  /// is first asked for.
  int GetTextCode() const {
    if (!has_code_) {
      code_ = codes_->Find(text_->GetText());
      has_code_ = true;
    }
    return code_;
  }

 private:
  void SetOther(const ScoreValue& value);
  bool AsksForMissing(const ScoreValue& value) const;

  const ScoreDictVar* variable_;
  /// Whether the variable calls no value missing but the system-missing number, and whether it does that.
  bool takes_every_value_;
  bool misses_sysmis_;
  mutable bool has_key_ = false;
  mutable bool has_code_ = false;
  bool is_missing_ = true;
  Kind kind_ = Kind::kNone;
  const ScoreValue* value_ = nullptr;
  double number_ = NumericValue::gSysmisValue;
  double seconds_ = NumericValue::gSysmisValue;
  const StringValue* text_;
  mutable ValueKey key_;
  const TextCodes* codes_ = nullptr;
  mutable int code_ = TextCodes::kUnknown;
  StringValue copied_text_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_SOURCEFIELD_H
