#include "kestrel/predicates/CompoundPredicate.h"

#include <algorithm>
#include <cstddef>
#include <memory>
#include <ostream>

namespace MCKestrel_800 {

namespace {

using Result = ScorePredicate::PredicateResult;
using Children = std::vector<ScorePredicate*>;

// In all of these `ask(child)` is the result of a child. What is kept of the results is what the rule needs,
// so that a long list needs no memory.

/// The result `deciding` of any child decides; `otherwise` is what remains when all are known.
template <class Ask>
Result FirstOf(Result deciding, Result otherwise, const Children& children, const Ask& ask) {
  bool isUnknown = false;
  for (const ScorePredicate* child : children) {
    const Result result = ask(*child);
    if (result == deciding) return deciding;
    isUnknown = isUnknown || result == ScorePredicate::PredUnknown;
  }
  return isUnknown ? ScorePredicate::PredUnknown : otherwise;
}

template <class Ask>
Result OddOf(const Children& children, const Ask& ask) {
  bool isOdd = false;
  for (const ScorePredicate* child : children) {
    const Result result = ask(*child);
    if (result == ScorePredicate::PredUnknown) return result;
    isOdd = isOdd != (result == ScorePredicate::PredTrue);
  }
  return isOdd ? ScorePredicate::PredTrue : ScorePredicate::PredFalse;
}

template <class Ask>
Result FirstKnown(std::size_t start, const Children& children, const Ask& ask) {
  for (std::size_t i = start; i < children.size(); ++i) {
    const Result result = ask(*children[i]);
    if (result == ScorePredicate::PredUnknown) continue;
    return i > start && result == ScorePredicate::PredTrue ? ScorePredicate::PredSurrogateTrue : result;
  }
  return ScorePredicate::PredUnknown;
}

template <class Ask>
Result Join(ScorePredicate::CompoundBoolOperator boolOperator, const Children& children, const Ask& ask) {
  switch (boolOperator) {
    case ScorePredicate::kOr:
      return FirstOf(ScorePredicate::PredTrue, ScorePredicate::PredFalse, children, ask);
    case ScorePredicate::kAnd:
      return FirstOf(ScorePredicate::PredFalse, ScorePredicate::PredTrue, children, ask);
    case ScorePredicate::kXor:
      return OddOf(children, ask);
    case ScorePredicate::kSurrogate:
      return FirstKnown(0, children, ask);
  }
  return ScorePredicate::PredUnknown;
}

}  // namespace

ScorePredicate::~ScorePredicate() = default;

CompoundPredicate::CompoundPredicate() = default;

CompoundPredicate::CompoundPredicate(CompoundBoolOperator boolOperator) : operator_(boolOperator) {}

// Through the other constructor, so that the destructor runs when a child cannot be cloned.
CompoundPredicate::CompoundPredicate(const CompoundPredicate& other) : CompoundPredicate(other.operator_) {
  children_.reserve(other.children_.size());
  for (const ScorePredicate* child : other.children_)
    children_.push_back(child->Clone());
}

CompoundPredicate::~CompoundPredicate() {
  for (ScorePredicate* child : children_)
    delete child;
}

CompoundPredicate* CompoundPredicate::Clone() const {
  return new CompoundPredicate(*this);
}

ScorePredicate::PredicateResult CompoundPredicate::Evaluate(const std::vector<double>& values) const {
  return Join(operator_, children_, [&](const ScorePredicate& child) { return child.Evaluate(values); });
}

ScorePredicate::PredicateResult CompoundPredicate::Evaluate(const ScoreCaseRecord* record,
                                                            const ScoreCaseRecord* derivedRecord) const {
  return Join(operator_, children_,
              [&](const ScorePredicate& child) { return child.Evaluate(record, derivedRecord); });
}

ScorePredicate::PredicateType CompoundPredicate::GetPredType() const {
  return kCompound;
}

bool CompoundPredicate::IsDerivedPredictor() const {
  return std::any_of(children_.begin(), children_.end(),
                     [](const ScorePredicate* child) { return child->IsDerivedPredictor(); });
}

void CompoundPredicate::SetSplit(const ScoreSplitVar*) {}

const ScoreSplitVar* CompoundPredicate::GetSplit() const {
  return nullptr;
}

void CompoundPredicate::Display(std::ostream& out) const {
  out << "Compound Predicate: \n";
}

void CompoundPredicate::AddPredicate(ScorePredicate* child) {
  if (child == nullptr) return;
  std::unique_ptr<ScorePredicate> owned(child);
  children_.push_back(child);
  static_cast<void>(owned.release());
}

bool CompoundPredicate::RemovePredicate(ScorePredicate* child) {
  const auto it = std::find(children_.begin(), children_.end(), child);
  if (it == children_.end()) return false;
  children_.erase(it);
  return true;
}

const std::vector<ScorePredicate*>& CompoundPredicate::GetPredicates() const {
  return children_;
}

std::vector<ScorePredicate*>& CompoundPredicate::GetPredicates() {
  return children_;
}

int CompoundPredicate::GetCount() const {
  return static_cast<int>(children_.size());
}

ScorePredicate::CompoundBoolOperator CompoundPredicate::GetBoolOperator() const {
  return operator_;
}

void CompoundPredicate::SetBoolOperator(CompoundBoolOperator boolOperator) {
  operator_ = boolOperator;
}

ScorePredicate::PredicateResult CompoundPredicate::EvaluateSurrogate(const std::vector<double>& values,
                                                                     int startIndex) const {
  if (operator_ != kSurrogate || startIndex < 0 || startIndex >= GetCount()) return PredFalse;
  return FirstKnown(static_cast<std::size_t>(startIndex), children_,
                    [&](const ScorePredicate& child) { return child.Evaluate(values); });
}

}  // namespace MCKestrel_800
