// The one implementation of ScoreResultField.

#ifndef KESTREL_TRANSLATE_RESULTFIELD_H
#define KESTREL_TRANSLATE_RESULTFIELD_H

#include <cstddef>
#include <string>
#include <vector>

#include "kestrel/platform/Export.h"
#include "kestrel/translate/ScoreResultField.h"

namespace MCKestrel_800 {

/// Output fields held as an ordered map of owned values. Copies are deep.
///
///   const ResultField& outputs = result.GetOutputFields();
///   const ScoreValue* risk = outputs.GetResultValue("risk");
class KESTREL_API ResultField : public ScoreResultField {
 public:
  ResultField();
  ResultField(const ResultField& other);
  ResultField& operator=(const ResultField& other);
  ~ResultField() override;

  void SetMapResultValue(const ValueMap& values) override;
  const ValueMap& GetMapResultValue() const override;
  const ScoreValue* GetResultValue(const std::string& name) const override;
  void SetResultValue(const std::string& name, const ScoreValue* value) override;
  void SetResultValue(const std::string& name, const std::string& text) override;
  void SetResultValue(const std::string& name, double number) override;
  int GetResultType(const std::string& name) const override;
  void AddResultField(const std::string& name, ScoreValue* value) override;
  std::vector<std::string> GetResultFields() const override;
  std::size_t GetResultSize() const override;

  /// Makes the value of each field missing (a text empty, any other value system-missing); fields and values
  /// stay where they are.
  void ClearValues();

  /// The value of a field for writing; null like GetResultValue.
  ScoreValue* GetValueForWriting(const std::string& name);

  /// A number that changes, to one that no ResultField had before, whenever a field or the object that holds
  /// its value comes or goes. Whoever keeps pointers to values asks whether it is still the same. 0 for an
  /// object that never had a field.
  unsigned long long GetLayoutStamp() const { return stamp_; }

 private:
  ScoreValue*& Slot(const std::string& name);
  void Replace(ScoreValue*& slot, ScoreValue* value);
  void DeleteValues();

  ValueMap values_;
  unsigned long long stamp_ = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSLATE_RESULTFIELD_H
