// What one node of a function tree is: a function, a field, a constant.

#ifndef KESTREL_TRANSFORM_APPLYNODESTATS_H
#define KESTREL_TRANSFORM_APPLYNODESTATS_H

#include <memory>
#include <string>
#include <vector>

#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/platform/Export.h"
#include "kestrel/transform/TransformFunction.h"

namespace MCKestrel_800 {

class ScoreDictVar;

/// The payload of a node. A node with a function applies it to its children. A node without one is a constant
/// when `IsConstNode`, else a reference to the field that the parameter name says.
///
/// Setters that take a value own it and delete the one that they held. Copies are deep but for the variable,
/// which belongs to a dictionary.
class KESTREL_API ApplyNodeStats {
 public:
  /// What a document asks for when an argument is invalid. Kept, without effect on the evaluation.
  enum InvalidValueTreatment : int { kReturnInvalid = 0, kAsIs = 1, kAsMissing = 2, kNotGiven = 3 };

  ApplyNodeStats();
  ApplyNodeStats(const ApplyNodeStats& other);
  ApplyNodeStats& operator=(const ApplyNodeStats& other);
  ~ApplyNodeStats();

  /// An identifier for diagnostic dumps.
  void SetNodeID(const std::string& id);
  const std::string& GetNodeID() const { return node_id_; }
  /// The name of the field of a reference, or of the function.
  void SetParameterName(const std::string& name);
  const std::string& GetParameterName() const { return parameter_name_; }
  /// The value of a constant.
  void SetValue(ScoreValue* value);
  const ScoreValue* GetValue() const { return value_.get(); }
  void SetTransFunction(TransformFunction function) { function_ = function; }
  TransformFunction GetTransFunction() const { return function_; }
  /// The field of a reference. May be null: evaluation finds the field by its name; this one is used when the
  /// dictionaries at hand do not know the name.
  void SetVariable(const ScoreDictVar* variable) { variable_ = variable; }
  const ScoreDictVar* GetVariable() const { return variable_; }
  /// The field's position in the case record, as far as it is known; -1 if not.
  void SetVarIndex(int index) { var_index_ = index; }
  int GetVarIndex() const { return var_index_; }
  void SetConstNode(bool is_const) { const_node_ = is_const; }
  bool IsConstNode() const { return const_node_; }

  /// Appends an array of values and takes them over, null ones included.
  void AddArray(const std::vector<ScoreValue*>& values);
  int GetNumberOfArray() const { return static_cast<int>(arrays_.size()); }
  /// The values of an array, which stay the node's; empty when there is no such array.
  std::vector<const ScoreValue*> GetArray(int index) const;
  void ClearArray();

  void SetInvalidValueTreatment(int treatment) { invalid_value_treatment_ = treatment; }
  int GetInvalidValueTreatment() const { return invalid_value_treatment_; }
  /// What takes the place of a system-missing result of a function.
  void SetRecodeMissValueTo(ScoreValue* value);
  const ScoreValue* GetRecodeMissValueTo() const { return missing_replacement_.get(); }
  /// What takes the place of a missing value of a referenced field.
  void SetFieldrefRecodeMissValueTo(ScoreValue* value);
  const ScoreValue* GetFieldrefRecodeMissValueTo() const { return field_missing_replacement_.get(); }

  /// Equal when all but the identifier, the variable and its position is equal; values by their own equality.
  bool operator==(const ApplyNodeStats& other) const;

 private:
  using Value = std::unique_ptr<ScoreValue>;

  std::string node_id_;
  std::string parameter_name_;
  Value value_;
  TransformFunction function_ = kNoFunction;
  const ScoreDictVar* variable_ = nullptr;
  int var_index_ = -1;
  bool const_node_ = false;
  std::vector<std::vector<Value>> arrays_;
  int invalid_value_treatment_ = kNotGiven;
  Value missing_replacement_;
  Value field_missing_replacement_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_APPLYNODESTATS_H
