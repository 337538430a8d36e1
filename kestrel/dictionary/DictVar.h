// The one implementation of ScoreDictVar.

#ifndef KESTREL_DICTIONARY_DICTVAR_H
#define KESTREL_DICTIONARY_DICTVAR_H

#include <string>

#include "kestrel/dictionary/ScoreDictVar.h"

namespace MCKestrel_800 {

class MissingValueSet;
class ValueLabelSet;

/// A variable held as plain fields and owned objects. A text field with two categories, "n/a" missing:
///
///   auto var = std::make_unique<DictVar>("color", ScoreDictVar::STRING_VAR);
///   var->SetMLevel(ScoreDictVar::kNominal);
///   var->AddScoreValueLabel(new StringValue("r"), "red");
///   var->AddScoreValueLabel(new StringValue("g"), "green");
///   auto missing = std::make_unique<MissingValueSet>();
///   missing->Add(new Range(new StringValue("n/a")));
///   var->SetMissingValues(missing.release());
///   dictionary.AddVar("color", var.release());
///
/// Copies are deep. Assignment, unlike the setters, frees what the variable owned before.
class KESTREL_API DictVar : public ScoreDictVar {
 public:
  /// A continuous variable without categories, missing values or encoder. `name` is taken as it is.
  DictVar(const std::string& name, VariableType type);
  DictVar(const DictVar& other);
  DictVar& operator=(const DictVar& other);
  ~DictVar() override;

  DictVar* Clone() const override;
  bool operator==(const ScoreDictVar& other) const override;
  bool IsMissingValue(const ScoreValue* value) const override;
  bool IsValidValue(const ScoreValue* value) const override;
  bool SetName(const std::string& name) override;
  void SetLabel(const std::string& label) override;
  void SetVarType(VariableType type) override;
  void SetMLevel(MeasureLevel level) override;
  void SetFormat(int decimals, int width) override;
  void SetDecimal(int decimals) override;
  void SetWidth(int width) override;
  const std::string& GetName() const override;
  const std::string& GetLabel() const override;
  VariableType GetVarType() const override;
  MeasureLevel GetMLevel() const override;
  int GetDecimal() const override;
  int GetWidth() const override;
  ScoreVarStats* GetVarStats() const override;
  void SetVarStats(ScoreVarStats* stats) override;
  ScoreValueLabelSet* GetValueLabels() const override;
  std::string GetLabelOfValue(const ScoreValue* value) const override;
  ScoreMissingValueSet* GetMissingValues() const override;
  void SetMissingValues(ScoreMissingValueSet* missingValues) override;
  void SetValueLabels(ScoreValueLabelSet* valueLabels) override;
  ScoreValue* ToMyValue(const std::string& text) const override;
  void Display(std::ostream& os) const override;
  int GetNumberOfCats() const override;
  void SetValueIndex(int index) override;
  void SetEncodedValueIndex(int index) override;
  int GetValueIndex() const override;
  int GetEncodedValueIndex() const override;
  void SetNoSpaceTrim(bool noSpaceTrim) override;
  bool GetNoSpaceTrim() const override;
  void SetEmptyStringOK(bool emptyStringOK) override;
  bool GetEmptyStringOK() const override;
  const std::string& GetXMeasure() const override;
  void SetXMeasure(const std::string& xMeasure) override;
  bool SetFlagVariable(bool flag) override;
  bool IsFlagVariable() const override;
  void SetOutlierHandleMethod(int method) override;
  int GetOutlierHandleMethod() const override;
  bool IsDerivedVariable() const override;
  void SetDateTimeType(DateTimeType type) override;
  DateTimeType GetDateTimeType() const override;
  void SetDefValue(ScoreValue* value) override;
  ScoreValue* GetDefValue() const override;
  void SetValueProbabilities(ScoreValueProbabilitySet* probabilities) override;
  ScoreValueProbabilitySet* GetValueProbabilities() const override;
  ScoreEncoder* GetEncoder() override;
  const ScoreEncoder* GetEncoder() const override;
  void SetEncoder(ScoreEncoder* encoder) override;
  void SetEmptyCateValues(bool empty) override;
  bool IsEmptyCateValues() const override;
  bool AddScoreValueLabel(ScoreValue* value, const std::string& label) override;
  void SetNumericDataType(NumericDataType type) override;
  NumericDataType GetNumericDataType() const override;
  bool IsUsageTypeEnable() const override;
  void SetUsageType(bool enabled) override;
  void SetFalgTypeTrueValue(const std::string& value) override;

  std::string GetFalgTypeTrueValue() const;
  bool IsString() const;

 private:
  /// True for the kinds whose missing marker is the system-missing number: all but text.
  bool IsNumericLike() const;
  bool IsInMissingRange(const ScoreValue* value) const;
  bool IsCategory(const ScoreValue* value) const;
  void CopyFields(const DictVar& other);
  void CopyOwned(const DictVar& other);
  void DeleteOwned();

  std::string name_;
  std::string label_;
  VariableType varType_;
  DateTimeType dateTimeType_{};
  NumericDataType numericDataType_ = kUnspecified;
  MeasureLevel mLevel_ = kContinuous;
  int decimals_ = 0;
  int width_ = -1;
  ScoreMissingValueSet* missingValues_ = nullptr;
  ScoreValueLabelSet* valueLabels_ = nullptr;
  ScoreVarStats* varStats_ = nullptr;
  int valueIndex_ = -1;
  int encodedValueIndex_ = -1;
  bool noSpaceTrim_ = false;
  bool emptyStringOK_ = false;
  std::string xMeasure_;
  bool flagVariable_ = false;
  bool usageTypeEnabled_ = true;
  int outlierHandleMethod_ = 0;
  ScoreValue* defValue_ = nullptr;
  ScoreValueProbabilitySet* valueProbabilities_ = nullptr;
  ScoreEncoder* encoder_ = nullptr;
  bool emptyCateValues_ = false;
  std::string flagTypeTrueValue_;

  // missingValues_ and valueLabels_ again where they are our own sets, which answer without a copy or a walk;
  // else null. Asked for when a set is put in, so that no case pays for it.
  const MissingValueSet* indexedMissingValues_ = nullptr;
  const ValueLabelSet* indexedValueLabels_ = nullptr;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_DICTVAR_H
