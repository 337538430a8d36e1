#include "plugins/regression/RegressionModel.h"

#include <cmath>
#include <ostream>
#include <utility>

#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NumberText.h"
#include "kestrel/model/Results.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/ReaderFault.h"
#include "plugins/regression/LinkFunctions.h"

namespace MCKestrel_800 {

RegressionModel::RegressionModel(ModelDictionaries dictionaries, ModelFrame frame, Definition definition)
    : VectorModel(std::move(dictionaries), std::move(frame), inputs_), definition_(std::move(definition)) {
  if (GetFrame().is_classification) {
    plan_ = std::make_unique<CategoryPlan>(definition_.normalization, definition_.tables, GetTargetVar());
    probabilities_.resize(plan_->GetCategories().size());
    CompileEquations(plan_->GetEquations());
    return;
  }
  if (definition_.normalization == Normalization::kSimplemax) {
    Fail(KestrelException::kUnsupported, "simplemax normalization: Not supported for regression!");
  }
  CompileEquations({0});
}

RegressionModel::~RegressionModel() = default;

void RegressionModel::CompileEquations(const std::vector<int>& tables) {
  const RegressionTable constant_zero;
  equations_.reserve(tables.size());
  for (const int table : tables) {
    equations_.emplace_back(table == CategoryPlan::kConstantZero ? constant_zero : definition_.tables[table],
                            inputs_);
  }
  inputs_.Seal(GetFrame().schema, *GetDictionary(), GetTransformationDictionary());
  for (RegressionEquation& equation : equations_)
    equation.Compile(inputs_);
  y_.resize(equations_.size());
}

bool RegressionModel::Predict(const double* values, unsigned outcome, ScoreResult& result) {
  // Every number among the inputs belongs to an equation that is evaluated, so one that is missing decides
  // the case.
  if ((outcome & CaseVector::kMissingNumber) != 0 || !Evaluate(values)) return false;
  return plan_ != nullptr ? Classify(result) : PredictNumber(result);
}

// False when an equation has no finite value.
bool RegressionModel::Evaluate(const double* values) {
  for (std::size_t j = 0; j < equations_.size(); ++j) {
    y_[j] = equations_[j].Evaluate(values);
    if (!std::isfinite(y_[j])) return false;
  }
  return true;
}

double RegressionModel::Normalize(double y) const {
  // With one equation, softmax is the logistic function.
  const bool is_softmax = definition_.normalization == Normalization::kSoftmax;
  return LinkBelow(is_softmax ? Normalization::kLogit : definition_.normalization, y);
}

bool RegressionModel::PredictNumber(ScoreResult& result) {
  const double prediction = definition_.normalization == Normalization::kNone ? y_[0] : Normalize(y_[0]);
  if (!std::isfinite(prediction)) return false;
  SetNumber(result, prediction);
  return true;
}

bool RegressionModel::Classify(ScoreResult& result) {
  if (!plan_->ComputeProbabilities(y_.data(), probabilities_.data())) return false;
  const std::vector<std::unique_ptr<ScoreValue>>& categories = plan_->GetCategories();
  std::size_t best = 0;
  for (std::size_t j = 1; j < categories.size(); ++j) {
    if (probabilities_[j] > probabilities_[best]) best = j;
  }
  result.SetPrediction(categories[best].get());
  result.SetProbability(probabilities_[best]);
  // Kind 0 is what MakeResult gives; another kind has no place for the single categories.
  if (result.GetResultKind() != 0) return true;
  auto& classification = static_cast<ScoreClsResult&>(result);
  for (std::size_t j = 0; j < categories.size(); ++j) {
    classification.AddCategoryProbability(categories[j].get(), probabilities_[j]);
  }
  return true;
}

std::string RegressionModel::GetModelKind() const {
  return PMMLModelTags::XML_ELE_REGMODEL;
}

namespace {

void DisplayTerm(const RegressionTerm& term, std::ostream& out) {
  const std::string& name = term.factors.front().field->name;
  switch (term.kind) {
    case RegressionTerm::Kind::kNumeric:
      out << "\tNumericPredictor " << name;
      if (term.exponent != 1.0) out << "; Exponent = " << FormatSixDigits(term.exponent);
      break;
    case RegressionTerm::Kind::kCategorical:
      out << "\tCategoricalPredictor " << name << " = " << term.value->GetString();
      break;
    case RegressionTerm::Kind::kProduct:
      out << "\tPredictorTerm " << name;
      for (std::size_t k = 1; k < term.factors.size(); ++k)
        out << " * " << term.factors[k].field->name;
      break;
  }
  out << "; Coefficient = " << FormatSixDigits(term.coefficient) << "\n";
}

}  // namespace

void RegressionModel::Display(std::ostream& out) const {
  out << "Start RegressionModel Display:\n";
  out << "Function = " << (GetFrame().is_classification ? "classification" : "regression")
      << "; Normalization = " << NormalizationText(definition_.normalization);
  if (!GetTargetName().empty()) out << "; Target = " << GetTargetName();
  out << "\n";
  for (const RegressionTable& table : definition_.tables) {
    out << "Table";
    if (table.category != nullptr) out << " " << table.category->GetString();
    out << "; Intercept = " << FormatSixDigits(table.intercept) << "\n";
    for (const RegressionTerm& term : table.terms)
      DisplayTerm(term, out);
  }
  out << "End of RegressionModel Display.\n\n";
}

}  // namespace MCKestrel_800
