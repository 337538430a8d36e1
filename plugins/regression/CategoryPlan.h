// How a classification's equations become probabilities of categories.

#ifndef KESTREL_PLUGINS_REGRESSION_CATEGORYPLAN_H
#define KESTREL_PLUGINS_REGRESSION_CATEGORYPLAN_H

#include <cstddef>
#include <memory>
#include <vector>

#include "kestrel/foundation/ScoreValue.h"
#include "plugins/regression/Normalization.h"
#include "plugins/regression/RegressionTable.h"

namespace MCKestrel_800 {

class ScoreDictVar;

/// The categories in the order of results, and the equations that are evaluated for them.
///
/// The categories are those of the tables, in document order; of an ordinal target with a list of values they
/// stand in the list's order. With y the values of the equations and F the method's function (see
/// LinkFunctions.h):
///
///   softmax, simplemax
///     p_j = exp(y_j) / sum exp(y_i), p_j = y_j / sum y_i; one table a category. A single table with softmax
///     serves a target with two values: the other's y is 0. These two do not depend on an order and so serve
///     ordinal targets as well.
///   other methods, two values
///     p = F(y) for one category, 1 - p for the other. The equation is the single table, or the first of two;
///     the second when the first is constantly zero, as producers write it for a reference category that
///     happens to come first.
///   other methods, three or more values of an ordinal target
///     p_1 = F(y_1), p_j = F(y_j) - F(y_(j-1)), and the last category has 1 - F(y_(k-1)). A table for the
///     last category is not evaluated and may be absent.
///   "none", three or more values of another target
///     p_j = y_j, and the last category has what is left of 1. A table for the last category is not
///     evaluated; one value of the target may be without table.
///   the links and "exp", three or more values of another target
///     One equation a category, each fitted to that category against the rest: p_j = F(y_j) / sum F(y_i).
///     One value of the target may be without table, or one table be constantly zero: that category is the
///     reference and has what is left of 1, 1 - sum F(y_i) over the others.
///
/// The PMML standard gives F(y_j) for each category of the last kind and leaves open that they do not sum to
/// 1. The programs that train one model a category against the rest divide by the sum, so that is what their
/// documents mean. A reference category is fitted by no equation: there the others' F are the probabilities
/// themselves.
///
/// "exp" has no upper bound, thresholds of an ordinal target may cross, and the F of several equations may
/// sum to more than 1. A probability outside [0, 1] by more than rounding (1e-12; less than that is cut off)
/// means that the equations do not fit the case, and it has none. "none" and "simplemax" bound nothing: what
/// their equations give stands.
class CategoryPlan {
 public:
  /// Which table an equation comes from; kConstantZero is an equation without table.
  static constexpr int kConstantZero = -1;

  /// Makes the plan of a model.
  /// tables  all of the model's, each with its category; not kept, but `GetEquations` speaks of positions in
  ///         it.
  /// target  null when the model has none.
  /// Errors (KestrelException without place): code 1 for categories given twice or missing.
  CategoryPlan(Normalization method, const std::vector<RegressionTable>& tables, const ScoreDictVar* target);

  /// The categories, of the target's type, in the order of results.
  const std::vector<std::unique_ptr<ScoreValue>>& GetCategories() const { return categories_; }

  /// The equations to be evaluated, each as the position of its table or kConstantZero.
  const std::vector<int>& GetEquations() const { return equations_; }

  /// Turns the equations' values into probabilities, in the order of GetCategories(). All `values` are
  /// finite. False when there are none: the shares of a sum that is zero, a number that is not finite, or a
  /// probability outside [0, 1] as said above.
  bool ComputeProbabilities(const double* values, double* probabilities) const;

 private:
  enum class Rule { kShares, kSimplemax, kTwoWay, kRemainder, kCumulative };

  void ListCategories(const std::vector<RegressionTable>& tables, const ScoreDictVar& target);
  void ChooseRule(const std::vector<RegressionTable>& tables, bool is_ordinal);
  void PlanShares();
  void PlanTwoWay(const std::vector<RegressionTable>& tables);
  void PlanOneAgainstRest(const std::vector<RegressionTable>& tables);
  void PlanAllBut(std::size_t category, Rule rule);
  bool Simplemax(const double* values, double* probabilities) const;
  void Remainder(const double* values, double* probabilities) const;
  void Cumulate(const double* values, double* probabilities) const;
  bool Settle(double* probabilities) const;

  const Normalization method_;
  Rule rule_ = Rule::kShares;
  std::vector<std::unique_ptr<ScoreValue>> categories_;
  /// By category: its table's position, or kConstantZero where it has none.
  std::vector<int> tables_of_categories_;
  std::vector<int> equations_;
  /// Of a two-way rule: the category whose probability is F(y).
  std::size_t first_category_ = 0;
  /// Of a remainder: the category that has what is left of 1.
  std::size_t rest_category_ = 0;
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_REGRESSION_CATEGORYPLAN_H
