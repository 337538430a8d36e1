// One derived field: a variable whose value is computed from other fields.

#ifndef KESTREL_TRANSFORM_TRANSFORMVAR_H
#define KESTREL_TRANSFORM_TRANSFORMVAR_H

#include <iosfwd>
#include <memory>
#include <string>
#include <vector>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

class DerivationPlan;
class FieldEvaluation;
class FunctionTree;
class ScoreCaseRecord;
class ScoreDictionary;
class ScoreValueMatcher;
class ScoreValueRange;
class TransformationDictionary;

/// What a derived field computes.
enum class TransExpression : int {
  kConstant = 0,
  kFieldRef = 1,
  kNormContinuous = 2,
  kNormDiscrete = 3,
  kDiscretize = 4,
  kMapValues = 5,
  kApply = 6
};

/// A variable with one transformation expression. "age" in three bins:
///
///   auto* band = new TransformVar("ageband", ScoreDictVar::STRING_VAR);
///   band->AddFieldNameAndTransExpression("age", TransExpression::kDiscretize);
///   band->AddBinningValue(new Range(nullptr, new NumericValue(18), false, false), new StringValue("young"));
///   band->AddBinningValue(new Range(18, 65, true, false), new StringValue("adult"));
///   band->SetRecodeDefaultValue(new StringValue("senior"));
///   dictionary.AddVar("ageband", band);
///   dictionary.AddDerievedVarName("ageband");
///
/// Values: a missing number or date/time is the system-missing value, a missing text the empty one. Nothing
/// throws for a bad value. Texts longer than the field's width are cut to it.
///
/// Setters that take an object own it and delete the one that they held. A definition is complete before the
/// first value is asked for. Copies are deep and share nothing; what was computed is not copied.
///
/// Threads: a field serves one case at a time.
class KESTREL_API TransformVar : public DictVar {
 public:
  struct Bin {
    std::unique_ptr<ScoreValueRange> range;
    std::unique_ptr<ScoreValue> value;  ///< null: the input itself
  };
  struct Encoding {
    std::unique_ptr<ScoreValueMatcher> matcher;
    std::unique_ptr<ScoreValue> value;
  };

  TransformVar(const std::string& name, VariableType type);
  TransformVar(const TransformVar& other);
  TransformVar& operator=(const TransformVar& other);
  ~TransformVar() override;

  TransformVar* Clone() const override;
  /// Always true.
  bool IsDerivedVariable() const override { return true; }
  void Display(std::ostream& os) const override;

  // ---- Building.

  /// The field that is read (empty for a constant and a function tree) and the kind.
  void AddFieldNameAndTransExpression(const std::string& field, TransExpression kind);
  const std::string& GetFieldName() const { return field_name_; }
  TransExpression GetTransExpression() const { return kind_; }

  /// The literal of a constant. A number is read from its start; text that is none is missing.
  void SetConstString(const std::string& text);
  const std::string& GetConstString() const { return constant_; }

  /// A point of a piecewise linear function, and the line `slope * x + intercept` from a point to the next.
  void AddLinearNorm(double orig, double norm);
  void AddNormInfo(double slope, double intercept);
  const std::vector<double>& GetOrig() const { return orig_; }
  const std::vector<double>& GetNorm() const { return norm_; }
  const std::vector<double>& GetSlopes() const { return slopes_; }
  const std::vector<double>& GetIntercepts() const { return intercepts_; }
  /// "asIs", "asMissingValues" or "asExtremeValues"; another text changes nothing.
  void SetOutlierTreatMent(const std::string& treatment);
  OutlierHandleMethod GetOutlierTreatment() const { return outliers_; }

  /// A bin of a discretisation. The first one that holds a value decides.
  void AddBinningValue(ScoreValueRange* range, ScoreValue* value);
  const std::vector<Bin>& GetBins() const { return bins_; }

  /// A row of an encoding. The first one that matches decides.
  void AddEncodingMap(ScoreValueMatcher* matcher, ScoreValue* value);
  const std::vector<Encoding>& GetAllEncodedValues() const { return encodings_; }

  /// What takes the place of a missing input; turns `SetRecodeMissingCopy` off.
  void SetRecodeMissValueTo(ScoreValue* value);
  const ScoreValue* GetRecodeMissValueRep() const { return missing_replacement_.get(); }
  /// What an input becomes that nothing matches; turns `SetRecodeElseCopy` off.
  void SetRecodeDefaultValue(ScoreValue* value);
  const ScoreValue* GetRecodeDefaultValue() const { return default_value_.get(); }
  /// What takes the place of the system-missing value of a numeric input.
  void SetRecodeSysmisValue(ScoreValue* value);
  const ScoreValue* GetRecodeSysmisValueRep() const { return sysmis_replacement_.get(); }
  /// Whether an input that nothing matches is copied, a missing one included; true deletes the default value.
  void SetRecodeElseCopy(bool copy);
  bool IsRecodeElseCopy() const { return else_copy_; }
  /// Whether a missing input is copied; true deletes the missing replacement.
  void SetRecodeMissingCopy(bool copy);
  bool IsRecodeMissingCopy() const { return missing_copy_; }
  /// The interval whose values are copied, for display.
  void SetRecodeIntervalCopy(ScoreValueRange* range);
  const ScoreValueRange* GetRecodeIntervalCopy() const { return interval_copy_.get(); }

  /// The function tree of an Apply expression.
  void SetRoot(FunctionTree* root);
  const FunctionTree* GetRoot() const { return root_.get(); }

  /// The names of the fields that the expression reads itself, each once, in the order in which it names
  /// them.
  std::vector<std::string> GetSourceNames() const;

  // ---- Evaluation.

  /// The field's value for a case; what it depends on is computed first. The dictionaries may be null. The
  /// value stays the field's and is valid until the next call. Never null.
  const ScoreValue* GetTransformedValue(const ScoreCaseRecord* record, const ScoreDictionary* dictionary,
                                        TransformationDictionary* transformations);

  /// The steps of it. What is returned stays the field's.
  /// The piecewise linear function; outliers by their treatment. With two points, outliers that are left as
  /// they are pass unchanged; with more, the line of the nearer end goes on. Outliers treated as missing are
  /// not made missing here, but like those left as they are.
  double GetNormValue(double x);
  /// The encoded value of the first row that matches; see HandleMissingAndInvalidValue for what none matches.
  /// `variable` is the one that the value belongs to, whose rules say whether it is missing; null is allowed
  /// for both.
  const ScoreValue* GetEncodedValue(const ScoreDictVar* variable, const ScoreValue* value);
  /// The same for the first bin that holds the value. A text is in no bin and counts as missing.
  const ScoreValue* GetBinningValue(const ScoreDictVar* variable, const ScoreValue* value);
  /// What becomes of a value that is missing or matches nothing. `is_string`: the result is a text.
  const ScoreValue* HandleMissingAndInvalidValue(const ScoreDictVar* variable, bool is_string,
                                                 const ScoreValue* value);

 private:
  friend class DerivationPlan;
  friend class TransformationDictionary;

  void CopyDefinition(const TransformVar& other);
  /// What is prepared from the definition, made when it is first needed.
  FieldEvaluation& Evaluation() const;
  void ForgetEvaluation();
  /// The type of the values that are computed.
  ScoreValue::ValueType GetResultType() const;

  std::string field_name_;
  TransExpression kind_ = TransExpression::kConstant;
  std::string constant_;
  std::vector<double> orig_;
  std::vector<double> norm_;
  std::vector<double> slopes_;
  std::vector<double> intercepts_;
  OutlierHandleMethod outliers_ = kAsIs;
  std::vector<Bin> bins_;
  std::vector<Encoding> encodings_;
  std::unique_ptr<ScoreValue> missing_replacement_;
  std::unique_ptr<ScoreValue> default_value_;
  std::unique_ptr<ScoreValue> sysmis_replacement_;
  bool else_copy_ = false;
  bool missing_copy_ = false;
  std::unique_ptr<ScoreValueRange> interval_copy_;
  std::unique_ptr<FunctionTree> root_;

  mutable std::unique_ptr<FieldEvaluation> evaluation_;
  std::unique_ptr<DerivationPlan> plan_;
  /// Another one after each change, by which plans notice that they are stale.
  unsigned long long definition_stamp_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_TRANSFORM_TRANSFORMVAR_H
