// What a model's derived fields read, directly and through others.

#ifndef KESTREL_PLUGINS_SUPPORT_DERIVEDNEEDS_H
#define KESTREL_PLUGINS_SUPPORT_DERIVEDNEEDS_H

#include <string>
#include <unordered_map>
#include <vector>

namespace MCKestrel_800 {

class ScoreDictVar;
class ScoreDictionary;
class TransformVar;
class TransformationDictionary;

/// Collects fields with all that they read. Derived fields are as a document gives them: each reads only
/// fields that stand before it. Costs what the derived fields that are needed take to look through; depth
/// costs no stack.
class DerivedNeeds {
 public:
  static constexpr int kNone = -1;

  struct Derived {
    std::string name;
    const TransformVar* variable = nullptr;
    bool is_needed = false;
    bool is_read = false;         ///< by a derived field that is needed
    std::vector<int> reads;       ///< derived fields, by number
    std::vector<int> reads_data;  ///< data fields, by position in GetDataFields()
  };

  /// Both must outlive this object.
  DerivedNeeds(const ScoreDictionary& data, const TransformationDictionary& derived);

  /// Adds a data field. Returns its position in GetDataFields().
  int AddData(const ScoreDictVar& variable);
  /// Adds a derived field and what it reads. Returns its number.
  int AddDerived(const std::string& name);

  /// The data fields in the order in which they were added, those that a derived field reads in its place.
  const std::vector<const ScoreDictVar*>& GetDataFields() const { return data_fields_; }
  /// All derived fields of the document by number, in its order. What is not needed has no other entry than
  /// its name.
  const std::vector<Derived>& GetDerived() const { return derived_fields_; }
  /// By number of a derived field: the position of the first data field that it is computed from, or kNone.
  std::vector<int> FindFirstData() const;

 private:
  void NoteReads(int number, std::vector<int>& waiting);

  const ScoreDictionary& data_;
  std::vector<const ScoreDictVar*> data_fields_;
  std::unordered_map<std::string, int> data_positions_;
  std::vector<Derived> derived_fields_;
  std::unordered_map<std::string, int> derived_numbers_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_DERIVEDNEEDS_H
