// Bytes as a whole document: either a proper refusal, or a model that scores.

#include <cstdint>
#include <iterator>
#include <memory>
#include <sstream>
#include <string>

#include "fuzz/Check.h"
#include "fuzz/CheckFault.h"
#include "fuzz/NullStream.h"
#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/dictionary/ScoreValueLabel.h"
#include "kestrel/dictionary/ScoreValueLabelSet.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/model/ModelFactory.h"
#include "kestrel/model/ResultEntities.h"
#include "kestrel/model/ScoreModel.h"
#include "kestrel/model/ScoreResult.h"

namespace {

using namespace MCKestrel_800;
using kestrel_fuzz::Check;

const char* const kKinds[] = {"RegressionModel", "TreeModel", "RuleSetModel"};

/// A new value of the variable's storage kind.
ScoreValue* MakeValue(const ScoreDictVar& variable) {
  switch (variable.GetVarType()) {
    case ScoreDictVar::STRING_VAR:
      return new StringValue("a");
    case ScoreDictVar::kDATETIME_VAR:
      return new DateTimeValue(86400.0, kDateTimeVal);
    default:
      return new NumericValue(1.5);
  }
}

void AddInputs(const ScoreModel& model, bool firstCategories, CaseRecord& record) {
  for (const ScoreDictVar* variable : model.GetPredictors()) {
    if (variable == nullptr) continue;
    const ScoreValueLabelSet* labels = variable->GetValueLabels();
    const bool category = firstCategories && labels != nullptr && labels->Size() > 0;
    record.Add(variable->GetName(),
               category ? labels->GetAllValueLabels().front()->GetValue()->Clone() : MakeValue(*variable));
  }
}

std::string Answer(MCScore::MCStatus status, const ScoreResult& result) {
  std::ostringstream out;
  out << status.GetErrorCode() << ' ';
  const ScoreValue* prediction = result.GetPrediction();
  out << (prediction == nullptr ? "nothing" : prediction->GetString()) << ' ' << result.GetProbability();
  return out.str();
}

void ScoreTwice(ScoreModel& model, const CaseRecord& record) {
  const std::unique_ptr<ScoreResult> result(model.MakeResult());
  Check(result != nullptr, "a model makes results");
  ResultEntities* const entities = ResultEntities::Of(result.get());
  if (entities != nullptr) entities->SetPathWanted(true);
  const MCScore::MCStatus first = model.Score(&record, result.get());
  const std::string answer = Answer(first, *result);
  const MCScore::MCStatus second = model.Score(&record, result.get());
  Check(Answer(second, *result) == answer, "a case that is scored again gets the same answer");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  std::istringstream in(std::string(reinterpret_cast<const char*>(data), size));
  try {
    const std::unique_ptr<ScoreModel> model(
        ModelFactory::MakeModelFromXML(in, {std::begin(kKinds), std::end(kKinds)}, ""));
    Check(model != nullptr, "a document that is not refused gives a model");
    ScoreTwice(*model, CaseRecord());
    for (const bool firstCategories : {false, true}) {
      CaseRecord record;
      AddInputs(*model, firstCategories, record);
      ScoreTwice(*model, record);
    }
    kestrel_fuzz::NullStream out;
    model->Display(out);
    if (model->GetDictionary() != nullptr) model->GetDictionary()->Display(out);
  } catch (const KestrelException& fault) {
    kestrel_fuzz::CheckFault(fault);
  }
  return 0;
}

/// Opens the model libraries before the first case: libFuzzer counts only code that is there when it starts.
extern "C" int LLVMFuzzerInitialize(int*, char***) {
  for (const char* kind : kKinds) {
    const std::string document = "<PMML><" + std::string(kind) + "/></PMML>";
    LLVMFuzzerTestOneInput(reinterpret_cast<const uint8_t*>(document.data()), document.size());
  }
  return 0;
}
