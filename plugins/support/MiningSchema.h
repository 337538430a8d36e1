// The gate through which a case's values enter a model: the fields that the model uses, with the treatment of
// missing, invalid and outlying values. All model libraries read it the same way, so it is read here.

#ifndef KESTREL_PLUGINS_SUPPORT_MININGSCHEMA_H
#define KESTREL_PLUGINS_SUPPORT_MININGSCHEMA_H

#include <xercesc/util/XercesDefs.hpp>

#include <cstddef>
#include <string>
#include <unordered_map>
#include <vector>

#include "plugins/support/MiningField.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

class ScoreDictionary;
class TransformationDictionary;

/// The fields of a `MiningSchema` element in document order, and the derived fields that a model may name
/// without having them there.
///
/// Treatment of a value, in this order:
///   missing (absent, system-missing or user-missing, which includes numbers outside a field's `Interval`)
///     `missingValueReplacement` takes its place where there is one. `missingValueTreatment` says how that
///     was found; it matters only as "returnInvalid", which refuses the case and goes before a replacement.
///   invalid (of the wrong kind, or a category that the field does not list)
///     `invalidValueTreatment`. As missing, it is replaced like a missing one; as it is, it is neither a
///     listed category nor an outlier.
///   outlier (a valid number of a continuous field below `lowValue` or above `highValue`)
///     The margin takes its place, or it counts as missing and is replaced like a missing one.
/// `importance` is not used. `optype` replaces the field's measurement level in this model's dictionary.
class MiningSchema {
 public:
  MiningSchema() = default;
  MiningSchema(MiningSchema&&) = default;
  MiningSchema& operator=(MiningSchema&&) = default;

  /// Reads the element. The dictionaries must belong to this model alone, because `optype` changes their
  /// variables; they must outlive the schema. `derived` has the derived fields that may be mining fields;
  /// null for none. Errors, all KestrelException with the place in the document:
  ///   code 1   another element than `MiningField` or `Extension`, no field at all, an empty name, a field
  ///            given twice;
  ///   code 3   `lowValue` or `highValue` is not a number;
  ///   code 4   a field without name;
  ///   code 6   an attribute outside its vocabulary, "asValue" without `invalidValueReplacement`, or a
  ///            `lowValue` above the `highValue`;
  ///   code 7   a replacement that is not a value of the field's type;
  ///   code 8   a field that is in neither dictionary, and a target that is not in the first;
  ///   code 11  a text field made continuous.
  static MiningSchema Read(const xercesc::DOMElement* element, ScoreDictionary* dictionary,
                           TransformationDictionary* derived = nullptr);

  /// Makes the derived fields known that are no mining fields. They have no treatment: a value that is none
  /// of a field's categories stands for itself. To be called once; `derived` must outlive the schema.
  void AddDerivedFields(const TransformationDictionary& derived);

  /// The field of that name, or null. Valid as long as the schema lives.
  const MiningField* Find(const std::string& name) const;

  /// What a predictor or predicate may name: an active field, or a derived field that is no mining field.
  /// Null for every other name. Valid as long as the schema lives, wherever it is moved to.
  const MiningField* FindInput(const std::string& name) const;

  const std::vector<MiningField>& GetFields() const { return fields_; }

  /// Gives each field's variable its role in the model, in document order; of several targets the last one
  /// becomes the model's. The model must have the schema's dictionary.
  void SetRoles(ScoreModel& model) const;

 private:
  std::vector<MiningField> fields_;
  std::unordered_map<std::string, std::size_t> positions_;
  std::vector<MiningField> derived_fields_;
  std::unordered_map<std::string, std::size_t> derived_positions_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_MININGSCHEMA_H
