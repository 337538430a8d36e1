// The case record that derived fields read: a case's values as the mining schema makes them.

#ifndef KESTREL_PLUGINS_SUPPORT_TREATEDRECORD_H
#define KESTREL_PLUGINS_SUPPORT_TREATEDRECORD_H

#include <cstddef>
#include <string>
#include <vector>

#include "kestrel/dictionary/CaseRecord.h"

namespace MCKestrel_800 {

/// A view of values that others own, under names that stay the same from case to case, and so does the layout
/// stamp. What would change a value through the record is refused: it may be a host's.
class TreatedRecord : public ScoreCaseRecord {
 public:
  TreatedRecord();
  TreatedRecord(const TreatedRecord&) = delete;
  TreatedRecord& operator=(const TreatedRecord&) = delete;
  ~TreatedRecord() override;

  /// Adds a name, without value. Returns its position.
  std::size_t AddName(const std::string& name);
  /// The value at a position from AddName, null for none; it is not taken over.
  void Show(std::size_t position, const ScoreValue* value) {
    // Nothing writes through the pointer: the list of values has no const form.
    values_[position] = const_cast<ScoreValue*>(value);
  }

  /// Does nothing; the value stays the caller's.
  void Add(const std::string& name, ScoreValue* value) override;
  /// These do nothing and give false.
  bool SetValue(int index, const std::string& text) override;
  bool SetValue(const std::string& name, const std::string& text) override;
  bool SetValue(int index, double value, DateTimeType type) override;
  bool SetValue(const std::string& name, double value, DateTimeType type) override;
  bool SetValue(int index, double value) override;
  bool SetValue(const std::string& name, double value) override;
  bool SetMissingValue(int index) override;
  bool SetMissingValue(const std::string& name) override;
  /// Does nothing.
  void Remove(const std::string& name) override;

  const ScoreValue* Get(int index) const override;
  const ScoreValue* Get(const std::string& name) const override;
  void SetUpNameIndexMap(const std::vector<std::string>& names) override;
  void SetUpNameIndexMap(const std::vector<ScoreDictVar*>& vars) override;
  bool HasMap() const override;
  int GetIndex(const std::string& name) const override;
  std::size_t Size() const override;
  std::vector<std::string> GetVarNames() const override;
  const std::vector<ScoreValue*>& GetAllValues() const override { return values_; }
  void Display(std::ostream& os) const override;
  unsigned long long GetLayoutStamp() const override { return names_.GetLayoutStamp(); }

 private:
  CaseRecord names_;  ///< the names alone
  std::vector<ScoreValue*> values_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_TREATEDRECORD_H
