#include "plugins/regression/RegressionEquation.h"

#include <cmath>

namespace MCKestrel_800 {
namespace {

// In front of each table of coefficients: one for a missing category (code -2), one for any other value (-1).
constexpr std::size_t kCodesBelowZero = 2;

// A table of coefficients is worth its room when at least this share of a field's categories has one; so the
// tables of an equation never take more room than a few times its terms.
constexpr std::size_t kTableShare = 4;

}  // namespace

RegressionEquation::RegressionEquation(const RegressionTable& table, CaseVector& inputs)
    : table_(&table), intercept_(table.intercept) {
  for (const RegressionTerm& term : table.terms)
    ClaimInputs(term, inputs);
}

void RegressionEquation::ClaimInputs(const RegressionTerm& term, CaseVector& inputs) {
  if (term.kind == RegressionTerm::Kind::kCategorical) {
    const int slot = inputs.AddCategory(*term.factors.front().field);
    claimed_.push_back(slot);
    claimed_.push_back(inputs.AddCategoryValue(slot, *term.value));
    return;
  }
  for (const RegressionTerm::Factor& factor : term.factors) {
    claimed_.push_back(inputs.AddNumber(*factor.field, factor.map_missing_to));
  }
}

void RegressionEquation::Compile(const CaseVector& inputs) {
  std::size_t claim = 0;
  const std::vector<RegressionTerm>& terms = table_->terms;
  for (std::size_t i = 0; i < terms.size();) {
    const RegressionTerm& term = terms[i];
    if (term.kind == RegressionTerm::Kind::kCategorical) {
      // Terms on one field stand together as a rule: they become one look-up.
      std::size_t end = i + 1;
      while (end < terms.size() && terms[end].kind == RegressionTerm::Kind::kCategorical &&
             terms[end].factors.front().field == term.factors.front().field) {
        ++end;
      }
      AddCategories(i, end, claim, inputs);
      claim += 2 * (end - i);
      i = end;
      continue;
    }
    if (term.kind == RegressionTerm::Kind::kProduct) {
      const int begin = static_cast<int>(product_slots_.size());
      for (std::size_t k = 0; k < term.factors.size(); ++k)
        product_slots_.push_back(claimed_[claim + k]);
      products_.push_back({term.coefficient, begin, static_cast<int>(product_slots_.size())});
      AddStep(StepKind::kProduct, products_.size());
    } else if (term.exponent == 1.0) {
      linear_.push_back({term.coefficient, static_cast<std::size_t>(claimed_[claim])});
      AddStep(StepKind::kLinear, linear_.size());
    } else {
      const bool is_whole =
          std::fabs(term.exponent) <= kLargestWhole && term.exponent == std::floor(term.exponent);
      powers_.push_back({term.coefficient, term.exponent, claimed_[claim],
                         is_whole ? static_cast<int>(term.exponent) : kNotWhole});
      AddStep(StepKind::kPower, powers_.size());
    }
    claim += term.factors.size();
    ++i;
  }
  claimed_ = std::vector<int>();
  table_ = nullptr;
}

// Notes that the array of a kind has grown by one: a new step, or one more term of the last.
void RegressionEquation::AddStep(StepKind kind, std::size_t size_after) {
  const int end = static_cast<int>(size_after);
  if (!steps_.empty() && steps_.back().kind == kind) {
    steps_.back().end = end;
  } else {
    steps_.push_back({kind, end - 1, end});
  }
}

void RegressionEquation::AddCategories(std::size_t begin, std::size_t end, std::size_t claim,
                                       const CaseVector& inputs) {
  const int slot = claimed_[claim];
  const std::size_t codes = static_cast<std::size_t>(inputs.GetCodeCount(slot));
  const bool use_table = kTableShare * (end - begin) >= codes;
  const std::size_t zero = coefficients_.size() + kCodesBelowZero;
  if (use_table) coefficients_.resize(zero + codes, 0.0);
  for (std::size_t i = begin; i < end; ++i, claim += 2) {
    const int code = claimed_[claim + 1];
    if (code < 0) continue;  // a value that no case can hold
    const double coefficient = table_->terms[i].coefficient;
    if (use_table) {
      coefficients_[zero + code] += coefficient;
    } else {
      categories_.push_back({coefficient, static_cast<double>(code), slot});
      AddStep(StepKind::kCategory, categories_.size());
    }
  }
  if (use_table) {
    category_tables_.push_back({slot, static_cast<int>(zero)});
    AddStep(StepKind::kCategoryTable, category_tables_.size());
  }
}

// The sum is a chain in the order of the terms; four a turn only spares counting.
inline double RegressionEquation::AddLinear(double y, const Linear* term, const Linear* end,
                                            const double* values) {
  for (; end - term >= 4; term += 4) {
    y += term[0].coefficient * values[term[0].slot];
    y += term[1].coefficient * values[term[1].slot];
    y += term[2].coefficient * values[term[2].slot];
    y += term[3].coefficient * values[term[3].slot];
  }
  for (; term != end; ++term)
    y += term->coefficient * values[term->slot];
  return y;
}

double RegressionEquation::Evaluate(const double* values) const {
  double y = intercept_;
  for (const Step& step : steps_) {
    switch (step.kind) {
      case StepKind::kLinear:
        y = AddLinear(y, linear_.data() + step.begin, linear_.data() + step.end, values);
        break;
      case StepKind::kPower:
        for (int i = step.begin; i < step.end; ++i)
          y += powers_[i].coefficient * Raise(values[powers_[i].slot], powers_[i]);
        break;
      case StepKind::kCategoryTable:
        for (int i = step.begin; i < step.end; ++i) {
          const CategoryTable& table = category_tables_[i];
          y += coefficients_[table.coefficients + static_cast<int>(values[table.slot])];
        }
        break;
      case StepKind::kCategory:
        for (int i = step.begin; i < step.end; ++i) {
          const Category& category = categories_[i];
          y += values[category.slot] == category.code ? category.coefficient : 0.0;
        }
        break;
      case StepKind::kProduct:
        for (int i = step.begin; i < step.end; ++i)
          y += Multiply(products_[i], values);
        break;
    }
  }
  return y;
}

double RegressionEquation::Multiply(const Product& product, const double* values) const {
  double result = values[product_slots_[product.begin]];
  for (int k = product.begin + 1; k < product.end; ++k)
    result *= values[product_slots_[k]];
  return product.coefficient * result;
}

// Whole exponents are multiplied out, which defines them for every base; zero to a negative power is
// infinite, and so is its equation. A broken exponent of a negative base is not a number.
double RegressionEquation::Raise(double base, const Power& power) {
  if (power.whole == kNotWhole) return std::pow(base, power.exponent);
  unsigned left = static_cast<unsigned>(power.whole < 0 ? -power.whole : power.whole);
  double result = 1.0;
  for (double square = base; left != 0; left >>= 1, square *= square) {
    if ((left & 1u) != 0) result *= square;
  }
  return power.whole < 0 ? 1.0 / result : result;
}

}  // namespace MCKestrel_800
