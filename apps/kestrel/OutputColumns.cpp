#include "apps/kestrel/OutputColumns.h"

#include <algorithm>

#include "apps/kestrel/PredictionColumns.h"
#include "apps/kestrel/TableWriter.h"
#include "kestrel/dictionary/ScoreDictionary.h"
#include "kestrel/foundation/ScoreValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/model/Results.h"
#include "kestrel/model/ScoreModel.h"
#include "kestrel/translate/ResultVar.h"

namespace kestrel_program {
namespace {

using namespace MCKestrel_800;

bool IsMissing(const ScoreValue* value) {
  if (value == nullptr || value->IsSystemMissingValue()) return true;
  const auto* text = dynamic_cast<const StringValue*>(value);
  return text != nullptr && text->GetText().empty();
}

}  // namespace

bool ComparesWithTrueValue(const ScoreModel& model) {
  const ScoreDictionary* dictionary = model.GetResultDictionary();
  if (dictionary == nullptr) return false;
  const std::vector<std::string> names = dictionary->GetVarNames();
  return std::any_of(names.begin(), names.end(), [dictionary](const std::string& name) {
    const auto* field = dynamic_cast<const ResultVar*>(dictionary->GetVar(name));
    return field != nullptr && field->GetFeature() == ScoreResultField::kResidual;
  });
}

OutputColumns::OutputColumns(const ScoreModel& model, ScoreResult* result) : fields_(OutputFieldsOf(result)) {
  const ScoreDictionary* dictionary = model.GetResultDictionary();
  if (fields_ == nullptr || dictionary == nullptr) return;
  names_ = dictionary->GetVarNames();
  values_.resize(names_.size());
}

OutputColumns::~OutputColumns() = default;

void OutputColumns::BeginCase() {
  if (!names_.empty()) fields_->ClearValues();
}

void OutputColumns::Write(TableWriter& writer) {
  if (names_.empty()) return;
  if (fields_->GetLayoutStamp() != layout_stamp_) FindValues();
  for (const ScoreValue* value : values_) {
    if (IsMissing(value)) {
      writer.AddMissing();
    } else {
      WriteValue(*value, writer);
    }
  }
}

void OutputColumns::FindValues() {
  for (std::size_t i = 0; i < names_.size(); ++i)
    values_[i] = fields_->GetResultValue(names_[i]);
  layout_stamp_ = fields_->GetLayoutStamp();
}

}  // namespace kestrel_program
