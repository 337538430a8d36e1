// One equation of a RegressionModel as its document gives it, names resolved and texts converted.

#ifndef KESTREL_PLUGINS_REGRESSION_REGRESSIONTABLE_H
#define KESTREL_PLUGINS_REGRESSION_REGRESSIONTABLE_H

#include <limits>
#include <memory>
#include <vector>

#include "kestrel/foundation/ScoreValue.h"
#include "plugins/support/MiningField.h"

namespace MCKestrel_800 {

/// One summand of an equation.
struct RegressionTerm {
  enum class Kind {
    kNumeric,      ///< `NumericPredictor`: coefficient * field ^ exponent
    kCategorical,  ///< `CategoricalPredictor`: coefficient where the field holds `value`, else 0
    kProduct       ///< `PredictorTerm`: coefficient * product of the fields
  };

  struct Factor {
    const MiningField* field = nullptr;
    /// What a `FieldRef` puts in place of a missing value; NaN for none.
    double map_missing_to = std::numeric_limits<double>::quiet_NaN();
  };

  Kind kind = Kind::kNumeric;
  double coefficient = 0.0;
  double exponent = 1.0;
  std::vector<Factor> factors;        ///< one, but for products
  std::unique_ptr<ScoreValue> value;  ///< of categorical terms
};

/// A `RegressionTable`, its terms in document order.
struct RegressionTable {
  std::unique_ptr<ScoreValue>
      category;  ///< `targetCategory`, of the target's type; null when it is not given
  double intercept = 0.0;
  std::vector<RegressionTerm> terms;

  /// Whether the equation is constantly zero, as producers write it for a reference category.
  bool IsReference() const { return terms.empty() && intercept == 0.0; }
};

}  // namespace MCKestrel_800

#endif  // KESTREL_PLUGINS_REGRESSION_REGRESSIONTABLE_H
