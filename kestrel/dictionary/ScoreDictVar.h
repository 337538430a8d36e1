// One input field of a model.

#ifndef KESTREL_DICTIONARY_SCOREDICTVAR_H
#define KESTREL_DICTIONARY_SCOREDICTVAR_H

#include <cstddef>
#include <iosfwd>
#include <string>

#include "kestrel/dictionary/ScoreEncoder.h"
#include "kestrel/dictionary/ScoreMissingValueSet.h"
#include "kestrel/dictionary/ScoreValueLabelSet.h"
#include "kestrel/dictionary/ScoreValueProbabilitySet.h"
#include "kestrel/dictionary/ScoreVarStats.h"
#include "kestrel/foundation/DateTimeType.h"
#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// A variable: its name, its storage kind and measurement level, the values it may take and those that count
/// as missing. `IsMissingValue` and `IsValidValue` are the one test of missing and valid case values.
///
/// Setters that take an object own it from then on and overwrite the pointer held so far without deleting
/// that object: whoever replaces one disposes of the old one. What getters return stays owned by the
/// variable.
///
/// A variable is built on one thread; afterwards several threads may read it as long as nobody calls a
/// setter.
class KESTREL_API ScoreDictVar {
 public:
  enum VariableType : int { kNUMERIC_VAR = 0, STRING_VAR = 1, kDATETIME_VAR = 4 };
  enum MeasureLevel : int { kContinuous = 0, kOrdinal = 1, kNominal = 2 };
  enum NumericDataType : int { kUnspecified = 0, kInteger = 1, kDouble = 2 };
  enum OutlierHandleMethod : int { kAsIs = 0, kAsMissingValues = 1, kAsExtremeValues = 2 };
  using DateTimeType = MCKestrel_800::DateTimeType;

  virtual ~ScoreDictVar();

  /// A deep copy, owned by the caller.
  virtual ScoreDictVar* Clone() const = 0;
  /// True when the names are the same bytes; nothing else is compared.
  virtual bool operator==(const ScoreDictVar& other) const = 0;

  /// True for null; for the system-missing number of a variable that is not a text; and for a value in one of
  /// the missing ranges, unless the variable is not a text and the value carries a label.
  virtual bool IsMissingValue(const ScoreValue* value) const = 0;
  /// False for a missing value. A categorical variable with labels takes the labelled values alone, a numeric
  /// variable without labels takes numbers and dates, any other variable takes everything.
  virtual bool IsValidValue(const ScoreValue* value) const = 0;

  /// An empty name is refused: false, nothing changes.
  virtual bool SetName(const std::string& name) = 0;
  virtual void SetLabel(const std::string& label) = 0;
  virtual void SetVarType(VariableType type) = 0;
  virtual void SetMLevel(MeasureLevel level) = 0;
  virtual void SetFormat(int decimals, int width) = 0;
  virtual void SetDecimal(int decimals) = 0;
  virtual void SetWidth(int width) = 0;
  virtual const std::string& GetName() const = 0;
  virtual const std::string& GetLabel() const = 0;
  virtual VariableType GetVarType() const = 0;
  virtual MeasureLevel GetMLevel() const = 0;
  virtual int GetDecimal() const = 0;
  /// In characters; -1 until a width is set.
  virtual int GetWidth() const = 0;
  virtual ScoreVarStats* GetVarStats() const = 0;
  virtual void SetVarStats(ScoreVarStats* stats) = 0;
  virtual ScoreValueLabelSet* GetValueLabels() const = 0;
  /// The label of the first category equal to `value`; empty when there is none.
  virtual std::string GetLabelOfValue(const ScoreValue* value) const = 0;
  virtual ScoreMissingValueSet* GetMissingValues() const = 0;
  virtual void SetMissingValues(ScoreMissingValueSet* missingValues) = 0;
  virtual void SetValueLabels(ScoreValueLabelSet* valueLabels) = 0;
  /// A new value of this variable's storage kind read from the text, owned by the caller; null for a kind
  /// other than number and text.
  virtual ScoreValue* ToMyValue(const std::string& text) const = 0;
  virtual void Display(std::ostream& os) const = 0;
  /// 1 for a continuous variable, else the number of value labels.
  virtual int GetNumberOfCats() const = 0;
  /// The variable's position in a model's case; -1 until it is set.
  virtual void SetValueIndex(int index) = 0;
  /// The variable's position in a model's vector of encoded values; -1 until it is set.
  virtual void SetEncodedValueIndex(int index) = 0;
  virtual int GetValueIndex() const = 0;
  virtual int GetEncodedValueIndex() const = 0;
  /// Whether trailing blanks count when a text is matched with the categories. Ignored unless the variable is
  /// a text.
  virtual void SetNoSpaceTrim(bool noSpaceTrim) = 0;
  virtual bool GetNoSpaceTrim() const = 0;
  /// Whether the empty text is a value. Ignored unless the variable is a text.
  virtual void SetEmptyStringOK(bool emptyStringOK) = 0;
  virtual bool GetEmptyStringOK() const = 0;
  virtual const std::string& GetXMeasure() const = 0;
  virtual void SetXMeasure(const std::string& xMeasure) = 0;
  /// A continuous variable refuses: false, nothing changes.
  virtual bool SetFlagVariable(bool flag) = 0;
  virtual bool IsFlagVariable() const = 0;
  /// One of `OutlierHandleMethod`.
  virtual void SetOutlierHandleMethod(int method) = 0;
  virtual int GetOutlierHandleMethod() const = 0;
  /// True for a variable that is computed from others.
  virtual bool IsDerivedVariable() const = 0;
  virtual void SetDateTimeType(DateTimeType type) = 0;
  virtual DateTimeType GetDateTimeType() const = 0;
  virtual void SetDefValue(ScoreValue* value) = 0;
  virtual ScoreValue* GetDefValue() const = 0;
  virtual void SetValueProbabilities(ScoreValueProbabilitySet* probabilities) = 0;
  virtual ScoreValueProbabilitySet* GetValueProbabilities() const = 0;
  virtual ScoreEncoder* GetEncoder() = 0;
  virtual const ScoreEncoder* GetEncoder() const = 0;
  virtual void SetEncoder(ScoreEncoder* encoder) = 0;
  virtual void SetEmptyCateValues(bool empty) = 0;
  virtual bool IsEmptyCateValues() const = 0;
  /// Adds a category. The variable gets an empty label set if it has none, whatever follows. A null value or
  /// an empty label is refused: false, and the caller keeps `value`. When the set holds an equal value,
  /// `value` is deleted and the result is false. Otherwise the variable owns `value`: true.
  virtual bool AddScoreValueLabel(ScoreValue* value, const std::string& label) = 0;
  virtual void SetNumericDataType(NumericDataType type) = 0;
  virtual NumericDataType GetNumericDataType() const = 0;
  virtual bool IsUsageTypeEnable() const = 0;
  virtual void SetUsageType(bool enabled) = 0;
  /// The text that stands for "true" in a flag variable. The spelling of the name is part of the interface.
  virtual void SetFalgTypeTrueValue(const std::string& value) = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_SCOREDICTVAR_H
