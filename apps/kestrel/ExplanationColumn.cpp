#include "apps/kestrel/ExplanationColumn.h"

#include "apps/kestrel/TableWriter.h"
#include "kestrel/model/ResultEntities.h"

namespace kestrel_program {

using MCKestrel_800::ResultEntities;

ExplanationColumn::ExplanationColumn(MCKestrel_800::ScoreResult* result)
    : entities_(ResultEntities::Of(result)) {
  if (entities_ != nullptr) entities_->SetPathWanted(true);
}

void ExplanationColumn::BeginCase() {
  if (entities_ != nullptr) entities_->Reset();
}

bool ExplanationColumn::HasPath() const {
  return entities_ != nullptr && entities_->GetPathLength() > 0;
}

void ExplanationColumn::Write(TableWriter& writer) {
  if (!HasPath()) return writer.AddMissing();
  path_.clear();
  for (std::size_t i = 0; i < entities_->GetPathLength(); ++i)
    path_.push_back(entities_->GetPathId(i));
  writer.AddList(path_);
}

}  // namespace kestrel_program
