#include "kestrel/predicates/SimplePredicate.h"

#include <memory>
#include <ostream>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/predicates/Range.h"
#include "kestrel/predicates/ScaleSplit.h"
#include "kestrel/predicates/SplitInput.h"

namespace MCKestrel_800 {

namespace {

struct OperatorName {
  const char* name;
  SimplePredicate::SimplePredOperator meaning;
};
constexpr OperatorName kOperatorNames[] = {
    {"equal", SimplePredicate::kEqual},
    {"notEqual", SimplePredicate::kNotEqual},
    {"lessThan", SimplePredicate::kLessThan},
    {"lessOrEqual", SimplePredicate::kLessOrEqual},
    {"greaterThan", SimplePredicate::kGreaterThan},
    {"greaterOrEqual", SimplePredicate::kGreaterOrEqual},
    {"isMissing", SimplePredicate::kIsMissing},
};

}  // namespace

SimplePredicate::SimplePredicate() = default;

SimplePredicate::SimplePredicate(const ScoreSplitVar* split) : split_(split) {}

SimplePredicate::SimplePredicate(const SimplePredicate& other)
    : ScorePredicate(other),
      missing_(other.missing_),
      number_(other.number_),
      text_(other.text_),
      operator_(other.operator_) {
  // Last, so that nothing can throw while the clone has no owner.
  if (other.split_ != nullptr) split_ = other.split_->Clone();
}

SimplePredicate::~SimplePredicate() {
  delete split_;
}

SimplePredicate* SimplePredicate::Clone() const {
  return new SimplePredicate(*this);
}

ScorePredicate::PredicateResult SimplePredicate::Evaluate(const std::vector<double>& values) const {
  const ScoreDictVar* variable = VariableOf(split_);
  if (variable == nullptr) return PredUnknown;
  const double x = FindNumber(*variable, values);
  if (IsMissingMarker(*variable, x)) return split_->GetMissvalMap() == -1 ? PredUnknown : PredTrue;
  // Range.h and ScaleSplit.h are included so that this is mostly no call.
  return ResultOfChild(split_->GetSplitChildIndex(x));
}

ScorePredicate::PredicateResult SimplePredicate::Evaluate(const ScoreCaseRecord* record,
                                                          const ScoreCaseRecord* derivedRecord) const {
  const ScoreDictVar* variable = VariableOf(split_);
  if (variable == nullptr) return PredUnknown;
  const RecordInput input = FindInput(*variable, record, derivedRecord);
  if (input.missing) return split_->GetMissvalMap() == -1 ? PredUnknown : PredTrue;
  const bool byCode = input.encoder != nullptr && split_->GetSplitVarType() == ScoreSplitVar::kDiscrete;
  return ResultOfChild(byCode ? split_->GetSplitChildIndex(input.code)
                              : split_->GetSplitChildIndex(input.value));
}

ScorePredicate::PredicateType SimplePredicate::GetPredType() const {
  return kSimple;
}

bool SimplePredicate::IsDerivedPredictor() const {
  const ScoreDictVar* variable = VariableOf(split_);
  return variable != nullptr && variable->IsDerivedVariable();
}

void SimplePredicate::SetSplit(const ScoreSplitVar* split) {
  split_ = split;
}

const ScoreSplitVar* SimplePredicate::GetSplit() const {
  return split_;
}

void SimplePredicate::Display(std::ostream& out) const {
  out << "Simple Predicate: \n";
}

void SimplePredicate::SetPredicateOperator(const std::string& text) {
  if (text.empty()) return;
  operator_ = kIsNotMissing;
  for (const OperatorName& row : kOperatorNames) {
    if (text == row.name) operator_ = row.meaning;
  }
}

SimplePredicate::SimplePredOperator SimplePredicate::GetPredicateOperator() const {
  return operator_;
}

void SimplePredicate::SetPredicateValue(const std::string& text) {
  text_ = text;
  // A split sees its variable as something to read. Registering a text is different: whoever builds a
  // predicate builds the dictionary as well, before any case is scored, and owns a variable that may change.
  auto* variable = const_cast<ScoreDictVar*>(VariableOf(split_));
  if (variable == nullptr) return;
  if (ScoreEncoder* encoder = variable->GetEncoder()) {
    number_ = encoder->Encode(text);
    return;
  }
  const std::unique_ptr<ScoreValue> value(variable->ToMyValue(text));
  if (value != nullptr) number_ = value->GetDouble();
}

double SimplePredicate::GetPredValueByDouble() const {
  return number_;
}

const std::string& SimplePredicate::GetPredValueByString() const {
  return text_;
}

bool SimplePredicate::IsMissingValue() const {
  return missing_;
}

void SimplePredicate::SetValueToMissing(bool missing) {
  missing_ = missing;
}

}  // namespace MCKestrel_800
