// The values that a document asks a model to give by name.

#ifndef KESTREL_PLUGINS_SUPPORT_OUTPUTFIELDS_H
#define KESTREL_PLUGINS_SUPPORT_OUTPUTFIELDS_H

#include <xercesc/util/XercesDefs.hpp>

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/translate/ScoreResultField.h"

XERCES_CPP_NAMESPACE_BEGIN
class DOMElement;
XERCES_CPP_NAMESPACE_END

namespace MCKestrel_800 {

class ResultField;
class ScoreCaseRecord;
class ScoreDictVar;
class ScoreDictionary;
class ScoreResult;
class ValueRules;

/// How a case was scored, for the output fields that tell of it.
struct ScoredCase {
  enum class Basis {
    kModel,    ///< by the model
    kDefault,  ///< data are missing, and the target's default is predicted
    kNothing,  ///< data are missing, and there is no prediction
    kRefused   ///< a value is invalid, and there is no prediction
  };
  Basis basis = Basis::kModel;
  const ScoreCaseRecord* record = nullptr;      ///< null when the case is none
  const ScoreDictVar* refused_field = nullptr;  ///< whose value is invalid
  bool is_decided_by_rule = false;
};

/// One output field, compiled.
struct OutputField {
  enum class RuleFeature { kConsequent, kId, kConfidence, kOther };

  std::string name;
  ScoreResultField::ResultFeature feature = ScoreResultField::kNoFeature;
  bool is_text = false;
  /// The one that a probability or residual is about, of the target's type; null for the predicted one.
  std::unique_ptr<ScoreValue> category;
  std::size_t category_position = 0;  ///< where the result of the last case had it
  RuleFeature rule_feature = RuleFeature::kConsequent;
};

/// The fields of an `Output` element, and the way from a result to their values.
///
/// The values stand in the result's ResultField (see OutputFieldsOf), a number or a text for each field, by
/// its variable's type: a number field tells a text that reads as a number as that number, and is otherwise
/// system-missing; a text field tells a number in its shortest form. What there is nothing to tell of is
/// missing: system-missing in a number field, the empty text in a text field.
///
///   predictedValue, predictedDisplayValue   the prediction, and the label that the target gives to it; its
///             text when it has none
///   probability   of the category that `value` names, or of the prediction
///   residual      the true value of the target, as the case has it, minus the prediction; in a
///             classification 1 or 0, as the true value is the category (`value`, or the predicted one) or
///             not, minus the category's probability
///   standardError   of a regression whose model knows it
///   entityId, clusterId   the part of the model that decided: a node of a tree, a rule. A number field tells
///             the number of a part without identifier ("#7").
///   entityAffinity, clusterAffinity   the confidence with which that part predicts
///   ruleValue     of the rule that decided, by `ruleFeature`: "consequent" (also without the attribute) what
///             it predicts, "rule" and "ruleId" its identifier, "confidence" its confidence; an `OutputField`
///             may have these words as its feature
///   warning       why there is no prediction or only the target's default; in a number field the status code
///   standardDeviation, and every rule feature but those above: no model here has them, so always missing
///
/// Writing allocates nothing after the first case into a result, but where a text outgrows the longest one
/// before. A result that goes from model to model gets its fields anew each time. Serves one case at a time.
class OutputFields {
 public:
  OutputFields();
  ~OutputFields();
  OutputFields(OutputFields&&) noexcept;
  OutputFields& operator=(OutputFields&&) noexcept;

  /// Reads the `Output` of a model element, its `OutputField`s and `ResultField`s.
  /// target   the variable that is predicted; null for none. It must outlive this object.
  /// results  set to the dictionary of the output fields (of ResultVars), or to null when there are none. A
  ///          field without `dataType` gets the type of what it tells.
  /// Errors, all KestrelException with the place in the document, beside those of
  /// PMMLTranslator::ParseResultField:
  ///   code 5   a `targetField` other than the target, a `rank` other than 1;
  ///   code 7   a probability or residual of a `value` that the target does not have.
  static OutputFields Read(const xercesc::DOMElement* model, const ScoreDictVar* target,
                           bool is_classification, std::unique_ptr<ScoreDictionary>& results);

  bool IsEmpty() const { return fields_.empty(); }
  /// Whether a field tells of the part of the model that decided, for which the result's entities have to be
  /// asked.
  bool TellEntities() const { return tell_entities_; }

  /// Fills the output fields of a result, when it is of a class that has them, from what else stands in it.
  void Write(const ScoredCase& scored, ScoreResult& result);

 private:
  class Cell;

  void SetUpTarget();
  void Prepare(ResultField& values);
  void WriteField(OutputField& field, const ScoredCase& scored, const ScoreResult& result, Cell cell);
  void WriteDisplayValue(const ScoreValue& prediction, Cell cell) const;
  void WriteRuleValue(const OutputField& field, const ScoreResult& result, Cell cell) const;
  void WriteWarning(const ScoredCase& scored, Cell cell);
  double FindProbability(OutputField& field, const ScoreResult& result) const;
  double FindResidual(OutputField& field, const ScoredCase& scored, const ScoreResult& result);
  const ScoreValue* FindTrueValue(const ScoreCaseRecord& record);

  std::vector<OutputField> fields_;
  bool tell_entities_ = false;
  const ScoreDictVar* target_ = nullptr;
  /// Judges true values and finds the labels of predicted ones; null when no field needs that.
  std::unique_ptr<ValueRules> target_rules_;
  std::vector<std::string> labels_;  ///< of the target's categories, by their codes
  // Of the result at hand, and of the layout of the record at hand.
  unsigned long long result_stamp_ = 0;
  std::vector<ScoreValue*> values_;  ///< by field; they stay the result's
  unsigned long long record_stamp_ = 0;
  int true_value_position_ = -1;
  std::string text_;  ///< kept for its room
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_SUPPORT_OUTPUTFIELDS_H
