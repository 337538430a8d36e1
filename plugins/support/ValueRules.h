// A variable's rules for missing and valid values, compiled so that a case's values are judged without
// walking sets of polymorphic ranges and labels.

#ifndef KESTREL_PLUGINS_SUPPORT_VALUERULES_H
#define KESTREL_PLUGINS_SUPPORT_VALUERULES_H

#include <string_view>
#include <vector>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/TextCodes.h"
#include "kestrel/foundation/ScoreValue.h"
#include "plugins/support/NumberCodes.h"

namespace MCKestrel_800 {

/// What a variable says of a value: exactly what its IsMissingValue and IsValidValue say, and the code of its
/// category.
///
/// Codes of a categorical variable with labels are those of its encoder, or the labels' positions where it
/// has none; other variables have the values that AddCategory was given. What the compiled form cannot hold
/// (values of a kind other than the variable's, texts of a host's own class, ranges of texts, dates with
/// missing values) is asked of the variable itself, which may allocate. The variable must outlive the rules
/// and not change. Built on one thread, then only read.
class ValueRules {
 public:
  enum Verdict { kValid, kMissing, kInvalid };
  static constexpr int kUnknown = -1;

  explicit ValueRules(const ScoreDictVar& variable);
  ValueRules(const ValueRules&) = delete;
  ValueRules& operator=(const ValueRules&) = delete;

  /// Gives a value of the variable's kind a code: the next free one, unless it has one. kUnknown when the
  /// variable lists its categories and the value is not among them, or when it is of another kind. Not to be
  /// called after Seal.
  int AddCategory(const ScoreValue& value);

  /// To be called once, after the last AddCategory and before the first case.
  void Seal();

  /// The number of codes, the unused ones below the highest included.
  int GetCodeCount() const { return code_count_; }

  /// Judges a value, which may be null.
  Verdict Judge(const ScoreValue* value) const;
  /// The code of a value, or kUnknown.
  int FindCode(const ScoreValue& value) const;

  /// The same for a plain number in a numeric variable and for a text in a text variable.
  Verdict JudgeNumber(double number) const;
  Verdict JudgeText(std::string_view text) const;
  /// The same with the code, found on the way: kUnknown unless the value is valid and has one.
  Verdict JudgeText(std::string_view text, int& code) const;

  /// Whether a numeric variable's numbers are all valid but for the system-missing one.
  bool TakesEveryNumber() const { return compiled_ && ranges_.empty() && !lists_categories_; }

  const ScoreDictVar& GetVariable() const { return variable_; }

 private:
  struct NumberRange {
    double low;
    double high;
    bool low_included;
    bool high_included;
    bool single;
    bool Contains(double number) const;
  };

  void CompileMissingValues();
  void CompileLabels();
  bool AddRange(const ScoreValueRange& range);
  Verdict Ask(const ScoreValue& value) const;

  const ScoreDictVar& variable_;
  const ScoreDictVar::VariableType type_;
  /// Whether JudgeNumber or JudgeText, by the variable's type, says what the variable says.
  bool compiled_ = true;
  /// Whether only listed categories are valid.
  bool lists_categories_ = false;
  int code_count_ = 0;
  std::vector<NumberRange> ranges_;
  TextCodes missing_texts_;
  TextCodes texts_;
  NumberCodes numbers_;
  /// The labels' numbers, which are never user-missing; for a continuous variable they are no categories.
  NumberCodes labelled_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_VALUERULES_H
