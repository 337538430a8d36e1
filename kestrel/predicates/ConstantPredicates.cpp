#include "kestrel/predicates/ConstantPredicates.h"

#include <ostream>

namespace MCKestrel_800 {

TruePredicate::TruePredicate() = default;
TruePredicate::~TruePredicate() = default;

TruePredicate* TruePredicate::Clone() const {
  return new TruePredicate(*this);
}

ScorePredicate::PredicateResult TruePredicate::Evaluate(const std::vector<double>&) const {
  return PredTrue;
}

ScorePredicate::PredicateResult TruePredicate::Evaluate(const ScoreCaseRecord*,
                                                        const ScoreCaseRecord*) const {
  return PredTrue;
}

ScorePredicate::PredicateType TruePredicate::GetPredType() const {
  return kTrue;
}

bool TruePredicate::IsDerivedPredictor() const {
  return false;
}

void TruePredicate::SetSplit(const ScoreSplitVar*) {}

const ScoreSplitVar* TruePredicate::GetSplit() const {
  return nullptr;
}

void TruePredicate::Display(std::ostream& out) const {
  out << "Constant TRUE\n";
}

FalsePredicate::FalsePredicate() = default;
FalsePredicate::~FalsePredicate() = default;

FalsePredicate* FalsePredicate::Clone() const {
  return new FalsePredicate(*this);
}

ScorePredicate::PredicateResult FalsePredicate::Evaluate(const std::vector<double>&) const {
  return PredFalse;
}

ScorePredicate::PredicateResult FalsePredicate::Evaluate(const ScoreCaseRecord*,
                                                         const ScoreCaseRecord*) const {
  return PredFalse;
}

ScorePredicate::PredicateType FalsePredicate::GetPredType() const {
  return kFalse;
}

bool FalsePredicate::IsDerivedPredictor() const {
  return false;
}

void FalsePredicate::SetSplit(const ScoreSplitVar*) {}

const ScoreSplitVar* FalsePredicate::GetSplit() const {
  return nullptr;
}

void FalsePredicate::Display(std::ostream& out) const {
  out << "Constant FALSE\n";
}

}  // namespace MCKestrel_800
