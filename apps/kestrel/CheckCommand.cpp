#include "apps/kestrel/CheckCommand.h"

#include <memory>

#include "apps/kestrel/InputFile.h"
#include "apps/kestrel/LoadedModel.h"
#include "apps/kestrel/OutputFile.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/model/ScoreModel.h"

namespace kestrel_program {

ExitCode Check(const std::string& model, const std::string& names_file) {
  const std::unique_ptr<MCKestrel_800::ScoreModel> loaded = LoadModel(model, names_file);
  const std::size_t inputs = loaded->GetPredictors().size();
  const MCKestrel_800::ScoreDictVar* target = loaded->GetTargetVar();
  OutputFile output("-");
  output.GetBuffer() +=
      (IsStandardStream(model) ? "standard input" : model) + ": good: " + loaded->GetModelKind() + " with " +
      std::to_string(inputs) + (inputs == 1 ? " input" : " inputs") +
      (target == nullptr ? std::string(", no target") : ", target " + target->GetName()) + "\n";
  output.Finish();
  return kDone;
}

}  // namespace kestrel_program
