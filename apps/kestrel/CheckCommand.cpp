#include "apps/kestrel/CheckCommand.h"

#include "apps/kestrel/InputFile.h"
#include "apps/kestrel/LoadedModel.h"
#include "apps/kestrel/OutputFile.h"
#include "apps/kestrel/ProgramError.h"
#include "kestrel/dictionary/ScoreDictVar.h"

namespace kestrel_program {

namespace {

std::string Counted(std::size_t count, const char* what) {
  return std::to_string(count) + " " + what + (count == 1 ? "" : "s");
}

std::string Summarize(const LoadedDocument& document) {
  if (document.legacy != nullptr) {
    const std::string fields = Counted(document.legacy->Size(), "field");
    return document.refusal.empty() ? "good: " + fields + ", no model" : "dictionary of " + fields;
  }
  if (document.model == nullptr) {
    return "good: " + Counted(document.fields.derived->GetDerivedVarNames().size(), "derived field") +
           ", no model";
  }
  const MCKestrel_800::ScoreDictVar* target = document.model->GetTargetVar();
  return "good: " + document.model->GetModelKind() + " with " +
         Counted(document.model->GetPredictors().size(), "input") +
         (target == nullptr ? std::string(", no target") : ", target " + target->GetName());
}

}  // namespace

ExitCode Check(const std::string& model, const std::string& names_file) {
  const LoadedDocument document = LoadDocument(model, names_file);
  OutputFile output("-");
  output.GetBuffer() +=
      (IsStandardStream(model) ? "standard input" : model) + ": " + Summarize(document) + "\n";
  output.Finish();
  if (!document.refusal.empty()) throw ProgramError(kDocument, document.refusal);
  return kDone;
}

}  // namespace kestrel_program
