// A model and a translator for the libraries that the factory's tests load. The model tells by Display which
// operation built it and with what.

#ifndef KESTREL_TESTS_MODEL_PLUGINS_STUBMODEL_H
#define KESTREL_TESTS_MODEL_PLUGINS_STUBMODEL_H

#include <memory>
#include <ostream>
#include <string>
#include <utility>
#include <vector>
#include <xercesc/dom/DOMElement.hpp>

#include "kestrel/foundation/NumericValue.h"
#include "kestrel/model/BaseModel.h"
#include "kestrel/model/Results.h"
#include "kestrel/translate/XmlText.h"

namespace kestrel_stub {

using namespace MCKestrel_800;

/// Scores every case with 42.
class StubModel : public BaseModel {
 public:
  StubModel(std::string kind, std::string story) : kind_(std::move(kind)), story_(std::move(story)) {}

  MCScore::MCStatus Score(const ScoreCaseRecord*, ScoreResult* result) override {
    result->Reset();
    const NumericValue prediction(42.0);
    result->SetPrediction(&prediction);
    return MCScore::MCStatus();
  }
  std::vector<const ScoreDictVar*> GetPredictors() const override { return {}; }
  ScoreResult* MakeResult() const override { return new RegResult; }
  std::string GetModelKind() const override { return kind_; }
  bool SuppressCategoryProbabilities() const override { return false; }
  void Display(std::ostream& out) const override { out << story_; }

 private:
  std::string kind_;
  std::string story_;
};

inline std::string TagOf(const xercesc::DOMElement* element) {
  return element == nullptr ? "none" : Narrow(element->getTagName());
}

}  // namespace kestrel_stub

#endif  // KESTREL_TESTS_MODEL_PLUGINS_STUBMODEL_H
