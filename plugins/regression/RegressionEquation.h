// A regression equation compiled for scoring: flat arrays that are walked once per case.

#ifndef KESTREL_PLUGINS_REGRESSION_REGRESSIONEQUATION_H
#define KESTREL_PLUGINS_REGRESSION_REGRESSIONEQUATION_H

#include <cstddef>
#include <vector>

#include "plugins/regression/RegressionTable.h"
#include "plugins/support/CaseVector.h"

namespace MCKestrel_800 {

/// Intercept plus terms, summed in document order, so that the digits are those of whoever wrote the
/// document.
///
/// Made in two steps, because the number of categories of a field is known only after all equations asked for
/// theirs: the constructor claims the inputs, Compile lays the terms out after CaseVector::Seal.
class RegressionEquation {
 public:
  /// Claims the inputs of the table's terms. The table must live until Compile.
  RegressionEquation(const RegressionTable& table, CaseVector& inputs);

  /// Lays the terms out. `inputs` is the sealed vector that the constructor got.
  void Compile(const CaseVector& inputs);

  /// The equation's value for a case. values  the case's inputs by slot; no number among them may be missing.
  /// A missing category adds nothing. Not finite where a power or a product has no finite value.
  double Evaluate(const double* values) const;

 private:
  enum class StepKind { kLinear, kPower, kCategoryTable, kCategory, kProduct };
  /// A run of neighbouring terms of one kind, as a range of the array for that kind.
  struct Step {
    StepKind kind;
    int begin;
    int end;
  };
  struct Linear {
    double coefficient;
    std::size_t slot;
  };
  struct Power {
    double coefficient;
    double exponent;
    int slot;
    int whole;  ///< the exponent when it is a small whole number, else kNotWhole
  };
  struct CategoryTable {
    int slot;
    int coefficients;  ///< where the coefficient of code 0 stands
  };
  struct Category {
    double coefficient;
    double code;
    int slot;
  };
  struct Product {
    double coefficient;
    int begin;
    int end;
  };
  static constexpr int kNotWhole = 1 << 20;
  static constexpr double kLargestWhole = 1024.0;

  void ClaimInputs(const RegressionTerm& term, CaseVector& inputs);
  void AddStep(StepKind kind, std::size_t size_after);
  void AddCategories(std::size_t begin, std::size_t end, std::size_t claim, const CaseVector& inputs);
  double Multiply(const Product& product, const double* values) const;
  static double AddLinear(double y, const Linear* term, const Linear* end, const double* values);
  static double Raise(double base, const Power& power);

  const RegressionTable* table_;
  std::vector<int>
      claimed_;  ///< until Compile: each term's slots, and after a categorical term's slot its code
  double intercept_;
  std::vector<Step> steps_;
  std::vector<Linear> linear_;
  std::vector<Power> powers_;
  std::vector<CategoryTable> category_tables_;
  std::vector<double> coefficients_;
  std::vector<Category> categories_;
  std::vector<Product> products_;
  std::vector<int> product_slots_;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_REGRESSION_REGRESSIONEQUATION_H
