// Random rule sets, scored by the library and by an evaluation that shares nothing with it.

#include <gtest/gtest.h>

#include <memory>
#include <set>
#include <string>

#include "tests/plugins/RuleSetReference.h"
#include "tests/plugins/RuleSetText.h"

namespace {

using namespace MCKestrel_800;
using namespace kestrel_tests;

constexpr unsigned kRuleSets = 2000;
constexpr int kCases = 12;

void FillRecord(const ReferenceCase& cells, CaseRecord& record) {
  for (int field = 0; field < kReferenceFieldCount; ++field) {
    const ReferenceCell& cell = cells[static_cast<size_t>(field)];
    const ReferenceField& row = kReferenceFields[field];
    if (cell.is_missing) {
      record.SetMissingValue(field);
    } else if (row.categories[0] == nullptr) {
      record.SetValue(field, cell.value);
    } else if (std::string(row.type) == "string") {
      record.SetValue(field, std::string(row.categories[static_cast<int>(cell.value)]));
    } else {
      record.SetValue(field, std::stod(row.categories[static_cast<int>(cell.value)]));
    }
  }
}

CaseRecord EmptyRecord() {
  CaseRecord record(kReferenceFieldCount);
  for (const ReferenceField& field : kReferenceFields) {
    if (std::string(field.type) == "string") {
      record.Add(field.name, new StringValue());
    } else {
      record.Add(field.name, new NumericValue());
    }
  }
  return record;
}

ReferenceAnswer AnswerOf(ScoreModel& model, const CaseRecord& record, ScoreResult& result) {
  ReferenceAnswer answer;
  const MCScore::MCStatus status = model.Score(&record, &result);
  if (!status.IsOK()) {
    EXPECT_EQ(status.GetErrorCode(), 90027);
  } else {
    answer.prediction = result.GetPrediction()->GetString();
  }
  answer.probability = result.GetProbability();
  const ResultEntities& entities = *ResultEntities::Of(&result);
  answer.deciding = entities.GetDecidingId();
  for (size_t i = 0; i < entities.GetPathLength(); ++i)
    answer.path.push_back(entities.GetPathId(i));
  if (const auto* categories = dynamic_cast<const ClsResult*>(&result)) {
    for (size_t i = 0; i < categories->GetCategoryCount(); ++i)
      answer.categories.emplace_back(categories->GetCategory(i)->GetString(), categories->GetProbability(i));
  }
  return answer;
}

TEST(RuleSetReference, AgreesOnRandomRuleSets) {
  int scored = 0;
  size_t fired = 0;
  std::set<std::string> predictions;
  CaseRecord record = EmptyRecord();
  for (unsigned seed = 1; seed <= kRuleSets; ++seed) {
    ReferenceRuleSet reference(seed);
    const std::string document = reference.GetDocument();
    const std::unique_ptr<ScoreModel> model = BuildRuleSet(document);
    const std::unique_ptr<ScoreResult> result(model->MakeResult());
    ResultEntities::Of(result.get())->SetPathWanted(true);
    for (int i = 0; i < kCases; ++i) {
      const ReferenceCase cells = reference.MakeCase();
      FillRecord(cells, record);
      const ReferenceAnswer wanted = reference.Answer(cells);
      const ReferenceAnswer answer = AnswerOf(*model, record, *result);
      ASSERT_TRUE(answer == wanted) << "seed " << seed << ", case " << i << ": " << ToText(answer)
                                    << " instead of " << ToText(wanted) << "\n"
                                    << document;
      scored += wanted.prediction.empty() ? 0 : 1;
      fired += wanted.path.size();
      predictions.insert(wanted.prediction);
    }
  }
  // The random rule sets are no empty exercise.
  EXPECT_GT(scored, 12000);
  EXPECT_GT(fired, 24000u);
  EXPECT_EQ(predictions.size(), 7u);
}

}  // namespace
