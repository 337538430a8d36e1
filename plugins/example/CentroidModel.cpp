#include <CentroidModel.h>

#include <cmath>
#include <ostream>

#include "kestrel/model/Results.h"

using namespace MCKestrel_800;
namespace centroid {

CentroidModel::CentroidModel(ModelDictionaries dictionaries, ModelFrame frame,
                             std::vector<Centroid> centroids)
    : VectorModel(std::move(dictionaries), std::move(frame), inputs_), centroids_(std::move(centroids)) {
  for (const Centroid& centroid : centroids_) {
    for (const auto& [field, value] : centroid.coordinates)
      terms_.emplace_back(inputs_.AddNumber(*GetFrame().schema.FindInput(field)), value);
  }
  inputs_.Seal(GetFrame().schema, *GetDictionary(), GetTransformationDictionary());
  shares_.resize(centroids_.size());
}

bool CentroidModel::Predict(const double* values, unsigned outcome, ScoreResult& result) {
  if ((outcome & CaseVector::kMissingNumber) != 0) return false;
  std::size_t nearest = 0;
  auto term = terms_.begin();
  for (std::size_t i = 0; i < shares_.size(); ++i) {
    shares_[i] = 0.0;
    for (const auto end = term + inputs_.GetSlotCount(); term != end; ++term)
      shares_[i] += std::pow(values[term->first] - term->second, 2);
    if (shares_[i] < shares_[nearest]) nearest = i;
  }
  const double least = shares_[nearest];
  if (!std::isfinite(least)) return false;
  double sum = 0.0;
  for (double& share : shares_)  // The nearest one's is 1, so that the sum is neither 0 nor infinite.
    sum += share = std::exp((least - share) / 2.0);
  result.SetPrediction(centroids_[nearest].category.get());
  result.SetProbability(shares_[nearest] / sum);
  if (result.GetResultKind() != 0) return true;  // Only a ScoreClsResult, kind 0, has the single categories.
  for (std::size_t i = 0; i < shares_.size(); ++i)
    static_cast<ScoreClsResult&>(result).AddCategoryProbability(centroids_[i].category.get(),
                                                                shares_[i] / sum);
  return true;
}

void CentroidModel::Display(std::ostream& out) const {
  for (const Centroid& centroid : centroids_) {
    out << "Centroid " << centroid.category->GetString() << "\n";
    for (const auto& [field, value] : centroid.coordinates)
      out << "\t" << field << " = " << value << "\n";
  }
}

}  // namespace centroid
