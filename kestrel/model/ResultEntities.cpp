#include "kestrel/model/ResultEntities.h"

#include <typeinfo>

#include "kestrel/model/Results.h"

namespace MCKestrel_800 {

ResultEntities::ResultEntities() = default;
ResultEntities::~ResultEntities() = default;

// Models ask for every case. Nearly all results are of one of the two classes themselves, whose descriptions
// have one address each; comparing that costs far less than to search the bases, or to compare names.
ResultEntities* ResultEntities::Of(ScoreResult* result) {
  if (result == nullptr) return nullptr;
  const std::type_info* const type = &typeid(*result);
  if (type == &typeid(ClsResult)) return &static_cast<ClsResult*>(result)->GetEntities();
  if (type == &typeid(RegResult)) return &static_cast<RegResult*>(result)->GetEntities();
  if (auto* classification = dynamic_cast<ClsResult*>(result)) return &classification->GetEntities();
  if (auto* regression = dynamic_cast<RegResult*>(result)) return &regression->GetEntities();
  return nullptr;
}

void ResultEntities::AddToPath(std::string_view id) {
  if (!path_wanted_) return;
  if (path_length_ < path_.size()) {
    path_[path_length_].assign(id);
  } else {
    path_.emplace_back(id);
  }
  ++path_length_;
}

}  // namespace MCKestrel_800
