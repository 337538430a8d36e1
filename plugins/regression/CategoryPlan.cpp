#include "plugins/regression/CategoryPlan.h"

#include <algorithm>
#include <cmath>
#include <string>
#include <utility>

#include "kestrel/dictionary/DictVar.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/translate/ReaderFault.h"
#include "plugins/regression/LinkFunctions.h"
#include "plugins/support/ValueRules.h"

namespace MCKestrel_800 {
namespace {

[[noreturn]] void FailOnCategory(const ScoreValue& category, const std::string& text) {
  Fail(KestrelException::kStructure, "\"" + category.GetString() + "\"" + text);
}

// How far a probability may lie outside [0, 1] and count as rounded: what the link functions promise.
constexpr double kRounding = 1e-12;

}  // namespace

CategoryPlan::CategoryPlan(Normalization method, const std::vector<RegressionTable>& tables,
                           const ScoreDictVar* target)
    : method_(method) {
  // Without a target the categories are plain texts.
  const DictVar text("target", ScoreDictVar::STRING_VAR);
  ListCategories(tables, target == nullptr ? text : *target);
  ChooseRule(tables, target != nullptr && target->GetMLevel() == ScoreDictVar::kOrdinal);
}

void CategoryPlan::ListCategories(const std::vector<RegressionTable>& tables, const ScoreDictVar& target) {
  ValueRules rules(target);
  // By code: the table, and then where the category stands.
  std::vector<int> table_of_code;
  for (std::size_t i = 0; i < tables.size(); ++i) {
    const ScoreValue& category = *tables[i].category;
    const int code = rules.AddCategory(category);
    // A category that cannot be coded (an infinity) is equal to no other.
    if (code >= 0) {
      if (table_of_code.size() <= static_cast<std::size_t>(code))
        table_of_code.resize(code + 1, kConstantZero);
      if (table_of_code[code] != kConstantZero) FailOnCategory(category, ": Duplicated Category Value!");
      table_of_code[code] = static_cast<int>(i);
    }
    categories_.emplace_back(category.Clone());
    tables_of_categories_.push_back(static_cast<int>(i));
  }
  const ScoreValueLabelSet* labels = target.GetValueLabels();
  if (labels == nullptr || labels->Size() == 0 || target.GetMLevel() == ScoreDictVar::kContinuous) return;
  if (target.GetMLevel() == ScoreDictVar::kOrdinal) {
    categories_.clear();
    tables_of_categories_.clear();
  }
  table_of_code.resize(rules.GetCodeCount(), kConstantZero);
  for (const ScoreValueLabel* label : labels->GetAllValueLabels()) {
    const ScoreValue& value = *label->GetValue();
    const int code = rules.FindCode(value);
    const int table = code < 0 ? kConstantZero : table_of_code[code];
    if (table != kConstantZero && target.GetMLevel() != ScoreDictVar::kOrdinal) continue;
    categories_.emplace_back(value.Clone());
    tables_of_categories_.push_back(table);
  }
}

void CategoryPlan::ChooseRule(const std::vector<RegressionTable>& tables, bool is_ordinal) {
  if (categories_.size() < 2) {
    Fail(KestrelException::kStructure, "Classification needs at least two categories!");
  }
  if (method_ == Normalization::kSoftmax || method_ == Normalization::kSimplemax) {
    PlanShares();
  } else if (categories_.size() == 2) {
    PlanTwoWay(tables);
  } else if (is_ordinal) {
    PlanAllBut(categories_.size() - 1, Rule::kCumulative);
  } else if (method_ == Normalization::kNone) {
    PlanAllBut(categories_.size() - 1, Rule::kRemainder);
  } else {
    PlanOneAgainstRest(tables);
  }
}

void CategoryPlan::PlanShares() {
  rule_ = method_ == Normalization::kSoftmax ? Rule::kShares : Rule::kSimplemax;
  const bool may_be_constant = rule_ == Rule::kShares && categories_.size() == 2;
  for (std::size_t j = 0; j < categories_.size(); ++j) {
    if (tables_of_categories_[j] == kConstantZero && !may_be_constant) {
      FailOnCategory(*categories_[j], ": RegressionTable is required for each category!");
    }
    equations_.push_back(tables_of_categories_[j]);
  }
}

void CategoryPlan::PlanTwoWay(const std::vector<RegressionTable>& tables) {
  rule_ = Rule::kTwoWay;
  const bool first_is_reference = tables.size() == 2 && tables[0].IsReference() && !tables[1].IsReference();
  const int table = first_is_reference ? 1 : 0;
  equations_.push_back(table);
  first_category_ = tables_of_categories_[0] == table ? 0 : 1;
}

void CategoryPlan::PlanOneAgainstRest(const std::vector<RegressionTable>& tables) {
  const std::size_t last = categories_.size() - 1;
  // Categories without table stand last; PlanAllBut refuses more than one.
  if (tables_of_categories_[last] == kConstantZero) return PlanAllBut(last, Rule::kRemainder);
  std::size_t reference = 0;
  int references = 0;
  for (std::size_t j = 0; j <= last; ++j) {
    if (!tables[tables_of_categories_[j]].IsReference()) continue;
    reference = j;
    ++references;
  }
  if (references == 1) return PlanAllBut(reference, Rule::kRemainder);
  rule_ = Rule::kShares;
  equations_ = tables_of_categories_;
}

void CategoryPlan::PlanAllBut(std::size_t category, Rule rule) {
  rule_ = rule;
  rest_category_ = category;
  for (std::size_t j = 0; j < categories_.size(); ++j) {
    if (j == category) continue;
    if (tables_of_categories_[j] == kConstantZero) {
      FailOnCategory(*categories_[j], ": RegressionTable is required for each category!");
    }
    equations_.push_back(tables_of_categories_[j]);
  }
}

bool CategoryPlan::ComputeProbabilities(const double* values, double* probabilities) const {
  switch (rule_) {
    case Rule::kShares:
      LinkShares(method_ == Normalization::kSoftmax ? Normalization::kExp : method_, values,
                 categories_.size(), probabilities);
      return true;
    case Rule::kSimplemax:
      if (!Simplemax(values, probabilities)) return false;
      break;
    case Rule::kTwoWay:
      probabilities[first_category_] = LinkBelow(method_, values[0]);
      probabilities[1 - first_category_] = LinkAbove(method_, values[0]);
      break;
    case Rule::kRemainder:
      Remainder(values, probabilities);
      break;
    case Rule::kCumulative:
      Cumulate(values, probabilities);
      break;
  }
  return Settle(probabilities);
}

// False for what cannot be probabilities, and what rounding put outside [0, 1] is cut off.
bool CategoryPlan::Settle(double* probabilities) const {
  for (std::size_t j = 0; j < categories_.size(); ++j) {
    double& p = probabilities[j];
    if (!std::isfinite(p)) return false;
    if (method_ == Normalization::kNone || method_ == Normalization::kSimplemax) continue;
    if (p < -kRounding || p > 1.0 + kRounding) return false;
    p = std::clamp(p, 0.0, 1.0);
  }
  return true;
}

bool CategoryPlan::Simplemax(const double* values, double* probabilities) const {
  const std::size_t count = categories_.size();
  double sum = 0.0;
  for (std::size_t j = 0; j < count; ++j)
    sum += values[j];
  if (sum == 0.0 || !std::isfinite(sum)) return false;
  for (std::size_t j = 0; j < count; ++j)
    probabilities[j] = values[j] / sum;
  return true;
}

// The largest F is not taken off 1 but asked for its own complement, which keeps the digits of small rests.
void CategoryPlan::Remainder(const double* values, double* probabilities) const {
  const double* const largest = std::max_element(values, values + equations_.size());
  double rest = LinkAbove(method_, *largest);
  double* out = probabilities;
  for (const double* y = values; y != values + equations_.size(); ++y, ++out) {
    if (out == probabilities + rest_category_) ++out;
    *out = LinkBelow(method_, *y);
    if (y != largest) rest -= *out;
  }
  probabilities[rest_category_] = rest;
}

void CategoryPlan::Cumulate(const double* values, double* probabilities) const {
  const std::size_t last = categories_.size() - 1;
  probabilities[0] = LinkBelow(method_, values[0]);
  for (std::size_t j = 1; j < last; ++j)
    probabilities[j] = LinkBetween(method_, values[j - 1], values[j]);
  probabilities[last] = LinkAbove(method_, values[last - 1]);
}

}  // namespace MCKestrel_800
