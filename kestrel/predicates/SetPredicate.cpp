#include "kestrel/predicates/SetPredicate.h"

#include <ostream>

#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/predicates/SplitInput.h"

namespace MCKestrel_800 {

SetPredicate::SetPredicate() = default;

SetPredicate::SetPredicate(const ScoreSplitVar* split) : split_(split) {}

SetPredicate::SetPredicate(const SetPredicate& other)
    : ScorePredicate(other), operator_(other.operator_), array_(other.array_) {
  // Last, so that nothing can throw while the clone has no owner.
  if (other.split_ != nullptr) split_ = other.split_->Clone();
}

SetPredicate::~SetPredicate() {
  delete split_;
}

SetPredicate* SetPredicate::Clone() const {
  return new SetPredicate(*this);
}

ScorePredicate::PredicateResult SetPredicate::Evaluate(const std::vector<double>& values) const {
  const ScoreDictVar* variable = VariableOf(split_);
  if (variable == nullptr) return PredUnknown;
  const double x = FindNumber(*variable, values);
  if (IsMissingMarker(*variable, x)) return PredUnknown;
  return ResultOfChild(split_->GetSplitChildIndex(x));
}

ScorePredicate::PredicateResult SetPredicate::Evaluate(const ScoreCaseRecord* record,
                                                       const ScoreCaseRecord* derivedRecord) const {
  const ScoreDictVar* variable = VariableOf(split_);
  if (variable == nullptr) return PredUnknown;
  const RecordInput input = FindInput(*variable, record, derivedRecord);
  if (input.missing) return PredUnknown;
  // By the code whatever kind the split is, unlike a simple predicate: a set holds categories.
  return ResultOfChild(input.encoder != nullptr ? split_->GetSplitChildIndex(input.code)
                                                : split_->GetSplitChildIndex(input.value));
}

ScorePredicate::PredicateType SetPredicate::GetPredType() const {
  return kSet;
}

bool SetPredicate::IsDerivedPredictor() const {
  const ScoreDictVar* variable = VariableOf(split_);
  return variable != nullptr && variable->IsDerivedVariable();
}

void SetPredicate::SetSplit(const ScoreSplitVar* split) {
  split_ = split;
}

const ScoreSplitVar* SetPredicate::GetSplit() const {
  return split_;
}

void SetPredicate::Display(std::ostream& out) const {
  out << "Set Predicate: \n";
}

void SetPredicate::SetPredicateOperator(const std::string& text) {
  operator_ = text == "isIn" ? kIsIn : kIsNotIn;
}

SetPredicate::SimpleSetPredOperator SetPredicate::GetPredicateOperator() const {
  return operator_;
}

void SetPredicate::SetArrayData(const std::vector<double>& values) {
  if (!values.empty()) array_ = values;
}

const std::vector<double>& SetPredicate::GetArrayData() const {
  return array_;
}

}  // namespace MCKestrel_800
