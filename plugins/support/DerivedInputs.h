// The fields of a model that has derived ones among them: reads a case, treats it and computes them.

#ifndef KESTREL_PLUGINS_SUPPORT_DERIVEDINPUTS_H
#define KESTREL_PLUGINS_SUPPORT_DERIVEDINPUTS_H

#include <cstddef>
#include <memory>
#include <vector>

#include "kestrel/foundation/ScoreValue.h"
#include "plugins/support/DerivedNeeds.h"
#include "plugins/support/FieldTreatment.h"
#include "plugins/support/MiningField.h"
#include "plugins/support/TreatedRecord.h"

namespace MCKestrel_800 {

class MiningSchema;
class ScoreCaseRecord;
class ScoreDictionary;
class TransformationDictionary;

/// Gives the values of a model's fields for a case, data fields as the case has them and derived fields as
/// they are computed.
///
/// Derived fields see what the mining schema makes of a field that they read, whether the model uses the
/// field itself or not. The same goes for a derived field that is in the schema: those that read it see it
/// treated. A data field that is not in the schema is read as it is. What the case may hold under a derived
/// field's name plays no part.
///
/// Serves one case at a time; allocates nothing for numbers and categories after the first one.
class DerivedInputs {
 public:
  /// schema   its fields must outlive this object, but not the schema itself.
  /// data, derived  must outlive it. `derived` is set up, and told what to compute; nobody may choose
  ///          something else afterwards.
  /// fields   the model's fields, by which the values are asked for.
  DerivedInputs(const MiningSchema& schema, const ScoreDictionary& data, TransformationDictionary& derived,
                const std::vector<const MiningField*>& fields);
  DerivedInputs(const DerivedInputs&) = delete;
  DerivedInputs& operator=(const DerivedInputs&) = delete;

  /// Reads a case and computes the derived fields. False when the schema refuses a value that a derived field
  /// reads: then the values are not to be used.
  bool Compute(const ScoreCaseRecord& record);

  /// The values after Compute; null for none. The field's number, in `fields`, tells its position.
  const ScoreValue* const* GetValues() const { return values_.data(); }
  int GetPosition(int field) const { return positions_[static_cast<std::size_t>(field)]; }

  /// The data fields that are read from a case, those that a derived field needs in its place.
  const std::vector<const ScoreDictVar*>& GetDataFields() const { return data_fields_; }
  /// The position there of a field, by its number in `fields`; for a derived field that of the first data
  /// field that it is computed from, or the number of data fields when there is none.
  int GetDataField(int field) const { return data_of_fields_[static_cast<std::size_t>(field)]; }
  /// After Compute gave false: the same for the field that was refused.
  int GetRefusedField() const { return refused_; }

 private:
  /// A data field that derived fields read.
  struct Source {
    std::size_t value;                          ///< position in values_
    std::size_t shown;                          ///< position in treated_
    std::unique_ptr<FieldTreatment> treatment;  ///< null when the field is not in the schema
  };
  /// A derived field that is in the schema and that others read.
  struct TreatedField {
    int level;  ///< how many such fields stand one behind the other before it
    std::size_t value_index;
    std::size_t shown;
    int data_field;
    std::unique_ptr<FieldTreatment> treatment;
  };
  struct Output {
    std::size_t value;
    std::size_t value_index;
  };

  bool IsDerived(const MiningField& field) const;
  void PlaceFields(const std::vector<const MiningField*>& fields, DerivedNeeds& needs);
  void AddSources(const MiningSchema& schema, const DerivedNeeds& needs);
  void AddTreatedFields(const MiningSchema& schema, const DerivedNeeds& needs);
  void ChooseWanted(const std::vector<const MiningField*>& fields);
  void LookUpPositions(const ScoreCaseRecord& record);
  void TakeCase(const ScoreCaseRecord& record);
  bool TreatSources();
  bool TreatDerived();

  const ScoreDictionary& data_;
  TransformationDictionary& derived_;
  std::vector<const ScoreDictVar*> data_fields_;
  std::vector<int> positions_;
  std::vector<int> data_of_fields_;
  std::vector<Source> sources_;
  std::vector<TreatedField> treated_fields_;  ///< in the order of their levels
  std::vector<Output> outputs_;
  TreatedRecord treated_;
  std::vector<const ScoreValue*> values_;  ///< of the data fields, then of the derived ones
  std::vector<int> case_positions_;        ///< of the data fields; -1 where the case does not have the name
  unsigned long long layout_stamp_ = 0;
  std::size_t positions_end_ = 0;
  int refused_ = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_DERIVEDINPUTS_H
