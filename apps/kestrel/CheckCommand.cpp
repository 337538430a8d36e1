#include "apps/kestrel/CheckCommand.h"

#include "apps/kestrel/InputFile.h"
#include "apps/kestrel/LoadedModel.h"
#include "apps/kestrel/OutputFile.h"
#include "kestrel/dictionary/ScoreDictVar.h"

namespace kestrel_program {

namespace {

std::string Counted(std::size_t count, const char* what) {
  return std::to_string(count) + " " + what + (count == 1 ? "" : "s");
}

std::string Summarize(const LoadedDocument& document) {
  if (document.model == nullptr) {
    return Counted(document.fields.derived->GetDerivedVarNames().size(), "derived field") + ", no model";
  }
  const MCKestrel_800::ScoreDictVar* target = document.model->GetTargetVar();
  return document.model->GetModelKind() + " with " +
         Counted(document.model->GetPredictors().size(), "input") +
         (target == nullptr ? std::string(", no target") : ", target " + target->GetName());
}

}  // namespace

ExitCode Check(const std::string& model, const std::string& names_file) {
  const LoadedDocument document = LoadDocument(model, names_file);
  OutputFile output("-");
  output.GetBuffer() +=
      (IsStandardStream(model) ? "standard input" : model) + ": good: " + Summarize(document) + "\n";
  output.Finish();
  return kDone;
}

}  // namespace kestrel_program
