// The smallest host: loads a model, fills one case, scores it and prints what the model says.

#include <fstream>
#include <iostream>
#include <memory>

#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/Results.h"
#include "kestrel/model/ScoreModel.h"

using namespace MCKestrel_800;

int main(int argc, char** argv) {
  if (argc != 2) {
    std::cerr << "usage: score_iris MODEL\n";
    return 2;
  }
  try {
    std::ifstream document(argv[1], std::ios::binary);
    const std::unique_ptr<ScoreModel> model(
        ModelFactory::MakeModelFromXML(document, {"RegressionModel"}, std::string()));

    // One slot per input, filled by position for each case; the record owns the values.
    CaseRecord flower(4);
    for (const char* name : {"sepal_length", "sepal_width", "petal_length", "petal_width"}) {
      flower.Add(name, new NumericValue());
    }
    flower.SetValue(0, 6.1);
    flower.SetValue(1, 2.8);
    flower.SetValue(2, 4.7);
    flower.SetValue(3, 1.2);

    const std::unique_ptr<ScoreResult> result(model->MakeResult());
    const MCScore::MCStatus status = model->Score(&flower, result.get());
    if (!status.IsOK()) {
      std::cerr << "the case could not be scored: status " << status.GetErrorCode() << '\n';
      return 1;
    }
    std::cout << result->GetPrediction()->GetString() << ' ' << result->GetProbability() << '\n';
  } catch (const KestrelException& fault) {
    std::cerr << argv[1] << ": " << fault.GetErrorMessage() << '\n';
    return 3;
  }
  return 0;
}
