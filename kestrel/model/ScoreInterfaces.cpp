// The destructors of the interfaces. They stand in a source of the core so that the core alone holds the
// classes' type information, which casts and exceptions across libraries go by.

#include "kestrel/model/ScoreClsResult.h"
#include "kestrel/model/ScoreModel.h"
#include "kestrel/model/ScoreRegResult.h"
#include "kestrel/model/ScoreResult.h"
#include "kestrel/model/ScoreVersionInfo.h"

namespace MCKestrel_800 {

ScoreModel::~ScoreModel() = default;
ScoreResult::~ScoreResult() = default;
ScoreClsResult::~ScoreClsResult() = default;
ScoreRegResult::~ScoreRegResult() = default;
ScoreVersionInfo::~ScoreVersionInfo() = default;

}  // namespace MCKestrel_800
