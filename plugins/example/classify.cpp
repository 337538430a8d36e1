#include <fstream>
#include <iostream>
#include <memory>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/Results.h"
#include "kestrel/model/ScoreModel.h"

using namespace MCKestrel_800;

int main() {
  std::ifstream document("model.xml", std::ios::binary);
  const std::unique_ptr<ScoreModel> model(ModelFactory::MakeModelFromXML(document, {"CentroidModel"}, ""));
  CaseRecord flower(2);
  flower.Add("petal_length", new NumericValue(4.7));
  flower.Add("petal_width", new NumericValue(1.2));
  const std::unique_ptr<ScoreResult> result(model->MakeResult());
  if (!model->Score(&flower, result.get()).IsOK()) return 1;
  std::cout << result->GetPrediction()->GetString() << ' ' << result->GetProbability() << '\n';
}
