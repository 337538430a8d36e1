// The one implementation of ScoreCaseRecord.

#ifndef KESTREL_DICTIONARY_CASERECORD_H
#define KESTREL_DICTIONARY_CASERECORD_H

#include <map>
#include <string>
#include <vector>

#include "kestrel/dictionary/ScoreCaseRecord.h"

namespace MCKestrel_800 {

class NumericValue;

/// A case record whose slots are written in place: filling an occupied slot by position allocates nothing for
/// numbers and dates, and for texts only when a text is longer than any before it in that slot.
///
/// A record is filled once with `Add` and then reused for case after case:
///
///   CaseRecord record;
///   record.Add("age", new NumericValue);    // position 0
///   record.Add("city", new StringValue);    // position 1
///   for each case: record.SetValue(0, 42.0), record.SetValue(1, "Oslo"), or record.SetMissingValue(1)
///
/// Copies are deep; when one cannot be made, the record that it was for stays as it was.
class KESTREL_API CaseRecord : public ScoreCaseRecord {
 public:
  /// Reserves room for `n` values; the record starts without slots. A number that is no sensible count is not
  /// taken at its word: room beyond a limit is made when it is needed.
  explicit CaseRecord(int n = 0);
  CaseRecord(const CaseRecord& other);
  CaseRecord& operator=(const CaseRecord& other);
  ~CaseRecord() override;

  void Add(const std::string& name, ScoreValue* value) override;
  bool SetValue(int index, const std::string& text) override;
  bool SetValue(const std::string& name, const std::string& text) override;
  bool SetValue(int index, double value, DateTimeType type) override;
  bool SetValue(const std::string& name, double value, DateTimeType type) override;
  bool SetValue(int index, double value) override;
  bool SetValue(const std::string& name, double value) override;
  bool SetMissingValue(int index) override;
  bool SetMissingValue(const std::string& name) override;
  void Remove(const std::string& name) override;
  const ScoreValue* Get(int index) const override;
  const ScoreValue* Get(const std::string& name) const override;
  void SetUpNameIndexMap(const std::vector<std::string>& names) override;
  void SetUpNameIndexMap(const std::vector<ScoreDictVar*>& vars) override;
  bool HasMap() const override;
  int GetIndex(const std::string& name) const override;
  std::size_t Size() const override;
  std::vector<std::string> GetVarNames() const override;
  const std::vector<ScoreValue*>& GetAllValues() const override;
  void Display(std::ostream& os) const override;
  unsigned long long GetLayoutStamp() const override;

 private:
  bool HasSlot(int index) const;
  void Put(std::size_t position, ScoreValue* value);
  bool SetOtherNumber(std::size_t position, double value);
  bool SetOtherMissing(std::size_t position);

  std::map<std::string, int> positions_;
  std::vector<ScoreValue*> values_;
  // values_[i] again where it is exactly a NumericValue, else null: spares the per-case road asking for its
  // type.
  std::vector<NumericValue*> numbers_;
  // The number of slots: the vectors would compute it anew from two addresses for every value that is set.
  std::size_t size_ = 0;
  unsigned long long stamp_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_DICTIONARY_CASERECORD_H
