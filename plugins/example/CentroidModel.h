#ifndef CENTROID_CENTROIDMODEL_H
#define CENTROID_CENTROIDMODEL_H

#include <map>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "plugins/support/VectorModel.h"

namespace centroid {

/// The mean case of a category.
struct Centroid {
  std::unique_ptr<MCKestrel_800::ScoreValue> category;
  std::map<std::string, double> coordinates;  ///< by field
};

/// Predicts the category of the nearest centroid by Euclidean distance, of equally near ones the first, and
/// none without a coordinate or a finite distance. A category's probability is exp(-d*d/2) over the sum of
/// that for all, d being the distance: what equal priors and independent normal fields of variance 1 come to.
class CentroidModel : public MCKestrel_800::VectorModel {
 public:
  /// centroids  at least one; all have coordinates of the same fields, inputs of the frame's schema.
  CentroidModel(MCKestrel_800::ModelDictionaries dictionaries, MCKestrel_800::ModelFrame frame,
                std::vector<Centroid> centroids);

  std::string GetModelKind() const override { return "CentroidModel"; }
  void Display(std::ostream& out) const override;

 protected:
  bool Predict(const double* values, unsigned outcome, MCKestrel_800::ScoreResult& result) override;

 private:
  std::vector<Centroid> centroids_;
  MCKestrel_800::CaseVector inputs_;
  std::vector<std::pair<int, double>>
      terms_;                   ///< slot and coordinate: of the first centroid, of the second...
  std::vector<double> shares_;  ///< of the case at hand; kept so that scoring allocates nothing
};

}  // namespace centroid

#endif  // CENTROID_CENTROIDMODEL_H
